// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.memory;

import com.quintora.orv.player.Times;
import com.quintora.orv.player.playlist.Entry;
import java.util.ArrayList;
import java.util.List;
import java.util.Map;
import picocli.CommandLine.TypeConversionException;

/** The media that were played last, the newest first, and where each was left. */
public final class RecentMedia {
    /**
     * One of them.
     *
     * @param positionMs where it was left; 0 when it was seen to its end, or hardly begun
     */
    public record Item(Entry entry, int positionMs) {}

    private static final int MOST = 20;
    // Nobody wants to go on so near to the start or to the end.
    private static final int MARGIN_MS = 10_000;

    private static final String SOURCE = "source";
    private static final String TITLE = "title";
    private static final String POSITION = "position";

    private final Memory memory;

    public RecentMedia(Memory memory) {
        this.memory = memory;
    }

    /** Blocks while the file is read. */
    public List<Item> list() {
        return listOf(memory.read());
    }

    /** Where media was left, in milliseconds; 0 when nothing is known. */
    public int positionOf(String source) {
        return list().stream()
                .filter(item -> item.entry().source().equals(source))
                .mapToInt(Item::positionMs)
                .findFirst()
                .orElse(0);
    }

    /**
     * Remembers that this was played up to there. Blocks while the file is written.
     *
     * @param durationMs 0 when it is not known: then media are live, and have no place
     */
    public void add(Entry entry, int positionMs, int durationMs) {
        if (entry.source().equals("-")) {
            return;
        }
        boolean isWorthIt = positionMs >= MARGIN_MS && positionMs <= durationMs - MARGIN_MS;
        Item newest = new Item(entry, isWorthIt ? positionMs : 0);
        memory.update(values -> add(values, newest));
    }

    private static void add(Map<String, String> values, Item newest) {
        List<Item> items = new ArrayList<>(listOf(values));
        items.removeIf(item -> item.entry().source().equals(newest.entry().source()));
        items.add(0, newest);
        values.keySet().removeIf(name -> name.startsWith("recent."));
        for (int i = 0; i < Math.min(MOST, items.size()); i++) {
            Item item = items.get(i);
            values.put(name(i, SOURCE), item.entry().source());
            if (!item.entry().title().isEmpty()) {
                values.put(name(i, TITLE), item.entry().title());
            }
            if (item.positionMs() > 0) {
                values.put(name(i, POSITION), Times.clock(item.positionMs()));
            }
        }
    }

    private static List<Item> listOf(Map<String, String> values) {
        List<Item> items = new ArrayList<>();
        for (int i = 0; i < MOST; i++) {
            String source = values.get(name(i, SOURCE));
            if (source != null && !source.isEmpty()) {
                String title = values.getOrDefault(name(i, TITLE), "");
                items.add(new Item(new Entry(source, title), position(values, i)));
            }
        }
        return items;
    }

    private static int position(Map<String, String> values, int place) {
        try {
            return Times.parseMillis(values.getOrDefault(name(place, POSITION), "0"));
        } catch (TypeConversionException e) {
            return 0; // Somebody has changed the file.
        }
    }

    // They sort by their number.
    private static String name(int place, String what) {
        int number = place + 1;
        return "recent." + (number < 10 ? "0" : "") + number + "." + what;
    }
}
