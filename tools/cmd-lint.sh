# SPDX-License-Identifier: Apache-2.0
# shellcheck shell=bash
# help: lint                         clang-format, clang-tidy and shellcheck over everything
use packages build lint
need_packages "check the sources" play test
build_targets on all
lint_everything
