// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertFalse;
import static org.junit.jupiter.api.Assertions.assertNotNull;
import static org.junit.jupiter.api.Assertions.assertTrue;

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
import javax.swing.JComponent;
import javax.swing.JFrame;
import javax.swing.JLabel;
import javax.swing.JTextArea;
import javax.swing.KeyStroke;
import javax.swing.SwingUtilities;
import org.junit.jupiter.api.AfterEach;
import org.junit.jupiter.api.Test;
import picocli.CommandLine;

/** The window, on a display, with real media. */
class WindowTest {
    private FutureTask<Integer> playing;
    private JFrame frame;

    @AfterEach
    void closeWindow() throws Exception {
        if (!playing.isDone()) {
            press("Q");
        }
        playing.get(Wait.LIMIT.toSeconds(), TimeUnit.SECONDS);
        assertFalse(frame.isDisplayable());
    }

    @Test
    void itShowsThePictureAndPlaysOn() throws Exception {
        open("long.mkv");
        awaitPicture();
        Wait.until("the time moves", () -> !label().equals("0:00"));
        assertEquals("long.mkv", frame.getTitle());
    }

    @Test
    void spacePausesAndPlays() throws Exception {
        open("long.mkv");
        awaitButton("Pause (Space)");
        press("SPACE");
        awaitButton("Play (Space)");
        press("SPACE");
        awaitButton("Pause (Space)");
    }

    @Test
    void keysMoveInTime() throws Exception {
        open("long.mkv");
        awaitButton("Pause (Space)");
        press("SPACE");
        awaitButton("Play (Space)");
        press("RIGHT");
        press("RIGHT");
        awaitSecond(18, 21);
        press("LEFT");
        awaitSecond(7, 11);
        press("HOME");
        awaitSecond(0, 0);
    }

    @Test
    void farKeyFramesDoNotHoldUpASkip() throws Exception {
        open("distant.mkv");
        awaitButton("Pause (Space)");
        press("SPACE");
        awaitButton("Play (Space)");
        press("RIGHT");
        awaitSecond(15, 16);
    }

    @Test
    void fullScreenCoversTheScreenAndComesBack() throws Exception {
        open("long.mkv");
        awaitPicture();
        int width = frame.getWidth();
        press("F");
        int screen = frame.getToolkit().getScreenSize().width;
        Wait.until("it is as wide as the screen", () -> frame.getWidth() == screen);
        assertNotNull(button("Leave full screen (F)"));
        press("ESCAPE");
        Wait.until("it has its old width", () -> frame.getWidth() == width);
        Wait.until("it plays on", () -> button("Pause (Space)") != null);
    }

    @Test
    void tracksAreOfferedWhereThereAreSome() throws Exception {
        open("tracks.mkv");
        awaitButton("Pause (Space)");
        assertTrue(button("Sound track (A)").isEnabled());
        assertTrue(button("Subtitles (S)").isEnabled());
    }

    @Test
    void whatHasNoSubtitlesOffersNone() throws Exception {
        open("long.mkv");
        awaitButton("Pause (Space)");
        assertFalse(button("Subtitles (S)").isEnabled());
    }

    @Test
    void aSoundFileShowsItsCover() throws Exception {
        open("covered.mp3");
        awaitPicture();
    }

    @Test
    void aFailureIsSaidInTheWindow() throws Exception {
        open("noise.bin");
        Wait.until("it says so", () -> find(JLabel.class, "This cannot be played") != null);
        JTextArea sentence = find(JTextArea.class, null);
        assertTrue(sentence.getText().startsWith(Media.path("noise.bin")), sentence.getText());
        assertFalse(button("Play (Space)").isEnabled());
        press("Q");
        assertEquals(1, playing.get(Wait.LIMIT.toSeconds(), TimeUnit.SECONDS));
    }

    private void open(String media) throws Exception {
        PlayOptions options = new PlayOptions();
        new CommandLine(options).parseArgs(Media.path(media));
        playing = new FutureTask<>(() -> PlayerWindow.play(options));
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
    private void press(String key) throws Exception {
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

    private void awaitPicture() throws Exception {
        Wait.until("a picture shows", () -> brightest(find(VideoPane.class, null)) > 100);
    }

    private void awaitButton(String name) throws Exception {
        Wait.until("there is " + name, () -> button(name) != null);
    }

    private FlatButton button(String name) throws Exception {
        return find(FlatButton.class, name);
    }

    private void awaitSecond(int from, int to) throws Exception {
        Wait.until(
                "the time is between " + from + " and " + to + " s",
                () -> {
                    int second = Integer.parseInt(label().substring(2));
                    return second >= from && second <= to;
                });
    }

    /** The elapsed time that stands beside the bar. */
    private String label() throws Exception {
        return onWindow(() -> find(frame, JLabel.class, null).getText());
    }

    private <T extends Component> T find(Class<T> type, String name) throws Exception {
        return onWindow(() -> find(frame, type, name));
    }

    private static <T extends Component> T find(Container parent, Class<T> type, String name) {
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

    private static int brightest(Component component) throws Exception {
        return onWindow(
                () -> {
                    var image = new BufferedImage(400, 300, BufferedImage.TYPE_INT_RGB);
                    component.paint(image.getGraphics());
                    int brightest = 0;
                    for (int x = 0; x < 400; x += 10) {
                        brightest = Math.max(brightest, image.getRGB(x, 150) & 255);
                        brightest = Math.max(brightest, image.getRGB(x, 150) >> 16 & 255);
                    }
                    return brightest;
                });
    }

    private static <T> T onWindow(Callable<T> question) throws Exception {
        FutureTask<T> task = new FutureTask<>(question);
        SwingUtilities.invokeAndWait(task);
        return task.get();
    }
}
