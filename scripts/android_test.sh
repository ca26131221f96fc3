#!/usr/bin/env bash
# Tests what is for Android on the build machine, without an NDK: the Java face on the desktop's JDK, the
# shape of the Android form, the archive, the code of docs/android.md and docs/java.md. Installs what it needs
# on Debian (as root).
#
#     scripts/android_test.sh            builds the tests and runs them
#     scripts/android_test.sh --build    builds them alone
set -euo pipefail
cd "$(dirname "$0")/.."
. scripts/packages.sh
need_packages cmake ninja-build g++ libgtest-dev python3 openjdk-17-jdk-headless \
    clang-14 lld-14 llvm-14 libc++-14-dev g++-aarch64-linux-gnu qemu-user-static \
    android-liblog-dev android-platform-frameworks-native-headers android-libnativehelper-dev proguard-cli

build=build/android_tests
cmake -S tests/android -B "$build" -G Ninja > /dev/null
cmake --build "$build" --parallel 2 -- --quiet
[[ ${1:-} == --build ]] || ctest --test-dir "$build" --parallel 2 --output-on-failure
