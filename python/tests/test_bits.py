"""Python and the program give the same bits; what runs long leaks nothing."""

import json
import os
import pathlib
import resource
import shutil
import subprocess
import sys
import threading
import time

import numpy as np
import pytest
import vorn
from scans import TOL, scan

# Tolerances that suit the measured contours; a tuple is a cap for tolerances by the spacing.
SHARED = {"rail_head_known_arcs": 0.01, "wheel_worn_a": 0.03, "rail_worn_low": 0.025,
          "mirror_sphere_83m": 0.00005, "hatch_boundary": 0.002, "glyph_five": (2.0,),
          "gcode_letter_d": 0.015, "airfoil_clark_y": 0.0004, "circle_r3": 0.001}


@pytest.fixture
def program():
    found = os.environ.get("CONTOUR_PROGRAM") or shutil.which("contour")
    if not found:
        pytest.skip("the program contour is not there: CONTOUR_PROGRAM does not name it")
    return found


def with_tolerances(path, tol):
    points = vorn.read_points(path)[:, :2]
    if not isinstance(tol, tuple):
        return np.column_stack((points, np.full(len(points), tol)))
    steps = np.hypot(*np.diff(points, axis=0).T)
    nearer = np.minimum(np.append(steps, np.inf), np.append(np.inf, steps))
    return np.column_stack((points, np.minimum(tol[0], 0.3 * nearer)))


def place(document):
    return document["x"], document["y"]


def assert_same_bits(contour, document):
    assert contour.is_closed == document["closed"]
    assert contour.max_deviation == document["deviation"]["largest"]["value"]
    assert len(contour) == len(document["elements"])
    for piece, other in zip(contour, document["elements"]):
        assert (piece.start, piece.end) == (place(other["start"]), place(other["end"]))
        assert piece.length == other["length"]
        assert isinstance(piece, vorn.Arc) == (other["kind"] == "arc")
        if isinstance(piece, vorn.Arc):
            assert piece.center == place(other["center"]) and piece.radius == other["radius"]
            assert piece.sweep == other["sweep"] and piece.ccw == (other["direction"] == "ccw")


#: What the program says when two points are too close, and when there is no fit.
EXIT_CODES = {vorn.PointsTooCloseError: 4, vorn.NoFitError: 5}


def compare_with_program(program, points, folder, strategy):
    path, out = folder / "points.csv", folder / "contour.json"
    path.write_text("x,y,w\n" + "".join(f"{x!r},{y!r},{w!r}\n" for x, y, w in points.tolist()))
    done = subprocess.run([program, "fit", path, "--strategy", strategy, "-o", out],
                          capture_output=True, text=True, check=False)
    try:
        contour = vorn.fit(points, strategy=strategy)
    except vorn.ContourError as error:
        assert done.returncode == EXIT_CODES[type(error)], done.stderr
        return
    assert_same_bits(contour, json.loads(out.read_text()))


@pytest.mark.parametrize("strategy", ["fewest", "mixed", "cells"])
def test_the_examples_have_the_bits_of_the_program(program, examples, tmp_path, strategy):
    for path in sorted(examples.glob("*.csv")):
        compare_with_program(program, vorn.read_points(path), tmp_path, strategy)


@pytest.mark.thorough
@pytest.mark.parametrize("strategy", ["fewest", "mixed", "cells"])
@pytest.mark.parametrize("name", SHARED)
def test_measured_contours_have_the_bits_of_the_program(program, shared, tmp_path, name, strategy):
    points = with_tolerances(shared / f"{name}.csv", SHARED[name])
    compare_with_program(program, points, tmp_path, strategy)


def resident_pages():
    return int(pathlib.Path("/proc/self/statm").read_text().split()[1])


@pytest.mark.thorough
def test_ten_thousand_fits_leak_nothing():
    points, bad = scan(0, 60), np.full((5, 2), np.nan)

    def stop(percent):
        raise InterruptedError

    def rounds(count):
        for _ in range(count):
            contour = vorn.fit(points, tol=TOL)
            contour.deviations(points)
            hash(contour)
            with pytest.raises(vorn.ContourError):
                vorn.fit(bad, tol=TOL)
            with pytest.raises(InterruptedError):
                vorn.fit(points, tol=TOL, progress=stop)

    rounds(1000)
    before, references = resident_pages(), sys.getrefcount(None)
    rounds(10_000)
    # A kilobyte of each fit would be 2,500 pages.
    assert resident_pages() - before < 500
    assert sys.getrefcount(None) - references < 100


@pytest.mark.thorough
@pytest.mark.skipif((os.cpu_count() or 1) < 2, reason="there is one processor")
def test_two_threads_fit_side_by_side():
    """Judged by the time of the processor against that of the clock, whatever else runs."""
    scans = [scan(seed) for seed in range(200)]

    def work(part):
        for points in part:
            vorn.fit(points, tol=TOL)

    threads = [threading.Thread(target=work, args=(scans[i::2],)) for i in range(2)]
    begin, used = time.perf_counter(), resource.getrusage(resource.RUSAGE_SELF)
    for thread in threads:
        thread.start()
    lone = []
    for thread in threads:
        thread.join()
        lone.append(time.perf_counter() - begin)
    after = resource.getrusage(resource.RUSAGE_SELF)
    processor = after.ru_utime + after.ru_stime - used.ru_utime - used.ru_stime
    # Behind one lock the processor could not be busy for longer than the clock runs.
    if os.getloadavg()[0] > os.cpu_count():
        pytest.skip(f"the machine is busy; {processor / lone[-1]:.2f} processors were used")
    assert processor / lone[-1] > 1.7
