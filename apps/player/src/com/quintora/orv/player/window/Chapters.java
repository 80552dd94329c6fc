// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import com.quintora.mmp.Chapter;
import com.quintora.orv.player.ReadingOrder;
import com.quintora.orv.player.Times;
import java.util.ArrayList;
import java.util.List;
import java.util.OptionalInt;
import java.util.function.IntConsumer;

/** The chapters of a media, in their order, counted from 0. Immutable; times in milliseconds. */
final class Chapters {
    static final Chapters NONE = new Chapters(List.of());

    // So soon after a chapter's start, the one before is meant.
    private static final int AT_START_MS = 3_000;

    private final List<Chapter> chapters;

    Chapters(List<Chapter> chapters) {
        this.chapters = List.copyOf(chapters);
    }

    int count() {
        return chapters.size();
    }

    int start(int index) {
        return chapters.get(index).startMillis();
    }

    /** The title, or a number where there is none. */
    String name(int index) {
        String title = chapters.get(index).title();
        return title.isEmpty() ? "Chapter " + (index + 1) : title;
    }

    /** The one that plays at that time; none before the first. */
    OptionalInt at(int millis) {
        int found = -1;
        for (int i = 0; i < count() && start(i) <= millis; i++) {
            found = i;
        }
        return found < 0 ? OptionalInt.empty() : OptionalInt.of(found);
    }

    /**
     * So many chapters on from that time, or back when negative: the first step back leads to the
     * start of the one that plays, unless it has just begun. Empty behind the last one.
     */
    OptionalInt from(int millis, int steps) {
        int now = at(millis).orElse(-1);
        boolean isWellInside = now >= 0 && millis - start(now) > AT_START_MS;
        int wanted = now + steps + (steps < 0 && isWellInside ? 1 : 0);
        return wanted < count() ? OptionalInt.of(Math.max(0, wanted)) : OptionalInt.empty();
    }

    List<ChoiceMenu.Choice> choices(int millis, IntConsumer goTo) {
        OptionalInt now = at(millis);
        List<ChoiceMenu.Choice> choices = new ArrayList<>();
        for (int i = 0; i < count(); i++) {
            int index = i;
            boolean isNow = now.isPresent() && now.getAsInt() == i;
            choices.add(
                    new ChoiceMenu.Choice(
                            ReadingOrder.ofSentence(
                                    Times.clock(start(i))
                                            + "  "
                                            + ReadingOrder.ofName(name(i))),
                            isNow,
                            () -> goTo.accept(index)));
        }
        return choices;
    }
}
