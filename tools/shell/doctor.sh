# SPDX-License-Identifier: Apache-2.0
# shellcheck shell=bash
# What ./orv doctor says of the machine. Each check prints one line and fails
# when ./orv play could not work for it.
use sound

# row WHAT STATE SENTENCE
row() { printf '%-10s %-8s %s\n' "$@"; }

check_machine() {
    local bad=0 check
    for check in packages java libraries display sound; do
        "check_$check" || bad=1
    done
    return $bad
}

check_packages() {
    local list missing status=0
    for list in play test armhf inspect tree corpus; do
        missing=$(missing_packages "$list" | awk '{print $1}' | paste -sd' ')
        if [ -z "$missing" ]; then
            row packages ok "all of tools/packages-$list.txt are installed"
        elif [ "$list" = play ]; then
            row packages missing "to build and play: $missing; ./orv play installs them"
            status=1
        else
            row packages missing "of tools/packages-$list.txt: $missing; installed when they are needed"
        fi
    done
    return $status
}

check_java() {
    local jdk
    jdk=$(find_jdk)
    if [ -z "$jdk" ]; then
        row java missing "$(jdk_complaint); ./orv play installs default-jdk"
        return 1
    fi
    row java ok "JDK $(java_version_of "$jdk") in $jdk"
}

check_libraries() {
    local complaint library version found=()
    complaint=$(mpv_complaint)
    if [ -n "$complaint" ]; then
        row libraries old "$complaint"
        return 1
    fi
    for library in mpv libavformat libavcodec libavfilter libavutil libswscale; do
        version=$(library_version "$library")
        [ -z "$version" ] || found+=("$library $version")
    done
    if [ ${#found[@]} -eq 0 ]; then
        row libraries missing "mpv and libav are not here; ./orv play installs them"
        return 1
    fi
    # What mpv calls its version there is its client interface's.
    row libraries ok "$(printf '%s\n' "${found[@]/#mpv /mpv client interface }" | paste -sd, | sed 's/,/, /g')"
}

check_display() {
    if [ -n "${DISPLAY:-}" ]; then
        row display ok "$DISPLAY"
    else
        row display none "without a display ./orv play plays in the terminal"
    fi
}

check_sound() {
    local output
    output=$(sound_output)
    if [ -n "$output" ]; then
        row sound ok "$output"
    else
        row sound none "there is no sound card and no sound server: video plays without sound"
    fi
}
