# SPDX-License-Identifier: Apache-2.0
"""What is measured, and what its figures mean: a comparison takes samples of
two sides in turn and yields a row for each quantity that they have in common."""

import dataclasses
import statistics
from collections.abc import Callable


class Failed(Exception):
    """Why a side has no figure, in a few words."""


@dataclasses.dataclass(frozen=True)
class Goal:
    """The most that a row may have: times the other side's figure, or of its
    own unit; with `over`, that much more than the other side's figure."""
    most: float
    kind: str = "ratio"  # or "value", or "over"

    def is_met(self, here, peer):
        if self.kind == "value":
            return here <= self.most
        if peer is None:
            return None
        return here <= (self.most * peer if self.kind == "ratio" else self.most + peer)


@dataclasses.dataclass(frozen=True)
class Quantity:
    """Something that every sample of a comparison has a number for."""
    name: str
    unit: str
    goal: Goal | None = None


@dataclasses.dataclass(frozen=True)
class Side:
    """One of the two that are compared. `take` returns a number for each
    quantity by its name, or raises Failed."""
    name: str
    take: Callable[[], dict[str, float]]


@dataclasses.dataclass(frozen=True)
class Comparison:
    """`peer` is None for what stands alone, `prepare` is called before the
    first sample and raises Failed when there can be none."""
    name: str
    quantities: tuple[Quantity, ...]
    here: Side
    peer: Side | None = None
    prepare: Callable[[], None] = lambda: None

    def row_names(self):
        return [row_name(self.name, quantity.name) for quantity in self.quantities]


def row_name(comparison, quantity):
    return f"{comparison}/{quantity}" if quantity else comparison


@dataclasses.dataclass(frozen=True)
class Figure:
    """The samples of one quantity of one side, a number a round."""
    samples: tuple[float, ...]

    @property
    def median(self):
        return statistics.median(self.samples)

    @property
    def least(self):
        return min(self.samples)

    @property
    def most(self):
        return max(self.samples)


@dataclasses.dataclass(frozen=True)
class Row:
    """A line of the table. Without `here` the row has failed, and `failure`
    says why; without `peer` there is nothing to compare with."""
    name: str
    unit: str
    goal: Goal | None
    peer_name: str | None = None
    here: Figure | None = None
    peer: Figure | None = None
    failure: str | None = None

    @property
    def ratio(self):
        """Of the medians; None where there are not two, or the other is 0."""
        if self.here is None or self.peer is None or self.peer.median == 0:
            return None
        return self.here.median / self.peer.median

    @property
    def is_met(self):
        """Whether the goal is; None without a goal or without figures."""
        if self.goal is None or self.here is None:
            return None
        return self.goal.is_met(self.here.median, self.peer.median if self.peer else None)
