// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.natives;

import java.util.Locale;
import java.util.Map;
import java.util.Set;

/** The Debian packages of the system's libraries. */
final class DebianPackages {
    private static final Set<String> ANDROID =
            Set.of("libbacktrace", "libbase", "libcutils", "liblog", "libnativehelper", "libutils");
    private static final Map<String, String> EXCEPTIONS =
            Map.of("libcurl-gnutls.so.4", "libcurl3-gnutls", "7z.so", "p7zip-full");

    private DebianPackages() {}

    /** The name by Debian's rule, "libmpv2" for "libmpv.so.2", but for the exceptions we need. */
    static String of(String library) {
        int end = library.indexOf(".so");
        if (EXCEPTIONS.containsKey(library) || end < 0) {
            return EXCEPTIONS.getOrDefault(library, library);
        }
        String name = library.substring(0, end);
        if (ANDROID.contains(name)) {
            return "android-" + name;
        }
        String number = library.substring(end + 3).replaceFirst("^\\.", "");
        String dash = name.matches(".*\\d") && !number.isEmpty() ? "-" : "";
        return (name.replace('_', '-') + dash + number).toLowerCase(Locale.ROOT);
    }
}
