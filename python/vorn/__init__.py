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
from vorn.contour_outlines import (Areas, Gap, Intersection, Intersections, OutlineArea,
                                   measure_areas)
from vorn.errors import (ContourError, ErrorCode, FileError, NoFitError, PointsTooCloseError,
                         SelfIntersectionError)
from vorn.fitting import fit
from vorn.least_squares import (LeastSquaresCircle, LeastSquaresLine, least_squares_circle,
                                least_squares_line)
from vorn.many import FitResult, fit_many
from vorn.pieces import Arc, Line, Piece
from vorn.plotting import plot
from vorn.points import Points, read_outlines, read_points, tolerance_per_point, write_points
from vorn.reports import CheckReport, FitReport, check, info, report, summary
from vorn.simplifying import Outlier, Scatter, Simplified, simplify
from vorn import frame, geometry

__all__ = ["Arc", "Areas", "CheckReport", "Contour", "ContourError", "ErrorCode", "FileError",
           "FitReport", "FitResult", "Gap", "Intersection", "Intersections", "LeastSquaresCircle",
           "LeastSquaresLine", "Line", "Nearest", "NoFitError", "Outlier", "OutlineArea", "Piece",
           "Points", "PointsTooCloseError", "Scatter", "SelfIntersectionError", "Simplified",
           "__version__", "check", "fit", "fit_many", "frame", "geometry", "info",
           "least_squares_circle", "least_squares_line", "measure_areas", "plot", "read_outlines",
           "read_points", "report", "simplify", "summary", "tolerance_per_point", "write_points"]
