#!/usr/bin/env bash
# Every test that a page names as `Suite.Name` exists. Arguments: the folder of tests, then the pages.
set -euo pipefail
tests=$1
shift
known=$(grep -rhozE '(TYPED_)?TEST(_F|_P)?\([A-Za-z0-9]+,\s*[A-Za-z0-9_]+\)' "$tests" --include='*.cpp' |
    tr '\0' '\n' | tr -d ' \n' | sed -E 's/(TYPED_)?TEST(_F|_P)?\(/\n/g; s/\)//g' | tr ',' '.')
checked=0
missing=0
for name in $(grep -hoE '`[A-Z][A-Za-z0-9]+\.[A-Z][A-Za-z0-9_]+`' "$@" | tr -d '`'); do
    checked=$((checked + 1))
    grep -qx "$name" <<< "$known" || { echo "no such test: $name" >&2; missing=1; }
done
echo "$checked names checked"
[[ $checked -gt 0 && $missing -eq 0 ]]
