#!/usr/bin/python3 -B
# SPDX-License-Identifier: Apache-2.0
"""diagrams.py FOLDER: draws each doc-files/NAME.dot below FOLDER as NAME.svg beside it."""

import pathlib
import re
import subprocess
import sys

from problem import Problem

# The page's colours and letters; a diagram may choose others.
STYLE = ["-Gbgcolor=transparent", "-Gfontname=sans-serif", "-Nfontname=sans-serif",
         "-Efontname=sans-serif", "-Nfontsize=11", "-Efontsize=10", "-Nshape=box"]


def svg_of(text, source, line):
    """The diagram as an SVG element; source and line are where the text begins."""
    done = subprocess.run(["dot", "-Tsvg", *STYLE], input=text, capture_output=True,
                          encoding="utf-8", check=False)
    if done.returncode != 0 or done.stderr:
        raise Problem([explain(done.stderr, source, line)])
    return done.stdout[done.stdout.index("<svg"):]


def explain(said, source, line):
    """Graphviz counts lines from the diagram's first."""
    first = said.strip().split("\n")[0] or "dot failed"
    place = re.search(r"in line (\d+)", first)
    return f"{source}:{line + int(place.group(1)) - 1 if place else line}: {first}"


def inline(svg, number):
    """For one of several diagrams in a page, whose ids must differ."""
    return re.sub(r'( id="|"#)', rf"\g<1>diagram{number}-", svg)


def draw_doc_files(folder, name_of=str):
    """Draws what stands in that folder's doc-files; name_of gives a file's name in problems."""
    for path in sorted(folder.rglob("doc-files/*.dot")):
        svg = svg_of(path.read_text("utf-8"), name_of(path), 1)
        path.with_suffix(".svg").write_text(svg, "utf-8")


if __name__ == "__main__":
    try:
        draw_doc_files(pathlib.Path(sys.argv[1]))
    except Problem as problem:
        sys.exit(str(problem))
