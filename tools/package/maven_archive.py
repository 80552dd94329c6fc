# SPDX-License-Identifier: Apache-2.0
"""JARs whose bytes depend on their contents alone, and what stands in them."""

import os
import re
import subprocess
import tempfile
import time
import zipfile

MANIFEST = "META-INF/MANIFEST.MF"
# What an archive can hold, and what a manifest's line can.
EARLIEST = 315532800
LINE_BYTES = 72


def manifest(attributes):
    """The text of a manifest, from a dictionary; long lines are folded as the format asks."""
    lines = []
    for name, value in {"Manifest-Version": "1.0", **attributes}.items():
        line = f"{name}: {value}"
        lines.append(line[:LINE_BYTES - 2])
        rest = line[LINE_BYTES - 2:]
        while rest:
            lines.append(" " + rest[:LINE_BYTES - 3])
            rest = rest[LINE_BYTES - 3:]
    return "".join(line + "\r\n" for line in lines).encode() + b"\r\n"


def attributes_of(text):
    """The main attributes of a manifest, as a dictionary."""
    unfolded = re.sub(r"\r?\n ", "", text.decode())
    main = re.split(r"\r?\n\r?\n", unfolded)[0]
    return dict(line.split(": ", 1) for line in main.splitlines() if ": " in line)


def write(path, attributes, files):
    """Writes a JAR of a dictionary from names to bytes. Its entries have the time
    of SOURCE_DATE_EPOCH."""
    seconds = max(int(os.environ["SOURCE_DATE_EPOCH"]), EARLIEST)
    moment = time.gmtime(seconds)[:6]
    with zipfile.ZipFile(path, "w", zipfile.ZIP_DEFLATED, compresslevel=9) as jar:
        for name, data in [(MANIFEST, manifest(attributes)), *sorted(files.items())]:
            entry = zipfile.ZipInfo(name, moment)
            entry.compress_type = zipfile.ZIP_DEFLATED
            entry.external_attr = 0o100644 << 16
            jar.writestr(entry, data)


def contents(path):
    """(attributes of the manifest, files) of a JAR that the build made."""
    with zipfile.ZipFile(path) as jar:
        files = {name: jar.read(name) for name in jar.namelist() if not name.endswith("/")}
    attributes = attributes_of(files.pop(MANIFEST, b""))
    for made in ("Manifest-Version", "Created-By"):
        attributes.pop(made, None)
    return attributes, files


def folder(path):
    """Every file below a folder, by its name from there."""
    files = {}
    for place, _, names in os.walk(path):
        for name in names:
            file = os.path.join(place, name)
            with open(file, "rb") as data:
                files[os.path.relpath(file, path)] = data.read()
    return files


def sources(list_file):
    """The sources that the build lists for one of its JARs: paths, and their
    names by package."""
    with open(list_file, encoding="utf-8") as lines:
        paths = [line.strip().strip('"') for line in lines if line.strip()]
    named = {}
    for path in paths:
        with open(path, encoding="utf-8") as source:
            text = source.read()
        package = re.search(r"^package ([\w.]+);", text, re.MULTILINE)
        place = package.group(1).replace(".", "/") + "/" if package else ""
        named[place + os.path.basename(path)] = text.encode()
    return paths, named


def javadoc(jdk, paths, class_path, title):
    """The pages of those sources, by their names."""
    is_module = any(os.path.basename(path) == "module-info.java" for path in paths)
    with tempfile.TemporaryDirectory() as out:
        command = [os.path.join(jdk, "bin/javadoc"), "-quiet", "-notimestamp", "-Xdoclint:none",
                   "-encoding", "UTF-8", "-docencoding", "UTF-8", "--release", "17",
                   "-windowtitle", title, "-doctitle", title, "-d", out,
                   "--module-path" if is_module else "-classpath", ":".join(class_path), *paths]
        done = subprocess.run(command, text=True, check=False, stdout=subprocess.PIPE,
                              stderr=subprocess.STDOUT)
        if done.returncode:
            raise OSError(f"javadoc failed: {done.stdout.strip()}")
        return folder(out)
