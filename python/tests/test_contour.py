"""Contours as values: pieces, measures, edits, files."""

import dataclasses
import json
import math
import pickle
import re
import struct

import numpy as np
import pytest
import vorn


@pytest.fixture
def slot():
    """A closed slot: two lines 4 long, two half circles of radius 1, counter-clockwise."""
    return (vorn.Contour.starting_at((0, 0)).append_line((4, 0))
            .append_arc((4, 2), center=(4, 1), ccw=True).append_line((0, 2))
            .append_arc((0, 0), center=(0, 1), ccw=True))


def test_a_contour_is_a_sequence(slot):
    assert len(slot) == 4
    assert [type(p) for p in slot] == [vorn.Line, vorn.Arc, vorn.Line, vorn.Arc]
    assert slot[-1].center == (0, 1)
    assert slot[1] in slot and slot.index(slot[2]) == 2
    assert isinstance(slot[1:3], vorn.Contour) and len(slot[1:3]) == 2
    with pytest.raises(IndexError):
        slot[4]


def test_pieces_are_frozen(slot):
    with pytest.raises(dataclasses.FrozenInstanceError):
        slot[0].start = (1, 1)


def test_an_arc_has_its_fields(slot):
    arc = slot[1]
    assert (arc.start, arc.end, arc.center) == ((4, 0), (4, 2), (4, 1))
    assert arc.radius == 1 and arc.ccw
    assert arc.sweep == pytest.approx(math.pi)
    assert arc.length == pytest.approx(math.pi)
    assert arc.points is None


def test_measures(slot):
    assert slot.is_closed
    assert slot.length == pytest.approx(8 + 2 * math.pi)
    assert slot.area == pytest.approx(8 + math.pi)
    assert slot.reversed().area == pytest.approx(-8 - math.pi)
    assert slot.bounds == pytest.approx((-1, 0, 5, 2))
    assert not slot.is_self_intersecting
    assert slot.start == slot.end == (0, 0)
    assert repr(slot) == "<Contour: 4 pieces (2 lines, 2 arcs), closed, length 14.2832>"


def test_what_no_fit_told_is_none(slot):
    assert slot.max_deviation is slot.max_index is slot.fewest_possible is slot.verdict is None


def test_a_bow_tie_crosses_itself():
    tie = (vorn.Contour.starting_at((0, 0)).append_line((2, 2)).append_line((2, 0))
           .append_line((0, 2)).append_line((0, 0)))
    assert tie.is_self_intersecting


def test_an_open_contour_has_no_area(slot):
    assert slot[:2].area is None


def test_deviations_are_distances(slot):
    points = [(2, 0.5), (2, -3), (5.5, 1), (4, 1), (-3, 1)]
    assert slot.deviations(points) == pytest.approx([0.5, 3, 0.5, 1, 2])
    assert slot.deviations(points, signed=True) == pytest.approx([0.5, -3, -0.5, 1, -2])
    assert slot.deviations(np.empty((0, 2))).shape == (0,)


def test_nearest_tells_place_piece_and_distance(slot):
    found = slot.nearest([(2, -3), (6, 1), (1, 5)])
    assert found.places == pytest.approx(np.array([(2, 0), (5, 1), (1, 2)]))
    assert found.pieces.tolist() == [0, 1, 2]
    assert found.distances == pytest.approx([3, 1, 3])


def test_deviations_need_places(slot):
    with pytest.raises(vorn.ContourError) as caught:
        slot.deviations([(0, 0), (math.nan, 0)])
    assert caught.value.indices == (1,)
    with pytest.raises(vorn.ContourError):
        vorn.Contour().deviations([(0, 0)])


@pytest.mark.parametrize("chord", [1.0, 0.1, 1e-3, 1e-6])
def test_samples_keep_to_the_chord(slot, chord):
    places = slot.sample(chord)
    assert slot.deviations(places).max() <= 1e-14
    middles = (places[1:] + places[:-1]) / 2
    assert slot.deviations(middles).max() <= chord * (1 + 1e-9)


@pytest.mark.parametrize("chord", [0, -1, math.nan])
def test_a_chord_is_above_zero(slot, chord):
    with pytest.raises(ValueError):
        slot.sample(chord)


def test_shifted_moves_all_places(slot):
    moved = slot.shifted(10, -20)
    assert moved[1] == dataclasses.replace(slot[1], start=(14, -20), end=(14, -18),
                                           center=(14, -19))
    assert moved.shifted(-10, 20) == slot


def test_split_cuts_into_equal_parts(slot):
    cut = slot.split(1, 4)
    assert len(cut) == 7 and cut.is_closed
    for part in cut[1:5]:
        assert part.sweep == pytest.approx(math.pi / 4)
    assert cut.length == pytest.approx(slot.length)
    assert slot.split(-2)[2:4].start == slot[2].start
    with pytest.raises(ValueError):
        slot.split(0, 1)
    with pytest.raises(IndexError):
        slot.split(4)


def test_equal_contours_have_equal_hashes(slot):
    again = vorn.Contour(list(slot))
    assert again == slot and hash(again) == hash(slot) and len({again, slot}) == 1
    assert slot != slot.shifted(0, 1e-15) or slot.shifted(0, 1e-15)[0].start == slot[0].start
    assert slot != vorn.Contour(slot, closed=False)
    assert slot != list(slot)


def test_pickles_are_whole_and_small(examples):
    contour = vorn.fit(vorn.read_points(examples / "gear_tooth.csv"))
    data = pickle.dumps(contour)
    again = pickle.loads(data)
    assert again == contour
    assert list(again) == list(contour)
    assert again.max_deviation == contour.max_deviation and again.verdict == contour.verdict
    assert len(data) < 400 + 112 * len(contour)


@pytest.mark.parametrize("name", ["json", "csv"])
def test_text_brings_back_every_bit(examples, name):
    contour = vorn.fit(vorn.read_points(examples / "gear_tooth.csv"))
    text = getattr(contour, "to_" + name)()
    assert getattr(vorn.Contour, "from_" + name)(text) == contour


@pytest.mark.parametrize("name, allowed", [("dxf", 1e-9), ("wkt", 1e-9), ("gcode", 2e-4)])
def test_text_brings_back_the_shape(slot, name, allowed):
    again = vorn.Contour.from_text(slot.to_text(name), name)
    assert again.is_closed and len(again) == len(slot)
    assert again.deviations(slot.sample(0.01)).max() <= allowed
    assert again.area == pytest.approx(slot.area, abs=10 * allowed)


def test_geojson_holds_chords(slot):
    for chord in (0.1, 0.001):
        document = json.loads(slot.to_geojson(chords=chord))
        assert '"Polygon"' in json.dumps(document)
        again = vorn.Contour.from_geojson(slot.to_geojson(chords=chord))
        assert again.is_closed and not again.as_arrays()["is_arc"].any()
        assert 0 < slot.deviations(again.sample(1)).max() + again.deviations(
            slot.sample(1e-4)).max() <= chord * (1 + 1e-9)
    with pytest.raises(vorn.ContourError):
        slot.to_text("geojson")
    for wrong in (0, -1, math.nan):
        with pytest.raises(ValueError):
            slot.to_geojson(chords=wrong)


def test_plain_svg_is_the_contour(slot, tmp_path):
    inches = vorn.Contour(slot, units="inch")
    again = vorn.Contour.from_svg(inches.to_plain_svg())
    assert again.area == pytest.approx(inches.area) and again.length == pytest.approx(inches.length)
    assert again.as_arrays()["is_arc"].tolist() == [False, True, True, False, True, True]
    assert re.search(r'width="[0-9.]+in"', inches.to_plain_svg())
    inches.save(tmp_path / "plain.svg", plain=True)
    assert (tmp_path / "plain.svg").read_text() == inches.to_plain_svg()
    inches.save(tmp_path / "drawing.svg", plain=False)
    assert (tmp_path / "drawing.svg").read_text() == inches.to_svg()
    with pytest.raises(vorn.ContourError):
        slot.to_text("svg")


def test_curves_become_chords_where_that_is_said():
    text = '<svg xmlns="http://www.w3.org/2000/svg"><path d="M0 0 C0 1 1 1 1 0"/></svg>'
    with pytest.raises(vorn.FileError):
        vorn.Contour.from_svg(text)
    assert len(vorn.Contour.from_svg(text, flatten=0.1)) < len(
        vorn.Contour.from_svg(text, flatten=0.001))
    with pytest.raises(ValueError):
        vorn.Contour.from_svg(text, flatten=0)


def test_dxf_has_versions(slot):
    millimetres = vorn.Contour(slot, units="mm")
    new = millimetres.to_dxf(dxf_version="r2000")
    assert "AC1015" in new and "LWPOLYLINE" in new and "$INSUNITS" in new
    assert "AC1009" in millimetres.to_dxf() and "LWPOLYLINE" not in millimetres.to_dxf()
    assert vorn.Contour.from_dxf(new).area == pytest.approx(slot.area)
    with pytest.raises(ValueError):
        slot.to_dxf(dxf_version="r14")


def test_digits_follow_from_the_points(slot):
    points = slot.sample(0.1)
    fine = vorn.Contour.from_gcode(slot.shifted(1 / 3, 1 / 7).to_text(
        "gcode", points=points + (1 / 3, 1 / 7), tol=1e-9))
    assert fine.deviations(points + (1 / 3, 1 / 7)).max() <= 1e-9
    coarse = vorn.Contour.from_gcode(slot.shifted(1 / 3, 1 / 7).to_gcode())
    assert coarse.deviations(points + (1 / 3, 1 / 7)).max() > 1e-9
    by_tolerance = slot.shifted(1 / 3, 1 / 7).to_gcode(tolerance=1e-9)
    assert len(by_tolerance) > len(slot.shifted(1 / 3, 1 / 7).to_gcode())
    with pytest.raises(ValueError, match="tolerances"):
        slot.to_text("gcode", points=points)


def test_what_reading_leaves_out_is_warned_of():
    with pytest.warns(UserWarning, match="left out 1 piece without length") as told:
        contour = vorn.Contour.from_wkt("LINESTRING (0 0, 1 0, 1 0, 2 0)")
    assert len(contour) == 2 and len(told) == 1
    with pytest.warns(UserWarning, match="beside x and y"):
        vorn.Contour.from_wkt("LINESTRING Z (0 0 5, 1 0 6)")


def test_gcode_takes_options(slot):
    text = slot.to_gcode(feed=600, radius_words=True, end="M30")
    assert "F600" in text and "R1" in text and "M30" in text
    text = slot.to_gcode(plane="xz", decimals=1, header="(begin {pieces})", footer="(end)")
    assert "G18" in text and "(begin 4)" in text and "(end)" in text
    text = slot.to_gcode(safe_height=5.0, cut_height=-1.0, plunge_feed=70.0, feed=600.0)
    assert "Z5" in text and "Z-1" in text and "F70" in text
    with pytest.raises(TypeError):
        slot.to_gcode(speed=1)
    with pytest.raises(ValueError):
        slot.to_gcode(end="stop")


def test_a_text_that_holds_no_contour_is_refused():
    for name in ("json", "csv", "dxf", "wkt", "gcode"):
        with pytest.raises(vorn.ContourError):
            vorn.Contour.from_text("nothing of the kind {", name)
    with pytest.raises(ValueError):
        vorn.Contour.from_text("", "svg")


@pytest.mark.parametrize("ending", ["json", "csv", "dxf", "wkt", "nc", "geojson"])
def test_files_come_back(slot, tmp_path, ending):
    path = tmp_path / f"slot.{ending}"
    slot.save(path, **({"chords": 0.01} if ending == "geojson" else {}))
    again = vorn.Contour.read(path)
    assert len(again) == 4 or ending == "geojson"
    assert again.area == pytest.approx(slot.area, rel=0.02)


def png_size(picture):
    """From the header of the picture."""
    return struct.unpack(">II", picture[16:24])


def test_drawings(slot, tmp_path):
    points = slot.sample(0.1)
    assert slot.to_svg().startswith("<svg") or slot.to_svg().startswith("<?xml")
    assert "<html" in slot.to_html(points, tol=0.1)
    assert slot.to_png().startswith(b"\x89PNG")
    assert "Slot &lt;1&gt;" in slot.to_svg(points, tol=0.1, title="Slot <1>")
    assert "Jones" in slot.to_html(points, tol=0.1, fields={"operator": "Jones"})
    assert png_size(slot.to_png(width=321))[0] == 321
    small, large = (png_size(slot.to_png(dpi=dpi)) for dpi in (50, 100))
    assert large == pytest.approx(np.multiply(small, 2), abs=1)
    for wrong in ({"dpi": 0}, {"width": 0}, {"dpi": math.nan}):
        with pytest.raises(ValueError):
            slot.to_png(**wrong)
    with pytest.raises(vorn.ContourError):
        slot.to_png(dpi=1e9)
    with pytest.raises(ValueError):
        slot.to_html(fields={"": "x"})
    for wrong in ({"dpi": 100}, {"width": 100}, {"fields": {"operator": "Jones"}}):
        with pytest.raises(TypeError):
            slot.to_svg(**wrong)
    slot.save(tmp_path / "slot.svg", points=points, tol=0.1, magnify=10)
    assert (tmp_path / "slot.svg").stat().st_size > 1000
    with pytest.raises(ValueError):
        slot.save(tmp_path / "slot.txt")


def test_a_notebook_shows_the_drawing(slot):
    assert "<svg" in slot._repr_html_()
    assert vorn.Contour()._repr_html_().startswith("&lt;Contour: 0 pieces")


def test_as_arrays_go_into_pandas(slot):
    pandas = pytest.importorskip("pandas")
    frame = pandas.DataFrame(slot.as_arrays())
    assert frame["length"].tolist() == [p.length for p in slot]
    assert frame["is_arc"].tolist() == [False, True, False, True]
    assert frame["radius"].isna().tolist() == [True, False, True, False]


def test_as_arrays_is_a_copy(slot):
    arrays = slot.as_arrays()
    arrays["end_x"] = 99
    assert slot[0].end == (4, 0)


def test_to_shapely(slot):
    pytest.importorskip("shapely")
    polygon = slot.to_shapely(chord=1e-4)
    assert polygon.area == pytest.approx(slot.area, abs=2e-3)
    assert slot[:2].to_shapely(chord=1e-4).length == pytest.approx(slot[:2].length, abs=1e-3)


def test_an_empty_contour_has_nothing():
    empty = vorn.Contour()
    assert len(empty) == 0 and empty.length == 0 and empty.area is None
    assert not empty.is_closed and not empty.is_self_intersecting
    assert pickle.loads(pickle.dumps(empty)) == empty
    with pytest.raises(vorn.ContourError):
        empty.bounds
    with pytest.raises(IndexError):
        empty.start


def test_errors_come_back_from_pickles(corner):
    corner[4] = (3, 0.02)
    with pytest.raises(vorn.PointsTooCloseError) as caught:
        vorn.fit(corner, tol=0.01, strategy="mixed")
    again = pickle.loads(pickle.dumps(caught.value))
    assert type(again) is vorn.PointsTooCloseError
    assert (str(again), again.code, again.indices) == (str(caught.value), 20, (3, 4))
    assert (again.distance, again.needed) == (caught.value.distance, caught.value.needed)
    place = vorn.FileError("a.csv:3:7: no", "a.csv", 3, 7)
    again = pickle.loads(pickle.dumps(place))
    assert (str(again), again.path, again.line, again.column) == ("a.csv:3:7: no", "a.csv", 3, 7)
