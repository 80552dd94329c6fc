# SPDX-License-Identifier: Apache-2.0
"""What is wrong with the documentation's sources."""


class Problem(Exception):
    """Lines, each FILE:LINE: what."""

    def __init__(self, lines):
        super().__init__("\n".join(lines))
        self.lines = list(lines)
