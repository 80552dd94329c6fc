# SPDX-License-Identifier: Apache-2.0
# shellcheck shell=bash
# help: doctor [--engine LIB | --classes JAR | --tree DIR] [--report [FILE]]    what this machine, an engine library, the Java classes or a platform tree lack; --report writes it and more to FILE (orv-report.txt), without personal data, with any of the others
use packages java libraries doctor

# What the answers need.
need_for() {
    case $1 in
    --engine) need_packages "look into libraries" inspect ;;
    --classes) need_packages "look into classes" inspect ;;
    --tree) need_packages "compile against platform trees" tree ;;
    esac
}

# ask OPTION VALUE
ask() {
    need_for "$1"
    case $1 in
    --engine) "$ORV_ROOT/tools/inspect/engine.py" check "$2" "$ORV_ROOT/abi" ;;
    --classes) "$ORV_ROOT/tools/inspect/classes.py" "$2" "$ORV_ROOT/abi/java.txt" ;;
    --tree) "$ORV_ROOT/tools/inspect/tree.py" "$2" "$ORV_ROOT" ;;
    esac
}

questions=()
report=
while [ $# -gt 0 ]; do
    case $1 in
    --engine | --classes | --tree)
        [ $# -gt 1 ] || die_usage "$1 of doctor lacks its value."
        questions+=("$1" "$2")
        shift 2
        ;;
    --report)
        [ -z "$report" ] || die_usage "doctor makes one report."
        report=orv-report.txt
        shift
        case ${1:---} in --*) ;; *) report=$1 && shift ;; esac
        ;;
    *) die_usage "doctor does not know '$1'." ;;
    esac
done

if [ -n "$report" ]; then
    need_packages "write a report" report
    for ((i = 0; i < ${#questions[@]}; i += 2)); do need_for "${questions[i]}"; done
    exec "$ORV_ROOT/tools/doctor/report.py" "$ORV_ROOT" "$ORV_BUILD" "$report" "${questions[@]}"
fi
case ${#questions[@]} in
0) check_machine ;;
2) ask "${questions[@]}" ;;
*) die_usage "doctor takes nothing, or --engine LIB, or --classes JAR, or --tree DIR; several only with --report." ;;
esac
