# SPDX-License-Identifier: Apache-2.0
"""The last actions of a run, which the Java program leaves in a file of slots of equal length,
each begun with its number; also after a crash."""

SLOT = 240


def actions(path):
    """The lines, the oldest first."""
    with open(path, "rb") as file:
        content = file.read()
    slots = [content[place:place + SLOT].strip(b"\0 \n")
             for place in range(0, len(content), SLOT)]
    numbered = sorted(slot.decode("utf-8", "replace") for slot in slots if slot)
    return [line.partition(" ")[2] for line in numbered]
