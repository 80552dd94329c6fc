
# SPDX-License-Identifier: Apache-2.0
# orv trace is a program of its own.
_complete_orv_and_trace() {
    local word=${COMP_WORDS[COMP_CWORD]} before=${COMP_WORDS[COMP_CWORD - 1]}
    if [ "$COMP_CWORD" -le 1 ] || [ "${COMP_WORDS[1]}" != trace ]; then
        _complete_orv
        [ "$COMP_CWORD" -ne 1 ] || mapfile -t -O "${#COMPREPLY[@]}" COMPREPLY < <(compgen -W trace -- "$word")
        return
    fi
    COMPREPLY=()
    case $before in -o | --output | --html) return ;; esac
    case $word in
    -*) mapfile -t COMPREPLY < <(compgen -W "-o --output --html --live -h --help" -- "$word") ;;
    esac
}
complete -F _complete_orv_and_trace -o default orv
