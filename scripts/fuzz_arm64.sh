#!/usr/bin/env bash
# Replays inputs of the fuzz targets that paint on 64-bit ARM, under qemu, at every level of the
# instruction set: the committed ones, and a share of those that scripts/fuzz.sh has kept. Installs what it
# needs on Debian (as root).
#
#     scripts/fuzz_arm64.sh           400 kept inputs of each target
#     scripts/fuzz_arm64.sh INPUTS
set -euo pipefail
cd "$(dirname "$0")/.."
. scripts/packages.sh

need_packages cmake ninja-build g++ pkg-config googletest libgtest-dev libfreetype-dev fonts-dejavu-core \
    g++-aarch64-linux-gnu qemu-user-static

share=${1:-400}
targets=(fuzz_effect_set fuzz_blender fuzz_capi fuzz_differential)
cmake --preset arm64 > /dev/null
cmake --build --preset arm64 --target "${targets[@]/%/_replay}" -- --quiet

for target in "${targets[@]}"; do
    kept=()
    if [[ -d build/fuzz/corpus/$target ]]; then
        # The fuzzer names an input by its hash: the first ones in that order are any ones.
        mapfile -t kept < <(find "build/fuzz/corpus/$target" -type f | LC_ALL=C sort)
    fi
    replayed=("tests/fuzz/corpus/$target" "${kept[@]:0:$share}")
    log=build/arm64/$target.log
    if ! qemu-aarch64-static -L /usr/aarch64-linux-gnu "build/arm64/tests/fuzz/${target}_replay" \
        "${replayed[@]}" > "$log" 2>&1; then
        tail -n 20 "$log" >&2 # its last name is that of the input
        echo "$target fails on 64-bit ARM: $log" >&2
        exit 1
    fi
    echo "$target: $(tail -n 1 "$log")"
done
