#!/usr/bin/python3 -B
# SPDX-License-Identifier: Apache-2.0
"""./orv release for a small project with stand-ins for its long commands, and
with planted faults."""

import hashlib
import os
import pathlib
import shutil
import subprocess
import tempfile
import unittest

SOURCE = pathlib.Path(os.environ["ORV_SOURCE"])
LIMIT = 120
STEPS = ["tree", "version", "changelog", "test-bookworm", "test-trixie", "test-armhf",
         "deb-bookworm", "deb-trixie", "maven", "docs", "source", "checksums", "signature"]
CHECKS = "tree,version,changelog"

FILES = {
    "CMakeLists.txt": "project(mediaplayer_orv VERSION 1.2.3 LANGUAGES CXX)\n",
    "CHANGELOG.md": "# Changelog\n\nThe newest first.\n\n## 1.2.3 (2026-11-22)\n\n- All.\n\n"
                    "## 1.2.2 (2026-01-01)\n\n- Some.\n",
    "debian/changelog": "one (1.2.3-0orv1) unstable; urgency=medium\n\n  * All.\n",
    "debian/control": "Source: one\n\nPackage: one-jni\n\nPackage: one-doc\n",
    "docs/maven.md": "<version>1.2.3</version>\ncom.quintora.mmp:mediaplayer-orv:1.2.3:linux\n",
    "samples/maven/pom.xml": "<orv.version>1.2.3</orv.version>\n",
    "samples/maven/build.gradle.kts": 'val orvVersion = "1.2.3"\n',
    "tools/releases.txt": "# name number\nbookworm 12\ntrixie 13\n",
    ".gitignore": "/build/\n",
}
# Notes its arguments; makes what the real one makes, but for what FAULT says.
ORV = r"""#!/bin/bash
echo "$*" >>"$CALLS"
case "$FAULT $*" in
"tests test --target armhf"*) echo "one failed"; echo "orv: armhf has failures."; exit 1 ;;
*" package deb"*)
    out=${DEB_OUT:-$ORV_BUILD/deb}; mkdir -p "$out"
    for name in one-jni one-doc; do
        [ "$FAULT $name" = "deb one-doc" ] || echo x >"$out/${name}_1.2.3-0orv1_all.deb"
    done ;;
*" package maven --into "*)
    mkdir -p "$4"
    for kind in "" -linux-x86_64 -linux-armhf; do
        [ "$FAULT$kind" = maven-linux-armhf ] || echo x >"$4/mediaplayer-orv-1.2.3$kind.jar"
    done ;;
*" docs")
    [ "$FAULT" != docs ] || { echo "docs/a.md:3: b.md: there is no such file"; exit 1; }
    mkdir -p "$ORV_BUILD/docs/site"; echo page >"$ORV_BUILD/docs/site/index.html" ;;
esac
"""
BARE_ROOT = r"""#!/bin/bash
[ "$1 $3" = "--release --keep" ] || exit 2
DEB_OUT=$4/src/build/deb "${0%/tools/*}/orv" in-root "$2" package deb
"""


class ReleaseTest(unittest.TestCase):
    def setUp(self):
        folder = tempfile.TemporaryDirectory()
        self.addCleanup(folder.cleanup)
        self.folder = pathlib.Path(folder.name)
        self.root = self.folder / "a project"
        self.calls = self.folder / "calls"
        self.calls.touch()
        (self.folder / "os-release").write_text("VERSION_CODENAME=bookworm\n", "utf-8")
        (self.folder / "temporary").mkdir()
        for name, text in FILES.items():
            self.write(name, text)
        for name, text in (("orv", ORV), ("tools/bare-root", BARE_ROOT)):
            self.write(name, text)
            (self.root / name).chmod(0o755)
        self.keys = self.folder / "keys"
        self.keys.mkdir(mode=0o700)
        self.git("init", "-q")
        self.commit()

    def write(self, name, text):
        path = self.root / name
        path.parent.mkdir(parents=True, exist_ok=True)
        path.write_text(text, "utf-8")

    def change(self, name, old, new):
        self.assertIn(old, FILES[name])
        self.write(name, FILES[name].replace(old, new))
        self.commit()

    def git(self, *arguments):
        subprocess.run(["git", "-C", self.root, "-c", "user.name=n", "-c", "user.email=e@x",
                        "-c", "commit.gpgsign=false", *arguments], check=True, timeout=LIMIT)

    def commit(self):
        self.git("add", "-A")
        self.git("commit", "-qm", "change", "--allow-empty")

    def make_key(self):
        environment = {**os.environ, "GNUPGHOME": str(self.keys)}
        subprocess.run(["gpg", "--batch", "--quiet", "--passphrase", "", "--quick-gen-key",
                        "releaser@example.org", "ed25519", "sign"], env=environment, check=True,
                       timeout=LIMIT, capture_output=True)
        self.addCleanup(subprocess.run, ["gpgconf", "--kill", "all"], env=environment, check=False)

    def release(self, *arguments, fault="", path=None):
        """(status, {step: (state, sentence)}, standard error)"""
        done = subprocess.run(
            [SOURCE / "tools/release/release.py", "--root", self.root,
             "--build", self.root / "build", *map(str, arguments)],
            capture_output=True, text=True, timeout=LIMIT, check=False, cwd=self.folder, env={
                **os.environ, "GNUPGHOME": str(self.keys), "CALLS": str(self.calls),
                "FAULT": fault, "ORV_OS_RELEASE": str(self.folder / "os-release"),
                "TMPDIR": str(self.folder / "temporary"), **({"PATH": path} if path else {})})
        rows = [line.split(None, 2) for line in done.stdout.splitlines()]
        rows = {row[0]: (row[1], row[2]) for row in rows if row[0] in STEPS}
        return done.returncode, rows, done.stderr

    def missing(self, *arguments, **options):
        """The sentences of what is missing, which the status must agree with."""
        status, rows, errors = self.release("--dry-run", *arguments, **options)
        self.assertEqual(errors, "")
        found = {name: said for name, (state, said) in rows.items() if state == "missing"}
        self.assertEqual(status, 1 if found else 0)
        return found

    def states(self, rows):
        return {name: state for name, (state, _) in rows.items()}


class WholeTest(ReleaseTest):
    def test_a_dry_run_tries_every_step_in_order_and_keeps_nothing(self):
        self.make_key()
        status, rows, errors = self.release("--dry-run")
        self.assertEqual((status, errors), (0, ""), rows)
        self.assertEqual(self.states(rows), dict.fromkeys(STEPS, "ok"))
        self.assertEqual(list(rows), STEPS)
        maven = self.calls.read_text().splitlines()[5].split(" ")
        self.assertEqual([maven[0], maven[-1]], ["package", "--with-armhf"])
        calls = self.calls.read_text().splitlines()
        self.assertEqual([*calls[:5], *calls[6:]], [
            "test --target native", "test --release trixie", "test --target armhf",
            "package deb", "in-root trixie package deb", "docs"])
        self.assertEqual(list((self.folder / "temporary").iterdir()), [])
        self.assertEqual(subprocess.run(
            ["git", "-C", self.root, "status", "--porcelain", "--ignored"], capture_output=True,
            text=True, check=True).stdout, "!! build/\n")

    def test_the_files_are_made_with_sums_and_a_signature(self):
        self.make_key()
        out = self.folder / "out"
        status, rows, errors = self.release("-o", out)
        self.assertEqual((status, errors), (0, ""), rows)
        sums = dict(reversed(line.split("  ")) for line in
                    (out / "SHA256SUMS").read_text().splitlines())
        made = {str(path.relative_to(out)): path for path in out.rglob("*") if path.is_file()}
        self.assertEqual(made.keys() - sums.keys(), {"SHA256SUMS", "SHA256SUMS.asc"})
        for name in ("deb/bookworm/one-jni_1.2.3-0orv1_all.deb",
                     "deb/trixie/one-doc_1.2.3-0orv1_all.deb", "docs/index.html",
                     "maven/mediaplayer-orv-1.2.3-linux-armhf.jar", "mediaplayer_orv-1.2.3.tar.gz"):
            self.assertEqual(sums[name], hashlib.sha256(made[name].read_bytes()).hexdigest())
        subprocess.run(["gpg", "--batch", "--verify", out / "SHA256SUMS.asc", out / "SHA256SUMS"],
                       env={**os.environ, "GNUPGHOME": str(self.keys)}, check=True,
                       capture_output=True, timeout=LIMIT)
        names = subprocess.run(["tar", "-tzf", out / "mediaplayer_orv-1.2.3.tar.gz"], check=True,
                               capture_output=True, text=True).stdout.splitlines()
        self.assertIn("mediaplayer_orv-1.2.3/debian/control", names)
        self.assertEqual([path.name for path in self.folder.glob(".release-*")], [])

    def test_no_file_is_made_once_a_step_is_missing(self):
        out = self.folder / "out"
        self.write("new.txt", "not committed")
        status, rows, _ = self.release("-o", out)
        self.assertEqual(status, 1)
        self.assertEqual(rows["docs"], ("skipped", "nothing is made, as tree is missing"))
        self.assertEqual(self.states(rows)["changelog"], "ok")
        self.assertFalse(out.exists())
        self.assertEqual(self.calls.read_text(), "")


class FaultsTest(ReleaseTest):
    def test_a_tree_with_changes(self):
        self.write("new.txt", "")
        self.write("CHANGELOG.md", FILES["CHANGELOG.md"] + "\n")
        self.assertEqual(self.missing("--only", CHECKS),
                         {"tree": "not committed: CHANGELOG.md and 1 more"})

    def test_a_version_that_differs(self):
        for name, sentence in (
                ("debian/changelog", "debian/changelog says 1.2.4"),
                ("docs/maven.md", "docs/maven.md says 1.2.4"),
                ("samples/maven/pom.xml", "samples/maven/pom.xml says 1.2.4"),
                ("samples/maven/build.gradle.kts", "samples/maven/build.gradle.kts says 1.2.4")):
            self.change(name, "1.2.3", "1.2.4")
            self.assertEqual(self.missing("--only", CHECKS), {
                "version": f"project(VERSION) is 1.2.3, but {sentence}"})
            self.write(name, FILES[name])
        self.change("docs/maven.md", "<version>1.2.3", "<version>")
        self.assertEqual(self.missing("--only", CHECKS), {
            "version": "project(VERSION) is 1.2.3, but docs/maven.md names no version"})

    def test_a_version_that_is_released_already(self):
        self.git("tag", "v1.2.3")
        self.assertEqual(self.missing("--only", CHECKS), {})
        self.commit()
        self.assertEqual(self.missing("--only", CHECKS), {
            "version": "the tag v1.2.3 is of another commit: raise project(VERSION)"})

    def test_a_changelog_without_the_section(self):
        self.change("CHANGELOG.md", "## 1.2.3 (2026-11-22)\n\n- All.\n\n", "")
        self.assertEqual(self.missing("--only", "changelog"), {
            "changelog": "CHANGELOG.md has no section '## 1.2.3 (YYYY-MM-DD)'"})

    def test_a_changelog_without_a_date(self):
        for date in (" (unreleased)", "", " (2026-13-01)"):
            self.change("CHANGELOG.md", " (2026-11-22)", date)
            self.assertEqual(self.missing("--only", "changelog"), {
                "changelog": f"the section of CHANGELOG.md has no date: '## 1.2.3{date}' "
                             "instead of '## 1.2.3 (YYYY-MM-DD)'"})

    def test_a_changelog_that_lists_nothing(self):
        self.change("CHANGELOG.md", "- All.\n", "")
        self.assertEqual(self.missing("--only", "changelog"), {
            "changelog": "the section 1.2.3 of CHANGELOG.md lists nothing"})

    def test_an_unreleased_entry_of_debian(self):
        self.change("debian/changelog", "unstable", "UNRELEASED")
        self.assertEqual(self.missing("--only", "changelog"), {
            "changelog": "the first entry of debian/changelog is UNRELEASED"})

    def test_no_key(self):
        self.assertEqual(self.missing("--only", "source,checksums,signature"), {
            "signature": "gpg has no secret key to sign with"})
        self.assertEqual(self.missing("--only", "signature", "--key", "nobody"), {
            "signature": "gpg has no secret key 'nobody'"})

    def test_no_gpg(self):
        programs = self.folder / "programs"
        programs.mkdir()
        for name in ("git", "bash", "mkdir", "python3"):
            (programs / name).symlink_to(shutil.which(name))
        self.assertEqual(self.missing("--only", "signature", path=str(programs)), {
            "signature": "gpg is not installed"})

    def test_a_long_step_that_fails(self):
        log = self.root / "build/log/release-test-armhf.log"
        self.assertEqual(self.missing("--only", "test", fault="tests"), {
            "test-armhf": f"armhf has failures; see {log}"})
        self.assertIn("one failed", log.read_text())
        self.assertEqual(self.missing("--only", "docs", fault="docs"), {
            "docs": f"it ends with 1; see {self.root / 'build/log/release-docs.log'}"})

    def test_packages_that_were_not_made(self):
        self.assertEqual(self.missing("--only", "deb,maven", fault="deb"), {
            "deb-bookworm": "no package of 1.2.3: one-doc",
            "deb-trixie": "no package of 1.2.3: one-doc"})
        self.assertEqual(self.missing("--only", "deb,maven", fault="maven"), {
            "maven": "the Maven repository lacks mediaplayer-orv-1.2.3-linux-armhf.jar"})

    def test_no_version_at_all(self):
        self.change("CMakeLists.txt", "VERSION 1.2.3 ", "")
        self.assertEqual(self.release("--dry-run"), (
            1, {}, "orv: CMakeLists.txt has no project(… VERSION …).\n"))


class ArgumentsTest(ReleaseTest):
    def test_steps_are_chosen_and_said_to_be(self):
        _, rows, _ = self.release("--dry-run", "--skip", "test,deb-trixie,signature")
        skipped = {name for name, row in rows.items() if row == ("skipped", "skipped by --skip")}
        self.assertEqual(skipped, {"test-bookworm", "test-trixie", "test-armhf", "deb-trixie",
                                   "signature"})
        self.assertNotIn("test", self.calls.read_text())
        status, rows, _ = self.release("--dry-run", "--only", "checksums")
        self.assertEqual((status, rows["checksums"]), (0, ("skipped", "no file was made")))
        self.assertEqual(rows["tree"], ("skipped", "skipped by --only"))

    def test_wrong_arguments_are_refused_in_one_sentence(self):
        full = self.folder / "full"
        full.mkdir()
        (full / "file").touch()
        see = ". See ./orv release --help.\n"
        for arguments, sentence in (
                ([], "it takes either --dry-run, or -o FOLDER for the files"),
                (["--dry-run", "-o", "out"],
                 "it takes either --dry-run, or -o FOLDER for the files"),
                (["-o", full], f"{full} is there already, and not an empty folder"),
                (["-o", self.root / "out"], f"{self.root / 'out'} is a part of what is released: "
                                            "name a folder outside of the checkout"),
                (["--dry-run", "--only", "tree,tests"],
                 f"--only: there is no step 'tests'; they are {', '.join(STEPS)}")):
            self.assertEqual(self.release(*arguments), (2, {}, f"orv: release: {sentence}{see}"))


if __name__ == "__main__":
    unittest.main()
