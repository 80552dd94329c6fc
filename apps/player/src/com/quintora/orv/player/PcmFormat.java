// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import com.quintora.mmp.util.PcmMediaInfo;
import com.quintora.mmp.util.PcmMediaInfo.AudioPcmInfo;
import java.util.regex.Matcher;
import java.util.regex.Pattern;
import picocli.CommandLine.TypeConversionException;

/** The description of raw PCM, written RATE:CHANNELS:FORMAT as in 44100:2:s16le. */
final class PcmFormat {
    private static final Pattern TEXT =
            Pattern.compile("(\\d{1,7}):(\\d{1,3}):(?:([suf])(\\d{1,2})(le|be)?|(alaw|mulaw))");

    private PcmFormat() {}

    static PcmMediaInfo parse(String text) {
        Matcher match = TEXT.matcher(text.trim());
        if (!match.matches()) {
            throw new TypeConversionException(
                    "'"
                            + text
                            + "' is not RATE:CHANNELS:FORMAT, with the format u8, s16le, s24be,"
                            + " s32le, f32le, alaw, mulaw or the like");
        }
        PcmMediaInfo info = describe(match);
        try {
            info.check();
        } catch (IllegalArgumentException e) {
            throw new TypeConversionException("'" + text + "': " + e.getMessage());
        }
        return info;
    }

    private static PcmMediaInfo describe(Matcher match) {
        int rate = Integer.parseInt(match.group(1));
        int channels = Integer.parseInt(match.group(2));
        String law = match.group(6);
        if (law != null) {
            return PcmMediaInfo.of(rate, channels, 8)
                    .withType(law.equals("alaw") ? AudioPcmInfo.A_LAW : AudioPcmInfo.MU_LAW);
        }
        PcmMediaInfo info =
                PcmMediaInfo.of(rate, channels, Integer.parseInt(match.group(4)))
                        .withType(typeOf(match.group(3)));
        return "be".equals(match.group(5)) ? info.withBigEndian() : info;
    }

    private static int typeOf(String letter) {
        return switch (letter) {
            case "u" -> AudioPcmInfo.UNSIGNED;
            case "f" -> AudioPcmInfo.FLOAT;
            default -> AudioPcmInfo.SIGNED;
        };
    }
}
