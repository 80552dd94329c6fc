// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import com.quintora.mmp.desktop.DesktopSurfaceView;
import com.quintora.mmp.desktop.VideoFrame;
import com.quintora.orv.player.Fact;
import com.quintora.orv.player.Failure;
import com.quintora.orv.player.PlayOptions;
import com.quintora.orv.player.ReadingOrder;
import com.quintora.orv.player.Session;
import com.quintora.orv.player.Snapshot;
import com.quintora.orv.player.Times;
import com.quintora.orv.player.memory.Memory;
import com.quintora.orv.player.memory.RecentMedia;
import com.quintora.orv.player.playlist.Entry;
import com.quintora.orv.player.playlist.EntryFinder;
import com.quintora.orv.player.playlist.Playlist;
import com.quintora.orv.player.playlist.Repeat;
import com.quintora.orv.player.subtitles.SubtitleLook;
import java.awt.Component;
import java.awt.EventQueue;
import java.util.List;
import java.util.Map;
import java.util.Optional;
import java.util.OptionalInt;
import java.util.concurrent.ExecutorService;
import java.util.concurrent.Executors;
import java.util.concurrent.RejectedExecutionException;
import java.util.function.Consumer;
import java.util.function.Supplier;

/**
 * Carries out what the window's controls ask: of the media that plays, or of the playlist, from
 * which one media after the other plays. On the window's thread, where nothing else is said.
 */
final class Conductor implements Controls, Playing.Listener {
    private static final String VOLUME = "volume";

    private final PlayOptions options;
    private final Stage stage;
    private final Playlist list;
    private final Memory memory;
    private final RecentMedia recent;
    private final Optional<DesktopLink> desktop;
    // Ends one media and begins the next, which both take their time.
    private final ExecutorService changes =
            Executors.newSingleThreadExecutor(task -> daemon(task, "changes"));
    // Reads folders, playlists and what is remembered of media.
    private final ExecutorService finder =
            Executors.newSingleThreadExecutor(task -> daemon(task, "finder"));
    private final Playing first;
    private volatile Playing now;
    private final SubtitleTuning subtitles;
    private volatile Failure firstFailure;
    private volatile boolean ending;
    private volatile int newest;

    private double volume;
    private boolean muted;
    private boolean isWatched = true;
    private int failuresInARow;
    private int leftAt; // Milliseconds; 0 for nothing to go on with.

    /** Any thread; the window need not be open yet. */
    Conductor(Stage stage, PlayOptions options, Playlist list) {
        this.options = options;
        this.stage = stage;
        this.list = list;
        memory = options.memory();
        recent = new RecentMedia(memory);
        desktop = options.bus().map(bus -> new DesktopLink(this, bus));
        Map<String, String> remembered = memory.read();
        volume = options.volume().orElseGet(() -> rememberedVolume(remembered)) / 100.0;
        stage.restore(remembered);
        subtitles =
                new SubtitleTuning(SubtitleLook.in(remembered), this::applySubtitleLook);
        Entry entry = list.currentEntry();
        first = playing(entry, optionsOf(entry, true), stage.screen());
        now = first;
    }

    private static int rememberedVolume(Map<String, String> remembered) {
        String percent = remembered.getOrDefault(VOLUME, "");
        return percent.matches("\\d{1,2}") ? Integer.parseInt(percent) : 100;
    }

    private static Thread daemon(Runnable task, String name) {
        Thread thread = new Thread(task, name);
        thread.setDaemon(true);
        return thread;
    }

    private Playing playing(Entry entry, PlayOptions its, Consumer<VideoFrame> screen) {
        return new Playing(entry, new Session(its, screen), stage, this);
    }

    private PlayOptions optionsOf(Entry entry, boolean isFirst) {
        return options.forEntry(
                entry, isFirst, list.repeatsCurrent(), (int) Math.round(effectiveVolume() * 100));
    }

    private double effectiveVolume() {
        return muted ? 0 : volume;
    }

    /** Begins to play; the window shows what becomes of it. Any thread. */
    void begin() {
        now.begin();
    }

    /** Ends what plays, and waits for that. Any thread but the window's. */
    void end() {
        ending = true;
        changes.shutdownNow();
        finder.shutdownNow();
        desktop.ifPresent(DesktopLink::close);
        endCurrent();
    }

    private synchronized void endCurrent() {
        if (!now.isEnded()) {
            endNow();
            memory.update(this::rememberWindow);
        }
    }

    private void endNow() {
        now.last().ifPresent(
                last -> recent.add(now.entry(), last.positionMs(), last.durationMs()));
        now.end();
    }

    private void rememberWindow(Map<String, String> values) {
        values.put(VOLUME, String.valueOf(Math.round(volume * 100)));
        subtitles.look().remember(values);
        stage.place().ifPresent(place -> values.put(WindowPlace.NAME, WindowPlace.of(place)));
    }

    /** The media that plays now, or will in a moment. Any thread. */
    Playing playing() {
        return now;
    }

    /** Of the first media that could not be played, or null. Any thread. */
    Failure failure() {
        return firstFailure;
    }

    /** Plays the media at that place of the list from its start. */
    @Override
    public void play(int place) {
        play(place, OptionalInt.empty());
    }

    private void play(int place, OptionalInt pin) {
        now.retire();
        leftAt = 0;
        subtitles.beginMedia();
        list.goTo(place);
        Entry entry = list.currentEntry();
        PlayOptions its = optionsOf(entry, false);
        Consumer<VideoFrame> screen = stage.newScreen(entry.name());
        stage.showList(list);
        int wish = ++newest;
        execute(
                changes,
                () ->
                        change(
                                wish,
                                () -> {
                                    Playing next = playing(entry, its, screen);
                                    next.unlockFirst(pin);
                                    return next;
                                }));
    }

    private synchronized void change(int wish, Supplier<Playing> next) {
        if (!now.isEnded()) {
            endNow();
        }
        if (!ending && wish == newest) {
            now = next.get();
            now.begin();
        }
    }

    private static void execute(ExecutorService thread, Runnable task) {
        try {
            thread.execute(task);
        } catch (RejectedExecutionException e) {
            // The window is closing.
        }
    }

    @Override
    public void next() {
        playOr(list.next(), "This is the last one");
    }

    @Override
    public void previous() {
        playOr(list.previous(), "This is the first one");
    }

    private void playOr(OptionalInt place, String refusal) {
        failuresInARow = 0;
        place.ifPresentOrElse(this::play, () -> stage.tell(refusal));
    }

    @Override
    public void open(List<String> sources) {
        find(
                sources,
                found -> {
                    list.set(found);
                    failuresInARow = 0;
                    play(list.current());
                });
    }

    @Override
    public void add(List<String> sources) {
        find(
                sources,
                found -> {
                    boolean isFirst = list.entries().isEmpty();
                    list.add(found);
                    showList();
                    if (isFirst) {
                        play(list.current());
                    } else {
                        stage.tell(found.size() == 1 ? "Added" : found.size() + " added");
                    }
                });
    }

    private void find(List<String> sources, Consumer<List<Entry>> then) {
        execute(
                finder,
                () -> {
                    try {
                        List<Entry> found = EntryFinder.find(sources);
                        EventQueue.invokeLater(() -> then.accept(found));
                    } catch (Failure e) {
                        String sentence = Playing.capitalized(e.getMessage());
                        EventQueue.invokeLater(() -> stage.tellLong(sentence));
                    }
                });
    }

    @Override
    public void remove(int place) {
        boolean isPlaying = place == list.current();
        list.remove(place);
        if (isPlaying && !list.entries().isEmpty()) {
            play(list.current());
        }
        showList();
    }

    @Override
    public void toggleShuffled() {
        list.setShuffled(!list.isShuffled());
        stage.tell(list.isShuffled() ? "Shuffled" : "In order");
        showList();
    }

    @Override
    public void changeRepeat() {
        Repeat[] all = Repeat.values();
        setRepeat(all[(list.repeat().ordinal() + 1) % all.length]);
    }

    @Override
    public void setRepeat(Repeat repeat) {
        list.setRepeat(repeat);
        stage.tell(RepeatNames.of(list.repeat()));
        showList();
    }

    private void showList() {
        now.setLooping(list.repeatsCurrent());
        stage.showList(list);
    }

    @Override
    public Playlist list() {
        return list;
    }

    @Override
    public void onOpened(Playing playing) {
        playing.showSubtitlesAs(subtitles::look);
        if (playing != first || !options.nameAPlace()) {
            execute(finder, () -> offerPlaceOf(playing)); // The picture need not wait for it.
        }
    }

    private void offerPlaceOf(Playing playing) {
        int left = recent.positionOf(playing.entry().source());
        if (left > 0) {
            EventQueue.invokeLater(() -> offer(playing, left));
        }
    }

    private void offer(Playing playing, int left) {
        if (!playing.isRetired()) {
            leftAt = left;
            stage.tellLong("Left at " + Times.clock(left) + " last time: Enter goes on there");
        }
    }

    @Override
    public void goOn() {
        if (leftAt > 0) {
            seekTo(leftAt);
        } else {
            stage.tell("It was not left anywhere before");
        }
    }

    @Override
    public void chooseRecent(Component above) {
        execute(
                finder,
                () -> {
                    List<Entry> played =
                            recent.list().stream().map(RecentMedia.Item::entry).toList();
                    EventQueue.invokeLater(() -> stage.openMenu(
                            above, "Recent files", played.stream().map(this::choice).toList()));
                });
    }

    private ChoiceMenu.Choice choice(Entry entry) {
        boolean isPlaying = entry.source().equals(list.currentEntry().source());
        return new ChoiceMenu.Choice(
                entry.name(), isPlaying, () -> open(List.of(entry.source())));
    }

    @Override
    public void onLook(Playing playing, Snapshot look) {
        desktop.ifPresent(
                link -> link.show(
                        playing, look, effectiveVolume(), stage.fillsScreen(), isWatched));
    }

    @Override
    public void onFailure(Playing playing, Failure failure) {
        if (firstFailure == null) {
            firstFailure = failure;
        }
        System.err.println("orv: " + failure.getMessage());
        EventQueue.invokeLater(() -> goOnAfter(playing, failure));
    }

    // Until each one in a row has failed.
    private void goOnAfter(Playing playing, Failure failure) {
        if (playing.isRetired()) {
            return;
        }
        failuresInARow++;
        OptionalInt next = list.next();
        if (next.isPresent() && failuresInARow < list.entries().size()) {
            String name = ReadingOrder.ofName(list.currentEntry().name());
            play(next.getAsInt());
            stage.tellLong("“" + name + "” cannot be played: " + failure.getMessage());
        } else {
            stage.showFailure(failure.getMessage());
        }
    }

    @Override
    public void onEnd(Playing playing) {
        EventQueue.invokeLater(
                () -> {
                    if (!playing.isRetired()) {
                        failuresInARow = 0;
                        list.next().ifPresent(this::play);
                    }
                });
    }

    @Override
    public void togglePlaying() {
        now.togglePlaying();
    }

    @Override
    public void skip(int millis) {
        now.skip(millis);
    }

    @Override
    public void seekTo(int millis) {
        now.seekTo(millis);
    }

    @Override
    public void changeChapter(int steps) {
        now.changeChapter(steps);
    }

    @Override
    public void chooseChapter(Component above) {
        now.chooseChapter(above);
    }

    @Override
    public void repeatFromHere() {
        now.repeatFromHere();
    }

    @Override
    public void repeatUntilHere() {
        now.repeatUntilHere();
    }

    @Override
    public void repeatNothing() {
        now.repeatNothing();
    }

    @Override
    public void step(int frames) {
        now.step(frames);
    }

    @Override
    public void keepPicture(boolean withSubtitles) {
        now.keepPicture(withSubtitles);
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
        showVolume();
        now.setVolume(effectiveVolume());
    }

    /** Shows in the window how loud it is. */
    void showVolume() {
        stage.showVolume(volume, muted);
    }

    @Override
    public void changeSpeed(int steps) {
        now.changeSpeed(steps);
    }

    @Override
    public void setSpeed(double speed) {
        now.setSpeed(speed);
    }

    @Override
    public void chooseSpeed(Component above) {
        now.chooseSpeed(above);
    }

    @Override
    public void chooseAudio(Component above) {
        now.chooseAudio(above);
    }

    @Override
    public void chooseSubtitles(Component above) {
        now.chooseSubtitles(above);
    }

    @Override
    public SubtitleTuning subtitleTuning() {
        return subtitles;
    }

    private void applySubtitleLook() {
        now.showSubtitlesAs(subtitles::look);
    }

    @Override
    public void shiftSubtitles(int byMillis) {
        subtitles.shift(byMillis);
        stage.tell("Subtitles " + SubtitleTuning.delay(subtitles.look().delayMs()));
    }

    @Override
    public void toggleSubtitlePanel() {
        stage.togglePanel("subtitles", () -> new SubtitlePanel(this));
    }

    @Override
    public void toggleLog() {
        stage.togglePanel("log", () -> new LogPanel(this));
    }

    @Override
    public void toggleInformation() {
        stage.togglePanel("information", () -> new InformationPanel(this));
    }

    @Override
    public void toggleLock() {
        stage.togglePanel("lock", () -> new PinPanel(this));
    }

    @Override
    public void readFacts(Consumer<List<Fact>> answer) {
        now.readFacts(stage.describeDrawing(), answer);
    }

    /** What could not be played while it was locked is played then. */
    @Override
    public void unlock(int pin, Consumer<Boolean> answer) {
        Playing asked = now;
        asked.unlock(
                pin,
                unlocks -> {
                    answer.accept(unlocks);
                    if (unlocks && asked.failure() != null) {
                        failuresInARow = 0;
                        play(list.current(), OptionalInt.of(pin));
                    }
                });
    }

    @Override
    public void addSubtitleFile() {
        stage.addSubtitleFile();
    }

    @Override
    public void addSubtitles(String path) {
        now.addSubtitles(path);
    }

    @Override
    public void toggleFullScreen() {
        stage.toggleFullScreen();
    }

    @Override
    public void setFullScreen(boolean fills) {
        if (stage.fillsScreen() != fills) {
            stage.toggleFullScreen();
        }
    }

    @Override
    public void raise() {
        stage.raise();
    }

    @Override
    public void toggleList() {
        stage.toggleList();
    }

    @Override
    public void chooseFiles() {
        stage.chooseFiles();
    }

    @Override
    public void chooseAddress() {
        stage.chooseAddress();
    }

    @Override
    public void openMenu() {
        stage.openMenu();
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
    public void tell(String words) {
        stage.tell(words);
    }

    @Override
    public void quit() {
        stage.close();
    }

    void requestFrameSize(int width, int height) {
        now.requestFrameSize(width, height);
    }

    /** Goes on with the surface that the view has now. */
    void drawOnNewSurfaceOf(DesktopSurfaceView view) {
        now.drawOnNewSurfaceOf(view);
    }

    /** Whether the window is seen. */
    void setWatched(boolean watched) {
        isWatched = watched;
        now.setWatched(watched);
    }
}
