"""Builds library and tests in a folder of their own, compiles changed sources, runs tests."""

import json
import os
import pathlib
import resource
import shlex
import signal
import subprocess
import tempfile

ROOT = pathlib.Path(__file__).resolve().parent.parent.parent
WORK = ROOT / "build" / "mutate"
PROGRAMS = ("unit_tests", "internal_tests")
LIBRARY = "libGeometryUtils.so.0"
WAITING = 6  # times the processor time that a test program may take, on a busy machine
MEMORY = 6 << 30  # bytes; a change must not eat the memory of the machine


class Failed(Exception):
    """A tool that the script needs has failed; its output is the text."""


def run_quietly(command, **options):
    done = subprocess.run(command, stdout=subprocess.PIPE, stderr=subprocess.STDOUT, text=True,
                          errors="replace", **options)
    if done.returncode != 0:
        raise Failed(f"{' '.join(map(str, command))[:300]}\n{done.stdout[-3000:]}")
    return done.stdout


def _without(command, *unwanted):
    return [word for word in command if word not in unwanted]


def without_launcher(words):
    """The words of a compilation without the compiler cache ahead of them, which CMake may call
    with variables of its own: "cmake -E env NAME=VALUE ccache c++ ..."."""
    names = [pathlib.Path(word).name for word in words]
    return words[names.index("ccache") + 1:] if "ccache" in names else words


class Build:
    """A configured build of a preset, with everything needed to compile one source once more."""

    def __init__(self, preset):
        self.preset = preset
        # As deep as the folders of other builds, so that the compiler cache knows the objects.
        self.folder = WORK.with_name(f"mutate-{preset}")
        self.is_sanitized = preset == "sanitize"

    def make(self, jobs):
        if not (self.folder / "build.ninja").exists():
            run_quietly(["cmake", "--preset", self.preset, "-B", str(self.folder),
                         # Objects are compiled by themselves, each with what it includes.
                         "-DCMAKE_DISABLE_PRECOMPILE_HEADERS=ON", "-DVORN_BUILD_PYTHON=OFF",
                         "-DVORN_BUILD_BENCHMARKS=OFF", "-DVORN_BUILD_IO=OFF",
                         "-DVORN_BUILD_CLI=OFF", "-DVORN_BUILD_FUZZ=OFF",
                         "-DVORN_BUILD_EXAMPLES=OFF"], cwd=ROOT)
        run_quietly(["cmake", "--build", str(self.folder), "--parallel", str(jobs), "--target",
                     "GeometryUtils", *PROGRAMS])
        self._read_commands()
        self._read_users()

    def _read_commands(self):
        """How each object is compiled: object, relative to the build folder -> words."""
        self.commands = {}
        for entry in json.loads((self.folder / "compile_commands.json").read_text()):
            words = without_launcher(shlex.split(entry["command"]))
            self.commands[words[words.index("-o") + 1]] = words
        self.core_objects = [name for name in self.commands if "/GeometryUtils.dir/" in name]
        self.test_objects = {
            program: [name for name in self.commands if f"/{program}.dir/" in name]
            for program in PROGRAMS}

    def _read_users(self):
        """Which objects a header is compiled into, as the last build noted them."""
        self.users = {}
        target = None
        for line in run_quietly(["ninja", "-C", str(self.folder), "-t", "deps"]).splitlines():
            if line.startswith(" "):
                path = os.path.normpath(self.folder / line.strip())
                if path.startswith(str(ROOT)):
                    self.users.setdefault(os.path.relpath(path, ROOT), []).append(target)
            else:
                target = line.split(":")[0]

    def source_of(self, name):
        """The file that an object is compiled from."""
        return self.folder / self.commands[name][-1]

    def object_of(self, source):
        return f"CMakeFiles/GeometryUtils.dir/{source}.o"

    def users_of(self, file):
        """(objects of the library, objects of the tests by program) that contain a file."""
        users = self.users.get(file, [])
        return ([name for name in self.core_objects if name in users],
                {program: [name for name in names if name in users]
                 for program, names in self.test_objects.items()})

    def compile(self, name, target, overlay=None, file=None):
        """Compiles an object again, with the files in the folder overlay before those of the tree.
        False where it does not compile. No warnings, no debug information: objects of two texts
        that mean the same are then equal byte for byte."""
        words = _without(self.commands[name], "-Werror")
        words[words.index("-o") + 1] = str(target)
        source = words[-1]
        if overlay is not None:
            words.insert(1, f"-I{overlay}")
            if os.path.relpath(source, ROOT) == file:
                words[-1] = str(overlay / file)
            words.append(f"-ffile-prefix-map={overlay}={ROOT}")
        words += ["-g0", "-w"]
        target.parent.mkdir(parents=True, exist_ok=True)
        done = subprocess.run(words, cwd=self.folder, stdout=subprocess.DEVNULL,
                              stderr=subprocess.DEVNULL, timeout=300)
        return done.returncode == 0

    def _compiler(self):
        return [self.commands[self.core_objects[0]][0]] + (
            ["-fsanitize=address,undefined"] if self.is_sanitized else [])

    def link_library(self, folder, replaced):
        """The shared library with some objects replaced: object -> path."""
        objects = [str(replaced.get(name, name)) for name in self.core_objects]
        run_quietly([*self._compiler(), "-shared", "-fuse-ld=gold", "-Wl,-Bsymbolic-functions",
                     f"-Wl,--version-script={ROOT}/cmake/exports.map", f"-Wl,-soname,{LIBRARY}",
                     "-o", str(folder / LIBRARY), *objects], cwd=self.folder)

    def link_tests(self, program, target, replaced, statically, extra=()):
        """A test program of its objects and the shared library, or of all objects themselves."""
        names = list(self.test_objects[program])
        names = (self.core_objects + names) if statically else names
        objects = [str(replaced.get(name, name)) for name in names]
        libraries = [] if statically else [str(self.folder / LIBRARY)]
        run_quietly([*self._compiler(), "-fuse-ld=gold",
                     *(["-no-pie"] if extra else ["-Wl,-s"]), "-o", str(target), *objects,
                     *map(str, extra), *libraries,
                     "-lgmock", "-lgtest_main", "-lgtest", "-lpthread"], cwd=self.folder)


def _limits(seconds, is_sanitized):
    """What bounds a test program, even where this script is ended before it."""
    def apply():
        os.setsid()
        resource.setrlimit(resource.RLIMIT_CORE, (0, 0))
        resource.setrlimit(resource.RLIMIT_CPU, (int(seconds) + 1, int(seconds) + 2))
        if not is_sanitized:
            resource.setrlimit(resource.RLIMIT_AS, (MEMORY, MEMORY))
    return apply


def run_tests(program, library_folder, names, seconds, is_sanitized=False):
    """Runs the named tests, for so many seconds of processor time at most, and stops at the first
    that fails. None when all pass, else what happened: the name of the test that failed,
    "timeout", or how the program ended."""
    environment = dict(os.environ, LD_LIBRARY_PATH=str(library_folder))
    if is_sanitized:
        environment["LSAN_OPTIONS"] = f"suppressions={ROOT}/tests/support/leaks.txt"
        environment["ASAN_OPTIONS"] = "detect_stack_use_after_return=1"
    with tempfile.NamedTemporaryFile("w", suffix=".flags") as flags:
        flags.write(f"--gtest_filter={':'.join(names)}\n--gtest_fail_fast\n--gtest_color=no\n")
        flags.flush()
        process = subprocess.Popen([str(program), f"--gtest_flagfile={flags.name}"], text=True,
                                   stdout=subprocess.PIPE, stderr=subprocess.STDOUT,
                                   errors="replace", env=environment, cwd=library_folder,
                                   preexec_fn=_limits(seconds, is_sanitized))
        try:
            output, _ = process.communicate(timeout=WAITING * seconds)
        except subprocess.TimeoutExpired:
            os.killpg(process.pid, signal.SIGKILL)
            process.communicate()
            return "timeout"
    if process.returncode == 0:
        return None
    if process.returncode == -signal.SIGXCPU:
        return "timeout"
    mark = "[ RUN " if process.returncode < 0 else "[  FAILED  ]"
    named = [line.split("]")[1].split(", where")[0].split(" (")[0].strip()
             for line in output.splitlines() if line.startswith(mark)]
    if process.returncode > 0:
        return named[0] if named else "the program fails"
    signal_name = signal.Signals(-process.returncode).name
    return f"{signal_name} in {named[-1] if named else 'the start of the program'}"
