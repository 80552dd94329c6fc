// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.testing;

import com.quintora.mmp.AudioTrack;
import com.quintora.mmp.Chapter;
import com.quintora.mmp.MediaDescription;
import com.quintora.mmp.MediaMetadata;
import com.quintora.mmp.SubtitleTrack;
import com.quintora.mmp.TrackFlags;
import com.quintora.mmp.VideoTrack;
import java.time.Duration;
import java.util.ArrayList;
import java.util.List;
import java.util.Optional;
import org.jetbrains.annotations.Nullable;

/** Describes media for a {@link FakeMediaPlayer}. Not thread-safe. */
public final class FakeMediaBuilder {
    private static final TrackFlags NO_FLAGS = new TrackFlags(0);

    final List<VideoTrack> video = new ArrayList<>();
    final List<AudioTrack> audio = new ArrayList<>();
    final List<SubtitleTrack> subtitles = new ArrayList<>();
    final List<Chapter> chapters = new ArrayList<>();
    Duration duration = Duration.ofSeconds(10);
    Duration openingTime = Duration.ZERO;
    int bufferedPercent = 100;
    long size;
    private @Nullable MediaMetadata metadata;
    @Nullable MediaDescription description;
    byte @Nullable [] cover;
    ThumbnailPainter painter = (position, width, height, mode) -> Optional.empty();

    FakeMediaBuilder() {}

    /**
     * Says how long the media is; ten seconds otherwise.
     *
     * @param length 0 for unknown, up to 24 days
     * @return this
     */
    public FakeMediaBuilder duration(Duration length) {
        duration = length;
        return this;
    }

    /**
     * Has the media open only after some time; at once otherwise. A prepare that blocks does not
     * wait for it.
     *
     * @param time how much {@link FakeMediaPlayer#advance} must let pass
     * @return this
     */
    public FakeMediaBuilder openingTime(Duration time) {
        openingTime = time;
        return this;
    }

    /**
     * Says how much is buffered when the media is open; all of it otherwise.
     *
     * @param percent 0 to 100
     * @return this
     */
    public FakeMediaBuilder bufferedPercent(int percent) {
        bufferedPercent = percent;
        return this;
    }

    /**
     * Says how many bytes the media has; unknown otherwise. Positions in bytes follow from it.
     *
     * @param bytes 0 for unknown
     * @return this
     */
    public FakeMediaBuilder size(long bytes) {
        size = bytes;
        return this;
    }

    /**
     * Adds a picture track.
     *
     * @param width pixels
     * @param height rows
     * @param frameRate frames per second
     * @return this
     */
    public FakeMediaBuilder video(int width, int height, double frameRate) {
        return video(new VideoTrack(video.size(), "h264", width, height, frameRate, 0, NO_FLAGS));
    }

    /**
     * Adds a picture track.
     *
     * @param track the track; its index must be the number of picture tracks before it
     * @return this
     */
    public FakeMediaBuilder video(VideoTrack track) {
        requireIndex(track.index(), video.size());
        video.add(track);
        return this;
    }

    /**
     * Adds a sound track of two channels.
     *
     * @param language an ISO 639 code; empty when unknown
     * @return this
     */
    public FakeMediaBuilder audio(String language) {
        return audio(new AudioTrack(audio.size(), "mp4a", 2, 48000, 0, 0, audio.size(), "", "AAC",
                "stereo", "", NO_FLAGS, "", "", "", language));
    }

    /**
     * Adds a sound track.
     *
     * @param track the track; its index must be the number of sound tracks before it
     * @return this
     */
    public FakeMediaBuilder audio(AudioTrack track) {
        requireIndex(track.index(), audio.size());
        audio.add(track);
        return this;
    }

    /**
     * Adds a subtitle track.
     *
     * @param language an ISO 639 code; empty when unknown
     * @return this
     */
    public FakeMediaBuilder subtitle(String language) {
        int index = subtitles.size();
        return subtitle(new SubtitleTrack(index, index, "srt ", language, "", NO_FLAGS));
    }

    /**
     * Adds a subtitle track.
     *
     * @param track the track; its index must be the number of subtitle tracks before it
     * @return this
     */
    public FakeMediaBuilder subtitle(SubtitleTrack track) {
        requireIndex(track.index(), subtitles.size());
        subtitles.add(track);
        return this;
    }

    /**
     * Adds a chapter mark.
     *
     * @param start where it begins
     * @param end where it ends
     * @param title its title
     * @return this
     */
    public FakeMediaBuilder chapter(Duration start, Duration end, String title) {
        chapters.add(new Chapter(chapters.size(), (int) start.toMillis(), (int) end.toMillis(), title));
        return this;
    }

    /**
     * Says what the media says of itself; otherwise that has its length alone.
     *
     * @param says the metadata
     * @return this
     */
    public FakeMediaBuilder metadata(MediaMetadata says) {
        metadata = says;
        return this;
    }

    /**
     * Says what the media says beyond the tables; nothing otherwise.
     *
     * @param says the description
     * @return this
     */
    public FakeMediaBuilder description(MediaDescription says) {
        description = says;
        return this;
    }

    /**
     * Puts a picture inside the media; none otherwise.
     *
     * @param file the bytes of an image file
     * @return this
     */
    public FakeMediaBuilder cover(byte[] file) {
        cover = file.clone();
        return this;
    }

    /**
     * Has thumbnails drawn; the media has none otherwise.
     *
     * @param draws draws them
     * @return this
     */
    public FakeMediaBuilder thumbnails(ThumbnailPainter draws) {
        painter = draws;
        return this;
    }

    /**
     * The media described so far.
     *
     * @return the media
     * @throws IllegalArgumentException for a number out of range
     */
    public FakeMedia build() {
        MediaMetadata says = metadata != null ? metadata : new MediaMetadata(
                (int) duration.toMillis(), 0, 0, 0, "", "", "", "", chapters.size(), "", "", "");
        return new FakeMedia(this, says);
    }

    private static void requireIndex(int index, int expected) {
        if (index != expected) {
            throw new IllegalArgumentException(
                    "the track's index is " + index + "; the next of its kind is " + expected);
        }
    }
}
