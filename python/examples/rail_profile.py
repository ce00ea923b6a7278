#!/usr/bin/env python3
"""A rail head: find the radii that a measured profile was ground to.

usage: rail_profile.py [FOLDER]   writes rail_profile.png there
"""

import pathlib
import sys

import matplotlib
import numpy as np
import vorn

matplotlib.use("Agg")
import matplotlib.pyplot as plt  # noqa: E402 (after the choice of how to draw)

TOL = 0.02  # mm


def measured_profile():
    """Half of a rail head by its radii, 0.2 mm between points, with the noise of an instrument."""
    heading, place, points = 0.0, np.zeros(2), []
    for radius, length in [(300, 10.0), (80, 15.0), (13, 16.0), (np.inf, 12.0)]:
        for _ in range(int(length / 0.2)):
            points.append(place)
            heading -= 0.2 / radius
            place = place + 0.2 * np.array([np.cos(heading), np.sin(heading)])
    return np.array(points) + np.random.default_rng(1).normal(0, 0.003, (len(points), 2))


def main(folder="."):
    points = measured_profile()
    contour = vorn.fit(points, tol=TOL, strategy="fewest")
    for piece in contour:
        shape = f"R {piece.radius:8.2f}" if isinstance(piece, vorn.Arc) else "line      "
        print(f"{shape}  {piece.length:6.2f} mm  points {piece.points}")
    print(f"{len(contour)} pieces, no contour has fewer than {contour.fewest_possible}")

    axes = plt.figure(figsize=(8, 6)).gca()
    vorn.plot(contour, points=points, tol=TOL, ax=axes)
    axes.set_title(f"Rail head: {len(points)} points, {len(contour)} pieces")
    plt.savefig(pathlib.Path(folder, "rail_profile.png"), dpi=100)


if __name__ == "__main__":
    main(*sys.argv[1:])
