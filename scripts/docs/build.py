#!/usr/bin/env python3
"""Checks the Markdown pages and builds the site: build.py LIBRARY_FOLDER SITE_FOLDER."""

import os
import shutil
import subprocess
import sys
from pathlib import Path

from compiled import code_faults
from counts import count_faults
from links import link_faults
from pages import ROOT, all_pages
from quoted import quote_faults
from site_pages import copy_pictures, site_faults, write_layout, write_pages
from style_tables import table_faults


def fail_on(faults):
    if faults:
        print("\n".join(faults), file=sys.stderr)
        sys.exit(1)


def build_site(pages, folder):
    """Doxygen's warnings, by which it fails, else the links of the site that lead nowhere."""
    pictures = write_pages(pages, folder / "pages")
    write_layout(pages, folder / "layout.xml")
    said = subprocess.run(["doxygen", "docs/Doxyfile"], cwd=ROOT, capture_output=True, text=True, check=False,
                          env={**os.environ, "SITE": str(folder)})
    if said.returncode:
        return (said.stdout + said.stderr).replace(f"{ROOT}/", "").strip().split("\n")
    copy_pictures(pictures, folder / "html")
    return site_faults(folder / "html")


def main(library, folder):
    pages = all_pages()
    fail_on(link_faults(pages))
    fail_on(quote_faults(pages))
    fail_on(table_faults())
    fail_on(count_faults())
    faults, blocks = code_faults(pages, library)
    fail_on(faults)
    shutil.rmtree(folder / "html", ignore_errors=True)
    fail_on(build_site(pages, folder))
    print(f"{len(pages)} pages, {sum(len(page.links) for page in pages)} links, {blocks} blocks of C++ and C; "
          f"site: {folder / 'html/index.html'}")


if __name__ == "__main__":
    main(Path(sys.argv[1]), Path(sys.argv[2]))
