#!/usr/bin/env python3
"""Plants mistakes in copies of the tree and runs the tests that should catch them: scripts/mutants.sh.

A mistake is a paragraph of tests/mutants/*.txt:

    [blend.last_pixel_left_out]     its name: the room, then what is wrong
    file: blend/rows.h
    line: const Place last = {row, count - kPixels};
    with: const Place last = {row, count - kPixels - 1};
    tests: MaskBlend*:ColourBlend*  filter of the tests that belong to the file

The text of `line` stands exactly once in the file; `with` takes its place, and may be empty. Further
keys: `program`, of the tests where it is not the room's; `needs`, the level (avx2, avx512), or
arm64, that the machine must have; and `equal`, the reason why no test can see it.
"""
import argparse
import collections
import os
import pathlib
import queue
import re
import shutil
import subprocess
import sys
import threading
import time

ROOT = pathlib.Path(__file__).resolve().parent.parent
LISTS = ROOT / "tests/mutants"
BUILDS = ROOT / "build/mutants"
ROOMS = ["core", "simd", "property", "blend", "ops", "cores", "effect", "style"]
UNIT = "voreleffect_tests"
# The unit tests of rooms that are not the library's; their sources are linked into them.
OWN_UNITS = {"style": "vorelstyle_tests"}
LIBRARY = "voreleffect_tested"
CPU_FLAGS = {"avx2": "avx2", "avx512": "avx512_vnni"}
# Longer than any test takes on a loaded machine: a mistake that never ends is caught.
SECONDS = {"x86": 600, "arm64": 3600}
KEYS = {"file", "line", "with", "tests", "program", "needs", "equal"}


class Mutant:
    def __init__(self, name, place):
        self.name = name
        self.place = place
        self.keys = {}

    def __getattr__(self, key):
        return self.keys.get(key, "")

    @property
    def room(self):
        return self.name.split(".")[0]

    @property
    def unit(self):
        return OWN_UNITS.get(self.room, UNIT)

    def source(self, root):
        return root / self.file

    def mutated(self, text):
        return text.replace(self.keys["line"], self.keys["with"])


def read_list(path):
    mutants = []
    for number, row in enumerate(path.read_text().splitlines(), 1):
        place = f"{path.relative_to(ROOT)}:{number}"
        if not row.strip() or row.startswith("#"):
            continue
        name = re.fullmatch(r"\[(.+)\]", row)
        key, colon, value = row.partition(":")
        if name:
            mutants.append(Mutant(name[1], place))
        elif colon and key in KEYS and mutants and key not in mutants[-1].keys:
            mutants[-1].keys[key] = value.strip()
        else:
            sys.exit(f"{place}: not understood: {row}")
    return mutants


def read_mutants():
    """All of them, checked against the tree."""
    mutants = [m for path in sorted(LISTS.glob("*.txt")) for m in read_list(path)]
    faults = []
    for m in mutants:
        missing = {"file", "line", "with", "tests"} - m.keys.keys()
        if missing:
            faults.append(f"{m.place}: [{m.name}] has no {', '.join(sorted(missing))}")
        elif m.room not in ROOMS or not m.file.startswith(m.room + "/"):
            faults.append(f"{m.place}: [{m.name}] is not of the room of {m.file}")
        elif not m.source(ROOT).is_file():
            faults.append(f"{m.place}: [{m.name}]: there is no {m.file}")
        else:
            found = m.source(ROOT).read_text().count(m.line)
            if found != 1:
                faults.append(f"{m.place}: [{m.name}]: its line stands {found} times in {m.file}")
            elif m.line == m.keys["with"]:
                faults.append(f"{m.place}: [{m.name}] changes nothing")
    names = collections.Counter(m.name for m in mutants)
    faults += [f"[{name}] stands {count} times" for name, count in names.items() if count > 1]
    if faults:
        sys.exit("\n".join(faults))
    return mutants


def lacks(mutant, arm64):
    """What keeps a mutant from being run here, or nothing."""
    if arm64 != (mutant.needs == "arm64"):
        return "arm64" if not arm64 else "x86-64"
    flag = CPU_FLAGS.get(mutant.needs)
    if flag and flag not in pathlib.Path("/proc/cpuinfo").read_text().split():
        return mutant.needs
    return ""


class Tree:
    """A copy of the sources with a build of its own."""

    def __init__(self, number, arm64, units):
        self.home = BUILDS / (f"arm64-{number}" if arm64 else str(number))
        self.units = units
        self.source = self.home / "source"
        self.build = self.home / "build"
        self.arm64 = arm64

    def copy(self):
        names = subprocess.run(["git", "ls-files", "-z", "--cached", "--others", "--exclude-standard"],
                               cwd=ROOT, capture_output=True, check=True, text=True).stdout.split("\0")
        wanted = {name for name in names if name and (ROOT / name).is_file()}
        for path in [p for p in self.source.rglob("*") if p.is_file()]:
            if str(path.relative_to(self.source)) not in wanted:
                path.unlink()
        for name in wanted:
            old = self.source / name
            # What has not changed keeps its time, and need not be built again.
            if old.is_file() and old.read_bytes() == (ROOT / name).read_bytes():
                continue
            old.parent.mkdir(parents=True, exist_ok=True)
            shutil.copy(ROOT / name, old)

    def configure(self):
        options = ["-DVOREL_BUILD_TESTS=ON", "-DCMAKE_BUILD_TYPE=Release", "-DVOREL_THINNED=8",
                   # A test need not be linked anew because the library has changed.
                   "-DCMAKE_LINK_DEPENDS_NO_SHARED=ON",
                   f"-DVOREL_BUILD_TOOLS={'ON' if self.units - {UNIT} else 'OFF'}"]
        if self.arm64:
            options = ["--preset", "arm64"] + options + ["-DVOREL_WERROR=OFF", "-DVOREL_ASSERTIONS=OFF"]
        else:
            options += ["-G", "Ninja", "-DCMAKE_CXX_COMPILER=g++"]
        if shutil.which("ccache") and "CMAKE_CXX_COMPILER_LAUNCHER" not in os.environ:
            options.append("-DCMAKE_CXX_COMPILER_LAUNCHER=ccache")
        self.run(["cmake", "-S", str(self.source), "-B", str(self.build)] + options, check=True,
                 cwd=self.source)

    def run(self, command, check=False, environment=None, seconds=None, cwd=None):
        """Returns whether the command ended well, and its output; one that takes too long did not."""
        try:
            done = subprocess.run(command, stdout=subprocess.PIPE, stderr=subprocess.STDOUT, text=True,
                                  errors="replace", timeout=seconds, cwd=cwd or self.home,
                                  env={**os.environ, **(environment or {})})
        except subprocess.TimeoutExpired:
            return False, "took too long"
        if check and done.returncode != 0:
            raise RuntimeError(" ".join(command) + "\n" + done.stdout)
        return done.returncode == 0, done.stdout

    def make(self, *targets):
        return self.run(["cmake", "--build", str(self.build), "--target", *targets, "--", "-j", "2"])

    def passes(self, program, tests, thinned=None):
        [path] = [p for p in self.build.rglob(program) if p.is_file() and os.access(p, os.X_OK)]
        command = [str(path), f"--gtest_filter={tests}"]
        if self.arm64:
            command = ["qemu-aarch64-static", "-L", "/usr/aarch64-linux-gnu"] + command
        # The first failure ends the program.
        environment = {"MALLOC_PERTURB_": "90", "GTEST_BRIEF": "1", "GTEST_BREAK_ON_FAILURE": "1"}
        if thinned:
            environment["VOREL_THINNED"] = str(thinned)
        good, output = self.run(command, environment=environment,
                                seconds=SECONDS["arm64" if self.arm64 else "x86"])
        if good and not re.search(r"\[  PASSED  \] [1-9]", output):
            raise RuntimeError(f"no test of {program} is named {tests}")
        return good

    def result(self, mutant):
        """Whether the mistake is caught, and by what."""
        path = mutant.source(self.source)
        text = path.read_text()
        path.write_text(mutant.mutated(text))
        try:
            program = mutant.program or mutant.unit
            in_library = program == UNIT
            # The tests themselves rarely know the mutated source: first without building them anew.
            for targets, program, tests, thinned, by in [
                    ([LIBRARY if in_library else program], program, mutant.tests, 16, "its tests"),
                    ([program], program, mutant.tests, 1, "its tests, all cases"),
                    ([mutant.unit], mutant.unit, "*", 4, "another test")]:
                built, output = self.make(*targets)
                if not built:
                    return "broken", output[-1500:]
                if not self.passes(program, tests, thinned):
                    return "caught", by
            return "survived", ""
        finally:
            path.write_text(text)


def chosen(mutants, names):
    known = {m.name for m in mutants} | {m.room for m in mutants}
    unknown = [name for name in names if name not in known]
    if unknown:
        sys.exit(f"no such room or name: {' '.join(unknown)}")
    return [m for m in mutants if not names or m.name in names or m.room in names]


def print_table(mutants, results):
    print(f"\n{'room':10} {'mistakes':>8} {'caught':>7} {'equal':>6} {'survived':>9} {'not run':>8}")
    for room in [r for r in ROOMS if any(m.room == r for m in mutants)] + ["all"]:
        of_room = [m for m in mutants if room in (m.room, "all")]
        counts = collections.Counter(results.get(m.name, ("not run", ""))[0] for m in of_room)
        print(f"{room:10} {len(of_room):8} {counts['caught']:7} {counts['equal']:6} "
              f"{counts['survived'] + counts['broken']:9} {counts['not run']:8}")


def main():
    parser = argparse.ArgumentParser(description=__doc__, formatter_class=argparse.RawTextHelpFormatter)
    parser.add_argument("names", nargs="*")
    parser.add_argument("--list", action="store_true")
    parser.add_argument("--equal", action="store_true")
    parser.add_argument("--arm64", action="store_true")
    parser.add_argument("--jobs", type=int, default=os.cpu_count())
    arguments = parser.parse_args()

    mutants = chosen(read_mutants(), arguments.names)
    if arguments.list:
        for m in mutants:
            print(f"{m.name:36} {m.file:32} {m.needs:7} {'equal' if m.equal else ''}")
        print(f"{len(mutants)} mistakes, {sum(1 for m in mutants if m.equal)} of them equal")
        return

    results = {}
    todo = queue.Queue()
    # Headers last: what includes them takes longer to build.
    for m in sorted(mutants, key=lambda m: m.file.endswith(".h")):
        if lacks(m, arguments.arm64):
            continue
        if m.equal and not arguments.equal:
            results[m.name] = ("equal", m.equal)
        elif bool(m.equal) == arguments.equal:
            todo.put(m)
    failed = []

    def work(tree):
        try:
            tree.copy()
            tree.configure()
            built, output = tree.make(LIBRARY, *tree.units)
            if not built:
                raise RuntimeError(output[-3000:])
            for unit in tree.units:
                if not tree.passes(unit, "*", 16):
                    raise RuntimeError("the tests fail without a mistake")
            while True:
                mutant = todo.get_nowait()
                start = time.monotonic()
                what, by = tree.result(mutant)
                if mutant.equal:
                    what, by = ("equal", "") if what == "survived" else ("survived", f"its reason: {what} by {by}")
                results[mutant.name] = (what, by)
                print(f"{mutant.name:36} {what:9} {time.monotonic() - start:5.0f} s  {by}", flush=True)
        except queue.Empty:
            pass
        except Exception as error:  # of one worker: the others must not go on
            failed.append(str(error))
            while not todo.empty():
                todo.get_nowait()

    count = max(1, min(arguments.jobs, todo.qsize()))
    units = {m.unit for m in todo.queue}
    workers = [threading.Thread(target=work, args=(Tree(i, arguments.arm64, units),)) for i in range(count)]
    for worker in workers:
        worker.start()
    for worker in workers:
        worker.join()
    if failed:
        sys.exit("\n".join(failed))

    print_table(mutants, results)
    survivors = [m for m in mutants if results.get(m.name, ("", ""))[0] in ("survived", "broken")]
    for m in survivors:
        print(f"\n{results[m.name][0]}: [{m.name}] {m.file}\n    - {m.line}\n    + {m.keys['with']}\n"
              f"    {results[m.name][1]}")
    sys.exit(1 if survivors else 0)


if __name__ == "__main__":
    main()
