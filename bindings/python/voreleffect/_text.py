"""Texts in fonts, painted as vorelpaint paints them."""

from __future__ import annotations

import functools
import os
from collections.abc import Callable, Iterable, Mapping, Sequence
from typing import TYPE_CHECKING, Any, Literal, Union

from . import _voreleffect as native
from ._look import Look, _stack_of
from ._picture import TextPicture
from ._style import Style
from ._values import Box, Color, Margins, color, number, spelled, string

if TYPE_CHECKING:
    import PIL.Image
    from typing_extensions import ParamSpec

    Arguments = ParamSpec("Arguments")

Font = Union[str, "os.PathLike[str]"]
#: A look, a stack of looks with the last on top, a style, or the name of a preset.
LookLike = Union[Look, Sequence[Look], Style, str, None]
Align = Literal["left", "center", "right", "start", "end"]
Anchor = Literal["top-left", "top", "top-right", "left", "center", "right", "bottom-left", "bottom", "bottom-right"]
Fit = Literal["none", "shrink", "wrap"]
TextBox = Literal["ink", "line"]

os.register_at_fork(after_in_child=native.after_fork_in_child)


def _fonts(font: Font | Iterable[Font]) -> list[bytes]:
    """Families and files as their bytes: the name of a file need not be UTF-8."""
    names = [os.fspath(each) for each in ([font] if isinstance(font, (str, bytes, os.PathLike)) else font)]
    for name in names:
        if not isinstance(name, str):
            raise TypeError(f"font: a str or a path, not {type(name).__name__}")
    return [name.encode(errors="surrogateescape") for name in names]


def _features(features: str | Iterable[str]) -> list[str]:
    split = features.split(",") if isinstance(features, str) and features else features
    return [string(feature, "features") for feature in split]


def _spacing(length: float | str) -> tuple[float, bool]:
    """The number, and whether it is a percentage."""
    if isinstance(length, str):
        ending = "%" if length.endswith("%") else "px" if length.endswith("px") else ""
        try:
            return number(float(length[: len(length) - len(ending)]), "letter_spacing"), ending == "%"
        except ValueError:
            raise ValueError(f"letter_spacing: {length!r} is no length such as 3, '3px' or '5%'") from None
    return number(length, "letter_spacing"), False


def _look(look: LookLike) -> Any:
    """What the extension takes for a look."""
    if look is None:
        return []
    if isinstance(look, str):
        return Style.preset(look)._native
    if isinstance(look, Style):
        return look._native
    return [each._native for each in _stack_of(look)]


def _background(background: Color | Literal["checkerboard"] | None) -> str:
    if background is None or background == "transparent":
        return "transparent"
    return "checkerboard" if background == "checkerboard" else spelled(color(background))


def text_picture(
    text: str,
    *,
    font: Font | Iterable[Font] = "DejaVu Sans",
    size: int = 96,
    look: LookLike = None,
    markup: bool = False,
    align: Align = "left",
    line_height: float = 1.0,
    letter_spacing: float | str = 0,
    features: str | Iterable[str] = (),
    variations: Mapping[str, float] | None = None,
    color: Color | None = None,
    opacity: float | None = None,
    effect_scale: float = 1.0,
    width: int | None = None,
    height: int | None = None,
    anchor: Anchor = "center",
    margin: int = 0,
    fit: Fit = "none",
    box: TextBox = "ink",
    padding: int = 8,
    background: Color | Literal["checkerboard"] | None = None,
    premultiplied: bool = False,
    strict: bool = False,
) -> TextPicture:
    """Paints a text and tells of the picture. The same pixels as vorelpaint of the same version paints with
    the same fonts.

    text            at most 64 KiB of UTF-8; a line feed starts a new line
    font            a family ("DejaVu Sans:bold"), a file, or up to 16 of them: each has what those before it
                    lack, installed ones what all lack
    size            of the font: 1 to 1000 pixels
    look            a Look, a stack of looks with the last on top, a Style, or the name of a preset
    markup          reads <c #RRGGBB>...</c> in the text as a colour; &lt;, &gt; and &amp; stand for <, > and &
    align           where short lines stand; start and end go by the text's direction
    line_height     0.5 to 10 line heights of the font
    letter_spacing  -200 to 200 pixels, or percent of the size as in "5%"
    features        of OpenType: "liga=0,ss01" or a list
    variations      axes of the first font: {"wght": 700}
    color           fill of the topmost look that has one, instead of the look's
    opacity         of that text, 0 to 1
    effect_scale    multiplies the effects' sizes: 0.05 to 20
    width, height   of the picture, 1 to 16384 pixels; without, what the text needs
    anchor, margin  where the text stands in these, and 0 to 8000 pixels between it and their edges
    fit             what is done with a text that is larger: nothing, a smaller font, broken lines
    box             what counts as the text's box: its ink, or its lines
    padding         pixels around the text and its effects where no width or height is given: 0 to 1000
    background      a colour, "checkerboard", or None for a transparent one
    premultiplied   leaves the pixels premultiplied; there is no background then
    strict          takes every note for an error

    Other threads run while it paints. Raises TextError for a font that is not there, a text that no
    character is seen of or that does not fit; StyleError; ValueError and TypeError for other arguments;
    MemoryError.
    """
    if premultiplied and background is not None:
        raise ValueError("premultiplied: not beside a background")
    arguments = {
        "text": string(text, "text"), "markup": bool(markup), "font": _fonts(font), "size": size,
        "align": string(align, "align"), "line_height": number(line_height, "line_height"),
        "letter_spacing": _spacing(letter_spacing), "features": _features(features),
        "variations": [(string(axis, "variations"), number(value, "variations"))
                       for axis, value in dict(variations or {}).items()],
        "color": None if color is None else _color(color),
        "opacity": None if opacity is None else number(opacity, "opacity"),
        "effect_scale": number(effect_scale, "effect_scale"), "width": width, "height": height,
        "anchor": string(anchor, "anchor"), "margin": margin, "fit": string(fit, "fit"),
        "box": string(box, "box"), "padding": padding, "strict": bool(strict),
        "background": None if premultiplied else _background(background),
    }
    array, x, y, baseline, painted_size, ink, box_, margins, key, fonts, missing, notes = native.paint_text(
        arguments, _look(look))
    return TextPicture(array, premultiplied, x, y, baseline, painted_size, Box(*ink), Box(*box_),
                       Margins(*margins), key, tuple(fonts), tuple(missing), tuple(notes))


_color = color


def _as_image(picture: Callable[Arguments, TextPicture]) -> Callable[Arguments, PIL.Image.Image]:
    """The same call, which returns the image alone."""

    @functools.wraps(picture)
    def text(*args: Arguments.args, **kwargs: Arguments.kwargs) -> PIL.Image.Image:
        return picture(*args, **kwargs).image()

    text.__name__ = text.__qualname__ = "text"
    text.__doc__ = ("Paints a text: a straight image of Pillow, mode RGBA. Raises ImportError without Pillow.\n\n"
                    f"As text_picture: {picture.__doc__}")
    return text


text = _as_image(text_picture)
