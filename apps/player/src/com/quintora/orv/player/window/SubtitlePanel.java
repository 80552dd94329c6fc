// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import com.quintora.orv.player.subtitles.Side;
import com.quintora.orv.player.subtitles.SubtitleLook;
import java.awt.BorderLayout;
import java.awt.Color;
import java.awt.Dimension;
import java.awt.GridBagConstraints;
import java.awt.GridBagLayout;
import java.awt.Insets;
import javax.swing.JComponent;
import javax.swing.JLabel;
import javax.swing.JPanel;

/** Which subtitles there are, when they come and how they look; each change is seen at once. */
final class SubtitlePanel extends SidePanel {
    private static final int WIDTH = 300;
    private static final int DELAY_STEP_MS = 100;
    private static final int LIFT_STEP = 5;

    private final Controls controls;
    private final SubtitleTuning tuning;
    private final JPanel rows = new JPanel(new GridBagLayout());
    private final FlatButton track;
    private final Stepper delay;
    private final Stepper size;
    private final Stepper lift;
    private final ChoiceRow<Integer> text;
    private final ChoiceRow<Integer> edge;
    private final ChoiceRow<Integer> ground;
    private final ChoiceRow<Side> side;

    SubtitlePanel(Controls controls) {
        super("Subtitles", new BorderLayout());
        this.controls = controls;
        tuning = controls.subtitleTuning();
        track = button("Choose…", "Choose subtitles (S)", this::chooseTrack);
        delay =
                new Stepper(
                        "Delay of subtitles", "Subtitles earlier", "Subtitles later",
                        step -> tuning.shift(step * DELAY_STEP_MS));
        size =
                new Stepper(
                        "Size of letters", "Smaller letters", "Larger letters",
                        step -> tuning.change(look -> look.withSize(look.size().plus(step))));
        lift =
                new Stepper(
                        "Height of subtitles", "Subtitles lower", "Subtitles higher",
                        step ->
                                tuning.change(
                                        look -> look.withLift(look.lift() + step * LIFT_STEP)));
        text = textColors();
        edge = edgeColors();
        ground = grounds();
        side = sides();
        arrange();
        tuning.watch(this::showLook);
        showLook();
    }

    private static FlatButton button(String text, String tip, Runnable action) {
        FlatButton button = new FlatButton(null, tip, action);
        button.setText(text);
        return button;
    }

    private void chooseTrack() {
        controls.chooseSubtitles(track);
    }

    private ChoiceRow<Integer> textColors() {
        var row =
                new ChoiceRow<Integer>(
                        "Colour of letters",
                        color -> tuning.change(look -> look.withTextColor(color)));
        return colors(row, "White", 0xFFFFFFFF, "Yellow", 0xFFFFE040, "Green", 0xFF60E060,
                "Cyan", 0xFF50E0F0, "Red", 0xFFFF5050, "Grey", 0xFFB0B0B0);
    }

    private ChoiceRow<Integer> edgeColors() {
        var row =
                new ChoiceRow<Integer>(
                        "Edge of letters",
                        color -> tuning.change(look -> look.withEdgeColor(color)));
        return colors(row, "None", 0, "Black", 0xFF000000, "White", 0xFFFFFFFF, "Blue",
                0xFF2040C0, "Red", 0xFFC02020);
    }

    private ChoiceRow<Integer> grounds() {
        var row =
                new ChoiceRow<Integer>(
                        "Background of subtitles",
                        color -> tuning.change(look -> look.withGroundColor(color)));
        return colors(row, "None", 0, "Shade", 0x90000000, "Black", 0xFF000000, "Blue",
                0xFF102060);
    }

    private static ChoiceRow<Integer> colors(ChoiceRow<Integer> row, Object... pairs) {
        for (int i = 0; i < pairs.length; i += 2) {
            int argb = (Integer) pairs[i + 1];
            row.add((String) pairs[i], new Color(argb, true), argb);
        }
        return row;
    }

    private ChoiceRow<Side> sides() {
        var row =
                new ChoiceRow<Side>(
                        "Place of subtitles",
                        side -> tuning.change(look -> look.withSide(side)));
        for (Side value : Side.values()) {
            row.add(value.label(), null, value);
        }
        return row;
    }

    private void arrange() {
        rows.setOpaque(false);
        rows.setBorder(Theme.border(0, 14, 8, 8));
        addRow("Track", track);
        addRow("From a file", button("Add…", "Add a subtitle file", controls::addSubtitleFile));
        addRow("Delay", delay);
        addRow("Size", size);
        addRow("Colour", text);
        addRow("Edge", edge);
        addRow("Background", ground);
        addRow("Height", lift);
        addRow("Place", side);
        addRow("", button("As usual", "Subtitles as usual", this::reset));
        GridBagConstraints rest = new GridBagConstraints();
        rest.gridy = rows.getComponentCount();
        rest.weighty = 1;
        rows.add(new JLabel(), rest);
        FollowFocus.in(rows);
        add(new DarkScroll(rows), BorderLayout.CENTER);
    }

    private void addRow(String name, JComponent control) {
        JLabel label = new JLabel(name);
        label.setFont(Theme.body());
        label.setForeground(Theme.MUTED);
        label.setLabelFor(control);
        int row = rows.getComponentCount() / 2;
        rows.add(label, at(0, row, GridBagConstraints.WEST));
        GridBagConstraints place = at(1, row, GridBagConstraints.EAST);
        place.weightx = 1;
        rows.add(control, place);
    }

    private static GridBagConstraints at(int column, int row, int anchor) {
        var place = new GridBagConstraints();
        place.gridx = column;
        place.gridy = row;
        place.anchor = anchor;
        place.insets = new Insets(Theme.px(2), 0, Theme.px(2), Theme.px(4));
        return place;
    }

    private void reset() {
        tuning.change(look -> SubtitleLook.USUAL);
    }

    private void showLook() {
        SubtitleLook look = tuning.look();
        delay.show(SubtitleTuning.delay(look.delayMs()));
        size.show(look.size().label());
        text.show(look.textColor());
        edge.show(look.edgeColor());
        ground.show(look.groundColor());
        lift.show(look.lift() + " %");
        side.show(look.side());
    }

    @Override
    public Dimension getPreferredSize() {
        return new Dimension(Theme.px(WIDTH), super.getPreferredSize().height);
    }

    @Override
    void onOpen() {
        track.requestFocusInWindow();
    }
}
