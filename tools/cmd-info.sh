# SPDX-License-Identifier: Apache-2.0
# shellcheck shell=bash
# help: info [--json] FILE|URL       container, duration, tracks, chapters and metadata
use player
run_player info "$@"
