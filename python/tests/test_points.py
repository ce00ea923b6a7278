"""What fit and read_points take as points."""

import collections
import copy
import pickle
import subprocess
import tracemalloc

import numpy as np
import pytest
import vorn


def test_a_third_column_holds_the_tolerances(corner):
    with_tolerances = np.column_stack((corner, np.full(len(corner), 0.01)))
    assert vorn.fit(with_tolerances) == vorn.fit(corner, tol=0.01)


def test_tol_goes_before_the_third_column(corner):
    with_tolerances = np.column_stack((corner, np.full(len(corner), 100.0)))
    assert vorn.fit(with_tolerances, tol=0.01) == vorn.fit(corner, tol=0.01)


def test_each_point_may_have_its_own_tolerance(corner):
    wide = np.full(len(corner), 0.01)
    moved = corner.copy()
    moved[1, 1] = 0.2
    wide[1] = 0.25
    assert vorn.fit(moved, tol=wide).verdict == "within tolerance"
    assert len(vorn.fit(moved, tol=wide)) < len(vorn.fit(moved, tol=0.01))


@pytest.mark.parametrize("dtype", [np.float64, np.float32, np.float16, np.longdouble, np.int32,
                                   np.uint8, ">f8"])
def test_every_number_type_gives_the_same(corner, dtype):
    assert vorn.fit(corner.astype(dtype), tol=0.01) == vorn.fit(corner, tol=0.01)


@pytest.mark.parametrize("strided", [
    lambda p: np.asfortranarray(p),
    lambda p: np.repeat(p, 2, axis=0)[::2],
    lambda p: p[::-1].copy()[::-1],
    lambda p: np.column_stack((p[:, 1], p[:, 0]))[:, ::-1],
    lambda p: np.broadcast_to(p, (3, *p.shape))[1],
    lambda p: p.tolist(),
    lambda p: tuple(map(tuple, p)),
    lambda p: memoryview(np.ascontiguousarray(p)),
])
def test_every_layout_gives_the_same(corner, strided):
    assert vorn.fit(strided(corner), tol=0.01) == vorn.fit(corner, tol=0.01)


@pytest.mark.parametrize("convert", [
    lambda p: p, lambda p: p.astype(np.float32), np.asfortranarray, lambda p: p[::-1],
    lambda p: np.repeat(p, 2, axis=0)[::2], lambda p: p.astype(np.int64)])
def test_points_are_copied_once(convert):
    """Into the memory of the library: NumPy makes no array of the size of the points."""
    points = convert(np.column_stack((np.arange(50_000.0), np.zeros(50_000))))
    tracemalloc.start()
    try:
        contour = vorn.fit(points, tol=0.01, strategy="fewest", closed=False)
        peak = tracemalloc.get_traced_memory()[1]
    finally:
        tracemalloc.stop()
    assert len(contour) == 1 and peak < points.nbytes / 4


def test_points_are_not_changed(corner):
    before = corner.copy()
    corner.flags.writeable = False
    vorn.fit(corner, tol=0.01)
    assert np.array_equal(before, corner)


def test_a_pandas_frame_is_taken_by_its_columns(corner):
    pandas = pytest.importorskip("pandas")
    frame = pandas.DataFrame({"w": 0.01, "y": corner[:, 1], "other": "a", "x": corner[:, 0]})
    assert vorn.fit(frame) == vorn.fit(corner, tol=0.01)
    assert vorn.fit(frame[["x", "y"]], tol=0.01) == vorn.fit(corner, tol=0.01)
    with pytest.raises(ValueError, match="no column 'x'"):
        vorn.fit(frame.rename(columns={"x": "X"}))


def test_a_frame_needs_no_pandas(corner):
    class Frame(dict):
        @property
        def columns(self):
            return list(self)

        def __len__(self):
            return len(corner)

    frame = Frame(x=corner[:, 0], y=corner[:, 1])
    assert vorn.fit(frame, tol=0.01) == vorn.fit(corner, tol=0.01)


@pytest.mark.parametrize("points, tol, error", [
    ([], 0.1, ValueError),
    ([(1, 2)], 0.1, vorn.ContourError),
    ([(1, 2, 3, 4), (5, 6, 7, 8)], 0.1, ValueError),
    ([1, 2, 3], 0.1, ValueError),
    ([("a", "b"), ("c", "d")], 0.1, (TypeError, ValueError)),
    ([(1j, 0), (1, 0)], 0.1, TypeError),
    (None, 0.1, TypeError),
    ([(0, 0), (1, 0)], None, vorn.ContourError),
    ([(0, 0), (1, 0)], 0, vorn.ContourError),
    ([(0, 0), (1, 0)], -1, vorn.ContourError),
    ([(0, 0), (1, 0)], float("nan"), vorn.ContourError),
    ([(0, 0), (1, 0)], float("inf"), vorn.ContourError),
    ([(0, 0), (1, 0)], [0.1, 0.1, 0.1], ValueError),
    ([(0, 0), (1, 0)], "wide", (TypeError, ValueError)),
])
def test_what_cannot_be_points_is_refused(points, tol, error):
    with pytest.raises(error):
        vorn.fit(points, tol=tol)


@pytest.mark.parametrize("value", [float("nan"), float("inf"), float("-inf")])
@pytest.mark.parametrize("column", [0, 1])
def test_a_value_that_is_no_place_is_named(corner, value, column):
    corner[4, column] = value
    with pytest.raises(vorn.ContourError, match="point 4") as caught:
        vorn.fit(corner, tol=0.01)
    assert caught.value.indices == (4,)


def test_named_tuples_are_points():
    point = collections.namedtuple("point", "x y w")
    contour = vorn.fit([point(0, 0, 0.01), point(1, 0, 0.01), point(2, 0, 0.01)])
    assert [piece.end for piece in contour] == [pytest.approx((2, 0), abs=1e-15)]


def test_read_points_reads_what_the_program_reads(tmp_path):
    path = tmp_path / "scan.csv"
    path.write_text("# units mm\nX;Z;w\n0,5;1;0,01\n\n2;3;0,02\n")
    points = vorn.read_points(path)
    assert points.tolist() == [[0.5, 1, 0.01], [2, 3, 0.02]]
    assert vorn.read_points(str(path), columns="Z,X").tolist() == [
        [1, 0.5, 0.01], [3, 2, 0.02]]


def test_read_points_takes_the_tolerance_of_a_comment(tmp_path):
    path = tmp_path / "scan.csv"
    path.write_text("# tolerance 0.25\nx,y\n0,1\n2,3\n")
    assert vorn.read_points(path).tolist() == [[0, 1, 0.25], [2, 3, 0.25]]


def test_an_error_in_a_file_names_the_place(tmp_path):
    path = tmp_path / "scan.csv"
    path.write_text("x,y\n0,1\n2,abc\n")
    with pytest.raises(vorn.FileError, match="abc") as caught:
        vorn.read_points(path)
    assert (caught.value.path, caught.value.line, caught.value.column) == (str(path), 3, 3)


def test_a_missing_file_is_an_os_error(tmp_path):
    with pytest.raises(OSError, match="no.csv"):
        vorn.read_points(tmp_path / "no.csv")


def test_points_know_their_unit(tmp_path):
    path = tmp_path / "scan.csv"
    path.write_text("X [mm];Z [mm]\n0;1\n2;3\n4;5,5\n")
    points = vorn.read_points(path)
    assert isinstance(points, np.ndarray) and points.units == "mm"
    for part in (points[1:], points[:, 0], points.copy(), pickle.loads(pickle.dumps(points)),
                 copy.deepcopy(points), points.T):
        assert part.units == "mm" and np.array_equal(points[1:], np.asarray(points)[1:])
    for computed in (points * 2, points + points, np.hypot(*points.T), points.max(axis=0)):
        assert type(computed) is np.ndarray
    assert isinstance(points.max(), float) and not isinstance(points.max(), np.ndarray)
    contour = vorn.fit(points, tol=0.01)
    assert contour.units == "mm"
    assert vorn.fit(points, tol=0.01, units="inch").units == "inch"
    assert contour == vorn.fit(np.asarray(points), tol=0.01)
    assert vorn.fit(np.asarray(points), tol=0.01).units == ""
    result, = vorn.fit_many([path], tol=0.01)
    assert result.contour.units == "mm"
    assert "(mm)" in contour.to_svg() or "mm" in contour.to_svg()
    assert vorn.Contour.from_json(contour.to_json()).units == "mm"


def test_other_units_attributes_are_not_taken_for_one():
    class Quantities(np.ndarray):
        units = object()

    points = np.array([(0.0, 0), (1, 0)]).view(Quantities)
    assert vorn.fit(points, tol=0.1).units == ""


def test_a_column_of_tolerances_has_any_name(tmp_path):
    path = tmp_path / "scan.csv"
    path.write_text("x,y,w,limit\n0,1,9,0.5\n2,3,9,0.25\n")
    assert vorn.read_points(path, tolerance_column="limit")[:, 2].tolist() == [0.5, 0.25]
    assert vorn.read_points(path, tolerance_column="4")[:, 2].tolist() == [0.5, 0.25]
    with pytest.raises(vorn.FileError):
        vorn.read_points(path, tolerance_column="no such")
    with pytest.raises(TypeError):
        vorn.read_points(path, colour="red")


def test_drawings_are_points_as_well(tmp_path):
    two = tmp_path / "two.wkt"
    two.write_text("MULTILINESTRING ((0 0, 1 0, 2 0), (5 5, 6 5))")
    assert [part.tolist() for part in vorn.read_outlines(two)] == [
        [[0, 0], [1, 0], [2, 0]], [[5, 5], [6, 5]]]
    with pytest.raises(vorn.FileError, match="holds 2 outlines"):
        vorn.read_points(two)
    bend = tmp_path / "bend.txt"
    bend.write_text("CIRCULARSTRING (0 0, 1 1, 2 0)")
    with pytest.raises(vorn.FileError):
        vorn.read_points(bend, format="wkt")
    points = vorn.read_points(bend, format="wkt", flatten=0.01)
    assert len(points) > 5 and np.abs(np.hypot(points[:, 0] - 1, points[:, 1]) - 1).max() < 1e-12
    for wrong in ({"format": "word"}, {"flatten": 0}, {"flatten": float("nan")}):
        with pytest.raises(ValueError):
            vorn.read_points(bend, **wrong)


def test_written_points_come_back_in_every_bit(tmp_path, program):
    path = tmp_path / "scan.csv"
    points = np.random.default_rng(3).normal(size=(50, 3)) * 10.0 ** np.arange(-20, 30)[:, None]
    points[:, 2] = np.abs(points[:, 2])
    vorn.write_points(path, points, units="mm")
    again = vorn.read_points(path)
    assert np.array_equal(again, points) and again.units == "mm"
    vorn.write_points(path, again[:, :2])
    assert vorn.read_points(path).shape == (50, 2) and vorn.read_points(path).units == "mm"
    vorn.write_points(path, points[:, :2], tol=0.25)
    assert vorn.read_points(path)[:, 2].tolist() == [0.25] * 50
    assert subprocess.run([program, "info", path], capture_output=True, check=False).returncode == 0
    with pytest.raises(vorn.ContourError, match="point 1"):
        vorn.write_points(path, [(0, 0), (0, np.nan)])


def test_tolerances_follow_the_spacing(corner, program, tmp_path):
    steps = np.array([(0, 0), (1, 0), (1.5, 0), (4, 0), (4, 2)], dtype=float)
    assert vorn.tolerance_per_point(steps, cap=0.2) == pytest.approx([0.2, 0.15, 0.15, 0.2, 0.2])
    closed = vorn.tolerance_per_point(steps + [(0, 0)] * 5, cap=9.0, closed=True)
    assert closed == pytest.approx([0.3, 0.15, 0.15, 0.6, 0.6])
    assert vorn.fit(steps, tolerance_per_point=0.2) == vorn.fit(
        steps, tol=vorn.tolerance_per_point(steps, cap=0.2))
    path, out = tmp_path / "steps.csv", tmp_path / "steps.json"
    vorn.write_points(path, steps)
    subprocess.run([program, "fit", path, "--tolerance-per-point", "0.2", "-o", out], check=True,
                   capture_output=True)
    assert vorn.Contour.read(out) == vorn.fit(steps, tolerance_per_point=0.2)
    with pytest.raises(TypeError, match="both"):
        vorn.fit(steps, tol=0.1, tolerance_per_point=0.2)
    for cap in (0, -1, np.nan, np.inf):
        with pytest.raises(ValueError):
            vorn.fit(steps, tolerance_per_point=cap)
        with pytest.raises(ValueError):
            vorn.tolerance_per_point(steps, cap)
    with pytest.raises(vorn.PointsTooCloseError):
        vorn.tolerance_per_point([(0, 0), (0, 0), (1, 0)], cap=1)


@pytest.mark.parametrize("columns", ["x", "x,x", "1,2,3,4", ","])
def test_columns_must_be_two_or_three(tmp_path, columns):
    path = tmp_path / "scan.csv"
    path.write_text("x,y\n0,1\n2,3\n")
    with pytest.raises(ValueError, match="columns"):
        vorn.read_points(path, columns=columns)
