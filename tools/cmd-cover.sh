# SPDX-License-Identifier: Apache-2.0
# shellcheck shell=bash
# help: cover FILE OUT               the embedded picture, byte for byte
use player
run_player cover "$@"
