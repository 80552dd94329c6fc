#!/usr/bin/env bash
# SPDX-License-Identifier: Apache-2.0
# Runs ./orv and its parts with stand-ins for the package and build tools: wrong
# arguments, missing packages and broken builds each give their line and status.
set -euo pipefail

root=$(dirname -- "$(dirname -- "$(dirname -- "$(readlink -f -- "$0")")")")
folder=$(mktemp -d)
trap 'rm -rf -- "$folder"' EXIT
mkdir "$folder/bin"
PATH=$folder/bin:$PATH
export ORV_BUILD="$folder/a build"
unset ORV_NO_INSTALL
failures=0

# stand_in NAME <script: puts a program in front of the real one.
stand_in() {
    { echo '#!/bin/bash' && cat; } >"$folder/bin/$1"
    chmod +x "$folder/bin/$1"
}

check() {
    [ "$2" = "$3" ] && return
    echo "FAILED $1: expected '$2', got '$3'"
    failures=$((failures + 1))
}

# expect WHAT STATUS TEXT COMMAND…: TEXT stands in one line of what it says.
expect() {
    local what=$1 expected=$2 text=$3 status=0
    shift 3
    "$@" >"$folder/said" 2>&1 </dev/null || status=$?
    check "$what: status" "$expected" "$status"
    [ -z "$text" ] || check "$what: says '$text'" 1 "$(grep -cF -- "$text" "$folder/said")"
}

# part FUNCTION…: calls a function of tools/shell as the commands do.
# shellcheck disable=SC2016
part() {
    "$BASH" -c 'set -euo pipefail; ORV_ROOT=$1; . "$1/tools/shell/common.sh"; use packages build doctor
        shift; "$@"' part "$root" "$@"
}

expect "no command" 0 "Usage: ./orv COMMAND" "$root/orv"
expect "another command" 2 "there is no command 'nonsense'" "$root/orv" nonsense
expect "a path as a command" 2 "there is no command" "$root/orv" ../shell/common
expect "an option first" 2 "options come after one" "$root/orv" --json info
expect "another target" 2 "not 'mips'" "$root/orv" test --target mips
expect "short tests without a sanitizer" 2 "--short goes with --sanitize alone." "$root/orv" test --short
expect "a filter of the thread sanitizer" 2 "--sanitize thread takes no --filter" \
    "$root/orv" test --sanitize thread --filter x
expect "a sanitizer for a release" 2 "without --target and --release" "$root/orv" test --sanitize --target armhf
expect "a target without a name" 2 "lacks its value" "$root/orv" test --target
expect "another option of bench" 2 "bench does not know '--fast'" "$root/orv" bench --fast
expect "another option of counts" 2 "counts does not know '--all'" "$root/orv" counts --all
expect "another option of trace-contract" 2 "trace-contract does not know '--all'" \
    "$root/orv" trace-contract --all
expect "the trace of a native method" 0 "native_prepareAsync ()V    " \
    "$root/tools/inspect/traces.py" "$root/tests/contract/traces" "native_prepareAsync"
expect "the trace of no native method" 1 "no native method with 'nonsense'" \
    "$root/tools/inspect/traces.py" "$root/tests/contract/traces" nonsense
expect "traces from no folder" 1 "no traces in" "$root/tools/inspect/traces.py" "$folder/none"
expect "rows of bench without a pattern" 2 "lacks its value" "$root/orv" bench --rows
expect "engine-test without a library" 2 "Usage: ./orv engine-test LIB" "$root/orv" engine-test
expect "help of engine-test" 0 "Usage: ./orv engine-test LIB" "$root/orv" engine-test --help
expect "another option of engine-test" 2 "engine-test does not know '--fast'" \
    "$root/orv" engine-test x.so --fast
expect "two libraries" 2 "takes one library, not 'x.so' and 'y.so'" "$root/orv" engine-test x.so y.so
expect "engine-test with options alone" 2 "lacks the engine's library" \
    "$root/orv" engine-test --jobs 2
expect "an address without a value" 2 "--address of engine-test lacks its value" \
    "$root/orv" engine-test x.so --address
expect "a limit of no seconds" 2 "--limit of engine-test is a whole number from 1 on, not '0'" \
    "$root/orv" engine-test x.so --limit=0
ORV_NO_INSTALL=1 expect "an engine that is not there" 2 "none.so: there is no such file; give" \
    "$root/orv" engine-test "$folder/none.so"
expect "another doctor" 2 "doctor does not know '--spell'" "$root/orv" doctor --spell x
ORV_NO_INSTALL=1 expect "a tree that is not there" 2 "none: there is no such folder" \
    "$root/orv" doctor --tree "$folder/none"
for script in "$root"/tools/cmd-*.sh; do
    name=$(basename -- "${script#*cmd-}" .sh)
    check "help of $name" 1 "$("$root/orv" help | grep -cE "^  $name( |$)")"
done

# bare COMMAND…: where neither sudo nor a JDK is on the PATH.
mkdir "$folder/usr"
ln -s /usr/bin/* "$folder/usr/"
rm -f "$folder/usr/sudo" "$folder/usr/javac"
bare() { PATH=$folder/bin:$folder/usr "$@"; }

stand_in id <<<'echo 0'
# shellcheck disable=SC2016
stand_in dpkg-query <<<'for p in "${@:4}"; do [ "$p" = mmdebstrap ] || echo "installed $p"; done'
# shellcheck disable=SC2016
stand_in apt-get <<<'echo "$@" >>"${0%/bin/*}/asked"; [ ! -e "${0%/bin/*}/fails" ]'
expect "missing package" 0 "needed to try: mmdebstrap (makes the sysroot)" \
    part need_packages try armhf
check "asks for it alone" yes "$(grep -q ' install .* mmdebstrap$' "$folder/asked" && echo yes)"
rm "$folder/asked"
expect "nothing missing" 0 "" part need_packages try play
ORV_NO_INSTALL=1 expect "no installation wanted" 0 "" part need_packages try armhf
check "asks for nothing" no "$([ -e "$folder/asked" ] && echo yes || echo no)"

# on SYSTEM COMMAND…: where /etc/os-release holds those lines.
on() {
    printf '%s\n' "$1" >"$folder/os-release"
    shift
    ORV_OS_RELEASE=$folder/os-release "$@"
}
debian12=$'ID=debian\nVERSION_CODENAME=bookworm'
debian13=$'ID=debian\nVERSION_CODENAME=trixie'
expect "a system of another kind" 1 "this is Fedora Linux 40; ./orv installs packages on Debian 12 and 13 alone. Install in your system's way what Debian calls mmdebstrap, then set ORV_NO_INSTALL=1." \
    on $'ID=fedora\nPRETTY_NAME="Fedora Linux 40"' part need_packages try armhf
expect "a relative of Debian" 1 "this is Ubuntu 24.04 LTS; ./orv installs" \
    on $'ID=ubuntu\nVERSION_CODENAME=noble\nPRETTY_NAME="Ubuntu 24.04 LTS"' part need_packages try armhf
expect "another system with all packages" 0 "" on ID=fedora part need_packages try play
expect "the newest Java of Debian 12" 0 "openjdk-17-jdk" on "$debian12" part list_packages test
expect "the newest Java of Debian 13" 0 "openjdk-25-jdk" on "$debian13" part list_packages test
expect "an unknown release for a root" 2 "--release is one of bookworm trixie, not 'sarge'" \
    "$root/orv" test --release sarge

# jdk NAME VERSION [headless]: a JDK in a folder of its own.
jdk() {
    mkdir -p "$folder/jvm/$1/bin" "$folder/jvm/$1/lib"
    echo "JAVA_VERSION=\"$2.0.1\"" >"$folder/jvm/$1/release"
    printf '#!/bin/sh\n' >"$folder/jvm/$1/bin/javac" && chmod +x "$folder/jvm/$1/bin/javac"
    [ -n "${3:-}" ] || touch "$folder/jvm/$1/lib/libawt_xawt.so"
}
# among_jdks COMMAND…: where those are all that the system has.
among_jdks() { ORV_JVM_DIR=$folder/jvm bare "$@"; }
unset JAVA_HOME
expect "no JDK" 1 "there is no JDK; version 17 or newer is needed" among_jdks part use_jdk
jdk old 11
expect "an old JDK" 1 "the JDK in $folder/jvm/old is version 11; 17 or newer is needed" among_jdks part use_jdk
jdk java-21 21 headless
expect "a JDK without windows" 1 "the JDK 21 in $folder/jvm/java-21 has no support for windows" \
    among_jdks part use_jdk
jdk java-17 17
jdk java-24 24
expect "the newest JDK" 0 "$folder/jvm/java-24" among_jdks part find_jdk
JAVA_HOME=$folder/jvm/java-17 expect "the JDK that JAVA_HOME names" 0 "$folder/jvm/java-17" \
    among_jdks part find_jdk
JAVA_HOME=$folder/jvm/old expect "a JAVA_HOME that is too old" 0 "$folder/jvm/java-24" \
    among_jdks part find_jdk
# shellcheck disable=SC2016
stand_in dpkg-query <<<'for p in "${@:4}"; do [ "$p" = default-jdk ] || echo "installed $p"; done'
expect "a JDK from elsewhere will do" 0 "" among_jdks on "$debian12" part need_packages try play
check "asks for no other" no "$([ -e "$folder/asked" ] && echo yes || echo no)"
rm -rf "$folder/jvm" && mkdir "$folder/jvm"
expect "a JDK where there is none" 0 "default-jdk (Java compiler" among_jdks on "$debian12" \
    part need_packages try play
rm "$folder/asked"
# shellcheck disable=SC2016
stand_in dpkg-query <<<'for p in "${@:4}"; do [ "$p" = mmdebstrap ] || echo "installed $p"; done'

stand_in pkg-config <<<'echo 1.109.0'
expect "an mpv that is too old" 1 "mpv's interface is version 1.109.0 here; 2.0 (mpv 0.35) or newer is needed" \
    part check_mpv
for version in 2.0.0 2.5.0 10.0; do
    stand_in pkg-config <<<"echo $version"
    expect "mpv's interface $version" 0 "" part check_mpv
done
stand_in pkg-config <<<'exit 1'
expect "no mpv yet" 0 "" part check_mpv

# shellcheck disable=SC2016
stand_in fc-list <<<'case $1 in *zh-cn | *ja | *hi) ;; *) echo "Some Sans" ;; esac'
expect "scripts without letters" 0 \
    "boxes in place of letters in Chinese, Japanese, Hindi; Debian has them in fonts-wqy-microhei fonts-lohit-deva" \
    part check_fonts
stand_in fc-list <<<'echo "Some Sans"'
expect "fonts for all scripts" 0 "fonts      ok       for Chinese, Japanese, Korean, Arabic, Hindi" \
    part check_fonts

# A server's socket is all that is looked at; there may be cards besides.
mkdir "$folder/run"
XDG_RUNTIME_DIR=$folder/run PULSE_SERVER=somewhere expect "a sound server elsewhere" 0 \
    "sound      ok       a sound server runs" part check_sound
python3 -c 'import socket, sys; socket.socket(socket.AF_UNIX).bind(sys.argv[1])' "$folder/run/pipewire-0"
XDG_RUNTIME_DIR=$folder/run PULSE_SERVER='' expect "PipeWire" 0 "a sound server runs" part check_sound
rm "$folder/run/pipewire-0"
if ! compgen -G '/dev/snd/pcm*p' >/dev/null; then
    XDG_RUNTIME_DIR=$folder/run PULSE_SERVER='' expect "no sound at all" 0 \
        "there is no sound card and no sound server" part check_sound
fi

stand_in id <<<'echo 1000'
expect "another release without root rights" 1 "can only be entered as root: sudo ./orv test --release trixie" \
    "$root/orv" test --release trixie
expect "no sudo" 1 "there is no sudo here. As root: apt-get install --no-install-recommends mmdebstrap" \
    bare part need_packages try armhf
stand_in sudo <<<'exit 1'
expect "no password" 1 "sudo did not give root, so nothing was installed" part need_packages try armhf
check "asks for nothing before" no "$([ -e "$folder/asked" ] && echo yes || echo no)"
stand_in id <<<'echo 0'
touch "$folder/fails"
expect "apt-get fails" 1 "could not be installed" part need_packages try armhf

mkdir -p "$ORV_BUILD" && touch "$ORV_BUILD/build.ninja"
cat >"$ORV_BUILD/CMakeCache.txt" <<END
Java_JAVAC_EXECUTABLE:FILEPATH=$(part find_jdk)/bin/javac
ORV_TESTS:BOOL=ON
CMAKE_COMPILE_WARNING_AS_ERROR:BOOL=OFF
END
stand_in ninja <<<'echo "FAILED: one.o"; seq 1 50000; exit 1'
expect "a broken build" 1 "the build failed; all it said is in" part build_targets off all
check "shows its first error" 1 "$(grep -c '^FAILED: one.o' "$folder/said")"
# A folder with tests takes warnings for errors; who only plays gets round them.
sed -i '$s/OFF/ON/' "$ORV_BUILD/CMakeCache.txt"
# shellcheck disable=SC2016
stand_in cmake <<<'echo "$@" >>"${0%/bin/*}/configured"'
# shellcheck disable=SC2016
stand_in ninja <<<'echo "FAILED: one.o"; grep -q ERROR:BOOL=OFF "${0%/bin/*}/configured" 2>/dev/null'
expect "a warning in a build for tests" 1 "the build failed" part build_targets on all
expect "a warning in a build for playing" 0 "" part build_targets off all
check "leaves the tests in" no "$(grep -q ORV_TESTS "$folder/configured" && echo yes || echo no)"
# Ctrl-C goes to the shell and to what it has started; ninja ends in its own way.
# shellcheck disable=SC2016
stand_in ninja <<<'trap "exit 2" INT; kill -INT $PPID; kill -INT $$'
# interruptible COMMAND…: with Ctrl-C in force, whatever started this test ignores.
interruptible() { env --default-signal=INT "$@"; }
expect "Ctrl-C while it builds" 130 "" interruptible "$root/orv" info none.mkv
check "is no broken build" 0 "$(grep -c failed "$folder/said")"

# Another build holds the lock until a condition is met.
stand_in ninja <<<'exit 0'
lock=$ORV_BUILD/.lock
# while_locked_until COMMAND…: the lock is let go when that succeeds.
while_locked_until() {
    exec {held}>"$lock"
    flock "$held"
    (until "$@"; do sleep 0.05; done) &
    local waits=$!
    exec {held}>&-
    expect "a second build" 0 "" part build_targets off all
    wait "$waits"
}
# The kernel's own list of locks is empty in a container.
somebody_waits() { cat /proc/[0-9]*/comm 2>/dev/null | grep -qx flock; }
it_says_so() { grep -q 'waiting for another build' "$folder/said"; }
while_locked_until somebody_waits
check "a short wait is no news" no "$(it_says_so && echo yes || echo no)"
while_locked_until it_says_so
check "a long one is" yes "$(it_says_so && echo yes || echo no)"

stand_in cmake <<<'echo "CMake Error: no such library"; exit 1'
rm "$ORV_BUILD/build.ninja"
expect "a configuration that fails" 1 "the build could not be configured" part build_targets off all

[ "$failures" -eq 0 ]
