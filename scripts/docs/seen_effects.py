#!/usr/bin/env python3
"""No effect can be left out of a program that people copy: seen_effects.py PROGRAM [ARGUMENT...]

The program is compiled with -include seen_effects.h. It runs once with all effects, and once without each of
them: another picture is to come out every time. The picture is the files that it writes, or, if there are none,
what it prints.
"""

import os
import subprocess
import sys
import tempfile
from pathlib import Path

HEADER = Path(__file__).parent / "seen_effects.h"


def picture_of(command, **environment):
    """What the program paints, and its exit code."""
    with tempfile.TemporaryDirectory() as folder:
        run = subprocess.run(command, cwd=folder, env={**os.environ, **environment}, stdout=subprocess.PIPE,
                             timeout=60, check=False)
        files = {path.name: path.read_bytes() for path in Path(folder).iterdir()}
    return files or {"": run.stdout}, run.returncode


def unseen_effects(command):
    """The places, as file:line, of the effects that are not seen in the picture; and the number of all effects."""
    with tempfile.TemporaryDirectory() as folder:
        added = Path(folder) / "added"
        picture, code = picture_of(command, ADDED_EFFECTS=str(added))
        if code:
            return [f"{command[0]}: the program ends with {code}"], 0
        effects = dict(line.split(" ", 1) for line in added.read_text().splitlines()) if added.exists() else {}
    unseen = [place for number, place in effects.items()
              if picture_of(command, HIDDEN_EFFECT=number)[0] == picture]
    return [f"{place}: without this effect the picture is the same" for place in unseen], len(effects)


def main(command):
    faults, count = unseen_effects(command)
    if not count and not faults:
        faults = [f"{command[0]}: adds no effect"]
    print("\n".join(faults) or f"{count} effects, each of them seen", file=sys.stderr if faults else sys.stdout)
    return 1 if faults else 0


if __name__ == "__main__":
    sys.exit(main([str(Path(sys.argv[1]).resolve()), *sys.argv[2:]]))
