#!/usr/bin/python3
"""Paints the gallery: gallery.py VORELPAINT FOLDER.

NAME-160-SHADE.png and NAME-48-SHADE.png are what the program paints; NAME-sizes.png has four sizes side by
side over a ground that is like a photograph, its colours rounded to steps of 5.
"""

import io
import json
import struct
import subprocess
import sys
import tempfile
import zlib
from pathlib import Path

from PIL import Image

import ground

FONT = "DejaVu Sans:bold"
SHADES = {"dark": "#23272E", "light": "#F4F1EA"}
BOARD = "#2F4F3F"  # for chalk, in place of the light shade
SHORT, LONG = "Type", "Summer Sale: 50% Off"
# The cells of a picture of sizes: the size of the font, the text, and the width that it has in pixels.
CELLS = ((24, SHORT, 90), (48, SHORT, 156), (96, SHORT, 296), (160, "Ag", 328))
ROUNDED = [5 * round(value / 5) for value in range(256)]


def preset_names(program):
    said = subprocess.run([program, "--list-presets"], check=True, capture_output=True, text=True).stdout
    return [line.split()[0] for line in said.splitlines()]


def shade_jobs(name):
    for shade, background in SHADES.items():
        common = {"preset": name, "background": BOARD if (name, shade) == ("chalk", "light") else background}
        yield {**common, "text": SHORT, "size": 160, "padding": 16, "output": f"{name}-160-{shade}.png"}
        yield {**common, "text": LONG, "size": 48, "output": f"{name}-48-{shade}.png"}


def cell_jobs(name):
    for size, text, width in CELLS:
        yield {"preset": name, "text": text, "size": size, "width": width, "height": ground.SIZE[1],
               "output": f"{name}-{size}.png"}


def paint(program, jobs, folder):
    subprocess.run([Path(program).resolve(), "--batch", "-", "--strict", "--font", FONT], check=True,
                   text=True, cwd=folder, input="".join(json.dumps(job) + "\n" for job in jobs))


def in_a_row(folder, name):
    """The cells of a preset beside each other, on nothing."""
    row = Image.new("RGBA", ground.SIZE, (0, 0, 0, 0))
    left = 0
    for size, _, width in CELLS:
        with Image.open(folder / f"{name}-{size}.png") as cell:
            row.paste(cell.convert("RGBA"), (left, 0))
        left += width
    return row


def chunk(kind, data):
    return struct.pack(">I", len(data)) + kind + data + struct.pack(">I", zlib.crc32(kind + data))


def unfiltered(image):
    """The image as a PNG whose rows are stored as they are: often smaller, as effects repeat themselves."""
    width, height = image.size
    pixels = image.tobytes()
    rows = b"".join(b"\0" + pixels[y * width * 3:(y + 1) * width * 3] for y in range(height))
    header = struct.pack(">IIBBBBB", width, height, 8, 2, 0, 0, 0)
    return (b"\x89PNG\r\n\x1a\n" + chunk(b"IHDR", header) + chunk(b"IDAT", zlib.compress(rows, 9))
            + chunk(b"IEND", b""))


def save(image, path):
    """Saves it without alpha, the smaller of two ways."""
    opaque = image.convert("RGB")
    filtered = io.BytesIO()
    opaque.save(filtered, "PNG", optimize=True)
    path.write_bytes(min(filtered.getvalue(), unfiltered(opaque), key=len))


def main(program, folder):
    names = preset_names(program)
    behind = ground.painted().convert("RGBA")
    with tempfile.TemporaryDirectory() as scratch:
        painted = Path(scratch)
        shades = [job for name in names for job in shade_jobs(name)]
        paint(program, shades + [job for name in names for job in cell_jobs(name)], painted)
        for job in shades:
            with Image.open(painted / job["output"]) as picture:
                save(picture, folder / job["output"])
        for name in names:
            row = Image.alpha_composite(behind, in_a_row(painted, name)).convert("RGB")
            save(row.point(3 * ROUNDED), folder / f"{name}-sizes.png")


if __name__ == "__main__":
    main(sys.argv[1], Path(sys.argv[2]))
