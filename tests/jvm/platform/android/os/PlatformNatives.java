// SPDX-License-Identifier: Apache-2.0
package android.os;

import android.view.Surface;
import java.io.FileDescriptor;

/** The platform's C++ side, as a player library uses it. */
public final class PlatformNatives {
    static {
        System.loadLibrary("orv_platform_natives");
    }

    private PlatformNatives() {}

    /** Registers functions that do nothing; 0, or -1 with an exception thrown. */
    static native int registerNatives(String classPath, String[] names, String[] signatures);

    /** What registerNatives logged since the last call, a line each: "tag: text". */
    static native String takeLog();

    /** Whether the runtime knows this machine and the calling thread's environment. */
    static native boolean runtimeIsThisMachine();

    static native int fdOf(FileDescriptor descriptor);

    /** The C++ parcel's rewriting of an int, a long, a float, a double and a string. */
    static native byte[] rewriteParcel(byte[] marshalled);

    public static native boolean hasSurface(Surface surface);

    public static native boolean hasProducer(Surface surface);

    /** Holds the surface's producer, as a player does, until dropProducer. */
    public static native long holdProducer(Surface surface);

    public static native void dropProducer(long producer);

    /** Draws one frame of that color (0xXXRRGGBB); the status of the producer. */
    public static native int draw(long producer, int width, int height, int color, long timeUs);

    /** Width and height that the consumer asks for; -1 when it does not answer. */
    public static native int[] defaultSize(long producer);
}
