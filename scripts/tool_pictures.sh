#!/usr/bin/env bash
# Paints the pictures of docs/vorelpaint.md and docs/film.md anew.
set -euo pipefail
cd "$(dirname "$0")/.."

scripts/demo.sh > /dev/null
build/demo/tools/vorelpaint --sheet --font "DejaVu Sans:bold" --background "#23272E" \
    -o docs/vorelpaint-sheet.png "Type"

# Frame 1 of the cues that the page shows.
work=$(mktemp -d)
trap 'rm -rf "$work"' EXIT
awk '$0 == "```" { inside = 0 } inside; $0 == "```vtt" { inside = 1 }' docs/film.md > "$work/talk.vtt"
build/demo/tools/vorelpaint --subtitles "$work/talk.vtt" --cue-style Narrator=chalk --cue-style shout=comic \
    --width 640 --height 160 --size 32 --background "#23272E" --fps 2 -o "$work/frame_%02d.png"
cp "$work/frame_01.png" docs/film-frame.png
