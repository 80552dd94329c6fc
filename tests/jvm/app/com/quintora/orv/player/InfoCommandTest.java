// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertTrue;

import com.google.gson.JsonObject;
import com.google.gson.JsonParser;
import com.quintora.mmp.Media;
import java.nio.file.Path;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.api.io.TempDir;

/** What info tells, to programs and to people. */
class InfoCommandTest {
    @Test
    void jsonHoldsEveryTrackAndChapter() throws Exception {
        JsonObject info = json("tracks.mkv");
        assertEquals("Matroska / WebM", info.get("container").getAsString());
        assertEquals(10_000, info.get("durationMs").getAsInt(), 100);
        JsonObject video = only(info, "video");
        assertEquals("320x180", video.get("width") + "x" + video.get("height"));
        assertEquals(25, video.get("frameRate").getAsDouble(), 0.01);
        JsonObject german = info.getAsJsonArray("audio").get(1).getAsJsonObject();
        assertEquals("\"Kommentar (größer)\"", german.get("title").toString());
        assertEquals("[\"default\"]", german.get("flags").toString());
        assertEquals(44_100, german.get("sampleRate").getAsInt());
        JsonObject japanese = info.getAsJsonArray("subtitles").get(1).getAsJsonObject();
        assertEquals("字幕", japanese.get("title").getAsString());
        JsonObject last = info.getAsJsonArray("chapters").get(2).getAsJsonObject();
        assertEquals("終章", last.get("title").getAsString());
        assertEquals(6_000, last.get("startMs").getAsInt());
    }

    @Test
    void jsonHoldsTheMetadataThatThereIs() throws Exception {
        JsonObject data = json("tagged.mp3").getAsJsonObject("metadata");
        assertEquals("Ode an die Freude – К радости", data.get("title").getAsString());
        assertEquals(1824, data.get("year").getAsInt());
        assertEquals(3, data.get("track").getAsInt());
        assertEquals(0, json("silent.mkv").getAsJsonObject("metadata").size());
    }

    @Test
    void peopleGetALineForEachThing() throws Exception {
        Cli info = Cli.run("info", Media.path("tracks.mkv"));
        assertEquals(0, info.status(), info.err());
        assertTrue(info.out().contains("\nduration      0:10.0"), info.out());
        assertTrue(info.out().contains("audio 1       "), info.out());
        assertTrue(info.out().contains("German \"Kommentar (größer)\""), info.out());
        assertTrue(info.outLines().contains("chapter 1     0:02.500  Глава вторая"), info.out());
    }

    @Test
    void metadataHaveNoPowerOverTheTerminal(@TempDir Path folder) throws Exception {
        Path file = folder.resolve("odd.mkv");
        Media.run("ffmpeg", "-nostdin", "-v", "error", "-i", Media.path("silent.mkv"), "-c", "copy",
                "-metadata", "title=\033[31mred\u009b2J\r\nline two\t!", file.toString());
        Cli info = Cli.run("info", file.toString());
        assertEquals(0, info.status(), info.err());
        assertTrue(info.outLines().contains("title         [31mred 2J line two !"), info.out());
        assertTrue(info.out().chars().noneMatch(c -> c != '\n' && Character.isISOControl(c)));
    }

    @Test
    void aFileThatIsNoMediaIsOneSentence() throws Exception {
        Cli info = Cli.run("info", "--json", Media.path("garbage.bin"));
        assertEquals(1, info.status());
        assertEquals("", info.out());
        assertEquals(1, info.errLines().size(), info.err());
        assertTrue(info.err().startsWith("orv: " + Media.path("garbage.bin")), info.err());
    }

    @Test
    void anArgumentThatLacksIsNamed() {
        Cli info = Cli.run("info");
        assertEquals(2, info.status());
        assertTrue(info.errLines().get(0).contains("FILE|URL"), info.err());
    }

    private static JsonObject json(String media) throws Exception {
        Cli info = Cli.run("info", "--json", Media.path(media));
        assertEquals(0, info.status(), info.err());
        return JsonParser.parseString(info.out()).getAsJsonObject();
    }

    private static JsonObject only(JsonObject info, String name) {
        assertEquals(1, info.getAsJsonArray(name).size());
        return info.getAsJsonArray(name).get(0).getAsJsonObject();
    }
}
