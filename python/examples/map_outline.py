#!/usr/bin/env python3
"""A lake on a map, in metres far from the origin: fewer and fewer pieces for wider tolerances.

usage: map_outline.py [FOLDER]   writes map_outline.png there
"""

import pathlib
import sys

import matplotlib
import numpy as np
import vorn

matplotlib.use("Agg")
import matplotlib.pyplot as plt  # noqa: E402 (after the choice of how to draw)

ORIGIN = (4_470_000.0, 5_330_000.0)  # of the grid of the map


def shore():
    """A smooth outline of some bays, a point every few metres."""
    random = np.random.default_rng(5)
    angle = np.linspace(0, 2 * np.pi, 900, endpoint=False)
    radius = 800.0 + sum(random.uniform(20, 120) / k * np.cos(k * angle + random.uniform(0, 6))
                         for k in range(2, 9))
    return np.column_stack((radius * np.cos(angle), radius * np.sin(angle))) + ORIGIN


def main(folder="."):
    points = shore()
    figure, axes = plt.subplots(1, 3, figsize=(13, 4.6))
    for tolerance, ax in zip((1, 5, 25), axes):
        contour = vorn.fit(points, tol=tolerance, strategy="fewest", closed=True)
        print(f"tolerance {tolerance} m: {len(contour)} pieces, {abs(contour.area) / 1e4:.3f} ha, "
              f"{len(contour.to_wkt())} letters of WKT")
        near = contour.shifted(-ORIGIN[0], -ORIGIN[1])
        vorn.plot(near, points=points[::9] - ORIGIN, tol=tolerance, magnify=1, ax=ax)
        ax.set_title(f"within {tolerance} m: {len(contour)} pieces for {len(points)} points")
    figure.tight_layout()
    figure.savefig(pathlib.Path(folder, "map_outline.png"), dpi=100)


if __name__ == "__main__":
    main(*sys.argv[1:])
