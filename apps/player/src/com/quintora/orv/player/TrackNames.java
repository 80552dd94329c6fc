// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import com.quintora.mmp.AudioTrack;
import com.quintora.mmp.SubtitleTrack;
import java.util.Locale;

/** What people call a track: its title and language, or its number where it has neither. */
public final class TrackNames {
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
        return Locale.forLanguageTag(code).getDisplayLanguage(Locale.ENGLISH);
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
