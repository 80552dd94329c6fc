// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.desktop;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertTrue;

import java.lang.module.Configuration;
import java.lang.module.ModuleDescriptor;
import java.lang.module.ModuleDescriptor.Requires;
import java.lang.module.ModuleFinder;
import java.net.URL;
import java.nio.file.Path;
import java.util.Set;
import java.util.stream.Collectors;
import org.junit.jupiter.api.Test;

/** The jar as a module; the other tests have it on the class path. */
class PlatformModuleTest {
    private static final String NAME = "com.quintora.mmp.platform";

    private final ModuleFinder finder = ModuleFinder.of(jar());

    // Of the class file alone: the class would load the native library, which one loader can.
    private static Path jar() {
        URL url = PlatformModuleTest.class.getResource("/android/view/Surface.class");
        String path = url.getPath();
        return Path.of(path.substring("file:".length(), path.indexOf("!")));
    }

    @Test
    void exportsThePlatformsPackagesAndTheDesktops() {
        ModuleDescriptor module = finder.find(NAME).orElseThrow().descriptor();
        assertEquals(
                Set.of("android.graphics", "android.media", "android.os", "android.view",
                        "com.quintora.mmp.desktop"),
                module.exports().stream().map(ModuleDescriptor.Exports::source)
                        .collect(Collectors.toSet()));
        assertTrue(module.exports().stream().noneMatch(ModuleDescriptor.Exports::isQualified));
        assertTrue(module.requires().stream().anyMatch(
                needed -> needed.name().equals("java.desktop")
                        && needed.modifiers().contains(Requires.Modifier.TRANSITIVE)));
    }

    @Test
    void nativeCodeFindsTheModulesClasses() throws Exception {
        ModuleLayer boot = ModuleLayer.boot();
        Configuration configuration =
                boot.configuration().resolve(finder, ModuleFinder.of(), Set.of(NAME));
        ClassLoader loader = boot.defineModulesWithOneLoader(configuration, null).findLoader(NAME);
        Class<?> readerClass = loader.loadClass("com.quintora.mmp.desktop.FrameReader");
        assertEquals(NAME, readerClass.getModule().getName());
        try (AutoCloseable reader =
                (AutoCloseable) readerClass.getDeclaredConstructor().newInstance()) {
            Object surface = readerClass.getMethod("getSurface").invoke(reader);
            assertEquals(NAME, surface.getClass().getModule().getName());
            assertEquals(true, surface.getClass().getMethod("isValid").invoke(surface));
        }
    }
}
