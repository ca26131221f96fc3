#!/usr/bin/env bash
# Paints a long batch, in which each line has words of its own, and prints how its memory goes: it fails when
# that grows by more than an eighth, and 4 MiB, after the first tenth.
#
#     scripts/long_batch.sh              20,000 lines
#     scripts/long_batch.sh LINES [OPTIONS of vorelpaint, such as --jobs 8]
set -euo pipefail
cd "$(dirname "$0")/.."
. scripts/packages.sh

need_packages procps
lines=${1:-20000}
shift || true
scripts/demo.sh > /dev/null
program=$PWD/build/demo/tools/vorelpaint

folder=$(mktemp -d)
trap 'rm -rf "$folder"' EXIT
cd "$folder"
awk -v n="$lines" 'BEGIN { for (i = 1; i <= n; ++i)
    printf "{\"text\": \"Line %d\", \"output\": \"%d.png\", \"size\": %d}\n", i, i, 12 + i % 40 }' > jobs.jsonl

"$program" --batch jobs.jsonl --preset gold "$@" &
painting=$!
echo "| lines painted | resident memory |"
echo "|---|---|"
first=0
last=0
for part in 1 2 3 4 5 6 7 8 9; do
    while [[ ! -e $((lines * part / 10)).png ]] && kill -0 "$painting" 2> /dev/null; do sleep 0.02; done
    last=$(ps -o rss= -p "$painting") || break
    [[ $first -gt 0 ]] || first=$last
    echo "| $((lines * part / 10)) | $((last / 1024)) MiB |"
done
wait "$painting"
[[ $(find . -name '*.png' | wc -l) -eq $lines ]]
if ((last > first + first / 8 + 4096)); then
    echo "memory has grown from $first to $last KiB" >&2
    exit 1
fi
