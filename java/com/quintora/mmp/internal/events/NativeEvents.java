// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.events;

import com.quintora.mmp.PlaybackInfo;
import com.quintora.mmp.internal.state.StateMachine;
import java.io.IOException;
import org.jetbrains.annotations.Nullable;

/** The events that the native half sends, and their numbers. */
public final class NativeEvents {
    private static final int PREPARED = 1;
    private static final int PLAYBACK_COMPLETE = 2;
    private static final int BUFFERING_UPDATE = 3;
    private static final int SEEK_COMPLETE = 4;
    private static final int SET_VIDEO_SIZE = 5;
    private static final int TIMED_TEXT = 99;
    private static final int ERROR = 100;
    private static final int INFO = 200;

    private final StateMachine states;
    private final Events events;
    private final Watcher watcher;

    public NativeEvents(StateMachine states, Events events, Watcher watcher) {
        this.states = states;
        this.events = events;
        this.watcher = watcher;
    }

    /**
     * Takes an event. The thread is the native half's and is needed for the next event: nothing
     * happens on it but the hand-over.
     */
    public void receive(int what, int arg1, int arg2, byte @Nullable [] payload) {
        int epoch = states.epoch();
        watcher.execute(() -> merge(epoch, what, arg1, arg2, payload));
    }

    private void merge(int epoch, int what, int arg1, int arg2, byte @Nullable [] payload) {
        switch (what) {
            case PREPARED -> prepared(epoch);
            case PLAYBACK_COMPLETE -> events.completed(epoch);
            case BUFFERING_UPDATE -> events.buffering(epoch, arg1);
            case SEEK_COMPLETE -> events.seekEnds(epoch, true);
            case SET_VIDEO_SIZE -> events.videoSize(epoch, arg1, arg2);
            case TIMED_TEXT -> events.timedText(epoch, payload);
            case ERROR -> events.failed(epoch, error(arg1, arg2));
            case INFO -> events.info(epoch, PlaybackInfo.of(arg1, arg2));
            default -> System.getLogger(NativeEvents.class.getName())
                    .log(System.Logger.Level.DEBUG, "unknown native event {0}", what);
        }
    }

    private void prepared(int epoch) {
        if (events.prepared(epoch)) {
            watcher.wake();
        }
    }

    private static IOException error(int what, int status) {
        return new IOException(
                String.format("the engine reported error %d: status=0x%X", what, status));
    }
}
