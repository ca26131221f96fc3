#!/usr/bin/env python3
"""Writes the first block of code in a language of a Markdown page to a file.

    code_block.py PAGE LANGUAGE FILE
"""
import re
import sys
from pathlib import Path

page, language, file = sys.argv[1:]
block = re.search(rf"^```{re.escape(language)}\n(.*?)^```$", Path(page).read_text(), re.MULTILINE | re.DOTALL)
if not block:
    sys.exit(f"{page}: no block of {language}")
Path(file).write_text(block[1])
