#!/usr/bin/env bash
# Compiles and links the Android form without an NDK, for its shape alone: that the __ANDROID__ paths
# compile for both kinds of CPU, and that the library takes from outside exactly what it should. The C library, its maths,
# liblog and the C++ runtime it is linked against are stubs (shape/stubs); nothing of this can run, and
# nothing of it is packaged.
#
#     tests/android/shape.sh    checks; prints what is taken from which library
set -euo pipefail
cd "$(dirname "$0")/../.."

sources=tests/android/shape/stubs

failed=0
complain() {
    echo "$1" >&2
    failed=1
}

# names FILE NM_OPTION... : the symbols of a library or of object files, without a local one
names() { llvm-nm-14 --format=just-symbols --extern-only "$@" | grep -v -e '^$' -e ':$' | LC_ALL=C sort -u; }
# same WHAT EXPECTED ACTUAL : two lists of lines
same() { diff -u --label expected --label actual <(echo "$2") <(echo "$3") || complain "$1 differ"; }
dynamic() { readelf --wide -d "$1" | sed -n "s/.*($2).*\[\(.*\)\]/\1/p" | LC_ALL=C sort; }
lines() { printf '%s\n' "$@" | LC_ALL=C sort; }

# check_library FILE NEEDED... : its name, its needs, its alignment, no text relocations
check_library() {
    local library=$1 alignment
    shift
    same "$library: NEEDED" "$(lines "$@")" "$(dynamic "$library" NEEDED)"
    same "$library: SONAME" "$(basename "$library")" "$(dynamic "$library" SONAME)"
    [[ $(readelf --wide -d "$library") != *TEXTREL* ]] || complain "$library: has text relocations"
    for alignment in $(readelf --wide -l "$library" | awk '$1 == "LOAD" { print $NF }'); do
        ((alignment >= 16384)) || complain "$library: a segment is aligned to $alignment, less than 16 KB"
    done
}

# build_form CPU TARGET... : into $build, with stubs in $stubs
build_form() {
    local name targets=("${@:2}")
    local compile=(clang-14 "--target=$1-linux-android24" "-DSTUBS_FOR_$1" -fPIC -fno-builtin -w)
    mkdir -p "$stubs"
    for name in c m log jnigraphics; do
        "${compile[@]}" -shared -nostdlib -fuse-ld=lld -Wl,-soname,"lib$name.so" "$sources/$name.c" \
            -o "$stubs/lib$name.so"
    done
    for name in cxx_static cxx_catch builtins; do
        "${compile[@]}" -c "$sources/$name.c" -o "$stubs/$name.o"
    done
    llvm-ar-14 crs "$stubs/libc++_static.a" "$stubs"/{cxx_static,cxx_catch,builtins}.o

    VOREL_CPU=$1 VOREL_STUBS=$stubs cmake -S tests/android/shape -B "$build" -G Ninja \
        -DCMAKE_BUILD_TYPE=Release -DCMAKE_TOOLCHAIN_FILE="$PWD/tests/android/shape/toolchain.cmake" > /dev/null
    cmake --build "$build" --parallel 2 --target "${targets[@]}" -- --quiet
    ninja -C "$build" -t cleandead > /dev/null # objects of sources that have gone
}

# check_users : what is linked with the library
check_users() {
    local recipe=$build/libbitmap_recipe.so
    check_library "$build/voreleffect/android/libvoreleffect_jni.so" libvoreleffect.so libc.so libjnigraphics.so
    same "$recipe: NEEDED" "$(lines libvoreleffect.so libjnigraphics.so libc.so)" "$(dynamic "$recipe" NEEDED)"
}

check_form() {
    local library exported objects outside shared runtime name
    library=$build/voreleffect/libvoreleffect.so
    check_library "$library" libc.so libm.so liblog.so
    # clang makes no constructor of a whole object for the abstract classes: nothing could call it.
    exported=$(grep -vE 'VFPropertyC1Ejf$|VFECoreBaseC1Ev$' tests/abi/symbols.txt)
    same "$library: exported symbols" "$exported" "$(names --dynamic --defined-only "$library")"

    # What the objects of the library leave undefined is, name by name, what the stubs have; what is left
    # when the C++ runtime is linked in is, name by name, what the three shared ones have.
    mapfile -t objects < <(find "$build/voreleffect/CMakeFiles" -name '*.o')
    outside=$(LC_ALL=C comm -23 <(names --undefined-only "${objects[@]}") <(names --defined-only "${objects[@]}"))
    shared=$(names --defined-only "$stubs"/lib{c,m,log}.so)
    runtime=$(names --defined-only "$stubs"/{cxx_static,builtins}.o)
    same "$library: symbols from outside (see $sources)" "$(lines "$shared" "$runtime")" "$outside"
    same "$library: undefined symbols (see $sources)" "$shared" "$(names --dynamic --undefined-only "$library")"

    for name in c m log; do
        echo "lib$name.so: $(names --defined-only "$stubs/lib$name.so" | paste -sd ' ')"
    done
    echo "C++ runtime, linked in: $(names --defined-only "$stubs"/{cxx_static,builtins}.o | llvm-cxxfilt-14 | paste -sd ';' | sed 's/;/; /g')"
}

# What uses the library has no code for one kind of CPU: once is enough.
users=(voreleffect_jni bitmap_recipe)
for cpu in aarch64 x86_64; do
    build=build/android_shape/$cpu
    stubs=$PWD/$build/stubs
    build_form "$cpu" voreleffect "${users[@]}"
    echo "$cpu:"
    check_form
    [[ ${#users[@]} -eq 0 ]] || check_users
    users=()
done
[[ $failed -eq 0 ]] && echo "the Android form has its shape"
exit "$failed"
