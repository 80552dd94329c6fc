// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal.media;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertFalse;

import com.quintora.mmp.MediaDescription;
import com.quintora.mmp.MediaStream;
import com.quintora.mmp.PictureDetails;
import java.util.List;
import java.util.Optional;
import java.util.OptionalInt;
import java.util.OptionalLong;
import org.junit.jupiter.api.Test;

class DescriptionTextTest {
    @Test
    void aTextOfAnotherFormIsUnknownValues() {
        assertEquals(Optional.empty(), DescriptionText.parse(""));
        assertEquals(Optional.empty(), DescriptionText.parse("neither\n=a\n[stream]\nindex=1\n"));
        String text = "[media]\nformat=x\nsize=many\nstartUs=-5\n[news]\nformat=y\n"
                + "[stream]\nkind=hologram\nindex=99999999999\nlevel=\n"
                + "[stream]\nkind=video\npixelAspect=4\ndisplayAspect=0:1\nframeRate=30000/1001\n"
                + "title=a\\nb\\\\n\\\nbroken";
        MediaDescription media = DescriptionText.parse(text).orElseThrow();
        assertEquals("x", media.format());
        assertEquals(OptionalLong.empty(), media.size());
        assertEquals(OptionalLong.of(-5), media.startMicros());
        MediaStream unknown = media.streams().get(0);
        assertEquals(MediaStream.Kind.DATA, unknown.kind());
        assertEquals(0, unknown.index());
        assertEquals(OptionalInt.empty(), unknown.level());
        assertEquals(List.of(), unknown.flags());
        MediaStream video = media.streams().get(1);
        assertEquals(Optional.of("a\nb\\n\\"), video.title());
        PictureDetails picture = video.picture().orElseThrow();
        assertEquals(Optional.empty(), picture.pixelAspect());
        assertEquals(Optional.empty(), picture.displayAspect());
        assertEquals(29.97, picture.frameRate().orElseThrow(), 0.001);
        assertFalse(picture.mirrored());
    }
}
