"""Runs the Conan recipe with stand-ins for the parts of Conan that it calls, for machines without Conan:
the recipe's own steps are tried, Conan itself is not.

    conan_stand_in.py RECIPE_DIRECTORY OUT shared|static
"""

import importlib.util
import pathlib
import shutil
import subprocess
import sys
import types


def run(*command):
    subprocess.run([str(part) for part in command], check=True, stdout=subprocess.DEVNULL)


class CppInfo:
    def __init__(self):
        self.libs, self.defines, self.system_libs, self.properties = [], [], [], {}

    def set_property(self, name, value):
        self.properties[name] = value


class ConanFile:
    def __init__(self):
        self.cpp_info = CppInfo()


class CMake:
    def __init__(self, recipe):
        self.recipe = recipe

    def configure(self):
        shared = "ON" if self.recipe.options.shared else "OFF"
        run("cmake", "-S", self.recipe.source_folder, "-B", self.recipe.build_folder, "-G", "Ninja",
            "-DCMAKE_BUILD_TYPE=Release", f"-DBUILD_SHARED_LIBS={shared}",
            f"-DCMAKE_INSTALL_PREFIX={self.recipe.package_folder}")

    def build(self):
        run("cmake", "--build", self.recipe.build_folder)

    def install(self):
        run("cmake", "--install", self.recipe.build_folder)


class CMakeToolchain:
    def __init__(self, recipe):
        pass

    def generate(self):
        pass


def copy(_, pattern, src, dst):
    """Like Conan's: the files that match, folders below `src` kept; a star goes through folders."""
    for path in pathlib.Path(src).glob(pattern.replace("/*", "/**/*")):
        if path.is_file():
            target = pathlib.Path(dst) / path.relative_to(src)
            target.parent.mkdir(parents=True, exist_ok=True)
            shutil.copy(path, target)


def module(name, **contents):
    made = types.ModuleType(name)
    vars(made).update(contents)
    sys.modules[name] = made


def main():
    recipe_folder, out, kind = pathlib.Path(sys.argv[1]).resolve(), pathlib.Path(sys.argv[2]), sys.argv[3]
    module("conan", ConanFile=ConanFile)
    module("conan.errors", ConanInvalidConfiguration=type("ConanInvalidConfiguration", (Exception,), {}))
    module("conan.tools")
    module("conan.tools.build", check_min_cppstd=lambda recipe, standard: None)
    module("conan.tools.cmake", CMake=CMake, CMakeToolchain=CMakeToolchain, cmake_layout=lambda recipe: None)
    module("conan.tools.files", copy=copy, load=lambda recipe, path: pathlib.Path(path).read_text(),
           rmdir=lambda recipe, path: shutil.rmtree(path))

    sys.dont_write_bytecode = True
    spec = importlib.util.spec_from_file_location("conanfile", recipe_folder / "conanfile.py")
    conanfile = importlib.util.module_from_spec(spec)
    spec.loader.exec_module(conanfile)

    recipe = conanfile.VoreleffectConan()
    recipe.settings = types.SimpleNamespace(os="Linux")
    recipe.options = types.SimpleNamespace(shared=kind == "shared", fPIC=True)
    recipe.recipe_folder = str(recipe_folder)
    recipe.export_sources_folder = recipe.source_folder = str(out / "sources")
    recipe.build_folder, recipe.package_folder = str(out / "build"), str(out / "package")
    recipe.set_version()
    recipe.export_sources()
    for step in ("layout", "validate", "generate", "build", "package", "package_info"):
        getattr(recipe, step)()

    # What Conan's generators would tell a program of its users.
    info, package = recipe.cpp_info, pathlib.Path(recipe.package_folder)
    assert (package / "licenses" / "LICENSE").is_file()
    assert info.properties["cmake_target_name"] == "voreleffect::voreleffect"
    program = out / "paints"
    run("g++", recipe_folder / "test_package" / "paints.cpp", f"-I{package}/include", f"-L{package}/lib",
        f"-Wl,-rpath,{package}/lib", *(f"-D{name}" for name in info.defines),
        *(f"-l{name}" for name in [*info.libs, *info.system_libs]), "-o", program)
    said = subprocess.run([program], check=True, capture_output=True, text=True).stdout.strip()
    assert said == f"voreleffect {recipe.version} paints", said


main()
