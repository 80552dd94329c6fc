// SPDX-License-Identifier: Apache-2.0
package android.view;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertFalse;
import static org.junit.jupiter.api.Assertions.assertTrue;

import android.os.PlatformNatives;
import com.quintora.mmp.desktop.FrameReader;
import org.junit.jupiter.api.Test;

class SurfaceTest {
    @Test
    void aReadersSurfaceHasAProducer() {
        try (FrameReader reader = new FrameReader()) {
            assertTrue(reader.getSurface().isValid());
            assertTrue(PlatformNatives.hasProducer(reader.getSurface()));
        }
    }

    @Test
    void aSurfaceWithoutAConsumerHasNoProducer() {
        Surface surface = new Surface();
        assertTrue(surface.isValid());
        assertTrue(PlatformNatives.hasSurface(surface));
        assertFalse(PlatformNatives.hasProducer(surface));
        surface.release();
    }

    @Test
    void aReleasedSurfaceIsNothingToNativeCode() {
        Surface surface = new Surface();
        surface.release();
        surface.release();
        assertFalse(surface.isValid());
        assertFalse(PlatformNatives.hasSurface(surface));
        assertFalse(PlatformNatives.hasSurface(null));
    }

    @Test
    void releasingUnderAUserIsHarmless() throws InterruptedException {
        for (int i = 0; i < 200; i++) {
            Surface surface = new Surface();
            Thread user = new Thread(() -> {
                while (PlatformNatives.hasSurface(surface)) {
                    Thread.onSpinWait();
                }
            });
            user.start();
            surface.release();
            user.join();
            assertFalse(surface.isValid());
            assertFalse(PlatformNatives.hasSurface(surface));
        }
    }

    @Test
    void aPlayerKeepsDrawingWhenTheSurfaceIsReleased() {
        try (FrameReader reader = new FrameReader()) {
            long producer = PlatformNatives.holdProducer(reader.getSurface());
            reader.getSurface().release();
            assertEquals(0, PlatformNatives.draw(producer, 4, 4, 0, 0));
            assertEquals(1, reader.getFrameCount());
            PlatformNatives.dropProducer(producer);
        }
    }
}
