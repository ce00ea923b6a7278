"""What a contour is written to and read from."""

from __future__ import annotations

import os
import warnings
from typing import Any, List, Optional, Type, TypeVar, Union

import numpy as np
import numpy.typing as npt

from vorn import _core
from vorn.contour_drawings import ContourDrawings

_Contour = TypeVar("_Contour", bound="ContourFiles")


class ContourFiles(ContourDrawings):
    """The part of `Contour` that knows files."""

    __slots__ = ()

    def to_text(self, format: str, points: Optional[npt.ArrayLike] = None,
                tol: Optional[npt.ArrayLike] = None, **options: Any) -> str:
        """The contour as the text of a file.

        Parameters
        ----------
        format : "json", "csv", "dxf", "gcode", "wkt", "geojson" or, with plain=True, "svg"
        points, tol : optional
            Measured points and their tolerances, as for `vorn.fit`: digits and chords, where these
            are not said, become so fine that the text keeps every point within its tolerance if the
            contour does.
        **options
            Of "dxf": dxf_version ("r12" or "r2000": units and layers of holes), entities (LINE and
            ARC in place of one polyline). Of "geojson": chords (how far they may be from arcs). Of
            "svg": plain (lines and arcs in their true size for a cutter, not a drawing). Of
            "gcode": feed, decimals, tolerance (the digits follow from it), end ("M2", "M30",
            "none"), plane ("xy", "xz"), radius_words, safe_height, cut_height, plunge_feed, header,
            footer. Lengths are in the unit of the points, feeds in that unit a minute.

        Raises
        ------
        ContourError
            The format cannot say what the contour needs, or a point is not finite.
        ValueError, TypeError
            There is no such format or option.

        Examples
        --------
        >>> from vorn import Contour
        >>> Contour.starting_at((0, 0)).append_line((1, 0)).to_text("wkt")
        'LINESTRING (0 0, 1 0)\\n'
        """
        return _core.to_text(self._rows, self._closed, self._units, format, options, points, tol)

    @classmethod
    def from_text(cls: Type[_Contour], text: str, format: str,
                  flatten: Optional[float] = None) -> _Contour:
        """The contour that such a text holds.

        Parameters
        ----------
        text : str
        format : str
            As for `to_text`; of "svg" every shape is read.
        flatten : float, optional
            How far chords may be from the curves of DXF and SVG that are no arcs, in their unit;
            these are refused if not said.

        Raises
        ------
        FileError
            The text holds no contour; `line` and `column` tell where that shows.
        ValueError
            There is no such format, or flatten is not above 0.

        Warns
        -----
        UserWarning
            Pieces without length were left out, or further coordinates beside x and y.

        Examples
        --------
        >>> from vorn import Contour
        >>> Contour.from_text("LINESTRING (0 0, 3 4)", "wkt").length
        5.0
        """
        return cls._read(*_core.from_text(text, format, flatten))

    def to_json(self) -> str:
        """The contour as JSON, every double with all its digits. Raises ContourError as `to_text`.

        >>> from vorn import Contour
        >>> '"line"' in Contour.starting_at((0, 0)).append_line((1, 0)).to_json()
        True
        """
        return self.to_text("json")

    @classmethod
    def from_json(cls: Type[_Contour], text: str) -> _Contour:
        """The contour that a JSON text holds. Raises FileError where it holds none.

        >>> from vorn import Contour
        >>> contour = Contour.starting_at((0, 0)).append_line((0.1, 0.7))
        >>> Contour.from_json(contour.to_json()) == contour
        True
        """
        return cls.from_text(text, "json")

    def to_csv(self) -> str:
        """The contour as CSV, a line for each piece. Raises ContourError as `to_text`.

        >>> from vorn import Contour
        >>> print(Contour.starting_at((0, 0)).append_line((1, 0)).to_csv(), end="")
        # closed no
        type,start_x,start_y,end_x,end_y,center_x,center_y,radius,direction
        line,0,0,1,0,,,,
        """
        return self.to_text("csv")

    @classmethod
    def from_csv(cls: Type[_Contour], text: str) -> _Contour:
        """The contour that such a CSV text holds. Raises FileError where it holds none.

        >>> from vorn import Contour
        >>> contour = Contour.starting_at((0, 0)).append_line((0.1, 0.7))
        >>> Contour.from_csv(contour.to_csv()) == contour
        True
        """
        return cls.from_text(text, "csv")

    def to_dxf(self, entities: bool = False, dxf_version: str = "r12") -> str:
        """The contour as DXF: one polyline, or LINE and ARC entities, in the version "r12" or
        "r2000". Raises ContourError as `to_text`.

        >>> from vorn import Contour
        >>> line = Contour.starting_at((0, 0)).append_line((1, 0))
        >>> "POLYLINE" in line.to_dxf(), "POLYLINE" in line.to_dxf(entities=True)
        (True, False)
        """
        return self.to_text("dxf", entities=entities, dxf_version=dxf_version)

    @classmethod
    def from_dxf(cls: Type[_Contour], text: str, flatten: Optional[float] = None) -> _Contour:
        """The contour that a DXF text holds; flatten and errors are those of `from_text`.

        >>> from vorn import Contour
        >>> Contour.from_dxf(Contour.starting_at((0, 0)).append_line((3, 4)).to_dxf()).length
        5.0
        """
        return cls.from_text(text, "dxf", flatten)

    def to_wkt(self) -> str:
        """The contour as well-known text. Raises ContourError as `to_text`.

        >>> from vorn import Contour
        >>> Contour.starting_at((0, 0)).append_line((1, 0)).append_line((1, 2)).to_wkt()
        'LINESTRING (0 0, 1 0, 1 2)\\n'
        """
        return self.to_text("wkt")

    @classmethod
    def from_wkt(cls: Type[_Contour], text: str) -> _Contour:
        """The contour that a well-known text holds. Raises FileError where it holds none.

        >>> from vorn import Contour
        >>> Contour.from_wkt("CIRCULARSTRING (0 0, 1 -1, 2 0)")[0].ccw
        True
        """
        return cls.from_text(text, "wkt")

    def to_gcode(self, **options: Any) -> str:
        """The contour as a tool path; the options are those of `to_text`, and so are the errors.

        >>> from vorn import Contour
        >>> "F600" in Contour.starting_at((0, 0)).append_line((1, 0)).to_gcode(feed=600)
        True
        """
        return self.to_text("gcode", **options)

    @classmethod
    def from_gcode(cls: Type[_Contour], text: str) -> _Contour:
        """The contour that a tool path runs along. Raises FileError where it cuts none.

        >>> from vorn import Contour
        >>> Contour.from_gcode("G21 G90\\nG0 X0 Y0\\nG1 X3 Y4\\nM2\\n").length
        5.0
        """
        return cls.from_text(text, "gcode")

    def to_geojson(self, chords: float) -> str:
        """The contour as GeoJSON, whose coordinates are those of the contour, not of the globe:
        Polygons of closed outlines with their holes, LineStrings of others. Chords leave arcs by no
        more than `chords`, in the unit of the points. Raises ContourError as `to_text`.

        >>> from vorn import Contour
        >>> "LineString" in Contour.starting_at((0, 0)).append_line((1, 0)).to_geojson(chords=0.1)
        True
        """
        return self.to_text("geojson", chords=chords)

    @classmethod
    def from_geojson(cls: Type[_Contour], text: str) -> _Contour:
        """The contour that a GeoJSON text holds. Raises FileError where it holds none.

        >>> from vorn import Contour
        >>> contour = Contour.starting_at((0, 0)).append_line((3, 4))
        >>> Contour.from_geojson(contour.to_geojson(chords=0.1)) == contour
        True
        """
        return cls.from_text(text, "geojson")

    def to_plain_svg(self) -> str:
        """The contour as SVG for a cutter: a path of lines and true arcs for each outline, in its
        true size where the unit is mm or inch. `to_svg` makes a drawing. Raises ContourError as
        `to_text`.

        >>> from vorn import Contour
        >>> contour = Contour.starting_at((0, 0), units="mm").append_line((3, 4))
        >>> Contour.from_svg(contour.to_plain_svg()).length
        5.0
        """
        return self.to_text("svg", plain=True)

    @classmethod
    def from_svg(cls: Type[_Contour], text: str, flatten: Optional[float] = None) -> _Contour:
        """The contour that the shapes of an SVG text make, turned up; flatten and errors are those
        of `from_text`.

        >>> from vorn import Contour
        >>> text = '<svg xmlns="http://www.w3.org/2000/svg"><path d="M0 0 L3 4"/></svg>'
        >>> Contour.from_svg(text).length
        5.0
        """
        return cls.from_text(text, "svg", flatten)

    def save(self, path: Union[str, "os.PathLike[str]"], **options: Any) -> None:
        """Writes a file in the format that its ending names. The file is written whole or not at
        all.

        Parameters
        ----------
        path : path-like
            Ends in json, csv, dxf, nc, gcode, wkt, geojson, svg, html or png.
        **options
            Those of `to_text` for what holds the contour, which "svg" does with plain=True; those
            of `to_svg` and `to_png` for drawings.

        Raises
        ------
        ValueError
            The ending names no format.
        FileError
            The file cannot be written.

        Examples
        --------
        >>> import pathlib, tempfile
        >>> from vorn import Contour
        >>> with tempfile.TemporaryDirectory() as folder:
        ...     path = pathlib.Path(folder, "line.wkt")
        ...     Contour.starting_at((0, 0)).append_line((1, 0)).save(path)
        ...     path.read_text()
        'LINESTRING (0 0, 1 0)\\n'
        """
        name = os.fspath(path)
        format = _core.format_of(name)
        if format is None:
            raise ValueError(f"the ending of '{name}' names no format")
        if format in ("html", "png") or (format == "svg" and not options.get("plain")):
            options.pop("plain", None)
            points = options.pop("points", None)
            contents = self._drawn(format, points, options.pop("tol", None), **options)
        else:
            contents = self.to_text(format, **options).encode()
        _core.write_file(name, contents)

    @classmethod
    def read(cls: Type[_Contour], path: Union[str, "os.PathLike[str]"],
             format: Optional[str] = None, flatten: Optional[float] = None) -> _Contour:
        """Reads a contour from a file of any format that holds one.

        Parameters
        ----------
        path : path-like
        format : str, optional
            As for `from_text`; if not said, the ending or the content of the file tells.
        flatten : float, optional
            As for `from_text`.

        Raises
        ------
        FileError
            The file cannot be read or holds no contour; `line` and `column` tell where that shows.
        ValueError
            As for `from_text`, which also tells of warnings.

        Examples
        --------
        >>> import tempfile
        >>> from vorn import Contour
        >>> with tempfile.NamedTemporaryFile("w", suffix=".wkt") as file:
        ...     print("LINESTRING (0 0, 3 4)", file=file, flush=True)
        ...     Contour.read(file.name).length
        5.0
        """
        return cls._read(*_core.from_file(os.fspath(path), format, flatten))

    @classmethod
    def _read(cls: Type[_Contour], rows: npt.NDArray[np.void], closed: bool, units: str,
              notes: List[str]) -> _Contour:
        for note in notes:
            warnings.warn(note, stacklevel=3)
        return cls._of(rows, closed, units)
