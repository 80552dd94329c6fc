// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import com.quintora.orv.player.subtitles.SubtitleLook;
import java.util.Locale;
import java.util.function.UnaryOperator;

/** How the window's subtitles look: what controls change, and what each media takes. */
final class SubtitleTuning {
    private final Runnable onChange;
    private Runnable watcher = () -> {};
    private volatile SubtitleLook look;

    /** Begins with what is remembered; each change is for the media to take. */
    SubtitleTuning(SubtitleLook remembered, Runnable onChange) {
        look = remembered;
        this.onChange = onChange;
    }

    /** Any thread. */
    SubtitleLook look() {
        return look;
    }

    /** Takes what is called after each change, on the window's thread. */
    void watch(Runnable watcher) {
        this.watcher = watcher;
    }

    void change(UnaryOperator<SubtitleLook> change) {
        set(change.apply(look));
        onChange.run();
    }

    /** By milliseconds, negative for earlier. */
    void shift(int byMillis) {
        change(now -> now.withDelay(now.delayMs() + byMillis));
    }

    /** Other media begins: how late subtitles are is of one media alone. */
    void beginMedia() {
        set(look.withDelay(0));
    }

    private void set(SubtitleLook changed) {
        look = changed;
        watcher.run();
    }

    /** As the user reads it. */
    static String delay(int millis) {
        return String.format(Locale.ROOT, "%+.1f s", millis / 1000.0);
    }
}
