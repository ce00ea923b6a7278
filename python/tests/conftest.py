"""What the tests share."""

import os
import pathlib
import shutil

import numpy as np
import pytest


def pytest_configure(config):
    config.addinivalue_line("markers", "thorough: takes minutes; ./test --all runs it")


@pytest.fixture
def examples():
    """The folder with the measured points that the project ships."""
    return pathlib.Path(os.environ["VORN_EXAMPLES"])


@pytest.fixture
def shared():
    """The folder with further measured contours."""
    folder = os.environ.get("VORN_DATA_DIR")
    if not folder:
        pytest.skip("VORN_DATA_DIR is not set")
    return pathlib.Path(folder)


@pytest.fixture
def program():
    """The program contour of this build."""
    found = os.environ.get("CONTOUR_PROGRAM") or shutil.which("contour")
    if not found:
        pytest.skip("the program contour is not there: CONTOUR_PROGRAM does not name it")
    return found


@pytest.fixture
def corner():
    """A corner of two lines, sampled with a step of 1."""
    return np.array([(0, 0), (1, 0), (2, 0), (3, 0), (3, 1), (3, 2), (3, 3)], dtype=float)


@pytest.fixture
def circle():
    """A full circle of radius 10 in 90 points, the first not repeated."""
    angles = np.arange(90) * (2 * np.pi / 90)
    return np.column_stack((10 * np.cos(angles), 10 * np.sin(angles)))
