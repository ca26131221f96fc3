#!/usr/bin/python3
"""Compares the PNGs of two folders pixel by pixel: compare.py COMMITTED PAINTED.

Fails with one line for each picture that is missing, left over or different.
"""

import sys
from pathlib import Path

from PIL import Image, ImageChops


def fault(committed, painted):
    """What tells the two apart, or None."""
    if not committed.exists():
        return "is painted, but not committed"
    if not painted.exists():
        return "is committed, but nothing paints it"
    with Image.open(committed) as a, Image.open(painted) as b:
        if a.size != b.size or a.mode != b.mode:
            return f"is {a.size[0]} x {a.size[1]} {a.mode}, painted {b.size[0]} x {b.size[1]} {b.mode}"
        bands = ImageChops.difference(a, b).split()
        different = bands[0]
        for band in bands[1:]:
            different = ImageChops.lighter(different, band)
        count = sum(different.histogram()[1:])
        if count:
            box = different.getbbox()
            return f"differs in {count} pixels, the first at row {box[1]}"
    return None


def main(committed, painted):
    names = sorted({path.name for folder in (committed, painted) for path in folder.glob("*.png")})
    faults = [(name, fault(committed / name, painted / name)) for name in names]
    faults = [(name, what) for name, what in faults if what]
    for name, what in faults:
        print(f"{committed / name} {what}", file=sys.stderr)
    return 1 if faults else 0


if __name__ == "__main__":
    sys.exit(main(Path(sys.argv[1]), Path(sys.argv[2])))
