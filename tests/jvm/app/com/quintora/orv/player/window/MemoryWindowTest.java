// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertFalse;
import static org.junit.jupiter.api.Assertions.assertTrue;

import com.quintora.mmp.Media;
import com.quintora.mmp.Wait;
import com.quintora.orv.player.memory.Memory;
import java.awt.Rectangle;
import java.nio.file.Files;
import java.nio.file.Path;
import javax.swing.JMenuItem;
import javax.swing.MenuElement;
import javax.swing.MenuSelectionManager;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.api.io.TempDir;

/** What a window finds again. */
class MemoryWindowTest extends WindowFixture {
    @TempDir Path folder;

    @Override
    boolean remembers() {
        return true;
    }

    @Override
    String[] usualOptions() {
        return new String[] {"--memory", file().toString()};
    }

    private Path file() {
        return folder.resolve("player.conf");
    }

    @Test
    void mediaGoOnWhereTheyWereLeft() throws Exception {
        open("long.mkv", "--start", "20");
        awaitSecond(20, 25);
        closeIt();
        open("long.mkv");
        Wait.until("it is offered", () -> notice() != null && notice().startsWith("Left at 0:2"));
        press("ENTER");
        awaitSecond(20, 30);
    }

    @Test
    void aPlaceThatIsAskedForGoesFirst() throws Exception {
        open("long.mkv", "--start", "20");
        awaitSecond(20, 25);
        closeIt();
        open("long.mkv", "--start", "40");
        awaitSecond(40, 45);
        press("ENTER");
        Wait.until("it is said", () -> "It was not left anywhere before".equals(notice()));
    }

    @Test
    void volumeSizeAndPlaceAreThoseOfBefore() throws Exception {
        open("long.mkv");
        awaitPicture();
        press("DOWN");
        press("DOWN");
        Rectangle place = new Rectangle(60, 50, 700, 420);
        onWindow(() -> {
            frame.setBounds(place);
            return null;
        });
        Wait.until("it is there", () -> place.equals(onWindow(frame::getBounds)));
        closeIt();
        assertEquals("90", Memory.in(file()).read().get("volume"));
        open("long.mkv");
        awaitPicture();
        assertEquals(place, onWindow(frame::getBounds));
        var volume = find(LevelBar.class, "Volume").getAccessibleContext().getAccessibleValue();
        Wait.until(
                "the volume is that of before",
                () -> onWindow(() -> volume.getCurrentAccessibleValue().intValue() == 90));
    }

    @Test
    void aPlaceOnNoScreenIsForgotten() throws Exception {
        Memory.in(file()).update(values -> values.put("window", "9000 9000 400x300"));
        open("long.mkv");
        awaitPicture();
        assertTrue(onWindow(frame::getX) < 5_000);
    }

    @Test
    void recentFilesAreInAMenu() throws Exception {
        open("silent.mkv", Media.path("long.mkv"));
        awaitPicture();
        press("N");
        Wait.until("the next", () -> "silent.mkv".equals(onWindow(frame::getTitle)));
        awaitPicture();
        press("shift O");
        Wait.until("the menu is open", () -> onWindow(ChoiceMenu::isOpen));
        MenuElement[] path =
                onWindow(() -> MenuSelectionManager.defaultManager().getSelectedPath());
        JMenuItem item = (JMenuItem) path[1];
        assertEquals("long.mkv", item.getText());
        onWindow(() -> {
            item.doClick(0);
            return null;
        });
        Wait.until("it plays", () -> "long.mkv".equals(onWindow(frame::getTitle)));
    }

    @Test
    void aFileThatCannotBeWrittenEndsNothing() throws Exception {
        Files.createDirectories(file());
        open("long.mkv");
        awaitPicture();
        closeIt();
        assertEquals(0, playing.get());
        assertFalse(Files.isRegularFile(file()));
    }

    private void closeIt() throws Exception {
        closeWindow();
    }
}
