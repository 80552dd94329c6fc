# SPDX-License-Identifier: Apache-2.0
# shellcheck shell=bash
# help: docs                         the pages of docs/ and the Javadoc as one site in build/docs/site, with every link checked
use packages java

[ $# = 0 ] || die_usage "docs does not know '$1'."
need_packages "build the documentation" docs
JAVA_HOME=$(find_jdk)
javadoc=${JAVA_HOME:+$JAVA_HOME/bin/}javadoc
command -v -- "$javadoc" >/dev/null || die "javadoc is not installed; it comes with a JDK."
"$ORV_ROOT/tools/docs/docs.py" --javadoc "$javadoc" "$ORV_ROOT" "$ORV_BUILD/docs"
