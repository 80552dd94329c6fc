// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import java.io.IOException;
import java.nio.file.Files;
import java.nio.file.Path;
import picocli.AutoComplete;

/** Writes the completions of the player's commands for bash, from what describes their arguments. */
public final class Completion {
    private Completion() {}

    public static void main(String[] arguments) throws IOException {
        String script = AutoComplete.bash("orv", Main.commandLine());
        // It is read by a shell, not run.
        Files.writeString(Path.of(arguments[0]), script.replaceFirst("^#!.*\n", ""));
    }
}
