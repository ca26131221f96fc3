"""How programs end: what runs in threads at that moment, and what is left of a batch."""

import subprocess
import sys

import pytest

BEGIN = """
import threading, time
import numpy as np
import voreleffect as ve

def again_and_again(paint):
    while True:
        paint()
"""

MASKS = """
mask = np.full((1500, 1500), 255, np.uint8)
look = ve.Look().outer_glow(90, "#fff").stroke(90, "#f00")
threading.Thread(target=again_and_again, args=(lambda: look.paint(mask),), daemon=True).start()
page = np.zeros((1500, 1500, 4), np.uint8)
threading.Thread(target=again_and_again, args=(lambda: look.paint(mask, onto=page),), daemon=True).start()
time.sleep(0.2)
"""

TEXTS = """
paint = lambda: ve.text_picture("Hello", size=300, look="neon")
threading.Thread(target=again_and_again, args=(paint,), daemon=True).start()
time.sleep(0.3)
"""

BATCH = """
pictures = ve.batch(({"text": f"{i}", "size": 300, "look": "neon"} for i in range(10**9)), workers=2)
next(pictures)
"""


@pytest.mark.parametrize("program", [MASKS, TEXTS, BATCH])
def test_a_program_ends_quietly_while_threads_paint(program):
    ended = subprocess.run([sys.executable, "-c", BEGIN + program], capture_output=True, text=True, timeout=60)
    assert (ended.returncode, ended.stderr) == (0, "")
