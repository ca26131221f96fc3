#!/usr/bin/env python3
"""Packs libraries, headers and class files as an AAR with a Prefab package inside.

    pack_aar.py --version 1.2.3 --ndk 27 --include DIR --classes DIR
                --libraries arm64-v8a=DIR --libraries x86_64=DIR --output FILE.aar

Each directory of libraries has libvoreleffect.so and libvoreleffect_jni.so for one kind of CPU.

The same files give the same bytes: names are sorted and every time stamp is the same.
"""
import argparse
import io
import json
import struct
import sys
import zipfile
from pathlib import Path

MACHINES = {"arm64-v8a": 183, "x86_64": 62}  # of an ABI, as ELF numbers them
LIBRARY = "libvoreleffect.so"
JNI_LIBRARY = "libvoreleffect_jni.so"
MIN_API = 21
ANDROID = Path(__file__).resolve().parent.parent / "android"
LICENSE = ANDROID.parent / "LICENSE"


def read_library(path, abi):
    """Its bytes; ends the program unless it is a library for the CPU whose segments fit 16 KB pages."""
    data = path.read_bytes()
    little_64_bit = data[:6] == b"\x7fELF\x02\x01"
    if not little_64_bit or struct.unpack_from("<H", data, 18)[0] != MACHINES[abi]:
        sys.exit(f"{path}: not a library for {abi}")
    (table,) = struct.unpack_from("<Q", data, 32)
    entry_size, entries = struct.unpack_from("<HH", data, 54)
    for entry in range(table, table + entries * entry_size, entry_size):
        (kind,) = struct.unpack_from("<I", data, entry)
        (alignment,) = struct.unpack_from("<Q", data, entry + 48)
        loaded = 1
        if kind == loaded and alignment % 16384:
            sys.exit(f"{path}: a segment is aligned to {alignment}, which does not fit 16 KB pages")
    return data


def zipped(files):
    """The bytes of an archive; `files` are contents by name."""
    archive = io.BytesIO()
    with zipfile.ZipFile(archive, "w") as target:
        for name in sorted(files):
            entry = zipfile.ZipInfo(name, (1980, 1, 1, 0, 0, 0))
            entry.create_system = 3
            entry.external_attr = 0o100644 << 16
            entry.compress_type = zipfile.ZIP_STORED if name.endswith(".jar") else zipfile.ZIP_DEFLATED
            target.writestr(entry, files[name])
    return archive.getvalue()


def tree(directory):
    """Contents of all files beneath a directory, by their path in it."""
    return {f.relative_to(directory).as_posix(): f.read_bytes() for f in directory.rglob("*") if f.is_file()}


def json_bytes(value):
    return (json.dumps(value, indent=2) + "\n").encode()


def prefab(version, ndk, headers, libraries):
    """The Prefab package of schema 2. Its reader refuses any field that is not in the schema."""
    module = "modules/voreleffect"
    files = {
        "prefab.json": json_bytes(
            {"schema_version": 2, "name": "voreleffect", "version": version, "dependencies": []}
        ),
        f"{module}/module.json": json_bytes({"export_libraries": [], "android": {}}),
        **{f"{module}/include/{name}": header for name, header in headers.items()},
    }
    for abi, contents in libraries.items():
        # The C++ runtime is linked in and hidden: "none" is what Prefab asks such a library to say, and
        # would else refuse it for each user of another runtime.
        told = {"abi": abi, "api": MIN_API, "ndk": ndk, "stl": "none", "static": False}
        place = f"{module}/libs/android.{abi}"
        files[f"{place}/abi.json"] = json_bytes(told)
        files[f"{place}/{LIBRARY}"] = contents[LIBRARY]
    return files


def libraries_of(given):
    """The libraries of a directory by their names, and their ABI: of "ABI=DIR"."""
    abi, _, directory = given.partition("=")
    if abi not in MACHINES or not directory:
        raise argparse.ArgumentTypeError(f"{given}: no ABI={'|'.join(MACHINES)} and directory")
    return abi, {name: read_library(Path(directory) / name, abi) for name in (LIBRARY, JNI_LIBRARY)}


def main():
    parser = argparse.ArgumentParser(description="Packs an AAR with a Prefab package inside.")
    parser.add_argument("--version", required=True)
    parser.add_argument("--ndk", required=True, type=int, help="major version of the NDK")
    parser.add_argument("--libraries", required=True, type=libraries_of, action="append", metavar="ABI=DIR")
    for name in ("include", "classes", "output"):
        parser.add_argument(f"--{name}", required=True, type=Path)
    given = parser.parse_args()

    headers = tree(given.include)
    classes = tree(given.classes)
    if not headers or not classes:
        sys.exit(f"no files in {given.classes if headers else given.include}")
    libraries = dict(given.libraries)
    package = prefab(given.version, given.ndk, headers, libraries)
    files = {
        "AndroidManifest.xml": (ANDROID / "AndroidManifest.xml").read_bytes(),
        "LICENSE": LICENSE.read_bytes(),
        "R.txt": b"",
        "classes.jar": zipped(classes),
        "proguard.txt": (ANDROID / "proguard.txt").read_bytes(),
        **{f"jni/{abi}/{name}": data for abi, own in libraries.items() for name, data in own.items()},
        **{f"prefab/{name}": content for name, content in package.items()},
    }
    given.output.write_bytes(zipped(files))


if __name__ == "__main__":
    main()
