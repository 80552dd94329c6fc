# SPDX-License-Identifier: Apache-2.0
# shellcheck shell=bash
# Whether anything has changed since the player was brought up to date last time:
# one look at the files' times in place of asking dpkg, CMake and ninja.

readonly CURRENT_STAMP=$ORV_BUILD/player-is-current

# What the player is made from.
readonly PLAYER_SOURCES=(CMakeLists.txt apps cmake engine frameworks java platform tools)
# What it is started with, besides the class archive.
readonly PLAYER_PARTS=(lib/lib{mediaplayer_orv,orv_platform,orvtarn}.so java/{orv_player,picocli,gson,jna}.jar)

# What decides which JDK is used, before one is chosen.
JAVA_CHOICE="${JAVA_HOME:-}|$(command -v javac || true)"
readonly JAVA_CHOICE

# Sets JAVA_HOME, as use_jdk would, when everything is as it was.
player_is_current() {
    local java_key java_home part
    [ -f "$CURRENT_STAMP" ] || return
    [ ! /var/lib/dpkg/status -nt "$CURRENT_STAMP" ] || return
    { read -r java_key && read -r java_home; } <"$CURRENT_STAMP" || return
    [ "$java_key" = "$JAVA_CHOICE" ] && [ -x "$java_home/bin/java" ] || return
    for part in "${PLAYER_PARTS[@]}"; do
        [ -f "$ORV_BUILD/$part" ] || return
    done
    [ -z "$(cd -- "$ORV_ROOT" &&
        find "${PLAYER_SOURCES[@]}" -newer "$CURRENT_STAMP" -print -quit 2>&1)" ] || return
    export JAVA_HOME=$java_home
}

# begin_current before the player is built, end_current after it: what changes
# meanwhile is newer than the stamp.
begin_current() {
    rm -f -- "$CURRENT_STAMP"
    CURRENT_SINCE=$(date +%s.%N)
}

end_current() {
    local draft=$CURRENT_STAMP.$$
    printf '%s\n' "$JAVA_CHOICE" "$JAVA_HOME" >"$draft"
    touch -d "@$CURRENT_SINCE" -- "$draft"
    mv -f -- "$draft" "$CURRENT_STAMP"
}
