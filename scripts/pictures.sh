#!/usr/bin/env bash
# Paints the pictures of the documents: docs/pictures (guide, effect pages, README) and docs/gallery.
#
#     scripts/pictures.sh            both anew
#     scripts/pictures.sh --check    into a temporary folder; fails when a committed one differs in a pixel
set -euo pipefail
cd "$(dirname "$0")/.."
. scripts/packages.sh

# Debian's own Python, to which python3-pil belongs.
python=/usr/bin/python3
need_packages python3 python3-pil

scripts/demo.sh > /dev/null

# paint_into FOLDER: FOLDER/pictures and FOLDER/gallery
paint_into() {
    mkdir -p "$1/pictures"
    rm -f "$1"/pictures/*.png
    $python -B scripts/pictures/paint.py build/demo/tools/vorelpaint "$1/pictures"
    scripts/gallery.sh "$1/gallery"
}

case ${1:-} in
    '') paint_into docs ;;
    --check)
        painted=$(mktemp -d)
        trap 'rm -rf "$painted"' EXIT
        paint_into "$painted"
        result=0
        for folder in pictures gallery; do
            $python -B scripts/pictures/compare.py "docs/$folder" "$painted/$folder" || result=1
        done
        if [ $result -ne 0 ]; then
            echo "pictures differ from what is painted; scripts/pictures.sh paints them anew" >&2
            exit 1
        fi
        echo "all pictures are current"
        ;;
    *) echo "usage: scripts/pictures.sh [--check]" >&2; exit 2 ;;
esac
