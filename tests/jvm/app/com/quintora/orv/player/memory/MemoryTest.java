// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.memory;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertFalse;
import static org.junit.jupiter.api.Assertions.assertTrue;

import com.quintora.orv.player.playlist.Entry;
import java.nio.charset.StandardCharsets;
import java.nio.file.Files;
import java.nio.file.Path;
import java.util.List;
import java.util.Map;
import org.junit.jupiter.api.BeforeEach;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.api.io.TempDir;

/** The file that the player keeps, and the media in it. */
class MemoryTest {
    @TempDir Path folder;

    private Path file;
    private Memory memory;
    private RecentMedia recent;

    @BeforeEach
    void make() {
        file = folder.resolve("orv/player.conf");
        memory = Memory.in(file);
        recent = new RecentMedia(memory);
    }

    @Test
    void aFileThatIsNotThereIsEmpty() {
        assertEquals(Map.of(), memory.read());
        assertFalse(Files.exists(file.getParent()));
    }

    @Test
    void anyTextComesBack() {
        String text = " a\\b: =#é\nשלום\t";
        memory.update(values -> values.put("name", text));
        assertEquals(Map.of("name", text), Memory.in(file).read());
    }

    @Test
    void whatOthersWroteStays() throws Exception {
        memory.update(values -> values.put("volume", "40"));
        Files.writeString(file, "later.version = x\nvolume=50\n");
        memory.update(values -> values.put("window", "1 2 3x4"));
        assertEquals(
                Map.of("later.version", "x", "volume", "50", "window", "1 2 3x4"), memory.read());
    }

    @Test
    void nothingElseIsLeftInTheFolder() throws Exception {
        memory.update(values -> values.put("volume", "40"));
        try (var files = Files.list(file.getParent())) {
            assertEquals(List.of(file), files.toList());
        }
    }

    @Test
    void aFileThatCannotBeReadIsLeftAlone() throws Exception {
        Files.createDirectories(file.getParent());
        byte[] noise = "a=\\u00zz\n".getBytes(StandardCharsets.ISO_8859_1);
        Files.write(file, noise);
        assertEquals(Map.of(), memory.read());
        memory.update(values -> values.put("volume", "40"));
        assertEquals("a=\\u00zz\n", Files.readString(file));
    }

    @Test
    void aFolderThatIsAFileIsNoFailure() throws Exception {
        Files.writeString(file.getParent(), "");
        memory.update(values -> values.put("volume", "40"));
        assertEquals(Map.of(), Memory.none().read());
        assertEquals("", Files.readString(file.getParent()));
    }

    @Test
    void theNewestMediaComeFirstEachOnce() {
        for (int i = 0; i < 30; i++) {
            recent.add(new Entry("/" + i, i == 29 ? "Title" : ""), 60_000, 600_000);
        }
        recent.add(new Entry("/15"), 61_000, 600_000);
        List<RecentMedia.Item> items = recent.list();
        assertEquals(20, items.size());
        assertEquals(new RecentMedia.Item(new Entry("/15"), 61_000), items.get(0));
        assertEquals(new RecentMedia.Item(new Entry("/29", "Title"), 60_000), items.get(1));
        assertEquals(1, items.stream().filter(i -> i.entry().source().equals("/15")).count());
    }

    @Test
    void placesNearTheStartAndTheEndAreNone() {
        int[][] places = {{9_999, 0}, {10_000, 10_000}, {50_000, 50_000}, {50_001, 0}};
        for (int[] place : places) {
            recent.add(new Entry("/a"), place[0], 60_000);
            assertEquals(place[1], recent.positionOf("/a"));
        }
        recent.add(new Entry("/live"), 30_000, 0);
        assertEquals(0, recent.positionOf("/live"));
        assertEquals(0, recent.positionOf("/never"));
    }

    @Test
    void standardInputHasNoPlace() {
        recent.add(new Entry("-"), 30_000, 60_000);
        assertTrue(recent.list().isEmpty());
    }

    @Test
    void whatSomebodyWroteThereByMistakeIsNoPlace() {
        memory.update(values -> {
            values.put("recent.01.source", "/a");
            values.put("recent.01.position", "soon");
            values.put("recent.03.source", "/b");
            values.put("recent.03.position", "1:00");
        });
        assertEquals(0, recent.positionOf("/a"));
        assertEquals(60_000, recent.positionOf("/b"));
    }
}
