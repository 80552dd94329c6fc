// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.testing;

import static org.junit.jupiter.api.Assertions.assertThrows;

import com.quintora.SubtitleAttr;
import com.quintora.mmp.ColorMode;
import com.quintora.mmp.Media;
import com.quintora.mmp.MediaError;
import com.quintora.mmp.MediaException;
import com.quintora.mmp.MediaPlayer;
import com.quintora.mmp.PlayerListener;
import com.quintora.mmp.PlayerState;
import com.quintora.mmp.Track;
import java.util.LinkedHashMap;
import java.util.Map;

/** Brings a player to a state and calls everything there, returning to it after each call. */
final class EveryCall {
    private interface Call {
        Object on(MediaPlayer player) throws Exception;
    }

    private interface Change {
        void on(MediaPlayer player) throws Exception;
    }

    private final PlayerState state;
    private final Map<String, Call> calls = new LinkedHashMap<>();

    EveryCall(PlayerState state) {
        this.state = state;
        ask("isPlaying", MediaPlayer::isPlaying);
        ask("getDuration", MediaPlayer::getDuration);
        ask("getVideoWidth", MediaPlayer::getVideoWidth);
        ask("getVolume", MediaPlayer::getVolume);
        ask("isLooping", MediaPlayer::isLooping);
        ask("metadata", player -> player.tracks().metadata().isPresent());
        ask("audio", player -> player.tracks().audio().size());
        ask("currentAudio", player -> player.tracks().currentAudio().isPresent());
        ask("currentIndex", player -> player.tracks().currentIndex(Track.Kind.AUDIO));
        ask("chapters", player -> player.tracks().chapters());
        ask("embedded", player -> player.pictures().embedded().isPresent());
        ask("getSpeed", player -> player.trickPlay().getSpeed());
        ask("canPlayAt", player -> player.trickPlay().canPlayAt(2));
        ask("getSessionId", player -> player.audio().getSessionId());
        change("addListener", player -> player.addListener(new PlayerListener() {}));
        change("setLooping", player -> player.setLooping(false));
        change("setVolume", player -> player.setVolume(1));
        change("setMuted", player -> player.audio().setMuted(false));
        change("setSurface", player -> player.setSurface(null));
        change("setStyle", player -> player.subtitles().setStyle(
                SubtitleAttr.builder().textColor(-1).build()));
        change("thumbnail", player -> player.pictures().thumbnail(0, 0, ColorMode.RGB565));
        change("setSpeed", player -> player.trickPlay().setSpeed(1));
        change("step", player -> player.trickPlay().step(1).join());
        change("stepAndWait", player -> player.trickPlay().stepAndWait(1));
        change("repeatOff", player -> player.trickPlay().repeatOff());
        change("seekToByteAndWait", player -> player.trickPlay().seekToByteAndWait(-1));
        change("select", player -> player.tracks().select(null));
        change("selectNone", player -> player.tracks().selectNone(Track.Kind.SUBTITLE).join());
        change("add", player -> player.subtitles().add((String) null));
        change("seekTo", player -> player.seekTo(0).join());
        change("seekToAndWait", player -> player.seekToAndWait(0));
        change("setDataSource", player -> player.setDataSource("/nowhere", Map.of("a", "b")));
        change("prepareAndWait", MediaPlayer::prepareAndWait);
        change("prepareAsync", player -> player.prepareAsync().join());
        change("start", MediaPlayer::start);
        change("pause", MediaPlayer::pause);
        change("stop", MediaPlayer::stop);
        change("reset", player -> player.reset().join());
        change("resetAndWait", MediaPlayer::resetAndWait);
        change("close", MediaPlayer::close);
    }

    private void ask(String name, Call call) {
        calls.put(name, call);
    }

    private void change(String name, Change change) {
        calls.put(name, player -> {
            change.on(player);
            return "done";
        });
    }

    void run(Subject s) throws Exception {
        if (state == PlayerState.IDLE) {
            calls.remove("setDataSource"); // There it looks for a file, which the fake does not.
        }
        s.player.setLooping(false);
        for (Map.Entry<String, Call> entry : calls.entrySet()) {
            boolean alive = s.player.getState() != PlayerState.RELEASED;
            if (s.player.getState() != state && alive) {
                reach(s);
            }
            s.call(entry.getKey(), () -> entry.getValue().on(s.player));
        }
        // The events of so many ways are another comparison's.
        s.player.close();
        s.events.clear();
    }

    private void reach(Subject s) throws Exception {
        MediaPlayer player = s.player;
        if (state == PlayerState.RELEASED) {
            player.close();
            return;
        }
        player.resetAndWait();
        if (state == PlayerState.IDLE) {
            return;
        }
        if (state == PlayerState.ERROR) {
            fail(s);
            return;
        }
        player.setDataSource(s.path);
        if (state == PlayerState.INITIALIZED) {
            return;
        }
        player.prepareAndWait();
        switch (state) {
            case STARTED -> player.start();
            case PAUSED -> {
                player.start();
                player.pause();
            }
            case STOPPED -> player.stop();
            case COMPLETED -> {
                player.seekToAndWait(player.getDuration());
                player.start();
                s.waitUntil("the end", () -> player.getState() == PlayerState.COMPLETED);
            }
            default -> { }
        }
    }

    private static void fail(Subject s) throws Exception {
        s.player.setDataSource(Media.path("garbage.bin"));
        if (s.isFake()) {
            s.control().failNextPrepare(MediaError.MALFORMED);
        }
        assertThrows(MediaException.class, s.player::prepareAndWait);
    }
}
