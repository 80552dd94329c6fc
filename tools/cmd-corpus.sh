# SPDX-License-Identifier: Apache-2.0
# shellcheck shell=bash
# help: corpus DIR [--report OUT]    plays, describes and pictures every file below a folder, and lists what differs from ffprobe and ffmpeg, worst first
use player
use packages
need_packages "compare with other programs" corpus
prepare_player
exec "$ORV_ROOT/tools/corpus/corpus.py" "$@" -- "${JAVA_COMMAND[@]}"
