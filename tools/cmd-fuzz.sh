# SPDX-License-Identifier: Apache-2.0
# shellcheck shell=bash
# help: fuzz [NAME | --all] [--time SECONDS] [--runs N] [--seed N]    looks for inputs that crash or break a promise: of target NAME, or of all, one a processor at a time, SECONDS (60) each; prints a line for each target and the sum of the runs; without arguments lists the targets
use packages preset

readonly USUAL_TIME=60
name=
all=
declare -A limits=()

# A target's comment, up to its first full stop.
describe_targets() {
    local source
    for source in "$ORV_ROOT"/fuzz/*Fuzzer.cpp; do
        printf '  %-22s  %s\n' "$(basename -- "$source" .cpp)" \
            "$(sed -n '3,/\./s|^// *||p' "$source" | tr '\n' ' ' | sed 's/\..*//')"
    done
}

all_targets() { describe_targets | awk '{print $1}'; }

# take_limit OPTION VALUE
take_limit() {
    [[ ${2:-} =~ ^[1-9][0-9]{0,8}$ ]] ||
        die_usage "--$1 of fuzz is a whole number from 1 on, not '${2:-}'."
    limits[$1]=$2
}

while [ $# -gt 0 ]; do
    case $1 in
    --time | --runs | --seed) take_limit "${1#--}" "${2:-}" && shift ;;
    --time=* | --runs=* | --seed=*) take_limit "$(expr "$1" : '--\([a-z]*\)')" "${1#*=}" ;;
    --all) all=yes ;;
    --help) name= && all= && limits=() && break ;;
    -*) die_usage "fuzz does not know '$1'." ;;
    *)
        [ -z "$name" ] || die_usage "fuzz takes one target, not '$name' and '$1'."
        name=$1
        ;;
    esac
    shift
done
[ -z "$name" ] || all_targets | grep -qxF -- "$name" ||
    die_usage "there is no fuzz target '$name'; ./orv fuzz lists them."
[ -z "$name" ] || [ -z "$all" ] || die_usage "fuzz takes --all or a target, not both."
if [ -z "$name$all" ] && [ ${#limits[@]} = 0 ]; then
    printf 'Fuzz targets:\n'
    describe_targets
    exit 0
fi

folder=$(preset_folder asan)

# libFuzzer's options of a target.
fuzzer_options() {
    local target=$1
    printf '%s\n' -print_final_stats=1 -timeout=30 -detect_leaks=0 -rss_limit_mb=3000 -report_slow_units=1000 \
        "-artifact_prefix=$found/$target-" "-dict=$ORV_ROOT/fuzz/$target.dict"
    [ -z "${limits[runs]:-}" ] || printf -- '-runs=%s\n' "${limits[runs]}"
    [ -z "${limits[seed]:-}" ] || printf -- '-seed=%s\n' "${limits[seed]}"
    [ -n "${limits[runs]:-}" ] && [ -z "${limits[time]:-}" ] ||
        printf -- '-max_total_time=%s\n' "${limits[time]:-$USUAL_TIME}"
}

# What was found to reach new code stays in grown/, for the next time.
fuzz_target() {
    local target=$1 status=0 options
    mkdir -p -- "$folder/grown/$target"
    mapfile -t options < <(fuzzer_options "$target")
    "$folder/bin/$target" "${options[@]}" "$folder/grown/$target" \
        "$ORV_ROOT/fuzz/corpus/$target" >"$ORV_BUILD/log/fuzz-$target.log" 2>&1 </dev/null ||
        status=$?
    report_target "$target" "$status"
}

# runs_of TARGET…: the runs of them together, in this call.
runs_of() {
    local target
    for target; do
        sed -n 's/^stat::number_of_executed_units: *//p' "$ORV_BUILD/log/fuzz-$target.log"
    done | awk '{ sum += $1 } END { print sum + 0 }'
}

# report_target TARGET STATUS: the line of a target, and its findings.
report_target() {
    local target=$1 log=$ORV_BUILD/log/fuzz-$1.log
    awk -v target="$target" -v runs="$(runs_of "$target")" '
        match($0, / cov: [0-9]+/) { cover = substr($0, RSTART + 6, RLENGTH - 6) }
        END { printf "%-22s  %12s runs  %6s places covered\n", target, runs, cover + 0 }' "$log"
    [ "$2" != 0 ] || return 0
    grep -m 1 -E '^broken: |^SUMMARY: |ERROR: |runtime error: ' "$log" | sed 's/^/    /' || true
    keep_findings "$target" || printf '    it ended with status %s; see %s\n' "$2" "$log"
    return 1
}

# The input becomes a seed, which the tests replay: they fail until its cause is mended.
keep_findings() {
    local input seed status=1
    for input in "$found/$1"-*; do
        # Empty for a leak that is found at the end, of no one input.
        [ -s "$input" ] || continue
        seed=fuzz/corpus/$1/found-$(sha256sum <"$input" | cut -c 1-10)
        mv -- "$input" "$ORV_ROOT/$seed"
        printf '    found: %s, which is a seed of the tests now; to see it again: %s %s\n' \
            "$seed" "$folder/bin/$1" "$seed"
        status=0
    done
    return "$status"
}

need_packages "fuzz" play test fuzz
mapfile -t targets < <(if [ -n "$name" ]; then printf '%s\n' "$name"; else all_targets; fi)
build_preset asan "${targets[@]}"
found=$(mktemp -d)
trap 'rm -rf -- "$found"' EXIT

started=$SECONDS
failed=
running=0
for target in "${targets[@]}"; do
    if [ "$running" -ge "$(nproc)" ]; then
        wait -n || failed=yes
        running=$((running - 1))
    fi
    fuzz_target "$target" &
    running=$((running + 1))
done
while [ "$running" -gt 0 ]; do
    wait -n || failed=yes
    running=$((running - 1))
done
[ ${#targets[@]} = 1 ] ||
    printf '%-22s  %12s runs  in %s s\n' "${#targets[@]} targets" "$(runs_of "${targets[@]}")" "$((SECONDS - started))"
[ -z "$failed" ]
