#!/usr/bin/env bash
# Paints the pictures that the commands of the tool's pages paint anew: docs/vorelpaint.
set -euo pipefail
cd "$(dirname "$0")/.."
. scripts/packages.sh

need_packages python3 fonts-dejavu-core fonts-noto-color-emoji fonts-vlgothic ffmpeg
scripts/demo.sh > /dev/null
for page in vorelpaint style-files layer-styles captions film; do
    python3 -B scripts/docs/page_commands.py build/demo/tools/vorelpaint "docs/$page.md" --paint
done
