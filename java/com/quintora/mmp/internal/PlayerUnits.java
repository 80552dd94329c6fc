// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal;

import com.quintora.mmp.MediaPlayer;
import com.quintora.mmp.internal.base.NativePlayer;
import com.quintora.mmp.internal.base.PlayerThreads;
import com.quintora.mmp.internal.base.SharedFields;
import com.quintora.mmp.internal.control.Background;
import com.quintora.mmp.internal.control.Commands;
import com.quintora.mmp.internal.control.Lifetime;
import com.quintora.mmp.internal.control.Playback;
import com.quintora.mmp.internal.control.Preparation;
import com.quintora.mmp.internal.control.Seeking;
import com.quintora.mmp.internal.control.Sources;
import com.quintora.mmp.internal.control.SurfaceBinding;
import com.quintora.mmp.internal.events.EndOfMedia;
import com.quintora.mmp.internal.events.Events;
import com.quintora.mmp.internal.events.NativeEvents;
import com.quintora.mmp.internal.events.PlayerObserver;
import com.quintora.mmp.internal.events.Watcher;
import com.quintora.mmp.internal.media.DirectCommands;
import com.quintora.mmp.internal.media.EngineAudioOutput;
import com.quintora.mmp.internal.media.EngineDivxNavigation;
import com.quintora.mmp.internal.media.EnginePictures;
import com.quintora.mmp.internal.media.EngineSubtitles;
import com.quintora.mmp.internal.media.EngineTracks;
import com.quintora.mmp.internal.media.EngineTrickPlay;
import com.quintora.mmp.internal.media.TrackTables;
import com.quintora.mmp.internal.source.CurrentSource;
import com.quintora.mmp.internal.state.StateMachine;
import java.util.concurrent.Executor;
import java.util.concurrent.ExecutorService;
import org.jetbrains.annotations.Nullable;

/** What a player is composed of: each unit is given those that it uses, made before it. */
public final class PlayerUnits {
    public final StateMachine states = new StateMachine();
    public final ExecutorService listening = PlayerThreads.forListeners();
    public final CurrentSource source;
    public final Events events;
    public final Watcher watcher;
    public final NativeEvents nativeEvents;
    public final SurfaceBinding surface;
    public final Sources sources;
    public final Preparation preparation;
    public final Playback playback;
    public final Seeking seeking;
    public final Lifetime lifetime;
    public final TrackTables tables;
    public final EngineTracks tracks;
    public final EngineSubtitles subtitles;
    public final EnginePictures pictures;
    public final EngineTrickPlay trickPlay;
    public final EngineAudioOutput audio;
    public final EngineDivxNavigation divx;
    public final DirectCommands engine;

    // The watcher does not hold it.
    private final PlayerObserver observer;

    /**
     * Composes a player.
     *
     * @param <N> its native methods, and the fields that the native half reads
     * @param player whom listeners are given
     * @param natives the native half
     * @param executor who calls listeners; null for a thread of the player's own
     */
    public <N extends NativePlayer & SharedFields> PlayerUnits(
            MediaPlayer player, N natives, @Nullable Executor executor) {
        source = new CurrentSource(natives);
        EndOfMedia end = new EndOfMedia(natives, source);
        events = new Events(player, states, source, executor == null ? listening : executor);
        observer = new PlayerObserver(natives, states, events, end);
        watcher = new Watcher(observer);
        nativeEvents = new NativeEvents(states, events, watcher);
        Commands commands = new Commands(natives, states, events, watcher, end);
        Background background = new Background(commands);
        surface = new SurfaceBinding(natives, natives, commands);
        sources = new Sources(natives, natives, commands, source);
        preparation = new Preparation(natives, commands, source, surface);
        playback = new Playback(natives, commands);
        seeking = new Seeking(natives, commands, end);
        lifetime = new Lifetime(natives, commands, source, surface, listening);
        tables = new TrackTables(natives, commands);
        tracks = new EngineTracks(natives, commands, background, tables);
        subtitles = new EngineSubtitles(natives, commands, background, tables);
        pictures = new EnginePictures(natives, commands, background);
        trickPlay = new EngineTrickPlay(natives, commands, seeking, background);
        audio = new EngineAudioOutput(natives, commands);
        divx = new EngineDivxNavigation(natives, commands);
        engine = new DirectCommands(natives, commands);
    }
}
