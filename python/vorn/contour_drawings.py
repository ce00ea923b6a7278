"""Drawings of a contour without other packages."""

from __future__ import annotations

from types import MappingProxyType
from typing import Any, Mapping, Optional

import numpy.typing as npt

from vorn import _core
from vorn.contour_rows import ContourRows
from vorn.errors import ContourError


def drawn(drawing: _core.Drawing, format: str, title: str = "contour",
          magnify: Optional[float] = None, fields: Mapping[str, str] = MappingProxyType({}),
          dpi: Optional[float] = None, width: Optional[int] = None) -> bytes:
    """The drawing in this style."""
    if format != "png" and (dpi is not None or width is not None):
        raise TypeError("dpi and width are for PNG")
    if format != "html" and fields:
        raise TypeError("fields are for HTML")
    drawing.title = title
    drawing.magnify = magnify
    drawing.fields = list(fields.items())
    return drawing.draw(format, dpi, width)


class ContourDrawings(ContourRows):
    """The part of `Contour` that draws itself."""

    __slots__ = ()

    def to_svg(self, points: Optional[npt.ArrayLike] = None,
               tol: Optional[npt.ArrayLike] = None, **style: Any) -> str:
        """A drawing on a page of A4; with points, their deviations magnified.

        Parameters
        ----------
        points : (n, 2) or (n, 3) array-like, optional
            The measured points, perhaps with their tolerances.
        tol : float or (n,) array-like, optional
            Tolerances of the points, in their unit.
        title : str, optional
        magnify : float, optional
            How many times larger than true deviations are drawn; a readable number if not said.

        Raises
        ------
        ContourError
            A point or a tolerance is not finite.
        ValueError
            The points have another shape.

        Examples
        --------
        >>> from vorn import Contour
        >>> line = Contour.starting_at((0, 0)).append_line((4, 0))
        >>> "</svg>" in line.to_svg([(1, 0.01), (3, -0.01)], tol=0.02, title="A line")
        True
        """
        return self._drawn("svg", points, tol, **style).decode()

    def to_html(self, points: Optional[npt.ArrayLike] = None,
                tol: Optional[npt.ArrayLike] = None, **style: Any) -> str:
        """The drawing as one page that pans, zooms and tells about the point under the cursor;
        parameters and errors as for `to_svg`, and `fields` is a dict of what stands at the head.

        >>> from vorn import Contour
        >>> "<title>A line" in Contour.starting_at((0, 0)).append_line((4, 0)).to_html(
        ...     title="A line", fields={"operator": "Jones"})
        True
        """
        return self._drawn("html", points, tol, **style).decode()

    def to_png(self, points: Optional[npt.ArrayLike] = None,
               tol: Optional[npt.ArrayLike] = None, **style: Any) -> bytes:
        """The drawing as a picture; parameters and errors as for `to_svg`.

        `dpi` tells how many pixels an inch of the page has, 150 if not said, or `width` how many
        pixels the picture is wide. What is too large to be drawn is a ContourError.

        >>> from vorn import Contour
        >>> Contour.starting_at((0, 0)).append_line((4, 0)).to_png()[1:4]
        b'PNG'
        """
        return self._drawn("png", points, tol, **style)

    def _drawn(self, format: str, points: Optional[npt.ArrayLike], tol: Optional[npt.ArrayLike],
               **style: Any) -> bytes:
        if not len(self._rows):
            raise ContourError("the contour has no pieces")
        return drawn(_core.Drawing(self._rows, self._closed, self._units, points, tol), format,
                     **style)

    def _repr_html_(self) -> str:
        """What a notebook shows."""
        if not len(self._rows):
            return repr(self).replace("<", "&lt;")
        return self.to_svg(title=repr(self)[1:-1])
