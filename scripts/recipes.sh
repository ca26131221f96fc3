#!/usr/bin/env bash
# Builds the recipes against the library as it is installed and runs them: each checks what it has painted. Their
# pictures are compared with those of docs/recipes.md.
#
#     scripts/recipes.sh [--update]    --update takes the pictures into docs/recipes instead of comparing them
set -euo pipefail
cd "$(dirname "$0")/.."
. scripts/packages.sh
. scripts/quietly.sh
. scripts/installed.sh

need_packages cmake ninja-build g++ pkg-config libfreetype-dev libharfbuzz-dev libpng-dev fonts-dejavu-core ffmpeg \
    qt6-base-dev libsdl2-dev libcairo2-dev libopencv-core-dev libopencv-imgproc-dev python3 python3-pil

root=$PWD
build=$root/build/examples/recipes
pictures=$root/build/examples/recipe_pictures
prefix=$(install_library)

# Not optimised: what takes time is in the library.
quietly cmake -S examples/recipes -B "$build" -G Ninja -DCMAKE_PREFIX_PATH="$prefix" \
    -DCMAKE_CXX_FLAGS="-Wall -Wextra -Wconversion -Wshadow -Werror"
grep -q "^voreleffect_DIR:PATH=$prefix/" "$build/CMakeCache.txt" ||
    { echo "the recipes are not built with the library in $prefix" >&2; exit 1; }
quietly cmake --build "$build"

rm -rf "$pictures"
mkdir -p "$pictures"
python=$(python_with_the_package)
cd "$pictures"
"$python" -B "$root/examples/recipes/numpy_pillow.py"
echo "numpy_pillow: build/examples/recipe_pictures/numpy_pillow.png"
for source in "$root"/examples/recipes/*.cpp; do
    recipe=$(basename "$source" .cpp)
    [[ $recipe != recipe ]] || continue
    QT_QPA_PLATFORM=offscreen quietly "$build/$recipe"
    echo "$recipe: build/examples/recipe_pictures/$recipe.png"
done
cd "$root"
if [[ ${1:-} == --update ]]; then
    cp "$pictures"/*.png docs/recipes
else
    # Debian's own Python, to which python3-pil belongs.
    /usr/bin/python3 -B scripts/pictures/compare.py docs/recipes "$pictures"
fi
