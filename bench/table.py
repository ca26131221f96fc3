#!/usr/bin/env python3
"""Prints the figures of a run of voreleffect_bench as tables:

    table.py RUN.json [--compare SAVED.json]

A figure is the fastest call of the whole run; beside ours stands the median, over the repetitions, of the
median call.
"""
import argparse
import json
import signal
from collections import defaultdict

from goals import LEVELS, goals

OTHERS = ("literal", "memcpy")
COUNTED = ("look", "text")  # whole pieces of work, in microseconds; everything else per pixel


class Run:
    """rows[row][maker] = (fastest, median, pixels), times in nanoseconds."""

    def __init__(self, path):
        with open(path, encoding="utf-8") as file:
            content = json.load(file)
        self.context = content["context"]
        self.rows = defaultdict(dict)
        found = defaultdict(dict)
        for entry in content["benchmarks"]:
            if entry.get("aggregate_name") in ("min", "median"):
                found[entry["run_name"].removesuffix("/manual_time")][entry["aggregate_name"]] = entry
        # Repetitions come interleaved; families are numbered as they were registered.
        for name, entry in sorted(found.items(), key=lambda item: item[1]["min"]["family_index"]):
            row, maker = name.rsplit("/", 1)
            self.rows[row][maker] = (entry["min"]["fastest"] * 1e9, entry["median"]["middle"] * 1e9,
                                     entry["min"]["pixels"])

    def fastest(self, row, maker):
        return self.rows.get(row, {}).get(maker, (None,))[0]

    def figure(self, row, maker, part=0):
        """In the unit of the row."""
        found = self.rows.get(row, {}).get(maker)
        if found is None:
            return None
        return found[part] / (1e3 if unit(row) == "us" else found[2])


def unit(row):
    return "us" if row.split("/")[0] in COUNTED else "ns/px"


def number(value):
    if value is None:
        return ""
    if value >= 100:
        return f"{value:.0f}"
    return f"{value:.1f}" if value >= 10 else f"{value:.3f}"


def print_table(head, lines):
    widths = [max(len(line[i]) for line in [head] + lines) for i in range(len(head))]
    rule = ["-" * (widths[0])] + ["-" * (width - 1) + ":" for width in widths[1:]]
    for line in [head, rule] + lines:
        first = line[0].ljust(widths[0])
        print("| " + " | ".join([first] + [cell.rjust(w) for cell, w in zip(line[1:], widths[1:])]) + " |")


def print_subject(subject, rows, run, saved):
    makers = {maker for row in rows for maker in run.rows[row]}
    levels = [level for level in LEVELS if level in makers]
    others = [maker for maker in OTHERS if maker in makers]
    peers = sorted(makers - set(levels) - set(OTHERS))
    head = [unit(rows[0])] + levels + ["median"] * bool(levels) + others + ["L/best"] * ("literal" in others)
    head += peers + [f"change of {level}" for level in levels if saved]
    lines = []
    for row in rows:
        line = [row.split("/", 1)[1]] + [number(run.figure(row, level)) for level in levels]
        if levels:
            line.append(number(run.figure(row, levels[0], 1)))
        line += [number(run.figure(row, maker)) for maker in others]
        if "literal" in others:
            line.append(ratio(run.fastest(row, "literal"), run.fastest(row, "best")))
        line += [number(run.figure(row, peer)) for peer in peers]
        if saved:
            line += [change(run.fastest(row, level), saved.fastest(row, level)) for level in levels]
        lines.append(line)
    print(f"\n### {subject}\n")
    print_table(head, lines)


def ratio(above, below):
    return f"{above / below:.1f}" if above and below else ""


def change(now, before):
    return f"{100 * (now / before - 1):+.1f} %" if now and before else ""


def reached(goal, run, level):
    """The figure that a goal limits, or None where the run does not hold it."""
    row, ours = goal["row"], run.fastest(goal["row"], level)
    if ours is None:
        return None
    if goal["kind"] in ("nsPerPixel", "us"):
        return run.figure(row, level)
    if goal["kind"] == "overRow":
        below = run.figure(goal["other"], level)
        return run.figure(row, level) / below if below else None
    other = run.fastest(row, goal.get("peer", "literal"))
    return other / ours if other else None


def print_goals(run):
    wording = {"timesLiteral": "at least {} times L", "timesPeer": "at least {} times {}",
               "nsPerPixel": "at most {} ns/px", "us": "at most {} us", "overRow": "at most {} times {}"}
    lines = []
    for goal in goals():
        for level in LEVELS:
            limit, value = goal["limits"][level], reached(goal, run, level)
            if limit is None or value is None:
                continue
            met = value >= limit if goal["kind"].startswith("times") else value <= limit
            said = wording[goal["kind"]].format(limit, goal.get("peer") or goal.get("other"))
            lines.append([goal["row"], level, said, number(value), "yes" if met else "no"])
    if lines:
        met = sum(line[-1] == "yes" for line in lines)
        print(f"\n### Goals: {met} of {len(lines)} met\n")
        print_table(["row", "level", "goal", "figure", "met"], lines)


def main():
    signal.signal(signal.SIGPIPE, signal.SIG_DFL)
    parser = argparse.ArgumentParser(description=__doc__.split("\n", maxsplit=1)[0])
    parser.add_argument("run")
    parser.add_argument("--compare")
    arguments = parser.parse_args()
    run = Run(arguments.run)
    saved = Run(arguments.compare) if arguments.compare else None
    subjects = defaultdict(list)
    for row in run.rows:
        subjects[row.split("/")[0]].append(row)
    for subject, rows in subjects.items():
        print_subject(subject, rows, run, saved)
    print_goals(run)


if __name__ == "__main__":
    main()
