#!/usr/bin/env bash
# Paints the gallery: every preset at 48 and 160 pixels, on a dark and on a light background; chalk,
# which is made for boards, on a green one in place of the light one.
#
#     scripts/gallery.sh [FOLDER]    docs/gallery unless told; PNGs in it are removed first
set -euo pipefail
cd "$(dirname "$0")/.."

scripts/demo.sh > /dev/null
paint=build/demo/tools/vorelpaint
folder=${1:-docs/gallery}
mkdir -p "$folder"
rm -f "$folder"/*.png

declare -A backgrounds=([dark]='#23272E' [light]='#F4F1EA')
for preset in $("$paint" --list-presets | awk '{print $1}'); do
    for shade in dark light; do
        background=${backgrounds[$shade]}
        [[ $preset-$shade == chalk-light ]] && background='#2F4F3F'
        common=(--preset "$preset" --background "$background")
        "$paint" "${common[@]}" --font 'DejaVu Sans:bold' --size 160 --padding 16 \
            -o "$folder/$preset-160-$shade.png" "Type"
        "$paint" "${common[@]}" --font 'DejaVu Sans:bold' --size 48 --effect-scale 0.5 \
            -o "$folder/$preset-48-$shade.png" "Summer Sale: 50% Off"
    done
done
