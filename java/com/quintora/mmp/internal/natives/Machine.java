// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.natives;

import java.util.Locale;

/**
 * What a native library is built for.
 *
 * @param system the operating system in small letters, as in "linux"
 * @param architecture the processor's, as in "x86_64", "armhf" or "aarch64"
 */
record Machine(String system, String architecture) {
    /** Those that native JARs are made for, and one that many have. */
    static final String[] KNOWN = {"linux-x86_64", "linux-armhf", "linux-aarch64"};

    static Machine ofThisVm() {
        return of(System.getProperty("os.name"), System.getProperty("os.arch"));
    }

    /** From Java's names of them, those of the properties os.name and os.arch. */
    static Machine of(String osName, String osArch) {
        String system = osName.toLowerCase(Locale.ROOT).replace(" ", "");
        return new Machine(system, architecture(osArch.toLowerCase(Locale.ROOT)));
    }

    private static String architecture(String osArch) {
        switch (osArch) {
            case "amd64":
            case "x86-64":
                return "x86_64";
            case "arm":
                return "armhf";
            case "i386":
            case "i486":
            case "i586":
            case "i686":
                return "x86";
            default:
                return osArch;
        }
    }

    /** The classifier of the native JAR, which is also the name of the folder in it. */
    String name() {
        return system + "-" + architecture;
    }
}
