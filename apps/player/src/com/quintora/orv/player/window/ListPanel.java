// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import com.quintora.orv.player.playlist.Entry;
import com.quintora.orv.player.playlist.Playlist;
import java.awt.BorderLayout;
import java.awt.Component;
import java.awt.Dimension;
import java.awt.Font;
import java.awt.event.MouseAdapter;
import java.awt.event.MouseEvent;
import javax.swing.Box;
import javax.swing.DefaultListCellRenderer;
import javax.swing.DefaultListModel;
import javax.swing.JComponent;
import javax.swing.JList;
import javax.swing.ListSelectionModel;
import javax.swing.TransferHandler;

/**
 * The playlist beside the picture: Up and Down choose, Enter or a double click plays, Delete takes
 * out.
 */
final class ListPanel extends SidePanel {
    private static final int WIDTH = 280;

    private final Controls controls;
    private final DefaultListModel<Entry> rows = new DefaultListModel<>();
    private final JList<Entry> list = new JList<>(rows);
    private final FlatButton shuffle;
    private final FlatButton repeat;
    private int current;

    ListPanel(Controls controls) {
        super("Playlist", new BorderLayout());
        this.controls = controls;
        shuffle = button("Shuffle", "Shuffle (Z)", controls::toggleShuffled);
        repeat = button("Repeat off", "Repeat one, all or nothing (R)", controls::changeRepeat);
        prepareList();
        add(new DarkScroll(list), BorderLayout.CENTER);
        add(buttons(), BorderLayout.SOUTH);
    }

    private static FlatButton button(String text, String tip, Runnable action) {
        FlatButton button = new FlatButton(null, tip, action);
        button.setText(text);
        return button;
    }

    private void prepareList() {
        list.setBackground(Theme.PANEL);
        list.setForeground(Theme.TEXT);
        list.setSelectionBackground(Theme.HOVER);
        list.setSelectionForeground(Theme.TEXT);
        list.setFont(Theme.body());
        list.setFixedCellHeight(Theme.px(28));
        list.setCellRenderer(new Row());
        list.setSelectionMode(ListSelectionModel.SINGLE_SELECTION);
        list.getAccessibleContext().setAccessibleName("Playlist");
        Keys.bind(list, WHEN_FOCUSED, "ENTER", this::playSelected);
        Keys.bind(list, WHEN_FOCUSED, "DELETE", this::removeSelected);
        list.addMouseListener(
                new MouseAdapter() {
                    @Override
                    public void mouseClicked(MouseEvent event) {
                        if (event.getClickCount() == 2) {
                            playSelected();
                        }
                    }
                });
    }

    private JComponent buttons() {
        Box row = Box.createHorizontalBox();
        row.setBorder(Theme.border(4, 8, 4, 8));
        row.add(button("Open…", "Open files (O)", controls::chooseFiles));
        row.add(Box.createHorizontalGlue());
        row.add(shuffle);
        row.add(repeat);
        return row;
    }

    @Override
    public Dimension getPreferredSize() {
        return new Dimension(Theme.px(WIDTH), super.getPreferredSize().height);
    }

    @Override
    void onOpen() {
        list.setSelectedIndex(current);
        list.ensureIndexIsVisible(current);
        list.requestFocusInWindow();
    }

    /** Shows these rows from now on; the chosen one stays chosen. */
    void show(Playlist changed) {
        int selected = list.getSelectedIndex();
        current = changed.current();
        rows.clear();
        rows.addAll(changed.entries());
        list.setSelectedIndex(Math.min(selected, rows.size() - 1));
        shuffle.setForeground(changed.isShuffled() ? Theme.ACCENT : Theme.TEXT);
        repeat.setText(RepeatNames.of(changed.repeat()));
        repaint();
    }

    void takeDrops(TransferHandler drops) {
        setTransferHandler(drops);
        list.setTransferHandler(drops);
    }

    private void playSelected() {
        if (list.getSelectedIndex() >= 0) {
            controls.play(list.getSelectedIndex());
        }
    }

    private void removeSelected() {
        if (list.getSelectedIndex() >= 0) {
            controls.remove(list.getSelectedIndex());
        }
    }

    /** A row, with a sign at the one that plays. */
    private final class Row extends DefaultListCellRenderer {
        @Override
        public Component getListCellRendererComponent(
                JList<?> list, Object value, int index, boolean isSelected, boolean hasFocus) {
            // The media's own words are never markup.
            putClientProperty("html.disable", true);
            Component row =
                    super.getListCellRendererComponent(
                            list, ((Entry) value).name(), index, isSelected, false);
            boolean isCurrent = index == current;
            setBorder(Theme.border(0, 14, 0, 8));
            setForeground(isCurrent ? Theme.ACCENT : Theme.TEXT);
            setFont(isCurrent ? Theme.body().deriveFont(Font.BOLD) : Theme.body());
            setToolTipText(((Entry) value).source());
            return row;
        }
    }
}
