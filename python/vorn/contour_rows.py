"""What a contour keeps: one row for each piece, and how it came about."""

from __future__ import annotations

from typing import NamedTuple, Optional, Type, TypeVar

import numpy as np
import numpy.typing as npt

from vorn import _core
from vorn.pieces import Place

_Contour = TypeVar("_Contour", bound="ContourRows")


class FitFacts(NamedTuple):
    """What a fit tells about its contour."""

    max_deviation: Optional[float] = None
    max_index: Optional[int] = None
    fewest_possible: Optional[int] = None
    verdict: Optional[str] = None
    strategy: Optional[str] = None


class ContourRows:
    """The part of `Contour` that holds its data; nothing changes them once they are set."""

    __slots__ = ("_rows", "_closed", "_units", "_facts", "_start")

    _rows: npt.NDArray[np.void]
    _closed: bool
    _units: str
    _facts: FitFacts
    _start: Optional[Place]

    def _set(self, rows: npt.NDArray[np.void], closed: Optional[bool], units: str,
             facts: FitFacts = FitFacts(), start: Optional[Place] = None) -> None:
        rows.flags.writeable = False
        self._rows = rows
        self._closed = bool(_core.returns_to_start(rows) if closed is None else closed)
        self._units = units
        self._facts = facts
        self._start = start

    @classmethod
    def _of(cls: Type[_Contour], rows: npt.NDArray[np.void], closed: Optional[bool] = None,
            units: str = "", facts: FitFacts = FitFacts(),
            start: Optional[Place] = None) -> _Contour:
        """A contour of these rows, which it keeps."""
        contour = cls.__new__(cls)
        contour._set(rows, closed, units, facts, start)
        return contour
