#!/usr/bin/env python3
"""Draws the pattern images of the presets beside itself: chalk.png, stripes.png, tiles.png.

Needs only Python's standard library and always writes the same pixels.
"""

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
        stroke = 0.35 if (x + y) % 16 < 9 else 0.6
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
    """Four glazed squares with pale joints."""
    half = size // 2
    glazes = ((38, 132, 176), (104, 187, 196), (240, 196, 92), (38, 132, 176))

    def pixel_at(x, y):
        if x % half == 0 or y % half == 0:
            return 232, 236, 232, 255
        glaze = glazes[(x // half) + 2 * (y // half)]
        shine = 24 if x % half == 1 or y % half == 1 else 0
        return tuple(min(255, c + shine) for c in glaze) + (255,)

    return pixel_at


def main():
    here = pathlib.Path(__file__).resolve().parent
    write_png(here / "chalk.png", 64, chalk(64))
    write_png(here / "stripes.png", 32, stripes(32))
    write_png(here / "tiles.png", 16, tiles(16))


if __name__ == "__main__":
    main()
