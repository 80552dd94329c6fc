# SPDX-License-Identifier: Apache-2.0
"""A file that keeps each outcome as it comes, so that a run of hours can be ended
and gone on with: a line of JSON for each."""

import hashlib
import json
import threading

from mutant import Failed


class Journal:
    """Knows what earlier runs found out of mutants whose source is still the same. What
    nothing noticed is left out: new tests may."""

    def __init__(self, path, source_of):
        self._source_of = source_of
        self._digests = {}
        self._lock = threading.Lock()
        self._known = {}
        try:
            self._file = open(path, "a+", encoding="utf-8")
        except OSError as error:
            raise Failed(f"{path} cannot be written: {error.strerror}.") from None
        self._file.seek(0)
        try:
            for line in self._file.read().splitlines():
                key, outcome, detail = json.loads(line)
                self._known[tuple(key)] = (outcome, detail)
        except (ValueError, TypeError):
            self._file.close()
            raise Failed(f"{path} is not a file of ./orv mutate --resume.") from None

    def close(self):
        self._file.close()

    def outcome(self, mutant):
        """(outcome, detail), or None when it is to be tried."""
        known = self._known.get(self._key(mutant))
        return known if known and known[0] != "unnoticed" else None

    def note(self, mutant, outcome, detail):
        with self._lock:
            self._file.write(json.dumps([self._key(mutant), outcome, detail]) + "\n")
            self._file.flush()  # a whole line at a time

    def _key(self, mutant):
        if mutant.file not in self._digests:
            self._digests[mutant.file] = hashlib.sha256(self._source_of(mutant)).hexdigest()
        return (self._digests[mutant.file], *mutant.identity())
