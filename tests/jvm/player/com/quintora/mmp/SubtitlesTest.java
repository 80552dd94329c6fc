// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertThrows;
import static org.junit.jupiter.api.Assertions.assertTrue;

import com.quintora.SubtitleAttr;
import java.nio.file.Files;
import java.nio.file.Path;
import java.util.Optional;
import java.util.List;
import java.util.concurrent.ExecutionException;
import java.util.function.IntPredicate;
import java.util.function.Predicate;
import org.junit.jupiter.api.AfterEach;
import org.junit.jupiter.api.BeforeEach;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.api.function.Executable;
import org.junit.jupiter.api.io.TempDir;

/** Subtitles and their looks, seen in the picture: a still grey one of 640 x 360. */
class SubtitlesTest extends PlayerFixture {
    private static final int GREY = 0x404040;
    private static final IntPredicate DRAWN = Frame.near(GREY, 24).negate();
    private static final IntPredicate YELLOW = Frame.near(0xFFFF00, 60);
    private static final IntPredicate RED = Frame.near(0xFF0000, 60);
    private static final IntPredicate BLUE = Frame.near(0x0000FF, 60);

    private final Screen screen = new Screen();

    @BeforeEach
    void prepare() throws Exception {
        player.setSurface(screen.surface());
        prepare("plain.mkv");
        player.seekToAndWait(2000);
        screen.await("the plain picture", SubtitlesTest::isPlain);
    }

    @AfterEach
    void closeScreen() {
        player.close();
        screen.close();
    }

    @Test
    void aTrackIsShownAndHidden() throws Exception {
        assertEquals(Optional.empty(), player.tracks().currentSubtitle());
        showSubtitle(0);
        Frame.Box text = awaitText().bounds(DRAWN);
        assertTrue(text.top() > 180, "it stands below the middle: " + text);
        assertEquals(320, text.left() + text.width() / 2, 6, "it stands in the middle: " + text);
        assertEquals(0, player.tracks().currentSubtitle().orElseThrow().index());
        player.tracks().selectNoneAndWait(Track.Kind.SUBTITLE);
        screen.await("no text", SubtitlesTest::isPlain);
        assertEquals(Optional.empty(), player.tracks().currentSubtitle());
    }

    @Test
    void tracksAreSwitched() throws Exception {
        showSubtitle(0);
        int inside = awaitText().bounds(DRAWN).width();
        showSubtitle(1);
        screen.await("the longer line", frame -> frame.bounds(DRAWN).width() > inside * 2);
        assertEquals(1, player.tracks().currentSubtitle().orElseThrow().index());
        assertEquals(1, player.tracks().currentSubtitle().orElseThrow().index());
    }

    @Test
    void theNativeHalfNumbersTracksOverAllKinds() throws Exception {
        player.native_selectTrack(2); // Picture, sound, then the first subtitles.
        awaitText();
        assertEquals(0, player.tracks().currentSubtitle().orElseThrow().index());
        player.native_deselectTrack(2);
        screen.await("no text", SubtitlesTest::isPlain);
    }

    @Test
    void lettersTakeTheirColour() throws Exception {
        showSubtitle(0);
        Frame before = awaitText();
        assertEquals(0, before.count(YELLOW));
        player.subtitles().setStyle(SubtitleAttr.builder().textColor(0xFFFFFF00).build());
        screen.await("yellow letters", frame -> frame.count(YELLOW) > 50);
    }

    @Test
    void edgesTakeTheirColour() throws Exception {
        showSubtitle(0);
        assertEquals(0, awaitText().count(RED));
        player.subtitles().setStyle(SubtitleAttr.builder().edgeColor(0xFFFF0000).build());
        screen.await("red edges", frame -> frame.count(RED) > 50);
    }

    @Test
    void theGroundTakesItsColour() throws Exception {
        showSubtitle(0);
        Frame.Box text = awaitText().bounds(DRAWN);
        player.subtitles().setStyle(SubtitleAttr.builder().backgroundColor(0xFF0000FF).build());
        Frame frame = screen.await("a blue ground",
                shown -> shown.count(BLUE) > text.width() * text.height() / 4);
        assertTrue(frame.bounds(BLUE).width() >= text.width(), "it lies behind the whole line");
    }

    @Test
    void lettersTakeTheirSize() throws Exception {
        showSubtitle(0);
        int usual = awaitText().bounds(DRAWN).height();
        player.subtitles().setStyle(SubtitleAttr.builder().fontSize(160).build());
        int large = screen.await("large letters", taller(usual * 2)).bounds(DRAWN).height();
        player.subtitles().setStyle(SubtitleAttr.builder().fontSize(20).build());
        screen.await("tiny letters", frame -> isText(frame) && !taller(usual).test(frame));
        player.subtitles().setStyle(SubtitleAttr.builder().fontSizeType(2).build());
        int size2 = screen.await("large type", taller(usual)).bounds(DRAWN).height();
        player.subtitles().setStyle(SubtitleAttr.builder().fontSizeType(0).build());
        screen.await("small type",
                frame -> isText(frame) && frame.bounds(DRAWN).height() < size2);
        assertTrue(large > size2);
    }

    @Test
    void textsMove() throws Exception {
        showSubtitle(0);
        Frame.Box usual = awaitText().bounds(DRAWN);
        player.subtitles().setStyle(SubtitleAttr.builder().displayOffset(0, -500).build());
        screen.await("the text further up",
                frame -> isText(frame) && frame.bounds(DRAWN).top() < usual.top() - 100);
        player.subtitles().setStyle(SubtitleAttr.builder().displayOffset(200, 0).build());
        screen.await("the text beginning at a fifth of 640",
                frame -> isText(frame) && Math.abs(frame.bounds(DRAWN).left() - 128) < 12
                        && Math.abs(frame.bounds(DRAWN).top() - usual.top()) < 10);
        player.subtitles().setStyle(SubtitleAttr.builder().displayOffset(-200, 0).build());
        screen.await("the text ending a fifth before 640", frame -> {
            Frame.Box box = frame.bounds(DRAWN);
            return isText(frame) && Math.abs(box.left() + box.width() - 512) < 12;
        });
        player.subtitles().setStyle(SubtitleAttr.builder().displayOffset(0, 0).build());
        screen.await("the text in its usual place", frame -> usual.equals(frame.bounds(DRAWN)));
    }

    @Test
    void textsShiftInTime() throws Exception {
        player.subtitles().addAndWait(Media.path("lines.srt"));
        awaitText();
        player.subtitles().setStyle(SubtitleAttr.builder().delay(8000).build());
        screen.await("nothing yet", SubtitlesTest::isPlain);
        player.subtitles().setStyle(SubtitleAttr.builder().delay(-500).build());
        awaitText();
    }

    @Test
    void severalAttributesTakeEffectTogether() throws Exception {
        showSubtitle(0);
        awaitText();
        player.subtitles().setStyle(SubtitleAttr.builder()
                .textColor(0xFFFFFF00)
                .edgeColor(0xFFFF0000)
                .fontSize(120)
                .build());
        screen.await("all of it",
                frame -> frame.count(YELLOW) > 200 && frame.count(RED) > 100);
    }

    @Test
    void aMaskWithEveryBitSetTakesAllGroups() throws Exception {
        showSubtitle(0);
        awaitText();
        SubtitleAttr attr = SubtitleAttr.builder().delay(0).fontSize(60).backgroundColor(0)
                .textColor(0xFFFFFF00).edgeColor(0xFFFF0000).displayOffset(0, 0).build();
        attr.mMask = -1;
        player.subtitles().setStyle(attr);
        screen.await("all of it", frame -> frame.count(YELLOW) > 50 && frame.count(RED) > 50);
    }

    @Test
    void attributesWithoutTheirGroupAreRefusedAndChangeNothing() throws Exception {
        showSubtitle(0);
        Frame before = awaitText();
        SubtitleAttr attr = SubtitleAttr.builder().textColor(0xFFFFFF00).build();
        attr.mMask |= SubtitleAttr.FLAG_SUBTITLE_BG_COLOR;
        assertThrows(IllegalArgumentException.class, () -> player.subtitles().setStyle(attr));
        // The native half stops at the missing group, before the one after it.
        player.native_setSubtitleAttr(attr);
        player.seekToAndWait(2000);
        assertEquals(before.bounds(DRAWN), awaitText().bounds(DRAWN));
        assertEquals(0, awaitText().count(YELLOW));
    }

    @Test
    void filesAreAddedAndShown() throws Exception {
        for (String name : new String[] {"lines.srt", "lines.ass", "latin1.srt"}) {
            int before = player.tracks().subtitles().size();
            player.subtitles().addAndWait(Media.path(name));
            awaitText();
            assertEquals(before + 1, player.tracks().subtitles().size(), name);
            assertEquals(before, player.tracks().currentSubtitle().orElseThrow().index(), name);
            assertTrue(player.tracks().subtitles().get(before).flags().isExternal(), name);
            player.tracks().selectNoneAndWait(Track.Kind.SUBTITLE);
            screen.await("no text", SubtitlesTest::isPlain);
        }
    }

    @Test
    void aPairOfFilesIsAddedAndShown() throws Exception {
        player.subtitles().addPairAndWait(Media.path("words.sub"), Media.path("words.idx"));
        awaitText();
        assertEquals(3, player.tracks().subtitles().size());
    }

    @Test
    void aPairOfFilesMayHaveDifferentNames(@TempDir Path folder) throws Exception {
        Path pictures = folder.resolve("pictures");
        Path index = folder.resolve("times");
        Files.copy(Path.of(Media.path("words.sub")), pictures);
        Files.copy(Path.of(Media.path("words.idx")), index);
        player.subtitles().addPairAndWait(pictures.toString(), index.toString());
        awaitText();
        assertEquals("en", player.tracks().subtitles().get(2).language(), "as the index says");
    }

    @Test
    void timedTextIsAddedAndShownWhenAskedFor() throws Exception {
        player.subtitles().addTimedTextAndWait(Media.path("lines.srt"));
        assertEquals(3, player.tracks().subtitles().size());
        showSubtitle(2);
        awaitText();
    }

    @Test
    void filesThatCannotBeReadAreRefusedAndAddNothing(@TempDir Path folder) throws Exception {
        String none = "/no/such.srt: no such file";
        assertMessage(none, () -> player.subtitles().addAndWait("/no/such.srt"));
        assertMessage(none, () -> player.subtitles().addTimedTextAndWait("/no/such.srt"));
        assertMessage("/no/such.idx: no such file",
                () -> player.subtitles().addPairAndWait("/no/such.sub", "/no/such.idx"));
        Path noise = Files.write(folder.resolve("noise.srt"), new byte[] {1, 2, 3, 4});
        assertMessage(noise + ": has no subtitles that can be read",
                () -> player.subtitles().addAndWait(noise.toString()));
        for (var adding : List.of(player.subtitles().add("/no/such.srt"),
                player.subtitles().addTimedText("/no/such.srt"),
                player.subtitles().addPair("/no/such.sub", "/no/such.srt"))) {
            ExecutionException later = assertThrows(ExecutionException.class, adding::get);
            assertEquals(none, later.getCause().getMessage());
        }
        assertEquals(0, player.native_addTimedTextSource("/no/such.srt"));
        assertEquals(2, player.tracks().subtitles().size());
        showSubtitle(0);
        awaitText();
    }

    private static void assertMessage(String message, Executable call) {
        MediaException thrown = assertThrows(MediaException.class, call);
        assertEquals(message, thrown.getMessage());
    }

    private Frame awaitText() throws InterruptedException {
        return screen.await("text", SubtitlesTest::isText);
    }

    private static boolean isPlain(Frame frame) {
        return frame.count(DRAWN) == 0;
    }

    private static boolean isText(Frame frame) {
        return frame.count(DRAWN) > 50;
    }

    private static Predicate<Frame> taller(int rows) {
        return frame -> frame.bounds(DRAWN).height() > rows;
    }
}
