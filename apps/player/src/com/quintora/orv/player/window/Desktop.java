// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import java.awt.Font;
import java.awt.Graphics2D;
import java.awt.Toolkit;
import java.awt.image.BufferedImage;
import java.util.List;
import java.util.concurrent.CompletableFuture;
import java.util.concurrent.CompletionException;
import javax.swing.UIManager;

/**
 * Java's own half of a window: the connection to the display, the fonts and Swing's settings, which
 * take as long as opening the media. One thread alone readies them, as they do not all bear two.
 */
final class Desktop {
    private static volatile CompletableFuture<Void> ready;

    private Desktop() {}

    /** Begins to ready it; returns at once. */
    static void begin() {
        CompletableFuture<Void> done = new CompletableFuture<>();
        Thread thread = new Thread(() -> ready(done), "desktop");
        thread.setDaemon(true);
        ready = done;
        thread.start();
    }

    /**
     * Returns when it is ready. Nothing else may use the display before.
     *
     * @throws java.awt.AWTError when there is no such display
     * @throws java.awt.HeadlessException when there can be none
     */
    static void await() {
        if (ready == null) {
            begin();
        }
        try {
            ready.join();
        } catch (CompletionException e) {
            if (e.getCause() instanceof Error problem) {
                throw problem;
            }
            throw e.getCause() instanceof RuntimeException problem ? problem : e;
        }
    }

    private static void ready(CompletableFuture<Void> done) {
        try {
            Toolkit.getDefaultToolkit().getScreenSize();
            loadFonts();
            Theme.dressDialogs();
            UIManager.getLookAndFeel();
            done.complete(null);
        } catch (RuntimeException | Error e) {
            done.completeExceptionally(e);
        }
    }

    // Found with the first text that is drawn.
    private static void loadFonts() {
        var image = new BufferedImage(Theme.button(), Theme.button(), BufferedImage.TYPE_INT_RGB);
        Graphics2D g = Theme.smooth(image.getGraphics());
        for (Font font : List.of(Theme.body(), Theme.small(), Theme.title())) {
            g.setFont(font);
            g.drawString("0:00", 0, Theme.button());
        }
        g.dispose();
    }
}
