# SPDX-License-Identifier: Apache-2.0
"""The compiler's findings in the words of docs/platform-tree.md: which header,
module, class or function is missing or different."""

import collections
import os
import re

Diagnostic = collections.namedtuple("Diagnostic", "file line column text notes")

BASE = "MediaPlayerBase"
BASE_HEADER = "media/MediaPlayerInterface.h"
# Names of the platform that the header's own name does not show.
HOMES = (
    (r"jni[A-Z]\w+", "nativehelper/JNIHelp.h"),
    (r"JNI\w+|JavaVM|j(object|class|string|int|long|boolean|byteArray)|jni\w+ID", "jni.h"),
    (r"ALOG\w*|__android_log_\w+", "log/log.h"),
    (r"android_view_Surface_\w+", "android_runtime/android_view_Surface.h"),
    (rf"MEDIA_\w+|media_\w+_type|{BASE}|Listener", BASE_HEADER),
    (r"ReadOptions|SeekMode|SEEK_\w+", "media/MediaTrack.h"),
    (r"sp|wp", "utils/RefBase.h"),
    (r"Autolock", "utils/Mutex.h"),
    (r"status_t|OK|NO_ERROR|NO_INIT|BAD_VALUE|INVALID_OPERATION|UNKNOWN_ERROR", "utils/Errors.h"),
)


def parse(text):
    """What clang wrote, each error or warning with its notes."""
    found = []
    for line in text.splitlines():
        match = re.match(r"(.+?):(\d+):(\d+): (fatal error|error|warning|note): (.*)", line)
        if match is None:
            continue
        file, number, column, severity, message = match.groups()
        diagnostic = Diagnostic(os.path.normpath(file), int(number), int(column), message, [])
        if severity != "note":
            found.append(diagnostic)
        elif found:
            found[-1].notes.append(diagnostic)
    return found


def plain(name):
    """A name without the namespaces and arguments that one compiler shows and
    another leaves out."""
    return re.sub(r"<.*", "", name).split("::")[-1].split()[-1]


class Words:
    def __init__(self, product, tree, modules, releases):
        self.product = product
        self.tree = tree
        self.modules = modules
        self.releases = releases

    def release_note(self, name):
        return f"; {self.releases[name]}" if name in self.releases else ""

    def header_of(self, name):
        """The header that declares a name of the platform, or None."""
        for pattern, header in HOMES:
            if re.fullmatch(pattern, name):
                return header
        return next((header for header in self.modules
                     if os.path.basename(header) == f"{name}.h"), None)

    def place(self, header):
        return f"{header}, module {self.modules[header]}"

    def path(self, path):
        """A file's path in the tree, in the product or in this project."""
        for folder in (self.tree, os.path.join(self.product, "../../..")):
            if os.path.isabs(path) and path.startswith(os.path.normpath(folder) + os.sep):
                return os.path.relpath(path, folder)
        return path

    def at(self, diagnostic):
        return f"{self.path(diagnostic.file)}:{diagnostic.line}"

    def is_trees(self, diagnostic):
        return diagnostic.file.startswith(self.tree + os.sep)

    def concerns_sources(self, diagnostic):
        """A warning between headers of the tree is the platform's own."""
        return not (re.search(r"\[-W.*\]$", diagnostic.text)
                    and all(map(self.is_trees, [diagnostic, *diagnostic.notes])))

    def as_it_is(self, diagnostic):
        sentence = f"{self.at(diagnostic)}: {diagnostic.text}"
        return sentence, sentence

    def line_of(self, diagnostic):
        """The source text there; the compiler also points into macros, which
        are no files."""
        path = os.path.join(self.product, diagnostic.file)
        if not os.path.isfile(path):
            return ""
        with open(path, encoding="utf-8", errors="replace") as file:
            return file.read().splitlines()[diagnostic.line - 1]

    def rest_of_line(self, diagnostic):
        """The source text from where the compiler points."""
        return self.line_of(diagnostic)[diagnostic.column - 1:]

    # Each sentence comes with the name that it is about; without one, the
    # finding only follows from another.

    def no_header(self, header, diagnostic):
        yield header, f"header {header} is missing, which {self.at(diagnostic)} includes"

    def missing(self, name, diagnostic):
        name = plain(name)
        header = self.header_of(name)
        if header:
            rest = self.rest_of_line(diagnostic)
            kind = "function" if re.match(rf"{name} *\(", rest) else \
                "constant" if name.isupper() else "class" if name[0].isupper() else "name"
            yield name, (f"{kind} {name} is missing ({self.place(header)}), which "
                         f"{self.at(diagnostic)} uses{self.release_note(name)}")

    def lacks(self, member, owner, diagnostic, how="has no {}, which {} uses"):
        owner, member = plain(owner), plain(member)
        header = self.header_of(owner)
        if header:
            name = f"{owner}::{member}"
            yield name, (f"class {owner} ({self.place(header)}) "
                         f"{how.format(member, self.at(diagnostic))}{self.release_note(name)}")

    def private(self, member, owner, diagnostic):
        return self.lacks(member, owner, diagnostic, "keeps {} to itself, which {} uses")

    def otherwise(self, name, diagnostic):
        for declared in filter(self.is_trees, diagnostic.notes[:1]):
            yield plain(name), (f"{plain(name)} takes other arguments in {self.at(declared)} than "
                                f"{self.at(diagnostic)} gives it{self.release_note(plain(name))}")

    def other_count(self, diagnostic):
        """The call's function is named in the note alone."""
        name = re.match(r"'(.+?)' declared here", "".join(
            note.text for note in diagnostic.notes[:1]))
        return self.otherwise(name.group(1), diagnostic) if name else ()

    def other_tag(self, ours, name, theirs, diagnostic):
        if self.is_trees(diagnostic):
            ours, theirs = theirs, ours
        name = plain(name)
        yield name, (f"{name} is a {theirs} in the tree and a {ours} in the sources"
                     f"{self.release_note(name)}")

    def not_a_class(self, diagnostic):
        name = re.match(r"\w[\w:]*", self.rest_of_line(diagnostic))
        return self.missing(name.group(), diagnostic) if name else ()

    def no_override(self, diagnostic):
        for name in re.findall(r"^.*?(\w+)\(", self.line_of(diagnostic)):
            yield name, (f"operation {name} of class {BASE} ({self.place(BASE_HEADER)}) is "
                         f"missing or is not the one in {self.at(diagnostic)}")

    def hidden(self, name, diagnostic):
        yield name, (f"class {BASE} ({self.place(BASE_HEADER)}) has another operation of the "
                     f"name {name}, which {self.at(diagnostic)} hides")

    def abstract(self, name, diagnostic):
        for note in diagnostic.notes:
            pure = re.match(r"unimplemented pure virtual method '(\w+)'", note.text)
            if pure:
                yield pure.group(1), (
                    f"class {plain(name)} does not have the operation {pure.group(1)}, which is "
                    f"pure in class {BASE} ({self.place(BASE_HEADER)})")

    def say(self, diagnostic):
        """The (name, sentence) pairs of what can be put into words."""
        for pattern, sentences in RULES:
            match = re.match(pattern, diagnostic.text)
            if match:
                return list(sentences(self, *match.groups(), diagnostic))
        return []


RULES = (
    (r"'(.+?)' file not found", Words.no_header),
    (r"use of undeclared identifier '(.+?)'", Words.missing),
    (r"unknown (?:type|class) name '(.+?)'", Words.missing),
    (r"no template named '(.+?)'", Words.missing),
    (r"expected class name", Words.not_a_class),
    (r"no (?:member|type) named '(.+?)' in namespace '.+?'", Words.missing),
    (r"no (?:member|type|template) named '(.+?)' in '(.+?)'", Words.lacks),
    (r"'(.+?)' is a (?:private|protected) member of '(.+?)'", Words.private),
    (r"no matching (?:member )?function for call to '(.+?)'", Words.otherwise),
    (r"no matching constructor for initialization of '(.+?)'", Words.otherwise),
    (r"(struct|class) '(.+?)' was previously declared as a (struct|class)", Words.other_tag),
    (r"too (?:many|few) arguments to function call", Words.other_count),
    (r"'\w+' marked 'override' but does not override", Words.no_override),
    (r"non-virtual member function marked 'override'", Words.no_override),
    (r"only virtual member functions can be marked 'override'", Words.no_override),
    (r"virtual function '\w+' has a different return type", Words.no_override),
    (r"'(?:.+::)?(\w+)' hides overloaded virtual function", Words.hidden),
    (r"allocating an object of abstract class type '(.+?)'", Words.abstract),
)
