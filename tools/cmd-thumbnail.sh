# SPDX-License-Identifier: Apache-2.0
# shellcheck shell=bash
# help: thumbnail FILE [--at SECONDS] [--sheet CxR] [--size WxH|full] OUT.png    one picture of the video, or a sheet of pictures from all over it
use player
run_player thumbnail "$@"
