// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import com.quintora.orv.player.Snapshot;
import com.quintora.orv.player.Times;
import java.awt.BorderLayout;
import java.awt.Component;
import java.awt.event.MouseAdapter;
import java.awt.event.MouseEvent;
import javax.swing.Box;
import javax.swing.JLabel;
import javax.swing.JPanel;

/** The row of controls under the picture. */
final class ControlBar extends JPanel {
    /** How much a key or a click on a button changes the volume. */
    static final double VOLUME_STEP = 0.05;

    private static final int SKIP_MS = 10_000;

    private final JLabel elapsed = label(Times.clock(0));
    private final JLabel total = label(Times.length(0));
    private Snapshot shown;
    private boolean remaining;
    private final SeekBar seekBar;
    private final FlatButton play;
    private final FlatButton previous;
    private final FlatButton next;
    private final FlatButton back;
    private final FlatButton forward;
    private final FlatButton mute;
    private final LevelBar volume;
    private final FlatButton speed;
    private final FlatButton audio;
    private final FlatButton subtitles;
    private final FlatButton list;
    private final FlatButton menu;
    private final FlatButton help;
    private final FlatButton fullScreen;

    ControlBar(Controls controls) {
        super(new BorderLayout(0, Theme.px(4)));
        seekBar = new SeekBar(controls::seekTo, step -> controls.skip(step * SKIP_MS));
        play = new FlatButton(Glyph.PLAY, "Play (Space)", controls::togglePlaying);
        previous = new FlatButton(Glyph.PREVIOUS, "Previous one (P)", controls::previous);
        next = new FlatButton(Glyph.NEXT, "Next one (N)", controls::next);
        back =
                new FlatButton(
                        Glyph.BACK, "Back 10 seconds (Left)", () -> controls.skip(-SKIP_MS));
        forward =
                new FlatButton(
                        Glyph.FORWARD, "Forward 10 seconds (Right)", () -> controls.skip(SKIP_MS));
        mute = new FlatButton(Glyph.VOLUME, "Mute (M)", controls::toggleMuted);
        volume =
                new LevelBar(
                        "Volume",
                        90,
                        controls::setVolume,
                        step -> controls.changeVolume(step * VOLUME_STEP));
        volume.setToolTipText("Volume (Up, Down)");
        speed = new FlatButton(null, "Speed ([ ])", () -> controls.chooseSpeed(speedButton()));
        audio =
                new FlatButton(
                        Glyph.AUDIO,
                        "Audio track (A)",
                        () -> controls.chooseAudio(audioButton()));
        subtitles =
                new FlatButton(
                        Glyph.SUBTITLES,
                        "Subtitles (S)",
                        () -> controls.chooseSubtitles(subtitlesButton()));
        fullScreen =
                new FlatButton(
                        Glyph.FULL_SCREEN, "Full screen (F)", controls::toggleFullScreen);
        list = new FlatButton(Glyph.LIST, "Playlist (L)", controls::toggleList);
        menu = new FlatButton(Glyph.MENU, "Menu (F10)", controls::openMenu);
        help = new FlatButton(null, "Keyboard shortcuts (H)", controls::toggleHelp);
        help.setText("?");
        speed.setText(Speeds.label(1));
        total.setToolTipText("Length");
        total.addMouseListener(
                new MouseAdapter() {
                    @Override
                    public void mousePressed(MouseEvent event) {
                        toggleRemaining();
                    }
                });
        setBackground(Theme.PANEL);
        setBorder(Theme.border(8, 14, 10, 14));
        add(timeRow(), BorderLayout.NORTH);
        add(buttonRow(), BorderLayout.CENTER);
    }

    Component audioButton() {
        return audio;
    }

    Component subtitlesButton() {
        return subtitles;
    }

    Component listButton() {
        return list;
    }

    Component menuButton() {
        return menu;
    }

    Component speedButton() {
        return speed;
    }

    SeekBar seekBar() {
        return seekBar;
    }

    void show(Snapshot now) {
        elapsed.setText(Times.clock(now.positionMs()));
        shown = now;
        showTotal();
        seekBar.showPosition(now.positionMs(), now.durationMs(), now.bufferedPercent());
        play.show(
                now.playing() ? Glyph.PAUSE : Glyph.PLAY,
                now.playing() ? "Pause (Space)" : "Play (Space)");
        speed.setText(Speeds.label(now.speed()));
    }

    private void showTotal() {
        int length = shown == null ? 0 : shown.durationMs();
        total.setText(
                remaining && length > 0
                        ? "−" + Times.clock(length - shown.positionMs())
                        : Times.length(length));
    }

    /** Whether the time that remains stands where the length would. */
    boolean showsRemaining() {
        return remaining;
    }

    void toggleRemaining() {
        remaining = !remaining;
        total.setToolTipText(remaining ? "Time that remains" : "Length");
        showTotal();
    }

    void showVolume(double level, boolean muted) {
        volume.showLevel(muted ? 0 : level, 0);
        mute.show(
                muted || level == 0 ? Glyph.MUTED : Glyph.VOLUME,
                muted ? "Unmute (M)" : "Mute (M)");
    }

    void showTracks(int audioTracks, int subtitleTracks) {
        audio.setEnabled(audioTracks > 0);
        subtitles.setEnabled(subtitleTracks > 0);
    }

    /** Leaves only what works without media. */
    void showNothingToPlay() {
        setUsable(false);
        showTracks(0, 0);
    }

    void showSomethingToPlay() {
        setUsable(true);
    }

    private void setUsable(boolean isUsable) {
        for (Component control : new Component[] {play, back, forward, seekBar, speed}) {
            control.setEnabled(isUsable);
        }
    }

    /** Whether there is more than one to choose from. */
    void showPlaces(boolean areSeveral) {
        previous.setVisible(areSeveral);
        next.setVisible(areSeveral);
    }

    void showFullScreen(boolean on) {
        fullScreen.show(
                on ? Glyph.WINDOWED : Glyph.FULL_SCREEN,
                on ? "Leave full screen (F)" : "Full screen (F)");
    }

    private JPanel timeRow() {
        JPanel row = new JPanel(new BorderLayout(Theme.gap(), 0));
        row.setOpaque(false);
        row.add(elapsed, BorderLayout.WEST);
        row.add(seekBar, BorderLayout.CENTER);
        row.add(total, BorderLayout.EAST);
        return row;
    }

    private Component buttonRow() {
        Box row = Box.createHorizontalBox();
        row.add(previous);
        row.add(play);
        row.add(next);
        row.add(back);
        row.add(forward);
        row.add(Box.createHorizontalStrut(Theme.gap()));
        row.add(mute);
        volume.setMaximumSize(volume.getPreferredSize());
        row.add(volume);
        row.add(Box.createHorizontalGlue());
        row.add(speed);
        row.add(audio);
        row.add(subtitles);
        row.add(list);
        row.add(menu);
        row.add(help);
        row.add(fullScreen);
        return row;
    }

    private static JLabel label(String text) {
        JLabel label = new JLabel(text);
        label.setFont(Theme.small());
        label.setForeground(Theme.MUTED);
        return label;
    }
}
