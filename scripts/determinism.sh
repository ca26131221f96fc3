#!/usr/bin/env bash
# Builds the library and its table of hashes with every compiler, optimisation and CPU at hand, paints
# it at every level of the instruction set that the CPU has, and compares each with
# tests/determinism/hashes.txt. Prints one line per build and level; fails when any differs.
#
#     scripts/determinism.sh            compares
#     scripts/determinism.sh --update   writes the file anew, painted by the literal engine
set -euo pipefail
cd "$(dirname "$0")/.."
. scripts/packages.sh
need_packages cmake ninja-build g++ clang-14 libc++-14-dev libc++abi-14-dev pkg-config googletest libgtest-dev \
    libstb-dev android-liblog-dev libfreetype-dev fonts-dejavu-core g++-aarch64-linux-gnu qemu-user-static

table=tests/determinism/hashes.txt
out=build/determinism
failed=0

# build NAME COMPILER FLAGS [CMAKE_OPTION...]
build() {
    local name=$1 compiler=$2 flags=$3
    shift 3
    cmake -S . -B "$out/$name" -G Ninja -DCMAKE_BUILD_TYPE=None -DVOREL_BUILD_TESTS=ON \
        -DCMAKE_CXX_COMPILER="$compiler" -DCMAKE_CXX_FLAGS="$flags" "$@" > /dev/null &&
        cmake --build "$out/$name" --target voreleffect_hashes -- --quiet
}

# check COMPILER FLAGS [CMAKE_OPTION...]: builds, runs and prints the lines
check() {
    local name="$1 $2" directory said
    directory=${name//[^a-zA-Z0-9+-]/_}
    build "$directory" "$@" || { failed=1; return; }
    said=$(ctest --test-dir "$out/$directory" --verbose -R HashesAreThoseOfTheTable 2>&1) ||
        { failed=1; printf '%-52s DIFFERS\n' "$name"; }
    sed -n 's/^[0-9]*: \(.*hashes are equal\|.*differs.*\)$/\1/p' <<< "$said" |
        while IFS= read -r line; do printf '%-52s %s\n' "$name" "$line"; done
}

if [[ ${1:-} == --update ]]; then
    build literal g++ -O2
    "$out/literal/tests/voreleffect_hashes" --literal > "$table"
fi

for flags in -O0 -O3; do
    check g++ $flags
    check clang++-14 $flags
done
check clang++-14 "-O2 -stdlib=libc++"
# The library has the last word, when it is linked too: the compiler's own files would let every process that
# loads it flush subnormal numbers.
for compiler in g++ clang++-14; do
    check "$compiler" -Ofast
    if nm "$out/$compiler"_-Ofast/libvoreleffect_tested.so | grep -w set_fast_math; then
        failed=1
        printf '%-52s FLUSHES when it is loaded\n' "$compiler -Ofast"
    fi
done
if grep -qw avx2 /proc/cpuinfo 2> /dev/null; then
    check g++ "-O3 -march=x86-64-v3"
    check clang++-14 "-O3 -march=x86-64-v3"
fi
if grep -qw avx512vl /proc/cpuinfo 2> /dev/null; then
    check g++ "-O3 -march=x86-64-v4"
fi
arm=(-DCMAKE_SYSTEM_NAME=Linux -DCMAKE_SYSTEM_PROCESSOR=aarch64
    "-DCMAKE_CROSSCOMPILING_EMULATOR=qemu-aarch64-static;-L;/usr/aarch64-linux-gnu")
check aarch64-linux-gnu-g++ -O0 "${arm[@]}"
check aarch64-linux-gnu-g++ -O3 "${arm[@]}"
check clang++-14 "--target=aarch64-linux-gnu -O3" "${arm[@]}"
exit "$failed"
