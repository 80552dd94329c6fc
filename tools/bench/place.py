# SPDX-License-Identifier: Apache-2.0
"""Where what is measured stands: the commands, the classes, the media."""

import glob
import os
import subprocess

from display import Display
from figures import Failed


class Place:
    """player: the command that starts the player application."""

    def __init__(self, root, build, player):
        self.root = root
        self.build = build
        self.player = player
        self._display = None

    def orv(self, *arguments):
        return [os.path.join(self.root, "orv"), *arguments]

    def java(self, program, *arguments):
        """A program of bench/java, started as a Java program usually is."""
        jars = sorted(glob.glob(os.path.join(self.build, "java", "*.jar")))
        return [self.player[0], "--enable-native-access=ALL-UNNAMED", "-cp", ":".join(jars),
                f"-Djava.library.path={os.path.join(self.build, 'lib')}", program, *arguments]

    def media(self, name):
        return os.path.join(self.build, "media", "bench", name)

    def make_media(self, *names):
        """Those that are not there yet; raises Failed."""
        script = os.path.join(self.root, "tools", "bench", "make-media.sh")
        done = subprocess.run([script, self.media(""), *names], capture_output=True, text=True,
                              check=False)
        if done.returncode != 0:
            raise Failed(f"the media cannot be made: {done.stderr.strip()}")

    def display(self):
        """Made when it is first asked for."""
        if self._display is None:
            self._display = Display()
        return self._display

    def close(self):
        if self._display is not None:
            self._display.close()

    def environment(self):
        """For programs that shall not show anything."""
        return {name: value for name, value in os.environ.items()
                if name not in ("DISPLAY", "WAYLAND_DISPLAY")}
