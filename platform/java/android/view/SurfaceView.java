// SPDX-License-Identifier: Apache-2.0
package android.view;

import android.media.Image;
import android.media.ImageReader;
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
 * software. It is a window of its own to the desktop, and covers what Swing paints.
 *
 * <p>For the window's thread, except where it says otherwise.
 */
@SuppressWarnings("serial") // Nobody serializes it.
public class SurfaceView extends Canvas {
    static {
        System.loadLibrary("orv_platform");
    }

    /** As on a television: 32 bits a pixel, none of them transparent. */
    private static final int FORMAT_RGBX = 2;

    private final boolean mAcceptsSoftwareGl;
    private final Holder mHolder = new Holder();
    private volatile ViewWindow mWindow;
    private volatile ImageReader mReader;
    private Surface mSurface;
    private BufferedImage mPicture;
    private long mPictureNs; // Its media time.
    private boolean mIsPictureNew;
    private volatile boolean mHeld;
    private Dimension mPixels = new Dimension();

    /** A view that leaves a graphics processor that is itself software alone. */
    public SurfaceView() {
        this(false);
    }

    /** acceptsSoftwareGl: draw by OpenGL also where that is software. The desktop's alone. */
    @SuppressWarnings("this-escape")
    public SurfaceView(boolean acceptsSoftwareGl) {
        mAcceptsSoftwareGl = acceptsSoftwareGl;
        setBackground(Color.BLACK);
        addComponentListener(new ComponentAdapter() {
            @Override
            public void componentResized(ComponentEvent event) {
                mHolder.change();
            }
        });
    }

    public SurfaceHolder getHolder() {
        return mHolder;
    }

    /** Whether the graphics processor draws now. Any thread. The desktop's alone. */
    public boolean isDrawnByGpu() {
        ViewWindow window = mWindow;
        return window != null && window.isDrawnByGpu();
    }

    /**
     * The name of the graphics processor, or why software draws; empty before a player has the
     * surface. Any thread. The desktop's alone.
     */
    public String describeDrawing() {
        ViewWindow window = mWindow;
        return window == null ? "" : window.describeDrawing();
    }

    /**
     * Waits for the next frame that is drawn, be it one from before drawn anew. For one thread,
     * any. The desktop's alone.
     *
     * @return its media time in nanoseconds, or -1 when none came in time
     */
    public long awaitFrame(int timeoutMillis) throws InterruptedException {
        ViewWindow window = mWindow;
        if (window == null) {
            Thread.sleep(timeoutMillis);
            return -1;
        }
        return window.awaitFrame(timeoutMillis);
    }

    /**
     * While it is held, the view keeps its picture whatever the player draws; afterwards it shows
     * the newest. Any thread. The desktop's alone.
     */
    public void hold(boolean held) {
        mHeld = held;
        ViewWindow window = mWindow;
        if (window != null) {
            window.hold(held);
        }
        if (!held) {
            EventQueue.invokeLater(this::showNewPicture);
        }
    }

    @Override
    public void addNotify() {
        super.addNotify();
        // The window must be there for others, too.
        Toolkit.getDefaultToolkit().sync();
        ImageReader reader = ImageReader.newInstance(0, 0);
        reader.setOnImageAvailableListener(this::onImage, EventQueue::invokeLater);
        mReader = reader;
        long id = ViewWindow.idOf(this);
        mWindow = id == 0 ? null : new ViewWindow(id, mAcceptsSoftwareGl);
        if (mWindow != null) {
            mWindow.hold(mHeld);
        }
        mSurface = mWindow == null ? reader.getSurface() : mWindow.surface(reader.getSurface());
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
            if (mWindow != null) {
                mWindow.close();
            }
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
        if (isDrawnByGpu()) {
            mWindow.redraw();
        } else if (mPicture != null) {
            graphics.drawImage(mPicture, 0, 0, getWidth(), getHeight(), null);
        } else {
            graphics.clearRect(0, 0, getWidth(), getHeight());
        }
    }

    // A picture that was drawn by software.
    private void onImage(ImageReader reader) {
        if (reader != mReader || mSurface == null) {
            return;
        }
        try (Image image = reader.acquireLatestImage()) {
            if (image != null) {
                mPicture = copyOf(image);
                mPictureNs = image.getTimestamp();
                mIsPictureNew = true;
            }
        }
        showNewPicture();
    }

    private void showNewPicture() {
        if (mHeld || !mIsPictureNew || mSurface == null) {
            return;
        }
        mIsPictureNew = false;
        if (mWindow != null) {
            mWindow.reportFrame(mPictureNs);
        }
        Graphics graphics = getGraphics();
        if (graphics != null && !isDrawnByGpu()) {
            paint(graphics);
            graphics.dispose();
        }
    }

    private static BufferedImage copyOf(Image image) {
        int width = image.getWidth();
        int height = image.getHeight();
        var picture = new BufferedImage(width, height, BufferedImage.TYPE_INT_RGB);
        int[] target = ((DataBufferInt) picture.getRaster().getDataBuffer()).getData();
        var source = image.getPlanes()[0].getBuffer().asIntBuffer();
        int stride = image.getPlanes()[0].getRowStride() / 4;
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
                    callback.surfaceChanged(this, FORMAT_RGBX, mPixels.width, mPixels.height);
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
            mReader.setDefaultSize(now.width, now.height);
            if (mWindow != null) {
                mWindow.redraw();
            }
            for (Callback callback : mCallbacks) {
                callback.surfaceChanged(this, FORMAT_RGBX, now.width, now.height);
            }
        }
    }

    static native long nativeWindowOf(java.awt.Component component);

    static native long nativeCreate(long id, boolean acceptsSoftwareGl);

    static native void nativeDestroy(long window);

    static native long nativeCreateProducer(long window, Surface buffers);

    static native void nativeReleaseProducer(long producer);

    static native void nativeRedraw(long window);

    static native void nativeHold(long window, boolean held);

    static native void nativeReportFrame(long window, long timeUs);

    static native void nativeClose(long window);

    static native boolean nativeIsDrawnByGpu(long window);

    static native String nativeDescribeDrawing(long window);

    static native void nativeAwaitFrame(long window, long seen, int timeoutMs, long[] frame);
}
