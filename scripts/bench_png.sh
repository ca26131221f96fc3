#!/usr/bin/env bash
# Measures what PNG files of the tool's pictures take, bytes and processor time, beside libpng's default.
#
#     scripts/bench_png.sh               prints the table
#     scripts/bench_png.sh --document    writes it into docs/benchmarks.md
set -euo pipefail
cd "$(dirname "$0")/.."
. scripts/packages.sh
. scripts/quietly.sh
. scripts/figures.sh

need_packages cmake ninja-build g++ pkg-config libbenchmark-dev libfreetype-dev libharfbuzz-dev \
    libfribidi-dev libfontconfig-dev libunibreak-dev libpng-dev libdeflate-dev \
    nlohmann-json3-dev libcli11-dev fontconfig fonts-dejavu-core

build=build/bench_png
quietly cmake -S . -B "$build" -G Ninja -DCMAKE_BUILD_TYPE=Release -DVOREL_BUILD_TOOLS=ON \
    -DVOREL_BUILD_BENCHES=ON
quietly cmake --build "$build" --target vorelpaint_png_bench

if [[ ${1-} != --document ]]; then
    exec "$build/bench/vorelpaint_png_bench"
fi
"$build/bench/vorelpaint_png_bench" > "$build/figures.md"
write_figures 'PNG figures' "$build/figures.md" docs/benchmarks.md
