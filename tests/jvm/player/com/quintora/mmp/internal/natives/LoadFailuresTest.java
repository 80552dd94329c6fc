// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.natives;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertSame;
import static org.junit.jupiter.api.Assertions.assertTrue;

import java.util.List;
import org.junit.jupiter.api.Test;

class LoadFailuresTest {
    private static String refused(String message) {
        return LoadFailures.refused("/x/lib.so", null, new UnsatisfiedLinkError(message))
                .getMessage();
    }

    @Test
    void aMissingSystemLibraryIsNamedWithItsPackage() {
        String reason =
                "libavcodec.so.59: cannot open shared object file: No such file or directory";
        String refused = refused("/x/lib.so: " + reason);
        assertTrue(refused.startsWith("The native library /x/lib.so did not load: " + reason + "."
                + " The system library libavcodec.so.59 is missing; in Debian it is of the package"
                + " libavcodec59. There, libmpv2 and libcurl3-gnutls bring all"), refused);
    }

    @Test
    void theSystemThatItWasBuiltOnIsNamedWhereItIsKnown() {
        UnsatisfiedLinkError cause = new UnsatisfiedLinkError("strange");
        assertEquals(
                "The native library /x/lib.so was built on Debian 12 and did not load: strange.",
                LoadFailures.refused("/x/lib.so", "Debian 12", cause).getMessage());
        assertEquals("The native library did not load: strange.",
                LoadFailures.refused(null, null, cause).getMessage());
    }

    @Test
    void aLibraryThatIsNowhereHasEveryAdvice() {
        Machine machine = new Machine("linux", "x86_64");
        String missing = LoadFailures.missing(machine, "1.2.3", List.of()).getMessage();
        assertTrue(missing.endsWith("Add the dependency com.quintora.mmp:mediaplayer-orv:1.2.3:"
                + machine.name() + ", or install the Debian package, or build the library with"
                + " ./orv build and start Java with -Djava.library.path=build/lib."), missing);
    }

    @Test
    void debiansRuleGivesThePackages() {
        assertEquals("libavcodec59", DebianPackages.of("libavcodec.so.59"));
        assertEquals("libstdc++6", DebianPackages.of("libstdc++.so.6"));
        assertEquals("libgcc-s1", DebianPackages.of("libgcc_s.so.1"));
        assertEquals("libx264-164", DebianPackages.of("libx264.so.164"));
        assertEquals("libcurl3-gnutls", DebianPackages.of("libcurl-gnutls.so.4"));
        assertEquals("android-libutils", DebianPackages.of("libutils.so.0"));
        assertEquals("p7zip-full", DebianPackages.of("7z.so"));
        assertEquals("strange", DebianPackages.of("strange"));
    }

    @Test
    void otherReasonsHaveTheirAdvice() {
        String noexec = refused("/x/lib.so: /x/lib.so: failed to map segment from shared object");
        assertTrue(noexec.contains("did not load: failed to map segment"), noexec);
        assertTrue(noexec.contains("-Dcom.quintora.mmp.cache=FOLDER"), noexec);
        assertTrue(refused("/lib/libc.so.6: version `GLIBC_2.38' not found (required by"
                + " /x/lib.so)").contains("built on a newer system"));
        assertTrue(refused("Native Library /x/lib.so already loaded in another classloader")
                .contains("one class loader"));
        assertEquals("The native library /x/lib.so did not load: strange.", refused("strange"));
    }

    @Test
    void theMachinesOwnErrorIsTheCause() {
        UnsatisfiedLinkError cause = new UnsatisfiedLinkError("strange");
        assertSame(cause, LoadFailures.refused("/x/lib.so", null, cause).getCause());
    }
}
