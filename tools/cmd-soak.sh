# SPDX-License-Identifier: Apache-2.0
# shellcheck shell=bash
# help: soak [--minutes M | --cycles N] [--seed S]    uses players for a long time while files, servers, disk and sound fail; fails when something grows, hangs, crashes or goes unreported
use packages build launch

options=("$@")
while [ $# -gt 0 ]; do
    case $1 in
    --minutes | --cycles | --seed | --first | --only | --workers | --batch | --limit | --plant) shift ;;
    --*=* | -h | --help) ;;
    *) die_usage "soak does not know '$1'." ;;
    esac
    shift || die_usage "an option of soak lacks its value."
done

# PulseAudio would put the sound server of many a desktop out, so it is left out there.
lists=(play test soak)
dpkg-query -s pipewire-pulse >/dev/null 2>&1 || lists+=(soak-sound)
need_packages "run for long" "${lists[@]}"
build_targets on orv_soak
use_utf8
exec "$ORV_ROOT/tools/soak/soak.py" "${options[@]}" -- "$JAVA_HOME/bin/java"
