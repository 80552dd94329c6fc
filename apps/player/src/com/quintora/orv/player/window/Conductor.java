// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import com.quintora.mmp.MediaException;
import com.quintora.mmp.OrvMediaPlayer;
import com.quintora.mmp.PlayerListener;
import com.quintora.mmp.PlayerState;
import com.quintora.orv.player.Failure;
import com.quintora.orv.player.PlayOptions;
import com.quintora.orv.player.Session;
import com.quintora.orv.player.Snapshot;
import java.awt.Component;
import java.awt.EventQueue;
import java.util.ArrayList;
import java.util.List;
import java.util.concurrent.Executors;
import java.util.concurrent.RejectedExecutionException;
import java.util.concurrent.ScheduledExecutorService;
import java.util.concurrent.TimeUnit;
import java.util.concurrent.atomic.AtomicInteger;

/**
 * Carries out what the window's controls ask, on a thread of its own, because the player's calls
 * may take their time; and tells the window how things stand.
 */
final class Conductor implements Controls {
    private static final int POLL_MS = 80;
    private static final int NO_SEEK = -1;

    /** A call of the player's. */
    interface Command {
        void run() throws Failure;
    }

    private final Session session;
    private final OrvMediaPlayer player;
    private final Stage stage;
    private final MediaDetails details;
    private final ScheduledExecutorService worker =
            Executors.newSingleThreadScheduledExecutor(
                    task -> {
                        Thread thread = new Thread(task, "conductor");
                        thread.setDaemon(true);
                        return thread;
                    });
    private final AtomicInteger pendingSeek = new AtomicInteger(NO_SEEK);
    private volatile Failure failure;

    // On the window's thread.
    private double volume;
    private boolean muted;

    Conductor(Session session, Stage stage, PlayOptions options) {
        this.session = session;
        this.stage = stage;
        player = session.player();
        details = new MediaDetails(player);
        volume = options.volume() / 100.0;
        player.addListener(new Events());
    }

    /** Opens the media and plays it; the window tells what becomes of it. */
    void begin() {
        worker.execute(() -> failOn(this::openAndPlay));
    }

    private void openAndPlay() throws Failure {
        session.open();
        details.read();
        EventQueue.invokeLater(() -> stage.showMedia(details, volume));
        session.start();
        worker.scheduleWithFixedDelay(
                () -> failOn(this::poll), 0, POLL_MS, TimeUnit.MILLISECONDS);
    }

    /** Runs what the playback cannot go on without. */
    void failOn(Command command) {
        try {
            command.run();
        } catch (Failure e) {
            fail(e);
        } catch (RuntimeException e) {
            if (player.getState() != PlayerState.RELEASED) {
                fail(new Failure(sentence(e), e));
            }
            // Otherwise the window was closed meanwhile. Nothing is left to poll in either case.
            worker.shutdown();
        }
    }

    // Exceptions that are no answer of the player's rarely have words that say enough.
    private static String sentence(Exception e) {
        boolean isAnswer =
                e instanceof Failure
                        || e instanceof IllegalStateException
                        || e instanceof IllegalArgumentException;
        return isAnswer && e.getMessage() != null ? e.getMessage() : "the player failed: " + e;
    }

    void end() {
        worker.shutdownNow();
    }

    Failure failure() {
        return failure;
    }

    @Override
    public void togglePlaying() {
        later(
                () -> {
                    if (player.isPlaying()) {
                        player.pause();
                    } else {
                        player.start();
                    }
                });
    }

    @Override
    public void skip(int millis) {
        stage.tell((millis < 0 ? "− " : "+ ") + Math.abs(millis) / 1000 + " s");
        later(() -> skipFrom(player.getCurrentPosition(), millis));
    }

    // A seek ends at the key frame before its goal. Where key frames are so far apart that this
    // leads back, the goal moves on.
    private void skipFrom(int from, int millis) {
        int duration = player.getDuration();
        int goal = from;
        do {
            goal = goalOf(goal, millis, duration);
            session.seekTo(goal);
        } while (millis > 0 && goal < duration && player.getCurrentPosition() <= from);
    }

    /** Where a skip leads, in milliseconds; without a duration (0) nobody knows where to stop. */
    static int goalOf(int from, int millis, int duration) {
        long end = duration > 0 ? duration : Integer.MAX_VALUE;
        return (int) Math.max(0, Math.min((long) from + millis, end));
    }

    // While the knob is dragged only its latest place counts.
    @Override
    public void seekTo(int millis) {
        if (pendingSeek.getAndSet(millis) == NO_SEEK) {
            later(() -> session.seekTo(pendingSeek.getAndSet(NO_SEEK)));
        }
    }

    @Override
    public void step(int frames) {
        later(() -> player.trickPlay().step(frames));
    }

    @Override
    public void setVolume(double level) {
        volume = level;
        muted = false;
        applyVolume();
    }

    @Override
    public void changeVolume(double by) {
        setVolume(Math.max(0, Math.min(1, volume + by)));
        stage.tell("Volume " + Math.round(volume * 100) + "%");
    }

    @Override
    public void toggleMuted() {
        muted = !muted;
        stage.tell(muted ? "Muted" : "Unmuted");
        applyVolume();
    }

    private void applyVolume() {
        stage.showVolume(volume, muted);
        double level = muted ? 0 : volume;
        later(() -> session.setVolume(level));
    }

    @Override
    public void changeSpeed(int steps) {
        later(() -> applySpeed(Speeds.from(player.trickPlay().getSpeed(), steps)));
    }

    private void applySpeed(double speed) throws Failure {
        session.setSpeed(speed);
        EventQueue.invokeLater(() -> stage.tell(Speeds.label(speed)));
    }

    @Override
    public void chooseSpeed(Component above) {
        later(
                () -> {
                    double now = player.trickPlay().getSpeed();
                    List<ChoiceMenu.Choice> choices = new ArrayList<>();
                    for (double speed : Speeds.offered()) {
                        choices.add(
                                new ChoiceMenu.Choice(
                                        Speeds.label(speed),
                                        speed == now,
                                        () -> later(() -> applySpeed(speed))));
                    }
                    openMenu(above, "Speed", choices);
                });
    }

    @Override
    public void chooseAudio(Component above) {
        later(
                () ->
                        openMenu(
                                above,
                                "Audio track",
                                details.audioChoices(
                                        index -> later(() -> session.selectAudio(index)))));
    }

    @Override
    public void chooseSubtitles(Component above) {
        later(
                () ->
                        openMenu(
                                above,
                                "Subtitles",
                                details.subtitleChoices(
                                        index -> later(() -> session.selectSubtitle(index)))));
    }

    private void openMenu(Component above, String title, List<ChoiceMenu.Choice> choices) {
        EventQueue.invokeLater(() -> stage.openMenu(above, title, choices));
    }

    @Override
    public void toggleFullScreen() {
        stage.toggleFullScreen();
    }

    @Override
    public void leave() {
        stage.leave();
    }

    @Override
    public void toggleHelp() {
        stage.toggleHelp();
    }

    @Override
    public void quit() {
        stage.close();
    }

    void requestFrameSize(int width, int height) {
        session.requestFrameSize(width, height);
    }

    private void later(Command command) {
        try {
            worker.execute(() -> carryOut(command));
        } catch (RejectedExecutionException e) {
            // The window is closing.
        }
    }

    // What the player refuses, such as a seek in a live stream, is worth a notice, no more.
    private void carryOut(Command command) {
        try {
            command.run();
        } catch (Failure | RuntimeException e) {
            if (failure == null && player.getState() != PlayerState.RELEASED) {
                EventQueue.invokeLater(() -> stage.tell(sentence(e)));
            }
        }
    }

    private void poll() {
        Snapshot now = session.snapshot();
        EventQueue.invokeLater(() -> stage.show(now));
    }

    // The first failure is the cause of what follows.
    private synchronized void fail(Failure problem) {
        if (failure != null) {
            return;
        }
        failure = problem;
        System.err.println("orv: " + problem.getMessage());
        EventQueue.invokeLater(() -> stage.showFailure(problem.getMessage()));
    }

    private final class Events implements PlayerListener {
        @Override
        public void onError(OrvMediaPlayer player, MediaException error) {
            fail(new Failure(error.getMessage(), error));
        }

        @Override
        public void onVideoSizeChanged(OrvMediaPlayer player, int width, int height) {
            EventQueue.invokeLater(() -> stage.showVideoSize(width, height));
        }
    }
}
