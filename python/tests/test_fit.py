"""Fitting: strategies, closing, progress, failures."""

import signal
import threading
import _thread
import warnings

import numpy as np
import pytest
import vorn


def test_a_corner_is_two_lines(corner):
    contour = vorn.fit(corner, tol=0.01)
    assert [type(piece) for piece in contour] == [vorn.Line, vorn.Line]
    assert [contour[0].start, contour[0].end, contour[1].end] == [
        pytest.approx(place, abs=1e-15) for place in [(0, 0), (3, 0), (3, 3)]]
    assert contour.verdict == "within tolerance"
    assert contour.max_deviation == pytest.approx(0, abs=1e-12)
    assert not contour.is_closed


def test_a_circle_is_two_half_circles(circle):
    contour = vorn.fit(circle, tol=0.01)
    assert contour.is_closed
    assert [type(piece) for piece in contour] == [vorn.Arc, vorn.Arc]
    for arc in contour:
        assert arc.radius == pytest.approx(10, abs=1e-9)
        assert arc.center == pytest.approx((0, 0), abs=1e-9)
        assert arc.ccw
    assert contour.length == pytest.approx(20 * np.pi)
    assert contour.area == pytest.approx(100 * np.pi)


@pytest.mark.parametrize("closed", [False, "no"])
def test_closed_can_be_denied(circle, closed):
    assert not vorn.fit(circle, tol=0.01, closed=closed).is_closed


@pytest.mark.parametrize("closed", [True, "yes"])
def test_closed_can_be_demanded(corner, closed):
    contour = vorn.fit(corner, tol=0.01, closed=closed)
    assert contour.is_closed
    assert contour[-1].end == contour[0].start
    assert abs(contour.area) == pytest.approx(4.5)


@pytest.mark.parametrize("strategy", ["fewest", "mixed", "cells"])
def test_every_strategy_keeps_the_tolerance(examples, strategy):
    points = vorn.read_points(examples / "gear_tooth.csv")
    contour = vorn.fit(points, strategy=strategy)
    assert contour.strategy == strategy
    assert contour.verdict == "within tolerance"
    relative = contour.deviations(points) / points[:, 2]
    assert relative.max() <= 1 + 1e-6
    assert relative.max() <= contour.max_deviation <= 1 + 1e-6


def test_the_fewest_pieces_are_proven(corner):
    contour = vorn.fit(corner, tol=0.01, strategy="fewest")
    assert len(contour) == contour.fewest_possible == 2
    assert vorn.fit(corner, tol=0.01, strategy="mixed").fewest_possible is None


def test_the_fewest_pieces_need_no_spacing(corner):
    dense = np.repeat(corner, 3, axis=0) + np.tile([(0, 0), (0.001, 0), (0, 0.001)], (7, 1))
    assert len(vorn.fit(dense, tol=0.01, strategy="fewest")) == 2
    with pytest.raises(vorn.PointsTooCloseError):
        vorn.fit(dense, tol=0.01, strategy="mixed")


def test_a_closed_contour_of_the_fewest_pieces(circle):
    contour = vorn.fit(circle, tol=0.01, strategy="fewest")
    assert contour.is_closed and contour.start == contour.end
    assert len(contour) == 2 and contour.verdict == "within tolerance"


def test_the_options_of_the_fewest_pieces():
    angles = np.linspace(0, 2, 60)
    bend = np.column_stack((10 * np.cos(angles), 10 * np.sin(angles)))
    assert len(vorn.fit(bend, tol=0.01, strategy="fewest")) == 1
    straight = vorn.fit(bend, tol=0.01, strategy="fewest", segments_only=True)
    assert len(straight) > 5 and not straight.as_arrays()["is_arc"].any()
    for options in ({"largest_radius": 9.0}, {"smallest_radius": 11.0}):
        contour = vorn.fit(bend, tol=0.01, strategy="fewest", **options)
        assert all(options.get("smallest_radius", 0) <= piece.radius
                   <= options.get("largest_radius", np.inf)
                   for piece in contour if isinstance(piece, vorn.Arc))
    for effort in ("quick", "wide", "full"):
        assert len(vorn.fit(bend, tol=0.01, strategy="fewest", effort=effort)) == 1
    for wrong in ({"largest_step": -1.0}, {"smallest_radius": -1.0}):
        with pytest.raises(vorn.ContourError):
            vorn.fit(bend, tol=0.01, strategy="fewest", **wrong)
    with pytest.raises(ValueError):
        vorn.fit(bend, tol=0.01, strategy="fewest", effort="lazy")
    with pytest.raises(TypeError):
        vorn.fit(bend, tol=0.01, strategy="fewest", largest_step="wide")


def test_the_strategy_arc_is_one_arc():
    angles = np.linspace(0.2, 1.9, 40)
    points = np.column_stack((5 * np.cos(angles) + 1, 5 * np.sin(angles) - 2))
    contour = vorn.fit(points, tol=0.01, strategy="arc")
    assert len(contour) == 1
    assert contour[0].radius == pytest.approx(5)
    assert contour[0].center == pytest.approx((1, -2))


def test_pieces_tell_the_points_that_they_cover(corner):
    assert [piece.points for piece in vorn.fit(corner, tol=0.01)] == [(0, 2), (3, 6)]


def test_start_is_the_seam_of_a_closed_contour():
    t = np.arange(40) / 10
    side = np.column_stack((t, np.zeros_like(t)))
    turn = np.array([[0, 1], [-1, 0]])
    points = np.vstack([side, side @ turn + (4, 0), side @ turn @ turn + (4, 4),
                        side @ turn @ turn @ turn + (0, 4)])
    contour = vorn.fit(points, tol=0.01, strategy="mixed", start=40)
    assert contour.start == pytest.approx((4, 0), abs=0.01)
    assert len(contour) == 4


@pytest.mark.parametrize("options, error", [
    ({"strategy": "best"}, ValueError),
    ({"closed": "maybe"}, ValueError),
    ({"start": "here"}, TypeError),
    ({"start": -1}, TypeError),
    ({"colour": "red"}, TypeError),
])
def test_wrong_options_are_refused(corner, options, error):
    with pytest.raises(error):
        vorn.fit(corner, tol=0.01, **options)


def test_points_too_close_are_named(corner):
    corner[4] = (3, 0.02)
    with pytest.raises(vorn.PointsTooCloseError) as caught:
        vorn.fit(corner, tol=0.01, strategy="mixed")
    assert caught.value.indices == (3, 4)
    assert caught.value.code is vorn.ErrorCode.POINTS_TOO_CLOSE
    assert (caught.value.distance, caught.value.needed) == (0.02, 1.5 * (0.01 + 0.01))


def test_distances_of_points_too_close_read_well(corner):
    def message(points, tol):
        with pytest.raises(vorn.PointsTooCloseError) as caught:
            vorn.fit(points, tol=tol, strategy="mixed")
        return str(caught.value)

    assert message([(0, 0), (0.1, 0), (2, 0)], 0.1).startswith(
        "points 0 and 1 are 0.1 apart, which must be more than 0.3 for their tolerances;")
    assert "are 0.2999999 apart, which must be more than 0.3 " in message(
        [(0, 0), (0.2999999, 0), (2, 0)], 0.1)
    with pytest.raises(vorn.PointsTooCloseError, match="lie in one place") as caught:
        vorn.fit([(0, 0), (1, 0), (1, 0)], tolerance_per_point=0.1)
    assert caught.value.indices == (1, 2)


@pytest.mark.parametrize("closing", [[], [(10, 0, 1e-6)]])
def test_points_too_close_across_the_seam_are_named(circle, closing):
    points = np.column_stack((circle, np.full(90, 0.01)))
    points = np.vstack((points, [(10, -0.002, 1e-6)], *closing))
    with pytest.raises(vorn.PointsTooCloseError, match='"fewest"') as caught:
        vorn.fit(points, strategy="mixed", closed=True)
    assert caught.value.indices == (90, 0)
    assert "--" not in str(caught.value)


def test_points_that_are_no_arc_name_the_worst(corner):
    with pytest.raises(vorn.NoFitError, match="no single arc") as caught:
        vorn.fit(corner, tol=0.0001, strategy="arc")
    error = caught.value
    # By hand: the circle of least squares of a corner of equal legs passes its middle point worst.
    assert error.code is vorn.ErrorCode.NO_FIT and error.indices == (3,)
    assert "point 3 is " in str(error) and "code" not in str(error)
    zigzag = [(0, 0), (1, 1), (2, 0), (3, 1), (4, 0)]
    with pytest.raises(vorn.NoFitError, match="no single arc"):
        vorn.fit(zigzag, tolerance_per_point=0.01, strategy="arc")


def test_the_first_point_without_a_shape_is_named(shared):
    points = vorn.read_points(shared / "rail_worn_low.csv")[:, :2]
    with pytest.raises(vorn.NoFitError, match="not with point 56;") as caught:
        vorn.fit(points, tol=0.025, strategy="cells")
    assert caught.value.indices == (56,)
    assert len(vorn.fit(points[:56], tol=0.025, strategy="cells", closed=False)) > 0
    with pytest.raises(vorn.NoFitError):
        vorn.fit(points[:57], tol=0.025, strategy="cells", closed=False)


def test_points_in_one_place_have_no_fit():
    with pytest.raises(vorn.NoFitError, match="all points coincide within their tolerances"):
        vorn.fit([(1, 1), (1, 1.001)], tol=0.01, strategy="fewest")


def test_a_tolerance_that_takes_long_is_warned_of():
    points = np.column_stack((np.arange(20.0), np.zeros(20)))
    with pytest.warns(UserWarning, match="tolerance of point 0, 1e-09, is less than 1e-08") as told:
        vorn.fit(points, tol=1e-9, strategy="mixed")
    assert told[0].filename == __file__
    with warnings.catch_warnings():
        warnings.simplefilter("error")
        vorn.fit(points, tol=1e-9, strategy="fewest")
        with pytest.raises(UserWarning):
            vorn.fit(points, tol=1e-9, strategy="mixed")


def test_progress_rises_to_its_end(examples):
    told = []
    vorn.fit(vorn.read_points(examples / "gear_tooth.csv"), progress=told.append)
    assert told == sorted(set(told))
    assert 1 <= told[0] and told[-1] == 100


class Bar:
    """What of a tqdm bar is used."""

    def __init__(self, total=None):
        self.n = 0
        self.total = total
        self.is_open = True
        Bar.latest = self

    def update(self, by):
        assert by > 0
        self.n += by

    def close(self):
        self.is_open = False


def test_a_bar_is_filled(corner):
    bar = Bar(100)
    vorn.fit(corner, tol=0.01, progress=bar)
    assert bar.n == 100 and bar.is_open
    vorn.fit(corner, tol=0.01, progress=bar)
    assert bar.n == 200


def test_a_class_of_bars_is_made_and_closed(corner):
    vorn.fit(corner, tol=0.01, progress=Bar)
    assert (Bar.latest.total, Bar.latest.n, Bar.latest.is_open) == (100, 100, False)


def test_tqdm_works(corner, capsys):
    tqdm = pytest.importorskip("tqdm")
    vorn.fit(corner, tol=0.01, progress=tqdm.tqdm)
    assert "100%" in capsys.readouterr().err


@pytest.mark.parametrize("error", [KeyboardInterrupt, ZeroDivisionError, SystemExit])
def test_what_progress_raises_comes_out(examples, error):
    points = vorn.read_points(examples / "gear_tooth.csv")

    def stop(percent):
        if percent >= 30:
            raise error("enough")

    with pytest.raises(error, match="enough"):
        vorn.fit(points, progress=stop)
    assert len(vorn.fit(points)) > 0


@pytest.fixture
def keyboard():
    """Interruptions as a terminal brings them; a job in the background may have been told to
    ignore them."""
    before = signal.signal(signal.SIGINT, signal.default_int_handler)
    yield
    signal.signal(signal.SIGINT, before)


def test_an_interruption_ends_a_fit(keyboard):
    t = np.arange(20000.0)
    wave = np.column_stack((t, 50 * np.sin(t / 300)))
    timer = threading.Timer(0.2, _thread.interrupt_main)
    timer.start()
    with pytest.raises(KeyboardInterrupt):
        for _ in range(1000):
            vorn.fit(wave, tol=0.01, strategy="mixed")
    timer.join()
