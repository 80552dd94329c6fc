# SPDX-License-Identifier: Apache-2.0
# shellcheck shell=bash
# help: test [--target native|armhf|all | --release NAME | --sanitize [thread] [--short]] [--filter REGEX] [--no-lint]    every test; a filter runs those whose names match, natively unless a target is given; --release plays and tests in a root of that Debian release; --sanitize runs the C++ tests and the fuzz targets' seeds with the address, leak and undefined-behaviour sanitizers, or with the thread sanitizer; --short leaves out the engine's
use packages build lint preset

target=
release=
filter=
again=
with_lint=yes
sanitize=
short=
while [ $# -gt 0 ]; do
    case $1 in
    --target) target=${2:-} && shift ;;
    --target=*) target=${1#*=} ;;
    --release) release=${2:-} && shift ;;
    --release=*) release=${1#*=} ;;
    --filter) filter=${2:-} && shift ;;
    --filter=*) filter=${1#*=} ;;
    --no-lint) with_lint= ;;
    --again) again=yes ;; # Where another release has run the tests that find the same in each.
    --sanitize)
        sanitize=memory
        [ "${2:-}" != thread ] || { sanitize=thread && shift; }
        ;;
    --short) short=yes ;;
    *) die_usage "test does not know '$1'." ;;
    esac
    shift || die_usage "an option of test lacks its value."
done

# Many tests wait more than they compute, so two more than there are processors run at a
# time.
test_native() {
    local once=mutate
    [ -z "$again" ] || once=
    # shellcheck disable=SC2086 # one word or none
    need_packages "build and test" play test tree maven $once
    build_targets on all
    local choice=(--label-exclude '^whole$')
    [ -z "$again" ] || choice=(--label-exclude '^(once|single)$')
    [ -z "$filter" ] || choice=(--label-exclude '^whole$' --tests-regex "$filter")
    [ -z "$with_lint" ] || [ -n "$filter" ] || lint_everything
    on_some_display ctest --test-dir "$ORV_BUILD" --output-on-failure --no-tests=error \
        --parallel "$(($(nproc) + 2))" "${choice[@]}"
}

# No Java: a virtual machine's own memory is beyond these sanitizers. The build is that
# of ./orv fuzz.
test_sanitized() {
    need_packages "build and test" play test fuzz
    if [ -n "$short" ]; then
        build_preset asan orv_short_tests
        ctest_sanitized --label-regex '^short$'
    else
        build_preset asan all
        ctest_sanitized
    fi
}

# What a sanitizer reports is a failure, also of a test that passes when it is repeated.
# Without a filter, tests of one program run by the hundred.
ctest_sanitized() {
    local reports status=0 choice=(--label-exclude '^single$')
    reports=$(preset_folder asan)/reports
    rm -rf -- "$reports" && mkdir -p -- "$reports"
    [ -z "$filter" ] || choice=(--tests-regex "$filter")
    ASAN_OPTIONS=log_path=$reports/asan UBSAN_OPTIONS=log_path=$reports/ubsan:print_stacktrace=1 \
        on_some_display ctest --test-dir "$(preset_folder asan)" --output-on-failure --no-tests=error \
        --parallel "$(($(nproc) + 1))" --exclude-regex '^tools\.' "${choice[@]}" "$@" || status=$?
    [ -n "$(find "$reports" -type f -size +0)" ] || return "$status"
    say "the sanitizers reported, in $reports:"
    cat -- "$reports"/* | grep -E '^SUMMARY|runtime error' | sort | uniq -c >&2
    return 1
}

# The window's tests need a display; a virtual one does where there is none.
on_some_display() {
    if [ -n "${DISPLAY:-}" ]; then
        "$@"
    else
        xvfb-run -a -s '-screen 0 1280x800x24' "$@"
    fi
}

test_armhf() {
    "$ORV_ROOT/tools/armhf-test" ${filter:+--filter "$filter"}
}

if [ -n "$sanitize" ]; then
    [ -z "$release$target" ] ||
        die_usage "--sanitize tests on this machine alone, without --target and --release."
    [ "$sanitize" = memory ] || [ -z "$filter" ] ||
        die_usage "--sanitize thread takes no --filter; tools/sanitize-thread does."
    case $sanitize in
    memory) test_sanitized ;;
    thread) "$ORV_ROOT/tools/sanitize-thread" ${short:+contract platform stress} ;;
    esac
    exit
fi

[ -z "$short" ] || die_usage "--short goes with --sanitize alone."

[ -z "$release" ] || exec "$ORV_ROOT/tools/release-test" "$release" \
    ${filter:+--filter "$filter"} ${with_lint:---no-lint}

# Some tests are one architecture's alone, and a filter may name just those.
[ -n "$target" ] || { [ -n "$filter" ] && target=native; } || target=all

case $target in
native) test_native ;;
armhf) test_armhf ;;
all)
    test_native
    test_armhf
    ;;
*) die_usage "--target is native, armhf or all, not '$target'." ;;
esac
