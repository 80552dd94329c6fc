# SPDX-License-Identifier: Apache-2.0
# shellcheck shell=bash
# help: engine-test LIB [--address URL] [--filter REGEX]    runs the engine suite against an engine library, of this machine or of 32-bit ARM in the emulator, and says operation by operation what holds
use packages build

readonly LIMIT=60 EMULATED_LIMIT=240

usage() {
    cat <<END
Usage: ./orv engine-test LIB [OPTIONS]

Runs the tests of tests/engine-kit against an engine library, each in a process of
its own, and prints for each operation of its header which sentences hold: pass,
FAIL, or not offered where the engine refuses as the header says. See docs/engine.md.

  --address URL    what stands in for the film: seekable media with a picture, eight
                   seconds or more, a key frame every two
  --media FOLDER   where the media are, instead of making them
  --filter REGEX   rows whose operation or test matches
  --limit SECONDS  after which a row hangs ($LIMIT; $EMULATED_LIMIT in the emulator)
  --jobs N         rows at a time (as many as there are processors, four at most)
  --json FILE      also writes the results there, as JSON
  --junit FILE     or as JUnit's XML

Exit status: 0 when no row fails, 1 when one does, 2 when LIB or an argument is unfit.
END
}

# check_number OPTION VALUE
check_number() {
    [[ $2 =~ ^[1-9][0-9]{0,4}$ ]] ||
        die_usage "$1 of engine-test is a whole number from 1 on, not '$2'."
}

library=
media=
limit=
options=()
[ $# -gt 0 ] || { usage >&2 && exit 2; }
while [ $# -gt 0 ]; do
    case $1 in
    --help | -h) usage && exit ;;
    --*=*)
        set -- "${1%%=*}" "${1#*=}" "${@:2}"
        continue
        ;;
    --address | --filter | --json | --junit) options+=("$1=${2:-}") ;;
    --jobs) check_number "$1" "${2:-}" && options+=("$1=$2") ;;
    --limit) check_number "$1" "${2:-}" && limit=$2 ;;
    --media) media=${2:-} ;;
    -*) die_usage "engine-test does not know '$1'." ;;
    *)
        [ -z "$library" ] || die_usage "engine-test takes one library, not '$library' and '$1'."
        library=$1
        shift
        continue
        ;;
    esac
    [ -n "${2:-}" ] || die_usage "$1 of engine-test lacks its value."
    shift 2
done
[ -n "$library" ] || die_usage "engine-test lacks the engine's library."

need_packages "look into libraries" inspect
tool=$ORV_ROOT/tools/engine-test/engine_test.py
machine=$("$tool" machine "$library") || exit

folder=$ORV_BUILD
if [ "$machine" = armhf ]; then
    "$ORV_ROOT/tools/armhf-build" engine_kit
    folder=$ORV_BUILD/armhf
    limit=${limit:-$EMULATED_LIMIT}
else
    need_packages "build the tests" play test
    build_targets on engine_kit
fi
if [ -z "$media" ]; then
    media=$ORV_BUILD/media
    mapfile -t names <"$ORV_ROOT/tests/engine-kit/media.txt"
    run_logged "$ORV_BUILD/log/media.log" "$ORV_ROOT/tests/media/make-media.sh" "$media" \
        "${names[@]}" || die "the media of the tests could not be made."
fi
exec "$tool" run "$library" --kit "$folder/engine-kit.json" --media "$media" \
    --limit "${limit:-$LIMIT}" "${options[@]}"
