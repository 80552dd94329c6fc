# SPDX-License-Identifier: Apache-2.0
# shellcheck shell=bash
# help: trace [-o TRACE.json] [--html PAGE] [--live] LOG...   how long the native methods took, from a log
use packages trace
need_packages "build the reader of logs" trace
build_trace
exec "$ORV_BUILD/trace/bin/orv-trace" "$@"
