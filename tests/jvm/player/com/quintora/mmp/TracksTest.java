// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertFalse;
import static org.junit.jupiter.api.Assertions.assertTrue;

import java.util.List;
import java.util.Optional;
import java.util.OptionalInt;
import org.junit.jupiter.api.Test;

/** The tables of tracks and chapters, and which of them play. */
class TracksTest extends PlayerFixture {
    @Test
    void beforeTheMediaIsPreparedThereIsNothing() {
        assertEquals(List.of(), player.tracks().audio());
        assertEquals(List.of(), player.tracks().video());
        assertEquals(List.of(), player.tracks().subtitles());
        assertEquals(List.of(), player.tracks().chapters());
        assertEquals(Optional.empty(), player.tracks().currentVideo());
        assertEquals(Optional.empty(), player.tracks().metadata());
        assertEquals(OptionalInt.empty(), player.tracks().currentAudio());
        assertEquals(OptionalInt.empty(), player.tracks().currentSubtitle());
        assertFalse(player.tracks().selectAudio(0));
    }

    @Test
    void soundTracksAreListed() throws Exception {
        prepare("feature.mkv");
        List<AudioTrack> tracks = player.tracks().audio();
        assertEquals(2, tracks.size());
        AudioTrack first = tracks.get(0);
        assertEquals(0, first.index());
        assertEquals("eng", first.language());
        assertEquals("Stereo", first.title());
        assertEquals(2, first.channels());
        assertEquals(44_100, first.sampleRate());
        assertEquals("fLaC", first.codec());
        assertTrue(first.codecName().contains("FLAC"), first.codecName());
        assertEquals("stereo", first.channelLayout());
        AudioTrack second = tracks.get(1);
        assertEquals(1, second.index());
        assertEquals("fra", second.language());
        assertEquals("Commentaire", second.title());
        assertEquals(1, second.channels());
        assertEquals("mono", second.channelLayout());
    }

    @Test
    void textsOfOtherScriptsArrive() throws Exception {
        prepare("tracks.mkv");
        AudioTrack second = player.tracks().audio().get(1);
        assertEquals("Kommentar (größer)", second.title());
        assertEquals("Nur für Fans", second.comment());
        assertTrue(second.flags().isDefault());
        assertTrue(second.flags().isSelected());
        SubtitleTrack japanese = player.tracks().subtitles().get(1);
        assertEquals("jpn", japanese.language());
        assertEquals("字幕", japanese.title());
        assertTrue(player.tracks().subtitles().get(0).flags().isForced());
    }

    @Test
    void pictureTracksAreListed() throws Exception {
        prepare("feature.mkv");
        List<VideoTrack> tracks = player.tracks().video();
        assertEquals(1, tracks.size());
        VideoTrack track = tracks.get(0);
        assertEquals("h264", track.codec());
        assertEquals(1280, track.width());
        assertEquals(720, track.height());
        assertEquals(30, track.frameRate(), 0.01);
        assertEquals(Optional.of(track), player.tracks().currentVideo());
    }

    @Test
    void subtitleTracksAreListed() throws Exception {
        prepare("feature.mkv");
        List<SubtitleTrack> tracks = player.tracks().subtitles();
        assertEquals(List.of("eng", "deu"), tracks.stream().map(SubtitleTrack::language).toList());
        assertEquals(List.of("Captions", "Untertitel"),
                tracks.stream().map(SubtitleTrack::title).toList());
        assertEquals(List.of(0, 1), tracks.stream().map(SubtitleTrack::index).toList());
        assertEquals(Optional.of(tracks.get(1)), player.tracks().subtitle(1));
        assertEquals(Optional.empty(), player.tracks().subtitle(2));
        assertEquals(Optional.empty(), player.tracks().subtitle(-1));
        assertEquals(Optional.empty(), player.tracks().subtitle(Integer.MAX_VALUE));
    }

    @Test
    void chaptersAreListed() throws Exception {
        prepare("feature.mkv");
        assertEquals(
                List.of(new Chapter(0, 0, 2500, "Opening"),
                        new Chapter(1, 2500, 6000, "Глава вторая"),
                        new Chapter(2, 6000, 10_000, "終章")),
                player.tracks().chapters());
        player.reset();
        prepare("silent.mkv");
        assertEquals(List.of(), player.tracks().chapters());
    }

    @Test
    void soundTracksAreSwitched() throws Exception {
        prepare("feature.mkv");
        assertEquals(OptionalInt.of(0), player.tracks().currentAudio());
        assertTrue(player.tracks().selectAudio(1));
        assertEquals(OptionalInt.of(1), player.tracks().currentAudio());
        assertTrue(player.tracks().audio().get(1).flags().isSelected());
        assertFalse(player.tracks().audio().get(0).flags().isSelected());
        assertFalse(player.tracks().selectAudio(2));
        assertFalse(player.tracks().selectAudio(-1));
        assertEquals(OptionalInt.of(1), player.tracks().currentAudio());
        player.tracks().select(1); // The picture is number 0.
        assertEquals(OptionalInt.of(0), player.tracks().currentAudio());
        player.start();
        awaitMoving();
    }

    @Test
    void unknownTrackNumbersAreIgnored() throws Exception {
        prepare("feature.mkv");
        for (int number : new int[] {-1, 99, Integer.MIN_VALUE, Integer.MAX_VALUE}) {
            player.tracks().select(number);
            player.tracks().deselect(number);
        }
        assertEquals(OptionalInt.of(0), player.tracks().currentAudio());
    }

    @Test
    void mediaWithoutPictureHasNone() throws Exception {
        prepare("tone.mp3");
        assertEquals(List.of(), player.tracks().video());
        assertEquals(Optional.empty(), player.tracks().currentVideo());
        assertEquals(0, player.getVideoWidth());
        assertEquals(1, player.tracks().audio().size());
        assertEquals(OptionalInt.of(0), player.tracks().currentAudio());
    }
}
