#!/usr/bin/env bash
# Builds the package of Python and tries it: a source distribution, the wheel that is made of it away from the
# tree, both in build/python-dist; the wheel's tests, types and examples in a clean virtual environment.
set -euo pipefail
cd "$(dirname "$0")/.."
. scripts/packages.sh
. scripts/quietly.sh

need_packages cmake ninja-build g++ pkg-config libfreetype-dev libfribidi-dev libharfbuzz-dev libunibreak-dev \
    libfontconfig-dev libpng-dev libdeflate-dev nlohmann-json3-dev libcli11-dev \
    python3 python3-dev python3-venv python3-build python3-setuptools python3-wheel pybind11-dev python3-pybind11 \
    python3-numpy python3-pil python3-pytest python3-hypothesis python3-distributed mypy \
    fonts-dejavu-core fonts-hosny-amiri culmus fonts-lohit-deva fonts-vlgothic fonts-noto-color-emoji \
    fonts-inter-variable

# Debian's, which sees Debian's packages.
python=/usr/bin/python3
# What others have compiled of the same sources is taken, wherever they stood.
export CCACHE_BASEDIR=${CCACHE_BASEDIR:-$PWD} CCACHE_NOHASHDIR=1

dist=build/python-dist
unpacked=build/python-sdist
rm -rf "$dist" "$unpacked"
mkdir -p "$unpacked"
quietly "$python" -m build --sdist --no-isolation --outdir "$dist" bindings/python
tar -xf "$dist"/voreleffect-*.tar.gz -C "$unpacked" --strip-components=1
quietly "$python" -m build --wheel --no-isolation --outdir "$dist" "$unpacked"

wheel=$("$python" -m zipfile -l "$dist"/voreleffect-*.whl)
for name in LICENSE NOTICE; do
    grep -q "^voreleffect-.*dist-info/$name " <<< "$wheel" || { echo "the wheel has no $name" >&2; exit 1; }
done

venv=build/python-venv
rm -rf "$venv"
"$python" -m venv --system-site-packages "$venv"
quietly "$venv/bin/pip" install --no-index --no-deps "$dist"/voreleffect-*.whl

# The tool, whose pictures are compared.
if [[ ! -x build/release/tools/vorelpaint ]]; then
    quietly cmake --preset release
    quietly cmake --build --preset release --target vorelpaint
fi
export VORELPAINT=$PWD/build/release/tools/vorelpaint
tests=$PWD/bindings/python/tests
(cd bindings/python && /usr/bin/mypy --no-incremental voreleffect tests/typed_use.py)
"$venv/bin/python" -m pytest -q -p no:cacheprovider "$tests"
PYTHONDONTWRITEBYTECODE=1 "$venv/bin/python" examples/python/first_look.py build/python-dist
PYTHONDONTWRITEBYTECODE=1 "$venv/bin/python" examples/python/at_scale.py "${VOREL_TITLES:-400}"
ls "$PWD/$dist"/*
