#!/usr/bin/env bash
# Builds the library and its table of hashes with every compiler, level and CPU at hand, and compares
# each with tests/determinism/hashes.txt. Prints one line per build; fails when any differs.
#
#     scripts/determinism.sh            compares
#     scripts/determinism.sh --update   writes the file anew, painted by the literal engine
set -euo pipefail
cd "$(dirname "$0")/.."
. scripts/packages.sh
need_packages g++ clang-14 libc++-14-dev libc++abi-14-dev g++-aarch64-linux-gnu qemu-user-static

table=tests/determinism/hashes.txt
out=build/determinism
mkdir -p "$out"
sources=(core/*.cpp property/*.cpp blend/*.cpp cores/*.cpp effect/*.cpp tests/determinism/hashes.cpp
    tests/support/literal_{blend,cores,engine}.cpp tests/support/mask_gallery.cpp)

# build NAME COMPILER FLAG...
build() {
    local name=$1
    shift
    "$@" -std=c++17 -ffp-contract=off -I. -Iinclude -DVOREL_GLYPH_MASKS='""' \
        "${sources[@]}" -o "$out/$name" 2> "$out/$name.log" || { cat "$out/$name.log" >&2; return 1; }
}

failed=0
# check NAME RUNNER... : runs a build and prints its line
check() {
    local name=$1 said
    shift
    if said=$("$@" "$out/$name" --compare "$table" 2>&1); then
        printf '%-52s %s\n' "$name" "$said"
    else
        printf '%-52s DIFFERS\n%s\n' "$name" "$said"
        failed=1
    fi
}

if [[ ${1:-} == --update ]]; then
    build literal g++ -O2
    "$out/literal" --literal > "$table"
fi

x86=("g++ -O0" "g++ -O3" "clang++-14 -O0" "clang++-14 -O3" "clang++-14 -O2 -stdlib=libc++")
wide=("g++ -O3 -march=x86-64-v3" "clang++-14 -O3 -march=x86-64-v3")
arm=("aarch64-linux-gnu-g++ -O0" "aarch64-linux-gnu-g++ -O3"
    "aarch64-linux-gnu-g++ -O3 -march=armv8.2-a+dotprod"
    "clang++-14 --target=aarch64-linux-gnu -O3")

[[ $(uname -m) != x86_64 ]] || grep -qw avx2 /proc/cpuinfo && x86+=("${wide[@]}")
for flags in "${x86[@]}"; do
    name=${flags//[^a-zA-Z0-9+-]/_}
    read -ra command <<< "$flags"
    build "$name" "${command[@]}" && check "$name" nice
done
for flags in "${arm[@]}"; do
    name=${flags//[^a-zA-Z0-9+-]/_}
    read -ra command <<< "$flags"
    build "$name" "${command[@]}" && check "$name" qemu-aarch64-static -L /usr/aarch64-linux-gnu
done
exit "$failed"
