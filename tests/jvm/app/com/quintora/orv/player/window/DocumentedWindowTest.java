// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertTrue;

import com.quintora.mmp.Media;
import com.quintora.mmp.Wait;
import java.awt.Component;
import java.awt.Dimension;
import java.awt.Rectangle;
import java.awt.Window;
import java.awt.image.BufferedImage;
import java.nio.file.Files;
import java.nio.file.Path;
import java.util.Arrays;
import java.util.List;
import java.util.Set;
import java.util.TreeSet;
import java.util.concurrent.Callable;
import java.util.regex.Matcher;
import java.util.regex.Pattern;
import javax.imageio.ImageIO;
import javax.swing.JTextArea;
import javax.swing.MenuSelectionManager;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.api.io.TempDir;

/**
 * The window as docs/player.md shows it. What it looks like now goes to the build folder; with
 * ORV_ACCEPT_SCREENSHOT set, to docs/pictures, too.
 */
class DocumentedWindowTest extends WindowFixture {
    private static final Dimension SIZE = new Dimension(854, 560);
    private static final int MOST_BYTES = 60_000;
    private static final Path DOCS = Path.of(System.getProperty("orv.test.docs"));
    private static final Path PICTURES = DOCS.resolve("pictures");
    private static final Path MADE =
            Path.of(System.getProperty("orv.test.media")).resolveSibling("pictures");
    private static final Pattern SHOWN = Pattern.compile("\\]\\((?:docs/)?pictures/([^)]+)\\)");
    private static final String ADVICE =
            "; ORV_ACCEPT_SCREENSHOT=1 ./orv test --filter jvm.DocumentedWindowTest writes it";

    // The sun, and a boat that crosses it within a minute: large even areas make small files.
    private static final String SEA =
            "color=0x5E83A8:size=854x480:rate=5[sky];"
                    + "color=0xF8C16A:size=170x130:rate=5[sun];"
                    + "color=0x1D3B59:size=854x190:rate=5[sea];"
                    + "color=0x0D1A28:size=150x26:rate=5[hull];"
                    + "color=0xF2F4F7:size=54x96:rate=5[sail];"
                    + "[sky][sun]overlay=342:200[a];[a][sea]overlay=0:290[b];"
                    + "[b][hull]overlay=x='12*t':y=316[c];[c][sail]overlay=x='52+12*t':y=214";

    @TempDir Path folder;

    @Test
    void thePagesPicturesAreOfTheWindow() throws Exception {
        openSeveral();
        Set<String> made = new TreeSet<>();

        press("L");
        made.add(keep("playlist", () -> find(ListPanel.class, null) != null));
        press("L");

        press("F10");
        made.add(keep("menu", () -> onWindow(DocumentedWindowTest::menuShows)));
        press("ESCAPE");

        press("H");
        made.add(keep("keys", () -> find(Help.class, null) != null));
        press("H");

        press("T");
        made.add(keep("subtitles", () -> find(SubtitlePanel.class, null) != null));
        press("T");

        press("I");
        made.add(keep("information", this::informationIsThere));
        press("I");

        pointAt(find(SeekBar.class, null), 0.6, 0.5);
        made.add(keep("preview", () -> onWindow(DocumentedWindowTest::previewHasAPicture)));

        for (String name : made) {
            checkDocumented(name);
        }
        assertEquals(made, picturesOf("player.md"), "the pictures that the page shows");
        assertTrue(made.containsAll(picturesOf("../README.md")), "the pictures of README.md");
        assertTrue(!picturesOf("../README.md").isEmpty(), "README.md shows one");
    }

    /** Paused in the middle of the first, in a window of the documented size. */
    private void openSeveral() throws Exception {
        String first = makeFilm("Harbour at dawn.mkv");
        openSource(
                copy(first, "The long way home.mkv"),
                first,
                copy(first, "Northern lights.mkv"),
                "--no-gpu", "--volume", "80", "--start", "21");
        Wait.until("it is the first", () -> frame.getTitle().equals("Harbour at dawn"));
        awaitPicture();
        awaitButton("Pause (Space)");
        press("SPACE");
        awaitButton("Play (Space)");
        onWindow(() -> {
            frame.getRootPane().setPreferredSize(SIZE);
            frame.pack();
            return null;
        });
        Wait.until("it has that size", () -> frame.getRootPane().getSize().equals(SIZE));
        pointAt(find(NoticePane.class, null), 0.5, 0.5);
    }

    private String makeFilm(String name) throws Exception {
        Path file = folder.resolve(name);
        Path words = Files.writeString(
                folder.resolve("words.srt"),
                "1\n00:00:00,000 --> 00:01:00,000\nThe first boats come in.\n");
        Path chapters = Files.writeString(
                folder.resolve("chapters.txt"),
                ";FFMETADATA1\ntitle=Harbour at dawn\n"
                        + chapter(0, 15, "Night") + chapter(15, 40, "First light")
                        + chapter(40, 60, "The market"));
        Media.run("ffmpeg", "-nostdin", "-v", "error",
                "-t", "60", "-f", "lavfi", "-i", SEA,
                "-i", words.toString(), "-i", chapters.toString(),
                "-map", "0", "-map", "1", "-map_metadata", "2", "-map_chapters", "2",
                "-c:v", "libx264", "-preset", "ultrafast", "-crf", "10", "-g", "25",
                "-pix_fmt", "yuv420p",
                "-metadata:s:s:0", "language=eng", "-disposition:s:0", "default",
                file.toString());
        return file.toString();
    }

    private static String chapter(int from, int to, String name) {
        return "[CHAPTER]\nTIMEBASE=1/1\nSTART=" + from + "\nEND=" + to + "\ntitle=" + name + "\n";
    }

    private String copy(String first, String name) throws Exception {
        return Files.copy(Path.of(first), folder.resolve(name)).toString();
    }

    /** Writes a picture of the window, once it shows that and stands still; gives its name. */
    private String keep(String name, Callable<Boolean> isThere) throws Exception {
        Wait.until(name + " shows", () -> isThere.call() && notice() == null);
        BufferedImage[] last = {onScreen()};
        Wait.until(name + " stands still", () -> {
            robot().waitForIdle();
            BufferedImage before = last[0];
            last[0] = onScreen();
            return Arrays.equals(pixels(before), pixels(last[0]));
        });
        String file = name + ".png";
        write(last[0], MADE.resolve(file));
        if (System.getenv("ORV_ACCEPT_SCREENSHOT") != null) {
            write(last[0], PICTURES.resolve(file));
        }
        return file;
    }

    private BufferedImage onScreen() throws Exception {
        Rectangle place = onWindow(() -> new Rectangle(
                frame.getRootPane().getLocationOnScreen(), frame.getRootPane().getSize()));
        return robot().createScreenCapture(place);
    }

    private static int[] pixels(BufferedImage image) {
        return image.getRGB(0, 0, image.getWidth(), image.getHeight(), null, 0, image.getWidth());
    }

    private static void write(BufferedImage image, Path file) throws Exception {
        Files.createDirectories(file.getParent());
        assertTrue(ImageIO.write(image, "png", file.toFile()), file.toString());
    }

    private static void checkDocumented(String name) throws Exception {
        Path file = PICTURES.resolve(name);
        assertTrue(Files.exists(file), "there is no " + file + ADVICE);
        BufferedImage picture = ImageIO.read(file.toFile());
        assertEquals(
                SIZE, new Dimension(picture.getWidth(), picture.getHeight()), file + ADVICE);
        assertTrue(Files.size(file) <= MOST_BYTES, file + " has " + Files.size(file) + " bytes");
    }

    private static Set<String> picturesOf(String page) throws Exception {
        Set<String> names = new TreeSet<>();
        Matcher shown = SHOWN.matcher(Files.readString(DOCS.resolve(page)));
        while (shown.find()) {
            names.add(shown.group(1));
        }
        return names;
    }

    private boolean informationIsThere() throws Exception {
        JTextArea area = find(JTextArea.class, "Information");
        return area != null && onWindow(area::getText).contains("State: paused");
    }

    private static boolean menuShows() {
        return MenuSelectionManager.defaultManager().getSelectedPath().length > 0;
    }

    private static boolean previewHasAPicture() {
        List<Window> open = Arrays.stream(Window.getWindows())
                .filter(window -> "preview".equals(window.getName()) && window.isShowing())
                .toList();
        return open.stream().map(window -> find(window, PreviewCard.class, null))
                .anyMatch(DocumentedWindowTest::isBright);
    }

    // Below the words is nothing but dark ground until the picture has come.
    private static boolean isBright(Component card) {
        if (card == null || card.getHeight() < 60) {
            return false;
        }
        var image = new BufferedImage(
                card.getWidth(), card.getHeight(), BufferedImage.TYPE_INT_RGB);
        card.paint(image.getGraphics());
        return Arrays.stream(pixels(image)).filter(rgb -> (rgb >> 16 & 255) > 200).count() > 500;
    }
}
