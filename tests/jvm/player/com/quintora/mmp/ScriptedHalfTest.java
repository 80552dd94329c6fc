// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertThrows;
import static org.junit.jupiter.api.Assertions.assertTrue;

import android.os.Parcel;
import android.view.Surface;
import com.quintora.SubtitleAttr;
import com.quintora.mmp.desktop.FrameReader;
import com.quintora.mmp.internal.source.StreamAdapter;
import com.quintora.mmp.util.DivxLastMemoryFilePosition;
import com.quintora.mmp.util.PcmMediaInfo;
import com.quintora.mmp.util.ThumbnailInfo;
import java.io.FileDescriptor;
import java.lang.ref.WeakReference;
import java.lang.reflect.InvocationTargetException;
import java.lang.reflect.Method;
import java.lang.reflect.Modifier;
import java.util.Arrays;
import java.util.HashSet;
import java.util.List;
import java.util.Map;
import java.util.Set;
import org.junit.jupiter.api.AfterEach;
import org.junit.jupiter.api.Test;

/**
 * Every native method and every callback between the real virtual machine and the native half,
 * with an engine by script that answers what the desktop's does not.
 */
class ScriptedHalfTest {
    // More than 32 local references of texts in one call.
    private static final int MANY_TRACKS = 40;
    private static final Set<String> ANSWERED_WITHOUT_THE_ENGINE = Set.of(
            "native_getFrameAt", "native_isLooping", "native_invoke", "native_setMetadataFilter",
            "native_getMetadata", "native_setParameter", "native_getParameter",
            "native_setAudioStreamType", "native_getAudioSessionId", "native_setAudioSessionId",
            "native_setAuxEffectSendLevel", "native_attachAuxEffect",
            "native_QTVDECSendCliCommand", "native_getDivxDisplayInfo",
            "native_getDivxLastMemoryFilePosition");
    // Those that make and end a player, called by the constructor and by the tests themselves.
    private static final Set<String> LIFE =
            Set.of("native_init", "native_setup", "native_release", "native_finalize");

    // Their records go to Java in other types than their signatures say, which is kept; no
    // service ever has one, and the checked virtual machine would end.
    private static final Set<String> MISMATCHED =
            Set.of("native_getDivxDisplayInfo", "native_getDivxLastMemoryFilePosition");

    private final FrameReader reader = new FrameReader();
    private final OrvMediaPlayer player = new OrvMediaPlayer();

    @AfterEach
    void close() {
        ScriptedHalf.answerDivx(false);
        player.close();
        reader.close();
    }

    @Test
    void everyNativeReachesTheEngineOfAPlayerAndRefusesOnceItIsReleased() throws Exception {
        List<Method> natives = Arrays.stream(OrvMediaPlayer.class.getDeclaredMethods())
                .filter(method -> Modifier.isNative(method.getModifiers()))
                .filter(method -> !LIFE.contains(method.getName()))
                .toList();
        assertEquals(83 - LIFE.size(), natives.size());
        ScriptedHalf.script(MANY_TRACKS);
        Set<String> silent = new HashSet<>();
        for (Method method : natives) {
            ScriptedHalf.answerDivx(!MISMATCHED.contains(method.getName()));
            ScriptedHalf.takeCalls();
            call(method);
            if (ScriptedHalf.takeCalls().isEmpty()) {
                silent.add(method.getName());
            }
        }
        assertEquals(ANSWERED_WITHOUT_THE_ENGINE, silent);
        player.native_release();
        assertEquals("release()\n", ScriptedHalf.takeCalls());
        for (Method method : natives) {
            assertRefusesOrAnswers(method);
        }
        assertEquals("", ScriptedHalf.takeCalls(), "nothing of a player that is gone");
        player.native_finalize();
    }

    @Test
    void divxRecordsArriveInJava() {
        ScriptedHalf.answerDivx(true);
        DivxNavigation divx = player.divx();
        assertEquals(new DivxNavigation.TitleInfo(1, -2, 3), divx.title(1).orElseThrow());
        assertEquals(new DivxNavigation.PositionInfo(1, -2, 3), divx.position().orElseThrow());
        DivxNavigation.ChapterInfo chapter = new DivxNavigation.ChapterInfo(4, 5, 6, -7);
        assertEquals(chapter, divx.chapter(1, 2, 3).orElseThrow());
        assertEquals(chapter, divx.playlist(1, 2).orElseThrow());
        assertEquals(9, divx.titleCount());
        assertEquals(9, divx.lastMemoryFileId());
    }

    @Test
    void divxPositionsThatJavaSetsArrive() {
        ScriptedHalf.answerDivx(true);
        ScriptedHalf.takeCalls();
        DivxLastMemoryFilePosition left = new DivxLastMemoryFilePosition();
        assertTrue(player.divx().setLastMemory(left));
        assertTrue(player.divx().setTitle(1, 2, 3));
        assertTrue(player.divx().setChapter(1, 2, 3, 4));
        assertTrue(player.divx().setPlaylist(5, 6, 7, 8));
        assertTrue(player.divx().pressButton(1, 2));
        assertTrue(player.divx().setFilePosition(3, 4));
        assertEquals("""
                setDivxLastMemoryFilePosition()
                setDivxTitleInfo(1, 2, 3)
                setDivxChapInfo(1, 2, 3, 4)
                setDivxPlayListInfo(5, 6, 7, 8)
                setDivxBtnInfo(1, 2)
                setDivxFilePosition(3, 4)
                """, ScriptedHalf.takeCalls());
    }

    @Test
    void tablesOfManyTracksArriveWhole() throws Exception {
        ScriptedHalf.script(MANY_TRACKS);
        player.setDataSource("/film");
        player.prepareAndWait();
        List<AudioTrack> audio = player.tracks().audio();
        assertEquals(MANY_TRACKS, audio.size());
        AudioTrack last = audio.get(MANY_TRACKS - 1);
        assertEquals(List.of("title", "codec", "stereo", "profile", "comment", "encoder",
                        "handler", "eng"),
                List.of(last.title(), last.codecName(), last.channelLayout(), last.profile(),
                        last.comment(), last.encoder(), last.handler(), last.language()));
        List<SubtitleTrack> subtitles = player.tracks().subtitles();
        assertEquals(MANY_TRACKS, subtitles.size());
        assertEquals("Titel", subtitles.get(MANY_TRACKS - 1).title());
        assertEquals(100 + MANY_TRACKS - 1, player.tracks().video().get(MANY_TRACKS - 1).width());
        assertEquals("film", player.tracks().metadata().orElseThrow().title());
    }

    @Test
    void aStreamIsUsedOnAThreadThatJavaDidNotStart() throws Exception {
        ScriptedSource source = new ScriptedSource(new byte[] {42, 0, 0, 0, 0, 0, 0, 0, 0, 0}) {
            @Override
            public int seekType() {
                return 42;
            }

            @Override
            public long seekTime(long first, long second) {
                return first * 10 + second;
            }
        };
        StreamAdapter adapter = new StreamAdapter(source, new NativeCalls(player));
        adapter.describe();
        player.units.source.use(adapter);
        assertEquals("read 0 8 42, seek 5, time 23, type 42, size 10, at 23, 100",
                ScriptedHalf.useStream(player));
        assertEquals(List.of(1, 1), List.of(source.cancels.get(), source.closes.get()));
    }

    @Test
    void anEventArrives() throws Exception {
        Recorder recorder = new Recorder();
        player.addListener(recorder);
        player.setDataSource("/film");
        player.prepareAndWait();
        ScriptedHalf.post(player, new WeakReference<>(player), 99, 0x64636261);
        recorder.await("text abcd");
    }

    @Test
    void theEnginesPlayersGoWithTheirPlayers() {
        int before = ScriptedHalf.livePlayers();
        OrvMediaPlayer other = new OrvMediaPlayer();
        assertEquals(before + 1, ScriptedHalf.livePlayers());
        other.close();
        assertEquals(before, ScriptedHalf.livePlayers());
        assertThrows(IllegalStateException.class, other::getDuration);
    }

    private void assertRefusesOrAnswers(Method method) throws Exception {
        try {
            call(method);
        } catch (InvocationTargetException e) {
            assertEquals(IllegalStateException.class, e.getCause().getClass(), method.getName());
        }
    }

    private void call(Method method) throws Exception {
        method.setAccessible(true);
        method.invoke(player, Arrays.stream(method.getParameterTypes())
                .map(this::argument)
                .toArray());
    }

    private Object argument(Class<?> type) {
        Map<Class<?>, Object> values = Map.of(
                int.class, 1, long.class, 1L, float.class, 1f, boolean.class, true,
                String.class, "/x", String[].class, new String[] {"a", "b"},
                FileDescriptor.class, FileDescriptor.in, Surface.class, reader.getSurface(),
                PcmMediaInfo.class, PcmMediaInfo.of(48_000, 2, 16),
                DivxLastMemoryFilePosition.class, new DivxLastMemoryFilePosition());
        if (values.containsKey(type)) {
            return values.get(type);
        }
        if (type == Parcel.class) {
            return Parcel.obtain();
        }
        if (type == ThumbnailInfo.class) {
            return new ThumbnailInfo(17, 16, 16);
        }
        assertEquals(SubtitleAttr.class, type);
        return SubtitleAttr.builder().delay(1).fontSize(2).backgroundColor(3).textColor(4)
                .edgeColor(5).displayOffset(6, 7).build();
    }
}
