# SPDX-License-Identifier: Apache-2.0
"""Compiles a changed source of the product or the engine, and links it with the
rest of a test program. The objects are those of the build tree, copied, so that
neither it nor the sources are touched."""

import dataclasses
import hashlib
import json
import multiprocessing
import os
import pathlib
import shlex
import shutil
import subprocess

import gtest
import processes
import reach
from mutant import Failed, Mutant, numbered

FINDERS = ("cpp.py", "mutant.py", "operators.py", "swaps.py")

# No time is spent on what a mutant is not asked for.
LEAN = ["-O1", "-g0", "-w"]


def output_of(command, folder):
    done = subprocess.run(command, cwd=folder, capture_output=True, text=True)
    if done.returncode != 0:
        raise Failed(f"{command[0]} failed: {(done.stderr or done.stdout).strip()[-500:]}")
    return done.stdout


class Unit:
    """A translation unit: its source, its object in the build tree, its compiler's words."""

    def __init__(self, entry, build):
        words = shlex.split(entry["command"])
        at = words.index("-o")
        self.source = os.path.realpath(entry["file"])
        self.object = os.path.relpath(os.path.join(entry["directory"], words[at + 1]), build)
        del words[at:at + 2]
        self.command = [w for w in words if w not in ("-c", entry["file"], "-Werror")]

    def arguments(self):
        """For clang: without the compilers' names and what GCC alone knows."""
        first = next(i for i, w in enumerate(self.command) if w.startswith("-"))
        return self.command[first:] + ["-w"]


class NativeArea:
    """The sources below a folder, and the program that tests them."""

    def __init__(self, name, folder, program, root, build):
        self.name = name
        self.root = pathlib.Path(root).resolve()
        self.build = pathlib.Path(build).resolve()
        self.folder = folder
        self.program = self.build / "bin" / program
        self.work = self.build / "mutate" / name
        self.base = self.work / "base"
        entries = json.loads((self.build / "compile_commands.json").read_text())
        self.link_words = self._link_command()
        units = [Unit(entry, self.build) for entry in entries
                 if os.path.realpath(entry["file"]).startswith(f"{self.root}/{folder}/")]
        # A source that is built twice is taken once, for the test program.
        self.units = [unit for unit in units if unit.object in self.link_words]
        if not self.units:
            raise Failed(f"{self.program} is not made of sources below {folder}.")
        self._users = self._users_of_files()

    def find(self, jobs, files=None):
        """All mutants of the area; of units that those files go into, when some are given."""
        units = self.units if files is None else \
            [unit for unit in self.units if any(unit in self.users(file) for file in files)]
        with multiprocessing.Pool(jobs) as pool:
            found = pool.map(self._find_in, units, chunksize=1)
        return numbered(m for mutants in found for m in mutants)

    def _find_in(self, unit):
        """Kept until the unit changes: to read all of an area takes a minute."""
        kept = self.work.with_name(f"found-{self.name}") / f"{unit.object.replace('/', '_')}.json"
        digest = self._digest(unit)
        if kept.is_file():
            content = json.loads(kept.read_text())
            if content["digest"] == digest:
                return [Mutant(**fields) for fields in content["mutants"]]
        found = self._read(unit)
        kept.parent.mkdir(parents=True, exist_ok=True)
        kept.write_text(json.dumps(
            {"digest": digest, "mutants": [dataclasses.asdict(mutant) for mutant in found]}))
        return found

    def _digest(self, unit):
        """Of what the mutants depend on: the unit's words, its own files and their finders."""
        own = sorted(file for file, units in self._users.items() if unit in units)
        digest = hashlib.sha256(shlex.join(unit.command).encode())
        for path in [*(self.root / file for file in own),
                     *(pathlib.Path(__file__).with_name(name) for name in FINDERS)]:
            digest.update(path.read_bytes())
        return digest.hexdigest()

    def _read(self, unit):
        import cpp  # clang's module, which --help does without

        def wanted(path):
            real = os.path.realpath(path)
            if real.startswith(f"{self.root}/{self.folder}/"):
                return self.name, os.path.relpath(real, self.root)
            return None
        return cpp.find(unit.source, unit.arguments(), wanted)

    def prepare(self):
        """Copies what a link needs."""
        shutil.rmtree(self.work, ignore_errors=True)
        for word in self.link_words:
            source = self.build / word
            if not word.startswith(("-", "/")) and source.is_file() and source != self.program:
                target = self.base / word
                target.parent.mkdir(parents=True, exist_ok=True)
                shutil.copy2(source, target)

    def _link_command(self):
        wanted = os.path.relpath(self.program, self.build)
        commands = output_of(["ninja", "-t", "commands", wanted], self.build).splitlines()
        for line in reversed(commands):
            for part in line.split(" && "):
                words = shlex.split(part)
                if "-o" in words and words[words.index("-o") + 1] == wanted:
                    return words
        raise Failed(f"the build does not say how {self.program} is linked.")

    def _users_of_files(self):
        """The units that each source and header of the area goes into."""
        users = {}
        units = {unit.object: unit for unit in self.units}
        unit = None
        for line in output_of(["ninja", "-t", "deps"], self.build).splitlines():
            if line and not line.startswith(" "):
                unit = units.get(line.split(": #deps")[0])
            elif unit and line:
                path = os.path.realpath(self.build / line.strip())
                if path.startswith(f"{self.root}/{self.folder}/"):
                    users.setdefault(os.path.relpath(path, self.root), []).append(unit)
        return users

    def users(self, file):
        return self._users.get(file, [])

    def workshop(self, name):
        return Workshop(self, self.work / name)

    def measure(self, workshop, pool_map, environment, say):
        return reach.measure(self, workshop, pool_map, environment, say)

    @staticmethod
    def run(program, tests, environment, seconds):
        return gtest.run(program, tests, environment, seconds)


class Workshop:
    """A copy of the area's sources, with one mutant in it at a time."""

    def __init__(self, area, folder):
        self.area = area
        self.folder = folder
        shutil.rmtree(folder, ignore_errors=True)
        shutil.copytree(area.root / area.folder, folder / area.folder)

    def make(self, mutant):
        """The program with the mutant, or None when it does not compile."""
        path = self.folder / mutant.file
        original = path.read_bytes()
        try:
            path.write_bytes(mutant.apply(original))
            units = self.area.users(mutant.file)
            if not all(self.compile(unit, LEAN) for unit in units):
                return None
            return self.link(units, ["-Wl,--strip-debug"])
        finally:
            path.write_bytes(original)

    def object(self, unit):
        return self.folder / "objects" / (unit.object.replace("/", "_"))

    def compile(self, unit, options):
        target = self.object(unit)
        target.parent.mkdir(exist_ok=True)
        here = [word.replace(f"{self.area.root}/{self.area.folder}",
                             f"{self.folder}/{self.area.folder}")
                for word in [*unit.command, unit.source]]
        return processes.succeeds([*here, *options, "-c", "-o", str(target)], self.folder)

    def link(self, units, further):
        """The changed units come first: of a header's functions the linker takes the first."""
        objects = {unit.object: str(self.object(unit)) for unit in units}
        words = [w for w in self.area.link_words if w not in objects]
        program = self.folder / self.area.program.name
        at = words.index("-o")
        words[at + 1] = str(program)
        words[at:at] = [*objects.values(), *further]
        if not processes.succeeds(words, self.area.base):
            raise Failed(f"a changed {self.area.program.name} cannot be linked.")
        return program
