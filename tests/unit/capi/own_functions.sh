#!/usr/bin/env bash
# Checks that an object of the C face has the functions of look.h to itself: of inline functions that it
# shared the linker could keep the copies of a program without exceptions, which end the process.
#
#     own_functions.sh OBJECT
set -euo pipefail
symbols=$("${NM:-nm}" --defined-only --demangle "$1")
grep -Eq 'VFontEffect::look_[0-9_]+::Look::key' <<< "$symbols" ||
    { echo "no code of look.h in $1" >&2; exit 1; }
if grep -E ' [WVu] VFontEffect::look_[0-9_]+::' <<< "$symbols"; then
    echo "$1 shares these" >&2
    exit 1
fi
