// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.events;

import com.quintora.mmp.PlaybackInfo;

/** What was last reported of the media, to report nothing twice. Used under a lock. */
final class Reported {
    private int width;
    private int height;
    private int percent = -1;
    private int seeks;
    private boolean rendering;
    private boolean waiting;

    void beginSeek() {
        seeks++;
    }

    boolean isSeeking() {
        return seeks > 0;
    }

    boolean endsSeek() {
        boolean sought = seeks > 0;
        seeks -= sought ? 1 : 0;
        return sought;
    }

    boolean isNewSize(int newWidth, int newHeight) {
        boolean isNew = width != newWidth || height != newHeight;
        width = newWidth;
        height = newHeight;
        return isNew;
    }

    boolean isNewPercent(int newPercent) {
        boolean isNew = percent != newPercent;
        percent = newPercent;
        return isNew;
    }

    boolean isNewInfo(PlaybackInfo.Kind kind) {
        boolean isNew = switch (kind) {
            case RENDERING_STARTED -> !rendering;
            case BUFFERING_STARTED -> !waiting;
            case BUFFERING_ENDED -> waiting;
            case OTHER -> true;
        };
        rendering |= kind == PlaybackInfo.Kind.RENDERING_STARTED;
        waiting = kind == PlaybackInfo.Kind.BUFFERING_STARTED
                || waiting && kind != PlaybackInfo.Kind.BUFFERING_ENDED;
        return isNew;
    }
}
