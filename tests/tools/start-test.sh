#!/usr/bin/env bash
# SPDX-License-Identifier: Apache-2.0
# How the player is started: from an archive that has the classes of each command,
# and without asking the package and build tools when nothing has changed.
# ORV_BUILD is a build folder, ORV_MEDIA one with test media.
set -euo pipefail

root=$(dirname -- "$(dirname -- "$(dirname -- "$(readlink -f -- "$0")")")")
folder=$(mktemp -d)
trap 'rm -rf -- "$folder"' EXIT
export ORV_NO_INSTALL=1 ORV_LOG=silent
unset DISPLAY
failures=0

fail() {
    echo "FAILED $*"
    failures=$((failures + 1))
}

# Prints what starts the player, a word a line.
# shellcheck disable=SC2016
prepare() {
    "$BASH" -c 'set -euo pipefail; ORV_ROOT=$1; . "$1/tools/shell/common.sh"; use player
        prepare_player; printf "%s\n" "${JAVA_COMMAND[@]}"' prepare "$root"
}

# classes_outside COMMAND…: the classes of the player and its libraries that its
# command reads from their jars.
classes_outside() {
    "${java[@]}" "-Xlog:class+load:file=$folder/classes" "${jar[@]}" "$@" >/dev/null 2>&1 ||
        fail "$1: exit status $?"
    grep 'source: file:' "$folder/classes" | sed 's/.*\] \([^ ]*\) source.*/\1/' || true
}

prepare >"$folder/command" || fail "the player cannot be started"
mapfile -t java < <(grep -v '^-Xlog' "$folder/command" | head -n -2)
mapfile -t jar < <(tail -n 2 "$folder/command")

for command in "info $ORV_MEDIA/tracks.mkv" "info --json $ORV_MEDIA/tone.flac" \
    "thumbnail $ORV_MEDIA/short.mp4 $folder/a.png" "cover $ORV_MEDIA/covered.mp3 $folder/a.jpg" \
    "play --no-window $ORV_MEDIA/one-frame.mkv"; do
    read -ra words <<<"$command"
    outside=$(classes_outside "${words[@]}")
    [ "$(grep -c . <<<"$outside")" -le 3 ] || fail "${words[0]}: not archived: $outside"
done

# The native libraries are loaded by a thread of their own: in a line of the log, in
# whichever format, its number follows the process's. Help needs none.
ORV_LOG=verbose "${java[@]}" "${jar[@]}" info "$ORV_MEDIA/short.mp4" >"$folder/log" 2>&1 || fail "info"
thread_of() {
    grep -a -m 1 -F "$1" "$folder/log" | sed -E 's/^.* [0-9]+ +([0-9]+) .*$/\1/'
}
[ -n "$(thread_of 'JNI_OnLoad()')" ] || fail "no log of the native libraries"
[ "$(thread_of 'JNI_OnLoad()')" != "$(thread_of '_setup(): Enter')" ] ||
    fail "the native libraries are loaded while nothing else is done"
ORV_LOG=verbose "${java[@]}" "${jar[@]}" info --help >"$folder/log" 2>&1 || fail "info --help"
[ -z "$(thread_of 'JNI_OnLoad()')" ] || fail "help loads the native libraries"

# What they lack is said as if they were loaded by whom they are for.
! "${java[@]/#-Djava.library.path=*/-Djava.library.path=$folder}" "${jar[@]}" \
    info "$ORV_MEDIA/short.mp4" >"$folder/log" 2>&1 || fail "no library: exit status 0"
grep -q "UnsatisfiedLinkError: There is no native library of the player for .*No folder of java.library.path has" "$folder/log" ||
    fail "no library: $(head -n 3 "$folder/log")"

# Where no archive can be made, only the first start of a build tries. It needs no Java
# for anything else.
archive=$(sed -n 's/^-XX:SharedArchiveFile=//p' "$folder/command")
rm -f -- "$archive"
JDK_JAVA_OPTIONS=-XX:+NoSuchOption prepare >/dev/null || fail "a start without an archive"
[ ! -e "$archive" ] || fail "the planted failure is none"
grep -q "classes could not be archived" "$ORV_BUILD/log/class-archive.log" ||
    fail "no word in the log: $(cat "$ORV_BUILD/log/class-archive.log")"
prepare >/dev/null || fail "a second start without an archive"
[ ! -e "$archive" ] || fail "each start tries again"
touch "$ORV_BUILD/java/orv_player.jar"
prepare >/dev/null || fail "a start after a build"
[ -s "$archive" ] || fail "a build does not try again"
[ ! -e "$archive.failed" ] || fail "the mark of an earlier build stays"

# The jar names the libraries that it needs: it is made anew with that list.
inputs=$(ninja -C "$ORV_BUILD" -t query java/orv_player.jar)
grep -q 'player/manifest\.txt$' <<<"$inputs" || fail "a new list of libraries does not reach the jar"

# Nobody may be asked now.
mkdir "$folder/bin"
for tool in dpkg-query cmake ninja; do
    printf '#!/bin/sh\necho "%s" >>"%s/asked"\nexit 1\n' "$tool" "$folder" >"$folder/bin/$tool"
    chmod +x "$folder/bin/$tool"
done
PATH=$folder/bin:$PATH
prepare >/dev/null || fail "a start without changes"
[ ! -e "$folder/asked" ] || fail "a start without changes asked $(paste -sd' ' "$folder/asked")"

# As if all sources had been changed since.
touch -d 2000-01-01 "$ORV_BUILD/player-is-current"
! prepare >/dev/null 2>&1 || fail "a change is not built"
grep -qx ninja "$folder/asked" || fail "a change is not noticed"

# What failed is tried again.
: >"$folder/asked"
! prepare >/dev/null 2>&1 || fail "a failed build is forgotten"
[ -s "$folder/asked" ] || fail "a failed build is not tried again"

[ $failures -eq 0 ] && echo "all as expected"
exit $((failures > 0))
