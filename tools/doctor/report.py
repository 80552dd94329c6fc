#!/usr/bin/python3 -B
# SPDX-License-Identifier: Apache-2.0
"""report.py CHECKOUT BUILD FILE [--engine LIB] [--classes JAR] [--tree DIR]: a report
of this machine and its build for who maintains the library, without personal data.
FILE is written whole or not at all; - is standard output."""

import os
import pathlib
import platform
import subprocess
import sys
import tempfile

from anonymous import Anonymous

TITLE = "Report of ./orv doctor"
QUESTIONS = ("--engine", "--classes", "--tree")
# What is set is said; only these have a value that is anybody's.
VARIABLES = ("ORV_BUILD", "ORV_NO_INSTALL", "ORV_LOG", "JAVA_HOME", "CXX", "CXXFLAGS", "LDFLAGS",
             "LD_LIBRARY_PATH", "DISPLAY", "WAYLAND_DISPLAY", "XDG_SESSION_TYPE", "LANG", "LC_ALL")
VALUES = ("ORV_LOG", "ORV_NO_INSTALL", "XDG_SESSION_TYPE", "LANG", "LC_ALL")
LOGS = ("configure.log", "ninja.log", "apt.log")
LOG_LINES = 30
HEAD = f"""{TITLE}

User names, home folders, host names, network addresses and secrets of the
environment were replaced by words such as USER, HOST and ADDRESS. Read it before
you send it all the same. It has:
"""


class Unfit(Exception):
    """A sentence for who started this."""


def said(root, *arguments):
    """What a command says, then its status when that is not 0."""
    try:
        done = subprocess.run(
            [str(word) for word in arguments], cwd=root, stdin=subprocess.DEVNULL, text=True,
            errors="replace", stdout=subprocess.PIPE, stderr=subprocess.STDOUT, check=False,
            env={**os.environ, "ORV_NO_INSTALL": os.environ.get("ORV_NO_INSTALL", "1")})
    except OSError as error:
        return f"{arguments[0]}: {error.strerror}"
    return done.stdout.strip() + (f"\n(status {done.returncode})" if done.returncode else "")


def first_line_of(path, start):
    try:
        with open(path, encoding="utf-8", errors="replace") as file:
            return next((line.split("=" if "=" in line else ":", 1)[1].strip().strip('"')
                         for line in file if line.startswith(start)), "unknown")
    except OSError:
        return "unknown"


def system(_):
    return "\n".join((
        f"system      {first_line_of('/etc/os-release', 'PRETTY_NAME=')}",
        f"kernel      {platform.system()} {platform.release()}, {platform.machine()}",
        f"processors  {os.cpu_count()}, {first_line_of('/proc/cpuinfo', 'model name')}",
        f"memory      {first_line_of('/proc/meminfo', 'MemTotal')}"))


def project(root):
    changed = said(root, "git", "status", "--porcelain").splitlines()
    return "\n".join((f"commit      {said(root, 'git', 'rev-parse', 'HEAD')}",
                      f"changed     {len(changed)} files"))


def tools(root):
    return "\n".join(f"{name:10}  {said(root, name, '--version').split(chr(10), 1)[0]}"
                     for name in ("c++", "cmake", "ninja", "java", "python3"))


def environment(_):
    return "\n".join(f"{name} {os.environ[name] if name in VALUES else 'is set'}"
                     for name in VARIABLES if os.environ.get(name)) or "nothing that matters is set"


def failed_tests(build):
    try:
        text = (build / "Testing/Temporary/LastTestsFailed.log").read_text("utf-8", "replace")
    except OSError:
        return "none that is known"
    return text.strip() or "none"


def end_of(log):
    try:
        lines = log.read_text("utf-8", errors="replace").splitlines()
    except OSError:
        return "there is none"
    return "\n".join(lines[-LOG_LINES:]) or "empty"


def sections(root, build, questions):
    """(heading, text) of each part."""
    yield "the system", system(root)
    yield "the checkout", project(root)
    yield "versions (./orv version)", said(root, root / "orv", "version")
    yield "compilers and tools", tools(root)
    yield "what ./orv doctor says", said(root, root / "orv", "doctor")
    for question, path in questions:
        yield (f"what ./orv doctor {question} says",
               said(root, root / "orv", "doctor", question, path))
    yield "environment variables, most without their values", environment(root)
    yield "tests that failed in the last run", failed_tests(build)
    for name in LOGS:
        yield f"the end of build/log/{name}", end_of(build / "log" / name)


def compose(root, build, questions):
    """(the text, the headings)"""
    anonymous = Anonymous({"CHECKOUT": str(root), "BUILD": str(build),
                           **{f"{option[2:].upper()}-FOLDER": str(pathlib.Path(path).parent)
                              for option, path in questions
                              if pathlib.Path(path).is_absolute()
                              and len(pathlib.Path(path).parent.parts) > 1}})
    parts = list(sections(root, build, questions))
    headings = [heading for heading, _ in parts]
    text = HEAD + "".join(f"- {heading}\n" for heading in headings)
    text += "".join(f"\n== {heading}\n\n{body}\n" for heading, body in parts)
    return anonymous.text(text), headings


def refuse_other_file(path):
    """A report may take the place of a report alone."""
    if path.is_dir():
        raise Unfit(f"{path}: Is a directory")
    try:
        with path.open("rb") as file:
            if file.read(len(TITLE)) not in (b"", TITLE.encode()):
                raise Unfit(f"{path} is there already, and no report; name another file")
    except FileNotFoundError:
        pass


def write_whole(path, text):
    with tempfile.NamedTemporaryFile("w", encoding="utf-8", dir=path.parent, prefix=".orv-report-",
                                     delete=False) as file:
        try:
            file.write(text)
            file.close()
            os.chmod(file.name, 0o644)
            os.replace(file.name, path)
        except BaseException:
            os.unlink(file.name)
            raise


def main(arguments):
    root, build, out, *rest = arguments
    root, build = pathlib.Path(root).resolve(), pathlib.Path(build).resolve()
    questions = [(option, os.path.abspath(path)) for option, path in zip(rest[::2], rest[1::2])]
    path = pathlib.Path(out)
    if out != "-":
        refuse_other_file(path)
    text, headings = compose(root, build, questions)
    if out == "-":
        sys.stdout.write(text)
        return
    write_whole(path, text)
    print(f"orv: the report is in {out}. It has {', '.join(headings)}; read it before you send it.",
          file=sys.stderr)


if __name__ == "__main__":
    try:
        main(sys.argv[1:])
    except Unfit as unfit:
        sys.exit(f"orv: {unfit}")
    except OSError as problem:
        sys.exit(f"orv: {problem.filename}: {problem.strerror}")
    except KeyboardInterrupt:
        sys.exit(130)
