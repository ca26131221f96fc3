"""Pictures: arrays that know where they stand."""

from __future__ import annotations

from dataclasses import dataclass
from typing import TYPE_CHECKING, Any

import numpy as np
import numpy.typing as npt

from ._values import Box, Margins

if TYPE_CHECKING:
    import PIL.Image

Array = npt.NDArray[np.uint8]


def image_of(array: Array, mode: str) -> PIL.Image.Image:
    """The array as an image of Pillow, which shares its memory and copies it when it is changed."""
    try:
        import PIL.Image
    except ImportError as error:
        raise ImportError("images need Pillow; the array of the picture does without") from error
    height, width = array.shape[:2]
    if array.size == 0:
        return PIL.Image.new(mode, (width, height))
    return PIL.Image.frombuffer(mode, (width, height), np.ascontiguousarray(array), "raw", mode, 0, 1)


def _converted(array: Array, dtype: Any, copy: bool | None) -> npt.NDArray[Any]:
    """What numpy asks an object for: the array itself, unless a copy is asked for or another type needs one."""
    converted = np.asarray(array, dtype)
    if converted is not array and copy is False:
        raise ValueError(f"pixels of {array.dtype} are copied to become {converted.dtype}")
    return array.copy() if converted is array and copy else converted


@dataclass(frozen=True, eq=False)
class Picture:
    """Premultiplied pixels, just large enough for the glyphs and their effects.

    ``numpy.asarray(picture)`` is ``picture.array``; nothing is copied.
    """

    array: Array  #: (height, width, 4) of uint8: red, green, blue, alpha; it owns the pixels
    left: int  #: of its left column, from the origin of the text
    top: int  #: of its top row, from the origin of the text

    @property
    def width(self) -> int:
        """Pixels of a row."""
        return int(self.array.shape[1])

    @property
    def height(self) -> int:
        """Rows."""
        return int(self.array.shape[0])

    @property
    def box(self) -> Box:
        """Where it lies, from the origin of the text."""
        return Box(self.left, self.top, self.left + self.width, self.top + self.height)

    def __array__(self, dtype: Any = None, copy: bool | None = None) -> npt.NDArray[Any]:
        return _converted(self.array, dtype, copy)

    def image(self) -> PIL.Image.Image:
        """A straight image of Pillow, mode RGBA. Raises ImportError without Pillow."""
        return image_of(self.array, "RGBa").convert("RGBA")


@dataclass(frozen=True, eq=False)
class TextPicture:
    """A text that is painted, and what is known of it. Places are from the top left corner."""

    array: Array  #: (height, width, 4) of uint8: red, green, blue, alpha; it owns the pixels
    is_premultiplied: bool  #: whether the colours are multiplied with alpha
    x: int  #: column of the origin of the text, where its first baseline begins
    y: int  #: row of the origin of the text
    baseline: int  #: row of the first baseline
    size: int  #: of the font, in pixels: the one that was asked for, or that fits
    ink: Box  #: around the glyphs
    box: Box  #: the box that was asked for
    margins: Margins  #: pixels that the effects need around the glyphs
    key: bytes  #: of the style, for a cache
    fonts: tuple[str, ...]  #: names of the fonts that have a glyph in it, in the order of their first use
    missing: tuple[str, ...]  #: characters that no font has
    notes: tuple[str, ...]  #: lines that say what is odd

    @property
    def width(self) -> int:
        """Pixels of a row."""
        return int(self.array.shape[1])

    @property
    def height(self) -> int:
        """Rows."""
        return int(self.array.shape[0])

    def __array__(self, dtype: Any = None, copy: bool | None = None) -> npt.NDArray[Any]:
        return _converted(self.array, dtype, copy)

    def image(self) -> PIL.Image.Image:
        """A straight image of Pillow, mode RGBA. Raises ImportError without Pillow."""
        if self.is_premultiplied:
            return image_of(self.array, "RGBa").convert("RGBA")
        return image_of(self.array, "RGBA")
