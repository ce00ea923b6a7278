"""What a contour is written to and read from."""

from __future__ import annotations

import os
from typing import Any, Optional, Type, TypeVar, Union

import numpy as np
import numpy.typing as npt

from vorn import _core

_Contour = TypeVar("_Contour", bound="ContourFiles")


class ContourFiles:
    """The part of `Contour` that knows files and drawings."""

    __slots__ = ()

    _rows: npt.NDArray[np.void]
    _closed: bool
    _units: str

    @classmethod
    def _of(cls: Type[_Contour], rows: npt.NDArray[np.void], closed: Optional[bool] = None,
            units: str = "") -> _Contour:
        """A contour of these pieces."""
        raise NotImplementedError

    def to_text(self, format: str, **options: Any) -> str:
        """The contour as the text of a file: "json", "csv", "dxf", "gcode" or "wkt".

        Options of "dxf": entities (LINE and ARC in place of one polyline). Of "gcode": feed,
        decimals, tolerance, end ("M2", "M30", "none"), plane ("xy", "xz"), radius_words,
        safe_height, cut_height, plunge_feed, header, footer. Raises ContourError where the format
        cannot say what the contour needs.
        """
        return _core.to_text(self._rows, self._closed, self._units, format, options)

    @classmethod
    def from_text(cls: Type[_Contour], text: str, format: str) -> _Contour:
        """The contour that such a text holds. Raises FileError where it holds none."""
        return cls._of(*_core.from_text(text, format))

    def to_json(self) -> str:
        """The contour as JSON, every double with all its digits."""
        return self.to_text("json")

    @classmethod
    def from_json(cls: Type[_Contour], text: str) -> _Contour:
        """The contour that a JSON text holds.

        >>> from vorn import Contour
        >>> contour = Contour.starting_at((0, 0)).append_line((0.1, 0.7))
        >>> Contour.from_json(contour.to_json()) == contour
        True
        """
        return cls.from_text(text, "json")

    def to_csv(self) -> str:
        """The contour as CSV, a line for each piece."""
        return self.to_text("csv")

    @classmethod
    def from_csv(cls: Type[_Contour], text: str) -> _Contour:
        """The contour that such a CSV text holds."""
        return cls.from_text(text, "csv")

    def to_dxf(self, entities: bool = False) -> str:
        """The contour as DXF: one polyline, or LINE and ARC entities."""
        return self.to_text("dxf", entities=entities)

    @classmethod
    def from_dxf(cls: Type[_Contour], text: str) -> _Contour:
        """The contour that a DXF text holds."""
        return cls.from_text(text, "dxf")

    def to_wkt(self) -> str:
        """The contour as well-known text."""
        return self.to_text("wkt")

    @classmethod
    def from_wkt(cls: Type[_Contour], text: str) -> _Contour:
        """The contour that a well-known text holds."""
        return cls.from_text(text, "wkt")

    def to_gcode(self, **options: Any) -> str:
        """The contour as a tool path; the options are those of `to_text`."""
        return self.to_text("gcode", **options)

    @classmethod
    def from_gcode(cls: Type[_Contour], text: str) -> _Contour:
        """The contour that a tool path runs along."""
        return cls.from_text(text, "gcode")

    def to_svg(self, points: Optional[npt.ArrayLike] = None,
               tol: Optional[npt.ArrayLike] = None, **style: Any) -> str:
        """A drawing on a page of A4; with points, their deviations magnified.

        Parameters
        ----------
        points : (n, 2) or (n, 3) array-like, optional
        tol : float or (n,) array-like, optional
            Tolerances of the points.
        title : str, optional
        magnify : float, optional
            How many times larger than true deviations are drawn; a readable number if not said.
        """
        return self._drawn("svg", points, tol, **style).decode()

    def to_html(self, points: Optional[npt.ArrayLike] = None,
                tol: Optional[npt.ArrayLike] = None, **style: Any) -> str:
        """The drawing as one page that pans, zooms and tells about the point under the cursor;
        parameters as for `to_svg`."""
        return self._drawn("html", points, tol, **style).decode()

    def to_png(self, points: Optional[npt.ArrayLike] = None,
               tol: Optional[npt.ArrayLike] = None, **style: Any) -> bytes:
        """The drawing as a picture; parameters as for `to_svg`."""
        return self._drawn("png", points, tol, **style)

    def _drawn(self, format: str, points: Optional[npt.ArrayLike], tol: Optional[npt.ArrayLike],
               title: str = "contour", magnify: Optional[float] = None) -> bytes:
        drawing = _core.Drawing(self._rows, self._closed, self._units, points, tol)
        drawing.title = title
        drawing.magnify = magnify
        return drawing.draw(format)

    def _repr_html_(self) -> str:
        if not len(self._rows):
            return repr(self).replace("<", "&lt;")
        return self.to_svg(title=repr(self)[1:-1])

    def save(self, path: Union[str, "os.PathLike[str]"], **options: Any) -> None:
        """Writes a file in the format that its ending names: json, csv, dxf, nc, gcode, wkt, svg,
        html or png. The file is written whole or not at all.

        Options are those of `to_text` or `to_svg`.
        """
        name = os.fspath(path)
        format = _core.format_of(name)
        if format is None:
            raise ValueError(f"the ending of '{name}' names no format")
        if format in ("svg", "html", "png"):
            points = options.pop("points", None)
            contents = self._drawn(format, points, options.pop("tol", None), **options)
        else:
            contents = self.to_text(format, **options).encode()
        _core.write_file(name, contents)

    @classmethod
    def read(cls: Type[_Contour], path: Union[str, "os.PathLike[str]"],
             format: Optional[str] = None) -> _Contour:
        """Reads a contour from a file of any format that holds one.

        Parameters
        ----------
        path : path-like
        format : str, optional
            As for `to_text`; if not said, the ending or the content of the file tells.
        """
        return cls._of(*_core.from_file(os.fspath(path), format))
