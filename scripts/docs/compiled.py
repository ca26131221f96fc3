"""The C++ and the C in the Markdown pages compile.

A block of `cpp` or `c` with a main is a program: it is compiled, linked and run, and each effect that it adds is
seen in its picture. One that defines functions is
a source file, as every other one of `c` is. Any other of `cpp` is the inside of a function and may use the names
that fragment.h declares. A block that includes Android's headers is left to scripts/android_test.sh, and one that
is quoted (quoted.py) to what builds its file.
"""

import os
import re
import subprocess
import tempfile
from concurrent.futures import ThreadPoolExecutor
from pathlib import Path

from pages import ROOT
from seen_effects import HEADER, unseen_effects

WARNINGS = ["-Wall", "-Wextra", "-Wconversion", "-Werror", "-I", str(ROOT / "include")]
# Of each language: how its sources end, the compiler with its options, and what the compiler calls it.
LANGUAGES = {
    "cpp": (".cpp", [os.environ.get("CXX", "g++"), "-std=c++17", *WARNINGS], "c++"),
    "c": (".c", [os.environ.get("CC", "gcc"), "-std=c99", "-Wpedantic", *WARNINGS], "c"),
}
FRAGMENT_FLAGS = ["-Wno-unused", "-I", str(Path(__file__).parent)]
ELSEWHERE = re.compile(r"#include <(android/|jni\.h)")
MAIN = re.compile(r"\bint main\(")
FUNCTION = re.compile(r"^(?!for|if|while|switch|else)\w[\w:&*<>, ]* [\w:]+\([^;]*\) \{$", re.MULTILINE)


def located(page, block, text):
    """The text, whose errors the compiler then reports at its place in the page."""
    return f'#line {block.line} "{page.name}"\n{text}\n'


def fault_of(arguments, source=None):
    """The first error of the compiler, or None."""
    said = subprocess.run(arguments, input=source, text=True, capture_output=True, check=False)
    if said.returncode == 0:
        return None
    lines = said.stderr.strip().split("\n")
    return next((line for line in lines if "error" in line or "undefined reference" in line), lines[-1])


def program_fault(page, block, library):
    with tempfile.TemporaryDirectory() as folder:
        suffix, compiler, _ = LANGUAGES[block.language]
        source, program = Path(folder) / f"program{suffix}", Path(folder) / "program"
        source.write_text(located(page, block, block.text))
        linked = [str(source), "-o", str(program), "-L", str(library), "-lvoreleffect", f"-Wl,-rpath,{library}"]
        # As it stands in the page first: the header includes more than the program may.
        fault = fault_of([*compiler, *linked]) or fault_of([*compiler, "-include", str(HEADER), *linked])
        return fault or next(iter(unseen_effects([str(program)])[0]), None)


def source_fault(language, source, options=()):
    _, compiler, name = LANGUAGES[language]
    return fault_of([*compiler, *options, "-fsyntax-only", "-x", name, "-"], source)


def fragment_fault(page, block):
    lines = block.text.split("\n")
    includes = "".join(line + "\n" for line in lines if line.startswith("#include"))
    inside = "\n".join("" if line.startswith("#include") else line for line in lines)
    source = (includes + '#include "fragment.h"\nvoid fragment();\nvoid fragment() {\n'
              + located(page, block, inside) + "}\n")
    return source_fault(block.language, source, FRAGMENT_FLAGS)


def block_fault(page, block, library):
    if MAIN.search(block.text):
        return program_fault(page, block, library)
    if block.language == "c" or FUNCTION.search(block.text):
        return source_fault(block.language, located(page, block, block.text))
    return fragment_fault(page, block)


def code_faults(pages, library):
    """One line for each block that does not compile, or whose program fails; and the number of blocks."""
    blocks = [(page, block) for page in pages for block in page.blocks
              if block.language in LANGUAGES and not ELSEWHERE.search(block.text)
              and not block.source]
    with ThreadPoolExecutor(2) as pool:
        faults = list(pool.map(lambda both: block_fault(*both, library), blocks))
    return [fault for fault in faults if fault], len(blocks)
