#!/usr/bin/env bash
# Compiles and runs what the studio exports, of every preset and of looks with each effect and option: C++ by
# look.h and by the classes, C, Java, Python, JavaScript, and the command with its style file. All paint the same bytes.
# What others have built is taken: build/release, the face of Java (scripts/android_test.sh), the packages of Python
# (scripts/python.sh) and of JavaScript (scripts/studio.sh build); else it is built now.
set -euo pipefail
cd "$(dirname "$0")/.."
. scripts/packages.sh
. scripts/quietly.sh
. scripts/installed.sh

need_packages openjdk-17-jdk-headless python3-numpy python3-pil fonts-dejavu-core
command -v npm > /dev/null || need_packages nodejs npm

release_tool
java=$PWD/build/android_tests/voreleffect
[[ -f $java/android/libvoreleffect_jni.so ]] || quietly scripts/android_test.sh --build
[[ -f bindings/js/dist/text.js && -d studio/node_modules/voreleffect ]] || quietly scripts/studio.sh build

export VOREL_EXPORTS=$PWD/build/exports VOREL_BUILD=$PWD/build/release
export VOREL_PYTHON=${VOREL_PYTHON:-$(python_with_the_package)}
export VOREL_JAVA=${VOREL_JAVA:-$java/android/classes:::$java:$java/android}
export VOREL_FONT=/usr/share/fonts/truetype/dejavu/DejaVuSans-Bold.ttf
rm -rf "$VOREL_EXPORTS"
mkdir -p "$VOREL_EXPORTS"
cd studio
npx vitest run tests/export/painted
