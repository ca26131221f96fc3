#!/usr/bin/env bash
# Builds the library and its Java face for Android (arm64-v8a and x86_64, API 21 and newer) with an NDK, and
# packs them as an AAR that native code uses through Prefab, in a Maven repository of one folder.
# docs/android.md tells how they are used.
#
#     ANDROID_NDK_HOME=... scripts/android.sh [BUILD_DIRECTORY]    build/android unless named
#
# Prints where the AAR and the repository are.
set -euo pipefail
cd "$(dirname "$0")/.."
. scripts/quietly.sh

ndk=${ANDROID_NDK_HOME:-}
if [[ ! -f $ndk/build/cmake/android.toolchain.cmake || ! -f $ndk/source.properties ]]; then
    echo "android.sh: set ANDROID_NDK_HOME to an Android NDK; there is none at '$ndk'" >&2
    exit 2
fi
build=${1:-build/android}

libraries=()
for abi in arm64-v8a x86_64; do
    cmake --preset "android-${abi%-v8a}" -B "$build/$abi"
    cmake --build "$build/$abi" --target voreleffect voreleffect_jni
    rm -rf "$build/$abi/stage"
    cmake --install "$build/$abi" --prefix "$build/$abi/stage" --strip
    libraries+=(--libraries "$abi=$build/$abi/stage/lib")
done

# Headers and classes are the same for all.
version=$(sed -n 's/^CMAKE_PROJECT_VERSION:[A-Z]*=//p' "$build/$abi/CMakeCache.txt")
archive=$build/voreleffect-$version.aar
scripts/pack_aar.py --version "$version" \
    --ndk "$(sed -n 's/^Pkg\.Revision *= *\([0-9]*\).*/\1/p' "$ndk/source.properties")" \
    --include "$build/$abi/stage/include" --classes "$build/$abi/android/classes" \
    "${libraries[@]}" --output "$archive"

rm -rf "$build/javadoc" "$build/maven"
quietly javadoc -quiet -notimestamp -encoding UTF-8 --release 8 -Xdoclint:none \
    -windowtitle "voreleffect $version" --source-path "android/java:android/stubs" -d "$build/javadoc" org.voreleffect
scripts/pack_maven.py --version "$version" --aar "$archive" --sources android/java \
    --javadoc "$build/javadoc" --output "$build/maven"
echo "$archive"
echo "$build/maven"
