#!/usr/bin/env bash
# The same look in six languages: builds the programs of examples/languages against the library as it is installed,
# runs each and compares the pages that they have painted, byte for byte; the picture is that of docs/languages.md.
#
#     scripts/languages.sh [--update]    --update takes the picture into docs/languages instead of comparing it
set -euo pipefail
cd "$(dirname "$0")/.."
. scripts/packages.sh
. scripts/quietly.sh
. scripts/installed.sh

need_packages cmake ninja-build g++ pkg-config ffmpeg python3 python3-pil
# Any Rust of the last years does; Debian's where there is none.
command -v rustc > /dev/null || need_packages rustc

programs=$PWD/examples/languages
build=$PWD/build/languages
pages=$build/pages
rm -rf "$build"
mkdir -p "$pages"
install_library

library=$(dirname "$(find "$prefix" -name libvoreleffect.so)")
export PKG_CONFIG_PATH=$library/pkgconfig LD_LIBRARY_PATH=$library
read -ra flags <<< "$(pkg-config --cflags --libs voreleffect)"

in_cpp() {
    quietly g++ -std=c++17 -Wall -Wextra -Wconversion -Werror "$programs/title.cpp" "${flags[@]}" -o "$build/cpp"
    "$build/cpp" "$1"
}

in_c() {
    quietly gcc -std=c99 -Wall -Wextra -Wpedantic -Wconversion -Werror "$programs/title.c" "${flags[@]}" -o "$build/c"
    "$build/c" "$1"
}

in_rust() {
    quietly rustc --edition 2021 -D warnings -L "$library" -o "$build/rust" "$programs/title.rs"
    "$build/rust" "$1"
}

for language in cpp c rust; do
    "in_$language" "$pages/$language.rgba"
    cmp "$pages/cpp.rgba" "$pages/$language.rgba"
    echo "$language: $(sha256sum < "$pages/$language.rgba" | cut -c -16)"
done

ffmpeg -nostdin -v error -f rawvideo -pixel_format rgba -video_size 100x110 -i "$pages/cpp.rgba" "$pages/title.png"
if [[ ${1:-} == --update ]]; then
    mkdir -p docs/languages
    cp "$pages/title.png" docs/languages
else
    # Debian's own Python, to which python3-pil belongs.
    /usr/bin/python3 -B scripts/pictures/compare.py docs/languages "$pages"
fi
