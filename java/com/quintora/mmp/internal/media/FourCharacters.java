// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.media;

/** Codec numbers of four characters, the first in the low byte. */
public final class FourCharacters {
    static final int CHAPTER = 'c' | 'h' << 8 | 'a' << 16 | 'p' << 24;
    static final int DESCRIPTION = 'd' | 'e' << 8 | 's' << 16 | 'c' << 24;

    private FourCharacters() {}

    /** The characters; empty for 0. Bytes that are no printable ASCII are shown as '?'. */
    public static String text(int code) {
        if (code == 0) {
            return "";
        }
        StringBuilder text = new StringBuilder(4);
        for (int shift = 0; shift < 32; shift += 8) {
            char c = (char) (code >>> shift & 0xFF);
            text.append(c >= ' ' && c <= '~' ? c : '?');
        }
        return text.toString();
    }
}
