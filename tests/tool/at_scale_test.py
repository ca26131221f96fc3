#!/usr/bin/env python3
"""Batches in parts, as docs/at-scale.md spreads them: at_scale_test.py VORELPAINT PAGE

The job array's script and the indexed job's command are taken from the page and run by several processes at a
time; processes that are given the variables stand for the scheduler. Some are killed in the middle and run again.
The parts together are the whole batch byte for byte.
"""

import json
import os
import re
import signal
import subprocess
import sys
import tempfile
import time
from pathlib import Path

ROOT = Path(__file__).resolve().parents[2]
sys.path.insert(0, str(ROOT / "scripts" / "docs"))

from page_commands import file_name  # noqa: E402
from pages import Page  # noqa: E402

JOBS = 120
SHARDS = 8


def write_batch(folder):
    lines = [json.dumps({"text": f"Line {i}", "output": f"{i}.png", "size": 20 + i % 7}) for i in range(JOBS)]
    (folder / "titles.jsonl").write_text("\n".join(lines) + "\n", encoding="utf-8")


def pictures(folder):
    return {path.name: path.read_bytes() for path in folder.iterdir() if path.suffix == ".png"}


def remove(folder):
    for path in folder.glob("*.png"):
        path.unlink()


def array_task(page, folder):
    """The job array's script, and what a task of it is given."""
    block = next(block for block in page.blocks if file_name(page, block) == "paint.sbatch")
    assert f"#SBATCH --array=1-{SHARDS}\n" in block.text
    script = folder / "paint.sbatch"
    script.write_text(block.text, encoding="utf-8")
    return lambda i: (["bash", str(script)], {"SLURM_ARRAY_TASK_ID": str(i + 1), "SLURM_CPUS_PER_TASK": "2"})


def indexed_task(page, _folder):
    """The indexed job's command, and what a pod of it is given."""
    block = next(block for block in page.blocks if file_name(page, block) == "paint.yaml")
    assert f"completions: {SHARDS}\n" in block.text and "completionMode: Indexed\n" in block.text
    command = re.search(r"args:\n +- (.*)\n", block.text)[1]
    return lambda i: (["sh", "-c", command], {"JOB_COMPLETION_INDEX": str(i)})


def start(task, i, folder, environment):
    command, variables = task(i)
    return subprocess.Popen(command, cwd=folder, env={**environment, **variables})


def kill_in_the_middle(task, folder, environment):
    """Starts all, and kills them when a part of the pictures is there."""
    processes = [start(task, i, folder, environment) for i in range(SHARDS)]
    end = time.monotonic() + 60
    while len(pictures(folder)) < JOBS // 6 and time.monotonic() < end:
        time.sleep(0.002)
    for process in processes:
        process.send_signal(signal.SIGKILL)
    return [process.wait() for process in processes]


def check(task, folder, environment, whole):
    remove(folder)
    ends = kill_in_the_middle(task, folder, environment)
    assert -signal.SIGKILL in ends, "all were done before they were killed"
    left = pictures(folder)
    assert 0 < len(left) < JOBS, len(left)
    assert all(whole[name] == bytes_ for name, bytes_ in left.items()), "a half-written picture"
    times = {name: (folder / name).stat().st_mtime_ns for name in left}
    processes = [start(task, i, folder, environment) for i in range(SHARDS)]
    assert [process.wait() for process in processes] == [0] * SHARDS
    assert pictures(folder) == whole
    assert times == {name: (folder / name).stat().st_mtime_ns for name in left}, "painted anew"


def main(program, page_path):
    page = Page(Path(page_path).resolve())
    environment = {**os.environ, "PATH": f"{Path(program).resolve().parent}:{os.environ['PATH']}"}
    with tempfile.TemporaryDirectory() as scratch:
        folder = Path(scratch)
        write_batch(folder)
        subprocess.run(["vorelpaint", "--batch", "titles.jsonl", "--preset", "gold"], cwd=folder, env=environment,
                       check=True)
        whole = pictures(folder)
        assert len(whole) == JOBS
        for task_of in (array_task, indexed_task):
            check(task_of(page, folder), folder, environment, whole)


if __name__ == "__main__":
    main(sys.argv[1], sys.argv[2])
