// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.events;

import com.quintora.mmp.internal.base.NativePlayer;
import com.quintora.mmp.internal.failure.Failures;
import com.quintora.mmp.internal.source.CurrentSource;
import java.io.IOException;

/**
 * Finds out whether the engine stands at the end of its media: there its position is the duration.
 * It may also be that where it waits for the bytes of media whose length is unknown, or known only
 * as far as they were read.
 */
public final class EndOfMedia {
    private final NativePlayer natives;
    private final CurrentSource source;

    public EndOfMedia(NativePlayer natives, CurrentSource source) {
        this.natives = natives;
        this.source = source;
    }

    public boolean isReached() {
        try {
            if (natives.isPlaying()) {
                return false;
            }
            int position = natives.getCurrentPosition();
            return position == natives.getDuration() && !awaitsBytes(position);
        } catch (IOException | SecurityException | IllegalStateException e) {
            return false; // The media failed or went just now.
        }
    }

    private boolean awaitsBytes(int position) {
        return source.stream().isReading() || position == 0 && Failures.isUrl(source.name());
    }
}
