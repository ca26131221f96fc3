#!/usr/bin/env bash
# Builds the Debian packages libvoreleffect1, libvoreleffect-dev, vorelpaint and python3-voreleffect; says where they are.
set -euo pipefail
cd "$(dirname "$0")/.."
. scripts/packages.sh
. scripts/quietly.sh

need_packages cmake ninja-build g++ pkg-config dpkg-dev file gzip \
    libfreetype-dev libfribidi-dev libharfbuzz-dev libunibreak-dev libfontconfig-dev libpng-dev \
    libdeflate-dev nlohmann-json3-dev libcli11-dev python3-dev pybind11-dev

# What others have compiled of the same sources is taken, wherever they stood.
export CCACHE_BASEDIR=${CCACHE_BASEDIR:-$PWD} CCACHE_NOHASHDIR=1

build=build/debian
# In /usr the multiarch directories are chosen, and programs need no search path of their own. No path
# of this machine gets into the packages.
quietly cmake -S . -B "$build" -G Ninja -DCMAKE_BUILD_TYPE=Release -DCMAKE_INSTALL_PREFIX=/usr \
    -DCMAKE_SKIP_INSTALL_RPATH=ON -DVOREL_BUILD_TOOLS=ON -DVOREL_BUILD_PYTHON=ON \
    -DPython3_EXECUTABLE=/usr/bin/python3 -DVOREL_WERROR="${VOREL_WERROR:-OFF}" \
    -DVOREL_UNITY="${VOREL_UNITY:-OFF}" \
    -DVOREL_PRESET_DIR=/usr/share/voreleffect/presets
quietly cmake --build "$build"

rm -rf "$build/packages"
quietly cpack --config "$build/CPackConfig.cmake" -B "$build/packages"
ls "$PWD/$build/packages"/*.deb
