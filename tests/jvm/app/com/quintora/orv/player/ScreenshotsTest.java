// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertThrows;
import static org.junit.jupiter.api.Assertions.assertTrue;

import java.awt.image.BufferedImage;
import java.io.IOException;
import java.nio.file.Files;
import java.nio.file.Path;
import java.util.Map;
import javax.imageio.ImageIO;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.api.io.TempDir;
import org.junit.jupiter.params.ParameterizedTest;
import org.junit.jupiter.params.provider.CsvSource;

/** Where pictures that the user keeps go, and how they are named. */
class ScreenshotsTest {
    @TempDir Path folder;

    @ParameterizedTest
    @CsvSource({
        "/films/Zug nach Süden.mkv, 3723456, Zug nach Süden-0001h02m03s456.png",
        "https://example.org/a/film.mp4?key=1, 0, film-0000h00m00s000.png",
        "https://example.org/, 59999, example.org-0000h00m59s999.png",
        "-, 1000, standard input-0000h00m01s000.png",
        "/films/.hidden.avi, 0, _hidden-0000h00m00s000.png",
        "/films/Vol. 2, 0, Vol. 2-0000h00m00s000.png",
    })
    void itIsNamedAfterTheMediaAndTheTime(String source, int millis, String name)
            throws Exception {
        Path file = new Screenshots(folder, source).save(still(millis));
        assertEquals(name, file.getFileName().toString());
        assertEquals(16, ImageIO.read(file.toFile()).getWidth());
    }

    @Test
    void aNameIsNeverTooLongForAFile() throws Exception {
        Path file = new Screenshots(folder, "/films/" + "ü".repeat(120) + ".mkv").save(still(0));
        assertTrue(file.getFileName().toString().startsWith("ü".repeat(100) + "-0000h"));
    }

    @Test
    void noFileIsOverwritten() throws Exception {
        var screenshots = new Screenshots(folder, "film.mkv");
        Path first = screenshots.save(still(5));
        Files.writeString(first, "mine");
        assertEquals("film-0000h00m00s005-2.png",
                screenshots.save(still(5)).getFileName().toString());
        assertEquals("film-0000h00m00s005-3.png",
                screenshots.save(still(5)).getFileName().toString());
        assertEquals("mine", Files.readString(first));
        assertEquals(3, count(), "and nothing else is left there");
    }

    @Test
    void whereNoneCanBeWrittenIsASentenceAndLeavesNothing() throws Exception {
        var none = new Screenshots(folder.resolve("none"), "film.mkv");
        Failure failure = assertThrows(Failure.class, () -> none.save(still(0)));
        assertTrue(failure.getMessage().endsWith("its folder does not exist"),
                failure.getMessage());
        Path file = Files.createFile(folder.resolve("file"));
        var notAFolder = new Screenshots(file, "film.mkv");
        Failure other = assertThrows(Failure.class, () -> notAFolder.save(still(0)));
        assertTrue(other.getMessage().startsWith("cannot write '" + file), other.getMessage());
        assertEquals(1, count());
    }

    @Test
    void theFolderIsTheDesktopsOwn() throws Exception {
        Path home = Files.createDirectory(folder.resolve("home"));
        assertEquals(home, find(home), "there are no settings");
        Path pictures = Files.createDirectory(home.resolve("My \"Bilder\""));
        settings(home, "# a comment", "XDG_MUSIC_DIR=\"$HOME/Music\"",
                "XDG_PICTURES_DIR=\"$HOME/My \\\"Bilder\\\"\"");
        assertEquals(pictures, find(home));
        settings(home, "XDG_PICTURES_DIR=\"" + folder + "\"");
        assertEquals(folder, find(home), "an absolute one");
        settings(home, "XDG_PICTURES_DIR=\"$HOME/gone\"");
        assertEquals(home, find(home), "one that is not there");
        settings(home, "XDG_PICTURES_DIR=\"$HOME/\"");
        assertEquals(home, find(home), "that is how none is written");
        settings(home, "XDG_PICTURES_DIR=nothing of use");
        assertEquals(home, find(home));
    }

    @Test
    void theSettingsAreWhereTheEnvironmentSays() throws Exception {
        Path home = Files.createDirectory(folder.resolve("home"));
        Files.writeString(folder.resolve("user-dirs.dirs"),
                "XDG_PICTURES_DIR=\"" + folder + "\"\n");
        var environment = Map.of("XDG_CONFIG_HOME", folder.toString());
        assertEquals(folder, PicturesFolder.find(environment::get, home));
    }

    private static Path find(Path home) {
        return PicturesFolder.find(name -> null, home);
    }

    private static void settings(Path home, String... lines) throws IOException {
        Path file = home.resolve(".config/user-dirs.dirs");
        Files.createDirectories(file.getParent());
        Files.writeString(file, String.join("\n", lines) + "\n");
    }

    private long count() throws IOException {
        try (var files = Files.list(folder)) {
            return files.count();
        }
    }

    private static Still still(int millis) {
        return new Still(new BufferedImage(16, 9, BufferedImage.TYPE_INT_RGB), millis);
    }
}
