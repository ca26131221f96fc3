#!/usr/bin/env bash
# The same look in seven languages: builds the programs of examples/languages against what users install, runs each and
# compares the pages that they have painted, byte for byte; the picture is that of docs/languages.md. The faces of
# Java, of Python and of JavaScript are those that scripts/android_test.sh, scripts/python.sh and scripts/js.sh have
# built; else they are built now.
#
#     scripts/languages.sh [--update]    --update takes the picture into docs/languages instead of comparing it
set -euo pipefail
cd "$(dirname "$0")/.."
. scripts/packages.sh
. scripts/quietly.sh
. scripts/installed.sh

need_packages cmake ninja-build g++ pkg-config ffmpeg python3 python3-pil openjdk-17-jdk-headless kotlin
# Any Rust of the last years does; Debian's where there is none.
command -v rustc > /dev/null || need_packages rustc

programs=$PWD/examples/languages
build=$PWD/build/languages
pages=$build/pages
rm -rf "$build"
mkdir -p "$pages"
prefix=$(install_library)
quietly scripts/android_test.sh --build
python=$(python_with_the_package)
project=$(project_with_the_package)

library=$(dirname "$(find "$prefix" -name libvoreleffect.so)")
export PKG_CONFIG_PATH=$library/pkgconfig
read -ra flags <<< "$(pkg-config --cflags --libs voreleffect) -Wl,-rpath,$library"
java=$PWD/build/android_tests/voreleffect
classes=$java/android/classes

# run_java CLASS_FILES CLASS PAGE
run_java() {
    java -Djava.library.path="$java:$java/android:$PWD/build/android_tests" -cp "$classes:$1" "$2" "$3"
}

in_cpp() {
    quietly g++ -std=c++17 -Wall -Wextra -Wconversion -Werror "$programs/title.cpp" "${flags[@]}" -o "$build/cpp"
    "$build/cpp" "$1"
}

in_c() {
    quietly gcc -std=c99 -Wall -Wextra -Wpedantic -Wconversion -Werror "$programs/title.c" "${flags[@]}" -o "$build/c"
    "$build/c" "$1"
}

in_python() {
    "$python" -B "$programs/title.py" "$1"
}

in_javascript() {
    cp "$programs/title.mjs" "$project"
    node "$project/title.mjs" "$1"
}

in_java() {
    quietly javac -Xlint:all -Werror -cp "$classes" -d "$build/java" "$programs/Title.java"
    run_java "$build/java" Title "$1"
}

in_kotlin() {
    quietly kotlinc "$programs/title.kt" -cp "$classes" -d "$build/kotlin"
    run_java "$build/kotlin:/usr/share/java/kotlin-stdlib.jar" TitleKt "$1"
}

in_rust() {
    quietly rustc --edition 2021 -D warnings -L "$library" -C link-arg="-Wl,-rpath,$library" -o "$build/rust" \
        "$programs/title.rs"
    "$build/rust" "$1"
}

for language in cpp c python javascript java kotlin rust; do
    "in_$language" "$pages/$language.rgba"
    cmp "$pages/cpp.rgba" "$pages/$language.rgba"
    echo "$language: $(sha256sum < "$pages/$language.rgba" | cut -c -16)"
done

ffmpeg -nostdin -v error -f rawvideo -pixel_format rgba -video_size 100x110 -i "$pages/cpp.rgba" "$pages/title.png"
if [[ ${1:-} == --update ]]; then
    cp "$pages/title.png" docs/languages
else
    # Debian's own Python, to which python3-pil belongs.
    /usr/bin/python3 -B scripts/pictures/compare.py docs/languages "$pages"
fi
