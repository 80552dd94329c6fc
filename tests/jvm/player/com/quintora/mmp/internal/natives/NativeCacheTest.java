// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.natives;

import static org.junit.jupiter.api.Assertions.assertArrayEquals;
import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertFalse;
import static org.junit.jupiter.api.Assertions.assertThrows;
import static org.junit.jupiter.api.Assertions.assertTrue;

import java.io.IOException;
import java.nio.file.Files;
import java.nio.file.Path;
import java.nio.file.attribute.FileTime;
import java.time.Instant;
import java.util.ArrayList;
import java.util.Arrays;
import java.util.List;
import java.util.Map;
import java.util.TreeSet;
import java.util.stream.Stream;
import org.junit.jupiter.api.BeforeEach;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.api.io.TempDir;

class NativeCacheTest {
    @TempDir Path root;
    private final Map<String, byte[]> files = Bundles.twoFiles();
    private final List<String> written = new ArrayList<>();
    private NativeBundle bundle;
    private NativeCache cache;

    @BeforeEach
    void make() throws IOException {
        bundle = Bundles.bundle("1.0.0", files);
        cache = new NativeCache(root.resolve("cache"), (file, bytes) -> {
            written.add(file.getFileName().toString().replaceFirst("\\.so\\..*", ".so"));
            NativeCache.TO_DISK.write(file, bytes);
        });
    }

    /** The folder has those files whole, and nothing else. */
    private void assertWhole(Path folder) throws IOException {
        try (Stream<Path> there = Files.list(folder)) {
            assertEquals(new TreeSet<>(files.keySet()),
                    new TreeSet<>(there.map(p -> p.getFileName().toString()).toList()));
        }
        for (Map.Entry<String, byte[]> file : files.entrySet()) {
            assertArrayEquals(file.getValue(), Files.readAllBytes(folder.resolve(file.getKey())));
        }
    }

    @Test
    void unpacksOnceIntoAFolderOfVersionAndDigest() throws Exception {
        Path folder = cache.unpack(bundle);
        assertEquals(root.resolve("cache").resolve(bundle.identity()), folder);
        assertTrue(bundle.identity().matches("1\\.0\\.0-[0-9a-f]{16}"), bundle.identity());
        assertWhole(folder);
        assertEquals(List.of("libfirst.so", "libsecond.so"), written);
        assertEquals(folder, cache.unpack(bundle));
        assertEquals(2, written.size());
    }

    @Test
    void whatIsMissingShortOrChangedIsWrittenAgain() throws Exception {
        Path folder = cache.unpack(bundle);
        Path second = folder.resolve("libsecond.so");
        byte[] whole = files.get("libsecond.so");
        byte[] changed = whole.clone();
        changed[whole.length / 2] ^= 1;
        for (byte[] wrong : List.of(new byte[0], Arrays.copyOf(whole, 100), changed)) {
            Files.write(second, wrong);
            written.clear();
            cache.unpack(bundle);
            assertEquals(List.of("libsecond.so"), written);
            assertWhole(folder);
        }
        Files.delete(second);
        cache.unpack(bundle);
        assertWhole(folder);
    }

    @Test
    void aLibraryThatIsInUseStaysWhatItWas() throws Exception {
        Path second = cache.unpack(bundle).resolve("libsecond.so");
        Files.writeString(second, "in use");
        try (var open = Files.newInputStream(second)) {
            cache.unpack(bundle);
            assertEquals("in use", new String(open.readAllBytes()));
        }
        assertArrayEquals(files.get("libsecond.so"), Files.readAllBytes(second));
    }

    @Test
    void aFailureLeavesNoHalfFileAndTheNextRunGoesOn() throws Exception {
        NativeCache failing = new NativeCache(root.resolve("cache"), (file, bytes) -> {
            if (file.getFileName().toString().startsWith("libsecond")) {
                Files.write(file, Arrays.copyOf(bytes, 10));
                throw new IOException("No space left on device");
            }
            NativeCache.TO_DISK.write(file, bytes);
        });
        assertThrows(IOException.class, () -> failing.unpack(bundle));
        Path folder = root.resolve("cache").resolve(bundle.identity());
        try (Stream<Path> there = Files.list(folder)) {
            assertEquals(List.of(folder.resolve("libfirst.so")), there.toList());
        }
        cache.unpack(bundle);
        assertEquals(List.of("libsecond.so"), written);
        assertWhole(folder);
    }

    @Test
    void whatAKilledProcessLeftIsRemovedAndWhatAnotherWritesIsNot() throws Exception {
        Path folder = Files.createDirectories(root.resolve("cache").resolve(bundle.identity()));
        Path abandoned = Files.writeString(folder.resolve("libfirst.so.1-1.part"), "half");
        Path current = Files.writeString(folder.resolve("libfirst.so.2-1.part"), "half");
        Files.setLastModifiedTime(abandoned, FileTime.from(Instant.now().minusSeconds(7200)));
        cache.unpack(bundle);
        assertFalse(Files.exists(abandoned));
        assertTrue(Files.exists(current));
    }
}
