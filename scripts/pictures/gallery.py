#!/usr/bin/python3
"""Paints the gallery: gallery.py VORELPAINT FOLDER.

NAME-160-SHADE.png and NAME-48-SHADE.png are what the program paints; NAME-sizes.png has four sizes side by
side over a ground that is like a photograph, in fewer colours.
"""

import json
import subprocess
import sys
import tempfile
from pathlib import Path

from PIL import Image

import ground

FONT = "DejaVu Sans:bold"
SHADES = {"dark": "#23272E", "light": "#F4F1EA"}
BOARD = "#2F4F3F"  # for chalk, in place of the light shade
SHORT, LONG = "Type", "Summer Sale: 50% Off"
CELLS = {24: 120, 48: 190, 96: 320, 160: 510}  # the size of the font and the width that it has, in pixels
COLOURS = 192  # of a picture of sizes, which keeps it small


def preset_names(program):
    said = subprocess.run([program, "--list-presets"], check=True, capture_output=True, text=True).stdout
    return [line.split()[0] for line in said.splitlines()]


def shade_jobs(name):
    for shade, background in SHADES.items():
        common = {"preset": name, "background": BOARD if (name, shade) == ("chalk", "light") else background}
        yield {**common, "text": SHORT, "size": 160, "padding": 16, "output": f"{name}-160-{shade}.png"}
        yield {**common, "text": LONG, "size": 48, "output": f"{name}-48-{shade}.png"}


def cell_jobs(name):
    for size, width in CELLS.items():
        yield {"preset": name, "text": SHORT, "size": size, "width": width, "height": ground.SIZE[1],
               "output": f"{name}-{size}.png"}


def paint(program, jobs, folder):
    subprocess.run([Path(program).resolve(), "--batch", "-", "--strict", "--font", FONT], check=True,
                   text=True, cwd=folder, input="".join(json.dumps(job) + "\n" for job in jobs))


def in_a_row(folder, name):
    """The cells of a preset beside each other, on nothing."""
    row = Image.new("RGBA", ground.SIZE, (0, 0, 0, 0))
    left = 0
    for size, width in CELLS.items():
        with Image.open(folder / f"{name}-{size}.png") as cell:
            row.paste(cell.convert("RGBA"), (left, 0))
        left += width
    return row


def main(program, folder):
    names = preset_names(program)
    behind = ground.painted().convert("RGBA")
    with tempfile.TemporaryDirectory() as scratch:
        painted = Path(scratch)
        shades = [job for name in names for job in shade_jobs(name)]
        paint(program, shades + [job for name in names for job in cell_jobs(name)], painted)
        for job in shades:
            with Image.open(painted / job["output"]) as picture:
                picture.convert("RGB").save(folder / job["output"], optimize=True)
        for name in names:
            picture = Image.alpha_composite(behind, in_a_row(painted, name)).convert("RGB")
            fewer = picture.quantize(COLOURS, method=Image.Quantize.MEDIANCUT, dither=Image.Dither.NONE)
            fewer.save(folder / f"{name}-sizes.png", optimize=True)


if __name__ == "__main__":
    main(sys.argv[1], Path(sys.argv[2]))
