#!/usr/bin/env bash
# Builds the site of the documents into build/docs/html. Fails, with a line for each fault, when
#   - a relative link or an anchor of a Markdown page leads nowhere,
#   - what a page quotes of a program is not what stands in it,
#   - the tables of keys in docs/style-files.md are behind the schema,
#   - a page has another number than is counted,
#   - a block of C++ or C in one does not compile, or its program fails or adds an effect that is not seen,
#   - a block of Python or of JavaScript fails,
#   - a public name is not documented, or Doxygen warns of anything else,
#   - a link of the finished site leads nowhere.
set -euo pipefail
cd "$(dirname "$0")/.."
. scripts/packages.sh

need_packages doxygen g++ python3
scripts/demo.sh > /dev/null # the library, with which the programs are linked
[[ -x build/python-venv/bin/python ]] || scripts/python.sh > /dev/null # the package of Python
build/python-venv/bin/python -B scripts/docs/python_blocks.py
[[ -d build/js-consumer/node_modules/voreleffect ]] || scripts/js.sh > /dev/null # the package of JavaScript
node scripts/docs/js_blocks.mjs build/js-consumer
python3 -B scripts/docs/build.py "$PWD/build/demo" "$PWD/build/docs"
# The studio, where it was built, comes along with the site.
[[ ! -d build/studio ]] || { rm -rf build/docs/html/studio && cp -r build/studio build/docs/html/studio; }
