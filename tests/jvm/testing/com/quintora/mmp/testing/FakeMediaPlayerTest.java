// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.testing;

import static org.junit.jupiter.api.Assertions.assertArrayEquals;
import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertFalse;
import static org.junit.jupiter.api.Assertions.assertInstanceOf;
import static org.junit.jupiter.api.Assertions.assertThrows;
import static org.junit.jupiter.api.Assertions.assertTrue;

import com.quintora.mmp.ColorMode;
import com.quintora.mmp.MediaError;
import com.quintora.mmp.MediaException;
import com.quintora.mmp.MediaPlayer;
import com.quintora.mmp.MediaStreamSource;
import com.quintora.mmp.PlaybackInfo;
import com.quintora.mmp.PlayerListener;
import com.quintora.mmp.PlayerState;
import com.quintora.mmp.Thumbnail;
import java.io.IOException;
import java.time.Duration;
import java.util.ArrayDeque;
import java.util.ArrayList;
import java.util.List;
import java.util.Map;
import java.util.Optional;
import java.util.Queue;
import java.util.concurrent.CompletableFuture;
import java.util.concurrent.CompletionException;
import org.junit.jupiter.api.Test;

/** What a test can do with the fake beyond what both players do. */
class FakeMediaPlayerTest {
    private static final Duration SECOND = Duration.ofSeconds(1);
    private final FakeMedia media = FakeMedia.builder()
            .video(640, 360, 25)
            .size(1_000_000)
            .bufferedPercent(20)
            .cover(new byte[] {1, 2})
            .thumbnails((position, width, height, mode) -> Optional.of(new Thumbnail(width, height,
                    mode, new byte[width * height * mode.bytesPerPixel()])))
            .build();
    private final FakeMediaPlayer player = new FakeMediaPlayer(media);

    private void play() throws IOException {
        player.setDataSource("http://host/film", Map.of("Cookie", "a=b"));
        player.prepareAndWait();
        player.start();
    }

    @Test
    void timeMovesThePositionBySpeed() throws Exception {
        play();
        player.advance(SECOND);
        assertEquals(1000, player.getCurrentPosition());
        player.trickPlay().setSpeed(2);
        player.advance(SECOND);
        assertEquals(3000, player.getCurrentPosition());
        player.trickPlay().setSpeed(-1);
        player.advance(Duration.ofMillis(500));
        assertEquals(2500, player.getCurrentPosition());
        player.pause();
        player.advance(SECOND);
        assertEquals(2500, player.getCurrentPosition());
        player.trickPlay().stepAndWait(1);
        assertEquals(2540, player.getCurrentPosition());
        assertEquals(254_000, player.trickPlay().getBytePosition());
        assertThrows(IllegalArgumentException.class, () -> player.advance(SECOND.negated()));
    }

    @Test
    void sectionsAndLoopsBeginAgain() throws Exception {
        play();
        player.setLooping(true);
        player.advance(Duration.ofSeconds(23));
        assertEquals(3000, player.getCurrentPosition());
        assertEquals(PlayerState.STARTED, player.getState());
        player.trickPlay().repeatFromHere();
        player.advance(SECOND);
        assertTrue(player.trickPlay().repeatUntilHere());
        player.advance(Duration.ofMillis(1300));
        assertEquals(3300, player.getCurrentPosition());
    }

    @Test
    void mediaOpenWhenTheirTimeHasPassed() throws Exception {
        player.control().setMedia(
                FakeMedia.builder().openingTime(SECOND).duration(Duration.ZERO).build());
        player.setDataSource("/film");
        CompletableFuture<Void> opened = player.prepareAsync();
        player.advance(Duration.ofMillis(999));
        assertEquals(PlayerState.PREPARING, player.getState());
        assertFalse(opened.isDone());
        player.advance(Duration.ofMillis(1));
        assertTrue(opened.isDone());
        player.start();
        player.advance(Duration.ofDays(1));
        assertEquals(PlayerState.STARTED, player.getState());
        player.control().finish();
        assertEquals(PlayerState.COMPLETED, player.getState());
    }

    @Test
    void aResetEndsAPrepareThatIsUnderWay() throws Exception {
        player.control().setMedia(FakeMedia.builder().openingTime(SECOND).build());
        player.setDataSource("/film");
        CompletableFuture<Void> opened = player.prepareAsync();
        player.resetAndWait();
        MediaException error = failureOf(opened, MediaException.class);
        assertEquals(MediaError.ABORTED, error.error());
        assertEquals(PlayerState.IDLE, player.getState());
    }

    @Test
    void heldSeeksAreOvertakenAndAborted() throws Exception {
        play();
        player.control().holdSeeks(true);
        CompletableFuture<Boolean> first = player.seekTo(1000);
        CompletableFuture<Boolean> second = player.seekTo(2000);
        CompletableFuture<Boolean> third = player.seekTo(3000);
        assertFalse(second.join());
        assertFalse(first.isDone());
        player.control().holdSeeks(false);
        assertTrue(first.join());
        assertTrue(third.join());
        assertEquals(3000, player.getCurrentPosition());
        player.control().holdSeeks(true);
        CompletableFuture<Boolean> fourth = player.seekTo(4000);
        player.close();
        assertEquals("seekTo(4000) was called after the player was released",
                failureOf(fourth, IllegalStateException.class).getMessage());
    }

    @Test
    void bufferingHoldsPlayingUp() throws Exception {
        List<Object> seen = new ArrayList<>();
        player.addListener(new PlayerListener() {
            @Override
            public void onBufferingUpdate(MediaPlayer of, int percent) {
                seen.add(percent);
            }

            @Override
            public void onInfo(MediaPlayer of, PlaybackInfo info) {
                seen.add(info.kind());
            }
        });
        play();
        player.control().setBuffering(true);
        player.advance(SECOND);
        assertFalse(player.isPlaying());
        assertEquals(0, player.getCurrentPosition());
        player.control().setBufferedPercent(60);
        player.control().setBuffering(false);
        player.advance(SECOND);
        assertEquals(1000, player.getCurrentPosition());
        assertEquals(60, player.getBufferedPercent());
        assertEquals(List.of(20, PlaybackInfo.Kind.BUFFERING_STARTED, 60,
                PlaybackInfo.Kind.BUFFERING_ENDED, PlaybackInfo.Kind.RENDERING_STARTED), seen);
    }

    @Test
    void mediaFailWhilePlaying() throws Exception {
        List<String> seen = new ArrayList<>();
        player.addListener(new PlayerListener() {
            @Override
            public void onError(MediaPlayer of, MediaException error) {
                seen.add(error.getMessage());
            }
        });
        play();
        player.control().fail(MediaError.CONNECTION_LOST);
        assertEquals(List.of("http://host/film: the connection to the server broke"), seen);
        assertEquals(PlayerState.ERROR, player.getState());
        assertThrows(IllegalStateException.class, player::start);
    }

    @Test
    void anExecutorCallsListenersLaterAndInOrder() throws Exception {
        Queue<Runnable> handed = new ArrayDeque<>();
        List<PlayerState> seen = new ArrayList<>();
        FakeMediaPlayer other = new FakeMediaPlayer(media, handed::add);
        other.addListener(new PlayerListener() {
            @Override
            public void onPrepared(MediaPlayer of) {
                of.start();
                seen.add(of.getState());
            }

            @Override
            public void onCompletion(MediaPlayer of) {
                seen.add(of.getState());
            }
        });
        other.setDataSource("/film");
        other.prepareAndWait();
        assertEquals(List.of(), seen);
        handed.remove().run();
        other.advance(Duration.ofMinutes(1));
        handed.remove().run();
        assertEquals(List.of(PlayerState.STARTED, PlayerState.COMPLETED), seen);
        assertTrue(handed.isEmpty());
    }

    @Test
    void whatTheProgramSetCanBeSeen() throws Exception {
        play();
        assertEquals("http://host/film", player.control().source().orElseThrow());
        assertEquals(Map.of("Cookie", "a=b"), player.control().headers());
        assertArrayEquals(new byte[] {1, 2}, player.pictures().embedded().orElseThrow());
        assertEquals(4, player.pictures().thumbnail(4, 3, ColorMode.RGB565).join().orElseThrow()
                .width());
        player.resetAndWait();
        assertTrue(player.control().source().isEmpty());
        assertTrue(player.pictures().thumbnailAndWait(4, 3, ColorMode.RGB565).isEmpty());
    }

    @Test
    void sourcesAreClosedAtTheResetAndWhenTheyAreRefused() throws Exception {
        List<String> closed = new ArrayList<>();
        player.setDataSource(source("first", closed));
        assertThrows(IllegalStateException.class,
                () -> player.setDataSource(source("second", closed)));
        assertEquals(List.of("second"), closed);
        player.resetAndWait();
        assertEquals(List.of("second", "first"), closed);
    }

    private static MediaStreamSource source(String name, List<String> closed) {
        return new MediaStreamSource() {
            @Override
            public int read(byte[] buffer, int length) {
                return -1;
            }

            @Override
            public void seek(long position) {}

            @Override
            public long size() {
                return 0;
            }

            @Override
            public void close() {
                closed.add(name);
            }
        };
    }

    private static <T extends Throwable> T failureOf(CompletableFuture<?> future, Class<T> kind) {
        CompletionException thrown = assertThrows(CompletionException.class, future::join);
        return assertInstanceOf(kind, thrown.getCause());
    }
}
