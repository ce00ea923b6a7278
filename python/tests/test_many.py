"""Many scans on the threads of one machine, and in frames of pandas."""

import concurrent.futures
import itertools
import pickle
import threading

import numpy as np
import pytest
import vorn
import vorn.frame
from scans import TOL, scan


def test_results_come_in_order_and_as_computed_alone():
    scans = [scan(seed, 60 + 10 * (seed % 5)) for seed in range(40)]
    results = list(vorn.fit_many(scans, tol=TOL))
    assert [result.number for result in results] == list(range(40))
    assert [result.contour for result in results] == [vorn.fit(s, tol=TOL) for s in scans]
    assert {result.error for result in results} == {None}


def test_a_scan_that_fails_is_a_result():
    bad = scan(1, 50)
    bad[7] = np.nan
    results = list(vorn.fit_many([scan(0, 50), bad, "no such file", 5, scan(2, 50)], tol=TOL))
    assert [result.contour is None for result in results] == [False, True, True, True, False]
    assert results[1].error.indices == (7,)
    assert isinstance(results[2].error, vorn.FileError) and results[2].path == "no such file"
    assert isinstance(results[3].error, ValueError)
    assert all(pickle.loads(pickle.dumps(result)) for result in results)
    assert len(pickle.dumps(results[1])) < 300


def test_paths_are_read_where_they_are_fitted(tmp_path, examples):
    path = examples / "gear_tooth.csv"
    results = list(vorn.fit_many([path, str(path)]))
    alone = vorn.fit(vorn.read_points(path))
    assert [(result.path, result.contour) for result in results] == [(str(path), alone)] * 2


def test_scans_are_fetched_only_a_little_ahead():
    fetched = itertools.count()
    last = [0]

    def endless():
        for last[0] in fetched:
            yield scan(last[0], 30)

    results = vorn.fit_many(endless(), tol=TOL, workers=2)
    for _ in range(10):
        next(results)
    assert last[0] < 30
    results.close()


class Client:
    """What of a Dask client is used; batches that hold a deadly scan kill the worker."""

    def __init__(self):
        self.batches = []

    def nthreads(self):
        return {"a": 1, "b": 1}

    def submit(self, work, scans, options, pure):
        assert not pure
        self.batches.append([number for number, _ in scans])
        future = concurrent.futures.Future()
        if any(points == "deadly" for _, points in scans if isinstance(points, str)):
            future.set_exception(ChildProcessError("the worker died"))
        else:
            future.set_result(work(scans, options))
        return future


def test_a_batch_that_kills_workers_is_taken_apart():
    client = Client()
    scans = [scan(seed, 50) for seed in range(7)]
    scans[4] = "deadly"
    results = list(vorn.fit_many(scans, tol=TOL, client=client, batch=3))
    assert [result.number for result in results] == list(range(7))
    assert [result.contour is None for result in results] == [n == 4 for n in range(7)]
    assert isinstance(results[4].error, ChildProcessError)
    assert results[3].contour == vorn.fit(scans[3], tol=TOL)
    assert sorted(client.batches) == [[0, 1, 2], [3], [3, 4, 5], [4], [5], [6]]


def test_no_scans_no_results():
    assert list(vorn.fit_many([])) == []


def test_threads_are_used():
    seen = set()

    class Telling:
        def __init__(self, points):
            self.points = points

        def __array__(self, dtype=None):
            seen.add(threading.get_ident())
            return self.points

    list(vorn.fit_many([Telling(scan(seed, 400)) for seed in range(20)], tol=TOL, workers=4))
    assert threading.get_ident() not in seen and len(seen) > 1


@pytest.mark.parametrize("options, error", [
    ({"progress": print}, TypeError), ({"batch": 0}, ValueError), ({"colour": 1}, TypeError)])
def test_wrong_options(options, error):
    if "colour" in options:
        assert isinstance(next(vorn.fit_many([scan(0, 30)], tol=TOL, **options)).error, error)
        return
    with pytest.raises(error):
        vorn.fit_many([scan(0)], tol=TOL, **options)


@pytest.fixture
def table():
    pandas = pytest.importorskip("pandas")
    frames = [pandas.DataFrame(scan(seed, 80), columns=["x", "y"]).assign(scan=f"part {seed}")
              for seed in range(5)]
    frames[2].loc[3, "x"] = np.nan
    whole = pandas.concat(frames)
    # Scans may be interleaved; the order within each counts.
    return whole.iloc[np.argsort(np.tile(np.arange(80), 5), kind="stable")]


def test_a_frame_of_scans(table):
    found = vorn.frame.fit(table, tol=TOL, rows="scans")
    assert sorted(found["scan"]) == [f"part {seed}" for seed in range(5)]
    for row in found.itertuples():
        seed = int(row.scan[-1])
        if seed == 2:
            assert row.error == "point 3: x or y is not finite" and row.pieces == 0
            continue
        alone = vorn.fit(scan(seed, 80), tol=TOL)
        assert (row.pieces, row.length, row.max_deviation, row.max_index, row.verdict) == (
            len(alone), alone.length, alone.max_deviation, alone.max_index, "within tolerance")


def test_a_frame_of_pieces(table):
    found = vorn.frame.fit(table, tol=TOL)
    alone = vorn.fit(scan(4, 80), tol=TOL)
    part = found[found["scan"] == "part 4"]
    assert part["piece"].tolist() == list(range(len(alone)))
    for name in alone.as_arrays().dtype.names:
        assert np.array_equal(part[name].to_numpy(), alone.as_arrays()[name], equal_nan=(
            name not in ("is_arc", "ccw")))
    failed = found[found["scan"] == "part 2"]
    assert failed["piece"].tolist() == [-1] and "point 3" in failed["error"].iloc[0]


def test_a_frame_with_columns_of_other_names(table):
    other = table.rename(columns={"x": "u", "y": "v", "scan": "id"}).assign(t=TOL)
    found = vorn.frame.fit(other, by="id", x="u", y="v", w="t", rows="scans")
    assert found["pieces"].tolist() == vorn.frame.fit(table, tol=TOL, rows="scans")[
        "pieces"].tolist()


def test_an_empty_frame_has_an_empty_result(table):
    for rows in ("pieces", "scans"):
        whole, empty = (vorn.frame.fit(part, tol=TOL, rows=rows)
                        for part in (table, table.iloc[:0]))
        assert len(empty) == 0 and empty.dtypes.equals(whole.dtypes)
    with pytest.raises(ValueError):
        vorn.frame.fit(table, tol=TOL, rows="columns")


def test_a_dask_frame_gives_the_same(table):
    dask_frame = pytest.importorskip("dask.dataframe")
    parts = dask_frame.from_pandas(table.reset_index(drop=True), npartitions=7)
    for rows in ("pieces", "scans"):
        lazy = vorn.frame.fit(parts, tol=TOL, rows=rows)
        found = lazy.compute(scheduler="threads").sort_values(["scan"], kind="stable")
        expected = vorn.frame.fit(table, tol=TOL, rows=rows).sort_values("scan", kind="stable")
        assert lazy.dtypes.equals(expected.dtypes)
        assert found.reset_index(drop=True).equals(expected.reset_index(drop=True))
