# SPDX-License-Identifier: Apache-2.0
"""The long steps of a release: tests, packages, documentation, source archive.
Each runs the command that a person would, and looks at what it made."""

import os
import re
import shutil

from outcome import Missing, output_of, run_logged

ARCHITECTURES = ("x86_64", "armhf")


def supported_releases(root):
    """Names of Debian's releases, oldest first."""
    lines = (root / "tools/releases.txt").read_text("utf-8").splitlines()
    return [line.split()[0] for line in lines if line.strip() and not line.startswith("#")]


def this_release():
    path = os.environ.get("ORV_OS_RELEASE", "/etc/os-release")
    try:
        with open(path, encoding="utf-8") as file:
            match = re.search(r'^VERSION_CODENAME="?(\w+)', file.read(), re.MULTILINE)
    except OSError:
        return ""
    return match[1] if match else ""


def test_debian(name):
    def step(release):
        options = ["--target", "native"] if name == this_release() else ["--release", name]
        run_logged(release, f"test-{name}", [release.root / "orv", "test", *options])
        return f"plays and passes its tests on {name}"
    return step


def test_armhf(release):
    run_logged(release, "test-armhf", [release.root / "orv", "test", "--target", "armhf"])
    return "passes its tests for 32-bit ARM"


def make_deb(name):
    """Debian packages of the commit; those of another release come out of its root."""
    def step(release):
        made = release.build / "deb"
        command = [release.root / "orv", "package", "deb"]
        if name != this_release():
            root = release.build / "roots" / name
            made = root / "src/build/deb"
            command = [release.root / "tools/bare-root", "--release", name, "--keep", root,
                       "env", "ORV_BUILD=/src/build", "./orv", "package", "deb"]
            root.parent.mkdir(parents=True, exist_ok=True)
        shutil.rmtree(made, ignore_errors=True)
        run_logged(release, f"deb-{name}", command)
        files = sorted(path.name for path in made.glob("*.deb"))
        lacking = [package for package in packages_of(release) if not any(
            file.startswith(f"{package}_{release.version}-") for file in files)]
        if lacking:
            raise Missing(f"no package of {release.version}: {', '.join(lacking)}")
        shutil.copytree(made, release.folder / "deb" / name)
        return f"{len(files)} packages for {name}"
    return step


def packages_of(release):
    control = (release.root / "debian/control").read_text("utf-8")
    return re.findall(r"^Package: (\S+)", control, re.MULTILINE)


def make_maven(release):
    made = release.folder / "maven"
    run_logged(release, "maven", [release.root / "orv", "package", "maven", "--into", made,
                                  "--with-armhf"])
    names = [f"mediaplayer-orv-{release.version}{suffix}.jar"
             for suffix in ("", *(f"-linux-{each}" for each in ARCHITECTURES))]
    lacking = [name for name in names if not any(made.rglob(name))]
    if lacking:
        raise Missing(f"the Maven repository lacks {', '.join(lacking)}")
    return f"a Maven repository with natives for {' and '.join(ARCHITECTURES)}"


def make_docs(release):
    run_logged(release, "docs", [release.root / "orv", "docs"])
    site = release.build / "docs/site"
    if not (site / "index.html").is_file():
        raise Missing("the documentation has no index.html")
    shutil.copytree(site, release.folder / "docs")
    return f"{sum(1 for _ in site.rglob('*.html'))} pages, every link leads somewhere"


def make_source(release):
    name = f"mediaplayer_orv-{release.version}"
    archive = release.folder / f"{name}.tar.gz"
    output_of(["git", "-C", release.root, "archive", f"--prefix={name}/", "-o", archive, "HEAD"])
    return archive.name
