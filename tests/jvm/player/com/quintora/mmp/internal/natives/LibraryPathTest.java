// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.natives;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertNull;

import java.nio.file.Files;
import java.nio.file.Path;
import java.util.List;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.api.io.TempDir;

class LibraryPathTest {
    @TempDir Path folder;

    @Test
    void anEmptyFolderBetweenOthersIsTheCurrentOne() {
        assertEquals(List.of("/a", ".", "/b"), LibraryPath.folders("/a::/b"));
        assertEquals(List.of("/a", "."), LibraryPath.folders("/a:"));
        assertEquals(List.of(".", "/a"), LibraryPath.folders(":/a"));
        assertEquals(List.of("/a"), LibraryPath.folders("/a"));
        assertEquals(List.of(), LibraryPath.folders(""));
        assertEquals(List.of(), LibraryPath.folders(null));
    }

    @Test
    void theFirstFolderWithTheFileWins() throws Exception {
        Path first = Files.createDirectory(folder.resolve("first"));
        Path second = Files.createDirectory(folder.resolve("second"));
        String path = folder.resolve("missing") + ":" + first + ":" + second;
        assertNull(LibraryPath.find(path, "libx.so"));
        Files.createFile(second.resolve("libx.so"));
        assertEquals(second.resolve("libx.so").toString(), LibraryPath.find(path, "libx.so"));
        Files.createFile(first.resolve("libx.so"));
        assertEquals(first.resolve("libx.so").toString(), LibraryPath.find(path, "libx.so"));
    }
}
