"""What every public function makes of input that it cannot use: an error of the right type, and
never a crash or a wrong answer."""

import decimal
import math
import os

import numpy as np
import pytest
import vorn
import vorn.frame
from vorn import geometry as g

NAN, INF = math.nan, math.inf
CORNER = np.array([(0, 0), (1, 0), (2, 0), (3, 0), (3, 1), (3, 2), (3, 3)], dtype=float)
LINE = vorn.Contour.starting_at((0, 0)).append_line((3, 0))


def plotted(points):
    matplotlib = pytest.importorskip("matplotlib")
    matplotlib.use("Agg")
    figure = pytest.importorskip("matplotlib.figure").Figure()
    return vorn.plot(LINE, points=points, ax=figure.gca())


USES = {
    "fit": lambda points: vorn.fit(points, tol=0.01),
    "deviations": LINE.deviations,
    "signed deviations": lambda points: LINE.deviations(points, signed=True),
    "nearest": LINE.nearest,
    "to_svg": LINE.to_svg,
    "to_html": LINE.to_html,
    "to_png": LINE.to_png,
    "plot": plotted,
    "write_points": lambda points: vorn.write_points(os.devnull, points) or "written",
    "tolerance_per_point": lambda points: vorn.tolerance_per_point(points, cap=0.01),
    "create_fitting_curve": lambda points: g.create_fitting_curve(
        np.column_stack((points, np.full(len(points), 0.01)))),
}


@pytest.fixture(params=USES)
def use(request):
    return USES[request.param]


def masked(points):
    return np.ma.masked_array(points, mask=np.arange(points.size).reshape(points.shape) == 4)


@pytest.mark.parametrize("spoil, given", [
    (lambda p: p.astype(str), "texts"),
    (lambda p: p.astype(complex), "complex numbers"),
    (lambda p: p.astype("datetime64[s]"), "dates or times"),
    (lambda p: p.view([("x", float), ("y", float)])[:, 0], "records"),
    (lambda p: np.where(p == 3, "3", p.astype(object)), "value 6 is '3' of type str"),
    (lambda p: np.where(p == 3, None, p.astype(object)), "value 6 is None of type NoneType"),
    (lambda p: np.where(p == 3, 3j, p.astype(object)), "value 6 is 3j of type complex")])
@pytest.mark.parametrize("name", sorted(set(USES) - {"create_fitting_curve"}))
def test_the_error_tells_what_was_given(name, spoil, given):
    with pytest.raises(TypeError, match=given):
        USES[name](spoil(CORNER))


BATCHES = {
    "line_deviations": lambda p: g.line_deviations([0, 1, 0], p),
    "line_segments_intersections": lambda p: g.line_segments_intersections(
        np.resize(p, (3, 4)), np.resize(p, (3, 4))),
    "lines_intersections": lambda p: g.lines_intersections(np.resize(p, (3, 4))),
    "are_points_valid_to_fit": lambda p: g.are_points_valid_to_fit(np.resize(p, (4, 3))),
    "polygon_areas": lambda p: g.polygon_areas(p, [7]),
    "natural_angle_to_azimuth_rad": lambda p: g.natural_angle_to_azimuth_rad(p),
    "natural_angle_to_tangential_azimuth_rad":
        lambda p: g.natural_angle_to_tangential_azimuth_rad(p, True),
    "get_natural_angle": lambda p: g.get_natural_angle(p, 1.0),
    "get_outside_max": g.get_outside_max,
    "get_outside_min": g.get_outside_min,
    "get_area": lambda p: g.get_area(p.ravel(), [12]),
    "check_poly_self_intersection": lambda p: g.check_poly_self_intersection(p.ravel(), [12]),
    "linear_equation_system_solve": lambda p: g.linear_equation_system_solve(p[:2], [1, 2]),
    "right-hand side": lambda p: g.linear_equation_system_solve(np.eye(7), p[:, 0]),
    "Matrix": lambda p: g.Matrix(p.ravel()[:9]),
    "mxv": lambda p: g.Matrix().mxv(p.ravel()[:3]),
}


@pytest.mark.parametrize("name", BATCHES)
def test_operations_on_arrays_refuse_what_fits_refuse(name):
    assert BATCHES[name](CORNER + 1.0) is not None
    for wrong in (CORNER.astype(str), CORNER.astype(complex), CORNER.astype("timedelta64[s]"),
                  np.where(CORNER == 0, None, CORNER.astype(object))):
        with pytest.raises(TypeError):
            BATCHES[name](wrong)


@pytest.mark.parametrize("name", set(BATCHES) - {
    "line_segments_intersections", "lines_intersections", "are_points_valid_to_fit"})
def test_operations_on_arrays_refuse_masked_values(name):
    cut = np.ma.masked_array(CORNER + 1.0, mask=CORNER == 0)
    with pytest.raises(ValueError, match="masked"):
        BATCHES[name](cut)


@pytest.mark.parametrize("call", [
    lambda m: g.line_segments_intersections(m(4), np.eye(4)), lambda m: g.lines_intersections(m(4)),
    lambda m: g.are_points_valid_to_fit(m(3))])
def test_rows_with_masked_values_are_refused(call):
    with pytest.raises(ValueError, match="masked"):
        call(lambda width: np.ma.masked_array(np.ones((4, width)), mask=np.eye(4)[:, :width]))


def test_single_calls_refuse_masked_values():
    masked = np.ma.masked
    triple = np.ma.masked_array([1.0, 2.0, 0.1], mask=[False, True, False])
    for call in (lambda: g.get_deviation(1.0, 0.0, masked, 2.0, 2.0),
                 lambda: g.get_signed_deviation(1.0, 0.0, 0.0, masked, 2.0),
                 lambda: g.add_segm([], (masked, 1.0)),
                 lambda: g.add_segm([], np.ma.masked_array([1.0, 2.0], mask=[True, False])),
                 lambda: g.is_point_valid_to_fit((0.0, 0.0, 0.1), triple),
                 lambda: g.get_circle((0, 0, 0.1), (1, 1, 0.1), triple),
                 lambda: g.get_line_segments_intersection((0, 0, 1, masked), (0, 1, 1, 0))):
        with pytest.raises(ValueError, match="masked"):
            call()
    whole = np.ma.masked_array([1.0, 2.0, 0.1])
    assert g.is_point_valid_to_fit((0.0, 0.0, 0.1), whole)


@pytest.mark.parametrize("name, spoil", {
    "no points": lambda p: [],
    "no array": lambda p: 5,
    "text": lambda p: "abc",
    "texts": lambda p: p.astype(str),
    "dates": lambda p: p.astype("datetime64[s]"),
    "complex": lambda p: p.astype(complex),
    "one column": lambda p: p[:, :1],
    "four columns": lambda p: np.hstack((p, p)),
    "one dimension": lambda p: p.ravel(),
    "three dimensions": lambda p: p[None],
    "records": lambda p: p.view([("x", float), ("y", float)])[:, 0],
    "ragged": lambda p: [[0, 0], [1]],
    "objects that are no numbers": lambda p: np.array([[0, "a"], [1, 2]], dtype=object),
}.items())
def test_what_is_no_array_of_points_is_refused(use, name, spoil):
    with pytest.raises((TypeError, ValueError)):
        use(spoil(CORNER))


@pytest.mark.parametrize("value", [NAN, INF, -INF])
@pytest.mark.parametrize("name", sorted(set(USES) - {"create_fitting_curve"}))
def test_a_place_that_is_not_finite_is_named(name, value):
    points = CORNER.copy()
    points[4, 1] = value
    with pytest.raises(vorn.ContourError, match="point 4") as caught:
        USES[name](points)
    assert caught.value.indices == (4,)


@pytest.mark.parametrize("name", ["fit", "deviations", "signed deviations", "nearest", "to_svg",
                                  "plot", "write_points", "tolerance_per_point"])
def test_masked_points_are_refused(name):
    with pytest.raises(ValueError, match="masked"):
        USES[name](masked(CORNER))
    assert USES[name](np.ma.masked_array(CORNER)) is not None
    with pytest.raises(ValueError, match="masked"):
        vorn.fit(CORNER, tol=np.ma.masked_array(np.full(7, 0.01), mask=np.arange(7) == 2))


def read_only(points):
    points = points.copy()
    points.flags.writeable = False
    return points


@pytest.mark.parametrize("convert", [
    lambda p: p.astype(object), np.matrix, lambda p: p.astype(">f4"), read_only,
    lambda p: [[decimal.Decimal(x), decimal.Decimal(y)] for x, y in p], np.ma.masked_array,
    lambda p: np.repeat(np.repeat(p, 2, axis=0), 3, axis=1)[::2, ::3], lambda p: p.astype(np.int8)])
def test_numbers_of_every_kind_are_taken(convert):
    points = convert(CORNER)
    assert vorn.fit(points, tol=0.01) == vorn.fit(CORNER, tol=0.01)
    assert np.array_equal(LINE.deviations(points), LINE.deviations(CORNER))


def test_columns_of_a_frame_may_be_of_any_number_type():
    pandas = pytest.importorskip("pandas")
    frame = pandas.DataFrame({"x": CORNER[:, 0], "y": CORNER[:, 1]})
    expected = vorn.fit(CORNER, tol=0.01)
    for other in (frame.astype(object), frame.convert_dtypes(), frame.astype("Float64")):
        assert vorn.fit(other, tol=0.01) == expected
    holes = frame.convert_dtypes()
    holes.loc[3, "y"] = pandas.NA
    with pytest.raises(TypeError, match="y: value 3 is <NA> of type NAType"):
        vorn.fit(holes, tol=0.01)
    with pytest.raises(TypeError, match="value 7 is <NA>"):
        vorn.fit(holes.to_numpy(), tol=0.01)


@pytest.mark.parametrize("scale", [1e100, 1e-100])
def test_huge_and_tiny_points_have_finite_answers(scale):
    contour = vorn.fit(CORNER * scale, tol=0.01 * scale, strategy="fewest")
    assert len(contour) == 2 and contour.verdict == "within tolerance"
    assert contour.length == pytest.approx(6 * scale, rel=0.02)


@pytest.mark.parametrize("tol", ["0.01", 1j, object(), {}, [0.01] * 6, np.full((7, 1), 0.01), NAN,
                                 INF, 0, -1])
def test_a_tolerance_is_a_number_above_zero_or_one_for_each_point(tol):
    for use in (lambda: vorn.fit(CORNER, tol=tol), lambda: LINE.to_svg(CORNER, tol=tol)):
        with pytest.raises((TypeError, ValueError)):
            use()


@pytest.mark.parametrize("tol", [decimal.Decimal("0.01"), np.float32(0.01), np.full(7, 0.01),
                                 [0.01] * 7, np.array(0.01)])
def test_tolerances_of_every_kind_are_taken(tol):
    assert len(vorn.fit(CORNER, tol=tol)) == 2


def test_closed_may_be_a_truth_value_of_numpy(circle):
    assert vorn.fit(circle, tol=0.01, closed=np.True_).is_closed
    assert not vorn.fit(circle, tol=0.01, closed=np.False_).is_closed


@pytest.mark.parametrize("options", [
    {"progress": 5}, {"closed": 1}, {"start": 2**70}, {"start": 1.5}, {"strategy": 5},
    {"strategy": "fewest", "largest_step": NAN}, {"strategy": "fewest", "segments_only": "yes"},
    {"strategy": "fewest", "smallest_radius": 5, "largest_radius": 1}, {"start": 3}])
def test_options_that_are_none_are_refused(options):
    with pytest.raises((TypeError, ValueError)):
        vorn.fit(CORNER, tol=0.01, **options)


@pytest.mark.parametrize("path", ["", "no such file", "a\0b", b"no such file"])
def test_a_file_that_is_not_there_is_an_error(path):
    for read in (vorn.read_points, vorn.Contour.read):
        with pytest.raises(vorn.FileError):
            read(path)
    for read in (vorn.read_points, vorn.Contour.read):
        with pytest.raises(TypeError):
            read(5)


@pytest.mark.parametrize("content", [b"", b"x,y\n", b"\0\1\2", b"\xff\xfe", b"x,y\n1\n"])
def test_a_file_without_points_is_an_error(tmp_path, content):
    path = tmp_path / "points.csv"
    path.write_bytes(content)
    with pytest.raises(vorn.FileError):
        vorn.read_points(path)
    with pytest.raises(vorn.FileError):
        vorn.Contour.read(path)


@pytest.mark.parametrize("place", [(NAN, 0), (0, INF), (1,), (1, 2, 3), 5, "ab", None])
def test_a_place_is_two_finite_numbers(place):
    for make in (vorn.Contour.starting_at, LINE.append_line,
                 lambda p: LINE.append_arc(p, center=(4, 0), ccw=True),
                 lambda p: LINE.append_arc((5, 0), center=p, ccw=True),
                 lambda p: vorn.Contour([vorn.Line((0, 0), p)])):
        with pytest.raises((TypeError, ValueError)):
            make(place)


@pytest.mark.parametrize("arc", [
    vorn.Arc((0, 0), (1, 1), (0, 1), -1.0, True, 1.0),
    vorn.Arc((0, 0), (1, 1), (0, 1), NAN, True, 1.0),
    vorn.Arc((0, 0), (1, 1), (0, 1), 1.0, True, NAN),
    vorn.Arc((0, 0), (1, 1), (0, 1), 1.0, True, -1.0),
    vorn.Arc((0, 0), (1, 1), (0, 0), 1.0, True, 1.0)])
def test_an_arc_has_a_radius_and_a_sweep(arc):
    with pytest.raises(vorn.ContourError) as caught:
        vorn.Contour([arc])
    assert caught.value.code is vorn.ErrorCode.INVALID_ARC_RADIUS
    with pytest.raises(vorn.ContourError, match="radius"):
        LINE.append_arc((3, 0), center=(3, 0), ccw=True)


def test_a_piece_knows_its_points_again():
    pieces = [vorn.Line((0, 0), (1, 0), (0, 4)), vorn.Line((1, 0), (1, 1))]
    assert [piece.points for piece in vorn.Contour(pieces)] == [(0, 4), None]
    for wrong in (5, "line", (0, 0)):
        with pytest.raises(TypeError, match="Line and Arc"):
            vorn.Contour([wrong])


@pytest.mark.parametrize("shift", [(NAN, 0), (0, INF), (1.7e308, 0)])
def test_a_shift_keeps_the_contour_finite(shift):
    far = vorn.Contour.starting_at((0, 0)).append_line((1.7e308, 0))
    with pytest.raises(vorn.ContourError):
        far.shifted(*shift)


@pytest.mark.parametrize("draw", ["to_svg", "to_html", "to_png"])
def test_there_is_no_drawing_of_nothing(draw):
    with pytest.raises(vorn.ContourError, match="no pieces"):
        getattr(vorn.Contour(), draw)()
    for magnify in (0, -1, NAN, INF):
        with pytest.raises(ValueError, match="magnify"):
            getattr(LINE, draw)([(1, 0)], tol=0.1, magnify=magnify)
    with pytest.raises(TypeError):
        getattr(LINE, draw)(colour="red")


@pytest.mark.parametrize("name", ["json", "csv", "dxf", "wkt", "gcode"])
def test_there_is_no_text_of_nothing(name):
    with pytest.raises(vorn.ContourError):
        vorn.Contour().to_text(name)


@pytest.mark.parametrize("name", ["json", "csv", "dxf", "wkt", "gcode"])
@pytest.mark.parametrize("text", ["", "[" * 100_000, "\0", "\ud7ff", "nan inf", "0\n" * 1000])
def test_mangled_text_holds_no_contour(name, text):
    with pytest.raises(vorn.ContourError):
        vorn.Contour.from_text(text, name)


def test_saving_fails_whole(tmp_path):
    with pytest.raises(OSError):
        LINE.save(tmp_path / "no folder" / "line.json")
    with pytest.raises(TypeError):
        LINE.save(tmp_path / "line.json", colour="red")
    with pytest.raises(ValueError):
        LINE.save(tmp_path / "line")
    assert list(tmp_path.iterdir()) == []


@pytest.mark.parametrize("options, error", [
    ({"workers": 0}, ValueError), ({"workers": -1}, ValueError), ({"batch": -1}, ValueError)])
def test_numbers_of_workers_are_above_zero(options, error):
    with pytest.raises(error):
        vorn.fit_many([], **options)
    with pytest.raises(TypeError):
        list(vorn.fit_many(5))


def test_frames_need_their_columns():
    pandas = pytest.importorskip("pandas")
    frame = pandas.DataFrame({"scan": [1, 1, None], "x": [0, 1, 2], "y": ["a", "b", "c"]})
    with pytest.raises(KeyError):
        vorn.frame.fit(frame, by="no such column", tol=0.1)
    with pytest.raises(KeyError):
        vorn.frame.fit(frame, x="no such column", tol=0.1)
    failed = vorn.frame.fit(frame, tol=0.1)
    assert failed["error"].notna().all() and failed["piece"].tolist() == [-1]
    assert failed[["start_x", "end_y", "length"]].isna().all(axis=None)


@pytest.mark.parametrize("call", [
    lambda: g.line_deviations(None, [(1, 1)]), lambda: g.line_deviations([0, 1j, 0], [(1, 1)]),
    lambda: g.line_segments_intersections("ab", "cd"), lambda: g.lines_intersections(5),
    lambda: g.are_points_valid_to_fit([[1, 2], [3]]), lambda: g.polygon_areas([(0, 0)], [0.5]),
    lambda: g.linear_equation_system_solve([[1, 2]], [1]), lambda: g.get_elem_point([5]),
    lambda: g.split_elem(g.Elem.segment((1, 0)), 2**40, (0, 0)), lambda: g.Matrix("abc"),
    lambda: g.create_fitting_curve([(0, 0, 0.1), (1, 1, 0.1)], strategy="mixed"),
    lambda: g.get_circle((0, 0), (1, 0), (2, 1)), lambda: g.get_deviation("a", 1, 2, 3, 4),
    lambda: g.shift_elem(None, (0, 0)), lambda: g.add_segm([], (1, 2, 3)),
    lambda: g.get_area([0.0] * 10, [-2**31]), lambda: g.get_area([0.0] * 3, [5]),
    lambda: g.check_poly_self_intersection([0.0] * 10, [2**31 - 1]),
    lambda: g.get_line_polygon((NAN, 0, 0), (1, 0, 0)),
    lambda: g.get_circle_polygon([(NAN, 0, 0)] * 3)])
def test_operations_of_the_core_refuse_what_they_cannot_use(call):
    with pytest.raises((TypeError, ValueError)):
        call()


def test_not_a_number_goes_through_the_elementary_operations():
    assert np.isnan(g.line_deviations([0, 1, NAN], [(1, 1)])).all()
    assert math.isnan(g.get_area([NAN] * 10, [8]))
    assert math.isnan(g.Matrix(np.full((3, 3), NAN)).det())
    assert g.get_outside_max([NAN, INF]).tolist() == [-2**31] * 2
