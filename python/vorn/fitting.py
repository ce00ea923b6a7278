"""From points to contours."""

from __future__ import annotations

from typing import Any, Callable, Optional, Tuple, Union

import numpy.typing as npt

from vorn import _core
from vorn.contour import Contour, fitted
from vorn.points import units_of

__all__ = ["fit"]

#: Told the percentage that is done; or a tqdm bar, or tqdm itself.
Progress = Union[Callable[[int], Any], Any]


def fit(points: Any, tol: Optional[npt.ArrayLike] = None, strategy: Optional[str] = None,
        closed: Union[str, bool] = "auto", progress: Optional[Progress] = None,
        units: Optional[str] = None, **options: Any) -> Contour:
    """A contour of lines and arcs that passes every point within its tolerance.

    Parameters
    ----------
    points : array-like
        In the order of the path: (n, 2) with x and y, (n, 3) with x, y and tolerance, of any number
        type and strides, masked nowhere, or a frame with the columns x, y and perhaps w (the
        tolerance). They are copied once. What `read_points` answers brings its unit along.
    tol : float or (n,) array-like, optional
        How far the contour may pass from the points, in their unit; goes before the tolerances that
        the points bring.
    strategy : str, optional
        "fewest", which is used if none is said: as few pieces as the tolerances allow, at any
        spacing of the points; where these lie far apart, its arcs may bulge between them. "mixed":
        lines and arcs compared run by run. "cells": lines first, arcs between them. "arc": one arc
        for all points.
    closed : "auto", bool, "yes" or "no"
        Whether the contour runs back to its start; "auto" judges by the ends of the points.
    progress : callable, optional
        Called with the percentage that is done, never falling. A tqdm bar does as well, and so
        does ``tqdm.tqdm`` itself. What it raises comes out of the fit.
    units : str, optional
        The unit of the points, for files and drawings; that which they bring if not said.
    tolerance_per_point : float, optional
        In place of `tol`: the smaller of this cap and 0.3 times the distance to the nearer
        neighbour, see `vorn.tolerance_per_point`.
    start : int, optional
        Where a closed contour is cut open, as a position in the points; not for "fewest".
    effort : "quick", "wide" or "full", optional
        How hard "fewest" looks for fewer pieces. What follows is for "fewest" as well; lengths are
        in the unit of the points.
    centre : bool
        Whether deviations are brought down once the pieces are found; True if not said.
    segments_only : bool
        Whether arcs are left out; False if not said.
    largest_step : float
        The largest angle between neighbouring points on an arc, radians; pi / 3 if not said.
    smallest_radius, largest_radius : float
        The limits of radii; 0 and infinity if not said.
    farthest_between_points : float
        How far a piece may leave the straight path between neighbouring points; infinity if not
        said.

    Returns
    -------
    Contour
        Look at its `verdict` and `max_deviation`.

    Raises
    ------
    PointsTooCloseError
        Two neighbours are too close for their tolerances; for "mixed" and "cells".
    NoFitError
        There is no contour within the tolerances; the message tells at which point.
    ContourError
        The points have no tolerances, or a value that is none, or are too few.
    TypeError
        The points or an option are of a type that cannot be used: texts, complex numbers, missing
        values and so on, or there is no such option.
    ValueError
        The points have another shape, some are masked, or an option is none of its words.

    Warns
    -----
    UserWarning
        A tolerance is so small beside the extent of the points that the fit may take minutes.

    Notes
    -----
    The interpreter lock is released, so fits in several threads run side by side, and an
    interruption from the keyboard ends a fit.

    Examples
    --------
    >>> import vorn
    >>> vorn.fit([(0, 0), (1, 0), (2, 0), (2, 1), (2, 2)], tol=0.01)
    <Contour: 2 pieces (2 lines, 0 arcs), open, length 4>
    """
    options.update(strategy=strategy, closed=closed)
    report, close = _reporter(progress)
    try:
        return fitted(*_core.fit(points, tol, options, report),
                      units=units_of(points) if units is None else units)
    finally:
        close()


def _nothing() -> None:
    pass


def _reporter(
        progress: Optional[Progress]
) -> Tuple[Optional[Callable[[int], Any]], Callable[[], Any]]:
    """What is called with percentages, and what is called at the end."""
    if isinstance(progress, type) and hasattr(progress, "update"):
        bar = progress(total=100)
        return _filling(bar), bar.close
    if hasattr(progress, "update") and hasattr(progress, "n"):
        return _filling(progress), _nothing
    return progress, _nothing


def _filling(bar: Any) -> Callable[[int], Any]:
    """Moves a bar on from where this fit found it."""
    begin = bar.n
    return lambda percent: bar.update(begin + percent - bar.n)
