"""Looks as values, and painting masks in them."""

from __future__ import annotations

import json
import os
from collections.abc import Iterable, Sequence
from typing import Any, Literal, Tuple, Union, overload

import numpy as np

from . import _voreleffect as native
from ._picture import Array, Picture
from ._values import Box, Color, Margins, StopLike, StopState, color, number, rgba_of, spelled, stops

#: One array of coverage, or placements (x, y, mask): see Look.paint.
Masks = Union[Any, Sequence[Tuple[int, int, Any]]]
Position = Literal["outside", "inside", "centre", "center"]
Order = Literal["rgba", "bgra"]

EffectState = Tuple[Any, ...]
LookState = Tuple[int, float, bool, float, Tuple[EffectState, ...]]

_PLAIN: LookState = (0, 1.0, True, 1.0, ())
_POSITIONS = {"centre": 0, "center": 0, "outside": 1, "inside": 2}
_POSITION_KEYS = ("center", "outside", "inside")


def _unit(value: object, name: str) -> float:
    return min(max(number(value, name), 0.0), 1.0)


class Look:
    """What text looks like: a fill and effects.

    At the start the fill is black and there are no effects. A look is a value: it never changes, each call
    returns another one, and any number of threads may share it.

        Look().fill("#3366cc").outer_shadow("#000", size=8, opacity=0.6).stroke(4, "#fff")

    Effects lie in three groups, from the top: those inside the glyphs, the fill, those beneath the text.
    Within a group the one that was added last lies on top. A look has one effect of a kind; another one
    takes its place. For more of them paint several looks, one over the other.

    Lengths are pixels, angles degrees: 0 the right, 90 above. Numbers out of their range become what the
    library makes of them, as in C++. What is no number raises TypeError, one that is not finite ValueError.

    Looks are equal when their keys are.
    """

    __slots__ = ("_native", "_state")
    _state: LookState
    _native: native.NativeLook

    def __new__(cls) -> Look:
        look = object.__new__(cls)
        _set_state(look, _PLAIN)
        return look

    def __setattr__(self, name: str, value: object) -> None:
        raise AttributeError(f"a look does not change: {name} cannot be set")

    def __delattr__(self, name: str) -> None:
        raise AttributeError(f"a look does not change: {name} cannot be deleted")

    # The fill.

    def fill(self, color: Color, opacity: float = 1.0) -> Look:
        """Fills the glyphs. Through a fill of an opacity (0 to 1) below 1 what lies beneath is seen."""
        _, _, _, text_opacity, effects = self._state
        return _look_of((_color(color), _unit(opacity, "opacity"), True, text_opacity, effects))

    def no_fill(self) -> Look:
        """Leaves out the fill. What lies beneath the text is cut out of the glyphs."""
        fill, fill_opacity, _, text_opacity, effects = self._state
        return _look_of((fill, fill_opacity, False, text_opacity, effects))

    def text_opacity(self, opacity: float) -> Look:
        """The opacity of the text, 0 to 1; below 1 what lies beneath it is cut out of the glyphs."""
        fill, fill_opacity, filled, _, effects = self._state
        return _look_of((fill, fill_opacity, filled, _unit(opacity, "opacity"), effects))

    # The effects, with the words of look.h in their order.

    def outer_shadow(self, color: Color, *, angle: float = 135, distance: float = 4, size: float = 4,
                     opacity: float = 1.0) -> Look:
        """A shadow behind the glyphs.

        angle     where the light comes from, in degrees: 0 the right, 90 above
        distance  how far it is moved, away from the light: 0 to 100 pixels
        size      radius of the blur: 0 to 100 pixels
        opacity   0 to 1
        """
        return self._shadow("outerShadow", color, angle, distance, size, opacity)

    def inner_shadow(self, color: Color, *, angle: float = 135, distance: float = 4, size: float = 4,
                     opacity: float = 1.0) -> Look:
        """A shadow that falls into the glyphs; see outer_shadow."""
        return self._shadow("innerShadow", color, angle, distance, size, opacity)

    def outer_glow(self, size: float, color: Color, *, stops: Iterable[StopLike] | None = None,
                   opacity: float = 1.0) -> Look:
        """A halo around the glyphs, 0 to 100 pixels wide.

        stops    1 to 256 colours from the edge of the glyphs onwards, instead of the one colour
        opacity  0 to 1, multiplied with that of each stop
        """
        return self._glow("outerGlow", size, color, stops, opacity)

    def inner_glow(self, size: float, color: Color, *, stops: Iterable[StopLike] | None = None,
                   opacity: float = 1.0) -> Look:
        """A glow from the edges of the glyphs inwards; see outer_glow."""
        return self._glow("innerGlow", size, color, stops, opacity)

    def linear_gradient(self, stops: Iterable[StopLike], *, angle: float = 0, scale: float = 1,
                        opacity: float = 1.0) -> Look:
        """A ramp across the box of the glyphs.

        stops    1 to 256
        angle    0 runs to the right, 90 upwards
        scale    its length in lengths of the box: 0.1 to 2; less paints nothing
        opacity  0 to 1, multiplied with that of each stop
        """
        return self._with(("linearGradient", number(angle, "angle"), number(scale, "scale"),
                           number(opacity, "opacity"), _stops(stops)))

    def radial_gradient(self, stops: Iterable[StopLike], *, scale: float = 1,
                        opacity: float = 1.0) -> Look:
        """A ramp from the centre of the box of the glyphs; its scale is in half widths of the box."""
        return self._with(("radialGradient", number(scale, "scale"), number(opacity, "opacity"), _stops(stops)))

    def stroke(self, size: float, color: Color, *, position: Position = "outside",
               opacity: float = 1.0) -> Look:
        """An outline, 0 to 100 pixels wide: outside, inside, or centred on the edge of the glyphs."""
        if position not in _POSITIONS:
            raise ValueError(f"position: {position!r} is none of outside, inside, centre")
        return self._with(("stroke", number(size, "size"), _color(color), number(opacity, "opacity"),
                           _POSITIONS[position]))

    def pattern(self, pixels: Any, *, scale: float = 1, opacity: float = 1.0) -> Look:
        """A picture tiled over the glyphs from the top left corner of their box.

        pixels  a (height, width, 4) array of uint8, red, green, blue and alpha, straight, that is not
                premultiplied; or an image of Pillow. It is copied.
        scale   pixels that are painted for one of the pattern: 0.1 to 10; less paints nothing
        """
        width, height, data = native.pattern_pixels(rgba_of(pixels))
        return self._with(("pattern", width, height, data, number(scale, "scale"), number(opacity, "opacity")))

    def _shadow(self, kind: str, color: Color, angle: float, distance: float, size: float,
                opacity: float) -> Look:
        return self._with((kind, _color(color), number(angle, "angle"), number(distance, "distance"),
                           number(size, "size"), number(opacity, "opacity")))

    def _glow(self, kind: str, size: float, color: Color, stops: Iterable[StopLike] | None,
              opacity: float) -> Look:
        ramp: tuple[StopState, ...] = () if stops is None else _stops(stops)
        return self._with((kind, number(size, "size"), _color(color), number(opacity, "opacity"), ramp))

    def _with(self, effect: EffectState) -> Look:
        """One of its kind that is there already is replaced, at its place in the order."""
        effects = list(self._state[4])
        same = [i for i, other in enumerate(effects) if other[0] == effect[0]]
        if same:
            effects[same[0]] = effect
        else:
            effects.append(effect)
        return _look_of((*self._state[:4], tuple(effects)))

    # What is known of it.

    @property
    def margins(self) -> Margins:
        """How far the look paints beyond the glyphs, in pixels; nothing is cut off."""
        return Margins(*self._native.margins())

    @property
    def key(self) -> bytes:
        """The look as bytes, for a cache: the same in every process; looks of one key paint the same."""
        return self._native.key()

    def __eq__(self, other: object) -> bool:
        if not isinstance(other, Look):
            return NotImplemented
        return self.key == other.key

    def __hash__(self) -> int:
        return hash(self.key)

    def __copy__(self) -> Look:
        return self

    def __deepcopy__(self, memo: object) -> Look:
        return self

    def __reduce__(self) -> tuple[Any, tuple[LookState]]:
        return _look_of, (self._state,)

    def __repr__(self) -> str:
        fill, fill_opacity, filled, text_opacity, effects = self._state
        calls = [f".fill({spelled(fill)!r}{_argument(fill_opacity)})"] if filled else [".no_fill()"]
        if text_opacity != 1.0:
            calls.append(f".text_opacity({text_opacity:g})")
        return "Look()" + "".join(calls + [_call_of(effect) for effect in effects])

    # Painting.

    @overload
    def paint(self, masks: Masks) -> Picture: ...

    @overload
    def paint(self, masks: Masks, *, onto: Array, x: int = 0, y: int = 0, order: Order = "rgba") -> Box: ...

    def paint(self, masks: Masks, *, onto: Array | None = None, x: int = 0, y: int = 0,
              order: Order = "rgba") -> Picture | Box:
        """Paints the coverage of glyphs in this look; see the function ``paint``."""
        return Painter(self)._paint(masks, onto, x, y, order)

    # Style files.

    @staticmethod
    def from_json(style: str | dict[str, Any], *, size: int = 96,
                  folder: str | os.PathLike[str] | None = None, images: dict[str, Any] | None = None) -> Look:
        """The one look of a style file (docs/style-files.md), its lengths for a font of `size` pixels.

        Raises StyleError for what is no style, and for one of several looks or of one that is moved.
        """
        from ._style import Style

        looks = Style.from_json(style, folder=folder, images=images).looks(size)
        if len(looks) != 1:
            raise native.StyleError(f"a look is one look, not {len(looks)}: take Style.from_json")
        return looks[0]

    def to_json(self) -> str:
        """A style file of this look. Raises StyleError for numbers that style files have not, ValueError
        for a look with a pattern, whose pixels stand in no style file.
        """
        style = _style_of(self._state)
        text = json.dumps(style, indent=2)
        native.NativeStyle(text, "", {}, None)
        return text


def _color(value: Color) -> int:
    return color(value)


def _stops(given: Iterable[StopLike]) -> tuple[StopState, ...]:
    return stops(given)


def _set_state(look: Look, state: LookState) -> None:
    object.__setattr__(look, "_state", state)
    object.__setattr__(look, "_native", native.NativeLook(state))


def _look_of(state: LookState) -> Look:
    look = object.__new__(Look)
    _set_state(look, state)
    return look


def _argument(opacity: float) -> str:
    return "" if opacity == 1.0 else f", opacity={opacity:g}"


def _stops_repr(ramp: tuple[StopState, ...]) -> str:
    return "[" + ", ".join(f"({spelled(c)!r}, {place:g}{'' if o == 1 else f', {o:g}'})"
                           for c, place, o in ramp) + "]"


def _call_of(effect: EffectState) -> str:
    """The call that adds it."""
    kind = effect[0]
    if kind in ("outerShadow", "innerShadow"):
        name = "outer_shadow" if kind == "outerShadow" else "inner_shadow"
        _, c, angle, distance, size, opacity = effect
        return (f".{name}({spelled(c)!r}, angle={angle:g}, distance={distance:g}, size={size:g}"
                f"{_argument(opacity)})")
    if kind in ("outerGlow", "innerGlow"):
        name = "outer_glow" if kind == "outerGlow" else "inner_glow"
        _, size, c, opacity, ramp = effect
        more = f", stops={_stops_repr(ramp)}" if ramp else ""
        return f".{name}({size:g}, {spelled(c)!r}{more}{_argument(opacity)})"
    if kind == "linearGradient":
        _, angle, scale, opacity, ramp = effect
        return f".linear_gradient({_stops_repr(ramp)}, angle={angle:g}, scale={scale:g}{_argument(opacity)})"
    if kind == "radialGradient":
        _, scale, opacity, ramp = effect
        return f".radial_gradient({_stops_repr(ramp)}, scale={scale:g}{_argument(opacity)})"
    if kind == "stroke":
        _, size, c, opacity, position = effect
        where = ("centre", "outside", "inside")[position]
        return f".stroke({size:g}, {spelled(c)!r}, position={where!r}{_argument(opacity)})"
    _, width, height, _, scale, opacity = effect
    return f".pattern(<{width} x {height} pixels>, scale={scale:g}{_argument(opacity)})"


def _gradient_of(ramp: tuple[StopState, ...]) -> list[dict[str, Any]]:
    return [{"color": spelled(c), "location": place, "opacity": o} for c, place, o in ramp]


def _keys_of(effect: EffectState) -> dict[str, Any]:
    """The effect as its object in a style file."""
    kind = effect[0]
    if kind in ("outerShadow", "innerShadow"):
        _, c, angle, distance, size, opacity = effect
        return {"angle": angle, "distance": distance, "size": size, "color": spelled(c), "opacity": opacity}
    if kind in ("outerGlow", "innerGlow"):
        _, size, c, opacity, ramp = effect
        gradient = {"gradient": _gradient_of(ramp)} if ramp else {}
        return {"size": size, "color": spelled(c), "opacity": opacity, **gradient}
    if kind == "linearGradient":
        _, angle, scale, opacity, ramp = effect
        return {"angle": angle, "scale": scale, "opacity": opacity, "gradient": _gradient_of(ramp)}
    if kind == "radialGradient":
        _, scale, opacity, ramp = effect
        return {"scale": scale, "opacity": opacity, "gradient": _gradient_of(ramp)}
    if kind == "stroke":
        _, size, c, opacity, position = effect
        return {"size": size, "color": spelled(c), "opacity": opacity, "position": _POSITION_KEYS[position]}
    raise ValueError("a pattern's pixels stand in no style file; write a Style, whose pattern names one")


def _style_of(state: LookState) -> dict[str, Any]:
    fill, fill_opacity, filled, text_opacity, effects = state
    style: dict[str, Any] = {"version": 2}
    if filled:
        style["textOpacity"] = text_opacity
    else:
        style["fill"] = False
    for effect in effects:
        style[effect[0]] = _keys_of(effect)
    if filled and fill_opacity < 1.0:
        style["text"] = {"color": spelled(fill), "opacity": fill_opacity}
    elif filled:
        style["color"] = spelled(fill)
    return style


class Painter:
    """Paints in a look, or in a stack of looks, again and again.

    Every time the same picture for the same masks. It keeps its layers for the next time, as large as the
    largest so far. Threads may share one, and take turns then; with one each they paint at once.
    """

    __slots__ = ("_native",)

    def __init__(self, looks: Look | Iterable[Look]) -> None:
        """Of one look, or of several, the last on top."""
        self._native = native.NativePainter([look._native for look in _stack_of(looks)])

    @property
    def margins(self) -> Margins:
        """How far the looks paint beyond the glyphs, all of them together."""
        return Margins(*self._native.margins())

    @overload
    def paint(self, masks: Masks) -> Picture: ...

    @overload
    def paint(self, masks: Masks, *, onto: Array, x: int = 0, y: int = 0, order: Order = "rgba") -> Box: ...

    def paint(self, masks: Masks, *, onto: Array | None = None, x: int = 0, y: int = 0,
              order: Order = "rgba") -> Picture | Box:
        """Paints the coverage of glyphs; see the function ``paint``."""
        return self._paint(masks, onto, x, y, order)

    def _paint(self, masks: Masks, onto: Array | None, x: int, y: int, order: Order) -> Picture | Box:
        placements = list(masks) if isinstance(masks, (list, tuple)) else [(0, 0, masks)]
        if onto is None:
            return Picture(*self._native.paint(placements))
        if order not in ("rgba", "bgra"):
            raise ValueError(f"order: {order!r} is none of rgba, bgra")
        if not isinstance(onto, np.ndarray):
            raise TypeError(f"a picture is painted onto a numpy array, not {type(onto).__name__}")
        return Box(*self._native.paint_onto(placements, onto, x, y, order == "bgra"))


def _stack_of(looks: Look | Iterable[Look]) -> list[Look]:
    stack = [looks] if isinstance(looks, Look) else list(looks)
    for look in stack:
        if not isinstance(look, Look):
            raise TypeError(f"a stack has looks, not {type(look).__name__}")
    return stack


@overload
def paint(looks: Look | Iterable[Look], masks: Masks) -> Picture: ...


@overload
def paint(looks: Look | Iterable[Look], masks: Masks, *, onto: Array, x: int = 0, y: int = 0,
          order: Order = "rgba") -> Box: ...


def paint(looks: Look | Iterable[Look], masks: Masks, *, onto: Array | None = None, x: int = 0, y: int = 0,
          order: Order = "rgba") -> Picture | Box:
    """Paints the coverage of glyphs in a look, or in a stack of looks, the last on top.

    masks  one (height, width) array of uint8, coverage of 0 to 255 with its top left corner at the origin;
           or a list of (x, y, mask), each with its left and top from the origin of the text. Anything that
           numpy makes such an array of will do, as an image of mode L. Sides are 0 to 65535. Masks of packed
           rows, slices and read-only ones are not copied; nobody may change them meanwhile.

    Gradients, patterns and what lies inside follow the box around all masks of a call.

    Without `onto` it returns a Picture of its own. Else it lays the painting over that array, (height,
    width, 4) of uint8, premultiplied, in the order RGBA or BGRA, clipped, so that the origin of the text
    stands at column `x` and row `y`, and returns the Box that was touched.

    Other threads run while it paints. Raises TypeError and ValueError for arguments, ValueError also for a
    picture of 2^31 bytes and more, MemoryError; nothing is painted then.
    """
    return Painter(looks)._paint(masks, onto, x, y, order)
