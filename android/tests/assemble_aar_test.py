#!/usr/bin/env python3
"""Tests of assemble_aar.py on made-up inputs."""

import os
import pathlib
import subprocess
import sys
import tempfile
import unittest
import zipfile

SCRIPT = pathlib.Path(__file__).resolve().parents[1] / "assemble_aar.py"


class Assembling(unittest.TestCase):
    def setUp(self):
        temporary = tempfile.TemporaryDirectory()
        self.addCleanup(temporary.cleanup)
        self.folder = pathlib.Path(temporary.name)
        self.write("build/CMakeCache.txt", b"CMAKE_PROJECT_VERSION:STATIC=3.2.1\n")
        self.write("arm64/libdraventaUtil.so", b"library")
        self.write("include/draventaUtil.h", b"// header\n")
        self.write("ndk/source.properties", b"Pkg.Desc = NDK\nPkg.Revision = 26.3.11579264\n")
        self.write_jar((2024, 5, 6, 7, 8, 10))

    def write(self, name, data):
        path = self.folder / name
        path.parent.mkdir(parents=True, exist_ok=True)
        path.write_bytes(data)

    def write_jar(self, date_time):
        with zipfile.ZipFile(self.folder / "face.jar", "w") as jar:
            jar.writestr(zipfile.ZipInfo("META-INF/MANIFEST.MF", date_time), "Created-By: a JDK\n")
            jar.writestr(zipfile.ZipInfo("p/Util.class", date_time), "class")

    def assemble(self, *options, epoch=None):
        environment = dict(os.environ)
        environment.pop("SOURCE_DATE_EPOCH", None)
        if epoch is not None:
            environment["SOURCE_DATE_EPOCH"] = epoch
        return subprocess.run(
            [sys.executable, SCRIPT, "--version-of", "build", "--library",
             "arm64-v8a=arm64/libdraventaUtil.so", "--jar", "face.jar", "--headers", "include",
             "--out", "out", *options], cwd=self.folder, env=environment, text=True,
            capture_output=True)

    def assembled(self, *options, epoch=None):
        result = self.assemble(*options, epoch=epoch)
        self.assertEqual(result.returncode, 0, result.stderr)
        return self.folder / result.stdout.split(":")[0]

    def expect_failure(self, line, *options, epoch=None):
        result = self.assemble(*options, epoch=epoch)
        self.assertNotEqual(result.returncode, 0)
        self.assertEqual(result.stderr.splitlines(), [f"assemble_aar: {line}"])

    def test_names_the_file_by_the_version_and_says_that_libraries_stand_in(self):
        self.assertEqual(self.assembled().name, "draventaUtil-3.2.1-standin.aar")

    def test_with_an_ndk_the_libraries_are_the_real_ones(self):
        archive = self.assembled("--ndk", "ndk")
        self.assertEqual(archive.name, "draventaUtil-3.2.1.aar")
        with zipfile.ZipFile(archive) as content:
            abi = content.read("prefab/modules/draventaUtil/libs/android.arm64-v8a/abi.json")
        self.assertIn(b'"ndk": 26', abi)

    def test_does_not_depend_on_when_the_jar_was_made(self):
        first = self.assembled().read_bytes()
        self.write_jar((2025, 1, 1, 0, 0, 0))
        self.assertEqual(self.assembled().read_bytes(), first)

    def test_takes_only_the_classes_of_the_jar(self):
        with zipfile.ZipFile(self.assembled()) as content:
            self.write("classes.jar", content.read("classes.jar"))
        with zipfile.ZipFile(self.folder / "classes.jar") as jar:
            self.assertEqual(jar.namelist(), ["p/Util.class"])

    def times(self, epoch):
        with zipfile.ZipFile(self.assembled(epoch=epoch)) as content:
            return {info.date_time for info in content.infolist()}

    def test_entries_have_the_time_of_source_date_epoch(self):
        self.assertEqual(self.times("1700000000"), {(2023, 11, 14, 22, 13, 20)})

    def test_entries_are_from_1980_at_the_earliest(self):
        self.assertEqual(self.times(None), {(1980, 1, 1, 0, 0, 0)})
        self.assertEqual(self.times("5"), {(1980, 1, 1, 0, 0, 0)})

    def test_a_time_that_is_no_number_is_refused(self):
        self.expect_failure("SOURCE_DATE_EPOCH is 'today': set it to whole seconds since 1970, or "
                            "unset it", epoch="today")

    def test_a_library_that_is_not_there_is_named(self):
        self.expect_failure("cannot read gone.so (No such file or directory): build the target "
                            "'stripped'", "--library", "x86_64=gone.so")

    def test_headers_that_are_not_there_are_named(self):
        self.expect_failure("no draventaUtil.h in build: install the component 'headers' there",
                            "--headers", "build")

    def test_a_build_without_version_is_named(self):
        self.write("build/CMakeCache.txt", b"")
        self.expect_failure("build/CMakeCache.txt names no version: remove the folder and call "
                            "./dev aar")


if __name__ == "__main__":
    unittest.main()
