# SPDX-License-Identifier: Apache-2.0
# shellcheck shell=bash
# Starts the player as JAVA_COMMAND says, built here or installed. Needs sound.sh.

# A short life needs a quick start: one compiler tier, which takes its time before it
# begins, and Java's objects from its archive, which 17 does for this collector alone.
# shellcheck disable=SC2034
readonly QUICK_START=(-XX:TieredStopAtLevel=1 -XX:CompileThresholdScaling=5
    -XX:+UseG1GC -XX:ParallelGCThreads=1 -XX:ConcGCThreads=1 -XX:-UsePerfData
    -Xlog:disable -Xlog:all=error:stderr)

# start_player ARGUMENT…: becomes the player.
start_player() {
    describe_terminal
    describe_sound
    choose_log "$@"
    choose_trust "$@"
    exec "${JAVA_COMMAND[@]}" "$@"
}

# Java itself cannot find out how wide its terminal is, nor whether it has one.
describe_terminal() {
    [ -t 1 ] || return 0
    local columns
    read -r _ columns < <(stty size 2>/dev/null </dev/tty) || columns=80
    [ "${columns:-0}" -gt 0 ] || columns=80
    java_option "-Dorv.columns=$columns"
}

# The engine plays on in silence, which its user should not take for a fault.
describe_sound() {
    [ -n "$(sound_output)" ] || java_option -Dorv.sound=none
}

# java_option OPTION: adds one to what starts the player.
java_option() { JAVA_COMMAND=("${JAVA_COMMAND[0]}" "$1" "${JAVA_COMMAND[@]:1}"); }

# The native libraries log to standard error, where a player's user wants quiet.
choose_log() {
    local argument
    for argument in "$@"; do
        [ "$argument" != --log ] || ORV_LOG=${ORV_LOG:-verbose}
    done
    export ORV_LOG=${ORV_LOG:-silent}
}

# Certificates of servers are checked unless the user says otherwise.
choose_trust() {
    local argument
    for argument in "$@"; do
        [ "$argument" != --insecure ] || export ORV_TLS_VERIFY=no
    done
}

# Java reads the names of files in the locale's encoding.
use_utf8() {
    case ${LC_ALL:-${LC_CTYPE:-${LANG:-}}} in
    *[Uu][Tt][Ff]*8*) ;;
    *) export LC_ALL=C.UTF-8 ;;
    esac
}
