"""What the tests share: a glyph's mask, looks of every effect, and pictures of vorelpaint."""

import json
import os
import subprocess
import tempfile
from pathlib import Path

import numpy as np
import PIL.Image
import pytest
from hypothesis import configuration

import voreleffect as ve

FONTS = Path("/usr/share/fonts")
VORELPAINT = os.environ["VORELPAINT"]

# Nothing is left in the tree.
configuration.set_hypothesis_home_dir(tempfile.mkdtemp())


def tile():
    """4 x 3 pixels of a pattern, each another one."""
    pixels = np.zeros((3, 4, 4), np.uint8)
    pixels[..., 0] = np.arange(12).reshape(3, 4) * 20
    pixels[..., 1] = 200 - pixels[..., 0]
    pixels[..., 2] = 90
    pixels[..., 3] = 255 - np.arange(12).reshape(3, 4) * 10
    return pixels


STOPS = [("#f00", 0.0), ("#0f0", 0.25, 0.5), ve.Stop("#00f", 1.0)]

#: One look of each effect with numbers of its own, and two of several.
LOOKS = {
    "fill": ve.Look().fill("#3366cc"),
    "faint_fill": ve.Look().fill("#3366cc", 0.5).outer_shadow("#000"),
    "no_fill": ve.Look().no_fill().stroke(3, "#fff"),
    "text_opacity": ve.Look().fill("#3366cc").text_opacity(0.4).outer_shadow("#800"),
    "outer_shadow": ve.Look().outer_shadow("#102030", angle=60, distance=7, size=5, opacity=0.7),
    "inner_shadow": ve.Look().fill("#fff").inner_shadow("#102030", angle=200, distance=3, size=2, opacity=0.7),
    "outer_glow": ve.Look().outer_glow(6, "#ffcc00", opacity=0.8),
    "outer_glow_stops": ve.Look().outer_glow(9, "#ffcc00", stops=STOPS),
    "inner_glow": ve.Look().inner_glow(4, "#ffcc00", opacity=0.8),
    "linear_gradient": ve.Look().linear_gradient(STOPS, angle=90, scale=1.5, opacity=0.9),
    "radial_gradient": ve.Look().radial_gradient(STOPS, scale=0.7),
    "stroke": ve.Look().stroke(4, "#fff"),
    "stroke_inside": ve.Look().stroke(2, "#fff", position="inside", opacity=0.6),
    "stroke_centre": ve.Look().stroke(5, "#fff", position="centre"),
    "pattern": ve.Look().pattern(tile(), scale=2, opacity=0.8),
    "all": (ve.Look().fill("#eee", 0.9).outer_shadow("#000").outer_glow(5, "#f80").stroke(2, "#248")
            .inner_shadow("#400").inner_glow(3, "#0ff").linear_gradient(STOPS, opacity=0.5).pattern(tile())),
}


def coverage(text="Ag", size=40):
    """The coverage of a text: what black paints is its alpha."""
    return ve.text_picture(text, size=size, padding=0).array[..., 3].copy()


@pytest.fixture(scope="session")
def mask():
    return coverage()


def painted_by_tool(folder, jobs):
    """The pictures that vorelpaint paints of jobs, in one run, as arrays of straight RGBA."""
    lines = [json.dumps({**job, "output": str(folder / f"{i}.png")}) for i, job in enumerate(jobs)]
    (folder / "jobs").write_text("\n".join(lines))
    subprocess.run([VORELPAINT, "--batch", folder / "jobs"], check=True, stderr=subprocess.DEVNULL)
    return [np.asarray(PIL.Image.open(folder / f"{i}.png").convert("RGBA")) for i in range(len(jobs))]
