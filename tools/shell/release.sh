# SPDX-License-Identifier: Apache-2.0
# shellcheck shell=bash
# Which systems ./orv installs packages on, and what differs between them.

# supported_releases: names, oldest first.
supported_releases() { awk '!/^#/ {print $1}' "$ORV_ROOT/tools/releases.txt"; }

# "12 and 13"
supported_numbers() { awk '!/^#/ {print $2}' "$ORV_ROOT/tools/releases.txt" | paste -sd, | sed 's/,/ and /g'; }

# release_value NAME COLUMN: the value of one column; for a release that
# is not listed those of the newest.
release_value() {
    awk -v name="$1" -v column="$2" '
        $1 == "#" && $2 == "name" { for (i = 2; i <= NF; i++) at[$i] = i - 1 }
        /^#/ { next }
        { value = $at[column] }
        $1 == name { exit }
        END { print value }' "$ORV_ROOT/tools/releases.txt"
}

# This machine's, such as bookworm; nothing where it has no name.
this_release() { os_release VERSION_CODENAME; }

# Its name for people, such as "Debian GNU/Linux 12 (bookworm)".
this_system() { os_release PRETTY_NAME; }

os_release() {
    # shellcheck disable=SC1090,SC1091
    (. "${ORV_OS_RELEASE:-/etc/os-release}" 2>/dev/null && printf '%s\n' "${!1:-}") || true
}

is_supported_release() {
    [ "$(os_release ID)" = debian ] && supported_releases | grep -qx -- "$(this_release)"
}
