// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.desktop;

import com.sun.jna.Memory;
import com.sun.jna.Pointer;
import java.nio.charset.StandardCharsets;
import java.util.ArrayList;
import java.util.List;
import java.util.Map;

/**
 * The values of messages, as D-Bus's types: String s, ObjectPath o, Boolean b, Integer u, Long x,
 * Double d, a List of String as, a Map of String a{sv}. A Variant holds any of them.
 */
final class Values {
    /** A value whose type is part of it. */
    record Variant(Object value) {}

    /** The name of an object or a track. */
    record ObjectPath(String path) {}

    private static final int WORD = 8;

    private final LibDbus dbus;

    Values(LibDbus dbus) {
        this.dbus = dbus;
    }

    /** Puts values at the end of a message. */
    void append(Pointer message, List<?> values) {
        Pointer iter = new Memory(LibDbus.ITER_BYTES);
        dbus.dbus_message_iter_init_append(message, iter);
        values.forEach(value -> append(iter, value));
    }

    private void append(Pointer iter, Object value) {
        if (value instanceof Variant variant) {
            Pointer inner = open(iter, 'v', signature(variant.value()));
            append(inner, variant.value());
            close(iter, inner);
        } else if (value instanceof Map<?, ?> map) {
            Pointer entries = open(iter, 'a', "{sv}");
            map.forEach((name, of) -> appendEntry(entries, name, of));
            close(iter, entries);
        } else if (value instanceof List<?> list) {
            Pointer items = open(iter, 'a', "s");
            list.forEach(item -> append(items, item));
            close(iter, items);
        } else {
            appendBasic(iter, value);
        }
    }

    private void appendEntry(Pointer entries, Object name, Object value) {
        Pointer entry = open(entries, 'e', null);
        append(entry, name);
        append(entry, new Variant(value));
        close(entries, entry);
    }

    private Pointer open(Pointer iter, char type, String signature) {
        Pointer inner = new Memory(LibDbus.ITER_BYTES);
        check(dbus.dbus_message_iter_open_container(iter, type, signature, inner));
        return inner;
    }

    private void close(Pointer iter, Pointer inner) {
        check(dbus.dbus_message_iter_close_container(iter, inner));
    }

    private void appendBasic(Pointer iter, Object value) {
        Memory word = new Memory(WORD);
        Memory text = null;
        if (value instanceof Boolean bit) {
            word.setInt(0, bit ? 1 : 0);
        } else if (value instanceof Integer number) {
            word.setInt(0, number);
        } else if (value instanceof Long number) {
            word.setLong(0, number);
        } else if (value instanceof Double number) {
            word.setDouble(0, number);
        } else {
            text = textOf(value instanceof ObjectPath path ? path.path() : (String) value);
            word.setPointer(0, text);
        }
        check(dbus.dbus_message_iter_append_basic(iter, signature(value).charAt(0), word));
    }

    // The library ends the program for a text that is not UTF-8, or that holds a zero.
    private static Memory textOf(String text) {
        byte[] bytes = text.replace("\0", "").getBytes(StandardCharsets.UTF_8);
        Memory memory = new Memory(bytes.length + 1L);
        memory.write(0, bytes, 0, bytes.length);
        memory.setByte(bytes.length, (byte) 0);
        return memory;
    }

    private static void check(int done) {
        if (done == 0) {
            throw new OutOfMemoryError("no memory for a message");
        }
    }

    private static String signature(Object value) {
        if (value instanceof Map) {
            return "a{sv}";
        }
        if (value instanceof List) {
            return "as";
        }
        if (value instanceof Variant) {
            return "v";
        }
        if (value instanceof ObjectPath) {
            return "o";
        }
        if (value instanceof Boolean) {
            return "b";
        }
        if (value instanceof Integer) {
            return "u";
        }
        if (value instanceof Long) {
            return "x";
        }
        return value instanceof Double ? "d" : "s";
    }

    /** The values of a message, without those of other types than these. */
    List<Object> read(Pointer message) {
        List<Object> values = new ArrayList<>();
        Pointer iter = new Memory(LibDbus.ITER_BYTES);
        if (dbus.dbus_message_iter_init(message, iter) == 0) {
            return values;
        }
        do {
            Object value = readOne(iter);
            if (value != null) {
                values.add(value);
            }
        } while (dbus.dbus_message_iter_next(iter) != 0);
        return values;
    }

    private Object readOne(Pointer iter) {
        Memory word = new Memory(WORD);
        return switch (dbus.dbus_message_iter_get_arg_type(iter)) {
            case 's', 'o' -> basic(iter, word).getPointer(0).getString(0, "UTF-8");
            case 'b' -> basic(iter, word).getInt(0) != 0;
            case 'i', 'u' -> basic(iter, word).getInt(0);
            case 'x', 't' -> basic(iter, word).getLong(0);
            case 'd' -> basic(iter, word).getDouble(0);
            case 'v' -> readInside(iter);
            default -> null;
        };
    }

    private Memory basic(Pointer iter, Memory word) {
        dbus.dbus_message_iter_get_basic(iter, word);
        return word;
    }

    private Object readInside(Pointer iter) {
        Pointer inner = new Memory(LibDbus.ITER_BYTES);
        dbus.dbus_message_iter_recurse(iter, inner);
        return readOne(inner);
    }
}
