#!/usr/bin/env bash
# Checks the layout (clang-format) and the code (clang-tidy, cppcheck) of everything that is tracked.
#
#     scripts/format.sh            check; fails on the first difference or finding
#     scripts/format.sh --fix      lay the sources out anew first
set -euo pipefail
cd "$(dirname "$0")/.."
source scripts/packages.sh

need_packages clang-format-14 clang-tidy-14 cppcheck

mapfile -t sources < <(git ls-files --cached --others --exclude-standard '*.h' '*.cpp')
if [[ "${1:-}" == --fix ]]; then clang-format-14 -i "${sources[@]}"; fi
clang-format-14 --dry-run --Werror "${sources[@]}"

database=build/sanitize
[[ -f $database/compile_commands.json ]] || scripts/test.sh sanitize
printf '%s\n' "${sources[@]}" | grep -E '^(core|property|blend|effect|cores|style|text|tools)/.*\.cpp$' |
    xargs -P "$(nproc)" -n 4 clang-tidy-14 --quiet -p "$database" 2> /dev/null
cppcheck --quiet --std=c++17 --enable=warning,performance,portability --inline-suppr --error-exitcode=1 \
    -I. -Iinclude core property blend cores effect style text tools
echo "layout and code are clean"
