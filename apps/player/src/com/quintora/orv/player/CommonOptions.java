// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player;

import picocli.CommandLine.Option;

/** What every command takes. */
final class CommonOptions {
    @Option(
            names = {"-h", "--help"},
            usageHelp = true,
            description = "Show this help.")
    private boolean help;

    // Read by the starting script, which sets the native libraries' log before they are loaded.
    @Option(names = "--log", description = "Show the native libraries' log.")
    private boolean log;

    // Read by the starting script, too: the engine looks at the environment.
    @Option(
            names = "--insecure",
            description = "Accept servers whose certificate is not trusted.")
    private boolean insecure;
}
