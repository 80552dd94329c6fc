// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import com.quintora.mmp.MediaException;
import com.quintora.mmp.MediaPlayer;
import com.quintora.mmp.OrvMediaPlayer;
import com.quintora.mmp.PlaybackInfo;
import com.quintora.mmp.PlayerListener;
import com.quintora.mmp.PlayerState;
import com.quintora.mmp.desktop.DesktopSurfaceView;
import com.quintora.orv.player.Fact;
import com.quintora.orv.player.Failure;
import com.quintora.orv.player.Previews;
import com.quintora.orv.player.ReadingOrder;
import com.quintora.orv.player.Section;
import com.quintora.orv.player.Session;
import com.quintora.orv.player.Snapshot;
import com.quintora.orv.player.Still;
import com.quintora.orv.player.Times;
import com.quintora.orv.player.playlist.Entry;
import com.quintora.orv.player.subtitles.SubtitleLook;
import java.awt.Component;
import java.awt.EventQueue;
import java.nio.file.Path;
import java.util.ArrayList;
import java.util.List;
import java.util.Locale;
import java.util.Optional;
import java.util.OptionalInt;
import java.util.concurrent.atomic.AtomicInteger;
import java.util.function.Consumer;
import java.util.function.Supplier;

/**
 * One media that the window plays. Carries out what the controls ask of it, on threads of its own,
 * because the player's calls may take their time; and shows in the window how things stand. Pausing
 * and the volume wait for nothing that takes long, such as a seek.
 */
final class Playing {
    /** A call of the player's. */
    interface Command {
        void run() throws Failure;
    }

    /** Whom it reports to, on any thread. */
    interface Listener {
        /** It can play no more; called once at most. */
        void onFailure(Playing playing, Failure failure);

        /** It is open, and begins to play. */
        void onOpened(Playing playing);

        /** How things stand now; again and again, on the window's thread. */
        void onLook(Playing playing, Snapshot now);

        /** It has come to its end. */
        void onEnd(Playing playing);
    }

    private final Entry entry;
    private final Session session;
    private final OrvMediaPlayer player;
    private final Stage stage;
    private final MediaDetails details;
    private final Mover mover;
    private final Workers workers = new Workers();
    private final AtomicInteger pendingSpeedSteps = new AtomicInteger();
    private final AtomicInteger pendingChapterSteps = new AtomicInteger();
    private final Listener listener;
    private RepeatMarks section = RepeatMarks.NONE; // On the thread of what takes long.
    private volatile boolean ending;
    private OptionalInt pin = OptionalInt.empty();
    private volatile boolean ended;
    private volatile Failure failure;
    private volatile Previews previews; // Null where there are none.
    private volatile Snapshot last;

    Playing(Entry entry, Session session, Stage stage, Listener listener) {
        this.entry = entry;
        this.session = session;
        this.stage = stage;
        this.listener = listener;
        player = session.player();
        details = new MediaDetails(player);
        mover = new Mover(new Moved(), this::later, this::tell);
        player.addListener(new Events());
    }

    /** Unlocks the media by that PIN before it is opened. To be called before it begins. */
    void unlockFirst(OptionalInt pin) {
        this.pin = pin;
    }

    /** Opens the media and plays it; the window shows what becomes of it. */
    void begin() {
        workers.later(() -> failOn(this::openAndPlay));
    }

    private void openAndPlay() throws Failure {
        chooseWay();
        pin.ifPresent(session::unlock);
        session.open();
        details.read();
        show(() -> stage.showMedia(details));
        session.section().ifPresent(this::showMarked);
        beginPreviews();
        listener.onOpened(this);
        session.start();
        workers.begin(() -> failOn(this::poll));
    }

    private void beginPreviews() {
        session.previews(
                        Theme.scale(), (part, image) -> show(() -> stage.showPreview(part, image)))
                .ifPresent(
                        made -> {
                            previews = made;
                            show(() -> stage.showPreviews(made));
                        });
    }

    private void showMarked(Section marked) {
        RepeatMarks marks =
                RepeatMarks.NONE.withStart(marked.from()).withEnd(marked.to());
        section = marks;
        show(() -> stage.showSection(marks));
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
        show(
                () -> {
                    if (draws) {
                        stage.drawOn(view);
                    } else {
                        stage.dropView(view);
                    }
                });
    }

    /** Goes on with the surface that the view has now. */
    void drawOnNewSurfaceOf(DesktopSurfaceView view) {
        later(() -> session.drawOnNewSurfaceOf(view));
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

    /** Shows and reports nothing more. */
    void retire() {
        ending = true;
    }

    boolean isRetired() {
        return ending;
    }

    /** Retires it, and releases the player. Blocks; whatever it does is ended. */
    void end() {
        ending = true;
        ended = true;
        workers.end();
        if (previews != null) {
            previews.close();
        }
        session.close();
    }

    boolean isEnded() {
        return ended;
    }

    Entry entry() {
        return entry;
    }

    /** How things stood when they were looked at last, if they ever were. */
    Optional<Snapshot> last() {
        return Optional.ofNullable(last);
    }

    /** Of what is open. */
    MediaDetails details() {
        return details;
    }

    Session session() {
        return session;
    }

    Failure failure() {
        return failure;
    }

    void togglePlaying() {
        soon(session::togglePlaying);
    }

    void skip(int millis) {
        mover.skip(millis);
    }

    void seekTo(int millis) {
        mover.seekTo(millis);
    }

    void step(int frames) {
        mover.step(frames);
    }

    /** To the start of the next chapter, or back when negative. */
    void changeChapter(int steps) {
        if (pendingChapterSteps.getAndAdd(steps) == 0) {
            later(
                    () -> {
                        int all = pendingChapterSteps.getAndSet(0);
                        goOnChapters(all);
                    });
        }
    }

    private void goOnChapters(int steps) throws Failure {
        Chapters chapters = details.chapters();
        if (chapters.count() == 0) {
            throw new Failure("the media has no chapters");
        }
        OptionalInt wanted = chapters.from(player.getCurrentPosition(), steps);
        goToChapter(wanted.orElseThrow(() -> new Failure("this is the last chapter")));
    }

    private void goToChapter(int index) throws Failure {
        int end = session.seekTo(details.chapters().start(index));
        tell(ReadingOrder.ofName(details.chapters().name(index)) + "  " + Times.clock(end));
    }

    void chooseChapter(Component above) {
        later(
                () ->
                        openMenu(
                                above,
                                "Chapters",
                                details.chapters()
                                        .choices(
                                                player.getCurrentPosition(),
                                                index -> later(() -> goToChapter(index)))));
    }

    /** Begins a section to repeat at the present place. */
    void repeatFromHere() {
        later(
                () -> {
                    int from = session.repeatFromHere();
                    section = RepeatMarks.NONE.withStart(from);
                    showSection("A section begins at " + Times.clock(from));
                });
    }

    /** Ends it at the present place, and repeats it. */
    void repeatUntilHere() {
        later(
                () -> {
                    int to = session.repeatUntilHere();
                    section = section.withEnd(to);
                    showSection(
                            "Repeats " + Times.clock(section.from()) + " to " + Times.clock(to));
                });
    }

    void repeatNothing() {
        later(
                () -> {
                    session.repeatNothing();
                    section = RepeatMarks.NONE;
                    showSection("No section is repeated");
                });
    }

    private void showSection(String words) {
        RepeatMarks marks = section;
        show(
                () -> {
                    stage.showSection(marks);
                    stage.tell(words);
                });
    }

    /** Writes the picture that shows to a file, with what subtitles show or without. */
    void keepPicture(boolean withSubtitles) {
        later(
                () -> {
                    Still still = session.still(withSubtitles);
                    workers.completely(() -> carryOut(() -> write(still)));
                });
    }

    private void write(Still still) throws Failure {
        Path file = session.screenshots().save(still);
        show(() -> stage.tellLong("Saved as " + file));
    }

    /** From 0 to 1. */
    void setVolume(double level) {
        soon(() -> session.setVolume(level));
    }

    void setLooping(boolean loops) {
        soon(() -> session.setLooping(loops));
    }

    void changeSpeed(int steps) {
        if (pendingSpeedSteps.getAndAdd(steps) == 0) {
            later(
                    () -> {
                        int all = pendingSpeedSteps.getAndSet(0);
                        applySpeed(Speeds.from(player.trickPlay().getSpeed(), all));
                    });
        }
    }

    void setSpeed(double speed) {
        later(() -> applySpeed(speed));
    }

    private void applySpeed(double speed) throws Failure {
        session.setSpeed(speed);
        tell(Speeds.label(speed));
    }

    void chooseSpeed(Component above) {
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

    void chooseAudio(Component above) {
        later(
                () ->
                        openMenu(
                                above,
                                "Audio track",
                                details.audioChoices(
                                        index -> later(() -> session.selectAudio(index)))));
    }

    void chooseSubtitles(Component above) {
        later(
                () ->
                        openMenu(
                                above,
                                "Subtitles",
                                details.subtitleChoices(
                                        index -> later(() -> session.selectSubtitle(index)))));
    }

    /** Has subtitles look as they are to look when it is their turn. */
    void showSubtitlesAs(Supplier<SubtitleLook> look) {
        soon(() -> session.showSubtitlesAs(look.get()));
    }

    /** Reads what is known of the media; answers on the window's thread, after a failure not. */
    void readFacts(String drawing, Consumer<List<Fact>> answer) {
        later(
                () -> {
                    List<Fact> facts = session.facts(drawing);
                    show(() -> answer.accept(facts));
                });
    }

    /** Unlocks media that parents locked; the answer comes on the window's thread. */
    void unlock(int pin, Consumer<Boolean> answer) {
        later(
                () -> {
                    boolean unlocks = session.unlock(pin);
                    show(() -> answer.accept(unlocks));
                });
    }

    /** Adds the subtitles of a file, and shows them. */
    void addSubtitles(String path) {
        later(
                () -> {
                    session.addSubtitles(path);
                    details.readTracks();
                    show(() -> stage.showTracks(details));
                });
    }

    private void openMenu(Component above, String title, List<ChoiceMenu.Choice> choices) {
        show(() -> stage.openMenu(above, title, choices));
    }

    void requestFrameSize(int width, int height) {
        session.requestFrameSize(width, height);
    }

    /** Whether the window is seen. */
    void setWatched(boolean watched) {
        soon(() -> session.setWatched(watched));
    }

    private void tell(String words) {
        show(() -> stage.tell(words));
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

    static String capitalized(String sentence) {
        return sentence.substring(0, 1).toUpperCase(Locale.ROOT) + sentence.substring(1);
    }

    private void poll() {
        Snapshot now = session.snapshot();
        last = now;
        boolean seeks = session.isSeeking();
        show(() -> {
            stage.show(now);
            stage.showWaiting(seeks, now.playing());
            listener.onLook(this, now);
        });
    }

    // The first failure is the cause of what follows.
    private synchronized void fail(Failure problem) {
        if (failure != null) {
            return;
        }
        failure = problem;
        listener.onFailure(this, problem);
    }

    // What comes after the end is of the next media.
    private void show(Runnable change) {
        EventQueue.invokeLater(
                () -> {
                    if (!ending) {
                        change.run();
                    }
                });
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
        public void onCompletion(MediaPlayer player) {
            if (Playing.this.player.trickPlay().getSpeed() > 0) {
                listener.onEnd(Playing.this);
            }
        }

        @Override
        public void onInfo(MediaPlayer player, PlaybackInfo info) {
            switch (info.kind()) {
                case BUFFERING_STARTED -> show(() -> stage.setBuffering(true));
                case BUFFERING_ENDED -> show(() -> stage.setBuffering(false));
                default -> { }
            }
        }

        @Override
        public void onVideoSizeChanged(MediaPlayer player, int width, int height) {
            show(() -> stage.showVideoSize(width, height));
        }
    }
}
