# SPDX-License-Identifier: Apache-2.0
# shellcheck shell=bash
# Installs the Debian packages that are missing. The lists are
# tools/packages-NAME.txt: a package a line, then what it is for; # comments.
# @NAME@ stands for what tools/releases.txt says of this machine's release.
use release java

list_packages() {
    local name
    for name in "$@"; do
        read_package_list "$ORV_ROOT/tools/packages-$name.txt"
    done
}

# read_package_list FILE
read_package_list() {
    local column substitutions=()
    for column in jdk gcc clang; do
        substitutions+=(-e "s/@$column@/$(release_value "$(this_release)" $column)/")
    done
    sed -e 's/#.*//' -e '/^[[:space:]]*$/d' "${substitutions[@]}" "$1"
}

# Prints the lines of the lists whose package is not installed: one question
# to dpkg for all of them, as this runs at every start.
missing_packages() {
    local lines names installed
    lines=$(list_packages "$@")
    # Any fit JDK will do, wherever it is from.
    [ -z "$(find_jdk)" ] || lines=$(grep -v '^default-jdk' <<<"$lines")
    mapfile -t names < <(awk '{print $1}' <<<"$lines")
    installed=$(dpkg-query -W -f '${db:Status-Status} ${Package}\n' "${names[@]}" 2>/dev/null || true)
    awk 'NR == FNR { if ($1 == "installed") have[$2] = 1; next } !($1 in have)' \
        <(printf '%s\n' "$installed") - <<<"$lines"
}

# need_packages WHY LIST…: WHY completes "packages needed to …".
need_packages() {
    local why=$1 missing names
    shift
    [ -z "${ORV_NO_INSTALL:-}" ] || return 0
    missing=$(missing_packages "$@")
    [ -n "$missing" ] || return 0
    mapfile -t names < <(awk '{print $1}' <<<"$missing")
    is_supported_release || die \
        "this is $(this_system); ./orv installs packages on Debian $(supported_numbers) alone." \
        "Install in your system's way what Debian calls ${names[*]}, then set ORV_NO_INSTALL=1."
    say "installing ${#names[@]} Debian package(s) needed to $why: $(describe_packages <<<"$missing")"
    install_packages "${names[@]}"
}

# "a (what for), b (what for)"
describe_packages() {
    sed -E 's/^([^ ]+) +(.*[^ ]) *$/\1 (\2)/' | paste -sd, | sed 's/,\([^ ]\)/, \1/g'
}

install_packages() {
    local lists_are_fresh=
    become_root "$@"
    finish_interrupted_installation
    if package_lists_are_old; then
        update_package_lists
        lists_are_fresh=yes
    fi
    apt_get install --no-install-recommends "$@" && return
    # The mirror may have replaced packages since the lists were read.
    [ -z "$lists_are_fresh" ] && update_package_lists &&
        apt_get install --no-install-recommends "$@" && return
    die "Debian's packages could not be installed; the lines above say what apt-get met." \
        "Once that is mended, start ./orv again."
}

# apt-get refuses to go on from there; what dpkg cannot mend, apt-get will report.
finish_interrupted_installation() {
    [ -n "$(find /var/lib/dpkg/updates -name '[0-9]*' -print -quit 2>/dev/null)" ] || return 0
    say "finishing an installation that was interrupted"
    run_logged "$ORV_BUILD/log/dpkg.log" "${AS_ROOT[@]}" env DEBIAN_FRONTEND=noninteractive \
        dpkg --configure -a || true
}

# Sets AS_ROOT to what a command needs in front to run as root.
become_root() {
    AS_ROOT=()
    [ "$(id -u)" -ne 0 ] || return 0
    command -v sudo >/dev/null || die \
        "installing packages needs root, and there is no sudo here. As root: apt-get install --no-install-recommends $*"
    sudo -v || die "sudo did not give root, so nothing was installed." \
        "Whoever has root can do it: apt-get install --no-install-recommends $*"
    AS_ROOT=(sudo)
}

# By ctime: apt gives the files the time that the mirror has for them.
package_lists_are_old() {
    [ -z "$(find /var/lib/apt/lists -maxdepth 1 -name '*_Packages*' -ctime -7 -print -quit 2>/dev/null)" ]
}

# A source of somebody else's may fail without harm: the installation will report it.
update_package_lists() {
    say "reading Debian's package lists"
    apt_get update -o APT::Update::Error-Mode=any || say \
        "not every package list could be read. Is the network up, and are the sources in /etc/apt right?"
}

# The status lines have a descriptor of their own, for apt closes it to the programs
# that it starts: with the standard output's, the installers' scripts would fail.
apt_get() {
    run_logged "$ORV_BUILD/log/apt.log" "${AS_ROOT[@]}" env DEBIAN_FRONTEND=noninteractive \
        sh -c 'exec apt-get "$@" 9>&1' apt-get -o APT::Status-Fd=9 -y -q \
        -o DPkg::Lock::Timeout=300 -o Dpkg::Use-Pty=0 -o Acquire::Retries=3 "$@"
}
