"""Measured points become contours of lines and arcs.

Three lines fit a contour::

    import vorn
    contour = vorn.fit(vorn.read_points("scan.csv"), tol=0.02)
    contour.save("scan.dxf")

`vorn.fit` takes NumPy arrays and answers a `vorn.Contour`, a sequence of `vorn.Line` and `vorn.Arc`
values that measures points, draws itself and knows the usual file formats. `vorn.fit_many` and
`vorn.frame.fit` take any number of scans, on one machine or on a cluster. `vorn.geometry` has the
operations below, one by one.
"""

from vorn._core import __version__
from vorn.contour import Contour, Nearest
from vorn.errors import (ContourError, ErrorCode, FileError, NoFitError, PointsTooCloseError,
                         SelfIntersectionError)
from vorn.fitting import fit, read_points
from vorn.many import FitResult, fit_many
from vorn.pieces import Arc, Line, Piece
from vorn.plotting import plot

__all__ = ["Arc", "Contour", "ContourError", "ErrorCode", "FileError", "FitResult", "Line",
           "Nearest", "NoFitError", "Piece", "PointsTooCloseError", "SelfIntersectionError",
           "__version__", "fit", "fit_many", "plot", "read_points"]
