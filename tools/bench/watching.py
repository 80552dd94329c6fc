# SPDX-License-Identifier: Apache-2.0
"""Programs that do not end by themselves: watched, then ended."""

import time

from figures import Failed
from tree import Tree


class EndedEarly(Exception):
    """A program that ended before what was waited for."""


def await_true(condition, tree, limit, what, pause):
    """Until the condition gives something, which is returned."""
    until = time.monotonic() + limit
    while not (result := condition()):
        if tree.has_ended():
            raise EndedEarly(f"ended before {what}")
        if time.monotonic() > until:
            raise Failed(f"not at {what} within {limit:g} s")
        time.sleep(pause)
    return result


def watch(command, environment, look):
    """(what `look` returned of the tree of processes, what that used): the
    program is ended as soon as that is seen."""
    tree = Tree(command, environment)
    try:
        seen = look(tree)
    except EndedEarly as early:
        raise Failed(f"{early}: {tree.end().reason()}") from early
    except BaseException:
        tree.end()
        raise
    return seen, tree.end()
