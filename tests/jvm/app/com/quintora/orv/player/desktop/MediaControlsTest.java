// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.desktop;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertFalse;
import static org.junit.jupiter.api.Assertions.assertTrue;

import com.quintora.mmp.Wait;
import java.lang.reflect.Proxy;
import java.util.Arrays;
import java.util.List;
import java.util.concurrent.CopyOnWriteArrayList;
import org.junit.jupiter.api.AfterEach;
import org.junit.jupiter.api.BeforeEach;
import org.junit.jupiter.api.Test;

/** The player as other programs find it on the bus. */
class MediaControlsTest {
    private static final Status PAUSED =
            new Status(
                    1, "A\0 “title” \uD800", "Somebody", "file:///a%20b.mkv", false, 60_000,
                    12_000, 1, 0.5, true, false, false, "None", false);

    private final List<String> asked = new CopyOnWriteArrayList<>();
    private final Remote remote =
            (Remote) Proxy.newProxyInstance(
                    Remote.class.getClassLoader(),
                    new Class<?>[] {Remote.class},
                    (proxy, method, arguments) -> {
                        asked.add(method.getName()
                                + (arguments == null ? "" : Arrays.toString(arguments)));
                        return null;
                    });
    private TestBus bus;
    private MediaControls controls;

    @BeforeEach
    void open() throws Exception {
        bus = new TestBus();
        controls = new MediaControls(bus.address(), remote);
    }

    @AfterEach
    void close() {
        controls.close();
        bus.close();
    }

    @Test
    void propertiesAreThoseOfTheStatus() throws Exception {
        controls.show(PAUSED, false);
        bus.await("PlaybackStatus", "\"Paused\"");
        String all = bus.send(
                "org.freedesktop.DBus.Properties.GetAll", "string:org.mpris.MediaPlayer2.Player");
        for (String part : List.of(
                "int64 12000000", "int64 60000000", "double 0.5", "\"A “title” ?\"",
                "\"Somebody\"", "\"file:///a%20b.mkv\"",
                "object path \"/com/quintora/orv/track/1\"")) {
            assertTrue(all.contains(part), () -> part + " in " + all);
        }
        assertTrue(bus.get("CanGoNext").contains("boolean true"));
        assertTrue(bus.get("CanGoPrevious").contains("boolean false"));
        assertEquals("", bus.get("NoSuchThing"));
    }

    @Test
    void methodsAndPropertiesReachThePlayer() throws Exception {
        controls.show(PAUSED, false);
        bus.await("PlaybackStatus", "Paused");
        bus.call("PlayPause");
        bus.call("Next");
        bus.call("Seek", "int64:-5000000");
        bus.call("SetPosition", "objpath:/com/quintora/orv/track/1", "int64:30000000");
        bus.call("SetPosition", "objpath:/com/quintora/orv/track/7", "int64:30000000");
        bus.call("SetPosition", "objpath:/com/quintora/orv/track/1", "int64:61000000");
        bus.call("OpenUri", "string:http://host/film.mkv");
        bus.set("Volume", "double:1.5");
        bus.set("Rate", "double:0");
        bus.set("Shuffle", "boolean:true");
        bus.set("LoopStatus", "string:Track");
        bus.call("Rewind");
        assertEquals(
                List.of("togglePlaying", "next", "skip[-5000]", "seekTo[30000]",
                        "open[http://host/film.mkv]", "setVolume[1.0]", "setPlaying[false]",
                        "setShuffled[true]", "setLoop[Track]"),
                asked);
    }

    @Test
    void changesAreSignalled() throws Exception {
        var signals = new CopyOnWriteArrayList<String>();
        Process monitor =
                new ProcessBuilder("dbus-monitor", "--address", bus.address(), "type='signal'")
                        .start();
        Thread reader = new Thread(() -> monitor.inputReader().lines().forEach(signals::add));
        reader.start();
        try {
            Wait.until("the monitor is there", () -> !signals.isEmpty());
            controls.show(PAUSED, false);
            bus.await("PlaybackStatus", "Paused");
            controls.show(PAUSED.at(40_000), false);
            awaitLine(signals, "member=Seeked");
            awaitLine(signals, "int64 40000000");
            controls.show(PAUSED.at(40_100), false);
            controls.show(new Status(
                    1, "Other", "", "", false, 60_000, 40_200, 1, 0.5, true, false, false, "None",
                    false), false);
            awaitLine(signals, "member=PropertiesChanged");
            awaitLine(signals, "\"Other\"");
            long seeks = signals.stream().filter(line -> line.contains("=Seeked")).count();
            assertEquals(1, seeks);
            assertFalse(signals.stream().anyMatch(line -> line.contains("PlaybackStatus")));
        } finally {
            monitor.destroy();
            reader.join();
        }
    }

    private static void awaitLine(List<String> lines, String part) throws Exception {
        Wait.until(part, () -> lines.stream().anyMatch(line -> line.contains(part)));
    }

    @Test
    void theScreenSaverIsKeptAwayWhilePlaying() throws Exception {
        var calls = new CopyOnWriteArrayList<String>();
        Bus saver = new Bus(bus.address());
        assertTrue(saver.takeName("org.freedesktop.ScreenSaver"));
        Thread thread = new Thread(() -> saver.run((type, method, values) -> {
            calls.add(method + values);
            return method.equals("Inhibit") ? List.of(7) : List.of();
        }));
        thread.start();
        try {
            controls.show(PAUSED, true);
            Wait.until("it is asked for", () -> calls.size() == 1);
            controls.show(PAUSED, false);
            Wait.until("it is given back", () -> calls.size() == 2);
            controls.show(PAUSED, true);
            Wait.until("it is asked for again", () -> calls.size() == 3);
            controls.close();
            Wait.until("it is given back at the end", () -> calls.size() == 4);
            assertEquals(
                    List.of("Inhibit[orv, A video is playing]", "UnInhibit[7]",
                            "Inhibit[orv, A video is playing]", "UnInhibit[7]"),
                    calls);
        } finally {
            saver.close();
            thread.join();
        }
    }

    @Test
    void aSecondPlayerHasANameOfItsOwn() throws Exception {
        controls.show(PAUSED, false);
        bus.await("PlaybackStatus", "Paused");
        try (MediaControls second = new MediaControls(bus.address(), remote)) {
            second.show(PAUSED, false);
            String name = "org.mpris.MediaPlayer2.orv.instance" + ProcessHandle.current().pid();
            Wait.until("it is there", () -> names().contains(name));
        }
    }

    private String names() throws Exception {
        Process process =
                new ProcessBuilder("dbus-send", "--bus=" + bus.address(), "--print-reply",
                                "--dest=org.freedesktop.DBus", "/org/freedesktop/DBus",
                                "org.freedesktop.DBus.ListNames")
                        .start();
        return String.join("\n", process.inputReader().lines().toList());
    }

    @Test
    void aBusThatIsNotThereIsNoFailure() throws Exception {
        try (MediaControls none = new MediaControls("unix:path=/nowhere/bus", remote)) {
            none.show(PAUSED, true);
            none.show(PAUSED.at(50_000), true);
        }
        try (MediaControls none = new MediaControls("disabled:", remote)) {
            none.show(PAUSED, true);
        }
    }

    @Test
    void aBusThatGoesAwayIsNoFailure() throws Exception {
        controls.show(PAUSED, true);
        bus.await("PlaybackStatus", "Paused");
        bus.close();
        controls.show(PAUSED.at(50_000), true);
        controls.close();
    }
}
