# SPDX-License-Identifier: Apache-2.0
# shellcheck shell=bash
# Brings the player application up to date and becomes it.
use sound launch

run_player() {
    prepare_player
    start_player "$@"
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

# The program's classes come from an archive.
set_java_command() {
    local jars=$ORV_BUILD/java kind=${DISPLAY:+window}
    # An archive is one Java's; after an update of Java another is made. That of a
    # machine with a display has the classes of the window, too.
    CLASS_ARCHIVE=$jars/player-${kind:-plain}-$(stat -Lc '%Z-%s' -- "$JAVA_HOME/bin/java").jsa
    JAVA_COMMAND=("$JAVA_HOME/bin/java" "${QUICK_START[@]}" -Xshare:auto "-XX:SharedArchiveFile=$CLASS_ARCHIVE"
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
        "$ORV_ROOT"/tools/shell/{player,launch}.sh; do
        [ "$1" -nt "$part" ] || return
    done
}
