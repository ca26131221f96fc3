#!/usr/bin/env python3
"""Counts what the blending loops cost on 64-bit ARM, where nothing is timed: instructions per pixel in the
code of g++ and clang, and llvm-mca's cycles per pixel on a Cortex-A76.

    bench/arm64_loops.py        prints a table in Markdown
"""
import re
import subprocess
import sys
import tempfile

COMPILERS = (("g++", ["aarch64-linux-gnu-g++"]), ("clang", ["clang++-14", "--target=aarch64-linux-gnu"]))
FLAGS = ["-std=c++17", "-O2", "-ffp-contract=off", "-fno-exceptions", "-DVOREL_LEVEL=neon", "-I.", "-Iinclude", "-S"]
PIXELS = 16  # of one step: a vector a channel
# Name, template, rule, and how many multiplications one step has: 8 for each product of pixels.
LOOPS = (
    ("source-over", "blendImage", "SrcOver,", 8),
    ("destination-over", "blendImage", "DstOver,", 8),
    ("mask mode 1", "blendMask", "SrcOverMask", 16),
    ("mask mode 2", "blendMask", "DstOverMask", 16),
    ("mask mode 3", "blendMask", "DstOverGate", 8),
    ("mask mode 7", "blendMask", "DstOverClip", 24),
    ("composite of layers", "blendMaskedImage", "MixByCoverage", 16),
)


def functions(compiler):
    """Instructions and labels of each function by its plain name."""
    with tempfile.NamedTemporaryFile(suffix=".s") as listing:
        subprocess.run(compiler + FLAGS + ["-o", listing.name, "blend/blend_kernels.cpp"], check=True)
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


def loop_of(lines, products):
    """The shortest loop with that many multiplications that stores pixels."""
    labels, code, best = {}, [], None
    for line in lines:
        label = re.match(r"(\.\w+):", line)
        if label:
            labels[label.group(1)] = len(code)
        elif line and not line.startswith("."):
            code.append(line)
            target = re.search(r"(\.L\w+)$", line)
            if target and target.group(1) in labels:
                loop = code[labels[target.group(1)]:]
                multiplied = sum(i.startswith("umull") for i in loop)
                paints = multiplied >= products and any(i.startswith("st4") for i in loop)
                if paints and (best is None or len(loop) < len(best)):
                    best = loop
    return best


def cycles(loop):
    """llvm-mca's cycles of one round, the branches left out."""
    straight = [i for i in loop if not re.match(r"(b|b\.\w+|cbn?z|tbn?z)\s", i)]
    report = subprocess.run(
        ["llvm-mca-14", "-mtriple=aarch64", "-mcpu=cortex-a76", "-iterations=1000"],
        input="\n".join(straight), capture_output=True, text=True, check=True).stdout
    return int(re.search(r"Total Cycles:\s+(\d+)", report).group(1)) / 1000


def main():
    print("| instructions (cycles) per pixel | " + " | ".join(name for name, _ in COMPILERS) + " |")
    print("|---|" + "---|" * len(COMPILERS))
    built = [functions(command) for _, command in COMPILERS]
    for title, family, rule, products in LOOPS:
        cells = []
        for found in built:
            lines = next(l for n, l in found.items() if family + "<" in n and "::" + rule in n + ",")
            loop = loop_of(lines, products)
            cells.append(f"{len(loop) / PIXELS:.1f} ({cycles(loop) / PIXELS:.2f})")
        print(f"| {title} | " + " | ".join(cells) + " |")


if __name__ == "__main__":
    sys.exit(main())
