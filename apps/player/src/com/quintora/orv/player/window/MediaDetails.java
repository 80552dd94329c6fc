// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import com.quintora.mmp.AudioTrack;
import com.quintora.mmp.MediaMetadata;
import com.quintora.mmp.OrvMediaPlayer;
import com.quintora.mmp.SubtitleTrack;
import com.quintora.mmp.Track;
import com.quintora.orv.player.ReadingOrder;
import com.quintora.orv.player.TrackNames;
import java.awt.image.BufferedImage;
import java.io.ByteArrayInputStream;
import java.io.IOException;
import java.util.ArrayList;
import java.util.List;
import java.util.Optional;
import java.util.function.IntConsumer;
import javax.imageio.ImageIO;

/** What the window needs to know of the media besides its picture. Not for the window's thread. */
final class MediaDetails {
    private final OrvMediaPlayer player;
    private boolean hasVideo;
    private volatile int audioTracks;
    private volatile int subtitleTracks;
    private Chapters chapters = Chapters.NONE;
    private String title = "";
    private String artist = "";
    private BufferedImage cover;

    MediaDetails(OrvMediaPlayer player) {
        this.player = player;
    }

    /** Call once, when the media is prepared. */
    void read() {
        hasVideo = player.getVideoWidth() > 0;
        readTracks();
        chapters = new Chapters(player.tracks().chapters());
        title = player.tracks().metadata().map(MediaMetadata::title).orElse("");
        artist = player.tracks().metadata().map(MediaMetadata::artist).orElse("");
        if (!hasVideo) {
            cover = player.pictures().embedded().map(MediaDetails::decode).orElse(null);
        }
    }

    /** Once more, when there may be others. */
    void readTracks() {
        audioTracks = player.tracks().audio().size();
        subtitleTracks = player.tracks().subtitles().size();
    }

    boolean hasVideo() {
        return hasVideo;
    }

    int audioTracks() {
        return audioTracks;
    }

    int subtitleTracks() {
        return subtitleTracks;
    }

    Chapters chapters() {
        return chapters;
    }

    String title() {
        return title;
    }

    String artist() {
        return artist;
    }

    /** The picture inside a sound file, or null. */
    BufferedImage cover() {
        return cover;
    }

    List<ChoiceMenu.Choice> audioChoices(IntConsumer select) {
        Optional<AudioTrack> current = player.tracks().currentAudio();
        List<ChoiceMenu.Choice> choices = new ArrayList<>();
        for (AudioTrack track : player.tracks().audio()) {
            boolean isChosen = isAt(current, track);
            choices.add(choice(TrackNames.of(track), isChosen, track.index(), select));
        }
        return choices;
    }

    List<ChoiceMenu.Choice> subtitleChoices(IntConsumer select) {
        Optional<SubtitleTrack> current = player.tracks().currentSubtitle();
        List<ChoiceMenu.Choice> choices = new ArrayList<>();
        for (SubtitleTrack track : player.tracks().subtitles()) {
            boolean isChosen = isAt(current, track);
            choices.add(choice(TrackNames.of(track), isChosen, track.index(), select));
        }
        if (!choices.isEmpty()) {
            choices.add(0, choice("Off", current.isEmpty(), -1, select));
        }
        return choices;
    }

    private static ChoiceMenu.Choice choice(
            String text, boolean chosen, int index, IntConsumer select) {
        return new ChoiceMenu.Choice(
                ReadingOrder.ofSentence(text), chosen, () -> select.accept(index));
    }

    private static boolean isAt(Optional<? extends Track> current, Track track) {
        return current.isPresent() && current.get().index() == track.index();
    }

    private static BufferedImage decode(byte[] bytes) {
        try {
            return ImageIO.read(new ByteArrayInputStream(bytes));
        } catch (IOException e) {
            return null; // A picture that cannot be shown is not worth a word.
        }
    }
}
