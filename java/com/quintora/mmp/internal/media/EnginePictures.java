// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.media;

import android.graphics.Bitmap;
import com.quintora.mmp.ColorMode;
import com.quintora.mmp.Pictures;
import com.quintora.mmp.Thumbnail;
import com.quintora.mmp.internal.base.Arguments;
import com.quintora.mmp.internal.base.NativePlayer;
import com.quintora.mmp.internal.control.Background;
import com.quintora.mmp.internal.control.Commands;
import com.quintora.mmp.util.ThumbnailInfo;
import java.util.Optional;
import java.util.concurrent.CompletableFuture;

/** Still pictures of a player's media. */
public final class EnginePictures implements Pictures {
    private final NativePlayer natives;
    private final Commands commands;
    private final Background background;

    public EnginePictures(NativePlayer natives, Commands commands, Background background) {
        this.natives = natives;
        this.commands = commands;
        this.background = background;
    }

    @Override
    public CompletableFuture<Optional<Thumbnail>> thumbnail(
            int width, int height, ColorMode colorMode) {
        ThumbnailInfo request = request("thumbnail()", width, height, colorMode);
        return background.submitAlways("thumbnail()", () -> draw(request, colorMode));
    }

    @Override
    public Optional<Thumbnail> thumbnailAndWait(int width, int height, ColorMode colorMode) {
        return draw(request("thumbnailAndWait()", width, height, colorMode), colorMode);
    }

    @Override
    public Optional<byte[]> embedded() {
        return commands.ask("embedded()",
                () -> Optional.ofNullable(natives.getEmbeddedPicture(0)));
    }

    @Override
    public CompletableFuture<Optional<Bitmap>> frameAt(int millis) {
        return background.submitAlways("frameAt()", () -> frameAtAndWait(millis));
    }

    @Override
    public Optional<Bitmap> frameAtAndWait(int millis) {
        return commands.ask("frameAtAndWait()",
                () -> Optional.ofNullable(natives.getFrameAt(millis)));
    }

    private ThumbnailInfo request(String call, int width, int height, ColorMode colorMode) {
        commands.requireAlive(call);
        requireRange("width", width, MAX_THUMBNAIL_WIDTH);
        requireRange("height", height, MAX_THUMBNAIL_HEIGHT);
        int mode = Arguments.require(colorMode, "the pixels' format").number();
        return new ThumbnailInfo(mode, width, height);
    }

    private Optional<Thumbnail> draw(ThumbnailInfo request, ColorMode colorMode) {
        return commands.ask("thumbnail()",
                        () -> Optional.ofNullable(natives.getThumbnailInfo(request)))
                .map(bytes -> new Thumbnail(
                        request.mThumbnailWidth, request.mThumbnailHeight, colorMode, bytes));
    }

    private static void requireRange(String name, int value, int most) {
        if (value < 1 || value > most) {
            throw new IllegalArgumentException(
                    "a thumbnail's " + name + " must be 1 to " + most + ": " + value);
        }
    }
}
