#!/usr/bin/env bash
# SPDX-License-Identifier: Apache-2.0
# Runs tools/sysroot with stand-ins for the package tools: one clear line for
# each failure, nothing half-made left behind, and the next run starts over.
set -euo pipefail

root=$(dirname -- "$(dirname -- "$(dirname -- "$(readlink -f -- "$0")")")")
folder=$(mktemp -d)
trap 'rm -rf -- "$folder"' EXIT
sysroot=$folder/sysroot
mkdir "$folder/bin"
PATH=$folder/bin:$PATH
failures=0
printf 'ID=debian\nVERSION_CODENAME=bookworm\n' >"$folder/os-release"
export ORV_OS_RELEASE=$folder/os-release

# stand_in NAME <script: puts a program in front of the real one.
stand_in() {
    { echo '#!/bin/bash' && cat; } >"$folder/bin/$1"
    chmod +x "$folder/bin/$1"
}

# expect WHAT STATUS TEXT: runs tools/sysroot and looks at how it ended.
expect() {
    local status=0
    "$root/tools/sysroot" "$sysroot" 2>"$folder/said" || status=$?
    check "$1: status" "$2" "$status"
    check "$1: says '$3'" 1 "$(grep -c -F -- "$3" "$folder/said")"
    check_absent "$1: leaves nothing unfinished" "$sysroot.unfinished"
}

check() {
    [ "$2" = "$3" ] && return
    echo "FAILED $1: expected '$2', got '$3'"
    failures=$((failures + 1))
}

check_absent() { check "$1" no "$([ -e "$2" ] && echo yes || echo no)"; }

stand_in apt-get <<<'echo stand-in-archive'

stand_in mmdebstrap <<<'echo "E: Unable to locate package libone"; exit 1'
expect "missing package" 1 "no sysroot: the archive has no package libone for armhf"

stand_in mmdebstrap <<<'echo "Err:1 archive Release"; echo "E: Failed to fetch Release"; exit 1'
expect "failing mirror" 1 "no sysroot: the archive that this machine's apt uses could not be read"

stand_in mmdebstrap <<<'echo "E: write failed: No space left on device"; exit 1'
expect "full disk" 1 "no sysroot: the disk is full"

stand_in mmdebstrap <<<'echo "E: something else"; exit 1'
expect "other failure" 1 "no sysroot: mmdebstrap failed: E: something else"

# The stand-in's arguments end in the folder and the archive.
# shellcheck disable=SC2016
stand_in mmdebstrap <<<'mkdir "${@: -2:1}"; kill -TERM $PPID; sleep 1; exit 1'
expect "interruption" 1 "no sysroot: interrupted; the next run starts over"

# shellcheck disable=SC2016
stand_in mmdebstrap <<<'mkdir -p "${@: -2:1}/etc" && ln -s /etc/real "${@: -2:1}/etc/link"'
mkdir -p "$sysroot.unfinished/left-by-a-killed-run"
expect "success" 0 "making the armhf sysroot"
check "programs find their loader" usr/lib "$(readlink "$sysroot/lib")"
check "links stay inside" real "$(readlink "$sysroot/etc/link")"
check_absent "starts over" "$sysroot/left-by-a-killed-run"

stand_in mmdebstrap <<<'exit 1'
check "made once" '' "$("$root/tools/sysroot" "$sysroot" 2>&1)"

echo "another list" >"$sysroot/.recipe"
expect "changed list" 1 "making the armhf sysroot"
check "a failure keeps the old one" "another list" "$(cat "$sysroot/.recipe")"

stand_in apt-get <<<'exit 0'
expect "no archive" 1 "no sysroot: this machine's apt knows no archive of Debian bookworm"

[ "$failures" -eq 0 ]
