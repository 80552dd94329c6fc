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

# Sets JAVA_COMMAND to what starts the player that is built.
prepare_player() {
    use packages build
    need_packages "build and play" play
    build_targets off mediaplayer_orv orv_player
    set_java_command
    archive_classes
    use_utf8
}

# A short life needs a quick start: one compiler tier, the simplest collector,
# and the program's classes from an archive.
set_java_command() {
    local jars=$ORV_BUILD/java
    # An archive is one Java's; after an update of Java another is made.
    CLASS_ARCHIVE=$jars/player-$(stat -Lc '%Z-%s' -- "$JAVA_HOME/bin/java").jsa
    JAVA_COMMAND=("$JAVA_HOME/bin/java" -XX:TieredStopAtLevel=1 -XX:+UseSerialGC
        -Xshare:auto "-XX:SharedArchiveFile=$CLASS_ARCHIVE" -Xlog:disable -Xlog:all=error:stderr
        "-Djava.library.path=$ORV_BUILD/lib"
        "-Dorv.sample=$ORV_BUILD/media/sample.mkv" "-Dorv.make-sample=$ORV_ROOT/tools/make-sample"
        -jar "$jars/orv_player.jar")
}

# Made by a run that loads the classes; without an archive the player starts too.
archive_classes() {
    [ -n "$(find "$ORV_BUILD/java" -name '*.jar' -newer "$CLASS_ARCHIVE" -print -quit 2>&1)" ] ||
        return 0
    rm -f -- "$ORV_BUILD"/java/player-*.jsa
    local draft=$CLASS_ARCHIVE.$$
    # shellcheck disable=SC2064
    trap "rm -f -- ${draft@Q}" EXIT
    if "${JAVA_COMMAND[@]/#-XX:SharedArchiveFile=*/-XX:ArchiveClassesAtExit=$draft}" play --help \
        >/dev/null 2>&1; then
        mv -f -- "$draft" "$CLASS_ARCHIVE"
    fi
    rm -f -- "$draft"
    trap - EXIT
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
