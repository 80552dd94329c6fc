// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.natives;

import java.io.IOException;
import java.io.OutputStream;
import java.nio.charset.StandardCharsets;
import java.nio.file.Files;
import java.nio.file.NoSuchFileException;
import java.nio.file.Path;
import java.util.Arrays;
import java.util.LinkedHashMap;
import java.util.Map;
import java.util.jar.JarEntry;
import java.util.jar.JarOutputStream;

/** Makes native JARs and what stands in them. */
final class Bundles {
    private static final int PART = 1 << 14;

    private Bundles() {}

    /** Two files that no machine could load. */
    static Map<String, byte[]> twoFiles() {
        Map<String, byte[]> files = new LinkedHashMap<>();
        files.put("libfirst.so", bytes("the first library".repeat(1000)));
        files.put("libsecond.so", bytes("the second library".repeat(3000)));
        return files;
    }

    static byte[] bytes(String text) {
        return text.getBytes(StandardCharsets.UTF_8);
    }

    /** The list of those files. */
    static String list(String version, Map<String, byte[]> files) {
        StringBuilder list = new StringBuilder("version " + version + "\nsystem Debian 99\n");
        StringBuilder lines = new StringBuilder();
        files.forEach((name, bytes) -> lines.append("file " + name + " " + bytes.length + " "
                + Digests.crc32(bytes) + " " + Digests.sha256(bytes) + "\n"));
        list.append("digest " + Digests.sha256(bytes(lines.toString())).substring(0, 16) + "\n");
        return list.append(lines).toString();
    }

    static NativeBundle bundle(String version, Map<String, byte[]> files) throws IOException {
        return listed(list(version, files), files);
    }

    static NativeBundle listed(String list, Map<String, byte[]> files) throws IOException {
        return new NativeBundle("here", name -> {
            if (name.equals(NativeBundle.LIST)) {
                return bytes(list);
            }
            if (!files.containsKey(name)) {
                throw new NoSuchFileException(name);
            }
            return files.get(name);
        });
    }

    /** A native JAR for that machine. */
    static Path jar(Path jar, Machine machine, String version, Map<String, byte[]> files)
            throws IOException {
        Map<String, byte[]> all = new LinkedHashMap<>(files);
        all.put(NativeBundle.LIST, bytes(list(version, files)));
        try (OutputStream out = Files.newOutputStream(jar);
                JarOutputStream entries = new JarOutputStream(out)) {
            for (Map.Entry<String, byte[]> file : all.entrySet()) {
                entries.putNextEntry(new JarEntry(NativeBundle.folder(machine) + file.getKey()));
                // In parts: with -Xcheck:jni each call of the compressor copies the whole array.
                byte[] bytes = file.getValue();
                for (int at = 0; at < bytes.length; at += PART) {
                    entries.write(
                            Arrays.copyOfRange(bytes, at, Math.min(at + PART, bytes.length)));
                }
            }
        }
        return jar;
    }
}
