// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import static org.junit.jupiter.api.Assertions.assertEquals;

import com.quintora.mmp.Media;
import com.quintora.mmp.Wait;
import com.quintora.orv.player.desktop.TestBus;
import org.junit.jupiter.api.AfterEach;
import org.junit.jupiter.api.BeforeEach;
import org.junit.jupiter.api.Test;

/** The window, as the desktop's media keys and panels have it. */
class MediaKeysWindowTest extends WindowFixture {
    private TestBus bus;

    @BeforeEach
    void openBus() throws Exception {
        bus = new TestBus();
        System.setProperty("orv.bus", bus.address());
    }

    @AfterEach
    void closeBus() {
        System.clearProperty("orv.bus");
        bus.close();
    }

    @Test
    void mediaKeysPlayPauseAndGoOn() throws Exception {
        open("silent.mkv", Media.path("long.mkv"));
        bus.await("PlaybackStatus", "Playing");
        bus.await("Metadata", "\"long.mkv\"");
        bus.call("Pause");
        bus.await("PlaybackStatus", "Paused");
        bus.call("Play");
        bus.await("PlaybackStatus", "Playing");
        bus.call("Next");
        bus.await("Metadata", "\"silent.mkv\"");
        bus.await("CanGoNext", "false");
        Wait.until("the title", () -> "silent.mkv".equals(onWindow(frame::getTitle)));
    }

    @Test
    void panelsSeekAndChangeTheVolume() throws Exception {
        open("long.mkv");
        bus.await("PlaybackStatus", "Playing");
        bus.call("Pause");
        bus.call("Seek", "int64:20000000");
        awaitSecond(20, 30);
        bus.set("Volume", "double:0.25");
        bus.await("Volume", "double 0.25");
        bus.set("LoopStatus", "string:Playlist");
        bus.await("LoopStatus", "Playlist");
        bus.send("org.mpris.MediaPlayer2.Quit");
        assertEquals(0, playing.get());
    }
}
