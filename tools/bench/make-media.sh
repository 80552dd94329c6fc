#!/usr/bin/env bash
# SPDX-License-Identifier: Apache-2.0
# make-media.sh FOLDER FILE…: makes the media of the benchmarks that are not there
# yet, each under another name until it is whole.
set -euo pipefail

quiet_ffmpeg() { ffmpeg -nostdin -v error -y "$@"; }

# Fifteen seconds that show where they are: a box in the middle, half as wide and high as
# the picture, is magenta until a second before the end, then green, in a black frame. The
# arguments: size, rate, file.
film() {
    local box="x=iw/4:y=ih/4:w=iw/2:h=ih/2:t=fill"
    local frame="x=iw/4-16:y=ih/4-16:w=iw/2+32:h=ih/2+32:color=black:t=fill"
    quiet_ffmpeg -f lavfi \
        -i "testsrc2=size=$1:rate=$2:duration=15,drawbox=$frame,drawbox=$box:color=magenta:enable='lt(t,14)',drawbox=$box:color=lime:enable='gte(t,14)'" \
        -f lavfi -i "sine=440:duration=15:sample_rate=48000" \
        -c:v libx264 -preset veryfast -crf 20 -g $((2 * $2)) -pix_fmt yuv420p -c:a aac -ac 2 "$3"
}
make_1080p60_mkv() { film 1920x1080 60 "$1"; }
make_wall_mkv() { film 640x360 30 "$1"; }
make_2160p30_mkv() { film 3840x2160 30 "$1"; }

# Three hours of a still: two small pictures a second, a key frame each ten seconds.
make_three_hours_mkv() {
    quiet_ffmpeg -f lavfi -i "color=gray:size=320x180:rate=2:duration=10800,drawbox=x=150:y=80:w=20:h=20:color=white:t=fill" \
        -c:v libx264 -preset ultrafast -g 20 -pix_fmt yuv420p "$1"
}

# A second of sound, as many times as there are tracks.
tracks() {
    local maps=() i
    for ((i = 0; i < $1; i++)); do maps+=(-map 0:a); done
    quiet_ffmpeg -f lavfi -i "sine=440:duration=1:sample_rate=8000" "${maps[@]}" -c:a pcm_s16le -f matroska "$2"
}
make_tracks_1_mka() { tracks 1 "$1"; }
make_tracks_8_mka() { tracks 8 "$1"; }
make_tracks_64_mka() { tracks 64 "$1"; }

folder=${1:?usage: make-media.sh FOLDER FILE…}
shift
mkdir -p -- "$folder"
for file in "$@"; do
    [ ! -e "$folder/$file" ] || continue
    unfinished=$(mktemp -d -- "$folder/.making-XXXXXX")
    trap 'rm -rf -- "$unfinished"' EXIT
    "make_$(tr '.-' '__' <<<"$file")" "$unfinished/$file"
    mv -- "$unfinished/$file" "$folder/$file"
    rmdir -- "$unfinished"
done
