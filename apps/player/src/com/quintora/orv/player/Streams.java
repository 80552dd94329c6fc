// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import com.quintora.mmp.MediaStream;
import java.util.List;
import java.util.Optional;
import java.util.OptionalDouble;
import java.util.OptionalInt;
import java.util.OptionalLong;
import java.util.stream.Stream;

/** The streams of a container, by what they hold. */
record Streams(List<MediaStream> all) {
    Stream<MediaStream> of(MediaStream.Kind kind) {
        return all.stream().filter(stream -> stream.kind() == kind);
    }

    /** The stream of a track; empty for tracks from other files. */
    Optional<MediaStream> of(MediaStream.Kind kind, int track) {
        return of(kind).filter(stream -> stream.track().equals(OptionalInt.of(track))).findFirst();
    }

    static Long orNull(OptionalLong number) {
        return number.isPresent() ? number.getAsLong() : null;
    }

    static Integer orNull(OptionalInt number) {
        return number.isPresent() ? number.getAsInt() : null;
    }

    static Double orNull(OptionalDouble number) {
        return number.isPresent() ? number.getAsDouble() : null;
    }
}
