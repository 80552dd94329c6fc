// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertThrows;

import com.quintora.mmp.util.PcmMediaInfo;
import com.quintora.mmp.util.PcmMediaInfo.AudioPcmInfo;
import java.nio.file.Files;
import java.nio.file.Path;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.api.io.TempDir;
import org.junit.jupiter.params.ParameterizedTest;
import org.junit.jupiter.params.provider.CsvSource;
import org.junit.jupiter.params.provider.ValueSource;

/** Raw samples, which only their description makes media. */
class PcmTest extends PlayerFixture {
    private static final int TWO_SECONDS = 2 * 44_100 * 4;

    @ParameterizedTest
    @ValueSource(booleans = {false, true})
    void samplesOfBothByteOrdersPlay(boolean bigEndian) throws Exception {
        PcmMediaInfo format = PcmMediaInfo.of(44_100, 2, 16).withLength(2000, TWO_SECONDS);
        player.setPcmFormat(bigEndian ? format.withBigEndian() : format);
        prepare(bigEndian ? "tone-s16be.pcm" : "tone-s16le.pcm");
        AudioTrack track = player.tracks().audio().get(0);
        assertEquals(2, track.channels());
        assertEquals(44_100, track.sampleRate());
        assertEquals(2000, player.getDuration(), 20);
        player.start();
        awaitState(PlayerState.COMPLETED);
    }

    @ParameterizedTest
    @CsvSource({
        "8000, 1, 8, 1", "8000, 1, 8, 3", "8000, 1, 8, 4", "48000, 2, 24, 0", "96000, 6, 32, 0",
        "48000, 2, 32, 2", "48000, 1, 16, 0"
    })
    void otherFormatsArePlayedAsTheyAreDescribed(int rate, int channels, int bits, int type,
            @TempDir Path folder) throws Exception {
        int second = rate * channels * bits / 8;
        Path silence = Files.write(folder.resolve("silence.pcm"), new byte[second]);
        player.setPcmFormat(PcmMediaInfo.of(rate, channels, bits).withType(type));
        open(silence.toString());
        assertEquals(rate, player.tracks().audio().get(0).sampleRate());
        assertEquals(channels, player.tracks().audio().get(0).channels());
        assertEquals(1000, player.getDuration(), 30);
    }

    @Test
    void samplesPlayFromAStream() throws Exception {
        byte[] samples = Files.readAllBytes(Path.of(Media.path("tone-s16le.pcm")));
        player.setPcmFormat(PcmMediaInfo.of(44_100, 2, 16).withLength(2000, samples.length));
        player.setDataSource(new ScriptedSource(samples));
        player.prepareAndWait();
        player.start();
        awaitState(PlayerState.COMPLETED);
    }

    @Test
    void theDescriptionIsForgottenWithItsMedia() throws Exception {
        player.setPcmFormat(PcmMediaInfo.of(44_100, 2, 16));
        prepare("tone-s16le.pcm");
        player.resetAndWait();
        prepare("silent.mkv");
        assertEquals(2000, player.getDuration(), 50);
        player.resetAndWait();
        player.setDataSource(Media.path("tone-s16le.pcm"));
        assertThrows(MediaException.class, player::prepareAndWait);
    }

    @Test
    void aDescriptionOutOfRangeIsRefused() throws Exception {
        PcmMediaInfo bad = PcmMediaInfo.of(44_100, 9, 16);
        assertThrows(IllegalArgumentException.class, () -> player.setPcmFormat(bad));
        assertThrows(IllegalArgumentException.class, () -> player.setPcmFormat(null));
        prepare("silent.mkv");
        PcmMediaInfo good = PcmMediaInfo.of(44_100, 2, 16);
        assertThrows(IllegalStateException.class, () -> player.setPcmFormat(good));
    }

    @Test
    void theEngineRefusesWhatTheNativeHalfPassesOn() throws Exception {
        PcmMediaInfo bad = PcmMediaInfo.of(44_100, 2, 16).withType(AudioPcmInfo.FLOAT);
        player.native_setPcmMediaInfo(bad);
        prepare("silent.mkv");
        assertEquals(2000, player.getDuration(), 50);
    }
}
