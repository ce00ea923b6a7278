"""The job script of the page about clusters does what the page says."""

import concurrent.futures
import os
import pathlib
import re
import subprocess

import pytest
import vorn
from scans import scan

PAGE = pathlib.Path(__file__).resolve().parents[1] / "docs" / "cluster.rst"


def job_script():
    """The indented block of the page that starts with the name of its interpreter."""
    block = re.search(r"^    #!/bin/bash\n(    .*\n|\n)+", PAGE.read_text(), re.MULTILINE).group()
    return re.sub(r"^    ", "", block, flags=re.MULTILINE)


class BatchSystem:
    """Runs the jobs of an array two at a time, each with the variables that tell it its share."""

    def __init__(self, folder, program):
        self.folder = folder
        commands = folder / "commands"
        commands.mkdir()
        (commands / "contour").symlink_to(program)
        self.path = os.pathsep.join([str(commands), os.environ["PATH"]])

    def submit(self, script):
        """The exit codes and messages of the jobs, by their number."""
        file = self.folder / "job.sh"
        file.write_text(script)
        file.chmod(0o755)
        wanted = dict(re.findall(r"^#SBATCH --([\w-]+)=(.*)$", script, re.MULTILINE))
        first, last = map(int, wanted["array"].split("-"))
        with concurrent.futures.ThreadPoolExecutor(2) as pool:
            return dict(pool.map(lambda number: self.run(file, number, wanted["cpus-per-task"]),
                                 range(first, last + 1)))

    def run(self, file, number, processors):
        variables = {**os.environ, "PATH": self.path, "SLURM_ARRAY_TASK_ID": str(number),
                     "SLURM_CPUS_PER_TASK": processors}
        done = subprocess.run([str(file)], cwd=self.folder, env=variables, check=False,
                              stdout=subprocess.PIPE, stderr=subprocess.STDOUT, text=True)
        return number, (done.returncode, done.stdout)


@pytest.fixture
def batch_system(program, tmp_path):
    (tmp_path / "scans").mkdir()
    return BatchSystem(tmp_path, program)


def write_scans(folder, count):
    """Files whose names a shell must quote."""
    for number in range(count):
        lines = "".join(f"{x!r},{y!r}\n" for x, y in scan(number, 40).tolist())
        (folder / "scans" / f"scan {number}.csv").write_text("x,y\n" + lines)


def assert_fitted(folder, number):
    name = f"scan {number}"
    found, = (folder / "fitted").glob(f"*/{name}.json")
    assert found.with_suffix(".dxf").exists()
    points = vorn.read_points(folder / "scans" / f"{name}.csv")
    assert vorn.Contour.read(found) == vorn.fit(points, tol=0.02)


def test_every_scan_is_fitted_by_one_job(batch_system, tmp_path):
    write_scans(tmp_path, 45)
    jobs = batch_system.submit(job_script())
    assert len(jobs) == 20 and {code for code, _ in jobs.values()} == {0}
    for number in range(45):
        assert_fitted(tmp_path, number)


def test_a_job_goes_on_past_files_that_cannot_be_fitted(batch_system, tmp_path):
    write_scans(tmp_path, 45)
    spoilt = {7: "x,y\n0,0\n1,one\n", 30: "x,y\n1,1\n1,1\n1,1\n"}
    for number, text in spoilt.items():
        (tmp_path / "scans" / f"scan {number}.csv").write_text(text)
    jobs = batch_system.submit(job_script())
    # 3: a line of the file is wrong; 5: all points are in one place.
    assert sorted(code for code, _ in jobs.values()) == [0] * 18 + [3, 5]
    messages = "".join(said for _, said in jobs.values())
    assert "scan 7.csv:3" in messages and "scan 30.csv" in messages
    for number in set(range(45)) - set(spoilt):
        assert_fitted(tmp_path, number)


def test_a_job_without_a_share_has_nothing_to_do(batch_system, tmp_path):
    write_scans(tmp_path, 3)
    jobs = batch_system.submit(job_script())
    assert {code for code, _ in jobs.values()} == {0}
    assert len(list((tmp_path / "fitted").glob("*/*.json"))) == 3
