// SPDX-License-Identifier: Apache-2.0
package com.quintora.orv.player.window;

import static org.junit.jupiter.api.Assertions.assertEquals;

import com.quintora.mmp.Media;
import com.quintora.orv.player.PlayerProcess;
import java.nio.file.Path;
import java.util.Map;
import org.junit.jupiter.api.Test;
import org.junit.jupiter.api.io.TempDir;

/** A display that is named and is not there. */
class StaleDisplayWindowTest {
    @Test
    void aDisplayThatIsGoneIsOneSentence(@TempDir Path folder) throws Exception {
        Map<String, String> stale = Map.of("DISPLAY", "unix:/none");
        try (PlayerProcess process =
                new PlayerProcess(folder, "silent", stale, "play", Media.path("short.mp4"))) {
            assertEquals(1, process.awaitEnd(), process::all);
            assertEquals(
                    "orv: cannot open a window on display unix:/none;"
                            + " --no-window plays in the terminal\n",
                    process.err());
        }
    }
}
