// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.playlist;

import java.util.ArrayList;
import java.util.Collections;
import java.util.List;
import java.util.OptionalInt;
import java.util.Random;
import java.util.stream.Collectors;
import java.util.stream.IntStream;

/**
 * Media in their order, which one is current, and which one comes next. Places count from 0. Not
 * thread-safe.
 */
public final class Playlist {
    private final List<Entry> entries = new ArrayList<>();
    private final Random random;
    // Places in the order in which they are played; the list's own unless shuffled.
    private List<Integer> order = List.of();
    private int current;
    private Repeat repeat = Repeat.OFF;
    private boolean isShuffled;

    public Playlist() {
        this(new Random());
    }

    /** Shuffles by that source of randomness. */
    public Playlist(Random random) {
        this.random = random;
    }

    public List<Entry> entries() {
        return Collections.unmodifiableList(entries);
    }

    /** Replaces all entries; the first to be played is current. */
    public void set(List<Entry> all) {
        entries.clear();
        entries.addAll(all);
        current = 0;
        reorder(false);
        current = order.isEmpty() ? 0 : order.get(0);
    }

    /** Adds entries at the end. */
    public void add(List<Entry> more) {
        entries.addAll(more);
        reorder(true);
    }

    /** Takes an entry away; when that was the current one, the one in its place is current. */
    public void remove(int place) {
        entries.remove(place);
        if (place < current || current == entries.size() && current > 0) {
            current--;
        }
        reorder(true);
    }

    /** The place of the entry that plays. */
    public int current() {
        return current;
    }

    /**
     * Of the current entry.
     *
     * @throws IndexOutOfBoundsException when the list is empty
     */
    public Entry currentEntry() {
        return entries.get(current);
    }

    public void goTo(int place) {
        current = place;
    }

    /** The place after the current one, as a key asks for it; none after the last. */
    public OptionalInt next() {
        return at(order.indexOf(current) + 1);
    }

    /** The place before the current one; none before the first. */
    public OptionalInt previous() {
        return at(order.indexOf(current) - 1);
    }

    private OptionalInt at(int index) {
        int count = order.size();
        if (repeat == Repeat.ALL && count > 1) {
            return OptionalInt.of(order.get(Math.floorMod(index, count)));
        }
        return index < 0 || index >= count ? OptionalInt.empty() : OptionalInt.of(order.get(index));
    }

    public Repeat repeat() {
        return repeat;
    }

    public void setRepeat(Repeat repeat) {
        this.repeat = repeat;
    }

    /** Whether the current entry begins again at its end. */
    public boolean repeatsCurrent() {
        return repeat == Repeat.ONE || repeat == Repeat.ALL && entries.size() == 1;
    }

    public boolean isShuffled() {
        return isShuffled;
    }

    /** Plays the others in an order of chance after the current one, or in the list's order. */
    public void setShuffled(boolean shuffled) {
        isShuffled = shuffled;
        reorder(true);
    }

    private void reorder(boolean keepsCurrent) {
        order = IntStream.range(0, entries.size()).boxed().collect(Collectors.toList());
        if (isShuffled) {
            Collections.shuffle(order, random);
            if (keepsCurrent && !order.isEmpty()) {
                Collections.swap(order, 0, order.indexOf(current));
            }
        }
    }
}
