# SPDX-License-Identifier: Apache-2.0
# shellcheck shell=bash
# Which releases of the engine's libraries are here.

# The oldest interface of mpv, as the engine's build file has it.
oldest_mpv() { sed -n 's/.*mpv>=\([0-9.]*\).*/\1/p' "$ORV_ROOT/engine/CMakeLists.txt"; }

# The version of a library for who builds with it; nothing when it is not here.
library_version() { pkg-config --modversion "$1" 2>/dev/null || true; }

# is_at_least VERSION OLDEST
is_at_least() { [ "$(printf '%s\n' "$2" "$1" | sort -V | head -n 1)" = "$2" ]; }

# A sentence when mpv is too old, nothing otherwise.
mpv_complaint() {
    local version
    version=$(library_version mpv)
    [ -z "$version" ] || is_at_least "$version" "$(oldest_mpv)" ||
        echo "mpv's interface is version $version here; $(oldest_mpv) (mpv 0.35) or newer is needed"
}

# For this machine's own libraries: a cross build has those of its sysroot.
check_mpv() {
    local complaint
    [ -z "${CMAKE_TOOLCHAIN_FILE:-}" ] || return 0
    complaint=$(mpv_complaint)
    [ -z "$complaint" ] || die "$complaint."
}
