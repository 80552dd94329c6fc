// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import java.io.IOException;
import java.nio.file.Files;
import java.nio.file.Path;
import picocli.AutoComplete;

/**
 * Writes the completions of the player's commands for bash, from what describes their arguments,
 * to a file: the first argument. Those of other commands, which the further ones name, follow.
 */
public final class Completion {
    private Completion() {}

    public static void main(String[] arguments) throws IOException {
        String script = AutoComplete.bash("orv", Main.commandLine());
        // It is read by a shell, not run.
        StringBuilder text = new StringBuilder(script.replaceFirst("^#!.*\n", ""));
        for (int i = 1; i < arguments.length; i++) {
            text.append(Files.readString(Path.of(arguments[i])));
        }
        Files.writeString(Path.of(arguments[0]), text);
    }
}
