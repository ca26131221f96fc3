#!/usr/bin/env bash
# Builds vorelpaint and paints a decorated picture: scripts/demo.sh [TEXT] [PRESET]
set -euo pipefail
cd "$(dirname "$0")/.."
. scripts/packages.sh
. scripts/quietly.sh

text=${1:-Every letter wears its light}
preset=${2:-gold}
build=build/demo
picture=$build/demo.png

need_packages cmake ninja-build g++ pkg-config fonts-dejavu-core \
    libraqm-dev libfreetype-dev libfribidi-dev libharfbuzz-dev libfontconfig-dev libpng-dev \
    nlohmann-json3-dev libcli11-dev

# The Release build of scripts/test.sh has the same program: where there is one, it is this build as well.
[[ -e $build ]] || rm -f "$build"
if [[ ! -e $build && -f build/release/build.ninja ]]; then ln -s release "$build"; fi
[[ -L $build ]] ||
    quietly cmake -S . -B "$build" -G Ninja -DCMAKE_BUILD_TYPE=Release -DVOREL_BUILD_TOOLS=ON
quietly cmake --build "$build" --target vorelpaint

"$build/tools/vorelpaint" --preset "$preset" --font "DejaVu Sans:bold" --size 96 --align center \
    --background '#33373D' --padding 24 -o "$picture" -- "$text"
echo "$PWD/$picture"
