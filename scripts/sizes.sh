#!/usr/bin/env bash
# Builds the shared library for 64-bit ARM and x86-64 with g++, and with clang and lld as Android's toolchain
# does, and prints how large it is when it is stripped, and its parts: code, unwind tables, names with
# relocations and virtual tables, constants.
#
#     scripts/sizes.sh [BUILD_DIRECTORY]    build/sizes unless named
set -euo pipefail
cd "$(dirname "$0")/.."
. scripts/packages.sh
need_packages cmake ninja-build g++ g++-aarch64-linux-gnu clang-14 lld binutils

build=${1:-build/sizes}

# build_with NAME OPTION...
build_with() {
    local name=$1
    shift
    cmake -S . -B "$build/$name" -G Ninja -DCMAKE_BUILD_TYPE=Release "$@" > /dev/null
    cmake --build "$build/$name" --target voreleffect -- --quiet
}
# bytes_of NAME...: of the sections of `sections` whose names begin so
bytes_of() {
    local name section size sum=0
    while read -r section size; do
        for name in "$@"; do
            [[ $section != "$name"* ]] || sum=$((sum + 16#$size))
        done
    done < <(awk '{ print $2, $6 }' <<< "$sections")
    echo "$sum"
}
# print_row NAME STRIP
print_row() {
    local file=$build/$1/stripped.so
    "$2" -o "$file" "$build/$1/libvoreleffect.so"
    sections=$(readelf --wide -S "$file" | sed -n 's/^ *\[ *\([0-9]*\)\] */\1 /p')
    printf '| %-17s | %7d | %7d | %7d | %7d | %7d |\n' "$1" "$(stat -c %s "$file")" \
        "$(bytes_of .text .plt .init .fini)" "$(bytes_of .eh_frame .gcc_except)" \
        "$(bytes_of .dyn .rela .gnu .hash .got .data.rel.ro)" "$(bytes_of .rodata)"
}

arm=(-DCMAKE_SYSTEM_NAME=Linux -DCMAKE_SYSTEM_PROCESSOR=aarch64)
clang=(-DCMAKE_CXX_COMPILER=clang++-14 -DCMAKE_SHARED_LINKER_FLAGS=-fuse-ld=lld
    -DCMAKE_EXE_LINKER_FLAGS=-fuse-ld=lld)
build_with arm64-g++ "${arm[@]}" -DCMAKE_CXX_COMPILER=aarch64-linux-gnu-g++
build_with arm64-clang "${arm[@]}" "${clang[@]}" -DCMAKE_CXX_COMPILER_TARGET=aarch64-linux-gnu
build_with x86-64-g++ -DCMAKE_CXX_COMPILER=g++
build_with x86-64-clang "${clang[@]}"

echo '| library           |   bytes |    code |  unwind |   names |   const |'
echo '| ----------------- | ------: | ------: | ------: | ------: | ------: |'
print_row arm64-g++ aarch64-linux-gnu-strip
print_row arm64-clang aarch64-linux-gnu-strip
print_row x86-64-g++ strip
print_row x86-64-clang strip
