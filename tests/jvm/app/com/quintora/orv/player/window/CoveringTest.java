// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import static org.junit.jupiter.api.Assertions.assertFalse;
import static org.junit.jupiter.api.Assertions.assertTrue;

import java.awt.Dimension;
import javax.swing.JLayeredPane;
import javax.swing.JPanel;
import javax.swing.JRootPane;
import org.junit.jupiter.api.Test;

/** What lies over a picture in its window. */
class CoveringTest {
    private final JPanel picture = new JPanel();
    private final NoticePane room = new NoticePane();
    private final JPanel bar = new JPanel();
    private final Deck deck = new Deck(room, bar, new JPanel());
    private final JRootPane root = new JRootPane();

    CoveringTest() {
        room.add(picture, "picture");
        bar.setPreferredSize(new Dimension(300, 40));
        root.setContentPane(deck);
        layOut();
    }

    @Test
    void nothingIsOverItAtFirst() {
        assertFalse(Covering.isOver(picture));
    }

    @Test
    void wordsAre() throws Exception {
        WindowFixture.onWindow(() -> {
            room.keepTelling("Seeking…");
            return null;
        });
        assertTrue(Covering.isOver(picture));
    }

    @Test
    void theBarIsOnlyWhereItOverlapsAndShows() {
        deck.setOverlapping(true);
        layOut();
        assertTrue(Covering.isOver(picture));
        bar.setVisible(false);
        assertFalse(Covering.isOver(picture));
    }

    @Test
    void theListOfKeysIs() {
        root.getGlassPane().setVisible(true);
        assertTrue(Covering.isOver(picture));
    }

    @Test
    void aMenuIsWhereItLies() {
        JPanel menu = new JPanel();
        root.getLayeredPane().add(menu, JLayeredPane.POPUP_LAYER);
        menu.setBounds(0, 210, 50, 20);
        assertFalse(Covering.isOver(picture), "below the picture");
        menu.setBounds(0, 150, 50, 80);
        assertTrue(Covering.isOver(picture));
    }

    private void layOut() {
        root.setSize(300, 240);
        root.doLayout();
        root.getLayeredPane().doLayout();
        deck.doLayout();
        room.doLayout();
    }
}
