# SPDX-License-Identifier: Apache-2.0
"""What is wrong with an engine library before anything of it runs: a refusal says what
in one sentence, and what to do."""

import pathlib
import re

from elftools.common.exceptions import ELFError

import elf
import engine as engine_needs
from refusal import Refusal


def machine(path):
    """x86_64 or armhf, by the library's header."""
    if not pathlib.Path(path).is_file():
        raise Refusal(f"{path}: there is no such file; give the path of the engine's library.")
    try:
        library = elf.Library(path)
        library.exported()
        return library.architecture
    except Refusal as refusal:
        raise Refusal(f"{refusal}; give the engine as a shared library for x86-64 or "
                      "32-bit ARM.") from None
    except (ELFError, StopIteration, ValueError, AttributeError):
        raise Refusal(f"{path}: the library is damaged or cut off; copy or build it "
                      "again.") from None


def check_symbols(path, lists):
    library = elf.Library(path)
    _, links = engine_needs.read_needs(lists / f"engine.{library.architecture}.txt")
    exported = library.exported()
    missing = [name for name in links if name not in exported]
    if missing:
        first = elf.demangled(missing)[missing[0]]
        raise Refusal(f"{path}: {len(missing)} of the {len(links)} functions that an engine has "
                      f"are not exported, {first} first; ./orv doctor --engine names them all.")


def check_loading(path, kit, limit):
    text = kit.load_error(limit)
    if text is None:
        return
    undefined = re.search(r"undefined symbol: (\w+)", text)
    if undefined:
        name = elf.demangled([undefined[1]])[undefined[1]]
        raise Refusal(f"{path}: nothing that it links to has the symbol {name}; "
                      "link the engine to the library that has it.")
    absent = re.search(r"loading shared libraries: ([^:]+): cannot open", text)
    if absent:
        raise Refusal(f"{path}: it needs {absent[1]}, which is not found; "
                      "install it or put it beside the engine.")
    last = text.strip().splitlines()[-1:] or ["it ends at once"]
    raise Refusal(f"{path}: it cannot be loaded ({last[0]}); mend that first.")


def check_media(folder, names):
    if not folder.is_dir():
        raise Refusal(f"{folder}: there is no such folder; tests/media/make-media.sh makes the "
                      "media, and without --media this does.")
    missing = [name for name in names if not (folder / name).is_file()]
    if missing:
        raise Refusal(f"{folder}: the media {' '.join(missing)} are missing; "
                      f"tests/media/make-media.sh {folder} makes them.")
