#!/usr/bin/env bash
# Paints a title a line with rsvg-convert, one SVG file and one process a picture and JOBS at a time:
#
#     librsvg_titles.sh shadow|gradient|glow TITLES FOLDER JOBS
#     librsvg_titles.sh --version
#
# Filters calculate in sRGB, which spares converting the picture, and in the area of the picture alone.
set -euo pipefail

if [[ $1 == --version ]]; then
    rsvg-convert --version | sed 's/.*version/librsvg/'
    exit
fi
look=$1 titles=$2 folder=$3 jobs=$4

area='filterUnits="userSpaceOnUse" x="0" y="0" width="1500" height="130"'
area+=' color-interpolation-filters="sRGB"'
text='x="750" y="92" text-anchor="middle" font-family="DejaVu Sans" font-weight="bold" font-size="96"'
outline='stroke-width="8" stroke-linejoin="round" paint-order="stroke"'
case $look in
    shadow)
        definition="<filter id='f' $area><feGaussianBlur in='SourceAlpha' stdDeviation='3'/>
            <feOffset dx='5' dy='5'/>
            <feComponentTransfer><feFuncA type='linear' slope='0.75'/></feComponentTransfer>
            <feMerge><feMergeNode/><feMergeNode in='SourceGraphic'/></feMerge></filter>"
        under='' over="fill='#FFF' stroke='#000' $outline filter='url(#f)'"
        ;;
    gradient)
        definition="<linearGradient id='g' gradientUnits='userSpaceOnUse' x1='0' y1='18' x2='0' y2='113'>
            <stop offset='0' stop-color='#FFE08A'/><stop offset='1' stop-color='#F08A24'/>
            </linearGradient>"
        under='' over="fill='url(#g)' stroke='#5A2A00' $outline"
        ;;
    glow)
        definition="<filter id='f' $area><feGaussianBlur stdDeviation='4'/></filter>"
        under="fill='#2090FF' stroke='#2090FF' stroke-width='12' stroke-linejoin='round'"
        under+=" filter='url(#f)'"
        over="fill='#FFF'"
        ;;
esac

# write_svg TITLE FILE
write_svg() {
    printf '<svg xmlns="http://www.w3.org/2000/svg" width="1500" height="130">'
    printf '<defs>%s</defs>' "$definition"
    [[ -z $under ]] || printf '<text %s %s>%s</text>' "$text" "$under" "$1"
    printf '<text %s %s>%s</text></svg>\n' "$text" "$over" "$1"
}

number=0
while IFS= read -r title; do
    write_svg "$title" > "$folder/$number.svg"
    printf '%s\0' "$folder/$number.png" "$folder/$number.svg"
    number=$((number + 1))
done < "$titles" | xargs -0 -P "$jobs" -n 2 rsvg-convert -o
