// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import com.quintora.orv.player.Previews;
import com.quintora.orv.player.Times;
import java.awt.Point;
import java.awt.Rectangle;
import java.awt.Window;
import java.awt.event.HierarchyEvent;
import java.awt.event.MouseAdapter;
import java.awt.event.MouseEvent;
import java.awt.image.BufferedImage;
import javax.swing.JWindow;
import javax.swing.SwingUtilities;

/**
 * What is at the pointer's place, above the bar: the picture, the time, the chapter. A window of
 * its own, as the picture below may be one. On the window's thread.
 */
final class SeekPreview extends MouseAdapter {
    private final SeekBar bar;
    private final PreviewCard card = new PreviewCard();
    private JWindow window;
    private Previews previews; // Null where there are no pictures.
    private int x;

    SeekPreview(SeekBar bar) {
        this.bar = bar;
        bar.addMouseListener(this);
        bar.addMouseMotionListener(this);
        bar.addHierarchyListener(this::onHierarchy);
    }

    /** Takes pictures from there from now on; null for none. */
    void use(Previews previews) {
        this.previews = previews;
        if (isOpen()) {
            update();
        }
    }

    /** A picture is there, which is wanted if the pointer still is at that part. */
    void show(int part, BufferedImage image) {
        if (isOpen() && previews != null && previews.partOf(bar.timeAt(x)) == part) {
            card.showPicture(image);
        }
    }

    private boolean isOpen() {
        return window != null && window.isVisible();
    }

    @Override
    public void mouseEntered(MouseEvent event) {
        follow(event);
    }

    @Override
    public void mouseMoved(MouseEvent event) {
        follow(event);
    }

    @Override
    public void mouseDragged(MouseEvent event) {
        follow(event);
    }

    @Override
    public void mouseExited(MouseEvent event) {
        if ((event.getModifiersEx() & MouseEvent.BUTTON1_DOWN_MASK) == 0) {
            hide();
        }
    }

    @Override
    public void mouseReleased(MouseEvent event) {
        if (!bar.contains(event.getPoint())) {
            hide();
        }
    }

    private void follow(MouseEvent event) {
        x = event.getX();
        update();
    }

    private void update() {
        if (!bar.isEnabled() || !bar.isShowing()) {
            hide();
            return;
        }
        int millis = bar.timeAt(x);
        card.showPlace(Times.clock(millis), bar.chapterAt(millis));
        if (previews == null) {
            card.showNoPictures();
        } else {
            card.keepRoom(previews.width(), previews.height());
            card.showPicture(previews.get(previews.partOf(millis)).orElse(null));
        }
        open();
    }

    private void open() {
        Window owner = SwingUtilities.getWindowAncestor(bar);
        if (window == null) {
            window = new JWindow(owner);
            window.setName("preview");
            window.setFocusableWindowState(false);
            window.add(card);
        }
        window.pack();
        window.setLocation(place(owner.getBounds()));
        window.setVisible(true);
    }

    // Above the pointer, as far as the window leaves room at the sides.
    private Point place(Rectangle owner) {
        Point corner = bar.getLocationOnScreen();
        int middle = corner.x + x - window.getWidth() / 2;
        int last = owner.x + owner.width - window.getWidth();
        return new Point(
                Math.max(owner.x, Math.min(middle, last)),
                corner.y - window.getHeight() - Theme.gap());
    }

    private void hide() {
        if (previews != null) {
            previews.forget();
        }
        if (isOpen()) {
            window.setVisible(false);
        }
    }

    // As in full screen, where the controls hide.
    private void onHierarchy(HierarchyEvent event) {
        if (!bar.isShowing()) {
            hide();
        }
    }
}
