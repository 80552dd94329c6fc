#!/usr/bin/env bash
# SPDX-License-Identifier: Apache-2.0
# The Debian packaging agrees with the project: what it builds with is what the lists of
# packages install, and each file that cmake --install makes goes into one package.
# ORV_BUILD is a build folder with library, engine and Java half.
set -euo pipefail

root=$(dirname -- "$(dirname -- "$(dirname -- "$(readlink -f -- "$0")")")")
folder=$(mktemp -d)
trap 'rm -rf -- "$folder"' EXIT
failures=0

fail() {
    echo "FAILED $*"
    failures=$((failures + 1))
}

# Build-Depends, a package a line, without versions and the packages that would do, too.
build_depends() {
    awk '/^Build-Depends:/ { on = 1; next } /^[^ ]/ { on = 0 } on { print $1 }' "$root/debian/control" | tr -d ,
}
listed=$(sed -e 's/#.*//' "$root"/tools/packages-{play,deb}.txt | awk 'NF {print $1}')
for package in $(build_depends); do
    case $package in debhelper-compat) package=debhelper ;; esac
    grep -qx -- "$package" <<<"$listed" || fail "$package of debian/control is not in the lists of packages"
done
# The other way round: a library that ./orv play installs to build with.
while read -r package; do
    build_depends | grep -qx -- "$package" || fail "$package of packages-play.txt is not in debian/control"
done < <(awk '$1 ~ /(-dev|-headers|^lib.*-java)$/ {print $1}' "$root/tools/packages-play.txt")
[ "$(build_depends | wc -l)" -gt 15 ] || fail "few build dependencies: $(build_depends | paste -sd' ')"

cmake --install "$ORV_BUILD" --prefix "$folder/usr" >"$folder/log" 2>&1 || fail "install: $(tail -n 5 "$folder/log")"
# Where debian/rules has them go, and what it leaves out.
mkdir -p "$folder/usr/lib/triplet/jni"
mv "$folder"/usr/lib/{cmake,pkgconfig} "$folder/usr/lib/triplet/"
mv "$folder"/usr/lib/*.so* "$folder/usr/lib/triplet/jni/"
mv "$folder/usr/share/doc/"* "$folder/usr/share/doc/libmediaplayer-orv-doc"
mapfile -t patterns < <(cat "$root"/debian/*.install)
# packages_with FILE: how many patterns match it or a folder above it.
packages_with() {
    local pattern count=0
    for pattern in "${patterns[@]}"; do
        # shellcheck disable=SC2053
        [[ $1 != $pattern && $1 != $pattern/* ]] || count=$((count + 1))
    done
    echo $count
}
files=0
while IFS= read -r file; do
    files=$((files + 1))
    [ "$(packages_with "$file")" -eq 1 ] || fail "$file goes into $(packages_with "$file") packages"
done < <(cd "$folder" && find usr \( -type f -o -type l \))
[ $files -gt 40 ] || fail "only $files files are installed"
for pattern in "${patterns[@]}"; do
    case $pattern in usr/share/man | usr/share/bash-completion) continue ;; esac
    (cd "$folder" && compgen -G "$pattern" >/dev/null) || fail "nothing is installed to $pattern"
done

# What is written for a desktop and for readers of manuals names the command.
grep -qx 'Exec=orv play %U' "$folder/usr/share/applications/com.quintora.orv.player.desktop" || fail "desktop entry"
[ -x "$folder/usr/bin/orv" ] || fail "no command"

status=0
"$root/tools/package/deb" --sign >"$folder/said" 2>&1 || status=$?
[ "$status" -eq 2 ] || fail "another option: status $status"
grep -q "package deb does not know '--sign'" "$folder/said" || fail "another option: $(cat "$folder/said")"

[ $failures -eq 0 ]
