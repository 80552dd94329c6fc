// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertThrows;
import static org.junit.jupiter.api.Assertions.assertTrue;

import java.util.List;
import java.util.Optional;
import java.util.OptionalDouble;
import java.util.OptionalInt;
import org.junit.jupiter.api.Test;

class DescriptionTest extends PlayerFixture {
    @Test
    void thereIsNoneBeforeTheMedia() {
        assertEquals(Optional.empty(), player.tracks().description());
        player.close();
        assertThrows(IllegalStateException.class, () -> player.tracks().description());
    }

    @Test
    void itNamesEveryStream() throws Exception {
        prepare("tracks.mkv");
        MediaDescription media = player.tracks().description().orElseThrow();
        assertEquals("matroska,webm", media.format());
        assertEquals(5, media.streams().size());
        MediaStream german = media.streams().get(2);
        assertEquals(MediaStream.Kind.AUDIO, german.kind());
        assertEquals(OptionalInt.of(1), german.track());
        assertEquals("flac", german.codec());
        assertEquals(Optional.of("Kommentar (größer)"), german.title());
        assertEquals(OptionalInt.of(44_100), german.sound().orElseThrow().sampleRate());
        assertEquals(Optional.empty(), german.picture());
        assertThrows(UnsupportedOperationException.class, () -> media.streams().clear());
    }

    @Test
    void itKnowsTurningColoursAndAttachments() throws Exception {
        prepare("hdr10.mp4");
        PictureDetails picture = onlyStream(MediaStream.Kind.VIDEO).picture().orElseThrow();
        assertEquals(Optional.of("PQ"), picture.color().highDynamicRange());
        assertEquals(OptionalInt.of(10), picture.bitDepth());
        assertEquals(OptionalDouble.of(4000), picture.light().masteringMax());
        player.resetAndWait();
        prepare("lying90mirrored.mp4");
        picture = onlyStream(MediaStream.Kind.VIDEO).picture().orElseThrow();
        assertEquals(90, picture.rotation());
        assertTrue(picture.mirrored());
        assertEquals(90, picture.displayWidth());
        player.resetAndWait();
        prepare("fonts.mkv");
        var font = onlyStream(MediaStream.Kind.ATTACHMENT).attachment().orElseThrow();
        assertEquals(Optional.of("Größe ＡＢ.ttf"), font.fileName());
        assertTrue(font.size().orElseThrow() > 100_000);
    }

    @Test
    void titlesKeepWhatLinesAreMadeOf() throws Exception {
        prepare("spoken.mkv");
        MediaStream video = onlyStream(MediaStream.Kind.VIDEO);
        assertEquals(Optional.of("Première \\ prise"), video.title());
        assertEquals(Optional.of("fra"), video.language());
    }

    private MediaStream onlyStream(MediaStream.Kind kind) {
        List<MediaStream> found =
                player.tracks().description().orElseThrow().streams().stream()
                        .filter(stream -> stream.kind() == kind)
                        .toList();
        assertEquals(1, found.size());
        return found.get(0);
    }
}
