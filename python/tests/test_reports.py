"""What is told of points and fits, and thinning, beside what the program does."""

import json
import subprocess

import numpy as np
import pytest
import vorn


def run(program, *words):
    return subprocess.run([program, *map(str, words)], capture_output=True, text=True, check=False)


@pytest.fixture
def scan(tmp_path):
    """A file of noisy points with three that the instrument got wrong, and its points."""
    random = np.random.default_rng(5)
    x = np.arange(0, 60, 0.1)
    points = np.column_stack((x, 3 * np.sin(x / 9))) + random.normal(0, 0.002, (600, 2))
    points[[100, 300, 301], 1] += (0.2, -0.3, 0.25)
    points[500] = points[499]
    path = tmp_path / "scan.csv"
    vorn.write_points(path, points, units="mm")
    return path


@pytest.mark.parametrize("words, options", [
    (("--outliers", "6"), {"outliers": 6}),
    (("--spacing", "0.7"), {"spacing": 0.7}),
    (("--spacing", "0.7", "--average"), {"spacing": 0.7, "average": True}),
    (("--drop-close", "-t", "0.05"), {"drop_close": True, "tol": 0.05}),
    (("--drop-close", "--tolerance-per-point", "0.1"),
     {"drop_close": True, "tolerance_per_point": 0.1}),
    (("--outliers", "6", "-t", "0.22"), {"outliers": 6, "tol": 0.22}),
    (("--outliers", "6", "--tolerance-per-point", "0.22"),
     {"outliers": 6, "tolerance_per_point": 0.22}),
    (("--outliers", "6", "--spacing", "0.3", "--drop-close", "-t", "0.15"),
     {"outliers": 6, "spacing": 0.3, "drop_close": True, "tol": 0.15}),
    (("--outliers", "6", "--spacing", "0.5", "--average", "--drop-close", "-t", "0.15"),
     {"outliers": 6, "spacing": 0.5, "average": True, "drop_close": True, "tol": 0.15}),
])
def test_simplify_leaves_what_the_program_leaves(program, scan, tmp_path, words, options):
    out = tmp_path / "rest.csv"
    assert run(program, "simplify", scan, *words, "-o", out).returncode == 0
    expected = vorn.read_points(out)[:, :2]
    found = vorn.simplify(vorn.read_points(scan), **options)
    assert np.array_equal(found.points[:, :2], expected) and found.points.units == "mm"
    assert len(found.kept) + len(found.dropped) == 600
    assert 2 <= len(expected) < 600
    if "average" not in options:
        assert np.array_equal(np.asarray(vorn.read_points(scan))[found.kept], expected)


def test_outliers_are_told(scan):
    found = vorn.simplify(vorn.read_points(scan), outliers=6)
    told = {outlier.point: outlier.distance for outlier in found.outliers}
    # Neighbours of an outlier may be taken for one, those further away are none.
    assert {100, 300, 301} <= set(told) <= {*range(96, 105), *range(296, 306)}
    assert found.dropped.tolist() == sorted(told)
    assert told[100] == pytest.approx(0.2, abs=0.02)
    assert all(outlier.deviations > 6 for outlier in found.outliers)
    assert found.scatter is None


def test_means_scatter_as_the_noise(scan):
    clean = vorn.simplify(vorn.read_points(scan), outliers=6).points
    found = vorn.simplify(clean, spacing=1.0, average=True)
    assert 0.001 < found.scatter.mean_deviation < 0.004
    assert found.scatter.mean_deviation <= found.scatter.largest_deviation
    assert 1 <= found.scatter.fewest <= 10 <= found.scatter.most


@pytest.mark.parametrize("options, error", [
    ({}, TypeError), ({"average": True, "outliers": 3}, ValueError),
    ({"drop_close": True, "tol": 0.1, "tolerance_per_point": 0.1}, TypeError),
    ({"spacing": 0}, ValueError), ({"outliers": -1}, ValueError),
    ({"outliers": float("nan")}, ValueError), ({"spacing": float("inf")}, ValueError),
    ({"drop_close": True, "tol": 1e9}, vorn.PointsTooCloseError),
    ({"drop_close": True, "closed": "maybe"}, ValueError)])
def test_simplify_refuses_wrong_use(scan, options, error):
    with pytest.raises(error):
        vorn.simplify(vorn.read_points(scan), **options)


@pytest.mark.parametrize("points", [[], [(0, 0)], [(0, 0), (np.nan, 1)], "text"])
def test_bad_points_are_refused_alike(points):
    line = vorn.Contour.starting_at((0, 0)).append_line((1, 0))
    for use in (lambda: vorn.simplify(points, spacing=1, average=True), lambda: vorn.info(points),
                lambda: vorn.report(points, tol=1), lambda: vorn.least_squares_line(points),
                lambda: vorn.least_squares_circle(points),
                lambda: vorn.check(points or [(np.inf, 0)], vorn.Contour() if len(points) == 1
                                   else line)):
        with pytest.raises((TypeError, ValueError)):
            use()


def without(document, *names):
    """What must be the same: all but names of files, times and where a tolerance came from."""
    if isinstance(document, dict):
        return {name: without(value, *names) for name, value in document.items()
                if name not in names}
    return [without(value, *names) for value in document] if isinstance(document, list) \
        else document


NOT_COMPARED = ("file", "path", "line", "lines", "columns", "source", "program", "seconds", "name",
                "generator", "version", "tolerance_source", "column")


def test_info_is_that_of_the_program(program, scan):
    said = json.loads(run(program, "info", scan, "-t", "0.05", "--json").stdout)
    facts = vorn.info(vorn.read_points(scan), tol=0.05)
    assert without(facts, *NOT_COMPARED) == without(said, *NOT_COMPARED)
    assert len(facts) > 8


def test_check_is_that_of_the_program(program, scan, tmp_path):
    points = vorn.read_points(scan)
    contour = vorn.fit(points, tol=0.02, strategy="fewest")
    contour.save(tmp_path / "contour.json")
    run(program, "check", scan, tmp_path / "contour.json", "-t", "0.015", "--json",
        tmp_path / "check.json", "--table", tmp_path / "check.csv")
    told = vorn.check(points, contour, tol=0.015)
    said = json.loads((tmp_path / "check.json").read_text())
    assert without(told.facts, *NOT_COMPARED) == without(said, *NOT_COMPARED)
    distances = contour.deviations(points)
    assert told.outside.tolist() == np.flatnonzero(distances > 0.015 * (1 + 1e-6)).tolist()
    assert len(told.outside) > 0
    assert told.worst_first[0] == distances.argmax()
    assert len(told.to_csv().splitlines()) == len((tmp_path / "check.csv").read_text().splitlines())
    assert len(vorn.check(points, contour).outside) == 0


def test_a_report_holds_the_fit(program, scan, tmp_path):
    points = vorn.read_points(scan)
    told = vorn.report(points, tol=0.02, strategy="fewest", fields={"operator": "Jones <1>"})
    assert told.contour == vorn.fit(points, tol=0.02, strategy="fewest")
    assert told.contour.units == "mm" and told.contour.verdict == "within tolerance"
    run(program, "fit", scan, "-t", "0.02", "--strategy", "fewest", "--field",
        "operator=Jones <1>", "-o", tmp_path / "fit.json")
    said = json.loads((tmp_path / "fit.json").read_text())
    assert without(told.facts, *NOT_COMPARED) == without(said, *NOT_COMPARED)
    assert vorn.Contour.from_json(told.to_json()) == told.contour
    assert "Jones" in told.to_html() and "</svg>" in told.to_svg(magnify=3, title="Scan")


def test_a_report_fails_as_a_fit_does(corner):
    with pytest.raises(vorn.PointsTooCloseError):
        vorn.report([(0, 0), (0.1, 0)], tol=1, strategy="mixed")
    with pytest.raises(TypeError):
        vorn.report(corner, tol=0.01, colour="red")
    told = []
    vorn.report(corner, tol=0.01, progress=told.append)
    assert told[-1] == 100


def test_a_summary_has_a_row_for_each(corner):
    reports = {"good": vorn.report(corner, tol=0.01),
               "other, \"one\"": vorn.report(corner, tol=1e-3)}
    table = vorn.summary(reports)
    assert "good" in table and "other" in table
    page = vorn.summary(reports, fields={"operator": "Jones"}, format="html")
    assert page.count("<svg") >= 2 and "Jones" in page
    with pytest.raises(ValueError):
        vorn.summary(reports, format="pdf")


def test_least_squares_against_numpy():
    random = np.random.default_rng(8)
    x = random.uniform(-3, 9, 200)
    points = np.column_stack((x, 0.4 * x + 2)) + random.normal(0, 0.01, (200, 2))
    line = vorn.least_squares_line(points)
    centred = points - points.mean(axis=0)
    axis = np.linalg.svd(centred)[2][0]
    assert line.place == pytest.approx(tuple(points.mean(axis=0)))
    assert np.tan(line.direction) == pytest.approx(axis[1] / axis[0])
    across = centred @ (-axis[1], axis[0])
    assert line.form_error == pytest.approx(np.ptp(across))
    assert line.deviation == pytest.approx(np.sqrt((across ** 2).sum() / 198))

    angles = random.uniform(0, 2, 300)
    places = np.column_stack((7 * np.cos(angles) + 1, 7 * np.sin(angles) - 2))
    circle = vorn.least_squares_circle(places)
    assert circle.radius == pytest.approx(7) and circle.center == pytest.approx((1, -2))
    assert circle.form_error < 1e-12 and circle.deviation < 1e-12
    assert vorn.least_squares_line([(0, 0), (1, 1)]).deviation is None
    for call in (lambda: vorn.least_squares_line([(1, 1), (1, 1)]),
                 lambda: vorn.least_squares_circle([(0, 0), (1, 1), (2, 2)])):
        with pytest.raises(vorn.ContourError):
            call()
