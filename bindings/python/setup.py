"""Builds the package: CMake compiles the extension module, the presets come along.

The sources of the library stand two folders above, or, in a source distribution, in the folder `library`.
"""

import os
import re
import shutil
import subprocess
import sys
from pathlib import Path

from setuptools import Extension, setup
from setuptools.command.build_ext import build_ext
from setuptools.command.build_py import build_py
from setuptools.command.sdist import sdist

HERE = Path(__file__).resolve().parent
PACKED = HERE / "library"
ROOT = PACKED if PACKED.is_dir() else HERE.parents[1]
PRESETS = ROOT / "style/presets"

# What the extension is built of.
SOURCES = ["CMakeLists.txt", "LICENSE", "NOTICE", "CHANGELOG.md", "README.md", "SECURITY.md", "blend", "capi", "cmake",
           "compose", "core", "cores", "effect", "include", "ops", "packaging/debian", "property", "simd", "style", "text",
           "unicode", "bindings/python/CMakeLists.txt", "bindings/python/METADATA.in", "bindings/python/src",
           "bindings/python/voreleffect"]


def version():
    text = (ROOT / "include/voreleffect/VFVersion.h").read_text(encoding="utf-8")
    return ".".join(re.search(rf"VOREL_VERSION_{part} (\d+)", text)[1] for part in ("MAJOR", "MINOR", "PATCH"))


def pybind11_include():
    import pybind11

    return pybind11.get_include()


class BuildWithCMake(build_ext):
    """One build folder, which the next build takes up again."""

    def build_extension(self, ext):
        build = ROOT / "build/python"
        subprocess.run(["cmake", "-S", ROOT, "-B", build, "-G", "Ninja", "-DCMAKE_BUILD_TYPE=Release",
                        "-DVOREL_BUILD_PYTHON=ON", "-DVOREL_INSTALL=OFF",
                        f"-DVOREL_WERROR={os.environ.get('VOREL_WERROR', 'OFF')}",
                        f"-DVOREL_UNITY={os.environ.get('VOREL_UNITY', 'OFF')}",
                        f"-DPython3_EXECUTABLE={sys.executable}",
                        f"-DVOREL_PYBIND11_INCLUDE={pybind11_include()}"], check=True, stdout=subprocess.DEVNULL)
        subprocess.run(["cmake", "--build", build, "--target", "_voreleffect", "--", "--quiet"], check=True)
        target = Path(self.get_ext_fullpath(ext.name))
        target.parent.mkdir(parents=True, exist_ok=True)
        shutil.copyfile(build / target.name, target)


class BuildWithPresets(build_py):
    def run(self):
        super().run()
        if self.editable_mode:
            return
        folder = Path(self.build_lib) / "voreleffect/presets"
        folder.mkdir(parents=True, exist_ok=True)
        for preset in sorted([*PRESETS.glob("*.json"), *PRESETS.glob("*.png")]):
            shutil.copyfile(preset, folder / preset.name)


class PackLibrary(sdist):
    """With the sources of the library, so that it builds wherever it is unpacked."""

    def make_release_tree(self, base_dir, files):
        super().make_release_tree(base_dir, files)
        for name in ("LICENSE", "NOTICE"):
            licence = Path(base_dir) / name
            licence.unlink()  # a link out of the distribution
            shutil.copyfile(ROOT / name, licence)
        for name in SOURCES:
            source, target = ROOT / name, Path(base_dir) / "library" / name
            if source.is_dir():
                shutil.copytree(source, target, ignore=shutil.ignore_patterns("__pycache__"))
            else:
                target.parent.mkdir(parents=True, exist_ok=True)
                shutil.copyfile(source, target)


setup(
    version=version(),
    packages=["voreleffect"],
    package_data={"voreleffect": ["py.typed", "*.pyi"]},
    ext_modules=[Extension("voreleffect._voreleffect", sources=[])],
    cmdclass={"build_ext": BuildWithCMake, "build_py": BuildWithPresets, "sdist": PackLibrary},
    zip_safe=False,
)
