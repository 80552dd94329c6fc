# SPDX-License-Identifier: Apache-2.0
# shellcheck shell=bash
# help: counts [--accept]            instructions of the library's hottest paths, and what the ARM library costs, against tests/counts/counts.txt; --accept records them
use packages build

mode=check
case ${1:-} in
'') ;;
--accept) mode=accept ;;
*) die_usage "counts does not know '$1'." ;;
esac

need_packages "count instructions" play test armhf
build_targets on orv_counts
"$ORV_ROOT/tools/armhf-build" mediaplayer_orv

held=$ORV_ROOT/tests/counts/counts.txt
failed=
# count WHAT…: where nothing is held of this compiler, that was said.
count() {
    local status=0
    "$ORV_ROOT/tools/counts/counts.py" "$mode" "$held" "$@" || status=$?
    [ "$status" = 0 ] || [ "$status" = 77 ] || failed=yes
}

count paths "$ORV_BUILD/bin/orv_counts" "$ORV_BUILD/lib/libcounted_product.so"
count library "$ORV_BUILD/armhf/lib/libmediaplayer_orv.so"
if [ "$mode" = accept ] && [ -z "$failed" ]; then
    say "tests/counts/counts.txt now holds what was counted; git diff shows the change." \
        "What it holds of other compilers is as it was: run this with them, too."
fi
[ -z "$failed" ]
