// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.natives;

import java.io.IOException;
import java.nio.file.Path;
import java.util.List;

/** The libraries of the native JAR that goes with this virtual machine, unpacked. */
final class NativeJar {
    /** Where this process has its libraries, once they are unpacked: all come from one folder. */
    private static Path unpacked;

    private static String system;

    private NativeJar() {}

    /**
     * The file of that name in the folder that they are unpacked into. Throws an
     * UnsatisfiedLinkError with sentences when there is no fitting native JAR, or no place for it.
     */
    static synchronized Path library(String fileName) {
        if (unpacked == null) {
            NativeBundle bundle =
                    choose(BundleFinder.ofThisVm(), Machine.ofThisVm(), JavaVersion.read());
            unpacked = CacheFolder.ofThisVm().unpack(bundle);
            system = bundle.system();
        }
        return unpacked.resolve(fileName);
    }

    /** What the unpacked libraries were built on, as in "Debian 12"; null before there are any. */
    static synchronized String system() {
        return system;
    }

    /** The bundle for that machine and of that version; of any version where that is null. */
    static NativeBundle choose(BundleFinder finder, Machine machine, String version) {
        try {
            List<NativeBundle> bundles = finder.find(machine);
            for (NativeBundle bundle : bundles) {
                if (version == null || bundle.version().equals(version)) {
                    return bundle;
                }
            }
            throw bundles.isEmpty()
                    ? LoadFailures.missing(machine, version, finder.machines())
                    : LoadFailures.otherVersion(bundles.get(0), version);
        } catch (IOException e) {
            throw LoadFailures.because("The native JAR cannot be read: " + e.getMessage(), e);
        }
    }
}
