// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import com.quintora.mmp.AudioTrack;
import com.quintora.mmp.MediaStream;
import com.quintora.mmp.SoundDetails;
import java.util.List;
import java.util.Optional;

/**
 * A sound track. stream is the place in the container, codec FFmpeg's name, fourcc the engine's
 * code.
 */
record AudioInfo(
        int index,
        Integer stream,
        String codec,
        String codecName,
        String fourcc,
        String profile,
        String language,
        String title,
        int channels,
        String channelLayout,
        int sampleRate,
        String sampleFormat,
        int bitsPerSample,
        int bitRate,
        List<String> flags) {

    static AudioInfo of(AudioTrack track, Streams streams) {
        Optional<MediaStream> stream = streams.of(MediaStream.Kind.AUDIO, track.index());
        return new AudioInfo(
                track.index(),
                stream.map(MediaStream::index).orElse(null),
                stream.map(MediaStream::codec).orElse(null),
                track.codecName(),
                track.codec().strip(),
                stream.flatMap(MediaStream::profile).orElse(null),
                track.language(),
                track.title(),
                track.channels(),
                track.channelLayout(),
                track.sampleRate(),
                stream.flatMap(MediaStream::sound).flatMap(SoundDetails::sampleFormat).orElse(null),
                track.bitsPerSample(),
                track.bitRate(),
                MediaInfo.flags(track.flags()));
    }
}
