#!/usr/bin/env python3
"""Measures how many pictures a second vorelpaint and other programs paint, and prints a table of it:

    measure.py --tool VORELPAINT [--against NAME VORELPAINT] --folder FOLDER [--quick]

All paint the same titles in looks of the same kind, one and two pictures at a time. Rounds take all
programs in turns; a rate is the median of the rounds, a ratio the median of the ratios within them.
"""
import argparse
import json
import shutil
import statistics
import subprocess
import sys
import time
from pathlib import Path

from PIL import Image

HERE = Path(__file__).resolve().parent
LOOKS = ("shadow", "gradient", "glow")
JOBS = (1, 2)
SIZE = (1500, 130)
ROUNDS = 5
QUICK = 4


class Rival:
    """A program with a script that takes a look, a file of titles, a folder and a number of jobs."""

    def __init__(self, pictures, interpreter, script, *options):
        self.pictures = pictures
        self.script = [interpreter, str(HERE / script), *options]
        self.name = self.version()

    def version(self):
        """The name with its version; empty where the program cannot be run."""
        if not shutil.which(self.script[0]):
            return ""
        run = subprocess.run([*self.script, "--version"], capture_output=True, text=True, check=False)
        return run.stdout.strip() if run.returncode == 0 else ""

    def commands(self, look, titles, folder, jobs):
        """What is run at the same time. Files that it needs are written before."""
        file = folder / "titles.txt"
        file.write_text("".join(f"{title}\n" for title in titles), encoding="utf-8")
        return [[*self.script, look, str(file), str(folder), str(jobs)]]


class Tool:
    """vorelpaint; one that does not know --jobs runs as often as there are jobs, each with its share."""

    def __init__(self, pictures, name, program):
        self.pictures = pictures
        self.name = name
        self.program = str(program)
        told = subprocess.run([self.program, "--help"], capture_output=True, text=True, check=True)
        self.knows_jobs = "--jobs" in told.stdout

    def commands(self, look, titles, folder, jobs):
        lines = [json.dumps({"text": title, "output": str(folder / f"{number}.png")})
                 for number, title in enumerate(titles)]
        shares = [lines] if self.knows_jobs else [lines[share::jobs] for share in range(jobs)]
        more = ["--jobs", str(jobs)] if self.knows_jobs else []
        return [self.batch(look, folder / f"share-{number}.jsonl", share) + more
                for number, share in enumerate(shares)]

    def batch(self, look, file, lines):
        file.write_text("".join(f"{line}\n" for line in lines), encoding="utf-8")
        return [self.program, "--batch", str(file), "--style", str(HERE / f"{look}.json"), "--font",
                "/usr/share/fonts/truetype/dejavu/DejaVuSans-Bold.ttf", "--size", "96",
                "--width", str(SIZE[0]), "--height", str(SIZE[1])]


def titles_of(count):
    return [f"Episode {number:04}: Rising Tide" for number in range(1, count + 1)]


def paint(program, look, count, jobs, folder):
    """Paints into the emptied folder. Returns the seconds that it took."""
    shutil.rmtree(folder, ignore_errors=True)
    folder.mkdir(parents=True)
    commands = program.commands(look, titles_of(count), folder, jobs)
    start = time.perf_counter()
    running = [subprocess.Popen(command, stdout=subprocess.DEVNULL) for command in commands]
    codes = [process.wait() for process in running]
    seconds = time.perf_counter() - start
    painted = len(list(folder.glob("*.png")))
    if any(codes) or painted != count:
        sys.exit(f"{program.name}, {look}: {painted} of {count} pictures, exit codes {codes}")
    return seconds


def traits(file):
    """What pictures of one kind share: the box of what is seen, and thousandths of the pixels."""
    with Image.open(file) as picture:
        if picture.size != SIZE or picture.mode not in ("RGBA", "LA"):
            sys.exit(f"{file}: {picture.size} {picture.mode}, not {SIZE} with alpha")
        alpha = picture.getchannel("A")
        seen = alpha.point(lambda value: 255 if value >= 128 else 0)
        left, top, right, bottom = seen.getbbox() or (0, 0, 0, 0)
        histogram = alpha.histogram()
        light = Image.composite(picture.convert("L"), Image.new("L", SIZE), seen).histogram()
    thousandth = SIZE[0] * SIZE[1] / 1000
    return {"width": right - left, "height": bottom - top,
            "seen pixels": sum(histogram[128:]) / thousandth,
            "translucent pixels": sum(histogram[8:248]) / thousandth,
            "light pixels": sum(light[150:]) / thousandth}


# How far a trait may be from that of vorelpaint's picture: a share of it, and an amount.
MARGINS = {"width": (0.02, 0), "height": (0.1, 0), "seen pixels": (0.2, 0),
           "translucent pixels": (0.5, 25), "light pixels": (0.2, 0)}


def check_kind(program, file, ours):
    theirs = traits(file)
    for trait, (share, amount) in MARGINS.items():
        their, our = theirs[trait], ours[trait]
        if abs(their - our) > share * our + amount:
            sys.exit(f"{program.name}: {file}: {trait}: {their:.0f}, of vorelpaint {our:.0f}")


def check(programs, folder):
    """Compares the kind of a few pictures by each program. Returns mean bytes by program and look."""
    sizes = {}
    for look in LOOKS:
        ours = None
        for number, program in enumerate(programs):
            place = folder / f"{look}-{number}"
            paint(program, look, QUICK, 2, place)
            ours = ours or traits(place / "0.png")
            check_kind(program, place / "0.png", ours)
            sizes[program, look] = statistics.mean(file.stat().st_size for file in place.glob("*.png"))
    return sizes


def measure(programs, folder, rounds, count_of):
    """rates[program, look, jobs]: pictures a second, one for each round."""
    rates = {}
    for number in range(rounds):
        for look in LOOKS:
            for jobs in JOBS:
                for program in programs:
                    count = count_of(program)
                    seconds = paint(program, look, count, jobs, folder / "measured")
                    rates.setdefault((program, look, jobs), []).append(count / seconds)
        print(f"round {number + 1} of {rounds}", file=sys.stderr)
    return rates


def ratio(ours, theirs):
    return statistics.median(our / their for our, their in zip(ours, theirs))


def figure(value):
    return f"{value:.0f}" if value >= 99.5 else f"{value:.1f}"


def print_table(programs, rates, sizes):
    widths = (8, max(len(program.name) for program in programs), 8, 8, 8, 8, 10)
    heads = ("look", "program", "N = 1", "N = 2", "ratio, 1", "ratio, 2", "KB/picture")

    def row(cells):
        print("| " + " | ".join(cell.ljust(width) if column < 2 else cell.rjust(width)
                                for column, (cell, width) in enumerate(zip(cells, widths))) + " |")

    row(heads)
    print("|" + "|".join("-" * (width + 1) + ("-" if column < 2 else ":")
                         for column, width in enumerate(widths)) + "|")
    for look in LOOKS:
        for program in programs:
            rows = [rates[program, look, jobs] for jobs in JOBS]
            ratios = [ratio(rates[programs[0], look, jobs], rates[program, look, jobs]) for jobs in JOBS]
            row([look, program.name, *(figure(statistics.median(rounds)) for rounds in rows),
                 *(figure(value) for value in ratios), f"{sizes[program, look] / 1024:.1f}"])


def found_programs(tool, against):
    """vorelpaint first, then what there is to compare it with."""
    programs = [Tool(1000, "vorelpaint", tool)]
    if against:
        programs.append(Tool(150, *against))
    rivals = {"Pillow": Rival(100, sys.executable, "pillow_titles.py"),
              "Pillow, level 1": Rival(100, sys.executable, "pillow_titles.py", "--fast"),
              "ImageMagick": Rival(30, "bash", "imagemagick_titles.sh"),
              "ImageMagick, level 1": Rival(30, "bash", "imagemagick_titles.sh", "--fast"),
              "librsvg": Rival(40, "bash", "librsvg_titles.sh"),
              "Skia": Rival(100, "node", "skia_titles.mjs")}
    for name, rival in rivals.items():
        if rival.name:
            programs.append(rival)
        else:
            print(f"{name} is not here: its rows are left out", file=sys.stderr)
    return programs


def main():
    parser = argparse.ArgumentParser()
    parser.add_argument("--tool", required=True)
    parser.add_argument("--against", nargs=2)
    parser.add_argument("--folder", required=True, type=Path)
    parser.add_argument("--quick", action="store_true")
    options = parser.parse_args()
    folder = options.folder.resolve()
    programs = found_programs(options.tool, options.against)
    sizes = check(programs, folder)
    if options.quick:
        rates = measure(programs, folder, 1, lambda program: QUICK)
    else:
        rates = measure(programs, folder, ROUNDS, lambda program: program.pictures)
    print_table(programs, rates, sizes)


main()
