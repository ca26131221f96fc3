"""Whether the installed package paints what the installed tool has: python_consumer.py PICTURE VERSION."""

import importlib.metadata
import sys

import numpy as np
import PIL.Image

import voreleffect as ve

expected = np.asarray(PIL.Image.open(sys.argv[1]).convert("RGBA"))
image = ve.text("Installed", look="gold")
assert ve.__version__ == sys.argv[2] and "/usr/lib/python3/" in ve.__file__
assert importlib.metadata.version("voreleffect") == sys.argv[2]
assert np.array_equal(np.asarray(image), expected)
assert ve.Look().stroke(3, "#fff").paint(np.full((2, 2), 255, np.uint8)).array.shape == (8, 8, 4)
