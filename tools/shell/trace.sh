# SPDX-License-Identifier: Apache-2.0
# shellcheck shell=bash
# Builds what ./orv trace runs, apart from the rest: it needs a C++ compiler alone.

build_trace() {
    local folder=$ORV_BUILD/trace build_lock
    mkdir -p -- "$ORV_BUILD/log" "$folder"
    exec {build_lock}>"$folder/.lock"
    flock "$build_lock"
    trace_is_current "$folder" || make_trace "$folder"
    exec {build_lock}>&-
}

# trace_is_current FOLDER: whether nothing has changed since it was built.
trace_is_current() {
    [ -x "$1/bin/orv-trace" ] && [ -f "$1/current" ] &&
        [ -z "$(find "$ORV_ROOT/tools/trace" -newer "$1/current" -print -quit)" ]
}

make_trace() {
    local folder=$1
    touch -- "$folder/begun"
    run_logged "$ORV_BUILD/log/trace-configure.log" cmake -S "$ORV_ROOT/tools/trace" -B "$folder" -G Ninja ||
        die "the build could not be configured."
    NINJA_STATUS='[%p] ' run_logged "$ORV_BUILD/log/trace-ninja.log" ninja -C "$folder" ||
        die "the build failed."
    mv -f -- "$folder/begun" "$folder/current"
}
