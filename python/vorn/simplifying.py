"""Fewer points, so that a fit can work with the rest."""

from __future__ import annotations

from typing import Any, List, NamedTuple, Optional, Union

import numpy as np
import numpy.typing as npt

from vorn import _core
from vorn.points import Points, units_of

__all__ = ["Outlier", "Scatter", "Simplified", "simplify"]


class Outlier(NamedTuple):
    """A point that its neighbours do not bear out.

    Attributes
    ----------
    point : int
        Its position in the input.
    distance : float
        How far it is from where its neighbours have it, in the unit of the points.
    deviations : float
        The same in standard deviations of all such distances.

    Examples
    --------
    >>> points = [(x, 0.001 * (x % 3)) for x in range(30)]
    >>> points[15] = (15, 1.0)
    >>> simplify(points, outliers=6).outliers[0].point
    15
    """

    point: int
    distance: float
    deviations: float


class Scatter(NamedTuple):
    """How the points of the windows lie that means stand for.

    Attributes
    ----------
    mean_deviation : float
        Root of the mean of the squared standard deviations across the path of all windows.
    largest_deviation : float
        That of the window where it is largest.
    fewest, most : int
        How many points the smallest and the largest window hold.

    Examples
    --------
    >>> simplify([(x, 0) for x in range(20)], spacing=5, average=True).scatter.most
    5
    """

    mean_deviation: float
    largest_deviation: float
    fewest: int
    most: int


class Simplified(NamedTuple):
    """What `simplify` answers.

    Attributes
    ----------
    points : Points
        Those that are left, or the means; with their tolerances if the input has some.
    kept : (m,) array of int
        The positions of those that were kept, ascending; of means, of those that they stand for.
    dropped : (k,) array of int
        The positions of the others.
    outliers : list of Outlier
    scatter : Scatter or None
        None where nothing was averaged.

    Examples
    --------
    >>> simplify([(x, 0) for x in range(9)], spacing=4).kept
    array([0, 4, 8])
    """

    points: Points
    kept: npt.NDArray[np.int64]
    dropped: npt.NDArray[np.int64]
    outliers: List[Outlier]
    scatter: Optional[Scatter]


def simplify(points: npt.ArrayLike, tol: Optional[npt.ArrayLike] = None, *,
             outliers: Optional[float] = None, spacing: Optional[float] = None,
             average: bool = False, drop_close: bool = False,
             tolerance_per_point: Optional[float] = None,
             closed: Union[str, bool] = "auto") -> Simplified:
    """Leaves points out, as the program ``contour simplify`` does: first outliers, then by the
    spacing, then those too close for their tolerances.

    Parameters
    ----------
    points : (n, 2) or (n, 3) array-like
        In the order of the path, perhaps with tolerances.
    tol : float or (n,) array-like, optional
        Tolerances, in place of those of the points.
    outliers : float, optional
        Leave out points further than so many standard deviations from where their neighbours have
        them, but none that is there within its tolerance.
    spacing : float, optional
        Keep the first point, always the next one at least so far along the path, and the last.
    average : bool
        Take the means of the points in windows of `spacing` along the path in their place.
    drop_close : bool
        Leave out points that are too close to the one before for the strategies "mixed" and
        "cells"; without tolerances, those in one place.
    tolerance_per_point : float, optional
        Tolerances are to follow the spacing, up to this cap; in place of `tol`.
    closed : "auto", bool, "yes" or "no"
        Whether the first and the last point are neighbours, for `drop_close`.

    Returns
    -------
    Simplified
        Named (points, kept, dropped, outliers, scatter).

    Raises
    ------
    PointsTooCloseError
        Fewer than two points would be left.
    ContourError
        A point or a tolerance is not finite, or there are too few points.
    TypeError
        Nothing is to be done, or tol and tolerance_per_point are both said.
    ValueError
        A number is not above 0, or average lacks a spacing.

    Examples
    --------
    >>> import vorn
    >>> dense = [(0.01 * i, 0.0) for i in range(101)]
    >>> spaced = vorn.simplify(dense, tol=0.02, drop_close=True)
    >>> len(spaced.points), vorn.fit(spaced.points, strategy="mixed").verdict
    (16, 'within tolerance')
    """
    _require_work(outliers, spacing, average, drop_close)
    if tol is not None and tolerance_per_point is not None:
        raise TypeError("tol and tolerance_per_point cannot both be said")
    values = _core.usable_points(points, tol)
    rest, kept = values, np.arange(len(values))
    found: List[Outlier] = []
    scatter = None
    if outliers is not None:
        found = _outliers(values, outliers, tolerance_per_point)
        kept = np.setdiff1d(kept, [outlier.point for outlier in found])
        rest = values[kept]
    if average:
        rest, mean, largest, fewest, most = _core.average_along(rest, spacing)
        scatter = Scatter(mean, largest, fewest, most)
    elif spacing is not None:
        left = _core.keep_every(rest, spacing)
        rest, kept = rest[left], kept[left]
    if drop_close:
        left = _core.keep_spaced(rest, tolerance_per_point, closed)
        rest, kept = rest[left], kept if average else kept[left]
    return Simplified(Points(rest, units_of(points)), kept,
                      np.setdiff1d(np.arange(len(values)), kept), found, scatter)


def _require_work(outliers: Optional[float], spacing: Optional[float], average: bool,
                  drop_close: bool) -> None:
    if outliers is None and spacing is None and not drop_close:
        raise TypeError("nothing is to be done: say outliers, spacing or drop_close")
    if average and spacing is None:
        raise ValueError("average needs the spacing")


def _outliers(values: npt.NDArray[np.float64], deviations: float,
              cap: Optional[float]) -> List[Outlier]:
    """A point that its neighbours bear out within its tolerance is none, however exact the others
    are."""
    limits: Any = cap or 0.0
    if cap is None and values.shape[1] > 2:
        limits = values[:, 2]
    limits = np.broadcast_to(limits, len(values))
    return [outlier for outlier in map(Outlier._make, _core.find_outliers(values, deviations))
            if not outlier.distance <= limits[outlier.point]]
