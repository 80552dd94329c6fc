# SPDX-License-Identifier: Apache-2.0
# shellcheck shell=bash
# Configures and builds into $ORV_BUILD, quiet unless something fails.
use java libraries

# build_targets WITH_TESTS TARGET…: WITH_TESTS is on or off. A build folder
# that once had tests keeps them, so that play and test can take turns.
build_targets() {
    local with_tests=$1
    shift
    mkdir -p -- "$ORV_BUILD/log"
    exec {build_lock}>"$ORV_BUILD/.lock"
    # Another that finds nothing to build is done before anybody wonders.
    flock -w 3 "$build_lock" || { say "waiting for another build to end" && flock "$build_lock"; }
    configure "$with_tests"
    if [ "$with_tests" = on ]; then
        ninja_quietly "$@" || die_of_build
    else
        ninja_quietly "$@" || ninja_in_spite_of_warnings "$@" || die_of_build
    fi
    exec {build_lock}>&-
}

configure() {
    use_jdk
    is_configured "$1" && return
    if [ ! -f "$ORV_BUILD/build.ninja" ]; then
        say "building; the first time takes a few minutes"
        # What an interrupted run left would be taken for settings.
        rm -f -- "$ORV_BUILD/CMakeCache.txt"
    fi
    # What a folder was made for stays, but that tests come to one without.
    local settings=("-DORV_TESTS=${1^^}" "-DCMAKE_COMPILE_WARNING_AS_ERROR:BOOL=${1^^}")
    [ "$1" = on ] || [ ! -f "$ORV_BUILD/build.ninja" ] || settings=()
    run_cmake "${settings[@]}"
}

# The JDK is looked for anew: the one of last time may be gone.
run_cmake() {
    check_mpv
    run_logged "$ORV_BUILD/log/configure.log" cmake -S "$ORV_ROOT" -B "$ORV_BUILD" -G Ninja \
        -U 'Java_*' "$@" || die "the build could not be configured."
}

is_configured() {
    [ -f "$ORV_BUILD/build.ninja" ] || return
    is_cached "Java_JAVAC_EXECUTABLE:FILEPATH=$JAVA_HOME/bin/javac" || return
    [ "$1" = off ] || { is_cached ORV_TESTS:BOOL=ON && warnings_are_errors; }
}

is_cached() { grep -qsxF -- "$1" "$ORV_BUILD/CMakeCache.txt"; }
warnings_are_errors() { is_cached CMAKE_COMPILE_WARNING_AS_ERROR:BOOL=ON; }

# A folder that was built with tests takes warnings for errors. Who only plays
# may have a newer compiler since, which finds more.
ninja_in_spite_of_warnings() {
    warnings_are_errors || return
    run_cmake -DCMAKE_COMPILE_WARNING_AS_ERROR:BOOL=OFF
    ninja_quietly "$@"
}

ninja_quietly() {
    local log=$ORV_BUILD/log/ninja.log
    NINJA_STATUS='[%p] ' follow_to "$log" ninja -C "$ORV_BUILD" "$@"
}

die_of_build() {
    local log=$ORV_BUILD/log/ninja.log
    sed -n '/^FAILED\|^CMake Error\|^ninja: error/,$p' "$log" | awk 'NR <= 60' >&2
    die "the build failed; all it said is in $log"
}
