# SPDX-License-Identifier: Apache-2.0
# shellcheck shell=bash
# help: abi [--accept]               compares the exported interface with abi/, on both architectures, and the public Java API; --accept records it
use packages build

mode=check
case ${1:-} in
'') ;;
--accept) mode=accept ;;
*) die_usage "abi does not know '$1'." ;;
esac

need_packages "compare interfaces" play test armhf
build_targets on mediaplayer_orv orvtarn contract_tests java_modules
"$ORV_ROOT/tools/armhf-build" mediaplayer_orv orvtarn

# list_engine_needs BUILD: what the product built there needs of an engine.
list_engine_needs() {
    "$ORV_ROOT/tools/inspect/engine.py" list "$1/lib/libmediaplayer_orv.so" "$1/lib/liborvtarn.so"
}

failed=
for target in "$ORV_BUILD" "$ORV_BUILD/armhf"; do
    "$ORV_ROOT/tools/abi" "$mode" "$target/lib/libmediaplayer_orv.so" || failed=yes
done
"$ORV_ROOT/tools/inspect/java_api.py" "$mode" "$ORV_BUILD/java/modules.txt" \
    "$ORV_ROOT/abi/java-api.txt" --java "$JAVA_HOME/bin/java" || failed=yes
if [ "$mode" = accept ]; then
    list_engine_needs "$ORV_BUILD" >"$ORV_ROOT/abi/engine.x86_64.txt"
    list_engine_needs "$ORV_BUILD/armhf" >"$ORV_ROOT/abi/engine.armhf.txt"
    ORV_ACCEPT_ABI=1 run_logged "$ORV_BUILD/log/java-members.log" \
        "$ORV_BUILD/bin/contract_tests" --gtest_filter='JavaMembersTest.*' ||
        die "the library's lookups in Java could not be listed."
    say "abi/ now describes what was built; git diff abi shows the change."
fi
[ -z "$failed" ]
