# SPDX-License-Identifier: Apache-2.0
# shellcheck shell=bash
# Brings the player application up to date and becomes it.

run_player() {
    use packages build
    need_packages "build and play" play
    build_targets off mediaplayer_orv orv_player
    use_utf8
    describe_terminal
    choose_log "$@"
    exec java "${ORV_JAVA_OPTIONS[@]}" "-Djava.library.path=$ORV_BUILD/lib" \
        "-Dorv.sample=$ORV_BUILD/media/sample.mkv" "-Dorv.make-sample=$ORV_ROOT/tools/make-sample" \
        -cp "$ORV_BUILD/java/*:/usr/share/java/picocli.jar:/usr/share/java/gson.jar" \
        com.quintora.orv.player.Main "$@"
}

# A short life needs a quick start: one compiler tier, the simplest collector.
ORV_JAVA_OPTIONS=(-XX:TieredStopAtLevel=1 -XX:+UseSerialGC -Xshare:auto)

# Java itself cannot tell how wide its terminal is, nor whether it has one.
describe_terminal() {
    [ -t 1 ] || return 0
    local columns
    read -r _ columns < <(stty size 2>/dev/null </dev/tty) || columns=80
    [ "${columns:-0}" -gt 0 ] || columns=80
    ORV_JAVA_OPTIONS+=("-Dorv.columns=$columns")
}

# The native libraries log to standard error, where a player's user wants quiet.
choose_log() {
    local argument
    for argument in "$@"; do
        [ "$argument" != --log ] || ORV_LOG=${ORV_LOG:-verbose}
    done
    export ORV_LOG=${ORV_LOG:-silent}
}

# Java reads the names of files in the locale's encoding.
use_utf8() {
    case ${LC_ALL:-${LC_CTYPE:-${LANG:-}}} in
    *[Uu][Tt][Ff]*8*) ;;
    *) export LC_ALL=C.UTF-8 ;;
    esac
}
