#!/usr/bin/env python3
"""Splits the instructions of a glyph's looks, as callgrind counts them, into pixels and the rest.

    bench/glyph_share.py [PROGRAM]        prints a table in Markdown

PROGRAM is voreleffect_counts, that of the preset bench unless given. Pixels are the inner loops, which are
compiled once per level, but for those of them that make tables, and what fills and copies planes. The rest
is all that a run asks for but its pixels: describing it, its key, memory, weights, discs, tables of colours,
the order of the effects, and the steps from band to band.
"""
import os
import re
import subprocess
import sys
import tempfile

LOOKS = "ABCD"
LEVELS = ("best", "16-byte")
LINE = re.compile(r"^ *([\d,]+) \( *[\d.]+%\) +[^ ]*?:([^/]+?)(?: \[.*)?$")
LOOP = re.compile(r"internal::(sse2|avx2|avx512)::")
TABLE_MAKER = re.compile(r"::(fillCells|mixStops|premultiplied|begin\w+|layoutBytes)\b")
PLANE = re.compile(r"^_*(memset|memcpy|memmove)_")
# Otherwise a fill of a plane is one instruction of the processor that counts as one for each byte.
ENVIRONMENT = dict(os.environ, GLIBC_TUNABLES="glibc.cpu.x86_rep_stosb_threshold=1073741824")


def counted(program, row, level):
    """The instructions of a run by function."""
    with tempfile.NamedTemporaryFile() as counts:
        subprocess.run(["valgrind", "--tool=callgrind", f"--callgrind-out-file={counts.name}",
                        "--toggle-collect=vorelCountedCall", program, row, level],
                       env=ENVIRONMENT, check=True, capture_output=True)
        listing = subprocess.run(["callgrind_annotate", "--threshold=100", counts.name], check=True,
                                 capture_output=True, text=True).stdout
    found = (LINE.match(line) for line in listing.splitlines())
    return [(int(match[1].replace(",", "")), match[2]) for match in found if match]


def is_pixels(function):
    return bool(PLANE.match(function) or LOOP.search(function) and not TABLE_MAKER.search(function))


def main():
    program = sys.argv[1] if len(sys.argv) > 1 else "build/bench/bench/voreleffect_counts"
    print("| look | level | instructions | not pixels | share |\n|---|---|---:|---:|---:|")
    for look in LOOKS:
        for level in LEVELS:
            functions = counted(program, f"look/{look}/GLYPH48", level)
            whole = sum(count for count, _ in functions)
            rest = sum(count for count, function in functions if not is_pixels(function))
            print(f"| {look} | {level} | {whole} | {rest} | {100 * rest / whole:.0f} % |")


if __name__ == "__main__":
    main()
