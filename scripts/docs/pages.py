"""The Markdown pages of the repository: their headings, links and blocks of code."""

import re
import subprocess
from dataclasses import dataclass
from pathlib import Path

ROOT = Path(__file__).resolve().parents[2]

FENCE = re.compile(r"^(```+|~~~+)\s*(\S*)")
HEADING = re.compile(r"^(#{1,6})\s+(.*?)\s*#*$")
# Of a text in brackets, which may hold an image, only what follows is looked at.
LINK = re.compile(r"\]\(\s*<?([^()\s>]+)>?(?:\s+\"[^\"]*\")?\s*\)")
HTML_LINK = re.compile(r"<(?:img|a)\b[^>]*?\b(?:src|href)=\"([^\"]+)\"")
CODE_SPAN = re.compile(r"(`+)(.+?)\1")
# Above a block that is a part of a file.
FROM = re.compile(r"^From \[[^\]]*\]\(([^()\s]+)\):$")
OUTSIDE = re.compile(r"^[a-z][a-z0-9+.-]*:|^//")


@dataclass
class Block:
    """A fenced block of code; `line` is that of its first line of code. One that is quoted has a source."""

    language: str
    line: int
    text: str
    source: Path | None = None


@dataclass
class Link:
    target: str
    line: int


def slug(heading):
    """The anchor of a heading, as Markdown viewers make it."""
    text = re.sub(r"!?\[([^\]]*)\]\([^)]*\)", r"\1", heading)
    return re.sub(r"[^\w\- ]", "", text.lower()).replace(" ", "-")


def slugs(headings):
    """Their anchors; the second of one name gets -1, the third -2."""
    seen, result = {}, []
    for heading in headings:
        name = slug(heading)
        count = seen.get(name, 0)
        seen[name] = count + 1
        result.append(f"{name}-{count}" if count else name)
    return result


class Page:
    def __init__(self, path):
        self.path = path
        self.name = path.relative_to(ROOT).as_posix()
        self.lines = path.read_text(encoding="utf-8").split("\n")
        self.blocks = []
        self.prose = []  # (line number, line), without code
        self._split()
        found = [(n, HEADING.match(line)) for n, line in self.prose]
        self.headings = [(n, match[2]) for n, match in found if match]
        self.anchors = dict(zip((n for n, _ in self.headings), slugs(h for _, h in self.headings)))
        self.links = [Link(target, n) for n, line in self.prose for target in self._links(line)]

    def title(self):
        return self.headings[0][1] if self.headings else self.path.stem

    def _split(self):
        fence, block, above = None, None, ""
        for number, line in enumerate(self.lines, 1):
            mark = FENCE.match(line)
            if fence:
                if line.rstrip() == fence:
                    self.blocks.append(block)
                    fence = None
                else:
                    block.text += line + "\n"
            elif mark:
                fence, block = mark[1], Block(mark[2], number + 1, "", self._source(above))
            else:
                self.prose.append((number, line))
                above = line if line.strip() else above

    def _source(self, above):
        match = FROM.match(above)
        return target_of(self, match[1])[0] if match else None

    @staticmethod
    def _links(line):
        line = CODE_SPAN.sub("``", line)
        return LINK.findall(line) + HTML_LINK.findall(line)


def all_pages():
    """Every page that is tracked, or new and not ignored."""
    listed = subprocess.run(["git", "ls-files", "--cached", "--others", "--exclude-standard", "*.md"],
                            cwd=ROOT, check=True, capture_output=True, text=True).stdout.split("\n")
    return [Page(ROOT / name) for name in sorted(set(listed)) if name and (ROOT / name).exists()]


def is_outside(target):
    return OUTSIDE.match(target) is not None


def target_of(page, target):
    """The file or folder that a link leads to, and the anchor in it, empty for none."""
    path, _, anchor = target.partition("#")
    base = ROOT if path.startswith("/") else page.path.parent
    return (base / path.lstrip("/")).resolve() if path else page.path, anchor
