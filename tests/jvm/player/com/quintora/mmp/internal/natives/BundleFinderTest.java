// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.natives;

import static org.junit.jupiter.api.Assertions.assertArrayEquals;
import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertThrows;
import static org.junit.jupiter.api.Assertions.assertTrue;

import java.io.IOException;
import java.net.URL;
import java.net.URLClassLoader;
import java.nio.file.Files;
import java.nio.file.Path;
import java.util.List;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.api.io.TempDir;

class BundleFinderTest {
    private static final Machine X86_64 = new Machine("linux", "x86_64");
    private static final Machine ARMHF = new Machine("linux", "armhf");

    @TempDir Path folder;

    private Path jar(String name, Machine machine, String version) throws IOException {
        return Bundles.jar(folder.resolve(name), machine, version, Bundles.twoFiles());
    }

    private static BundleFinder onClassPath(Path... jars) throws IOException {
        URL[] places = new URL[jars.length];
        for (int i = 0; i < jars.length; i++) {
            places[i] = jars[i].toUri().toURL();
        }
        return new BundleFinder(new URLClassLoader(places, null), null);
    }

    private static BundleFinder onModulePath(String path) {
        return new BundleFinder(new URLClassLoader(new URL[0], null), path);
    }

    private static void assertReads(NativeBundle bundle) throws IOException {
        for (NativeBundle.Entry entry : bundle.entries()) {
            assertArrayEquals(Bundles.twoFiles().get(entry.name()), bundle.read(entry));
        }
        assertEquals(2, bundle.entries().size());
    }

    @Test
    void theJarOfTheMachineIsFoundOnTheClassPath() throws Exception {
        BundleFinder finder = onClassPath(jar("arm.jar", ARMHF, "1"), jar("x.jar", X86_64, "2"));
        List<NativeBundle> found = finder.find(X86_64);
        assertEquals(1, found.size());
        assertEquals("2", found.get(0).version());
        assertReads(found.get(0));
        assertEquals(List.of("linux-x86_64", "linux-armhf"), finder.machines());
    }

    @Test
    void theJarIsFoundOnTheModulePathThoughNothingRequiresIt() throws Exception {
        jar("mediaplayer-orv-linux.jar", X86_64, "3");
        for (String path : List.of(folder.toString(),
                "/missing:" + folder.resolve("mediaplayer-orv-linux.jar"))) {
            List<NativeBundle> found = onModulePath(path).find(X86_64);
            assertEquals(1, found.size(), path);
            assertReads(found.get(0));
        }
        assertTrue(onModulePath(folder.toString()).find(ARMHF).isEmpty());
    }

    @Test
    void aModulePathThatCannotBeReadIsRefusedInASentence() throws Exception {
        Files.writeString(folder.resolve("broken.jar"), "not a JAR");
        String refusal = assertThrows(IOException.class,
                () -> onModulePath(folder.toString()).find(X86_64)).getMessage();
        assertTrue(refusal.startsWith("the module path [" + folder + "] cannot be read: "),
                refusal);
    }

    @Test
    void theVersionOfTheClassesIsChosen() throws Exception {
        BundleFinder finder = onClassPath(jar("a.jar", X86_64, "1"), jar("b.jar", X86_64, "2"));
        assertEquals("2", NativeJar.choose(finder, X86_64, "2").version());
        assertEquals("1", NativeJar.choose(finder, X86_64, null).version());
        String refusal = assertThrows(UnsatisfiedLinkError.class,
                () -> NativeJar.choose(finder, X86_64, "3")).getMessage();
        assertTrue(refusal.startsWith("The native JAR is version 1, but the Java classes are"
                + " version 3: give both dependencies one version."), refusal);
    }

    @Test
    void withoutAJarTheRefusalSaysWhatWasLookedForAndWhatToDo() throws Exception {
        String refusal = assertThrows(UnsatisfiedLinkError.class,
                () -> NativeJar.choose(onClassPath(), X86_64, "1.0.0")).getMessage();
        for (String part : List.of(
                "There is no native library of the player for linux-x86_64.",
                LibraryPath.folders(System.getProperty("java.library.path")).get(0),
                "META-INF/native/linux-x86_64/mediaplayer-orv.list",
                "com.quintora.mmp:mediaplayer-orv:1.0.0:linux-x86_64",
                "Debian package",
                "./orv build")) {
            assertTrue(refusal.contains(part), () -> part + " in " + refusal);
        }
    }

    @Test
    void aJarForAnotherMachineIsNamed() throws Exception {
        BundleFinder finder = onClassPath(jar("arm.jar", ARMHF, "1"));
        String refusal = assertThrows(UnsatisfiedLinkError.class,
                () -> NativeJar.choose(finder, X86_64, "1")).getMessage();
        assertTrue(refusal.contains("There are native JARs, but for linux-armhf."), refusal);
        assertTrue(refusal.contains("for linux-x86_64."), refusal);
    }
}
