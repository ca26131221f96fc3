#!/usr/bin/env bash
# Compiles the Kotlin of docs/java.md with Debian's kotlinc, runs it with stand-ins for Android's classes, and
# sees the compiler refuse a null. The compiler takes 300 MB, so this stands outside of android_test.sh, whose
# build it uses. Installs what it needs on Debian (as root).
set -euo pipefail
cd "$(dirname "$0")/.."
. scripts/packages.sh
need_packages kotlin

scripts/android_test.sh --build
tests=build/android_tests
classes=$tests/voreleffect/android/classes
build=$tests/kotlin
stand_ins=$build/stand_ins
sources=tests/android/kotlin
rm -rf "$build"
mkdir -p "$build"

javac --release 11 -nowarn -Xlint:-options -d "$stand_ins" \
    "$sources"/android/graphics/*.java tests/android/bitmaps/android/graphics/*.java
python3 tests/android/code_block.py docs/java.md kotlin "$build/recipe.kt"
kotlinc -nowarn -cp "$classes:$stand_ins" "$build/recipe.kt" "$sources/RecipeTest.kt" -d "$build/classes" \
    2> "$build/said" || { cat "$build/said" >&2; exit 1; }
libraries=$tests/voreleffect:$tests/voreleffect/android:$tests
java -Xcheck:jni -Djava.library.path="$libraries" \
    -cp "$classes:$stand_ins:$build/classes:/usr/share/java/kotlin-stdlib.jar" RecipeTestKt

if kotlinc -nowarn -cp "$classes" "$sources/Refused.kt" -d "$build/refused" 2> "$build/said"; then
    echo "kotlin_test.sh: the compiler takes a null for a Glyph" >&2
    exit 1
fi
grep -q "Refused.kt:.*error: type mismatch" "$build/said" || { cat "$build/said" >&2; exit 1; }
echo "a null is refused by the compiler"
