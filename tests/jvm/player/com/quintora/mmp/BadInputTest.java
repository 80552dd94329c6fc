// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertNull;
import static org.junit.jupiter.api.Assertions.assertThrows;
import static org.junit.jupiter.api.Assertions.assertTrue;
import static org.junit.jupiter.api.Assumptions.assumeFalse;

import android.os.Parcel;
import android.view.Surface;
import android.view.Surfaces;
import com.quintora.mmp.desktop.FrameReader;
import java.io.FileDescriptor;
import java.io.FileInputStream;
import java.io.IOException;
import java.net.ServerSocket;
import java.nio.charset.StandardCharsets;
import java.nio.file.Files;
import java.nio.file.Path;
import java.nio.file.attribute.PosixFilePermissions;
import java.util.Collections;
import java.util.HashMap;
import java.util.Map;
import java.util.Random;
import java.util.Set;
import org.junit.jupiter.api.AfterEach;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.api.function.Executable;
import org.junit.jupiter.api.io.TempDir;

/** What cannot be played is named, and the player serves on. */
class BadInputTest extends PlayerFixture {
    @TempDir Path folder;

    @AfterEach
    void theNextCorrectCallWorks() throws Exception {
        player.resetAndWait();
        prepare("silent.mkv");
        player.start();
        awaitMoving();
    }

    @Test
    void aPathThatIsNull() {
        String none = null;
        IllegalArgumentException e = assertThrows(
                IllegalArgumentException.class, () -> player.setDataSource(none));
        assertEquals("the path or URL is null", e.getMessage());
        assertThrows(IllegalArgumentException.class,
                () -> player.setDataSource(none, Map.of("a", "b")));
        assertThrows(IllegalArgumentException.class, () -> player.native_setDataSource(none));
        assertThrows(IllegalArgumentException.class,
                () -> player.native_setDataSource(none, null, null));
    }

    @Test
    void aFileThatIsMissing() {
        MediaException e = refusedAtOnce(folder + "/none.mkv");
        assertEquals(folder + "/none.mkv: no such file", e.getMessage());
        assertEquals(MediaError.NOT_FOUND, e.error());
    }

    @Test
    void aFolder() {
        assertEquals(folder + ": is a directory", refusedAtOnce(folder.toString()).getMessage());
    }

    @Test
    void aNameThatIsEmpty() {
        assertEquals("the path is empty", refusedAtOnce("").getMessage());
    }

    @Test
    void aFileThatMustNotBeRead() throws IOException {
        Path locked = Files.write(folder.resolve("locked.mkv"), new byte[100]);
        Files.setPosixFilePermissions(locked, PosixFilePermissions.fromString("---------"));
        assumeFalse(Files.isReadable(locked), "the superuser reads every file");
        SecurityException e = assertThrows(
                SecurityException.class, () -> player.setDataSource(locked.toString()));
        assertEquals(locked + ": permission denied", e.getMessage());
    }

    @Test
    void aFileThatIsEmpty() throws IOException {
        Path empty = Files.createFile(folder.resolve("empty.mkv"));
        assertEquals(empty + ": is empty", refusedByPrepare(empty).getMessage());
    }

    @Test
    void aHundredRandomBytes() throws IOException {
        byte[] noise = new byte[100];
        new Random(42).nextBytes(noise);
        Path file = Files.write(folder.resolve("noise.mkv"), noise);
        MediaException e = refusedByPrepare(file);
        assertEquals(MediaError.MALFORMED, e.error());
        assertEquals(file + ": unknown format", e.getMessage());
    }

    @Test
    void mediaThatEndsBeforeItsIndex() throws Exception {
        MediaException e = refusedByPrepare(Path.of(Media.path("cut.mp4")));
        assertTrue(e.status() < 0, e.toString());
    }

    @Test
    void mediaThatEndsInTheMiddlePlaysUpToThere() throws Exception {
        prepare("cut.mkv");
        player.start();
        Wait.until("it ended or failed; it was " + player.getState(),
                () -> player.getState() == PlayerState.COMPLETED
                        || player.getState() == PlayerState.ERROR);
    }

    @Test
    void aCodecThatIsUnknown() throws Exception {
        byte[] media = Files.readAllBytes(Path.of(Media.path("silent.mkv")));
        Path file = Files.write(
                folder.resolve("unknown.mkv"),
                replace(media, "V_MPEG4/ISO/AVC", "V_QQQQQ/QQQ/QQQ"));
        MediaException e = refusedByPrepare(file);
        assertEquals(MediaError.UNSUPPORTED, e.error());
        assertEquals(file + ": has no track that can be played", e.getMessage());
    }

    @Test
    void aUrlThatRefusesTheConnection() throws IOException {
        int port;
        try (ServerSocket closedSoon = new ServerSocket(0)) {
            port = closedSoon.getLocalPort();
        }
        String url = "http://127.0.0.1:" + port + "/film.mkv";
        assertEquals(
                url + ": the server refuses the connection",
                refusedByPrepare(url).getMessage());
    }

    @Test
    void aProtocolThatIsUnknown() {
        MediaException e = assertThrows(MediaException.class, () -> open("gopherette://x/y.mkv"));
        assertTrue(e.getMessage().startsWith("gopherette://x/y.mkv: "), e.getMessage());
    }

    @Test
    void headerArraysThatDoNotMatch() {
        String[] two = {"a", "b"};
        String[] three = {"1", "2", "3"};
        assertThrows(IllegalArgumentException.class,
                () -> player.native_setDataSource("http://h/", two, three));
        assertThrows(IllegalArgumentException.class,
                () -> player.native_setDataSource("http://h/", two, null));
        assertThrows(IllegalArgumentException.class,
                () -> player.native_setDataSource("http://h/", null, three));
        assertEquals(PlayerState.IDLE, player.getState());
    }

    @Test
    void headersThatAreNull() {
        Map<String, String> headers = new HashMap<>();
        headers.put("Accept", null);
        assertNullRefused("the value of the header Accept",
                () -> player.setDataSource("http://h/", headers));
        headers.clear();
        headers.put(null, "x");
        assertNullRefused("a header's name", () -> player.setDataSource("http://h/", headers));
    }

    @Test
    void argumentsThatAreNull() throws Exception {
        Parcel parcel = Parcel.obtain();
        EngineCommands engine = player.engine();
        assertNullRefused("the headers' map", () -> player.setDataSource("http://h/", null));
        MediaStreamSource none = null;
        assertNullRefused("the stream source", () -> player.setDataSource(none));
        assertNullRefused("the PCM description", () -> player.setPcmFormat(null));
        assertNullRefused("the listener", () -> player.addListener(null));
        assertNullRefused("the role", () -> engine.setRole(null));
        assertNullRefused("the command", () -> engine.sendCommand(null, 1));
        assertNullRefused("the request", () -> engine.invoke(null, parcel));
        assertNullRefused("the reply", () -> engine.invoke(parcel, null));
        assertNullRefused("the value", () -> engine.setParameter(1, null));
        assertNullRefused("the reply", () -> engine.getParameter(1, null));
        assertNullRefused("the reply", () -> engine.getMetadata(true, true, null));
        assertNullRefused("the set of wanted kinds",
                () -> engine.setMetadataFilter(null, Set.of()));
        assertNullRefused("the set of unwanted kinds",
                () -> engine.setMetadataFilter(Set.of(), null));
        assertNullRefused("a code",
                () -> engine.setMetadataFilter(Collections.singleton(null), Set.of()));
        assertNullRefused("the path or URL", () -> player.subtitles().addAndWait(null));
        assertNullRefused("the path of the pictures", () -> player.subtitles().addPairAndWait(null, "x"));
        assertNullRefused("the path of the index", () -> player.subtitles().addPairAndWait("x", null));
        assertNullRefused("the path or URL", () -> player.subtitles().addTimedTextAndWait(null));
        assertNullRefused("the attributes' object", () -> player.subtitles().setStyle(null));
        assertNullRefused("the pixels' format", () -> player.pictures().thumbnailAndWait(1, 1, null));
        assertNullRefused("the position", () -> player.divx().setLastMemory(null));
        assertNullRefused("the channel", () -> new ChannelStreamSource(null));
        parcel.recycle();
    }

    private static void assertNullRefused(String name, Executable call) {
        IllegalArgumentException e = assertThrows(IllegalArgumentException.class, call);
        assertEquals(name + " is null", e.getMessage());
    }

    @Test
    void headerArraysWithNullEntriesSetNoSource() throws Exception {
        player.native_setDataSource(
                "http://h/", new String[] {"a", null}, new String[] {"1", "2"});
        assertThrows(IllegalStateException.class, player::native_prepare);
        player.native_setDataSource("http://h/", new String[] {"a"}, new String[] {null});
        assertThrows(IllegalStateException.class, player::native_prepare);
        player.setDataSource(Media.path("video.mp4"));
        player.prepareAndWait();
        assertEquals(PlayerState.PREPARED, player.getState());
    }

    @Test
    void aDescriptorThatIsNull() {
        FileDescriptor none = null;
        assertThrows(IllegalArgumentException.class, () -> player.setDataSource(none));
        assertThrows(IllegalArgumentException.class,
                () -> player.native_setDataSource(none, 0, 1));
    }

    @Test
    void aDescriptorThatIsClosed() throws Exception {
        FileInputStream file = new FileInputStream(Media.path("silent.mkv"));
        FileDescriptor fd = file.getFD();
        file.close();
        MediaException e = assertThrows(MediaException.class, () -> player.setDataSource(fd));
        assertEquals("the descriptor: is not open, or a value is out of range", e.getMessage());
    }

    @Test
    void aRangeThatIsNegative() throws Exception {
        try (FileInputStream file = new FileInputStream(Media.path("silent.mkv"))) {
            FileDescriptor fd = file.getFD();
            assertThrows(MediaException.class, () -> player.setDataSource(fd, -1, 100));
            assertThrows(MediaException.class, () -> player.setDataSource(fd, 0, -1));
        }
    }

    @Test
    void aSurfaceThatWasReleased() throws Exception {
        try (FrameReader reader = new FrameReader()) {
            Surface surface = reader.getSurface();
            player.setSurface(surface);
            surface.release();
            IllegalArgumentException e = assertThrows(
                    IllegalArgumentException.class, () -> player.setSurface(surface));
            assertEquals("The surface has been released", e.getMessage());
            player.setSurface(null);
        }
    }

    @Test
    void aSurfaceWithoutAConsumer() {
        Surface surface = Surfaces.withoutConsumer();
        IllegalArgumentException e = assertThrows(
                IllegalArgumentException.class, () -> player.setSurface(surface));
        assertEquals("The surface does not have a binding SurfaceTexture!", e.getMessage());
        player.setSurface(null);
    }

    @Test
    void asynchronousFailuresAreTold() throws Exception {
        player.setDataSource(Media.path("garbage.bin"));
        player.prepareAsync();
        recorder.await("error");
        assertEquals(PlayerState.ERROR, player.getState());
        assertEquals(MediaError.MALFORMED, recorder.error.error());
        assertEquals(1, recorder.count("error"));
        assertEquals(0, recorder.count("prepared"));
    }

    @Test
    void nullsWhereTheNativeHalfChecksThem() {
        player.native_setSubtitleDataSource(null);
        player.native_setSubtitleDataSourceEx(null, null);
        assertEquals(-1, player.native_addTimedTextSource(null));
        assertEquals(0, player.native_QTVDECSendCliCommand(null, 0));
        assertNull(player.native_getFrameAt(0));
    }

    private MediaException refusedAtOnce(String path) {
        MediaException e = assertThrows(MediaException.class, () -> player.setDataSource(path));
        assertEquals(PlayerState.IDLE, player.getState());
        return e;
    }

    private MediaException refusedByPrepare(Path file) throws IOException {
        return refusedByPrepare(file.toString());
    }

    private MediaException refusedByPrepare(String source) throws IOException {
        player.setDataSource(source);
        MediaException e = assertThrows(MediaException.class, player::prepareAndWait);
        assertEquals(PlayerState.ERROR, player.getState());
        return e;
    }

    private static byte[] replace(byte[] bytes, String from, String to) {
        String text = new String(bytes, StandardCharsets.ISO_8859_1);
        assertTrue(text.contains(from), "the media does not hold " + from);
        return text.replace(from, to).getBytes(StandardCharsets.ISO_8859_1);
    }
}
