# SPDX-License-Identifier: Apache-2.0
"""The mutants that change nothing that anybody could observe, as equivalents.toml
lists them with the reason for each."""

import tomllib

from mutant import Failed, squeeze

NEEDED = ("file", "function", "operator", "text", "reason")
OPTIONAL = ("becomes", "number")


class Equivalents:
    def __init__(self, path):
        self._path = path
        with open(path, "rb") as file:
            try:
                self._entries = tomllib.load(file).get("equivalent", [])
            except tomllib.TOMLDecodeError as error:
                raise Failed(f"{path}: {error}.") from None
        for entry in self._entries:
            missing = [name for name in NEEDED if not str(entry.get(name, "")).strip()]
            unknown = [name for name in entry if name not in NEEDED + OPTIONAL]
            if missing or unknown:
                raise Failed(f"{path}: an entry of {entry.get('file', 'no file')} "
                             + (f"lacks '{missing[0]}'." if missing else
                                f"has the unknown '{unknown[0]}'."))

    def matches(self, mutant):
        return any(matches(entry, text, mutant)
                   for entry in self._entries for text in texts(entry))

    def stale(self, mutants, files):
        """A sentence for each entry of those files that fits no mutant any more."""
        return [f"{self._path.name}: nothing in {entry['file']} is '{squeeze(text)}' "
                f"for {entry['operator']} in {entry['function']} any more."
                for entry in self._entries if entry["file"] in files for text in texts(entry)
                if not any(matches(entry, text, mutant) for mutant in mutants)]


def texts(entry):
    """One, or a list of those alike."""
    return [entry["text"]] if isinstance(entry["text"], str) else entry["text"]


def matches(entry, text, mutant):
    return (entry["file"], entry["function"], entry["operator"], squeeze(text)) == (
        mutant.file, mutant.function, mutant.operator, squeeze(mutant.text)) \
        and ("becomes" not in entry or squeeze(entry["becomes"]) == squeeze(mutant.becomes)) \
        and entry.get("number", mutant.number) == mutant.number
