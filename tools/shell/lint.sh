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

# The compiler's precompiled headers are not clang's: its commands go without. A source of
# several programs is checked once.
lint_tidy() {
    local log=$ORV_BUILD/log/tidy.log database=$ORV_BUILD/tidy
    mkdir -p "$database"
    sed -E 's/-Winvalid-pch -include ([^ "\\]+|\\"[^"]*\\")//' "$ORV_BUILD/compile_commands.json" |
        python3 -c 'import json, sys; print(json.dumps(list({each["file"]: each for each in json.load(sys.stdin)}.values())))' \
            >"$database/compile_commands.json"
    run-clang-tidy -quiet -p "$database" '^((?!cmake_pch).)*$' >"$log" 2>&1 && return
    grep -E '(warning|error):' "$log" | sort -u
    say "all that clang-tidy said is in $log"
    return 1
}
