"""A letter in a look, painted on a grey page: title.py FILE writes the page's pixels, R, G, B, A."""

import sys

import numpy as np
import voreleffect as ve

y, x = np.mgrid[:72, :60]
letter = np.where((x < 18) | (x >= 42) | ((y >= 27) & (y < 45)), 255, 0).astype(np.uint8)  # an H

look = (ve.Look()
        .fill("#E8412C")
        .outer_shadow("#1B2A41", angle=135, distance=6, size=8, opacity=0.6)
        .stroke(4, "#FFFFFF")
        .linear_gradient([("#FFD75E", 0), ("#FFD75E", 1, 0)], angle=270))

page = np.full((110, 100, 4), (200, 200, 200, 255), np.uint8)
look.paint(letter, onto=page, x=20, y=18)
page.tofile(sys.argv[1])
