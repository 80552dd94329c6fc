// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.testing;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertFalse;

import com.quintora.SubtitleAttr;
import com.quintora.mmp.ColorMode;
import com.quintora.mmp.Media;
import com.quintora.mmp.MediaError;
import com.quintora.mmp.PlayerState;
import com.quintora.mmp.Track;
import com.quintora.mmp.internal.failure.Failures;
import java.io.FileDescriptor;
import java.io.IOException;
import java.nio.file.Path;
import java.time.Duration;
import java.util.List;
import java.util.stream.Collectors;
import java.util.stream.IntStream;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.params.ParameterizedTest;
import org.junit.jupiter.params.provider.EnumSource;
import org.junit.jupiter.params.provider.EnumSource.Mode;

/** The same calls on the fake and on the real player are answered and reported alike. */
class ContractTest {
    private interface Script {
        void run(Subject subject) throws Exception;
    }

    private static void compare(String media, Script script) throws Exception {
        try (Subject real = Subject.real(media);
                Subject fake = Subject.fake(media)) {
            script.run(real);
            script.run(fake);
            assertFalse(real.answers.isEmpty());
            assertEquals("", differences(real.answers, fake.answers));
            assertEquals(real.events, fake.events);
        }
    }

    private static String differences(List<String> real, List<String> fake) {
        assertEquals(real.size(), fake.size());
        return IntStream.range(0, real.size())
                .filter(line -> !real.get(line).equals(fake.get(line)))
                .mapToObj(line -> "\nreal " + real.get(line) + "\nfake " + fake.get(line))
                .collect(Collectors.joining());
    }

    private static void prepare(Subject s) throws Exception {
        int before = s.events.size();
        s.run("set", () -> s.player.setDataSource(s.path));
        s.run("prepare", s.player::prepareAndWait);
        s.waitUntil("the size was reported",
                () -> s.events.lastIndexOf("size 320x180") >= before);
    }

    @Test
    void aLifeFromPrepareToRelease() throws Exception {
        compare("short.mp4", s -> {
            s.run("set", () -> s.player.setDataSource(Path.of(s.path)));
            s.call("prepareAsync", s.player::prepareAsync);
            s.waitUntil("the size", () -> s.events.contains("size 320x180"));
            s.call("duration", s.player::getDuration);
            s.call("width", s.player::getVideoWidth);
            s.call("height", s.player::getVideoHeight);
            s.call("seek", () -> s.player.seekTo(2000));
            s.run("start", s.player::start);
            s.playUntil("completion");
            s.call("playing", s.player::isPlaying);
            s.call("position", s.player::getCurrentPosition);
            s.run("pause", s.player::pause);
            s.run("start again", s.player::start);
            s.run("pause", s.player::pause);
            s.call("seek", () -> s.player.seekTo(2000));
            s.run("start", s.player::start);
            s.playUntil("completion");
            s.run("seek and wait", () -> s.player.seekToAndWait(0));
            s.run("stop", s.player::stop);
            s.call("position", s.player::getCurrentPosition);
            s.call("duration", s.player::getDuration);
            s.run("prepare", s.player::prepareAndWait);
            s.waitUntil("prepared", () -> s.events.get(s.events.size() - 1).equals("prepared"));
            s.run("reset", s.player::resetAndWait);
            prepare(s);
            s.call("reset", s.player::reset);
            s.call("release", s.player::release);
            s.call("release", s.player::release);
        });
    }

    @Test
    void loopingGoesOnWithoutACompletion() throws Exception {
        compare("short.mp4", s -> {
            s.run("looping", () -> s.player.setLooping(true));
            prepare(s);
            s.run("seek", () -> s.player.seekToAndWait(2000));
            s.run("start", s.player::start);
            s.waitUntil("it began again", () -> s.player.getCurrentPosition() > 0
                    && s.player.getCurrentPosition() < 1500);
            s.run("pause", s.player::pause);
            s.run("reset", s.player::resetAndWait);
            s.call("looping", s.player::isLooping);
        });
    }

    @Test
    void tracksAreChosenAndRefusedAlike() throws Exception {
        compare("tracks.mkv", s -> {
            prepare(s);
            s.call("audio", () -> s.player.tracks().audio());
            s.call("video", () -> s.player.tracks().video());
            s.call("subtitles", () -> s.player.tracks().subtitles());
            s.call("chapters", () -> s.player.tracks().chapters());
            s.call("metadata", () -> s.player.tracks().metadata());
            Track sound = s.player.tracks().audio().get(1);
            s.call("select", () -> s.player.tracks().select(sound));
            s.call("audio", () -> s.player.tracks().audio());
            s.call("current", () -> s.player.tracks().currentAudio());
            Track text = s.player.tracks().subtitles().get(1);
            s.run("select", () -> s.player.tracks().selectAndWait(text));
            s.call("current", () -> s.player.tracks().currentIndex(Track.Kind.SUBTITLE));
            s.call("none", () -> s.player.tracks().selectNone(Track.Kind.SUBTITLE));
            s.call("current", () -> s.player.tracks().currentSubtitle());
            s.call("none", () -> s.player.tracks().selectNone(Track.Kind.VIDEO));
            s.call("none", () -> s.player.tracks().selectNone(Track.Kind.AUDIO));
            s.run("none", () -> s.player.tracks().selectNoneAndWait(Track.Kind.AUDIO));
            s.run("null", () -> s.player.tracks().selectAndWait(null));
            s.run("null", () -> s.player.tracks().selectNone(null));
            s.run("null", () -> s.player.tracks().currentIndex(null));
        });
    }

    @Test
    void subtitlesAreAddedAndRefusedAlike() throws Exception {
        String lines = Media.path("lines.srt");
        compare("short.mp4", s -> {
            prepare(s);
            s.call("add", () -> s.player.subtitles().add(lines).thenApply(Track::index));
            s.call("current", () -> s.player.tracks().currentIndex(Track.Kind.SUBTITLE));
            s.call("external", () ->
                    s.player.tracks().subtitles().get(0).flags().isExternal());
            s.call("add", () -> s.player.subtitles().addAndWait(lines).index());
            s.call("current", () -> s.player.tracks().currentIndex(Track.Kind.SUBTITLE));
            orderSubtitleFailure(s, MediaError.NOT_FOUND);
            s.call("missing", () -> s.player.subtitles().add("/nowhere.srt"));
            orderSubtitleFailure(s, MediaError.IO);
            s.call("other", () -> s.player.subtitles().addAndWait(Media.path("garbage.bin")));
            s.call("null", () -> s.player.subtitles().add((String) null));
            s.run("style", () -> s.player.subtitles().setStyle(
                    SubtitleAttr.builder().textColor(0xFFFFFF00).build()));
            s.run("null", () -> s.player.subtitles().setStyle(null));
            s.run("reset", s.player::resetAndWait);
            s.call("subtitles", () -> s.player.tracks().subtitles());
        });
    }

    private static void orderSubtitleFailure(Subject s, MediaError error) {
        if (s.isFake()) {
            s.control().failNextSubtitles(error);
        }
    }

    @Test
    void speedsAndStepsAreTakenAndRefusedAlike() throws Exception {
        compare("short.mp4", s -> {
            s.call("can play", () -> s.player.trickPlay().canPlayAt(2));
            s.call("can seek", () -> s.player.trickPlay().canSeekAt(2));
            prepare(s);
            for (double speed : new double[] {1, 0.25, 2, 32, -1, 0, 0.1, 33, -33, Double.NaN}) {
                s.call("can play " + speed, () -> s.player.trickPlay().canPlayAt(speed));
                s.call("can seek " + speed, () -> s.player.trickPlay().canSeekAt(speed));
            }
            s.run("refused", () -> s.player.trickPlay().setSpeed(33));
            s.run("speed", () -> s.player.trickPlay().setSpeed(4));
            s.call("speed", () -> s.player.trickPlay().getSpeed());
            s.run("start", s.player::start);
            s.playUntil("completion");
            s.call("speed", () -> s.player.trickPlay().getSpeed());
            s.run("seek", () -> s.player.seekToAndWait(0));
            s.run("step", () -> s.player.trickPlay().stepAndWait(3));
            s.call("step", () -> s.player.trickPlay().step(-1));
            s.call("repeat", () -> s.player.trickPlay().repeatUntilHere());
            s.call("repeat", () -> s.player.trickPlay().repeatFromHere());
            s.call("repeat", () -> s.player.trickPlay().repeatOff());
            s.call("step too far", () -> s.player.trickPlay().step(100_000));
            s.run("bytes", () -> s.player.trickPlay().seekToByteAndWait(-1));
            s.run("reset", s.player::resetAndWait);
            s.call("speed", () -> s.player.trickPlay().getSpeed());
        });
    }

    @Test
    void soundIsSetAndRefusedAlike() throws Exception {
        compare("short.mp4", s -> {
            s.run("volume", () -> s.player.setVolume(0.5f));
            s.run("volume", () -> s.player.audio().setVolume(0.25f, 1));
            s.call("volume", s.player::getVolume);
            s.run("muted", () -> s.player.audio().setMuted(true));
            s.call("left", () -> s.player.audio().getLeftVolume());
            s.call("muted", () -> s.player.audio().isMuted());
            s.run("too loud", () -> s.player.setVolume(1.5f));
            s.run("no number", () -> s.player.setVolume(Float.NaN));
            s.run("session", () -> s.player.audio().setSessionId(-1));
            s.call("session", () -> s.player.audio().getSessionId());
            s.run("aux", () -> s.player.audio().setAuxEffectSendLevel(2));
        });
    }

    @Test
    void badArgumentsAreRefusedAlike() throws Exception {
        compare("short.mp4", s -> {
            s.run("null", () -> s.player.setDataSource((String) null));
            s.run("null", () -> s.player.setDataSource("/a", null));
            s.run("null", () -> s.player.setDataSource((FileDescriptor) null, 0, 0));
            s.run("null", () -> s.player.setDataSource((Path) null));
            s.run("null", () -> s.player.setPcmFormat(null));
            s.run("null", () -> s.player.addListener(null));
            s.run("closed", () -> s.player.setDataSource(new FileDescriptor(), 0, 5));
            prepare(s);
            s.run("negative", () -> s.player.seekTo(-1));
            s.run("null", () -> s.player.seekTo((Duration) null));
            s.run("negative", () -> s.player.seekToAndWait(-7));
            s.run("small", () -> s.player.pictures().thumbnail(0, 9, ColorMode.RGBA8888));
            s.run("high", () -> s.player.pictures().thumbnail(9, 256, ColorMode.RGBA8888));
            s.run("null", () -> s.player.pictures().thumbnailAndWait(9, 9, null));
        });
    }

    @Test
    void mediaFailAlike() throws Exception {
        compare("short.mp4", s -> {
            String garbage = Media.path("garbage.bin");
            s.run("set", () -> s.player.setDataSource(garbage));
            orderFailure(s);
            s.run("prepare", s.player::prepareAndWait);
            s.run("start", s.player::start);
            s.run("reset", s.player::resetAndWait);
            s.run("set", () -> s.player.setDataSource(garbage));
            orderFailure(s);
            s.call("prepare", s.player::prepareAsync);
            s.waitUntil("an error", () -> !s.events.isEmpty());
            s.call("reset", s.player::reset);
            if (s.isFake()) {
                s.control().failNextDataSource(MediaError.NOT_FOUND);
            }
            s.run("missing", () -> s.player.setDataSource("/nowhere.mp4"));
            prepare(s);
        });
    }

    private static void orderFailure(Subject s) {
        if (s.isFake()) {
            s.control().failNextPrepare(MediaError.MALFORMED);
        }
    }

    @ParameterizedTest
    @EnumSource(mode = Mode.EXCLUDE, names = "PREPARING") // Which passes at once.
    void everyStateAnswersAlike(PlayerState state) throws Exception {
        compare("short.mp4", new EveryCall(state)::run);
    }

    @Test
    void mediaFailWithTheSameSentences() {
        for (String source : new String[] {"/film.mkv", "rtsp://host/film"}) {
            for (MediaError error : MediaError.values()) {
                if (error == MediaError.HTTP || error == MediaError.ABORTED) {
                    continue; // One says its status as well, the other is nothing that media do.
                }
                String thrown = "status=0x" + Integer.toHexString(error.status()).toUpperCase();
                String real = Failures.explain(source, new IOException(thrown), null).getMessage();
                assertEquals(real, FakeFailures.media(source, error).getMessage());
            }
        }
    }
}
