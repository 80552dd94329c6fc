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

# A short life needs a quick start: one compiler tier, which takes its time before it
# begins; the program's classes from an archive, and Java's objects, which 17 takes
# from its own for this collector alone.
set_java_command() {
    local jars=$ORV_BUILD/java kind=${DISPLAY:+window}
    # An archive is one Java's; after an update of Java another is made. That of a
    # machine with a display has the classes of the window, too.
    CLASS_ARCHIVE=$jars/player-${kind:-plain}-$(stat -Lc '%Z-%s' -- "$JAVA_HOME/bin/java").jsa
    JAVA_COMMAND=("$JAVA_HOME/bin/java" -XX:TieredStopAtLevel=1 -XX:CompileThresholdScaling=5
        -XX:+UseG1GC -XX:ParallelGCThreads=1 -XX:ConcGCThreads=1 -XX:-UsePerfData
        -Xshare:auto "-XX:SharedArchiveFile=$CLASS_ARCHIVE" -Xlog:disable -Xlog:all=error:stderr
        "-Djava.library.path=$ORV_BUILD/lib"
        "-Dorv.sample=$ORV_BUILD/media/sample.mkv" "-Dorv.make-sample=$ORV_ROOT/tools/make-sample"
        -jar "$jars/orv_player.jar")
}

# Made by a run of all commands that shows nothing. Without an archive the player
# starts, too, only slower: where making it fails, it is left at that for this build.
archive_classes() {
    local failed=$CLASS_ARCHIVE.failed
    { is_of_this_build "$CLASS_ARCHIVE" || is_of_this_build "$failed"; } && return
    rm -f -- "${CLASS_ARCHIVE%-*-*}"-*.jsa{,.failed}
    local draft=$CLASS_ARCHIVE.$$ log=$ORV_BUILD/log/class-archive.log folder status=0
    mkdir -p -- "${log%/*}"
    folder=$(mktemp -d)
    # shellcheck disable=SC2064
    trap "rm -rf -- ${draft@Q} ${folder@Q}" EXIT
    local command=("${JAVA_COMMAND[@]/#-XX:SharedArchiveFile=*/-XX:ArchiveClassesAtExit=$draft}")
    command[-2]=-cp
    ORV_LOG=silent timeout -k 5 60 "${command[@]}" com.quintora.orv.player.Rehearsal "$folder" \
        >"$log" 2>&1 </dev/null || status=$?
    if [ $status -ne 0 ] || ! mv -f -- "$draft" "$CLASS_ARCHIVE" 2>>"$log"; then
        echo "The player's classes could not be archived (exit status $status, 124 and 137 for" \
            "more than a minute); until the next build it starts without." >>"$log"
        : >"$failed"
    fi
    rm -rf -- "$draft" "$folder"
    trap - EXIT
}

# is_of_this_build FILE: whether it was made after what an archive depends on.
is_of_this_build() {
    local part
    for part in "$ORV_BUILD"/java/{orv_player,mediaplayer_orv_java,orv_platform_java}.jar \
        "$ORV_ROOT/tools/shell/player.sh"; do
        [ "$1" -nt "$part" ] || return
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
