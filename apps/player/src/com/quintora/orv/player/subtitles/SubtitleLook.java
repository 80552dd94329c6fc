// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.subtitles;

import com.quintora.SubtitleAttr;
import java.util.Locale;
import java.util.Map;
import java.util.Optional;

/**
 * How subtitles look, and when they come.
 *
 * @param textColor as 0xAARRGGBB, as the other colours
 * @param edgeColor of the letters' edge
 * @param groundColor of what is behind the letters
 * @param lift how far they stand above their usual place, in percent of the picture's height, 0 to
 *     90
 * @param delayMs by how much they come later, in milliseconds; negative for earlier
 */
public record SubtitleLook(
        LetterSize size,
        int textColor,
        int edgeColor,
        int groundColor,
        Side side,
        int lift,
        int delayMs) {
    public static final SubtitleLook USUAL =
            new SubtitleLook(
                    LetterSize.MEDIUM, 0xFFFFFFFF, 0xFF000000, 0, Side.CENTER, 0, 0);

    private static final int MOST_LIFT = 90;
    private static final int MOST_DELAY_MS = 3_600_000;

    private static final String SIZE = "subtitles.size";
    private static final String TEXT = "subtitles.color";
    private static final String EDGE = "subtitles.edge";
    private static final String GROUND = "subtitles.background";
    private static final String SIDE = "subtitles.side";
    private static final String LIFT = "subtitles.lift";

    public SubtitleLook withSize(LetterSize changed) {
        return new SubtitleLook(
                changed, textColor, edgeColor, groundColor, side, lift, delayMs);
    }

    public SubtitleLook withTextColor(int changed) {
        return new SubtitleLook(size, changed, edgeColor, groundColor, side, lift, delayMs);
    }

    public SubtitleLook withEdgeColor(int changed) {
        return new SubtitleLook(size, textColor, changed, groundColor, side, lift, delayMs);
    }

    public SubtitleLook withGroundColor(int changed) {
        return new SubtitleLook(size, textColor, edgeColor, changed, side, lift, delayMs);
    }

    public SubtitleLook withSide(Side changed) {
        return new SubtitleLook(size, textColor, edgeColor, groundColor, changed, lift, delayMs);
    }

    /** With the nearest lift there is. */
    public SubtitleLook withLift(int changed) {
        int possible = Math.max(0, Math.min(MOST_LIFT, changed));
        return new SubtitleLook(
                size, textColor, edgeColor, groundColor, side, possible, delayMs);
    }

    /** With that delay; at most an hour, either way. */
    public SubtitleLook withDelay(int changed) {
        int possible = Math.max(-MOST_DELAY_MS, Math.min(MOST_DELAY_MS, changed));
        return new SubtitleLook(size, textColor, edgeColor, groundColor, side, lift, possible);
    }

    /** What makes this look of another; empty when they are the same. */
    public Optional<SubtitleAttr> changesFrom(SubtitleLook before) {
        var builder = SubtitleAttr.builder();
        if (size != before.size) {
            size.giveTo(builder);
        }
        if (textColor != before.textColor) {
            builder.textColor(textColor);
        }
        if (edgeColor != before.edgeColor) {
            builder.edgeColor(edgeColor);
        }
        if (groundColor != before.groundColor) {
            builder.backgroundColor(groundColor);
        }
        if (side != before.side || lift != before.lift) {
            builder.displayOffset(side.offset(), -10 * lift);
        }
        if (delayMs != before.delayMs) {
            builder.delay(delayMs);
        }
        return equals(before) ? Optional.empty() : Optional.of(builder.build());
    }

    /** Writes down all but the delay, which is of one media. */
    public void remember(Map<String, String> values) {
        values.put(SIZE, name(size));
        values.put(TEXT, hex(textColor));
        values.put(EDGE, hex(edgeColor));
        values.put(GROUND, hex(groundColor));
        values.put(SIDE, name(side));
        values.put(LIFT, String.valueOf(lift));
    }

    /** The look that was written down; the usual one in what is missing or makes no sense. */
    public static SubtitleLook in(Map<String, String> values) {
        return new SubtitleLook(
                        find(LetterSize.class, values.get(SIZE), USUAL.size),
                        color(values.get(TEXT), USUAL.textColor),
                        color(values.get(EDGE), USUAL.edgeColor),
                        color(values.get(GROUND), USUAL.groundColor),
                        find(Side.class, values.get(SIDE), USUAL.side),
                        0,
                        0)
                .withLift(number(values.get(LIFT)));
    }

    private static String name(Enum<?> constant) {
        return constant.name().toLowerCase(Locale.ROOT);
    }

    private static String hex(int argb) {
        return String.format("#%08X", argb);
    }

    private static <T extends Enum<T>> T find(Class<T> type, String name, T otherwise) {
        for (T constant : type.getEnumConstants()) {
            if (name(constant).equals(name)) {
                return constant;
            }
        }
        return otherwise;
    }

    private static int color(String text, int otherwise) {
        return text != null && text.matches("#\\p{XDigit}{8}")
                ? Integer.parseUnsignedInt(text.substring(1), 16)
                : otherwise;
    }

    private static int number(String text) {
        return text != null && text.matches("\\d{1,3}") ? Integer.parseInt(text) : 0;
    }
}
