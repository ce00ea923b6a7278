"""Scans made by a formula, the same in every process."""

import numpy as np


def scan(seed, count=1000):
    """A wall, a round corner of another radius for each seed, and a wall, with a little noise."""
    random = np.random.default_rng(seed)
    radius = random.uniform(5, 20)
    t = np.linspace(0, 40 + radius * np.pi / 2, count)
    turn = np.clip((t - 20) / radius, 0, np.pi / 2)
    before, after = np.minimum(t, 20), np.maximum(t - 20 - radius * np.pi / 2, 0)
    points = np.column_stack((before + radius * np.sin(turn), radius * (1 - np.cos(turn)) + after))
    return points + random.normal(0, 0.001, points.shape)


TOL = 0.01
