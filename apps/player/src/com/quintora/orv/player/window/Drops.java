// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import com.quintora.orv.player.playlist.Entry;
import java.awt.datatransfer.DataFlavor;
import java.awt.datatransfer.Transferable;
import java.awt.datatransfer.UnsupportedFlavorException;
import java.io.File;
import java.io.IOException;
import java.nio.file.Files;
import java.nio.file.InvalidPathException;
import java.nio.file.Path;
import java.util.List;
import java.util.function.Consumer;
import javax.swing.JComponent;
import javax.swing.TransferHandler;

/** What is dropped on the window is played; what is dropped on the playlist is added to it. */
final class Drops {
    private final Controls controls;

    Drops(Controls controls) {
        this.controls = controls;
    }

    void playOn(JComponent window) {
        window.setTransferHandler(new Target(controls::open));
    }

    void addOn(ListPanel list) {
        list.takeDrops(new Target(controls::add));
    }

    /** Paths and URLs of what is dropped; empty when it is neither. */
    static List<String> sources(Transferable dropped) throws IOException {
        try {
            if (dropped.isDataFlavorSupported(DataFlavor.javaFileListFlavor)) {
                List<?> files =
                        (List<?>) dropped.getTransferData(DataFlavor.javaFileListFlavor);
                return files.stream().map(file -> ((File) file).getPath()).toList();
            }
            String text = (String) dropped.getTransferData(DataFlavor.stringFlavor);
            return text.lines().map(String::strip).filter(Drops::isPlayable).toList();
        } catch (UnsupportedFlavorException e) {
            throw new IOException(e);
        }
    }

    private static boolean isPlayable(String line) {
        try {
            return Entry.isUrl(line) || !line.isEmpty() && Files.exists(Path.of(line));
        } catch (InvalidPathException e) {
            return false;
        }
    }

    private final class Target extends TransferHandler {
        private final Consumer<List<String>> use;

        Target(Consumer<List<String>> use) {
            this.use = use;
        }

        @Override
        public boolean canImport(TransferSupport drop) {
            return drop.isDataFlavorSupported(DataFlavor.javaFileListFlavor)
                    || drop.isDataFlavorSupported(DataFlavor.stringFlavor);
        }

        @Override
        public boolean importData(TransferSupport drop) {
            try {
                List<String> sources = sources(drop.getTransferable());
                if (sources.isEmpty()) {
                    controls.tell("What was dropped is neither a file nor an address");
                } else {
                    use.accept(sources);
                }
                return !sources.isEmpty();
            } catch (IOException e) {
                controls.tell("What was dropped cannot be read: " + e.getMessage());
                return false;
            }
        }
    }
}
