# SPDX-License-Identifier: Apache-2.0
# shellcheck shell=bash
# Configures and builds into $ORV_BUILD, quiet unless something fails.

# build_targets WITH_TESTS TARGET…: WITH_TESTS is on or off. A build folder
# that once had tests keeps them, so that play and test can take turns.
build_targets() {
    local with_tests=$1
    shift
    mkdir -p -- "$ORV_BUILD/log"
    exec {build_lock}>"$ORV_BUILD/.lock"
    flock -n "$build_lock" || { say "waiting for another build to end" && flock "$build_lock"; }
    configure "$with_tests"
    ninja_quietly "$@"
    exec {build_lock}>&-
}

configure() {
    is_configured "$1" && return
    if [ ! -f "$ORV_BUILD/build.ninja" ]; then
        say "building; the first time takes a few minutes"
        # What an interrupted run left would be taken for settings.
        rm -f -- "$ORV_BUILD/CMakeCache.txt"
    fi
    run_logged "$ORV_BUILD/log/configure.log" cmake -S "$ORV_ROOT" -B "$ORV_BUILD" -G Ninja \
        -D "ORV_TESTS=${1^^}" || die "the build could not be configured."
}

is_configured() {
    [ -f "$ORV_BUILD/build.ninja" ] || return
    [ "$1" = off ] || grep -qx 'ORV_TESTS:BOOL=ON' "$ORV_BUILD/CMakeCache.txt"
}

# Says nothing while all goes well, and then only the errors.
ninja_quietly() {
    local log=$ORV_BUILD/log/ninja.log
    NINJA_STATUS='[%p] ' follow_to "$log" ninja -C "$ORV_BUILD" "$@" && return
    sed -n '/^FAILED\|^CMake Error\|^ninja: error/,$p' "$log" | awk 'NR <= 60' >&2
    die "the build failed; all it said is in $log"
}
