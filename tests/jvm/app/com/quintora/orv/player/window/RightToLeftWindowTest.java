// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertTrue;

import com.quintora.mmp.Media;
import com.quintora.mmp.Wait;
import java.awt.Dimension;
import java.awt.image.BufferedImage;
import java.nio.file.Path;
import java.util.Arrays;
import java.util.List;
import javax.swing.DefaultListCellRenderer;
import javax.swing.JList;
import javax.swing.JTextArea;
import javax.swing.ListCellRenderer;
import javax.swing.text.BadLocationException;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.api.io.TempDir;

/**
 * Hebrew names and titles. What is drawn is compared with the same letters given from left to
 * right, as they should stand, behind a sign that forbids Java to order them.
 */
class RightToLeftWindowTest extends WindowFixture {
    private static final String NAME = "שלום עולם (2).mkv";
    private static final String NAME_AS_SEEN = "mkv.(2) םלוע םולש";
    private static final String TITLE = "ערב טוב!";

    @TempDir Path folder;

    @Test
    void aTitleAndAFileNameStandInTheirOrder() throws Exception {
        openSource(titled("short.mp4", NAME, "title=" + TITLE), "--no-gpu", "--loop");
        Wait.until("the title is there", () -> TITLE.equals(onWindow(frame::getTitle)));
        press("L");
        JList<?> list = find(JList.class, "Playlist");
        onWindow(() -> {
            Letters.assertSame(rowOf(list, NAME_AS_SEEN, 1), rowOf(list, null, 1));
            return null;
        });
        press("I");
        String start = "Source: ";
        Wait.until("the source is there", () -> information().getText().startsWith(start));
        onWindow(() -> {
            JTextArea text = information();
            int name = text.getText().indexOf(NAME);
            assertTrue(name > 0, text::getText);
            assertTrue(x(text, name) > x(text, name + 3), "from right to left");
            assertTrue(x(text, name) > x(text, name + 5), "the second word is to the left");
            assertTrue(x(text, 0) < x(text, start.length() - 2), "ours from left to right");
            return null;
        });
    }

    @Test
    void aRowTooNarrowForItLosesItsEndWhichIsAtTheLeft() throws Exception {
        openSource(titled("short.mp4", NAME), "--no-gpu", "--loop");
        awaitButton("Pause (Space)");
        press("L");
        JList<?> list = find(JList.class, "Playlist");
        onWindow(() -> {
            BufferedImage whole = rowOf(list, null, 1);
            BufferedImage cut = rowOf(list, null, 0.6);
            assertTrue(cut.getWidth() < whole.getWidth() * 3 / 4);
            int kept = cut.getWidth() / 2;
            Letters.assertSame(Letters.right(whole, kept), Letters.right(cut, kept));
            assertTrue(isEmpty(cut, 5, cut.getHeight() / 2), "only dots at the left");
            return null;
        });
    }

    @Test
    void aSentenceThatBeginsWithSuchANameIsStillRead() throws Exception {
        openSource(Media.path("silent.mkv"), "--no-gpu", folder.resolve("שלום!").toString());
        Wait.until("it is said", () -> notice() != null && notice().contains("cannot be played"));
        String said = notice().substring(0, notice().indexOf(':') + 1);
        onWindow(() -> {
            Letters.assertSame(
                    notice(Letters.AS_THEY_STAND + "“!םולש” cannot be played:"), notice(said));
            return null;
        });
    }

    @Test
    void anArtistStandsInTheirOrder() throws Exception {
        openSource(
                titled("tone.mp3", "tone.mp3", "artist=שלום abc עולם!"), "--no-gpu", "--loop");
        Wait.until("the artist is there", () -> artist() != null);
        JTextArea text = artist();
        onWindow(() -> {
            String words = text.getText();
            double[] places =
                    List.of("שלום", "abc", "עולם", "!").stream()
                            .mapToDouble(word -> x(text, words.indexOf(word)))
                            .toArray();
            double[] fromTheRight = places.clone();
            Arrays.sort(fromTheRight);
            for (int i = 0; i < places.length; i++) {
                assertEquals(fromTheRight[places.length - 1 - i], places[i], words);
            }
            return null;
        });
    }

    private JTextArea artist() throws Exception {
        JTextArea text = find(JTextArea.class, null);
        return text != null && text.getText().contains("abc") ? text : null;
    }

    private String titled(String media, String name, String... tags) throws Exception {
        String made = folder.resolve(name).toString();
        String[] start = {
            "ffmpeg", "-nostdin", "-v", "error", "-i", Media.path(media), "-c", "copy"
        };
        String[] command = Arrays.copyOf(start, start.length + 2 * tags.length + 1);
        for (int i = 0; i < tags.length; i++) {
            command[start.length + 2 * i] = "-metadata";
            command[start.length + 2 * i + 1] = tags[i];
        }
        command[command.length - 1] = made;
        Media.run(command);
        return made;
    }

    private JTextArea information() {
        return find(frame, JTextArea.class, "Information");
    }

    private static double x(JTextArea text, int place) {
        try {
            return text.modelToView2D(place).getX();
        } catch (BadLocationException e) {
            throw new AssertionError(e);
        }
    }

    /** The letters of the first row, or others in their place, with a part of the room it needs. */
    private static BufferedImage rowOf(JList<?> list, String seen, double part) {
        Object entry = list.getModel().getElementAt(0);
        var row = (DefaultListCellRenderer) rendererOf(list)
                .getListCellRendererComponent(list, entry, 0, false, false);
        if (seen != null) {
            row.setText(Letters.AS_THEY_STAND + seen);
        }
        Dimension size = row.getPreferredSize();
        row.setSize((int) (size.width * part), size.height);
        return Letters.inkOf(row);
    }

    @SuppressWarnings("unchecked")
    private static ListCellRenderer<Object> rendererOf(JList<?> list) {
        return (ListCellRenderer<Object>) list.getCellRenderer();
    }

    private static BufferedImage notice(String words) {
        NoticePane pane = new NoticePane();
        pane.setSize(700, 80);
        pane.tell(words);
        return Letters.inkOf(pane);
    }

    private static boolean isEmpty(BufferedImage image, int columns, int rows) {
        int ground = Theme.PANEL.getRGB();
        for (int x = 0; x < columns; x++) {
            for (int y = 0; y < rows; y++) {
                if (image.getRGB(x, y) != ground) {
                    return false;
                }
            }
        }
        return true;
    }
}
