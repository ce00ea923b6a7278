"""Contours drawn by matplotlib, which is imported when something is drawn."""

from __future__ import annotations

from typing import Any, Optional

import numpy as np
import numpy.typing as npt

from vorn import _core
from vorn.contour import Contour
from vorn.pieces import Arc

__all__ = ["plot"]

# Told apart by any kind of colour vision, and by width where there is no colour.
_LINE_COLOUR = "#0072b2"
_ARC_COLOUR = "#d55e00"
_POINT_COLOUR = "#333333"
_BAND_COLOUR = "#009e73"
#: Chords leave arcs by this part of the size of the contour, less than a pixel shows.
_CHORD = 2e-5
#: Of the size of the contour: how far the largest tolerance is drawn from it when nobody says.
_READABLE = 0.04


def plot(contour: Contour, points: Optional[npt.ArrayLike] = None,
         tol: Optional[npt.ArrayLike] = None, magnify: Optional[float] = None,
         ax: Any = None) -> Any:
    """Draws a contour: lines, arcs, and dots where pieces meet.

    Parameters
    ----------
    contour : Contour
    points : (n, 2) or (n, 3) array-like, optional
        Measured points, drawn `magnify` times as far from the contour as they are.
    tol : float or (n,) array-like, optional
        Their tolerances, drawn as a band with the same magnification; a third column of the points
        if not said.
    magnify : float, optional
        If not said, a round number that makes the largest tolerance, or else the largest deviation,
        readable. Told in the legend.
    ax : matplotlib axes, optional
        Where to draw; the current ones if not said.

    Returns
    -------
    matplotlib axes

    Raises
    ------
    ContourError
        A point is not finite, or the contour has no pieces.
    ValueError
        The points have another shape, or tol or magnify is not a number above 0.

    Examples
    --------
    >>> import matplotlib
    >>> matplotlib.use("Agg")
    >>> contour = Contour.starting_at((0, 0)).append_line((4, 0))
    >>> plot(contour, points=[(1, 0.01), (2, -0.01)], tol=0.02).get_aspect()
    1.0
    """
    if ax is None:
        import matplotlib.pyplot

        ax = matplotlib.pyplot.gca()
    if points is not None:
        _draw_points(ax, contour, _core.numbers(points, "points"), tol, magnify)
    _draw_pieces(ax, contour)
    ax.set_aspect("equal")
    if contour.units:
        ax.set_xlabel(f"x in {contour.units}")
        ax.set_ylabel(f"y in {contour.units}")
    ax.legend(loc="best", fontsize="small", framealpha=0.9)
    return ax


def _size(contour: Contour) -> float:
    left, low, right, high = contour.bounds
    return float(np.hypot(right - left, high - low)) or 1.0


def _draw_pieces(ax: Any, contour: Contour) -> None:
    chord = _CHORD * _size(contour)
    named = set()
    for index, piece in enumerate(contour):
        is_arc = isinstance(piece, Arc)
        name = "arc" if is_arc else "line"
        ax.plot(*contour[index:index + 1].sample(chord).T, zorder=3,
                color=_ARC_COLOUR if is_arc else _LINE_COLOUR, linewidth=2.2 if is_arc else 1.4,
                label=None if name in named else name, solid_capstyle="butt")
        named.add(name)
    joints = np.array([contour.start] + [piece.end for piece in contour])
    ax.plot(*joints.T, "o", color="white", markeredgecolor=_POINT_COLOUR, markersize=4, zorder=4,
            linestyle="none", label="joint")


def _draw_points(ax: Any, contour: Contour, points: npt.NDArray[np.float64],
                 tol: Optional[npt.ArrayLike], magnify: Optional[float]) -> None:
    if tol is None and points.ndim == 2 and points.shape[1] > 2:
        tol = points[:, 2]
    feet = contour.nearest(points)
    points = points[:, :2]
    away = points - feet.places
    tol = None if tol is None else _core.numbers(tol, "tolerances")
    _require_above_zero("tol", tol)
    _require_above_zero("magnify", magnify)
    if magnify is None:
        widest = feet.distances.max(initial=0.0) if tol is None else np.max(tol)
        magnify = _round_number(_READABLE * _size(contour) / widest) if widest > 0 else 1.0
    times = "" if magnify == 1 else f", {magnify:g} times as far"
    if tol is not None:
        _draw_band(ax, contour, feet.places, magnify * np.broadcast_to(tol, len(points)), times)
    ax.plot(*(feet.places + magnify * away).T, ".", color=_POINT_COLOUR, markersize=3, zorder=5,
            linestyle="none", label="points" + times)


def _require_above_zero(name: str, value: Optional[npt.ArrayLike]) -> None:
    if value is not None and not np.all(np.isfinite(value) & np.greater(value, 0)):
        raise ValueError(f"{name} must be a number above 0")


def _draw_band(ax: Any, contour: Contour, places: npt.NDArray[np.float64],
               width: npt.NDArray[np.float64], times: str) -> None:
    """Both edges of the tolerance, at the feet of the points."""
    if contour.is_closed:
        places, width = np.vstack((places, places[:1])), np.append(width, width[:1])
    step = np.gradient(places, axis=0) if len(places) > 1 else np.array([[1.0, 0.0]])
    length = np.hypot(*step.T)[:, None]
    normal = np.column_stack((-step[:, 1], step[:, 0])) / np.where(length > 0, length, 1.0)
    for sign, name in ((1, "tolerance" + times), (-1, None)):
        edge = places + sign * width[:, None] * normal
        ax.plot(*edge.T, "-", color=_BAND_COLOUR, linewidth=0.8, alpha=0.7, zorder=2, label=name)


def _round_number(value: float) -> float:
    """1, 2 or 5 times a power of ten, not above the value; but never less than 1."""
    power = 10.0 ** np.floor(np.log10(value))
    return float(max(1.0, max(step for step in (1, 2, 5) if step * power <= value) * power))
