// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertFalse;
import static org.junit.jupiter.api.Assertions.assertThrows;
import static org.junit.jupiter.api.Assertions.assertTrue;

import com.quintora.mmp.Media;
import com.quintora.mmp.PlayerState;
import com.quintora.mmp.Wait;
import java.util.concurrent.FutureTask;
import java.util.concurrent.TimeUnit;
import java.util.concurrent.atomic.AtomicLong;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.params.ParameterizedTest;
import org.junit.jupiter.params.provider.CsvSource;

/** Where seeks and steps of a session end, what shows then, and who waits for them. */
class SessionSeekTest {
    private final AtomicLong shownNs = new AtomicLong(-1);

    /** The times are those of the frames, 30 a second; key frames are 15 seconds apart. */
    @ParameterizedTest
    @CsvSource({"0, 0", "1000, 1000", "12345, 12333", "14999, 15000", "29967, 29967",
        "60000, 29967"})
    void aSeekEndsAtTheFrameThatIsShownThen(int millis, int frame) throws Exception {
        try (Session session = open("distant.mkv")) {
            assertEquals(frame, session.seekTo(millis), 1);
            assertFalse(session.snapshot().playing());
            awaitShown(frame);
        }
    }

    /** There is no frame but that one to be seen. */
    @Test
    void aKeyFrameShowsWhereASeekNeedsNoStep() throws Exception {
        try (Session session = open("distant.mkv")) {
            for (int millis : new int[] {1_000, 15_000, 2_000, 0, 15_000}) {
                session.seekTo(millis);
                awaitShown(millis);
            }
        }
    }

    @Test
    void aStartIsExactAndWaitsThere() throws Exception {
        try (Session session = open("distant.mkv", "--start", "12.5")) {
            assertEquals(12_500, session.player().getCurrentPosition(), 1);
            assertFalse(session.snapshot().playing());
            awaitShown(12_500);
            session.start();
            Wait.until("it goes on", () -> session.player().getCurrentPosition() > 13_000);
        }
    }

    /** The sound begins 11 ms before the picture. */
    @ParameterizedTest
    @CsvSource({"stream.ts, 7.33, 7311", "distant.ts, 13.35, 13311", "distant.mpg, 19.935, 19931",
        "stream.vob, 7.335, 7331"})
    void aStartInABroadcastIsExact(String media, String start, int frame) throws Exception {
        try (Session session = open(media, "--start", start)) {
            assertEquals(frame, session.player().getCurrentPosition(), 1);
            awaitShown(frame);
        }
    }

    @Test
    void aSeekInSoundAloneIsOne() throws Exception {
        try (Session session = open("tone.flac")) {
            assertEquals(1_000, session.seekTo(1_000), 150);
        }
    }

    @Test
    void stepsAreFrames() throws Exception {
        try (Session session = open("distant.mkv", "--start", "12")) {
            session.step(2);
            assertEquals(12_067, session.player().getCurrentPosition(), 1);
            session.step(-1);
            assertEquals(12_033, session.player().getCurrentPosition(), 1);
            awaitShown(12_033);
            session.seekTo(60_000);
            Failure last = assertThrows(Failure.class, () -> session.step(1));
            assertEquals("this is the last frame", last.getMessage());
        }
    }

    @Test
    void soundHasNothingToStepThrough() throws Exception {
        try (Session session = open("tone.flac")) {
            Failure none = assertThrows(Failure.class, () -> session.step(1));
            assertEquals("the media has no picture to step through", none.getMessage());
        }
    }

    @Test
    void whatPlayedPlaysOnAfterASeek() throws Exception {
        try (Session session = open("distant.mkv")) {
            session.start();
            session.seekTo(7_000);
            assertTrue(session.snapshot().playing());
            Wait.until("it goes on", () -> session.player().getCurrentPosition() > 7_500);
        }
    }

    /** The server keeps back what the seek needs, so that it lasts. */
    @Test
    void aPauseDoesNotWaitForASeek() throws Exception {
        try (StallingServer server = new StallingServer(Media.path("long.mkv"), 0.3);
                Session session = openUrl(server.url())) {
            session.start();
            FutureTask<Integer> seek = new FutureTask<>(() -> session.seekTo(50_000));
            Thread seeker = new Thread(seek, "seeker");
            seeker.start();
            Wait.until("it seeks", () -> session.player().getState() == PlayerState.PAUSED);
            assertTrue(session.snapshot().playing(), "a seek is no pause");
            session.togglePlaying();
            session.setVolume(0.5);
            assertFalse(session.snapshot().playing());
            assertFalse(seek.isDone(), "the seek was over before");
            server.goOn();
            seek.get(Wait.LIMIT.toSeconds(), TimeUnit.SECONDS);
            assertEquals(PlayerState.PAUSED, session.player().getState());
        }
    }

    private void awaitShown(int millis) throws Exception {
        Wait.until("its frame shows", () -> Math.abs(shownNs.get() / 1e6 - millis) <= 1);
    }

    private Session open(String media, String... arguments) throws Exception {
        return openUrl(Media.path(media), arguments);
    }

    private Session openUrl(String source, String... arguments) throws Exception {
        String[] all = new String[arguments.length + 1];
        System.arraycopy(arguments, 0, all, 1, arguments.length);
        all[0] = source;
        PlayOptions options = PlayOptions.of(all);
        Session session = new Session(options, image -> shownNs.set(image.getTimestamp()));
        session.open();
        return session;
    }
}
