#!/usr/bin/python3
"""Paints the strips of pictures of the documents: paint.py VORELPAINT FOLDER."""

import copy
import json
import sys
from pathlib import Path

from PIL import Image

from strips import Cell, Strip, paint_strips
from tool_pages import TOOL_PAGES

PRESETS = Path(__file__).resolve().parents[2] / "style" / "presets"

ANGLES = (0, 45, 90, 135, 180, 225, 270, 315)
OPACITIES = (0.1, 0.25, 0.5, 0.75, 1)


def with_value(style, key, value):
    """A copy of the style with `value` at a key such as "stroke.size"."""
    changed = copy.deepcopy(style)
    at = changed
    *path, last = key.split(".")
    for part in path:
        at = at.setdefault(part, {})
    at[last] = value
    return changed


def sweep(name, style, key, values, **how):
    """One cell for each value of one number; the last part of the key is its caption."""
    word = how.pop("word", key.split(".")[-1])
    return Strip(name, [Cell(f"{word} {value}", with_value(style, key, value)) for value in values], **how)


def stops(*triples):
    """Stops from (location, colour) or (location, colour, opacity)."""
    return [{"location": t[0], "color": t[1], "opacity": t[2] if len(t) > 2 else 1} for t in triples]


def tile():
    """A 12 x 12 tile whose corner and sides can be told apart: a red corner, blue on the left."""
    image = Image.new("RGBA", (12, 12), "#F2C14E")
    image.paste("#2B6CB0", (0, 0, 3, 12))
    image.paste("#C8321E", (0, 0, 6, 6))
    return image


def dots():
    """A white disc on nothing."""
    image = Image.new("RGBA", (12, 12), (255, 255, 255, 0))
    for y in range(12):
        for x in range(12):
            if (x - 5.5) ** 2 + (y - 5.5) ** 2 < 16:
                image.putpixel((x, y), (255, 255, 255, 255))
    return image


PATTERNS = {"tile.png": tile(), "dots.png": dots()}

# --- One look for each effect ----------------------------------------------------------------------

SUNSET = stops((0, "#5B2A86"), (0.55, "#E8412C"), (1, "#FFD75E"))
DUSK = stops((0, "#5B2A86"), (1, "#FFB03A"))

STROKE = {"color": "#F2C14E", "stroke": {"size": 6, "color": "#2B3A67", "position": "outside"}}
OUTER_SHADOW = {"color": "#3366CC",
                "outerShadow": {"angle": 135, "distance": 8, "size": 6, "color": "#000000", "opacity": 0.6}}
INNER_SHADOW = {"color": "#F2C14E",
                "innerShadow": {"angle": 135, "distance": 4, "size": 6, "color": "#4A1E00", "opacity": 0.9}}
OUTER_GLOW = {"color": "#FFFFFF", "outerGlow": {"size": 16, "color": "#35C4FF"}}
INNER_GLOW = {"color": "#8A1538", "innerGlow": {"size": 6, "color": "#FFE08A"}}
LINEAR = {"linearGradient": {"angle": 90, "gradient": SUNSET}}
RADIAL = {"radialGradient": {"gradient": stops((0, "#FFE99A"), (0.5, "#F08A24"), (1, "#7A1F5C"))}}
PATTERN = {"pattern": {"image": "tile.png", "scale": 1}}


SIGN_MARGIN = 14


def sign(name, style, ground="paper"):
    """The picture that stands for an effect in a table."""
    return Strip(f"effect-{name}", [Cell("", style)], text="Type", size=64, ground=ground,
                 least=SIGN_MARGIN, most=SIGN_MARGIN)


SIGNS = [
    sign("text-fill", {"color": "#3366CC"}),
    sign("stroke", STROKE),
    sign("outer-shadow", OUTER_SHADOW),
    sign("inner-shadow", INNER_SHADOW),
    sign("outer-glow", OUTER_GLOW, "night"),
    sign("inner-glow", with_value(INNER_GLOW, "innerGlow.size", 4)),
    sign("linear-gradient", LINEAR),
    sign("radial-gradient", RADIAL),
    sign("pattern", PATTERN),
]

# --- The guide -------------------------------------------------------------------------------------

FIRST = {"color": "#3366CC", "outerShadow": {"angle": 135, "distance": 6, "size": 8, "color": "#000000",
                                            "opacity": 0.6},
         "stroke": {"size": 4, "color": "#FFFFFF", "position": "outside"}}
SHADE = {"angle": 135, "distance": 5, "size": 6, "color": "#000000", "opacity": 0.8}
RAMP = {"angle": 90, "gradient": DUSK}
ROOMY = {"color": "#F2C14E", "stroke": STROKE["stroke"],
         "outerShadow": {"angle": 135, "distance": 16, "size": 8, "color": "#000000", "opacity": 0.6}}
FADED = {"color": "#3366CC", "stroke": {"size": 3, "color": "#2B3A67", "position": "outside"}}
FAR_SHADOW = {"angle": 135, "distance": 14, "size": 0, "color": "#C8321E"}
WIDE_STROKE = {"size": 8, "color": "#2B3A67", "position": "outside"}


def first_steps():
    shadow, stroke = {"outerShadow": FIRST["outerShadow"]}, {"stroke": FIRST["stroke"]}
    fill = {"color": FIRST["color"]}
    return [Cell("the fill", fill), Cell("a stroke outside", {**fill, **stroke}),
            Cell("a shadow", {**fill, **shadow, **stroke}),
            Cell("a gradient", {**fill, **shadow, **stroke, "linearGradient": RAMP})]


GUIDE = [
    Strip("guide-steps", first_steps(), text="Type", size=64, columns=4),
    Strip("guide-margins",
          [Cell("with the margins", ROOMY), Cell("without", ROOMY, cut=True)],
          text="Type", columns=2, boxes=True),
    sweep("guide-opacity", with_value(FIRST, "stroke.color", "#2B3A67"), "textOpacity", (1, 0.75, 0.5, 0.25, 0), ground="checks", word="opacity"),
    Strip("guide-two-opacities",
          [Cell("setTextOpacity(0.5)", with_value(OUTER_SHADOW, "textOpacity", 0.5)),
           Cell("addText(colour, 0.5)",
                {"text": {"color": "#3366CC", "opacity": 0.5}, "outerShadow": OUTER_SHADOW["outerShadow"]})],
          text="Type", ground="checks", columns=2),
    Strip("guide-opacity-inside",
          [Cell("fill 0.5", with_value(FADED, "textOpacity", 0.5)),
           Cell("fill 0.5\ngradient 1", {**with_value(FADED, "textOpacity", 0.5), "linearGradient": RAMP}),
           Cell("fill 0.5\ngradient 0.5", with_value({**with_value(FADED, "textOpacity", 0.5),
                                                     "linearGradient": RAMP}, "linearGradient.opacity", 0.5)),
           Cell("fill 0\ngradient 0.5", with_value({**with_value(FADED, "textOpacity", 0),
                                                   "linearGradient": RAMP}, "linearGradient.opacity", 0.5))],
          ground="checks", columns=4),
    Strip("guide-order-inside",
          [Cell("gradient first, then inner shadow", {"linearGradient": RAMP, "innerShadow": SHADE}),
           Cell("inner shadow first, then gradient", {"innerShadow": SHADE, "linearGradient": RAMP})],
          text="Type", columns=2),
    Strip("guide-order-beneath",
          [Cell("shadow first, then stroke", {"color": "#F2C14E", "outerShadow": FAR_SHADOW,
                                              "stroke": WIDE_STROKE}),
           Cell("stroke first, then shadow", {"color": "#F2C14E", "stroke": WIDE_STROKE,
                                              "outerShadow": FAR_SHADOW})],
          text="Type", columns=2),
]

# --- The effect pages ------------------------------------------------------------------------------

TEXT_FILL = [
    sweep("text-fill-text-opacity", {"color": "#3366CC"}, "textOpacity", (0, 0.25, 0.5, 0.75, 1),
          ground="checks", word="opacity"),
    Strip("text-fill-beneath",
          [Cell("the fill alone", {"color": "#C8321E"}),
           Cell("under a pattern\nwith holes", {"color": "#C8321E", "pattern": {"image": "dots.png"}}),
           Cell("under a gradient\nof opacity 0.5",
                {"color": "#C8321E", "linearGradient": {"angle": 0, "opacity": 0.5, "gradient": stops(
                    (0, "#FFFFFF"), (1, "#000000"))}}),
           Cell("under an opaque\ngradient", {"color": "#C8321E", "linearGradient": RAMP})], columns=4),
]

STROKES = [
    Strip("stroke-position",
          [Cell(position, with_value(with_value(STROKE, "stroke.size", 4), "stroke.position", position))
           for position in ("center", "outside", "inside")], text="Type", columns=3),
    sweep("stroke-size-outside", STROKE, "stroke.size", (0, 1, 2, 4, 8, 12, 16, 32), columns=4),
    sweep("stroke-size-inside", with_value(STROKE, "stroke.position", "inside"), "stroke.size",
          (0, 1, 2, 4, 6, 8)),
    sweep("stroke-size-center", with_value(STROKE, "stroke.position", "center"), "stroke.size",
          (0, 1, 2, 4, 8, 12, 16, 32), columns=4),
    Strip("stroke-opacity",
          [Cell(f"{position}, {opacity}", with_value(with_value(STROKE, "stroke.position", position),
                                                     "stroke.opacity", opacity))
           for position in ("center", "outside", "inside") for opacity in (0.25, 0.5, 1)],
          ground="checks", columns=3),
    Strip("stroke-joined",
          [Cell("joined letters", with_value(STROKE, "stroke.opacity", 0.5), text="\u0633\u0644\u0627\u0645"),
           Cell("overlapping glyphs", with_value(STROKE, "stroke.opacity", 0.5), text="A\u0338O\u0338")],
          ground="checks", columns=2),
]

OUTER_SHADOWS = [
    sweep("outer-shadow-angle", with_value(OUTER_SHADOW, "outerShadow.distance", 12), "outerShadow.angle",
          ANGLES, columns=4),
    sweep("outer-shadow-distance", with_value(OUTER_SHADOW, "outerShadow.size", 2), "outerShadow.distance",
          (0, 4, 8, 16, 32, 64), columns=3),
    sweep("outer-shadow-size", OUTER_SHADOW, "outerShadow.size", (0, 2, 4, 8, 16, 32), columns=3),
    sweep("outer-shadow-opacity", OUTER_SHADOW, "outerShadow.opacity", OPACITIES, columns=5),
    Strip("outer-shadow-text-opacity",
          [Cell("text 1", OUTER_SHADOW), Cell("text 0.5", with_value(OUTER_SHADOW, "textOpacity", 0.5)),
           Cell("text 0", with_value(OUTER_SHADOW, "textOpacity", 0))], ground="checks"),
]

INNER_SHADOWS = [
    sweep("inner-shadow-angle", with_value(INNER_SHADOW, "innerShadow.distance", 6), "innerShadow.angle",
          ANGLES, columns=4),
    sweep("inner-shadow-distance", with_value(INNER_SHADOW, "innerShadow.angle", 90), "innerShadow.distance",
          (0, 2, 4, 8, 16, 100)),
    sweep("inner-shadow-size", INNER_SHADOW, "innerShadow.size", (0, 2, 4, 8, 16, 32)),
    sweep("inner-shadow-opacity", INNER_SHADOW, "innerShadow.opacity", OPACITIES, columns=5),
]

RING = stops((0, "#35C4FF"), (0.3, "#35C4FF", 0), (0.5, "#FF4FA3"), (1, "#FF4FA3"))


def with_stops(effect, key, *choices):
    """One cell for each (caption, stops)."""
    return [Cell(caption, with_value(effect, f"{key}.gradient", chosen)) for caption, chosen in choices]


def edge_strip(name, effect, key, middle, colour, widths, **how):
    """The corner of a letter whose glow changes its colour at `middle`, over ramps of these widths."""
    def cell(width):
        start, end = round(middle - width / 2, 2), round(middle + width / 2, 2)
        chosen = stops((0, colour), (start, colour), (end, "#E8412C"), (1, "#E8412C"))
        caption = f"{start} and {end}" if width else f"a hard edge at {middle}"
        return Cell(caption, with_value(effect, f"{key}.gradient", chosen), window=(4, 4, 60, 48))

    return Strip(name, [cell(width) for width in widths], columns=3, enlarged=4, **how)


OUTER_GLOWS = [
    sweep("outer-glow-size", OUTER_GLOW, "outerGlow.size", (0, 4, 8, 16, 32, 64), columns=3, ground="night"),
    sweep("outer-glow-opacity", OUTER_GLOW, "outerGlow.opacity", OPACITIES, columns=5, ground="night"),
    Strip("outer-glow-stops",
          with_stops(with_value(OUTER_GLOW, "outerGlow.size", 24), "outerGlow",
                     ("one stop", stops((0, "#35C4FF"))),
                     ("two stops", stops((0, "#FFF36B"), (1, "#E8412C"))),
                     ("three stops", stops((0, "#FFFFFF"), (0.4, "#8B5CF6"), (1, "#22D3EE"))),
                     ("a hard edge at 0.5", stops((0, "#FFF36B"), (0.5, "#FFF36B"), (0.5, "#E8412C"),
                                                  (1, "#E8412C"))),
                     ("stops at 0.5 and 1", stops((0.5, "#FFF36B"), (1, "#E8412C"))),
                     ("a clear stop at 0.3", RING)),
          ground="night", columns=3),
    edge_strip("outer-glow-edge", with_value(OUTER_GLOW, "outerGlow.size", 24), "outerGlow", 0.5, "#FFF36B",
               (0, 0.04, 0.12), ground="night"),
]

INNER_GLOWS = [
    sweep("inner-glow-size", INNER_GLOW, "innerGlow.size", (0, 1, 2, 4, 6, 8, 12, 16), columns=4, most=0),
    sweep("inner-glow-opacity", INNER_GLOW, "innerGlow.opacity", OPACITIES, columns=5, most=0),
    Strip("inner-glow-stops",
          with_stops(with_value(INNER_GLOW, "innerGlow.size", 8), "innerGlow",
                     ("one stop", stops((0, "#FFE08A"))),
                     ("two stops", stops((0, "#FFFFFF"), (1, "#F08A24"))),
                     ("three stops", stops((0, "#22D3EE"), (0.4, "#FFFFFF"), (1, "#F08A24"))),
                     ("a hard edge at 0.3", stops((0, "#FFE08A"), (0.3, "#FFE08A"), (0.3, "#E8412C"),
                                                  (1, "#E8412C")))),
          columns=4, most=0),
    edge_strip("inner-glow-edge", with_value(INNER_GLOW, "innerGlow.size", 12), "innerGlow", 0.3, "#FFE08A",
               (0, 0.08, 0.24)),
]

FILL_STOPS = (
    ("one stop", stops((0, "#E8412C"))),
    ("two stops", DUSK),
    ("three stops", SUNSET),
    ("a hard edge at 0.5", stops((0, "#5B2A86"), (0.5, "#5B2A86"), (0.5, "#FFB03A"), (1, "#FFB03A"))),
    ("stops at 0.4 and 0.6", stops((0.4, "#5B2A86"), (0.6, "#FFB03A"))),
    ("a clear last stop", stops((0, "#5B2A86"), (1, "#5B2A86", 0))),
)
SCALES = (0.1, 0.25, 0.5, 1, 1.5, 2)

# Around the circle of hues, whose steps are large: alone, and as a look whose steps lie between them.
HUES = stops((0, "#FF0000"), (0.17, "#FFFF00"), (0.33, "#00FF00"), (0.5, "#00FFFF"), (0.67, "#0000FF"),
             (0.83, "#FF00FF"), (1, "#FF0000"))
WHEEL_ALONE = {"linearGradient": {"angle": 0, "gradient": HUES}}
WHEEL_BETWEEN = {"fill": False, "linearGradient": {"angle": 0, "scale": 0.98, "opacity": 0.5,
                                                   "gradient": HUES}}
WHEEL = {"version": 2, **WHEEL_ALONE}

LINEAR_GRADIENTS = [
    sweep("linear-gradient-angle", {"linearGradient": {"gradient": DUSK}}, "linearGradient.angle", ANGLES,
          columns=4),
    sweep("linear-gradient-scale", {"linearGradient": {"angle": 0, "gradient": DUSK}},
          "linearGradient.scale", SCALES, text="Type", columns=3),
    Strip("linear-gradient-stops",
          with_stops({"color": "#9BC1BC", "linearGradient": {"angle": 0}}, "linearGradient", *FILL_STOPS),
          columns=3),
    sweep("linear-gradient-opacity", {"color": "#9BC1BC", "linearGradient": {"angle": 0, "gradient": DUSK}},
          "linearGradient.opacity", OPACITIES, columns=5),
    sweep("linear-gradient-wide", {"linearGradient": {"gradient": DUSK}}, "linearGradient.angle",
          (0, 45, 90), text="Summer Sale", size=56, columns=1),
    Strip("linear-gradient-steps",
          [Cell(caption, style, window=(1345, 66, 110, 70)) for caption, style in (
              ("one ramp across 2300 pixels", WHEEL), ("a ramp for each word", {**WHEEL, "span": "word"}),
              ("two ramps in a stack", {"version": 2, "looks": [WHEEL_ALONE, WHEEL_BETWEEN]}))],
          text="Summer Sale", size=320, columns=3, enlarged=3),
]

RADIAL_STOPS = stops((0, "#FFE99A"), (1, "#7A1F5C"))

RADIAL_GRADIENTS = [
    sweep("radial-gradient-scale", {"radialGradient": {"gradient": RADIAL_STOPS}}, "radialGradient.scale",
          SCALES),
    Strip("radial-gradient-stops",
          with_stops({"color": "#9BC1BC", "radialGradient": {}}, "radialGradient", *FILL_STOPS), columns=3),
    sweep("radial-gradient-opacity", {"color": "#9BC1BC", "radialGradient": {"gradient": RADIAL_STOPS}},
          "radialGradient.opacity", OPACITIES, columns=5),
    Strip("radial-gradient-box",
          [Cell("wide", {"radialGradient": {"gradient": RADIAL_STOPS}}, text="Summer Sale"),
           Cell("tall", {"radialGradient": {"gradient": RADIAL_STOPS}}, text="M\nM\nM")],
          size=40, columns=2),
]

PATTERNS_SWEPT = [
    sweep("pattern-scale", PATTERN, "pattern.scale", (0.5, 1, 1.5, 2, 4, 10)),
    sweep("pattern-opacity", with_value(PATTERN, "color", "#9BC1BC"), "pattern.opacity", OPACITIES,
          columns=5),
    Strip("pattern-start", [Cell("", with_value(PATTERN, "pattern.scale", 2), text=text)
                            for text in ("Type", "line", "A")], boxes=True, columns=3),
    Strip("pattern-alpha",
          [Cell(f"fill {fill}", {"color": fill, "pattern": {"image": "dots.png"}})
           for fill in ("#3366CC", "#C8321E", "#33373D")], columns=3),
]

# --- The README ------------------------------------------------------------------------------------


def preset(name, text):
    """A preset with its pictures found from anywhere."""
    style = json.loads((PRESETS / f"{name}.json").read_text())
    for look in style.get("looks", [style]):
        if "pattern" in look:
            look["pattern"]["image"] = str(PRESETS / look["pattern"]["image"])
    return Cell("", style, text=text)


README = [
    Strip("looks", [preset("gold", "Gold"), preset("neon-sign", "Open"), preset("comic-double", "Pow!"),
                    preset("varsity", "Class"), preset("chrome", "Turbo"), preset("retro-3d", "Disco"),
                    preset("candy", "Sweet"), preset("ice", "Frost"), preset("graffiti", "Street"),
                    preset("lower-third", "Live"), preset("sticker", "Cut"), preset("lava", "Lava")],
          size=88, ground="night", columns=3, most=18),
]

STRIPS = (SIGNS + README + GUIDE + TEXT_FILL + STROKES + OUTER_SHADOWS + INNER_SHADOWS + OUTER_GLOWS
          + INNER_GLOWS + LINEAR_GRADIENTS + RADIAL_GRADIENTS + PATTERNS_SWEPT + TOOL_PAGES)


def main(program, folder):
    paint_strips(program, STRIPS, PATTERNS, folder)


if __name__ == "__main__":
    main(sys.argv[1], sys.argv[2])
