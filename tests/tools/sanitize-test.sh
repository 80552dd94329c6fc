#!/usr/bin/env bash
# SPDX-License-Identifier: Apache-2.0
# ./orv test --sanitize with stand-ins for the build and for ctest: what a sanitizer
# reports is a failure, also where every test passes.
set -euo pipefail

root=$(dirname -- "$(dirname -- "$(dirname -- "$(readlink -f -- "$0")")")")
folder=$(mktemp -d)
trap 'rm -rf -- "$folder"' EXIT
mkdir "$folder/bin" "$folder/build"
export ORV_BUILD=$folder/build ORV_NO_INSTALL=1
PATH=$folder/bin:$PATH
failures=0

for tool in cmake ninja pkg-config; do
    printf '#!/bin/sh\n' >"$folder/bin/$tool"
done
cat >"$folder/bin/ctest" <<END
#!/bin/bash
printf '%s\n' "\$@" >"$folder/arguments"
report=\${ASAN_OPTIONS#*log_path=}
[ -z "\${REPORT:-}" ] || echo "\$REPORT" >"\${report%%:*}.1"
exit "\${STATUS:-0}"
END
chmod +x "$folder"/bin/*

# expect WHAT STATUS TEXT ARGUMENTS…: TEXT stands in what ./orv test --sanitize says.
expect() {
    local what=$1 expected=$2 text=$3 status=0
    shift 3
    "$root/orv" test --sanitize "$@" >"$folder/said" 2>&1 </dev/null || status=$?
    if [ "$status" != "$expected" ] || ! grep -qF -- "$text" "$folder/said"; then
        echo "FAILED $what: status $status for $expected, or it does not say '$text':"
        cat "$folder/said"
        failures=$((failures + 1))
    fi
}

passes() {
    grep -qxF -- "$1" "$folder/arguments" && return
    echo "FAILED: ctest does not get $1"
    failures=$((failures + 1))
}

expect "no report" 0 "" --short
passes '^short$'
STATUS=8 expect "a failed test" 8 "" --short
REPORT='SUMMARY: AddressSanitizer: heap-use-after-free' expect "a report" 1 \
    "AddressSanitizer: heap-use-after-free" --short
# The report of another time is none of this one.
expect "a report of before" 0 "" --filter TrackTable
passes TrackTable
[ "$failures" = 0 ]
