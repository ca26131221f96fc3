"""Many texts on several threads or processes."""

from __future__ import annotations

import multiprocessing
import os
from collections import deque
from collections.abc import Callable, Iterable, Iterator, Mapping
from concurrent.futures import Executor, Future, ProcessPoolExecutor, ThreadPoolExecutor
from concurrent.futures.process import BrokenProcessPool
from typing import Any, Literal, Union

from ._picture import TextPicture
from ._text import text_picture

#: A text, or the arguments of text_picture by their names.
Job = Union[str, Mapping[str, Any]]


class JobError(Exception):
    """A job of a batch that could not be done; its ``__cause__`` tells why."""

    def __init__(self, index: int, cause: BaseException | str) -> None:
        super().__init__(index, str(cause))
        self.index = index  #: which of the jobs, from 0

    def __str__(self) -> str:
        return f"job {self.index}: {self.args[1]}"


def _paint(job: Job) -> TextPicture:
    if isinstance(job, str):
        return text_picture(job)
    if not isinstance(job, Mapping):
        raise TypeError(f"a job is a str or a mapping of arguments, not {type(job).__name__}")
    return text_picture(**job)


def _cores() -> int:
    return len(os.sched_getaffinity(0)) if hasattr(os, "sched_getaffinity") else os.cpu_count() or 1


class _Crew:
    """Workers that are made anew when one of their processes was killed."""

    def __init__(self, workers: int, processes: bool) -> None:
        self.make: Callable[[], Executor] = lambda: ThreadPoolExecutor(workers)
        if processes:
            context = multiprocessing.get_context("spawn")
            self.make = lambda: ProcessPoolExecutor(workers, mp_context=context)
        self.executor = self.make()

    def give(self, job: Job) -> Future[TextPicture]:
        try:
            return self.executor.submit(_paint, job)
        except BrokenProcessPool:
            self.executor.shutdown(wait=False)
            self.executor = self.make()
            return self.executor.submit(_paint, job)

    def end(self) -> None:
        self.executor.shutdown(wait=True, cancel_futures=True)


def batch(jobs: Iterable[Job], *, workers: int | None = None, processes: bool = False,
          errors: Literal["raise", "yield"] = "raise") -> Iterator[Any]:
    """Paints texts and yields a TextPicture for each, in the order of the jobs.

    jobs       texts, or mappings of the arguments of text_picture: {"text": "Hello", "look": "neon"}. They
               are taken one by one: at most two of each worker are under way or wait to be taken, which
               bounds the memory.
    workers    threads or processes; as many as there are cores for this process
    processes  takes processes of their own instead of threads. Threads paint at once, too; processes are
               for jobs whose faults must not reach this one. The program needs a main module that can be
               imported, as multiprocessing says.
    errors     "raise" raises JobError at the turn of a job that could not be done and ends the batch;
               "yield" yields the JobError in the place of the picture and goes on. A process that is
               killed takes along the jobs that were under way; others take its place.
    """
    if errors not in ("raise", "yield"):
        raise ValueError(f"errors: {errors!r} is none of raise, yield")
    count = _cores() if workers is None else workers
    if isinstance(count, bool) or not isinstance(count, int):
        raise TypeError(f"workers: a whole number, not {type(count).__name__}")
    if not 1 <= count <= 1000:
        raise ValueError(f"workers: {count} is no whole number from 1 to 1000")
    return _results(jobs, _Crew(count, processes), 2 * count, errors == "raise")


def _results(jobs: Iterable[Job], crew: _Crew, most: int, raises: bool) -> Iterator[Any]:
    waiting: deque[Future[TextPicture]] = deque()
    source, index, is_over = iter(jobs), 0, False
    try:
        while True:
            while not is_over and len(waiting) < most:
                try:
                    waiting.append(crew.give(next(source)))
                except StopIteration:
                    is_over = True
            if not waiting:
                return
            yield _result(waiting.popleft(), index, raises)
            index += 1
    finally:
        crew.end()


def _result(future: Future[TextPicture], index: int, raises: bool) -> Any:
    try:
        return future.result()
    except Exception as cause:
        error = JobError(index, cause)
        error.__cause__ = cause
        if raises:
            raise error from cause
        return error
