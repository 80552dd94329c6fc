# SPDX-License-Identifier: Apache-2.0
"""The site's pages that are written in Markdown, and its index."""

import collections
import html
import os
import pathlib
import shutil
import string

import api
import links
import markdown

HERE = pathlib.Path(__file__).parent
TEMPLATE = string.Template((HERE / "page.html").read_text("utf-8"))
FIRST = ["README.md", "CONTRIBUTING.md", "CHANGELOG.md"]

# files: of the site; references: their links.
Written = collections.namedtuple("Written", "files references")


def build(root, modules, site):
    """The pages of FIRST, of docs/, and of those that they link to."""
    rendered = {}
    waiting = [pathlib.PurePosixPath(name) for name in FIRST if (root / name).is_file()]
    waiting += [pathlib.PurePosixPath(path.relative_to(root))
                for path in sorted((root / "docs").rglob("*.md"))]
    references = []
    while waiting:
        source = waiting.pop(0)
        if source in rendered:
            continue
        resolver = Resolver(root, modules, site, source)
        page = markdown.render((root / source).read_text("utf-8"), source, resolver.resolve)
        rendered[source] = page
        waiting += resolver.pages
        references += [links.Reference(source, line, target, html_name(source), href, resource)
                       for line, target, href, resource in page.links]
    shutil.copy(HERE / "style.css", site / "style.css")
    for source, page in rendered.items():
        write(site, html_name(source), page.title, page.body, rendered, modules)
    index = pathlib.PurePosixPath("index.html")
    write(site, index, "Documentation", contents(rendered, modules), rendered, modules)
    return Written({html_name(source) for source in rendered}, references)


class Resolver:
    """Makes the links of a repository's file into those of the site's page."""

    def __init__(self, root, modules, site, source):
        self.root, self.modules, self.site, self.source = root, modules, site, source
        self.pages = []

    def resolve(self, target):
        path, mark, fragment = target.partition("#")
        if not path or links.is_external(target):
            return target
        named = pathlib.PurePosixPath(os.path.normpath(self.source.parent / path))
        if ".." in named.parts or named.is_absolute():
            return target
        return relative(self.place_of(named), html_name(self.source)) + mark + fragment

    def place_of(self, named):
        """Where the site has that file of the repository."""
        if (self.root / named / "README.md").is_file():
            named /= "README.md"
        described = api.page_of(named, self.modules, self.site)
        if described is not None:
            return described
        if (self.root / named).is_file():
            if named.suffix == ".md":
                self.pages.append(named)
                return html_name(named)
            (self.site / named).parent.mkdir(parents=True, exist_ok=True)
            shutil.copy(self.root / named, self.site / named)
        return named


def html_name(source):
    return source.with_suffix(".html")


def relative(place, page):
    return os.path.relpath(place, page.parent)


def entries(rendered, modules):
    """(place, title, summary) of each page and module."""
    for source, page in rendered.items():
        yield html_name(source), page.title, page.summary
    for module in modules:
        place = pathlib.PurePosixPath("api") / module.name / "module-summary.html"
        yield place, module.name, "Javadoc of the Java module."


def link(place, page, title):
    current = ' aria-current="page"' if place == page else ""
    return f'<a href="{html.escape(relative(place, page))}"{current}>{html.escape(title)}</a>'


def contents(rendered, modules):
    index = pathlib.PurePosixPath("index.html")
    lines = []
    for place, title, summary in entries(rendered, modules):
        lines.append(f"<li>{link(place, index, title)}<br>{html.escape(summary)}</li>")
    return "<h1>Documentation</h1>\n<ul>\n" + "\n".join(lines) + "\n</ul>\n"


def write(site, name, title, body, rendered, modules):
    navigation = [f"<li>{link(place, name, label)}</li>"
                  for place, label, _ in entries(rendered, modules)]
    text = TEMPLATE.substitute(
        title=html.escape(title), style=relative("style.css", name),
        index=relative("index.html", name), navigation="\n".join(navigation), body=body)
    (site / name).parent.mkdir(parents=True, exist_ok=True)
    (site / name).write_text(text, "utf-8")
