// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import android.view.Surface;
import com.quintora.mmp.ChannelStreamSource;
import com.quintora.mmp.MediaException;
import com.quintora.mmp.MediaPlayer;
import com.quintora.mmp.OrvMediaPlayer;
import com.quintora.mmp.PlayerListener;
import com.quintora.mmp.PlayerRole;
import com.quintora.mmp.SubtitleTrack;
import com.quintora.mmp.Track;
import com.quintora.mmp.VideoTrack;
import com.quintora.mmp.desktop.DesktopSurfaceView;
import com.quintora.mmp.desktop.VideoFrame;
import com.quintora.orv.player.playlist.Entry;
import java.awt.image.BufferedImage;
import com.quintora.orv.player.subtitles.SubtitleLook;
import java.io.IOException;
import java.nio.file.AccessDeniedException;
import java.nio.file.Files;
import java.nio.file.NoSuchFileException;
import java.nio.file.Path;
import java.util.List;
import java.util.Locale;
import java.util.Optional;
import java.util.concurrent.CountDownLatch;
import java.util.function.BiConsumer;
import java.util.function.Consumer;

/**
 * One playback: a player, its frames, and how it went. Any thread may call any method; those that
 * name a failure block while the player works. Closing it ends a call that blocks elsewhere.
 */
public final class Session implements AutoCloseable {
    private final PlayOptions options;
    private final OrvMediaPlayer player = NativeHalf.newPlayer();
    private final FramePump frames;
    private final Playhead playhead;
    private final CountDownLatch ended = new CountDownLatch(1);
    private final Stopwatch stopwatch = new Stopwatch();
    private volatile SectionRepeater repeater; // Of the section that the options name.
    private final Facts facts;
    private SubtitleLook look = SubtitleLook.USUAL;
    private volatile double frameRate;
    private volatile boolean isOnView;
    private volatile Failure failure;

    /** The screen is called with each frame, on a thread of its own, and must not keep it. */
    public Session(PlayOptions options, Consumer<VideoFrame> screen) {
        this.options = options;
        frames = new FramePump(screen);
        playhead = new Playhead(player, frames);
        facts = new Facts(options.source, player);
        player.addListener(new Ending());
    }

    public OrvMediaPlayer player() {
        return player;
    }

    /** Asks for frames of that size from now on; 0 x 0 for the video's own. */
    public void requestFrameSize(int width, int height) {
        frames.reader().setFrameSize(width, height);
    }

    /** Whether anybody sees the frames: otherwise none is drawn, and afterwards the newest is. */
    public void setWatched(boolean watched) {
        frames.count().expectJump();
        player.engine().setRole(watched ? PlayerRole.MAIN : PlayerRole.BACKGROUND);
    }

    /**
     * Has the graphics processor draw on that view, whose surface is there, instead of giving
     * frames to the screen. To be asked before the media is opened.
     *
     * @return false when it does not: frames go to the screen
     */
    public boolean drawOn(DesktopSurfaceView view) {
        player.setSurface(view.getHolder().getSurface());
        isOnView = view.isDrawnByGpu();
        if (isOnView) {
            frames.watch(view);
        } else {
            player.setSurface(frames.reader().getSurface());
        }
        return isOnView;
    }

    /** Goes on with the surface that such a view has now; without one, the picture waits. */
    public void drawOnNewSurfaceOf(DesktopSurfaceView view) {
        Surface surface = view.getHolder().getSurface();
        if (surface != null && surface.isValid()) {
            player.setSurface(surface);
        }
    }

    /** Opens the media and brings it to where it shall begin; a session that fails has ended. */
    public void open() throws Failure {
        try {
            openMedia();
        } catch (Failure e) {
            ended.countDown();
            throw e;
        }
    }

    private void openMedia() throws Failure {
        try {
            setSource();
            if (!isOnView) {
                player.setSurface(frames.reader().getSurface());
            }
            frames.start();
            player.prepareAndWait();
            Silence.explain(player);
            frameRate = player.tracks().currentVideo().map(VideoTrack::frameRate).orElse(0.0);
            playhead.open();
            goToStart();
            frames.count().expect(frameRate);
            applyOptions();
        } catch (IOException | SecurityException | IllegalStateException e) {
            throw new Failure(e.getMessage(), e);
        }
    }

    public void start() {
        if (options.section != null) {
            repeater = new SectionRepeater(player, options.section);
            repeater.start();
        }
        frames.count().expectJump();
        stopwatch.start(player.getCurrentPosition());
        player.start();
    }

    /** Plays or pauses; waits for no seek: what is asked for during one holds after it. */
    public void togglePlaying() {
        playhead.togglePlaying();
    }

    /**
     * Goes to the frame that is shown at that time; media without a picture, and media that plays
     * backward, to where the player's own seek leads. Blocks; what played plays on afterwards.
     *
     * @return where it ended, in milliseconds
     */
    public int seekTo(int millis) throws Failure {
        if (!player.trickPlay().canSeekAt(1)) {
            throw new Failure("seeking is not possible in this media");
        }
        playhead.seekTo(millis);
        return player.getCurrentPosition();
    }

    /** Whether a seek or step is under way. */
    public boolean isSeeking() {
        return playhead.isMoving();
    }

    /** Goes some frames on, or back when negative, and pauses there. Blocks. */
    public void step(int count) throws Failure {
        if (player.getVideoWidth() == 0) {
            throw new Failure("the media has no picture to step through");
        }
        try {
            playhead.step(count);
        } catch (IllegalStateException e) {
            throw new Failure(count > 0 ? "this is the last frame" : "this is the first frame", e);
        }
    }

    /**
     * The picture that shows, at the video's own size; what is seen stays as it is meanwhile.
     * Blocks.
     *
     * @param withSubtitles whether those that show are in it
     */
    public Still still(boolean withSubtitles) throws Failure {
        if (player.getVideoWidth() == 0) {
            throw new Failure("the media has no picture to keep");
        }
        Size size = ShownPicture.sizeOf(player);
        Optional<SubtitleTrack> hidden =
                withSubtitles ? Optional.empty() : player.tracks().currentSubtitle();
        return playhead.keepPicture(
                () -> {
                    hidden.ifPresent(
                            track -> player.tracks().selectNoneAndWait(Track.Kind.SUBTITLE));
                    try {
                        return FrameGrabber.take(player, size, frames.surface());
                    } finally {
                        hidden.ifPresent(player.tracks()::selectAndWait);
                    }
                });
    }

    /** The section that the options have it repeat. */
    public Optional<Section> section() {
        return Optional.ofNullable(options.section);
    }

    /**
     * Begins a section to repeat at the present position; the one before ends.
     *
     * @return that position, in milliseconds
     */
    public int repeatFromHere() throws Failure {
        endRepeater();
        int position = player.getCurrentPosition();
        if (!player.trickPlay().repeatFromHere()) {
            throw new Failure("no section of this media can be repeated");
        }
        return position;
    }

    /**
     * Ends the section at the present position: it repeats from now on.
     *
     * @return that position, in milliseconds
     */
    public int repeatUntilHere() throws Failure {
        int position = player.getCurrentPosition();
        if (!player.trickPlay().repeatUntilHere()) {
            throw new Failure("a section ends after its beginning, which is to be marked first");
        }
        return position;
    }

    public void repeatNothing() {
        endRepeater();
        player.trickPlay().repeatOff();
    }

    private void endRepeater() {
        if (repeater != null) {
            repeater.interrupt();
        }
    }

    /**
     * Makes small pictures of its media beside it, once it is open, from when they are asked for.
     * Empty for media without a picture or an end, and for what is no file.
     *
     * @param scale how many times as large as usual they are, 1 to 4
     * @param onPicture is called with each picture and the part that it is of, on a thread of their
     *     own
     */
    public Optional<Previews> previews(
            double scale, BiConsumer<Integer, BufferedImage> onPicture) {
        boolean isPossible =
                player.getVideoWidth() > 0
                        && player.getDuration() > 0
                        && player.trickPlay().canSeekAt(1)
                        && isFile();
        return isPossible
                ? Optional.of(
                        new Previews(
                                options.source,
                                player.getDuration(),
                                ShownPicture.sizeOf(player),
                                scale,
                                onPicture))
                : Optional.empty();
    }

    private boolean isFile() {
        boolean isPath = !options.stream && options.pcm == null && !Entry.isUrl(options.source);
        return isPath && Files.isRegularFile(Path.of(options.source));
    }

    /** Where pictures of its media go that the user keeps. */
    public Screenshots screenshots() {
        return options.screenshots();
    }

    public void setSpeed(double speed) throws Failure {
        try {
            // At other speeds frames are left out on purpose.
            frames.count().expect(0);
            player.trickPlay().setSpeed(speed);
            frames.count().expect(speed == 1 ? frameRate : 0);
        } catch (IllegalArgumentException e) {
            throw new Failure(e.getMessage(), e);
        }
    }

    /** Whether the media begins again at its end, which is none then. */
    public void setLooping(boolean loops) {
        player.setLooping(loops);
    }

    /** From 0 to 1. */
    public void setVolume(double level) {
        player.setVolume((float) level);
    }

    public void selectAudio(int index) throws Failure {
        select(index, player.tracks().audio(), "sound");
    }

    /** Shows a subtitle track; a negative index is for none. */
    public void selectSubtitle(int index) throws Failure {
        if (index < 0) {
            player.tracks().selectNoneAndWait(Track.Kind.SUBTITLE);
        } else {
            select(index, player.tracks().subtitles(), "subtitle");
        }
    }

    private void select(int index, List<? extends Track> tracks, String kind) throws Failure {
        if (index < 0 || index >= tracks.size()) {
            throw new Failure(noTrack(kind, index, tracks.size()));
        }
        try {
            player.tracks().selectAndWait(tracks.get(index));
        } catch (IllegalStateException e) {
            throw new Failure(e.getMessage(), e);
        }
    }

    public void addSubtitles(String path) throws Failure {
        try {
            if (path.toLowerCase(Locale.ROOT).endsWith(".idx")) {
                player.subtitles().addPairAndWait(picturesOf(path), path);
            } else {
                player.subtitles().addAndWait(path);
            }
        } catch (IOException e) {
            throw new Failure(e.getMessage(), e);
        }
    }

    /** Shows subtitles in that way from the next picture on. */
    public synchronized void showSubtitlesAs(SubtitleLook wanted) {
        wanted.changesFrom(look).ifPresent(player.subtitles()::setStyle);
        look = wanted;
    }

    public Snapshot snapshot() {
        return new Snapshot(
                player.getCurrentPosition(),
                player.getDuration(),
                playhead.isPlaying(),
                player.trickPlay().getSpeed(),
                player.getBufferedPercent(),
                frames.count().shown(),
                frames.count().dropped());
    }

    /** All that is known of the media and its playback; the drawing is in words. Blocks. */
    public List<Fact> facts(String drawing) {
        return facts.read(snapshot(), drawing);
    }

    /** Unlocks media that parents locked; whether that was the PIN. */
    public boolean unlock(int pin) {
        return player.engine().unlock(pin);
    }

    /** Reaches zero when the media has come to its end or has failed. */
    public CountDownLatch ended() {
        return ended;
    }

    /** What ended the playback, or null when that was the end of the media. */
    public Failure failure() {
        return failure;
    }

    /** How quickly and how smoothly it went, in a line. */
    public String report() {
        return stopwatch.report(frames);
    }

    @Override
    public void close() {
        frames.close();
        player.close();
    }

    private void setSource() throws IOException {
        if (options.pcm != null) {
            player.setPcmFormat(options.pcm);
        }
        String source = StandardInput.path(options.source);
        boolean once = StandardInput.isPipe(options.source);
        if (once && (options.stream || StandardInput.isNamed(options.source))) {
            player.setDataSource(StandardInput.streamed(options.source));
        } else if (options.stream) {
            player.setDataSource(openStream(source));
        } else {
            player.setDataSource(source);
        }
    }

    private static ChannelStreamSource openStream(String file) throws IOException {
        if (file.isEmpty()) {
            throw new IOException("the path is empty");
        }
        if (Files.isDirectory(Path.of(file))) {
            throw new IOException(file + ": is a directory");
        }
        try {
            return ChannelStreamSource.open(Path.of(file));
        } catch (NoSuchFileException e) {
            throw new IOException(file + ": no such file", e);
        } catch (AccessDeniedException e) {
            throw new IOException(file + ": may not be read", e);
        }
    }

    private void goToStart() throws Failure {
        int duration = player.getDuration();
        Section section = options.section;
        if (section != null && !player.trickPlay().canSeekAt(1)) {
            throw new Failure("no section of '" + options.source + "' can be repeated");
        }
        if (duration > 0 && section != null && section.to() > duration) {
            throw Failure.endsBefore(options.source, duration, "the section does");
        }
        if (duration > 0 && options.start > duration) {
            throw Failure.endsBefore(options.source, duration, "that moment");
        }
        int start = section != null ? section.from() : options.start;
        if (start == 0 && options.speed < 0) {
            start = duration;
        }
        if (start > 0) {
            seekTo(start);
        }
    }

    private void applyOptions() throws Failure {
        if (options.loop) {
            setLooping(true);
        }
        int volume = options.volume().orElse(100);
        if (volume != 100) {
            setVolume(volume / 100.0);
        }
        if (options.audioTrack != null) {
            selectAudio(options.audioTrack);
        }
        chooseSubtitles();
        if (options.speed != 1) {
            setSpeed(options.speed);
        }
    }

    /** What is asked for, or what the media itself wants to be seen. */
    private void chooseSubtitles() throws Failure {
        if (options.subtitle != null) {
            addSubtitles(options.subtitle);
        }
        if (options.subtitleTrack != null) {
            selectSubtitle(options.subtitleTrack);
        } else if (options.subtitle == null) {
            player.tracks().subtitles().stream()
                    .filter(track -> track.flags().isDefault() || track.flags().isForced())
                    .findFirst()
                    .ifPresent(player.tracks()::selectAndWait);
        }
    }

    /** A VobSub pair's other file: film.sub of film.idx, FILM.SUB of FILM.IDX. */
    static String picturesOf(String index) {
        StringBuilder path = new StringBuilder(index);
        for (int i = 0; i < 3; i++) {
            int at = index.length() - 3 + i;
            char letter = "sub".charAt(i);
            boolean isCapital = Character.isUpperCase(index.charAt(at));
            path.setCharAt(at, isCapital ? Character.toUpperCase(letter) : letter);
        }
        return path.toString();
    }

    private static String noTrack(String kind, int index, int count) {
        if (count == 0) {
            return "the media has no " + kind + " track";
        }
        String known = count == 1 ? "the only one is 0" : "they are 0 to " + (count - 1);
        return "there is no " + kind + " track " + index + "; " + known;
    }

    private final class Ending implements PlayerListener {
        @Override
        public void onCompletion(MediaPlayer player) {
            stopwatch.stop(player.getCurrentPosition());
            ended.countDown();
        }

        @Override
        public void onError(MediaPlayer player, MediaException error) {
            failure = new Failure(error.getMessage(), error);
            ended.countDown();
        }
    }
}
