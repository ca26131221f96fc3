#!/usr/bin/env python3
"""Runs the blocks of `python` in the Markdown pages, with the package of whoever runs it: those of a page one after
the other, in one program and in a folder of its own."""

import os
import sys
import tempfile
import traceback

from pages import ROOT, all_pages


def block_fault(page, block, names):
    try:
        # Lines are counted as in the page.
        exec(compile("\n" * (block.line - 1) + block.text, page.name, "exec"), names)
    except Exception as error:
        lines = [frame.lineno for frame in traceback.extract_tb(error.__traceback__) if frame.filename == page.name]
        return f"{page.name}:{lines[0] if lines else block.line}: {type(error).__name__}: {error}"
    return None


def page_faults(page, blocks):
    names = {"__name__": "page"}
    with tempfile.TemporaryDirectory() as folder:
        os.chdir(folder)
        try:
            return [fault for fault in (block_fault(page, block, names) for block in blocks) if fault]
        finally:
            os.chdir(ROOT)


def main():
    faults, count = [], 0
    for page in all_pages():
        blocks = [block for block in page.blocks if block.language == "python" and not block.source]
        faults += page_faults(page, blocks) if blocks else []
        count += len(blocks)
    print("\n".join(faults) if faults else f"{count} blocks of Python run", file=sys.stderr if faults else sys.stdout)
    return 1 if faults or not count else 0


if __name__ == "__main__":
    sys.exit(main())
