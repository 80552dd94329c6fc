# SPDX-License-Identifier: Apache-2.0
# shellcheck shell=bash
# help: version                      this project's version, and those of mpv and FFmpeg; also --version
use version

[ $# -eq 0 ] || die_usage "version takes nothing, not '$1'."
echo "orv $(product_version)"
mpv_line
ffmpeg_line
build_line
