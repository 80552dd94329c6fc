// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.natives;

import java.io.EOFException;
import java.io.IOException;
import java.io.RandomAccessFile;
import java.nio.ByteBuffer;
import java.nio.ByteOrder;
import java.nio.charset.StandardCharsets;

/**
 * What the header and the notes of a native library say.
 *
 * @param architecture the processor's that it is built for, in the names of {@link Machine}
 * @param version this project's version that it is of, or null where it does not say
 */
record ElfFile(String architecture, String version) {
    /** The owner's name in the note with the version, which the build links in. */
    static final String NOTE_OWNER = "mediaplayer_orv";

    private static final int NOTE_SEGMENT = 4;
    private static final int LARGEST_NOTES = 1 << 16;

    /** Throws an IOException with a sentence when it is no ELF file or a damaged one. */
    static ElfFile read(String path) throws IOException {
        try (RandomAccessFile file = new RandomAccessFile(path, "r")) {
            ByteBuffer header = header(file, path);
            boolean wide = header.get(4) == 2;
            return new ElfFile(
                    architecture(header.getShort(18), wide), version(file, header, wide));
        } catch (EOFException e) {
            throw new IOException(path + " is cut off: it is shorter than its ELF header says", e);
        }
    }

    private static ByteBuffer header(RandomAccessFile file, String path) throws IOException {
        if (file.length() < 52 || file.readInt() != 0x7F454C46) {
            throw new IOException(path + " is not an ELF file, so not a native library");
        }
        file.seek(0);
        byte[] bytes = new byte[64];
        file.readFully(bytes, 0, (int) Math.min(64, file.length()));
        boolean big = bytes[5] == 2;
        return ByteBuffer.wrap(bytes).order(big ? ByteOrder.BIG_ENDIAN : ByteOrder.LITTLE_ENDIAN);
    }

    private static String architecture(short machine, boolean wide) {
        switch (machine & 0xFFFF) {
            case 3:
                return "x86";
            case 40:
                return "armhf";
            case 62:
                return wide ? "x86_64" : "x32";
            case 183:
                return "aarch64";
            case 243:
                return wide ? "riscv64" : "riscv32";
            default:
                return "ELF machine " + (machine & 0xFFFF);
        }
    }

    private static String version(RandomAccessFile file, ByteBuffer header, boolean wide)
            throws IOException {
        long start = wide ? header.getLong(32) : header.getInt(28) & 0xFFFFFFFFL;
        int size = header.getShort(wide ? 54 : 42) & 0xFFFF;
        int count = header.getShort(wide ? 56 : 44) & 0xFFFF;
        ByteBuffer segments = read(file, start, size * count, header.order());
        for (int i = 0; i < count; i++) {
            int segment = i * size;
            if (segments.getInt(segment) != NOTE_SEGMENT) {
                continue;
            }
            long offset = wide ? segments.getLong(segment + 8) : segments.getInt(segment + 4);
            long length = wide ? segments.getLong(segment + 32) : segments.getInt(segment + 16);
            if (length <= LARGEST_NOTES) {
                String found = version(read(file, offset, (int) length, header.order()));
                if (found != null) {
                    return found;
                }
            }
        }
        return null;
    }

    /** The text of our note among those of a segment, or null. */
    private static String version(ByteBuffer notes) {
        while (notes.remaining() >= 12) {
            int nameSize = notes.getInt();
            int textSize = notes.getInt();
            notes.getInt();
            if (nameSize < 0 || textSize < 0 || nameSize > notes.remaining()) {
                return null;
            }
            String name = text(notes, nameSize);
            if (textSize > notes.remaining()) {
                return null;
            }
            String text = text(notes, textSize);
            if (name.equals(NOTE_OWNER)) {
                return text;
            }
        }
        return null;
    }

    /** The text up to its terminating zero; skips the padding to four bytes, too. */
    private static String text(ByteBuffer notes, int size) {
        byte[] bytes = new byte[size];
        notes.get(bytes);
        notes.position(Math.min(notes.limit(), (notes.position() + 3) & ~3));
        int end = 0;
        while (end < size && bytes[end] != 0) {
            end++;
        }
        return new String(bytes, 0, end, StandardCharsets.UTF_8);
    }

    private static ByteBuffer read(RandomAccessFile file, long offset, int size, ByteOrder order)
            throws IOException {
        if (offset < 0 || size < 0 || offset + size > file.length()) {
            throw new EOFException();
        }
        byte[] bytes = new byte[size];
        file.seek(offset);
        file.readFully(bytes);
        return ByteBuffer.wrap(bytes).order(order);
    }
}
