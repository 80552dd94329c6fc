// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import java.util.ArrayList;
import java.util.List;
import java.util.concurrent.CopyOnWriteArrayList;

/** Writes down what a player reports. */
class Recorder implements PlayerListener {
    final List<String> reported = new CopyOnWriteArrayList<>();
    final List<Thread> threads = new CopyOnWriteArrayList<>();
    volatile MediaException error;

    @Override
    public void onPrepared(MediaPlayer player) {
        note("prepared");
    }

    @Override
    public void onCompletion(MediaPlayer player) {
        note("completion");
    }

    @Override
    public void onSeekComplete(MediaPlayer player) {
        note("seek");
    }

    @Override
    public void onVideoSizeChanged(MediaPlayer player, int width, int height) {
        note("size " + width + "x" + height);
    }

    @Override
    public void onBufferingUpdate(MediaPlayer player, int percent) {
        note("buffering " + percent);
    }

    @Override
    public void onError(MediaPlayer player, MediaException failure) {
        error = failure;
        note("error");
    }

    @Override
    public void onInfo(MediaPlayer player, PlaybackInfo info) {
        note("info " + info.what() + " " + info.extra());
    }

    @Override
    public void onTimedText(MediaPlayer player, byte[] payload) {
        note("text " + (payload == null ? "null" : new String(payload)));
    }

    void await(String what) throws Exception {
        Wait.until(what + " was reported; it was " + reported, () -> reported.contains(what));
    }

    long count(String what) {
        return reported.stream().filter(what::equals).count();
    }

    /** What was reported, without the amounts of buffered media, which vary. */
    List<String> withoutBuffering() {
        List<String> rest = new ArrayList<>(reported);
        rest.removeIf(what -> what.startsWith("buffering"));
        return rest;
    }

    private void note(String what) {
        threads.add(Thread.currentThread());
        reported.add(what);
    }
}
