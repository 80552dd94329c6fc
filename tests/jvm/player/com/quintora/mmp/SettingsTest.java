// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertFalse;
import static org.junit.jupiter.api.Assertions.assertThrows;
import static org.junit.jupiter.api.Assertions.assertTrue;

import android.os.Parcel;
import com.quintora.mmp.util.DivxLastMemoryFilePosition;
import java.io.IOException;
import java.net.URI;
import java.nio.file.Files;
import java.nio.file.Path;
import java.time.Duration;
import java.util.Optional;
import java.util.Set;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.api.io.TempDir;
import org.junit.jupiter.params.ParameterizedTest;
import org.junit.jupiter.params.provider.EnumSource;
import org.junit.jupiter.params.provider.ValueSource;

/** The sound's settings, the engine's own affairs and DivX navigation, on media that play. */
class SettingsTest extends PlayerFixture {
    @TempDir
    Path folder;

    @Test
    void theVolumeIsZeroToOne() throws Exception {
        prepare("video.mp4");
        player.audio().setVolume(0.25f, 1);
        player.audio().setVolume(0, 0);
        for (float bad : new float[] {-0.1f, 1.1f, Float.NaN}) {
            assertThrows(IllegalArgumentException.class, () -> player.audio().setVolume(bad, 1));
            assertThrows(IllegalArgumentException.class, () -> player.audio().setVolume(1, bad));
            assertThrows(IllegalArgumentException.class,
                    () -> player.audio().setAuxEffectSendLevel(bad));
        }
        player.start();
        awaitMoving();
    }

    @Test
    void theAudioSessionIsKept() throws Exception {
        assertEquals(0, player.audio().getSessionId());
        player.audio().setSessionId(17);
        assertEquals(17, player.audio().getSessionId());
        assertThrows(IllegalArgumentException.class, () -> player.audio().setSessionId(-1));
        assertThrows(IOException.class, () -> player.native_setAudioSessionId(-1));
        assertEquals(17, player.audio().getSessionId());
        player.resetAndWait();
        assertEquals(17, player.audio().getSessionId());
    }

    @Test
    void streamTypesAndEffectsAreAccepted() throws Exception {
        player.audio().setStreamType(3);
        player.audio().setStreamType(5);
        player.audio().attachAuxEffect(1);
        player.audio().setAuxEffectSendLevel(0.5f);
        prepare("video.mp4");
        player.start();
        awaitMoving();
    }

    @ParameterizedTest
    @EnumSource(PlayerRole.class)
    void mediaPlayInEveryRole(PlayerRole role) throws Exception {
        try (Screen screen = new Screen()) {
            player.setSurface(screen.surface());
            player.engine().setRole(role);
            prepare("video.mp4");
            player.start();
            awaitMoving();
            if (role == PlayerRole.BACKGROUND) {
                awaitMoving();
                assertTrue(screen.isBlank(), "the background has no picture");
            } else {
                screen.await("a picture", frame -> frame.width() == 320);
            }
            player.close();
        }
    }

    @Test
    void whatThisEngineDoesNotHaveIsSaid() throws Exception {
        prepare("video.mp4");
        assertFalse(player.engine().unlock(1234));
        assertFalse(player.engine().unlock(-1));
        assertFalse(player.engine().setTransportStream(5));
        assertThrows(IllegalArgumentException.class,
                () -> player.engine().setTransportStream(65_541));
        assertTrue(player.engine().sendCommand("vdec.stat", 1), "every command is accepted");
    }

    @Test
    void requestsAndParametersLeadNowhere() {
        Parcel request = Parcel.obtain();
        Parcel reply = Parcel.obtain();
        request.writeInt(7);
        assertEquals(0, player.engine().invoke(request, reply));
        assertFalse(player.engine().setParameter(1, request));
        player.engine().getParameter(1, reply);
        assertFalse(player.engine().getMetadata(false, false, reply));
        assertEquals(0, player.engine().setMetadataFilter(Set.of(1, 2), Set.of()));
        assertEquals(0, reply.dataSize());
        assertEquals(4, request.dataSize());
        request.recycle();
        reply.recycle();
    }

    @ParameterizedTest
    @ValueSource(ints = {0, 1, -1, Integer.MAX_VALUE})
    void thereIsNoDivxNavigationHere(int number) throws Exception {
        prepare("video.mp4");
        DivxNavigation divx = player.divx();
        assertEquals(0, divx.titleCount());
        assertEquals(0, divx.lastMemoryFileId());
        assertEquals(Optional.empty(), divx.title(number));
        assertEquals(Optional.empty(), divx.chapter(number, number, number));
        assertEquals(Optional.empty(), divx.playlist(number, number));
        assertEquals(Optional.empty(), divx.position());
        assertEquals(Optional.empty(), divx.display(number, number, number, number, number));
        assertEquals(Optional.empty(), divx.lastMemory());
        assertFalse(divx.setTitle(number, number, number));
        assertFalse(divx.setChapter(number, number, number, number));
        assertFalse(divx.setPlaylist(number, number, number, number));
        assertFalse(divx.pressButton(number, number));
        assertFalse(divx.setFilePosition(number, number));
        assertFalse(divx.setLastMemory(new DivxLastMemoryFilePosition()));
    }

    @Test
    void theVolumeIsKnownAlsoWhileMuted() throws Exception {
        assertEquals(1, player.getVolume());
        assertFalse(player.audio().isMuted());
        player.setVolume(0.5f);
        player.setMuted(true);
        assertEquals(0.5f, player.getVolume());
        player.audio().setVolume(0.25f, 0.75f);
        assertTrue(player.isMuted());
        player.audio().setMuted(false);
        assertEquals(0.25f, player.audio().getLeftVolume());
        assertEquals(0.75f, player.audio().getRightVolume());
        assertEquals(0.75f, player.getVolume());
        assertThrows(IllegalArgumentException.class, () -> player.setVolume(1.5f));
        player.resetAndWait();
        assertEquals(0.75f, player.getVolume(), "it outlasts a reset");
    }

    @Test
    void aListenerThatIsAddedTwiceIsCalledOnce() throws Exception {
        player.addListener(recorder);
        prepare("silent.mkv");
        player.start();
        recorder.await("completion");
        assertEquals(1, recorder.count("prepared"));
        assertEquals(1, recorder.count("completion"));
    }

    @Test
    void filesArePathsAndUrisToo() throws Exception {
        Path file = Path.of(Media.path("video.mp4"));
        player.setDataSource(file);
        player.prepareAndWait();
        assertEquals(Optional.of(Duration.ofMillis(player.getDuration())), player.duration());
        player.resetAndWait();
        assertEquals(Optional.empty(), player.duration());
        Path strange = Files.copy(file, folder.resolve("100% sure? #1.mp4"));
        player.setDataSource(strange.toUri());
        player.prepareAndWait();
        assertEquals(Duration.ZERO, player.position());
        assertThrows(IllegalArgumentException.class,
                () -> player.setDataSource(URI.create("film.mp4")));
    }
}
