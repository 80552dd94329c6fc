// SPDX-License-Identifier: Apache-2.0
package android.os;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertTrue;

import java.io.FileDescriptor;
import java.io.FileInputStream;
import java.io.IOException;
import java.nio.file.Files;
import java.nio.file.Path;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.api.io.TempDir;

class FileDescriptorTest {
    @Test
    void nativeCodeSeesTheDescriptorOfAnOpenFile(@TempDir Path folder) throws IOException {
        Path file = Files.createFile(folder.resolve("media"));
        try (FileInputStream stream = new FileInputStream(file.toFile())) {
            int fd = PlatformNatives.fdOf(stream.getFD());
            assertTrue(fd > 2, "descriptor " + fd);
            assertEquals(file.toRealPath(), Path.of("/proc/self/fd/" + fd).toRealPath());
        }
    }

    @Test
    void theStandardStreamsHaveTheirNumbers() {
        assertEquals(0, PlatformNatives.fdOf(FileDescriptor.in));
        assertEquals(2, PlatformNatives.fdOf(FileDescriptor.err));
    }

    @Test
    void noDescriptorIsMinusOne(@TempDir Path folder) throws IOException {
        Path file = Files.createFile(folder.resolve("media"));
        FileInputStream stream = new FileInputStream(file.toFile());
        FileDescriptor descriptor = stream.getFD();
        stream.close();
        assertEquals(-1, PlatformNatives.fdOf(descriptor));
        assertEquals(-1, PlatformNatives.fdOf(new FileDescriptor()));
        assertEquals(-1, PlatformNatives.fdOf(null));
    }
}
