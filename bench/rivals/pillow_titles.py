#!/usr/bin/env python3
"""Paints a title a line with Pillow, all of them in one process or in a pool of several:

    pillow_titles.py [--fast] shadow|gradient|glow TITLES FOLDER JOBS
    pillow_titles.py [--fast] --version

--fast has PNG files compressed by zlib's level 1; the default is 6.
Masks of one channel are blurred, and text is drawn straight onto its shadow: less work than layers of
four channels laid over each other.
"""
import functools
import multiprocessing
import sys

import PIL
from PIL import Image, ImageDraw, ImageFilter, ImageFont

SIZE = (1500, 130)
CENTRE = (750, 92)  # of the base line
FONT = ImageFont.truetype("/usr/share/fonts/truetype/dejavu/DejaVuSans-Bold.ttf", 96)


def draw(picture, text, at=CENTRE, **more):
    ImageDraw.Draw(picture).text(at, text, font=FONT, anchor="ms", **more)


def blurred(text, sigma, **more):
    mask = Image.new("L", SIZE)
    draw(mask, text, **more)
    return mask.filter(ImageFilter.GaussianBlur(sigma))


def shadow(text):
    picture = Image.new("RGBA", SIZE)
    picture.putalpha(blurred(text, 4, at=(CENTRE[0] + 5, CENTRE[1] + 5), fill=191))
    draw(picture, text, fill="#FFFFFF", stroke_width=4, stroke_fill="#000000")
    return picture


@functools.lru_cache(maxsize=1)
def ramp():
    """From yellow at the top of the letters to orange at their lower end."""
    down = Image.linear_gradient("L").resize((SIZE[0], 95))
    picture = Image.new("RGBA", SIZE, "#FFE08A")
    picture.paste(Image.composite(Image.new("RGBA", down.size, "#F08A24"),
                                  Image.new("RGBA", down.size, "#FFE08A"), down), (0, 18))
    return picture


def gradient(text):
    picture = Image.new("RGBA", SIZE)
    draw(picture, text, fill="#5A2A00", stroke_width=4)
    letters = Image.new("L", SIZE)
    draw(letters, text, fill=255)
    picture.paste(ramp(), mask=letters)
    return picture


def glow(text):
    picture = Image.new("RGBA", SIZE, "#2090FF")
    picture.putalpha(blurred(text, 4, fill=255, stroke_width=6))
    draw(picture, text, fill="#FFFFFF")
    return picture


LOOKS = {"shadow": shadow, "gradient": gradient, "glow": glow}


def paint(look, folder, settings, numbered):
    number, text = numbered
    LOOKS[look](text).save(f"{folder}/{number}.png", **settings)


def main():
    fast = sys.argv[1] == "--fast"
    settings = {"compress_level": 1} if fast else {}
    arguments = sys.argv[2 if fast else 1:]
    if arguments == ["--version"]:
        print(f"Pillow {PIL.__version__}{', level 1' if fast else ''}")
        return
    look, titles, folder, jobs = arguments
    with open(titles, encoding="utf-8") as file:
        numbered = list(enumerate(file.read().splitlines()))
    one = functools.partial(paint, look, folder, settings)
    if jobs == "1":
        for title in numbered:
            one(title)
    else:
        with multiprocessing.Pool(int(jobs)) as pool:
            pool.map(one, numbered)


main()
