"""Numbers in the pages that count something in the tree, or in another page, are those that are counted."""

import re

from pages import ROOT


def text_of(name):
    return (ROOT / name).read_text(encoding="utf-8")


def lines_of(name):
    return len(text_of(name).splitlines())


def files_of(pattern):
    return len(list(ROOT.glob(pattern)))


def compared_builds():
    """The builds of the table of hashes: "g++ 12 -O0 and -O3" are two."""
    rows = re.findall(r"^\| (.*) \|.*\| \d+ hashes are equal \|$", text_of("docs/determinism.md"), re.MULTILINE)
    return sum(1 + row.count(" and ") for row in rows)


def fuzzed_millions():
    """The executions of the table of fuzzing."""
    executions = re.findall(r"^\| `fuzz_\w+`.*\| ([\d,]+) \| \d+ \| \d+ \|$", text_of("docs/reliability.md"),
                            re.MULTILINE)
    return sum(int(count.replace(",", "")) for count in executions) // 1_000_000


# A page, what stands there around the number, and how it is counted.
COUNTS = [
    ("README.md", r"(\d+) ready-made\s", lambda: files_of("style/presets/*.json")),
    ("README.md", r"(\d+) hashes in \d+ builds", lambda: lines_of("tests/determinism/hashes.txt")),
    ("README.md", r"\d+ hashes in (\d+) builds", compared_builds),
    ("README.md", r"(\d+) million inputs", fuzzed_millions),
    ("docs/determinism.md", r"holds (\d+) hashes", lambda: lines_of("tests/determinism/hashes.txt")),
]


def untold_targets():
    """Fuzz targets that the page of reliability leaves out."""
    told = set(re.findall(r"^\| `(fuzz_\w+)`", text_of("docs/reliability.md"), re.MULTILINE))
    there = {path.stem for path in (ROOT / "tests" / "fuzz").glob("fuzz_*.cpp")}
    return [f"docs/reliability.md: tells of another set of fuzz targets: {name}" for name in sorted(told ^ there)]


def count_faults():
    faults = untold_targets()
    for page, pattern, counted in COUNTS:
        found = re.findall(pattern, text_of(page))
        right = counted()
        if not found:
            faults.append(f"{page}: nothing like '{pattern}'")
        faults += [f"{page}: '{pattern}' has {number}, counted are {right}" for number in found if int(number) != right]
    return faults
