"""Contours made of other contours."""

from __future__ import annotations

from typing import Type, TypeVar

import numpy as np
import numpy.typing as npt

from vorn import _core
from vorn.contour_rows import ContourRows
from vorn.errors import ContourError
from vorn.pieces import Place

#: The places of every piece.
_ENDS = ("start_x", "start_y", "end_x", "end_y")

_Contour = TypeVar("_Contour", bound="ContourEdits")


class ContourEdits(ContourRows):
    """The part of `Contour` that makes other contours; the contour itself stays as it is."""

    __slots__ = ()

    @classmethod
    def starting_at(cls: Type[_Contour], start: Place, units: str = "") -> _Contour:
        """A contour without pieces, to append to.

        Parameters
        ----------
        start : (float, float)
        units : str
            "mm", "inch" and so on, for files; may be empty.

        Raises
        ------
        ContourError
            The start is not finite.

        Examples
        --------
        >>> from vorn import Contour
        >>> Contour.starting_at((1, 2)).append_line((4, 6)).length
        5.0
        """
        x, y = _core.line(start, start)[["start_x", "start_y"]].item()
        return cls._of(_core.no_rows(), False, units, start=(x, y))

    @property
    def start(self) -> Place:
        """Where the first piece starts, (x, y). Raises IndexError for a contour without pieces or
        start.

        >>> from vorn import Contour
        >>> Contour.starting_at((1, 2)).append_line((4, 6)).start
        (1.0, 2.0)
        """
        if len(self._rows):
            return float(self._rows[0]["start_x"]), float(self._rows[0]["start_y"])
        if self._start is None:
            raise IndexError("the contour has no start")
        return self._start

    @property
    def end(self) -> Place:
        """Where the last piece ends, (x, y); the start of a contour without pieces.

        >>> from vorn import Contour
        >>> Contour.starting_at((1, 2)).append_line((4, 6)).end
        (4.0, 6.0)
        """
        if len(self._rows):
            return float(self._rows[-1]["end_x"]), float(self._rows[-1]["end_y"])
        return self.start

    def shifted(self: _Contour, dx: float, dy: float) -> _Contour:
        """The same contour moved by (dx, dy), in the unit of the points. Raises ContourError where
        that leaves the range of numbers.

        >>> from vorn import Contour
        >>> Contour.starting_at((0, 0)).append_line((1, 0)).shifted(2, 3).end
        (3.0, 3.0)
        """
        rows = self._rows.copy()
        with np.errstate(over="ignore", invalid="ignore"):
            for end in ("start", "end", "center"):
                rows[end + "_x"] += dx
                rows[end + "_y"] += dy
        start = None if self._start is None else (self._start[0] + dx, self._start[1] + dy)
        if not np.isfinite([dx, dy, *(rows[name].sum() for name in _ENDS)]).all():
            raise ContourError(f"a contour cannot be moved by {dx!r}, {dy!r}")
        return self._of(rows, self._closed, self._units, self._facts, start)

    def reversed(self: _Contour) -> _Contour:
        """The same contour run through from its end to its start, without the points covered.

        >>> from vorn import Contour
        >>> Contour.starting_at((0, 0)).append_line((1, 0)).reversed()[0]
        Line(start=(1.0, 0.0), end=(0.0, 0.0), points=None)
        """
        return self._of(_core.reversed_rows(self._rows), self._closed, self._units)

    def split(self: _Contour, index: int, parts: int = 2) -> _Contour:
        """The same contour with one piece cut into parts of equal length.

        Parameters
        ----------
        index : int
            The position of the piece; negative ones count from the end.
        parts : int
            How many, 2 or more.

        Raises
        ------
        IndexError
            There is no such piece.
        ValueError
            There would be less than two parts.

        Examples
        --------
        >>> from vorn import Contour
        >>> [p.end for p in Contour.starting_at((0, 0)).append_line((4, 0)).split(0)]
        [(2.0, 0.0), (4.0, 0.0)]
        """
        at = range(len(self._rows))[index]
        cut = _core.split(self._rows[at:at + 1], parts)
        return self._of(np.concatenate((self._rows[:at], cut, self._rows[at + 1:])), self._closed,
                        self._units)

    def append_line(self: _Contour, end: Place) -> _Contour:
        """The contour with a line from its end to `end`, (x, y), behind it. Raises ContourError for
        a place that is not finite.

        >>> from vorn import Contour
        >>> Contour.starting_at((0, 0)).append_line((1, 0)).append_line((1, 1)).length
        2.0
        """
        return self._with(_core.line(self.end, end))

    def append_arc(self: _Contour, end: Place, center: Place, ccw: bool) -> _Contour:
        """The contour with an arc from its end to `end` behind it.

        Parameters
        ----------
        end : (float, float)
            As far from the center as the end of the contour is.
        center : (float, float)
        ccw : bool
            Whether the arc runs counter-clockwise, the y axis pointing up.

        Raises
        ------
        ContourError
            A place is not finite, or the center is the end of the contour.

        Examples
        --------
        >>> from vorn import Contour
        >>> bend = Contour.starting_at((0, 0)).append_arc((2, 2), center=(0, 2), ccw=True)
        >>> bend[0].radius, round(bend.length, 6)
        (2.0, 3.141593)
        """
        return self._with(_core.arc(self.end, end, center, ccw))

    def _with(self: _Contour, row: npt.NDArray[np.void]) -> _Contour:
        return self._of(np.concatenate((self._rows, row)), None, self._units)
