// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.terminal;

import static org.junit.jupiter.api.Assertions.assertEquals;

import java.io.ByteArrayOutputStream;
import java.io.PrintStream;
import org.junit.jupiter.api.Test;

/** The terminal is left as it was found. */
class TerminalTest {
    private final ByteArrayOutputStream bytes = new ByteArrayOutputStream();
    private final Terminal terminal = new Terminal(new PrintStream(bytes), 80);

    @Test
    void aDrawnLineHidesTheCursorUntilTheTerminalIsRestored() {
        terminal.draw("one");
        terminal.draw("two");
        terminal.restore();
        terminal.restore();
        assertEquals("\033[?25l\r\033[Kone\r\033[Ktwo\033[?25h\n", bytes.toString());
    }

    @Test
    void aLineOfItsOwnComesAfterTheDrawnOne() {
        terminal.draw("bar");
        terminal.line("words");
        assertEquals("\033[?25l\r\033[Kbar\033[?25h\nwords\n", bytes.toString());
    }

    @Test
    void nothingIsWrittenOnceItIsClosed() {
        terminal.draw("bar");
        terminal.close();
        int length = bytes.size();
        terminal.draw("late");
        terminal.line("later");
        terminal.restore();
        assertEquals(length, bytes.size());
    }
}
