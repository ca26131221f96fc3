"""Values of arguments: colours, numbers, stops, and what calls return."""

from __future__ import annotations

import math
import numbers
from collections.abc import Iterable
from typing import Any, NamedTuple, Tuple, Union

#: ``"#RGB"``, ``"#RRGGBB"``, ``0xRRGGBB``, or (red, green, blue) with 0 to 255 each.
Color = Union[str, int, Tuple[int, int, int]]


class Margins(NamedTuple):
    """Pixels around glyphs, 0 or more on each side."""

    left: int
    top: int
    right: int
    bottom: int


class Box(NamedTuple):
    """A box of whole pixels; right and bottom lie one past the last column and row."""

    left: int
    top: int
    right: int
    bottom: int


class Stop(NamedTuple):
    """One colour of a ramp. A tuple (color, place) or (color, place, opacity) stands for one."""

    color: Color
    place: float  #: 0 to 1, ascending from stop to stop
    opacity: float = 1.0  #: 0 to 1


StopLike = Union[Stop, Tuple[Color, float], Tuple[Color, float, float]]
StopState = Tuple[int, float, float]

MOST_STOPS = 256


def number(value: object, name: str) -> float:
    """A finite number. Raises TypeError, or ValueError for one that is none."""
    if not isinstance(value, numbers.Real):
        raise TypeError(f"{name}: a number, not {type(value).__name__}")
    try:
        result = float(value)
    except OverflowError:
        result = math.inf
    if not math.isfinite(result) or abs(result) > 3e38:
        raise ValueError(f"{name}: {value!r} is no finite number")
    return result


def string(value: object, name: str) -> str:
    """A text that UTF-8 can say. Raises TypeError, or ValueError for halves of surrogate pairs."""
    if not isinstance(value, str):
        raise TypeError(f"{name}: a str, not {type(value).__name__}")
    value.encode()  # raises UnicodeEncodeError, a ValueError
    return value


def _channel(value: object) -> int:
    if isinstance(value, bool) or not isinstance(value, numbers.Integral):
        raise TypeError(f"a channel of a colour is a whole number, not {type(value).__name__}")
    channel = int(value)
    if not 0 <= channel <= 255:
        raise ValueError(f"a channel of a colour is 0 to 255, not {channel}")
    return channel


def color(value: Color) -> int:
    """The colour as 0xRRGGBB. Raises TypeError or ValueError."""
    if isinstance(value, str):
        digits = value[1:]
        is_hex = value[:1] == "#" and len(digits) in (3, 6) and set(digits) <= set("0123456789abcdefABCDEF")
        if not is_hex:
            raise ValueError(f"{value!r} is no colour: write '#RRGGBB' or '#RGB'")
        return int("".join(2 * digit for digit in digits) if len(digits) == 3 else digits, 16)
    if isinstance(value, numbers.Integral) and not isinstance(value, bool):
        whole = int(value)
        if not 0 <= whole <= 0xFFFFFF:
            raise ValueError(f"{whole:#x} is no colour: it is 0 to 0xFFFFFF")
        return whole
    if isinstance(value, Iterable) and not isinstance(value, (bytes, dict, set)):
        channels = [_channel(channel) for channel in value]
        if len(channels) != 3:
            raise ValueError(f"a colour has 3 channels, not {len(channels)}")
        return channels[0] << 16 | channels[1] << 8 | channels[2]
    raise TypeError(f"a colour is a str, an int or (red, green, blue), not {type(value).__name__}")


def stops(given: Iterable[StopLike]) -> tuple[StopState, ...]:
    """1 to 256 stops as (0xRRGGBB, place, opacity). Raises TypeError or ValueError."""
    result = []
    for stop in given:
        if not isinstance(stop, tuple) or len(stop) not in (2, 3):
            raise TypeError("a stop is a Stop, (color, place) or (color, place, opacity)")
        full = Stop(*stop)
        result.append((color(full.color), number(full.place, "place"), number(full.opacity, "opacity")))
    if not 1 <= len(result) <= MOST_STOPS:
        raise ValueError(f"a ramp has 1 to {MOST_STOPS} stops, not {len(result)}")
    return tuple(result)


def spelled(value: int) -> str:
    """0xRRGGBB as style files have it."""
    return f"#{value:06X}"


def rgba_of(image: Any) -> Any:
    """An image of Pillow as straight RGBA, anything else as it is."""
    if hasattr(image, "convert") and hasattr(image, "getbands"):
        return image.convert("RGBA")
    return image
