#!/usr/bin/env bash
# Runs the tests of separate threads, and of the tool's crew, under ThreadSanitizer.
set -euo pipefail
cd "$(dirname "$0")/.."
. scripts/packages.sh

need_packages cmake ninja-build g++ clang-14 libclang-rt-14-dev pkg-config googletest libgtest-dev \
    libfreetype-dev libfribidi-dev libharfbuzz-dev libfontconfig-dev libpng-dev libdeflate-dev \
    libunibreak-dev nlohmann-json3-dev libcli11-dev libraqm-dev fonts-dejavu-core android-liblog-dev

# ThreadSanitizer maps fixed addresses: on kernels that spread mappings widely it needs them unspread.
run=()
if setarch --addr-no-randomize true 2> /dev/null; then run=(setarch --addr-no-randomize); fi

build=build/thread
cmake -S . -B "$build" -G Ninja -DCMAKE_BUILD_TYPE=RelWithDebInfo -DCMAKE_CXX_COMPILER=clang++-14 \
    -DCMAKE_CXX_FLAGS='-fsanitize=thread -fno-omit-frame-pointer' \
    -DCMAKE_CXX_FLAGS_RELWITHDEBINFO='-O2 -gline-tables-only -DNDEBUG' -DVOREL_ASSERTIONS=ON \
    -DVOREL_BUILD_TESTS=ON -DVOREL_BUILD_TOOLS=ON -DVOREL_WERROR=ON -DVOREL_UNITY=ON > /dev/null
"${run[@]}" cmake --build "$build" --target reliability_threads_tests vorelpaint_series_tests -- --quiet

# A race shows only when both accesses are recent: the tests run several times.
export TSAN_OPTIONS='halt_on_error=1 history_size=7'
"${run[@]}" "$build/tests/reliability/reliability_threads_tests" --gtest_repeat=3
series=$build/tests/tool/vorelpaint_series_tests
waiting='Jobs/PipedSeries.OldFiles*' # sleeps for seconds: once
"${run[@]}" "$series" --gtest_filter="$waiting"
"${run[@]}" "$series" --gtest_repeat=3 \
    --gtest_filter="Crew.*:Threads/CrewOf.*:Series.AnyNumber*:Series.Sheet*:Series.WhatCameBefore*:Jobs/PipedSeries.*-$waiting"
