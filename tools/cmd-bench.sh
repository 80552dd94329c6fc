# SPDX-License-Identifier: Apache-2.0
# shellcheck shell=bash
# help: bench [--rows REGEX] [--rounds N] [--json FILE] [--plot FILE.svg] [--list]    what calls, players, pictures and streams cost, each beside its floor or its peer
use packages build player

options=("$@")
while [ $# -gt 0 ]; do
    case $1 in
    --rows | --rounds | --json | --plot) shift ;;
    --rows=* | --rounds=* | --json=* | --plot=* | --list) ;;
    *) die_usage "bench does not know '$1'." ;;
    esac
    shift || die_usage "an option of bench lacks its value."
done

need_packages "measure, and compare with other programs" play test bench
build_targets on orv_bench orv_player mediaplayer_orv
set_java_command
archive_classes
use_utf8
exec "$ORV_ROOT/tools/bench/bench.py" "${options[@]}" -- "${JAVA_COMMAND[@]}"
