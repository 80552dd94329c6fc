// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import static org.junit.jupiter.api.Assertions.fail;

import android.media.Image;
import android.media.ImageReader;
import android.view.Surface;
import java.util.function.Predicate;

/** What a player draws on. */
final class Screen implements AutoCloseable {
    private final ImageReader reader = ImageReader.newInstance(0, 0);
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
            try (Image image = reader.awaitImage(100)) {
                last = image == null ? last : Frame.of(image);
            }
        }
        return last;
    }

    /** Whether no frame has ever been shown. */
    boolean isBlank() {
        try (Image image = reader.acquireLatestImage()) {
            return last == null && image == null;
        }
    }

    @Override
    public void close() {
        reader.close();
    }
}
