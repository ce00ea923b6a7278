#!/usr/bin/env python3
"""Many scans with Dask: how the radius of a worn tool drifts over a shift.

usage: many_scans.py [FOLDER] [SCHEDULER]   writes many_scans.png there

Without the address of a scheduler, two workers are started on this machine.
"""

import pathlib
import sys

import distributed
import matplotlib
import numpy as np
import vorn

matplotlib.use("Agg")
import matplotlib.pyplot as plt  # noqa: E402 (after the choice of how to draw)

TOL = 0.01
SCANS = 200


def scan(number):
    """A rounded corner whose radius grows with the wear of the tool."""
    random = np.random.default_rng(number)
    radius = 8.0 + 0.004 * number + random.normal(0, 0.02)
    turn = np.linspace(0, np.pi / 2, 120)
    arc = np.column_stack((radius * np.sin(turn), radius * (1 - np.cos(turn))))
    wall = np.column_stack((np.linspace(-6, -0.1, 60), np.zeros(60)))
    points = np.vstack((wall, arc)) + random.normal(0, 0.001, (180, 2))
    if number % 50 == 49:
        points[17] = np.nan  # the instrument lost the surface
    return points


def main(folder=".", scheduler=None):
    if scheduler is None:
        cluster = distributed.LocalCluster(n_workers=2, threads_per_worker=1, host="127.0.0.1",
                                           dashboard_address=None)
        client = distributed.Client(cluster)
    else:
        client = distributed.Client(scheduler)
    radii, failures = {}, {}
    for number, _, contour, error in vorn.fit_many(map(scan, range(SCANS)), tol=TOL,
                                                   client=client):
        if contour is None:
            failures[number] = error
        else:
            arcs = [piece for piece in contour if isinstance(piece, vorn.Arc)]
            radii[number] = max(arcs, key=lambda arc: arc.length).radius
    print(f"{len(radii)} scans fitted, {len(failures)} failed:")
    for number, error in failures.items():
        print(f"  scan {number}: {error}")

    axes = plt.figure(figsize=(7, 4)).gca()
    axes.plot(list(radii), list(radii.values()), ".", label="radius of the corner")
    axes.plot(*np.transpose([(n, np.polyval(np.polyfit(list(radii), list(radii.values()), 1), n))
                             for n in radii]), label="trend")
    axes.set_xlabel("scan")
    axes.set_ylabel("radius")
    axes.legend()
    plt.savefig(pathlib.Path(folder, "many_scans.png"), dpi=100)
    client.close()
    if scheduler is None:
        cluster.close()


if __name__ == "__main__":
    main(*sys.argv[1:])
