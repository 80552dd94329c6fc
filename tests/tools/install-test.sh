#!/usr/bin/env bash
# SPDX-License-Identifier: Apache-2.0
# cmake --install: the prefix can be moved, programs outside of the project build
# against it by CMake and by pkg-config and run, its player runs, and the binaries
# name nothing of the build tree. ORV_BUILD is a build folder with library, engine
# and Java half; ORV_MEDIA one with test media; ORV_NINJA, ORV_CXX what builds.
set -euo pipefail

root=$(dirname -- "$(dirname -- "$(dirname -- "$(readlink -f -- "$0")")")")
folder=$(mktemp -d)
trap 'rm -rf -- "$folder"' EXIT
export ORV_LOG=silent
unset DISPLAY LD_LIBRARY_PATH PKG_CONFIG_PATH
version=$(sed -n 's/^project(.* VERSION \([^ ]*\) .*/\1/p' "$root/CMakeLists.txt")
film=$ORV_MEDIA/short.mp4
failures=0

fail() {
    echo "FAILED $*"
    failures=$((failures + 1))
}

# expect WHAT TEXT COMMAND…: succeeds, and one line of its output is that text.
expect() {
    local what=$1 text=$2
    shift 2
    "$@" >"$folder/said" 2>&1 </dev/null || fail "$what: status $?: $(tail -n 5 "$folder/said")"
    grep -qxE -- "$text" "$folder/said" || fail "$what: no line '$text' in: $(tail -n 5 "$folder/said")"
}

install_to() { cmake --install "$ORV_BUILD" --prefix "$@" >"$folder/log" 2>&1 || fail "install: $(tail -n 5 "$folder/log")"; }

install_to "$folder/first" --strip
mv "$folder/first" "$folder/moved"
prefix=$folder/moved

# What a program would find the build by: its own places, and those of its sources.
for file in "$prefix"/lib/*.so* "$prefix"/bin/* "$prefix"/lib/pkgconfig/* "$prefix"/lib/cmake/*/*; do
    ! grep -qaF -e "$ORV_BUILD" -e "$root" -e "$folder/first" "$file" || fail "${file#"$prefix"/} names the build tree"
done
for library in mediaplayer_orv orvtarn orv_platform; do
    # shellcheck disable=SC2016
    LC_ALL=C readelf -d "$prefix/lib/lib$library.so" | grep -qE 'RUNPATH.*\[\$ORIGIN:[^:]*/android\]' ||
        fail "lib$library.so does not look beside itself"
done
while IFS= read -r link; do
    [ -e "$link" ] || fail "${link#"$prefix"/} leads nowhere"
    [[ $(readlink -- "$link") != /* ]] || fail "${link#"$prefix"/} is not relative"
done < <(find "$prefix" -type l)

# By CMake, configured for the place after the move.
cmake -S "$root/tests/tools/install" -B "$folder/by-cmake" -G Ninja -DCMAKE_MAKE_PROGRAM="$ORV_NINJA" \
    -DCMAKE_CXX_COMPILER="$ORV_CXX" -DCMAKE_PREFIX_PATH="$prefix" >"$folder/log" 2>&1 ||
    fail "find_package: $(tail -n 20 "$folder/log")"
"$ORV_NINJA" -C "$folder/by-cmake" >"$folder/log" 2>&1 || fail "a program by CMake: $(tail -n 20 "$folder/log")"
expect "the engine by CMake" "0 3000" "$folder/by-cmake/engine_probe" "$film"
expect "the library by CMake" "0 3000" "$folder/by-cmake/service_probe" "$film"
sed 's/(mediaplayer_orv 1\.0/(mediaplayer_orv 2.0/' "$root/tests/tools/install/CMakeLists.txt" >"$folder/CMakeLists.txt"
! cmake -S "$folder" -B "$folder/too-new" -G Ninja -DCMAKE_MAKE_PROGRAM="$ORV_NINJA" \
    -DCMAKE_CXX_COMPILER="$ORV_CXX" -DCMAKE_PREFIX_PATH="$prefix" >"$folder/log" 2>&1 ||
    fail "find_package of version 2 succeeds"

# By pkg-config.
export PKG_CONFIG_PATH=$prefix/lib/pkgconfig
expect "pkg-config's version" "${version//./\\.}" pkg-config --modversion mediaplayer_orv
# by_pkg_config PROGRAM MODULE
by_pkg_config() {
    local flags
    read -ra flags < <(pkg-config --cflags --libs "$2")
    "$ORV_CXX" -std=c++17 -o "$folder/$1" "$root/tests/tools/install/$1.cpp" "${flags[@]}" \
        >"$folder/log" 2>&1 || fail "$1 by pkg-config: $(tail -n 20 "$folder/log")"
}
by_pkg_config engine_probe orvtarn
by_pkg_config service_probe mediaplayer_orv
expect "the engine by pkg-config" "0 3000" "$folder/engine_probe" "$film"
expect "the library by pkg-config" "0 3000" "$folder/service_probe" "$film"

# The player, from a place with a space in its name, through a link, with nothing of
# this environment.
mkdir "$folder/one more" "$folder/bin"
mv "$prefix" "$folder/one more/place"
ln -s "../one more/place/bin/orv" "$folder/bin/orv"
orv() { env -i HOME="$folder/home" PATH="$PATH" ORV_LOG=silent JAVA_HOME="${JAVA_HOME:-}" "$folder/bin/orv" "$@"; }
expect "info" "duration +0:03\.000" orv info "$film"
expect "play" "3\.0 s of 3\.0 s.*" orv play --no-window --speed 32 "$film"
orv thumbnail "$film" "$folder/a.png" || fail "thumbnail: status $?"
[ "$(head -c 4 "$folder/a.png" | tail -c 3)" = PNG ] || fail "thumbnail: no picture"
printf '11-22 10:00:01.000 1 1 I OrvMediaClient-JNI: OrvMediaClient_start(): %s\n' Enter Leave >"$folder/a log"
expect "trace" "start +1 .*" orv trace "$folder/a log"
expect "its version" "orv ${version//./\\.}" orv --version
expect "its help" "Usage: orv COMMAND.*" orv
status=0
orv test >"$folder/said" 2>&1 || status=$?
[ "$status:$(cat "$folder/said")" = "2:orv: there is no command 'test'. See orv help." ] ||
    fail "another command: $status, $(cat "$folder/said")"
mkdir -p "$folder/old/bin"
echo 'JAVA_VERSION="11.0.2"' >"$folder/old/release"
printf '#!/bin/sh\n' >"$folder/old/bin/java" && chmod +x "$folder/old/bin/java"
! JAVA_HOME=$folder/old orv info "$film" >"$folder/said" 2>&1 || fail "an old Java: status 0"
grep -qx "orv: the Java in $folder/old is version 11; 17 or newer is needed." "$folder/said" ||
    fail "an old Java: $(cat "$folder/said")"

# Each file belongs to a component, and each component can go alone.
for component in runtime engine java player dev doc; do
    cmake --install "$ORV_BUILD" --prefix "$folder/parts" --component $component >"$folder/log" 2>&1 ||
        fail "component $component: $(tail -n 5 "$folder/log")"
done
diff <(cd "$folder/parts" && find . | sort) <(cd "$folder/one more/place" && find . | sort) ||
    fail "the components together are not everything"

# Without engine and Java there is the platform, and what engines are written against.
cmake -S "$root" -B "$folder/bare" -G Ninja -DCMAKE_MAKE_PROGRAM="$ORV_NINJA" -DCMAKE_CXX_COMPILER="$ORV_CXX" \
    -DORV_ENGINE=OFF -DORV_JAVA=OFF -DORV_TESTS=OFF >"$folder/log" 2>&1 || fail "neither: $(tail -n 5 "$folder/log")"
for component in dev engine java player; do
    cmake --install "$folder/bare" --prefix "$folder/without" --component $component >"$folder/log" 2>&1 ||
        fail "neither: component $component: $(tail -n 5 "$folder/log")"
done
check_is() { [ "$1" = "$2" ] || fail "without engine and Java: '$2' in place of '$1'"; }
check_is "include lib" "$(cd "$folder/without" && echo *)"
check_is "orv_platform.pc" "$(cd "$folder/without/lib/pkgconfig" && echo *)"
[ -f "$folder/without/include/mediaplayer_orv/orvtarn/TarnPlayer.h" ] || fail "no headers of the engine's contract"

[ $failures -eq 0 ]
