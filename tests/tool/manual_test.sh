#!/usr/bin/env bash
# The manual page is well-formed, bears the day of the release and tells every option of the help:
# manual_test.sh VORELPAINT PAGE CHANGELOG
set -euo pipefail
program=$1
page=$2
changelog=$3

findings=$(mandoc -T lint -W style "$page" || true)
[[ -z $findings ]] || { printf '%s\n' "$findings" >&2; exit 1; }

day=$(sed -n "/^## $("$program" --version | cut -d ' ' -f 2) (\(.*\))\$/{s//\1/p;q}" "$changelog")
[[ -n $day && $(sed -n 1p "$page") == ".TH VORELPAINT 1 $day "* ]] || { echo "the page is not of '$day'" >&2; exit 1; }

text=$(mandoc -T ascii -O width=100 "$page" | col -b)
# Kept whole before it is searched: a search that ends early would break the program's pipe.
help=$("$program" --help)
options=$(sed -n '/^Examples:/q; s/^ *\(-., *\)\?\(-.,\)\?\(--[a-z-]*\).*/\3/p' <<< "$help")
[[ $(wc -l <<< "$options") -ge 20 ]]
for option in $options; do
    grep -q -- "^  *\(-[a-z], \)\?$option\( \|$\)" <<< "$text" || { echo "no $option in the page" >&2; exit 1; }
done
for section in NAME SYNOPSIS DESCRIPTION OPTIONS 'EXIT CODES' EXAMPLES; do
    grep -q "^$section$" <<< "$text" || { echo "no section $section" >&2; exit 1; }
done
