"""Python and the program give the same bits."""

import json
import subprocess

import numpy as np
import pytest
import vorn

STRATEGIES = ["fewest", "mixed", "cells", "arc"]

# Tolerances that suit the measured contours; a tuple is a cap for tolerances by the spacing.
SHARED = {"rail_head_known_arcs": 0.01, "wheel_worn_a": 0.03, "rail_worn_low": 0.025,
          "mirror_sphere_83m": 0.00005, "hatch_boundary": 0.002, "glyph_five": (2.0,),
          "gcode_letter_d": 0.015, "airfoil_clark_y": 0.0004, "circle_r3": 0.001,
          "test_track_centreline": (0.03,)}

#: What has no fit: shapes that are no single arc, and runs that "cells" has no shape for. Of the
#: others some have a contour that leaves the tolerance, which is compared as well.
REFUSED = {("rail_head_known_arcs", "cells"), ("wheel_worn_a", "arc"), ("rail_worn_low", "cells"),
           ("hatch_boundary", "cells"), ("hatch_boundary", "arc"), ("glyph_five", "cells"),
           ("glyph_five", "arc"), ("gcode_letter_d", "arc"), ("airfoil_clark_y", "arc")}


def with_tolerances(path, tol):
    points = vorn.read_points(path)[:, :2]
    if not isinstance(tol, tuple):
        return np.column_stack((points, np.full(len(points), tol)))
    steps = np.hypot(*np.diff(points, axis=0).T)
    # The last point of a closed contour is the first one again, so both have the same neighbours.
    outside = steps[[-1, 0]] if np.array_equal(points[0], points[-1]) else [np.inf, np.inf]
    nearer = np.minimum(np.append(steps, outside[1]), np.append(outside[0], steps))
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


def program_fit(program, points, folder, strategy):
    """The contour that the program writes, or the number that it ends with."""
    path, out = folder / "points.csv", folder / "contour.json"
    path.write_text("x,y,w\n" + "".join(f"{x!r},{y!r},{w!r}\n" for x, y, w in points.tolist()))
    out.unlink(missing_ok=True)
    done = subprocess.run([program, "fit", path, "--strategy", strategy, "-o", out],
                          capture_output=True, text=True, check=False)
    return json.loads(out.read_text()) if out.exists() else done.returncode


def compare_with_program(program, points, folder, strategy):
    """Whether there is a contour, after it was compared."""
    expected = program_fit(program, points, folder, strategy)
    try:
        contour = vorn.fit(points, strategy=strategy)
    except vorn.ContourError as error:
        assert expected == EXIT_CODES[type(error)]
        return False
    assert_same_bits(contour, expected)
    return True


@pytest.mark.parametrize("strategy", STRATEGIES)
def test_the_examples_have_the_bits_of_the_program(program, examples, tmp_path, strategy):
    for path in sorted(examples.glob("*.csv")):
        compare_with_program(program, vorn.read_points(path), tmp_path, strategy)


@pytest.mark.parametrize("strategy", STRATEGIES)
@pytest.mark.parametrize("name", SHARED)
def test_measured_contours_have_the_bits_of_the_program(program, shared, tmp_path, name, strategy):
    points = with_tolerances(shared / f"{name}.csv", SHARED[name])
    fitted = compare_with_program(program, points, tmp_path, strategy)
    assert fitted == ((name, strategy) not in REFUSED)


@pytest.mark.parametrize("turn", [0.4, 1.0, -1.5])
def test_one_arc_has_the_bits_of_the_program(program, tmp_path, turn):
    angles = np.linspace(0.3, 0.3 + turn, 50)
    noise = np.random.default_rng(11).normal(0, 0.002, (50, 2))
    places = np.column_stack((40 * np.cos(angles), 40 * np.sin(angles))) + noise
    points = np.column_stack((places, np.full(50, 0.01)))
    assert compare_with_program(program, points, tmp_path, "arc")
