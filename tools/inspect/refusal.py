# SPDX-License-Identifier: Apache-2.0
"""What the tools say of input that is not what they are for."""

import sys


class Refusal(Exception):
    """The input is unfit; the text is one clear line."""


def exit_with(main, *arguments):
    """Ends the program with what main returns, or with 2 for unfit input."""
    try:
        sys.exit(main(*arguments))
    except Refusal as refusal:
        print(f"orv: {refusal}", file=sys.stderr)
        sys.exit(2)
