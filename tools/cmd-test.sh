# SPDX-License-Identifier: Apache-2.0
# shellcheck shell=bash
# help: test [--target native|armhf|all | --release NAME | --sanitize] [--filter REGEX] [--no-lint]    every test; a filter runs those whose names match, natively unless a target is given; --release plays and tests in a root of that Debian release; --sanitize runs the C++ tests and the fuzz targets' seeds with the address, leak and undefined-behaviour sanitizers
use packages build lint preset

target=
release=
filter=
with_lint=yes
sanitize=
while [ $# -gt 0 ]; do
    case $1 in
    --target) target=${2:-} && shift ;;
    --target=*) target=${1#*=} ;;
    --release) release=${2:-} && shift ;;
    --release=*) release=${1#*=} ;;
    --filter) filter=${2:-} && shift ;;
    --filter=*) filter=${1#*=} ;;
    --no-lint) with_lint= ;;
    --sanitize) sanitize=yes ;;
    *) die_usage "test does not know '$1'." ;;
    esac
    shift || die_usage "an option of test lacks its value."
done

# Media plays in real time: on a busy machine a test may miss its moment, and is
# run once more. ctest shows both runs. Many tests wait more than they compute, so one
# more than there are processors runs at a time.
test_native() {
    need_packages "build and test" play test tree maven
    build_targets on all
    [ -z "$with_lint" ] || [ -n "$filter" ] || lint_everything
    on_some_display ctest --test-dir "$ORV_BUILD" --output-on-failure --no-tests=error \
        --repeat until-pass:2 --parallel "$(($(nproc) + 1))" \
        ${filter:+--tests-regex "$filter"}
}

# No Java: a virtual machine's own memory is beyond these sanitizers.
test_sanitized() {
    need_packages "build and test" play test
    build_preset asan all
    LSAN_OPTIONS=suppressions=$ORV_ROOT/cmake/lsan.supp:print_suppressions=0 \
        UBSAN_OPTIONS=halt_on_error=1:print_stacktrace=1 on_some_display \
        ctest --test-dir "$(preset_folder asan)" --output-on-failure --no-tests=error \
        --repeat until-pass:2 --parallel "$(($(nproc) + 1))" \
        --exclude-regex '^tools\.' ${filter:+--tests-regex "$filter"}
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
    test_sanitized
    exit
fi

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
