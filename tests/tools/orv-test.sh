#!/usr/bin/env bash
# SPDX-License-Identifier: Apache-2.0
# Runs ./orv and its parts with stand-ins for the package and build tools: wrong
# arguments, missing packages and broken builds each give their line and status.
set -euo pipefail

root=$(dirname -- "$(dirname -- "$(dirname -- "$(readlink -f -- "$0")")")")
folder=$(mktemp -d)
trap 'rm -rf -- "$folder"' EXIT
mkdir "$folder/bin"
PATH=$folder/bin:$PATH
export ORV_BUILD="$folder/a build"
unset ORV_NO_INSTALL
failures=0

# stand_in NAME <script: puts a program in front of the real one.
stand_in() {
    { echo '#!/bin/bash' && cat; } >"$folder/bin/$1"
    chmod +x "$folder/bin/$1"
}

check() {
    [ "$2" = "$3" ] && return
    echo "FAILED $1: expected '$2', got '$3'"
    failures=$((failures + 1))
}

# expect WHAT STATUS TEXT COMMAND…: TEXT stands in one line of what it says.
expect() {
    local what=$1 expected=$2 text=$3 status=0
    shift 3
    "$@" >"$folder/said" 2>&1 </dev/null || status=$?
    check "$what: status" "$expected" "$status"
    [ -z "$text" ] || check "$what: says '$text'" 1 "$(grep -cF -- "$text" "$folder/said")"
}

# part FUNCTION…: calls a function of tools/shell as the commands do.
# shellcheck disable=SC2016
part() {
    "$BASH" -c 'set -euo pipefail; ORV_ROOT=$1; . "$1/tools/shell/common.sh"; use packages build
        shift; "$@"' part "$root" "$@"
}

expect "no command" 0 "Usage: ./orv COMMAND" "$root/orv"
expect "another command" 2 "there is no command 'nonsense'" "$root/orv" nonsense
expect "a path as a command" 2 "there is no command" "$root/orv" ../shell/common
expect "an option first" 2 "options come after one" "$root/orv" --json info
expect "another target" 2 "not 'mips'" "$root/orv" test --target mips
expect "a target without a name" 2 "lacks its value" "$root/orv" test --target
expect "another option of bench" 2 "bench does not know '--fast'" "$root/orv" bench --fast
expect "a filter of bench without a pattern" 2 "lacks its value" "$root/orv" bench --filter
expect "another doctor" 2 "doctor does not know '--spell'" "$root/orv" doctor --spell x
for script in "$root"/tools/cmd-*.sh; do
    name=$(basename -- "${script#*cmd-}" .sh)
    check "help of $name" 1 "$("$root/orv" help | grep -cE "^  $name( |$)")"
done

stand_in id <<<'echo 0'
# shellcheck disable=SC2016
stand_in dpkg-query <<<'for p in "${@:4}"; do [ "$p" = mmdebstrap ] || echo "installed $p"; done'
# shellcheck disable=SC2016
stand_in apt-get <<<'echo "$@" >>"${0%/bin/*}/asked"; [ ! -e "${0%/bin/*}/fails" ]'
expect "missing package" 0 "needed to try: mmdebstrap (makes the sysroot)" \
    part need_packages try armhf
check "asks for it alone" yes "$(grep -q ' install .* mmdebstrap$' "$folder/asked" && echo yes)"
rm "$folder/asked"
expect "nothing missing" 0 "" part need_packages try play
ORV_NO_INSTALL=1 expect "no installation wanted" 0 "" part need_packages try armhf
check "asks for nothing" no "$([ -e "$folder/asked" ] && echo yes || echo no)"

# without NAME COMMAND…: where that program is not installed.
without() {
    local program others=$folder/without
    rm -rf -- "$others" && mkdir "$others"
    for program in awk dpkg-query find id paste sed apt-get; do
        [ "$program" = "$1" ] || ln -s "$(command -v "$program")" "$others/$program"
    done
    shift
    PATH=$others "$@"
}
expect "no apt-get" 1 "name in your system's way, then set ORV_NO_INSTALL=1: tools/packages-play.txt" \
    without apt-get part need_packages try play test
stand_in id <<<'echo 1000'
expect "no sudo" 1 "there is no sudo here. As root: apt-get install --no-install-recommends mmdebstrap" \
    without sudo part need_packages try armhf
stand_in sudo <<<'exit 1'
expect "no password" 1 "sudo did not give root, so nothing was installed" part need_packages try armhf
check "asks for nothing before" no "$([ -e "$folder/asked" ] && echo yes || echo no)"
stand_in id <<<'echo 0'
touch "$folder/fails"
expect "apt-get fails" 1 "could not be installed" part need_packages try armhf

mkdir -p "$ORV_BUILD" && touch "$ORV_BUILD/build.ninja"
stand_in ninja <<<'echo "FAILED: one.o"; seq 1 50000; exit 1'
expect "a broken build" 1 "the build failed; all it said is in" part build_targets off all
check "shows its first error" 1 "$(grep -c '^FAILED: one.o' "$folder/said")"
stand_in cmake <<<'echo "CMake Error: no such library"; exit 1'
rm "$ORV_BUILD/build.ninja"
expect "a configuration that fails" 1 "the build could not be configured" part build_targets off all

[ "$failures" -eq 0 ]
