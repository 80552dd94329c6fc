// SPDX-License-Identifier: Apache-2.0

/**
 * Plays audio and video: {@link com.quintora.mmp.MediaPlayer} is what a program asks for, {@link
 * com.quintora.mmp.OrvMediaPlayer} the class that plays.
 *
 * <h2>A first program</h2>
 *
 * <pre>{@code
 * try (MediaPlayer player = new OrvMediaPlayer()) {
 *     player.setDataSource(Path.of("/media/song.flac"));
 *     player.prepareAndWait();
 *     player.start();
 *     while (player.getState() == PlayerState.STARTED) {
 *         Thread.sleep(200);
 *     }
 * }
 * }</pre>
 *
 * <h2>The life of a player</h2>
 *
 * <p>A player stands in one {@link com.quintora.mmp.PlayerState}. Its methods and what happens to
 * its media lead from one to the next:
 *
 * <p><img src="doc-files/states.svg" alt="A data source leads from IDLE to INITIALIZED, preparing
 * over PREPARING to PREPARED, start to STARTED; from there pause to PAUSED, the end of the media
 * to COMPLETED, stop to STOPPED, a failure to ERROR.">
 *
 * <p>One player plays any number of media, one after the other: {@link
 * com.quintora.mmp.MediaPlayer#reset()} makes it {@link com.quintora.mmp.PlayerState#IDLE} from
 * every state but the last, after a failure, too. {@link
 * com.quintora.mmp.MediaPlayer#release()} or {@link com.quintora.mmp.MediaPlayer#close()} end it.
 * A method that the state does not allow throws {@link java.lang.IllegalStateException}.
 *
 * <p>What goes beyond playing stands in parts of the player: {@link com.quintora.mmp.Tracks},
 * {@link com.quintora.mmp.Subtitles}, {@link com.quintora.mmp.Pictures}, {@link
 * com.quintora.mmp.TrickPlay} and {@link com.quintora.mmp.AudioOutput}. They live as long as it
 * does, and each of its media shows through the same objects.
 *
 * <h2>Threads</h2>
 *
 * <p>Any thread may call any method at any time. What takes its time has two forms: one returns at
 * once with a {@link java.util.concurrent.CompletableFuture}, which is completed on a thread of the
 * library; the other, whose name ends in {@code AndWait}, blocks and says for how long at most. A
 * thread that must not wait, such as that of a user interface, calls the first form, and {@link
 * com.quintora.mmp.MediaPlayer#release()} in place of {@link
 * com.quintora.mmp.MediaPlayer#close()}. A reset or a release on another thread ends whatever
 * waits.
 *
 * <h2>Events</h2>
 *
 * <p>A {@link com.quintora.mmp.PlayerListener} receives each event once, in order, one call at a
 * time: on a thread of the player's own, or by the executor that the player was made with, such as
 * {@code SwingUtilities::invokeLater}. It may call the player. After a reset no event of the old
 * media arrives any more.
 *
 * <p>A failure has one way to the program: thrown by the call that waits, or by the future that it
 * completes, or, when it meets the media while they play, by {@link
 * com.quintora.mmp.PlayerListener#onError}. It is a {@link com.quintora.mmp.MediaException}, whose
 * {@link com.quintora.mmp.MediaError} says what kind of failure it is, and what can be done.
 *
 * <h2>Surfaces</h2>
 *
 * <p>The picture is drawn on an {@link android.view.Surface}, which may be set and changed in every
 * state; without one the sound plays alone. On a television a surface is the platform's. On the
 * desktop it is that of an {@link android.view.SurfaceView} in a window, or of a {@link
 * com.quintora.mmp.desktop.FrameReader}, which lends the program each frame. The player does not
 * own the surface: the program releases it, and sets another or null before.
 *
 * <h2>Streams of a program's own</h2>
 *
 * <p>Where media are neither a file nor at a URL, the engine reads them from a {@link
 * com.quintora.mmp.MediaStreamSource}; {@link com.quintora.mmp.ChannelStreamSource} is the one for
 * channels.
 *
 * <p><img src="doc-files/stream.svg" alt="The program sets the source. The player asks it to
 * describe itself, cancels and closes it; the engine's threads read and seek, one call at a
 * time.">
 *
 * <p>A read may block, a cancel must not; none of the source's methods may call the player, since
 * reset and release wait for the one that runs. A player with such a source is never collected: its
 * owner releases it.
 */
package com.quintora.mmp;
