// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import static org.junit.jupiter.api.Assertions.assertEquals;

import com.quintora.SubtitleAttr;
import com.quintora.mmp.util.DivxLastMemoryFilePosition;
import com.quintora.mmp.util.PcmMediaInfo;
import com.quintora.mmp.util.ThumbnailInfo;
import java.lang.reflect.Constructor;
import java.lang.reflect.InvocationTargetException;
import java.lang.reflect.Method;
import java.lang.reflect.Modifier;
import java.util.Arrays;
import java.util.List;
import java.util.Map;
import java.util.function.Supplier;
import java.util.stream.Stream;
import org.junit.jupiter.api.DynamicTest;
import org.junit.jupiter.api.TestFactory;

/** Every native method on a player without a service: before setup, and after release. */
class NoServiceTest {
    private static final String THROWS = "java.lang.IllegalStateException: null";

    // What the methods answer that do not throw.
    private static final Map<String, String> ANSWERS = Map.ofEntries(
            Map.entry("native_release", "void"),
            Map.entry("native_finalize", "void"),
            Map.entry("native_getFrameAt", "null"),
            Map.entry("native_setAudioTrack", "false"),
            Map.entry("native_getVideoCodecInfo", "false"),
            Map.entry("native_getPlayMode", "0"),
            Map.entry("native_getBufferPercent", "0"),
            Map.entry("native_onSubtitleTrack", "void"),
            Map.entry("native_offSubtitleTrack", "void"),
            Map.entry("native_deselectTrack", "void"),
            Map.entry("native_selectTrack", "void"),
            Map.entry("native_getSubtitleTrackInfo", "false"),
            Map.entry("native_getAllSubtitleTrackInfo", "-1"),
            Map.entry("native_getAllAudioTrackInfo", "0"),
            Map.entry("native_getAllVideoTrackInfo", "0"),
            Map.entry("native_setSubtitleDataSource", "void"),
            Map.entry("native_setSubtitleDataSourceEx", "void"),
            Map.entry("native_addTimedTextSource", "-1"),
            Map.entry("native_setSubtitleAttr", "void"),
            Map.entry("native_setPcmMediaInfo", "void"),
            Map.entry("native_setPcmFlag", "void"),
            Map.entry("native_setDataSourceByInputStream", "void"),
            Map.entry("native_getMetaDataInfo", "false"),
            Map.entry("native_setABRepeat", "-1"),
            Map.entry("native_QTVDECSendCliCommand", "-1"),
            Map.entry("native_getDivxTitleInfo", "false"),
            Map.entry("native_getDivxChapInfo", "false"),
            Map.entry("native_getDivxPlayListInfo", "false"),
            Map.entry("native_getDivxPositionInfo", "false"),
            Map.entry("native_getDivxDisplayInfo", "false"),
            Map.entry("native_getDivxLastMemoryFilePosition", "false"),
            Map.entry("native_getDivxTitleNum", "0"),
            Map.entry("native_getDivxLastMemoryFileID", "0"),
            Map.entry("native_setDivxTitleInfo", "-1"),
            Map.entry("native_setDivxChapInfo", "-1"),
            Map.entry("native_setDivxPlayListInfo", "-1"),
            Map.entry("native_setDivxBtnInfo", "-1"),
            Map.entry("native_setDivxLastMemoryFilePosition", "-1"),
            Map.entry("native_setDivxFilePosition", "-1"),
            Map.entry("native_setUnLockPin", "-1"));

    // They do not need a service, or make one.
    private static final List<String> NOT_CALLED = List.of("native_init", "native_setup");

    @TestFactory
    Stream<DynamicTest> beforeSetup() {
        return everyNative("before setup", NoServiceTest::withoutConstructor);
    }

    @TestFactory
    Stream<DynamicTest> afterRelease() {
        return everyNative("after release", NoServiceTest::released);
    }

    private static Stream<DynamicTest> everyNative(String when, Supplier<OrvMediaPlayer> maker) {
        return Arrays.stream(OrvMediaPlayer.class.getDeclaredMethods())
                .filter(method -> Modifier.isNative(method.getModifiers()))
                .filter(method -> !NOT_CALLED.contains(method.getName()))
                .map(method -> DynamicTest.dynamicTest(
                        method.getName() + method.getParameterCount() + " " + when,
                        () -> answersAsWithoutService(method, maker.get())));
    }

    private static void answersAsWithoutService(Method method, OrvMediaPlayer player)
            throws Exception {
        String expected = ANSWERS.getOrDefault(method.getName(), THROWS);
        assertEquals(expected, call(method, player));
        assertEquals(expected, call(method, player), "the second time");
    }

    private static String call(Method method, OrvMediaPlayer player) throws Exception {
        Object[] arguments = Arrays.stream(method.getParameterTypes())
                .map(NoServiceTest::argument)
                .toArray();
        try {
            Object result = method.invoke(player, arguments);
            return method.getReturnType() == void.class ? "void" : String.valueOf(result);
        } catch (InvocationTargetException e) {
            Throwable thrown = e.getCause();
            return thrown.getClass().getName() + ": " + thrown.getMessage();
        }
    }

    private static Object argument(Class<?> type) {
        Map<Class<?>, Object> values = Map.of(
                int.class, 0, long.class, 0L, float.class, 0f, boolean.class, false,
                String.class, "/nowhere",
                SubtitleAttr.class, new SubtitleAttr(),
                ThumbnailInfo.class, new ThumbnailInfo(),
                PcmMediaInfo.class, new PcmMediaInfo(),
                DivxLastMemoryFilePosition.class, new DivxLastMemoryFilePosition());
        return values.get(type);
    }

    private static OrvMediaPlayer released() {
        OrvMediaPlayer player = new OrvMediaPlayer();
        player.close();
        return player;
    }

    /** A player whose constructor, which sets it up, never ran. */
    private static OrvMediaPlayer withoutConstructor() {
        try {
            Class.forName(OrvMediaPlayer.class.getName());
            Class<?> factoryClass = Class.forName("sun.reflect.ReflectionFactory");
            Object factory = factoryClass.getMethod("getReflectionFactory").invoke(null);
            Constructor<?> constructor = (Constructor<?>) factoryClass
                    .getMethod("newConstructorForSerialization", Class.class, Constructor.class)
                    .invoke(factory, OrvMediaPlayer.class, Object.class.getConstructor());
            return (OrvMediaPlayer) constructor.newInstance();
        } catch (ReflectiveOperationException e) {
            throw new AssertionError(e);
        }
    }
}
