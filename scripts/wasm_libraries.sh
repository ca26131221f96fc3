#!/usr/bin/env bash
# Brings what the module with text is made of to build/wasm_sources: the sources of FreeType, HarfBuzz and
# FriBidi, tables of what libunibreak says, and the headers of nlohmann-json, all of the versions that are
# installed here, so that the same bytes come out of vorelpaint and of the module. What is there already
# stays. Installs what it needs on Debian (as root); the system's own sources of packages stay as they are.
set -euo pipefail
cd "$(dirname "$0")/.."
. scripts/packages.sh

libraries=(libfreetype6 libharfbuzz0b libfribidi0)
need_packages dpkg-dev g++ libunibreak-dev nlohmann-json3-dev wasi-libc libc++-19-dev-wasm32 "${libraries[@]}"

folder=build/wasm_sources
mkdir -p "$folder"
folder=$(cd "$folder" && pwd)

# source_of PACKAGE: its source package and version, as "freetype=2.12.1"
source_of() { dpkg-query -W -f '${source:Package}=${source:Version}' "$1"; }

# prepare_apt: lists of sources, and of what there is, of this folder alone
prepare_apt() {
    local state=$folder/apt file
    mkdir -p "$state"/{parts,lists/partial,archives/partial}
    for file in /etc/apt/sources.list.d/*.sources; do
        [ -e "$file" ] && sed 's/^Types:.*/Types: deb-src/' "$file" > "$state/parts/$(basename "$file")"
    done
    for file in /etc/apt/sources.list /etc/apt/sources.list.d/*.list; do
        [ -e "$file" ] && sed -n 's/^deb /deb-src /p' "$file" > "$state/parts/$(basename "$file" .list).list"
    done
    apt=(apt-get -qq -o "Dir::Etc::SourceList=/dev/null" -o "Dir::Etc::SourceParts=$state/parts"
        -o "Dir::State::Lists=$state/lists" -o "Dir::Cache=$state" -o APT::Sandbox::User=root)
    "${apt[@]}" update
}

# fetch SOURCE: unpacks it, with Debian's patches, into the folder of its name. Where Debian has gone on to another
# revision that one is taken, if it is of the same upstream version.
fetch() {
    local name=${1%%=*} version=${1#*=} work
    [ -n "${apt-}" ] || prepare_apt
    work=$(mktemp -d "$folder/unpacking.XXXXXX")
    (cd "$work" && { "${apt[@]}" source "$1" || "${apt[@]}" source "$name"; } > /dev/null)
    version=${version#*:} && version=${version%-*}
    [ -d "$work/$name-$version" ] || { echo "there is no source of $name $version" >&2; return 1; }
    rm -rf "${folder:?}/$name"
    mv "$work/$name"-*/ "$folder/$name"
    rm -r "$work"
    echo "$1" > "$folder/$name.version"
}

for library in "${libraries[@]}"; do
    source=$(source_of "$library")
    [ "$(cat "$folder/${source%%=*}.version" 2> /dev/null || true)" = "$source" ] || fetch "$source"
done

# Of libunibreak the compiled library is enough to know where lines break.
breaks=$folder/linebreak learner=bindings/js/module/third_party/learn_line_breaks.cpp
version=$(dpkg-query -W -f '${Version}' libunibreak1)
if [ "$(cat "$breaks.version" 2> /dev/null || true)" != "$version" ] ||
    [ "$learner" -nt "$breaks/line_break_tables.h" ]; then
    mkdir -p "$breaks"
    g++ -std=c++17 -O2 "$learner" -lunibreak -o "$breaks/learn_line_breaks"
    "$breaks/learn_line_breaks" > "$breaks/line_break_tables.h"
    echo "$version" > "$breaks.version"
fi

# The headers in a folder of their own: in the system's they stand beside those of its C library.
mkdir -p "$folder/json"
rm -rf "$folder/json/nlohmann"
cp -rp /usr/include/nlohmann "$folder/json/"

# The licences of what is compiled into the module, for the NOTICE of the package.
heading() { printf '\n%s\n%s\n\n' "$(printf -- '-%.0s' {1..108})" "$1"; }
{
    heading 'FreeType, in voreleffect-text.wasm'
    cat "$folder/freetype/docs/FTL.TXT"
    heading 'HarfBuzz, in voreleffect-text.wasm'
    cat "$folder/harfbuzz/COPYING"
    heading 'FriBidi, in voreleffect-text.wasm; scripts/wasm_libraries.sh gets its sources'
    cat "$folder/fribidi/COPYING"
    heading 'libunibreak, in voreleffect-text.wasm: tables of what it says, made by learn_line_breaks.cpp'
    cat /usr/share/doc/libunibreak1/copyright
    heading 'wasi-libc with musl, in voreleffect.wasm and voreleffect-text.wasm'
    cat /usr/share/doc/wasi-libc/copyright
    heading 'libc++, in voreleffect.wasm and voreleffect-text.wasm'
    cat /usr/share/doc/libc++-19-dev-wasm32/copyright
} > "$folder/NOTICE"
