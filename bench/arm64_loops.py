#!/usr/bin/env python3
"""Counts what the inner loops cost on 64-bit ARM, where nothing is timed, in the code of g++ and clang:
instructions, and llvm-mca's cycles on a Cortex-A76 (which LLVM describes as it does the A57: three
operations a cycle, two ports for vectors, of which one multiplies), over 1000 rounds without their branches.

    bench/arm64_loops.py [TITLE...]     a table in Markdown, of the loops whose title begins like that
    bench/arm64_loops.py --document     the table into docs/benchmarks.md

All is per result: a pixel, of growth per pass, of the differences per term.

The bound of a loop is what its operations take when none waits for another: a third of their number or the
busiest port's work, whichever is larger (llvm-mca's reciprocal throughput of the block), of the code of the
compiler that needs less. So chains of dependent operations, and what one compiler adds, raise the ratio of
cycles to bound. A ratio above LIMIT stands in bold, and the script fails.
"""
import functools
import re
import subprocess
import sys
import tempfile
from typing import NamedTuple

# As cmake/ has the library built.
COMPILERS = (("g++", ["aarch64-linux-gnu-g++", "-fno-tree-ch", "-fno-align-jumps", "-fno-align-labels"]),
             ("clang", ["clang++-14", "--target=aarch64-linux-gnu"]))
FLAGS = ["-std=c++17", "-O2", "-fPIC", "-fvisibility=hidden", "-ffp-contract=off", "-fno-exceptions",
         "-Wno-psabi", "-DVOREL_VECTOR_BYTES=16", "-DNDEBUG", "-I.", "-Iinclude", "-S"]
SMALL_WITH_CLANG = ("ops/blur/difference_loops.cpp", "ops/dilate/dilation_loops.cpp",
                    "ops/grow/growth_loops.cpp", "ops/ramp/ramp_loops.cpp")
NEON = ("-DVOREL_LEVEL=neon",)
DOT_PRODUCTS = ("-DVOREL_LEVEL=dotprod", "-march=armv8.2-a+dotprod")
LIMIT = 1.25
BRANCH = r"(b|b\.\w+|b[a-z]{2}|cbn?z|tbn?z)\s"


class Loop(NamedTuple):
    """The shortest loop of a function that has so many instructions of some kinds, as they begin."""
    title: str
    source: str
    function: str  # found in the function's name, a regular expression
    kinds: dict
    units: int  # what a round of the loop makes
    flags: tuple = NEON
    bare: bool = False  # whether inner loops do not count
    part: tuple = ("", "")  # what counts begins and ends with the first and the last instruction like that

    def found_in(self, functions):
        loops = [loop for name, code in functions.items() if re.search(self.function, name)
                 for loop in loops_of(code, self.bare) if self.fits(loop)]
        if not loops:
            raise LookupError(f"{self.source}: no loop looks like {self.title}")
        loop = min(loops, key=len)
        first, last = self.part
        begin = next(i for i, code in enumerate(loop) if re.match(first, code))
        end = next(i for i in reversed(range(len(loop))) if re.match(last, loop[i]))
        return loop[begin:end + 1]

    def fits(self, loop):
        return all(sum(bool(re.match(kind, i)) for i in loop) >= count for kind, count in self.kinds.items())


def blend(title, family, rule, products):
    """A step of 16 pixels has 8 multiplications for each product of pixels."""
    return Loop(title, "blend/blend_loops.cpp", f"{family}<.*::{rule}", {"umull": products, "st4": 1}, 16)


def dilation(title, function, kinds, units):
    return Loop("dilation, " + title, "ops/dilate/dilation_loops.cpp", function, kinds, units)


def dots(title, function):
    """A dot product adds 4 taps to 4 results; 64 results are made at a time."""
    return Loop("blur, " + title, "ops/blur/dot_loops.cpp", function, {"udot": 64}, 64, DOT_PRODUCTS)


def plain(title, function, kinds, units):
    """Without dot products."""
    return Loop("blur, plain, " + title, "ops/blur/dot_loops.cpp", function, kinds, units)


def narrow(title, function, kinds, units):
    """Sums of 16 bits."""
    return Loop("blur, plain, " + title, "ops/blur/narrow_loops.cpp", function, kinds, units)


def division(title, function):
    """What stands behind the loops over the taps, from the conversion of their sums on."""
    return Loop("blur, " + title, "ops/blur/dot_loops.cpp", function, {"fcvtzs": 16}, 64, DOT_PRODUCTS, True,
                ("scvtf", "st"))


def ramp(title, function, kinds):
    return Loop(title, "ops/ramp/ramp_loops.cpp", function, kinds, 16)


LOOPS = (
    blend("source-over", "blendImage", "SrcOver,", 8),
    blend("destination-over", "blendImage", "DstOver,", 8),
    blend("destination-over where covered", "blendMaskedImage", "DstOverWhereCovered", 8),
    blend("mask mode 1", "blendMask", "SrcOverMask", 16),
    blend("mask mode 2", "blendMask", "DstOverMask", 16),
    blend("mask mode 3", "blendMask", "DstOverGate", 8),
    blend("mask mode 7", "blendMask", "DstOverClip", 24),
    blend("composite of layers", "blendMaskedImage", "MixByCoverage", 16),
    Loop("copy in one colour", "blend/blend_loops.cpp", "solidColour", {"umull": 2, "st4": 1}, 16),
    Loop("copy of the larger", "blend/blend_loops.cpp", "maxCoverage", {"umax": 1, r"str\s+q": 1}, 16),
    dilation("cells of reach 1", "rowsByCells<1", {"umax": 8, "uqsub": 3, "str": 1}, 16),
    dilation("cells of reach 2", "rowsByCells<2", {"umax": 24, "uqsub": 6, "str": 1}, 16),
    dilation("spreading, a pair of columns", "rowsBySpreading",
             {r"ldr\s+q": 2, "umax": 1, r"str\s+q": 1}, 16),
    dilation("spreading, two full cells", "rowsBySpreading", {r"ldr\s+q": 1, "umax": 1}, 16),
    dilation("spreading, a row", "rowsBySpreading", {"ldr": 2, "umax": 1, r"str\s+q": 1}, 16),
    dilation("spreading, a cell of the rim", "rowsBySpreading", {"ldr": 2, "uqsub": 1, "umax": 1}, 16),
    dilation("tiles, a window", "fillRows|beginTiles", {"umax": 3, r"str\s+q": 1}, 16),
    dilation("tiles, two cells of the rim", "dilatedTile|addTouching|rowsByTiles",
             {"umax": 4, "uqsub": 2, r"ldu?r\s+q": 4, "ldp": 1}, 16),
    dilation("tiles, two windows", "dilatedTile|addTouching|rowsByTiles",
             {"umax": 2, "asr": 1, r"ldr\s+q": 2}, 16),
    dilation("tiles, the largest coverage", "largestCoverage|beginTiles", {r"ldr\s+q": 1, "umax": 1}, 16),
    dilation("tiles, neighbours in 8 rows", "findNeighbours|beginTiles",
             {"smin": 1, r"ldr\s+q": 1, r"str\s+q": 1}, 16),
    dilation("tiles, a row of reaches", "passReaches|beginTiles",
             {"smax": 1, r"ldr\s+q": 2, r"str\s+q": 1}, 16),
    dilation("tiles, 16 rows that touch", "touchingRange|addTouching|rowsByTiles|dilatedTile",
             {"uqsub": 2, "cmhs": 1}, 16),
    dilation("squares, joining four", "joinSquares|rowsBySquares|fillPlanes", {"umax": 3, r"str\s+q": 1}, 16),
    dilation("squares, two of them", "dilatedVector|rowsBySquares", {"umax": 2, r"ldr\s+q": 2}, 16),
    dilation("squares, a cell of the rim", "dilatedVector|rowsBySquares",
             {"umax": 1, "uqsub": 1, "ldrsw": 1}, 16),
    dilation("smaller of two rows", "keepMin", {"umin": 1}, 16),
    dots("down, 16 taps", "down"),
    dots("across, 16 taps", "across"),
    plain("down, 4 taps", "down", {"uadalp": 16}, 64),
    plain("across, 4 taps", "across", {"uadalp": 16}, 64),
    narrow("down, four rows of radii to 3", "down", {"mla": 2, r"str\s+q": 1}, 64),
    narrow("across, a row of radii to 3", "across", {"mla": 2, r"str\s+q": 1}, 16),
    division("down, division", "down"),
    division("across, division", "across"),
    # Four rows of results at a time, 16 of each.
    Loop("differences, a term", "ops/blur/difference_loops.cpp", "next", {r"(add|sub)\s+v": 8}, 64),
    Loop("differences, transposing four rows", "ops/blur/difference_loops.cpp", "storeTransposed",
         {"zip": 4, "st": 2}, 64),
    # Two rows at a time, a pair sum in each.
    Loop("growth", "ops/grow/growth_loops.cpp", "grow", {"uaddlp": 2, "st": 1}, 32),
    Loop("copy, inverted", "ops/grow/growth_loops.cpp", "copyInverted", {"eor": 1, "str": 1}, 16),
    ramp("linear gradient", "LinearRow", {"umull": 8, "st4": 1}),
    ramp("radial gradient", "RadialRow", {"umull": 8, "st4": 1}),
    ramp("colours by the table", "byValue", {"umull": 8, "st4": 1}),
    ramp("fading", "fade", {"mul": 2}),
    ramp("premultiplied colours", "premultiplied", {"umull": 6}),
    Loop("mixing of stops", "ops/ramp/ramp_loops.cpp", "mixStops", {"fdiv": 1}, 4),
    Loop("tile, rows", "ops/tile/tile_loops.cpp", "mixRows", {"umull": 4}, 4),
    Loop("tile, columns", "ops/tile/tile_loops.cpp", "mixColumns", {"mul": 2}, 4),
)


@functools.cache
def listing_of(compiler, flags, source):
    size = ["-Os"] if compiler == "clang" and source in SMALL_WITH_CLANG else []
    command = [*dict(COMPILERS)[compiler], *FLAGS, *size, *flags, "-o", "-", source]
    return subprocess.run(command, capture_output=True, text=True, check=True).stdout


@functools.cache
def functions(compiler, flags, source):
    """Lines of each function by its plain name."""
    lines = {}
    for line in listing_of(compiler, flags, source).splitlines():
        start = re.match(r"(_Z[\w.]+):", line)
        if start:
            name = start.group(1)
            lines[name] = []
        elif lines:
            lines[name].append(line.split("//")[0].strip())
    plain = subprocess.run(["c++filt"], input="\n".join(lines), capture_output=True, text=True, check=True)
    return dict(zip(plain.stdout.splitlines(), lines.values()))


def loops_of(lines, bare):
    """The instructions from each label to each branch back to it; bare, without those of loops in between."""
    labels, code, inner = {}, [], set()
    for line in lines:
        label = re.match(r"(\.\w+):", line)
        if label:
            labels[label.group(1)] = len(code)
        elif line and line[0] not in ".#":
            code.append(line)
            target = re.search(r"(\.L\w+)$", line)
            if target and target.group(1) in labels:
                places = range(labels[target.group(1)], len(code))
                yield [code[i] for i in places if not (bare and i in inner)]
                inner.update(places)


class Cost(NamedTuple):
    instructions: float
    cycles: float
    throughput: float


def operations_of(instruction):
    """A load or store and the addition to its address apart, as the core carries them out: llvm-mca has the
    new address wait for the data. Loads of a lane as loads of the register, which they fill with zeros:
    llvm-mca has them keep what stood there, and wait for it."""
    lane = re.match(r"ldr\s+[bhsd](\d+), \[(\w+)(?:, ([wx]\d+))?.*\]", instruction)
    if lane:
        register, base, index = lane.groups()
        address = "x" + index[1:] if index else base
        instruction = instruction.replace(lane.group(0), f"ldr q{register}, [{address}]")
    moved = re.match(r"(.*\[)([xs]\w+)(\]), (\S+)$", instruction)
    if moved:
        access, base, end, step = moved.groups()
        return [access + base + end, f"add {base}, {base}, {step}"]
    moved = re.match(r"(.*\[)(\w+), (\S+)\]!$", instruction)
    if moved:
        access, base, step = moved.groups()
        return [f"add {base}, {base}, {step}", access + base + "]"]
    return [instruction]


def cost(which, compiler):
    """Of what a round of the loop makes; the branches cost no cycles."""
    loop = which.found_in(functions(compiler, which.flags, which.source))
    straight = [part for i in loop if not re.match(BRANCH, i) for part in operations_of(i)]
    report = subprocess.run(
        ["llvm-mca-14", "-mtriple=aarch64", "-mcpu=cortex-a76", "-mattr=+dotprod", "-iterations=1000"],
        input="\n".join(straight), capture_output=True, text=True, check=True)
    if "error:" in report.stderr:
        raise ValueError(f"{which.title}: {report.stderr}")
    report = report.stdout
    cycles = int(re.search(r"Total Cycles:\s+(\d+)", report).group(1)) / 1000
    throughput = float(re.search(r"Block RThroughput:\s+([\d.]+)", report).group(1))
    return Cost(*(value / which.units for value in (len(loop), cycles, throughput)))


def row(which):
    """The cells of a loop and its ratios of cycles to the bound."""
    costs = [cost(which, name) for name, _ in COMPILERS]
    bound = min(c.throughput for c in costs)
    cells, ratios = [f"{bound:.2f}"], [c.cycles / bound for c in costs]
    for c, ratio in zip(costs, ratios):
        mark = "**" if ratio > LIMIT else ""
        cells += [f"{c.instructions:.2f}", f"{c.cycles:.2f}", f"{mark}{ratio:.2f}{mark}"]
    return cells, ratios


def table(loops):
    """The lines of the table, and the titles of the loops above the limit."""
    lines = ["| a result | bound | " + " | ".join(f"{name} | cycles | ratio" for name, _ in COMPILERS) + " |",
             "|---|" + "---:|" * (1 + 3 * len(COMPILERS))]
    slow = []
    for which in loops:
        cells, ratios = row(which)
        lines.append(f"| {which.title} | " + " | ".join(cells) + " |")
        if max(ratios) > LIMIT:
            slow.append(which.title)
    return lines, slow


def document(lines):
    """Puts the table between its marks, as write_figures of scripts/figures.sh does with others."""
    with tempfile.NamedTemporaryFile("w", suffix=".md") as figures:
        print(*lines, sep="\n", file=figures, flush=True)
        call = f". scripts/figures.sh; write_figures 'ARM figures' {figures.name} docs/benchmarks.md"
        subprocess.run(["bash", "-c", call], check=True)


def main():
    wanted = [title for title in sys.argv[1:] if title != "--document"]
    lines, slow = table([loop for loop in LOOPS if not wanted or loop.title.startswith(tuple(wanted))])
    if "--document" in sys.argv:
        document(lines)
    else:
        print(*lines, sep="\n")
    if slow:
        print(f"above {LIMIT} times the bound: {', '.join(slow)}", file=sys.stderr)
    return 1 if slow else 0


if __name__ == "__main__":
    sys.exit(main())
