// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import java.awt.BorderLayout;
import java.awt.Dimension;
import javax.swing.JLabel;
import javax.swing.JPanel;
import javax.swing.JPasswordField;

/** Asks for the PIN of media that parents locked. */
final class PinPanel extends SidePanel {
    private static final int WIDTH = 400;
    private static final int DIGITS = 4;
    private static final String REFUSED =
            "Not unlocked: the PIN is wrong, or nothing is locked here";

    private final Controls controls;
    private final JPasswordField pin = DarkField.of(new JPasswordField(DIGITS), "PIN");
    private final JLabel answer = new JLabel(" ");

    PinPanel(Controls controls) {
        super("Parental lock", new BorderLayout());
        this.controls = controls;
        pin.addActionListener(event -> unlock());
        FlatButton button = new FlatButton(null, "Unlock (Enter)", this::unlock);
        button.setText("Unlock");
        JPanel row = new JPanel(new BorderLayout(Theme.gap(), 0));
        row.setOpaque(false);
        row.add(pin, BorderLayout.CENTER);
        row.add(button, BorderLayout.EAST);
        answer.setFont(Theme.small());
        JPanel form = new JPanel(new BorderLayout(0, Theme.gap()));
        form.setOpaque(false);
        form.setBorder(Theme.border(0, 14, 8, 8));
        form.add(row, BorderLayout.NORTH);
        form.add(answer, BorderLayout.CENTER);
        add(form, BorderLayout.NORTH);
    }

    @Override
    public Dimension getPreferredSize() {
        return new Dimension(Theme.px(WIDTH), super.getPreferredSize().height);
    }

    @Override
    void onOpen() {
        pin.setText("");
        say(" ", false);
        pin.requestFocusInWindow();
    }

    // No word of it stays in the field.
    @Override
    void onClose() {
        pin.setText("");
    }

    private void unlock() {
        String digits = new String(pin.getPassword());
        pin.setText("");
        if (!digits.matches("[0-9]{" + DIGITS + "}")) {
            say("A PIN has " + DIGITS + " digits", true);
            return;
        }
        say("…", false);
        controls.unlock(
                Integer.parseInt(digits),
                unlocks -> say(unlocks ? "Unlocked" : REFUSED, !unlocks));
    }

    private void say(String words, boolean isAlert) {
        answer.setForeground(isAlert ? Theme.ALERT : Theme.TEXT);
        answer.setText(words);
        answer.getAccessibleContext().setAccessibleName(words);
    }
}
