// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import static org.junit.jupiter.api.Assertions.fail;

import android.view.Surface;
import com.quintora.mmp.desktop.FrameReader;
import com.quintora.mmp.desktop.VideoFrame;
import java.util.function.Predicate;

/** What a player draws on. */
final class Screen implements AutoCloseable {
    private final FrameReader reader = new FrameReader();
    private Frame last;

    Surface surface() {
        return reader.getSurface();
    }

    /** The first frame from now on, the one on screen included, that is as wanted. */
    Frame await(String what, Predicate<Frame> wanted) throws InterruptedException {
        long end = System.nanoTime() + Wait.LIMIT.toNanos();
        while (last == null || !wanted.test(last)) {
            if (System.nanoTime() > end) {
                fail("no frame showed " + what);
            }
            try (VideoFrame frame = reader.awaitFrame(100)) {
                last = frame == null ? last : Frame.of(frame);
            }
        }
        return last;
    }

    /** Whether no frame has ever been shown. */
    boolean isBlank() {
        try (VideoFrame frame = reader.acquireLatestFrame()) {
            return last == null && frame == null;
        }
    }

    @Override
    public void close() {
        reader.close();
    }
}
