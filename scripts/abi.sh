#!/usr/bin/env bash
# Checks what a built library shows to the linker: its exported symbols (tests/abi/symbols.txt), what it
# takes from the C++ runtime (tests/abi/runtime.txt), its name, its needs, its alignment, and, unless libraries
# are named, that README.md tells its size.
#
#     scripts/abi.sh [LIBRARY...]   the release and arm64 builds unless named
#     scripts/abi.sh --update       writes both lists anew from the release build
set -euo pipefail
cd "$(dirname "$0")/.."

list=tests/abi/symbols.txt
runtime_list=tests/abi/runtime.txt
symbols() { nm -D --defined-only "$1" | awk '{print $3}' | LC_ALL=C sort; }
runtime() {
    nm -D --undefined-only --without-symbol-versions "$1" | awk '{print $2}' |
        grep -E '^(_Z|__cxa_|__gxx_|_Unwind_)' | LC_ALL=C sort
}

if [[ ${1:-} == --update ]]; then
    symbols build/release/libvoreleffect.so > "$list"
    runtime build/release/libvoreleffect.so > "$runtime_list"
    exit 0
fi

# told_size ARCHITECTURE: the KiB of the stripped library in README.md
told_size() { sed -n "s/^| Library, stripped.* \([0-9]*\) KiB on $1.*/\1/p" README.md; }
# stripped_size LIBRARY PREFIX: likewise, of this one, by the strip whose name begins so
stripped_size() {
    local copy size
    copy=$(mktemp)
    "$2strip" -o "$copy" "$1"
    size=$(stat -c %s "$copy")
    rm "$copy"
    echo $(((size + 512) / 1024))
}
# check_size LIBRARY ARCHITECTURE PREFIX: sizes may differ by a hundredth, as compilers' patches do
check_size() {
    local size told
    size=$(stripped_size "$1" "$3")
    told=$(told_size "$2")
    ((100 * size >= 99 * told && 100 * size <= 101 * told)) ||
        complain "has $size KiB stripped, $told on $2 as README.md says"
}

failed=0
complain() {
    echo "$library: $1" >&2
    failed=1
}

libraries=("$@")
[[ $# -gt 0 ]] || libraries=(build/release/libvoreleffect.so build/arm64/libvoreleffect.so)
for library in "${libraries[@]}"; do
    diff -u "$list" <(symbols "$library") || complain "exports other symbols than $list"
    diff -u "$runtime_list" <(runtime "$library") || complain "takes other symbols than $runtime_list"
    dynamic=$(readelf --wide -d "$library")
    grep -q 'SONAME.*\[libvoreleffect\.so' <<< "$dynamic" || complain "has no SONAME"
    ! grep -q TEXTREL <<< "$dynamic" || complain "has text relocations"
    needed=$(sed -n 's/.*NEEDED.*\[\(.*\)\]/\1/p' <<< "$dynamic" |
        grep -vE '^(libc|libm|libgcc_s|libstdc\+\+|libc\+\+|ld-linux-[a-z0-9-]+)\.so' || true)
    [[ -z $needed ]] || complain "needs more than the C and C++ runtime: $needed"
    for alignment in $(readelf --wide -l "$library" | awk '$1 == "LOAD" { print $NF }'); do
        ((alignment >= 16384)) || complain "has a segment aligned to $alignment, less than 16 KB"
    done
    echo "$library: $(symbols "$library" | wc -l) symbols checked"
done
if [[ $# -eq 0 ]]; then
    library=build/release/libvoreleffect.so
    check_size "$library" x86-64 ''
    library=build/arm64/libvoreleffect.so
    check_size "$library" '64-bit ARM' aarch64-linux-gnu-
fi
exit "$failed"
