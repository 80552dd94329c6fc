# SPDX-License-Identifier: Apache-2.0
# shellcheck shell=bash
# help: mutate [--area product|engine|java] [--sample N --seed S] [--since REV] [--list]    changes the code in one small place at a time, and reports which changes no test notices
use packages build

options=("$@")
area=all
while [ $# -gt 0 ]; do
    case $1 in
    --area) area=${2:-} && shift ;;
    --area=*) area=${1#*=} ;;
    --sample | --seed | --since | --filter | --resume | --jobs) shift ;;
    --sample=* | --seed=* | --since=* | --filter=* | --resume=* | --jobs=* | --list) ;;
    -h | --help) exec "$ORV_ROOT/tools/mutate/mutate.py" --help ;;
    *) die_usage "mutate does not know '$1'." ;;
    esac
    shift || die_usage "an option of mutate lacks its value."
done

need_packages "change the code and run its tests" play test mutate
case $area in
product) targets=(contract_tests) ;;
engine) targets=(engine_tests) ;;
java) targets=(orv_jvm_tests) ;;
all) targets=(contract_tests engine_tests orv_jvm_tests) ;;
*) die_usage "--area is product, engine, java or all, not '$area'." ;;
esac
build_targets on "${targets[@]}"
[ "$area" = product ] || run_logged "$ORV_BUILD/log/media.log" \
    "$ORV_ROOT/tests/media/make-media.sh" "$ORV_BUILD/media" ||
    die "the tests' media could not be made."
exec "$ORV_ROOT/tools/mutate/mutate.py" --root "$ORV_ROOT" --build "$ORV_BUILD" \
    --java-home "$JAVA_HOME" "${options[@]}"
