# SPDX-License-Identifier: Apache-2.0
# shellcheck shell=bash
# help: size                         size, relocations and start-up work of the ARM library
use packages

need_packages "build for ARM and look into libraries" play test armhf
"$ORV_ROOT/tools/armhf-build" mediaplayer_orv
# The budget of tests/abi/CMakeLists.txt.
"$ORV_ROOT/tools/inspect/size.py" "$ORV_BUILD/armhf/lib/libmediaplayer_orv.so" \
    --budget "$(sed -n 's/^set(ORV_SIZE_BUDGET \([0-9]*\))$/\1/p' "$ORV_ROOT/tests/abi/CMakeLists.txt")"
