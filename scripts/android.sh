#!/usr/bin/env bash
# Builds the library and its Java facade for Android (arm64-v8a, API 21 and newer) with an NDK, and packs
# them as an AAR that native code uses through Prefab. docs/android.md tells how it is used.
#
#     ANDROID_NDK_HOME=... scripts/android.sh [BUILD_DIRECTORY]    build/android-arm64 unless named
set -euo pipefail
cd "$(dirname "$0")/.."

ndk=${ANDROID_NDK_HOME:-}
if [[ ! -f $ndk/build/cmake/android.toolchain.cmake || ! -f $ndk/source.properties ]]; then
    echo "android.sh: set ANDROID_NDK_HOME to an Android NDK; there is none at '$ndk'" >&2
    exit 2
fi
build=${1:-build/android-arm64}

cmake --preset android-arm64 -B "$build"
cmake --build "$build"
rm -rf "$build/stage"
cmake --install "$build" --prefix "$build/stage" --strip

version=$(sed -n 's/^CMAKE_PROJECT_VERSION:[A-Z]*=//p' "$build/CMakeCache.txt")
archive=$build/voreleffect-$version.aar
scripts/pack_aar.py --version "$version" \
    --ndk "$(sed -n 's/^Pkg\.Revision *= *\([0-9]*\).*/\1/p' "$ndk/source.properties")" \
    --include "$build/stage/include" --classes "$build/android/classes" \
    --library "$build/stage/lib/libvoreleffect.so" --jni-library "$build/stage/lib/libvoreleffect_jni.so" \
    --output "$archive"
echo "$archive"
