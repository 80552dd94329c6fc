// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import com.quintora.mmp.desktop.DesktopSurfaceView;
import com.quintora.orv.player.GpuUse;
import java.io.IOException;
import java.nio.file.DirectoryStream;
import java.nio.file.Files;
import java.nio.file.Path;
import java.util.List;

/** Whether the graphics processor draws the pictures, and why not. */
final class PictureWay {
    private static final List<Path> DEVICES = List.of(Path.of("/dev/nvidiactl"), Path.of("/dev/dxg"));
    private static final Path RENDERERS = Path.of("/dev/dri");

    private final GpuUse use;
    private final boolean isTried;
    private volatile DesktopSurfaceView view;

    PictureWay(GpuUse use) {
        this.use = use;
        isTried = use == GpuUse.ALWAYS || (use == GpuUse.USUAL && hasDevice());
    }

    /** Whether the graphics processor is to be tried at all. */
    boolean isTried() {
        return isTried;
    }

    /** A view for it to be tried on. */
    DesktopSurfaceView makeView() {
        view = new DesktopSurfaceView(use == GpuUse.ALWAYS);
        return view;
    }

    /** For --stats. */
    String describe() {
        if (view != null && view.isDrawnByGpu()) {
            return "pictures drawn by the graphics processor: " + view.describeDrawing();
        }
        return "pictures drawn by software: " + whyNot();
    }

    private String whyNot() {
        if (use == GpuUse.NEVER) {
            return "--no-gpu";
        }
        String reason = view == null ? "" : view.describeDrawing();
        return reason.isEmpty() ? "there is no graphics processor" : reason;
    }

    // Asking OpenGL takes longer.
    private static boolean hasDevice() {
        if (DEVICES.stream().anyMatch(Files::exists)) {
            return true;
        }
        try (DirectoryStream<Path> found = Files.newDirectoryStream(RENDERERS, "renderD*")) {
            return found.iterator().hasNext();
        } catch (IOException e) {
            return false;
        }
    }
}
