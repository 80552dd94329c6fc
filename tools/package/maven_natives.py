# SPDX-License-Identifier: Apache-2.0
"""The native libraries of one machine, made ready to stand in a JAR: stripped,
and finding one another by the folder that they stand in."""

import hashlib
import os
import subprocess
import sys
import zlib

sys.path.insert(1, os.path.join(os.path.dirname(os.path.realpath(__file__)), "../inspect"))

import elf
from refusal import Refusal

LIBRARY = "libmediaplayer_orv.so"
LIST = "mediaplayer-orv.list"
TRIPLETS = {"x86_64": "x86_64-linux-gnu", "armhf": "arm-linux-gnueabihf"}


def dynamic(library):
    """(names that it needs, folders that it has them looked for in)"""
    needed, folders = [], []
    for tag in library.elf.get_section_by_name(".dynamic").iter_tags():
        if tag.entry.d_tag == "DT_NEEDED":
            needed.append(tag.needed)
        elif tag.entry.d_tag == "DT_RUNPATH":
            folders += filter(None, tag.runpath.split(":"))
    return needed, folders


def inside(sysroot, place):
    """The folder that the target finds under that name, also where it is one already."""
    return place if place.startswith(sysroot) else sysroot + place


def closure(folder, sysroot):
    """{name: path} of the library and all that it needs besides what the system
    finds by itself, each after what it needs."""
    found = {}

    def add(name, path):
        needed, folders = dynamic(elf.Library(path))
        for other in needed:
            paths = [os.path.join(place, other) for place in
                     [folder, *(inside(sysroot, place) for place in folders)]]
            there = next((path for path in paths if os.path.isfile(path)), None)
            if there and other not in found:
                add(other, there)
        found[name] = path

    add(LIBRARY, os.path.join(folder, LIBRARY))
    return found


def package_of(path, architecture, sysroot):
    """The Debian package of a system's library; the ARM ones are named as this machine's."""
    path = os.path.realpath(path)
    if sysroot and path.startswith(sysroot):
        path = path[len(sysroot):].replace(TRIPLETS[architecture], TRIPLETS["x86_64"])
    done = subprocess.run(["dpkg", "-S", path], text=True, check=False, stdout=subprocess.PIPE,
                          stderr=subprocess.PIPE)
    if done.returncode:
        raise Refusal(f"{path} is of no Debian package, so its licence is not known")
    return done.stdout.split(":")[0]


def licence(package):
    path = f"/usr/share/doc/{package}/copyright"
    try:
        with open(path, "rb") as file:
            return file.read()
    except OSError as error:
        raise Refusal(f"the licence {path} cannot be read: {error.strerror}") from None


def ready(path, out, architecture, names):
    """Writes a copy without debugging information, which looks beside it for those
    names that it needs; its bytes."""
    prefix = TRIPLETS[architecture] + "-" if architecture != "x86_64" else ""
    needed, _ = dynamic(elf.Library(path))
    place = ["--set-rpath", "$ORIGIN"] if names & set(needed) else ["--remove-rpath"]
    for command in ([prefix + "strip", "--strip-unneeded", "-o", out, path],
                    ["patchelf", *place, out]):
        done = subprocess.run(command, text=True, check=False, stdout=subprocess.PIPE,
                              stderr=subprocess.STDOUT)
        if done.returncode:
            raise Refusal(f"{command[0]} failed: {done.stdout.strip()}")
    with open(out, "rb") as file:
        return file.read()


def listing(version, system, libraries):
    """The list that the Java half reads."""
    lines = "".join(
        f"file {name} {len(data)} {zlib.crc32(data):08x} {hashlib.sha256(data).hexdigest()}\n"
        for name, data in libraries.items())
    digest = hashlib.sha256(lines.encode()).hexdigest()[:16]
    return f"version {version}\nsystem {system}\ndigest {digest}\n{lines}".encode()


def bundle(folder, version, system, sysroot, work):
    """(machine's name, {name in the JAR: bytes}) of the libraries built in a folder."""
    architecture = elf.Library(os.path.join(folder, LIBRARY)).architecture
    sysroot = os.path.realpath(sysroot) if architecture == "armhf" else ""
    libraries, files = {}, {}
    place = f"META-INF/native/linux-{architecture}/"
    found = closure(folder, sysroot)
    for name, path in found.items():
        copy = os.path.join(work, f"{architecture}-{name}")
        libraries[name] = ready(path, copy, architecture, found.keys())
        files[place + name] = libraries[name]
        if os.path.realpath(os.path.dirname(path)) != os.path.realpath(folder):
            package = package_of(path, architecture, sysroot)
            files[f"{place}licences/{package}"] = licence(package)
    files[place + LIST] = listing(version, system, libraries)
    return f"linux-{architecture}", files
