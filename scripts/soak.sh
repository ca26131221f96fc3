#!/usr/bin/env bash
# Paints many random runs and shows that memory stays flat and results stay the same.
#
#     scripts/soak.sh              100,000 runs
#     scripts/soak.sh RUNS
set -euo pipefail
cd "$(dirname "$0")/.."
. scripts/packages.sh

need_packages cmake ninja-build g++ pkg-config googletest libgtest-dev libfreetype-dev fonts-dejavu-core \
    android-liblog-dev

build=build/soak
cmake -S . -B "$build" -G Ninja -DCMAKE_BUILD_TYPE=Release -DCMAKE_CXX_COMPILER=g++ \
    -DVOREL_BUILD_TESTS=ON -DVOREL_WERROR=ON > /dev/null
cmake --build "$build" --target soak -- --quiet
time "$build/tests/reliability/soak" "${1:-100000}"
