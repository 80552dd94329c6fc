// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import com.quintora.mmp.ColorMode;
import com.quintora.mmp.OrvMediaPlayer;
import com.quintora.mmp.PlayerRole;
import com.quintora.mmp.Track;
import java.awt.image.BufferedImage;
import java.io.IOException;
import java.util.LinkedHashMap;
import java.util.Map;
import java.util.Optional;
import java.util.concurrent.TimeUnit;
import java.util.concurrent.locks.Condition;
import java.util.concurrent.locks.ReentrantLock;
import java.util.function.BiConsumer;

/**
 * Small pictures of a media file while it plays: of the key frames near the asked times. A second
 * player makes them, which is there while pictures are asked for and a little longer. Only the
 * newest wish counts. Thread-safe; nothing blocks.
 */
public final class Previews implements AutoCloseable {
    private static final int ROWS = 108;
    private static final int MOST_COLUMNS = 256;

    // Some seven megabytes at most; of larger ones there are fewer.
    private static final int MOST_KEPT = 64;

    // Of the whole length; a bar has not many more pixels.
    private static final int PARTS = 400;
    private static final int NOTHING = -1;
    private static final int IDLE_SECONDS = 20;

    private final String source;
    private final int durationMs;
    private final Size size;
    private final int mostKept;
    private final BiConsumer<Integer, BufferedImage> onPicture;
    private final ReentrantLock lock = new ReentrantLock();
    private final Condition wished = lock.newCondition();

    // All under the lock.
    private final Map<Integer, BufferedImage> kept =
            new LinkedHashMap<>(16, 0.75f, true) {
                @Override
                protected boolean removeEldestEntry(Map.Entry<Integer, BufferedImage> eldest) {
                    return size() > mostKept;
                }
            };
    private int wish = NOTHING;
    private OrvMediaPlayer player;
    private boolean hasThread;
    private boolean cannot;
    private boolean closed;

    /** Calls back, on a thread of its own, with a picture and the number of its part. */
    Previews(
            String source,
            int durationMs,
            Size video,
            double scale,
            BiConsumer<Integer, BufferedImage> onPicture) {
        this.source = source;
        this.durationMs = durationMs;
        this.onPicture = onPicture;
        int rows = (int) Math.round(ROWS * scale);
        int mostColumns = (int) Math.round(MOST_COLUMNS * scale);
        mostKept = (int) (MOST_KEPT / (scale * scale));
        int columns = video.withHeight(rows).width();
        size = columns <= mostColumns
                ? new Size(columns, rows)
                : new Size(mostColumns, Math.max(1, rows * mostColumns / columns));
    }

    /** Of which part of the media that time is; pictures are made of parts. */
    public int partOf(int millis) {
        return (int) Math.max(0, Math.min(PARTS - 1, (long) millis * PARTS / durationMs));
    }

    /** The columns of the pictures. */
    public int width() {
        return size.width();
    }

    public int height() {
        return size.height();
    }

    /** The picture of a part, if it is there; otherwise it is made, unless another is wished. */
    public Optional<BufferedImage> get(int part) {
        lock.lock();
        try {
            BufferedImage there = kept.get(part);
            wish = there == null && !cannot && !closed ? part : NOTHING;
            if (wish != NOTHING) {
                wished.signal();
                begin();
            }
            return Optional.ofNullable(there);
        } finally {
            lock.unlock();
        }
    }

    /** What is not made yet is wished no more. */
    public void forget() {
        lock.lock();
        wish = NOTHING;
        lock.unlock();
    }

    private void begin() {
        if (!hasThread) {
            hasThread = true;
            Thread thread = new Thread(this::run, "previews");
            thread.setDaemon(true);
            thread.setPriority(Thread.MIN_PRIORITY);
            thread.start();
        }
    }

    private void run() {
        OrvMediaPlayer maker = NativeHalf.newPlayer();
        try {
            open(maker);
            for (int part = await(); part != NOTHING; part = await()) {
                draw(maker, part);
            }
        } catch (IOException | RuntimeException e) {
            giveUp(); // The media plays all the same, without pictures above the bar.
        } catch (InterruptedException e) {
            Thread.currentThread().interrupt();
        } finally {
            end(maker);
        }
    }

    private void open(OrvMediaPlayer maker) throws IOException {
        if (!take(maker)) {
            return;
        }
        maker.setDataSource(source);
        maker.engine().setRole(PlayerRole.BACKGROUND);
        maker.prepareAndWait();
        maker.tracks().selectNoneAndWait(Track.Kind.AUDIO);
    }

    private boolean take(OrvMediaPlayer maker) {
        lock.lock();
        try {
            player = maker;
            return !closed;
        } finally {
            lock.unlock();
        }
    }

    /** Gives what is wished, or nothing when that was so for a while. */
    private int await() throws InterruptedException {
        long left = TimeUnit.SECONDS.toNanos(IDLE_SECONDS);
        lock.lock();
        try {
            while (wish == NOTHING && !closed && left > 0) {
                left = wished.awaitNanos(left);
            }
            int taken = closed ? NOTHING : wish;
            wish = NOTHING;
            hasThread = taken != NOTHING;
            return taken;
        } finally {
            lock.unlock();
        }
    }

    private void draw(OrvMediaPlayer maker, int part) {
        // The middle of the part.
        maker.seekToAndWait((int) ((2L * part + 1) * durationMs / (2 * PARTS)));
        Optional<BufferedImage> picture =
                maker.pictures()
                        .thumbnailAndWait(size.width(), size.height(), ColorMode.XRGB8888)
                        .map(ThumbnailImage::of);
        picture.ifPresent(
                image -> {
                    lock.lock();
                    kept.put(part, image);
                    lock.unlock();
                    onPicture.accept(part, image);
                });
    }

    private void giveUp() {
        lock.lock();
        cannot = true;
        lock.unlock();
    }

    // There may be another one by now.
    private void end(OrvMediaPlayer maker) {
        lock.lock();
        try {
            player = player == maker ? null : player;
        } finally {
            lock.unlock();
        }
        maker.close();
    }

    /** Ends what is under way; does not block. */
    @Override
    public void close() {
        OrvMediaPlayer ended;
        lock.lock();
        try {
            closed = true;
            kept.clear();
            wished.signal();
            ended = player;
        } finally {
            lock.unlock();
        }
        if (ended != null) {
            ended.release();
        }
    }
}
