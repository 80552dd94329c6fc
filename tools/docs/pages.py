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
    """The pages of FIRST, of docs/, and the files and folders that they link to."""
    sources = [pathlib.PurePosixPath(name) for name in FIRST if (root / name).is_file()]
    sources += [pathlib.PurePosixPath(path.relative_to(root))
                for path in sorted((root / "docs").rglob("*.md"))]
    rendered, references = {}, []
    waiting = list(sources)
    while waiting:
        source = waiting.pop(0)
        if source in rendered:
            continue
        resolver = Resolver(root, modules, site, source)
        page = render(root, source, resolver)
        rendered[source] = page
        waiting += resolver.pages
        references += [links.Reference(source, line, target, resolver.page, href, resource)
                       for line, target, href, resource in page.links]
    shutil.copy(HERE / "style.css", site / "style.css")
    listed = {html_name(root, source): page for source, page in rendered.items()
              if source.suffix == ".md"}
    for source, page in rendered.items():
        write(site, html_name(root, source), page.title, page.body, listed, modules)
    index = pathlib.PurePosixPath("index.html")
    write(site, index, "Documentation", contents(listed, modules), listed, modules)
    return Written({html_name(root, source) for source in rendered}, references)


def render(root, source, resolver):
    if (root / source).is_dir():
        return list_folder(root, source, resolver)
    return markdown.render((root / source).read_text("utf-8"), source, resolver.resolve)


def list_folder(root, source, resolver):
    """What a repository's viewer shows of a folder."""
    names = sorted(f"{path.name}/" if path.is_dir() else path.name
                   for path in (root / source).iterdir() if not path.name.startswith("."))
    lines = [f'<li><a href="{html.escape(resolver.place(source / name))}">{html.escape(name)}</a>'
             "</li>" for name in names]
    body = f"<h1>{html.escape(str(source))}</h1>\n<ul>\n" + "\n".join(lines) + "\n</ul>\n"
    return markdown.Page(str(source), "", body, [])


class Resolver:
    """Makes the links of a repository's file into those of the site's page."""

    def __init__(self, root, modules, site, source):
        self.root, self.modules, self.site, self.source = root, modules, site, source
        self.page = html_name(root, source)
        self.pages = []  # What else the site is to have.

    def resolve(self, target):
        path, mark, fragment = target.partition("#")
        if not path or links.is_external(target):
            return target
        named = pathlib.PurePosixPath(os.path.normpath(self.source.parent / path))
        if ".." in named.parts or named.is_absolute():
            return target
        return self.place(named) + mark + fragment

    def place(self, named):
        """Where the site has that file or folder of the repository, from the page."""
        if (self.root / named / "README.md").is_file():
            named /= "README.md"
        described = api.page_of(named, self.modules, self.site)
        if described is not None:
            return relative(described, self.page)
        path = self.root / named
        if path.is_dir() or (path.is_file() and named.suffix == ".md"):
            self.pages.append(named)
            return relative(html_name(self.root, named), self.page)
        if path.is_file():
            (self.site / named).parent.mkdir(parents=True, exist_ok=True)
            shutil.copy(path, self.site / named)
        return relative(named, self.page)


def html_name(root, source):
    """The page of a Markdown file or of a folder."""
    if (root / source).is_dir():
        return source / "index.html"
    return source.with_suffix(".html")


def relative(place, page):
    return os.path.relpath(place, page.parent)


def entries(listed, modules):
    """(place, title, summary) of each page and module."""
    for place, page in listed.items():
        yield place, page.title, page.summary
    for module in modules:
        place = pathlib.PurePosixPath("api") / module.name / "module-summary.html"
        yield place, module.name, "Javadoc of the Java module."


def link(place, page, title):
    current = ' aria-current="page"' if place == page else ""
    return f'<a href="{html.escape(relative(place, page))}"{current}>{html.escape(title)}</a>'


def contents(listed, modules):
    index = pathlib.PurePosixPath("index.html")
    lines = []
    for place, title, summary in entries(listed, modules):
        lines.append(f"<li>{link(place, index, title)}<br>{html.escape(summary)}</li>")
    return "<h1>Documentation</h1>\n<ul>\n" + "\n".join(lines) + "\n</ul>\n"


def write(site, name, title, body, listed, modules):
    navigation = [f"<li>{link(place, name, label)}</li>"
                  for place, label, _ in entries(listed, modules)]
    text = TEMPLATE.substitute(
        title=html.escape(title), style=relative("style.css", name),
        index=relative("index.html", name), navigation="\n".join(navigation), body=body)
    (site / name).parent.mkdir(parents=True, exist_ok=True)
    (site / name).write_text(text, "utf-8")
