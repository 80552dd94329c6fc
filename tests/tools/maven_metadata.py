#!/usr/bin/python3 -B
# SPDX-License-Identifier: Apache-2.0
"""maven_metadata.py DIR: whether what a Maven repository says of its files is so."""

import hashlib
import json
import pathlib
import sys
import xml.etree.ElementTree

POM = "{http://maven.apache.org/POM/4.0.0}"
NAMES = ["mediaplayer-orv", "mediaplayer-orv-platform", "mediaplayer-orv-testing"]
# Gradle chooses among variants by these.
ATTRIBUTES = {"org.gradle.category", "org.gradle.dependency.bundling", "org.gradle.usage"}
SUMS = ["md5", "sha1", "sha256"]


def require(condition, text):
    if not condition:
        sys.exit(f"orv: {text}")


def check_sums(root):
    files = [path for path in root.rglob("*") if path.is_file() and path.suffix[1:] not in SUMS]
    require(files, "the repository is empty")
    for path in files:
        for kind in SUMS:
            found = pathlib.Path(f"{path}.{kind}").read_text()
            require(found == hashlib.new(kind, path.read_bytes()).hexdigest(),
                    f"{path} has another {kind} than its file says")


def check_variants(folder, module):
    for variant in module["variants"]:
        require(ATTRIBUTES <= variant["attributes"].keys(), f"{variant['name']} lacks attributes")
        for file in variant["files"]:
            data = (folder / file["url"]).read_bytes()
            require(len(data) == file["size"], f"{file['name']} has another size")
            for kind in SUMS:
                require(hashlib.new(kind, data).hexdigest() == file[kind],
                        f"{file['name']} has another {kind} in the module")


def dependencies(pom):
    """Those that programs get, too."""
    return {(d.find(POM + "artifactId").text, d.find(POM + "version").text)
            for d in pom.iter(POM + "dependency") if d.find(POM + "scope").text == "compile"}


def check_artefact(folder, name, version):
    base = folder / version / f"{name}-{version}"
    pom = xml.etree.ElementTree.parse(f"{base}.pom")
    require(pom.find(POM + "licenses").find(f".//{POM}name").text == "Apache-2.0", "no licence")
    require(pom.find(POM + "version").text == version, f"{name} has another version in its POM")
    module = json.loads(pathlib.Path(f"{base}.module").read_text())
    require(module["formatVersion"] == "1.1", "an unknown format of metadata")
    require(module["component"]["version"] == version, f"{name} has another version for Gradle")
    check_variants(folder / version, module)
    published = {file["name"] for variant in module["variants"] for file in variant["files"]}
    jars = {path.name for path in (folder / version).glob("*.jar")}
    require(jars == published, f"Gradle knows {published}, and there are {jars}")
    for classifier in ("", "-sources", "-javadoc"):
        require(f"{base.name}{classifier}.jar" in jars, f"{name} lacks its JAR {classifier}")
    gradle = {(d["module"], d["version"]["requires"]) for variant in module["variants"]
              for d in variant.get("dependencies", [])}
    require(gradle == dependencies(pom), f"{name} needs other things with Maven than with Gradle")
    for other, number in gradle:
        require((folder.parent / other / number).is_dir(),
                f"{name} needs {other}, which is missing")


def main():
    root = pathlib.Path(sys.argv[1])
    check_sums(root)
    group = root / "com/quintora/mmp"
    found = sorted(path.name for path in group.iterdir())
    require(set(NAMES) <= set(found), f"there are only {found}")
    for name in found:
        metadata = xml.etree.ElementTree.parse(group / name / "maven-metadata.xml")
        check_artefact(group / name, name, metadata.find(".//release").text)


if __name__ == "__main__":
    main()
