// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import java.awt.Color;
import java.awt.Dimension;
import java.awt.Font;
import java.awt.Graphics;
import java.awt.GridBagConstraints;
import java.awt.GridBagLayout;
import java.awt.Insets;
import java.awt.event.ComponentAdapter;
import java.awt.event.ComponentEvent;
import java.awt.event.MouseAdapter;
import java.awt.event.MouseEvent;
import java.util.ArrayList;
import java.util.List;
import javax.swing.Box;
import javax.swing.BoxLayout;
import javax.swing.JComponent;
import javax.swing.JLabel;
import javax.swing.JPanel;
import javax.swing.JScrollPane;

/**
 * The list of the window's keys, over everything else until a key or a click ends it: in as many
 * columns as it needs to be seen whole, if the window is wide enough.
 */
final class Help extends JPanel {
    private static final Color SHADE = new Color(0, 0, 0, 150);
    private static final int MOST_COLUMNS = 4;
    private static final int MARGIN = 8;

    private List<ActionGroup> groups = List.of();

    Help() {
        super(new GridBagLayout());
        setOpaque(false);
        getAccessibleContext().setAccessibleName("Keyboard shortcuts");
        addMouseListener(
                new MouseAdapter() {
                    @Override
                    public void mousePressed(MouseEvent event) {
                        setVisible(false);
                    }
                });
        addComponentListener(
                new ComponentAdapter() {
                    @Override
                    public void componentShown(ComponentEvent event) {
                        arrange();
                    }

                    @Override
                    public void componentResized(ComponentEvent event) {
                        arrange();
                    }
                });
    }

    void list(List<ActionGroup> groups) {
        this.groups = groups;
    }

    private void arrange() {
        if (!isVisible()) {
            return;
        }
        JComponent card = cardOf(1);
        for (int columns = 2; columns <= MOST_COLUMNS && isTooHigh(card); columns++) {
            JComponent wider = cardOf(columns);
            if (wider.getPreferredSize().width > room().width) {
                break;
            }
            card = wider;
        }
        removeAll();
        add(scrolling(card));
        revalidate();
        repaint();
    }

    private boolean isTooHigh(JComponent card) {
        return card.getPreferredSize().height > room().height;
    }

    private Dimension room() {
        return new Dimension(getWidth() - 2 * Theme.px(MARGIN), getHeight() - 2 * Theme.px(MARGIN));
    }

    // In a small window not all of it is seen at a time.
    private JScrollPane scrolling(JComponent card) {
        Dimension size = card.getPreferredSize();
        JScrollPane pane = new DarkScroll(card);
        boolean isCut = isTooHigh(card);
        pane.setPreferredSize(
                new Dimension(
                        Math.min(size.width + (isCut ? DarkScroll.bar() : 0), room().width),
                        Math.min(size.height, room().height)));
        return pane;
    }

    private JComponent cardOf(int columns) {
        JPanel card = new Card(new GridBagLayout());
        card.setBorder(Theme.border(14, 22, 14, 8));
        int column = 0;
        for (List<ActionGroup> part : spread(columns)) {
            JPanel list = new JPanel();
            list.setLayout(new BoxLayout(list, BoxLayout.Y_AXIS));
            list.setOpaque(false);
            part.forEach(group -> list.add(listOf(group)));
            list.add(Box.createVerticalGlue());
            card.add(list, at(column, 0, 18));
            column++;
        }
        return card;
    }

    /** The groups in their order, in columns of about the same height. */
    private List<List<ActionGroup>> spread(int columns) {
        int rows = groups.stream().mapToInt(Help::rows).sum();
        List<List<ActionGroup>> parts = new ArrayList<>();
        parts.add(new ArrayList<>());
        int before = 0;
        for (ActionGroup group : groups) {
            int middle = before + rows(group) / 2;
            if (parts.size() < columns && middle * columns >= rows * parts.size()) {
                parts.add(new ArrayList<>());
            }
            parts.get(parts.size() - 1).add(group);
            before += rows(group);
        }
        return parts;
    }

    private static int rows(ActionGroup group) {
        return 2 + (int) group.actions().stream().filter(Help::hasKeys).count();
    }

    private static boolean hasKeys(Action action) {
        return !action.keys().isEmpty();
    }

    private static JPanel listOf(ActionGroup group) {
        JPanel list = new JPanel(new GridBagLayout());
        list.setOpaque(false);
        list.setAlignmentX(LEFT_ALIGNMENT);
        list.setBorder(Theme.border(0, 0, 10, 0));
        JLabel heading = label(group.name(), Theme.small());
        heading.setForeground(Theme.ACCENT);
        list.add(heading, at(0, 0, 14));
        int row = 1;
        for (Action action : group.actions().stream().filter(Help::hasKeys).toList()) {
            JLabel keys = label(action.keyNames(), Theme.body().deriveFont(Font.BOLD));
            JLabel name = label(action.name(), Theme.body());
            keys.setLabelFor(name);
            list.add(keys, at(0, row, 14));
            list.add(name, at(1, row, 0));
            row++;
        }
        GridBagConstraints rest = at(2, row, 0);
        rest.weightx = 1;
        list.add(Box.createHorizontalGlue(), rest);
        return list;
    }

    private static JLabel label(String text, Font font) {
        JLabel label = new JLabel(text);
        label.setFont(font);
        label.setForeground(Theme.TEXT);
        return label;
    }

    private static GridBagConstraints at(int column, int row, int gap) {
        var place = new GridBagConstraints();
        place.gridx = column;
        place.gridy = row;
        place.anchor = GridBagConstraints.NORTHWEST;
        place.insets = new Insets(0, 0, Theme.px(1), Theme.px(gap));
        return place;
    }

    @Override
    protected void paintComponent(Graphics g) {
        g.setColor(SHADE);
        g.fillRect(0, 0, getWidth(), getHeight());
    }
}
