// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import java.awt.BorderLayout;
import java.awt.Color;
import java.awt.Dimension;
import java.awt.Graphics;
import java.awt.GridBagLayout;
import javax.swing.JComponent;
import javax.swing.JLabel;
import javax.swing.JPanel;
import javax.swing.JTextArea;

/** What the window says in place of a picture: why it cannot play, or what it waits for. */
final class MessagePanel extends JPanel {
    private static final int TEXT_WIDTH = 420;
    private static final int SIGN = 44;

    private final JLabel title = new JLabel();
    private final JTextArea text = new JTextArea();
    private final JPanel wayOn = new JPanel(new BorderLayout());
    private final JComponent sign = new Sign();
    private Glyph glyph = Glyph.ALERT;
    private Color color = Theme.ALERT;

    /** Offers to open something else, where that is the way on. */
    MessagePanel(Runnable open) {
        super(new GridBagLayout());
        setBackground(Theme.STAGE);
        // The media's own words are never markup.
        title.putClientProperty("html.disable", true);
        title.setFont(Theme.title());
        title.setForeground(Theme.TEXT);
        text.setFont(Theme.body(14));
        text.setForeground(Theme.MUTED);
        text.setOpaque(false);
        text.setEditable(false);
        text.setFocusable(false);
        text.setLineWrap(true);
        text.setWrapStyleWord(true);
        JPanel words = new JPanel(new BorderLayout(0, Theme.gap()));
        words.setOpaque(false);
        words.add(title, BorderLayout.NORTH);
        words.add(text, BorderLayout.CENTER);
        words.add(wayOn, BorderLayout.SOUTH);
        FlatButton button = new FlatButton(null, "Open other files (O)", open);
        button.setText("Open other files…");
        button.setForeground(Theme.ACCENT);
        wayOn.setOpaque(false);
        wayOn.add(button, BorderLayout.WEST);
        JPanel card = new Card(new BorderLayout(Theme.px(20), 0));
        card.setBorder(Theme.border(24, 24, 24, 28));
        card.add(sign, BorderLayout.WEST);
        card.add(words, BorderLayout.CENTER);
        add(card);
    }

    /** Offers a way on, too, or not. */
    void tell(Glyph glyph, Color color, String title, String text, boolean offers) {
        wayOn.setVisible(offers);
        this.glyph = glyph;
        this.color = color;
        this.title.setText(title);
        // Whole addresses are cut off at the end.
        int width = Theme.px(TEXT_WIDTH);
        this.title.setPreferredSize(null);
        Dimension whole = this.title.getPreferredSize();
        this.title.setPreferredSize(
                new Dimension(Math.min(whole.width, width), whole.height));
        this.text.setText(text);
        // A text area knows its height only once its width is set.
        this.text.setSize(width, Short.MAX_VALUE);
        this.text.setPreferredSize(
                new Dimension(width, this.text.getUI().getPreferredSize(this.text).height));
        revalidate();
        repaint();
    }

    private final class Sign extends JComponent {
        Sign() {
            setPreferredSize(Theme.size(SIGN, SIGN));
        }

        @Override
        protected void paintComponent(Graphics graphics) {
            var g = Theme.smooth(graphics);
            glyph.paint(g, 0, 0, Theme.px(SIGN), color);
            g.dispose();
        }
    }
}
