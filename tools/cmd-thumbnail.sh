# SPDX-License-Identifier: Apache-2.0
# shellcheck shell=bash
# help: thumbnail FILE [--at SECONDS] [--size WxH] OUT.png    one picture of the video
use player
run_player thumbnail "$@"
