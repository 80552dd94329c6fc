# SPDX-License-Identifier: Apache-2.0
# shellcheck shell=bash
# The version of the product, and of what its engine is built on.
use libraries

readonly FFMPEG_LIBRARIES='libavformat libavcodec libavfilter libavutil libswscale'

# The one place that has it.
product_version() { sed -n 's/^project(mediaplayer_orv VERSION \([0-9.]*\).*/\1/p' "$ORV_ROOT/CMakeLists.txt"; }

# Which release a development package is of, as its makers number it: 5.1.7 of
# 7:5.1.7-0+deb12u1. Nothing where dpkg does not know it.
release_of_package() {
    dpkg-query -W -f '${db:Status-Status} ${Version}\n' "$1" 2>/dev/null |
        sed -nE 's/^installed ([0-9]+:)?([^-+~]*).*/\2/p' || true
}

# name_and_release NAME PACKAGE
name_and_release() {
    local release
    release=$(release_of_package "$2")
    printf '%s' "$1${release:+ $release}"
}

# What a program that is built now gets.
mpv_line() {
    local interface
    interface=$(library_version mpv)
    if [ -n "$interface" ]; then
        echo "$(name_and_release mpv libmpv-dev) (client interface $interface)"
    else
        echo "mpv is not here; ./orv play installs it"
    fi
}

ffmpeg_line() {
    local library version found=()
    for library in $FFMPEG_LIBRARIES; do
        version=$(library_version "$library")
        found+=("$library ${version:-is missing}")
    done
    case ${found[*]} in
    *[0-9].[0-9]*) echo "$(name_and_release FFmpeg libavformat-dev) ($(printf '%s, ' "${found[@]}" | sed 's/, $//'))" ;;
    *) echo "FFmpeg's libraries are not here; ./orv play installs them" ;;
    esac
}

# The media libraries that the engine of this build asks the loader for.
build_line() {
    local engine=$ORV_BUILD/lib/liborvtarn.so names=
    if [ ! -f "$engine" ]; then
        echo "nothing is built yet in $ORV_BUILD"
        return
    fi
    names=$(LC_ALL=C readelf -d "$engine" 2>/dev/null |
        sed -nE 's/.*\(NEEDED\).*\[(lib(mpv|av|sw)[^]]*)\].*/\1/p' | paste -sd, | sed 's/,/, /g')
    echo "the build in $ORV_BUILD uses ${names:-libraries that only readelf (binutils) can name}"
}
