#!/usr/bin/python3
"""What the binding adds to C++, and how scans fare on workers: a table on the standard output.

    cmake --build build/dev --target vorn_core python_benchmark
    PYTHONPATH=build/dev/python python/benchmarks/compare.py build/dev/python/benchmarks
    PYTHONPATH=build/dev/python python/benchmarks/compare.py --workers

Both sides do the same work on the same numbers, in turn, and the least time of each counts.
"""

import argparse
import os
import pathlib
import pickle
import subprocess
import sys
import tempfile
import time

import numpy as np
import vorn
from vorn import geometry

sys.path.insert(0, str(pathlib.Path(__file__).resolve().parent.parent / "tests"))
from scans import TOL, scan  # noqa: E402 (its folder is known only now)

REPEATS = 15
ROUNDS = 8
ELEMENTS = 200_000
POINTS = 1000


def least_seconds(run):
    """Of some runs."""
    times = []
    for _ in range(REPEATS):
        begin = time.perf_counter()
        run()
        times.append(time.perf_counter() - begin)
    return min(times)


def native_times(program, path):
    """Name and time of each line that the C++ program prints."""
    text = subprocess.run([program, path, repr(TOL)], check=True, capture_output=True,
                          text=True).stdout
    return {name: float(value) for name, value, _ in map(str.split, text.splitlines())}


def python_times(points):
    """The same, measured here: seconds of the fit, nanoseconds of an element."""
    numbers = np.fmod(np.arange(4 * ELEMENTS) * 0.6180339887, 1.0)
    places, segments = numbers[:2 * ELEMENTS].reshape(-1, 2), numbers.reshape(-1, 4)
    batches = {
        "line_deviations": lambda: geometry.line_deviations([0.6, 0.8, -1.0], places),
        "line_segments_intersections":
            lambda: geometry.line_segments_intersections([0, 0, 1, 1], segments),
        "polygon_areas": lambda: geometry.polygon_areas(places, [ELEMENTS])}
    times = {name: least_seconds(run) / ELEMENTS * 1e9 for name, run in batches.items()}
    times["fit"] = least_seconds(lambda: vorn.fit(points, tol=TOL, strategy="mixed"))
    return times


def compare_binding(folder):
    points = scan(0, POINTS)
    native, python = {}, {}
    with tempfile.TemporaryDirectory() as scratch:
        path = pathlib.Path(scratch, "points.csv")
        path.write_text("x,y\n" + "".join(f"{x!r},{y!r}\n" for x, y in points.tolist()))
        for _ in range(ROUNDS):
            for times, new in ((native, native_times(folder / "python_benchmark", path)),
                               (python, python_times(points))):
                for name, value in new.items():
                    times[name] = min(value, times.get(name, value))
    print(f"fit of {POINTS} points: C++ {native['fit'] * 1e3:.3f} ms, Python "
          f"{python['fit'] * 1e3:.3f} ms, {100 * (python['fit'] / native['fit'] - 1):+.2f} %")
    for name in ("line_deviations", "line_segments_intersections", "polygon_areas"):
        print(f"{name}: C++ {native[name]:.1f} ns, Python {python[name]:.1f} ns, "
              f"{python[name] - native[name]:+.1f} ns an element")


def scans_a_second(count, **where):
    """The most of some runs: what else the machine does only takes away."""
    return max(scans_of_a_run(count, **where) for _ in range(ROUNDS))


def scans_of_a_run(count, **where):
    begin = time.perf_counter()
    failed = sum(r.error is not None for r in vorn.fit_many((scan(i) for i in range(count)),
                                                            tol=TOL, **where))
    assert failed == 0
    return count / (time.perf_counter() - begin)


def move_seconds(client, count):
    """To send a scan to a worker and a contour back, nothing being fitted there."""
    contour = vorn.fit(scan(0), tol=TOL, strategy="mixed")
    batches = [[scan(16 * k + i) for i in range(16)] for k in range(count // 16)]
    begin = time.perf_counter()
    client.gather([client.submit(lambda scans, answer: [answer] * len(scans), batch, contour,
                                 pure=False) for batch in batches])
    return (time.perf_counter() - begin) / (16 * len(batches))


def compare_workers(count):
    import distributed

    print(f"a scan of {POINTS} points travels as {len(pickle.dumps(scan(0)))} bytes, a contour as "
          f"{len(pickle.dumps(vorn.fit(scan(0), tol=TOL, strategy='mixed')))}")
    print(f"threads of one process: {scans_a_second(count, workers=1):.1f} scans a second with 1, "
          f"{scans_a_second(count, workers=2):.1f} with 2")
    for workers in (1, 2):
        with distributed.LocalCluster(n_workers=workers, threads_per_worker=1, processes=True,
                                      host="127.0.0.1", dashboard_address=None) as cluster, \
                distributed.Client(cluster) as client:
            scans_of_a_run(32, client=client)
            rate = scans_a_second(count, client=client)
            print(f"{workers} worker{'s' * (workers > 1)}: {rate:.1f} scans a second; to move a "
                  f"scan and its contour takes {1e3 * move_seconds(client, count):.2f} ms")


def main():
    parser = argparse.ArgumentParser(description=__doc__.splitlines()[0])
    parser.add_argument("folder", nargs="?", type=pathlib.Path, help="of python_benchmark")
    parser.add_argument("--workers", action="store_true", help="time scans on workers")
    parser.add_argument("--scans", type=int, default=160, help="how many in a run (160)")
    options = parser.parse_args()
    print(f"{os.cpu_count()} processors, load {os.getloadavg()[0]:.1f}")
    if options.folder:
        compare_binding(options.folder)
    if options.workers:
        compare_workers(options.scans)


if __name__ == "__main__":
    main()
