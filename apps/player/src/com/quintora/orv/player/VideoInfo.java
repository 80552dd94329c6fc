// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import com.quintora.mmp.MediaStream;
import com.quintora.mmp.PictureDetails;
import com.quintora.mmp.VideoTrack;
import java.util.List;
import java.util.Optional;

/**
 * A video track, or an embedded picture. stream is the place in the container, codec FFmpeg's
 * name, fourcc the engine's code; width and height are as stored, displayWidth and displayHeight
 * of square pixels and turned; rotation is clockwise; luminances are in cd/m².
 */
record VideoInfo(
        Integer index,
        Integer stream,
        String codec,
        String codecName,
        String fourcc,
        String profile,
        Integer level,
        String language,
        String title,
        int width,
        int height,
        Integer displayWidth,
        Integer displayHeight,
        String pixelAspect,
        String displayAspect,
        Integer rotation,
        Boolean mirrored,
        String pixelFormat,
        Integer bitDepth,
        String fieldOrder,
        Color color,
        double frameRate,
        int bitRate,
        List<String> flags) {

    record Color(
            String primaries,
            String transfer,
            String matrix,
            String range,
            String chromaLocation,
            String highDynamicRange,
            Double masteringMinLuminance,
            Double masteringMaxLuminance,
            Double maxContentLight,
            Double maxFrameAverageLight,
            Integer dolbyVisionProfile) {}

    static VideoInfo of(VideoTrack track, Streams streams) {
        Optional<MediaStream> stream = streams.of(MediaStream.Kind.VIDEO, track.index());
        return of(
                track.index(),
                track.codec().strip(),
                track.width(),
                track.height(),
                track.frameRate(),
                track.bitRate(),
                MediaInfo.flags(track.flags()),
                stream);
    }

    /** An embedded picture. */
    static VideoInfo of(MediaStream stream) {
        PictureDetails picture = stream.picture().orElseThrow();
        return of(
                null, null, picture.width(), picture.height(), 0, 0, stream.flags(),
                Optional.of(stream));
    }

    private static VideoInfo of(
            Integer index,
            String fourcc,
            int width,
            int height,
            double frameRate,
            int bitRate,
            List<String> flags,
            Optional<MediaStream> stream) {
        Optional<PictureDetails> picture = stream.flatMap(MediaStream::picture);
        return new VideoInfo(
                index,
                stream.map(MediaStream::index).orElse(null),
                stream.map(MediaStream::codec).orElse(null),
                stream.map(MediaStream::codecName).orElse(null),
                fourcc,
                stream.flatMap(MediaStream::profile).orElse(null),
                stream.map(found -> Streams.orNull(found.level())).orElse(null),
                stream.flatMap(MediaStream::language).orElse(null),
                stream.flatMap(MediaStream::title).orElse(null),
                width,
                height,
                picture.map(PictureDetails::displayWidth).orElse(null),
                picture.map(PictureDetails::displayHeight).orElse(null),
                picture.flatMap(PictureDetails::pixelAspect).map(Object::toString).orElse(null),
                picture.flatMap(PictureDetails::displayAspect).map(Object::toString).orElse(null),
                picture.map(PictureDetails::rotation).orElse(null),
                picture.map(PictureDetails::mirrored).orElse(null),
                picture.flatMap(PictureDetails::pixelFormat).orElse(null),
                picture.map(found -> Streams.orNull(found.bitDepth())).orElse(null),
                picture.flatMap(PictureDetails::fieldOrder).orElse(null),
                picture.map(VideoInfo::color).orElse(null),
                frameRate,
                bitRate,
                flags);
    }

    private static Color color(PictureDetails picture) {
        var color = picture.color();
        var light = picture.light();
        return new Color(
                color.primaries().orElse(null),
                color.transfer().orElse(null),
                color.matrix().orElse(null),
                color.range().orElse(null),
                color.chromaLocation().orElse(null),
                color.highDynamicRange().orElse(null),
                Streams.orNull(light.masteringMin()),
                Streams.orNull(light.masteringMax()),
                Streams.orNull(light.maxContent()),
                Streams.orNull(light.maxFrameAverage()),
                Streams.orNull(light.dolbyVisionProfile()));
    }
}
