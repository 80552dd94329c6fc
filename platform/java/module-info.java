// SPDX-License-Identifier: Apache-2.0

/**
 * The part of a television's platform that players and their programs meet, for desktop Linux.
 *
 * <p>The packages {@code android.*} hold the classes that a program shares with a television; what
 * is public there has the platform's names, signatures and constants, and only as much of them as
 * players and their programs need. {@link android.view.SurfaceView} is the exception: here it is an
 * AWT component. {@link com.quintora.mmp.desktop} holds what the desktop alone has.
 *
 * <p>The classes load the native library {@code orv_platform} from {@code java.library.path}; where
 * it is missing, their first use throws {@link UnsatisfiedLinkError}. From Java 24 on a program
 * grants this module native access, by
 * {@code --enable-native-access=com.quintora.mmp.platform}; on the class path the name to grant it
 * to is {@code ALL-UNNAMED}.
 */
module com.quintora.mmp.platform {
    requires transitive java.desktop;

    exports android.graphics;
    exports android.media;
    exports android.os;
    exports android.view;
    exports com.quintora.mmp.desktop;
}
