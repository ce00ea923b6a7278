"""What a fit tells about its contour."""

from __future__ import annotations

from typing import Optional

from vorn.contour_rows import ContourRows


class ContourFacts(ContourRows):
    """The part of `Contour` that remembers the fit."""

    __slots__ = ()

    @property
    def max_deviation(self) -> Optional[float]:
        """Largest distance of a point from the contour in units of its tolerance, the larger of
        what the fit reports and what measuring shows; up to 1 is within. None for a contour that
        no fit made.

        >>> import vorn
        >>> vorn.fit([(0, 0), (1, 0.1), (2, 0)], tol=0.2).max_deviation <= 1
        True
        """
        return self._facts.max_deviation

    @property
    def max_index(self) -> Optional[int]:
        """Position of the point with that deviation, from 0, or None.

        >>> import vorn
        >>> points = [(0, 0, 0.1), (1, 0, 0.1), (2, 0.01, 0.011), (3, 0, 0.1), (4, 0, 0.1)]
        >>> vorn.fit(points, strategy="fewest", centre=False).max_index in range(5)
        True
        """
        return self._facts.max_index

    @property
    def fewest_possible(self) -> Optional[int]:
        """No contour within the tolerances has fewer pieces than this, which is proven; None for
        other strategies than "fewest".

        >>> import vorn
        >>> corner = [(0, 0), (1, 0), (2, 0), (2, 1), (2, 2)]
        >>> vorn.fit(corner, tol=0.01, strategy="fewest").fewest_possible
        2
        """
        return self._facts.fewest_possible

    @property
    def verdict(self) -> Optional[str]:
        """How the fit ended: "within tolerance", "outside tolerance", "not closed" (the ends of a
        closed contour do not meet), "stops early" (before the last point), or None.

        >>> import vorn
        >>> vorn.fit([(0, 0), (1, 0), (2, 0)], tol=0.01).verdict
        'within tolerance'
        """
        return self._facts.verdict

    @property
    def strategy(self) -> Optional[str]:
        """The strategy of the fit, or None.

        >>> import vorn
        >>> vorn.fit([(0, 0), (1, 0), (2, 0)], tol=0.01, strategy="cells").strategy
        'cells'
        >>> vorn.Contour().strategy is None
        True
        """
        return self._facts.strategy
