# SPDX-License-Identifier: Apache-2.0
# shellcheck shell=bash
# help: help                         this list
printf 'Usage: ./orv COMMAND [OPTIONS]\n\n'
sed -n 's/^# help: /  /p' "$ORV_ROOT"/tools/cmd-{play,info,thumbnail,cover}.sh
printf '\n'
for script in "$ORV_ROOT"/tools/cmd-*.sh; do
    case $script in */cmd-play.sh | */cmd-info.sh | */cmd-thumbnail.sh | */cmd-cover.sh) continue ;; esac
    sed -n 's/^# help: /  /p' "$script"
done
cat <<'END'

Each installs the Debian packages that it lacks (through sudo unless root) and
builds what has changed before it starts. ./orv play --help lists its options.

Environment:
  ORV_BUILD=DIR      build there instead of build/
  ORV_NO_INSTALL=1   never install packages
END
