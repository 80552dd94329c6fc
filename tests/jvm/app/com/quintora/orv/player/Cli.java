// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import java.io.ByteArrayOutputStream;
import java.io.PrintStream;
import java.nio.charset.StandardCharsets;
import java.util.List;

/** Runs a command as main does, but for ending the program. */
record Cli(int status, String out, String err) {
    static Cli run(String... arguments) {
        PrintStream out = System.out;
        PrintStream err = System.err;
        var outBytes = new ByteArrayOutputStream();
        var errBytes = new ByteArrayOutputStream();
        System.setOut(new PrintStream(outBytes, true, StandardCharsets.UTF_8));
        System.setErr(new PrintStream(errBytes, true, StandardCharsets.UTF_8));
        try {
            int status = Main.commandLine(arguments).execute(arguments);
            return new Cli(
                    status,
                    outBytes.toString(StandardCharsets.UTF_8),
                    errBytes.toString(StandardCharsets.UTF_8));
        } finally {
            System.setOut(out);
            System.setErr(err);
        }
    }

    List<String> outLines() {
        return out.lines().toList();
    }

    List<String> errLines() {
        return err.lines().toList();
    }
}
