"""What the pages quote of programs stands in them, letter for letter.

A block below a line `From [qimage.cpp](../examples/recipes/qimage.cpp):` is a part of that file, which is compiled
and run elsewhere. In a row of a table whose first cell links to a program of examples/languages all code is of it.
"""

import re

from pages import CODE_SPAN, ROOT, target_of

ROW = re.compile(r"^\| *\[[^\]]*\]\(([^()\s]+)\) *\|")
PROGRAMS = ROOT / "examples/languages"


def block_faults(page):
    for block in page.blocks:
        if block.source and block.text not in block.source.read_text(encoding="utf-8"):
            yield f"{page.name}:{block.line}: not what stands in {block.source.name}"


def row_faults(page):
    for number, line in page.prose:
        match = ROW.match(line)
        source = target_of(page, match[1])[0] if match else None
        if source is None or PROGRAMS not in source.parents:
            continue
        text = source.read_text(encoding="utf-8")
        for span in CODE_SPAN.finditer(line):
            if span[2] not in text:
                yield f"{page.name}:{number}: not in {source.name}: {span[2]}"


def quote_faults(pages):
    """One line for each block, or code of a row, that is not what stands in its file."""
    return [fault for page in pages for find in (block_faults, row_faults) for fault in find(page)]
