#!/usr/bin/env python3
"""Compiles the Java of a page, and runs its programs; in a folder of their own, where they leave what they write.

    java_page.py PAGE CLASSES LIBRARY_PATH FOLDER

A block with a class is a source file. Any other is the inside of a method and may use the names below.
"""
import re
import shutil
import subprocess
import sys
from pathlib import Path

CLASS = re.compile(r"^public class (\w+)", re.MULTILINE)
FRAGMENT = """import java.util.Arrays;
import java.util.List;
import org.voreleffect.*;

class Fragment%d {
    static void run(Glyph letter) throws Exception {
%s
    }
}
"""


def sources(page):
    """The text of each source file by its name."""
    files = {}
    for number, block in enumerate(re.findall(r"^```java\n(.*?)^```$", page, re.MULTILINE | re.DOTALL)):
        named = CLASS.search(block)
        files[f"{named[1] if named else f'Fragment{number}'}.java"] = block if named else FRAGMENT % (number, block)
    return files


def main(page, classes, libraries, folder):
    shutil.rmtree(folder, ignore_errors=True)
    folder.mkdir(parents=True)
    files = sources(Path(page).read_text(encoding="utf-8"))
    for name, text in files.items():
        (folder / name).write_text(text, encoding="utf-8")
    subprocess.run(["javac", "--release", "8", "-Xlint:all,-options", "-Werror", "-cp", classes, "-d", ".", *files],
                   cwd=folder, check=True)
    programs = [Path(name).stem for name, text in files.items() if "void main(" in text]
    for program in programs:
        subprocess.run(["java", "-Xcheck:jni", f"-Djava.library.path={libraries}", "-Djava.awt.headless=true",
                        "-cp", f"{classes}:.", program], cwd=folder, check=True)
    print(f"{len(files)} blocks compiled, {len(programs)} run")


if __name__ == "__main__":
    main(*sys.argv[1:4], Path(sys.argv[4]))
