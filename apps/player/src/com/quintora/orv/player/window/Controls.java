// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import com.quintora.orv.player.Fact;
import com.quintora.orv.player.playlist.Playlist;
import com.quintora.orv.player.playlist.Repeat;
import java.awt.Component;
import java.util.List;
import java.util.function.Consumer;

/** What the window's buttons and keys do. Called on the window's thread; none blocks. */
interface Controls {
    void togglePlaying();

    /** Moves by milliseconds, negative for back. */
    void skip(int millis);

    void seekTo(int millis);

    /** To the next chapter's start, or back when negative. */
    void changeChapter(int steps);

    void chooseChapter(Component above);

    /** Begins a section to repeat at the present place. */
    void repeatFromHere();

    /** Ends it at the present place, and repeats it. */
    void repeatUntilHere();

    void repeatNothing();

    /** Shows one frame more, or the one before. */
    void step(int frames);

    /** Writes the picture that shows to a file. */
    void keepPicture(boolean withSubtitles);

    /** From 0 to 1. */
    void setVolume(double level);

    void changeVolume(double by);

    void toggleMuted();

    /** To the next of the offered speeds, or the one before. */
    void changeSpeed(int steps);

    /** Times the normal speed. */
    void setSpeed(double speed);

    void chooseSpeed(Component above);

    void chooseAudio(Component above);

    void chooseSubtitles(Component above);

    /** How subtitles look. */
    SubtitleTuning subtitleTuning();

    /** Moves subtitles in time by milliseconds, negative for earlier. */
    void shiftSubtitles(int byMillis);

    void toggleSubtitlePanel();

    void toggleLog();

    void toggleInformation();

    /** Shows or hides where a PIN is entered. */
    void toggleLock();

    /** Reads what is known of what plays; answers later, unless that is not open yet. */
    void readFacts(Consumer<List<Fact>> answer);

    /** Unlocks media that parents locked; the answer is whether that was the PIN. */
    void unlock(int pin, Consumer<Boolean> answer);

    /** Asks for a file of subtitles for what plays. */
    void addSubtitleFile();

    /** Adds the subtitles of a file to what plays. */
    void addSubtitles(String path);

    /** Plays the media at that place of the list, counted from 0. */
    void play(int place);

    void next();

    void previous();

    /** Plays these instead of the list: media, folders, playlists, by paths or URLs. */
    void open(List<String> sources);

    /** Adds these to the list. */
    void add(List<String> sources);

    /** Takes the media at that place out of the list. */
    void remove(int place);

    void toggleShuffled();

    void setRepeat(Repeat repeat);

    /** To the next way of repeating. */
    void changeRepeat();

    /** What is played; not to be changed but by these methods. */
    Playlist list();

    void toggleList();

    /** Asks for files, folders or playlists to be played. */
    void chooseFiles();

    /** Offers what was played before. */
    void chooseRecent(Component above);

    /** Goes to where the media was left last time. */
    void goOn();

    /** Asks for an address to be played. */
    void chooseAddress();

    void openMenu();

    void toggleFullScreen();

    void setFullScreen(boolean fills);

    /** Brings the window before others. */
    void raise();

    /** Closes the list of keys, or else the panel, or else leaves the full screen. */
    void leave();

    void toggleHelp();

    /** Shows a few words for a moment. */
    void tell(String words);

    void quit();
}
