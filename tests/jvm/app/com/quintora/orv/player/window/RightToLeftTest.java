// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import static org.junit.jupiter.api.Assertions.assertTrue;

import com.quintora.mmp.Chapter;
import com.quintora.orv.player.Ellipsis;
import java.awt.FontMetrics;
import java.util.List;
import javax.swing.JLabel;
import org.junit.jupiter.api.Test;

/** Hebrew names in what is drawn. */
class RightToLeftTest {
    private static final String NAME = "שלום עולם טוב.mkv";

    @Test
    void whatIsShortenedAtItsEndKeepsItsFirstLetters() {
        FontMetrics metrics = new JLabel().getFontMetrics(Theme.body());
        String shown = Ellipsis.atEnd(NAME, metrics, metrics.stringWidth(NAME) / 2);
        String kept = shown.substring(0, shown.length() - 1);
        assertTrue(NAME.startsWith(kept) && kept.length() > 3, shown);
        String seen = "…" + new StringBuilder(kept).reverse();
        Letters.assertSame(Letters.drawn(Letters.AS_THEY_STAND + seen), Letters.drawn(shown));
    }

    @Test
    void menusKeepTimesBeforeNames() {
        var chapters = new Chapters(List.of(new Chapter(0, 10_000, 20_000, "ערב טוב!")));
        String row = chapters.choices(0, place -> {}).get(0).text();
        Letters.assertSame(
                Letters.drawn(Letters.AS_THEY_STAND + "0:10  !בוט ברע"), Letters.drawn(row));
    }
}
