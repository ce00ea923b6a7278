"""Fits in several threads run side by side. No test here depends on how busy the machine is."""

import contextlib
import ctypes
import os
import sys
import threading
import time

import numpy as np
import pytest
import vorn
from scans import TOL, scan

#: What a fit may need until the other one is there, or until the processors are free for both.
PATIENCE = 120.0  # seconds
#: How long the interpreter lock is held at a time; shorter than a fit waits between its looks for
#: signals, for which it needs the lock.
HELD = 2000  # microseconds


def test_two_fits_are_inside_at_once():
    """Each report of progress waits for that of the other fit: no lock is held through a fit."""
    points = scan(0, 300)
    barrier = threading.Barrier(2, timeout=PATIENCE)
    contours = []

    def meet():
        contours.append(vorn.fit(points, tol=TOL, strategy="mixed",
                                 progress=lambda percent: barrier.wait()))

    threads = [threading.Thread(target=meet) for _ in range(2)]
    for thread in threads:
        thread.start()
    for thread in threads:
        thread.join()
    assert contours == [vorn.fit(points, tol=TOL, strategy="mixed")] * 2


@contextlib.contextmanager
def fits_at_work(count):
    """The processor clocks of threads that do nothing but fit, and ask for the interpreter lock
    only between fits and for the looks for signals."""
    t = np.arange(2000.0)
    wave = np.column_stack((t, 50 * np.sin(t / 300)))
    done = threading.Event()

    def work():
        deadline = time.monotonic() + PATIENCE
        while time.monotonic() < deadline and not done.is_set():
            vorn.fit(wave, tol=0.01, strategy="mixed")
        done.wait()

    threads = [threading.Thread(target=work) for _ in range(count)]
    for thread in threads:
        thread.start()
    try:
        yield [time.pthread_getcpuclockid(thread.ident) for thread in threads]
    finally:
        done.set()
        for thread in threads:
            thread.join()


@pytest.fixture
def kept_lock():
    """This thread gives the interpreter lock away only where it sleeps on purpose."""
    usual = sys.getswitchinterval()
    sys.setswitchinterval(10 * PATIENCE)
    yield
    sys.setswitchinterval(usual)


def progress_without_lock(clocks):
    """Yields how long this thread sat on the interpreter lock, and the processor time that each of
    the others used meanwhile."""
    # Called so, a function of C keeps the lock; time.sleep gives it away.
    usleep = ctypes.PyDLL(None).usleep
    deadline = time.monotonic() + PATIENCE
    while time.monotonic() < deadline:
        begin = time.monotonic()
        before = [time.clock_gettime(clock) for clock in clocks]
        usleep(HELD)
        used = [time.clock_gettime(clock) - b for clock, b in zip(clocks, before)]
        yield time.monotonic() - begin, used
        time.sleep(0.001)


def test_a_fit_goes_on_while_another_thread_has_the_interpreter_lock(kept_lock):
    """A fit that needed the lock would stand still meanwhile."""
    total = 0.0
    with fits_at_work(1) as clocks:
        for _, (used,) in progress_without_lock(clocks):
            total += used
            if total > 0.05:
                break
    assert total > 0.05


@pytest.mark.skipif(len(os.sched_getaffinity(0)) < 2, reason="there is one processor")
def test_two_fits_use_two_processors(kept_lock):
    """Taking turns, they could not use more processor time together than passes on the clock. A
    busy machine lets them run at once more seldom, so this waits until it has seen it."""
    most = 0.0
    with fits_at_work(2) as clocks:
        for passed, used in progress_without_lock(clocks):
            most = max(most, sum(used) / passed)
            if most > 1.3:
                break
    assert most > 1.3
