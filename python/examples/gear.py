#!/usr/bin/env python3
"""A gear tooth: fit it, look at the deviations, hand it to a drawing program and a machine.

usage: gear.py [FOLDER]   writes gear.png, gear.dxf and gear.nc there
"""

import pathlib
import sys

import matplotlib
import vorn

matplotlib.use("Agg")
import matplotlib.pyplot as plt  # noqa: E402 (after the choice of how to draw)

SCAN = pathlib.Path(__file__).resolve().parents[2] / "examples" / "gear_tooth.csv"


def main(folder="."):
    points = vorn.read_points(SCAN)  # x, y and the tolerance that the file states
    contour = vorn.fit(points)
    print(contour)
    print(f"largest deviation {contour.max_deviation:.1%} of the tolerance, "
          f"at point {contour.max_index}")

    contour.save(pathlib.Path(folder, "gear.dxf"))
    contour.save(pathlib.Path(folder, "gear.nc"), feed=600)

    figure, (above, below) = plt.subplots(2, figsize=(7, 9), height_ratios=(3, 1))
    vorn.plot(contour, points=points, ax=above)
    above.set_title("A gear tooth and its tolerance")
    below.plot(contour.deviations(points, signed=True) / points[:, 2], linewidth=0.8)
    below.axhline(1, color="grey")
    below.axhline(-1, color="grey")
    below.set_xlabel("point")
    below.set_ylabel("deviation / tolerance")
    figure.tight_layout()
    figure.savefig(pathlib.Path(folder, "gear.png"), dpi=100)


if __name__ == "__main__":
    main(*sys.argv[1:])
