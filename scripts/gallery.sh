#!/usr/bin/env bash
# Paints the gallery: every preset at 48 and 160 pixels, on a dark and on a light background, and in four
# sizes over a ground like a photograph; chalk, which is made for boards, on a green one in place of the
# light one.
#
#     scripts/gallery.sh [FOLDER]    docs/gallery unless told; PNGs in it are removed first
set -euo pipefail
cd "$(dirname "$0")/.."
. scripts/packages.sh

# Debian's own Python, to which python3-pil belongs.
python=/usr/bin/python3
need_packages python3 python3-pil

scripts/demo.sh > /dev/null
folder=${1:-docs/gallery}
mkdir -p "$folder"
rm -f "$folder"/*.png
$python -B scripts/pictures/gallery.py build/demo/tools/vorelpaint "$folder"
