"""Conan 2 recipe of the library: conan create packaging/conan [-o shared=False]"""

import os
import re

from conan import ConanFile
from conan.errors import ConanInvalidConfiguration
from conan.tools.build import check_min_cppstd
from conan.tools.cmake import CMake, CMakeToolchain, cmake_layout
from conan.tools.files import copy, load, rmdir

required_conan_version = ">=2.0"


# What the library is made of.
ROOMS = ("blend", "capi", "cmake", "core", "cores", "effect", "include", "ops", "property", "simd")


class VoreleffectConan(ConanFile):
    name = "voreleffect"
    description = "Text effects painted from glyph coverage masks, the same bytes on every CPU"
    license = "Apache-2.0"
    topics = ("text", "graphics", "effects", "font")
    package_type = "library"
    settings = "os", "arch", "compiler", "build_type"
    options = {"shared": [True, False], "fPIC": [True, False]}
    default_options = {"shared": True, "fPIC": True}
    implements = ["auto_shared_fpic"]

    @property
    def _tree(self):
        return os.path.normpath(os.path.join(self.recipe_folder, "..", ".."))

    def set_version(self):
        header = load(self, os.path.join(self._tree, "include", "voreleffect", "VFVersion.h"))
        numbers = re.findall(r"^#define VOREL_VERSION_(?:MAJOR|MINOR|PATCH) (\d+)$", header, re.MULTILINE)
        self.version = ".".join(numbers)

    def export_sources(self):
        for pattern in (
            "CMakeLists.txt",
            "LICENSE",
            "README.md",
            *(f"{folder}/*" for folder in ROOMS),
        ):
            copy(self, pattern, src=self._tree, dst=self.export_sources_folder)

    def layout(self):
        cmake_layout(self)

    def validate(self):
        check_min_cppstd(self, 17)
        if self.settings.os not in ("Linux", "Android"):
            raise ConanInvalidConfiguration(f"{self.name} is for Linux and Android")

    def generate(self):
        CMakeToolchain(self).generate()

    def build(self):
        cmake = CMake(self)
        cmake.configure()
        cmake.build()

    def package(self):
        copy(self, "LICENSE", src=self.source_folder, dst=os.path.join(self.package_folder, "licenses"))
        CMake(self).install()
        # Conan writes these for its users from package_info.
        rmdir(self, os.path.join(self.package_folder, "lib", "cmake"))
        rmdir(self, os.path.join(self.package_folder, "lib", "pkgconfig"))

    def package_info(self):
        self.cpp_info.libs = ["voreleffect"]
        self.cpp_info.set_property("cmake_file_name", "voreleffect")
        self.cpp_info.set_property("cmake_target_name", "voreleffect::voreleffect")
        self.cpp_info.set_property("pkg_config_name", "voreleffect")
        if not self.options.shared:
            self.cpp_info.defines = ["VOREL_STATIC"]
            self.cpp_info.system_libs = ["m", "log"] if self.settings.os == "Android" else ["m"]
