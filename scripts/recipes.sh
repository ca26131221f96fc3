#!/usr/bin/env bash
# Builds the recipes against an installed library and runs them: each checks what it has painted. Their
# pictures are compared with those of docs/recipes.md.
#
#     scripts/recipes.sh                     installs the library into build/examples/prefix first
#     scripts/recipes.sh PREFIX              takes the library that is installed there
#     scripts/recipes.sh --update [PREFIX]   takes the pictures into docs/recipes instead
set -euo pipefail
cd "$(dirname "$0")/.."
. scripts/packages.sh
. scripts/quietly.sh

need_packages cmake ninja-build g++ pkg-config libfreetype-dev libpng-dev fonts-dejavu-core ffmpeg \
    qt6-base-dev libsdl2-dev libcairo2-dev libopencv-core-dev libopencv-imgproc-dev python3 python3-pil

update=
if [[ ${1:-} == --update ]]; then
    update=1
    shift
fi
root=$PWD
build=$root/build/examples
pictures=$build/recipe_pictures
prefix=${1:-$build/prefix}
if [[ $# -eq 0 ]]; then
    quietly cmake -S . -B "$build/library" -G Ninja -DCMAKE_BUILD_TYPE=Release \
        -DCMAKE_INSTALL_PREFIX="$prefix"
    quietly cmake --build "$build/library" --target install
fi

# A new prefix, a new search for the library. Not optimised: what takes time is in the library.
quietly cmake --fresh -S examples/recipes -B "$build/recipes" -G Ninja -DCMAKE_PREFIX_PATH="$prefix" \
    -DCMAKE_CXX_FLAGS="-Wall -Wextra -Wconversion -Wshadow -Werror"
grep -q "^voreleffect_DIR:PATH=$prefix/" "$build/recipes/CMakeCache.txt" ||
    { echo "the recipes are not built with the library in $prefix" >&2; exit 1; }
quietly cmake --build "$build/recipes"

rm -rf "$pictures"
mkdir -p "$pictures"
cd "$pictures"
for source in "$root"/examples/recipes/*.cpp; do
    recipe=$(basename "$source" .cpp)
    [[ $recipe != line ]] || continue
    QT_QPA_PLATFORM=offscreen quietly "$build/recipes/$recipe"
    echo "$recipe: build/examples/recipe_pictures/$recipe.png"
done
cd "$root"
if [[ -n $update ]]; then
    mkdir -p docs/recipes
    cp "$pictures"/*.png docs/recipes
else
    # Debian's own Python, to which python3-pil belongs.
    /usr/bin/python3 -B scripts/pictures/compare.py docs/recipes "$pictures"
fi
