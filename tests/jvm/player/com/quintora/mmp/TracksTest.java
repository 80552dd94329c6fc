// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertFalse;
import static org.junit.jupiter.api.Assertions.assertThrows;
import static org.junit.jupiter.api.Assertions.assertTrue;

import java.util.List;
import java.util.Optional;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.api.function.Executable;

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
        assertEquals(Optional.empty(), player.tracks().currentAudio());
        assertEquals(Optional.empty(), player.tracks().currentSubtitle());
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
        assertTrue(player.native_getVideoCodecInfo());
    }

    @Test
    void subtitleTracksAreListed() throws Exception {
        prepare("feature.mkv");
        List<SubtitleTrack> tracks = player.tracks().subtitles();
        assertEquals(List.of("eng", "deu"), tracks.stream().map(SubtitleTrack::language).toList());
        assertEquals(List.of("Captions", "Untertitel"),
                tracks.stream().map(SubtitleTrack::title).toList());
        assertEquals(List.of(0, 1), tracks.stream().map(SubtitleTrack::index).toList());
    }

    @Test
    void chaptersAreListed() throws Exception {
        prepare("feature.mkv");
        assertEquals(
                List.of(new Chapter(0, 0, 2500, "Opening"),
                        new Chapter(1, 2500, 6000, "Глава вторая"),
                        new Chapter(2, 6000, 10_000, "終章")),
                player.tracks().chapters());
        player.resetAndWait();
        prepare("silent.mkv");
        assertEquals(List.of(), player.tracks().chapters());
    }

    @Test
    void soundTracksAreSwitched() throws Exception {
        prepare("feature.mkv");
        List<AudioTrack> tracks = player.tracks().audio();
        assertEquals(0, player.tracks().currentAudio().orElseThrow().index());
        player.tracks().selectAndWait(tracks.get(1));
        assertEquals(1, player.tracks().currentAudio().orElseThrow().index());
        assertTrue(player.tracks().audio().get(1).flags().isSelected());
        assertFalse(player.tracks().audio().get(0).flags().isSelected());
        player.tracks().select(tracks.get(0)).get();
        assertEquals(0, player.tracks().currentAudio().orElseThrow().index());
        player.start();
        awaitMoving();
    }

    @Test
    void picturesAndSoundAreTurnedOffAndOn() throws Exception {
        prepare("feature.mkv");
        VideoTrack picture = player.tracks().video().get(0);
        player.tracks().selectNoneAndWait(Track.Kind.VIDEO);
        assertEquals(Optional.empty(), player.tracks().currentVideo());
        IllegalStateException refusal = assertThrows(IllegalStateException.class,
                () -> player.tracks().selectNoneAndWait(Track.Kind.AUDIO));
        assertEquals("the engine cannot turn its only track off, which is a sound track",
                refusal.getMessage());
        player.tracks().selectAndWait(picture);
        player.tracks().selectNone(Track.Kind.AUDIO).get();
        assertEquals(Optional.empty(), player.tracks().currentAudio());
        assertTrue(player.tracks().video().get(0).flags().isSelected());
    }

    @Test
    void tracksThatTheMediaDoesNotHaveAreRefused() throws Exception {
        prepare("feature.mkv");
        SubtitleTrack unknown =
                new SubtitleTrack(99, 0, "", "", "", new TrackFlags(0));
        for (Executable call : List.<Executable>of(
                () -> player.tracks().select(unknown), () -> player.tracks().selectAndWait(unknown))) {
            IllegalArgumentException refusal =
                    assertThrows(IllegalArgumentException.class, call);
            assertEquals("there is no subtitle track 99; the media has 2", refusal.getMessage());
        }
        assertThrows(IllegalArgumentException.class, () -> player.tracks().select(null));
        assertThrows(IllegalArgumentException.class, () -> player.tracks().selectNone(null));
        assertEquals(0, player.tracks().currentAudio().orElseThrow().index());
    }

    @Test
    void nothingIsSelectedBeforeTheMediaIsPrepared() {
        SubtitleTrack track = new SubtitleTrack(0, 0, "", "", "", new TrackFlags(0));
        assertThrows(IllegalStateException.class, () -> player.tracks().select(track));
        assertThrows(IllegalStateException.class,
                () -> player.tracks().selectNone(Track.Kind.AUDIO));
        assertThrows(IllegalStateException.class,
                () -> player.tracks().selectNoneAndWait(Track.Kind.AUDIO));
    }

    @Test
    void theNativeHalfIgnoresUnknownTrackNumbers() throws Exception {
        prepare("feature.mkv");
        for (int number : new int[] {-1, 99, Integer.MIN_VALUE, Integer.MAX_VALUE}) {
            player.native_selectTrack(number);
            player.native_deselectTrack(number);
        }
        assertEquals(0, player.tracks().currentAudio().orElseThrow().index());
    }

    @Test
    void mediaWithoutPictureHasNone() throws Exception {
        prepare("tone.mp3");
        assertEquals(List.of(), player.tracks().video());
        assertEquals(Optional.empty(), player.tracks().currentVideo());
        assertEquals(0, player.getVideoWidth());
        assertEquals(1, player.tracks().audio().size());
        assertEquals(0, player.tracks().currentAudio().orElseThrow().index());
    }
}
