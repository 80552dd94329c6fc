# SPDX-License-Identifier: Apache-2.0
# shellcheck shell=bash
# help: help    this list

# The help lines of those commands: what to write, then what it does.
describe() {
    local name
    for name in "$@"; do
        sed -n 's/^# help: //p' "$ORV_ROOT/tools/cmd-$name.sh"
    done | awk -F '  +' '
        length($1) <= 34 { printf "  %-34s  %s\n", $1, $2; next }
        { printf "  %s\n  %-34s  %s\n", $1, "", $2 }'
}

readonly PLAYER_COMMANDS='play info thumbnail cover'
other_commands() {
    local script name
    for script in "$ORV_ROOT"/tools/cmd-*.sh; do
        name=$(basename -- "${script#*cmd-}" .sh)
        case " $PLAYER_COMMANDS " in *" $name "*) ;; *) printf '%s\n' "$name" ;; esac
    done
}

printf 'Usage: ./orv COMMAND [OPTIONS]\n\n'
# shellcheck disable=SC2086
describe $PLAYER_COMMANDS
printf '\n'
# shellcheck disable=SC2046
describe $(other_commands)
cat <<'END'

Each installs the Debian packages that it lacks (through sudo unless root) and
builds what has changed before it starts. ./orv play --help lists its options.

Environment:
  ORV_BUILD=DIR      build there instead of build/
  ORV_NO_INSTALL=1   never install packages
END
