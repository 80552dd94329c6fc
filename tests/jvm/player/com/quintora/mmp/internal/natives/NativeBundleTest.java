// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.natives;

import static org.junit.jupiter.api.Assertions.assertArrayEquals;
import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertNotEquals;
import static org.junit.jupiter.api.Assertions.assertThrows;

import java.io.IOException;
import java.util.List;
import java.util.Map;
import org.junit.jupiter.api.Test;

class NativeBundleTest {
    private static String refusal(String list) {
        return assertThrows(IOException.class, () -> Bundles.listed(list, Map.of())).getMessage();
    }

    @Test
    void theListSaysWhatThereIs() throws Exception {
        NativeBundle bundle = Bundles.bundle("1.2.3", Bundles.twoFiles());
        assertEquals("1.2.3", bundle.version());
        assertEquals("Debian 99", bundle.system());
        List<NativeBundle.Entry> entries = bundle.entries();
        assertEquals("libfirst.so", entries.get(0).name());
        assertEquals("libsecond.so", entries.get(1).name());
        assertArrayEquals(Bundles.twoFiles().get("libfirst.so"), bundle.read(entries.get(0)));
    }

    @Test
    void otherContentsHaveAnotherIdentity() throws Exception {
        Map<String, byte[]> others = Bundles.twoFiles();
        others.put("libsecond.so", Bundles.bytes("changed"));
        assertNotEquals(Bundles.bundle("1", Bundles.twoFiles()).identity(),
                Bundles.bundle("1", others).identity());
        assertNotEquals(Bundles.bundle("1", Bundles.twoFiles()).identity(),
                Bundles.bundle("2", Bundles.twoFiles()).identity());
    }

    @Test
    void aLibraryMayHaveTheNumberOfItsInterfaceInItsName() throws Exception {
        byte[] bytes = Bundles.bytes("x");
        NativeBundle bundle = Bundles.bundle("1",
                Map.of("libplain.so", bytes, "libnumbered.so.1", bytes));
        assertEquals("libplain.so", bundle.fileOf("libplain.so"));
        assertEquals("libnumbered.so.1", bundle.fileOf("libnumbered.so"));
        assertEquals("here lists no libnumber.so",
                assertThrows(IOException.class, () -> bundle.fileOf("libnumber.so")).getMessage());
    }

    @Test
    void aDamagedJarIsRecognized() throws Exception {
        Map<String, byte[]> files = Bundles.twoFiles();
        String list = Bundles.list("1", files);
        files.get("libsecond.so")[5] ^= 1;
        NativeBundle bundle = Bundles.listed(list, files);
        bundle.read(bundle.entries().get(0));
        IOException refusal =
                assertThrows(IOException.class, () -> bundle.read(bundle.entries().get(1)));
        assertEquals("libsecond.so in the native JAR is not the one of its list here; the JAR is"
                + " damaged", refusal.getMessage());
    }

    @Test
    void badListsAreRefusedInASentence() {
        assertEquals("here is not a list of native libraries with their version", refusal(""));
        assertEquals("here has a line that is not understood: hello", refusal("hello\n"));
        assertEquals("here has a size that is not a number: many",
                refusal("file libx.so many 00000000 0"));
        for (String name : List.of("../libx.so", "/etc/libx.so", ".hidden")) {
            assertEquals("here has a name that is not a file's: " + name,
                    refusal("file " + name + " 1 00000000 0"));
        }
        assertEquals("here has a name that is not a file's: ../1", refusal("version ../1"));
        assertEquals("here has a name that is not a file's: a/b", refusal("digest a/b"));
    }
}
