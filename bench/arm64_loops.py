#!/usr/bin/env python3
"""Counts what the inner loops cost on 64-bit ARM, where nothing is timed: instructions in the code of g++
and clang, and llvm-mca's cycles on a Cortex-A76. Blends and growth are counted per pixel (and pass), the
blur per result and 16 taps, or by differences of the weights per result and term.

    bench/arm64_loops.py        prints a table in Markdown
"""
import re
import subprocess
import sys
import tempfile
from typing import NamedTuple

COMPILERS = (("g++", ["aarch64-linux-gnu-g++"]), ("clang", ["clang++-14", "--target=aarch64-linux-gnu"]))
FLAGS = ["-std=c++17", "-O2", "-ffp-contract=off", "-fno-exceptions", "-Wno-psabi", "-DVOREL_VECTOR_BYTES=16",
         "-I.", "-Iinclude", "-S"]
NEON = ["-DVOREL_LEVEL=neon"]
DOT_PRODUCTS = ["-DVOREL_LEVEL=dotprod", "-march=armv8.2-a+dotprod"]


class Loop(NamedTuple):
    """The shortest loop of a function that has so many instructions of a kind, and ends in a store of
    another kind or in none."""
    title: str
    source: str
    flags: list
    function: tuple  # what the function's name has in it
    kind: str
    count: int
    store: str
    units: int  # what a round of the loop makes

    def found_in(self, functions):
        loops = [loop for name, code in functions.items() if all(part in name for part in self.function)
                 for loop in loops_of(code) if self.fits(loop)]
        return min(loops, key=len)

    def fits(self, loop):
        made = sum(i.startswith(self.kind) for i in loop)
        return made >= self.count and (not self.store or any(i.startswith(self.store) for i in loop))


def blend(title, family, rule, products):
    """A step of 16 pixels has 8 multiplications for each product of pixels."""
    return Loop(title, "blend/blend_loops.cpp", NEON, (family + "<", "::" + rule), "umull", products, "st4", 16)


LOOPS = (
    blend("source-over", "blendImage", "SrcOver,", 8),
    blend("destination-over", "blendImage", "DstOver,", 8),
    blend("mask mode 1", "blendMask", "SrcOverMask", 16),
    blend("mask mode 2", "blendMask", "DstOverMask", 16),
    blend("mask mode 3", "blendMask", "DstOverGate", 8),
    blend("mask mode 7", "blendMask", "DstOverClip", 24),
    blend("composite of layers", "blendMaskedImage", "MixByCoverage", 16),
    # A dot product adds 4 taps to 4 results.
    Loop("blur, down", "ops/blur/dot_loops.cpp", DOT_PRODUCTS, ("down",), "udot", 64, "", 64),
    Loop("blur, across", "ops/blur/dot_loops.cpp", DOT_PRODUCTS, ("across",), "udot", 64, "", 64),
    # Four rows of results at a time, 16 of each.
    Loop("differences, a term", "ops/blur/difference_loops.cpp", NEON, ("next",), "add\tv", 8, "", 64),
    # Two rows at a time, a pair sum in each.
    Loop("growth", "ops/grow/growth_loops.cpp", NEON, ("grow",), "uaddlp", 2, "st", 32),
)


def functions(compiler, flags, source):
    """Lines of each function by its plain name."""
    with tempfile.NamedTemporaryFile(suffix=".s") as listing:
        subprocess.run(compiler + FLAGS + flags + ["-o", listing.name, source], check=True)
        text = open(listing.name).read()
    lines = {}
    for line in text.splitlines():
        start = re.match(r"(_Z\w+):", line)
        if start:
            name = start.group(1)
            lines[name] = []
        elif lines:
            lines[name].append(line.split("//")[0].strip())
    plain = subprocess.run(["c++filt"], input="\n".join(lines), capture_output=True, text=True, check=True)
    return dict(zip(plain.stdout.splitlines(), lines.values()))


def loops_of(lines):
    """The instructions from each label to each branch back to it."""
    labels, code = {}, []
    for line in lines:
        label = re.match(r"(\.\w+):", line)
        if label:
            labels[label.group(1)] = len(code)
        elif line and not line.startswith("."):
            code.append(line)
            target = re.search(r"(\.L\w+)$", line)
            if target and target.group(1) in labels:
                yield code[labels[target.group(1)]:]


def cycles(loop):
    """llvm-mca's cycles of one round, the branches left out."""
    straight = [i for i in loop if not re.match(r"(b|b\.\w+|cbn?z|tbn?z)\s", i)]
    report = subprocess.run(
        ["llvm-mca-14", "-mtriple=aarch64", "-mcpu=cortex-a76", "-mattr=+dotprod", "-iterations=1000"],
        input="\n".join(straight), capture_output=True, text=True, check=True).stdout
    return int(re.search(r"Total Cycles:\s+(\d+)", report).group(1)) / 1000


def main():
    print("| instructions (cycles) | " + " | ".join(name for name, _ in COMPILERS) + " |")
    print("|---|" + "---|" * len(COMPILERS))
    for which in LOOPS:
        cells = []
        for _, compiler in COMPILERS:
            loop = which.found_in(functions(compiler, which.flags, which.source))
            cells.append(f"{len(loop) / which.units:.2f} ({cycles(loop) / which.units:.2f})")
        print(f"| {which.title} | " + " | ".join(cells) + " |")


if __name__ == "__main__":
    sys.exit(main())
