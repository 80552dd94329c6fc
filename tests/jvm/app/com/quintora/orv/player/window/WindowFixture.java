// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import static org.junit.jupiter.api.Assertions.assertFalse;

import com.quintora.mmp.Media;
import com.quintora.mmp.Wait;
import com.quintora.orv.player.PlayOptions;
import java.awt.Component;
import java.awt.Container;
import java.awt.Frame;
import java.awt.event.ActionEvent;
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
import org.junit.jupiter.api.AfterEach;
import picocli.CommandLine;

/** A window, on a display, that plays real media; its test ends by closing it. */
abstract class WindowFixture {
    FutureTask<Integer> playing;
    JFrame frame;

    @AfterEach
    void closeWindow() throws Exception {
        if (!playing.isDone()) {
            press("Q");
        }
        playing.get(Wait.LIMIT.toSeconds(), TimeUnit.SECONDS);
        assertFalse(frame.isDisplayable());
    }

    final void open(String media, String... options) throws Exception {
        PlayOptions parsed = new PlayOptions();
        CommandLine parser = new CommandLine(parsed);
        parser.parseArgs(Stream.concat(Stream.of(options), Stream.of(Media.path(media)))
                .toArray(String[]::new));
        playing = new FutureTask<>(() -> PlayerWindow.play(parsed));
        new Thread(playing, "main").start();
        Wait.until("the window is open", () -> openFrame() != null);
        frame = openFrame();
    }

    private static JFrame openFrame() {
        for (Frame candidate : Frame.getFrames()) {
            if (candidate instanceof JFrame window && window.isShowing()) {
                return window;
            }
        }
        return null;
    }

    /** As if the key were pressed in the window. */
    final void press(String key) throws Exception {
        SwingUtilities.invokeAndWait(
                () -> {
                    var root = frame.getRootPane();
                    Object action =
                            root.getInputMap(JComponent.WHEN_IN_FOCUSED_WINDOW)
                                    .get(KeyStroke.getKeyStroke(key));
                    root.getActionMap()
                            .get(action)
                            .actionPerformed(new ActionEvent(root, 0, key));
                });
    }

    final void awaitPicture() throws Exception {
        Wait.until("a picture shows", () -> brightest(find(VideoPane.class, null), 150) > 100);
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
                () -> {
                    int second = Integer.parseInt(label().substring(2));
                    return second >= from && second <= to;
                });
    }

    /** The elapsed time that stands beside the bar. */
    final String label() throws Exception {
        return onWindow(() -> find(frame, JLabel.class, null).getText());
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

    static <T> T onWindow(Callable<T> question) throws Exception {
        FutureTask<T> task = new FutureTask<>(question);
        SwingUtilities.invokeAndWait(task);
        return task.get();
    }
}
