// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import com.quintora.orv.player.Failure;
import com.quintora.orv.player.GpuUse;
import com.quintora.orv.player.Interruption;
import com.quintora.orv.player.PlayOptions;
import com.quintora.orv.player.playlist.Playlist;
import java.awt.AWTError;
import java.awt.EventQueue;
import java.awt.HeadlessException;
import java.lang.reflect.InvocationTargetException;
import java.util.concurrent.CompletableFuture;
import java.util.concurrent.ExecutionException;

/** Plays in a window until it is closed. */
public final class PlayerWindow {
    private PlayerWindow() {}

    /** Begins what any window needs, for one that is going to be opened; returns at once. */
    public static void begin() {
        Desktop.begin();
    }

    /**
     * Returns the exit status: 0, or 1 when the media could not be played.
     *
     * @throws Failure when there can be no window
     */
    public static int play(PlayOptions options) throws Failure, InterruptedException {
        Playlist list = options.playlist();
        PictureWay way = new PictureWay(options.gpuUse());
        Stage stage = makeStage(list.currentEntry().name(), way, options);
        Conductor conductor = new Conductor(stage, options, list);
        try (Interruption interruption = new Interruption(conductor::end, () -> {})) {
            CompletableFuture<Void> closed = new CompletableFuture<>();
            EventQueue.invokeLater(() -> open(stage, conductor, closed));
            conductor.begin();
            await(closed);
            if (options.reportsStats()) {
                System.out.println(conductor.playing().session().report());
                System.out.println(way.describe());
            }
            conductor.end();
            return conductor.failure() == null || interruption.happened() ? 0 : 1;
        } finally {
            conductor.end();
        }
    }

    /** Plays to the end in a window that is never shown, and draws it where nobody looks. */
    public static void rehearse(PlayOptions options) throws Failure, InterruptedException {
        Playlist list = options.playlist();
        PictureWay way = new PictureWay(GpuUse.NEVER);
        Stage stage = makeStage(list.currentEntry().name(), way, options);
        Conductor conductor = new Conductor(stage, options, list);
        try {
            EventQueue.invokeLater(() -> stage.build(conductor, () -> {}));
            conductor.begin();
            conductor.playing().session().ended().await();
            EventQueue.invokeAndWait(stage::drawUnseen);
            conductor.end();
            EventQueue.invokeAndWait(stage::close);
        } catch (InvocationTargetException e) {
            throw noWindow("(" + e.getCause() + ")", e.getCause());
        } finally {
            conductor.end();
        }
    }

    private static Stage makeStage(String title, PictureWay way, PlayOptions options)
            throws Failure {
        try {
            Desktop.await();
            Theme.scale(options.scale().orElseGet(ScaleFactor::ofDesktop));
            return new Stage(title, way);
        } catch (AWTError | HeadlessException e) {
            throw noWindow("on display " + System.getenv("DISPLAY"), e);
        }
    }

    // Whatever goes wrong ends the wait for the window to be closed.
    private static void open(Stage stage, Conductor conductor, CompletableFuture<Void> closed) {
        try {
            stage.open(conductor, () -> closed.complete(null));
        } catch (RuntimeException | Error e) {
            closed.completeExceptionally(e);
        }
    }

    private static void await(CompletableFuture<Void> closed)
            throws Failure, InterruptedException {
        try {
            closed.get();
        } catch (ExecutionException e) {
            throw noWindow("(" + e.getCause() + ")", e.getCause());
        }
    }

    private static Failure noWindow(String where, Throwable cause) {
        return new Failure(
                "cannot open a window " + where + "; --no-window plays in the terminal", cause);
    }
}
