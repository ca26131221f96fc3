"""Text effects: outlines, shadows, glows, gradients and patterns, the same bytes on every CPU.

Masks of glyphs, from any rasteriser, are painted in a Look:

    >>> import numpy as np
    >>> import voreleffect as ve
    >>> look = ve.Look().fill("#3366cc").stroke(4, "#fff")
    >>> picture = look.paint(np.full((20, 30), 255, np.uint8))
    >>> picture.array.shape, picture.left, picture.top
    ((28, 38, 4), -4, -4)

Texts in fonts are painted by text, in a Look, a Style or a preset:

    >>> ve.text("Hello", look="neon").mode
    'RGBA'
"""

from ._batch import JobError, batch
from ._look import Look, Painter, paint
from ._picture import Picture, TextPicture
from ._style import Style, presets
from ._text import text, text_picture
from ._values import Box, Margins, Stop
from ._voreleffect import Error, StyleError, TextError
from ._voreleffect import version as __version__

__all__ = [
    "Box", "Error", "JobError", "Look", "Margins", "Painter", "Picture", "Stop", "Style", "StyleError",
    "TextError", "TextPicture", "__version__", "batch", "paint", "presets", "text", "text_picture",
]
