// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertFalse;
import static org.junit.jupiter.api.Assertions.assertNotNull;
import static org.junit.jupiter.api.Assertions.assertTrue;

import java.awt.Component;
import java.awt.event.InputEvent;
import java.awt.event.KeyEvent;
import java.awt.event.MouseEvent;
import java.lang.reflect.Proxy;
import java.util.ArrayList;
import java.util.Arrays;
import java.util.List;
import javax.accessibility.AccessibleContext;
import javax.accessibility.AccessibleRole;
import javax.swing.JComponent;
import javax.swing.JFrame;
import javax.swing.KeyStroke;
import javax.swing.SwingUtilities;
import org.junit.jupiter.api.AfterEach;
import org.junit.jupiter.api.BeforeEach;
import org.junit.jupiter.api.Test;

/** What keys, mouse and screen readers do with the controls. */
class KeyboardWindowTest {
    private final List<String> calls = new ArrayList<>();
    private JFrame frame;
    private ControlBar bar;
    private List<ActionGroup> actions;

    @BeforeEach
    void open() throws Exception {
        Controls controls =
                (Controls) Proxy.newProxyInstance(
                        Controls.class.getClassLoader(),
                        new Class<?>[] {Controls.class},
                        (proxy, method, arguments) -> {
                            String of = arguments == null ? "" : Arrays.toString(arguments);
                            calls.add(method.getName() + of);
                            return null;
                        });
        SwingUtilities.invokeAndWait(() -> {
            frame = new JFrame();
            bar = new ControlBar(controls);
            frame.add(bar);
            actions = WindowActions.of(controls, bar);
            Keys.bind(bar, actions);
            bar.seekBar().showPosition(30_000, 60_000, 100);
            frame.pack();
            frame.setVisible(true);
        });
    }

    @AfterEach
    void close() throws Exception {
        SwingUtilities.invokeAndWait(frame::dispose);
    }

    @Test
    void spaceDoesOneThingWhereverTheFocusIs() throws Exception {
        type(find(FlatButton.class, "Play (Space)"), KeyEvent.VK_SPACE);
        type(find(FlatButton.class, "Mute (M)"), KeyEvent.VK_SPACE);
        type(bar.seekBar(), KeyEvent.VK_SPACE);
        assertEquals(List.of("togglePlaying", "toggleMuted", "togglePlaying"), calls);
    }

    @Test
    void aBarHasTheArrowsWhileItHasTheFocus() throws Exception {
        LevelBar volume = find(LevelBar.class, "Volume");
        type(volume, KeyEvent.VK_RIGHT);
        type(volume, KeyEvent.VK_DOWN);
        type(volume, KeyEvent.VK_HOME);
        type(bar.seekBar(), KeyEvent.VK_LEFT);
        type(bar.seekBar(), KeyEvent.VK_END);
        assertEquals(
                List.of("changeVolume[0.05]", "changeVolume[-0.05]", "setVolume[0.0]",
                        "skip[-10000]", "seekTo[60000]"),
                calls);
    }

    @Test
    void controlsCanHaveTheFocus() throws Exception {
        assertTrue(bar.seekBar().isFocusable());
        assertTrue(find(LevelBar.class, "Volume").isFocusable());
        assertTrue(find(FlatButton.class, "Play (Space)").isFocusable());
    }

    @Test
    void onlyTheLeftButtonOfTheMouseSeeks() throws Exception {
        press(bar.seekBar(), MouseEvent.BUTTON3);
        press(bar.seekBar(), MouseEvent.BUTTON2);
        assertEquals(List.of(), calls);
        press(bar.seekBar(), MouseEvent.BUTTON1);
        assertEquals(List.of("seekTo[0]"), calls);
    }

    @Test
    void theBarIsASliderOfSeconds() throws Exception {
        AccessibleContext slider = bar.seekBar().getAccessibleContext();
        List<Object> values = new ArrayList<>();
        // The window may get the keyboard meanwhile, of which the slider tells, too.
        slider.addPropertyChangeListener(change -> {
            if (AccessibleContext.ACCESSIBLE_VALUE_PROPERTY.equals(change.getPropertyName())) {
                values.add(change.getNewValue());
            }
        });
        assertEquals(AccessibleRole.SLIDER, slider.getAccessibleRole());
        assertEquals(30, slider.getAccessibleValue().getCurrentAccessibleValue());
        assertEquals(60, slider.getAccessibleValue().getMaximumAccessibleValue());
        SwingUtilities.invokeAndWait(
                () -> slider.getAccessibleValue().setCurrentAccessibleValue(45));
        assertEquals(List.of("seekTo[45000]"), calls);
        assertEquals(List.of(45), values);
    }

    @Test
    void mediaOfUnknownLengthHaveNoPlaceToSet() throws Exception {
        SwingUtilities.invokeAndWait(() -> bar.seekBar().showPosition(5_000, 0, 0));
        press(bar.seekBar(), MouseEvent.BUTTON1);
        var value = bar.seekBar().getAccessibleContext().getAccessibleValue();
        assertTrue(!value.setCurrentAccessibleValue(3));
        assertEquals(List.of(), calls);
    }

    @Test
    void noTwoActionsHaveTheSameKey() {
        List<String> keys =
                actions.stream()
                        .flatMap(group -> group.actions().stream())
                        .flatMap(action -> action.keys().stream())
                        .toList();
        var bound = bar.getInputMap(JComponent.WHEN_IN_FOCUSED_WINDOW).keys();
        assertEquals(keys.size(), bound.length, () -> keys + " for " + Arrays.toString(bound));
    }

    @Test
    void everyKeyIsReadable() {
        for (ActionGroup group : actions) {
            for (Action action : group.actions()) {
                action.keys().forEach(key -> assertNotNull(KeyStroke.getKeyStroke(key), key));
                assertFalse(action.keyNames().contains("_"), action.keyNames());
            }
        }
        assertEquals("Shift+Page Up", KeyNames.of("shift PAGE_UP"));
        assertEquals("?", KeyNames.of("typed ?"));
    }

    private static void type(Component component, int code) throws Exception {
        SwingUtilities.invokeAndWait(() -> {
            for (int kind : new int[] {KeyEvent.KEY_PRESSED, KeyEvent.KEY_RELEASED}) {
                component.dispatchEvent(
                        new KeyEvent(component, kind, 0, 0, code, KeyEvent.CHAR_UNDEFINED));
            }
        });
    }

    private static void press(Component component, int button) throws Exception {
        SwingUtilities.invokeAndWait(() -> {
            for (int kind : new int[] {MouseEvent.MOUSE_PRESSED, MouseEvent.MOUSE_RELEASED}) {
                component.dispatchEvent(
                        new MouseEvent(component, kind, 0, InputEvent.getMaskForButton(button),
                                0, 5, 1, false, button));
            }
        });
    }

    private <T extends Component> T find(Class<T> type, String name) throws Exception {
        return WindowFixture.onWindow(() -> WindowFixture.find(frame, type, name));
    }
}
