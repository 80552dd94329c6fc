# SPDX-License-Identifier: Apache-2.0
"""The Java in Markdown pages, compiled as a program would have it.

A fence marked java holds statements, or whole classes when a line begins with
"class", "public", "final", "interface" or "record". An HTML comment
in front of it may say more, its parts in this order:

    <!-- java: Surface surface, MediaPlayer player -->    variables that it assumes
    <!-- java members: MediaPlayer player -->             a class's members; fields it assumes
    <!-- java with testing: -->                           compiled where a JAR is of that name
"""

import collections
import pathlib
import re
import subprocess

from markdown_it import MarkdownIt

# What a program's editor would import.
IMPORTS = """
android.graphics.* android.os.Parcel android.view.* com.quintora.SubtitleAttr com.quintora.mmp.*
com.quintora.mmp.desktop.* com.quintora.mmp.util.PcmMediaInfo java.awt.BorderLayout
java.awt.EventQueue java.awt.image.BufferedImage java.io.* java.net.URI java.nio.*
java.nio.channels.* java.nio.file.* java.time.Duration java.util.* java.util.concurrent.*
javax.swing.JFrame javax.swing.JLabel javax.swing.JSlider javax.swing.SwingUtilities
"""
COMMENT = re.compile(r"<!-- java( members)?(?: with (\w+))?: ?(.*?) ?-->", re.DOTALL)
CLASSES = re.compile(r"^(class|public|final|interface|record) ", re.MULTILINE)
PUBLIC = re.compile(r"^public (?:\w+ )*?(?:class|interface|record|enum) (\w+)", re.MULTILINE)

# line: of the page, where the code's first line stands.
Snippet = collections.namedtuple("Snippet", "page line code members jar variables")


def read(page):
    """The page's snippets."""
    tokens = MarkdownIt("commonmark").enable("table").parse(page.read_text("utf-8"))
    found = []
    for before, token in zip([None, *tokens], tokens):
        if token.type == "fence" and token.info.strip() == "java":
            said = COMMENT.match(before.content) if before and before.type == "html_block" else None
            members, jar, variables = said.groups() if said else (None, None, "")
            found.append(Snippet(page, token.map[0] + 2, token.content, bool(members), jar,
                                 " ".join(variables.split())))
    return found


def is_compilation_unit(snippet):
    return not snippet.members and CLASSES.search(snippet.code) is not None


def file_name(snippet):
    public = PUBLIC.search(snippet.code) if is_compilation_unit(snippet) else None
    return f"{public[1]}.java" if public else "Snippet.java"


def program(snippet, package):
    """The code in what it needs around it, on the page's own lines."""
    imports = "".join(f"import {name};" for name in IMPORTS.split())
    start, end = "", ""
    if snippet.members:
        fields = "".join(f"{field.strip()};" for field in snippet.variables.split(",") if field)
        start, end = f"{imports} abstract class Snippet {{ {fields}", "}\n"
    elif not is_compilation_unit(snippet):
        start = (f"{imports} abstract class Snippet {{ "
                 f"void run({snippet.variables}) throws Exception {{")
        end = "} }\n"
    lead = "\n" * (snippet.line - 2)
    return f"{lead}package {package}; {start}\n{snippet.code}{end}"


def compile_all(javac, jars, snippets, folder):
    """What the compiler says, by the pages' lines; empty when all is well."""
    said_by = {}
    for number, snippet in enumerate(snippets):
        source = folder / f"snippet{number}" / file_name(snippet)
        source.parent.mkdir(parents=True)
        source.write_text(program(snippet, source.parent.name), "utf-8")
        said_by[source] = snippet.page
    done = subprocess.run(
        [javac, "-encoding", "UTF-8", "--release", "17", "-proc:none", "-Xlint:all", "-Werror",
         "-Xmaxerrs", "1000", "--module-path", ":".join(map(str, jars)),
         "--add-modules", "ALL-MODULE-PATH", "-d", folder / "classes", *said_by],
        capture_output=True, encoding="utf-8", check=False)
    said = done.stdout + done.stderr
    for source, page in said_by.items():
        said = said.replace(str(source), str(page))
    return said if done.returncode != 0 else ""


def read_jars(modules):
    """The JARs that build/java/modules.txt names."""
    return [pathlib.Path(line.split(" ", 1)[1])
            for line in modules.read_text("utf-8").splitlines()]
