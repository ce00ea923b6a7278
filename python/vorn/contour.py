"""Contours of lines and arcs."""

from __future__ import annotations

from typing import Any, Iterable, Iterator, NamedTuple, Optional, Sequence, Tuple, Union, \
    overload

import numpy as np
import numpy.typing as npt

from vorn import _core
from vorn.contour_files import ContourFiles
from vorn.pieces import Arc, Line, Piece, Place, piece_of

__all__ = ["Contour", "Nearest"]

#: What holds for pieces bit by bit when contours are equal; the rest follows from it.
_DEFINING = ("start_x", "start_y", "end_x", "end_y", "center_x", "center_y", "radius", "is_arc",
             "ccw")


class FitFacts(NamedTuple):
    """What a fit tells about its contour."""

    max_deviation: Optional[float] = None
    max_index: Optional[int] = None
    fewest_possible: Optional[int] = None
    verdict: Optional[str] = None
    strategy: Optional[str] = None


class Nearest(NamedTuple):
    """The places of a contour that are nearest to some points."""

    #: (n, 2): the places.
    places: npt.NDArray[np.float64]
    #: (n,): the positions of the pieces that they lie on.
    pieces: npt.NDArray[np.int64]
    #: (n,): how far the points are from them.
    distances: npt.NDArray[np.float64]


class Contour(ContourFiles, Sequence[Piece]):
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

    Examples
    --------
    >>> import vorn
    >>> square = vorn.Contour.starting_at((0, 0)).append_line((2, 0)).append_line((2, 1))
    >>> square.append_arc((0, 1), center=(1, 1), ccw=True).append_line((0, 0))
    <Contour: 4 pieces (3 lines, 1 arc), closed, length 7.14159>
    """

    __slots__ = ("_rows", "_closed", "_units", "_facts", "_start")

    _rows: npt.NDArray[np.void]
    _closed: bool
    _units: str
    _facts: FitFacts
    _start: Optional[Place]

    def __init__(self, pieces: Iterable[Piece] = (), closed: Optional[bool] = None,
                 units: str = "") -> None:
        rows = [_row_of(piece) for piece in pieces]
        joined = np.concatenate(rows) if rows else _core.no_rows()
        self._set(joined, closed, units)

    def _set(self, rows: npt.NDArray[np.void], closed: Optional[bool], units: str,
             facts: FitFacts = FitFacts(), start: Optional[Place] = None) -> None:
        rows.flags.writeable = False
        self._rows = rows
        self._closed = bool(_core.returns_to_start(rows) if closed is None else closed)
        self._units = units
        self._facts = facts
        self._start = start

    @classmethod
    def _of(cls, rows: npt.NDArray[np.void], closed: Optional[bool] = None, units: str = "",
            facts: FitFacts = FitFacts(), start: Optional[Place] = None) -> Contour:
        contour = cls.__new__(cls)
        contour._set(rows, closed, units, facts, start)
        return contour

    @classmethod
    def starting_at(cls, start: Place, units: str = "") -> Contour:
        """A contour without pieces, to append to.

        >>> Contour.starting_at((1, 2)).append_line((4, 6)).length
        5.0
        """
        return cls._of(_core.no_rows(), False, units, start=(float(start[0]), float(start[1])))

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

    # What a fit tells.

    @property
    def max_deviation(self) -> Optional[float]:
        """Largest distance of a point from the contour in units of its tolerance, the larger of
        what the fit reports and what measuring shows; up to 1 is within. None for a contour that
        no fit made."""
        return self._facts.max_deviation

    @property
    def max_index(self) -> Optional[int]:
        """Position of the point with that deviation, or None."""
        return self._facts.max_index

    @property
    def fewest_possible(self) -> Optional[int]:
        """No contour within the tolerances has fewer pieces than this, which is proven; None for
        other strategies than "fewest"."""
        return self._facts.fewest_possible

    @property
    def verdict(self) -> Optional[str]:
        """How the fit ended: "within tolerance", "outside tolerance", "not closed" (the ends of a
        closed contour do not meet), "stops early" (before the last point), or None."""
        return self._facts.verdict

    @property
    def strategy(self) -> Optional[str]:
        """The strategy of the fit, or None."""
        return self._facts.strategy

    # Measures.

    @property
    def units(self) -> str:
        """The unit of all lengths, as files name it; may be empty."""
        return self._units

    @property
    def is_closed(self) -> bool:
        """Whether the contour runs back to its start."""
        return self._closed

    @property
    def start(self) -> Place:
        """Where the first piece starts. Raises IndexError for a contour without pieces or start."""
        if self._start is not None and not len(self):
            return self._start
        return self[0].start

    @property
    def end(self) -> Place:
        """Where the last piece ends."""
        return self[-1].end if len(self) else self.start

    @property
    def length(self) -> float:
        """Along all pieces."""
        return float(self._rows["length"].sum())

    @property
    def area(self) -> Optional[float]:
        """What a closed contour encloses, positive when it runs counter-clockwise; of one that
        crosses itself the sum over its loops. None for an open contour.

        >>> circle = Contour([Arc((1, 0), (-1, 0), (0, 0), 1.0, True, 3.141592653589793),
        ...                   Arc((-1, 0), (1, 0), (0, 0), 1.0, True, 3.141592653589793)])
        >>> round(circle.area, 12)
        3.14159265359
        """
        return _core.area(self._rows, self._closed)

    @property
    def bounds(self) -> Tuple[float, float, float, float]:
        """Least x, least y, largest x, largest y, the bulges of arcs included."""
        return _core.bounds(self._rows)

    @property
    def is_self_intersecting(self) -> bool:
        """Whether the contour crosses, touches or overlaps itself anywhere but at its joints."""
        return _core.meets_itself(self._rows, self._closed)

    def deviations(self, points: npt.ArrayLike, signed: bool = False) -> npt.NDArray[np.float64]:
        """How far points are from the nearest place of the contour.

        Parameters
        ----------
        points : (n, 2) or (n, 3) array-like
            Tolerances, if any, are not looked at.
        signed : bool
            Whether distances to the right of the sense of travel are negative.

        Returns
        -------
        (n,) array
            In the unit of the points.

        >>> line = Contour.starting_at((0, 0)).append_line((10, 0))
        >>> line.deviations([(1, 2), (5, -3), (13, 4)])
        array([2., 3., 5.])
        >>> line.deviations([(1, 2), (5, -3)], signed=True)
        array([ 2., -3.])
        """
        measure = _core.signed_distances if signed else _core.distances
        return measure(self._rows, points)

    def nearest(self, points: npt.ArrayLike) -> Nearest:
        """The nearest place of the contour for each point.

        Parameters
        ----------
        points : (n, 2) or (n, 3) array-like

        Examples
        --------
        >>> line = Contour.starting_at((0, 0)).append_line((10, 0))
        >>> line.nearest([(1, 2), (13, 4)]).places
        array([[ 1.,  0.],
               [10.,  0.]])
        """
        return Nearest(*_core.nearest(self._rows, points))

    def sample(self, chord: float) -> npt.NDArray[np.float64]:
        """Points along the contour whose straight connections leave it by at most `chord`.

        Returns
        -------
        (n, 2) array
            The ends of all pieces are among them.

        >>> Contour.starting_at((0, 0)).append_arc((2, 0), center=(1, 0), ccw=False).sample(0.3)
        array([[0., 0.],
               [1., 1.],
               [2., 0.]])
        """
        return _core.sample(self._rows, chord)

    # Other contours.

    def shifted(self, dx: float, dy: float) -> Contour:
        """The same contour moved by (dx, dy).

        >>> Contour.starting_at((0, 0)).append_line((1, 0)).shifted(2, 3).end
        (3.0, 3.0)
        """
        rows = self._rows.copy()
        for end in ("start", "end", "center"):
            rows[end + "_x"] += dx
            rows[end + "_y"] += dy
        start = None if self._start is None else (self._start[0] + dx, self._start[1] + dy)
        return self._of(rows, self._closed, self._units, self._facts, start)

    def reversed(self) -> Contour:
        """The same contour run through from its end to its start, without the points covered."""
        return self._of(_core.reversed_rows(self._rows), self._closed, self._units)

    def split(self, index: int, parts: int = 2) -> Contour:
        """The same contour with one piece cut into parts of equal length.

        >>> [p.end for p in Contour.starting_at((0, 0)).append_line((4, 0)).split(0)]
        [(2.0, 0.0), (4.0, 0.0)]
        """
        at = range(len(self))[index]
        cut = _core.split(self._rows[at:at + 1], parts)
        return self._of(np.concatenate((self._rows[:at], cut, self._rows[at + 1:])), self._closed,
                        self._units)

    def append_line(self, end: Place) -> Contour:
        """The contour with a line from its end to `end` behind it."""
        return self._with(_core.line(self.end, end))

    def append_arc(self, end: Place, center: Place, ccw: bool) -> Contour:
        """The contour with an arc from its end to `end` behind it.

        Parameters
        ----------
        end : (float, float)
            As far from the center as the end of the contour is.
        center : (float, float)
        ccw : bool
            Whether the arc runs counter-clockwise.
        """
        return self._with(_core.arc(self.end, end, center, ccw))

    def _with(self, row: npt.NDArray[np.void]) -> Contour:
        return self._of(np.concatenate((self._rows, row)), None, self._units)

    # Files.

    def as_arrays(self) -> npt.NDArray[np.void]:
        """One row for each piece, as a structured array that can be changed.

        The fields are start_x, start_y, end_x, end_y, center_x, center_y, radius, start_angle,
        end_angle, sweep, length (floats; those of arcs are not-a-number for lines, but sweep is 0),
        first_point, last_point (integers, -1 where not known), is_arc and ccw.
        ``pandas.DataFrame(contour.as_arrays())`` takes it as it is.

        >>> Contour.starting_at((0, 0)).append_line((3, 4)).as_arrays()["length"]
        array([5.])
        """
        return self._rows.copy()

    def to_shapely(self, chord: float) -> Any:
        """A shapely Polygon of a closed contour that does not cross itself, else a LineString,
        arcs replaced by chords that leave them by at most `chord`. Needs shapely."""
        import shapely.geometry

        places = self.sample(chord)
        if self.is_closed:
            return shapely.geometry.Polygon(places)
        return shapely.geometry.LineString(places)


def _counted(count: int, noun: str) -> str:
    return f"{count} {noun}" + ("" if count == 1 else "s")


def _row_of(piece: Piece) -> npt.NDArray[np.void]:
    if isinstance(piece, Arc):
        row = _core.arc(piece.start, piece.end, piece.center, piece.ccw)
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
