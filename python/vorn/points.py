"""Measured points: the arrays that files bring, and files that hold them."""

from __future__ import annotations

import os
from typing import TYPE_CHECKING, Any, List, Optional, Tuple, Union

import numpy as np
import numpy.typing as npt

from vorn import _core
from vorn.errors import FileError

__all__ = ["Points", "read_outlines", "read_points", "tolerance_per_point", "units_of",
           "write_points"]

if TYPE_CHECKING:
    _Array = np.ndarray[Any, np.dtype[np.float64]]
else:
    _Array = np.ndarray

_Path = Union[str, "os.PathLike[str]"]


class Points(_Array):
    """An array of measured points that knows their unit: what `read_points` answers.

    It is a NumPy array (n, 3) of x, y and tolerance, or (n, 2), and can be used wherever one can.
    Parts and copies of it keep the unit; what is computed from it is a plain array, because the
    unit of that may be another.

    Attributes
    ----------
    units : str
        "mm", "inch" and so on; empty where the file does not say.

    Examples
    --------
    >>> points = Points([(0, 0), (1, 2)], units="mm")
    >>> points[1:].units, type(points * 2).__name__
    ('mm', 'ndarray')
    >>> import vorn
    >>> vorn.fit(points, tol=0.1).units
    'mm'
    """

    units: str

    def __new__(cls, values: npt.ArrayLike, units: str = "") -> Points:
        points = np.array(_core.numbers(values, "points"), dtype=np.float64).view(cls)
        points.units = units
        return points

    def __array_finalize__(self, source: Any) -> None:
        self.units = getattr(source, "units", "")

    def __array_wrap__(self, array: Any, context: Any = None) -> Any:
        return np.asarray(array)[()]

    def __reduce__(self) -> Tuple[Any, ...]:
        return Points, (np.asarray(self), self.units)


def units_of(points: Any) -> str:
    """The unit that points bring along; empty where they bring none.

    >>> units_of(Points([(0, 0)], units="mm")), units_of([(0, 0)])
    ('mm', '')
    """
    units = getattr(points, "units", "")
    return units if isinstance(units, str) else ""


def read_points(path: _Path, columns: str = "", **options: Any) -> Points:
    """Reads points from a file, as the program ``contour`` reads them.

    Parameters
    ----------
    path : path-like
        Lines of ``x,y`` or ``x,y,w`` with any usual separator, header and comments; or a drawing or
        tool path with one outline, whose vertices are the points. "-" is the standard input.
    columns : str, optional
        "x,y" or "x,y,w" as names of the header or numbers counted from 1; found if not said.
    tolerance_column : str, optional
        The column that holds the tolerances, by its name or number; w if not said.
    format : "csv", "dxf", "gcode", "wkt", "geojson", "svg" or "json", optional
        If not said, the ending or the content of the file tells.
    flatten : float, optional
        How far chords may be from the arcs and curves of a drawing, in its unit; these are refused
        if not said.

    Returns
    -------
    Points
        (n, 3) with tolerances, from a column w or a comment ``# tolerance T``; (n, 2) without
        them. `units` holds their unit, from a comment ``# units mm`` or the header.

    Raises
    ------
    FileError
        The file cannot be read, a line of it is wrong (`line` and `column` tell which), or it holds
        several outlines.
    TypeError, ValueError
        There is no such option, format or choice of columns.

    Examples
    --------
    >>> import tempfile
    >>> with tempfile.NamedTemporaryFile("w+", suffix=".csv") as file:
    ...     print("X [mm];Y [mm]\\n0,5;1\\n2;3", file=file, flush=True)
    ...     points = read_points(file.name)
    >>> points.tolist(), points.units
    ([[0.5, 1.0], [2.0, 3.0]], 'mm')
    """
    outlines = read_outlines(path, columns=columns, **options)
    if len(outlines) > 1:
        name = os.fspath(path)
        raise FileError(f"{name}: holds {len(outlines)} outlines; read_outlines reads them all",
                        name)
    return outlines[0]


def read_outlines(path: _Path, columns: str = "", **options: Any) -> List[Points]:
    """Reads all runs of points in a file, each to be fitted by itself.

    Parameters and errors are those of `read_points`. A table of points is one run; of a drawing or
    tool path, runs whose ends meet are one.

    Returns
    -------
    list of Points

    Examples
    --------
    >>> import tempfile
    >>> with tempfile.NamedTemporaryFile("w+", suffix=".wkt") as file:
    ...     print("MULTILINESTRING ((0 0, 1 0), (5 5, 6 5, 6 6))", file=file, flush=True)
    ...     [len(points) for points in read_outlines(file.name)]
    [2, 3]
    """
    if columns:
        options["columns"] = columns
    return [Points(array, units) for array, units in _core.read_points(os.fspath(path), options)]


def write_points(path: _Path, points: npt.ArrayLike, tol: Optional[npt.ArrayLike] = None,
                 units: Optional[str] = None) -> None:
    """Writes points as a table that `read_points` and the program read back, every bit of them.

    Parameters
    ----------
    path : path-like
        The file is written whole or not at all.
    points : (n, 2) or (n, 3) array-like
    tol : float or (n,) array-like, optional
        Tolerances, in place of those of the points.
    units : str, optional
        Their unit; that which the points bring if not said.

    Raises
    ------
    ContourError
        A point or a tolerance is not finite.
    FileError
        The file cannot be written.

    Examples
    --------
    >>> import pathlib, tempfile
    >>> with tempfile.TemporaryDirectory() as folder:
    ...     path = pathlib.Path(folder, "scan.csv")
    ...     write_points(path, [(0, 0), (0.1, 2)], tol=0.02, units="mm")
    ...     print(path.read_text(), end="")
    # units mm
    x,y,w
    0.0,0.0,0.02
    0.1,2.0,0.02
    """
    units = units_of(points) if units is None else units
    table = _core.usable_points(points, tol)
    lines = [f"# units {units}"] if units else []
    lines.append("x,y,w" if table.shape[1] > 2 else "x,y")
    lines += [",".join(map(repr, row)) for row in table.tolist()]
    _core.write_file(os.fspath(path), ("\n".join(lines) + "\n").encode())


def tolerance_per_point(points: npt.ArrayLike, cap: float,
                        closed: Union[str, bool] = "auto") -> npt.NDArray[np.float64]:
    """Tolerances that follow from the spacing: for each point 0.3 times the distance to its nearer
    neighbour, at most `cap`. No neighbours are too close for these.

    ``fit(points, tolerance_per_point=cap)`` uses them.

    Parameters
    ----------
    points : (n, 2) or (n, 3) array-like
        Tolerances, if any, are not looked at.
    cap : float
        In the unit of the points, above 0.
    closed : "auto", bool, "yes" or "no"
        Whether the first and the last point are neighbours.

    Returns
    -------
    (n,) array

    Raises
    ------
    PointsTooCloseError
        Two neighbours lie in one place.
    ContourError
        A point is not finite.
    ValueError
        The cap is not above 0.

    Examples
    --------
    >>> tolerance_per_point([(0, 0), (1, 0), (1.5, 0), (11.5, 0)], cap=0.25)
    array([0.25, 0.15, 0.15, 0.25])
    """
    return _core.tolerance_per_point(points, cap, closed)
