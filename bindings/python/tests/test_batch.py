import itertools
import os
import signal
import threading
import time

import numpy as np
import pytest

import voreleffect as ve

JOBS = [{"text": f"Title {i}", "size": 20 + i % 7, "look": ve.presets()[i % 5]} for i in range(24)]


@pytest.mark.parametrize("workers", [1, 2, 5, None])
def test_pictures_come_in_the_order_of_the_jobs(workers):
    for job, picture in zip(JOBS, ve.batch(JOBS, workers=workers)):
        assert np.array_equal(picture.array, ve.text_picture(**job).array)


def test_of_no_jobs_there_is_nothing():
    assert list(ve.batch([])) == []


def test_a_text_alone_is_a_job():
    assert np.array_equal(next(ve.batch(["Hello"])).array, ve.text_picture("Hello").array)


def test_jobs_are_taken_as_they_are_needed():
    taken = itertools.count()
    pictures = ve.batch(({"text": f"{next(taken)}", "size": 9} for _ in itertools.repeat(0)), workers=2)
    for _ in range(3):
        next(pictures)
    assert next(taken) <= 3 + 2 * 2
    pictures.close()


def test_a_fault_is_told_with_the_index_of_its_job():
    jobs = [{"text": "a"}, {"text": "b", "font": "/no/such.ttf"}, {"text": "c"}, 5, {"txt": "d"}]
    pictures = ve.batch(jobs)
    next(pictures)
    with pytest.raises(ve.JobError, match="job 1: no font file '/no/such.ttf'") as caught:
        next(pictures)
    assert caught.value.index == 1 and isinstance(caught.value.__cause__, ve.TextError)
    told = list(ve.batch(jobs, errors="yield"))
    assert [type(each).__name__ for each in told] == ["TextPicture", "JobError", "TextPicture", "JobError", "JobError"]
    assert [each.index for each in told if isinstance(each, ve.JobError)] == [1, 3, 4]


def test_arguments_are_checked_at_once():
    for arguments, fault in (({"workers": 0}, ValueError), ({"workers": 1.5}, TypeError), ({"errors": "no"}, ValueError)):
        with pytest.raises(fault):
            ve.batch([], **arguments)


def test_processes_paint_the_same():
    for job, picture in zip(JOBS, ve.batch(JOBS, workers=2, processes=True)):
        assert np.array_equal(picture.array, ve.text_picture(**job).array) and isinstance(picture, ve.TextPicture)


def test_faults_come_back_from_processes():
    jobs = [{"text": "a"}, {"text": "b", "font": "/no/such.ttf"}, {"text": "c", "look": ve.Look().stroke(2, "#fff")}]
    one, two, three = ve.batch(jobs, workers=1, processes=True, errors="yield")
    assert two.index == 1 and isinstance(two.__cause__, ve.TextError)
    assert np.array_equal(three.array, ve.text_picture(**jobs[2]).array) and one.array.any()


def children():
    found = []
    for task in os.listdir("/proc/self/task"):
        with open(f"/proc/self/task/{task}/children") as file:
            for child in map(int, file.read().split()):
                with open(f"/proc/{child}/cmdline") as line:
                    if "spawn_main" in line.read():
                        found.append(child)
    return found


def test_a_process_that_is_killed_takes_its_jobs_along_and_no_others():
    jobs = ({"text": f"{i}", "size": 200, "look": "gold"} for i in range(30))
    told, killed = [], False
    for each in ve.batch(jobs, workers=2, processes=True, errors="yield"):
        told.append(each)
        if len(told) == 3 and not killed:
            os.kill(children()[0], signal.SIGKILL)
            killed = True
    lost = [each.index for each in told if isinstance(each, ve.JobError)]
    assert killed and len(told) == 30 and len(lost) <= 4
    for index, each in enumerate(told):
        if index not in lost:
            assert np.array_equal(each.array, ve.text_picture(f"{index}", size=200, look="gold").array)


def slow_mask():
    """Noise, so large that others see it being painted."""
    return np.random.default_rng(1).integers(0, 256, (2500, 2500), np.uint8)


def test_other_threads_run_while_it_paints():
    painter = ve.Painter(ve.Look().outer_glow(90, "#fff").stroke(90, "#f00"))
    mask = slow_mask()
    done = threading.Event()

    def paint():
        painter.paint(mask)
        done.set()

    thread = threading.Thread(target=paint)
    start, longest, last = time.monotonic(), 0.0, time.monotonic()
    thread.start()
    while not done.is_set():
        now = time.monotonic()
        longest, last = max(longest, now - last), now
    thread.join()
    took = time.monotonic() - start
    assert took > 0.05 and longest < took / 2


def test_threads_may_share_a_painter_and_a_look():
    look = ve.Look().fill("#36c").outer_shadow("#000").stroke(3, "#fff")
    painter = ve.Painter(look)
    masks = [np.full((20 + i, 30), 255 - i, np.uint8) for i in range(8)]
    expected = [look.paint(mask).array for mask in masks]
    faults = []

    def work(seed):
        for i in np.random.default_rng(seed).integers(0, 8, 60):
            if not np.array_equal(painter.paint(masks[i]).array, expected[i]):
                faults.append(i)

    threads = [threading.Thread(target=work, args=(seed,)) for seed in range(4)]
    for thread in threads:
        thread.start()
    for thread in threads:
        thread.join()
    assert not faults


def test_a_forked_child_paints():
    expected = ve.text_picture("before", look="neon").array
    stop = threading.Event()

    def busy(first):
        """Asks for fonts and families that were not asked for before, so that locks are held most of the time."""
        for i in itertools.count(first):
            if stop.is_set():
                return
            try:
                ve.text_picture(chr(0x4E00 + i % 20000), size=9, font=f"No {i}" if i % 2 else "DejaVu Sans")
            except ve.TextError:
                pass

    threads = [threading.Thread(target=busy, args=(7000 * first,)) for first in range(3)]
    for thread in threads:
        thread.start()
    try:
        for _ in range(8):
            child = os.fork()
            if child == 0:
                same = np.array_equal(ve.text_picture("before", look="neon").array, expected)
                os._exit(0 if same else 1)
            deadline = time.monotonic() + 20
            while (ended := os.waitpid(child, os.WNOHANG))[0] == 0 and time.monotonic() < deadline:
                time.sleep(0.01)
            if ended[0] == 0:
                os.kill(child, signal.SIGKILL)
                os.waitpid(child, 0)
            assert ended[0] == child and ended[1] == 0
    finally:
        stop.set()
        for thread in threads:
            thread.join()


def test_a_forked_child_paints_with_a_painter_that_another_thread_holds():
    painter = ve.Painter(ve.Look().outer_glow(90, "#fff").stroke(90, "#f00"))
    small, large = np.full((4, 4), 255, np.uint8), slow_mask()
    expected = painter.paint(small).array
    thread = threading.Thread(target=painter.paint, args=(large,))
    thread.start()
    time.sleep(0.02)
    child = os.fork()
    if child == 0:
        signal.alarm(20)
        os._exit(0 if np.array_equal(painter.paint(small).array, expected) else 1)
    was_painting = thread.is_alive()
    assert os.waitpid(child, 0)[1] == 0 and was_painting
    thread.join()
    assert np.array_equal(painter.paint(small).array, expected)


def resident():
    with open("/proc/self/statm") as file:
        return int(file.read().split()[1]) * os.sysconf("SC_PAGE_SIZE")


def test_memory_stays_where_it_is():
    mask = np.full((100, 100), 255, np.uint8)
    page = np.zeros((200, 200, 4), np.uint8)

    def once(i):
        look = ve.Look().stroke(3, "#fff").outer_shadow("#000").pattern(np.full((9, 9, 4), i % 256, np.uint8))
        look.paint(mask)
        look.paint([(0, 0, mask)] * 3, onto=page)
        look.paint(mask[:, ::-1])
        try:
            look.paint(mask.astype(float))
        except TypeError:
            pass
        ve.text_picture(f"{i % 50}", size=20, look=look)
        ve.Style.preset("tiles")

    for i in range(60):
        once(i)
    before = resident()
    for i in range(500):
        once(i)
    # One picture of 40 KB that were lost in each call would be 20 MB.
    assert resident() - before < 8 << 20
