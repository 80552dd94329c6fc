# SPDX-License-Identifier: Apache-2.0
# shellcheck shell=bash
# Builds by a preset of CMakePresets.json, into a folder of its own below $ORV_BUILD.
use build

# preset_folder PRESET
preset_folder() { printf '%s\n' "$ORV_BUILD/$1"; }

# build_preset PRESET TARGET…
build_preset() {
    local folder lock preset=$1
    shift
    folder=$(preset_folder "$preset")
    mkdir -p -- "$folder" "$ORV_BUILD/log"
    exec {lock}>"$folder/.lock"
    flock -w 3 "$lock" || { say "waiting for another build to end" && flock "$lock"; }
    [ -f "$folder/build.ninja" ] || say "building; the first time takes some minutes"
    check_mpv
    (cd -- "$ORV_ROOT" && run_logged "$ORV_BUILD/log/$preset-configure.log" \
        cmake --preset "$preset" -B "$folder") || die "the build could not be configured."
    NINJA_STATUS='[%p] ' run_logged "$ORV_BUILD/log/$preset-ninja.log" \
        ninja -C "$folder" "$@" || die "the build failed."
    exec {lock}>&-
}
