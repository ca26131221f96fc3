#!/usr/bin/env python3
"""Draws the pattern images of the presets beside itself: chalk.png, halftone.png, spray.png, stripes.png,
tiles.png.

Needs only Python's standard library and always writes the same pixels.
"""

import math
import pathlib
import random
import struct
import zlib


def write_png(path, size, pixel_at):
    """Writes a size x size PNG; pixel_at(x, y) gives straight R, G, B, A."""
    rows = b"".join(
        b"\0" + b"".join(bytes(pixel_at(x, y)) for x in range(size)) for y in range(size))

    def chunk(kind, data):
        checksum = zlib.crc32(kind + data)
        return struct.pack(">I", len(data)) + kind + data + struct.pack(">I", checksum)

    header = struct.pack(">IIBBBBB", size, size, 8, 6, 0, 0, 0)
    path.write_bytes(b"\x89PNG\r\n\x1a\n" + chunk(b"IHDR", header)
                     + chunk(b"IDAT", zlib.compress(rows, 9)) + chunk(b"IEND", b""))


def chalk(size):
    """Grains of white, dense along slanted strokes of the stick."""
    grain = random.Random(7)
    noise = [[grain.random() for _ in range(size)] for _ in range(size)]

    def pixel_at(x, y):
        stroke = 0.35 if (x + y) % 24 < 13 else 0.6
        alpha = 255 if noise[y][x] > stroke else int(60 * noise[y][x])
        return 245, 248, 240, alpha

    return pixel_at


def stripes(size):
    """Slanted stripes of red and white that meet at the tile's edges, softened by a blend."""
    def pixel_at(x, y):
        position = (x + y) % size
        distance = min(position, size - position) - size / 4
        white = min(1.0, max(0.0, distance + 0.5))
        red = (226, 24, 72)
        return tuple(round(c + (255 - c) * white) for c in red) + (255,)

    return pixel_at


def tiles(size):
    """Four glazed squares in pale joints. The joints lie beside the multiples of 6 pixels, the only ones
    that are seen of a tile made six times smaller: small tiles keep their glaze."""
    half, joint = size // 2, size // 16
    glazes = ((38, 132, 176), (120, 200, 206), (246, 200, 92), (38, 132, 176))

    def pixel_at(x, y):
        in_x, in_y = (x - joint) % half, (y - joint) % half
        if in_x < joint or in_y < joint:
            return 240, 240, 232, 255
        column, row = (x - joint) % size // half, (y - joint) % size // half
        shine = 22 if min(in_x, in_y) < joint + 2 else 0
        return tuple(min(255, c + shine) for c in glazes[column + 2 * row]) + (255,)

    return pixel_at


def distance_around(size, x, y, x2, y2):
    """From one place to another on a tile that goes on at its edges."""
    across, down = abs(x - x2), abs(y - y2)
    return math.hypot(min(across, size - across), min(down, size - down))


def halftone(size):
    """Dots of printer's orange in slanted rows."""
    first, second = size / 4 - 0.5, size * 3 / 4 - 0.5
    radius = size * 0.21

    def pixel_at(x, y):
        distance = min(distance_around(size, x, y, at, at) for at in (first, second))
        return 255, 90, 0, round(255 * min(1.0, max(0.0, radius - distance + 0.5)))

    return pixel_at


def spray(size):
    """White droplets of a can, most of them tiny."""
    can = random.Random(5)
    alpha = [[0.0] * size for _ in range(size)]
    for _ in range(size * size // 60):
        x, y = can.random() * size, can.random() * size
        radius = can.choice((0.9, 1, 1.3, 2, 3))
        for row in range(size):
            for column in range(size):
                drop = radius - distance_around(size, column, row, x, y) + 0.5
                alpha[row][column] = max(alpha[row][column], min(1.0, drop))
    return lambda x, y: (255, 255, 255, round(255 * alpha[y][x]))


def main():
    here = pathlib.Path(__file__).resolve().parent
    write_png(here / "chalk.png", 96, chalk(96))
    write_png(here / "halftone.png", 16, halftone(16))
    write_png(here / "spray.png", 96, spray(96))
    write_png(here / "stripes.png", 32, stripes(32))
    write_png(here / "tiles.png", 48, tiles(48))


if __name__ == "__main__":
    main()
