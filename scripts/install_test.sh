#!/usr/bin/env bash
# Takes the library as its users do, from outside the tree: by find_package, pkg-config, add_subdirectory
# and FetchContent, shared and static, from a prefix that was moved; then builds the Debian packages and
# takes it from them (as root; they are removed afterwards); then builds and runs the examples.
set -euo pipefail
cd "$(dirname "$0")/.."
. scripts/packages.sh
. scripts/quietly.sh
need_packages cmake ninja-build g++ pkg-config binutils python3 python3-numpy python3-pil ffmpeg

source=$PWD
build=$source/build/install
outside=$(mktemp -d)
version=$(sed -n '/^## \([0-9.]*\) .*/{s//\1/p;q}' CHANGELOG.md)
packages=()
clean_up() {
    rm -rf "$outside"
    # The names are those that this run has installed.
    [[ ${#packages[@]} -eq 0 ]] || dpkg --purge "${packages[@]}" > /dev/null
}
trap clean_up EXIT

fail() {
    echo "$1" >&2
    exit 1
}

cp -r tests/install/consumer "$outside/sources"
cp -r tests/install/c_consumer "$outside/c_sources"

# check WHAT KIND PROGRAM PLUGIN: a built consumer works and has taken the library in as KIND.
check() {
    local what=$1 kind=$2 program=$3 plugin=$4 said needs
    said=$("$program") || fail "$what: the program fails"
    [[ $said == "$version" ]] || fail "$what: the headers say version $said, CHANGELOG.md $version"
    for file in "$program" "$plugin"; do
        needs=$(readelf --wide -d "$file" | sed -n 's/.*NEEDED.*\[libvoreleffect\(.*\)\]/\1/p')
        case $kind in
            shared) [[ $needs == .so.1 ]] || fail "$what: $file does not need libvoreleffect.so.1" ;;
            static) [[ -z $needs ]] || fail "$what: $file needs libvoreleffect$needs" ;;
        esac
    done
    ! nm -DC --defined-only "$plugin" | grep VFontEffect || fail "$what: the plug-in exports the library"
    echo "$what, $kind: a program and a plug-in paint"
}

# by_cmake WHAT KIND OPTION...
by_cmake() {
    local what=$1 kind=$2 out
    shift 2
    out=$(mktemp -d -p "$outside")
    quietly cmake -S "$outside/sources" -B "$out" -G Ninja "$@"
    quietly cmake --build "$out"
    check "$what" "$kind" "$out/consumer" "$out/libplugin.so"
}

# by_pkg_config WHAT KIND OPTION...: the options are those of pkg-config
by_pkg_config() {
    local what=$1 kind=$2 out flags libs
    shift 2
    out=$(mktemp -d -p "$outside")
    [[ $(pkg-config --modversion voreleffect) == "$version" ]] || fail "$what: another version"
    read -ra flags <<< "$(pkg-config "$@" --cflags voreleffect)"
    read -ra libs <<< "$(pkg-config "$@" --libs voreleffect) -Wl,-rpath,$(pkg-config --variable=libdir voreleffect)"
    local source=$outside/sources
    g++ -fvisibility=hidden -fvisibility-inlines-hidden -fPIC -shared "${flags[@]}" "$source/plugin.cpp" \
        "${libs[@]}" -o "$out/libplugin.so"
    # Linked by gcc, which adds no library of its own that the package should have named.
    g++ "${flags[@]}" -c "$source/consumer.cpp" -o "$out/consumer.o"
    gcc "$out/consumer.o" "${libs[@]}" -lstdc++ -o "$out/consumer"
    check "$what" "$kind" "$out/consumer" "$out/libplugin.so"
}

# check_c WHAT KIND PROGRAM: a built program in C paints, and asks for no C++ runtime where the shared
# library does.
check_c() {
    local what=$1 kind=$2 program=$3 said needs
    said=$("$program") || fail "$what: the program in C fails"
    [[ $said == "$version" ]] || fail "$what: the library says version $said, CHANGELOG.md $version"
    needs=$(readelf --wide -d "$program" | sed -n 's/.*NEEDED.*\[\(.*\)\]/\1/p')
    [[ $kind == static || $needs != *stdc++* ]] || fail "$what: the program in C needs libstdc++"
    echo "$what, $kind: a program in C paints"
}

# c_by_cmake WHAT KIND OPTION...
c_by_cmake() {
    local what=$1 kind=$2 out
    shift 2
    out=$(mktemp -d -p "$outside")
    quietly cmake -S "$outside/c_sources" -B "$out" -G Ninja "$@"
    quietly cmake --build "$out"
    check_c "$what" "$kind" "$out/c_consumer"
}

# c_by_pkg_config WHAT KIND OPTION...: the options are those of pkg-config
c_by_pkg_config() {
    local what=$1 kind=$2 out flags
    shift 2
    out=$(mktemp -d -p "$outside")
    read -ra flags <<< "$(pkg-config "$@" --cflags --libs voreleffect) -Wl,-rpath,$(pkg-config --variable=libdir voreleffect)"
    gcc -std=c99 -Wall -Wextra -Wpedantic -Werror "$outside/c_sources/c_consumer.c" "${flags[@]}" -o "$out/c_consumer"
    check_c "$what" "$kind" "$out/c_consumer"
}

declare -A shared=([shared]=ON [static]=OFF)
declare -A moved=()
for kind in shared static; do
    quietly cmake -S . -B "$build/$kind" -G Ninja -DCMAKE_BUILD_TYPE=Release \
        -DBUILD_SHARED_LIBS="${shared[$kind]}" -DCMAKE_INSTALL_PREFIX="$outside/$kind"
    quietly cmake --build "$build/$kind"
    quietly cmake --install "$build/$kind"
    moved[$kind]="$outside/moved-$kind"
    mv "$outside/$kind" "${moved[$kind]}"
    ! grep -rlF -e "$outside" -e "$source" "${moved[$kind]}" || fail "an installed file names a place"

    by_cmake find_package $kind -DCMAKE_PREFIX_PATH="${moved[$kind]}" -DCMAKE_BUILD_TYPE=Release
    pc=$(find "${moved[$kind]}" -name voreleffect.pc -printf %h)
    static=()
    [[ $kind == shared ]] || static=(--static)
    PKG_CONFIG_PATH=$pc by_pkg_config pkg-config $kind "${static[@]}"
    c_by_cmake find_package $kind -DCMAKE_PREFIX_PATH="${moved[$kind]}" -DCMAKE_BUILD_TYPE=Release
    PKG_CONFIG_PATH=$pc c_by_pkg_config pkg-config $kind "${static[@]}"
    for way in add_subdirectory FetchContent; do
        by_cmake $way $kind -DTAKE=$way -DVOREL_SOURCE="$source" -DBUILD_SHARED_LIBS="${shared[$kind]}"
    done

    # Neither package manager is at hand: stand-ins run the port and the recipe.
    quietly cmake -DPORT_DIR="$source/packaging/vcpkg/ports/voreleffect" -DOUT="$outside/vcpkg-$kind" \
        -DVERSION="$version" -DSHARED="${shared[$kind]}" -P tests/install/vcpkg_stand_in.cmake
    quietly python3 tests/install/conan_stand_in.py packaging/conan "$outside/conan-$kind" $kind
    echo "vcpkg port and Conan recipe, $kind: stand-ins run them"
done

# Another major number is refused.
! cmake -S "$outside/sources" -B "$outside/refused" -DCMAKE_PREFIX_PATH="${moved[shared]}" -DWANTED=1.0 \
    > /dev/null 2>&1 || fail "find_package takes $version for 1.0"

# Each component by itself: the shared library alone runs a program.
quietly cmake --install "$build/shared" --component runtime --prefix "$outside/runtime"
[[ $(find "$outside/runtime" ! -type d -printf '%f\n' | grep -v '^libvoreleffect\.so\.1') == "" ]] ||
    fail "the component runtime has more than the library"

scripts/examples.sh "${moved[shared]}"

if [[ $(id -u) -ne 0 ]]; then
    echo "Debian packages: not tried, which takes root"
    exit
fi

files=$(scripts/debian.sh)
mapfile -t files <<< "$files"
names=(libvoreleffect1 libvoreleffect-dev vorelpaint python3-voreleffect)
for file in "${files[@]}"; do
    depends=$(dpkg-deb --field "$file" Depends)
    [[ $file == */libvoreleffect1_* || $file == */python3-voreleffect_* || $depends == *"libvoreleffect1 ("* ]] ||
        fail "$file does not depend on libvoreleffect1"
    [[ $file != */vorelpaint_* || ", $depends," == *", ffmpeg,"* ]] || fail "$file does not depend on ffmpeg"
done
! dpkg-query -W "${names[@]}" 2> /dev/null | grep . || fail "a package is installed already: not touched"
packages=("${names[@]}")
quietly dpkg --install "${files[@]}"
by_cmake "Debian, find_package" shared -DCMAKE_BUILD_TYPE=Release
by_pkg_config "Debian, pkg-config" shared
c_by_cmake "Debian, find_package" shared -DCMAKE_BUILD_TYPE=Release
c_by_pkg_config "Debian, pkg-config" shared
picture=$outside/picture.png
(cd / && vorelpaint --preset gold -o "$picture" "Installed")
[[ $(file -b "$picture") == PNG* ]] || fail "Debian: vorelpaint paints no picture"
printf '00:00:00,000 --> 00:00:00,200\nInstalled\n' > "$outside/film.srt"
(cd / && vorelpaint --subtitles "$outside/film.srt" --background "#204060" -o "$outside/film.mp4")
[[ $(file -b "$outside/film.mp4") == *MP4* ]] || fail "Debian: vorelpaint makes no film"
[[ $(vorelpaint --version) == "vorelpaint $version" ]] || fail "Debian: vorelpaint tells another version"
# Kept whole before it is searched: a search that ends at its first match would break ldd's pipe.
taken=$(ldd "$(command -v vorelpaint)")
grep -q '=> \(/usr\)\?/lib.*libvoreleffect.so.1' <<< "$taken" ||
    fail "Debian: vorelpaint does not take the library from its package"
tests/tool/installed_test.sh "$(command -v vorelpaint)" /usr || fail "Debian: not all that vorelpaint names"
echo "Debian: vorelpaint paints, and its pages are there"
(cd / && /usr/bin/python3 -B "$source/tests/install/python_consumer.py" "$picture" "$version") ||
    fail "Debian: the package of Python does not paint what vorelpaint does"
! readelf --wide -d /usr/lib/python3/dist-packages/voreleffect/*.so | grep libvoreleffect ||
    fail "Debian: the module of Python needs the library beside it"
echo "Debian: the package of Python paints what vorelpaint does"
# What Python itself compiles goes with the package.
[[ -d /usr/lib/python3/dist-packages/voreleffect/__pycache__ ]] || fail "Debian: the package of Python is not compiled"
quietly dpkg --purge python3-voreleffect
[[ ! -e /usr/lib/python3/dist-packages/voreleffect ]] || fail "Debian: the package of Python leaves files behind"
packages=(libvoreleffect1 libvoreleffect-dev vorelpaint)
