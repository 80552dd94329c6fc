#!/bin/bash
# SPDX-License-Identifier: Apache-2.0
#
# Makes the media of the tests: make-media.sh FOLDER [FILE...]
#
# Without names, all of them; --list instead of the folder names them. A file that is there already is kept. Each file
# has a function of its own; it appears whole or not at all, so that several
# tests may ask for the same file at the same time.
set -eu

FILES="video.mp4 lying.mp4 video.mkv video.ts video.avi slides.mkv rotated.mp4 hd.mp4 hd709.mp4 odd.mkv
       alpha.mov still.png silent.mkv tracks.mkv tracks.mp4 tagged.mp3 tagged.ogg broken-tags.mp4
       front.jpg back.png covered.mp3 covered.flac covered.m4a covered.mkv noise.bin
       cut.mp4 cut.mkv
       feature.mkv short.mp4 short.ts long.mkv light.mkv sparse.mkv distant.mkv silent.mp4 plain.mkv plain.mp4 pictures.mkv
       lines.srt latin1.srt lines.ass words.idx words.sub languages.idx languages.sub tone.mp3
       tone.flac tone-s16le.pcm tone-s16be.pcm subtitles-only.mkv garbage.bin empty.bin unseen.mkv dead.mkv first-of-two.m3u
       first-missing.m3u nothing.m3u locale
       soft.mp4 turned-90.mp4 turned-180.mp4 turned-270.mp4 turned-and-not.mp4 anamorphic.mkv
       yuv420p10.mkv yuv422p.mkv yuv422p10.mkv yuv444p.mkv yuv444p12.mkv
       bt601.mkv bt601-full.mkv bt709.mkv bt709-full.mkv bt2020.mkv pq.mkv hlg.mkv
       top-first.ts bottom-first.ts one-frame.mkv
       counted-60.mkv counted-sound.mkv counted-film.mp4 counted-varying.mkv counted.ts
       stream.ts stream.m2ts stream.mpg stream.vob distant.ts distant.m2ts distant.mpg distant.vob
       lying90.mp4 lying180.mp4 lying270.mp4 mirrored.mp4 flipped.mp4 lying90mirrored.mp4
       wide-pixels.mkv deep-422.mkv full-444.mkv hdr-pq.mkv hdr-hlg.mkv hdr10.mp4 fields-top.mkv
       fields-bottom.mpg h263.3gp he-aac.m4a fonts.mkv spoken.mkv"

quiet_ffmpeg() { ffmpeg -nostdin -v error -y "$@"; }

# A moving picture whose frames all differ: size, seconds.
moving() { echo "testsrc2=size=$1:rate=25:duration=$2"; }

# H.264 with a key frame every two seconds.
h264() { echo "-c:v libx264 -preset veryfast -crf 16 -g 50 -keyint_min 50 -sc_threshold 0 -pix_fmt yuv420p"; }

moving_with_sound() {
    # shellcheck disable=SC2046
    quiet_ffmpeg -f lavfi -i "$(moving 320x180 10)" -f lavfi -i "sine=440:duration=10" \
        $(h264) -c:a "$1" -ac 2 -ar 48000 "$2"
}

make_video_mp4() { moving_with_sound aac "$1"; }
make_video_mkv() { moving_with_sound libvorbis "$1"; }
make_video_ts() { moving_with_sound mp2 "$1"; }

make_video_avi() {
    quiet_ffmpeg -f lavfi -i "$(moving 320x180 5)" -c:v mpeg4 -q:v 2 -g 50 "$1"
}

# One picture a second.
make_slides_mkv() {
    # shellcheck disable=SC2046
    quiet_ffmpeg -f lavfi -i "testsrc2=size=320x180:rate=1:duration=8" $(h264) "$1"
}

# Stored lying, to be shown upright.
make_rotated_mp4() {
    need video.mp4
    quiet_ffmpeg -i "$folder/video.mp4" -c copy -an "$1.mp4"
    python3 "$here/set-display-matrix.py" "$1.mp4" 0 1 -1 0 180 0 "$1"
    rm "$1.mp4"
}

# Without a word about its colours, and with.
make_hd_mp4() {
    # shellcheck disable=SC2046
    quiet_ffmpeg -f lavfi -i "$(moving 1280x720 1),scale=out_color_matrix=bt709" $(h264) "$1"
}

make_hd709_mp4() {
    # shellcheck disable=SC2046
    quiet_ffmpeg -f lavfi -i "$(moving 1280x720 1),scale=out_color_matrix=bt709" $(h264) \
        -colorspace bt709 -color_primaries bt709 -color_trc bt709 "$1"
}

make_odd_mkv() {
    quiet_ffmpeg -f lavfi -i "$(moving 162x92 1),format=yuv444p,crop=161:91" -c:v ffv1 "$1"
}

# Left half transparent, right half opaque.
make_alpha_mov() {
    quiet_ffmpeg -f lavfi -i "color=red:size=64x64:rate=25:duration=1,format=argb,geq=r=255:g=0:b=0:a=255*gte(X\,32)" \
        -c:v qtrle "$1"
}

make_still_png() { quiet_ffmpeg -f lavfi -i "$(moving 320x180 1)" -frames:v 1 "$1"; }

make_silent_mkv() {
    # shellcheck disable=SC2046
    quiet_ffmpeg -f lavfi -i "$(moving 320x180 2)" $(h264) "$1"
}

subtitle() { printf '1\n00:00:00,000 --> 00:00:09,000\n%s\n' "$2" >"$1"; }

# The marks of three chapters in ffmpeg's own text format.
chapters() {
    printf ';FFMETADATA1\n'
    printf '[CHAPTER]\nTIMEBASE=1/1000\nSTART=%s\nEND=%s\ntitle=%s\n' \
        0 2500 "Opening" 2500 6000 "Глава вторая" 6000 10000 "終章"
}

# Two audio and two subtitle tracks with languages and titles, and chapters.
# The arguments: the codec of the subtitles, the file.
several_tracks() {
    need video.mp4
    local parts
    parts=$(mktemp -d)
    subtitle "$parts/1.srt" "Good evening"
    subtitle "$parts/2.srt" "Guten Abend"
    chapters >"$parts/chapters.txt"
    quiet_ffmpeg -i "$folder/video.mp4" -f lavfi -i "sine=880:duration=10:sample_rate=44100" \
        -i "$parts/1.srt" -i "$parts/2.srt" -i "$parts/chapters.txt" \
        -map 0:v -map 0:a -map 1:a -map 2 -map 3 -map_metadata:g -1 -map_chapters 4 \
        -c:v copy -c:a:0 copy -c:a:1 "$1" -c:s "$2" \
        -metadata:s:a:0 language=eng -metadata:s:a:0 title="Main mix" \
        -metadata:s:a:1 language=deu -metadata:s:a:1 title="Kommentar (größer)" \
        -metadata:s:a:1 comment="Nur für Fans" \
        -metadata:s:s:0 language=eng -metadata:s:s:0 title="Full" \
        -metadata:s:s:1 language=jpn -metadata:s:s:1 title="字幕" \
        -disposition:a:0 0 -disposition:a:1 default -disposition:s:0 forced "$3"
    rm -r "$parts"
}

make_tracks_mkv() { several_tracks flac subrip "$1"; }
make_tracks_mp4() { several_tracks aac mov_text "$1"; }

# Texts in several scripts; a comment of 130 units that ends in pairs of them.
tags() {
    local clef=$'\xF0\x9D\x84\x9E' comment
    comment=$(printf 'c%.0s' {1..126})$clef$clef
    tag_options=(-metadata title="Ode an die Freude – К радости" -metadata artist="東京交響楽団"
        -metadata album="$(printf 'Α%.0s' {1..128})" -metadata genre="موسيقى"
        -metadata composer="Ludwig van Beethoven" -metadata comment="$comment"
        -metadata track=3/12 -metadata disc=2/4 -metadata date=1824-05-07)
}

make_tagged_mp3() {
    tags
    quiet_ffmpeg -f lavfi -i "sine=440:duration=4" -c:a libmp3lame -b:a 128k "${tag_options[@]}" "$1"
}

make_tagged_ogg() {
    tags
    quiet_ffmpeg -f lavfi -i "sine=440:duration=4" -c:a libvorbis "${tag_options[@]}" "$1"
}

# Latin-1 where UTF-8 belongs, and numbers that are none.
make_broken_tags_mp4() {
    need video.mp4
    quiet_ffmpeg -i "$folder/video.mp4" -c copy -movflags use_metadata_tags \
        -metadata title=$'caf\xE9 au lait' -metadata artist=$'\xFF\xFE' -metadata track=many \
        -metadata date=unknown "$1"
}

make_front_jpg() { quiet_ffmpeg -f lavfi -i "testsrc=size=96x64:duration=1:rate=1" -frames:v 1 "$1"; }
make_back_png() { quiet_ffmpeg -f lavfi -i "color=blue:size=32x32:duration=1:rate=1" -frames:v 1 "$1"; }

# The back of the sleeve comes first, to be distinguished from the front. The arguments:
# the codec and the file.
covered() {
    need front.jpg back.png
    quiet_ffmpeg -f lavfi -i "sine=440:duration=2" -i "$folder/back.png" -i "$folder/front.jpg" \
        -map 0 -map 1 -map 2 -c:a "$1" -c:v copy -disposition:v attached_pic \
        -metadata:s:v:0 comment="Cover (back)" -metadata:s:v:1 comment="Cover (front)" "$2"
}

make_covered_mp3() { covered libmp3lame "$1"; }
make_covered_flac() { covered flac "$1"; }

make_covered_m4a() {
    need front.jpg
    quiet_ffmpeg -f lavfi -i "sine=440:duration=2" -i "$folder/front.jpg" -map 0 -map 1 \
        -c:a aac -c:v copy -disposition:v attached_pic "$1"
}

make_covered_mkv() {
    need front.jpg silent.mkv
    quiet_ffmpeg -i "$folder/silent.mkv" -attach "$folder/front.jpg" -c copy \
        -metadata:s:t mimetype=image/jpeg "$1"
}

# Broadcast formats, which have no index: ten pictures a second, all different,
# with sound. The arguments: seconds, pictures from key frame to key frame, codec
# options, the file.
broadcast() {
    local seconds=$1 group=$2 file=${!#}
    quiet_ffmpeg -f lavfi -i "testsrc2=size=160x90:rate=10:duration=$seconds" \
        -f lavfi -i "sine=440:duration=$seconds" "${@:3:$#-3}" -g "$group" -c:a mp2 -b:a 64k "$file"
}

broadcast_h264() { broadcast "$1" "$2" -c:v libx264 -preset veryfast -crf 20 -sc_threshold 0 "$3"; }
# MPEG-2 has no rate below 23.976.
broadcast_mpeg2() { broadcast "$1" "$2" -r 25 -c:v mpeg2video -q:v 3 -bf 2 -sc_threshold 1000000000 "$3"; }

make_stream_ts() { broadcast_h264 9 20 "$1"; }
make_stream_m2ts() { broadcast_h264 9 20 "$1"; }
make_stream_mpg() { broadcast_mpeg2 9 50 "$1"; }
make_stream_vob() { broadcast_mpeg2 9 50 "$1"; }
# A key frame at the start and after 20 seconds.
make_distant_ts() { broadcast_h264 24 200 "$1"; }
make_distant_m2ts() { broadcast_h264 24 200 "$1"; }
make_distant_mpg() { broadcast_mpeg2 24 500 "$1"; }
make_distant_vob() { broadcast_mpeg2 24 500 "$1"; }

# A second of small video that is stored otherwise than it is to be shown. The
# arguments: six numbers of the display matrix (a b c d x y), the file.
with_matrix() {
    need lying.mp4
    python3 "$here/set-display-matrix.py" "$folder/lying.mp4" "${@:1:6}" "$7"
}

make_lying_mp4() {
    # shellcheck disable=SC2046
    quiet_ffmpeg -f lavfi -i "$(moving 160x90 1)" $(h264) "$1"
}

make_lying90_mp4() { with_matrix 0 1 -1 0 90 0 "$1"; }
make_lying180_mp4() { with_matrix -1 0 0 -1 160 90 "$1"; }
make_lying270_mp4() { with_matrix 0 -1 1 0 0 160 "$1"; }
make_mirrored_mp4() { with_matrix -1 0 0 1 160 0 "$1"; }
make_flipped_mp4() { with_matrix 1 0 0 -1 0 90 "$1"; }
make_lying90mirrored_mp4() { with_matrix 0 1 1 0 0 0 "$1"; }

# Pixels that are not square, to be shown as 120x90.
make_wide_pixels_mkv() {
    # shellcheck disable=SC2046
    quiet_ffmpeg -f lavfi -i "$(moving 160x90 1),setsar=3/4" $(h264) "$1"
}

make_deep_422_mkv() {
    quiet_ffmpeg -f lavfi -i "$(moving 160x90 1)" -c:v libx264 -preset veryfast -crf 16 \
        -pix_fmt yuv422p10le "$1"
}

make_full_444_mkv() {
    quiet_ffmpeg -f lavfi -i "$(moving 160x90 1)" -vf scale=out_color_matrix=bt709:out_range=pc \
        -c:v libx264 -preset veryfast -crf 16 -pix_fmt yuv444p -color_range pc -colorspace bt709 \
        -color_primaries bt709 -color_trc bt709 "$1"
}

# Video of high dynamic range whose white has 1000 cd/m². The arguments: the
# transfer's name for zscale and ffmpeg, further parameters of x265, the file.
high_range() {
    quiet_ffmpeg -f lavfi -i "$(moving 160x90 1)" \
        -vf "format=gbrp,zscale=tin=bt709:pin=bt709:min=gbr:rin=full:t=linear:p=bt709:npl=1000,format=gbrpf32le,zscale=tin=linear:pin=bt709:min=gbr:t=$1:p=bt2020:m=bt2020nc:r=limited:npl=1000,format=yuv420p10le" \
        -c:v libx265 -preset ultrafast -crf 16 -color_range tv -color_primaries bt2020 \
        -color_trc "$1" -colorspace bt2020nc \
        -x265-params "log-level=none:colorprim=bt2020:transfer=$1:colormatrix=bt2020nc:range=limited$2" \
        -tag:v hvc1 "$3"
}

make_hdr_pq_mkv() { high_range smpte2084 "" "$1"; }
make_hdr_hlg_mkv() { high_range arib-std-b67 "" "$1"; }
# What it was mastered for, in its frames and in the container.
make_hdr10_mp4() {
    local frames=$1.frames.mp4
    high_range smpte2084 ":hdr10=1:master-display=G(13250,34500)B(7500,3000)R(34000,16000)WP(15635,16450)L(40000000,50):max-cll=4000,400" "$frames"
    python3 "$here/add-light-boxes.py" "$frames" 0.005 4000 4000 400 "$1"
    rm "$frames"
}

# Two fields of different moments in each picture. The arguments: which comes
# first (tff or bff), the codec's options, the file.
in_fields() {
    quiet_ffmpeg -f lavfi -i "testsrc2=size=160x96:rate=50:duration=1" -vf "interlace=scan=$1" \
        -flags +ildct+ilme -g 12 "${@:2}"
}

make_fields_top_mkv() {
    in_fields tff -c:v libx264 -preset veryfast -crf 16 -x264-params tff=1 -field_order tt \
        -pix_fmt yuv420p "$1"
}

make_fields_bottom_mpg() { in_fields bff -c:v mpeg2video -q:v 2 -field_order bb "$1"; }

make_h263_3gp() {
    quiet_ffmpeg -f lavfi -i "$(moving 176x144 1)" -c:v h263 -q:v 3 "$1"
}

# High-efficiency AAC declares half of the rate that it is played at. Debian has no
# encoder: this marks AAC of 22050 Hz as extended to 44100 (the bits behind the
# sync word 0x2b7 of ISO/IEC 14496-3 say "not extended" in what ffmpeg writes).
make_he_aac_m4a() {
    quiet_ffmpeg -f lavfi -i "sine=440:duration=1:sample_rate=22050" -c:a aac -ac 2 "$1"
    LC_ALL=C sed -i 's/\x56\xe5\x00/\x56\xe5\xa0/' "$1"
}

# Attached files: a font, and a text that says nothing of its type.
make_fonts_mkv() {
    need silent.mkv
    quiet_ffmpeg -i "$folder/silent.mkv" -c copy \
        -attach /usr/share/fonts/truetype/dejavu/DejaVuSans.ttf \
        -metadata:s:t:0 mimetype=application/x-truetype-font \
        -metadata:s:t:0 filename="Größe ＡＢ.ttf" "$1"
}

# Video with a language and a title of its own.
make_spoken_mkv() {
    need silent.mkv
    quiet_ffmpeg -i "$folder/silent.mkv" -c copy -metadata:s:v language=fra \
        -metadata:s:v title=$'Première \\ prise' "$1"
}

make_noise_bin() { yes 'neither sound nor picture' | head -c 65536 >"$1"; }
make_cut_mp4() { need video.mp4 && head -c 20000 "$folder/video.mp4" >"$1"; }
make_cut_mkv() { need video.mkv && head -c 40000 "$folder/video.mkv" >"$1"; }

# What follows is for playing: 30 frames a second, so that the clock shows.
playing() { echo "testsrc2=size=$1:rate=30:duration=$2"; }
tone() { echo "sine=frequency=$1:duration=$2,volume=0.1"; }
# FLAC has no samples before the first: the picture's times stay round.
fast_h264() { echo "-c:v libx264 -preset ultrafast -crf 28 -pix_fmt yuv420p -bf 0 -sc_threshold 0"; }

# A subtitle for each two seconds: text, seconds.
lines() {
    local s
    for ((s = 0; s < $2; s += 2)); do
        printf '%d\n00:00:%02d,000 --> 00:00:%02d,000\n%s\n\n' \
            $((s / 2 + 1)) "$s" $((s + 2)) "$1"
    done
}

# 10 s, 720p: two audio tracks, two subtitle tracks; a key frame every two seconds.
make_feature_mkv() {
    # shellcheck disable=SC2046
    quiet_ffmpeg -f lavfi -i "$(playing 1280x720 10)" -f lavfi -i "$(tone 440 10)" \
        -f lavfi -i "$(tone 880 10)" -i <(lines 'First line' 10) -i <(lines 'Zweite Zeile' 10) \
        -i <(chapters) -map 0:v -map 1:a -map 2:a -map 3:s -map 4:s -map_chapters 5 \
        $(fast_h264) -g 60 -c:a flac -ac:a:0 2 -ac:a:1 1 -c:s subrip \
        -metadata:s:a:0 language=eng -metadata:s:a:0 title=Stereo \
        -metadata:s:a:1 language=fra -metadata:s:a:1 title=Commentaire \
        -metadata:s:s:0 language=eng -metadata:s:s:0 title=Captions \
        -metadata:s:s:1 language=deu -metadata:s:s:1 title=Untertitel \
        -disposition:s:0 default -metadata title="The Feature" "$1"
}

# 3 s, key frames every second.
playing_short() {
    # shellcheck disable=SC2046
    quiet_ffmpeg -f lavfi -i "$(playing 320x180 3)" -f lavfi -i "$(tone 440 3)" \
        $(fast_h264) -g 30 -c:a aac -ac 2 "$@"
}

make_short_mp4() { playing_short -movflags +faststart "$1"; }
make_short_ts() { playing_short "$1"; }

# A minute, key frames every second.
make_long_mkv() {
    # shellcheck disable=SC2046
    quiet_ffmpeg -f lavfi -i "$(playing 320x180 60)" -f lavfi -i "$(tone 440 60)" \
        $(fast_h264) -g 30 -c:a flac -ac 2 "$1"
}

# Five minutes of few and small frames and few samples: 32 times the speed is no
# work even for an emulator on a busy machine.
make_light_mkv() {
    # shellcheck disable=SC2046
    quiet_ffmpeg -f lavfi -i "testsrc2=size=64x36:rate=5:duration=300" \
        -f lavfi -i "sine=440:duration=300:sample_rate=8000" \
        $(fast_h264) -g 5 -c:a flac -ac 1 "$1"
}

# Five seconds at 30 frames a second, of which after the first only one is there.
make_sparse_mkv() {
    # shellcheck disable=SC2046
    quiet_ffmpeg -f lavfi -i "$(playing 160x90 6),select=lt(t\,1)+not(mod(n\,30))" -vsync vfr \
        $(fast_h264) -g 60 "$1"
}

# Half a minute with a key frame every 15 seconds.
make_distant_mkv() {
    # shellcheck disable=SC2046
    quiet_ffmpeg -f lavfi -i "$(playing 160x90 30)" $(fast_h264) -g 450 "$1"
}

make_silent_mp4() {
    # shellcheck disable=SC2046
    quiet_ffmpeg -f lavfi -i "$(playing 320x180 2)" $(fast_h264) -g 30 "$1"
}

# A still grey picture, on which subtitles show.
grey() { echo "color=c=0x404040:size=640x360:rate=30:duration=20"; }

make_plain_mkv() {
    # shellcheck disable=SC2046
    quiet_ffmpeg -f lavfi -i "$(grey)" -f lavfi -i "$(tone 440 20)" -i <(lines 'Inside' 20) \
        -i <(lines 'Another one, and longer' 20) -map 0 -map 1 -map 2 -map 3 \
        $(fast_h264) -g 60 -c:a flac -c:s subrip -disposition:s 0 "$1"
}

# A black and a white picture, of which the first is the usual one.
make_pictures_mkv() {
    # shellcheck disable=SC2046
    quiet_ffmpeg -f lavfi -i "color=black:size=160x90:rate=30:duration=2" \
        -f lavfi -i "color=white:size=160x90:rate=30:duration=2" -map 0 -map 1 \
        $(fast_h264) -g 30 -disposition:v:0 default "$1"
}

make_plain_mp4() {
    # shellcheck disable=SC2046
    quiet_ffmpeg -f lavfi -i "$(grey)" $(fast_h264) -g 60 "$1"
}

make_lines_srt() { lines 'Outside' 20 >"$1"; }
make_latin1_srt() { lines 'Große Grüße' 20 | iconv -f UTF-8 -t ISO-8859-1 >"$1"; }
make_lines_ass() { lines 'Styled' 20 | quiet_ffmpeg -f srt -i /dev/stdin "$1"; }

# A VobSub pair: the index and the pictures that it points to.
make_words_sub() { python3 "$here/make-vobsub.py" /dev/null "$1"; }
make_words_idx() { python3 "$here/make-vobsub.py" "$1" /dev/null; }
make_languages_sub() { python3 "$here/make-vobsub.py" /dev/null "$1" 2; }
make_languages_idx() { python3 "$here/make-vobsub.py" "$1" /dev/null 2; }

make_tone_mp3() { quiet_ffmpeg -f lavfi -i "$(tone 440 3)" -c:a libmp3lame -b:a 128k "$1"; }
make_tone_flac() { quiet_ffmpeg -f lavfi -i "$(tone 440 3)" -c:a flac "$1"; }

# Raw samples: two seconds, stereo, 44100 a second.
make_tone_s16le_pcm() { quiet_ffmpeg -f lavfi -i "$(tone 440 2)" -ac 2 -ar 44100 -f s16le "$1"; }
make_tone_s16be_pcm() { quiet_ffmpeg -f lavfi -i "$(tone 440 2)" -ac 2 -ar 44100 -f s16be "$1"; }

make_subtitles_only_mkv() { lines 'Alone' 4 | quiet_ffmpeg -f srt -i /dev/stdin -c:s subrip "$1"; }
# Video of which nothing can be decoded, with sound and alone.
make_unseen_mkv() {
    # shellcheck disable=SC2046
    quiet_ffmpeg -f lavfi -i "$(playing 320x180 2)" -f lavfi -i "$(tone 440 2)" \
        $(fast_h264) -c:a flac -bsf:v noise=amount=1 "$1"
}

make_dead_mkv() {
    need unseen.mkv
    quiet_ffmpeg -i "$folder/unseen.mkv" -map 0:v -c copy "$1" 2>/dev/null
}

make_first_of_two_m3u() {
    need silent.mp4 long.mkv
    printf '#EXTM3U\nsilent.mp4\nlong.mkv\n' >"$1"
}

make_first_missing_m3u() {
    need long.mkv
    printf '#EXTM3U\nnowhere.mp4\nlong.mkv\n' >"$1"
}

make_nothing_m3u() { printf '#EXTM3U\n' >"$1"; }

# A locale that writes numbers with a comma, whatever the machine has.
make_locale() {
    mkdir "$1"
    localedef --no-archive -i de_DE -f UTF-8 "$1/de_DE.UTF-8"
}

# What follows is for the look of pictures: soft edges, as half of the colours is
# left out in most formats and programs fill them in differently.
soft() { echo "testsrc2=size=${1:-192x108}:rate=25:duration=2,gblur=2"; }

make_soft_mp4() {
    # shellcheck disable=SC2046
    quiet_ffmpeg -f lavfi -i "$(soft)" $(h264) -crf 8 "$1"
}
# The arguments: a display matrix without its last column, as in with_matrix.
soft_with_matrix() {
    need soft.mp4
    python3 "$here/set-display-matrix.py" "$folder/soft.mp4" "$@"
}
make_turned_90_mp4() { soft_with_matrix 0 1 -1 0 108 0 "$1"; }
make_turned_180_mp4() { soft_with_matrix -1 0 0 -1 192 108 "$1"; }
make_turned_270_mp4() { soft_with_matrix 0 -1 1 0 0 192 "$1"; }

# Two pictures of which the second, the usual one, is stored lying.
make_turned_and_not_mp4() {
    need soft.mp4 turned-90.mp4
    quiet_ffmpeg -i "$folder/soft.mp4" -i "$folder/turned-90.mp4" -map 0 -map 1 -c copy \
        -disposition:v:0 0 -disposition:v:1 default "$1"
}

# Pixels that are not square.
make_anamorphic_mkv() {
    # shellcheck disable=SC2046
    quiet_ffmpeg -f lavfi -i "$(soft 144x108),setsar=4/3" $(h264) -crf 8 "$1"
}

# Without loss, in one format of pixels: file, format, further options.
in_format() {
    quiet_ffmpeg -f lavfi -i "$(soft)" -pix_fmt "$2" -c:v ffv1 "${@:3}" "$1"
}
make_yuv420p10_mkv() { in_format "$1" yuv420p10le; }
make_yuv422p_mkv() { in_format "$1" yuv422p; }
make_yuv422p10_mkv() { in_format "$1" yuv422p10le; }
make_yuv444p_mkv() { in_format "$1" yuv444p; }
make_yuv444p12_mkv() { in_format "$1" yuv444p12le; }

# The same colours in a matrix and a range: file, matrix, range, further names.
in_colours() {
    quiet_ffmpeg -f lavfi -i "$(soft),scale=out_color_matrix=$2:out_range=$3" -pix_fmt yuv420p \
        -c:v ffv1 -colorspace "$4" -color_range "$3" -color_primaries "$5" -color_trc "$6" "$1"
}
make_bt601_mkv() { in_colours "$1" bt601 tv smpte170m smpte170m smpte170m; }
make_bt601_full_mkv() { in_colours "$1" bt601 pc smpte170m smpte170m smpte170m; }
make_bt709_mkv() { in_colours "$1" bt709 tv bt709 bt709 bt709; }
make_bt709_full_mkv() { in_colours "$1" bt709 pc bt709 bt709 bt709; }
make_bt2020_mkv() { in_colours "$1" bt2020 tv bt2020nc bt709 bt709; }

# Of a high dynamic range: file, transfer.
in_high_range() {
    quiet_ffmpeg -f lavfi -i "$(soft),format=gbrp,zscale=tin=bt709:pin=bt709:min=gbr:rin=pc:t=linear:p=bt709:m=gbr:npl=300,format=gbrpf32le,zscale=tin=linear:pin=bt709:min=gbr:p=bt2020:t=$2:m=bt2020nc:r=tv,format=yuv420p10le" \
        -c:v ffv1 -colorspace bt2020nc -color_range tv -color_primaries bt2020 -color_trc "$2" "$1"
}
make_pq_mkv() { in_high_range "$1" smpte2084; }
make_hlg_mkv() { in_high_range "$1" arib-std-b67; }

# Fifty fields a second, two in each frame: file, order, the encoder's options.
interlaced() {
    quiet_ffmpeg -f lavfi -i "testsrc2=size=192x108:rate=50:duration=2,scroll=horizontal=0.02,gblur=2,tinterlace=interleave_$2" \
        -pix_fmt yuv420p "${@:3}" "$1"
}
mpeg2_fields() { echo "-c:v mpeg2video -q:v 2 -g 25 -flags +ildct+ilme"; }
# shellcheck disable=SC2046
make_top_first_ts() { interlaced "$1" top $(mpeg2_fields) -top 1; }
# shellcheck disable=SC2046
make_bottom_first_ts() { interlaced "$1" bottom $(mpeg2_fields) -top 0; }

make_one_frame_mkv() {
    # shellcheck disable=SC2046
    quiet_ffmpeg -f lavfi -i "$(soft)" -frames:v 1 $(h264) -crf 8 "$1"
}

# Frames that show their numbers: eight stripes are the binary digits, the lowest
# one first, white for one. The arguments after the file: the rate, frames from one
# key frame to the next, more filters, and more options of the file.
counted() {
    # shellcheck disable=SC2046,SC2086
    quiet_ffmpeg -f lavfi -i "nullsrc=size=128x32:rate=$2:duration=4,format=yuv420p,geq=lum='if(bitand(N\,pow(2\,floor(X/16)))\,235\,16)':cb=128:cr=128${4-}" \
        $(fast_h264) -crf 12 -g "$3" -vsync passthrough ${5-} "$1"
}
make_counted_60_mkv() { counted "$1" 60 60; }
# AAC begins before time zero, so that all times are moved on: the container's begin
# with the sound's, while the first block is a frame, 21 ms later.
make_counted_sound_mkv() {
    counted "$1" 60 60 "[out0];sine=duration=3:sample_rate=48000[out1]" "-c:a aac -bf 2"
}
make_counted_ts() { counted "$1" 25 25; }
make_counted_film_mp4() { counted "$1" 24000/1001 24; }
# Of each ten frames five are left.
make_counted_varying_mkv() { counted "$1" 60 30 ",select=lt(mod(n*n\,10)\,5)"; }

make_garbage_bin() { seq 1 40 | sha512sum | head -c 100 | tr '0-9a-f' '\200-\217' >"$1"; }
make_empty_bin() { : >"$1"; }

# Makes each file that is not there yet, under another name until it is whole.
need() {
    local file unfinished
    for file in "$@"; do
        [ -e "$folder/$file" ] && continue
        unfinished=$(mktemp -d "$folder/.making-XXXXXX")
        "make_$(tr '.-' '__' <<<"$file")" "$unfinished/$file"
        mv "$unfinished/$file" "$folder/$file"
        rmdir "$unfinished"
    done
}

[ $# -ge 1 ] || { echo "usage: make-media.sh FOLDER [FILE...]" >&2; exit 2; }
if [ "$1" = --list ]; then
    xargs -n 1 <<<"$FILES"
    exit
fi
folder=$1
here=$(dirname -- "$(readlink -f -- "${BASH_SOURCE[0]}")")
shift
mkdir -p "$folder"
read -r -d '' -a every <<<"$FILES" || true
[ $# -gt 0 ] || set -- "${every[@]}"
for file in "$@"; do
    case " ${every[*]} " in
    *" $file "*) need "$file" ;;
    *) echo "make-media.sh: no such file is made: $file" >&2; exit 2 ;;
    esac
done
