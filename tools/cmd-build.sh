# SPDX-License-Identifier: Apache-2.0
# shellcheck shell=bash
# help: build [TARGET...]              builds everything, or those targets, into build/
use packages build
need_packages "build everything with its tests" play test
build_targets on "${@:-all}"
