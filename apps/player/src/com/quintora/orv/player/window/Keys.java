// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import java.awt.event.ActionEvent;
import java.util.ArrayList;
import java.util.List;
import javax.swing.AbstractAction;
import javax.swing.JComponent;
import javax.swing.KeyStroke;

/** The window's keys. They rest while a menu is open, which has keys of its own. */
final class Keys {
    private final JComponent content;
    private final Controls controls;
    private final List<Help.Line> lines = new ArrayList<>();

    private Keys(JComponent content, Controls controls) {
        this.content = content;
        this.controls = controls;
    }

    /**
     * Binds every key for the window in which that component is; gives what the help says of them.
     * It must not be the root pane, where these bindings would hide those of an open menu.
     */
    static List<Help.Line> bind(JComponent content, Controls controls, ControlBar bar) {
        Keys keys = new Keys(content, controls);
        keys.bindPlaying();
        keys.bindSkips();
        keys.bindSound();
        keys.bindChoices(bar);
        keys.bindWindow();
        return keys.lines;
    }

    private void bindPlaying() {
        line("Space, K", "Play or pause");
        on("SPACE", controls::togglePlaying);
        on("K", controls::togglePlaying);
        line("[  ]", "Slower, faster");
        on("OPEN_BRACKET", () -> controls.changeSpeed(-1));
        on("CLOSE_BRACKET", () -> controls.changeSpeed(1));
        line(",  .", "Previous frame, next frame");
        on("COMMA", () -> controls.step(-1));
        on("PERIOD", () -> controls.step(1));
    }

    private void bindSkips() {
        line("Left, Right", "10 seconds back, forward");
        on("LEFT", () -> controls.skip(-10_000));
        on("RIGHT", () -> controls.skip(10_000));
        line("Shift+Left, Shift+Right", "1 second back, forward");
        on("shift LEFT", () -> controls.skip(-1_000));
        on("shift RIGHT", () -> controls.skip(1_000));
        line("Page Up, Page Down", "1 minute back, forward");
        on("PAGE_UP", () -> controls.skip(-60_000));
        on("PAGE_DOWN", () -> controls.skip(60_000));
        line("Home", "Go to the start");
        on("HOME", () -> controls.seekTo(0));
    }

    private void bindSound() {
        line("Up, Down", "Volume up, down");
        on("UP", () -> controls.changeVolume(ControlBar.VOLUME_STEP));
        on("DOWN", () -> controls.changeVolume(-ControlBar.VOLUME_STEP));
        line("M", "Mute or unmute");
        on("M", controls::toggleMuted);
    }

    private void bindChoices(ControlBar bar) {
        line("A", "Audio track");
        on("A", () -> controls.chooseAudio(bar.audioButton()));
        line("S", "Subtitles");
        on("S", () -> controls.chooseSubtitles(bar.subtitlesButton()));
    }

    private void bindWindow() {
        line("F, F11", "Full screen");
        on("F", controls::toggleFullScreen);
        on("F11", controls::toggleFullScreen);
        line("Escape", "Close this list, leave full screen");
        on("ESCAPE", controls::leave);
        line("H, ?, F1", "This list");
        on("H", controls::toggleHelp);
        on("typed ?", controls::toggleHelp);
        on("F1", controls::toggleHelp);
        line("Q", "Close the window");
        on("Q", controls::quit);
    }

    /** What to say of the keys that follow. */
    private void line(String keys, String meaning) {
        lines.add(new Help.Line(keys, meaning));
    }

    private void on(String key, Runnable action) {
        bind(content, JComponent.WHEN_IN_FOCUSED_WINDOW, key, action);
    }

    /** While a component has the focus or, as the condition says, its window has. */
    static void bind(JComponent component, int condition, String key, Runnable action) {
        component.getInputMap(condition).put(KeyStroke.getKeyStroke(key), key);
        component.getActionMap()
                .put(
                        key,
                        new AbstractAction() {
                            @Override
                            public void actionPerformed(ActionEvent event) {
                                action.run();
                            }

                            @Override
                            public boolean isEnabled() {
                                return !ChoiceMenu.isOpen();
                            }
                        });
    }
}
