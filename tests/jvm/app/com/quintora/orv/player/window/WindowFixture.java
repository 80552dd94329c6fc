// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import static org.junit.jupiter.api.Assertions.assertFalse;

import android.view.SurfaceView;
import com.quintora.mmp.Media;
import com.quintora.mmp.Wait;
import com.quintora.orv.player.PlayOptions;
import java.awt.Color;
import java.awt.Component;
import java.awt.Container;
import java.awt.Frame;
import java.awt.Point;
import java.awt.Rectangle;
import java.awt.Robot;
import java.awt.event.InputEvent;
import java.awt.event.KeyEvent;
import java.awt.image.BufferedImage;
import java.util.concurrent.Callable;
import java.util.concurrent.FutureTask;
import java.util.concurrent.TimeUnit;
import java.util.stream.Stream;
import javax.swing.JComponent;
import javax.swing.JFrame;
import javax.swing.JLabel;
import javax.swing.KeyStroke;
import javax.swing.SwingUtilities;
import javax.swing.text.JTextComponent;
import org.junit.jupiter.api.AfterEach;

/** A window, on a display, that plays real media; its test ends by closing it. */
abstract class WindowFixture {
    FutureTask<Integer> playing;
    JFrame frame;
    private Robot robot;

    @AfterEach
    void closeWindow() throws Exception {
        if (onWindow(ChoiceMenu::isOpen)) {
            press("ESCAPE");
        }
        if (onWindow(() -> frame.getMostRecentFocusOwner() instanceof JTextComponent)) {
            press("ESCAPE"); // A field takes the letters.
        }
        if (!playing.isDone()) {
            press("Q");
        }
        playing.get(Wait.LIMIT.toSeconds(), TimeUnit.SECONDS);
        assertFalse(frame.isDisplayable());
    }

    final void open(String media, String... options) throws Exception {
        openSource(Media.path(media), options);
    }

    /** Of a path or a URL. */
    final void openSource(String source, String... options) throws Exception {
        PlayOptions parsed =
                PlayOptions.of(
                        Stream.of(memoryOptions(), usualOptions(), options, new String[] {source})
                                .flatMap(Stream::of)
                                .toArray(String[]::new));
        playing = new FutureTask<>(() -> PlayerWindow.play(parsed));
        new Thread(playing, "main").start();
        Wait.until("the window is open", () -> openFrame() != null);
        frame = openFrame();
    }

    private String[] memoryOptions() {
        return remembers() ? new String[0] : new String[] {"--no-memory"};
    }

    /** Whether the window may keep things; where, the test says by an option. */
    boolean remembers() {
        return false;
    }

    /** Options that every player of the test gets. */
    String[] usualOptions() {
        return new String[0];
    }

    private static JFrame openFrame() {
        for (Frame candidate : Frame.getFrames()) {
            // One that is still being made is listed, and says that it shows.
            if (candidate instanceof JFrame window
                    && window.isDisplayable()
                    && window.isShowing()) {
                return window;
            }
        }
        return null;
    }

    /** Presses a key in the window, and lets it go: a name of KeyStroke's, as in "shift LEFT". */
    final void press(String key) throws Exception {
        KeyStroke stroke = KeyStroke.getKeyStroke(key);
        SwingUtilities.invokeAndWait(
                () -> {
                    for (int kind : new int[] {KeyEvent.KEY_PRESSED, KeyEvent.KEY_RELEASED}) {
                        Component target = keyboardTarget();
                        target.dispatchEvent(
                                new KeyEvent(target, kind, 0, stroke.getModifiers(),
                                        stroke.getKeyCode(), KeyEvent.CHAR_UNDEFINED));
                    }
                });
    }

    // On a display without a window manager, or beside other windows, none may have the focus.
    private Component keyboardTarget() {
        Component focused = frame.getMostRecentFocusOwner();
        return ChoiceMenu.isOpen() || focused == null ? frame.getRootPane() : focused;
    }

    /** Moves the pointer to a place of a component, from 0 to 1 across and down. */
    final void pointAt(Component component, double across, double down) throws Exception {
        Point place = onWindow(component::getLocationOnScreen);
        robot().mouseMove(
                place.x + (int) Math.round((component.getWidth() - 1) * across),
                place.y + (int) Math.round((component.getHeight() - 1) * down));
    }

    /** Clicks into the middle of a component. */
    final void click(Component component) throws Exception {
        Wait.until("it can be clicked", () -> onWindow(component::isShowing));
        onWindow(() -> {
            if (component instanceof JComponent control) {
                control.scrollRectToVisible(
                        new Rectangle(control.getWidth(), control.getHeight()));
            }
            return null;
        });
        pointAt(component, 0.5, 0.5);
        robot().mousePress(InputEvent.BUTTON1_DOWN_MASK);
        robot().mouseRelease(InputEvent.BUTTON1_DOWN_MASK);
        robot().waitForIdle();
    }

    /** The mouse and the screen as they are. */
    final Robot robot() throws Exception {
        if (robot == null) {
            robot = new Robot();
        }
        return robot;
    }

    final void awaitPicture() throws Exception {
        Wait.until("a picture shows", () -> {
            VideoPane video = find(VideoPane.class, null);
            SurfaceView view = find(SurfaceView.class, null);
            return video != null && brightest(video, 150) > 100
                    || view != null && brightestOnScreen(view) > 100;
        });
    }

    final void awaitButton(String name) throws Exception {
        Wait.until("there is " + name, () -> button(name) != null);
    }

    final FlatButton button(String name) throws Exception {
        return find(FlatButton.class, name);
    }

    final void awaitSecond(int from, int to) throws Exception {
        Wait.until(
                "the time is between " + from + " and " + to + " s",
                () -> second() >= from && second() <= to);
    }

    /** Of the elapsed time, which is below a minute. */
    final int second() throws Exception {
        return Integer.parseInt(label().substring(2));
    }

    /** The elapsed time that stands beside the bar. */
    final String label() throws Exception {
        return onWindow(() -> find(frame, JLabel.class, null).getText());
    }

    /** The words on the picture, or null. */
    final String notice() throws Exception {
        return find(NoticePane.class, null).getAccessibleContext().getAccessibleDescription();
    }

    final <T extends Component> T find(Class<T> type, String name) throws Exception {
        return onWindow(() -> find(frame, type, name));
    }

    static <T extends Component> T find(Container parent, Class<T> type, String name) {
        for (Component child : parent.getComponents()) {
            if (type.isInstance(child) && isCalled(child, name)) {
                return type.cast(child);
            }
            T inside = child instanceof Container box ? find(box, type, name) : null;
            if (inside != null) {
                return inside;
            }
        }
        return null;
    }

    /** Without a name, the first that shows. */
    private static boolean isCalled(Component component, String name) {
        return name == null
                ? component.isShowing()
                : name.equals(component.getAccessibleContext().getAccessibleName());
    }

    /** The brightest red or blue of a row. */
    static int brightest(Component component, int y) throws Exception {
        return onWindow(
                () -> {
                    var image = new BufferedImage(400, 300, BufferedImage.TYPE_INT_RGB);
                    component.paint(image.getGraphics());
                    int brightest = 0;
                    for (int x = 0; x < 400; x++) {
                        brightest = Math.max(brightest, image.getRGB(x, y) & 255);
                        brightest = Math.max(brightest, image.getRGB(x, y) >> 16 & 255);
                    }
                    return brightest;
                });
    }

    /** The same of a row of the screen, two thirds down a component. */
    static int brightestOnScreen(Component view) throws Exception {
        Rectangle row = onWindow(() -> {
            if (!view.isShowing()) {
                return null;
            }
            Point place = view.getLocationOnScreen();
            return new Rectangle(place.x, place.y + view.getHeight() * 2 / 3, view.getWidth(), 1);
        });
        if (row == null) {
            return 0;
        }
        BufferedImage screen = new Robot().createScreenCapture(row);
        int brightest = 0;
        for (int x = 0; x < screen.getWidth(); x++) {
            Color color = new Color(screen.getRGB(x, 0));
            brightest = Math.max(brightest, Math.max(color.getRed(), color.getBlue()));
        }
        return brightest;
    }

    static <T> T onWindow(Callable<T> question) throws Exception {
        FutureTask<T> task = new FutureTask<>(question);
        SwingUtilities.invokeAndWait(task);
        return task.get();
    }
}
