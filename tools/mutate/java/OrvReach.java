// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import java.io.IOException;
import java.nio.file.Files;
import java.nio.file.Path;
import java.nio.file.StandardOpenOption;
import java.util.Set;
import java.util.concurrent.ConcurrentHashMap;

/** Which methods a process calls: appended to the file that ORV_REACH names, when it ends. */
public final class OrvReach {
    private static final Set<String> NOTED = ConcurrentHashMap.newKeySet();

    static {
        Runtime.getRuntime().addShutdownHook(new Thread(OrvReach::write));
    }

    private OrvReach() {}

    public static void note(String place) {
        NOTED.add(place);
    }

    private static void write() {
        try {
            Files.write(Path.of(System.getenv("ORV_REACH")), NOTED,
                    StandardOpenOption.CREATE, StandardOpenOption.APPEND);
        } catch (IOException e) {
            throw new java.io.UncheckedIOException(e);
        }
    }
}
