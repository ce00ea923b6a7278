"""Contours beside each other: places in common, outlines, areas. Expected values by hand."""

import csv
import json
import math
import pickle
import subprocess

import numpy as np
import pytest
import vorn


def path(*places, units=""):
    contour = vorn.Contour.starting_at(places[0], units)
    for place in places[1:]:
        contour = contour.append_line(place)
    return contour


def square(low, high):
    return path((low, low), (high, low), (high, high), (low, high), (low, low))


def test_two_contours_cross_touch_and_overlap():
    line = path((-5, 0), (5, 0))
    zigzag = path((-4, -1), (-4, 1), (0, 0), (1, 1), (2, 0), (3, 0), (3, 2))
    found = line.intersections(zigzag)
    assert [place.kind for place in found] == ["crossing", "touching", "overlap"]
    assert [place.place for place in found] == [(-4, 0), (0, 0), (2, 0)]
    assert found[2].until == (3, 0) and found[0].until is None
    assert found[0][3:] == (0, 1.0, 0, 1.0)
    assert repr(found) == "<Intersections: 1 crossing, 1 touching, 1 overlap>"
    assert found[:2] == [found[0], found[1]] and found[-1] == found[2]
    rows = list(csv.reader(found.to_csv().splitlines()))
    assert len([row for row in rows if row and not row[0].startswith("#")]) == 4
    assert len(json.loads(found.to_json())["intersections"]) == 3
    assert len(line.intersections(path((9, 9), (10, 9)))) == 0


def test_an_arc_is_crossed_where_it_should_be():
    arc = vorn.Contour.starting_at((2, 0)).append_arc((-2, 0), center=(0, 0), ccw=True)
    first, second = arc.intersections(path((-3, 1), (3, 1)))
    assert first.place == pytest.approx((math.sqrt(3), 1))
    assert second.place == pytest.approx((-math.sqrt(3), 1))
    assert first.position == pytest.approx(2 * math.pi / 6)
    assert first.other_position == pytest.approx(3 + math.sqrt(3))


def test_a_contour_meets_itself():
    tie = path((0, 0), (2, 2), (2, 0), (0, 2))
    place, = tie.intersections()
    assert (place.kind, place.place, place.piece, place.other_piece) == ("crossing", (1, 1), 0, 2)
    assert tie.is_self_intersecting and not square(0, 1).intersections()


def test_intersections_are_those_of_the_program(program, tmp_path, examples):
    gear = vorn.fit(vorn.read_points(examples / "gear_tooth.csv"))
    middle = np.mean(gear.sample(0.01), axis=0)
    gear.save(tmp_path / "a.json")
    gear.shifted(*(middle / 1000)).save(tmp_path / "b.json")
    said = subprocess.run([program, "intersect", tmp_path / "a.json", tmp_path / "b.json",
                           "--json"], check=True, capture_output=True, text=True).stdout
    found = gear.intersections(gear.shifted(*(middle / 1000)))
    assert json.loads(said)["intersections"] == json.loads(found.to_json())["intersections"]


def test_scattered_pieces_make_outlines():
    hole, frame = square(1, 2), square(0, 4)
    pieces = [*frame[2:], *hole[::-1].reversed()[::-1], *frame[:2]]
    outlines = vorn.Contour(pieces, units="mm").outlines()
    assert sorted(abs(outline.area) for outline in outlines) == [1, 16]
    assert {outline.units for outline in outlines} == {"mm"}
    assert all(outline.is_closed and outline.gaps() == [] for outline in outlines)


def test_gaps_are_told_and_cut():
    both = vorn.Contour([*path((0, 0), (1, 0)), *path((1, 3), (0, 3))])
    assert both.gaps() == [vorn.Gap(0, 1, 3.0)]
    assert [run.start for run in both.runs()] == [(0, 0), (1, 3)]
    assert path((0, 0), (1, 0), (1, 1)).gaps() == []
    assert len(path((0, 0), (1, 0), (1, 1)).runs()) == 1


def test_the_areas_of_outlines_with_holes():
    areas = vorn.measure_areas([square(0, 10), square(1, 3).reversed(), square(20, 21)])
    assert [area.area for area in areas] == [100, -4, 1]
    assert [area.depth for area in areas] == [0, 1, 0]
    assert [area.is_hole for area in areas] == [False, True, False]
    assert areas.net == 97 and len(areas) == 3
    assert [area.perimeter for area in areas[:2]] == [40, 8]
    assert areas[1].centroid == pytest.approx((2, 2))
    assert json.loads(areas.to_json())
    tie, = vorn.measure_areas([path((0, 0), (2, 2), (2, 0), (0, 2), (0, 0))])
    assert tie.crosses_itself and tie.centroid is None
    for wrong in (path((0, 0), (1, 0)), vorn.Contour()):
        with pytest.raises(vorn.ContourError, match="contour 1 is open"):
            vorn.measure_areas([square(0, 1), wrong])


def test_the_departure_is_the_larger_of_both():
    line = path((0, 0), (8, 0))
    assert line.departure(path((0, 0), (4, 0), (4, 3), (4, 0), (8, 0))) == 3
    assert path((0, 0), (4, 0), (4, 3), (4, 0), (8, 0)).departure(line) == 3
    assert line.departure(line) == 0
    with pytest.raises(vorn.ContourError):
        line.departure(vorn.Contour())


def test_what_is_found_can_be_pickled():
    place, = path((0, 0), (2, 2), (2, 0), (0, 2)).intersections()
    assert pickle.loads(pickle.dumps(place)) == place
    area, = vorn.measure_areas([square(0, 1)])
    assert pickle.loads(pickle.dumps(area)) == area


def test_a_file_of_several_outlines(tmp_path):
    both = vorn.Contour([*square(0, 4), *square(1, 2)])
    for name in ("both.dxf", "both.wkt", "both.json"):
        both.save(tmp_path / name)
        found = vorn.Contour.read(tmp_path / name).outlines()
        assert [outline.area for outline in found] == [16, 1]
