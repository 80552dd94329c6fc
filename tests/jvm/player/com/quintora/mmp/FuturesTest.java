// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertFalse;
import static org.junit.jupiter.api.Assertions.assertSame;
import static org.junit.jupiter.api.Assertions.assertThrows;
import static org.junit.jupiter.api.Assertions.assertTrue;

import java.time.Duration;
import java.util.ArrayList;
import java.util.List;
import java.util.Optional;
import java.util.concurrent.CompletableFuture;
import java.util.concurrent.ExecutionException;
import java.util.concurrent.TimeUnit;
import org.junit.jupiter.api.Test;

/** The forms that return at once: when their futures are completed, and with what. */
class FuturesTest extends PlayerFixture {
    @Test
    void aPrepareIsCompletedOnceThePlayerIsPrepared() throws Exception {
        player.setDataSource(Media.path("video.mp4"));
        await(player.prepareAsync());
        assertEquals(PlayerState.PREPARED, player.getState());
    }

    @Test
    void aFailedPrepareCarriesWhatTheListenerGets() throws Exception {
        player.setDataSource(Media.path("garbage.bin"));
        CompletableFuture<Void> prepared = player.prepareAsync();
        Throwable failure = failureOf(prepared);
        recorder.await("error");
        assertSame(recorder.error, failure);
        assertEquals(MediaError.MALFORMED, recorder.error.error());
    }

    @Test
    void aResetAbortsAPrepare() throws Exception {
        ScriptedSource source = new ScriptedSource(new byte[10_000]);
        source.misreading(0, source::block);
        player.setDataSource(source);
        CompletableFuture<Void> prepared = player.prepareAsync();
        Wait.until("the engine reads", () -> source.reads.get() > 0);
        await(player.reset());
        assertEquals(PlayerState.IDLE, player.getState());
        MediaException failure = (MediaException) failureOf(prepared);
        assertEquals(MediaError.ABORTED, failure.error());
    }

    @Test
    void aPlayerIsInErrorUntilItsResetIsDone() throws Exception {
        prepare("video.mp4");
        CompletableFuture<Void> reset = player.reset();
        assertTrue(player.getState() == PlayerState.ERROR || reset.isDone());
        await(reset);
        assertEquals(PlayerState.IDLE, player.getState());
    }

    @Test
    void aReleaseReturnsTheSameFutureAlways() throws Exception {
        prepare("video.mp4");
        player.start();
        CompletableFuture<Void> released = player.release();
        assertEquals(PlayerState.RELEASED, player.getState());
        assertSame(released, player.release());
        await(released);
        player.close();
    }

    @Test
    void aListenerMayReleaseItsPlayer() throws Exception {
        List<CompletableFuture<Void>> releases = new ArrayList<>();
        player.addListener(new PlayerListener() {
            @Override
            public void onPrepared(MediaPlayer prepared) {
                releases.add(prepared.release());
            }
        });
        player.setDataSource(Media.path("video.mp4"));
        player.prepareAsync();
        Wait.until("it was released", () -> player.getState() == PlayerState.RELEASED);
        Wait.until("the listener is done", () -> !releases.isEmpty());
        await(releases.get(0));
    }

    @Test
    void ofManySeeksThatWaitTheLastIsCarriedOut() throws Exception {
        prepare("video.mp4");
        List<CompletableFuture<Boolean>> seeks = new ArrayList<>();
        // Under the lock that a seek takes first: the first of them begins, the others wait.
        player.units.states.commands.lock();
        try {
            for (int second = 1; second <= 9; second++) {
                seeks.add(player.seekTo(Duration.ofSeconds(second)));
            }
            Wait.until("the overtaken ones are over",
                    () -> seeks.stream().filter(CompletableFuture::isDone).count() >= 7);
        } finally {
            player.units.states.commands.unlock();
        }
        assertTrue(await(seeks.get(8)));
        long carriedOut = 0;
        for (CompletableFuture<Boolean> seek : seeks) {
            carriedOut += await(seek) ? 1 : 0;
        }
        assertTrue(carriedOut <= 2, carriedOut + " of 9 were carried out");
        assertEquals(9000, player.getCurrentPosition(), 1000);
        long expected = carriedOut;
        Wait.until("each that was carried out was reported",
                () -> recorder.count("seek") == expected);
    }

    @Test
    void aSeekOfMediaThatAreGoneFails() throws Exception {
        prepare("video.mp4");
        player.units.states.commands.lock();
        CompletableFuture<Boolean> seek;
        try {
            seek = player.seekTo(5000);
        } finally {
            player.units.states.commands.unlock();
        }
        player.close();
        // It was carried out before the release, or not at all.
        try {
            assertTrue(await(seek));
        } catch (ExecutionException e) {
            assertEquals(IllegalStateException.class, e.getCause().getClass());
        }
    }

    @Test
    void badTimesAreRefusedAtOnce() throws Exception {
        prepare("video.mp4");
        assertThrows(IllegalArgumentException.class, () -> player.seekTo(-1));
        assertThrows(IllegalArgumentException.class, () -> player.seekTo((Duration) null));
        assertThrows(IllegalArgumentException.class, () -> player.seekTo(Duration.ofMillis(-1)));
        assertThrows(IllegalArgumentException.class, () -> player.seekTo(Duration.ofDays(25)));
        await(player.seekTo(Duration.ofDays(24)));
        assertTrue(player.getCurrentPosition() >= 8000, "the last key frame, or after it");
    }

    @Test
    void stepsAndThumbnailsComeInTheirOrder() throws Exception {
        prepare("video.mp4");
        CompletableFuture<Void> step = player.trickPlay().step(2);
        CompletableFuture<Optional<Thumbnail>> thumbnail =
                player.pictures().thumbnail(16, 9, ColorMode.XRGB8888);
        Thumbnail drawn = await(thumbnail).orElseThrow();
        assertTrue(step.isDone());
        assertEquals(16 * 9 * 4, drawn.toByteArray().length);
        assertEquals(PlayerState.PAUSED, player.getState());
    }

    @Test
    void theOtherFormsThatReturnAtOnceDoTheSame() throws Exception {
        prepare("video.mp4");
        assertEquals(Optional.empty(), await(player.pictures().frameAt(1000)));
        await(player.trickPlay().seekToByte(0));
        assertEquals(0, player.getCurrentPosition(), 500);
        SubtitleTrack added = await(player.subtitles().addTimedText(Media.path("lines.srt")));
        assertEquals(List.of(added), player.tracks().subtitles());
        assertEquals(Optional.empty(), player.tracks().currentSubtitle());
    }

    @Test
    void whatIsWrongAtOnceIsThrownAtOnce() {
        assertThrows(IllegalStateException.class, () -> player.trickPlay().step(1));
        assertThrows(IllegalStateException.class, () -> player.subtitles().add("x.srt"));
        assertThrows(IllegalStateException.class, () -> player.trickPlay().seekToByte(1));
        assertThrows(IllegalArgumentException.class,
                () -> player.pictures().thumbnail(0, 9, ColorMode.XRGB8888));
        assertFalse(player.isPlaying());
    }

    private static <T> T await(CompletableFuture<T> future) throws Exception {
        return future.get(Wait.LIMIT.toSeconds(), TimeUnit.SECONDS);
    }

    private static Throwable failureOf(CompletableFuture<?> future) {
        return assertThrows(ExecutionException.class, () -> await(future)).getCause();
    }
}
