#!/usr/bin/env bash
# Builds the package of JavaScript and tries it: under node, in Chromium, and in projects that have installed it from
# its tarball, with and without bundlers. Installs what it needs on Debian (as root). What a project has installed
# stands in build/js-consumer afterwards.
set -euo pipefail
cd "$(dirname "$0")/.."
. scripts/packages.sh
. scripts/quietly.sh
. scripts/installed.sh

need_packages chromium fonts-dejavu-core fonts-hosny-amiri fonts-lohit-deva fonts-inter-variable fonts-bebas-neue \
    fonts-noto-color-emoji
command -v node > /dev/null || need_packages nodejs
command -v npm > /dev/null || need_packages npm
[[ $(node --print 'parseInt(process.versions.node)') -ge 20 ]] || { echo 'node 20 or later is needed' >&2; exit 1; }

quietly scripts/wasm.sh modules
release_tool # whose pictures are compared
cd bindings/js
! grep -q '"resolved"' package-lock.json || { echo 'package-lock.json names a registry' >&2; exit 1; }
quietly npm ci --ignore-scripts --no-audit --no-fund
node build.mjs
npx eslint .
npx prettier --log-level warn --check .
node --test --test-concurrency="$(nproc)" tests/*.test.js
node tests/equality.mjs ../../build/release/tools/vorelpaint
node sizes.mjs
