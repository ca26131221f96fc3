#!/usr/bin/env bash
# No source of the library that names a float is compiled with fast arithmetic: by itself each refuses, and
# in this build the last word is against it. Arguments: the compiler, the root of the sources, the build's
# compile_commands.json.
set -euo pipefail
compiler=$1 root=$2 commands=$3
fast=(-Ofast -ffast-math -ffinite-math-only)
# Options that -ffast-math stands for; given one by one, clang does not tell of them.
"$compiler" --version | grep -q clang || fast+=(-funsafe-math-optimizations -freciprocal-math -fno-signed-zeros)
level=(-DVOREL_LEVEL=scalar -DVOREL_SCALAR -DVOREL_VECTOR_BYTES=4)

cd "$root"
checked=0
wrong=0
for source in $(grep -lwE 'float|double' {core,simd,property,blend,cores,effect}/*.cpp ops/*/*.cpp); do
    checked=$((checked + 1))
    for flag in "${fast[@]}"; do
        said=$("$compiler" -std=c++17 -I. -Iinclude "${level[@]}" "$flag" -E -o /dev/null "$source" 2>&1) &&
            { echo "$source is compiled with $flag"; wrong=1; }
        [[ $said == *'not with -Ofast'* ]] ||
            { echo "$source does not say why $flag is refused: $said"; wrong=1; }
    done
    command=$(grep -F -- "-c $root/$source\"" "$commands" | head -n 1) || { echo "$source is not built"; wrong=1; }
    flags=$(grep -oE -- ' -f(no-)?fast-math| -Ofast' <<< "$command" | tail -n 1)
    [[ $flags == ' -fno-fast-math' ]] || { echo "$source is compiled with:$flags"; wrong=1; }
done
echo "$checked sources checked"
[[ $checked -gt 15 && $wrong -eq 0 ]]
