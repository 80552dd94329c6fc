// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import com.quintora.orv.player.playlist.Repeat;
import java.util.List;

/** All that the window does: the keys, the list of keys and the menu are made from this. */
final class WindowActions {
    private WindowActions() {}

    /** Menus of choices open above the bar's buttons. */
    static List<ActionGroup> of(Controls controls, ControlBar bar) {
        return List.of(
                playback(controls, bar),
                place(controls, bar),
                section(controls),
                tracks(controls, bar),
                list(controls, bar),
                pictures(controls),
                window(controls, bar));
    }

    private static ActionGroup playback(Controls controls, ControlBar bar) {
        return new ActionGroup("Playback")
                .add("Play or pause", controls::togglePlaying, "SPACE", "K")
                .add("Slower", () -> controls.changeSpeed(-1), "OPEN_BRACKET")
                .add("Faster", () -> controls.changeSpeed(1), "CLOSE_BRACKET")
                .add("Speed…", () -> controls.chooseSpeed(bar.speedButton()))
                .add("Previous frame", () -> controls.step(-1), "COMMA")
                .add("Next frame", () -> controls.step(1), "PERIOD");
    }

    private static ActionGroup section(Controls controls) {
        return new ActionGroup("Repeat a section")
                .add("Begin it here", controls::repeatFromHere, "shift A")
                .add("End it here, and repeat it", controls::repeatUntilHere, "shift B")
                .add("Repeat it no more", controls::repeatNothing, "BACK_SPACE");
    }

    private static ActionGroup place(Controls controls, ControlBar bar) {
        return new ActionGroup("Go to")
                .add("10 seconds back", () -> controls.skip(-10_000), "LEFT")
                .add("10 seconds forward", () -> controls.skip(10_000), "RIGHT")
                .add("1 second back", () -> controls.skip(-1_000), "shift LEFT")
                .add("1 second forward", () -> controls.skip(1_000), "shift RIGHT")
                .add("1 minute back", () -> controls.skip(-60_000), "PAGE_UP")
                .add("1 minute forward", () -> controls.skip(60_000), "PAGE_DOWN")
                .add("Next chapter", () -> controls.changeChapter(1), "shift N")
                .add("Previous chapter", () -> controls.changeChapter(-1), "shift P")
                .add("Chapters…", () -> controls.chooseChapter(bar.menuButton()), "C")
                .add("The start", () -> controls.seekTo(0), "HOME")
                .add("Where it was left", controls::goOn, "ENTER");
    }

    private static ActionGroup tracks(Controls controls, ControlBar bar) {
        return new ActionGroup("Sound and subtitles")
                .add("Volume up", () -> controls.changeVolume(ControlBar.VOLUME_STEP), "UP")
                .add("Volume down", () -> controls.changeVolume(-ControlBar.VOLUME_STEP), "DOWN")
                .add("Mute or unmute", controls::toggleMuted, "M")
                .add("Audio track…", () -> controls.chooseAudio(bar.audioButton()), "A")
                .add("Subtitles…", () -> controls.chooseSubtitles(bar.subtitlesButton()), "S")
                .add("Subtitles earlier", () -> controls.shiftSubtitles(-100), "shift X")
                .add("Subtitles later", () -> controls.shiftSubtitles(100), "X")
                .add("Add a subtitle file…", controls::addSubtitleFile, "shift T")
                .add("How subtitles look", controls::toggleSubtitlePanel, "T");
    }

    private static ActionGroup list(Controls controls, ControlBar bar) {
        return new ActionGroup("Playlist")
                .add("Open files…", controls::chooseFiles, "O")
                .add("Open an address…", controls::chooseAddress, "U")
                .add("Recent files…", () -> controls.chooseRecent(bar.listButton()), "shift O")
                .add("Next one", controls::next, "N")
                .add("Previous one", controls::previous, "P")
                .addSwitch(
                        "Shuffle", () -> controls.list().isShuffled(), controls::toggleShuffled,
                        "Z")
                .addSwitch(
                        "Repeat one, all or nothing",
                        () -> controls.list().repeat() != Repeat.OFF,
                        controls::changeRepeat,
                        "R")
                .add("Show or hide the playlist", controls::toggleList, "L");
    }

    private static ActionGroup pictures(Controls controls) {
        return new ActionGroup("Screenshot")
                .add("With subtitles", () -> controls.keepPicture(true), "shift S")
                .add("Without subtitles", () -> controls.keepPicture(false), "control S");
    }

    private static ActionGroup window(Controls controls, ControlBar bar) {
        return new ActionGroup("Window")
                .addSwitch(
                        "Time that remains", bar::showsRemaining, bar::toggleRemaining)
                .add("Information", controls::toggleInformation, "I")
                .add("Log", controls::toggleLog, "G")
                .add("Parental lock…", controls::toggleLock, "shift L")
                .add("Full screen", controls::toggleFullScreen, "F", "F11")
                .add("Close what is open, leave full screen", controls::leave, "ESCAPE")
                .add("Menu", controls::openMenu, "F10")
                .add("Keyboard shortcuts", controls::toggleHelp, "H", "typed ?", "F1")
                .add("Close the window", controls::quit, "Q");
    }
}
