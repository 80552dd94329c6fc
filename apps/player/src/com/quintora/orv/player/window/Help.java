// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import java.awt.Color;
import java.awt.Font;
import java.awt.Graphics;
import java.awt.GridBagConstraints;
import java.awt.GridBagLayout;
import java.awt.Insets;
import java.awt.event.MouseAdapter;
import java.awt.event.MouseEvent;
import java.util.List;
import javax.swing.BorderFactory;
import javax.swing.JComponent;
import javax.swing.JLabel;
import javax.swing.JPanel;

/** The list of the window's keys, over everything else until a key or a click ends it. */
final class Help extends JPanel {
    /** A line of it: keys as they are written on a keyboard, and what they do. */
    record Line(String keys, String meaning) {}

    private static final Color SHADE = new Color(0, 0, 0, 150);

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
    }

    void list(List<Line> lines) {
        JPanel card = new Card(new GridBagLayout());
        card.setBorder(BorderFactory.createEmptyBorder(14, 22, 14, 26));
        for (int row = 0; row < lines.size(); row++) {
            JLabel keys = label(lines.get(row).keys(), Theme.BODY.deriveFont(Font.BOLD));
            JLabel meaning = label(lines.get(row).meaning(), Theme.BODY);
            keys.setLabelFor(meaning);
            card.add(keys, at(0, row, 28));
            card.add(meaning, at(1, row, 0));
        }
        removeAll();
        add(card);
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
        place.anchor = GridBagConstraints.WEST;
        place.insets = new Insets(0, 0, 1, gap);
        return place;
    }

    @Override
    protected void paintComponent(Graphics g) {
        g.setColor(SHADE);
        g.fillRect(0, 0, getWidth(), getHeight());
    }
}
