// SPDX-License-Identifier: Apache-2.0
package com.quintora.samples;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertFalse;
import static org.junit.jupiter.api.Assertions.assertTrue;

import com.quintora.mmp.Media;
import java.io.OutputStream;
import java.nio.file.Files;
import java.nio.file.Path;
import java.util.HexFormat;
import java.util.List;
import java.util.zip.CRC32;
import java.util.zip.ZipEntry;
import java.util.zip.ZipOutputStream;
import javax.crypto.Cipher;
import javax.crypto.spec.IvParameterSpec;
import javax.crypto.spec.SecretKeySpec;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.api.io.TempDir;
import org.junit.jupiter.params.ParameterizedTest;
import org.junit.jupiter.params.provider.CsvSource;
import org.junit.jupiter.params.provider.ValueSource;

/** The samples that need no screen play to the end, and all of them explain what is wrong. */
class SamplesTest {
    private static final int MOST_LINES = 80;

    @TempDir
    Path folder;

    @Test
    void noneIsLong() throws Exception {
        List<Path> sources = Sample.sources();
        assertEquals(8, sources.size());
        for (Path source : sources) {
            int lines = Files.readAllLines(source).size();
            assertTrue(lines <= MOST_LINES, source.getFileName() + " has " + lines);
        }
    }

    @Test
    void wrongArgumentsAreAnsweredByASentence() throws Exception {
        for (Path source : Sample.sources()) {
            String name = source.getFileName().toString().replace(".java", "");
            if (Sample.canRun(name)) {
                Sample.Result result = run(name);
                assertEquals(2, result.status(), name);
                assertEquals(1, result.errors().size(), name);
                assertTrue(result.errors().get(0).startsWith("usage: " + name + " "), name);
            }
        }
    }

    @ParameterizedTest
    @CsvSource({"PlayInSwing,", "PlayInJavaFx,", "ContactSheet, out.png", "Karaoke, words.srt",
        "EventLog,", "Wall,", "PlayEncrypted,", "PlayFromZip, entry"})
    void aMissingFileIsNamed(String name, String second) throws Exception {
        if (!Sample.canRun(name)) {
            return;
        }
        Sample.Result result = second == null
                ? run(name, "/nowhere.mp4") : run(name, "/nowhere.mp4", second);
        String said = String.join("\n", result.errors());
        assertEquals(1, result.status(), said);
        assertTrue(said.contains("/nowhere.mp4"), said);
        assertFalse(said.contains("\tat "), said);
    }

    @Test
    void theLogIsInOrderAndRunsFromItsSource() throws Exception {
        try (Sample sample = Sample.startSource("EventLog", Media.path("short.mp4"))) {
            Sample.Result result = sample.await();
            assertEquals(0, result.status(), () -> String.join("\n", result.errors()));
            List<String> events = result.output().stream()
                    .filter(line -> !line.contains("buffered"))
                    .map(line -> line.substring(line.indexOf("at ") + 11).strip())
                    .toList();
            assertEquals(List.of("PREPARED   prepared, PT3S", "STARTED    picture of 320x180",
                    "STARTED    info RENDERING_STARTED (3, 0)", "COMPLETED  completion"),
                    events.stream().map(line -> line.replace("PT3.021S", "PT3S")).toList());
        }
    }

    @Test
    void theLogSaysWhatFailed() throws Exception {
        Sample.Result result = run("EventLog", Media.path("garbage.bin"));
        assertTrue(result.output().get(0).contains("error MALFORMED: "), result.output().get(0));
    }

    @ParameterizedTest
    @ValueSource(ints = {ZipEntry.STORED, ZipEntry.DEFLATED})
    void anEntryOfAZipFilePlaysToTheEnd(int method) throws Exception {
        byte[] film = film();
        Path archive = folder.resolve("films.zip");
        try (ZipOutputStream zip = new ZipOutputStream(Files.newOutputStream(archive))) {
            ZipEntry entry = new ZipEntry("some/film.mp4");
            entry.setMethod(method);
            entry.setSize(film.length);
            CRC32 sum = new CRC32();
            sum.update(film);
            entry.setCrc(sum.getValue());
            zip.putNextEntry(entry);
            zip.write(film);
        }
        Sample.Result result = run("PlayFromZip", archive.toString(), "some/film.mp4");
        assertEquals(List.of("the end"), result.output(), () -> result.errors().toString());
        Sample.Result missing = run("PlayFromZip", archive.toString(), "other");
        assertEquals(1, missing.status());
        assertTrue(missing.errors().toString().contains("there is no entry other"));
    }

    // The counter of all ones runs over into every byte.
    @ParameterizedTest
    @ValueSource(strings = {"00000000000000000000000000000001", "ffffffffffffffffffffffffffffffff"})
    void anEncryptedFilePlaysToTheEnd(String counter) throws Exception {
        String key = "000102030405060708090a0b0c0d0e0f";
        byte[] iv = HexFormat.of().parseHex(counter);
        Cipher cipher = Cipher.getInstance("AES/CTR/NoPadding");
        cipher.init(Cipher.ENCRYPT_MODE, new SecretKeySpec(HexFormat.of().parseHex(key), "AES"),
                new IvParameterSpec(iv));
        byte[] film = film();
        Path secret = folder.resolve("film.aes");
        try (OutputStream out = Files.newOutputStream(secret)) {
            out.write(iv);
            out.write(cipher.doFinal(film));
        }
        try (Sample sample = Sample.start("PlayEncrypted", secret.toString()).type(key + "\n")) {
            Sample.Result result = sample.await();
            assertEquals(List.of("COMPLETED"), result.output(), () -> result.errors().toString());
        }
        try (Sample sample = Sample.start("PlayEncrypted", secret.toString())
                .type(key.replace('0', '1') + "\n")) {
            assertEquals(1, sample.await().status());
        }
        try (Sample sample = Sample.start("PlayEncrypted", secret.toString()).type("0102")) {
            Sample.Result result = sample.await();
            assertTrue(result.errors().toString().contains("the key must have 16, 24 or 32 bytes"),
                    result.errors().toString());
        }
    }

    /** A second of noise, some MB, with its index at the end: it cannot be read in one go. */
    private byte[] film() throws Exception {
        Path file = folder.resolve("noise.mp4");
        Media.run("ffmpeg", "-v", "error", "-nostdin", "-f", "lavfi", "-i",
                "color=gray:size=640x360:rate=30:duration=1,noise=alls=100:allf=t", "-c:v",
                "libx264", "-preset", "ultrafast", "-qp", "10", "-pix_fmt", "yuv420p",
                file.toString());
        byte[] film = Files.readAllBytes(file);
        assertTrue(film.length > 4_000_000, "it has " + film.length + " bytes");
        return film;
    }

    private static Sample.Result run(String name, String... args) throws Exception {
        try (Sample sample = Sample.start(name, args)) {
            return sample.type("00112233445566778899aabbccddeeff").await();
        }
    }
}
