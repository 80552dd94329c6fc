# SPDX-License-Identifier: Apache-2.0
# shellcheck shell=bash
# Brings the player application up to date and becomes it.

run_player() {
    prepare_player
    describe_terminal
    describe_sound
    choose_log "$@"
    choose_trust "$@"
    exec "${JAVA_COMMAND[@]}" "$@"
}

# Sets JAVA_COMMAND to what starts the player, which is built if need be.
prepare_player() {
    use current
    if ! player_is_current; then
        use packages build
        need_packages "build and play" play
        begin_current
        build_targets off mediaplayer_orv orv_player
        end_current
    fi
    set_java_command
    archive_classes
    use_utf8
}

# A short life needs a quick start: one compiler tier, the simplest collector,
# and the program's classes from an archive.
set_java_command() {
    local jars=$ORV_BUILD/java kind=${DISPLAY:+window}
    # An archive is one Java's; after an update of Java another is made. That of a
    # machine with a display has the classes of the window, too.
    CLASS_ARCHIVE=$jars/player-${kind:-plain}-$(stat -Lc '%Z-%s' -- "$JAVA_HOME/bin/java").jsa
    JAVA_COMMAND=("$JAVA_HOME/bin/java" -XX:TieredStopAtLevel=1 -XX:+UseSerialGC -XX:-UsePerfData
        -Xshare:auto "-XX:SharedArchiveFile=$CLASS_ARCHIVE" -Xlog:disable -Xlog:all=error:stderr
        "-Djava.library.path=$ORV_BUILD/lib"
        "-Dorv.sample=$ORV_BUILD/media/sample.mkv" "-Dorv.make-sample=$ORV_ROOT/tools/make-sample"
        -jar "$jars/orv_player.jar")
}

# Made by a run of all commands that shows nothing; without an archive the player
# starts, too.
archive_classes() {
    archive_is_current && return
    rm -f -- "${CLASS_ARCHIVE%-*-*}"-*.jsa
    local draft=$CLASS_ARCHIVE.$$ folder
    folder=$(mktemp -d)
    # shellcheck disable=SC2064
    trap "rm -rf -- ${draft@Q} ${folder@Q}" EXIT
    local command=("${JAVA_COMMAND[@]/#-XX:SharedArchiveFile=*/-XX:ArchiveClassesAtExit=$draft}")
    command[-2]=-cp
    if ORV_LOG=silent timeout 60 "${command[@]}" com.quintora.orv.player.Rehearsal "$folder" \
        >/dev/null 2>&1 </dev/null; then
        mv -f -- "$draft" "$CLASS_ARCHIVE"
    fi
    rm -rf -- "$draft" "$folder"
    trap - EXIT
}

archive_is_current() {
    local jar
    for jar in "$ORV_BUILD"/java/{orv_player,mediaplayer_orv_java,orv_platform_java}.jar; do
        [ "$CLASS_ARCHIVE" -nt "$jar" ] || return
    done
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
    use sound
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
