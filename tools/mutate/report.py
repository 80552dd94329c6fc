# SPDX-License-Identifier: Apache-2.0
"""What a run says: a live line while it goes on, then counts and what was missed."""

import collections
import sys
import threading

OUTCOMES = ("noticed", "timed out", "unnoticed", "did not compile", "equivalent")
GOALS = {"product": 100.0, "engine": 95.0, "java": 95.0}


class Report:
    def __init__(self, total):
        self.total = total
        self.results = []  # (mutant, outcome, detail)
        self._lock = threading.Lock()

    def add(self, mutant, outcome, detail, diff):
        """diff: lines, shown at once when nothing noticed the mutant."""
        with self._lock:
            self.results.append((mutant, outcome, detail))
            if outcome == "unnoticed":
                self._clear()
                print(f"unnoticed: {mutant.place()} {mutant.function} "
                      f"({mutant.operator}; {detail})")
                print("".join(f"    {line}\n" for line in diff), end="", flush=True)
            self._show()

    def _show(self):
        if not sys.stderr.isatty():
            return
        counts = collections.Counter(outcome for _, outcome, _ in self.results)
        told = ", ".join(f"{counts[o]} {o}" for o in OUTCOMES if counts[o])
        print(f"\r\033[K     {len(self.results)} of {self.total}: {told}", end="",
              file=sys.stderr, flush=True)

    @staticmethod
    def _clear():
        if sys.stderr.isatty():
            print("\r\033[K", end="", file=sys.stderr, flush=True)

    def print_table(self):
        """A row for each operator of each area."""
        self._clear()
        rows = [("area", "operator", "made", *OUTCOMES, "score")]
        for area in GOALS:
            here = self._of_area(area)
            for operator in sorted({operator for operator, _ in here}):
                rows.append((area, operator, *counted([o for p, o in here if p == operator])))
            if here:
                rows.append((area, "all", *counted([outcome for _, outcome in here])))
        widths = [max(len(row[i]) for row in rows) for i in range(len(rows[0]))]
        for row in rows:
            print("  ".join(cell.ljust(width) if i < 2 else cell.rjust(width)
                            for i, (cell, width) in enumerate(zip(row, widths))).rstrip())

    def meets_goals(self):
        scores = {area: score([o for _, o in self._of_area(area)]) for area in GOALS}
        return all(share is None or share >= GOALS[area] for area, share in scores.items())

    def _of_area(self, area):
        """(operator, outcome) of each."""
        return [(m.operator, outcome) for m, outcome, _ in self.results if m.area == area]


def score(outcomes):
    """Percent noticed of those that can be; None when there are none."""
    noticed = sum(o in ("noticed", "timed out") for o in outcomes)
    judged = noticed + sum(o == "unnoticed" for o in outcomes)
    return 100.0 * noticed / judged if judged else None


def counted(outcomes):
    share = score(outcomes)
    return [str(len(outcomes)), *(str(outcomes.count(o)) for o in OUTCOMES),
            "-" if share is None else f"{share:.1f} %"]
