// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertTrue;

import com.quintora.mmp.Media;
import com.quintora.mmp.Wait;
import java.awt.datatransfer.DataFlavor;
import java.awt.datatransfer.StringSelection;
import java.awt.datatransfer.Transferable;
import java.io.File;
import java.nio.file.Files;
import java.nio.file.Path;
import java.util.List;
import javax.swing.JComponent;
import javax.swing.JList;
import javax.swing.TransferHandler;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.api.io.TempDir;

/** Several media in one window. */
class PlaylistWindowTest extends WindowFixture {
    @TempDir Path folder;

    @Test
    void keysGoFromOneToTheOther() throws Exception {
        open("long.mkv", Media.path("silent.mkv"));
        awaitTitle("silent.mkv");
        press("N");
        awaitTitle("long.mkv");
        awaitPicture();
        press("N");
        Wait.until("it is said", () -> "This is the last one".equals(notice()));
        press("P");
        awaitTitle("silent.mkv");
        awaitPicture();
    }

    @Test
    void theNextOneFollowsTheEnd() throws Exception {
        open("long.mkv", Media.path("short.mp4"));
        awaitTitle("long.mkv");
        awaitPicture();
    }

    @Test
    void whatCannotBePlayedIsSkippedWithASentence() throws Exception {
        open("long.mkv", folder.resolve("none.mkv").toString());
        awaitTitle("long.mkv");
        awaitPicture();
        assertTrue(notice().startsWith("“none.mkv” cannot be played: "), notice());
        press("Q");
        assertEquals(1, playing.get());
    }

    @Test
    void afterADeadListAnotherFileIsPlayed() throws Exception {
        openSource(folder.resolve("b.mkv").toString(), folder.resolve("a.mkv").toString());
        awaitButton("Open other files (O)");
        Wait.until("it says so", () -> button("Open other files (O)").isShowing());
        drop(frame.getRootPane(), List.of(new File(Media.path("long.mkv"))));
        awaitTitle("long.mkv");
        awaitPicture();
        Wait.until("the controls work again", () -> button("Pause (Space)") != null);
    }

    @Test
    void theKeyboardPlaysAndTakesOutOfTheList() throws Exception {
        open("long.mkv", Media.path("silent.mkv"));
        press("L");
        JList<?> list = find(JList.class, null);
        press("DOWN");
        press("ENTER");
        awaitTitle("long.mkv");
        press("DELETE");
        awaitTitle("silent.mkv");
        Wait.until("one is left", () -> onWindow(() -> list.getModel().getSize()) == 1);
        press("ESCAPE");
        Wait.until("it is closed", () -> find(JList.class, null) == null);
    }

    @Test
    void aDropOnTheListIsAddedToIt() throws Exception {
        open("long.mkv");
        press("L");
        JList<?> list = find(JList.class, null);
        drop(list, List.of(new File(Media.path("short.mp4"))));
        Wait.until("there are two", () -> onWindow(() -> list.getModel().getSize()) == 2);
        awaitTitle("long.mkv");
    }

    @Test
    void aDropOfTextIsOneSentence() throws Exception {
        open("long.mkv");
        awaitPicture();
        drop(frame.getRootPane(), new StringSelection("some words\nof a page"));
        assertEquals("What was dropped is neither a file nor an address", notice());
    }

    @Test
    void aDropOfAFolderWithoutMediaIsOneSentence() throws Exception {
        open("long.mkv");
        awaitPicture();
        Files.writeString(folder.resolve("notes.txt"), "");
        drop(frame.getRootPane(), List.of(folder.toFile()));
        Wait.until("it is said", () -> ("'" + folder + "' has no media files").equals(notice()));
        awaitTitle("long.mkv");
    }

    @Test
    void oneIsRepeatedUntilAKeyEndsIt() throws Exception {
        open("long.mkv", Media.path("short.mp4"));
        press("R");
        Wait.until("it is said", () -> "Repeat this one".equals(notice()));
        awaitSecond(2, 3);
        awaitSecond(0, 1);
        awaitTitle("short.mp4");
        press("R");
        press("R");
        awaitTitle("long.mkv");
    }

    private void awaitTitle(String title) throws Exception {
        Wait.until("the title is " + title, () -> title.equals(onWindow(frame::getTitle)));
    }

    private static void drop(JComponent on, List<File> files) throws Exception {
        drop(on, new FileSelection(files));
    }

    private static void drop(JComponent on, Transferable what) throws Exception {
        onWindow(() -> on.getTransferHandler()
                .importData(new TransferHandler.TransferSupport(on, what)));
    }

    private record FileSelection(List<File> files) implements Transferable {
        @Override
        public DataFlavor[] getTransferDataFlavors() {
            return new DataFlavor[] {DataFlavor.javaFileListFlavor};
        }

        @Override
        public boolean isDataFlavorSupported(DataFlavor flavor) {
            return DataFlavor.javaFileListFlavor.equals(flavor);
        }

        @Override
        public Object getTransferData(DataFlavor flavor) {
            return files;
        }
    }
}
