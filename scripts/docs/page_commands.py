#!/usr/bin/env python3
"""The commands of a page work as printed: page_commands.py VORELPAINT PAGE [--paint]

Each block of `sh` is run by bash in an empty folder, one after the other, with VORELPAINT on the path. What
it prints is the block that follows it with nothing but blank lines between; without such a block it prints
nothing. `json` and `jsonl` are compared by value, a line of output for each value, all else by the letter, but
for times and memory. A block that ends with an error of the program has its exit code 2, any other 0.

A block under a line that ends with a name in backticks and a colon, such as "`look.json`:", is that file,
there from the start. A picture of the page in docs/vorelpaint is the one of its name that the commands
painted; --paint puts it there.
"""

import json
import os
import re
import shutil
import subprocess
import sys
import tempfile
from pathlib import Path

from pages import ROOT, Page, target_of

PAINTED = ROOT / "docs" / "vorelpaint"
FILE_NAME = re.compile(r"`([\w.-]+\.\w+)`:$")
OUTPUT_LANGUAGES = ("text", "json", "jsonl", "cpp")
ERROR = re.compile(r"vorelpaint: (?!note: |line \d+: note: )")
MEASURED = re.compile(r" +[0-9.]+ ms .*")
MEMORY = re.compile(r" ms +([0-9.]+ [KMG]iB)")
UNITS = {"KiB": 1, "MiB": 1024, "GiB": 1024 * 1024}


def is_blank(line):
    return not line.strip()


def line_above(page, block):
    """The last line above the block's fence that is not blank; empty when there is none."""
    above = [line for line in page.lines[:block.line - 2] if not is_blank(line)]
    return above[-1] if above else ""


def file_name(page, block):
    """The name of the file that the block is, or None."""
    match = FILE_NAME.search(line_above(page, block))
    return match[1] if match else None


def end_line(block):
    """The number of the line of its closing fence."""
    return block.line + block.text.count("\n")


def output_block(page, block):
    """The block that shows what this one prints, or None."""
    at = page.blocks.index(block) + 1
    if at == len(page.blocks):
        return None
    other = page.blocks[at]
    between = page.lines[end_line(block):other.line - 2]
    shows = other.language in OUTPUT_LANGUAGES and all(is_blank(line) for line in between)
    return other if shows else None


def settled(text):
    """Without what differs from machine to machine: times and memory, and the headings above them."""
    return "\n".join(MEASURED.sub("", line) for line in text.split("\n") if not line.startswith("  step "))


def memory_figures(text):
    """The memory of the measured steps, in KiB."""
    return [float(number) * UNITS[unit] for number, unit in map(str.split, MEMORY.findall(text))]


def has_like_memory(printed, shown):
    """Whether no figure differs by more than a quarter: buffers end at whole vectors, which differ in length. Under
    sanitizers nothing is counted."""
    if "not counted" in printed:
        return True
    return all(abs(a - b) <= b / 4 for a, b in zip(memory_figures(printed), memory_figures(shown), strict=True))


def values(text, language):
    """The JSON values of an output or a block; a block of `json` is one, over several lines."""
    return [json.loads(text)] if language == "json" else [json.loads(line) for line in text.splitlines()]


def is_shown(printed, shown):
    if shown is None:
        return printed == ""
    if shown.language in ("json", "jsonl"):
        return values(printed, shown.language) == values(shown.text, shown.language)
    return settled(printed) == settled(shown.text) and has_like_memory(printed, shown.text)


def expected_status(shown):
    lines = shown.text.strip().split("\n") if shown else [""]
    return 2 if ERROR.match(lines[-1]) else 0


def block_faults(page, block, environment, folder):
    """Runs one block of commands; one line for what it does otherwise than the page says."""
    shown = output_block(page, block)
    run = subprocess.run(["bash", "-e", "-o", "pipefail", "-c", block.text], cwd=folder, env=environment, text=True,
                         stdin=subprocess.DEVNULL, stdout=subprocess.PIPE, stderr=subprocess.STDOUT, check=False)
    place = f"{page.name}:{block.line}"
    if run.returncode != expected_status(shown):
        return [f"{place}: ends with {run.returncode}: {run.stdout}"]
    return [] if is_shown(run.stdout, shown) else [f"{place}: prints otherwise than is shown:\n{run.stdout}"]


def painted_pictures(page):
    """The pictures of the page that its commands paint."""
    files = {target_of(page, link.target)[0] for link in page.links}
    return sorted(file for file in files if file.parent == PAINTED)


def picture_fault(page, picture, folder, paint):
    painted = folder / picture.name
    if not painted.exists():
        return f"{page.name}: no command paints {picture.name}"
    if paint:
        shutil.copyfile(painted, picture)
    elif not picture.exists() or painted.read_bytes() != picture.read_bytes():
        return f"{page.name}: {picture.name} differs from what its command paints; run scripts/tool_pictures.sh"
    return None


def page_faults(page, program, paint):
    with tempfile.TemporaryDirectory() as scratch:
        folder = Path(scratch)
        environment = {**os.environ, "LC_ALL": "C.UTF-8", "PATH": f"{program.parent}:{os.environ['PATH']}"}
        for block in page.blocks:
            name = file_name(page, block)
            if name:
                (folder / name).write_text(block.text, encoding="utf-8")
        commands = [block for block in page.blocks if block.language == "sh"]
        faults = [] if commands else [f"{page.name}: no commands"]
        for block in commands:
            faults += block_faults(page, block, environment, folder)
        faults += [picture_fault(page, picture, folder, paint) for picture in painted_pictures(page)]
    return [fault for fault in faults if fault]


def main(program, name, paint):
    faults = page_faults(Page(Path(name).resolve()), Path(program).resolve(), paint)
    for fault in faults:
        print(fault, file=sys.stderr)
    return 1 if faults else 0


if __name__ == "__main__":
    sys.exit(main(sys.argv[1], sys.argv[2], sys.argv[3:] == ["--paint"]))
