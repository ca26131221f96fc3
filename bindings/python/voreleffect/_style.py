"""Whole style files: stacks of looks, with lengths that may be shares of the font's size."""

from __future__ import annotations

import json
import operator
import os
from pathlib import Path
from typing import Any

from . import _voreleffect as native
from ._look import Look, _look_of
from ._values import Margins, number, rgba_of, string

#: More than a style may have: what is longer is refused.
_MOST_READ = 1 << 20
_PRESETS = Path(__file__).with_name("presets")


def presets() -> list[str]:
    """The names of the presets that come with the package, sorted."""
    return sorted(path.stem for path in _PRESETS.glob("*.json"))


class Style:
    """A style file (docs/style-files.md): one look or several, moved or of lines, words and glyphs.

    It is made by from_json, read or preset, and never changes. Styles are equal when their files say the
    same and have the same pictures.
    """

    __slots__ = ("_images", "_name", "_native", "_text")
    _text: str
    _name: str
    _images: dict[str, Any]
    _native: native.NativeStyle

    def __init__(self) -> None:
        raise TypeError("a style comes from Style.from_json, Style.read or Style.preset")

    def __setattr__(self, name: str, value: object) -> None:
        raise AttributeError(f"a style does not change: {name} cannot be set")

    def __delattr__(self, name: str) -> None:
        raise AttributeError(f"a style does not change: {name} cannot be deleted")

    @staticmethod
    def from_json(style: str | dict[str, Any], *, name: str = "", folder: str | os.PathLike[str] | None = None,
                  images: dict[str, Any] | None = None) -> Style:
        """The style of the text of a style file, or of what json.loads makes of one.

        name    what messages call it
        folder  where the PNG files of its patterns lie
        images  pictures of its patterns by their names, (height, width, 4) arrays or images of Pillow

        Raises StyleError, which tells the path of the key that is wrong.
        """
        text = string(style if isinstance(style, str) else json.dumps(style), "style")
        given = {string(key, "images"): rgba_of(image) for key, image in dict(images or {}).items()}
        where = None if folder is None else os.fsencode(folder)
        return _made(text, name, native.NativeStyle(text, string(name, "name"), given, where))

    @staticmethod
    def read(path: str | os.PathLike[str]) -> Style:
        """The style of a file; the pictures of its patterns lie beside it. Raises OSError or StyleError."""
        file = Path(path)
        name = os.fsencode(file).decode(errors="replace")
        with file.open("rb") as opened:
            data = opened.read(_MOST_READ)
        try:
            text = data.decode()
        except UnicodeDecodeError as error:
            raise native.StyleError(f"style '{name}': {error}") from None
        return Style.from_json(text, name=name, folder=file.parent)

    @staticmethod
    def preset(name: str) -> Style:
        """The preset of this name. Raises StyleError, which lists the presets, when there is none."""
        if name not in presets():
            raise native.StyleError(f"no preset {name!r}; there are {', '.join(presets())}")
        return Style.read(_PRESETS / f"{name}.json")

    def to_json(self) -> str:
        """The text that it was made of."""
        return self._text

    @property
    def description(self) -> str:
        """What the file says that it shows; may be empty."""
        return self._native.description()

    def looks(self, size: int, *, effect_scale: float = 1.0) -> list[Look]:
        """Its looks for a font of `size` pixels, the lowest first, to paint masks in.

        Raises StyleError when one is moved or of lines, words or glyphs: these the function text paints.
        """
        size, scale = _size(size, effect_scale)
        return [_look_of(state) for state in self._native.looks(size, scale)]

    def key(self, size: int, *, effect_scale: float = 1.0) -> bytes:
        """Its key for a cache, with a font of `size` pixels."""
        size, scale = _size(size, effect_scale)
        return self._native.key(size, scale)

    def margins(self, size: int, *, effect_scale: float = 1.0) -> Margins:
        """How far it paints beyond the glyphs of a font of `size` pixels."""
        size, scale = _size(size, effect_scale)
        return Margins(*self._native.margins(size, scale))

    def _said(self) -> tuple[str, Any]:
        said = json.loads(self._text.removeprefix("\ufeff"))  # the mark that editors put before UTF-8
        return json.dumps(said, sort_keys=True), self._images

    def __eq__(self, other: object) -> bool:
        if not isinstance(other, Style):
            return NotImplemented
        return self._said() == other._said()

    def __hash__(self) -> int:
        return hash(self._said()[0])

    def __copy__(self) -> Style:
        return self

    def __deepcopy__(self, memo: object) -> Style:
        return self

    def __reduce__(self) -> tuple[Any, tuple[Any, ...]]:
        return _unpickled, (self._text, self._name, self._images)

    def __repr__(self) -> str:
        return f"<Style {self._name or 'of JSON'!r}: {self.description!r}>"


def _size(size: int, effect_scale: float) -> tuple[int, float]:
    whole, scale = operator.index(size), number(effect_scale, "effect_scale")
    if not 1 <= whole <= 1000:
        raise ValueError(f"size: {whole} is no whole number from 1 to 1000")
    if not 0.05 <= scale <= 20:
        raise ValueError(f"effect_scale: {scale:g} is no number from 0.05 to 20")
    return whole, scale


def _made(text: str, name: str, made: native.NativeStyle) -> Style:
    style = object.__new__(Style)
    for slot, value in (("_text", text), ("_name", name), ("_native", made), ("_images", made.images())):
        object.__setattr__(style, slot, value)
    return style


def _unpickled(text: str, name: str, images: dict[str, tuple[int, int, bytes]]) -> Style:
    import numpy as np

    arrays = {key: np.frombuffer(data, np.uint8).reshape(height, width, 4)
              for key, (width, height, data) in images.items()}
    return Style.from_json(text, name=name, images=arrays)
