// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import static org.junit.jupiter.api.Assertions.assertEquals;

import com.quintora.mmp.Media;
import com.quintora.mmp.OrvMediaPlayer;
import com.quintora.mmp.Wait;
import java.util.List;
import java.util.concurrent.CopyOnWriteArrayList;
import org.junit.jupiter.api.AfterEach;
import org.junit.jupiter.api.BeforeEach;
import org.junit.jupiter.api.Test;

/** Frames that come while none is to be shown. */
class FramePumpTest {
    private final List<Long> shownMs = new CopyOnWriteArrayList<>();
    private final FramePump pump =
            new FramePump(image -> shownMs.add(Math.round(image.getTimestamp() / 1e6)));
    private final OrvMediaPlayer player = new OrvMediaPlayer();

    @BeforeEach
    void open() throws Exception {
        player.setDataSource(Media.path("long.mkv"));
        player.setSurface(pump.reader().getSurface());
        pump.start();
        player.prepareAndWait();
        Wait.until("the first frame shows", () -> !shownMs.isEmpty());
    }

    @AfterEach
    void close() {
        pump.close();
        player.close();
    }

    @Test
    void theOnlyOneShowsAfterwards() throws Exception {
        pump.hide(true);
        seekAndAwaitFrame(5_000);
        awaitPumpHolding();
        shownMs.clear();
        pump.hide(false);
        Wait.until("it shows", () -> !shownMs.isEmpty());
        assertEquals(List.of(5_000L), shownMs.stream().distinct().toList());
    }

    @Test
    void onlyTheLastOfSeveralShowsAfterwards() throws Exception {
        pump.hide(true);
        for (int millis : new int[] {5_000, 9_000, 3_000}) {
            seekAndAwaitFrame(millis);
            awaitPumpHolding();
        }
        shownMs.clear();
        pump.hide(false);
        Wait.until("it shows", () -> !shownMs.isEmpty());
        assertEquals(List.of(3_000L), shownMs.stream().distinct().toList());
    }

    private void seekAndAwaitFrame(int millis) throws Exception {
        long before = pump.reader().getFrameCount();
        player.seekToAndWait(millis);
        Wait.until("it is drawn", () -> pump.reader().getFrameCount() > before);
    }

    private static void awaitPumpHolding() throws Exception {
        Wait.until(
                "the pump waits with a frame",
                () -> Thread.getAllStackTraces().keySet().stream()
                        .anyMatch(thread -> thread.getName().equals("frames")
                                && thread.getState() == Thread.State.WAITING));
    }
}
