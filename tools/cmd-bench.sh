# SPDX-License-Identifier: Apache-2.0
# shellcheck shell=bash
# help: bench [--filter REGEX]       what calls, players, pictures and streams cost here
use packages build player

filter=
while [ $# -gt 0 ]; do
    case $1 in
    --filter) filter=${2:-} && shift ;;
    --filter=*) filter=${1#*=} ;;
    *) die_usage "bench does not know '$1'." ;;
    esac
    shift || die_usage "an option of bench lacks its value."
done

need_packages "build and run the benchmarks" play test
build_targets on orv_bench
"$ORV_ROOT/tests/media/make-media.sh" "$ORV_BUILD/media" feature.mkv tone-s16le.pcm
use_utf8
say "these figures are this machine's: compare those of one run with each other"
exec "$ORV_BUILD/bin/orv_bench" ${filter:+"--benchmark_filter=$filter"}
