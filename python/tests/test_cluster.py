"""A scheduler and two workers, each a process of its own, on the loopback address."""

import os
import pathlib
import subprocess
import sys
import time

import numpy as np
import pytest
import vorn
import vorn.frame
from scans import TOL, scan

distributed = pytest.importorskip("distributed")


class Cluster:
    """Starts the processes as a user would, and ends them."""

    def __init__(self, folder):
        self.file = folder / "scheduler.json"
        self.scheduler = self.start("scheduler", "--host", "127.0.0.1", "--port", "0",
                                    "--no-dashboard", "--scheduler-file", str(self.file))
        self.workers = [
            self.start("worker", "--scheduler-file", str(self.file), "--host", "127.0.0.1",
                       "--nthreads", "1", "--no-nanny", "--no-dashboard", "--memory-limit", "0",
                       "--local-directory", str(folder / f"worker-{i}"))
            for i in range(2)]
        self.client = distributed.Client(scheduler_file=str(self.file), timeout="60s")
        self.client.wait_for_workers(2, timeout=60)

    @staticmethod
    def start(role, *options):
        paths = [str(pathlib.Path(__file__).parent), os.environ.get("PYTHONPATH", "")]
        return subprocess.Popen(
            [sys.executable, "-m", f"distributed.cli.dask_{role}", *options],
            env={**os.environ, "PYTHONPATH": os.pathsep.join(paths)},
            stdout=subprocess.DEVNULL, stderr=subprocess.DEVNULL)

    def stop(self):
        self.client.close()
        for process in (*self.workers, self.scheduler):
            process.terminate()
            process.wait(timeout=30)


@pytest.fixture
def cluster(tmp_path):
    started = Cluster(tmp_path)
    yield started
    started.stop()


@pytest.mark.thorough
def test_a_worker_may_die_in_the_middle(cluster):
    count = 2000
    contours = []
    for result in vorn.fit_many((scan(seed) for seed in range(count)), tol=TOL,
                                client=cluster.client):
        assert result.error is None and result.number == len(contours)
        contours.append(result.contour)
        if len(contours) == count // 2:
            assert len(cluster.client.nthreads()) == 2
            cluster.workers[0].kill()
    assert len(contours) == count
    assert len(cluster.client.nthreads()) == 1
    assert cluster.workers[0].wait(timeout=30) != 0
    alone = vorn.fit_many((scan(seed) for seed in range(count)), tol=TOL)
    assert all(result.contour == contour for result, contour in zip(alone, contours))


@pytest.mark.thorough
def test_results_come_in_order_and_failures_stay_alone(cluster, examples):
    path = examples / "gear_tooth.csv"
    scans = [scan(0, 50), "no such file", np.full((5, 2), np.nan), path, [(0, 0)], scan(5, 50)]
    results = list(vorn.fit_many(scans, tol=TOL, client=cluster.client, batch=2))
    alone = list(vorn.fit_many(scans, tol=TOL))
    assert [r.number for r in results] == list(range(6))
    assert [r.contour for r in results] == [r.contour for r in alone]
    assert [str(r.error) for r in results] == [str(r.error) for r in alone]
    assert [type(r.error) for r in results] == [type(r.error) for r in alone]


@pytest.mark.thorough
def test_a_scan_that_kills_its_worker_fails_alone(cluster, monkeypatch):
    cluster.client.run_on_scheduler(lambda: __import__("dask").config.set(
        {"distributed.scheduler.allowed-failures": 0}))
    cluster.client.run_on_scheduler(
        lambda dask_scheduler: setattr(dask_scheduler, "allowed_failures", 0))
    results = list(vorn.fit_many([scan(0, 50), Deadly(), scan(2, 50)], tol=TOL, batch=1,
                                 client=cluster.client))
    assert [r.contour is None for r in results] == [False, True, False]
    assert "killed" in type(results[1].error).__name__.lower()


class Deadly:
    """Ends the process that looks at it."""

    def __array__(self, dtype=None):
        os._exit(9)


@pytest.mark.thorough
def test_a_dask_frame_on_the_cluster(cluster):
    pandas = pytest.importorskip("pandas")
    dask_frame = pytest.importorskip("dask.dataframe")
    table = pandas.concat(
        [pandas.DataFrame(scan(seed, 100), columns=["x", "y"]).assign(scan=seed)
         for seed in range(30)], ignore_index=True)
    parts = dask_frame.from_pandas(table, npartitions=11)
    found = vorn.frame.fit(parts, tol=TOL).compute().sort_values(["scan", "piece"])
    expected = vorn.frame.fit(table, tol=TOL)
    assert found.reset_index(drop=True).equals(expected)


@pytest.mark.thorough
def test_results_that_nobody_takes_are_cancelled(cluster):
    results = vorn.fit_many((scan(seed) for seed in range(10**9)), tol=TOL,
                            client=cluster.client)
    assert next(results).number == 0
    results.close()
    deadline = time.monotonic() + 30
    while cluster.client.processing() and any(cluster.client.processing().values()):
        assert time.monotonic() < deadline
        time.sleep(0.2)
