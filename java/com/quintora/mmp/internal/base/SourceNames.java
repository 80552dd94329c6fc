// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.base;

import java.net.URI;
import java.nio.file.FileSystems;
import java.nio.file.Path;

/** What the engine calls a file or URI. */
public final class SourceNames {
    private SourceNames() {}

    public static String of(Path file) {
        if (Arguments.require(file, "the file").getFileSystem() != FileSystems.getDefault()) {
            throw new IllegalArgumentException(
                    file + " is in " + file.getFileSystem()
                            + ", of which the engine knows nothing; use a MediaStreamSource");
        }
        return file.toAbsolutePath().toString();
    }

    // The engine takes what follows file:// as it stands, without percent signs.
    public static String of(URI uri) {
        if (!Arguments.require(uri, "the URI").isAbsolute()) {
            throw new IllegalArgumentException("the URI " + uri + " names no scheme");
        }
        return "file".equalsIgnoreCase(uri.getScheme())
                ? of(Path.of(uri))
                : uri.toASCIIString();
    }
}
