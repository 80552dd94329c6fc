// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import com.quintora.mmp.OrvMediaPlayer;
import com.quintora.mmp.PlayerState;
import com.quintora.mmp.Track;
import java.util.ArrayList;
import java.util.EnumSet;
import java.util.List;
import java.util.Locale;
import java.util.Optional;
import java.util.Set;
import java.util.stream.Collectors;
import java.util.stream.Stream;

/** What can be said of a playback, for people to read. Not for the window's thread. */
final class Facts {
    private static final Set<PlayerState> OPEN =
            EnumSet.of(
                    PlayerState.PREPARED,
                    PlayerState.STARTED,
                    PlayerState.PAUSED,
                    PlayerState.COMPLETED);

    private final String source;
    private final OrvMediaPlayer player;
    private MediaInfo media; // Read once: it stays, and takes the engine some time.

    Facts(String source, OrvMediaPlayer player) {
        this.source = source;
        this.player = player;
    }

    /** How things stand. */
    synchronized List<Fact> read(Snapshot now, String drawing) {
        List<Fact> facts = new ArrayList<>();
        facts.add(new Fact("Source", source));
        facts.add(new Fact("State", player.getState().name().toLowerCase(Locale.ROOT)));
        if (OPEN.contains(player.getState())) {
            addMedia(facts, now, drawing);
        }
        facts.removeIf(fact -> fact.value().isEmpty());
        return facts;
    }

    private void addMedia(List<Fact> facts, Snapshot now, String drawing) {
        if (media == null) {
            media = MediaInfo.of(source, player);
        }
        facts.add(new Fact("Container", container()));
        facts.add(new Fact("Bit rate", rate(media.bitRate())));
        place(player.tracks().currentVideo(), media.video())
                .ifPresent(video -> addVideo(facts, video, now, drawing));
        place(player.tracks().currentAudio(), media.audio())
                .ifPresent(audio -> addAudio(facts, audio));
        facts.add(new Fact("Subtitles", subtitles()));
        facts.add(
                new Fact("Time", Times.clock(now.positionMs()) + " of "
                        + Times.length(now.durationMs()) + ", speed " + now.speed()));
        facts.add(new Fact("Buffered", now.bufferedPercent() + " %"));
    }

    private static <T> Optional<T> place(Optional<? extends Track> current, List<T> infos) {
        return current.map(Track::index).filter(index -> index < infos.size()).map(infos::get);
    }

    private String container() {
        return Stream.of(media.container(), size(media.sizeBytes()))
                .filter(word -> !word.isEmpty())
                .collect(Collectors.joining(", "));
    }

    private static void addVideo(
            List<Fact> facts, VideoInfo video, Snapshot now, String drawing) {
        facts.add(new Fact("Video", codec(video.codecName(), video.fourcc(), video.profile())));
        facts.add(new Fact("Picture", InfoWords.size(video)));
        facts.add(new Fact("Colours", InfoWords.look(video)));
        facts.add(
                new Fact(
                        "Frame rate",
                        video.frameRate() > 0
                                ? String.format(Locale.ROOT, "%.3f per second", video.frameRate())
                                : ""));
        facts.add(new Fact("Video bit rate", rate(video.bitRate())));
        facts.add(
                new Fact("Frames", now.framesShown() + " shown, " + now.framesDropped()
                        + " dropped"));
        facts.add(new Fact("Drawn by", drawing));
    }

    private static void addAudio(List<Fact> facts, AudioInfo audio) {
        facts.add(new Fact("Sound", codec(audio.codecName(), audio.fourcc(), audio.profile())));
        String layout = audio.channelLayout().isEmpty()
                ? audio.channels() + " channels"
                : audio.channelLayout();
        facts.add(new Fact("Samples", audio.sampleRate() + " Hz, " + layout));
        facts.add(new Fact("Sound bit rate", rate(audio.bitRate())));
    }

    private String subtitles() {
        return player.tracks()
                .currentSubtitle()
                .map(TrackNames::of)
                .orElse(player.tracks().subtitles().isEmpty() ? "" : "off");
    }

    private static String codec(String name, String fourcc, String profile) {
        String known = name == null || name.isEmpty() ? fourcc : name;
        return profile == null || profile.isEmpty() ? known : known + ", " + profile;
    }

    private static String rate(int bitsPerSecond) {
        return bitsPerSecond > 0
                ? String.format(Locale.ROOT, "%,d kbit/s", Math.round(bitsPerSecond / 1000.0))
                : "";
    }

    private static String size(Long bytes) {
        return bytes == null || bytes <= 0
                ? ""
                : String.format(Locale.ROOT, "%.1f MB", bytes / 1e6);
    }
}
