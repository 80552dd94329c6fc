# SPDX-License-Identifier: Apache-2.0
"""Starts the Java program in surroundings of its own: no display, no sound but a private
server's, and a small disk for its home, caches and temporary files."""

import os
import pathlib
import shutil
import signal
import subprocess

DISK = "1m"
JARS = ("orv_platform_java", "mediaplayer_orv_java", "orv_soak_java")
# Memory that does not depend on when the virtual machine compiles or collects.
QUIET = ("-Xms128m", "-Xmx128m", "-XX:+AlwaysPreTouch", "-XX:+UseSerialGC",
         "-XX:TieredStopAtLevel=1", "-XX:-UseDynamicNumberOfCompilerThreads",
         "-XX:-UsePerfData", "-XX:-CreateCoredumpOnCrash")
NAMESPACES = (["unshare", "--mount"], ["unshare", "--mount", "--map-root-user"])
MOUNT = f'mount -t tmpfs -o size={DISK} tmpfs "$0" && exec "$@"'


class Machine:
    """folder: what is kept of the run. place: an empty folder with a short path, for sockets and
    the small disk."""

    def __init__(self, build, java, folder, place):
        self._build = pathlib.Path(build)
        self._java = java
        self._folder = pathlib.Path(folder)
        self._disk = pathlib.Path(place) / "disk"
        self._socket = pathlib.Path(place) / "pulse"
        self._disk.mkdir()
        self._mount = self._find_mount()
        self.has_sound = shutil.which("pulseaudio") is not None
        self.has_disk = self._mount is not None

    def _find_mount(self):
        """What to put before a command so that its disk is a small one; None without a right to."""
        for namespace in NAMESPACES:
            prefix = [*namespace, "sh", "-c", MOUNT, str(self._disk)]
            if subprocess.run([*prefix, "true"], capture_output=True, check=False).returncode == 0:
                return prefix
        return None

    def crash_report(self):
        return self._folder / "hs_err.log"

    def start(self, settings):
        """settings: `name=value` for the program."""
        jars = ":".join(str(self._build / "java" / f"{jar}.jar") for jar in JARS)
        command = [*(self._mount or []), self._java, *QUIET, f"-XX:ErrorFile={self.crash_report()}",
                   "--enable-native-access=ALL-UNNAMED", f"-Djava.io.tmpdir={self._disk}",
                   f"-Djava.library.path={self._build / 'lib'}", "-cp", jars,
                   "com.quintora.orv.soak.Soak", f"folder={self._folder}", *settings]
        if self.has_sound:
            command.append(f"sound={self._socket}")
        if self.has_disk:
            command.append(f"disk={self._disk}")
        with open(self._folder / "log", "wb") as log:
            return subprocess.Popen(command, stdin=subprocess.DEVNULL, stdout=subprocess.PIPE,
                                    stderr=log, env=self._environment(), text=True,
                                    start_new_session=True)

    def _environment(self):
        hidden = ("DISPLAY", "WAYLAND_DISPLAY", "PULSE_SERVER", "JAVA_TOOL_OPTIONS")
        own = {name: value for name, value in os.environ.items() if name not in hidden}
        return {**own, "HOME": str(self._disk), "XDG_CACHE_HOME": str(self._disk),
                "TMPDIR": str(self._disk), "XDG_RUNTIME_DIR": str(self._disk.parent),
                "PULSE_SERVER": f"unix:{self._socket}", "ALSA_CONFIG_PATH": "/dev/null",
                "MALLOC_ARENA_MAX": "2"}


def end(process):
    """With all that it started."""
    try:
        os.killpg(process.pid, signal.SIGKILL)
    except ProcessLookupError:
        pass
    process.wait()
