// SPDX-License-Identifier: Apache-2.0

/**
 * A media player without an engine, for the tests of programs that use {@link
 * com.quintora.mmp.MediaPlayer}. Start with {@link com.quintora.mmp.testing.FakeMediaPlayer}.
 */
module com.quintora.mmp.testing {
    requires transitive com.quintora.mmp;
    // Not transitive: a module that requires this one could not be compiled without it.
    requires static org.jetbrains.annotations;

    exports com.quintora.mmp.testing;
}
