"""Contours of lines and arcs."""

from __future__ import annotations

from typing import Any, Iterable, Iterator, Optional, Sequence, Tuple, Union, overload

import numpy as np
import numpy.typing as npt

from vorn import _core
from vorn.contour_edits import ContourEdits
from vorn.contour_facts import ContourFacts
from vorn.contour_files import ContourFiles
from vorn.contour_measures import ContourMeasures, Nearest
from vorn.contour_outlines import ContourOutlines
from vorn.contour_rows import FitFacts
from vorn.pieces import Piece, Place, piece_of, row_of

__all__ = ["Contour", "Nearest"]

#: What holds for pieces bit by bit when contours are equal; the rest follows from it.
_DEFINING = ("start_x", "start_y", "end_x", "end_y", "center_x", "center_y", "radius", "is_arc",
             "ccw")


class Contour(ContourFacts, ContourMeasures, ContourEdits, ContourOutlines, ContourFiles,
              Sequence[Piece]):
    """Lines and arcs that follow each other: an immutable sequence of `Line` and `Arc` values.

    `vorn.fit` makes contours from points, `Contour.read` reads them from files, and
    ``Contour(pieces)`` builds one. Lengths are in the unit of the points, angles in radians, and
    counter-clockwise means so with the y axis pointing up.

    Contours are equal when their pieces are equal in every bit and both or neither are closed; they
    can be hashed, and pickled in about 112 bytes for each piece.

    Parameters
    ----------
    pieces : iterable of Line and Arc
        The pieces in their order; each should start where the one before ends.
    closed : bool, optional
        Whether the contour runs back to its start; None to judge by its ends.
    units : str
        "mm", "inch" and so on, for files; may be empty.

    Raises
    ------
    TypeError
        A piece is neither a Line nor an Arc.
    ContourError
        A place is not finite, or a radius or sweep is none.

    Examples
    --------
    >>> import vorn
    >>> square = vorn.Contour.starting_at((0, 0)).append_line((2, 0)).append_line((2, 1))
    >>> square.append_arc((0, 1), center=(1, 1), ccw=True).append_line((0, 0))
    <Contour: 4 pieces (3 lines, 1 arc), closed, length 7.14159>
    """

    __slots__ = ()

    def __init__(self, pieces: Iterable[Piece] = (), closed: Optional[bool] = None,
                 units: str = "") -> None:
        rows = [row_of(piece) for piece in pieces]
        joined = np.concatenate(rows) if rows else _core.no_rows()
        self._set(joined, closed, units)

    # A sequence of pieces.

    def __len__(self) -> int:
        return len(self._rows)

    @overload
    def __getitem__(self, index: int) -> Piece: ...

    @overload
    def __getitem__(self, index: slice) -> Contour: ...

    def __getitem__(self, index: Union[int, slice]) -> Union[Piece, Contour]:
        if isinstance(index, slice):
            return self._of(self._rows[index].copy(), None, self._units)
        return piece_of(self._rows[index])

    def __iter__(self) -> Iterator[Piece]:
        return map(piece_of, self._rows)

    def as_arrays(self) -> npt.NDArray[np.void]:
        """One row for each piece, as a structured array that can be changed.

        The fields are start_x, start_y, end_x, end_y, center_x, center_y, radius, start_angle,
        end_angle, sweep, length (floats, angles in radians; those of arcs are not-a-number for
        lines, but sweep is 0), first_point, last_point (integers, -1 where not known), is_arc and
        ccw. ``pandas.DataFrame(contour.as_arrays())`` takes it as it is.

        >>> Contour.starting_at((0, 0)).append_line((3, 4)).as_arrays()["length"]
        array([5.])
        """
        return self._rows.copy()

    # A value.

    def __eq__(self, other: object) -> bool:
        if not isinstance(other, Contour):
            return NotImplemented
        return self._key() == other._key()

    def __hash__(self) -> int:
        return hash(self._key())

    def _key(self) -> Tuple[Any, ...]:
        return (self._closed, self._start,
                *(self._rows[name].tobytes() for name in _DEFINING))

    def __reduce__(self) -> Tuple[Any, ...]:
        return _restore, (self._rows.tobytes(), self._closed, self._units, tuple(self._facts),
                          self._start)

    def __repr__(self) -> str:
        arcs = int(self._rows["is_arc"].sum())
        lines = len(self) - arcs
        state = "closed" if self.is_closed else "open"
        return (f"<Contour: {_counted(len(self), 'piece')} ({_counted(lines, 'line')}, "
                f"{_counted(arcs, 'arc')}), {state}, length {self.length:.6g}>")


def _counted(count: int, noun: str) -> str:
    return f"{count} {noun}" + ("" if count == 1 else "s")


def _restore(rows: bytes, closed: bool, units: str, facts: Tuple[Any, ...],
             start: Optional[Place]) -> Contour:
    """A contour from what pickling keeps of it."""
    dtype = _core.no_rows().dtype
    return Contour._of(np.frombuffer(rows, dtype=dtype).copy(), closed, units, FitFacts(*facts),
                       start)


def fitted(rows: npt.NDArray[np.void], closed: bool, facts: Tuple[Any, ...],
           units: str = "") -> Contour:
    """The contour that a fit answered."""
    return Contour._of(rows, closed, units, FitFacts(*facts))
