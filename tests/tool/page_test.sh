#!/usr/bin/env bash
# The commands of the tool's page work as printed, and what they print and paint is what the page shows:
# page_test.sh VORELPAINT PAGE
set -euo pipefail
program=$(realpath "$1")
page=$(realpath "$2")
work=$(mktemp -d)
trap 'rm -rf "$work"' EXIT
cd "$work"

# The blocks of a language, one behind the other.
blocks() { awk -v fence="\`\`\`$1" '$0 == "```" { inside = 0 } inside; $0 == fence { inside = 1 }' "$page"; }
fail() { echo "$1" >&2; exit 1; }

blocks jsonl > titles.jsonl
[[ $(wc -l < titles.jsonl) -eq 3 ]] || fail "the page has no batch"
blocks sh > commands.sh
[[ $(grep -c '^vorelpaint' commands.sh) -eq 6 ]] || fail "the page has not the six commands that were counted"
PATH="${program%/*}:$PATH" bash -e commands.sh > printed

for picture in title.png sheet.png chapter-1.png line-1.png end.png; do
    [[ -s $picture ]] || fail "$picture is not painted"
done
cmp sheet.png "${page%/*}/vorelpaint-sheet.png" || fail "run scripts/tool_pictures.sh"
blocks cpp | diff - comic.cpp || fail "the page shows other calls"

# Times and memory differ from machine to machine.
settled() { sed -E '/^  step /d; s/ +[0-9.]+ ms .*//' "$@"; }
blocks text | sed -n '/^style/,$p' | settled > expected
settled printed | diff expected - || fail "the page shows another explanation"
