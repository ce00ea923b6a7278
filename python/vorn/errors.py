"""What the functions of this package raise."""

from __future__ import annotations

import enum
from typing import Any, Dict, Optional, Sequence, Type

__all__ = ["ContourError", "ErrorCode", "FileError", "NoFitError", "PointsTooCloseError",
           "SelfIntersectionError", "error_for"]


class ErrorCode(enum.IntEnum):
    """Why an operation failed; the numbers are those of the library.

    >>> ErrorCode(20).name
    'POINTS_TOO_CLOSE'
    """

    OK = 0
    INVALID_ARC_RADIUS = 1
    FAILED = 2
    OUT_OF_MEMORY = 4
    INTERSECTION_UNDEFINED = 6
    SELF_INTERSECTION = 19
    POINTS_TOO_CLOSE = 20
    ORIENTATION_MISMATCH = 21
    NO_FIT = 23
    INVALID_LINE_CELL = 24


class ContourError(ValueError):
    """An operation on points or contours that has no answer. Errors can be pickled, so they come
    back whole from other processes.

    Attributes
    ----------
    code : ErrorCode
        Why.
    indices : tuple of int
        The points concerned, as positions in the input; empty where it is about no point.

    Examples
    --------
    >>> import vorn
    >>> try:
    ...     vorn.fit([(0, 0), (1, 0), (float("nan"), 0)], tol=0.01)
    ... except vorn.ContourError as error:
    ...     print(error, error.code.name, error.indices)
    point 2: x or y is not finite FAILED (2,)
    """

    def __init__(self, message: str, code: int = ErrorCode.FAILED,
                 indices: Sequence[int] = ()) -> None:
        super().__init__(message)
        self.code = ErrorCode(code)
        self.indices = tuple(indices)

    def __reduce__(self) -> tuple[type, tuple[Any, ...]]:
        return type(self), (str(self), int(self.code), self.indices)


class PointsTooCloseError(ContourError):
    """Two neighbouring points are too close for their tolerances; `indices` names the two.

    The strategies "mixed" and "cells" need neighbours more than 1.5 times the sum of their
    tolerances apart. The strategy "fewest" does not.

    Attributes
    ----------
    distance : float or None
        How far the two are apart, in the unit of the points, with all digits; None where only the
        core was asked.
    needed : float or None
        What the distance must be above.

    Examples
    --------
    >>> import vorn
    >>> try:
    ...     vorn.fit([(0, 0), (0.1, 0), (2, 0)], tol=0.1, strategy="mixed")
    ... except vorn.PointsTooCloseError as error:
    ...     print(error, error.indices, error.needed)  # doctest: +ELLIPSIS
    points 0 and 1 are 0.1 apart, which must be more than 0.3 for ... (0, 1) 0.30000000000000004
    """

    def __init__(self, message: str, code: int = ErrorCode.POINTS_TOO_CLOSE,
                 indices: Sequence[int] = (), distance: Optional[float] = None,
                 needed: Optional[float] = None) -> None:
        super().__init__(message, code, indices)
        self.distance = distance
        self.needed = needed

    def __reduce__(self) -> tuple[type, tuple[Any, ...]]:
        return type(self), (str(self), int(self.code), self.indices, self.distance, self.needed)


class NoFitError(ContourError):
    """The points have no contour within their tolerances.

    The message says what happened, and `indices` names the point where: the one furthest out of its
    tolerance from the best single arc, or the first that no lines and arcs take in.

    >>> import vorn
    >>> try:
    ...     vorn.fit([(0, 0), (1, 1), (2, 0), (3, 1), (4, 0)], tol=0.01, strategy="arc")
    ... except vorn.NoFitError as error:
    ...     print(str(error).partition(";")[0])
    no single arc passes the points within their tolerances: point 2 is 0.701 from the circle of \
least squares, 70.1 times its tolerance
    """


class SelfIntersectionError(ContourError):
    """A contour crosses or touches itself where it must not.

    >>> import vorn.geometry
    >>> places = [(0, 0), (2, 2), (2, 0), (0, 2), (0, 0)]
    >>> try:
    ...     vorn.geometry.get_area([vorn.geometry.Elem.segment(place) for place in places])
    ... except vorn.SelfIntersectionError as error:
    ...     print(error.code.name)
    SELF_INTERSECTION
    """


class FileError(ContourError, OSError):
    """A file cannot be read or written, or holds something else than it should.

    Attributes
    ----------
    path : str
        The file.
    line : int
        Counted from 1; 0 where it is about no line.
    column : int
        Counted from 1; 0 where it is about no column.

    Examples
    --------
    >>> import vorn
    >>> try:
    ...     vorn.Contour.from_wkt("LINESTRING (0 0, one 1)")
    ... except vorn.FileError as error:
    ...     print(error.line, error.column)
    1 18
    """

    def __init__(self, message: str, path: str = "", line: int = 0, column: int = 0) -> None:
        ContourError.__init__(self, message)
        self.path = path
        self.line = line
        self.column = column

    def __str__(self) -> str:
        return str(self.args[0])

    def __reduce__(self) -> tuple[type, tuple[Any, ...]]:
        return type(self), (str(self), self.path, self.line, self.column)


_TYPES: Dict[int, Type[ContourError]] = {
    ErrorCode.POINTS_TOO_CLOSE: PointsTooCloseError,
    ErrorCode.NO_FIT: NoFitError,
    ErrorCode.SELF_INTERSECTION: SelfIntersectionError}


def error_for(message: str, code: int, indices: Sequence[int] = ()) -> ContourError:
    """The exception that goes with a code.

    >>> error_for("no arc", ErrorCode.NO_FIT)
    NoFitError('no arc')
    """
    return _TYPES.get(ErrorCode(code), ContourError)(message, code, indices)
