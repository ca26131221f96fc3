"""Many titles over a cluster, one of whose workers is killed: every picture is there, and is the one of a run without.

    python3 at_scale.py [TITLES [WORKERS]]

The cluster is Dask's own on this machine, a process a worker; on another one give its address to Client. A task
paints a chunk of titles and returns their hashes, as one would write files or rows of a table. Tasks that were
under way on a worker that ends are done again by the others, and paint the same bytes: nothing has to be
compared, locked or cleaned up.
"""

import hashlib
import os
import signal
import sys
import time

import voreleffect as ve

CHUNK = 50


def title(number):
    """The arguments of one title; its look depends on the number alone."""
    presets = ve.presets()
    return {"text": f"Title {number}", "size": 24 + number % 9, "look": presets[number % len(presets)]}


def hash_of(picture):
    return hashlib.sha256(repr(picture.array.shape).encode() + picture.array.tobytes()).hexdigest()


def painted(numbers):
    """The hashes of the pictures of some titles, by their numbers."""
    pictures = ve.batch((title(number) for number in numbers), workers=1)
    return {number: hash_of(picture) for number, picture in zip(numbers, pictures)}


def over_a_cluster(chunks, workers):
    """The hashes of all, and how many workers were lost on the way."""
    from distributed import Client, LocalCluster, as_completed

    with LocalCluster(n_workers=workers, threads_per_worker=1, dashboard_address=None, silence_logs=50) as cluster, \
            Client(cluster) as client:
        victim = next(iter(client.run(os.getpid).values()))
        hashes, lost = {}, 0
        for future in as_completed(client.map(painted, chunks, pure=False)):
            hashes.update(future.result())
            if not lost and len(hashes) >= sum(map(len, chunks)) // 3:
                os.kill(victim, signal.SIGKILL)
                lost = 1
        # Dask's workers tell at length of being ended while they start, as the one in the place of the victim is.
        client.wait_for_workers(workers)
        return hashes, lost


def main(count, workers):
    chunks = [range(first, min(first + CHUNK, count)) for first in range(0, count, CHUNK)]
    start = time.monotonic()
    hashes, lost = over_a_cluster(chunks, workers)
    middle = time.monotonic()
    alone = {}
    for chunk in chunks:
        alone.update(painted(chunk))
    print(f"{len(hashes)} of {count} titles on {workers} workers, {lost} of them killed, in {middle - start:.1f} s; "
          f"one after the other in {time.monotonic() - middle:.1f} s")
    if hashes != alone:
        sys.exit(f"{sum(hashes.get(number) != alone[number] for number in alone)} titles are missing or differ")
    print("all pictures are the same")


if __name__ == "__main__":
    main(*(int(argument) for argument in (sys.argv[1:] + ["10000", "3"][len(sys.argv) - 1:])))
