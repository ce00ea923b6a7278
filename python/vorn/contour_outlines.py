"""Contours beside each other: outlines, gaps, places in common."""

from __future__ import annotations

from typing import Any, Iterable, List, NamedTuple, Optional, Sequence, Tuple, TypeVar, Union, \
    overload

import numpy.typing as npt

from vorn import _core
from vorn.contour_rows import ContourRows
from vorn.pieces import Place

_Contour = TypeVar("_Contour", bound="ContourOutlines")


class Gap(NamedTuple):
    """Two pieces that follow each other but do not meet.

    Attributes
    ----------
    before, after : int
        Positions of the pieces; after is 0 for the seam of a closed contour.
    size : float
        How far the two ends are apart.

    Examples
    --------
    >>> from vorn import Contour, Line
    >>> Contour([Line((0, 0), (1, 0)), Line((1, 2), (0, 2))]).gaps()
    [Gap(before=0, after=1, size=2.0)]
    """

    before: int
    after: int
    size: float


class Intersection(NamedTuple):
    """A place that two contours, or two parts of one, have in common.

    Attributes
    ----------
    kind : str
        "crossing": each passes to the other side. "touching": they stay on one side, run in one
        direction there, or one of them ends there. "overlap": they share a stretch, from `place` to
        `until`.
    place : (float, float)
        Of a stretch its first place.
    until : (float, float) or None
        Where a stretch ends.
    piece, position : int, float
        On the first contour: the piece, and the length from the start up to there.
    other_piece, other_position : int, float
        The same on the other contour, or on the later part of the same one.

    Examples
    --------
    >>> from vorn import Contour
    >>> a = Contour.starting_at((0, 0)).append_line((4, 0))
    >>> b = Contour.starting_at((1, -1)).append_line((1, 1))
    >>> a.intersections(b)[0].place
    (1.0, 0.0)
    """

    kind: str
    place: Place
    until: Optional[Place]
    piece: int
    position: float
    other_piece: int
    other_position: float


class Intersections(Sequence[Intersection]):
    """All places that contours have in common, sorted along the first; from
    `Contour.intersections`.

    >>> from vorn import Contour
    >>> eight = Contour.starting_at((0, 0)).append_line((2, 2)).append_line((2, 0))
    >>> places = eight.append_line((0, 2)).intersections()
    >>> places, places[0].place
    (<Intersections: 1 crossing, 0 touching, 0 overlap>, (1.0, 1.0))
    """

    __slots__ = ("_meetings", "_places")

    def __init__(self, meetings: _core.Meetings) -> None:
        self._meetings = meetings
        self._places = [Intersection(*place) for place in meetings.places()]

    def __len__(self) -> int:
        return len(self._places)

    @overload
    def __getitem__(self, index: int) -> Intersection: ...

    @overload
    def __getitem__(self, index: slice) -> List[Intersection]: ...

    def __getitem__(self, index: Union[int, slice]) -> Union[Intersection, List[Intersection]]:
        return self._places[index]

    def __repr__(self) -> str:
        kinds = [place.kind for place in self._places]
        counts = (f"{kinds.count(kind)} {kind}" for kind in ("crossing", "touching", "overlap"))
        return f"<Intersections: {', '.join(counts)}>"

    def to_json(self) -> str:
        """The places as JSON, every digit; pieces are numbered from 1 there.

        >>> from vorn import Contour
        >>> a = Contour.starting_at((0, 0)).append_line((4, 0))
        >>> '"crossing"' in a.intersections(a.shifted(1, 0)).to_json()
        False
        """
        return self._meetings.to_json()

    def to_csv(self) -> str:
        """The places as CSV; pieces are numbered from 1 there.

        >>> from vorn import Contour
        >>> a = Contour.starting_at((0, 0)).append_line((4, 0))
        >>> "overlap" in a.intersections(a.shifted(1, 0)).to_csv()
        True
        """
        return self._meetings.to_csv()


class OutlineArea(NamedTuple):
    """What one closed contour encloses; one of `measure_areas`.

    Attributes
    ----------
    area : float
        Positive counter-clockwise; of a contour that crosses itself the sum over its loops.
    perimeter : float
        With the straight bridges over gaps.
    centroid : (float, float) or None
        None for a contour that crosses itself or encloses nothing.
    depth : int
        In how many of the contours it lies.
    is_hole : bool
        Whether it takes away from the one around it.
    crosses_itself : bool
    gaps : int
        How many gaps were bridged.

    Examples
    --------
    >>> from vorn import Contour
    >>> square = Contour.starting_at((0, 0))
    >>> for place in [(2, 0), (2, 2), (0, 2), (0, 0)]:
    ...     square = square.append_line(place)
    >>> measure_areas([square])[0].centroid
    (1.0, 1.0)
    """

    area: float
    perimeter: float
    centroid: Optional[Place]
    depth: int
    is_hole: bool
    crosses_itself: bool
    gaps: int


class Areas(Sequence[OutlineArea]):
    """The areas of several contours, some of which may be holes in others; from `measure_areas`.

    >>> from vorn import Contour
    >>> square = Contour.starting_at((0, 0))
    >>> for place in [(2, 0), (2, 2), (0, 2), (0, 0)]:
    ...     square = square.append_line(place)
    >>> len(measure_areas([square, square.shifted(5, 0)]))
    2
    """

    __slots__ = ("_areas", "_measures")

    def __init__(self, areas: _core.Areas) -> None:
        self._areas = areas
        self._measures = [OutlineArea(*measure) for measure in areas.measures()]

    def __len__(self) -> int:
        return len(self._measures)

    @overload
    def __getitem__(self, index: int) -> OutlineArea: ...

    @overload
    def __getitem__(self, index: slice) -> List[OutlineArea]: ...

    def __getitem__(self, index: Union[int, slice]) -> Union[OutlineArea, List[OutlineArea]]:
        return self._measures[index]

    @property
    def net(self) -> float:
        """The area of all without their senses, that of holes taken off.

        >>> from vorn import Contour
        >>> def square(low, high):
        ...     start = Contour.starting_at((low, low)).append_line((high, low))
        ...     return start.append_line((high, high)).append_line((low, high)).append_line(
        ...         (low, low))
        >>> measure_areas([square(0, 4), square(1, 2)]).net
        15.0
        """
        return self._areas.net()

    def to_json(self) -> str:
        """The measures as JSON, every digit.

        >>> from vorn import Contour
        >>> bend = Contour.starting_at((0, 0)).append_arc((2, 0), center=(1, 0), ccw=True)
        >>> "area" in measure_areas([bend.append_line((0, 0))]).to_json()
        True
        """
        return self._areas.to_json()


def measure_areas(contours: Iterable[Any]) -> Areas:
    """Measures closed contours that belong together, and finds out which are holes in others.

    Parameters
    ----------
    contours : iterable of Contour
        All closed; they must not cross each other. Gaps are bridged by straight lines.

    Returns
    -------
    Areas
        A sequence of OutlineArea, with `net`.

    Raises
    ------
    ContourError
        A contour is open.

    Examples
    --------
    >>> from vorn import Contour
    >>> bend = Contour.starting_at((0, 0)).append_arc((2, 0), center=(1, 0), ccw=True)
    >>> areas = measure_areas([bend.append_line((0, 0))])
    >>> round(areas[0].area, 6), round(areas[0].perimeter, 6)
    (1.570796, 5.141593)
    """
    return Areas(_core.Areas([contour._parts() for contour in contours]))


class ContourOutlines(ContourRows):
    """The part of `Contour` that is about its outlines and other contours."""

    __slots__ = ()

    def _parts(self) -> Tuple[npt.NDArray[Any], bool, str]:
        return self._rows, self._closed, self._units

    def gaps(self) -> List[Gap]:
        """The places where pieces that follow each other do not meet, up to rounding.

        >>> from vorn import Contour
        >>> Contour.starting_at((0, 0)).append_line((1, 0)).append_line((1, 1)).gaps()
        []
        """
        return [Gap(*gap) for gap in _core.gaps(self._parts())]

    def runs(self: _Contour) -> List[_Contour]:
        """The contour cut at its gaps, its pieces in their order and sense. Several contours make
        one with gaps by ``Contour([*a, *b])``, which is how a file holds several.

        >>> from vorn import Contour, Line
        >>> [run.end for run in Contour([Line((0, 0), (1, 0)), Line((1, 2), (0, 2))]).runs()]
        [(1.0, 0.0), (0.0, 2.0)]
        """
        return [self._of(*parts) for parts in _core.runs(self._parts())]

    def outlines(self: _Contour) -> List[_Contour]:
        """The outlines that the pieces make: chained by their ends where these are no further apart
        than a millionth of the size, whatever their order and sense. What a file with several
        outlines holds.

        >>> from vorn import Contour, Line
        >>> scattered = Contour([Line((1, 0), (1, 1)), Line((0, 0), (1, 0)), Line((5, 5), (6, 6))])
        >>> [len(outline) for outline in scattered.outlines()]
        [2, 1]
        """
        return [self._of(*parts) for parts in _core.outlines(self._parts())]

    def intersections(self, other: Optional[ContourOutlines] = None) -> Intersections:
        """The places that this contour and another one have in common, or where this one meets
        itself but for the joints of its pieces.

        Parameters
        ----------
        other : Contour, optional
            If not said, the contour itself.

        Returns
        -------
        Intersections
            A sequence of Intersection, sorted along this contour; gaps are not bridged. It can be
            written as JSON and CSV.

        Examples
        --------
        >>> from vorn import Contour
        >>> line = Contour.starting_at((-2, 0)).append_line((2, 0))
        >>> arc = Contour.starting_at((1, 0)).append_arc((-1, 0), center=(0, 0), ccw=True)
        >>> [(place.kind, place.place) for place in line.intersections(arc)]
        [('touching', (-1.0, 0.0)), ('touching', (1.0, 0.0))]
        """
        return Intersections(_core.Meetings(self._parts(),
                                            None if other is None else other._parts()))

    def departure(self, other: ContourOutlines) -> float:
        """How far one contour leaves the other: the largest distance, in either direction, from the
        ends and seven places between the ends of each piece to the other contour. Raises
        ContourError for a contour without pieces.

        >>> from vorn import Contour
        >>> line = Contour.starting_at((0, 0)).append_line((4, 0))
        >>> line.departure(line.shifted(0, 0.5))
        0.5
        """
        return _core.departure(self._rows, other._rows)
