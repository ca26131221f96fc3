#!/usr/bin/env bash
# Builds every example against an installed library, runs it and checks that it paints; the pictures are
# in build/examples/pictures.
#
#     scripts/examples.sh            installs the library into build/examples/prefix first
#     scripts/examples.sh PREFIX     takes the library that is installed there
set -euo pipefail
cd "$(dirname "$0")/.."
. scripts/packages.sh
. scripts/quietly.sh

need_packages cmake ninja-build g++ pkg-config libfreetype-dev libharfbuzz-dev libpng-dev \
    fonts-dejavu-core file

root=$PWD
build=$root/build/examples
pictures=$build/pictures
prefix=${1:-$build/prefix}
if [[ $# -eq 0 ]]; then
    quietly cmake -S . -B "$build/library" -G Ninja -DCMAKE_BUILD_TYPE=Release \
        -DCMAKE_INSTALL_PREFIX="$prefix"
    quietly cmake --build "$build/library" --target install
fi

# paint NAME PICTURE ARGUMENT...: builds an example and runs it among the pictures
paint() {
    local name=$1 picture=$2
    shift 2
    # A new prefix, a new search for the library.
    quietly cmake --fresh -S "examples/$name" -B "$build/$name" -G Ninja -DCMAKE_BUILD_TYPE=Release \
        -DCMAKE_PREFIX_PATH="$prefix" -DCMAKE_CXX_FLAGS="-Wall -Wextra -Wconversion -Wshadow -Werror"
    grep -q "^voreleffect_DIR:PATH=$prefix/" "$build/$name/CMakeCache.txt" ||
        { echo "$name: not built with the library in $prefix" >&2; return 1; }
    quietly cmake --build "$build/$name"
    (cd "$pictures" && "$build/$name/$name" "$@")
    [[ $(file -b "$pictures/$picture") == *"image data"* ]] || { echo "$name: no picture" >&2; return 1; }
    echo "$name: build/examples/pictures/$picture"
}

rm -rf "$pictures"
mkdir -p "$pictures"
paint hello_effect hello_effect.ppm
paint freetype_text freetype_text.png
paint glyph_cache glyph_cache.png
paint stacked_looks stacked_looks.png
paint subtitles subtitles/frame_00000.png "$root/examples/subtitles/sample.srt" subtitles 6

# From 0 to the end of the last cue and half a second more: 8 seconds of 6 frames.
frames=$(find "$pictures/subtitles" -name '*.png' | wc -l)
[[ $frames -eq 48 ]] || { echo "subtitles: $frames frames, not 48" >&2; exit 1; }
