#!/usr/bin/env python3
"""Tests scripts/android.sh, the archive that it packs and the Maven repository that it lays out, with
libraries for Linux in place of Android's.

VOREL_PAINTED, from the environment, is where paint_runs has painted on the build machine.
"""
import hashlib
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
# Of each ABI: the prefix of its tools, and what runs its programs here.
ABIS = {
    "arm64-v8a": ("aarch64-linux-gnu-", ("qemu-aarch64-static", "-L", "/usr/aarch64-linux-gnu", "-E")),
    "x86_64": ("", ("env",)),
}
NATIVE_CLASSES = ("VorelEffect", "Look", "Painter", "Picture", "VorelBitmaps")
POM = "{http://maven.apache.org/POM/4.0.0}"


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
        for abi, (tools, _) in ABIS.items():
            (stubs / abi).mkdir(parents=True)
            for name in ("log", "jnigraphics"):
                source, library = TESTS / f"shape/stubs/{name}.c", stubs / abi / f"lib{name}.so"
                run(f"{tools}gcc", "-shared", "-fPIC", "-w", str(source), "-o", str(library))
        done = android_script(standin_ndk(cls.directory / "ndk"), VOREL_STUBS=str(stubs))
        assert done.returncode == 0, done.stdout + done.stderr
        cls.path, cls.maven = (ROOT / line for line in done.stdout.splitlines()[-2:])
        cls.content = cls.directory / "aar"
        with zipfile.ZipFile(cls.path) as archive:
            cls.names = archive.namelist()
            archive.extractall(cls.content)

    def pack(self, output, **replaced):
        """Packs what android.sh packed, but with the files named here."""
        given = {
            "version": "1.2.3",
            "ndk": "27",
            "include": BUILD / "x86_64/stage/include",
            "classes": BUILD / "x86_64/android/classes",
            "libraries": f"x86_64={BUILD / 'x86_64/stage/lib'}",
            **replaced,
        }
        options = [part for name, value in given.items() for part in (f"--{name}", str(value))]
        command = [ROOT / "scripts/pack_aar.py", *options, "--output", output]
        return subprocess.run(command, capture_output=True, text=True)

    def json(self, name):
        return json.loads((self.content / name).read_text())

    def test_holds_what_an_app_and_prefab_look_for_and_no_more(self):
        headers = [f"{HEADERS}/{header.name}" for header in (BUILD / "x86_64/stage/include/voreleffect").iterdir()]
        self.assertGreaterEqual(len(headers), 8)
        expected = [
            "AndroidManifest.xml",
            "LICENSE",
            "R.txt",
            "classes.jar",
            "proguard.txt",
            *(f"jni/{abi}/{name}" for abi in ABIS for name in ("libvoreleffect.so", "libvoreleffect_jni.so")),
            "prefab/prefab.json",
            f"{PREFAB}/module.json",
            *(f"{PREFAB}/libs/android.{abi}/{name}" for abi in ABIS for name in ("abi.json", "libvoreleffect.so")),
            *headers,
        ]
        self.assertEqual(sorted(self.names), sorted(expected))

    def test_prefab_package_has_exactly_the_fields_of_schema_2(self):
        version = re.fullmatch(r"voreleffect-(\d+\.\d+\.\d+)\.aar", self.path.name)[1]
        self.assertIn(f":STATIC={version}\n", (BUILD / "x86_64/CMakeCache.txt").read_text())
        self.assertEqual(
            self.json("prefab/prefab.json"),
            {"schema_version": 2, "name": "voreleffect", "version": version, "dependencies": []},
        )
        self.assertEqual(self.json(f"{PREFAB}/module.json"), {"export_libraries": [], "android": {}})
        for abi in ABIS:
            self.assertEqual(
                self.json(f"{PREFAB}/libs/android.{abi}/abi.json"),
                {"abi": abi, "api": 21, "ndk": 27, "stl": "none", "static": False},
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
        for abi in ABIS:
            own = self.content / "jni" / abi
            for library in ("libvoreleffect.so", "libvoreleffect_jni.so"):
                self.assertEqual(dynamic(own / library, "SONAME"), [library])
            needed = dynamic(own / "libvoreleffect_jni.so", "NEEDED")
            self.assertIn("libvoreleffect.so", needed)
            self.assertIn("libjnigraphics.so", needed)
            for_app = (own / "libvoreleffect.so").read_bytes()
            self.assertEqual(
                (self.content / PREFAB / f"libs/android.{abi}/libvoreleffect.so").read_bytes(), for_app
            )

    def test_classes_are_of_java_8_and_none_of_them_is_somebody_elses(self):
        sources = {path.stem for path in (ROOT / "android/java/org/voreleffect").glob("[A-Z]*.java")}
        with zipfile.ZipFile(self.content / "classes.jar") as classes:
            names = classes.namelist()
            for name in names:
                self.assertEqual(int.from_bytes(classes.read(name)[6:8], "big"), 52)
        packed = {re.fullmatch(r"org/voreleffect/(\w+)(\$\w+)?\.class", name)[1] for name in names}
        self.assertEqual(packed, sources)

    def test_only_the_class_of_bitmaps_names_a_class_of_android(self):
        with zipfile.ZipFile(self.content / "classes.jar") as classes:
            naming = [name for name in classes.namelist() if b"android/graphics" in classes.read(name)]
        self.assertEqual(naming, ["org/voreleffect/VorelBitmaps.class"])

    def natives(self):
        """The functions that the native methods of the classes are."""
        names = []
        for path in (self.content / "classes.jar",):
            with zipfile.ZipFile(path) as classes:
                every = [name.removesuffix(".class").replace("/", ".") for name in classes.namelist()]
            listed = run("javap", "-p", "-cp", str(path), *every)
            for part in re.split(r"^Compiled from .*$", listed, flags=re.MULTILINE):
                owner = re.search(r"class org\.voreleffect\.([\w$]+)", part)
                names += [f"Java_org_voreleffect_{owner[1]}_{name}" for name in
                          re.findall(r" native .* (\w+)\(", part)]
        return sorted(names)

    def test_every_native_method_of_the_classes_is_in_the_libraries_and_nothing_else(self):
        natives = self.natives()
        self.assertEqual({name.split("_")[3] for name in natives}, set(NATIVE_CLASSES))
        self.assertGreaterEqual(len(natives), 35)
        for abi in ABIS:
            symbols = run("nm", "-D", "--defined-only", str(self.content / "jni" / abi / "libvoreleffect_jni.so"))
            self.assertEqual(sorted(line.split()[2] for line in symbols.splitlines()), natives)

    def test_program_built_from_the_package_paints_the_bytes_of_the_build_machine(self):
        expected = sorted(Path(os.environ["VOREL_PAINTED"]).iterdir())
        self.assertGreaterEqual(len(expected), 15)
        for abi, (tools, runner) in ABIS.items():
            painted = self.directory / f"painted_{abi}"
            program = self.directory / f"paint_runs_{abi}"
            libraries = self.content / PREFAB / f"libs/android.{abi}"
            include = ("-isystem", str(self.content / PREFAB / "include"))
            compiler = (f"{tools}g++", "-std=c++17", "-O1", str(TESTS / "paint_runs.cpp"))
            run(*compiler, *include, f"-L{libraries}", "-lvoreleffect", "-o", str(program))
            painted.mkdir()
            run(*runner, f"LD_LIBRARY_PATH={libraries}:{self.directory / 'stubs' / abi}", str(program), str(painted))
            for file in expected:
                self.assertEqual((painted / file.name).read_bytes(), file.read_bytes(), f"{abi}: {file.name}")

    def test_pom_has_what_a_public_repository_asks_for(self):
        version = re.fullmatch(r"voreleffect-(.*)\.aar", self.path.name)[1]
        place = self.maven / "org/voreleffect/voreleffect" / version
        pom = xml.parse(place / f"voreleffect-{version}.pom").getroot()
        self.assertEqual(pom.tag, f"{POM}project")
        text = {name: pom.findtext(name.replace("/", f"/{POM}").join((POM, ""))) for name in (
            "modelVersion", "groupId", "artifactId", "version", "packaging", "name", "description", "url",
            "licenses/license/name", "licenses/license/url", "developers/developer/name",
            "developers/developer/organization", "scm/connection", "scm/developerConnection", "scm/url")}
        self.assertEqual([name for name, value in text.items() if not (value or "").strip()], [])
        told = [text[name] for name in ("modelVersion", "groupId", "artifactId", "version", "packaging")]
        self.assertEqual(told, ["4.0.0", "org.voreleffect", "voreleffect", version, "aar"])
        self.assertTrue(text["licenses/license/name"].startswith("Apache-2.0"))
        self.assertTrue(text["scm/connection"].startswith("scm:git:"))
        self.assertEqual(pom.findall(f".//{POM}dependency"), [])
        self.assertNotIn("@", (place / f"voreleffect-{version}.pom").read_text().replace("maintainers@", ""))

    def test_repository_has_the_archive_its_sources_and_its_javadoc_with_check_sums(self):
        (place,) = (self.maven / "org/voreleffect/voreleffect").iterdir()
        kinds = (".aar", ".pom", "-sources.jar", "-javadoc.jar")
        files = [f"voreleffect-{place.name}{kind}" for kind in kinds]
        sums = ("md5", "sha1", "sha256", "sha512")
        expected = [*files, *(f"{file}.{digest}" for file in files for digest in sums)]
        self.assertEqual(sorted(path.name for path in place.iterdir()), sorted(expected))
        for file in files:
            data = (place / file).read_bytes()
            for digest in sums:
                self.assertEqual((place / f"{file}.{digest}").read_text(), hashlib.new(digest, data).hexdigest())
        self.assertEqual((place / files[0]).read_bytes(), self.path.read_bytes())
        for file, entry in ((files[2], "org/voreleffect/Look.java"), (files[3], "org/voreleffect/Look.html")):
            with zipfile.ZipFile(place / file) as archive:
                self.assertIn(entry, archive.namelist())
                self.assertEqual([n for n in archive.namelist() if "androidx" in n], [])

    def java_8_library(self):
        """The classes of Java 8, without their code, as the compiler has them; marked as Java 8, too."""
        home = Path(shutil.which("javac")).resolve().parents[1]
        with zipfile.ZipFile(home / "lib/ct.sym") as signatures:
            classes = {re.sub(r"^\w+/(java.base/)?(.*)[.]sig$", r"\2.class", name): signatures.read(name)
                       for name in signatures.namelist() if re.match(r"\w*8\w*/(java.base/)?java/.*\.sig$", name)}
        library = self.directory / "java8.jar"
        with zipfile.ZipFile(library, "w") as archive:
            for name, content in classes.items():
                archive.writestr(name, content[:6] + b"\x00\x34" + content[8:])
        return library

    def test_shrunk_classes_still_paint(self):
        program = self.directory / "program"
        shrunk = self.directory / "shrunk.jar"
        rules = self.directory / "rules.txt"
        classes = self.content / "classes.jar"
        run("javac", "--release", "8", "-nowarn", "-cp", str(classes), "-d", str(program),
            str(TESTS / "java/Shrunk.java"))
        rules.write_text(f"-injars {program}\n-injars {classes}\n-outjars {shrunk}\n"
                         f"-libraryjars {self.java_8_library()}\n"
                         f"-include {self.content / 'proguard.txt'}\n-dontnote\n"
                         "-keep public class Shrunk { public static void main(java.lang.String[]); }\n")
        done = subprocess.run(["proguard", f"@{rules}"], capture_output=True, text=True)
        self.assertEqual(done.returncode, 0, done.stdout + done.stderr)
        with zipfile.ZipFile(shrunk) as archive:
            names = archive.namelist()
        self.assertIn("org/voreleffect/Painter.class", names)
        self.assertNotIn("org/voreleffect/Stops.class", names)  # it was renamed, or the rules keep too much
        libraries = f"{self.content / 'jni/x86_64'}:{self.directory / 'stubs/x86_64'}"
        painted = [run("java", "-Xcheck:jni", f"-Djava.library.path={libraries}", "-cp", str(path), "Shrunk",
                       env={**os.environ, "LD_LIBRARY_PATH": libraries})
                   for path in (f"{program}:{classes}", shrunk)]
        self.assertRegex(painted[0], r"^painted [0-9a-f]{64}$")
        self.assertEqual(painted[0], painted[1])

    def test_packing_the_same_files_again_gives_the_same_bytes(self):
        copy = self.directory / "copy"
        shutil.copytree(BUILD / "x86_64/stage/include", copy)  # with other times
        outputs = [self.directory / "first.aar", self.directory / "second.aar"]
        self.assertEqual(self.pack(outputs[0]).returncode, 0)
        self.assertEqual(self.pack(outputs[1], include=copy).returncode, 0)
        self.assertEqual(outputs[0].read_bytes(), outputs[1].read_bytes())

    def test_library_for_another_cpu_or_page_size_is_refused(self):
        for name, source in (("text", ROOT / "README.md"), ("program", Path("/bin/true")), ("pages", None)):
            libraries = self.directory / name
            shutil.copytree(BUILD / "arm64-v8a/stage/lib", libraries)
            refused = libraries / "libvoreleffect_jni.so"
            if source:
                shutil.copyfile(source, refused)
            else:
                run("aarch64-linux-gnu-gcc", "-shared", "-Wl,-z,max-page-size=4096", "-xc", "/dev/null",
                    "-o", str(refused))
            output = self.directory / "refused.aar"
            done = self.pack(output, libraries=f"arm64-v8a={libraries}")
            self.assertNotEqual(done.returncode, 0)
            self.assertIn(str(refused), done.stderr)
            self.assertFalse(output.exists())
        for wrong in (f"x86_64={BUILD / 'arm64-v8a/stage/lib'}", "mips=/", "x86_64"):
            self.assertNotEqual(self.pack(self.directory / "refused.aar", libraries=wrong).returncode, 0)

    def test_without_an_ndk_one_line_says_so(self):
        for ndk in ("", "/nowhere"):
            done = android_script(ndk)
            self.assertEqual(done.returncode, 2)
            self.assertEqual(len(done.stderr.splitlines()), 1)
            self.assertIn("ANDROID_NDK_HOME", done.stderr)
            self.assertEqual(done.stdout, "")


if __name__ == "__main__":
    unittest.main()
