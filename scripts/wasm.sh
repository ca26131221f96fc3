#!/usr/bin/env bash
# Builds the library as WebAssembly modules, with vectors, without, and with text, and tests it: the unit tests,
# the table of hashes and the fuzzing inputs under node at both levels, the modules as they are shipped, and the table in
# headless Chromium. Installs what it needs on Debian (as root).
#
#     scripts/wasm.sh            all of it
#     scripts/wasm.sh modules    builds the modules alone
#
# The modules come to stand in build/wasm32/bindings/js/module or build/wasm32-module/bindings/js/module.
set -euo pipefail
cd "$(dirname "$0")/.."
. scripts/packages.sh

need_packages cmake ninja-build clang-19 lld-19 llvm-19 libc++-19-dev-wasm32 libclang-rt-19-dev-wasm32 wasi-libc

scripts/wasm_libraries.sh

# build PRESET
build() {
    cmake --preset "$1" > /dev/null
    cmake --build --preset "$1" -- --quiet
}

if [[ ${1-} == modules ]]; then
    build wasm32-module
    ls -l build/wasm32-module/bindings/js/module/*.wasm
    exit
fi

need_packages g++ pkg-config libfreetype-dev fonts-dejavu-core googletest libgtest-dev chromium
command -v node > /dev/null || need_packages nodejs
build wasm32
# The literal form paints its table in every other build; the pages are the same ones.
ctest --preset wasm32 --parallel "$(nproc)" --progress --exclude-regex 'ByTheLiteralForm|^Docs'
modules=build/wasm32/bindings/js/module
node tests/wasm/module_test.mjs "$modules"

# vectors MODULE: how many instructions of vectors there are in it
vectors() { llvm-objdump-19 --disassemble "$modules/$1" | grep -cE '\b(v128|[if](8x16|16x8|32x4|64x2))\.' || true; }
[[ $(vectors voreleffect.wasm) -gt 0 && $(vectors voreleffect-scalar.wasm) -eq 0 ]] ||
    { echo 'the modules have not the instructions of their levels' >&2; exit 1; }

table=tests/determinism/hashes.txt
echo 'in Chromium:'
node tests/wasm/in_browser.mjs build/wasm32/tests/voreleffect_hashes.wasm --compare "$table" -- "$table"
