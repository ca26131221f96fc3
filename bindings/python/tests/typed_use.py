"""How a typed program uses the package: mypy reads it, nothing runs it."""

import numpy as np
import numpy.typing as npt

import voreleffect as ve

look: ve.Look = ve.Look().fill("#fff", 0.5).stroke(4, 0xFF0000, position="inside").outer_glow(
    3, (1, 2, 3), stops=[("#fff", 0), ve.Stop("#000", 1)])
mask: npt.NDArray[np.uint8] = np.zeros((3, 4), np.uint8)
picture: ve.Picture = look.paint(mask)
picture = ve.paint([look, look], [(0, 0, mask), (5, 0, mask)])
pixels: npt.NDArray[np.uint8] = picture.array
box: ve.Box = look.paint(mask, onto=pixels, x=1, order="bgra")
margins: ve.Margins = ve.Painter(look).margins
text: ve.TextPicture = ve.text_picture("Hello", look="neon", font=["DejaVu Sans"], letter_spacing="5%")
image = ve.text("Hello", size=20, look=[look], align="center")
ve.text("Hello", sise=20)  # type: ignore[call-arg]
ve.text_picture("Hello", align="middle")  # type: ignore[arg-type]
look.stroke(4)  # type: ignore[call-arg]
look.stroke(4, "#fff", position="beside")  # type: ignore[arg-type]
key: bytes = text.key
names: list[str] = ve.presets()
style: ve.Style = ve.Style.from_json({"color": "#fff"})
