# SPDX-License-Identifier: Apache-2.0
# shellcheck shell=bash
# help: package maven|deb [OPTIONS]    what other programs depend on: a Maven repository in build/maven, or Debian packages; --help lists the options
kind=${1:-}
[ $# -eq 0 ] || shift
case $kind in
maven | deb) ;;
*) die_usage "package makes maven or deb, not '$kind'." ;;
esac

[ -x "$ORV_ROOT/tools/package/$kind" ] || die "this checkout cannot make packages for $kind: it lacks tools/package/$kind."
exec "$ORV_ROOT/tools/package/$kind" "$@"
