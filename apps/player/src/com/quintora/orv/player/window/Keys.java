// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import java.awt.event.ActionEvent;
import java.util.Map;
import java.util.TreeMap;
import javax.swing.AbstractAction;
import javax.swing.JComponent;
import javax.swing.KeyStroke;

/** The window's keys. */
final class Keys {
    private Keys() {}

    static void bind(JComponent root, Controls controls, ControlBar bar) {
        actions(controls, bar).forEach((key, action) -> bind(root, key, action));
    }

    private static Map<String, Runnable> actions(Controls controls, ControlBar bar) {
        Map<String, Runnable> keys = new TreeMap<>();
        keys.put("SPACE", controls::togglePlaying);
        keys.put("K", controls::togglePlaying);
        keys.put("LEFT", () -> controls.skip(-10_000));
        keys.put("RIGHT", () -> controls.skip(10_000));
        keys.put("shift LEFT", () -> controls.skip(-1_000));
        keys.put("shift RIGHT", () -> controls.skip(1_000));
        keys.put("PAGE_UP", () -> controls.skip(-60_000));
        keys.put("PAGE_DOWN", () -> controls.skip(60_000));
        keys.put("HOME", () -> controls.seekTo(0));
        keys.put("COMMA", () -> controls.step(-1));
        keys.put("PERIOD", () -> controls.step(1));
        keys.put("UP", () -> controls.changeVolume(0.05));
        keys.put("DOWN", () -> controls.changeVolume(-0.05));
        keys.put("M", controls::toggleMuted);
        keys.put("OPEN_BRACKET", () -> controls.changeSpeed(-1));
        keys.put("CLOSE_BRACKET", () -> controls.changeSpeed(1));
        keys.put("A", () -> controls.chooseAudio(bar.audioButton()));
        keys.put("S", () -> controls.chooseSubtitles(bar.subtitlesButton()));
        keys.put("F", controls::toggleFullScreen);
        keys.put("F11", controls::toggleFullScreen);
        keys.put("ESCAPE", controls::leaveFullScreen);
        keys.put("Q", controls::quit);
        return keys;
    }

    private static void bind(JComponent root, String key, Runnable action) {
        root.getInputMap(JComponent.WHEN_IN_FOCUSED_WINDOW).put(KeyStroke.getKeyStroke(key), key);
        root.getActionMap()
                .put(
                        key,
                        new AbstractAction() {
                            @Override
                            public void actionPerformed(ActionEvent event) {
                                action.run();
                            }
                        });
    }
}
