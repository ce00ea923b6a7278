"""What a contour is written to and read from."""

from __future__ import annotations

import os
from typing import Any, Optional, Type, TypeVar, Union

from vorn import _core
from vorn.contour_drawings import ContourDrawings

_Contour = TypeVar("_Contour", bound="ContourFiles")


class ContourFiles(ContourDrawings):
    """The part of `Contour` that knows files."""

    __slots__ = ()

    def to_text(self, format: str, **options: Any) -> str:
        """The contour as the text of a file.

        Parameters
        ----------
        format : "json", "csv", "dxf", "gcode" or "wkt"
        **options
            Of "dxf": entities (LINE and ARC in place of one polyline). Of "gcode": feed, decimals,
            tolerance, end ("M2", "M30", "none"), plane ("xy", "xz"), radius_words, safe_height,
            cut_height, plunge_feed, header, footer. Lengths are in the unit of the points, feeds in
            that unit a minute.

        Raises
        ------
        ContourError
            The format cannot say what the contour needs.
        ValueError, TypeError
            There is no such format or option.

        Examples
        --------
        >>> from vorn import Contour
        >>> Contour.starting_at((0, 0)).append_line((1, 0)).to_text("wkt")
        'LINESTRING (0 0, 1 0)\\n'
        """
        return _core.to_text(self._rows, self._closed, self._units, format, options)

    @classmethod
    def from_text(cls: Type[_Contour], text: str, format: str) -> _Contour:
        """The contour that such a text holds.

        Parameters
        ----------
        text : str
        format : str
            As for `to_text`.

        Raises
        ------
        FileError
            The text holds no contour; `line` and `column` tell where that shows.
        ValueError
            There is no such format.

        Examples
        --------
        >>> from vorn import Contour
        >>> Contour.from_text("LINESTRING (0 0, 3 4)", "wkt").length
        5.0
        """
        return cls._of(*_core.from_text(text, format))

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

    def to_dxf(self, entities: bool = False) -> str:
        """The contour as DXF: one polyline, or LINE and ARC entities. Raises ContourError as
        `to_text`.

        >>> from vorn import Contour
        >>> line = Contour.starting_at((0, 0)).append_line((1, 0))
        >>> "POLYLINE" in line.to_dxf(), "POLYLINE" in line.to_dxf(entities=True)
        (True, False)
        """
        return self.to_text("dxf", entities=entities)

    @classmethod
    def from_dxf(cls: Type[_Contour], text: str) -> _Contour:
        """The contour that a DXF text holds. Raises FileError where it holds none.

        >>> from vorn import Contour
        >>> Contour.from_dxf(Contour.starting_at((0, 0)).append_line((3, 4)).to_dxf()).length
        5.0
        """
        return cls.from_text(text, "dxf")

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

    def save(self, path: Union[str, "os.PathLike[str]"], **options: Any) -> None:
        """Writes a file in the format that its ending names. The file is written whole or not at
        all.

        Parameters
        ----------
        path : path-like
            Ends in json, csv, dxf, nc, gcode, wkt, svg, html or png.
        **options
            Those of `to_text` or `to_svg`.

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

        Raises
        ------
        FileError
            The file cannot be read or holds no contour; `line` and `column` tell where that shows.

        Examples
        --------
        >>> import tempfile
        >>> from vorn import Contour
        >>> with tempfile.NamedTemporaryFile("w", suffix=".wkt") as file:
        ...     print("LINESTRING (0 0, 3 4)", file=file, flush=True)
        ...     Contour.read(file.name).length
        5.0
        """
        return cls._of(*_core.from_file(os.fspath(path), format))
