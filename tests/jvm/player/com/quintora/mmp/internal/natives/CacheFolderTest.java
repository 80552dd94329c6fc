// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.natives;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertNull;
import static org.junit.jupiter.api.Assertions.assertThrows;
import static org.junit.jupiter.api.Assertions.assertTrue;
import static org.junit.jupiter.api.Assumptions.assumeFalse;

import java.io.IOException;
import java.nio.file.Files;
import java.nio.file.Path;
import java.nio.file.attribute.PosixFilePermissions;
import java.util.ArrayList;
import java.util.List;
import java.util.Map;
import java.util.Properties;
import java.util.logging.Handler;
import java.util.logging.LogRecord;
import java.util.logging.Logger;
import org.junit.jupiter.api.AfterEach;
import org.junit.jupiter.api.BeforeEach;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.api.io.TempDir;

class CacheFolderTest {
    /** Fails as a write to a full disk does. */
    private static final NativeCache.Writer FULL =
            (file, bytes) -> Files.write(Path.of("/dev/full"), bytes);

    @TempDir Path folder;
    private Path preferred;
    private Path temporary;
    private NativeBundle bundle;

    private final Logger logger = Logger.getLogger("com.quintora.mmp");
    private final List<String> warnings = new ArrayList<>();
    private final Handler handler = new Handler() {
        @Override
        public void publish(LogRecord line) {
            warnings.add(line.getLevel() + " " + line.getMessage());
        }

        @Override
        public void flush() {}

        @Override
        public void close() {}
    };

    @BeforeEach
    void make() throws IOException {
        preferred = folder.resolve("cache");
        temporary = Files.createDirectory(folder.resolve("tmp"));
        bundle = Bundles.bundle("1.0.0", Bundles.twoFiles());
        logger.addHandler(handler);
        logger.setUseParentHandlers(false);
    }

    @AfterEach
    void stopListening() {
        logger.removeHandler(handler);
        logger.setUseParentHandlers(true);
    }

    private Path unpack(NativeCache.Writer writer) {
        return new CacheFolder(preferred, temporary, writer).unpack(bundle);
    }

    /** The libraries are in a folder of this process, and one warning says why. */
    private void assertTemporary(Path unpacked, String reason) {
        assertTrue(unpacked.startsWith(temporary), unpacked::toString);
        assertTrue(Files.isRegularFile(unpacked.resolve("libsecond.so")));
        assertEquals(List.of("WARNING The native libraries are unpacked into "
                + unpacked.getParent() + " for this process alone, as " + reason
                + ". The system property com.quintora.mmp.cache names another folder."), warnings);
    }

    @Test
    void theUsersCacheIsTakenWithoutAWord() {
        assertEquals(preferred.resolve(bundle.identity()), unpack(NativeCache.TO_DISK));
        assertEquals(List.of(), warnings);
    }

    @Test
    void aCacheThatIsAFileIsReplacedByATemporaryFolder() throws Exception {
        Files.createFile(preferred);
        assertTemporary(unpack(NativeCache.TO_DISK), preferred + " cannot be used: "
                + preferred.resolve(bundle.identity()) + ": Not a directory");
    }

    @Test
    void aCacheWithoutPermissionIsReplacedByATemporaryFolder() throws Exception {
        Files.createDirectory(preferred,
                PosixFilePermissions.asFileAttribute(PosixFilePermissions.fromString("r-x------")));
        assumeFalse(Files.isWritable(preferred), "root may write anywhere");
        assertTemporary(unpack(NativeCache.TO_DISK), preferred
                + " cannot be used: no permission for " + preferred.resolve(bundle.identity()));
    }

    @Test
    void aFullDiskOfTheCacheIsEvadedInTheTemporaryFolder() {
        assertTemporary(unpack((file, bytes) -> {
            if (file.startsWith(preferred)) {
                FULL.write(file, bytes);
            }
            NativeCache.TO_DISK.write(file, bytes);
        }), preferred + " cannot be used: No space left on device");
    }

    @Test
    void aCompleteCacheThatCannotBeWrittenIsUsed() {
        Path unpacked = unpack(NativeCache.TO_DISK);
        assertEquals(unpacked, unpack((file, bytes) -> {
            throw new IOException("Read-only file system");
        }));
        assertEquals(List.of(), warnings);
    }

    @Test
    void withNowhereToWriteTheRefusalSaysBothReasonsAndTheProperty() {
        assertEquals("The native libraries cannot be unpacked: " + preferred
                + " cannot be used: No space left on device, and neither can " + temporary
                + ": No space left on device. Name a folder that can be written to with"
                + " -Dcom.quintora.mmp.cache=FOLDER.",
                assertThrows(UnsatisfiedLinkError.class, () -> unpack(FULL)).getMessage());
    }

    @Test
    void aUserWithoutAHomeGetsATemporaryFolder() {
        preferred = null;
        assertTemporary(unpack(NativeCache.TO_DISK), "the user has no home folder");
    }

    @Test
    void theFolderIsThatOfThePropertyElseOfTheCacheElseOfTheHome() {
        Properties properties = new Properties();
        properties.setProperty("user.home", "/home/x");
        assertEquals(Path.of("/home/x/.cache/mediaplayer-orv"),
                CacheFolder.preferred(properties, Map.of()));
        Map<String, String> environment = Map.of("XDG_CACHE_HOME", "/cache");
        assertEquals(Path.of("/cache/mediaplayer-orv"),
                CacheFolder.preferred(properties, environment));
        assertEquals(Path.of("/home/x/.cache/mediaplayer-orv"),
                CacheFolder.preferred(properties, Map.of("XDG_CACHE_HOME", "relative")));
        properties.setProperty("com.quintora.mmp.cache", "/named");
        assertEquals(Path.of("/named"), CacheFolder.preferred(properties, environment));
        properties.setProperty("com.quintora.mmp.cache", "named");
        assertTrue(CacheFolder.preferred(properties, environment).isAbsolute());
        properties.remove("com.quintora.mmp.cache");
        properties.setProperty("user.home", "?");
        assertNull(CacheFolder.preferred(properties, Map.of()));
    }
}
