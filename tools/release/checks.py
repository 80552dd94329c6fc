# SPDX-License-Identifier: Apache-2.0
"""What must hold of a checkout before it is released."""

import datetime
import re

from outcome import Missing, output_of

NUMBER = r"(\d+(?:\.\d+)+)"
# Where users read the version, beside project(VERSION): the file and what stands there.
PLACES = [
    ("debian/changelog", rf"\A\S+ \({NUMBER}-[^)]*\)"),
    ("CHANGELOG.md", rf"\A(?:(?!^## ).*\n)*## {NUMBER}"),
    ("docs/maven.md", rf"<version>{NUMBER}</version>"),
    ("docs/maven.md", rf"com\.quintora\.mmp:mediaplayer-orv:{NUMBER}"),
    ("samples/maven/pom.xml", rf"<orv\.version>{NUMBER}</orv\.version>"),
    ("samples/maven/build.gradle.kts", rf'^val orvVersion = "{NUMBER}"'),
]


def product_version(root):
    """The one place that has it."""
    try:
        text = (root / "CMakeLists.txt").read_text("utf-8")
    except OSError:
        return None
    match = re.search(rf"^project\(\w+ VERSION {NUMBER}\b", text, re.MULTILINE)
    return match and match[1]


def check_tree(release):
    lines = output_of(["git", "-C", release.root, "status", "--porcelain"]).splitlines()
    if lines:
        more = f" and {len(lines) - 1} more" if len(lines) > 1 else ""
        raise Missing(f"not committed: {lines[0][3:]}{more}")
    return f"nothing is uncommitted in {commit_of(release)}"


def commit_of(release, what="HEAD"):
    return output_of(["git", "-C", release.root, "rev-parse", "--short", what]).strip()


def check_version(release):
    others = []
    for name, pattern in PLACES:
        path = release.root / name
        found = re.findall(pattern, path.read_text("utf-8"), re.MULTILINE) if path.exists() else []
        if not found:
            others.append(f"{name} names no version")
        others += [f"{name} says {number}" for number in sorted(set(found) - {release.version})]
    if others:
        raise Missing(f"project(VERSION) is {release.version}, but "
                      + ", ".join(dict.fromkeys(others)))
    tag = f"v{release.version}"
    tagged = output_of(["git", "-C", release.root, "tag", "--list", tag])
    if tagged and commit_of(release, f"{tag}^{{commit}}") != commit_of(release):
        raise Missing(f"the tag {tag} is of another commit: raise project(VERSION)")
    return f"{release.version} in project(VERSION) and {len({name for name, _ in PLACES})} files"


def check_changelog(release):
    text = (release.root / "CHANGELOG.md").read_text("utf-8")
    heading = re.search(rf"^## {re.escape(release.version)}(?![.\d])(.*)\n((?:(?!## ).*\n?)*)",
                        text, re.MULTILINE)
    if heading is None:
        raise Missing(f"CHANGELOG.md has no section '## {release.version} (YYYY-MM-DD)'")
    date = re.fullmatch(r" \((\d{4}-\d\d-\d\d)\)", heading[1].rstrip())
    if date is None or not is_date(date[1]):
        raise Missing(f"the section of CHANGELOG.md has no date: '{heading[0].splitlines()[0]}' "
                      f"instead of '## {release.version} (YYYY-MM-DD)'")
    if "- " not in heading[2]:
        raise Missing(f"the section {release.version} of CHANGELOG.md lists nothing")
    first = (release.root / "debian/changelog").read_text("utf-8").split("\n", 1)[0]
    if "UNRELEASED" in first:
        raise Missing("the first entry of debian/changelog is UNRELEASED")
    return f"CHANGELOG.md has {release.version}, of {date[1]}"


def is_date(text):
    try:
        datetime.date.fromisoformat(text)
    except ValueError:
        return False
    return True
