#!/usr/bin/env bash
# The studio: one page in which looks for text are made. Installs what it needs on Debian (as root).
#
#     scripts/studio.sh           builds it and serves it at an address of this machine, which it prints
#     scripts/studio.sh build     builds it into build/studio, a folder to be put on any server
#     scripts/studio.sh test      builds it, and checks its sources and the page in Chromium
#     scripts/studio.sh pictures  builds it, and takes the pictures of docs/studio.md anew
set -euo pipefail
cd "$(dirname "$0")/.."
. scripts/packages.sh
. scripts/quietly.sh
. scripts/installed.sh

# The fonts that lie beside the page.
need_packages fonts-dejavu-core fonts-lobster fonts-bebas-neue fonts-lohit-deva
command -v node > /dev/null || need_packages nodejs
command -v npm > /dev/null || need_packages npm

# install FOLDER: what its lock file names, unless it is there already
install() {
    local installed=$1/node_modules/.package-lock.json
    [[ ! $installed -nt $1/package-lock.json ]] || return 0
    ! grep -q '"resolved": "http' "$1/package-lock.json" ||
        { echo "$1/package-lock.json names a registry" >&2; return 1; }
    (cd "$1" && quietly npm ci --ignore-scripts --no-audit --no-fund)
}

build() {
    quietly scripts/wasm.sh modules
    install bindings/js
    (cd bindings/js && quietly node build.mjs)
    install studio
    (cd studio && node tools/copy_files.js && quietly npx vite build)
}

# With the tool, whose pictures are compared.
check() {
    need_packages chromium fonts-hosny-amiri
    release_tool
    cd studio
    npx prettier --log-level warn --check .
    npx eslint .
    npx tsc --noEmit
    quietly npx vitest run
    npx playwright test
}

# Pictures of 256 colours are a quarter as large.
take_pictures() {
    need_packages chromium python3 python3-pil
    (cd studio && node pictures/take.mjs)
    /usr/bin/python3 -B - docs/studio/*.png <<'END'
import sys
from PIL import Image
for name in sys.argv[1:]:
    Image.open(name).convert("RGB").quantize(256, dither=Image.Dither.NONE).save(name, optimize=True)
END
}

case ${1-serve} in
    build) build ;;
    test) build && check ;;
    pictures) build && take_pictures ;;
    serve)
        build
        cd studio
        exec npx vite preview --host 127.0.0.1
        ;;
    *)
        echo "usage: scripts/studio.sh [build | test | pictures]" >&2
        exit 2
        ;;
esac
