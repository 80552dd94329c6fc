// SPDX-License-Identifier: Apache-2.0
package android.view;

import android.graphics.PixelFormat;
import com.quintora.mmp.desktop.FrameReader;
import com.quintora.mmp.desktop.VideoFrame;
import com.quintora.mmp.platform.internal.ViewDrawing;
import java.awt.Canvas;
import java.awt.Color;
import java.awt.Dimension;
import java.awt.EventQueue;
import java.awt.Graphics;
import java.awt.Toolkit;
import java.awt.event.ComponentAdapter;
import java.awt.event.ComponentEvent;
import java.awt.geom.AffineTransform;
import java.awt.image.BufferedImage;
import java.awt.image.DataBufferInt;
import java.util.List;
import java.util.concurrent.CopyOnWriteArrayList;

/**
 * A part of a window that a player draws on: by the graphics processor where there is one, else by
 * software.
 *
 * <p>On a television this is one of the platform's views; here it is a heavyweight AWT component
 * instead, for a program to add to a window as it adds any other. It is a window of its own to the
 * desktop, and covers what Swing paints. Of the platform's methods it has {@link #getHolder()},
 * whose {@link SurfaceHolder} is as on a television; the others are AWT's. The surface is there
 * while the component is displayable. {@link com.quintora.mmp.desktop.DesktopSurfaceView} also says
 * what draws.
 *
 * <p>For the thread of AWT's events.
 *
 * @serial exclude
 */
@SuppressWarnings("serial") // Nobody serializes it.
public class SurfaceView extends Canvas {
    private static final int FORMAT = PixelFormat.RGBX_8888;

    private final ViewDrawing mDrawing;
    private final Holder mHolder = new Holder();
    private FrameReader mReader;
    private volatile Surface mSurface;
    private BufferedImage mPicture;
    private long mPictureNs; // Its media time.
    private boolean mIsPictureNew;
    private Dimension mPixels = new Dimension();

    /** Makes a view that leaves a graphics processor alone which is itself software. */
    public SurfaceView() {
        this(new ViewDrawing(false));
    }

    /**
     * For the desktop's view, which shares what draws.
     *
     * @param drawing draws on this view alone
     * @hidden
     */
    @SuppressWarnings({"exports", "this-escape"})
    protected SurfaceView(ViewDrawing drawing) {
        mDrawing = drawing;
        mDrawing.setOnRelease(() -> EventQueue.invokeLater(this::showNewPicture));
        setBackground(Color.BLACK);
        addComponentListener(new ComponentAdapter() {
            @Override
            public void componentResized(ComponentEvent event) {
                mHolder.change();
            }
        });
    }

    /**
     * What holds the surface.
     *
     * @return always the same one
     */
    public SurfaceHolder getHolder() {
        return mHolder;
    }

    @Override
    public void addNotify() {
        super.addNotify();
        // The window must be there for others, too.
        Toolkit.getDefaultToolkit().sync();
        FrameReader reader = new FrameReader();
        reader.setOnFrameAvailable(() -> takePicture(reader), EventQueue::invokeLater);
        mReader = reader;
        mSurface = mDrawing.open(this, reader.getSurface());
        mPixels = new Dimension();
        mHolder.callbacks().forEach(callback -> callback.surfaceCreated(mHolder));
        mHolder.change();
    }

    /** The window goes only when no player draws on it any more. */
    @Override
    public void removeNotify() {
        if (mSurface != null) {
            mHolder.callbacks().forEach(callback -> callback.surfaceDestroyed(mHolder));
            mSurface.release();
            mSurface = null;
            mDrawing.close();
            mReader.close();
            mPicture = null;
            mIsPictureNew = false;
        }
        super.removeNotify();
    }

    @Override
    public void update(Graphics graphics) {
        paint(graphics);
    }

    @Override
    public void paint(Graphics graphics) {
        if (mDrawing.isByGpu()) {
            mDrawing.redraw();
        } else if (mPicture != null) {
            graphics.drawImage(mPicture, 0, 0, getWidth(), getHeight(), null);
        } else {
            graphics.clearRect(0, 0, getWidth(), getHeight());
        }
    }

    // A picture that was drawn by software.
    private void takePicture(FrameReader reader) {
        if (reader != mReader || mSurface == null) {
            return;
        }
        try (VideoFrame frame = reader.acquireLatestFrame()) {
            if (frame != null) {
                mPicture = copyOf(frame);
                mPictureNs = frame.getTimestamp();
                mIsPictureNew = true;
            }
        }
        showNewPicture();
    }

    private void showNewPicture() {
        if (mDrawing.isHeld() || !mIsPictureNew || mSurface == null) {
            return;
        }
        mIsPictureNew = false;
        mDrawing.reportFrame(mPictureNs);
        Graphics graphics = getGraphics();
        if (graphics != null && !mDrawing.isByGpu()) {
            paint(graphics);
            graphics.dispose();
        }
    }

    private static BufferedImage copyOf(VideoFrame frame) {
        int width = frame.getWidth();
        int height = frame.getHeight();
        var picture = new BufferedImage(width, height, BufferedImage.TYPE_INT_RGB);
        int[] target = ((DataBufferInt) picture.getRaster().getDataBuffer()).getData();
        var source = frame.getPixels().asIntBuffer();
        int stride = frame.getRowStride() / 4;
        for (int y = 0; y < height; y++) {
            source.get(y * stride, target, y * width, width);
        }
        return picture;
    }

    private Dimension pixels() {
        AffineTransform scale = getGraphicsConfiguration().getDefaultTransform();
        return new Dimension(
                (int) Math.round(getWidth() * scale.getScaleX()),
                (int) Math.round(getHeight() * scale.getScaleY()));
    }

    private final class Holder implements SurfaceHolder {
        private final List<Callback> mCallbacks = new CopyOnWriteArrayList<>();

        List<Callback> callbacks() {
            return mCallbacks;
        }

        @Override
        public void addCallback(Callback callback) {
            mCallbacks.add(callback);
            if (mSurface != null) {
                callback.surfaceCreated(this);
                if (mPixels.width > 0) {
                    callback.surfaceChanged(this, FORMAT, mPixels.width, mPixels.height);
                }
            }
        }

        @Override
        public void removeCallback(Callback callback) {
            mCallbacks.remove(callback);
        }

        @Override
        public Surface getSurface() {
            return mSurface;
        }

        // Also before the view has a size.
        void change() {
            if (mSurface == null || getWidth() <= 0 || getHeight() <= 0) {
                return;
            }
            Dimension now = pixels();
            if (now.equals(mPixels)) {
                return;
            }
            mPixels = now;
            mReader.setFrameSize(now.width, now.height);
            mDrawing.redraw();
            for (Callback callback : mCallbacks) {
                callback.surfaceChanged(this, FORMAT, now.width, now.height);
            }
        }
    }
}
