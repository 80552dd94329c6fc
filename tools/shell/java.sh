# SPDX-License-Identifier: Apache-2.0
# shellcheck shell=bash
# Which of the installed JDKs builds and plays.

readonly OLDEST_JAVA=17

# The major version of the JDK in that folder; 0 when there is none.
java_version_of() {
    local version=
    [ ! -x "$1/bin/javac" ] || version=$(sed -n 's/^JAVA_VERSION="\([0-9]*\).*/\1/p' "$1/release" 2>/dev/null)
    echo "${version:-0}"
}

# One that is new enough and can open a window.
is_fit_jdk() {
    [ "$(java_version_of "$1")" -ge $OLDEST_JAVA ] && [ -e "$1/lib/libawt_xawt.so" ]
}

# Prints the folder of the JDK to use: that of JAVA_HOME, else of the javac on
# the PATH, else the newest that the system has. Nothing when none is fit.
find_jdk() {
    local home
    while IFS= read -r home; do
        is_fit_jdk "$home" && printf '%s\n' "$home" && return
    done < <(jdk_candidates)
    return 0
}

jdk_candidates() {
    local javac
    [ -z "${JAVA_HOME:-}" ] || printf '%s\n' "$JAVA_HOME"
    javac=$(command -v javac) && dirname -- "$(dirname -- "$(readlink -f -- "$javac")")"
    printf '%s\n' "${ORV_JVM_DIR:-/usr/lib/jvm}"/*/ | sed 's|/$||' | sort -t- -k2 -rV
}

# Why there is none, in a sentence.
jdk_complaint() {
    local home version
    while IFS= read -r home; do
        version=$(java_version_of "$home")
        [ "$version" -gt 0 ] || continue
        if [ "$version" -ge $OLDEST_JAVA ]; then
            echo "the JDK $version in $home has no support for windows (its package is a headless one)"
        else
            echo "the JDK in $home is version $version; $OLDEST_JAVA or newer is needed"
        fi
        return
    done < <(jdk_candidates)
    echo "there is no JDK; version $OLDEST_JAVA or newer is needed"
}

# Sets JAVA_HOME, for CMake and for what is started.
use_jdk() {
    JAVA_HOME=$(find_jdk)
    [ -n "$JAVA_HOME" ] || die "$(unset JAVA_HOME && jdk_complaint)."
    export JAVA_HOME
}
