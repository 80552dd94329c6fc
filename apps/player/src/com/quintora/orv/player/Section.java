// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import picocli.CommandLine.TypeConversionException;

/** A section to repeat, in milliseconds: written A-B or, with plain seconds, A:B. */
public record Section(int from, int to) {
    static Section parse(String text) {
        int cut = text.indexOf('-') > 0 ? text.indexOf('-') : text.indexOf(':');
        boolean isOfSeconds = text.indexOf('-') < 0;
        // Which of several colons separates the times is not known.
        if (cut <= 0 || isOfSeconds && cut != text.lastIndexOf(':')) {
            throw new TypeConversionException(
                    "'" + text + "' is not a section; write 10:20 for seconds, or 0:10-0:20");
        }
        Section section =
                new Section(
                        Times.parseMillis(text.substring(0, cut)),
                        Times.parseMillis(text.substring(cut + 1)));
        if (section.from >= section.to) {
            throw new TypeConversionException(
                    "the section '" + text + "' ends before it begins");
        }
        return section;
    }
}
