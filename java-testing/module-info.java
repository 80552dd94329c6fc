// SPDX-License-Identifier: Apache-2.0

/**
 * A media player without an engine, for the tests of programs that use {@link
 * com.quintora.mmp.MediaPlayer}. Start with {@link com.quintora.mmp.testing.FakeMediaPlayer}.
 */
module com.quintora.mmp.testing {
    requires transitive com.quintora.mmp;
    requires static transitive org.jetbrains.annotations;

    exports com.quintora.mmp.testing;
}
