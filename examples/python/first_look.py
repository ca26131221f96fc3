# %% [markdown]
# # First look
#
# A look is a fill and effects; it is painted into masks of glyphs, or into texts in fonts. Run the cells one by
# one in a notebook, or all of them: `python3 first_look.py [FOLDER]` leaves the pictures in a folder.

# %%
import sys
from pathlib import Path

import numpy as np

import voreleffect as ve

folder = Path(sys.argv[1] if len(sys.argv) > 1 and Path(sys.argv[1]).is_dir() else ".")

# %% [markdown]
# A text in a look of one's own.

# %%
look = ve.Look().fill("#3366cc").outer_shadow("#000", size=8, distance=6, opacity=0.6).stroke(4, "#fff")
hello = ve.text("Hello", size=96, look=look, background="#dde4ee")
hello.save(folder / "first_look_hello.png")
hello

# %% [markdown]
# A preset, and what is known of the picture: a key for a cache, the baseline, the margins.

# %%
picture = ve.text_picture("Gold", size=120, look="gold")
print(picture.width, picture.height, picture.baseline, picture.margins, picture.key.hex()[:16])
picture.image().save(folder / "first_look_gold.png")

# %% [markdown]
# A mask of any origin: here a disc. The picture is an array; nothing is copied.

# %%
rows, columns = np.mgrid[:80, :80] - 39.5
disc = (np.clip(38 - np.hypot(rows, columns), 0, 1) * 255).astype(np.uint8)
badge = ve.Look().radial_gradient([("#fff4b0", 0), ("#d08000", 1)]).outer_glow(12, "#ffb000").stroke(3, "#402000")
painted = badge.paint(disc)
print(painted.array.shape, painted.left, painted.top)
painted.image().save(folder / "first_look_badge.png")

# %% [markdown]
# Onto a frame: premultiplied pixels, RGBA or BGRA, clipped.

# %%
frame = np.zeros((180, 320, 4), np.uint8)
frame[..., 2] = np.linspace(40, 160, 320).astype(np.uint8)
frame[..., 3] = 255
for i in range(5):
    badge.paint(disc[::2, ::2], onto=frame, x=20 + 60 * i, y=30 + 20 * i)
ve_image = ve.Picture(frame, 0, 0).image()
ve_image.save(folder / "first_look_frame.png")

# %% [markdown]
# Many texts on all cores, in order.

# %%
for job, result in zip("ABC", ve.batch({"text": letter, "look": "candy", "size": 64} for letter in "ABC")):
    print(job, result.array.shape)
