# SPDX-License-Identifier: Apache-2.0
# shellcheck shell=bash
# Brings the player application up to date and becomes it.

run_player() {
    use packages build
    need_packages "build and play" play
    build_targets off mediaplayer_orv orv_player
    use_utf8
    exec java "${ORV_JAVA_OPTIONS[@]}" "-Djava.library.path=$ORV_BUILD/lib" \
        "-Dorv.sample=$ORV_BUILD/media/sample.mkv" "-Dorv.make-sample=$ORV_ROOT/tools/make-sample" \
        -cp "$ORV_BUILD/java/*:/usr/share/java/picocli.jar:/usr/share/java/gson.jar" \
        com.quintora.orv.player.Main "$@"
}

# A short life needs a quick start: one compiler tier, the simplest collector.
ORV_JAVA_OPTIONS=(-XX:TieredStopAtLevel=1 -XX:+UseSerialGC -Xshare:auto)

# Java reads the names of files in the locale's encoding.
use_utf8() {
    case ${LC_ALL:-${LC_CTYPE:-${LANG:-}}} in
    *[Uu][Tt][Ff]*8*) ;;
    *) export LC_ALL=C.UTF-8 ;;
    esac
}
