// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.natives;

import java.security.MessageDigest;
import java.security.NoSuchAlgorithmException;
import java.util.HexFormat;
import java.util.zip.CRC32;

/** Sums of bytes, in small hexadecimal digits. */
final class Digests {
    private Digests() {}

    /** Eight digits. */
    static String crc32(byte[] bytes) {
        CRC32 sum = new CRC32();
        sum.update(bytes);
        return HexFormat.of().toHexDigits((int) sum.getValue());
    }

    static String sha256(byte[] bytes) {
        try {
            return HexFormat.of().formatHex(MessageDigest.getInstance("SHA-256").digest(bytes));
        } catch (NoSuchAlgorithmException e) {
            throw new IllegalStateException("each Java platform has SHA-256", e);
        }
    }
}
