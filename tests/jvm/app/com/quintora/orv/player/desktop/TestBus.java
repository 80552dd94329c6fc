// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.desktop;

import com.quintora.mmp.Wait;
import java.io.BufferedReader;
import java.io.IOException;
import java.io.InputStreamReader;
import java.nio.charset.StandardCharsets;
import java.util.ArrayList;
import java.util.List;
import java.util.concurrent.TimeUnit;
import java.util.stream.Stream;

/** A message bus of its own, and dbus-send to ask on it. */
public final class TestBus implements AutoCloseable {
    private static final String OBJECT = "/org/mpris/MediaPlayer2";
    private static final String PLAYER = "org.mpris.MediaPlayer2.Player";

    private final Process daemon;
    private final String address;

    public TestBus() throws IOException {
        daemon =
                new ProcessBuilder("dbus-daemon", "--session", "--nofork", "--print-address")
                        .redirectError(ProcessBuilder.Redirect.DISCARD)
                        .start();
        var output = new InputStreamReader(daemon.getInputStream(), StandardCharsets.UTF_8);
        address = new BufferedReader(output).readLine();
    }

    public String address() {
        return address;
    }

    /** A property of the player's, as dbus-send prints it; empty while there is no player. */
    public String get(String property) throws Exception {
        return send(
                "org.freedesktop.DBus.Properties.Get", "string:" + PLAYER, "string:" + property);
    }

    public void set(String property, String value) throws Exception {
        send(
                "org.freedesktop.DBus.Properties.Set",
                "string:" + PLAYER,
                "string:" + property,
                "variant:" + value);
    }

    /** A method of the player's. */
    public void call(String method, String... arguments) throws Exception {
        send(PLAYER + "." + method, arguments);
    }

    public void await(String property, String value) throws Exception {
        Wait.until(property + " is " + value, () -> get(property).contains(value));
    }

    /** Calls a method of the player's object by its whole name; gives what dbus-send prints. */
    public String send(String method, String... arguments) throws Exception {
        List<String> command = new ArrayList<>(List.of(
                "dbus-send", "--bus=" + address, "--print-reply", "--dest=" + Mpris.NAME, OBJECT,
                method));
        Stream.of(arguments).forEach(command::add);
        Process process =
                new ProcessBuilder(command)
                        .redirectError(ProcessBuilder.Redirect.DISCARD)
                        .start();
        String output =
                new String(process.getInputStream().readAllBytes(), StandardCharsets.UTF_8);
        process.waitFor(Wait.LIMIT.toSeconds(), TimeUnit.SECONDS);
        return output;
    }

    @Override
    public void close() {
        daemon.destroy();
    }
}
