"""Any number of scans, on one machine or on a cluster."""

from __future__ import annotations

import collections
import concurrent.futures
import itertools
import os
from typing import Any, Callable, Deque, Dict, Iterable, Iterator, List, NamedTuple, Optional, \
    Tuple

import numpy.typing as npt

from vorn.contour import Contour
from vorn.fitting import fit
from vorn.points import read_points

__all__ = ["FitResult", "fit_many"]

#: Batches that wait for each worker, so that none runs dry while results are fetched.
_AHEAD = 4


class FitResult(NamedTuple):
    """What became of one scan: a contour or an error.

    Attributes
    ----------
    number : int
        The position of the scan, from 0.
    path : str or None
        The path of a scan that was read from a file.
    contour : Contour or None
        None where the fit failed.
    error : Exception or None
        None where it did not.

    Examples
    --------
    >>> result = next(fit_many([[(0, 0), (3, 4)]], tol=0.01))
    >>> result.number, result.contour.length, result.error
    (0, 5.0, None)
    """

    number: int
    path: Optional[str]
    contour: Optional[Contour]
    error: Optional[Exception]


#: A scan and its position.
_Numbered = Tuple[int, Any]


def fit_many(scans: Iterable[Any], tol: Optional[npt.ArrayLike] = None, client: Any = None,
             workers: Optional[int] = None, batch: int = 16, **options: Any
             ) -> Iterator[FitResult]:
    """Fits scans side by side and yields their results in order, each as soon as it can be told.

    A scan that fails is a result with its error and stops no other. Scans are fetched only a little
    ahead of the results that are taken, so any number of them fits in the memory.

    Parameters
    ----------
    scans : iterable
        Of whatever `vorn.fit` takes as points, and of paths, which `vorn.read_points` reads where
        the fit is done.
    tol : float, optional
        Tolerance of all scans; those without need a column of tolerances.
    client : dask.distributed.Client, optional
        The cluster to fit on. Its workers need this package and, for paths, the files. Without one
        threads of this process do the work.
    workers : int, optional
        How many threads; as many as there are processors if not said.
    batch : int
        How many scans travel to a worker of the cluster at a time.
    **options
        As for `vorn.fit`.

    Yields
    ------
    FitResult
        (number, path, contour, error).

    Raises
    ------
    TypeError, ValueError
        There is a progress, or batch or workers is below 1. What is wrong with a scan or with the
        options of its fit is the error of its result.

    Examples
    --------
    >>> scans = [[(0, 0), (1, 0), (2, 0)], [(0, 0)], [(0, 0), (0, 3)]]
    >>> for number, path, contour, error in fit_many(scans, tol=0.01):
    ...     print(number, contour, error)
    0 <Contour: 1 piece (1 line, 0 arcs), open, length 2> None
    1 None a contour needs at least two points
    2 <Contour: 1 piece (1 line, 0 arcs), open, length 3> None
    """
    if "progress" in options:
        raise TypeError("fit_many() takes no progress; count the results")
    if batch < 1 or (workers is not None and workers < 1):
        raise ValueError("batch and workers must be 1 or more")
    fitting = dict(options, tol=tol)
    numbered = enumerate(scans)
    if client is not None:
        return _on_cluster(numbered, client, batch, fitting)
    return _on_threads(numbered, workers or os.cpu_count() or 1, fitting)


def _fit_one(scan: _Numbered, options: Dict[str, Any]) -> FitResult:
    number, points = scan
    path = os.fspath(points) if isinstance(points, (str, os.PathLike)) else None
    try:
        measured = points if path is None else read_points(path)
        return FitResult(number, path, fit(measured, **options), None)
    except Exception as error:
        # The frames of a traceback would keep the points alive.
        return FitResult(number, path, None, error.with_traceback(None))


def _fit_batch(scans: List[_Numbered], options: Dict[str, Any]) -> List[FitResult]:
    return [_fit_one(scan, options) for scan in scans]


def _in_order(jobs: Iterator[Any], ahead: int, result: Callable[[Any], List[FitResult]],
              cancel: Callable[[Any], Any]) -> Iterator[FitResult]:
    """Keeps so many jobs under way, and yields what they answer in their order."""
    waiting: Deque[Any] = collections.deque(itertools.islice(jobs, ahead))
    try:
        while waiting:
            answers = result(waiting.popleft())
            waiting.extend(itertools.islice(jobs, 1))
            yield from answers
    finally:
        for job in waiting:
            cancel(job)


def _on_threads(scans: Iterator[_Numbered], workers: int,
                options: Dict[str, Any]) -> Iterator[FitResult]:
    with concurrent.futures.ThreadPoolExecutor(workers, "vorn") as pool:
        jobs = (pool.submit(_fit_one, scan, options) for scan in scans)
        yield from _in_order(jobs, _AHEAD * workers, lambda job: [job.result()],
                             lambda job: job.cancel())


def _batches(scans: Iterator[_Numbered], size: int) -> Iterator[List[_Numbered]]:
    return iter(lambda: list(itertools.islice(scans, size)), [])


def _on_cluster(scans: Iterator[_Numbered], client: Any, size: int,
                options: Dict[str, Any]) -> Iterator[FitResult]:
    def submit(scans: List[_Numbered]) -> Tuple[Any, List[_Numbered]]:
        return client.submit(_fit_batch, scans, options, pure=False), scans

    def result(job: Tuple[Any, List[_Numbered]]) -> List[FitResult]:
        future, scans = job
        try:
            return list(future.result())
        except Exception as error:
            # Workers died of it: each scan alone, so that only the one that kills them fails.
            if len(scans) > 1:
                return [answer for scan in scans for answer in result(submit([scan]))]
            return [FitResult(scans[0][0], None, None, error.with_traceback(None))]

    ahead = _AHEAD * max(1, sum(client.nthreads().values()))
    yield from _in_order(map(submit, _batches(scans, size)), ahead, result,
                         lambda job: job[0].cancel())
