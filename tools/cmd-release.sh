# SPDX-License-Identifier: Apache-2.0
# shellcheck shell=bash
# help: release --dry-run | -o FOLDER [--only STEPS] [--skip STEPS] [--key KEY]    what a release needs, step by step, and what of it is missing; -o makes its files; --help lists the steps
use packages

need_packages "check and sign releases" release
exec "$ORV_ROOT/tools/release/release.py" --root "$ORV_ROOT" --build "$ORV_BUILD" "$@"
