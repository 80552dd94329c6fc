# SPDX-License-Identifier: Apache-2.0
# shellcheck shell=bash
# What every subcommand needs: messages, and the other helpers on request.

say() { printf 'orv: %s\n' "$*" >&2; }

die() {
    say "$*"
    exit 1
}

die_usage() {
    say "$*" "See ./orv help."
    exit 2
}

# use packages build …: reads those helpers of tools/shell.
use() {
    local name
    for name in "$@"; do
        # shellcheck disable=SC1090
        . "$ORV_ROOT/tools/shell/$name.sh"
    done
}

# run_logged LOG COMMAND…: quiet while it succeeds; on failure shows the end of
# what it said and returns its status.
run_logged() {
    local log=$1 status=0
    shift
    mkdir -p -- "$(dirname -- "$log")"
    "$@" >"$log" 2>&1 </dev/null || status=$?
    if [ "$status" -ne 0 ]; then
        tail -n 40 -- "$log" >&2
        say "all of it is in $log"
    fi
    return "$status"
}
