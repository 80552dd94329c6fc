// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.desktop;

import com.quintora.orv.player.desktop.Values.ObjectPath;
import com.quintora.orv.player.desktop.Values.Variant;
import java.util.LinkedHashMap;
import java.util.List;
import java.util.Map;
import java.util.Objects;

/**
 * The player's object on the bus, as the Media Player Remote Interfacing Specification, version
 * 2.2, has it: properties of the status, and methods for the remote. On the bus's thread.
 */
final class Mpris implements Bus.Service {
    static final String NAME = "org.mpris.MediaPlayer2.orv";
    static final String PATH = "/org/mpris/MediaPlayer2";

    private static final String ROOT = "org.mpris.MediaPlayer2";
    private static final String PLAYER = "org.mpris.MediaPlayer2.Player";
    private static final String PROPERTIES = "org.freedesktop.DBus.Properties";
    private static final String INTROSPECTION = "org.freedesktop.DBus.Introspectable";
    private static final String PEER = "org.freedesktop.DBus.Peer";
    private static final String TRACK = "/com/quintora/orv/track/";
    private static final double SLOWEST = 0.25;
    private static final double FASTEST = 32;
    private static final int MICROS = 1000; // in a millisecond

    private final Remote remote;
    private Status status;
    private long since = System.nanoTime();

    Mpris(Remote remote, Status status) {
        this.remote = remote;
        this.status = status;
    }

    /** Takes a new status, and signals what is different from before. */
    void show(Status next, Bus bus) {
        boolean jumps = next.jumpsFrom(status, passed());
        Map<String, Object> changed = new LinkedHashMap<>(playerProperties(next));
        changed.entrySet().removeAll(playerProperties(status).entrySet());
        changed.remove("Position");
        boolean fills = next.fillsScreen() != status.fillsScreen();
        status = next;
        since = System.nanoTime();
        signal(bus, PLAYER, changed);
        signal(bus, ROOT, fills ? Map.of("Fullscreen", next.fillsScreen()) : Map.of());
        if (jumps) {
            bus.signal(PATH, PLAYER, "Seeked", next.positionMs() * MICROS);
        }
    }

    private static void signal(Bus bus, String type, Map<String, Object> changed) {
        if (!changed.isEmpty()) {
            bus.signal(PATH, PROPERTIES, "PropertiesChanged", type, changed, List.of());
        }
    }

    /** Where the media is by now. */
    private long position() {
        return status.positionAfter(passed());
    }

    private double passed() {
        return (System.nanoTime() - since) / 1e6;
    }

    @Override
    public List<?> answer(String type, String method, List<Object> values) {
        return switch (type) {
            case PROPERTIES -> property(method, values);
            case INTROSPECTION -> method.equals("Introspect") ? List.of(MprisXml.TEXT) : null;
            case PEER -> method.equals("Ping") ? List.of() : null;
            case ROOT -> root(method);
            case PLAYER -> player(method, values);
            default -> null;
        };
    }

    private List<?> property(String method, List<Object> values) {
        Map<String, Object> all = properties(text(values, 0));
        if (all == null) {
            return null;
        }
        switch (method) {
            case "GetAll":
                return List.of(all);
            case "Get":
                Object value = all.get(text(values, 1));
                return value == null ? null : List.of(new Variant(value));
            case "Set":
                return values.size() == 3 && set(text(values, 1), values.get(2))
                        ? List.of()
                        : null;
            default:
                return null;
        }
    }

    private static String text(List<Object> values, int index) {
        return values.size() > index && values.get(index) instanceof String text ? text : "";
    }

    private boolean set(String name, Object value) {
        if (value instanceof Double number) {
            return setNumber(name, number);
        }
        if (value instanceof Boolean bit) {
            return setSwitch(name, bit);
        }
        if (name.equals("LoopStatus") && value instanceof String loop) {
            remote.setLoop(loop);
            return true;
        }
        return false;
    }

    private boolean setNumber(String name, double number) {
        if (name.equals("Volume")) {
            remote.setVolume(Math.max(0, Math.min(1, number)));
        } else if (name.equals("Rate") && number == 0) {
            remote.setPlaying(false); // As the specification has it.
        } else if (name.equals("Rate")) {
            remote.setSpeed(Math.max(SLOWEST, Math.min(FASTEST, number)));
        } else {
            return false;
        }
        return true;
    }

    private boolean setSwitch(String name, boolean bit) {
        if (name.equals("Shuffle")) {
            remote.setShuffled(bit);
        } else if (name.equals("Fullscreen")) {
            remote.setFullScreen(bit);
        } else {
            return false;
        }
        return true;
    }

    private List<?> root(String method) {
        switch (method) {
            case "Raise" -> remote.raise();
            case "Quit" -> remote.quit();
            default -> {
                return null;
            }
        }
        return List.of();
    }

    private List<?> player(String method, List<Object> values) {
        switch (method) {
            case "Play" -> remote.setPlaying(true);
            case "Pause", "Stop" -> remote.setPlaying(false);
            case "PlayPause" -> remote.togglePlaying();
            case "Next" -> remote.next();
            case "Previous" -> remote.previous();
            case "Seek" -> remote.skip(number(values, 0) / MICROS);
            case "SetPosition" -> setPosition(text(values, 0), number(values, 1) / MICROS);
            case "OpenUri" -> remote.open(text(values, 0));
            default -> {
                return null;
            }
        }
        return List.of();
    }

    private static long number(List<Object> values, int index) {
        return values.size() > index && values.get(index) instanceof Long number ? number : 0;
    }

    // What is asked for other media, or beyond this one, comes too late.
    private void setPosition(String track, long millis) {
        boolean isThere = millis >= 0 && (status.lengthMs() == 0 || millis <= status.lengthMs());
        if (track.equals(TRACK + status.track()) && isThere) {
            remote.seekTo(millis);
        }
    }

    private Map<String, Object> properties(String type) {
        return switch (type) {
            case ROOT -> rootProperties();
            case PLAYER -> playerProperties(status.at(position()));
            default -> null;
        };
    }

    private Map<String, Object> rootProperties() {
        Map<String, Object> all = new LinkedHashMap<>();
        all.put("CanQuit", true);
        all.put("CanRaise", true);
        all.put("HasTrackList", false);
        all.put("Fullscreen", status.fillsScreen());
        all.put("CanSetFullscreen", true);
        all.put("Identity", "orv");
        all.put("DesktopEntry", "com.quintora.orv.player");
        all.put("SupportedUriSchemes", List.of("file", "http", "https"));
        all.put("SupportedMimeTypes", List.of("video/mp4", "video/x-matroska", "audio/mpeg"));
        return all;
    }

    private static Map<String, Object> playerProperties(Status of) {
        Map<String, Object> all = new LinkedHashMap<>();
        all.put("PlaybackStatus", of.plays() ? "Playing" : "Paused");
        all.put("LoopStatus", of.loop());
        all.put("Rate", of.speed());
        all.put("Shuffle", of.isShuffled());
        all.put("Metadata", metadata(of));
        all.put("Volume", of.volume());
        all.put("Position", of.positionMs() * MICROS);
        all.put("MinimumRate", SLOWEST);
        all.put("MaximumRate", FASTEST);
        all.put("CanGoNext", of.hasNext());
        all.put("CanGoPrevious", of.hasPrevious());
        all.put("CanPlay", true);
        all.put("CanPause", true);
        all.put("CanSeek", of.lengthMs() > 0);
        all.put("CanControl", true);
        return all;
    }

    private static Map<String, Object> metadata(Status of) {
        Map<String, Object> all = new LinkedHashMap<>();
        all.put("mpris:trackid", new ObjectPath(TRACK + of.track()));
        all.put("xesam:title", Objects.requireNonNullElse(of.title(), ""));
        if (of.lengthMs() > 0) {
            all.put("mpris:length", of.lengthMs() * MICROS);
        }
        if (!of.artist().isEmpty()) {
            all.put("xesam:artist", List.of(of.artist()));
        }
        if (!of.url().isEmpty()) {
            all.put("xesam:url", of.url());
        }
        return all;
    }
}
