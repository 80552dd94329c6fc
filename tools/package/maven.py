#!/usr/bin/python3 -B
# SPDX-License-Identifier: Apache-2.0
"""maven.py --source DIR --build DIR --into DIR --jdk DIR --system NAME
         --jars TARGET... --natives DIR... [--sysroot DIR]

Makes the folder of a Maven repository from what the build made. It stands
beside its place under another name until it is complete. Needs
SOURCE_DATE_EPOCH, the time that all of it bears."""

import argparse
import dataclasses
import glob
import hashlib
import os
import re
import shutil
import sys
import tempfile
import time

sys.path.insert(1, os.path.join(os.path.dirname(os.path.realpath(__file__)), "../inspect"))

import maven_archive as archive
import maven_natives as natives
import maven_project as project
import refusal

LIBRARY = "mediaplayer_orv_java"


@dataclasses.dataclass
class Artefact:
    name: str
    title: str
    description: str
    needs: list = dataclasses.field(default_factory=list)
    is_annotated: bool = False


ARTEFACTS = {
    LIBRARY: Artefact(
        "mediaplayer-orv", "Mediaplayer ORV",
        "A media player for Java programs. The JARs with the classifiers linux-x86_64 and"
        " linux-armhf hold the native half with the Android support libraries that it needs, for"
        " the release of Debian that they were built on. libmpv, FFmpeg and libcurl are the"
        " system's: in Debian, the packages libmpv2 and libcurl3-gnutls.",
        ["mediaplayer-orv-platform"]),
    "orv_platform_java": Artefact(
        "mediaplayer-orv-platform", "Mediaplayer ORV, platform",
        "The android classes that programs of the player meet, for desktop Linux. Their native"
        " half is in the native JARs of mediaplayer-orv."),
    "mediaplayer_orv_testing": Artefact(
        "mediaplayer-orv-testing", "Mediaplayer ORV, testing",
        "What tests of programs with the player need: players without a native half.",
        ["mediaplayer-orv"]),
}


def cached(build, pattern):
    """The values of the build's settings whose names match."""
    with open(os.path.join(build, "CMakeCache.txt"), encoding="utf-8") as cache:
        return re.findall(rf"^{pattern}=(.+)$", cache.read(), re.MULTILINE)


class Repository:
    def __init__(self, options, root, work):
        self.options, self.root, self.work = options, root, work
        self.version = cached(options.build, "CMAKE_PROJECT_VERSION:STATIC")[0]
        with open(os.path.join(options.source, "LICENSE"), "rb") as licence:
            self.licence = {"META-INF/LICENSE": licence.read()}
        self.class_path = [os.path.join(options.build, "java", target + ".jar")
                           for target in options.jars]
        self.class_path += cached(options.build, r"\w+:FILEPATH(?==.*\.jar$)")

    def place(self, artefact, *name):
        return os.path.join(self.root, *project.GROUP.split("."), artefact.name, *name)

    def write_jar(self, artefact, classifier, attributes, files):
        suffix = f"-{classifier}" if classifier else ""
        path = self.place(artefact, self.version, f"{artefact.name}-{self.version}{suffix}.jar")
        archive.write(path, attributes, {**files, **self.licence})
        return path

    def write_file(self, data, *place):
        with open(os.path.join(*place), "wb") as file:
            file.write(data)

    def add(self, target):
        """The JARs of one target of the build, and all that describes them."""
        artefact = ARTEFACTS[target]
        os.makedirs(self.place(artefact, self.version))
        attributes, files = archive.contents(
            os.path.join(self.options.build, "java", target + ".jar"))
        artefact.is_annotated = any(b"Lorg/jetbrains/annotations/" in data
                                    for data in files.values())
        attributes.update({"Implementation-Title": artefact.name,
                           "Implementation-Version": self.version})
        jars = {"": self.write_jar(artefact, "", attributes, files)}
        lists = glob.glob(f"{self.options.build}/*/CMakeFiles/{target}.dir/java_sources")
        paths, named = archive.sources(lists[0])
        jars["sources"] = self.write_jar(artefact, "sources", {}, named)
        others = [jar for jar in self.class_path if not jar.endswith(f"/{target}.jar")]
        pages = archive.javadoc(self.options.jdk, paths, others,
                                f"{artefact.title} {self.version}")
        jars["javadoc"] = self.write_jar(artefact, "javadoc", {}, pages)
        if target == LIBRARY:
            self.add_natives(artefact, jars)
        self.describe(artefact, jars)

    def add_natives(self, artefact, jars):
        for folder in self.options.natives:
            machine, files = natives.bundle(folder, self.version, self.options.system,
                                            self.options.sysroot, self.work)
            module = f"{project.GROUP}.natives.{machine.replace('-', '.')}"
            jars[machine] = self.write_jar(
                artefact, machine, {"Automatic-Module-Name": module}, files)

    def describe(self, artefact, jars):
        base = self.place(artefact, self.version, f"{artefact.name}-{self.version}")
        self.write_file(project.pom(artefact, self.version), base + ".pom")
        self.write_file(project.gradle_module(artefact, self.version, jars), base + ".module")
        moment = time.strftime("%Y%m%d%H%M%S", time.gmtime(int(os.environ["SOURCE_DATE_EPOCH"])))
        self.write_file(project.versions(artefact.name, self.version, moment),
                        self.place(artefact, "maven-metadata.xml"))
        for place, _, names in os.walk(self.place(artefact)):
            for name in names:
                self.add_sums(os.path.join(place, name))

    def add_sums(self, path):
        with open(path, "rb") as file:
            data = file.read()
        for kind in ("md5", "sha1", "sha256"):
            self.write_file(hashlib.new(kind, data).hexdigest().encode(), f"{path}.{kind}")


def main():
    parser = argparse.ArgumentParser(description="Makes the folder of a Maven repository.")
    for name in ("source", "build", "into", "jdk", "system"):
        parser.add_argument(f"--{name}", required=True)
    parser.add_argument("--jars", nargs="+", required=True)
    parser.add_argument("--natives", nargs="+", required=True)
    parser.add_argument("--sysroot", default="")
    options = parser.parse_args()
    into = os.path.realpath(options.into)
    os.makedirs(os.path.dirname(into), exist_ok=True)
    # Beside its place, so that it comes there whole.
    with tempfile.TemporaryDirectory(prefix=".maven-", dir=os.path.dirname(into)) as work:
        root = os.path.join(work, "repository")
        repository = Repository(options, root, work)
        for target in options.jars:
            repository.add(target)
        shutil.rmtree(into, ignore_errors=True)
        os.rename(root, into)
    return 0


if __name__ == "__main__":
    refusal.exit_with(main)
