"""The pieces of a contour."""

from __future__ import annotations

import dataclasses
import math
from typing import Optional, Tuple, Union

import numpy as np
import numpy.typing as npt

from vorn import _core
from vorn.errors import ErrorCode, error_for

__all__ = ["Arc", "Line", "Piece", "Place"]

#: A place in the plane: x and y, in the unit of the points.
Place = Tuple[float, float]


@dataclasses.dataclass(frozen=True)
class Line:
    """A straight piece of a contour.

    Attributes
    ----------
    start : (float, float)
        Where it begins, (x, y).
    end : (float, float)
        Where it ends, (x, y).
    points : (int, int) or None
        Positions of the first and the last point that it covers; None when that is not known. In
        a closed contour first > last means from first to the end of the input and on from its
        beginning to last. Neighbouring pieces may share a point.

    Examples
    --------
    >>> Line((0, 0), (3, 4)).length
    5.0
    """

    start: Place
    end: Place
    points: Optional[Tuple[int, int]] = None

    @property
    def length(self) -> float:
        """From start to end, in the unit of the points.

        >>> Line((1, 1), (1, 3)).length
        2.0
        """
        # As the library rounds it; math.hypot may differ in the last bit.
        return float(np.hypot(self.end[0] - self.start[0], self.end[1] - self.start[1]))


@dataclasses.dataclass(frozen=True)
class Arc:
    """A piece of a contour along a circle, always less than a full turn.

    Attributes
    ----------
    start : (float, float)
        Where it begins, (x, y).
    end : (float, float)
        Where it ends, (x, y).
    center : (float, float)
        Of the circle.
    radius : float
        Of the circle, above 0.
    ccw : bool
        Whether it runs counter-clockwise, the y axis pointing up.
    sweep : float
        Radians turned from start to end, never negative.
    points : (int, int) or None
        As for Line.

    Examples
    --------
    >>> Arc((1, 0), (0, 1), (0, 0), 1.0, True, 1.5).length
    1.5
    """

    start: Place
    end: Place
    center: Place
    radius: float
    ccw: bool
    sweep: float
    points: Optional[Tuple[int, int]] = None

    @property
    def length(self) -> float:
        """Along the arc, in the unit of the points.

        >>> Arc((2, 0), (0, 2), (0, 0), 2.0, True, 1.5).length
        3.0
        """
        return self.radius * self.sweep


#: What a contour is made of.
Piece = Union[Line, Arc]


def piece_of(row: np.void) -> Piece:
    """The piece that a row of ``Contour.as_arrays`` describes."""
    r = row.item()
    points = None if r[11] < 0 else (r[11], r[12])
    if not r[13]:
        return Line((r[0], r[1]), (r[2], r[3]), points)
    return Arc((r[0], r[1]), (r[2], r[3]), (r[4], r[5]), r[6], r[14], r[9], points)


def row_of(piece: Piece) -> npt.NDArray[np.void]:
    """The row, alone in its array, that describes a piece."""
    if isinstance(piece, Arc):
        row = _core.arc(piece.start, piece.end, piece.center, piece.ccw)
        if not (0 < piece.radius < math.inf and 0 <= piece.sweep < math.inf):
            raise error_for(f"an arc has no radius above 0 or no sweep: {piece!r}",
                            ErrorCode.INVALID_ARC_RADIUS)
        row["radius"] = piece.radius
        row["sweep"] = piece.sweep
        row["length"] = piece.length
    elif isinstance(piece, Line):
        row = _core.line(piece.start, piece.end)
    else:
        raise TypeError(f"a contour is made of Line and Arc values, not {piece!r}")
    if piece.points is not None:
        row["first_point"], row["last_point"] = piece.points
    return row
