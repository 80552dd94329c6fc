# SPDX-License-Identifier: Apache-2.0
"""Compiles a changed source of the Java half, and runs the tests of it in a Java
virtual machine: those of tests/jvm that are about the player and its units."""

import base64
import hashlib
import json
import os
import pathlib
import re
import shutil

import processes
import reach
import tests
from mutant import Failed, Mutant, numbered
from native import output_of

TOOL = pathlib.Path(__file__).with_name("java")
FOLDERS = ("player", "testing")
# No time is spent on what a mutant is not asked for.
QUICK = ["-XX:TieredStopAtLevel=1", "-XX:+UseSerialGC"]
FAILED = re.compile(r"className = '([\w.]+)")
LIMIT_SECONDS = 600


class JavaArea:
    name = "java"

    def __init__(self, root, build, java_home):
        self.root = pathlib.Path(root).resolve()
        self.build = pathlib.Path(build).resolve()
        self.work = self.build / "mutate/java"
        self.sources = sorted((self.root / "java").rglob("*.java"))
        self._java = pathlib.Path(java_home) / "bin/java"
        self._javac = pathlib.Path(java_home) / "bin/javac"
        self._tests = self._tests_of_ctest()

    def _tests_of_ctest(self):
        """The command of each test class."""
        listed = json.loads(output_of(
            ["ctest", "--show-only=json-v1", "--tests-regex", r"^jvm\."], self.build))
        commands = {}
        for test in listed["tests"]:
            name = test["command"][-1].removeprefix("--select-class=")
            path = name.replace(".", "/") + ".java"
            if any((self.root / "tests/jvm" / folder / path).is_file() for folder in FOLDERS):
                commands[name] = test["command"]
        if not commands:
            raise Failed(f"{self.build} has no tests of the Java half.")
        return commands

    def find(self, _, files=None):
        """All mutants of the area; of those files, when some are given."""
        chosen = [path for path in self.sources
                  if files is None or os.path.relpath(path, self.root) in files]
        lines = self._scan([], chosen).splitlines() if chosen else []
        sources = {str(path): path.read_bytes() for path in chosen}
        return numbered(self._mutant(line.split("\t"), sources) for line in lines)

    def _mutant(self, fields, sources):
        path, function, operator, *numbers, becomes = fields
        start, end, first, last = map(int, numbers)
        source = sources[path]
        return Mutant(self.name, os.path.relpath(path, self.root), function, operator,
                      source.count(b"\n", 0, start) + 1, start, end, source[start:end].decode(),
                      base64.b64decode(becomes).decode(), first, last)

    def _scan(self, options, sources):
        classes = self.work.with_name("java-tool")
        if not self._compile(TOOL.glob("*.java"), classes, []):
            raise Failed("the tool for Java sources cannot be compiled.")
        return output_of([str(self._java), *QUICK, "-cp", str(classes), "FindMutants", *options,
                          *map(str, sources)], self.root)

    def prepare(self):
        shutil.rmtree(self.work, ignore_errors=True)
        self.work.mkdir(parents=True)

    def workshop(self, name):
        return Workshop(self, self.work / name)

    def compile_half(self, files, target):
        """Whether those sources of the Java half can be compiled in place of its own."""
        path = self._class_path(next(iter(self._tests.values())))
        annotations = "/usr/share/java/org.jetbrains.annotations-java8.jar"
        return self._compile(files, target, ["-cp", f"{path}:{annotations}"])

    def _compile(self, files, target, options):
        target.mkdir(parents=True, exist_ok=True)
        return processes.succeeds(
            [str(self._javac), *(f"-J{word}" for word in QUICK), "-nowarn", "-proc:none",
             "-implicit:none", *options, "-d", str(target), *map(str, files)], self.root)

    @staticmethod
    def _class_path(command):
        return command[command.index("-cp") + 1]

    def run(self, classes, names, environment, seconds):
        """Those test classes, in one virtual machine."""
        command = command_of(self._tests[names[0]], classes, names)
        try:
            status, out = processes.run([str(self._java), *command], self.root, environment,
                                        seconds)
        except processes.TimedOut:
            return tests.Run({}, None, True)
        if status == 0:
            return tests.Run(dict.fromkeys(names, 0.0))
        failed = [name for name in FAILED.findall(out) if name in names]
        return tests.Run({}, failed[0] if failed else names[0] if len(names) == 1
                         else tests.UNNAMED)

    def measure(self, workshop, pool_map, environment, say):
        """Which test classes call which method; also, that all pass without a mutant."""
        digest = hashlib.sha256()
        for path in [*sorted((self.build / "java").glob("*.jar")),
                     *sorted((self.build / "lib").glob("*.so")), *TOOL.glob("*.java")]:
            digest.update(path.read_bytes())
        kept = self.work.with_name("reach-java.json")
        known = reach.kept_at(kept, digest.hexdigest())
        if known:
            return known
        say("building and running every test without a mutant")
        classes = self._instrumented(workshop)
        notes = workshop.folder / "notes"
        notes.mkdir()
        environment = environment()

        def timed(group):
            started = processes.now()
            result = self.run(classes, group, {
                **environment, "ORV_REACH": str(notes / group[0])}, LIMIT_SECONDS)
            result.passed = dict.fromkeys(result.passed, processes.now() - started)
            return result
        durations = reach.pass_all(timed, [[name] for name in self._tests], pool_map,
                                   "the Java tests")
        return reach.keep(kept, digest.hexdigest(), durations, self._calls(notes))

    def _instrumented(self, workshop):
        copies = workshop.folder / "reach"
        self._scan(["--reach", str(copies)], self.sources)
        inner = copies / self.root.relative_to("/") / "java"
        (inner / "module-info.java").unlink()
        shutil.copy(TOOL / "OrvReach.java", inner)
        if not self.compile_half(inner.rglob("*.java"), workshop.classes):
            raise Failed("the Java half cannot be compiled with notes of its calls.")
        return workshop.classes

    def _calls(self, notes):
        calls = {}
        for path in notes.iterdir():
            for place in set(path.read_text().splitlines()):
                file, line = place.rsplit(":", 1)
                file = os.path.relpath(file, self.root)
                calls.setdefault(file, {}).setdefault(line, []).append(path.name)
        return calls


def command_of(test, classes, names):
    """What Java is given for those test classes, from the command of one of them: without
    the check of its native calls, which is slow, nor the program that reads its complaints."""
    words = [word for word in test[test.index("-Xcheck:jni") + 1:]
             if not word.startswith(("--select-class", "--details"))]
    at = words.index("-cp") + 1
    words[at] = f"{classes}:{words[at]}"
    return [*QUICK, "-Xmx1g", *words, "--details=none",
            *(f"--select-class={name}" for name in names)]


class Workshop:
    """A folder for the classes of one mutant at a time."""

    def __init__(self, area, folder):
        self.area = area
        self.folder = folder
        self.classes = folder / "classes"
        self.folder.mkdir(parents=True)

    def make(self, mutant):
        """The classes of the mutant, or None when it does not compile."""
        shutil.rmtree(self.classes, ignore_errors=True)
        path = self.folder / mutant.file
        path.parent.mkdir(parents=True, exist_ok=True)
        path.write_bytes(mutant.apply((self.area.root / mutant.file).read_bytes()))
        try:
            return self.classes if self.area.compile_half([path], self.classes) else None
        finally:
            path.unlink()
