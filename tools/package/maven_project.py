# SPDX-License-Identifier: Apache-2.0
"""What Maven and Gradle read of an artefact: the POM and Gradle's module metadata."""

import hashlib
import json
import os
from xml.sax.saxutils import escape

GROUP = "com.quintora.mmp"
JAVA = 17
# What Gradle calls the machines.
ARCHITECTURES = {"linux-x86_64": "x86-64", "linux-armhf": "arm-v7"}
# The sources say by it what may be null; no program needs it when it runs.
ANNOTATIONS = ("org.jetbrains", "annotations", "23.0.0")


def dependency(group, name, version, scope, optional=False):
    extra = "      <optional>true</optional>\n" if optional else ""
    return (f"    <dependency>\n      <groupId>{group}</groupId>\n"
            f"      <artifactId>{name}</artifactId>\n      <version>{version}</version>\n"
            f"      <scope>{scope}</scope>\n{extra}    </dependency>\n")


def pom(artefact, version):
    dependencies = "".join(dependency(GROUP, name, version, "compile") for name in artefact.needs)
    if artefact.is_annotated:
        dependencies += dependency(*ANNOTATIONS, "provided", optional=True)
    if dependencies:
        dependencies = f"\n  <dependencies>\n{dependencies}  </dependencies>"
    return f"""<?xml version="1.0" encoding="UTF-8"?>
<project xmlns="http://maven.apache.org/POM/4.0.0"
         xmlns:xsi="http://www.w3.org/2001/XMLSchema-instance"
         xsi:schemaLocation="http://maven.apache.org/POM/4.0.0 http://maven.apache.org/xsd/maven-4.0.0.xsd">
  <!-- do_not_remove: published-with-gradle-metadata -->
  <modelVersion>4.0.0</modelVersion>
  <groupId>{GROUP}</groupId>
  <artifactId>{artefact.name}</artifactId>
  <version>{version}</version>
  <name>{escape(artefact.title)}</name>
  <description>{escape(artefact.description)}</description>
  <licenses>
    <license>
      <name>Apache-2.0</name>
      <url>https://www.apache.org/licenses/LICENSE-2.0.txt</url>
    </license>
  </licenses>{dependencies}
</project>
""".encode()


def gradle_file(path):
    with open(path, "rb") as file:
        data = file.read()
    sums = {kind: hashlib.new(kind, data).hexdigest() for kind in ("sha256", "sha1", "md5")}
    name = os.path.basename(path)
    return {"name": name, "url": name, "size": len(data), **sums}


def library(usage, **more):
    return {"org.gradle.category": "library", "org.gradle.dependency.bundling": "external",
            "org.gradle.jvm.version": JAVA, "org.gradle.libraryelements": "jar",
            "org.gradle.usage": usage, **more}


def documentation(kind):
    return {"org.gradle.category": "documentation", "org.gradle.dependency.bundling": "external",
            "org.gradle.docstype": kind, "org.gradle.usage": "java-runtime"}


def gradle_module(artefact, version, jars):
    """The metadata as JSON. jars goes from classifiers, "" for none, to paths. A native
    JAR has a capability of its own: it comes beside the classes, not in their place."""
    needs = [{"group": GROUP, "module": name, "version": {"requires": version}}
             for name in artefact.needs]
    more = {"dependencies": needs} if needs else {}
    variants = [
        {"name": "apiElements", "attributes": library("java-api"), **more,
         "files": [gradle_file(jars[""])]},
        {"name": "runtimeElements", "attributes": library("java-runtime"), **more,
         "files": [gradle_file(jars[""])]},
        {"name": "javadocElements", "attributes": documentation("javadoc"),
         "files": [gradle_file(jars["javadoc"])]},
        {"name": "sourcesElements", "attributes": documentation("sources"),
         "files": [gradle_file(jars["sources"])]}]
    for machine in sorted(ARCHITECTURES.keys() & jars.keys()):
        attributes = library("java-runtime", **{
            "org.gradle.native.operatingSystem": "linux",
            "org.gradle.native.architecture": ARCHITECTURES[machine]})
        variants.append({
            "name": f"{machine}-runtimeElements", "attributes": attributes,
            "files": [gradle_file(jars[machine])],
            "capabilities": [{"group": GROUP, "name": f"{artefact.name}-{machine}",
                              "version": version}]})
    component = {"group": GROUP, "module": artefact.name, "version": version,
                 "attributes": {"org.gradle.status": "release"}}
    return (json.dumps({"formatVersion": "1.1", "component": component, "variants": variants},
                       indent=2) + "\n").encode()


def versions(name, version, moment):
    """The file that lists the versions of an artefact; the moment is 14 digits."""
    return f"""<?xml version="1.0" encoding="UTF-8"?>
<metadata>
  <groupId>{GROUP}</groupId>
  <artifactId>{name}</artifactId>
  <versioning>
    <latest>{version}</latest>
    <release>{version}</release>
    <versions>
      <version>{version}</version>
    </versions>
    <lastUpdated>{moment}</lastUpdated>
  </versioning>
</metadata>
""".encode()
