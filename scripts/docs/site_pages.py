"""The site: turns the Markdown pages into Doxygen's dialect, lays out its navigation, checks its links."""

import re
import shutil
import subprocess
from html import escape

from pages import CODE_SPAN, ROOT, is_outside, target_of

# The pages in the order of the navigation; a group has a title and its pages. What is not named here
# stands in the last group.
NAVIGATION = [
    ("Guide", ["docs/guide.md"]),
    ("Recipes", ["docs/recipes.md"]),
    ("Effects", ["docs/effects/README.md", "docs/effects/text-fill.md", "docs/effects/stroke.md",
                 "docs/effects/outer-shadow.md", "docs/effects/inner-shadow.md",
                 "docs/effects/outer-glow.md", "docs/effects/inner-glow.md",
                 "docs/effects/linear-gradient.md", "docs/effects/radial-gradient.md",
                 "docs/effects/pattern.md"]),
    ("Using it", ["docs/languages.md", "docs/c.md", "docs/python.md", "bindings/python/README.md",
                  "docs/javascript.md", "bindings/js/README.md", "docs/java.md", "docs/limits.md",
                  "examples/README.md", "docs/android.md", "packaging/README.md", "docs/versioning.md",
                  "docs/studio.md", "docs/looks.md", "docs/vorelpaint.md", "docs/captions.md",
                  "docs/film.md", "docs/at-scale.md", "docs/style-files.md", "docs/layer-styles.md"]),
    ("How it works", ["docs/architecture.md", "docs/pixels.md", "docs/fixed-point.md", "docs/quirks.md",
                      "docs/determinism.md", "docs/reliability.md", "docs/benchmarks.md",
                      "docs/adding-a-core.md", "docs/adding-a-level.md"]),
    ("Project", ["CHANGELOG.md", "CONTRIBUTING.md", "SECURITY.md"]),
]
START = "README.md"
MARKDOWN_LINK = re.compile(r"(!?)\[((?:[^\[\]]|!?\[[^\]]*\]\([^)]*\))*)\]\(([^()\s]+)\)")
ASIDE = re.compile("\0(\\d+)\0")
IMAGE_SOURCE = re.compile(r"(<img\b[^>]*?\bsrc=\")([^\"]+)(\")")


def identity(name):
    """The label of a page, made of its path: docs/effects/stroke.md is effects_stroke."""
    path = name.removeprefix("docs/").removesuffix(".md").removesuffix("/README")
    return re.sub(r"\W", "_", path.lower())


class SitePage:
    """One page in Doxygen's dialect, line for line, so that its warnings name the right line."""

    def __init__(self, page, by_path):
        self.page = page
        self.by_path = by_path
        self.pictures = {}  # file: its place in the site
        headings = {n for n, _ in page.headings}
        prose = {n for n, _ in page.prose}
        self.lines = []
        for number, line in enumerate(page.lines, 1):
            # The start page's own headings would stand in the navigation.
            if number in headings and (page.name != START or number == page.headings[0][0]):
                line = f"{line} {{#{self.label(page, number)}}}"
            self.lines.append(self.converted(line) if number in prose else line)

    @staticmethod
    def label(page, number):
        first = page.headings[0][0]
        if page.name == START:
            return "start"
        name = identity(page.name)
        return name if number == first else f"{name}_{page.anchors[number].replace('-', '_')}"

    def converted(self, line):
        """Links and pictures of a line, its code left alone."""
        self.code = []

        def set_aside(span):
            self.code.append(span[2].strip())
            return f"\0{len(self.code) - 1}\0"

        line = CODE_SPAN.sub(set_aside, line)
        line = IMAGE_SOURCE.sub(lambda m: m[1] + self.picture(m[2]) + m[3], line)
        line = MARKDOWN_LINK.sub(self.link, line)
        # In double backticks: Doxygen would end a span of single ones at an apostrophe. It reads entities there.
        return ASIDE.sub(lambda m: f"``{self.code[int(m[1])].replace('&', '&amp;')}``", line)

    def picture(self, target):
        """Pictures stand beside the pages of the site, in folders of their last name."""
        path, _ = target_of(self.page, target)
        self.pictures[path] = f"{path.parent.name}/{path.name}"
        return self.pictures[path]

    def link(self, match):
        bang, text, target = match.groups()
        if bang:
            return f'<img src="{self.picture(target)}" alt="{escape(text)}"/>'
        text = ASIDE.sub(lambda m: self.code[int(m[1])], MARKDOWN_LINK.sub(self.link, text))
        if is_outside(target):
            return f"[{text}]({target})"
        path, anchor = target_of(self.page, target)
        if path.suffix == ".h" and path.parent.name == "voreleffect":
            return f"[{text}](@ref {path.name})"
        other = self.by_path.get(path)
        if other is None:
            return text  # a file of the repository that the site does not have
        if "<img" in text:
            return f'<a href="{identity(other.name)}.html">{text}</a>'
        if not anchor:
            return f"[{text}](@ref {self.label(other, other.headings[0][0])})"
        number = next(n for n, name in other.anchors.items() if name == anchor)
        return f"[{text}](@ref {self.label(other, number)})"


def write_pages(pages, folder):
    """The pages as <label>.md, and a comment that makes a page of each header; returns their pictures."""
    shutil.rmtree(folder, ignore_errors=True)
    folder.mkdir(parents=True)
    by_path = {page.path: page for page in pages}
    pictures = {}
    for page in pages:
        converted = SitePage(page, by_path)
        name = "start" if page.name == START else identity(page.name)
        (folder / f"{name}.md").write_text("\n".join(converted.lines))
        pictures.update(converted.pictures)
    headers = sorted(path.name for path in (ROOT / "include/voreleffect").glob("*.h"))
    (folder / "headers.dox").write_text("".join(f"/** @file {name} */\n" for name in headers))
    return pictures


def attribute(text):
    """As Doxygen reads it between double quotes: it knows no number of an apostrophe."""
    return escape(text, quote=False).replace('"', "&quot;")


def tab(kind, title, url="", inside=""):
    where = f' url="{url}"' if url else ""
    head = f'<tab type="{kind}" visible="yes"{where} title="{attribute(title)}"'
    return f"{head}>{inside}</tab>\n" if inside else f"{head}/>\n"


def write_layout(pages, path):
    """Doxygen's own layout with this site's navigation."""
    titles = {page.name: page.title().replace("`", "") for page in pages if page.name != START}
    named = {name for _, names in NAVIGATION for name in names}
    groups = [(title, [name for name in names if name in titles]) for title, names in NAVIGATION]
    groups[-1][1].extend(sorted(set(titles) - named))
    tabs = tab("mainpage", "Start")
    for title, names in groups:
        entries = "".join(tab("user", "Overview" if titles[name] == title and len(names) > 1 else titles[name],
                              f"@ref {identity(name)}") for name in names)
        tabs += tab("usergroup", title, inside=entries) if len(names) > 1 else entries
    tabs += tab("usergroup", "Reference", inside=tab("classlist", "Classes") + tab("classmembers", "Members")
                + tab("namespacemembers", "Functions and enumerations") + tab("filelist", "Headers"))
    subprocess.run(["doxygen", "-l", path], check=True, capture_output=True)
    layout = re.sub(r"<navindex>.*?</navindex>", lambda _: f"<navindex>\n{tabs}</navindex>",
                    path.read_text(), flags=re.DOTALL)
    path.write_text(layout)


def copy_pictures(pictures, html):
    for source, place in pictures.items():
        (html / place).parent.mkdir(exist_ok=True)
        shutil.copyfile(source, html / place)


def site_faults(html):
    """One line for each link inside the site that leads nowhere."""
    texts = {path.name: path.read_text(errors="replace") for path in html.glob("*.html")}
    anchors = {name: set(re.findall(r"\b(?:id|name)=\"([^\"]+)\"", text)) for name, text in texts.items()}
    faults = []
    for name, text in texts.items():
        for target in sorted(set(re.findall(r"\b(?:href|src)=\"([^\"]+)\"", text))):
            file, _, anchor = target.partition("#")
            if is_outside(target):
                continue
            if file and not (html / file).exists():
                faults.append(f"site: {name}: no such file: {target}")
            elif anchor and anchor not in anchors.get(file or name, {anchor}):
                faults.append(f"site: {name}: no such place: {target}")
    return faults
