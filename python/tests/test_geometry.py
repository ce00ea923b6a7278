"""The operations of the core, one by one. Expected values are worked out by hand or by NumPy."""

import math
import pickle

import numpy as np
import pytest
import vorn
from vorn import geometry as g

NAN = math.nan
SQUARE = [g.Elem.segment(p) for p in [(0, 0), (0, 2), (2, 2), (2, 0), (0, 0)]]


def test_angles():
    assert g.get_natural_angle(-1.0, 0.0) == pytest.approx(math.pi / 2)
    angles = np.linspace(-3, 1.5, 7)
    assert g.natural_angle_to_azimuth_rad(angles) == pytest.approx(math.pi / 2 - angles)
    assert g.natural_angle_to_tangential_azimuth_rad(angles, True) == pytest.approx(
        math.pi - angles)
    assert math.isnan(g.get_natural_angle(NAN, 1.0))


def test_arc_measures():
    arc = g.Elem.arc((0, 3), (0, 0), 3.0, 1.0, (0.0, math.pi / 2))
    assert g.get_arc_length(arc) == pytest.approx(1.5 * math.pi)
    assert g.get_arc_angle_rad(arc) == pytest.approx(math.pi / 2)
    assert g.get_arc_angle_rad(g.Elem.arc((0, 3), (0, 0), 0.0, 1.0, (0.0, 1.0))) == 0


def test_deviations():
    assert g.get_deviation(0.0, 2.0, -2.0, 7.0, 4.0) == 3
    assert g.get_signed_deviation(0.0, 2.0, -2.0, 7.0, 4.0) == 3
    assert g.get_signed_deviation(0.0, 2.0, -2.0, 7.0, 0.0) == -1
    assert g.get_deviation([0, 0, 5, 0, 3, 2]) == pytest.approx(2)
    assert math.isnan(g.get_deviation(1.0, 1.0, 0.0, NAN, 0.0))
    for call in (lambda: g.get_deviation(0.0, 0.0, 1.0, 1.0, 1.0),
                 lambda: g.get_signed_deviation(0.0, 0.0, 1.0, 1.0, 1.0),
                 lambda: g.get_deviation([1, 1, 1, 1, 2, 2])):
        with pytest.raises(vorn.ContourError) as caught:
            call()
        assert caught.value.code is vorn.ErrorCode.FAILED


def test_circle():
    center, radius, points, ccw = g.get_circle((3, 0, 0.1), (0, 3, 0.1), (-3, 0, 0.1))
    assert center == pytest.approx((0, 0)) and radius == pytest.approx(3.1) and ccw
    with pytest.raises(vorn.ContourError):
        g.get_circle((0, 0, 0), (1, 0, 0), (2, 0, 0))


def test_segments():
    assert g.get_line_segments_intersection((0, 0, 4, 0), (1, -1, 1, 1)) == (
        g.SegmentsRelPosition.INTERSECTING, (1, 0))
    assert g.get_line_segments_intersection((0, 0, 4, 0), (2, 0, 8, 0)) == (
        g.SegmentsRelPosition.COLLINEAR, (3, 0))
    assert g.get_line_segments_intersection((0, 0, 4, 0), (5, 1, 5, 2)) == (
        g.SegmentsRelPosition.DISJOINT, None)


def test_chains():
    contour = g.add_arc(g.add_segm([], (1, 0)), ((1, 0), (-1, 0)), ((0, 0), 1.0), False)
    assert len(contour) == 2 and contour[1].type == g.ElemType.ARC
    assert contour[1].direction == 1 and contour[1].end_angle == pytest.approx(math.pi)
    assert g.get_elem_point(contour) == (-1, 0)
    rest, removed = g.remove_elem(contour)
    assert rest == contour[:1] and removed == contour[1] and len(contour) == 2
    assert g.shift_elem(contour[1], (5, 6)).center == (5, 6)
    halves = g.split_elem(contour[1], 2, (1, 0))
    assert halves[0].end == pytest.approx((0, 1)) and halves[1].end == (-1, 0)
    assert g.replace_elem(contour, g.Elem.segment((7, 7)))[-1].end == (7, 7)
    assert g.delete_fitting_curve(contour) == []


@pytest.mark.parametrize("call", [
    lambda: g.remove_elem([]), lambda: g.get_elem_point([]),
    lambda: g.replace_elem([], g.Elem.segment((0, 0))),
    lambda: g.split_elem(g.Elem.segment((0, 0)), 1, (0, 0)),
    lambda: g.split_elem(g.Elem.segment((0, 0)), -5, (0, 0)),
    lambda: g.get_area([]), lambda: g.check_poly_self_intersection([]),
    lambda: g.get_area([0, 0, 1, 1], [99]),
    lambda: g.check_poly_self_intersection([], []),
    lambda: g.get_permissible_rect((0, 0, 1), (1, 0, 1)),
    lambda: g.get_line_polygon((0, 0, 1), (1, 0, 1)),
    lambda: g.get_circle_polygon([(0, 0, 0.1), (1, 0, 0.1), (2, 0, 0.1)]),
    lambda: g.linear_equation_system_solve([[0, 1], [0, 1]], [1, 1]),
    lambda: g.get_lines_intersection(1.0, 0.0, 1.0, 1.0),
    lambda: g.reorth_elements(2, np.eye(3), 3),
])
def test_what_has_no_answer_raises(call):
    with pytest.raises(vorn.ContourError):
        call()


def test_areas_and_crossings():
    assert g.get_area(SQUARE) == 4
    assert not g.check_poly_self_intersection(SQUARE)
    tie = [g.Elem.segment(p) for p in [(0, 0), (2, 2), (2, 0), (0, 2), (0, 0)]]
    assert g.check_poly_self_intersection(tie)
    with pytest.raises(vorn.SelfIntersectionError):
        g.get_area(tie)
    assert g.get_area([0, 0, 0, 2, 2, 2, 2, 0, 0, 0], [8]) == 4


def test_cells():
    rect = np.array(g.get_permissible_rect((0, 0, 0.5), (10, 0, 0.5)))
    assert np.hypot(*(rect[:2] - (10, 0)).T) == pytest.approx(0.5)
    assert np.hypot(*(rect[2:] - (0, 0)).T) == pytest.approx(0.5)
    vertices, x_of_y = g.get_line_polygon((0, 0, 0.1), (0, 5, 0.1))
    assert x_of_y and len(vertices) == 4
    assert not g.get_line_polygon((0, 0, 0.1), (5, 0, 0.1), x_of_y=False)[1]
    centers = np.array(g.get_circle_polygon([(5, 0, 0.01), (0, 5, 0.01), (-5, 0, 0.01)]))
    assert np.abs(centers).max() < 0.1


def test_create_fitting_curve(corner):
    points = np.column_stack((corner, np.full(len(corner), 0.01)))
    told = []
    contour, deviation, index = g.create_fitting_curve(points, progress=told.append)
    assert len(contour) == 3 and deviation <= 1 and -1 <= index < 7 and told[-1] == 100
    ends = [piece.end for piece in vorn.fit(points, strategy="mixed")]
    assert [elem.end for elem in contour[1:]] == ends
    with pytest.raises(vorn.PointsTooCloseError) as caught:
        g.create_fitting_curve([(0, 0, 0.01), (1, 0, 0.01), (1, 0, 0.01)])
    assert caught.value.indices == (1, 2)
    with pytest.raises(ValueError):
        g.create_fitting_curve(corner)
    with pytest.raises(vorn.ContourError):
        g.create_fitting_curve([(0, 0, 0.01)])


def test_numeric():
    matrix = np.array([[2.0, 1, 0], [1, 3, 1], [0, 1, 4]])
    before = matrix.copy()
    solution = g.linear_equation_system_solve(matrix, [1, 2, 3])
    assert solution == pytest.approx(np.linalg.solve(matrix, [1, 2, 3]))
    assert np.array_equal(matrix, before)
    with pytest.raises(ValueError):
        g.linear_equation_system_solve(matrix, [1, 2])
    assert g.get_outside_max([1.2, -1.2, 1e300]).tolist() == [2, -1, -2**31]
    assert g.get_outside_min(1.2) == 1
    assert g.get_lines_intersection(2.0, 1.0, -1.0, 4.0) == (1, 3)


def test_matrix():
    a = g.Matrix()
    a.init_mx_my_mz(0.1, 0.2, 0.3)
    assert a.get_angles_from_mx_my_mz() == pytest.approx([0.1, 0.2, 0.3])
    b = g.Matrix()
    b.init_mz_my_mx(0.1, 0.2, 0.3)
    assert b.get_angles_from_mz_my_mx() == pytest.approx([0.1, 0.2, 0.3])
    assert (a * b).to_array() == pytest.approx(a.to_array() @ b.to_array())
    assert (a @ b).det() == pytest.approx(1)
    assert a.mxv([1, 2, 3]) == pytest.approx(a.to_array() @ [1, 2, 3])
    assert a.vxm([1, 2, 3, 4, 5]) == pytest.approx([*(np.array([1, 2, 3]) @ a.to_array()), 4, 5])
    assert pickle.loads(pickle.dumps(a)).to_array().tolist() == a.to_array().tolist()
    turned = g.Matrix(a.to_array())
    turned.transpose()
    assert turned.to_array() == pytest.approx(a.to_array().T)
    drifted = g.Matrix(a.to_array() * 1.001)
    drifted.reorth(8)
    assert drifted.to_array() == pytest.approx(a.to_array())
    assert a.quantity_of_data_elements() == 9
    drifted.init_i()
    assert drifted.to_array().tolist() == np.eye(3).tolist()
    for wrong in ([1, 2], np.eye(2), np.eye(4)):
        with pytest.raises(ValueError):
            g.Matrix(wrong)
    with pytest.raises(ValueError):
        a.mxv([1, 2])


def test_elements_are_values():
    arc = g.Elem.arc((0, 1), (0, 0), 1.0, -1.0, (0.5, 1.5))
    again = pickle.loads(pickle.dumps(arc))
    assert again == arc and hash(again) == hash(arc) and arc != g.Elem.segment((0, 1))
    assert eval(repr(arc), {"Elem": g.Elem}) == arc
    assert (arc.start_angle, arc.end_angle, arc.radius) == (0.5, 1.5, 1)
    with pytest.raises(AttributeError):
        arc.radius = 2


def randoms(*shape):
    return np.random.default_rng(7).uniform(-10, 10, shape)


def test_batches_answer_what_single_calls_do():
    lines, points = randoms(200, 3), randoms(200, 2)
    assert g.line_deviations(lines, points).tolist() == [
        g.get_deviation(*line, *point) for line, point in zip(lines, points)]
    assert g.line_deviations(lines[0], points, signed=True).tolist() == [
        g.get_signed_deviation(*lines[0], *point) for point in points]
    first, second = randoms(2, 200, 4)
    relations, places = g.line_segments_intersections(first, second)
    for a, b, relation, place in zip(first, second, relations, places):
        single = g.get_line_segments_intersection(a, b)
        assert single[0] == g.SegmentsRelPosition(relation)
        assert single[1] == tuple(place) if single[1] else np.isnan(place).all()
    rows = randoms(200, 4)
    assert g.lines_intersections(rows).tolist() == [
        list(g.get_lines_intersection(*row)) for row in rows]
    weighed = np.abs(randoms(200, 3)) * (1, 1, 0.2)
    assert g.are_points_valid_to_fit(weighed).tolist() == [
        g.is_point_valid_to_fit(a, b) for a, b in zip(weighed, weighed[1:])]


def test_polygon_areas_are_those_of_the_shoelace_rule():
    vertices = randoms(120, 2)
    counts = [3, 7, 0, 50, 1, 59]
    expected, first = [], 0
    for count in counts:
        x, y = vertices[first:first + count].T
        expected.append(-0.5 * (x * np.roll(y, -1) - y * np.roll(x, -1)).sum())
        first += count
    assert g.polygon_areas(vertices, counts) == pytest.approx(np.array(expected))


def test_batches_have_holes_where_there_is_no_answer():
    assert np.isnan(g.line_deviations([0, 0, 1], [(1, 1), (2, 2)])).all()
    assert np.isnan(g.lines_intersections([(1, 0, 1, 1)])).all()


@pytest.mark.parametrize("call", [
    lambda: g.line_deviations(randoms(3, 3), randoms(2, 2)),
    lambda: g.line_deviations(randoms(3, 2), randoms(3, 2)),
    lambda: g.line_segments_intersections(randoms(3, 4), randoms(2, 4)),
    lambda: g.lines_intersections(randoms(2, 3)),
    lambda: g.are_points_valid_to_fit(randoms(5)),
    lambda: g.polygon_areas(randoms(5, 2), [4]),
    lambda: g.polygon_areas(randoms(5, 2), [-1, 6]),
    lambda: g.polygon_areas(randoms(5, 2), [2**62, 2**62]),
])
def test_batches_refuse_other_shapes(call):
    with pytest.raises(ValueError):
        call()


def test_empty_batches_are_empty():
    assert g.line_deviations([0, 1, 0], np.empty((0, 2))).shape == (0,)
    assert g.are_points_valid_to_fit(np.empty((0, 3))).shape == (0,)
    assert g.polygon_areas(np.empty((0, 2)), []).shape == (0,)
    assert g.lines_intersections(np.empty((0, 4))).shape == (0, 2)
