"""The quick start does what the README says."""

import pathlib
import re

import vorn

README = pathlib.Path(__file__).resolve().parents[2] / "README.md"


def test_the_quick_start_runs(tmp_path, monkeypatch, examples):
    text = README.read_text(encoding="utf-8")
    code, after = re.search(r"```python\n(.*?)```(.*?)\n## ", text, re.DOTALL).groups()
    assert len(code.splitlines()) == 3
    monkeypatch.chdir(tmp_path)
    (tmp_path / "examples").symlink_to(examples)
    names = {}
    exec(code, names)
    pieces = int(re.search(r"a sequence of (\d+) lines and arcs", after).group(1))
    assert len(names["contour"]) == pieces
    assert len(vorn.Contour.read(tmp_path / "tooth.dxf")) == pieces
