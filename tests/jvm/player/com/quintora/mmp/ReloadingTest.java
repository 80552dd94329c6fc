// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertNotSame;
import static org.junit.jupiter.api.Assertions.assertTrue;

import java.io.File;
import java.io.IOException;
import java.lang.ref.WeakReference;
import java.net.URL;
import java.net.URLClassLoader;
import java.nio.file.Files;
import java.nio.file.Path;
import java.util.ArrayList;
import java.util.List;
import org.junit.jupiter.api.Test;

/** Class loaders with classes and native half of their own, one after the other. */
class ReloadingTest {
    @Test
    void aLoaderIsCollectedWithItsPlayersAndTheLibraryCanBeLoadedAgain() throws Exception {
        Dropped first = useAndDrop();
        awaitCollection("the forgotten player", first.player());
        Wait.until("the shared threads had nothing to do for so long that they ended",
                () -> !sharedThreadsRun());
        awaitCollection("the loader", first.loader());
        Wait.until("another loader could have the library", ReloadingTest::loadsAgain);
        assertTrue(isMapped());
    }

    /** What must be collected. */
    private record Dropped(WeakReference<?> loader, WeakReference<?> player) {}

    private static void awaitCollection(String what, WeakReference<?> reference)
            throws Exception {
        Wait.until(what + " was collected", () -> {
            System.gc();
            return reference.get() == null;
        });
    }

    private static boolean sharedThreadsRun() {
        return Thread.getAllStackTraces().keySet().stream()
                .anyMatch(thread -> thread.getName().startsWith("OrvMediaPlayer"));
    }

    private static boolean isMapped() throws IOException {
        return Files.readString(Path.of("/proc/self/maps")).contains("libmediaplayer_orv.so");
    }

    /** Releases one player of a new loader, lets another play on, and drops all. */
    private static Dropped useAndDrop() throws Exception {
        URLClassLoader loader = new URLClassLoader(jars(), ClassLoader.getPlatformClassLoader());
        Class<?> type = loader.loadClass("com.quintora.mmp.OrvMediaPlayer");
        assertNotSame(OrvMediaPlayer.class, type);
        type.getMethod("close").invoke(play(type));
        return new Dropped(new WeakReference<>(loader), new WeakReference<>(play(type)));
    }

    /** Whether the library could be loaded: it has one loader at a time, until that is gone. */
    private static boolean loadsAgain() throws Exception {
        try {
            useAndDrop();
            return true;
        } catch (LinkageError held) {
            return false;
        }
    }

    private static Object play(Class<?> type) throws Exception {
        Object player = type.getConstructor().newInstance();
        type.getMethod("setDataSource", String.class).invoke(player, Media.path("video.mp4"));
        type.getMethod("prepareAndWait").invoke(player);
        type.getMethod("start").invoke(player);
        assertEquals(true, type.getMethod("isPlaying").invoke(player));
        return player;
    }

    /** The JARs of the player's and of the desktop's classes. */
    private static URL[] jars() throws Exception {
        List<URL> urls = new ArrayList<>();
        for (String path : System.getProperty("java.class.path").split(File.pathSeparator)) {
            String name = Path.of(path).getFileName().toString();
            if (name.equals("mediaplayer_orv_java.jar") || name.equals("orv_platform_java.jar")) {
                urls.add(Path.of(path).toUri().toURL());
            }
        }
        assertEquals(2, urls.size());
        return urls.toArray(URL[]::new);
    }
}
