"""The line and the circle that are nearest to points."""

from __future__ import annotations

from typing import NamedTuple, Optional

import numpy.typing as npt

from vorn import _core
from vorn.pieces import Place

__all__ = ["LeastSquaresCircle", "LeastSquaresLine", "least_squares_circle",
           "least_squares_line"]


class LeastSquaresLine(NamedTuple):
    """What `least_squares_line` answers; lengths are in the unit of the points.

    Attributes
    ----------
    place : (float, float)
        The mean of the points, which the line runs through.
    direction : float
        Polar angle in (-pi/2, pi/2], radians.
    form_error : float
        From the outermost point on one side to the outermost on the other.
    deviation : float or None
        Standard deviation of the points about the line; None for two points.
    direction_deviation : float or None
        Standard deviation of the direction in radians, if the distances are independent.

    Examples
    --------
    >>> least_squares_line([(0, 0), (1, 1), (2, 2)]).place
    (1.0, 1.0)
    """

    place: Place
    direction: float
    form_error: float
    deviation: Optional[float]
    direction_deviation: Optional[float]


class LeastSquaresCircle(NamedTuple):
    """What `least_squares_circle` answers; lengths are in the unit of the points.

    Attributes
    ----------
    center : (float, float)
    radius : float
    form_error : float
        From the outermost point on one side to the outermost on the other.
    deviation : float or None
        Standard deviation of the points about the circle; None for three points.
    radius_deviation : float or None
        Standard deviation of the radius, if the distances are independent. On a flat arc it is much
        larger than that of the points.

    Examples
    --------
    >>> least_squares_circle([(1, 0), (0, 1), (-1, 0)]).form_error < 1e-15
    True
    """

    center: Place
    radius: float
    form_error: float
    deviation: Optional[float]
    radius_deviation: Optional[float]


def least_squares_line(points: npt.ArrayLike) -> LeastSquaresLine:
    """The line with the least sum of squared orthogonal distances from points (n, 2) or (n, 3);
    tolerances are not looked at.

    Raises
    ------
    ContourError
        There are no two different points, or one is not finite.

    Examples
    --------
    >>> line = least_squares_line([(0, 0.1), (1, -0.1), (2, -0.1), (3, 0.1)])
    >>> line.direction, round(line.form_error, 12)
    (0.0, 0.2)
    """
    return LeastSquaresLine(*_core.least_squares_line(points))


def least_squares_circle(points: npt.ArrayLike) -> LeastSquaresCircle:
    """The circle with the least sum of squared orthogonal distances from points (n, 2) or (n, 3);
    tolerances are not looked at.

    Raises
    ------
    ContourError
        There are no three points off one line, or one is not finite.

    Examples
    --------
    >>> circle = least_squares_circle([(3, 0), (0, 3), (-3, 0), (0, -3)])
    >>> round(circle.radius, 12)
    3.0
    """
    return LeastSquaresCircle(*_core.least_squares_circle(points))
