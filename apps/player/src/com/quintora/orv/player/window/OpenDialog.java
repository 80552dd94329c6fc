// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import java.awt.Component;
import java.awt.Dimension;
import java.io.File;
import java.util.Arrays;
import java.util.List;
import javax.swing.JFileChooser;
import javax.swing.JOptionPane;

/** Asks what to play. */
final class OpenDialog {
    // What Java gives it at least.
    private static final int WIDTH = 500;
    private static final int HEIGHT = 326;

    // Where the last one was, for as long as the program runs.
    private static File folder;

    private final Component above;
    private final Controls controls;

    OpenDialog(Component above, Controls controls) {
        this.above = above;
        this.controls = controls;
    }

    /** Asks for files, folders of media or playlists. */
    void chooseFiles() {
        JFileChooser chooser = newChooser();
        chooser.setDialogTitle("Open files, folders or playlists");
        chooser.setFileSelectionMode(JFileChooser.FILES_AND_DIRECTORIES);
        chooser.setMultiSelectionEnabled(true);
        chooser.setApproveButtonText("Play");
        if (chooser.showOpenDialog(above) == JFileChooser.APPROVE_OPTION) {
            folder = chooser.getCurrentDirectory();
            controls.open(
                    Arrays.stream(chooser.getSelectedFiles()).map(File::getPath).toList());
        }
    }

    // Its least size is in pixels, which do not grow with its letters.
    private static JFileChooser newChooser() {
        JFileChooser chooser = new JFileChooser(folder);
        Dimension wanted = chooser.getPreferredSize();
        Dimension least = Theme.size(WIDTH, HEIGHT);
        chooser.setPreferredSize(
                new Dimension(
                        Math.max(wanted.width, least.width),
                        Math.max(wanted.height, least.height)));
        return chooser;
    }

    /** Asks for a file of subtitles for what plays. */
    void chooseSubtitles() {
        JFileChooser chooser = newChooser();
        chooser.setDialogTitle("Add a subtitle file");
        chooser.setApproveButtonText("Add");
        if (chooser.showOpenDialog(above) == JFileChooser.APPROVE_OPTION) {
            folder = chooser.getCurrentDirectory();
            controls.addSubtitles(chooser.getSelectedFile().getPath());
        }
    }

    /** Asks for a URL. */
    void chooseAddress() {
        String address =
                JOptionPane.showInputDialog(
                        above, "Address of a media file, stream or playlist:", "Open an address",
                        JOptionPane.PLAIN_MESSAGE);
        if (address != null && !address.isBlank()) {
            controls.open(List.of(address.strip()));
        }
    }
}
