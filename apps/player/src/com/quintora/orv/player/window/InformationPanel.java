// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import com.quintora.orv.player.Fact;
import java.awt.BorderLayout;
import java.awt.Dimension;
import java.util.List;
import java.util.stream.Collectors;
import javax.swing.JTextArea;
import javax.swing.Timer;

/** What is known of the media and its playback, read anew while the panel is open. */
final class InformationPanel extends SidePanel {
    private static final int WIDTH = 320;
    private static final int PERIOD_MS = 500;
    private static final int PATIENCE = 6;

    private final Controls controls;
    private final JTextArea text = new JTextArea();
    private final Timer timer = new Timer(PERIOD_MS, event -> ask());
    private int waiting; // Times that the timer came since an answer was asked for.

    InformationPanel(Controls controls) {
        super("Information", new BorderLayout());
        this.controls = controls;
        text.setEditable(false);
        text.setLineWrap(true);
        text.setWrapStyleWord(true);
        text.setOpaque(false);
        text.setFont(Theme.body());
        text.setForeground(Theme.TEXT);
        text.setSelectionColor(Theme.TRACK);
        text.setSelectedTextColor(Theme.TEXT);
        text.setBorder(Theme.border(0, 14, 8, 8));
        text.getAccessibleContext().setAccessibleName("Information");
        add(new DarkScroll(text), BorderLayout.CENTER);
        timer.setInitialDelay(0);
    }

    @Override
    public Dimension getPreferredSize() {
        return new Dimension(Theme.px(WIDTH), super.getPreferredSize().height);
    }

    @Override
    void onOpen() {
        timer.start();
        text.requestFocusInWindow();
    }

    @Override
    void onClose() {
        timer.stop();
        waiting = 0;
    }

    // While one is answered slowly no others pile up. Of media that ended none comes.
    private void ask() {
        if (waiting == 0 || waiting > PATIENCE) {
            waiting = 0;
            controls.readFacts(this::show);
        }
        waiting++;
    }

    private void show(List<Fact> facts) {
        waiting = 0;
        String words =
                facts.stream()
                        .map(fact -> fact.name() + ": " + fact.value())
                        .collect(Collectors.joining("\n"));
        boolean isSelecting = text.getSelectionStart() != text.getSelectionEnd();
        if (!words.equals(text.getText()) && !isSelecting) {
            int caret = text.getCaretPosition();
            text.setText(words);
            text.setCaretPosition(Math.min(caret, words.length()));
        }
    }
}
