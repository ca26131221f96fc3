#!/usr/bin/env bash
# Plants the mistakes of tests/mutants in the sources, one at a time, and runs the tests that belong to
# each: all must be caught. Installs what it needs on Debian (as root). By hand and before releases.
#
#     scripts/mutants.sh                    all of them, on as many copies of the tree as there are cores
#     scripts/mutants.sh blend ops          those of some rooms
#     scripts/mutants.sh blend.tail_not_stored   one, by its name
#     scripts/mutants.sh --list             what there is, without running anything
#     scripts/mutants.sh --equal [...]      those that are said to change nothing: no test may see them
#     scripts/mutants.sh --arm64 [...]      those of 64-bit ARM, under qemu
#     scripts/mutants.sh --jobs N [...]     on N copies
#
# Ends with 1 when a mistake survives, or when the line of one is not found exactly once.
set -euo pipefail
cd "$(dirname "$0")/.."
. scripts/packages.sh

case " $* " in
    *" --list "*) ;;
    *" --arm64 "*) need_packages cmake ninja-build g++ pkg-config googletest libfreetype-dev fonts-dejavu-core \
        python3 g++-aarch64-linux-gnu qemu-user-static ;;
    *) need_packages cmake ninja-build g++ pkg-config libgtest-dev libfreetype-dev fonts-dejavu-core \
        android-liblog-dev libraqm-dev libfribidi-dev libharfbuzz-dev libfontconfig-dev libpng-dev \
        libdeflate-dev nlohmann-json3-dev libcli11-dev python3 python3-jsonschema zsh fish mandoc ffmpeg locales ;;
esac
exec python3 -B scripts/mutants.py "$@"
