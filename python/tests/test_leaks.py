"""What runs long keeps no memory."""

import pathlib
import sys

import numpy as np
import pytest
import vorn
from scans import TOL, scan


def resident_pages():
    return int(pathlib.Path("/proc/self/statm").read_text().split()[1])


@pytest.mark.thorough
def test_ten_thousand_fits_leak_nothing():
    points, bad = scan(0, 60), np.full((5, 2), np.nan)

    def stop(percent):
        raise InterruptedError

    def rounds(count):
        for _ in range(count):
            contour = vorn.fit(points, tol=TOL)
            contour.deviations(points)
            hash(contour)
            with pytest.raises(vorn.ContourError):
                vorn.fit(bad, tol=TOL)
            with pytest.raises(InterruptedError):
                vorn.fit(points, tol=TOL, progress=stop)

    rounds(1000)
    before, references = resident_pages(), sys.getrefcount(None)
    rounds(10_000)
    # A kilobyte of each fit would be 2,500 pages.
    assert resident_pages() - before < 500
    assert sys.getrefcount(None) - references < 100
