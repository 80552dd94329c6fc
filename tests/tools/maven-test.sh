#!/usr/bin/env bash
# SPDX-License-Identifier: Apache-2.0
# The Maven repository: made twice it is the same, its sums are right, and the sample
# builds from it without a network and plays with an empty cache, also twice at once.
# ORV_BUILD is a build folder, ORV_MEDIA one with test media. Ends with 77 without Maven.
set -euo pipefail

root=$(dirname -- "$(dirname -- "$(dirname -- "$(readlink -f -- "$0")")")")
command -v mvn >/dev/null || { echo "there is no mvn here" && exit 77; }
folder=$(mktemp -d)
trap 'rm -rf -- "$folder"' EXIT
export ORV_NO_INSTALL=1 ORV_LOG=silent
unset DISPLAY JAVA_TOOL_OPTIONS

fail() {
    echo "FAILED $*"
    exit 1
}

package() {
    "$root/orv" package maven --without-armhf --into "$folder/$1" >"$folder/$1.log" 2>&1
}

package first &
package second || fail "no repository: $(cat "$folder/second.log")"
wait $! || fail "no repository: $(cat "$folder/first.log")"
diff -r "$folder/first" "$folder/second" || fail "two repositories of the same sources differ"
"$root/tests/tools/maven_metadata.py" "$folder/first" || fail "the repository contradicts itself"

native=$(find "$folder/first" -name '*-linux-x86_64.jar')
mkdir "$folder/native"
(cd "$folder/native" && "$JAVA_HOME/bin/jar" xf "$native")
! grep -rl -e "$root" -e "$ORV_BUILD" "$folder/native" ||
    fail "a library names the folder that it was built in"

cp -r -- "$root/samples/maven" "$folder/sample"
(cd "$folder/sample" && mvn -B -o -q -s debian-settings.xml -Duser.home="$folder" \
    -Dorv.local="$folder/local" -Dorv.repository="$folder/first" package) >"$folder/mvn.log" 2>&1 ||
    fail "the sample does not build: $(cat "$folder/mvn.log")"

# play NAME CACHE: plays with that cache, into an output of that name.
play() {
    XDG_CACHE_HOME=$folder/$2 "$JAVA_HOME/bin/java" --enable-native-access=ALL-UNNAMED \
        -Djava.library.path="$folder" -cp "$folder/sample/target/*:$folder/sample/target/lib/*" \
        sample.Play "$ORV_MEDIA/short.mp4" >"$folder/$1.out" 2>&1 || true
    for line in '^duration: [1-9][0-9]* ms$' '^VideoTrack' '^AudioTrack' '^played to the end$'; do
        grep -q "$line" "$folder/$1.out" || fail "the sample printed: $(cat "$folder/$1.out")"
    done
}

play alone cache
find "$folder/cache/mediaplayer-orv" -name libmediaplayer_orv.so | grep -q . ||
    fail "nothing was unpacked"
cat >"$folder/First.java" <<'END'
public class First {
    public static void main(String[] arguments) throws Exception {
        Class.forName("android.view.Surface");
        System.out.println("loaded");
    }
}
END
XDG_CACHE_HOME=$folder/first-cache "$JAVA_HOME/bin/java" -Djava.library.path="$folder" \
    -cp "$folder/sample/target/lib/*" "$folder/First.java" >"$folder/First.out" 2>&1 ||
    fail "the desktop's classes do not find their library: $(cat "$folder/First.out")"
play left shared &
play right shared
wait $! || exit 1
[ -z "$(find "$folder/shared" -name '*.part')" ] || fail "something half is left in the cache"

# A module that requires the player's needs nothing but the same JARs.
mkdir "$folder/module"
echo 'module play { requires com.quintora.mmp; }' >"$folder/module/module-info.java"
"$JAVA_HOME/bin/javac" -p "$folder/sample/target/lib" -d "$folder/play" "$folder/module/module-info.java" \
    "$folder/sample/src/main/java/sample/Play.java" || fail "the sample does not compile as a module"
XDG_CACHE_HOME=$folder/modular "$JAVA_HOME/bin/java" -Djava.library.path="$folder" \
    --enable-native-access=com.quintora.mmp -p "$folder/sample/target/lib:$folder/play" \
    -m play/sample.Play "$ORV_MEDIA/short.mp4" >"$folder/modular.out" 2>&1 || true
grep -q '^played to the end$' "$folder/modular.out" ||
    fail "the sample printed as a module: $(cat "$folder/modular.out")"
mkdir "$folder/testing"
echo 'module check { requires com.quintora.mmp.testing; }' >"$folder/testing/module-info.java"
testing=$(echo "$folder"/first/com/quintora/mmp/mediaplayer-orv-testing/*/*[0-9].jar)
"$JAVA_HOME/bin/javac" -p "$folder/sample/target/lib:$testing" -d "$folder/check" \
    "$folder/testing/module-info.java" || fail "a test does not compile as a module"
[ -d "$folder/modular/mediaplayer-orv" ] || fail "nothing was unpacked for the module"
