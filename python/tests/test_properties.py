"""What holds for fits of any points."""

import numpy as np
import pytest
import vorn

hypothesis = pytest.importorskip("hypothesis")
st = hypothesis.strategies

# The same examples in every run.
settings = hypothesis.settings(deadline=None, derandomize=True, max_examples=40, print_blob=True)

STRATEGIES = ["fewest", "mixed"]
TOL = 2.0 ** -7


@st.composite
def paths(draw):
    """Chains of straight and bent runs with steps near 1, on a grid that doubles hold exactly."""
    heading, place, points = 0.0, np.zeros(2), [np.zeros(2)]
    for _ in range(draw(st.integers(1, 4))):
        heading += draw(st.floats(-1.2, 1.2))
        bend = draw(st.one_of(st.just(0.0), st.floats(-0.3, 0.3)))
        for _ in range(draw(st.integers(2, 12))):
            heading += bend
            place = place + (np.cos(heading), np.sin(heading))
            points.append(place)
    noise = np.random.default_rng(draw(st.integers(0, 10**6))).uniform(-1, 1, (len(points), 2))
    return np.round((np.array(points) + noise * TOL / 2) * 2**20) / 2**20


@pytest.mark.parametrize("strategy", STRATEGIES)
@settings
@hypothesis.given(points=paths())
def test_every_point_is_within_tolerance(strategy, points):
    contour = vorn.fit(points, tol=TOL, strategy=strategy, closed=False)
    assert contour.verdict == "within tolerance"
    assert contour.deviations(points).max() <= TOL * (1 + 1e-6)
    assert np.linalg.norm(np.subtract(contour.start, points[0])) <= 2 * TOL
    assert np.linalg.norm(np.subtract(contour.end, points[-1])) <= 2 * TOL


@pytest.mark.parametrize("strategy", STRATEGIES)
@settings
@hypothesis.given(points=paths())
def test_pieces_join(strategy, points):
    contour = vorn.fit(points, tol=TOL, strategy=strategy, closed=False)
    for before, after in zip(contour, contour[1:]):
        assert before.end == after.start


@pytest.mark.parametrize("strategy", STRATEGIES)
@settings
@hypothesis.given(points=paths())
def test_the_points_of_the_pieces_follow_each_other(strategy, points):
    covered = [piece.points for piece in vorn.fit(points, tol=TOL, strategy=strategy,
                                                  closed=False)]
    assert covered[0][0] == 0 and covered[-1][1] == len(points) - 1
    assert all(first <= last for first, last in covered)
    assert all(b[0] - a[1] in (0, 1) for a, b in zip(covered, covered[1:]))


@settings
@hypothesis.given(points=paths(), power=st.integers(-20, 20))
def test_scaling_by_a_power_of_two_scales_the_contour(points, power):
    scale = 2.0 ** power
    contour = vorn.fit(points, tol=TOL, strategy="mixed", closed=False)
    scaled = vorn.fit(points * scale, tol=TOL * scale, strategy="mixed", closed=False)
    assert scaled.deviations(points * scale).max() <= TOL * scale * (1 + 1e-6)
    # Thresholds are absolute, so rounding may decide otherwise about the reach of a piece.
    hypothesis.assume(len(scaled) == len(contour))
    for a, b in zip(contour, scaled):
        assert type(a) is type(b) and a.points == b.points
        assert np.allclose(np.multiply(a.end, scale), b.end, rtol=0, atol=scale * TOL)


@pytest.mark.parametrize("strategy", STRATEGIES)
@settings
@hypothesis.given(points=paths(), dx=st.integers(-10**4, 10**4), dy=st.integers(-10**4, 10**4))
def test_a_shift_keeps_the_promise(strategy, points, dx, dy):
    moved = points + (dx, dy)
    contour = vorn.fit(moved, tol=TOL, strategy=strategy, closed=False)
    assert contour.deviations(moved).max() <= TOL * (1 + 1e-6)
    assert contour.shifted(-dx, -dy).deviations(points).max() <= TOL * (1 + 1e-6)


@pytest.mark.parametrize("strategy", STRATEGIES)
@settings
@hypothesis.given(points=paths())
def test_points_from_the_other_end_keep_the_promise(strategy, points):
    contour = vorn.fit(points[::-1], tol=TOL, strategy=strategy, closed=False)
    assert contour.deviations(points).max() <= TOL * (1 + 1e-6)
    back = contour.reversed()
    assert (back.start, back.end) == (contour.end, contour.start)
    assert back.reversed() == contour
    assert np.allclose(back.deviations(points), contour.deviations(points), rtol=0, atol=1e-12)
    assert back.length == pytest.approx(contour.length)


@settings
@hypothesis.given(points=paths())
def test_two_fits_have_the_same_bits(points):
    assert vorn.fit(points, tol=TOL) == vorn.fit(points.tolist(), tol=TOL)


@settings
@hypothesis.given(points=paths(), name=st.sampled_from(["json", "csv"]))
def test_text_brings_back_every_bit(points, name):
    contour = vorn.fit(points, tol=TOL, closed=False)
    assert vorn.Contour.from_text(contour.to_text(name), name) == contour


@settings
@hypothesis.given(points=paths(), name=st.sampled_from(["dxf", "wkt", "r2000", "svg", "geojson"]))
def test_text_brings_back_the_shape(points, name):
    contour = vorn.fit(points, tol=TOL, closed=False)
    options = {"r2000": {"dxf_version": "r2000"}, "svg": {"plain": True},
               "geojson": {"chords": 1e-7}}.get(name, {})
    name = name.replace("r2000", "dxf")
    again = vorn.Contour.from_text(contour.to_text(name, **options), name)
    assert again.deviations(contour.sample(0.01)).max() < 1e-6
    assert again.length == pytest.approx(contour.length)


@settings
@hypothesis.given(points=paths(), parts=st.integers(2, 9), at=st.integers(0, 10**6))
def test_a_split_changes_no_shape(points, parts, at):
    contour = vorn.fit(points, tol=TOL, closed=False)
    cut = contour.split(at % len(contour), parts)
    assert len(cut) == len(contour) + parts - 1
    assert cut.length == pytest.approx(contour.length)
    assert contour.deviations(cut.sample(0.01)).max() < 1e-9


@settings
@hypothesis.given(
    points=st.lists(st.tuples(*[st.floats(allow_nan=True, allow_infinity=True)] * 3), max_size=9))
def test_any_numbers_are_fitted_or_refused(points):
    try:
        contour = vorn.fit(points)
    except (vorn.ContourError, ValueError):
        return
    assert len(contour) > 0
