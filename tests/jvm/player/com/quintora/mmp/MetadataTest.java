// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertTrue;

import org.junit.jupiter.api.Test;
import org.junit.jupiter.params.ParameterizedTest;
import org.junit.jupiter.params.provider.ValueSource;

class MetadataTest extends PlayerFixture {
    @ParameterizedTest
    @ValueSource(strings = {"tagged.mp3", "tagged.ogg"})
    void tagsOfSeveralScriptsArrive(String media) throws Exception {
        prepare(media);
        MediaMetadata metadata = player.tracks().metadata().orElseThrow();
        assertEquals("Ode an die Freude – К радости", metadata.title());
        assertEquals("東京交響楽団", metadata.artist());
        assertEquals("موسيقى", metadata.genre());
        assertEquals("Ludwig van Beethoven", metadata.composer());
        assertEquals(1824, metadata.year());
        assertEquals(3, metadata.trackNumber());
        assertEquals(4000, metadata.durationMillis(), 100);
        assertTrue(metadata.bitRate() > 0);
    }

    @Test
    void textsEndAtTheirLimitAndNeverInsideACharacter() throws Exception {
        prepare("tagged.mp3");
        MediaMetadata metadata = player.tracks().metadata().orElseThrow();
        assertEquals("Α".repeat(128), metadata.album());
        assertEquals("c".repeat(126) + "\uD834\uDD1E", metadata.comment());
    }

    @Test
    void brokenTagsDoNoHarm() throws Exception {
        prepare("broken-tags.mp4");
        MediaMetadata metadata = player.tracks().metadata().orElseThrow();
        assertTrue(metadata.title().startsWith("caf"), metadata.title());
        assertEquals(0, metadata.trackNumber());
        assertEquals(0, metadata.year());
    }

    @Test
    void theContainerAndItsChaptersAreNamed() throws Exception {
        prepare("feature.mkv");
        MediaMetadata metadata = player.tracks().metadata().orElseThrow();
        assertEquals("The Feature", metadata.title());
        assertEquals(3, metadata.chapterCount());
        assertEquals("Matroska / WebM", metadata.container());
    }
}
