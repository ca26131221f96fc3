#!/usr/bin/env bash
# Checks that the objects of one level of the instruction set share nothing with other code: an inline
# function outside of the level's namespace would be merged with other copies by the linker, which might
# keep the one with instructions that the CPU does not have.
#
#     objects.sh LEVEL OBJECT...
set -euo pipefail
level=$1
shift
own="11VFontEffect8internal${#level}${level}"
symbols=$("${NM:-nm}" --defined-only --format=posix "$@")
grep -q "$own" <<< "$symbols" || { echo "no code of the level $level in: $*" >&2; exit 1; }
# Names of type information (_ZT), which sanitizers add, are no code.
shared=$(awk '$2 ~ /^[WVu]$/ && $1 !~ /^_ZT/ { print $1 }' <<< "$symbols" | { grep -v "$own" || true; } | sort -u)
[[ -z $shared ]] && exit 0
echo "objects of the level $level hold functions that other objects share:" >&2
c++filt <<< "$shared" >&2
exit 1
