// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertSame;
import static org.junit.jupiter.api.Assertions.assertThrows;
import static org.junit.jupiter.api.Assertions.assertTrue;

import com.quintora.SubtitleAttr;
import com.quintora.mmp.ColorMode;
import com.quintora.mmp.MediaError;
import com.quintora.mmp.MediaException;
import com.quintora.mmp.Pictures;
import com.quintora.mmp.PlayerState;
import com.quintora.mmp.SubtitleTrack;
import com.quintora.mmp.Track;
import com.quintora.mmp.TrackFlags;
import com.quintora.mmp.Wait;
import com.quintora.mmp.util.PcmMediaInfo;
import java.io.IOException;
import java.lang.Thread.State;
import java.util.ArrayList;
import java.util.List;
import java.util.Optional;
import java.util.concurrent.CompletableFuture;
import java.util.concurrent.CompletionException;
import java.util.concurrent.CountDownLatch;
import java.util.concurrent.TimeUnit;
import java.util.concurrent.atomic.AtomicInteger;
import org.junit.jupiter.api.AfterEach;
import org.junit.jupiter.api.Test;

/** The units of a player, without a native library. */
class UnitsTest {
    private static final int SELECTED = 1 << 3; // of a track's flags

    private final ScriptedNatives natives = new ScriptedNatives();
    private final PlayerUnits units = natives.units();

    @AfterEach
    void close() {
        units.lifetime.close();
    }

    @Test
    void aPlayersWayLeadsThroughTheNativeHalf() throws Exception {
        prepare();
        units.playback.start();
        assertEquals(PlayerState.STARTED, units.states.state());
        units.lifetime.close();
        assertEquals(PlayerState.RELEASED, units.states.state());
        assertTrue(natives.calls.containsAll(List.of("setDataSource", "prepare", "start")));
        assertEquals(1, natives.count("release"));
    }

    @Test
    void aSourceIsForAPlayerThatHasNone() throws Exception {
        units.sources.set("film.mkv");
        assertThrows(IllegalStateException.class, () -> units.sources.set("other.mkv"));
        assertEquals(List.of("setDataSource[film.mkv]"), natives.lines);
        assertEquals("film.mkv", units.source.name());
    }

    @Test
    void aSourceThatTheEngineRefusesLeavesNoName() throws Exception {
        natives.answer("setDataSource", () -> {
            throw new IOException("gone");
        });
        assertThrows(IOException.class, () -> units.sources.set("film.mkv"));
        assertEquals("", units.source.name());
        assertEquals(PlayerState.IDLE, units.states.state());
    }

    @Test
    void aSourceHasItsNameBeforeAnybodyCanPrepareIt() throws Exception {
        CountDownLatch mayMove = new CountDownLatch(1);
        natives.answer("setDataSource", () -> {
            mayMove.await();
            return null;
        });
        Thread opening = new Thread(() -> {
            try {
                units.sources.set("film.mkv");
            } catch (IOException e) {
                throw new AssertionError(e);
            }
        });
        opening.start();
        Wait.until("the engine opens it", () -> natives.count("setDataSource") == 1);
        synchronized (units.states) { // no state can change
            mayMove.countDown();
            Wait.until("its state is to change", () -> opening.getState() == State.BLOCKED);
            assertEquals("film.mkv", units.source.name());
        }
        opening.join();
        assertEquals(PlayerState.INITIALIZED, units.states.state());
    }

    @Test
    void aPcmFormatIsHandedOverBeforeItsFlagAndInIdleAlone() throws Exception {
        PcmMediaInfo format = PcmMediaInfo.of(44_100, 2, 16);
        PcmMediaInfo bad = PcmMediaInfo.of(44_100, 9, 16);
        assertThrows(IllegalArgumentException.class, () -> units.sources.setPcmFormat(bad));
        assertEquals(List.of(), natives.lines);
        units.sources.setPcmFormat(format);
        assertEquals(List.of("setPcmMediaInfo[" + format + "]", "setPcmFlag[]"), natives.lines);
        units.sources.set("film.pcm");
        natives.lines.clear();
        assertThrows(IllegalStateException.class, () -> units.sources.setPcmFormat(format));
        assertThrows(IllegalArgumentException.class, () -> units.sources.setPcmFormat(bad),
                "what is wrong in every state counts first");
        assertEquals(List.of(), natives.lines);
    }

    @Test
    void aStyleIsCheckedBeforeItIsHandedOver() {
        SubtitleAttr bad = new SubtitleAttr();
        bad.mMask = SubtitleAttr.FLAG_SUBTITLE_TEXT_COLOR;
        assertThrows(IllegalArgumentException.class, () -> units.subtitles.setStyle(bad));
        assertEquals(List.of(), natives.lines);
        SubtitleAttr good = SubtitleAttr.builder().delay(5).build();
        units.subtitles.setStyle(good);
        assertEquals(List.of("setSubtitleAttr[" + good + "]"), natives.lines);
        natives.answer("setSubtitleAttr", () -> {
            throw new IllegalStateException("busy");
        });
        assertEquals("the engine refused setStyle(): busy", assertThrows(
                IllegalStateException.class, () -> units.subtitles.setStyle(good)).getMessage());
    }

    @Test
    void ofSeeksThatWaitForAnotherOnlyTheLastIsCarriedOut() throws Exception {
        prepare();
        CountDownLatch go = new CountDownLatch(1);
        AtomicInteger seeks = new AtomicInteger();
        natives.answer("seekTo", () -> {
            seeks.incrementAndGet();
            go.await();
            return null;
        });
        CompletableFuture<Boolean> first = units.seeking.seekTo(1);
        Wait.until("the first is under way", () -> seeks.get() == 1);
        List<CompletableFuture<Boolean>> others = new ArrayList<>();
        for (int i = 2; i <= 5; i++) {
            others.add(units.seeking.seekTo(i));
        }
        for (CompletableFuture<Boolean> overtaken : others.subList(0, 3)) {
            assertEquals(false, await(overtaken), "overtaken while the first still runs");
        }
        go.countDown();
        assertTrue(await(first));
        assertTrue(await(others.get(3)));
        assertEquals(2, seeks.get());
    }

    @Test
    void whatWaitsInTheBackgroundEndsWithItsMedia() throws Exception {
        prepare();
        CountDownLatch go = new CountDownLatch(1);
        natives.answer("step", () -> {
            go.await();
            return null;
        });
        CompletableFuture<Void> running = units.trickPlay.step(1);
        Wait.until("the first runs", () -> natives.count("step") == 1);
        CompletableFuture<Void> waiting = units.trickPlay.step(2);
        units.lifetime.resetAndWait();
        go.countDown();
        prepare();
        running.handle((done, thrown) -> null).join();
        Throwable thrown = assertThrows(CompletionException.class, waiting::join).getCause();
        assertEquals("step() was ended by a reset", thrown.getMessage());
        assertEquals(1, natives.count("step"), "no step of the new media");
    }

    @Test
    void anEngineThatFailsToReleaseIsReportedOnceAndReleasedAllTheSame() {
        natives.answer("release", () -> {
            throw new IllegalStateException("stuck");
        });
        IllegalStateException thrown =
                assertThrows(IllegalStateException.class, units.lifetime::close);
        assertEquals("the engine refused release(): stuck", thrown.getMessage());
        assertEquals(PlayerState.RELEASED, units.states.state());
        units.lifetime.close();
        CompletableFuture<Void> released = units.lifetime.release();
        assertSame(thrown, assertThrows(CompletionException.class, released::join).getCause());
        assertEquals(1, natives.count("release"));
    }

    @Test
    void aResetThatFailsLeavesThePlayerInError() throws Exception {
        prepare();
        natives.answer("reset", () -> {
            throw new IOException("stuck");
        });
        Throwable thrown =
                assertThrows(CompletionException.class, units.lifetime.reset()::join).getCause();
        assertEquals(MediaError.UNKNOWN, ((MediaException) thrown).error());
        assertEquals(PlayerState.ERROR, units.states.state());
    }

    @Test
    void aTrackThatTheEngineDoesNotShowIsRefused() throws Exception {
        prepare();
        natives.answer("getAllSubtitleTrackInfo", () -> {
            units.tables.addSubtitle(0, 1, 0, "eng;Captions", 0);
            return 1;
        });
        natives.answer("getCurrentSubtitleIndex", () -> -1);
        SubtitleTrack track = units.tracks.subtitles().get(0);
        IllegalStateException thrown = assertThrows(
                IllegalStateException.class, () -> units.tracks.selectAndWait(track));
        assertEquals("the engine cannot play subtitle track 0", thrown.getMessage());
        assertEquals(new SubtitleTrack(0, 1, "", "eng", "Captions", new TrackFlags(0)), track);
    }

    @Test
    void aThumbnailHasAtLeastOnePixelAndAtMostItsLimits() {
        int widest = Pictures.MAX_THUMBNAIL_WIDTH;
        int highest = Pictures.MAX_THUMBNAIL_HEIGHT;
        for (int[] size : new int[][] {{1, 1}, {widest, highest}}) {
            natives.lines.clear();
            assertEquals(Optional.empty(),
                    units.pictures.thumbnailAndWait(size[0], size[1], ColorMode.ABGR8888));
            assertEquals(1, natives.lines.size(), size[0] + " x " + size[1]);
        }
        for (int[] size : new int[][] {{0, 1}, {1, 0}, {widest + 1, 1}, {1, highest + 1}}) {
            assertThrows(IllegalArgumentException.class,
                    () -> units.pictures.thumbnailAndWait(size[0], size[1], ColorMode.ABGR8888));
        }
    }

    @Test
    void aVideoTrackIsDeselectedByItsIndex() throws Exception {
        prepare();
        AtomicInteger flags = new AtomicInteger(SELECTED);
        natives.answer("getAllVideoTrackInfo", () -> {
            units.tables.addVideo(0, 0, 16, 9, 25_000, 0, flags.get());
            return 1;
        });
        natives.answer("deselectTrack", () -> {
            flags.set(0);
            return null;
        });
        units.tracks.selectNoneAndWait(Track.Kind.VIDEO);
        assertTrue(natives.lines.contains("deselectTrack[0]"), natives.lines.toString());
    }

    @Test
    void whileMutedAVolumeIsKeptForLater() {
        units.audio.setVolume(0.5f, 0.5f);
        units.audio.setMuted(true);
        units.audio.setVolume(0.25f, 0.75f);
        units.audio.setMuted(false);
        assertEquals(
                List.of("setVolume[0.5, 0.5]", "setVolume[0.0, 0.0]", "setVolume[0.25, 0.75]"),
                natives.lines);
        natives.answer("setVolume", () -> {
            throw new IllegalStateException("no");
        });
        assertThrows(IllegalStateException.class, () -> units.audio.setVolume(1, 1));
        assertEquals(0.25f, units.audio.getLeftVolume(), "a refused volume is not remembered");
    }

    private static <T> T await(CompletableFuture<T> future) throws Exception {
        return future.get(Wait.LIMIT.toSeconds(), TimeUnit.SECONDS);
    }

    private void prepare() throws IOException {
        units.sources.set("film.mkv");
        units.preparation.prepareAndWait();
    }
}
