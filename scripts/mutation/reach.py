"""Which tests run a line of the library, and how long each takes."""

import bisect
import collections
import dataclasses
import json
import os
import subprocess

from .program import PROGRAMS, ROOT, WORK, run_quietly

_FOLDER = WORK / "reach"
_TABLE = _FOLDER / "table.json"
_LISTENER = "scripts/mutation/ReachListener.cpp"
_LONGEST_BLOCK = 15  # lines
_BESIDE = 2  # lines
_INSTRUMENTED = ["-O1", "-g1", "-w",
                 "-fsanitize-coverage=inline-8bit-counters,pc-table,no-prune"]


@dataclasses.dataclass
class Test:
    program: str
    name: str
    seconds: float


def _compile(build, jobs):
    """The objects of the library with counters, and the listener."""
    waiting = [(name, _FOLDER / name) for name in build.core_objects]
    running = []
    for name, target in waiting:
        target.parent.mkdir(parents=True, exist_ok=True)
        gcc_only = ("-Wduplicated-branches", "-Wduplicated-cond", "-Wlogical-op", "-Werror")
        words = [word for word in build.commands[name] if word not in gcc_only]
        words[0] = "clang++"
        words[words.index("-o") + 1] = str(target)
        running.append(subprocess.Popen(words + _INSTRUMENTED, cwd=build.folder))
        if len(running) >= jobs and running.pop(0).wait() != 0:
            raise RuntimeError(f"{name} does not compile with counters")
    if any(process.wait() != 0 for process in running):
        raise RuntimeError("the library does not compile with counters")
    listener = _FOLDER / "ReachListener.o"
    run_quietly(["g++", "-std=c++20", "-O1", "-c", str(ROOT / _LISTENER), "-o", str(listener)])
    return dict(waiting), listener


def _run(build, program, objects, listener):
    executable = _FOLDER / program
    build.link_tests(program, executable, objects, statically=True, extra=[listener])
    notes = _FOLDER / f"{program}.txt"
    subprocess.run([str(executable), "--gtest_brief=1"], check=True, cwd=_FOLDER,
                   env=dict(os.environ, VORN_REACH=str(notes)), stdout=subprocess.DEVNULL)
    return executable, notes


def _places(executable, addresses):
    """(file, line) of every frame at each address, relative to the sources."""
    mapped = run_quietly(["addr2line", "-e", str(executable), "-i", "-a"],
                         input="\n".join(addresses))
    places = []
    for line in mapped.splitlines():
        if line.startswith("0x"):
            places.append([])
            continue
        path, _, number = line.split(" (disc")[0].rpartition(":")
        path = os.path.normpath(path)
        if path.startswith(str(ROOT)) and number.isdigit() and int(number) > 0:
            places[-1].append((os.path.relpath(path, ROOT), int(number)))
    return places


def _lines_by_object(objects):
    """Which lines of which header each object has code of: header -> object -> lines."""
    found = collections.defaultdict(lambda: collections.defaultdict(set))
    for name, path in objects.items():
        header = None
        for line in run_quietly(["objdump", "--dwarf=decodedline", str(path)]).splitlines():
            if line.startswith("/"):
                header = os.path.relpath(line.rstrip(":"), ROOT) if line.endswith(".h:") else None
            elif header and len(words := line.split()) >= 3 and words[1].isdigit():
                found[header][name].add(int(words[1]))
    return {header: {name: sorted(lines) for name, lines in by_object.items()}
            for header, by_object in found.items()}


def measure(build, jobs):
    """Runs every test once and writes down which lines it runs."""
    _FOLDER.mkdir(parents=True, exist_ok=True)
    objects, listener = _compile(build, jobs)
    tests, lines = [], collections.defaultdict(set)
    for program in PROGRAMS:
        executable, notes = _run(build, program, objects, listener)
        addresses, seen = [], []
        for line in notes.read_text().splitlines():
            kind, *words = line.split()
            if kind == "pc":
                addresses.append(words[0])
            else:
                tests.append((program, words[0], int(words[1]) / 1e6))
                seen.append([int(word) for word in words[2:]])
        places = _places(executable, addresses)
        first = len(tests) - len(seen)
        for place in (place for frames in places for place in frames):
            lines[place]  # every block counts as a line that can be run, if only by no test
        for number, blocks in enumerate(seen):
            for block in blocks:
                for place in places[block]:
                    lines[place].add(first + number)
    by_file = collections.defaultdict(dict)
    for (file, line), numbers in lines.items():
        by_file[file][line] = sorted(numbers)
    _TABLE.write_text(json.dumps({"tests": tests, "lines": by_file,
                                  "objects": _lines_by_object(objects)}))


class Reach:
    """What measure() has written."""

    def __init__(self):
        table = json.loads(_TABLE.read_text())
        self.objects = table["objects"]
        self.tests = [Test(*entry) for entry in table["tests"]]
        self.lines = {file: {int(line): set(numbers) for line, numbers in lines.items()}
                      for file, lines in table["lines"].items()}
        self.sorted_lines = {file: sorted(lines) for file, lines in self.lines.items()}

    def users_of_line(self, file, line, users):
        """Those of the objects that include a header and have code of a line of it, or of one
        beside it; all of them where none has, as with a constant."""
        lines = self.objects.get(file, {})
        having = [name for name in users if any(abs(number - line) <= _BESIDE
                                                for number in lines.get(name, ()))]
        return having or users

    def breadth(self, file):
        """How many lines of a file each test runs."""
        counts = collections.Counter()
        for numbers in self.lines.get(file, {}).values():
            counts.update(numbers)
        return counts

    def of_line(self, file, line):
        """(tests that run the block of a line or one beside it, tests that run the file), as sets
        of numbers. A constant belongs to no block, so every test of its file may notice it, and
        where the file has no code either, every test there is."""
        if file not in self.lines:
            return set(), set(range(len(self.tests)))
        numbers = self.sorted_lines[file]
        here = bisect.bisect_right(numbers, line)
        blocks = [number for number in numbers if abs(number - line) <= _BESIDE]
        if here > 0 and line - numbers[here - 1] <= _LONGEST_BLOCK:
            blocks.append(numbers[here - 1])
        whole = set().union(*self.lines[file].values())
        return set().union(*(self.lines[file][number] for number in blocks)), whole


def is_measured():
    return _TABLE.exists()
