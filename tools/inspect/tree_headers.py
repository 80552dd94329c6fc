# SPDX-License-Identifier: Apache-2.0
"""Where a platform tree, or a folder of its headers, keeps what the sources
include."""

import glob
import os
import re

from refusal import Refusal

CROSS = "/usr/arm-linux-gnueabihf/include"
# The parts of a whole tree in which headers are looked for; a tree has a
# million files elsewhere. The last hold what its build has generated.
PARTS = ("frameworks/native", "frameworks/av", "frameworks/base/core/jni", "libnativehelper",
         "hardware/libhardware", "system/core", "system/libbase", "system/logging",
         "system/media", "system/libhidl", "system/libhwbinder", "system/libfmq",
         "frameworks/playback", "vendor",
         "out/soong/.intermediates/frameworks/native", "out/soong/.intermediates/frameworks/av")
# What the modules' headers include in turn is mostly there.
SUPPORT = ("system/libbase/include", "system/core/base/include", "system/core/libcutils/include",
           "system/core/libsystem/include", "system/media/audio/include",
           "hardware/libhardware/include", "frameworks/native/include",
           "frameworks/native/libs/arect/include", "frameworks/native/libs/math/include",
           "frameworks/native/libs/nativebase/include",
           "frameworks/native/libs/nativewindow/include", "frameworks/native/libs/ui/include",
           "frameworks/av/media/libaudioclient/include")
FOLDERS = 5000  # at most so many are looked into in each part
ENGINE = "liborvtarn_headers"


def read_page(path):
    """({header: module}, {module: its folders in a tree}, {name: what the
    releases differ in}) of docs/platform-tree.md."""
    modules, folders, releases = {}, {}, {}
    with open(path, encoding="utf-8") as file:
        rows = re.findall(r"^\| `([^`|]+)` \| (.*) \|$", file.read(), re.MULTILINE)
    for name, text in rows:
        headers, *rest = text.split(" | ")
        if not rest:
            releases[name] = text.replace("`", "")
            continue
        modules.update(dict.fromkeys(re.findall(r"`([\w/]+\.h)`", headers), name))
        folders[name] = re.findall(r"`([\w/]+)`", rest[0])
    return modules, folders, releases


def read_includes(product):
    """(all headers that the product's sources include by <>, those of them
    that it can do without)"""
    included, optional = set(), set()
    for pattern in ("**/*.cpp", "**/*.h"):
        for path in glob.glob(os.path.join(product, pattern), recursive=True):
            with open(path, encoding="utf-8") as file:
                text = file.read()
            included.update(re.findall(r"^ *#include <(.*)>", text, re.MULTILINE))
            optional.update(re.findall(r"__has_include\(<(.*)>\)", text))
    return included, optional


def library_flags(tree):
    """The target, and where the C and C++ libraries' headers are: in the tree,
    else Debian's for the cross compiler."""
    bionic = [os.path.join(tree, folder) for folder in (
        "external/libcxx/include", "external/libcxxabi/include", "bionic/libc/include",
        "bionic/libc/kernel/uapi", "bionic/libc/kernel/uapi/asm-arm",
        "bionic/libc/kernel/android/uapi")]
    if os.path.isdir(bionic[0]) and os.path.isdir(bionic[2]):
        target, folders = "armv7a-linux-androideabi10000", bionic
    else:
        versions = glob.glob(f"{CROSS}/c++/[0-9]*")
        if not versions:
            raise Refusal("there are no C++ headers for ARM; "
                          "they come with the package g++-arm-linux-gnueabihf")
        newest = max(versions, key=lambda path: int(re.search(r"\d+$", path).group()))
        target, folders = "armv7a-linux-gnueabihf", [newest, f"{newest}/arm-linux-gnueabihf", CROSS]
    return [f"--target={target}", "-nostdinc++", "-nostdlibinc",
            *(f"-isystem{folder}" for folder in folders)]


def includes(path, header):
    with open(path, encoding="utf-8", errors="replace") as file:
        return re.search(rf'^ *# *include *[<"]{re.escape(header)}[>"]', file.read(), re.MULTILINE)


def folders_below(top):
    """The folders under one, itself first, the shallow before the deep."""
    found, seen = [top], {os.path.realpath(top)}
    for folder in found:
        try:
            entries = sorted(os.scandir(folder), key=lambda entry: entry.name)
        except OSError:
            continue
        for entry in entries:
            if len(found) >= FOLDERS:
                return found
            if entry.name.startswith(".") or entry.name in ("test", "tests") or not entry.is_dir():
                continue
            real = os.path.realpath(entry.path) if entry.is_symlink() else entry.path
            if real not in seen:
                seen.add(real)
                found.append(entry.path)
    return found


class Headers:
    """The include folders of one tree, found header by header."""

    def __init__(self, tree, folders):
        self.tree = tree
        self.roots = []
        self._folders = folders
        self._searched = None

    def add_support(self):
        for folder in (*sum(self._folders.values(), []), *SUPPORT):
            if os.path.isdir(os.path.join(self.tree, folder)):
                self._add(os.path.join(self.tree, folder))

    def _candidates(self):
        if self._searched is None:
            parts = [part for part in PARTS if os.path.isdir(os.path.join(self.tree, part))]
            tops = [os.path.join(self.tree, part) for part in parts] or [self.tree]
            self._searched = [self.tree, *(folder for top in tops for folder in folders_below(top))]
            # Folders that a build gives to others have such names.
            self._searched.sort(key=lambda path: "include" not in os.path.basename(path))
        return self._searched

    def _has(self, root, header):
        return os.path.isfile(os.path.join(root, header))

    def find(self, header, module=None):
        """Whether the tree has it; its include folder is then one of roots."""
        known = [os.path.join(self.tree, folder) for folder in self._folders.get(module, ())]
        for root in self.roots + known:
            if self._has(root, header):
                self._add(root)
                return True
        root = next((root for root in self._candidates() if self._has(root, header)), None)
        if root is not None:
            self._add(root)
        return root is not None

    def generated_note(self, header):
        """Where a header comes from that only a build of the tree makes."""
        source = header.removesuffix(".h") + ".aidl"
        if any(self._has(root, source) for root in self._candidates()):
            return f"; the tree's build makes it from {source}"
        return ""

    def _add(self, root):
        if root not in self.roots:
            self.roots.append(root)
