#!/usr/bin/env bash
# Builds every example against an installed library, runs it and checks that it paints, the same again and
# another picture without any one of its effects; the pictures are in build/examples/pictures.
#
#     scripts/examples.sh            installs the library into build/examples/prefix first
#     scripts/examples.sh PREFIX     takes the library that is installed there
set -euo pipefail
cd "$(dirname "$0")/.."
. scripts/packages.sh
. scripts/quietly.sh

need_packages cmake ninja-build g++ pkg-config libfreetype-dev libharfbuzz-dev libpng-dev \
    fonts-dejavu-core file ffmpeg python3

root=$PWD
build=$root/build/examples
pictures=$build/pictures
prefix=${1:-$build/prefix}
if [[ $# -eq 0 ]]; then
    quietly cmake -S . -B "$build/library" -G Ninja -DCMAKE_BUILD_TYPE=Release \
        -DCMAKE_INSTALL_PREFIX="$prefix"
    quietly cmake --build "$build/library" --target install
fi

PKG_CONFIG_PATH=$(dirname "$(find "$prefix" -name voreleffect.pc)")
export PKG_CONFIG_PATH

# compile NAME: builds an example
compile() {
    local name=$1
    # A new prefix, a new search for the library.
    quietly cmake --fresh -S "examples/$name" -B "$build/$name" -G Ninja -DCMAKE_BUILD_TYPE=Release \
        -DCMAKE_PREFIX_PATH="$prefix" -DCMAKE_CXX_FLAGS="-Wall -Wextra -Wconversion -Wshadow -Werror"
    grep -q "^voreleffect_DIR:PATH=$prefix/" "$build/$name/CMakeCache.txt" ||
        { echo "$name: not built with the library in $prefix" >&2; return 1; }
    quietly cmake --build "$build/$name"
}

# see_effects NAME ARGUMENT...: each effect of the example is seen in what it paints
see_effects() {
    local name=$1 modules=(voreleffect freetype2 harfbuzz libpng) flags libs
    shift
    read -ra flags <<< "$(pkg-config --cflags "${modules[@]}")"
    read -ra libs <<< "$(pkg-config --libs "${modules[@]}")"
    "${CXX:-g++}" -std=c++17 -include scripts/docs/seen_effects.h "${flags[@]}" "examples/$name/$name.cpp" \
        -o "$build/$name/seen" "${libs[@]}" "-Wl,-rpath,$(pkg-config --variable=libdir voreleffect)"
    echo "$name: $(python3 -B scripts/docs/seen_effects.py "$build/$name/seen" "$@")"
}

# paint NAME PICTURE ARGUMENT...: builds an example and runs it among the pictures
paint() {
    local name=$1 picture=$2
    shift 2
    compile "$name"
    (cd "$pictures" && "$build/$name/$name" "$@")
    [[ $(file -b "$pictures/$picture") == *"image data"* ]] || { echo "$name: no picture" >&2; return 1; }
    echo "$name: build/examples/pictures/$picture"
    see_effects "$name" "$@"
}

rm -rf "$pictures"
mkdir -p "$pictures"
paint hello_effect hello_effect.ppm
paint freetype_text freetype_text.png
paint glyph_cache glyph_cache.png
paint stacked_looks stacked_looks.png

# Laid over a film, as the program's source says, the cues of the sample are seen in the frames of their
# times, from 0.5, 3.0 and 5.3 seconds to 2.5, 5.0 and 7.5; the others stay what they are.
compile subtitles
see_effects subtitles "$root/examples/subtitles/sample.srt"
film=$build/subtitles/film.mkv
subtitled=$build/subtitles/subtitled.mkv
lossless=(-c:v ffv1 -pix_fmt gbrp -y)
ffmpeg -nostdin -v error -f lavfi -i testsrc2=size=640x360:rate=25:duration=8 "${lossless[@]}" "$film"
"$build/subtitles/subtitles" examples/subtitles/sample.srt |
    ffmpeg -v error -i "$film" -f rawvideo -pixel_format rgba -video_size 640x360 -framerate 25 -i - \
        -filter_complex "[1:v]format=gbrap,unpremultiply=inplace=1[cues];[0:v][cues]overlay=format=gbrp" \
        "${lossless[@]}" "$subtitled"
frames_of() { ffmpeg -nostdin -v error -i "$1" -f framemd5 - | sed '/^#/d; s/.*, *//'; }
seen=$(paste <(frames_of "$film") <(frames_of "$subtitled") | awk '$1 != $2 { print NR - 1 }')
[[ $seen == "$(seq 13 62; seq 75 124; seq 133 187)" ]] ||
    { echo "subtitles: seen in the frames ${seen//$'\n'/ }" >&2; exit 1; }
ffmpeg -nostdin -v error -ss 4 -i "$subtitled" -frames:v 1 -y "$pictures/subtitles.png"
echo "subtitles: build/examples/pictures/subtitles.png"
