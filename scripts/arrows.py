#!/usr/bin/env python3
"""Checks which way the rooms of the sources depend on each other.

    scripts/arrows.py              checks the sources of the tree; prints FILE:LINE and the rule
    scripts/arrows.py ROOT         those of another tree
    scripts/arrows.py --self-test  checks the checks on trees made up for it

A room includes its own files, the rooms below it (BELOW) and the public headers that it is for
(PUBLIC). No room but simd/ asks the preprocessor for a level of the instruction set; ALLOWED_TO_ASK
lists the files that may, with the reason. Rooms that are built without files (FILELESS) include no header of
files, of fontconfig or of the console.
"""
import pathlib
import re
import sys
import tempfile

CORE = {"core"}
SIMD = CORE | {"simd"}
BLEND = SIMD | {"blend"}
OPS_ROOMS = {"ops/blur", "ops/dilate", "ops/grow", "ops/ramp", "ops/tile"}
OPS = BLEND | OPS_ROOMS | {"ops"}

# Room -> the rooms that it may include beside itself. A file belongs to the innermost room of its path.
BELOW = {
    "core": set(),
    "simd": CORE,
    "property": CORE,
    "blend": SIMD,
    "ops/blur": BLEND,
    "ops/dilate": BLEND,
    "ops/grow": BLEND,
    "ops/ramp": BLEND,
    "ops/tile": BLEND,
    # The tables of all operators' loops.
    "ops": BLEND | OPS_ROOMS,
    "cores": OPS | {"property"},
    "effect": OPS | {"property", "cores"},
    # The C face is look.h behind handles: it knows the public headers alone.
    "capi": set(),
    "unicode": set(),
    "style": {"unicode"},
    "text": {"unicode"},
    "compose": {"style", "text", "unicode"},
    # The part that opens files and asks fontconfig.
    "compose/system": {"compose", "style", "text", "unicode"},
    "tools": {"compose", "compose/system", "style", "text", "unicode"},
    "bindings": {"compose", "compose/system", "style", "text", "unicode"},
    "examples": set(),
    "include": set(),
}

PIXELS = {"VFExport.h", "VFVersion.h", "VFBitmap.h"}
RECORDS = PIXELS | {"VFProperty.h"}
CLASSES = RECORDS | {"VFBlender.h", "VFECore.h", "VFEffect.h", "VFLog.h", "voreleffect.h"}
# The classes, and the faces above them, which neither the library nor its headers know.
ALL_PUBLIC = None

# Room -> the public headers that it may include; None for all of them.
PUBLIC = {
    "core": PIXELS | {"VFLog.h"},
    "simd": set(),
    "property": RECORDS,
    "blend": PIXELS | {"VFBlender.h"},
    "ops/blur": PIXELS,
    "ops/dilate": PIXELS,
    "ops/grow": PIXELS,
    "ops/ramp": PIXELS,
    "ops/tile": PIXELS,
    "ops": PIXELS,
    "cores": RECORDS | {"VFBlender.h", "VFECore.h", "VFLog.h"},
    "effect": CLASSES,
    "capi": ALL_PUBLIC,
    "unicode": set(),
    "style": ALL_PUBLIC,
    "text": ALL_PUBLIC,
    "compose": ALL_PUBLIC,
    "compose/system": ALL_PUBLIC,
    "tools": ALL_PUBLIC,
    "bindings": ALL_PUBLIC,
    "examples": ALL_PUBLIC,
    "include": CLASSES,
}

# Rooms that are built where there are no files, no installed fonts and no console.
FILELESS = ("style", "text", "compose", "unicode")
OF_FILES = re.compile(
    r"\s*#\s*include\s*<(filesystem|fstream|iostream|fcntl\.h|unistd\.h|dirent\.h|sys/[^>]*|fontconfig/[^>]*|png\.h)>")
# The part of text/ that finds installed fonts.
WITH_FILES = ("text/font_coverage.", "text/fontconfig.", "text/system_fonts.")

# These may include anything.
FREE = ("tests", "bench", "fuzz", "android")

PUBLIC_FOLDER = "include/voreleffect"
SOURCES = (".h", ".c", ".cpp", ".inc")

LEVEL = re.compile(
    r"\b(VOREL_LEVEL\w*|VOREL_NATIVE\w*|VOREL_(?:WITHOUT_)?SCALAR|VOREL_WITHOUT_VECTORS|VOREL_VECTOR_BYTES|VOREL_DOT_PRODUCTS|"
    r"VOREL_PLANAR_PIXELS|VOREL_MASK_REGISTERS|__SSE\w*|__AVX\w*|__F16C__|__FMA__|__ARM_NEON\w*|"
    r"__ARM_FEATURE\w*|__wasm\w*|__aarch64__|__arm__|__x86_64__|__i386__|__amd64__|_M_X64|_M_ARM64)"
)
CONDITION = re.compile(r"\s*#\s*(?:if|ifdef|ifndef|elif)\b")
INCLUDE = re.compile(r'\s*#\s*include\s*(?:"([^"]+)"|<(voreleffect/[^>]+)>)')

ALLOWED_TO_ASK = {
    "core/float_state.h": "each kind of CPU has its own registers for the state of its arithmetic",
    "tests/support/float_states.cpp": "sets those registers for the tests",
    "tests/support/guarded.h": "WebAssembly has no pages that are forbidden",
    "tests/unit/simd/level_test.cpp": "tests which levels each kind of CPU has",
}


def without_comments(text):
    """The text with its comments blanked; every line keeps its number."""
    token = re.compile(r'"(?:\\.|[^"\\\n])*"|\'(?:\\.|[^\'\\\n])*\'|//[^\n]*|/\*.*?\*/', re.S)

    def blank(match):
        found = match.group(0)
        return "\n" * found.count("\n") if found.startswith("/") else found

    return token.sub(blank, text)


def logical_lines(text):
    """(number, line), lines that are continued by a backslash joined."""
    number, held = 1, ""
    for at, line in enumerate(without_comments(text).split("\n"), 1):
        if not held:
            number = at
        held += line
        if held.endswith("\\"):
            held = held[:-1] + " "
            continue
        yield number, held
        held = ""


def room_of(path):
    """The innermost room of a path from the root; its first folder where no room is known."""
    parts = path.split("/")
    for depth in (2, 1):
        room = "/".join(parts[:depth])
        if len(parts) > depth and room in BELOW:
            return room
    return parts[0]


def resolved(root, path, named):
    """The path from the root of an included file, None when there is no such file in the tree."""
    for folder in (pathlib.PurePosixPath(path).parent.as_posix(), ".", "include"):
        candidate = root / folder / named
        if candidate.is_file():
            return candidate.resolve().relative_to(root.resolve()).as_posix()
    return None


def fault_of_include(root, path, named):
    """The rule that an include breaks, None when it breaks none."""
    room = room_of(path)
    target = resolved(root, path, named)
    if target is None:
        return f'includes "{named}", which is not there'
    if target.startswith(PUBLIC_FOLDER + "/"):
        header = target[len(PUBLIC_FOLDER) + 1:]
        allowed = PUBLIC[room]
        if allowed is ALL_PUBLIC:
            return None
        if header not in allowed:
            names = ", ".join(sorted(allowed)) or "none"
            return f'includes "{named}": of the public headers {room}/ may include {names}'
        return None
    to = room_of(target)
    if to != room and to not in BELOW[room]:
        names = ", ".join(f"{below}/" for below in sorted(BELOW[room])) or "none"
        return f'includes "{named}" of {to}/: below {room}/ are {names}'
    return None


def sources(root):
    """The paths from the root of all sources in rooms; build folders are none."""
    tops = sorted({room.split("/")[0] for room in BELOW} | set(FREE))
    for top in tops:
        for file in sorted((root / top).rglob("*")):
            if file.suffix in SOURCES and file.is_file():
                yield file.relative_to(root).as_posix()


def faults(root):
    """One line for each arrow upwards and each question for a level outside of simd/."""
    found = []
    for path in sources(root):
        room = room_of(path)
        # A source of a room's subfolder that is not known would be checked by no rule of its own.
        if room == "ops" and path.count("/") > 1:
            found.append(f"{path}:1: {path.rsplit('/', 1)[0]}/ is no room that scripts/arrows.py knows")
        asks = room != "simd" and path not in ALLOWED_TO_ASK
        for number, line in logical_lines((root / path).read_text(encoding="utf-8")):
            include = INCLUDE.match(line)
            if include and room not in FREE:
                fault = fault_of_include(root, path, include.group(1) or include.group(2))
                if fault:
                    found.append(f"{path}:{number}: {fault}")
            header = OF_FILES.match(line)
            if header and room in FILELESS and not path.startswith(WITH_FILES):
                found.append(f"{path}:{number}: includes <{header.group(1)}>: {room}/ opens no file and prints nothing")
            if asks and CONDITION.match(line):
                found.extend(f"{path}:{number}: asks for {name}: levels are chosen in simd/ alone"
                             for name in sorted(set(LEVEL.findall(line))))
    return found


# Made-up sources over a sound tree, and what the check must say of them.
SOUND = {
    "include/voreleffect/VFBitmap.h": "#pragma once\n",
    "include/voreleffect/VFBlender.h": '#pragma once\n#include "VFBitmap.h"\n',
    "include/voreleffect/VFProperty.h": '#pragma once\n#include "VFBitmap.h"\n',
    "include/voreleffect/VFEffect.h": '#pragma once\n#include "VFProperty.h"\n',
    "include/voreleffect/look.h": '#pragma once\n#include "VFEffect.h"\n',
    "core/box.h": '#pragma once\n#include <cstdint>\n#include "voreleffect/VFBitmap.h"\n',
    "simd/lanes.h": '#pragma once\n#if defined(__AVX2__)\n#endif\n#include "core/box.h"\n',
    "property/limits.h": '#include "core/box.h"\n#include "voreleffect/VFProperty.h"\n',
    "blend/rules.h": '#include "simd/lanes.h"\n#include "voreleffect/VFBlender.h"\n',
    "ops/blur/plan.h": '#include "blend/rules.h"\n',
    "ops/loop_tables.cpp": '#include "ops/blur/plan.h"\n',
    "cores/glow.h": '#include "ops/blur/plan.h"\n#include "property/limits.h"\n',
    "effect/render.cpp": '#include "cores/glow.h"\n#include "voreleffect/VFEffect.h"\n',
    "capi/c.cpp": '#include "voreleffect/look.h"\n',
    "style/look.h": '#include "voreleffect/VFEffect.h"\n',
    "unicode/utf8.h": "#pragma once\n",
    "text/font.h": '#pragma once\n#include "unicode/utf8.h"\n',
    "compose/picture.h": '#include "style/look.h"\n#include "text/font.h"\n',
    "compose/system/files.h": '#include "compose/picture.h"\n',
    "bindings/python/module.cpp": '#include "compose/system/files.h"\n#include "voreleffect/look.h"\n',
    "tools/main.cpp": '#include "style/look.h"\n#include "text/font.h"\n#include "part.h"\n',
    "tools/part.h": "#pragma once\n",
    "examples/one/one.cpp": "#include <voreleffect/VFEffect.h>\n",
    "tests/unit/glow_test.cpp": '#include "cores/glow.h"\n// #if __AVX2__\n',
    "tests/support/float_states.cpp": "sets those registers for the tests",
    "tests/support/guarded.h": "WebAssembly has no pages that are forbidden",
    "tests/unit/simd/level_test.cpp": "#if defined(__x86_64__)\n#endif\n",
}
CASES = [
    ({}, []),
    ({"core/views.h": '#pragma once\n\n#include "simd/lanes.h"\n'}, ["core/views.h:3: ", "simd/"]),
    ({"simd/lanes.h": '#include "blend/rules.h"\n'}, ["simd/lanes.h:1: ", "blend/"]),
    ({"blend/copy.cpp": '#include "ops/blur/plan.h"\n'}, ["blend/copy.cpp:1: ", "ops/blur/"]),
    ({"ops/blur/plan.h": '/* one\n two */\n#include "cores/glow.h"\n'}, ["ops/blur/plan.h:3: ", "cores/"]),
    ({"ops/blur/plan.h": '#include "property/limits.h"\n'}, ["ops/blur/plan.h:1: ", "property/"]),
    ({"ops/blur/plan.h": '#include "voreleffect/VFProperty.h"\n'}, ["ops/blur/plan.h:1: ", "public"]),
    ({"ops/ramp/ramp.h": '#include "ops/blur/plan.h"\n'}, ["ops/ramp/ramp.h:1: ", "ops/blur/"]),
    ({"ops/blur/plan.h": '#include "../loop_tables.cpp"\n'}, ["ops/blur/plan.h:1: ", "ops/"]),
    ({"ops/warp/warp.h": "#pragma once\n"}, ["ops/warp/warp.h:1: ", "no room"]),
    ({"property/limits.h": '#include "blend/rules.h"\n'}, ["property/limits.h:1: ", "blend/"]),
    ({"cores/glow.h": "#include <voreleffect/VFEffect.h>\n"}, ["cores/glow.h:1: ", "public"]),
    ({"cores/glow.h": '#include "effect/render.cpp"\n'}, ["cores/glow.h:1: ", "effect/"]),
    ({"effect/render.cpp": '#include "style/look.h"\n'}, ["effect/render.cpp:1: ", "style/"]),
    ({"style/look.h": '#include "text/font.h"\n'}, ["style/look.h:1: ", "text/"]),
    ({"text/font.h": '#include "style/look.h"\n'}, ["text/font.h:1: ", "style/"]),
    ({"effect/render.cpp": "#include <voreleffect/look.h>\n"}, ["effect/render.cpp:1: ", "public"]),
    ({"capi/c.cpp": '#include "effect/render.cpp"\n'}, ["capi/c.cpp:1: ", "effect/"]),
    ({"effect/render.cpp": '#include "capi/c.cpp"\n'}, ["effect/render.cpp:1: ", "capi/"]),
    ({"include/voreleffect/VFEffect.h": '#include "look.h"\n'}, ["include/voreleffect/VFEffect.h:1: ", "public"]),
    ({"text/font.h": '#include "compose/picture.h"\n'}, ["text/font.h:1: ", "compose/"]),
    ({"compose/picture.h": '#include "compose/system/files.h"\n'}, ["compose/picture.h:1: ", "compose/system/"]),
    ({"compose/picture.h": '#include "tools/part.h"\n'}, ["compose/picture.h:1: ", "tools/"]),
    ({"bindings/python/module.cpp": '#include "tools/part.h"\n'}, ["bindings/python/module.cpp:1: ", "tools/"]),
    ({"style/look.h": "#include <filesystem>\n"}, ["style/look.h:1: ", "opens no file"]),
    ({"compose/picture.h": "#pragma once\n#include <iostream>\n"}, ["compose/picture.h:2: ", "prints nothing"]),
    ({"text/font.h": "#include <fontconfig/fontconfig.h>\n"}, ["text/font.h:1: ", "opens no file"]),
    ({"text/system_fonts.cpp": "#include <fontconfig/fontconfig.h>\n"}, []),
    ({"compose/system/files.h": "#include <filesystem>\n"}, []),
    ({"unicode/utf8.h": '#include "text/font.h"\n'}, ["unicode/utf8.h:1: ", "text/"]),
    ({"text/font.h": '#include "core/box.h"\n'}, ["text/font.h:1: ", "core/"]),
    ({"tools/part.h": '#include "core/box.h"\n'}, ["tools/part.h:1: ", "core/"]),
    ({"examples/one/one.cpp": '#include "../../core/box.h"\n'}, ["examples/one/one.cpp:1: ", "core/"]),
    ({"effect/gone.cpp": '#include "effect/gone.h"\n'}, ["effect/gone.cpp:1: ", "not there"]),
    ({"include/voreleffect/VFLog.h": '#include "core/box.h"\n'}, ["include/voreleffect/VFLog.h:1: ", "core/"]),
    ({"blend/rows.h": "\n#if VOREL_ONE || \\\n    defined(__ARM_NEON)\n#endif\n"}, ["blend/rows.h:2: ", "__ARM_NEON"]),
    ({"cores/glow.h": "#ifdef VOREL_NATIVE_TAPS\n#endif\n"}, ["cores/glow.h:1: ", "VOREL_NATIVE_TAPS"]),
    ({"tests/unit/glow_test.cpp": "#elif __x86_64__\n"}, ["tests/unit/glow_test.cpp:1: ", "__x86_64__"]),
    ({"blend/rows.h": "#if defined(__wasm_simd128__)\n#endif\n"}, ["blend/rows.h:1: ", "__wasm_simd128__"]),
    ({"tools/part.h": "# if VOREL_LEVEL == 2\n#endif\n"}, ["tools/part.h:1: ", "VOREL_LEVEL"]),
]


def self_test():
    """Whether a sound tree passes and every made-up fault is told, with its line."""
    wrong = 0
    for changed, expected in CASES:
        with tempfile.TemporaryDirectory() as folder:
            root = pathlib.Path(folder)
            for path, text in {**SOUND, **changed}.items():
                (root / path).parent.mkdir(parents=True, exist_ok=True)
                (root / path).write_text(text, encoding="utf-8")
            said = faults(root)
        right = not said if not expected else (
            len(said) == 1 and said[0].startswith(expected[0]) and expected[1] in said[0])
        if not right:
            wrong += 1
            print(f"of {changed}: said {said}, expected {expected}", file=sys.stderr)
    print(f"arrows: {len(CASES)} made-up trees, {wrong} judged wrongly")
    return wrong == 0


def main(arguments):
    if arguments == ["--self-test"]:
        return 0 if self_test() else 1
    root = pathlib.Path(arguments[0]) if arguments else pathlib.Path(__file__).resolve().parent.parent
    found = faults(root)
    for line in found:
        print(line, file=sys.stderr)
    checked = sum(1 for _ in sources(root))
    if checked == 0:
        print(f"no sources in {root}", file=sys.stderr)
    return 1 if found or checked == 0 else 0


if __name__ == "__main__":
    sys.exit(main(sys.argv[1:]))
