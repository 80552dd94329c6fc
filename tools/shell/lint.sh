# SPDX-License-Identifier: Apache-2.0
# shellcheck shell=bash
# The static checks. Each prints what it finds and says how it ended.

lint_everything() {
    local failed=() check
    for check in licence format scripts tidy; do
        "lint_$check" || failed+=("$check")
    done
    [ ${#failed[@]} -eq 0 ] || die "lint failed: ${failed[*]}"
    say "lint: layout, scripts and static checks are clean"
}

# find_sources NAME…: the files of ours whose names match, NUL between them.
find_sources() {
    local names=() name
    for name in "$@"; do names+=(-o -name "$name"); done
    find "$ORV_ROOT" -mindepth 1 \( -name .git -o -name 'build*' -type d \) -prune -o \
        -type f \( "${names[@]:1}" \) -print0
}

lint_licence() {
    local lacking
    lacking=$(find_sources '*.cpp' '*.h' '*.java' '*.sh' '*.py' '*.cmake' '*.map' '*.bp' CMakeLists.txt |
        xargs -0 grep -L '^[#/*]* *SPDX-License-Identifier: Apache-2.0$' || true)
    [ -z "$lacking" ] || { say "no licence identifier in: $lacking" && return 1; }
}

# One version in every release: others lay the same code out differently.
lint_format() {
    find_sources '*.cpp' '*.h' | xargs -0 "clang-format-$(release_value "$(this_release)" clang)" --dry-run -Werror
}

lint_scripts() {
    {
        find_sources '*.sh'
        cd "$ORV_ROOT" || return
        grep -rlIZ --exclude-dir='build*' --exclude-dir=.git \
            -m 1 -e '^#!/usr/bin/env bash' -e '^#!/bin/sh' -e '^#!/bin/bash' .
    } | xargs -0 realpath -z | sort -zu | xargs -0 shellcheck --external-sources
}

# Sources are checked in groups, which share the time that their headers take; a group lies
# where its sources do, and has their settings.
lint_tidy() {
    local log=$ORV_BUILD/log/tidy.log groups=$ORV_BUILD/tidy/groups singles=$ORV_BUILD/tidy/singles
    database "$groups" -DCMAKE_UNITY_BUILD=ON -DCMAKE_UNITY_BUILD_BATCH_SIZE=16
    (cd -- "$ORV_ROOT" && find . -path './build*' -prune -o -name .clang-tidy -print0 |
        xargs -0 cp --parents -t "$groups")
    database "$singles"
    "$ORV_ROOT/tools/tidy" "$groups" "$singles" "$log" && return
    say "all that clang-tidy said is in $log"
    return 1
}

# database FOLDER OPTION…: how each source is compiled. The compiler's precompiled headers are
# not clang's: its commands go without.
database() {
    local folder=$1
    shift
    run_logged "$ORV_BUILD/log/tidy-configure.log" cmake -S "$ORV_ROOT" -B "$folder" -G Ninja \
        -DORV_TESTS=ON -DCMAKE_DISABLE_PRECOMPILE_HEADERS=ON "$@"
}
