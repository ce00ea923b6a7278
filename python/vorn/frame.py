"""Scans in data frames of pandas or Dask."""

from __future__ import annotations

from typing import Any, Dict, Iterator, List, Optional

import numpy as np
import numpy.typing as npt

from vorn import _core
from vorn.contour import Contour
from vorn.many import FitResult, fit_many

__all__ = ["fit"]

#: Keeps the order of points while Dask brings the rows of a scan together.
_POSITION = "__vorn_position__"
_POSITIONS_IN_PARTITION = 2**40


def fit(frame: Any, by: str = "scan", x: str = "x", y: str = "y", w: Optional[str] = None,
        tol: Optional[float] = None, rows: str = "pieces", **options: Any) -> Any:
    """Fits every scan of a frame.

    Parameters
    ----------
    frame : pandas or Dask data frame
        One row for each point, those of a scan in the order of the path. Other scans may stand
        between them, and in Dask a scan may lie in several partitions.
    by : str
        The column that tells the scans apart. Rows without a value there are left out.
    x, y : str
        The columns of the points.
    w : str, optional
        The column of their tolerances.
    tol : float, optional
        One tolerance for all.
    rows : "pieces" or "scans"
        Whether the result has a row for each piece or one for each scan.
    **options
        As for `vorn.fit`.

    Returns
    -------
    pandas or Dask data frame, as the input
        "pieces": the scan, the number of the piece in it, the fields of `Contour.as_arrays`, and
        `error`. "scans": the scan, pieces, lines, arcs, length, area (not-a-number for open
        contours), closed, max_deviation, max_index, fewest_possible (-1 where not known), verdict
        and error. A scan that fails has one row with its error and, among pieces, the number -1.

    Raises
    ------
    KeyError
        The frame has no such column.
    ValueError
        `rows` is something else.

    Examples
    --------
    >>> import pandas
    >>> points = pandas.DataFrame({"scan": [7, 7, 7, 8], "x": [0, 1, 2, 0], "y": [0, 0, 0, 5]})
    >>> fit(points, tol=0.01, rows="scans")[["scan", "pieces", "length", "error"]]
       scan  pieces  length                                error
    0     7       1     2.0                                 None
    1     8       0     NaN  a contour needs at least two points
    """
    if rows not in _TABLES:
        raise ValueError(f"rows must be 'pieces' or 'scans', not {rows!r}")
    choice = {"by": by, "columns": [x, y] + ([w] if w else []), "rows": rows,
              "options": dict(options, tol=tol)}
    if hasattr(frame, "map_partitions"):
        return _fit_dask(frame, choice)
    return _fit_pandas(frame, choice)


def _fit_pandas(frame: Any, choice: Dict[str, Any], **threads: Any) -> Any:
    import pandas

    names: List[Any] = []

    def scans() -> Iterator[npt.NDArray[np.float64]]:
        for name, points in frame.groupby(choice["by"], sort=False):
            names.append(name)
            yield points[choice["columns"]].to_numpy()

    results = fit_many(scans(), **choice["options"], **threads)
    tables = [_TABLES[choice["rows"]](names[result.number], result, choice["by"])
              for result in results]
    if not tables:
        # The types of the columns, from a contour that is left out.
        line = Contour._of(_core.line((0.0, 0.0), (1.0, 0.0)))
        name = frame[choice["by"]].dtype.type()
        tables = [_TABLES[choice["rows"]](name, FitResult(0, None, line, None),
                                          choice["by"]).iloc[:0]]
    return pandas.concat(tables, ignore_index=True)


def _fit_dask(frame: Any, choice: Dict[str, Any]) -> Any:
    numbered = frame[[choice["by"], *choice["columns"]]].map_partitions(
        _with_positions, meta=_with_positions(frame._meta[[choice["by"], *choice["columns"]]]))
    empty = _fit_pandas(frame._meta, choice)
    # Whoever runs the partitions decides how many run side by side.
    return numbered.shuffle(choice["by"]).map_partitions(_fit_partition, choice, meta=empty)


def _with_positions(part: Any, partition_info: Optional[Dict[str, int]] = None) -> Any:
    number = partition_info["number"] if partition_info else 0
    first = number * _POSITIONS_IN_PARTITION
    return part.assign(**{_POSITION: np.arange(first, first + len(part), dtype=np.int64)})


def _fit_partition(part: Any, choice: Dict[str, Any]) -> Any:
    return _fit_pandas(part.sort_values(_POSITION), choice, workers=1)


def _table_of_pieces(name: Any, result: FitResult, by: str) -> Any:
    import pandas

    if result.contour is None:
        nothing = _core.line((0.0, 0.0), (0.0, 0.0))
        for field in ("start_x", "start_y", "end_x", "end_y", "length"):
            nothing[field] = np.nan
        table = pandas.DataFrame(nothing)
        table.insert(0, "piece", -1)
    else:
        table = pandas.DataFrame(result.contour.as_arrays())
        table.insert(0, "piece", np.arange(len(table)))
    table.insert(0, by, name)
    table["error"] = _error_of(result, len(table))
    return table


def _table_of_scan(name: Any, result: FitResult, by: str) -> Any:
    import pandas

    contour = result.contour or Contour()
    arcs = int(contour.as_arrays()["is_arc"].sum())
    area = contour.area
    table = pandas.DataFrame({
        by: [name], "pieces": len(contour), "lines": len(contour) - arcs, "arcs": arcs,
        "length": contour.length if result.contour else np.nan,
        "area": np.nan if area is None else area, "closed": contour.is_closed,
        "max_deviation": _or(contour.max_deviation, np.nan),
        "max_index": _or(contour.max_index, -1),
        "fewest_possible": _or(contour.fewest_possible, -1)})
    table["verdict"] = pandas.Series([contour.verdict], dtype=object)
    table["error"] = _error_of(result, 1)
    return table


def _error_of(result: FitResult, count: int) -> Any:
    import pandas

    return pandas.Series([None if result.error is None else str(result.error)] * count,
                         dtype=object)


def _or(value: Any, otherwise: Any) -> Any:
    return otherwise if value is None else value


_TABLES = {"pieces": _table_of_pieces, "scans": _table_of_scan}
