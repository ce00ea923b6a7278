"""Drawings by matplotlib."""

import subprocess
import sys

import numpy as np
import pytest
import vorn

matplotlib = pytest.importorskip("matplotlib")
matplotlib.use("Agg")
plt = pytest.importorskip("matplotlib.pyplot")


@pytest.fixture
def ax():
    figure, axes = plt.subplots()
    yield axes
    plt.close(figure)


@pytest.fixture
def contour():
    return (vorn.Contour.starting_at((0, 0), units="mm").append_line((10, 0))
            .append_arc((10, 4), center=(10, 2), ccw=True))


def labels(ax):
    return [text.get_text() for text in ax.get_legend().get_texts()]


def test_lines_and_arcs_are_told_apart(ax, contour):
    assert vorn.plot(contour, ax=ax) is ax
    assert labels(ax) == ["line", "arc", "joint"]
    assert ax.get_xlabel() == "x in mm" and ax.get_aspect() == 1
    drawn = ax.lines[1].get_xydata()
    assert contour.deviations(drawn).max() < 1e-12


def test_points_are_magnified(ax, contour):
    vorn.plot(contour, points=[(2, 0.01), (4, -0.02), (12.01, 2)], magnify=50, ax=ax)
    drawn = next(line for line in ax.lines if line.get_label() == "points, 50 times as far")
    assert drawn.get_xydata() == pytest.approx(np.array([(2, 0.5), (4, -1), (12.5, 2)]))


def test_the_band_is_the_tolerance(ax, contour):
    vorn.plot(contour, points=[(1, 0.0, 0.1), (2, 0, 0.2), (3, 0, 0.2)], magnify=1, ax=ax)
    assert "tolerance" in labels(ax)
    upper, lower = ax.lines[0].get_ydata(), ax.lines[1].get_ydata()
    assert upper == pytest.approx([0.1, 0.2, 0.2]) and lower == pytest.approx(-upper)


def test_the_band_of_a_closed_contour_is_closed(ax):
    square = vorn.Contour.starting_at((0, 0))
    for corner in [(4, 0), (4, 4), (0, 4), (0, 0)]:
        square = square.append_line(corner)
    vorn.plot(square, points=[(2, 0), (4, 2), (2, 4), (0, 2)], tol=0.5, magnify=1, ax=ax)
    for band in ax.lines[:2]:
        assert len(band.get_xdata()) == 5
        assert square.deviations(band.get_xydata()[1:4]) == pytest.approx(0.5)


def test_what_cannot_be_drawn_is_refused(ax, contour):
    with pytest.raises(vorn.ContourError):
        vorn.plot(vorn.Contour(), ax=ax)
    for wrong in ([], [1, 2], [(1, 2, 3, 4)]):
        with pytest.raises(ValueError):
            vorn.plot(contour, points=wrong, ax=ax)
    for options in ({"tol": 0}, {"tol": np.nan}, {"magnify": -1}, {"magnify": np.inf}):
        with pytest.raises(ValueError):
            vorn.plot(contour, points=[(1, 0)], ax=ax, **options)


@pytest.mark.parametrize("widest, times", [(0.1, "5"), (0.001, "500"), (0.0004, "1000"), (3, "")])
def test_the_magnification_is_a_round_number(ax, contour, widest, times):
    vorn.plot(contour, points=[(1, 0), (2, 0)], tol=widest, ax=ax)
    expected = f"points, {times} times as far" if times else "points"
    assert expected in labels(ax)


def test_without_axes_the_current_ones_are_taken(contour):
    figure = plt.figure()
    assert vorn.plot(contour).figure is figure
    plt.close(figure)


def test_matplotlib_is_imported_only_when_called():
    code = "import sys, vorn; sys.exit(any(m in sys.modules for m in ('matplotlib', 'pandas')))"
    assert subprocess.run([sys.executable, "-c", code]).returncode == 0
