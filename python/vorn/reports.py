"""What the program says of points, of a fit, and of points against a contour."""

from __future__ import annotations

import json
from types import MappingProxyType
from typing import Any, Dict, Mapping, Optional, Union

import numpy as np
import numpy.typing as npt

from vorn import _core
from vorn.contour import Contour, fitted
from vorn.contour_drawings import drawn
from vorn.points import units_of

__all__ = ["CheckReport", "FitReport", "check", "info", "report", "summary"]

_NO_FIELDS: Mapping[str, str] = MappingProxyType({})


def info(points: npt.ArrayLike, tol: Optional[npt.ArrayLike] = None,
         closed: Union[str, bool] = "auto") -> Dict[str, Any]:
    """What there is to know about measured points before a fit, as ``contour info`` tells it.

    Parameters
    ----------
    points : (n, 2) or (n, 3) array-like
    tol : float or (n,) array-like, optional
        With tolerances, neighbours that are too close for them are listed.
    closed : "auto", bool, "yes" or "no"

    Returns
    -------
    dict
        The document that ``contour info --json`` writes: points, extent, spacing, duplicates,
        corners, noise, whether they are closed, the tolerances that the spacing allows and a
        suggestion. Points are counted from 0; what is not known is None.

    Raises
    ------
    ContourError
        There are fewer than two points, or a value is not finite.

    Examples
    --------
    >>> facts = info([(0, 0), (1, 0), (2, 0), (2, 1), (2, 3)])
    >>> facts["spacing"]["most"]["distance"], facts["corners"][0]["point"]
    (2.0, 2)
    """
    text = _core.info_json(points, tol, units_of(points), closed)
    return dict(json.loads(text))


class CheckReport:
    """Points measured against a contour: what `check` answers.

    >>> line = Contour.starting_at((0, 0)).append_line((4, 0))
    >>> check([(1, 0.01), (3, -0.03)], line, tol=0.02).outside
    array([1])
    """

    __slots__ = ("_report", "_facts")

    def __init__(self, report: _core.CheckReport) -> None:
        self._report = report
        self._facts: Optional[Dict[str, Any]] = None

    @property
    def outside(self) -> npt.NDArray[np.int64]:
        """Positions of the points beyond their tolerance, which counts up to 1 + 1e-6 of it.

        >>> line = Contour.starting_at((0, 0)).append_line((4, 0))
        >>> len(check([(1, 0.02)], line, tol=0.02).outside)
        0
        """
        return np.array(self._report.outside(), dtype=np.int64)

    @property
    def worst_first(self) -> npt.NDArray[np.int64]:
        """Positions of all points, the one with the largest deviation first: in units of its
        tolerance, or as a length where there are no tolerances.

        >>> line = Contour.starting_at((0, 0)).append_line((4, 0))
        >>> check([(1, 0.01), (2, 0), (3, -0.03)], line).worst_first
        array([2, 0, 1])
        """
        return np.array(self._report.worst_first(), dtype=np.int64)

    @property
    def facts(self) -> Dict[str, Any]:
        """All that was found, the document of `to_json`: deviations, scatter, the line or circle of
        least squares of each piece, gaps, crossings, area.

        >>> line = Contour.starting_at((0, 0)).append_line((4, 0))
        >>> sorted(check([(1, 0.01), (3, -0.03)], line).facts)[:3]
        ['area', 'contour', 'crosses']
        """
        if self._facts is None:
            self._facts = dict(json.loads(self.to_json()))
        return self._facts

    def to_json(self) -> str:
        """As JSON, every digit. Points are counted from 0, pieces from 1.

        >>> line = Contour.starting_at((0, 0)).append_line((4, 0))
        >>> check([(1, 0.01)], line).to_json()[0]
        '{'
        """
        return self._report.to_json()

    def to_csv(self) -> str:
        """Every point in a line of CSV, with all digits, deviations signed.

        >>> line = Contour.starting_at((0, 0)).append_line((4, 0))
        >>> len(check([(1, 0.01)], line).to_csv().splitlines())
        2
        """
        return self._report.to_csv()


def check(points: npt.ArrayLike, contour: Contour,
          tol: Optional[npt.ArrayLike] = None) -> CheckReport:
    """Measures points against a contour, as ``contour check`` does: by code that knows nothing of
    the fit.

    Parameters
    ----------
    points : (n, 2) or (n, 3) array-like
        With a third column or `tol` they are judged.
    contour : Contour
    tol : float or (n,) array-like, optional

    Returns
    -------
    CheckReport

    Raises
    ------
    ContourError
        A value is not finite, or there are no points or no pieces.

    Examples
    --------
    >>> line = Contour.starting_at((0, 0)).append_line((4, 0))
    >>> report = check([(1, 0.01), (2, 0), (3, -0.03)], line, tol=0.02)
    >>> report.outside, report.worst_first
    (array([2]), array([2, 0, 1]))
    """
    return CheckReport(_core.CheckReport(points, tol, units_of(points), contour._parts()))


class FitReport:
    """All that is told about one fit: what `report` answers.

    Attributes
    ----------
    contour : Contour
        What `vorn.fit` answers for the same arguments.

    Examples
    --------
    >>> told = report([(0, 0), (1, 0), (2, 0)], tol=0.01)
    >>> told.contour, told.facts["verdict"]
    (<Contour: 1 piece (1 line, 0 arcs), open, length 2>, 'within tolerance')
    """

    __slots__ = ("contour", "_report", "_fields")

    def __init__(self, report: _core.FitReport, units: str, fields: Mapping[str, str]) -> None:
        self._report = report
        self._fields = dict(fields)
        self.contour = fitted(*report.parts(), units=units)

    @property
    def facts(self) -> Dict[str, Any]:
        """The document of `to_json`: input, counts, pieces with their lines and circles of least
        squares, deviations, closure, verdict.

        >>> report([(0, 0), (1, 0), (2, 0)], tol=0.01).facts["strategy"]
        'fewest'
        """
        return dict(json.loads(self.to_json()))

    def to_json(self) -> str:
        """As the JSON that ``contour fit`` writes; `Contour.from_json` reads the contour of it.

        >>> Contour.from_json(report([(0, 0), (3, 4)], tol=0.01).to_json()).length
        5.0
        """
        return self._report.to_json(list(self._fields.items()))

    def to_svg(self, title: str = "contour", magnify: Optional[float] = None) -> str:
        """The drawing of the fit with its points and tolerances; see `Contour.to_svg`.

        >>> "</svg>" in report([(0, 0), (3, 4)], tol=0.01).to_svg()
        True
        """
        return drawn(self._report.drawing(), "svg", title, magnify).decode()

    def to_html(self, title: str = "contour", magnify: Optional[float] = None) -> str:
        """The page of the fit, with the fields at its head; see `Contour.to_html`.

        >>> "Jones" in report([(0, 0), (3, 4)], 0.01, fields={"operator": "Jones"}).to_html()
        True
        """
        return drawn(self._report.drawing(), "html", title, magnify, self._fields).decode()


def report(points: Any, tol: Optional[npt.ArrayLike] = None, progress: Any = None,
           units: Optional[str] = None, fields: Mapping[str, str] = _NO_FIELDS,
           **options: Any) -> FitReport:
    """Fits as `vorn.fit` does and keeps all that the program tells of it.

    Parameters
    ----------
    points, tol, units, **options
        As for `vorn.fit`.
    progress : callable, optional
        Called with the percentage that is done.
    fields : dict of str to str
        What stands at the head, such as {"part": "A 7", "operator": "Jones"}.

    Returns
    -------
    FitReport

    Raises
    ------
    PointsTooCloseError, NoFitError, ContourError, TypeError, ValueError
        As `vorn.fit`.

    Examples
    --------
    >>> told = report([(0, 0), (1, 0), (2, 0), (2, 1), (2, 2)], tol=0.01)
    >>> len(told.contour), told.facts["input"]["points"]
    (2, 5)
    """
    units = units_of(points) if units is None else units
    return FitReport(_core.FitReport(points, tol, units, options, progress), units, fields)


def summary(reports: Mapping[str, FitReport], fields: Mapping[str, str] = _NO_FIELDS,
            format: str = "csv") -> str:
    """Many fits at a glance, the worst first, with totals: what ``contour fit --summary`` writes.

    Parameters
    ----------
    reports : dict of str to FitReport
        By their names.
    fields : dict of str to str
        What stands at the head of the page.
    format : "csv" or "html"
        A table, or a page with a small picture of each contour.

    Raises
    ------
    ValueError
        The format is another one.

    Examples
    --------
    >>> told = report([(0, 0), (1, 0), (2, 0)], tol=0.01)
    >>> "part 7" in summary({"part 7": told})
    True
    """
    if format not in ("csv", "html"):
        raise ValueError(f"format must be 'csv' or 'html', not {format!r}")
    return _core.summary([(name, told._report) for name, told in reports.items()],
                         list(fields.items()), format == "html")
