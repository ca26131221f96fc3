#!/usr/bin/env bash
# Paints a title a line with ImageMagick, one process a picture and JOBS at a time:
#
#     imagemagick_titles.sh [--fast] shadow|gradient|glow TITLES FOLDER JOBS
#     imagemagick_titles.sh [--fast] --version
#
# --fast has PNG files compressed by zlib's level 1; the default is 7.
# Only the channel of alpha is blurred. A process has one thread, so that JOBS of them keep as many cores
# busy.
set -euo pipefail

convert=/usr/bin/convert
if [[ ! -x $convert ]]; then convert=/usr/bin/magick; fi
png=(-depth 8) fast=''
if [[ $1 == --fast ]]; then
    png+=(-define png:compression-level=1) fast=', level 1'
    shift
fi
if [[ $1 == --version ]]; then
    "$convert" -version | sed -n "1s/Version: \(ImageMagick [^ ]*\).*/\1$fast/p"
    exit
fi
look=$1 titles=$2 folder=$3 jobs=$4
export MAGICK_THREAD_LIMIT=1

canvas=(-size 1500x130 xc:none -gravity center -pointsize 96
    -font /usr/share/fonts/truetype/dejavu/DejaVuSans-Bold.ttf)
soften=(-channel A -blur 0x4 +channel)

# arguments TITLE: what ImageMagick is told about one picture.
arguments() {
    case $look in
        shadow)
            told=("${canvas[@]}" -fill '#000000BF' -annotate +5+5 "$1" "${soften[@]}"
                -fill black -stroke black -strokewidth 8 -annotate 0 "$1"
                -fill white -stroke none -annotate 0 "$1")
            ;;
        gradient)
            told=("${canvas[@]}" -fill '#5A2A00' -stroke '#5A2A00' -strokewidth 8 -annotate 0 "$1"
                -stroke none \( -size 1500x95 'gradient:#FFE08A-#F08A24' -background '#F08A24'
                -extent 1500x130 -write mpr:ramp +delete \) -tile mpr:ramp -annotate 0 "$1")
            ;;
        glow)
            told=("${canvas[@]}" -fill white -stroke white -strokewidth 12 -annotate 0 "$1"
                "${soften[@]}" -fill '#2090FF' -colorize 100 -fill white -stroke none -annotate 0 "$1")
            ;;
    esac
}

arguments ''
number=0
while IFS= read -r title; do
    arguments "$title"
    printf '%s\0' "${told[@]}" "${png[@]}" "PNG32:$folder/$((number++)).png"
done < "$titles" | xargs -0 -P "$jobs" -n $((${#told[@]} + ${#png[@]} + 1)) "$convert"
