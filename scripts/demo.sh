#!/usr/bin/env bash
# Builds vorelpaint and paints a decorated picture: scripts/demo.sh [TEXT] [PRESET]
set -euo pipefail
cd "$(dirname "$0")/.."
. scripts/packages.sh
. scripts/quietly.sh

usage="usage: scripts/demo.sh [TEXT] [PRESET]

Builds vorelpaint in build/demo, the first time for a minute or two, paints TEXT in the look PRESET into
build/demo/demo.png and prints the path of the picture. docs/looks.md shows every preset.

  TEXT    what is painted [Every letter wears its light]
  PRESET  one of those in style/presets [gold]"
case ${1-} in
    -h | --help)
        echo "$usage"
        exit
        ;;
    -?*)
        echo "demo.sh: no option $1; scripts/demo.sh --help tells what there is" >&2
        exit 2
        ;;
esac
if [[ $# -gt 2 ]]; then
    echo "demo.sh: more than TEXT and PRESET; quotes keep the words of a text together" >&2
    exit 2
fi

text=${1:-Every letter wears its light}
preset=${2:-gold}
build=build/demo
picture=$build/demo.png

# build COMMAND...: on a terminal its progress is seen, elsewhere what it says when it fails.
build() {
    if [[ -t 2 ]]; then "$@" >&2; else quietly "$@"; fi
}

echo "demo.sh: building vorelpaint in $build" >&2
need_packages cmake ninja-build g++ pkg-config fonts-dejavu-core \
    libfreetype-dev libfribidi-dev libharfbuzz-dev libfontconfig-dev libpng-dev \
    libdeflate-dev libunibreak-dev nlohmann-json3-dev libcli11-dev

# The Release build of scripts/test.sh has the same program: where there is one, it is this build as well.
[[ -e $build ]] || rm -f "$build"
if [[ ! -e $build && -f build/release/build.ninja ]]; then ln -s release "$build"; fi
[[ -L $build ]] ||
    quietly cmake -S . -B "$build" -G Ninja -DCMAKE_BUILD_TYPE=Release -DVOREL_BUILD_TOOLS=ON
build cmake --build "$build" --target vorelpaint

"$build/tools/vorelpaint" --preset "$preset" --font "DejaVu Sans:bold" --size 96 --align center \
    --background '#33373D' --padding 24 -o "$picture" -- "$text"
echo "$PWD/$picture"
