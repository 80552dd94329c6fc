// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.natives;

import java.io.IOException;
import java.io.InputStream;
import java.nio.charset.StandardCharsets;

/** The version of this Java half. */
final class JavaVersion {
    private static final String RESOURCE = "/META-INF/mediaplayer-orv.version";

    private JavaVersion() {}

    /** That which the build wrote into the JAR; null where these classes were built otherwise. */
    static String read() {
        try (InputStream in = JavaVersion.class.getResourceAsStream(RESOURCE)) {
            return in == null
                    ? null
                    : new String(in.readAllBytes(), StandardCharsets.UTF_8).trim();
        } catch (IOException e) {
            return null;
        }
    }
}
