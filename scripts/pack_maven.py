#!/usr/bin/env python3
"""Lays an AAR out as a Maven repository of one folder: the AAR, its POM, its sources and its Javadoc.

    pack_maven.py --version 1.2.3 --aar FILE.aar --sources DIR --javadoc DIR --output DIR

Beside each file stand its check sums. Signatures are left to whoever publishes it. The same files give the
same bytes.
"""
import argparse
import hashlib
import sys
from pathlib import Path

from pack_aar import LICENSE, tree, zipped

GROUP = "org/voreleffect"
NAME = "voreleffect"
POM = LICENSE.parent / "packaging/maven/voreleffect.pom"


def main():
    parser = argparse.ArgumentParser(description="Lays an AAR out as a Maven repository.")
    parser.add_argument("--version", required=True)
    for name in ("aar", "sources", "javadoc", "output"):
        parser.add_argument(f"--{name}", required=True, type=Path)
    given = parser.parse_args()

    files = {"aar": given.aar.read_bytes()}
    files["pom"] = POM.read_text(encoding="utf-8").replace("@VERSION@", given.version).encode()
    for kind in ("sources", "javadoc"):
        contents = tree(getattr(given, kind))
        if not contents:
            sys.exit(f"no files in {getattr(given, kind)}")
        files[f"{kind}.jar"] = zipped({"META-INF/LICENSE": LICENSE.read_bytes(), **contents})

    folder = given.output / GROUP / NAME / given.version
    folder.mkdir(parents=True, exist_ok=True)
    for kind, data in files.items():
        separator = "-" if kind.endswith("jar") else "."
        path = folder / f"{NAME}-{given.version}{separator}{kind}"
        path.write_bytes(data)
        for digest in ("md5", "sha1", "sha256", "sha512"):
            Path(f"{path}.{digest}").write_text(hashlib.new(digest, data).hexdigest())


if __name__ == "__main__":
    main()
