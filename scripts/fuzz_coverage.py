#!/usr/bin/env python3
"""Tells which lines of the library a set of profiles has reached, by room.

    scripts/fuzz_coverage.py EXPORT.json UNREACHED.txt

EXPORT.json is what `llvm-cov export` prints. A line of a source that is compiled once for each level of
the instruction set counts once for each of them: it is reached at a level or it is not. UNREACHED.txt
names the lines that no input can reach, each with the reason; the others that are not reached are
printed. Ends with 1 when fewer than 99 of 100 lines that can be reached are.
"""
import collections
import json
import os
import pathlib
import re
import sys

ROOMS = ["core", "simd", "property", "blend", "ops", "cores", "effect"]
LEVELS = ["scalar", "sse2", "avx2", "avx512", "neon", "dotprod"]
NO_LEVEL = "-"
# A name within the level's namespace, as the compiler mangles it.
IN_LEVEL = re.compile(r"11VFontEffect8internal(?:%s)" % "|".join(f"{len(name)}({name})" for name in LEVELS))
CODE = 0
LEAST_SHARE = 0.99


def level_of(function):
    found = IN_LEVEL.search(function)
    return next(group for group in found.groups() if group) if found else NO_LEVEL


def counts_of(regions):
    """How often each line of a function was run: as often as the innermost of its regions there, or the
    one that begins there and was run most often."""
    counts = {}
    for first, _, last, _, count in sorted(regions, key=lambda r: (r[0], r[1], -r[2], -r[3])):
        counts[first] = max(counts.get(first, 0), count)
        for line in range(first + 1, last + 1):
            counts[line] = count
    return counts


def lines_of(export, root):
    """{(room's file, line): {level: count}}"""
    lines = collections.defaultdict(dict)
    for function in export["data"][0]["functions"]:
        level = level_of(function["name"])
        for number, filename in enumerate(function["filenames"]):
            path = pathlib.Path(os.path.normpath(filename))
            if not path.is_relative_to(root) or path.relative_to(root).parts[0] not in ROOMS:
                continue
            name = str(path.relative_to(root))
            source = path.read_text().splitlines()
            regions = [r[:5] for r in function["regions"] if r[5] == number and r[7] == CODE]
            for line, count in counts_of(regions).items():
                if not re.search(r"\w", source[line - 1]):  # the end of a block
                    continue
                of_line = lines[name, line]
                of_line[level] = max(of_line.get(level, 0), count)
    return lines


def braces(line):
    """How many blocks the line opens and does not close."""
    return line.count("{") - line.count("}")


class Unreached:
    """The lines that no input reaches: FILE | LEVELS | text of the line | reason, LEVELS being * or
    names of levels. A text that ends with ... is the first line of a block, of which all lines are
    meant."""

    def __init__(self, path):
        self.entries = []
        for number, row in enumerate(path.read_text().splitlines(), 1):
            if not row or row.startswith("#"):
                continue
            parts = [part.strip() for part in row.split(" | ")]
            if len(parts) != 4 or not parts[3]:
                sys.exit(f"{path}:{number}: not FILE | LEVELS | TEXT | REASON")
            self.entries.append((number, *parts))

    def lines(self, root):
        """{(file, line): levels or None}; None is every level. A text that is not there ends the script."""
        named = {}
        for number, name, levels, text, _ in self.entries:
            source = (root / name).read_text().splitlines()
            whole = text.endswith("...")
            wanted = text.removesuffix("...").strip()
            found = [i for i, line in enumerate(source) if line.strip().startswith(wanted)
                     and (whole or line.strip() == wanted)]
            if len(found) != 1:
                sys.exit(f"line {number}: {name} has {len(found)} lines {wanted!r}")
            first = last = found[0]
            if whole:
                depth = braces(source[first])
                while depth > 0:
                    last += 1
                    depth += braces(source[last])
            for line in range(first, last + 1):
                named[name, line + 1] = None if levels == "*" else set(levels.split())
        return named


def main():
    if len(sys.argv) != 3:
        sys.exit(__doc__)
    root = pathlib.Path(__file__).resolve().parent.parent
    lines = lines_of(json.loads(pathlib.Path(sys.argv[1]).read_text()), root)
    named = Unreached(pathlib.Path(sys.argv[2])).lines(root)

    total = collections.Counter()
    reached = collections.Counter()
    excused = collections.Counter()
    missing = collections.defaultdict(list)
    for (name, line), levels in sorted(lines.items()):
        room = name.split("/")[0]
        for level, count in levels.items():
            total[room] += 1
            if count > 0:
                reached[room] += 1
            elif (name, line) in named and (named[name, line] is None or level in named[name, line]):
                excused[room] += 1
            else:
                missing[name, line].append(level)
    for (name, line), levels in missing.items():
        text = (root / name).read_text().splitlines()[line - 1].strip()
        print(f"{name}:{line}: {' '.join(levels)}: {text}")
    print(f"{'room':10} {'lines':>6} {'reached':>8} {'share':>7} {'with a reason':>14} {'not reached':>12}")
    for room in [room for room in ROOMS if total[room]] + ["all"]:
        of = [sum(c.values()) if room == "all" else c[room] for c in (total, reached, excused)]
        print(f"{room:10} {of[0]:6} {of[1]:8} {of[1] / of[0]:7.2%} {of[2]:14} {of[0] - of[1] - of[2]:12}")
    share = sum(reached.values()) / (sum(total.values()) - sum(excused.values()))
    print(f"{share:.2%} of the lines that can be reached")
    sys.exit(0 if share >= LEAST_SHARE else 1)


if __name__ == "__main__":
    main()
