"""The strips of the pages of the tool: docs/style-files.md and docs/layer-styles.md."""

from strips import Cell, Strip

FILL = "#F2B134"
DARK = "#4A1E00"
LIGHT = "#FFFFFF"
BLUE = "#1F4E9E"


def stack(*looks):
    return {"version": 2, "looks": list(looks)}


def stops(*pairs):
    """Stops from (location, colour)."""
    return [{"location": location, "color": colour} for location, colour in pairs]


PLAIN = {"color": FILL}
RAMP = stops((0, "#5B2A86"), (1, "#FFB03A"))

# --- Style files -----------------------------------------------------------------------------------


def outlined(size):
    return {"version": 2, "color": "#FFFFFF", "stroke": {"size": size, "color": BLUE, "position": "outside"}}


STYLE_FILES = [
    Strip("style-lengths",
          [Cell(f"{length}, font of {size}", outlined(length), size=size)
           for length in ("5px", "5%") for size in (16, 32, 64, 96)], columns=4),
    Strip("style-thin",
          [Cell(f"{round(0.02 * size, 2)} px", outlined("2%"), size=size) for size in (15, 25, 35, 45, 50, 60, 75)],
          columns=7),
    Strip("style-span",
          [Cell(span, {"version": 2, "span": span, "linearGradient": {"angle": 0, "gradient": RAMP}},
                text="One or two\nwords")
           for span in ("block", "line", "word", "glyph")], size=56, columns=2),
    Strip("style-fill",
          [Cell(caption, {"version": 2, **fill, "outerShadow": {"angle": 135, "distance": 5, "size": 4,
                                                                "color": "#000000", "opacity": 0.6},
                          "stroke": {"size": 3, "color": BLUE, "position": "outside"}}, text="Type")
           for caption, fill in (("filled", {"color": "#FFFFFF"}), ('"fill": false', {"fill": False}))],
          size=64, ground="checks", columns=2),
]

# --- From a design tool's layer style to a look ----------------------------------------------------


def drop_shadow(angle):
    return {"outerShadow": {"angle": angle, "distance": 8, "size": 6, "color": DARK, "opacity": 0.7}}


def inner_shadow(angle):
    return {"innerShadow": {"angle": angle, "distance": 5, "size": 4, "color": DARK, "opacity": 0.9}}


def gradient_overlay(angle):
    return {"linearGradient": {"angle": angle, "gradient": RAMP}}


def shade(kind, angle, colour, opacity):
    """A look that is but a shadow of this kind, by light from this angle."""
    return {"fill": False, kind: {"angle": angle, "distance": 3, "size": 4, "color": colour, "opacity": opacity}}


INNER_LIT, INNER_DARK = shade("innerShadow", 120, LIGHT, 0.9), shade("innerShadow", 300, DARK, 0.7)
OUTER_LIT, OUTER_DARK = shade("outerShadow", 300, LIGHT, 0.9), shade("outerShadow", 120, DARK, 0.7)
# The same with the light turned around.
SUNK_LIT, SUNK_DARK = shade("outerShadow", 120, LIGHT, 0.9), shade("outerShadow", 300, DARK, 0.7)


def mirrored(ramp):
    """The stops of a reflected gradient: the first in the middle, the last at both ends."""
    return ([{**stop, "location": 0.5 - stop["location"] / 2} for stop in reversed(ramp)]
            + [{**stop, "location": 0.5 + stop["location"] / 2} for stop in ramp])


def reversed_stops(ramp):
    return [{**stop, "location": 1 - stop["location"]} for stop in reversed(ramp)]


HALF_BLACK = {"color": "#000000", "opacity": 0.5}
MOVED = {"color": "#000000", "textOpacity": 0.5, "offset": {"x": 9, "y": 9}}
BENEATH = {"outerShadow": {"angle": 135, "distance": 6, "size": 4, "color": "#000000", "opacity": 0.8},
           "stroke": {"size": 3, "color": DARK, "position": "outside"}}
BANDS = ((10, "#5B2A86"), (8, "#8A4A7A"), (6, "#B56A62"), (4, "#D98A4E"), (2, "#FFB03A"))

LAYER_STYLES = [
    Strip("layer-angles",
          [Cell(f"{name}, {angle}", {"color": FILL, **effect(angle)})
           for name, effect in (("drop shadow", drop_shadow), ("inner shadow", inner_shadow),
                                ("gradient", gradient_overlay)) for angle in (135, 90, 0, -45)],
          size=64, columns=4),
    Strip("layer-spread",
          [Cell("spread 0 %", {"color": FILL, "outerShadow": {"angle": 135, "distance": 13, "size": 12,
                                                              **HALF_BLACK}}),
           Cell("about 30 %", stack({**MOVED, "outerGlow": {"size": 12, **HALF_BLACK}}, PLAIN)),
           Cell("100 %", stack({**MOVED, "stroke": {"size": 12, "position": "outside", **HALF_BLACK}}, PLAIN))],
          columns=3),
    Strip("layer-gradients",
          [Cell("linear", gradient_overlay(90)),
           Cell("reversed", {"linearGradient": {"angle": 90, "gradient": reversed_stops(RAMP)}}),
           Cell("reflected", {"linearGradient": {"angle": 90, "gradient": mirrored(RAMP)}}),
           Cell("radial", {"radialGradient": {"gradient": RAMP}})], text="Type", size=64, columns=4),
    Strip("layer-bevels",
          [Cell("inner bevel", stack(PLAIN, INNER_DARK, INNER_LIT)),
           Cell("outer bevel", stack(OUTER_LIT, OUTER_DARK, PLAIN)),
           Cell("emboss", stack(OUTER_LIT, OUTER_DARK, PLAIN, INNER_DARK, INNER_LIT)),
           Cell("pillow emboss", stack(SUNK_LIT, SUNK_DARK, PLAIN, INNER_DARK, INNER_LIT))],
          ground="slate", columns=4),
    Strip("layer-nearest",
          [Cell("satin", stack({"color": "#C0392B"}, *(
              {"fill": False, "innerShadow": {"angle": angle, "distance": 9, "size": 8, "color": DARK,
                                              "opacity": 0.5}} for angle in (20, 200)))),
           Cell("glow from the centre", {"color": "#FFF3B0", "innerGlow": {"size": 7, "color": "#C0392B"}}),
           Cell("stroke in bands", stack(*(
               {"fill": False, "stroke": {"size": size, "color": colour, "position": "outside"}}
               for size, colour in BANDS), {"color": "#FFFFFF"}))], columns=3),
    Strip("layer-fill-opacity",
          [Cell("fill 100 %", {"color": FILL, **BENEATH}),
           Cell("fill 50 %", {"color": FILL, "textOpacity": 0.5, **BENEATH}),
           Cell("fill 0 %", {"version": 2, "fill": False, **BENEATH}),
           Cell("fill 50 %,\nnot knocked out", {"text": {"color": FILL, "opacity": 0.5}, **BENEATH})],
          ground="checks", columns=4),
]

TOOL_PAGES = STYLE_FILES + LAYER_STYLES
