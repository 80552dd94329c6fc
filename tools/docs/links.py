# SPDX-License-Identifier: Apache-2.0
"""Every link of the site: where it stands, and whether what it names is there."""

import collections
import functools
import html.parser
import os
import re
import urllib.parse

# source and line: where it is written; target: how. page: the site's file that
# has it, from the site's top; href: how it stands there. resource: what a
# browser loads by itself.
Reference = collections.namedtuple("Reference", "source line target page href resource")

RESOURCES = {("img", "src"), ("script", "src"), ("link", "href"), ("iframe", "src"),
             ("image", "href"), ("image", "xlink:href"), ("source", "src"), ("video", "src")}
LINKS = {("a", "href"), ("a", "xlink:href"), ("area", "href")}
CSS_URL = re.compile(r"""(?:@import\s+|url\()\s*(?:url\()?["']?([^"')\s;]+)""")


class Reader(html.parser.HTMLParser):
    """The links and the anchors of a piece of HTML."""

    def __init__(self, text):
        super().__init__()
        self.links = []  # (line, target, resource)
        self.anchors = set()
        self.feed(text)
        self.close()

    def handle_starttag(self, tag, attrs):
        for name, value in attrs:
            if name == "id" or (tag == "a" and name == "name"):
                self.anchors.add(value)
            elif value is not None and (tag, name) in RESOURCES | LINKS:
                if not (tag == "link" and ("rel", "canonical") in attrs):
                    self.links.append((self.getpos()[0], value, (tag, name) in RESOURCES))


def references_of(site, skip):
    """Those of the site's pages and stylesheets but the skipped files."""
    found = []
    for path in sorted(site.rglob("*")):
        name = path.relative_to(site)
        if name in skip or not path.is_file():
            continue
        if path.suffix == ".html":
            links = Reader(path.read_text("utf-8")).links
        elif path.suffix == ".css":
            links = stylesheet_links(path.read_text("utf-8"))
        else:
            continue
        found += [Reference(name, line, target, name, target, resource)
                  for line, target, resource in links]
    return found


def stylesheet_links(text):
    for number, line in enumerate(text.splitlines(), 1):
        for target in CSS_URL.findall(line):
            if not target.startswith("data:"):
                yield number, target, True


def is_external(href):
    return bool(urllib.parse.urlsplit(href).scheme) or href.startswith("//")


def external(references):
    """The addresses outside the site, each once."""
    return sorted({reference.href for reference in references if is_external(reference.href)})


def check(site, references):
    """Problems as lines FILE:LINE: what."""
    anchors = functools.lru_cache(None)(
        lambda path: Reader((site / path).read_text("utf-8")).anchors)
    problems = []
    for reference in references:
        complaint = complain(site, reference, anchors)
        if complaint:
            problems.append(f"{reference.source}:{reference.line}: {reference.target}: {complaint}")
    return problems


def complain(site, reference, anchors):
    if is_external(reference.href):
        return "is loaded from elsewhere" if reference.resource else None
    parts = urllib.parse.urlsplit(reference.href)
    path = urllib.parse.unquote(parts.path)
    place = reference.page
    if path:
        place = type(place)(os.path.normpath(place.parent / path))
        if path.startswith("/") or ".." in place.parts:
            return "leads out of the documentation"
        if not (site / place).is_file():
            return "there is no such file"
    fragment = urllib.parse.unquote(parts.fragment)
    if fragment and place.suffix == ".html" and fragment not in anchors(place):
        return f"{place} has no anchor '{fragment}'"
    return None
