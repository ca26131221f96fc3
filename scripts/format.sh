#!/usr/bin/env bash
# Checks the layout (clang-format), which way the rooms depend on each other (scripts/arrows.py) and the
# code (clang-tidy, cppcheck) of everything that is tracked.
#
#     scripts/format.sh            check; fails on the first difference or finding
#     scripts/format.sh --fix      lay the sources out anew first
set -euo pipefail
cd "$(dirname "$0")/.."
source scripts/packages.sh

need_packages cmake ninja-build clang-14 pkg-config clang-format-14 clang-tidy-14 cppcheck python3 python3-dev \
    pybind11-dev libfreetype-dev libfribidi-dev libharfbuzz-dev libfontconfig-dev libpng-dev \
    libdeflate-dev libunibreak-dev nlohmann-json3-dev libcli11-dev

mapfile -t sources < <(git ls-files --cached --others --exclude-standard '*.h' '*.cpp')
if [[ "${1:-}" == --fix ]]; then clang-format-14 -i "${sources[@]}"; fi
printf '%s\n' "${sources[@]}" | xargs -P "$(nproc)" -n 40 clang-format-14 --dry-run --Werror

python3 -B scripts/arrows.py --self-test
python3 -B scripts/arrows.py

# Each source by itself, as the builds of the tests do not compile them.
database=build/tidy
cmake --preset tidy > /dev/null
rooms=()
for room in core simd property blend ops cores effect capi unicode style text compose tools; do
    [[ ! -d $room ]] || rooms+=("$room")
done
printf '%s\n' "${sources[@]}" | grep -E "^($(IFS='|'; echo "${rooms[*]}"))/.*\.cpp\$" |
    xargs -P "$(nproc)" -n 1 clang-tidy-14 --quiet -p "$database" 2> /dev/null
# The one of Python is in no database: the options are those of a source beside them, and what Python takes.
python=$(/usr/bin/python3 -c 'import sysconfig; print(sysconfig.get_path("include"))')
printf '%s\n' "${sources[@]}" | grep '^bindings/python/.*\.cpp$' |
    xargs -P "$(nproc)" -n 1 clang-tidy-14 --quiet -p "$database" --extra-arg=-fexceptions \
        --extra-arg=-isystem"$python" 2> /dev/null
cppcheck --quiet --std=c++17 --enable=warning,performance,portability --inline-suppr --error-exitcode=1 \
    -j "$(nproc)" -I. -Iinclude "${rooms[@]}" bindings
echo "layout and code are clean"
