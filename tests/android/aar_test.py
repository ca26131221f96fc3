#!/usr/bin/env python3
"""Tests scripts/android.sh and the archive that it packs, with a library for ARM Linux in place of
Android's.

VOREL_PAINTED, from the environment, is where paint_runs has painted on the build machine.
"""
import json
import os
import re
import shutil
import subprocess
import tempfile
import unittest
import xml.etree.ElementTree as xml
import zipfile
from pathlib import Path

ROOT = Path(__file__).resolve().parents[2]
TESTS = ROOT / "tests/android"
BUILD = ROOT / "build/android_standin"
PREFAB = "prefab/modules/voreleffect"
HEADERS = f"{PREFAB}/include/voreleffect"
LIBRARIES = f"{PREFAB}/libs/android.arm64-v8a"
JNI = "jni/arm64-v8a"


def run(*command, **options):
    """What a command prints; its failure is the test's."""
    return subprocess.run(command, check=True, capture_output=True, text=True, **options).stdout


def android_script(ndk, **environment):
    return subprocess.run(
        [ROOT / "scripts/android.sh", BUILD],
        env={**os.environ, "ANDROID_NDK_HOME": str(ndk), **environment},
        capture_output=True,
        text=True,
    )


def standin_ndk(directory):
    """What android.sh asks of an NDK: its toolchain file and its version."""
    (directory / "build/cmake").mkdir(parents=True)
    shutil.copy(TESTS / "standin_toolchain.cmake", directory / "build/cmake/android.toolchain.cmake")
    (directory / "source.properties").write_text("Pkg.Desc = Stand-in\nPkg.Revision = 27.0.12077973\n")
    return directory


def dynamic(library, entry):
    """The values of one kind of entry, such as NEEDED, in the dynamic section."""
    return re.findall(rf"\({entry}\).*\[(.*)\]", run("readelf", "--wide", "--dynamic", str(library)))


class Archive(unittest.TestCase):
    @classmethod
    def setUpClass(cls):
        cls.directory = Path(cls.enterClassContext(tempfile.TemporaryDirectory()))
        shutil.rmtree(BUILD, ignore_errors=True)
        stubs = cls.directory / "stubs"
        stubs.mkdir()
        log = TESTS / "shape/stubs/log.c"
        run("aarch64-linux-gnu-gcc", "-shared", "-fPIC", "-w", str(log), "-o", str(stubs / "liblog.so"))
        done = android_script(standin_ndk(cls.directory / "ndk"), VOREL_STUBS=str(stubs))
        assert done.returncode == 0, done.stdout + done.stderr
        cls.path = ROOT / done.stdout.splitlines()[-1]
        cls.content = cls.directory / "aar"
        with zipfile.ZipFile(cls.path) as archive:
            cls.names = archive.namelist()
            archive.extractall(cls.content)

    def pack(self, output, **replaced):
        """Packs what android.sh packed, but with the files named here."""
        given = {
            "version": "1.2.3",
            "ndk": "27",
            "include": BUILD / "stage/include",
            "classes": BUILD / "android/classes",
            "library": BUILD / "stage/lib/libvoreleffect.so",
            "jni-library": BUILD / "stage/lib/libvoreleffect_jni.so",
            **replaced,
        }
        options = [part for name, value in given.items() for part in (f"--{name}", str(value))]
        command = [ROOT / "scripts/pack_aar.py", *options, "--output", output]
        return subprocess.run(command, capture_output=True, text=True)

    def json(self, name):
        return json.loads((self.content / name).read_text())

    def test_holds_what_an_app_and_prefab_look_for_and_no_more(self):
        headers = [f"{HEADERS}/{header.name}" for header in (BUILD / "stage/include/voreleffect").iterdir()]
        self.assertGreaterEqual(len(headers), 8)
        expected = [
            "AndroidManifest.xml",
            "LICENSE",
            "R.txt",
            "classes.jar",
            "proguard.txt",
            f"{JNI}/libvoreleffect.so",
            f"{JNI}/libvoreleffect_jni.so",
            "prefab/prefab.json",
            f"{PREFAB}/module.json",
            f"{LIBRARIES}/abi.json",
            f"{LIBRARIES}/libvoreleffect.so",
            *headers,
        ]
        self.assertEqual(sorted(self.names), sorted(expected))

    def test_prefab_package_has_exactly_the_fields_of_schema_2(self):
        version = re.fullmatch(r"voreleffect-(\d+\.\d+\.\d+)\.aar", self.path.name)[1]
        self.assertIn(f":STATIC={version}\n", (BUILD / "CMakeCache.txt").read_text())
        self.assertEqual(
            self.json("prefab/prefab.json"),
            {"schema_version": 2, "name": "voreleffect", "version": version, "dependencies": []},
        )
        self.assertEqual(self.json(f"{PREFAB}/module.json"), {"export_libraries": [], "android": {}})
        self.assertEqual(
            self.json(f"{LIBRARIES}/abi.json"),
            {"abi": "arm64-v8a", "api": 21, "ndk": 27, "stl": "none", "static": False},
        )

    def test_manifest_names_the_package_and_the_oldest_api(self):
        manifest = xml.parse(self.content / "AndroidManifest.xml").getroot()
        self.assertEqual(manifest.tag, "manifest")
        self.assertEqual(manifest.get("package"), "org.voreleffect")
        android = "{http://schemas.android.com/apk/res/android}"
        self.assertEqual(manifest.find("uses-sdk").get(f"{android}minSdkVersion"), "21")

    def test_headers_are_those_of_the_project(self):
        for header in (ROOT / "include/voreleffect").glob("*.h"):
            self.assertEqual((self.content / HEADERS / header.name).read_bytes(), header.read_bytes())

    def test_libraries_are_named_as_they_are_loaded(self):
        for library in ("libvoreleffect.so", "libvoreleffect_jni.so"):
            self.assertEqual(dynamic(self.content / JNI / library, "SONAME"), [library])
        self.assertIn("libvoreleffect.so", dynamic(self.content / JNI / "libvoreleffect_jni.so", "NEEDED"))
        for_app = (self.content / JNI / "libvoreleffect.so").read_bytes()
        self.assertEqual((self.content / LIBRARIES / "libvoreleffect.so").read_bytes(), for_app)

    def test_classes_are_of_java_8(self):
        with zipfile.ZipFile(self.content / "classes.jar") as classes:
            self.assertEqual(
                classes.namelist(),
                ["org/voreleffect/VorelEffect$Painter.class", "org/voreleffect/VorelEffect.class"],
            )
            for name in classes.namelist():
                self.assertEqual(int.from_bytes(classes.read(name)[6:8], "big"), 52)

    def test_every_native_method_of_the_class_is_in_the_library_and_nothing_else(self):
        jar = str(self.content / "classes.jar")
        declared = re.findall(r" native .* (\w+)\(", run("javap", "-p", "-cp", jar, "org.voreleffect.VorelEffect"))
        self.assertGreaterEqual(len(declared), 25)
        symbols = run("nm", "-D", "--defined-only", str(self.content / JNI / "libvoreleffect_jni.so"))
        exported = [line.split()[2] for line in symbols.splitlines()]
        self.assertEqual(sorted(exported), sorted(f"Java_org_voreleffect_VorelEffect_{name}" for name in declared))

    def test_program_built_from_the_package_paints_the_bytes_of_the_build_machine(self):
        program = self.directory / "paint_runs"
        libraries = self.content / LIBRARIES
        include = ("-isystem", str(self.content / PREFAB / "include"))
        compiler = ("aarch64-linux-gnu-g++", "-std=c++17", "-O1", str(TESTS / "paint_runs.cpp"))
        run(*compiler, *include, f"-L{libraries}", "-lvoreleffect", "-o", str(program))
        painted = self.directory / "painted"
        painted.mkdir()
        emulator = ("qemu-aarch64-static", "-L", "/usr/aarch64-linux-gnu", "-E", f"LD_LIBRARY_PATH={libraries}")
        run(*emulator, str(program), str(painted))
        expected = sorted(Path(os.environ["VOREL_PAINTED"]).iterdir())
        self.assertGreaterEqual(len(expected), 15)
        for file in expected:
            self.assertEqual((painted / file.name).read_bytes(), file.read_bytes(), file.name)

    def test_packing_the_same_files_again_gives_the_same_bytes(self):
        copy = self.directory / "copy"
        shutil.copytree(BUILD / "stage/include", copy)  # with other times
        outputs = [self.directory / "first.aar", self.directory / "second.aar"]
        self.assertEqual(self.pack(outputs[0]).returncode, 0)
        self.assertEqual(self.pack(outputs[1], include=copy).returncode, 0)
        self.assertEqual(outputs[0].read_bytes(), outputs[1].read_bytes())

    def test_library_for_another_cpu_or_page_size_is_refused(self):
        small_pages = self.directory / "small_pages.so"
        link = ("aarch64-linux-gnu-gcc", "-shared", "-Wl,-z,max-page-size=4096", "-xc", "/dev/null")
        run(*link, "-o", str(small_pages))
        for library in (Path("/bin/true"), ROOT / "README.md", small_pages):
            output = self.directory / "refused.aar"
            done = self.pack(output, **{"jni-library": library})
            self.assertNotEqual(done.returncode, 0)
            self.assertIn(str(library), done.stderr)
            self.assertFalse(output.exists())

    def test_without_an_ndk_one_line_says_so(self):
        for ndk in ("", "/nowhere"):
            done = android_script(ndk)
            self.assertEqual(done.returncode, 2)
            self.assertEqual(len(done.stderr.splitlines()), 1)
            self.assertIn("ANDROID_NDK_HOME", done.stderr)
            self.assertEqual(done.stdout, "")


if __name__ == "__main__":
    unittest.main()
