#!/usr/bin/env python3
"""A closed cam: strategies side by side, area, and the radii round the cam.

usage: closed_cam.py [FOLDER]   writes closed_cam.png there
"""

import pathlib
import sys

import matplotlib
import numpy as np
import vorn

matplotlib.use("Agg")
import matplotlib.pyplot as plt  # noqa: E402 (after the choice of how to draw)

SCAN = pathlib.Path(__file__).resolve().parents[2] / "examples" / "cam.csv"


def main(folder="."):
    points = vorn.read_points(SCAN)
    figure, axes = plt.subplots(1, 2, figsize=(11, 5))
    for strategy, ax in zip(("mixed", "fewest"), axes):
        contour = vorn.fit(points, strategy=strategy)
        radii = [piece.radius for piece in contour if isinstance(piece, vorn.Arc)]
        print(f"{strategy}: {len(contour)} pieces, closed: {contour.is_closed}, "
              f"area {contour.area:.2f}, radii {np.min(radii):.2f} to {np.max(radii):.2f}")
        vorn.plot(contour, points=points, ax=ax)
        ax.set_title(f'"{strategy}": {len(contour)} pieces')
    figure.tight_layout()
    figure.savefig(pathlib.Path(folder, "closed_cam.png"), dpi=100)


if __name__ == "__main__":
    main(*sys.argv[1:])
