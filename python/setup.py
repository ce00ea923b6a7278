"""Builds the compiled part of vorn with CMake, from the tree around this folder.

pip wheel --no-build-isolation --no-deps python/

needs no network. What the variable CMAKE_ARGS holds goes to CMake as well. The libraries are built
into the extension, so the wheel needs nothing of this project beside it, only librsvg of the system
for its drawings.
"""

import os
import pathlib
import re
import shlex
import shutil
import subprocess
import sys

from setuptools import Extension, setup
from setuptools.command.build_ext import build_ext

ROOT = pathlib.Path(__file__).resolve().parent.parent


def version():
    """That of the whole project."""
    return re.search(r"^\s*VERSION ([0-9.]+)$", (ROOT / "CMakeLists.txt").read_text(),
                     re.MULTILINE).group(1)


class BuildWithCMake(build_ext):
    """Makes the one extension module."""

    OPTIONS = {"CMAKE_BUILD_TYPE": "Release", "BUILD_SHARED_LIBS": "OFF", "VORN_INSTALL": "OFF",
               "VORN_BUILD_PYTHON": "ON", "VORN_BUILD_CLI": "OFF", "VORN_BUILD_EXAMPLES": "OFF",
               "VORN_BUILD_TESTS": "OFF", "VORN_BUILD_BENCHMARKS": "OFF",
               "Python3_EXECUTABLE": sys.executable}

    def build_extension(self, extension):
        folder = pathlib.Path(self.build_temp).resolve()
        generator = ["-G", "Ninja"] if shutil.which("ninja") else []
        self.run_command_line("cmake", "-S", ROOT, "-B", folder, *generator,
                              *(f"-D{name}={value}" for name, value in self.OPTIONS.items()),
                              *shlex.split(os.environ.get("CMAKE_ARGS", "")))
        self.run_command_line("cmake", "--build", folder, "--target", "vorn_core", "--parallel")
        built, = (folder / "python" / "vorn").glob("_core.*.so")
        target = pathlib.Path(self.get_ext_fullpath(extension.name))
        target.parent.mkdir(parents=True, exist_ok=True)
        shutil.copyfile(built, target)

    @staticmethod
    def run_command_line(*command):
        subprocess.run([str(word) for word in command], check=True)


setup(version=version(), ext_modules=[Extension("vorn._core", sources=[])],
      cmdclass={"build_ext": BuildWithCMake})
