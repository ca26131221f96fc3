# shellcheck shell=bash
# To be sourced, after packages.sh and quietly.sh: install_skia brings the canvas that bench/rivals/skia.mjs needs.

# install_skia FOLDER, which is RIVALS_NODE then.
install_skia() {
    command -v npm > /dev/null || need_packages nodejs npm || return 1
    mkdir -p "$1"
    quietly npm install --prefix "$1" --no-audit --no-fund @napi-rs/canvas@1.1.1
}
