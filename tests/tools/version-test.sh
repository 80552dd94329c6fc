#!/usr/bin/env bash
# SPDX-License-Identifier: Apache-2.0
# ./orv version: the version of the build file, which the change log and the package
# have too; those of the media libraries as pkg-config and dpkg give them; and a
# sentence for each that is not there.
set -euo pipefail

root=$(dirname -- "$(dirname -- "$(dirname -- "$(readlink -f -- "$0")")")")
folder=$(mktemp -d)
trap 'rm -rf -- "$folder"' EXIT
mkdir "$folder/bin"
export ORV_BUILD="$folder/a build" ORV_NO_INSTALL=1
failures=0

fail() {
    echo "FAILED $*"
    failures=$((failures + 1))
}

# stand_in NAME <script: puts a program in front of the real one.
stand_in() {
    { echo '#!/bin/bash' && cat; } >"$folder/bin/$1"
    chmod +x "$folder/bin/$1"
}

# said LINE: the last run succeeded and printed exactly that line.
said() { grep -qxF -- "$1" "$folder/said" || fail "no line '$1' in: $(cat "$folder/said")"; }

run() { PATH=$folder/bin:$PATH "$root/orv" "$@" >"$folder/said" 2>"$folder/errors" </dev/null; }

version=$(sed -n 's/^project(.* VERSION \([^ ]*\) .*/\1/p' "$root/CMakeLists.txt")
[[ $version =~ ^[0-9]+\.[0-9]+\.[0-9]+$ ]] || fail "'$version' is no semantic version"
grep -qE "^## ${version//./\\.}( |\$)" "$root/CHANGELOG.md" || fail "CHANGELOG.md has no section $version"
if [ -f "$root/debian/changelog" ]; then
    head -n 1 "$root/debian/changelog" | grep -qF "($version" || fail "debian/changelog is not of $version"
fi

# shellcheck disable=SC2016
stand_in pkg-config <<<'case $2 in mpv) echo 2.0.0 ;; libavformat) echo 59.27.100 ;; libswscale) exit 1 ;; *) echo 1.2.3 ;; esac'
# shellcheck disable=SC2016
stand_in dpkg-query <<<'case ${@: -1} in libmpv-dev) echo "installed 0.35.1-4" ;; *) echo "installed 7:5.1.7-0+deb12u1" ;; esac'
run version || fail "version: status $?"
said "orv $version"
said "mpv 0.35.1 (client interface 2.0.0)"
said "FFmpeg 5.1.7 (libavformat 59.27.100, libavcodec 1.2.3, libavfilter 1.2.3, libavutil 1.2.3, libswscale is missing)"
said "nothing is built yet in $ORV_BUILD"
cp "$folder/said" "$folder/before"
run --version || fail "--version: status $?"
cmp -s "$folder/before" "$folder/said" || fail "--version prints something else"
[ ! -s "$folder/errors" ] || fail "says on standard error: $(cat "$folder/errors")"
[ ! -e "$ORV_BUILD" ] || fail "it makes a build folder"

# A system without dpkg, then one with nothing.
stand_in dpkg-query <<<'exit 127'
run version || fail "without dpkg: status $?"
said "mpv (client interface 2.0.0)"
stand_in pkg-config <<<'exit 1'
run version || fail "without libraries: status $?"
said "mpv is not here; ./orv play installs it"
said "FFmpeg's libraries are not here; ./orv play installs them"

# Any library with such needs will do for the engine.
mkdir -p "$ORV_BUILD/lib"
: >"$ORV_BUILD/lib/liborvtarn.so"
stand_in readelf <<'END'
echo ' 0x0000000000000001 (NEEDED)             Shared library: [libutils.so.0]'
echo ' 0x0000000000000001 (NEEDED)             Shared library: [libmpv.so.2]'
echo ' 0x0000000000000001 (NEEDED)             Shared library: [libavcodec.so.59]'
END
run version || fail "with a build: status $?"
said "the build in $ORV_BUILD uses libmpv.so.2, libavcodec.so.59"

! run version --long || fail "an argument: status 0"
grep -q "version takes nothing, not '--long'" "$folder/errors" || fail "an argument: $(cat "$folder/errors")"

[ $failures -eq 0 ]
