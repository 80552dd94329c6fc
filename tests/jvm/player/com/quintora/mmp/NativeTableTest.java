// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import static org.junit.jupiter.api.Assertions.assertEquals;

import java.lang.invoke.MethodType;
import java.lang.reflect.Field;
import java.lang.reflect.Method;
import java.lang.reflect.Modifier;
import java.util.Arrays;
import java.util.List;
import java.util.TreeSet;
import java.util.stream.Stream;
import org.junit.jupiter.api.Test;

/** The names and signatures by which the native half and the Java class know each other. */
class NativeTableTest {
    private static final List<String> NATIVES = rows("""
            native_setDataSource (Ljava/lang/String;)V
            native_setDataSource (Ljava/lang/String;[Ljava/lang/String;[Ljava/lang/String;)V
            native_setDataSource (Ljava/io/FileDescriptor;JJ)V
            native_setVideoSurface (Landroid/view/Surface;)V
            native_prepare ()V
            native_prepareAsync ()V
            native_start ()V
            native_stop ()V
            native_getVideoWidth ()I
            native_getVideoHeight ()I
            native_seekTo (I)V
            native_pause ()V
            native_isPlaying ()Z
            native_getCurrentPosition ()I
            native_getDuration ()I
            native_release ()V
            native_reset ()V
            native_setAudioStreamType (I)V
            native_setLooping (Z)V
            native_isLooping ()Z
            native_setVolume (FF)V
            native_getFrameAt (I)Landroid/graphics/Bitmap;
            native_invoke (Landroid/os/Parcel;Landroid/os/Parcel;)I
            native_setMetadataFilter (Landroid/os/Parcel;)I
            native_getMetadata (ZZLandroid/os/Parcel;)Z
            static native_init ()V
            native_setup (Ljava/lang/Object;)V
            native_finalize ()V
            native_getAudioSessionId ()I
            native_setAudioSessionId (I)V
            native_setAuxEffectSendLevel (F)V
            native_attachAuxEffect (I)V
            native_setParameter (ILandroid/os/Parcel;)Z
            native_getParameter (ILandroid/os/Parcel;)V
            native_setAudioTrack (I)Z
            native_getVideoCodecInfo ()Z
            native_setPlayMode (I)I
            native_getPlayMode ()I
            native_getBufferPercent ()I
            native_onSubtitleTrack (I)V
            native_offSubtitleTrack ()V
            native_deselectTrack (I)V
            native_selectTrack (I)V
            native_getSubtitleTrackInfo (I)Z
            native_getAllSubtitleTrackInfo ()I
            native_getAllAudioTrackInfo (Z)I
            native_getAllVideoTrackInfo ()I
            native_setSubtitleDataSource (Ljava/lang/String;)V
            native_setSubtitleDataSourceEx (Ljava/lang/String;Ljava/lang/String;)V
            native_addTimedTextSource (Ljava/lang/String;)I
            native_setSubtitleAttr (Lcom/quintora/SubtitleAttr;)V
            native_getThumbnailInfo (Lcom/quintora/mmp/util/ThumbnailInfo;)[B
            native_step (I)V
            native_getEmbeddedPicture (I)[B
            native_setPcmMediaInfo (Lcom/quintora/mmp/util/PcmMediaInfo;)V
            native_setPcmFlag ()V
            native_setDataSourceByInputStream ()V
            native_seekToPosition (J)V
            native_canDoSeek (I)Z
            native_canDoTrick (I)Z
            native_setTS (I)Z
            native_getCurrentBytePosition ()I
            native_setPlayerRole (I)V
            native_getMetaDataInfo ()Z
            native_setABRepeat (I)I
            native_QTVDECSendCliCommand (Ljava/lang/String;I)I
            native_getDivxTitleInfo (I)Z
            native_getDivxChapInfo (III)Z
            native_getDivxPlayListInfo (II)Z
            native_getDivxPositionInfo ()Z
            native_getDivxDisplayInfo (IIIII)Z
            native_getDivxLastMemoryFilePosition ()Z
            native_getDivxTitleNum ()I
            native_getDivxLastMemoryFileID ()I
            native_setDivxTitleInfo (III)I
            native_setDivxChapInfo (IIII)I
            native_setDivxPlayListInfo (IIII)I
            native_setDivxBtnInfo (II)I
            native_setDivxLastMemoryFilePosition (Lcom/quintora/mmp/util/DivxLastMemoryFilePosition;)I
            native_setDivxFilePosition (II)I
            native_getCurrentAudioIndex ()I
            native_getCurrentSubtitleIndex ()I
            native_setUnLockPin (I)I
            """);

    private static final List<String> CALLBACKS = rows("""
            static postEventFromNative (Ljava/lang/Object;IIILjava/lang/Object;)V
            readStream (I)I
            seekStream (IJ)J
            seekStreamEx (IJ)J
            timeSeekStream (JJ)J
            getSeekType ()I
            cancelRead ()V
            closeStream ()V
            setVideoCodecInfo (IIIIII)V
            setAllVideoCodecInfo (IIIIIIII)V
            setSubtitleTrackInfo (IILjava/lang/String;I)V
            setAllSubtitleTrackInfo (IIIILjava/lang/String;I)V
            setAllAudioTrackInfo (IIIIIIII%1$s%1$s%1$s%1$sI%1$s%1$s%1$s%1$s)V
            setMetaDataInfo (IIII%1$s%1$s%1$s%1$sI%1$s%1$s%1$s)V
            setDivxTitleInfoPrm (III)V
            setDivxChapInfoPrm (IIII)V
            setDivxPlayListInfoPrm (IIII)V
            setDivxPositionInfoPrm (III)V
            setDivxDisplayInfoPrm (IIIII%1$sI%1$sI)V
            setDivxLastMemoryFilePositionPrm (JIIIIIJJJJJJIIJJI)V
            """.formatted("Ljava/lang/String;"));

    private static final List<String> FIELDS = rows("""
            mNativeContext J
            mNativeSurfaceTexture J
            mStreamReadBuffer [B
            mStreamSize J
            mStreamCurPos J
            mStreamSeekable Z
            mDataSourceType I
            mStallingSupport Z
            mStreamDuration J
            """);

    @Test
    void theClassDeclaresExactlyTheNativesOfTheTable() {
        assertEquals(83, NATIVES.size());
        List<String> declared = methods().filter(m -> Modifier.isNative(m.getModifiers()))
                .map(NativeTableTest::row)
                .toList();
        assertSame(NATIVES, declared);
    }

    @Test
    void theClassDeclaresEveryCallback() {
        List<String> declared = methods().map(NativeTableTest::row)
                .filter(CALLBACKS::contains)
                .toList();
        assertSame(CALLBACKS, declared);
    }

    @Test
    void theClassDeclaresEveryFieldThatTheNativeHalfReads() {
        List<String> declared = Arrays.stream(OrvMediaPlayer.class.getDeclaredFields())
                .filter(field -> !Modifier.isStatic(field.getModifiers()))
                .map(field -> field.getName() + " " + field.getType().descriptorString())
                .filter(FIELDS::contains)
                .toList();
        assertSame(FIELDS, declared);
    }

    @Test
    void loadingBindsTheNativesAndTheMembers() throws Exception {
        OrvMediaPlayer.native_init(); // Throws when it is unbound or misses a member.
        OrvMediaPlayer player = new OrvMediaPlayer();
        Field context = OrvMediaPlayer.class.getDeclaredField("mNativeContext");
        context.setAccessible(true);
        assertEquals(true, context.getLong(player) != 0, "native_setup wrote no service");
        player.close();
        assertEquals(0, context.getLong(player));
    }

    private static Stream<Method> methods() {
        return Arrays.stream(OrvMediaPlayer.class.getDeclaredMethods());
    }

    private static String row(Method method) {
        String type = MethodType.methodType(method.getReturnType(), method.getParameterTypes())
                .toMethodDescriptorString();
        boolean isStatic = Modifier.isStatic(method.getModifiers());
        return (isStatic ? "static " : "") + method.getName() + " " + type;
    }

    private static List<String> rows(String text) {
        return text.lines().map(String::strip).toList();
    }

    private static void assertSame(List<String> expected, List<String> actual) {
        assertEquals(
                String.join("\n", new TreeSet<>(expected)),
                String.join("\n", new TreeSet<>(actual)));
        assertEquals(expected.size(), actual.size());
    }
}
