# SPDX-License-Identifier: Apache-2.0
# shellcheck shell=bash
# help: doctor [--engine LIB | --classes JAR | --tree DIR]    what this machine, an engine library, the Java classes or a platform tree lack
use packages java libraries doctor

case $# in
0) check_machine ;;
2)
    case $1 in
    --engine)
        need_packages "look into libraries" inspect
        "$ORV_ROOT/tools/inspect/engine.py" check "$2" "$ORV_ROOT/abi"
        ;;
    --classes)
        need_packages "look into classes" inspect
        "$ORV_ROOT/tools/inspect/classes.py" "$2" "$ORV_ROOT/abi/java.txt"
        ;;
    --tree)
        need_packages "compile against platform trees" tree
        "$ORV_ROOT/tools/inspect/tree.py" "$2" "$ORV_ROOT"
        ;;
    *) die_usage "doctor does not know '$1'." ;;
    esac
    ;;
*) die_usage "doctor takes nothing, or --engine LIB, or --classes JAR, or --tree DIR." ;;
esac
