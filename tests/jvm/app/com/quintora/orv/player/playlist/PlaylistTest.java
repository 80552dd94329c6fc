// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.playlist;

import static org.junit.jupiter.api.Assertions.assertEquals;
import static org.junit.jupiter.api.Assertions.assertFalse;
import static org.junit.jupiter.api.Assertions.assertTrue;

import java.util.ArrayList;
import java.util.HashSet;
import java.util.List;
import java.util.OptionalInt;
import java.util.Random;
import java.util.stream.IntStream;
import org.junit.jupiter.api.Test;

/** Which media comes next. */
class PlaylistTest {
    private final Playlist list = new Playlist(new Random(7));

    @Test
    void oneComesAfterTheOther() {
        fill(3);
        assertEquals(OptionalInt.of(1), list.next());
        assertEquals(OptionalInt.empty(), list.previous());
        list.goTo(2);
        assertEquals(OptionalInt.empty(), list.next());
        assertEquals(OptionalInt.of(1), list.previous());
    }

    @Test
    void allAreRepeated() {
        fill(3);
        list.setRepeat(Repeat.ALL);
        assertEquals(OptionalInt.of(2), list.previous());
        list.goTo(2);
        assertEquals(OptionalInt.of(0), list.next());
        assertFalse(list.repeatsCurrent());
    }

    @Test
    void ofOneAllIsTheSame() {
        fill(1);
        list.setRepeat(Repeat.ALL);
        assertTrue(list.repeatsCurrent());
        assertEquals(OptionalInt.empty(), list.next());
    }

    @Test
    void aKeyLeavesTheRepeatedOne() {
        fill(2);
        list.setRepeat(Repeat.ONE);
        assertTrue(list.repeatsCurrent());
        assertEquals(OptionalInt.of(1), list.next());
    }

    @Test
    void shuffledEachComesOnce() {
        fill(20);
        list.goTo(5);
        list.setShuffled(true);
        List<Integer> played = new ArrayList<>(List.of(5));
        for (OptionalInt next; (next = list.next()).isPresent(); ) {
            list.goTo(next.getAsInt());
            played.add(next.getAsInt());
        }
        assertEquals(20, new HashSet<>(played).size());
        assertEquals(20, played.size());
        assertFalse(played.equals(played.stream().sorted().toList()), played::toString);
    }

    @Test
    void whatIsTakenOutOrAddedLeavesTheCurrentOne() {
        fill(4);
        list.goTo(2);
        list.remove(0);
        assertEquals("2", list.currentEntry().source());
        list.remove(2);
        assertEquals("2", list.currentEntry().source());
        assertEquals(OptionalInt.empty(), list.next());
        list.add(List.of(new Entry("new")));
        assertEquals(OptionalInt.of(2), list.next());
        list.goTo(2);
        list.remove(2);
        assertEquals("2", list.currentEntry().source());
    }

    private void fill(int count) {
        list.set(IntStream.range(0, count).mapToObj(i -> new Entry("" + i)).toList());
    }
}
