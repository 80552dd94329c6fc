# SPDX-License-Identifier: Apache-2.0
# shellcheck shell=bash
# help: play [OPTIONS] [FILE|URL]    play it in a window, or in the terminal where there is no display
use player
run_player play "$@"
