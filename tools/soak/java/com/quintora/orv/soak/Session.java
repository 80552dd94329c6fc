// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.soak;

import com.quintora.mmp.MediaError;
import com.quintora.mmp.MediaException;
import com.quintora.mmp.MediaPlayer;
import com.quintora.mmp.OrvMediaPlayer;
import com.quintora.mmp.PlayerListener;
import com.quintora.mmp.PlayerState;
import com.quintora.mmp.desktop.FrameReader;
import java.util.Random;
import java.util.concurrent.CompletableFuture;
import java.util.concurrent.CompletionException;
import java.util.concurrent.ExecutionException;
import java.util.concurrent.atomic.AtomicReference;

/** The life of a player with its media, judged at each step. */
final class Session {
    private static final long POLL_MILLIS = 5;

    final Run run;
    final int cycle;
    final Random random;
    final Subject subject;
    OrvMediaPlayer player = new OrvMediaPlayer();
    FrameReader screen;

    private final AtomicReference<MediaException> reported;

    Session(Run run, int cycle, Random random, Subject subject) {
        this.run = run;
        this.cycle = cycle;
        this.random = random;
        this.subject = subject;
        reported = listen(player);
        run.tally.made();
        if (random.nextInt(4) != 0) {
            screen = new FrameReader();
            player.setSurface(screen.getSurface());
        }
    }

    /** The listener must not know the session, which knows the player. */
    private static AtomicReference<MediaException> listen(MediaPlayer player) {
        AtomicReference<MediaException> reported = new AtomicReference<>();
        player.addListener(new PlayerListener() {
            @Override
            public void onError(MediaPlayer from, MediaException error) {
                reported.set(error);
            }
        });
        return reported;
    }

    /** An action that must succeed for media without a fault. */
    boolean act(String what, Run.Step step) throws Exception {
        return act(what, false, step);
    }

    /** An action that the engine may refuse for any media. */
    boolean actIfPossible(String what, Run.Step step) throws Exception {
        return act(what, true, step);
    }

    private boolean act(String what, boolean mayBeRefused, Run.Step step) throws Exception {
        Journal.Action action = run.journal.begin(cycle, subject + ": " + what);
        try {
            run.plant.inAction(cycle);
            step.run();
            action.end("done");
            return true;
        } catch (ExecutionException | CompletionException | MediaException
                | IllegalStateException e) {
            Throwable cause = e.getCause() != null && !(e instanceof MediaException)
                    && !(e instanceof IllegalStateException) ? e.getCause() : e;
            action.end(cause.toString());
            judge(what, mayBeRefused, cause);
            return false;
        } catch (IllegalArgumentException e) {
            action.end(e.toString());
            // What was possible may no longer be once the media have failed.
            if (subject.expectation.isWell()) {
                throw e;
            }
            return false;
        } catch (Exception | Error e) {
            action.end(e.toString());
            throw e;
        }
    }

    private void judge(String what, boolean mayBeRefused, Throwable thrown) {
        if (thrown instanceof MediaException media) {
            reported.set(media);
            subject.expectation.check(media);
        } else if (!(thrown instanceof IllegalStateException)
                || subject.expectation.isWell() && !mayBeRefused) {
            throw new AssertionError(subject + ": " + what + " threw " + thrown, thrown);
        }
    }

    /** Sets the source and prepares; false when that failed as it may. */
    boolean open() throws Exception {
        long from = System.nanoTime();
        boolean wait = random.nextBoolean();
        boolean opened = act("open", () -> subject.open(player))
                && act(wait ? "prepareAndWait" : "prepareAsync", () -> {
                    if (wait) {
                        player.prepareAndWait();
                    } else {
                        player.prepareAsync().get();
                    }
                });
        if (opened && subject.expectation.notice() == Expectation.Notice.OPENING) {
            throw new AssertionError(subject + ": the fault was not reported");
        }
        if (opened && subject.kind.equals("file")) {
            run.tally.opened((System.nanoTime() - from) / 1e9);
        }
        if (!opened) {
            run.tally.count("reported on opening");
        }
        return opened;
    }

    /** Begins to prepare, and gives up before that is done, or just after. */
    void abandon() throws Exception {
        if (!act("open", () -> subject.open(player))) {
            return;
        }
        CompletableFuture<?>[] preparing = new CompletableFuture<?>[1];
        act("prepareAsync to be abandoned", () -> preparing[0] = player.prepareAsync());
        Thread.sleep(random.nextInt(40));
        act("reset while it prepares", () -> player.reset().get());
        if (preparing[0] != null) {
            act("the end of what was abandoned", () -> {
                try {
                    preparing[0].get();
                } catch (ExecutionException e) {
                    if (!(e.getCause() instanceof MediaException media
                            && media.error() == MediaError.ABORTED)) {
                        throw e;
                    }
                }
            });
        }
    }

    /** Whether actions make sense: throws when media without a fault have failed. */
    boolean isUsable() {
        MediaException error = reported.get();
        if (error != null) {
            subject.expectation.check(error);
        }
        if (player.getState() == PlayerState.ERROR && subject.expectation.isWell()) {
            throw new AssertionError(subject + ": the player is in the state ERROR");
        }
        return error == null && player.getState() != PlayerState.ERROR;
    }

    /** Plays media whose fault must be noticed up to there. */
    void awaitFailure() throws Exception {
        if (!isUsable()) {
            run.tally.count("reported while playing");
            return;
        }
        act("play until it fails", () -> {
            player.setLooping(false);
            player.start();
            awaitEnd();
        });
        if (isUsable() || reported.get() == null) {
            throw new AssertionError(
                    subject + ": the fault was not reported, the state is " + player.getState());
        }
        run.tally.count("reported while playing");
    }

    private void awaitEnd() throws InterruptedException {
        while (player.getState() != PlayerState.COMPLETED
                && (player.getState() != PlayerState.ERROR || reported.get() == null)) {
            Thread.sleep(POLL_MILLIS);
        }
    }

    /**
     * Plays on: the position changes, or the media end. All that is left of damaged media may be
     * one picture, which would be repeated at one position.
     */
    void awaitMoving() throws InterruptedException {
        if (!subject.expectation.isWell()) {
            player.setLooping(false);
        }
        int from = player.getCurrentPosition();
        while (player.getCurrentPosition() == from && player.getState() == PlayerState.STARTED) {
            Thread.sleep(POLL_MILLIS);
        }
    }

    /** A player whose media failed plays others after a reset. */
    void serveOn() throws Exception {
        Subject others = FileSubjects.whole(run.settings.media().resolve("silent.mkv"));
        Journal.Action action = run.journal.begin(cycle, "serve on after " + subject);
        player.resetAndWait();
        reported.set(null);
        others.open(player);
        player.prepareAndWait();
        player.start();
        awaitMoving();
        action.end("done");
    }

    /** Ends the player's life in one of the ways that there are. */
    void end() throws Exception {
        run.tally.living.decrementAndGet();
        switch (subject.mayBeForgotten() ? random.nextInt(6) : random.nextInt(5)) {
            case 0, 1 -> finish("close", () -> player.close());
            case 2, 3 -> finish("release", () -> player.release().get());
            case 4 -> finish("reset and close", () -> {
                player.resetAndWait();
                player.close();
            });
            default -> {
                run.tally.forgotten.incrementAndGet();
                run.journal.begin(cycle, "forget the player").end("done");
                run.closeLater(subject);
                if (screen != null) {
                    run.closeLater(screen);
                }
                player = null;
                return;
            }
        }
        if (screen != null) {
            screen.close();
        }
        subject.close();
    }

    private void finish(String what, Run.Step step) throws Exception {
        Journal.Action action = run.journal.begin(cycle, subject + ": " + what);
        step.run();
        action.end("done");
    }
}
