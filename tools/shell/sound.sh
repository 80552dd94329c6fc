# SPDX-License-Identifier: Apache-2.0
# shellcheck shell=bash
# What sound there is.

# Prints what would play: a server or the first card. Nothing when there is none.
sound_output() {
    local runtime=${XDG_RUNTIME_DIR:-/run/user/$(id -u)}
    if [ -n "${PULSE_SERVER:-}" ] || [ -S "$runtime/pulse/native" ] || [ -S "$runtime/pipewire-0" ]; then
        echo "a sound server runs"
    elif [ -n "$(compgen -G '/dev/snd/pcm*p')" ]; then
        sed -n 's/^ *[0-9]* \[.*\]: //p' /proc/asound/cards | head -n 1
    fi
}
