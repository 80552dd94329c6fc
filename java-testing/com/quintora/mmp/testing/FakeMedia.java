// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.testing;

import com.quintora.mmp.AudioTrack;
import com.quintora.mmp.Chapter;
import com.quintora.mmp.MediaDescription;
import com.quintora.mmp.MediaMetadata;
import com.quintora.mmp.SubtitleTrack;
import com.quintora.mmp.VideoTrack;
import java.time.Duration;
import java.util.List;
import java.util.Optional;
import org.jetbrains.annotations.Nullable;

/**
 * What a {@link FakeMediaPlayer} plays.
 *
 * <pre>{@code
 * FakeMedia film = FakeMedia.builder()
 *         .duration(Duration.ofMinutes(90))
 *         .video(1920, 1080, 25)
 *         .audio("eng").audio("deu")
 *         .build();
 * }</pre>
 *
 * Immutable.
 */
public final class FakeMedia {
    private static final Duration LONGEST = Duration.ofMillis(Integer.MAX_VALUE);

    private final Duration duration;
    private final Duration openingTime;
    private final int bufferedPercent;
    private final long size;
    private final List<VideoTrack> video;
    private final List<AudioTrack> audio;
    private final List<SubtitleTrack> subtitles;
    private final List<Chapter> chapters;
    private final MediaMetadata metadata;
    private final @Nullable MediaDescription description;
    private final ThumbnailPainter painter;
    private final byte @Nullable [] cover;

    FakeMedia(FakeMediaBuilder from, MediaMetadata metadata) {
        duration = requireDuration(from.duration);
        openingTime = from.openingTime;
        bufferedPercent = requirePercent(from.bufferedPercent);
        size = from.size;
        video = List.copyOf(from.video);
        audio = List.copyOf(from.audio);
        subtitles = List.copyOf(from.subtitles);
        chapters = List.copyOf(from.chapters);
        this.metadata = metadata;
        description = from.description;
        painter = from.painter;
        cover = from.cover;
        if (openingTime.isNegative() || size < 0) {
            throw new IllegalArgumentException(
                    "an opening time and a size are not negative: " + openingTime + ", " + size);
        }
    }

    /**
     * A description to fill in.
     *
     * @return one of media of ten seconds, fully buffered, that have nothing else yet
     */
    public static FakeMediaBuilder builder() {
        return new FakeMediaBuilder();
    }

    /**
     * Media for tests to which it does not matter.
     *
     * @return ten seconds with a picture of 320x180 at 25 frames per second and one sound track
     */
    public static FakeMedia any() {
        return builder().video(320, 180, 25).audio("").build();
    }

    Duration duration() {
        return duration;
    }

    Duration openingTime() {
        return openingTime;
    }

    int bufferedPercent() {
        return bufferedPercent;
    }

    long size() {
        return size;
    }

    List<VideoTrack> video() {
        return video;
    }

    List<AudioTrack> audio() {
        return audio;
    }

    List<SubtitleTrack> subtitles() {
        return subtitles;
    }

    List<Chapter> chapters() {
        return chapters;
    }

    MediaMetadata metadata() {
        return metadata;
    }

    @Nullable MediaDescription description() {
        return description;
    }

    ThumbnailPainter painter() {
        return painter;
    }

    byte @Nullable [] cover() {
        return cover == null ? null : cover.clone();
    }

    Optional<VideoTrack> picture() {
        return video.stream()
                .filter(track -> track.flags().isSelected())
                .findFirst()
                .or(() -> video.stream().findFirst());
    }

    static int requirePercent(int percent) {
        if (percent < 0 || percent > 100) {
            throw new IllegalArgumentException("a percentage is 0 to 100: " + percent);
        }
        return percent;
    }

    private static Duration requireDuration(Duration duration) {
        if (duration.isNegative() || duration.compareTo(LONGEST) > 0) {
            throw new IllegalArgumentException("a duration is 0 to 2147483647 ms: " + duration);
        }
        return duration;
    }
}
