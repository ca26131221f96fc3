#!/usr/bin/env bash
# Builds the project three times and runs all tests in each: g++ Release, clang with AddressSanitizer
# and UndefinedBehaviorSanitizer, and 64-bit ARM under qemu. Installs what it needs on Debian (as root).
#
#     scripts/test.sh              all three builds
#     scripts/test.sh quick        the unit tests of the g++ Release build alone, an eighth of the random cases
#     scripts/test.sh release      one of them: release, sanitize, arm64; dev; or the library's tests alone by
#                                  libcxx (clang, libc++)
set -euo pipefail
cd "$(dirname "$0")/.."
. scripts/packages.sh

need_packages cmake ninja-build g++ clang-14 libclang-rt-14-dev pkg-config \
    libc++-14-dev libc++abi-14-dev googletest libgtest-dev libbenchmark-dev libstb-dev android-liblog-dev \
    libraqm-dev libfreetype-dev libfribidi-dev libharfbuzz-dev libfontconfig-dev libpng-dev \
    libdeflate-dev libunibreak-dev nlohmann-json3-dev libcli11-dev libharfbuzz-bin fontconfig fonts-dejavu-core \
    fonts-hosny-amiri culmus fonts-lohit-deva fonts-tlwg-loma-ttf fonts-vlgothic fonts-alee \
    fonts-noto-color-emoji fonts-inter-variable \
    python3 python3-jsonschema zsh fish mandoc bsdextrautils ffmpeg \
    locales parallel g++-aarch64-linux-gnu qemu-user-static

presets=("$@")
[[ $# -gt 0 ]] || presets=(release sanitize arm64)
for preset in "${presets[@]}"; do
    echo "== $preset"
    TIMEFORMAT="== $preset: %U s user, %S s system, %R s on the clock"
    time {
        labels=()
        targets=(all)
        case $preset in
            quick)
                preset=release targets=(unit_tests) labels=(--label-regex '^unit$')
                export VOREL_THINNED=8
                ;;
            libcxx)
                targets=(unit_tests reliability_allocation_tests)
                labels=(--label-regex '^(unit|memory)$')
                ;;
        esac
        cmake --preset "$preset" > /dev/null
        cmake --build --preset "$preset" --target "${targets[@]}" -- --quiet
        ctest --preset "$preset" --parallel "$(nproc)" --progress "${labels[@]}"
    }
done
