// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.testing;

import com.quintora.mmp.Media;
import com.quintora.mmp.MediaException;
import com.quintora.mmp.MediaPlayer;
import com.quintora.mmp.OrvMediaPlayer;
import com.quintora.mmp.PlaybackInfo;
import com.quintora.mmp.PlayerListener;
import com.quintora.mmp.Wait;
import java.time.Duration;
import java.util.List;
import java.util.concurrent.Callable;
import java.util.concurrent.CopyOnWriteArrayList;
import java.util.concurrent.ExecutionException;
import java.util.concurrent.Future;
import java.util.concurrent.TimeUnit;

/** A player under comparison, and a transcript of what it answered and reported. */
final class Subject implements PlayerListener, AutoCloseable {
    private static final Duration TICK = Duration.ofMillis(50);

    final MediaPlayer player;
    final String path;
    final List<String> answers = new CopyOnWriteArrayList<>();
    final List<String> events = new CopyOnWriteArrayList<>();

    private Subject(MediaPlayer player, String path) {
        this.player = player;
        this.path = path;
        player.addListener(this);
    }

    static Subject real(String media) throws Exception {
        return new Subject(new OrvMediaPlayer(), Media.path(media));
    }

    /** A fake with the tables that the real player has of the media. */
    static Subject fake(String media) throws Exception {
        FakeMediaBuilder like = FakeMedia.builder();
        try (MediaPlayer player = new OrvMediaPlayer()) {
            player.setDataSource(Media.path(media));
            player.prepareAndWait();
            like.duration(player.duration().orElseThrow());
            like.metadata(player.tracks().metadata().orElseThrow());
            player.tracks().video().forEach(like::video);
            player.tracks().audio().forEach(like::audio);
            player.tracks().subtitles().forEach(like::subtitle);
            player.tracks().chapters().forEach(
                    mark -> like.chapter(mark.start(), mark.end().orElseThrow(), mark.title()));
        }
        return new Subject(new FakeMediaPlayer(like.build()), Media.path(media));
    }

    FakeControl control() {
        return ((FakeMediaPlayer) player).control();
    }

    boolean isFake() {
        return player instanceof FakeMediaPlayer;
    }

    /** Writes down what a call answers, and the state that it leaves. */
    void call(String name, Callable<?> call) {
        String answer;
        try {
            answer = String.valueOf(result(call.call()));
        } catch (ExecutionException e) {
            answer = "future: " + failure(e.getCause());
        } catch (Exception e) {
            answer = failure(e);
        }
        answers.add(name + ": " + answer + " [" + player.getState() + "]");
    }

    void run(String name, Action action) {
        call(name, () -> {
            action.run();
            return "done";
        });
    }

    /** A call that may throw. */
    interface Action {
        void run() throws Exception;
    }

    /** Lets time pass until there is such an event, after those that were already there. */
    void playUntil(String event) throws Exception {
        int before = (int) count(event);
        waitUntil(event + " after " + events, () -> count(event) > before);
    }

    void waitUntil(String what, Callable<Boolean> condition) throws Exception {
        Wait.until(what, () -> {
            boolean holds = condition.call();
            if (!holds && isFake()) {
                control().advance(TICK);
            }
            return holds;
        });
    }

    private long count(String event) {
        return events.stream().filter(event::equals).count();
    }

    private static Object result(Object value) throws Exception {
        return value instanceof Future<?> future
                ? "future: " + future.get(Wait.LIMIT.toSeconds(), TimeUnit.SECONDS)
                : value;
    }

    private static String failure(Throwable thrown) {
        return thrown.getClass().getSimpleName() + ": " + thrown.getMessage();
    }

    @Override
    public void onPrepared(MediaPlayer of) {
        events.add("prepared");
    }

    @Override
    public void onCompletion(MediaPlayer of) {
        events.add("completion");
    }

    @Override
    public void onSeekComplete(MediaPlayer of) {
        events.add("seek");
    }

    @Override
    public void onVideoSizeChanged(MediaPlayer of, int width, int height) {
        events.add("size " + width + "x" + height);
    }

    @Override
    public void onError(MediaPlayer of, MediaException error) {
        events.add("error " + error.error() + ": " + error.getMessage());
    }

    @Override
    public void onInfo(MediaPlayer of, PlaybackInfo info) {
        if (info.kind() == PlaybackInfo.Kind.RENDERING_STARTED) {
            events.add("rendering"); // When data are waited for is a matter of the machine.
        }
    }

    @Override
    public void close() {
        player.close();
    }
}
