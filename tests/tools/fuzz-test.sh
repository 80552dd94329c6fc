#!/usr/bin/env bash
# SPDX-License-Identifier: Apache-2.0
# ./orv fuzz with a stand-in for the build and for a target: its list, wrong
# arguments, what it prints of a run, and what becomes of a finding.
set -euo pipefail

source=$(dirname -- "$(dirname -- "$(dirname -- "$(readlink -f -- "$0")")")")
folder=$(mktemp -d)
trap 'rm -rf -- "$folder"' EXIT
# Findings are written into the checkout: it is a copy.
root=$folder/checkout
mkdir -p "$root/fuzz/corpus" "$folder/bin" "$folder/build/asan/bin"
cp -r "$source/orv" "$source/tools" "$root"
cp "$source"/fuzz/*Fuzzer.cpp "$root/fuzz"
for target in "$root"/fuzz/*Fuzzer.cpp; do
    mkdir "$root/fuzz/corpus/$(basename -- "$target" .cpp)"
done
export ORV_BUILD=$folder/build ORV_NO_INSTALL=1
PATH=$folder/bin:$PATH
failures=0

for tool in cmake ninja pkg-config; do
    printf '#!/bin/sh\n' >"$folder/bin/$tool"
    chmod +x "$folder/bin/$tool"
done

# stand_in STATUS: a target that says what libFuzzer says, and has found something
# unless STATUS is 0.
stand_in() {
    cat >"$folder/build/asan/bin/PcmFuzzer" <<END
#!/bin/bash
printf '%s\n' "\$@" >"$folder/arguments"
echo '#2 INITED cov: 41 ft: 2 corp: 1/1b'
echo '#9 NEW cov: 123 ft: 2 corp: 1/1b'
echo 'stat::number_of_executed_units: 4567'
[ $1 = 0 ] && exit 0
echo 'broken: the sky is up'
for argument; do
    case \$argument in -artifact_prefix=*) echo input >"\${argument#*=}crash-1" ;; esac
done
exit $1
END
    chmod +x "$folder/build/asan/bin/PcmFuzzer"
}

# expect WHAT STATUS TEXT ARGUMENTS…: TEXT stands in what ./orv fuzz says of them.
expect() {
    local what=$1 expected=$2 text=$3 status=0
    shift 3
    "$root/orv" fuzz "$@" >"$folder/said" 2>&1 </dev/null || status=$?
    if [ "$status" != "$expected" ] || ! grep -qF -- "$text" "$folder/said"; then
        echo "FAILED $what: status $status for $expected, or it does not say '$text':"
        cat "$folder/said"
        failures=$((failures + 1))
    fi
}

passes() {
    grep -qxF -- "$1" "$folder/arguments" && return
    echo "FAILED: the target does not get $1"
    failures=$((failures + 1))
}

expect "no arguments" 0 "  PcmFuzzer               The description of a raw PCM stream"
expect "another target" 2 "there is no fuzz target 'Nope'; ./orv fuzz lists them." Nope
expect "two targets" 2 "fuzz takes one target, not 'PcmFuzzer' and 'EventFuzzer'." PcmFuzzer EventFuzzer
expect "a target and all" 2 "fuzz takes --all or a target, not both." --all PcmFuzzer
expect "another option" 2 "fuzz does not know '--fast'." --fast
expect "a time that is no number" 2 "--time of fuzz is a whole number from 1 on, not 'soon'." --time soon
expect "no time at all" 2 "--time of fuzz is a whole number from 1 on, not '0'." --time=0
expect "an option without its value" 2 "--runs of fuzz is a whole number from 1 on, not ''." PcmFuzzer --runs

stand_in 0
expect "a run" 0 "4567 runs     123 places covered" PcmFuzzer --time 7 --seed=3
passes -max_total_time=7
passes -seed=3
expect "runs without a time" 0 "4567 runs" PcmFuzzer --runs 9
passes -runs=9
if grep -q max_total_time "$folder/arguments"; then
    echo "FAILED: a number of runs has a time, too"
    failures=$((failures + 1))
fi

count=0
for target in "$root"/fuzz/*Fuzzer.cpp; do
    name=$(basename -- "$target" .cpp)
    [ "$name" = PcmFuzzer ] || cp "$folder/build/asan/bin/PcmFuzzer" "$folder/build/asan/bin/$name"
    count=$((count + 1))
done
expect "all targets" 0 "$(printf '%-22s  %12s runs  in ' "$count targets" $((4567 * count)))" --all
passes -max_total_time=60
[ "$(grep -c ' runs  ' "$folder/said")" = $((count + 1)) ] || {
    echo "FAILED: not one line for each target and one for all:"
    cat "$folder/said"
    failures=$((failures + 1))
}

stand_in 77
expect "a finding" 1 "broken: the sky is up" PcmFuzzer
seed=$(sed -n 's/.*found: \([^,]*\),.*/\1/p' "$folder/said")
if [ "$(cat "$root/${seed:-none}")" != input ]; then
    echo "FAILED: the finding is no seed"
    failures=$((failures + 1))
fi
[ "$failures" = 0 ]
