"""Contact strips: one text painted by vorelpaint in several styles, side by side, each with a caption."""

import json
import subprocess
import tempfile
from concurrent.futures import ThreadPoolExecutor
from dataclasses import dataclass, field
from pathlib import Path

from PIL import Image, ImageDraw, ImageFont

CAPTION_FONT = "/usr/share/fonts/truetype/dejavu/DejaVuSans.ttf"
CAPTION_SIZE = 15
CAPTION_LINE = 19
SPACE = 10  # around each text and its effects
PAINT_PADDING = 2

# What lies behind the text, and the colour of the captions on it.
GROUNDS = {"paper": ("#F4F1EA", "#33373D"), "night": ("#23272E", "#D7D9DC"), "slate": ("#9AA7B3", "#23272E"),
           "checks": ("#FFFFFF", "#33373D")}
CHECK_SIDE = 8
CHECK_COLOUR = "#D5D5D5"

GLYPH_BOX, MARGIN_BOX = "#D03030", "#2060C0"


@dataclass
class Cell:
    """One text in one style; a caption may have several lines."""

    caption: str
    style: dict
    text: str = ""  # the strip's, unless given
    size: int = 0  # the strip's, unless given
    cut: bool = False  # show what is left without the margins
    window: tuple = ()  # show this part alone: left, top, width and height, from the margins' corner


@dataclass
class Strip:
    """A picture of cells; what reaches farther from the glyphs than `most` is cut, and at least `least`
    pixels are left around them."""

    name: str
    cells: list
    text: str = "Rg"
    size: int = 80
    ground: str = "paper"
    columns: int = 6
    least: int = 0
    most: int = 1000
    font: str = "DejaVu Sans:bold"
    align: str = "left"
    boxes: bool = False  # outline the box of the glyphs and the box with the margins
    enlarged: int = 1  # the side of the square that shows a pixel


@dataclass
class Painted:
    image: Image.Image  # without padding
    left: int
    top: int
    right: int
    bottom: int
    cell: Cell = field(repr=False)

    def glyph_box(self):
        return self.left, self.top, self.image.width - self.right, self.image.height - self.bottom


class Painter:
    """Runs vorelpaint; style files and pictures stand in `folder`, where the patterns are."""

    def __init__(self, program, folder):
        self.program = program
        self.folder = Path(folder)

    def paint(self, strip, cell):
        with tempfile.NamedTemporaryFile("w", suffix=".json", dir=self.folder) as style:
            json.dump(cell.style, style)
            style.flush()
            picture = Path(style.name).with_suffix(".png")
            said = subprocess.run(
                [self.program, "--style", style.name, "--font", strip.font, "--size", str(cell.size or strip.size),
                 "--align", strip.align, "--padding", str(PAINT_PADDING), "--print-margins",
                 "-o", picture, "--", cell.text or strip.text],
                check=True, capture_output=True, text=True).stdout.split()
        # "margins left 0 top 0 right 0 bottom 0"
        left, top, right, bottom = (int(said[i]) for i in (2, 4, 6, 8))
        with Image.open(picture) as file:
            image = file.convert("RGBA")
        inner = (PAINT_PADDING, PAINT_PADDING, image.width - PAINT_PADDING, image.height - PAINT_PADDING)
        image = image.crop(inner)
        if not cell.window:
            return Painted(image, left, top, right, bottom, cell)
        x, y, width, height = cell.window
        part = image.crop((x, y, x + width, y + height))
        shown = (width * strip.enlarged, height * strip.enlarged)
        return Painted(part.resize(shown, Image.Resampling.NEAREST), 0, 0, 0, 0, cell)


def checks(size):
    image = Image.new("RGB", size, GROUNDS["checks"][0])
    draw = ImageDraw.Draw(image)
    for y in range(0, size[1], CHECK_SIDE):
        for x in range(y // CHECK_SIDE % 2 * CHECK_SIDE, size[0], 2 * CHECK_SIDE):
            draw.rectangle((x, y, x + CHECK_SIDE - 1, y + CHECK_SIDE - 1), CHECK_COLOUR)
    return image


def outline(draw, box, colour):
    """A frame just outside of a half-open box."""
    left, top, right, bottom = box
    draw.rectangle((left - 1, top - 1, right, bottom), outline=colour)


def draw_cell(strip, painted, size, origin, room):
    """A cell of `size` whose glyph box starts at `origin`; `room` is what is shown around it."""
    ground, ink = GROUNDS[strip.ground]
    canvas = Image.new("RGB", size, ground)
    height = size[1] - caption_height(strip)
    if strip.ground == "checks":
        canvas.paste(checks((size[0] - 2, height - 2)), (1, 1))
    box = painted.glyph_box()
    shown = box if painted.cell.cut else (max(box[0] - room[0], 0), max(box[1] - room[1], 0),
                                          box[2] + room[2], box[3] + room[3])
    part = painted.image.crop((shown[0], shown[1], min(shown[2], painted.image.width),
                               min(shown[3], painted.image.height)))
    layer = Image.new("RGBA", size, (0, 0, 0, 0))
    layer.paste(part, (origin[0] - (box[0] - shown[0]), origin[1] - (box[1] - shown[1])))
    canvas = Image.alpha_composite(canvas.convert("RGBA"), layer).convert("RGB")
    draw = ImageDraw.Draw(canvas)
    if strip.boxes:
        left, top = origin[0] - box[0], origin[1] - box[1]
        if not painted.cell.cut:
            outline(draw, (left, top, left + painted.image.width, top + painted.image.height), MARGIN_BOX)
        outline(draw, (left + box[0], top + box[1], left + box[2], top + box[3]), GLYPH_BOX)
    font = ImageFont.truetype(CAPTION_FONT, CAPTION_SIZE, layout_engine=ImageFont.Layout.BASIC)
    for line, words in enumerate(painted.cell.caption.split("\n")):
        draw.text((size[0] // 2, height + line * CAPTION_LINE), words, ink, font, anchor="ma")
    return canvas


def caption_height(strip):
    lines = max(cell.caption.count("\n") + 1 if cell.caption else 0 for cell in strip.cells)
    return lines * CAPTION_LINE + (6 if lines else 0)


def caption_width(cells):
    font = ImageFont.truetype(CAPTION_FONT, CAPTION_SIZE, layout_engine=ImageFont.Layout.BASIC)
    return max(int(font.getlength(line)) for cell in cells for line in cell.caption.split("\n"))


def draw_strip(strip, all_painted):
    """Lays the cells out in rows; the glyph boxes of a row start at one y, each in the middle of its cell."""
    room = [min(strip.most, max(strip.least, *(getattr(p, side) for p in all_painted)))
            for side in ("left", "top", "right", "bottom")]
    boxes = [p.glyph_box() for p in all_painted]
    across = max(box[2] - box[0] for box in boxes)
    down = max(box[3] - box[1] for box in boxes)
    width = max(room[0] + across + room[2] + 2 * SPACE, caption_width(strip.cells) + SPACE)
    middle = (width - room[0] - across - room[2]) // 2 + room[0] + across // 2
    size = (width, room[1] + down + room[3] + 2 * SPACE + caption_height(strip))
    columns = min(strip.columns, len(all_painted))
    rows = -(-len(all_painted) // columns)
    sheet = Image.new("RGB", (columns * size[0], rows * size[1]), GROUNDS[strip.ground][0])
    for at, (painted, box) in enumerate(zip(all_painted, boxes)):
        left = middle - (box[2] - box[0]) // 2
        cell = draw_cell(strip, painted, size, (left, SPACE + room[1]), room)
        sheet.paste(cell, (at % columns * size[0], at // columns * size[1]))
    return sheet


def paint_strips(program, strips, patterns, folder):
    """Paints every strip into `folder`; `patterns` maps the names of pattern images to images."""
    with tempfile.TemporaryDirectory() as scratch, ThreadPoolExecutor(2) as pool:
        painter = Painter(program, scratch)
        for name, image in patterns.items():
            image.save(Path(scratch) / name)
        for strip in strips:
            painted = list(pool.map(lambda cell: painter.paint(strip, cell), strip.cells))
            draw_strip(strip, painted).save(Path(folder) / f"{strip.name}.png", optimize=True)
