// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.testing;

import static com.quintora.mmp.testing.FakeState.requireValue;

import android.graphics.Bitmap;
import com.quintora.mmp.ColorMode;
import com.quintora.mmp.Pictures;
import com.quintora.mmp.Thumbnail;
import java.time.Duration;
import java.util.Optional;
import java.util.concurrent.CompletableFuture;

/** Still pictures as the media's painter draws them. */
final class FakePictures implements Pictures {
    private final FakeSession session;

    FakePictures(FakeSession session) {
        this.session = session;
    }

    @Override
    public CompletableFuture<Optional<Thumbnail>> thumbnail(
            int width, int height, ColorMode colorMode) {
        return CompletableFuture.completedFuture(draw("thumbnail()", width, height, colorMode));
    }

    @Override
    public Optional<Thumbnail> thumbnailAndWait(int width, int height, ColorMode colorMode) {
        return draw("thumbnailAndWait()", width, height, colorMode);
    }

    @Override
    public Optional<byte[]> embedded() {
        return session.guard.ask(() -> {
            session.state.requireAlive("embedded()");
            return Optional.ofNullable(session.opened()).map(FakeMedia::cover);
        });
    }

    @Override
    public CompletableFuture<Optional<Bitmap>> frameAt(int millis) {
        return CompletableFuture.completedFuture(noFrame("frameAt()"));
    }

    @Override
    public Optional<Bitmap> frameAtAndWait(int millis) {
        return noFrame("frameAtAndWait()");
    }

    /** As where the native half cannot grab frames. */
    private Optional<Bitmap> noFrame(String call) {
        return session.guard.ask(() -> {
            session.state.requireAlive(call);
            return Optional.empty();
        });
    }

    private Optional<Thumbnail> draw(String call, int width, int height, ColorMode colorMode) {
        return session.guard.ask(() -> {
            session.state.requireAlive(call);
            requireRange("width", width, MAX_THUMBNAIL_WIDTH);
            requireRange("height", height, MAX_THUMBNAIL_HEIGHT);
            requireValue(colorMode, "the pixels' format");
            Duration position = Duration.ofMillis((long) session.head.position());
            return Optional.ofNullable(session.opened())
                    .flatMap(media -> media.painter().paint(position, width, height, colorMode));
        });
    }

    private static void requireRange(String name, int value, int most) {
        if (value < 1 || value > most) {
            throw new IllegalArgumentException(
                    "a thumbnail's " + name + " must be 1 to " + most + ": " + value);
        }
    }
}
