// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.natives;

import java.io.IOException;
import java.nio.file.Path;
import java.util.List;

/** The libraries of the native JAR that goes with this virtual machine, unpacked. */
final class NativeJar {
    /** What this process unpacked, and where; null before. All libraries are from one bundle. */
    private static NativeBundle bundle;

    private static Path folder;

    private NativeJar() {}

    /**
     * The unpacked file with that library, such as "libx.so". Throws an UnsatisfiedLinkError with
     * sentences when there is no fitting native JAR, or no place for it.
     */
    static synchronized Path library(String name) {
        if (bundle == null) {
            NativeBundle chosen =
                    choose(BundleFinder.ofThisVm(), Machine.ofThisVm(), JavaVersion.read());
            folder = CacheFolder.ofThisVm().unpack(chosen);
            bundle = chosen;
        }
        try {
            return folder.resolve(bundle.fileOf(name));
        } catch (IOException e) {
            throw LoadFailures.because("The native JAR is not whole: " + e.getMessage(), e);
        }
    }

    /** What the unpacked libraries were built on, as in "Debian 12"; null before there are any. */
    static synchronized String system() {
        return bundle == null ? null : bundle.system();
    }

    /** The bundle for that machine and of that version; of any version where that is null. */
    static NativeBundle choose(BundleFinder finder, Machine machine, String version) {
        try {
            List<NativeBundle> bundles = finder.find(machine);
            for (NativeBundle found : bundles) {
                if (version == null || found.version().equals(version)) {
                    return found;
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
