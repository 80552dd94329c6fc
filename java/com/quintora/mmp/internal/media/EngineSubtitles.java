// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.media;

import com.quintora.SubtitleAttr;
import com.quintora.mmp.MediaException;
import com.quintora.mmp.SubtitleTrack;
import com.quintora.mmp.Subtitles;
import com.quintora.mmp.internal.base.Arguments;
import com.quintora.mmp.internal.base.EngineCall;
import com.quintora.mmp.internal.base.NativePlayer;
import com.quintora.mmp.internal.control.Background;
import com.quintora.mmp.internal.control.Commands;
import com.quintora.mmp.internal.failure.Failures;
import java.util.List;
import java.util.concurrent.CompletableFuture;

/**
 * Files of subtitles. The engine reports no failure: whether there is a new track is read from the
 * table, one file after the other.
 */
public final class EngineSubtitles implements Subtitles {
    private final NativePlayer natives;
    private final Commands commands;
    private final Background background;
    private final TrackTables tables;
    private final Object adding = new Object();

    public EngineSubtitles(
            NativePlayer natives, Commands commands, Background background, TrackTables tables) {
        this.natives = natives;
        this.commands = commands;
        this.background = background;
        this.tables = tables;
    }

    @Override
    public CompletableFuture<SubtitleTrack> add(String pathOrUrl) {
        required(pathOrUrl);
        return background.submit("add()", () -> addAndWait(pathOrUrl));
    }

    @Override
    public SubtitleTrack addAndWait(String pathOrUrl) throws MediaException {
        required(pathOrUrl);
        return add("addAndWait()", pathOrUrl, () -> natives.setSubtitleDataSource(pathOrUrl));
    }

    @Override
    public CompletableFuture<SubtitleTrack> addPair(String pictures, String index) {
        required(pictures, index);
        return background.submit("addPair()", () -> addPairAndWait(pictures, index));
    }

    @Override
    public SubtitleTrack addPairAndWait(String pictures, String index) throws MediaException {
        required(pictures, index);
        return add("addPairAndWait()", index,
                () -> natives.setSubtitleDataSourceEx(pictures, index));
    }

    @Override
    public CompletableFuture<SubtitleTrack> addTimedText(String pathOrUrl) {
        required(pathOrUrl);
        return background.submit("addTimedText()", () -> addTimedTextAndWait(pathOrUrl));
    }

    @Override
    public SubtitleTrack addTimedTextAndWait(String pathOrUrl) throws MediaException {
        required(pathOrUrl);
        return add("addTimedTextAndWait()", pathOrUrl,
                () -> natives.addTimedTextSource(pathOrUrl));
    }

    @Override
    public void setStyle(SubtitleAttr attr) {
        commands.requireAlive("setStyle()");
        Arguments.require(attr, "the attributes' object").check();
        commands.run("setStyle()", () -> natives.setSubtitleAttr(attr));
    }

    private SubtitleTrack add(String call, String name, EngineCall command)
            throws MediaException {
        synchronized (adding) {
            commands.requireMedia(call);
            int before = tables.subtitles().size();
            commands.run(call, command);
            List<SubtitleTrack> after = tables.subtitles();
            if (after.size() <= before) {
                throw Failures.subtitles(name);
            }
            return after.get(after.size() - 1);
        }
    }

    private static void required(String pictures, String index) {
        Arguments.require(pictures, "the path of the pictures");
        Arguments.require(index, "the path of the index");
    }

    private static void required(String pathOrUrl) {
        Arguments.require(pathOrUrl, "the path or URL");
    }
}
