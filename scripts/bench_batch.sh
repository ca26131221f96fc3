#!/usr/bin/env bash
# Measures how many pictures a second vorelpaint and other programs paint; docs/benchmarks.md tells more.
#
#     scripts/bench_batch.sh [--quick] [--against COMMIT] [--tool FILE] [--document]
#
#     --quick            four pictures of each kind, once: shows that all of it works, not how fast
#     --against COMMIT   also vorelpaint as it was then
#     --tool FILE        this vorelpaint instead of one built from the tree
#     --document         into docs/benchmarks.md
set -euo pipefail
invoked=$PWD
cd "$(dirname "$0")/.."
. scripts/packages.sh
. scripts/quietly.sh
. scripts/figures.sh
. scripts/skia.sh

quick='' against='' tool='' document=''
while [[ $# -gt 0 ]]; do
    case $1 in
        --quick) quick=--quick ;;
        --against) against=$(git rev-parse --short --verify "$2^{commit}"); shift ;;
        --tool) tool=$(cd "$invoked" && realpath -e "$2"); shift ;;
        --document) document=docs/benchmarks.md ;;
        *) sed -n '2,/^set/{/^#/p}' "scripts/${0##*/}" >&2; exit 2 ;;
    esac
    shift
done

build=build/bench_batch

# build_tool SOURCE FOLDER
build_tool() {
    quietly cmake -S "$1" -B "$2" -G Ninja -DCMAKE_BUILD_TYPE=Release -DVOREL_BUILD_TOOLS=ON
    quietly cmake --build "$2" --target vorelpaint
}

# extract COMMIT FOLDER: the files of the commit, which never change.
extract() {
    [[ ! -d $2 ]] || return 0
    rm -rf "$2.part"
    mkdir -p "$2.part"
    git archive "$1" | tar -x -C "$2.part"
    mv "$2.part" "$2"
}

# Other programs are installed one by one: without one only its rows are missing.
install_rivals() {
    local package
    for package in imagemagick librsvg2-bin; do need_packages "$package" || true; done
    install_skia "$build/node" || true
}

need_packages cmake ninja-build g++ pkg-config libfreetype-dev libharfbuzz-dev libfribidi-dev \
    libfontconfig-dev libunibreak-dev libpng-dev libdeflate-dev nlohmann-json3-dev libcli11-dev \
    fontconfig fonts-dejavu-core git python3 python3-pil
install_rivals

if [[ -z $tool ]]; then
    build_tool . "$build/tool"
    tool=$build/tool/tools/vorelpaint
fi
options=(--tool "$tool" --folder "$build/pictures")
if [[ -n $against ]]; then
    before=$build/$against
    extract "$against" "$before/source"
    build_tool "$before/source" "$before/build"
    options+=(--against "vorelpaint of $against" "$before/build/tools/vorelpaint")
fi

# The Python that Debian's Pillow belongs to, whichever comes first in the PATH.
measure() {
    describe_run "${CXX:-c++}"
    echo
    RIVALS_NODE=$build/node /usr/bin/python3 -B bench/rivals/measure.py "${options[@]}" $quick
}

if [[ -z $document ]]; then
    measure
    exit
fi
measure > "$build/figures.md"
write_figures 'batch figures' "$build/figures.md" "$document"
echo "$document"
