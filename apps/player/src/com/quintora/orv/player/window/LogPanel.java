// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import com.quintora.mmp.desktop.LogReader;
import com.quintora.orv.player.log.LogLines;
import java.awt.BorderLayout;
import java.awt.Dimension;
import java.awt.Font;
import java.awt.Toolkit;
import java.awt.datatransfer.StringSelection;
import java.util.List;
import java.util.Locale;
import javax.swing.Box;
import javax.swing.JComponent;
import javax.swing.JPanel;
import javax.swing.JScrollBar;
import javax.swing.JTextArea;
import javax.swing.JTextField;
import javax.swing.Timer;
import javax.swing.event.DocumentEvent;
import javax.swing.event.DocumentListener;

/** The native libraries' log while it is open: filtered, and to be copied. */
final class LogPanel extends SidePanel {
    private static final int WIDTH = 420;
    private static final int PERIOD_MS = 250;

    private final Controls controls;
    private final LogLines lines = new LogLines();
    private final JTextArea text = new JTextArea();
    private final DarkScroll scroll = new DarkScroll(text);
    private final JTextField part = DarkField.of(new JTextField(), "Text to look for in the log");
    private final Stepper least;
    private final Timer timer = new Timer(PERIOD_MS, event -> readLines());
    private LogReader reader; // While it is open.

    LogPanel(Controls controls) {
        super("Log", new BorderLayout());
        this.controls = controls;
        least = new Stepper("Least priority", "More lines", "Fewer lines", this::step);
        text.setEditable(false);
        text.setFont(new Font(Font.MONOSPACED, Font.PLAIN, Theme.px(11)));
        text.setBackground(Theme.STAGE);
        text.setForeground(Theme.TEXT);
        text.setCaretColor(Theme.TEXT);
        text.getAccessibleContext().setAccessibleName("Lines of the log");
        part.getDocument().addDocumentListener(new Filter());
        add(filters(), BorderLayout.NORTH);
        add(scroll, BorderLayout.CENTER);
        add(buttons(), BorderLayout.SOUTH);
        showLeast();
    }

    private JComponent filters() {
        JPanel row = new JPanel(new BorderLayout(Theme.gap(), 0));
        row.setOpaque(false);
        row.setBorder(Theme.border(0, 14, 6, 8));
        row.add(part, BorderLayout.CENTER);
        row.add(least, BorderLayout.EAST);
        return row;
    }

    private JComponent buttons() {
        Box row = Box.createHorizontalBox();
        row.setBorder(Theme.border(4, 8, 4, 8));
        row.add(button("Copy", "Copy the lines shown", this::copy));
        row.add(button("Clear", "Clear the log", this::clear));
        return row;
    }

    private static FlatButton button(String text, String tip, Runnable action) {
        FlatButton button = new FlatButton(null, tip, action);
        button.setText(text);
        return button;
    }

    @Override
    public Dimension getPreferredSize() {
        return new Dimension(Theme.px(WIDTH), super.getPreferredSize().height);
    }

    @Override
    void onOpen() {
        reader = new LogReader();
        timer.start();
        part.requestFocusInWindow();
    }

    @Override
    void onClose() {
        timer.stop();
        reader.close();
        reader = null;
    }

    private void readLines() {
        List<LogReader.Line> newer = reader == null ? List.of() : reader.read();
        if (!newer.isEmpty()) {
            lines.add(newer);
            showLines();
        }
    }

    // The end stays in sight unless somebody has gone to other lines.
    private void showLines() {
        JScrollBar bar = scroll.getVerticalScrollBar();
        int place = bar.getValue();
        boolean isAtEnd = place + bar.getVisibleAmount() >= bar.getMaximum() - 2;
        if (text.getSelectionStart() != text.getSelectionEnd()) {
            return; // Somebody is choosing lines to copy.
        }
        text.setText(String.join("\n", lines.shown()));
        text.setCaretPosition(isAtEnd ? text.getDocument().getLength() : 0);
        if (!isAtEnd) {
            bar.setValue(place);
        }
    }

    private void step(int by) {
        LogReader.Priority[] all = LogReader.Priority.values();
        int place = lines.least().ordinal() + by;
        lines.setLeast(all[Math.max(0, Math.min(all.length - 1, place))]);
        showLeast();
        showLines();
    }

    private void showLeast() {
        least.show(lines.least().name().toLowerCase(Locale.ROOT));
    }

    private void copy() {
        String selected = text.getSelectedText();
        String copied = selected == null ? text.getText() : selected;
        Toolkit.getDefaultToolkit()
                .getSystemClipboard()
                .setContents(new StringSelection(copied), null);
        controls.tell("Copied");
    }

    private void clear() {
        lines.clear();
        text.setText("");
    }

    private final class Filter implements DocumentListener {
        @Override
        public void insertUpdate(DocumentEvent event) {
            changedUpdate(event);
        }

        @Override
        public void removeUpdate(DocumentEvent event) {
            changedUpdate(event);
        }

        @Override
        public void changedUpdate(DocumentEvent event) {
            lines.setPart(part.getText());
            showLines();
        }
    }
}
