// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import com.quintora.orv.player.Ellipsis;
import com.quintora.orv.player.ReadingOrder;
import java.awt.CardLayout;
import java.awt.Color;
import java.awt.Component;
import java.awt.Graphics;
import java.awt.Graphics2D;
import javax.accessibility.AccessibleContext;
import javax.accessibility.AccessibleRole;
import javax.swing.JPanel;
import javax.swing.Timer;

/** Shows one of its components, and for a moment a few words on it. */
final class NoticePane extends JPanel {
    private static final int NOTICE_MS = 1_200;
    private static final int LONG_NOTICE_MS = 6_000;
    private static final int PLACE = 20;

    private final CardLayout cards = new CardLayout();
    private final Timer noticeEnd = new Timer(NOTICE_MS, event -> setNotice(""));
    private String notice = "";
    private String lasting = "";
    private Component cover;
    private WordsWindow wordsOnCover;

    NoticePane() {
        setLayout(cards);
        noticeEnd.setRepeats(false);
    }

    /** Shows the component that was added under that name. */
    void show(String name) {
        cards.show(this, name);
    }

    /** While that component shows, which nothing can be painted on, words lie over it. */
    void writeOver(Component heavy) {
        cover = heavy;
        wordsOnCover = new WordsWindow(heavy);
    }

    /** Writes a few words onto what is shown. */
    void tell(String words) {
        tell(words, NOTICE_MS);
    }

    /** The same for long enough to be read, of what was not asked for. */
    void tellLong(String words) {
        tell(words, LONG_NOTICE_MS);
    }

    private void tell(String words, int millis) {
        setNotice(words);
        noticeEnd.setInitialDelay(millis);
        noticeEnd.restart();
    }

    /** Writes a few words until others come, or none; what is shown for a moment goes first. */
    void keepTelling(String words) {
        if (!words.equals(lasting)) {
            lasting = words;
            showWords();
        }
    }

    private void setNotice(String words) {
        notice = words;
        showWords();
    }

    private void showWords() {
        getAccessibleContext().setAccessibleDescription(words());
        if (cover != null) {
            wordsOnCover.show(cover.isShowing() ? words() : "");
        }
        repaint();
    }

    private String words() {
        return notice.isEmpty() ? lasting : notice;
    }

    /** Not any panel: something is drawn there. */
    @Override
    public AccessibleContext getAccessibleContext() {
        if (accessibleContext == null) {
            accessibleContext =
                    new AccessibleJPanel() {
                        @Override
                        public AccessibleRole getAccessibleRole() {
                            return AccessibleRole.CANVAS;
                        }
                    };
        }
        return accessibleContext;
    }

    boolean hasWords() {
        return !words().isEmpty();
    }

    /** A new frame is painted from here on, or it would cover the words. */
    @Override
    protected boolean isPaintingOrigin() {
        return hasWords();
    }

    /** What is shown covers all of it. */
    @Override
    protected void paintComponent(Graphics graphics) {}

    @Override
    public void paint(Graphics graphics) {
        super.paint(graphics);
        if (hasWords() && (cover == null || !cover.isShowing())) {
            paintWords(graphics, words());
        }
    }

    private void paintWords(Graphics graphics, String all) {
        Graphics2D g = Theme.smooth(graphics);
        g.setFont(Theme.body(16));
        var metrics = g.getFontMetrics();
        int place = Theme.px(PLACE);
        int left = Theme.px(14);
        int top = Theme.px(8);
        int room = getWidth() - 2 * (place + left);
        String words = Ellipsis.inMiddle(ReadingOrder.ofSentence(all), metrics, room);
        int width = metrics.stringWidth(words) + 2 * left;
        int height = metrics.getHeight() + 2 * top;
        g.setColor(new Color(0, 0, 0, 170));
        g.fillRoundRect(place, place, width, height, Theme.corner() * 2, Theme.corner() * 2);
        g.setColor(Theme.TEXT);
        g.drawString(words, place + left, place + top + metrics.getAscent());
        g.dispose();
    }
}
