// SPDX-License-Identifier: Apache-2.0
package com.quintora.mmp.internal;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertSame;
import static org.junit.jupiter.api.Assertions.assertTrue;

import com.quintora.mmp.DivxNavigation;
import com.quintora.mmp.util.DivxLastMemoryFilePosition;
import java.util.List;
import java.util.Map;
import java.util.Optional;
import java.util.function.BooleanSupplier;
import java.util.function.Supplier;
import org.junit.jupiter.api.AfterEach;
import org.junit.jupiter.api.Test;

/** DivX navigation as an engine that knows it would answer; the desktop's does not. */
class DivxUnitTest {
    private final ScriptedNatives natives = new ScriptedNatives();
    private final PlayerUnits units = natives.units();

    @AfterEach
    void close() {
        units.lifetime.close();
    }

    @Test
    void aRecordIsThatOfItsCallAndOfNoOther() {
        DivxLastMemoryFilePosition left = new DivxLastMemoryFilePosition();
        Map<String, Object> records = Map.of(
                "getDivxTitleInfo", new DivxNavigation.TitleInfo(1, 2, 3),
                "getDivxChapInfo", new DivxNavigation.ChapterInfo(1, 2, 3, 4),
                "getDivxPlayListInfo", new DivxNavigation.ChapterInfo(5, 6, 7, 8),
                "getDivxPositionInfo", new DivxNavigation.PositionInfo(1, 2, 3),
                "getDivxDisplayInfo", new DivxNavigation.DisplayInfo(List.of(1), "a", "b"),
                "getDivxLastMemoryFilePosition", left);
        Map<String, Supplier<Optional<?>>> getters = Map.of(
                "getDivxTitleInfo", () -> units.divx.title(1),
                "getDivxChapInfo", () -> units.divx.chapter(1, 2, 3),
                "getDivxPlayListInfo", () -> units.divx.playlist(5, 6),
                "getDivxPositionInfo", units.divx::position,
                "getDivxDisplayInfo", () -> units.divx.display(1, 2, 3, 4, 5),
                "getDivxLastMemoryFilePosition", units.divx::lastMemory);
        getters.forEach((name, getter) -> {
            natives.answer(name, () -> {
                units.divx.receive(records.get(name));
                return true;
            });
            assertSame(records.get(name), getter.get().orElseThrow(), name);
            natives.answer(name, () -> false);
            assertEquals(Optional.empty(), getter.get(), name + " without a record");
        });
        assertTrue(natives.lines.containsAll(List.of("getDivxTitleInfo[1]",
                "getDivxChapInfo[1, 2, 3]", "getDivxPlayListInfo[5, 6]", "getDivxPositionInfo[]",
                "getDivxDisplayInfo[1, 2, 3, 4, 5]", "getDivxLastMemoryFilePosition[]")),
                natives.lines.toString());
    }

    @Test
    void whatIsSetIsPassedOnAndAboveZeroMeansDone() {
        DivxLastMemoryFilePosition left = new DivxLastMemoryFilePosition();
        Map<String, BooleanSupplier> setters = Map.of(
                "setDivxTitleInfo[1, 2, 3]", () -> units.divx.setTitle(1, 2, 3),
                "setDivxChapInfo[1, 2, 3, 4]", () -> units.divx.setChapter(1, 2, 3, 4),
                "setDivxPlayListInfo[1, 2, 3, 4]", () -> units.divx.setPlaylist(1, 2, 3, 4),
                "setDivxBtnInfo[1, 2]", () -> units.divx.pressButton(1, 2),
                "setDivxFilePosition[1, 2]", () -> units.divx.setFilePosition(1, 2),
                "setDivxLastMemoryFilePosition[" + left + "]",
                () -> units.divx.setLastMemory(left));
        setters.forEach((line, setter) -> {
            String name = line.substring(0, line.indexOf('['));
            for (int answer : new int[] {1, 7, 0, -1}) {
                natives.answer(name, () -> answer);
                natives.lines.clear();
                assertEquals(answer > 0, setter.getAsBoolean(), name + " that answers " + answer);
                assertEquals(List.of(line), natives.lines);
            }
        });
    }

    @Test
    void countsArePassedOn() {
        natives.answer("getDivxTitleNum", () -> 3);
        natives.answer("getDivxLastMemoryFileID", () -> 9);
        assertEquals(3, units.divx.titleCount());
        assertEquals(9, units.divx.lastMemoryFileId());
    }
}
