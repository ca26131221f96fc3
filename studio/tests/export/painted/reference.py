"""Paints every case of FOLDER/cases.json, and runs what was exported for Python: reference.py FOLDER

Of each case it writes NAME.rgba, premultiplied, and NAME.straight.rgba; of the exported program and the
exported command, which run in FOLDER/NAME, NAME.python.rgba and NAME.command.rgba, straight; of all cases
pages.txt: NAME WIDTH HEIGHT X Y.
"""

import base64
import json
import os
import subprocess
import sys
from pathlib import Path

import numpy as np
import PIL.Image
import voreleffect as ve


def image_of(pattern):
    data = np.frombuffer(base64.b64decode(pattern["data"]), np.uint8)
    return data.reshape(pattern["height"], pattern["width"], 4)


def painted(case, **options):
    images = {name: image_of(pattern) for name, pattern in case["patterns"].items()}
    style = ve.Style.from_json(case["style"], images=images)
    opacity = None if case["opacity"] == 1 else case["opacity"]
    return ve.text_picture(case["text"], font=case["font"], size=case["size"], look=style, align=case["align"],
                           line_height=case["lineHeight"], letter_spacing=case["letterSpacing"], opacity=opacity,
                           padding=case["padding"], markup=case["markup"], **options)


def keep(picture, name):
    np.asarray(PIL.Image.open(picture).convert("RGBA")).tofile(name)


def main(folder):
    pages = []
    for name, case in json.loads((folder / "cases.json").read_text()).items():
        picture = painted(case, premultiplied=True)
        pages.append(f"{name} {picture.width} {picture.height} {picture.x} {picture.y}\n")
        picture.array.tofile(folder / f"{name}.rgba")
        background = case["background"] if case["background"].startswith("#") else None
        painted(case, background=background).array.tofile(folder / f"{name}.straight.rgba")
        os.chdir(folder / name)
        exec(compile(Path("title.py").read_bytes(), f"{name}/title.py", "exec"), {})
        keep("title.png", folder / f"{name}.python.rgba")
        subprocess.run(["sh", "title.sh"], check=True)
        keep("title.png", folder / f"{name}.command.rgba")
    (folder / "pages.txt").write_text("".join(pages))


main(Path(sys.argv[1]).resolve())
