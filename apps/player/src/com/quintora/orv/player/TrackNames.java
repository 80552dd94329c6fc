// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import com.quintora.mmp.AudioTrack;
import com.quintora.mmp.SubtitleTrack;
import java.util.HashMap;
import java.util.Locale;
import java.util.Map;

/** What people call a track: its title and language, or its number where it has neither. */
public final class TrackNames {
    /** ISO 639 has a second code of three letters for some languages, and media like to use it. */
    private static final String BIBLIOGRAPHIC_CODES =
            "alb:sq arm:hy baq:eu bur:my chi:zh cze:cs dut:nl fre:fr geo:ka ger:de gre:el ice:is"
                    + " mac:mk mao:mi may:ms per:fa rum:ro slo:sk tib:bo wel:cy";

    private static final Map<String, String> TWO_LETTERS = new HashMap<>();

    static {
        for (String code : Locale.getISOLanguages()) {
            TWO_LETTERS.put(Locale.forLanguageTag(code).getISO3Language(), code);
        }
        for (String pair : BIBLIOGRAPHIC_CODES.split(" ")) {
            TWO_LETTERS.put(pair.substring(0, 3), pair.substring(4));
        }
    }

    private TrackNames() {}

    public static String of(AudioTrack track) {
        String name = name(track.index(), track.title(), track.language());
        return track.channelLayout().isEmpty() ? name : name + "  ·  " + track.channelLayout();
    }

    public static String of(SubtitleTrack track) {
        return name(track.index(), track.title(), track.language());
    }

    /** A language in English, or its code where that has no name. */
    static String language(String code) {
        return Locale.forLanguageTag(TWO_LETTERS.getOrDefault(code, code))
                .getDisplayLanguage(Locale.ENGLISH);
    }

    private static String name(int index, String title, String languageCode) {
        String language = languageCode.equals("und") ? "" : language(languageCode);
        if (title.isEmpty() || language.isEmpty()) {
            String only = title + language;
            return only.isEmpty() ? "Track " + (index + 1) : only;
        }
        return title + "  (" + language + ")";
    }
}
