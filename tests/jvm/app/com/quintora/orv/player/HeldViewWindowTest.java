// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import static org.junit.jupiter.api.Assertions.assertEquals;

import com.quintora.mmp.desktop.DesktopSurfaceView;
import java.util.ArrayList;
import java.util.List;
import org.junit.jupiter.api.Test;

/** A view that is drawn on keeps its picture while frames are not to be shown. */
class HeldViewWindowTest {
    private final List<Boolean> holds = new ArrayList<>();

    @Test
    void framesOfAViewAreHiddenToo() {
        try (FramePump pump = new FramePump(image -> {})) {
            pump.hide(true);
            pump.watch(new RecordedView());
            pump.hide(true);
            pump.hide(false);
        }
        assertEquals(List.of(true, false), holds);
    }

    @SuppressWarnings("serial") // Nobody serializes it.
    private final class RecordedView extends DesktopSurfaceView {
        @Override
        public void hold(boolean held) {
            holds.add(held);
        }
    }
}
