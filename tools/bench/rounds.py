# SPDX-License-Identifier: Apache-2.0
"""Takes the samples: the sides of a comparison alternate, and each round has
the other one first, so that what changes in the machine meanwhile meets both."""

import dataclasses

from figures import Failed, Figure, Row, row_name


def measure(comparison, wanted, rounds):
    """The rows of a comparison whose names are wanted."""
    quantities = [q for q in comparison.quantities if row_name(comparison.name, q.name) in wanted]
    rows = [Row(row_name(comparison.name, q.name), q.unit, q.goal,
                comparison.peer.name if comparison.peer else None) for q in quantities]
    try:
        comparison.prepare()
        samples = _samples(comparison, rounds)
    except Failed as failure:
        return [dataclasses.replace(row, failure=str(failure)) for row in rows]
    return [_filled(row, quantity.name, comparison, samples)
            for row, quantity in zip(rows, quantities)]


def _samples(comparison, rounds):
    """Per side a list with a dictionary for each round."""
    sides = [side for side in (comparison.here, comparison.peer) if side]
    samples = {side.name: [] for side in sides}
    for number in range(rounds):
        for side in sides if number % 2 == 0 else reversed(sides):
            try:
                samples[side.name].append(side.take())
            except Failed as failure:
                raise Failed(f"{side.name}: {failure}") from failure
    return samples


def _filled(row, quantity, comparison, samples):
    def figure(side):
        numbers = [sample[quantity] for sample in samples[side.name] if quantity in sample]
        return Figure(tuple(numbers)) if numbers else None
    here = figure(comparison.here)
    if here is None:
        return dataclasses.replace(row, failure=f"{comparison.here.name}: gave no such figure")
    return dataclasses.replace(row, here=here,
                               peer=figure(comparison.peer) if comparison.peer else None)
