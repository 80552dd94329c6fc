// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.natives;

import java.io.IOException;

/** Whether a native library goes with this virtual machine and these classes. */
final class LibraryCheck {
    private LibraryCheck() {}

    /**
     * Throws an UnsatisfiedLinkError with a sentence unless that file is a library for that machine
     * and of that version. A library that does not say its version passes, as those of televisions
     * do not; so does each where the version asked for is null.
     */
    static void check(String file, Machine machine, String version) {
        ElfFile library = read(file);
        if (!library.architecture().equals(machine.architecture())) {
            throw new UnsatisfiedLinkError(
                    file + " is built for " + library.architecture()
                            + ", but this Java virtual machine is one for "
                            + machine.architecture()
                            + ": use the library or the Java of the other's architecture.");
        }
        if (version != null && library.version() != null && !library.version().equals(version)) {
            throw new UnsatisfiedLinkError(
                    file + " is version " + library.version()
                            + ", but the Java classes are version " + version
                            + ": install both of one version, or leave the library's folder out of"
                            + " java.library.path, so that the native JAR is used.");
        }
    }

    private static ElfFile read(String file) {
        try {
            return ElfFile.read(file);
        } catch (IOException e) {
            throw LoadFailures.because("The native library cannot be used: " + e.getMessage(), e);
        }
    }
}
