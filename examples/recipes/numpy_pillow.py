"""A line of text on an image of Pillow and on an array of NumPy, its coverage drawn by Pillow."""

import numpy as np
import voreleffect as ve
from PIL import Image, ImageDraw, ImageFont

FONT = "/usr/share/fonts/truetype/dejavu/DejaVuSans-Bold.ttf"


def mask_of(text, font):
    """The coverage of a line and where it stands from the start of the baseline: left, top, mask."""
    left, top, right, bottom = font.getbbox(text, anchor="ls")
    mask = Image.new("L", (right - left, bottom - top))
    ImageDraw.Draw(mask).text((-left, -top), text, 255, font, anchor="ls")
    return left, top, mask


def on_image(image, look, masks, x, y):
    """Lays the painted masks over an image of RGBA, whose pixels are straight. All of it must lie within."""
    picture = look.paint(masks)
    image.alpha_composite(picture.image(), (x + picture.left, y + picture.top))


def on_array(array, look, masks, x, y):
    """Lays them over an array of premultiplied pixels: (height, width, 4) of uint8."""
    look.paint(masks, onto=array, x=x, y=y)


def check_laid(array, look, masks, x, y, paper):
    """Each channel is over + under * (255 - alpha) / 255, to the nearest."""
    over = np.zeros(array.shape, np.int64)
    picture = look.paint(masks)
    left, top = x + picture.left, y + picture.top
    over[top:top + picture.height, left:left + picture.width] = picture.array
    through = (2 * np.array(paper) * (255 - over[..., 3:]) + 255) // 510
    assert np.array_equal(array, np.minimum(over + through, 255)), "over + under * (255 - alpha) / 255"


def main():
    look = (ve.Look()
            .fill("#FFE873")
            .outer_shadow("#0A1E33", angle=120, distance=6, size=6, opacity=0.8)
            .stroke(4, "#1F4E79"))
    masks = [mask_of("NumPy", ImageFont.truetype(FONT, 72))]
    paper = (75, 139, 190, 255)

    array = np.full((120, 320, 4), paper, np.uint8)
    on_array(array, look, masks, 20, 80)
    check_laid(array, look, masks, 20, 80, paper)

    # Pillow lays over with roundings of its own.
    image = Image.new("RGBA", (320, 120), paper)
    on_image(image, look, masks, 20, 80)
    assert np.abs(np.asarray(image).astype(int) - array).max() <= 2, "as on the array"
    image.save("numpy_pillow.png")

    blank = image.copy()
    on_image(blank, look, [mask_of(" ", ImageFont.truetype(FONT, 72))], 20, 80)
    assert blank == image, "a blank leaves the image as it was"


main()
