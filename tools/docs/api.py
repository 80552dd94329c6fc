# SPDX-License-Identifier: Apache-2.0
"""The Javadoc of the Java modules."""

import collections
import pathlib
import re
import subprocess

import diagrams
from problem import Problem

LIST = pathlib.Path(__file__).with_name("modules.txt")

# folder: as modules.txt has it; sources: the folder of its module-info.java;
# both below the project's root.
Module = collections.namedtuple("Module", "name folder sources")


def listed(kind):
    """What the list has of that kind: module or jar."""
    words = (line.split("#")[0].split() for line in LIST.read_text("utf-8").splitlines())
    return [entry[1] for entry in words if entry and entry[0] == kind]


def find_modules(root):
    modules = []
    for folder in listed("module"):
        for info in sorted((root / folder).rglob("module-info.java")):
            name = re.search(r"^(?:open )?module ([\w.]+)", info.read_text("utf-8"), re.MULTILINE)
            if name is None:
                raise Problem([f"{info.relative_to(root)}:1: declares no module"])
            modules.append(Module(name.group(1), folder, info.parent.relative_to(root)))
    return modules


def build(javadoc, root, modules, site):
    """Into site/api; its diagrams are drawn from doc-files/NAME.dot."""
    if not modules:
        return
    names = ",".join(module.name for module in modules)
    command = [javadoc, "-quiet", "-Werror", "-notimestamp", "--release", "17",
               "-encoding", "UTF-8", "-docencoding", "UTF-8", "--module", names,
               "-d", str(site / "api"), *options_of(javadoc)]
    jars = [jar for jar in listed("jar") if pathlib.Path(jar).is_file()]
    if jars:
        command += ["--module-path", ":".join(jars)]
    for module in modules:
        command += ["--module-source-path", f"{module.name}={root / module.sources}"]
    done = subprocess.run(command, capture_output=True, encoding="utf-8", check=False)
    if done.returncode != 0:
        said = (done.stdout + done.stderr).replace(f"{root}/", "")
        raise Problem([said.strip()])
    drop_lacking_letters(site / "api")
    name_constants(site / "api/constant-values.html")
    for module in modules:
        place = site / "api" / module.name
        diagrams.draw_doc_files(
            place, lambda path, m=module, p=place: m.sources / path.relative_to(p))


def options_of(javadoc):
    said = subprocess.run([javadoc, "--version"], capture_output=True, encoding="utf-8",
                          check=True).stdout
    version = int(re.search(r"\d+", said)[0])
    # Before 21, records' compact constructors need the comments that they cannot have.
    options = ["-Xdoclint:all" if version >= 21 else "-Xdoclint:all,-missing"]
    # From 23 on, the pages bring letters along unless this says otherwise.
    return options + ["--no-fonts"] if version >= 23 else options


def drop_lacking_letters(folder):
    """Debian's JDKs do not have all letters that their stylesheet asks for."""
    for sheet in folder.rglob("*.css"):
        text = sheet.read_text("utf-8")
        kept = re.sub(r"^@import url\('([^']+)'\);\n",
                      lambda found: found[0] if (sheet.parent / found[1]).is_file() else "",
                      text, flags=re.MULTILINE)
        if kept != text:
            sheet.write_text(kept, "utf-8")


def name_constants(page):
    """The list at its top links to anchors that Java 17's Javadoc names otherwise."""
    if page.is_file():
        text = page.read_text("utf-8")
        page.write_text(re.sub(
            r'<h2 title="([^"]+)">',
            lambda found: found[0] if f'id="{found[1]}"' in text
            else f'<h2 title="{found[1]}" id="{found[1]}">', text), "utf-8")


def page_of(path, modules, site):
    """Where the site describes a source file or folder of a module, from its top; or None."""
    for module in modules:
        base = pathlib.PurePosixPath("api") / module.name
        if str(path) in (module.folder, str(module.sources)):
            return base / "module-summary.html"
        if path.suffix == ".java" and module.sources in path.parents:
            page = base / path.relative_to(module.sources).with_suffix(".html")
            if (site / page).is_file():
                return page
    return None
