// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import android.view.Surface;
import com.quintora.mmp.internal.base.SourceNames;
import com.quintora.mmp.internal.base.Times;
import com.quintora.mmp.util.PcmMediaInfo;
import java.io.FileDescriptor;
import java.io.IOException;
import java.net.URI;
import java.nio.file.Path;
import java.time.Duration;
import java.util.Map;
import java.util.Optional;
import java.util.concurrent.CompletableFuture;
import org.jetbrains.annotations.Nullable;

/**
 * Plays audio and video. {@link OrvMediaPlayer} is the one that plays; programs that ask for this
 * interface can be tested with a fake.
 *
 * <pre>{@code
 * try (MediaPlayer player = new OrvMediaPlayer()) {
 *     player.setDataSource(Path.of("/media/film.mkv"));
 *     player.setSurface(surface);
 *     player.prepareAndWait();
 *     player.start();
 *     ...
 * }
 * }</pre>
 *
 * <p><b>States.</b> A player stands in one {@link PlayerState}. Each method says in which it may be
 * called and throws {@link IllegalStateException} with a sentence otherwise, in every case after
 * {@link #release()}.
 *
 * <p><b>Threads.</b> Any thread may call any method at any time, also from inside a {@link
 * PlayerListener}. Calls that change whether the player runs wait for one another.
 *
 * <p><b>Blocking.</b> What takes its time has two forms. The plain one returns at once with a
 * {@link CompletableFuture}, which is completed on a thread of the library: go on from there with
 * {@code thenAcceptAsync(..., executor)}. The one whose name ends in {@code AndWait} blocks until it is
 * done, says for how long at most, and throws what the future would have been completed with.
 * Arguments and states are checked before a method returns, in both forms; a future that reports
 * such a failure does not exist. To cancel a future does not end the work; reset and release do.
 * {@link #close()} alone blocks without the ending, as try-with-resources demands.
 *
 * <p><b>Null.</b> Where null is not said to be possible it is refused with an {@link
 * IllegalArgumentException}; nothing returns null.
 *
 * <p><b>Units.</b> Times are milliseconds as {@code int}, or a {@link Duration}; sizes are pixels;
 * positions in the media's data are bytes where the name says so.
 */
public interface MediaPlayer extends AutoCloseable {
    /**
     * Adds a listener. Allowed in every state.
     *
     * @param listener the listener; adding it again changes nothing
     * @throws IllegalArgumentException when it is null
     * @throws IllegalStateException after release
     */
    void addListener(PlayerListener listener);

    /**
     * Removes a listener; no call of it begins afterwards on this thread. Allowed in every state,
     * also after release.
     *
     * @param listener the listener; an unknown one is ignored
     */
    void removeListener(PlayerListener listener);

    /**
     * The player's state. Allowed in every state, also after release.
     *
     * @return the state
     */
    PlayerState getState();

    /**
     * Plays a file or a URL next. State: IDLE; then INITIALIZED. Opens nothing yet but a local
     * file.
     *
     * @param pathOrUrl a file's path, or a URL such as {@code http://host/film.mp4}
     * @throws IllegalArgumentException when it is null
     * @throws MediaException when it is a file that does not exist, a directory, or a URL whose
     *     scheme is not supported
     * @throws SecurityException when the file is not readable
     * @throws IllegalStateException in another state
     */
    void setDataSource(String pathOrUrl) throws IOException;

    /**
     * Plays a URL next, with headers in every request for it. State: IDLE; then INITIALIZED.
     *
     * @param url the URL
     * @param headers names and values
     * @throws IllegalArgumentException when the URL, the headers, a name or a value is null
     * @throws IOException as {@link #setDataSource(String)}
     * @throws IllegalStateException in another state
     */
    void setDataSource(String url, Map<String, String> headers) throws IOException;

    /**
     * Plays an open file next. State: IDLE; then INITIALIZED.
     *
     * @param fd an open descriptor; the player keeps a duplicate of it
     * @param offset where the media begins, in bytes
     * @param length how long it is, in bytes; more than there is means up to the end
     * @throws IllegalArgumentException when the descriptor is null
     * @throws MediaException when it is not open, or the offset or length is negative
     * @throws IllegalStateException in another state
     */
    void setDataSource(FileDescriptor fd, long offset, long length) throws IOException;

    /**
     * Plays bytes that the program produces next. State: IDLE; then INITIALIZED. The source is
     * closed at the next reset or release, or by this call when it throws. Blocks while the source
     * describes itself.
     *
     * @param source where the bytes come from
     * @throws IllegalArgumentException when it is null
     * @throws IOException when the source fails to report its size or its other properties
     * @throws IllegalStateException in another state
     */
    void setDataSource(MediaStreamSource source) throws IOException;

    /**
     * Plays a file next; as {@link #setDataSource(String)}.
     *
     * @param file the file, of the default file system
     * @throws IllegalArgumentException when it is null, or of another file system
     * @throws IOException as {@link #setDataSource(String)}
     * @throws IllegalStateException in another state than IDLE
     */
    default void setDataSource(Path file) throws IOException {
        setDataSource(SourceNames.of(file));
    }

    /**
     * Plays what a URI names next; as {@link #setDataSource(String)}.
     *
     * @param uri an absolute URI, {@code file:} included
     * @throws IllegalArgumentException when it is null or relative
     * @throws IOException as {@link #setDataSource(String)}
     * @throws IllegalStateException in another state than IDLE
     */
    default void setDataSource(URI uri) throws IOException {
        setDataSource(SourceNames.of(uri));
    }

    /**
     * Plays an open file from its start to its end next; as {@link #setDataSource(FileDescriptor,
     * long, long)}.
     *
     * @param fd an open descriptor; the player keeps a duplicate of it
     * @throws IllegalArgumentException when it is null
     * @throws MediaException when it is not open
     * @throws IllegalStateException in another state than IDLE
     */
    default void setDataSource(FileDescriptor fd) throws IOException {
        setDataSource(fd, 0, Long.MAX_VALUE);
    }

    /**
     * Declares that the next data source is raw PCM. State: IDLE, before the data source.
     *
     * @param format what the bytes mean
     * @throws IllegalArgumentException when it is null, and naming the value that is out of range
     * @throws IllegalStateException in another state
     */
    void setPcmFormat(PcmMediaInfo format);

    /**
     * Chooses where the picture is drawn. Every state. Waits for {@link #prepareAndWait()} on
     * another thread, for nothing else.
     *
     * @param surface a surface that is not released; null for no picture
     * @throws IllegalArgumentException when the surface was released or nobody consumes it; the
     *     picture stays where it was
     * @throws IllegalStateException after release
     */
    void setSurface(@Nullable Surface surface);

    /**
     * Begins to open the media. State: INITIALIZED or STOPPED; then PREPARING, and later PREPARED
     * with {@link PlayerListener#onPrepared} or ERROR with {@link PlayerListener#onError}.
     *
     * @return completed when the player is PREPARED; exceptionally with the {@link MediaException}
     *     that {@link PlayerListener#onError} reports, or with one of {@link MediaError#ABORTED}
     *     after a reset or release
     * @throws MediaException when the engine refuses at once, or reset or release came between
     * @throws IllegalStateException in another state
     */
    CompletableFuture<Void> prepareAsync() throws IOException;

    /**
     * Opens the media. State: INITIALIZED or STOPPED; then PREPARED, or ERROR when it throws.
     * Blocks until the media is open or has failed: without limit where a source of the program's
     * own blocks, otherwise as long as the engine waits for a server. Reset and release on another
     * thread end it.
     *
     * @throws MediaException when the media cannot be opened or played; {@link MediaError#ABORTED}
     *     when reset or release came between
     * @throws IllegalStateException in another state
     */
    void prepareAndWait() throws IOException;

    /**
     * Plays, from the start when the media had come to its end. State: PREPARED, STARTED, PAUSED or
     * COMPLETED; then STARTED.
     *
     * @throws IllegalStateException in another state, or when the engine refuses
     */
    void start();

    /**
     * Halts at the present position. State: STARTED, PAUSED or COMPLETED; then PAUSED, but
     * COMPLETED stays. A player that has just come to its end becomes COMPLETED.
     *
     * @throws IllegalStateException in another state, or when the engine refuses
     */
    void pause();

    /**
     * Stops; the player must be prepared again before it can play. State: PREPARED, STARTED,
     * PAUSED, COMPLETED or STOPPED; then STOPPED.
     *
     * @throws IllegalStateException in another state, or when the engine refuses
     */
    void stop();

    /**
     * Forgets the media, without waiting for it; no listener is called for it any more. State:
     * every one but RELEASED; then ERROR, and IDLE once it is done. Ends what other threads wait
     * for.
     *
     * @return completed when the player is IDLE; exceptionally with a {@link MediaException} when
     *     the engine fails, and the state stays ERROR then
     * @throws IllegalStateException after release
     */
    CompletableFuture<Void> reset();

    /**
     * Forgets the media; as {@link #reset()}, but blocks until it is done: at most 100 ms for a
     * listener that is running on another thread, and as long as a method of a {@link
     * MediaStreamSource} runs.
     *
     * @throws MediaException when the engine fails; the state stays ERROR then
     * @throws IllegalStateException after release
     */
    void resetAndWait() throws IOException;

    /**
     * Frees everything that the player holds, without waiting for it; no listener is called any
     * more. State: every one; then RELEASED. A second call does nothing.
     *
     * @return completed when everything is freed; exceptionally with an {@link
     *     IllegalStateException} when the engine fails, and the player is released all the same.
     *     A second call returns the future of the first
     */
    CompletableFuture<Void> release();

    /**
     * Frees everything that the player holds; as {@link #release()}, but blocks until it is done:
     * at most 100 ms for a listener that is running on another thread, and as long as a method of
     * a {@link MediaStreamSource} runs. Does nothing once a release has begun, also on another
     * thread; its future says when that is done.
     *
     * @throws IllegalStateException when the engine fails; the player is released all the same
     */
    @Override
    void close();

    /**
     * Goes to a key frame at or before a time. State: PREPARED, STARTED, PAUSED or COMPLETED;
     * COMPLETED becomes PAUSED or STARTED, as the engine goes on. Seeks run one after the other;
     * of several that wait only the last is carried out.
     *
     * @param millis milliseconds from the start; past the end means the end
     * @return completed with true when the picture is shown, with false when a later call took the
     *     place of this one; exceptionally with an {@link IllegalStateException} when the engine
     *     cannot seek, or after a reset or release
     * @throws IllegalArgumentException when it is negative
     * @throws IllegalStateException in another state
     */
    CompletableFuture<Boolean> seekTo(int millis);

    /**
     * Goes to a key frame at or before a time; as {@link #seekTo(int)}.
     *
     * @param time from the start, up to 24 days
     * @return as {@link #seekTo(int)}
     * @throws IllegalArgumentException when it is null, negative or longer
     * @throws IllegalStateException in another state
     */
    default CompletableFuture<Boolean> seekTo(Duration time) {
        return seekTo(Times.toMillis(time));
    }

    /**
     * Goes to a key frame at or before a time, and blocks until it is shown or the engine gives up
     * waiting for it. Every call is carried out. State: as {@link #seekTo(int)}.
     *
     * @param millis milliseconds from the start; past the end means the end
     * @throws IllegalArgumentException when it is negative
     * @throws IllegalStateException in another state, or when the engine cannot seek
     */
    void seekToAndWait(int millis);

    /**
     * Whether the media runs. Every state.
     *
     * @return true in STARTED, but not while it waits for data
     * @throws IllegalStateException after release
     */
    boolean isPlaying();

    /**
     * The position. Every state.
     *
     * @return milliseconds; 0 before the media is prepared and after it failed
     * @throws IllegalStateException after release
     */
    int getCurrentPosition();

    /**
     * The position; as {@link #getCurrentPosition()}.
     *
     * @return the time from the start
     * @throws IllegalStateException after release
     */
    default Duration position() {
        return Duration.ofMillis(getCurrentPosition());
    }

    /**
     * How long the media is. Every state.
     *
     * @return milliseconds; 0 before it is prepared, or when unknown
     * @throws IllegalStateException after release
     */
    int getDuration();

    /**
     * How long the media is; as {@link #getDuration()}.
     *
     * @return the duration; empty before the media is prepared, or when unknown
     * @throws IllegalStateException after release
     */
    default Optional<Duration> duration() {
        return Times.known(getDuration());
    }

    /**
     * How much of the media is buffered. Every state.
     *
     * @return percent, 0 to 100; 0 before it is prepared
     * @throws IllegalStateException after release
     */
    int getBufferedPercent();

    /**
     * The picture's width. Every state.
     *
     * @return pixels; 0 before it is known
     * @throws IllegalStateException after release
     */
    int getVideoWidth();

    /**
     * The picture's height. Every state.
     *
     * @return rows; 0 before it is known
     * @throws IllegalStateException after release
     */
    int getVideoHeight();

    /**
     * Chooses whether the media begins again at its end. Every state but ERROR, in which the engine
     * refuses; outlasts a reset.
     *
     * @param looping true to begin again
     * @throws IllegalStateException after release, or when the engine refuses
     */
    void setLooping(boolean looping);

    /**
     * Whether the media begins again at its end. Every state.
     *
     * @return what was last set
     * @throws IllegalStateException after release
     */
    boolean isLooping();

    /**
     * Sets the volume of both sides; as {@link AudioOutput#setVolume}.
     *
     * @param volume 0 for silence to 1 for as recorded
     * @throws IllegalArgumentException for a volume out of range
     * @throws IllegalStateException after release, or when the engine refuses
     */
    default void setVolume(float volume) {
        audio().setVolume(volume, volume);
    }

    /**
     * The volume, of the louder side; muting does not change it. Every state.
     *
     * @return 0 to 1; 1 at first
     * @throws IllegalStateException after release
     */
    default float getVolume() {
        return Math.max(audio().getLeftVolume(), audio().getRightVolume());
    }

    /**
     * Silences the sound, or has it at its volume again; as {@link AudioOutput#setMuted}.
     *
     * @param muted true for silence
     * @throws IllegalStateException after release, or when the engine refuses
     */
    default void setMuted(boolean muted) {
        audio().setMuted(muted);
    }

    /**
     * Whether the sound is muted. Every state.
     *
     * @return what was last set; false at first
     * @throws IllegalStateException after release
     */
    default boolean isMuted() {
        return audio().isMuted();
    }

    /**
     * The media's tracks, chapters and metadata.
     *
     * @return the same object always
     */
    Tracks tracks();

    /**
     * Subtitles on the picture: files to add, and their look.
     *
     * @return the same object always
     */
    Subtitles subtitles();

    /**
     * Thumbnails and embedded pictures.
     *
     * @return the same object always
     */
    Pictures pictures();

    /**
     * Speeds, single steps, repeated sections and byte positions.
     *
     * @return the same object always
     */
    TrickPlay trickPlay();

    /**
     * Volume, session and effects of the sound.
     *
     * @return the same object always
     */
    AudioOutput audio();
}
