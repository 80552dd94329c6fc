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

# After Ctrl-C, which has ended the program in the foreground, too.
interrupted() {
    local watchers
    mapfile -t watchers < <(jobs -p)
    [ ${#watchers[@]} -eq 0 ] || kill "${watchers[@]}" 2>/dev/null || true
    [ ! -t 2 ] || printf '\r\033[K' >&2
    exit 130
}

# use packages build …: reads those helpers of tools/shell, each once.
USED=' '
use() {
    local name
    for name in "$@"; do
        case $USED in *" $name "*) continue ;; esac
        USED+="$name "
        # shellcheck disable=SC1090
        . "$ORV_ROOT/tools/shell/$name.sh"
    done
}

# run_logged LOG COMMAND…: quiet while it succeeds, but for its progress on a
# terminal; on failure shows the end of what it said and fails.
run_logged() {
    local log=$1
    shift
    follow_to "$log" "$@" && return
    grep -v '^[dp][lm]status:' "$log" | tail -n 40 >&2
    say "all of it is in $log"
    return 1
}

# follow_to LOG COMMAND…: writes what it says to the log, and shows how far it is.
follow_to() {
    local log=$1 status=0 watcher=
    shift
    mkdir -p -- "${log%/*}"
    : >"$log"
    if [ -t 2 ]; then
        tail -n +1 -f --pid=$$ "$log" > >(show_progress) 2>/dev/null &
        watcher=$!
    fi
    "$@" >>"$log" 2>&1 </dev/null || status=$?
    [ -z "$watcher" ] || { kill "$watcher" && wait "$watcher"; } 2>/dev/null || true
    [ ! -t 2 ] || printf '\r\033[K' >&2
    return "$status"
}

# The percentages that apt-get (its status lines) and ninja ([ 12%]) report.
show_progress() {
    local line percent
    while IFS= read -r line; do
        case $line in
        dlstatus:* | pmstatus:*) IFS=: read -r _ _ percent _ <<<"$line" ;;
        '['*'%]'*) percent=${line#*[} && percent=${percent%%%*} ;;
        *) continue ;;
        esac
        printf '\r     %3d%%' "${percent%%.*}" >&2
    done
    printf '\r\033[K' >&2
}
