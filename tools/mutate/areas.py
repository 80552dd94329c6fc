# SPDX-License-Identifier: Apache-2.0
"""The parts of the project that are changed, each with the tests that could notice."""

import contextlib
import os
import pathlib
import sys

from jvm import JavaArea
from native import NativeArea
from trial import Trial

sys.path.append(str(pathlib.Path(__file__).resolve().parent.parent / "bench"))
import display  # noqa: E402


class Area:
    """One area, and how its mutants are tried."""

    def __init__(self, inner, jobs, say, confirms=False, on_display=False):
        """confirms: a failure counts when it comes twice, as tests that play media may miss
        their moment on a busy machine; on_display: each job has a display."""
        self.name = inner.name
        self.work = inner.work
        self.jobs = jobs
        self._inner = inner
        self._say = say
        self._confirms = confirms
        self._on_display = on_display

    def find(self, files):
        return self._inner.find(self.jobs, files)

    @contextlib.contextmanager
    def trial(self):
        with contextlib.ExitStack() as stack:
            environments = []
            for _ in range(self.jobs):
                if self._on_display:
                    screen = display.Display()
                    stack.callback(screen.close)
                    environments.append(screen.environment())
                else:
                    environments.append(dict(os.environ))
            yield Trial(self._inner, self.jobs, environments, self._confirms, self._say)


def make(name, options, say):
    processors = os.cpu_count()
    if name == "java":
        return Area(JavaArea(options.root, options.build, options.java_home),
                    options.jobs or processors, say, confirms=True)
    if name == "engine":
        # Its tests wait more than they compute.
        return Area(NativeArea(name, "engine/src", "engine_tests", options.root, options.build),
                    options.jobs or 2 * processors, say, confirms=True, on_display=True)
    return Area(NativeArea(name, "frameworks", "contract_tests", options.root, options.build),
                options.jobs or processors, say)
