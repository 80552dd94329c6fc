# SPDX-License-Identifier: Apache-2.0
# shellcheck shell=bash
# What ./orv doctor says of the machine. Each check prints one line and fails
# when ./orv play could not work for it.
use sound

# row WHAT STATE SENTENCE
row() { printf '%-10s %-8s %s\n' "$@"; }

check_machine() {
    local bad=0 check
    for check in packages java libraries display graphics fonts sound; do
        "check_$check" || bad=1
    done
    return $bad
}

check_packages() {
    local list missing status=0
    for list in play test armhf inspect tree corpus bench deb; do
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

# What the player looks at before it tries OpenGL.
check_graphics() {
    if [ -n "$(compgen -G '/dev/dri/renderD*')$(compgen -G '/dev/nvidiactl')$(compgen -G '/dev/dxg')" ]; then
        row graphics ok "a graphics processor draws the window's pictures if OpenGL can use it"
    else
        row graphics none "no graphics processor: software draws the window's pictures"
    fi
}

# Languages of other scripts, as fontconfig calls them, and what covers them.
readonly SCRIPTS='zh-cn Chinese fonts-wqy-microhei
ja Japanese fonts-wqy-microhei
ko Korean fonts-wqy-microhei
ar Arabic fonts-dejavu-core
hi Hindi fonts-lohit-deva'

# Any font will do, whatever package it is from.
check_fonts() {
    local language name package boxes=() packages=()
    command -v fc-list >/dev/null || { row fonts unknown "there is no fc-list to ask" && return; }
    while read -r language name package; do
        [ -n "$(fc-list ":lang=$language" family)" ] && continue
        boxes+=("$name")
        case " ${packages[*]} " in *" $package "*) ;; *) packages+=("$package") ;; esac
    done <<<"$SCRIPTS"
    if [ ${#boxes[@]} -eq 0 ]; then
        row fonts ok "for $(cut -d' ' -f2 <<<"$SCRIPTS" | paste -sd, | sed 's/,/, /g')"
    else
        row fonts missing "boxes in place of letters in $(printf '%s\n' "${boxes[@]}" |
            paste -sd, | sed 's/,/, /g'); Debian has them in ${packages[*]}"
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
