# SPDX-License-Identifier: Apache-2.0
# shellcheck shell=bash
# help: trace-contract [METHOD…] [--accept]  what native methods do, step by step, as the tests hold it; --accept writes down what they do now
use packages build

accept=
methods=()
while [ $# -gt 0 ]; do
    case $1 in
    --accept) accept=yes ;;
    -*) die_usage "trace-contract does not know '$1'." ;;
    *) methods+=("$1") ;;
    esac
    shift
done

traces=$ORV_ROOT/tests/contract/traces
if [ -n "$accept" ]; then
    need_packages "trace the native methods" play test
    build_targets on contract_tests
    (cd "$ORV_BUILD/tests/contract" && ORV_ACCEPT_TRACES=1 "$ORV_BUILD/bin/contract_tests" --gtest_brief=1)
    say "tests/contract/traces now holds what the native methods do; git diff shows the change."
fi
need_packages "print traces" play
"$ORV_ROOT/tools/inspect/traces.py" "$traces" "${methods[@]}"
