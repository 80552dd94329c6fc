// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import com.quintora.mmp.MediaException;
import com.quintora.mmp.MediaPlayer;
import com.quintora.mmp.OrvMediaPlayer;
import com.quintora.mmp.PlaybackInfo;
import com.quintora.mmp.PlayerListener;
import com.quintora.mmp.PlayerState;
import com.quintora.mmp.desktop.DesktopSurfaceView;
import com.quintora.orv.player.Failure;
import com.quintora.orv.player.PlayOptions;
import com.quintora.orv.player.Session;
import com.quintora.orv.player.Snapshot;
import java.awt.Component;
import java.awt.EventQueue;
import java.util.ArrayList;
import java.util.List;
import java.util.Locale;
import java.util.concurrent.atomic.AtomicInteger;

/**
 * Carries out what the window's controls ask, on threads of its own, because the player's calls may
 * take their time; and shows in the window how things stand. Pausing and the volume wait for nothing
 * that takes long, such as a seek.
 */
final class Conductor implements Controls {
    /** A call of the player's. */
    interface Command {
        void run() throws Failure;
    }

    private final Session session;
    private final OrvMediaPlayer player;
    private final Stage stage;
    private final MediaDetails details;
    private final Mover mover;
    private final Workers workers = new Workers();
    private final AtomicInteger pendingSpeedSteps = new AtomicInteger();
    private volatile boolean ending;
    private volatile Failure failure;

    // On the window's thread.
    private double volume;
    private boolean muted;

    Conductor(Session session, Stage stage, PlayOptions options) {
        this.session = session;
        this.stage = stage;
        player = session.player();
        details = new MediaDetails(player);
        mover = new Mover(new Moved(), this::later, this::tell);
        volume = options.volume() / 100.0;
        player.addListener(new Events());
    }

    /** Opens the media and plays it; the window shows what becomes of it. */
    void begin() {
        workers.later(() -> failOn(this::openAndPlay));
    }

    private void openAndPlay() throws Failure {
        chooseWay();
        session.open();
        details.read();
        EventQueue.invokeLater(() -> stage.showMedia(details, volume));
        session.start();
        workers.begin(() -> failOn(this::poll));
    }

    private void chooseWay() throws Failure {
        try {
            stage.awaitView().ifPresent(this::tryGpu);
        } catch (InterruptedException e) {
            Thread.currentThread().interrupt();
            throw new Failure("interrupted", e);
        }
    }

    private void tryGpu(DesktopSurfaceView view) {
        boolean draws = session.drawOn(view);
        EventQueue.invokeLater(
                () -> {
                    if (draws) {
                        stage.drawOn(view, () -> later(() -> session.drawOnNewSurfaceOf(view)));
                    } else {
                        stage.dropView(view);
                    }
                });
    }

    /** Runs what the playback cannot go on without. */
    void failOn(Command command) {
        try {
            command.run();
        } catch (Failure | RuntimeException e) {
            if (!isEnding()) {
                fail(e instanceof Failure problem ? problem : new Failure(sentence(e), e));
            }
            workers.endPolling();
        }
    }

    // What fails then is no failure.
    private boolean isEnding() {
        return ending || player.getState() == PlayerState.RELEASED;
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
        ending = true;
        workers.end();
    }

    Failure failure() {
        return failure;
    }

    @Override
    public void togglePlaying() {
        soon(session::togglePlaying);
    }

    @Override
    public void skip(int millis) {
        mover.skip(millis);
    }

    @Override
    public void seekTo(int millis) {
        mover.seekTo(millis);
    }

    @Override
    public void step(int frames) {
        mover.step(frames);
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
        soon(() -> session.setVolume(level));
    }

    @Override
    public void changeSpeed(int steps) {
        if (pendingSpeedSteps.getAndAdd(steps) == 0) {
            later(
                    () -> {
                        int all = pendingSpeedSteps.getAndSet(0);
                        applySpeed(Speeds.from(player.trickPlay().getSpeed(), all));
                    });
        }
    }

    private void applySpeed(double speed) throws Failure {
        session.setSpeed(speed);
        tell(Speeds.label(speed));
    }

    @Override
    public void chooseSpeed(Component above) {
        soon(
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

    /** Whether the window is seen. */
    void setWatched(boolean watched) {
        soon(() -> session.setWatched(watched));
    }

    private void tell(String words) {
        EventQueue.invokeLater(() -> stage.tell(words));
    }

    private void later(Command command) {
        workers.later(() -> carryOut(command));
    }

    private void soon(Command command) {
        workers.soon(() -> carryOut(command));
    }

    // What the player refuses, such as a seek in a live stream, is worth a notice, no more.
    private void carryOut(Command command) {
        try {
            command.run();
        } catch (Failure | RuntimeException e) {
            if (failure == null && !isEnding()) {
                tell(capitalized(sentence(e)));
            }
        }
    }

    private static String capitalized(String sentence) {
        return sentence.substring(0, 1).toUpperCase(Locale.ROOT) + sentence.substring(1);
    }

    private void poll() {
        Snapshot now = session.snapshot();
        boolean seeks = session.isSeeking();
        EventQueue.invokeLater(() -> {
            stage.show(now);
            stage.showWaiting(seeks, now.playing());
        });
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

    private final class Moved implements Mover.Playback {
        @Override
        public int position() {
            return player.getCurrentPosition();
        }

        @Override
        public int duration() {
            return player.getDuration();
        }

        @Override
        public int seekTo(int millis) throws Failure {
            return session.seekTo(millis);
        }

        @Override
        public void step(int frames) throws Failure {
            session.step(frames);
        }
    }

    private final class Events implements PlayerListener {
        @Override
        public void onError(MediaPlayer player, MediaException error) {
            fail(new Failure(error.getMessage(), error));
        }

        @Override
        public void onInfo(MediaPlayer player, PlaybackInfo info) {
            switch (info.kind()) {
                case BUFFERING_STARTED -> EventQueue.invokeLater(() -> stage.setBuffering(true));
                case BUFFERING_ENDED -> EventQueue.invokeLater(() -> stage.setBuffering(false));
                default -> { }
            }
        }

        @Override
        public void onVideoSizeChanged(MediaPlayer player, int width, int height) {
            EventQueue.invokeLater(() -> stage.showVideoSize(width, height));
        }
    }
}
