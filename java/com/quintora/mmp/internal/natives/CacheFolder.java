// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.natives;

import java.io.IOException;
import java.lang.System.Logger.Level;
import java.nio.file.AccessDeniedException;
import java.nio.file.FileAlreadyExistsException;
import java.nio.file.FileSystemException;
import java.nio.file.Files;
import java.nio.file.Path;
import java.util.Map;
import java.util.Properties;

/** Unpacks into the user's cache or, where that cannot be, into a folder for this process. */
final class CacheFolder {
    /** The system property that names another folder. */
    static final String PROPERTY = "com.quintora.mmp.cache";

    private static final String NAME = "mediaplayer-orv";

    private final Path preferred;
    private final Path temporary;
    private final NativeCache.Writer writer;

    /** The preferred folder is null where the user has none; the other is for temporary files. */
    CacheFolder(Path preferred, Path temporary, NativeCache.Writer writer) {
        this.preferred = preferred;
        this.temporary = temporary;
        this.writer = writer;
    }

    static CacheFolder ofThisVm() {
        Path temporary = Path.of(System.getProperty("java.io.tmpdir"));
        return new CacheFolder(
                preferred(System.getProperties(), System.getenv()), temporary, NativeCache.TO_DISK);
    }

    /** The folder that the user's settings name; null for users without a home. */
    static Path preferred(Properties properties, Map<String, String> environment) {
        String named = properties.getProperty(PROPERTY, "");
        if (!named.isEmpty()) {
            return Path.of(named).toAbsolutePath();
        }
        Path cache = Path.of(environment.getOrDefault("XDG_CACHE_HOME", ""));
        if (!cache.isAbsolute()) {
            cache = Path.of(properties.getProperty("user.home", "")).resolve(".cache");
        }
        return cache.isAbsolute() ? cache.resolve(NAME) : null;
    }

    /**
     * Gives the folder with the bundle's libraries. Logs one warning when it is not the user's
     * cache; throws an UnsatisfiedLinkError when there is no folder to write to.
     */
    Path unpack(NativeBundle bundle) {
        String reason = "the user has no home folder";
        if (preferred != null) {
            try {
                return new NativeCache(preferred, writer).unpack(bundle);
            } catch (IOException e) {
                reason = preferred + " cannot be used: " + reason(e);
            }
        }
        return unpackForThisProcess(bundle, reason);
    }

    private Path unpackForThisProcess(NativeBundle bundle, String reason) {
        try {
            Path root = Files.createTempDirectory(temporary, NAME + "-");
            deleteAtExit(root, bundle);
            Path folder = new NativeCache(root, writer).unpack(bundle);
            System.getLogger("com.quintora.mmp").log(Level.WARNING,
                    "The native libraries are unpacked into " + root
                            + " for this process alone, as " + reason + ". The system property "
                            + PROPERTY + " names another folder.");
            return folder;
        } catch (IOException e) {
            throw LoadFailures.because("The native libraries cannot be unpacked: " + reason
                    + ", and neither can " + temporary + ": " + reason(e)
                    + ". Name a folder that can be written to with -D" + PROPERTY
                    + "=FOLDER.", e);
        }
    }

    /** The last one registered is deleted first. */
    private static void deleteAtExit(Path root, NativeBundle bundle) {
        root.toFile().deleteOnExit();
        Path folder = root.resolve(bundle.identity());
        folder.toFile().deleteOnExit();
        for (NativeBundle.Entry entry : bundle.entries()) {
            folder.resolve(entry.name()).toFile().deleteOnExit();
        }
    }

    /** Why, without Java's names of exceptions. */
    private static String reason(IOException e) {
        if (e instanceof AccessDeniedException denied) {
            return "no permission for " + denied.getFile();
        }
        if (e instanceof FileAlreadyExistsException other) {
            return other.getFile() + " is not a folder";
        }
        if (e instanceof FileSystemException system && system.getReason() != null) {
            return system.getFile() + ": " + system.getReason();
        }
        return e.getMessage();
    }
}
