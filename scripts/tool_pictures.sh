#!/usr/bin/env bash
# Paints the picture of docs/vorelpaint.md anew.
set -euo pipefail
cd "$(dirname "$0")/.."

scripts/demo.sh > /dev/null
build/demo/tools/vorelpaint --sheet --font "DejaVu Sans:bold" --background "#23272E" \
    -o docs/vorelpaint-sheet.png "Type"
