// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.natives;

import java.io.IOException;
import java.nio.charset.StandardCharsets;
import java.util.ArrayList;
import java.util.List;

/**
 * The native libraries that a JAR holds for one machine, as the list in it names them.
 *
 * <p>The list is text, a fact a line: {@code version 1.0.0}, {@code system Debian 12}, {@code
 * digest} with hexadecimal digits that another set of libraries does not have and, for each
 * library, {@code file NAME BYTES CRC-32 SHA-256}. The first sum is for each start, at which the
 * second would take longer than all the rest; the second is for unpacking.
 */
final class NativeBundle {
    /** The name of the list, which stands beside the libraries. */
    static final String LIST = "mediaplayer-orv.list";

    /** One library: its name, size in bytes, and its sums in small hexadecimal digits. */
    record Entry(String name, long size, String crc32, String sha256) {
        /** Whether a file has these bytes, as far as chance goes. */
        boolean isOf(byte[] bytes) {
            return bytes.length == size && Digests.crc32(bytes).equals(crc32);
        }
    }

    /** Where the files of the bundle's folder are read from. */
    interface Contents {
        /** The bytes of the file of that name; throws when there is none. */
        byte[] read(String name) throws IOException;
    }

    private final String place;
    private final Contents contents;
    private final List<Entry> entries = new ArrayList<>();
    private String version;
    private String digest;
    private String system = "an unknown system";

    /**
     * Reads the list. The place, such as its address, is for messages. Throws an IOException with a
     * sentence when the list is not one.
     */
    NativeBundle(String place, Contents contents) throws IOException {
        this.place = place;
        this.contents = contents;
        byte[] list = contents.read(LIST);
        for (String line : new String(list, StandardCharsets.UTF_8).split("\n")) {
            parse(line.trim());
        }
        if (version == null || digest == null || entries.isEmpty()) {
            throw new IOException(place + " is not a list of native libraries with their version");
        }
    }

    /** The folder of that machine's list and libraries in a JAR. */
    static String folder(Machine machine) {
        return "META-INF/native/" + machine.name() + "/";
    }

    String place() {
        return place;
    }

    String version() {
        return version;
    }

    /** The system that the libraries were built on, as in "Debian 12". */
    String system() {
        return system;
    }

    /** A name that no other contents have, for the folder in the cache. */
    String identity() {
        return version + "-" + digest;
    }

    List<Entry> entries() {
        return List.copyOf(entries);
    }

    /**
     * The file with that library, such as "libx.so": of that name, or of it and the number of its
     * interface. Throws an IOException with a sentence when there is none.
     */
    String fileOf(String library) throws IOException {
        for (Entry entry : entries) {
            if (entry.name().equals(library) || entry.name().startsWith(library + ".")) {
                return entry.name();
            }
        }
        throw new IOException(place + " lists no " + library);
    }

    /** The bytes of that library; throws an IOException when they are not those of the list. */
    byte[] read(Entry entry) throws IOException {
        byte[] bytes = contents.read(entry.name());
        if (!entry.isOf(bytes) || !Digests.sha256(bytes).equals(entry.sha256())) {
            throw new IOException(
                    entry.name() + " in the native JAR is not the one of its list " + place
                            + "; the JAR is damaged");
        }
        return bytes;
    }

    private void parse(String line) throws IOException {
        String[] words = line.split(" ");
        if (line.startsWith("version ")) {
            version = fileName(line.substring(8));
        } else if (line.startsWith("system ")) {
            system = line.substring(7);
        } else if (line.startsWith("digest ")) {
            digest = fileName(line.substring(7));
        } else if (words.length == 5 && words[0].equals("file")) {
            entries.add(new Entry(fileName(words[1]), size(words[2]), words[3], words[4]));
        } else if (!line.isEmpty()) {
            throw new IOException(place + " has a line that is not understood: " + line);
        }
    }

    /** Names of files are unpacked by these words: they must not lead to another folder. */
    private String fileName(String word) throws IOException {
        if (word.isEmpty() || word.startsWith(".") || word.contains("/")) {
            throw new IOException(place + " has a name that is not a file's: " + word);
        }
        return word;
    }

    private long size(String word) throws IOException {
        try {
            return Long.parseLong(word);
        } catch (NumberFormatException e) {
            throw new IOException(place + " has a size that is not a number: " + word, e);
        }
    }
}
