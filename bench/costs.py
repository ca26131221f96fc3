#!/usr/bin/env python3
"""Prints what looks cost on pictures of four sizes, beside other ways to paint them:

    costs.py --programs FOLDER [--quick]

Programs take turns, a figure is the fastest call of all turns. Skia is measured where RIVALS_NODE names the folder
that its canvas is installed in.
"""
import argparse
import json
import os
import signal
import subprocess
import sys
from pathlib import Path

from table import print_table

HERE = Path(__file__).resolve().parent
SKIA = HERE / "rivals" / "skia_costs.mjs"
FRAME = 1 / 60
KINDS = {"GLYPH48": "a glyph", "LINE48": "a subtitle line", "TITLE160": "a title", "POSTER4K": "a 4K poster"}
# Makers and the heads of their columns.
OURS = {"best": "best", "16-byte": "16 bytes"}
OTHERS = {"literal": "literal", "Skia": "Skia", "OpenCV": "OpenCV, a part"}


def run(command):
    return subprocess.run(command, check=True, capture_output=True, text=True).stdout


def has_skia():
    if "RIVALS_NODE" not in os.environ:
        return False
    try:
        run(["node", SKIA, "--version"])
    except (OSError, subprocess.CalledProcessError):
        return False
    return True


def measure(programs, turns, seconds):
    """The pictures, and fastest[row, maker] in seconds."""
    costs = programs / "voreleffect_costs"
    pictures = programs / "pictures.json"
    pictures.write_text(run([costs, "--pictures"]), encoding="utf-8")
    commands = [[costs, str(seconds)]]
    if has_skia():
        commands.append(["node", SKIA, pictures, str(seconds)])
    fastest = {}
    for _ in range(turns):
        for command in commands:
            for line in run(command).splitlines():
                row, maker, taken = line.split(" ")
                fastest[row, maker] = min(fastest.get((row, maker), float("inf")), float(taken))
    return json.loads(pictures.read_text(encoding="utf-8")), fastest


def figure(value):
    """Three digits, or all before the point."""
    if value >= 99.5:
        return f"{value:.0f}"
    return f"{value:.1f}" if value >= 9.95 else f"{value:.2f}"


def duration(seconds):
    if seconds is None:
        return ""
    return f"{figure(seconds * 1e6)} us" if seconds < 0.9995e-3 else f"{figure(seconds * 1e3)} ms"


def against(theirs, ours):
    """The time of another, and in times of ours."""
    return f"{duration(theirs)} ({figure(theirs / ours)})" if theirs else ""


def line_of(picture, row, fastest):
    best = fastest[row, "best"]
    kind = f"{KINDS[picture['name']]}, {picture['width']} x {picture['height']}"
    return [kind, row.split("/")[1], *(duration(fastest.get((row, maker))) for maker in OURS),
            figure(FRAME / best), *(against(fastest.get((row, maker)), best) for maker in OTHERS)]


def main():
    signal.signal(signal.SIGPIPE, signal.SIG_DFL)
    parser = argparse.ArgumentParser(description=__doc__.split("\n", maxsplit=1)[0])
    parser.add_argument("--programs", required=True, type=Path)
    parser.add_argument("--quick", action="store_true")
    options = parser.parse_args()
    turns, seconds = (1, 0.01) if options.quick else (5, 0.1)
    pictures, fastest = measure(options.programs, turns, seconds)
    lines = [line_of(picture, f"look/{look}/{picture['name']}", fastest)
             for picture in pictures for look in "ABCD"]
    print_table(["picture", "look", *OURS.values(), "in 16.7 ms", *OTHERS.values()], lines)
    for maker, head in OTHERS.items():
        if not any(found == maker for _, found in fastest):
            print(f"{maker} is not here: the column '{head}' is empty", file=sys.stderr)


if __name__ == "__main__":
    main()
