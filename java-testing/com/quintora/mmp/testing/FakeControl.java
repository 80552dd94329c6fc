// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.testing;

import static com.quintora.mmp.testing.FakeState.requireValue;

import android.view.Surface;
import com.quintora.SubtitleAttr;
import com.quintora.mmp.MediaError;
import com.quintora.mmp.MediaException;
import java.time.Duration;
import java.util.Map;
import java.util.Optional;
import org.jetbrains.annotations.Nullable;

/**
 * What a test does with a {@link FakeMediaPlayer} that programs cannot: lets time pass, orders
 * failures and looks at what was set. Thread-safe; nothing blocks.
 */
public final class FakeControl {
    private final FakeSession session;
    private final FakeSources sources;
    private final FakePreparation preparation;
    private final FakeSeeking seeking;
    private final FakeSubtitles subtitles;
    private @Nullable Surface surface;

    FakeControl(
            FakeSession session, FakeSources sources, FakePreparation preparation,
            FakeSeeking seeking, FakeSubtitles subtitles) {
        this.session = session;
        this.sources = sources;
        this.preparation = preparation;
        this.seeking = seeking;
        this.subtitles = subtitles;
    }

    /**
     * Lets time pass: a prepare comes nearer to its end; a player that plays moves on by the time
     * multiplied with the speed, and completes, or begins again when it is looping, at the end.
     * Played backward the media stay at their start. One call does one of these.
     *
     * @param time how much
     * @throws IllegalArgumentException when it is null or negative
     */
    public void advance(Duration time) {
        if (requireValue(time, "the time").isNegative()) {
            throw new IllegalArgumentException("time does not go back: " + time);
        }
        session.guard.run(() -> {
            session.play(time);
            preparation.pass(time);
        });
    }

    /**
     * Goes to the end of what is played, also when its duration is unknown: a position of 0 then.
     *
     * @throws IllegalStateException unless the player is STARTED
     */
    public void finish() {
        session.guard.run(session::finish);
    }

    /**
     * Chooses what is played from the next prepare on.
     *
     * @param media the media
     * @throws IllegalArgumentException when it is null
     */
    public void setMedia(FakeMedia media) {
        requireValue(media, "the media");
        session.guard.run(() -> session.media = media);
    }

    /**
     * Has the next data source refused.
     *
     * @param error why
     * @throws IllegalArgumentException when it is null
     */
    public void failNextDataSource(MediaError error) {
        requireValue(error, "the error");
        session.guard.run(() -> sources.failNext(error));
    }

    /**
     * Has the next prepare fail, with the sentence that the real player has for it.
     *
     * @param error why
     * @throws IllegalArgumentException when it is null
     */
    public void failNextPrepare(MediaError error) {
        requireValue(error, "the error");
        session.guard.run(() -> preparation.failNext(error));
    }

    /**
     * Has the next prepare fail.
     *
     * @param failure what is thrown, or reported
     * @throws IllegalArgumentException when it is null
     */
    public void failNextPrepare(MediaException failure) {
        requireValue(failure, "the failure");
        session.guard.run(() -> preparation.failNext(failure));
    }

    /**
     * Has the next file of subtitles refused.
     *
     * @param error {@link MediaError#NOT_FOUND}, or another for a file that cannot be read
     * @throws IllegalArgumentException when it is null
     */
    public void failNextSubtitles(MediaError error) {
        requireValue(error, "the error");
        session.guard.run(() -> subtitles.failNext(error));
    }

    /**
     * Has the media fail now: the player goes to ERROR, and the listeners hear why.
     *
     * @param error why
     * @throws IllegalArgumentException when it is null
     * @throws IllegalStateException in IDLE, INITIALIZED, ERROR and RELEASED
     */
    public void fail(MediaError error) {
        requireValue(error, "the error");
        session.guard.run(() -> {
            MediaException failure = FakeFailures.media(sources.name(), error);
            session.fail("fail()", failure);
            preparation.failPending(failure);
        });
    }

    /**
     * Has playing wait for data, or go on.
     *
     * @param waits whether it waits from now on
     * @throws IllegalStateException unless the player is STARTED
     */
    public void setBuffering(boolean waits) {
        session.guard.run(() -> session.setBuffering("setBuffering()", waits));
    }

    /**
     * Says how much of the media is buffered.
     *
     * @param percent 0 to 100
     * @throws IllegalArgumentException for another percentage
     * @throws IllegalStateException when the player has no prepared media
     */
    public void setBufferedPercent(int percent) {
        session.guard.run(() -> session.setBufferedPercent(percent));
    }

    /**
     * Keeps seeks that do not block from coming to their end, or lets them.
     *
     * @param held true to keep them; false to carry out those that wait, and later ones at once
     */
    public void holdSeeks(boolean held) {
        seeking.setHeld(held);
    }

    /**
     * What the program plays.
     *
     * @return the path or URL, or words for another source; empty for none
     */
    public Optional<String> source() {
        return session.guard.ask(() -> Optional.of(sources.name()).filter(name -> !name.isEmpty()));
    }

    /**
     * The headers that the program gave with its URL.
     *
     * @return names and values
     */
    public Map<String, String> headers() {
        return session.guard.ask(sources::headers);
    }

    /**
     * Where the program has the picture drawn.
     *
     * @return the surface; empty for nowhere
     */
    public Optional<Surface> surface() {
        return session.guard.ask(() -> Optional.ofNullable(surface));
    }

    /**
     * How the program last changed the subtitles' look.
     *
     * @return the attributes; empty when it did not
     */
    public Optional<SubtitleAttr> subtitleStyle() {
        return session.guard.ask(() -> Optional.ofNullable(subtitles.style()));
    }

    void setSurface(@Nullable Surface chosen) {
        if (chosen != null && !chosen.isValid()) {
            throw new IllegalArgumentException("The surface has been released");
        }
        surface = chosen;
    }
}
