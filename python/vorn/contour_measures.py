"""What can be measured on a contour."""

from __future__ import annotations

from typing import Any, NamedTuple, Optional, Tuple

import numpy as np
import numpy.typing as npt

from vorn import _core
from vorn.contour_rows import ContourRows


class Nearest(NamedTuple):
    """The places of a contour that are nearest to some points; what `Contour.nearest` answers.

    Attributes
    ----------
    places : (n, 2) array
        In the unit of the points.
    pieces : (n,) array of int
        The positions of the pieces that they lie on.
    distances : (n,) array
        How far the points are from them, never negative.

    Examples
    --------
    >>> from vorn import Contour
    >>> line = Contour.starting_at((0, 0)).append_line((10, 0))
    >>> places, pieces, distances = line.nearest([(1, 2), (13, 4)])
    >>> pieces.tolist(), distances.tolist()
    ([0, 0], [2.0, 5.0])
    """

    places: npt.NDArray[np.float64]
    pieces: npt.NDArray[np.int64]
    distances: npt.NDArray[np.float64]


class ContourMeasures(ContourRows):
    """The part of `Contour` that measures itself and points."""

    __slots__ = ()

    @property
    def units(self) -> str:
        """The unit of all lengths, as files name it; may be empty.

        >>> from vorn import Contour
        >>> Contour.starting_at((0, 0), units="mm").append_line((1, 0)).units
        'mm'
        """
        return self._units

    @property
    def is_closed(self) -> bool:
        """Whether the contour runs back to its start.

        >>> from vorn import Contour
        >>> triangle = Contour.starting_at((0, 0)).append_line((1, 0)).append_line((0, 1))
        >>> triangle.is_closed, triangle.append_line((0, 0)).is_closed
        (False, True)
        """
        return self._closed

    @property
    def length(self) -> float:
        """Along all pieces, in the unit of the points.

        >>> from vorn import Contour
        >>> Contour.starting_at((0, 0)).append_line((3, 4)).append_line((3, 5)).length
        6.0
        """
        return float(self._rows["length"].sum())

    @property
    def area(self) -> Optional[float]:
        """What a closed contour encloses, in the unit of the points squared, positive when it runs
        counter-clockwise; of one that crosses itself the sum over its loops. None for an open
        contour.

        >>> from vorn import Arc, Contour
        >>> circle = Contour([Arc((1, 0), (-1, 0), (0, 0), 1.0, True, 3.141592653589793),
        ...                   Arc((-1, 0), (1, 0), (0, 0), 1.0, True, 3.141592653589793)])
        >>> round(circle.area, 12)
        3.14159265359
        """
        return _core.area(self._rows, self._closed)

    @property
    def bounds(self) -> Tuple[float, float, float, float]:
        """Least x, least y, largest x, largest y, the bulges of arcs included. Raises ContourError
        for a contour without pieces.

        >>> from vorn import Contour
        >>> Contour.starting_at((-1, 0)).append_arc((1, 0), center=(0, 0), ccw=False).bounds
        (-1.0, 0.0, 1.0, 1.0)
        """
        return _core.bounds(self._rows)

    @property
    def is_self_intersecting(self) -> bool:
        """Whether the contour crosses, touches or overlaps itself anywhere but at its joints.

        >>> from vorn import Contour
        >>> bent = Contour.starting_at((0, 0)).append_line((2, 0)).append_line((2, 2))
        >>> bent.is_self_intersecting, bent.append_line((1, -1)).is_self_intersecting
        (False, True)
        """
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

        Raises
        ------
        ContourError
            A point is not finite, or the contour has no pieces.

        Examples
        --------
        >>> from vorn import Contour
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
            Tolerances, if any, are not looked at.

        Returns
        -------
        Nearest
            Named arrays (places, pieces, distances).

        Raises
        ------
        ContourError
            A point is not finite, or the contour has no pieces.

        Examples
        --------
        >>> from vorn import Contour
        >>> line = Contour.starting_at((0, 0)).append_line((10, 0))
        >>> line.nearest([(1, 2), (13, 4)]).places
        array([[ 1.,  0.],
               [10.,  0.]])
        """
        return Nearest(*_core.nearest(self._rows, points))

    def sample(self, chord: float) -> npt.NDArray[np.float64]:
        """Points along the contour whose straight connections leave it by at most `chord`.

        Parameters
        ----------
        chord : float
            In the unit of the points, above 0.

        Returns
        -------
        (n, 2) array
            The ends of all pieces are among them.

        Raises
        ------
        ValueError
            The chord is not above 0.
        ContourError
            An arc would need more than ten million chords.

        Examples
        --------
        >>> from vorn import Contour
        >>> Contour.starting_at((0, 0)).append_arc((2, 0), center=(1, 0), ccw=False).sample(0.3)
        array([[0., 0.],
               [1., 1.],
               [2., 0.]])
        """
        return _core.sample(self._rows, chord)

    def to_shapely(self, chord: float) -> Any:
        """A shapely geometry with chords in the place of arcs. Needs shapely.

        Parameters
        ----------
        chord : float
            How far chords may leave arcs, in the unit of the points, above 0.

        Returns
        -------
        shapely Polygon or LineString
            A Polygon of a closed contour, else a LineString.

        Examples
        --------
        >>> from vorn import Contour
        >>> square = Contour.starting_at((0, 0)).append_line((2, 0)).append_line((2, 2))
        >>> square.append_line((0, 2)).append_line((0, 0)).to_shapely(chord=0.1).area
        4.0
        """
        import shapely.geometry

        places = self.sample(chord)
        if self.is_closed:
            return shapely.geometry.Polygon(places)
        return shapely.geometry.LineString(places)
