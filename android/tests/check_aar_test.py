#!/usr/bin/env python3
"""Breaks a sound archive in one way after another, and sees check_aar.py find each."""

import argparse
import copy
import io
import json
import pathlib
import subprocess
import sys
import tempfile
import unittest
import zipfile

sys.path.insert(0, str(pathlib.Path(__file__).resolve().parents[1]))
import assemble_aar  # noqa: E402
import check_aar  # noqa: E402
from check_aar import LIBRARY, METADATA, MODULE, UTIL, VERSION_FILE  # noqa: E402

sound = None  # the archive to break
expected = None  # what it is compared with
unstripped = None  # the library for x86-64 before it was stripped

UTIL_CLASS = "com.velt.android.orvane.lumetrix.jni.Util"
JNI_X86 = f"jni/x86_64/{LIBRARY}"
PREFAB_X86 = f"{MODULE}/libs/android.x86_64/{LIBRARY}"


def zipped(infos_and_data):
    result = io.BytesIO()
    with zipfile.ZipFile(result, "w") as archive:
        for info, data in infos_and_data:
            archive.writestr(info, data)
    return result.getvalue()


class ABrokenArchive(unittest.TestCase):
    def setUp(self):
        temporary = tempfile.TemporaryDirectory()
        self.addCleanup(temporary.cleanup)
        self.folder = pathlib.Path(temporary.name)
        with zipfile.ZipFile(sound) as archive:
            self.entries = {name: archive.read(name) for name in archive.namelist()}

    def expect_fault(self, check, fault, data=None, name=None):
        """Writes the entries, or data, and expects the fault from the check, and from it alone."""
        path = self.folder / (name or sound.name)
        path.write_bytes(data or assemble_aar.zipped(self.entries))
        results = check_aar.faults_of(path, expected)
        found = {what: faults for what, faults in results.items() if faults}
        self.assertEqual(list(found), [check], found)
        self.assertIn(fault, "\n".join(found[check]))

    def replace(self, name, old, new):
        self.assertIn(old, self.entries[name])
        self.entries[name] = self.entries[name].replace(old, new)

    def set_json(self, name, key, value):
        content = json.loads(self.entries[name])
        self.assertNotEqual(content[key], value)
        content[key] = value
        self.entries[name] = assemble_aar.as_json(content)

    def set_library(self, data):
        """In both places, so that only the library itself is wrong."""
        self.entries[JNI_X86] = self.entries[PREFAB_X86] = data

    def set_classes(self, classes):
        self.entries["classes.jar"] = assemble_aar.zipped(classes)

    def util(self):
        with zipfile.ZipFile(io.BytesIO(self.entries["classes.jar"])) as jar:
            return jar.read(UTIL)

    def test_is_the_only_one_with_faults(self):
        found = check_aar.faults_of(sound, expected)
        self.assertEqual(list(found), list(check_aar.CHECKS))
        self.assertFalse(any(found.values()), found)

    # Layout

    def test_lacks_an_entry(self):
        entries = dict(self.entries)
        for name in entries:
            with self.subTest(name):
                self.entries = {other: data for other, data in entries.items() if other != name}
                self.expect_fault("entries", f"{name} is missing")

    def test_has_an_entry_too_many(self):
        for name in (f"jni/x86/{LIBRARY}", "assets/notes.txt", f"{MODULE}/include/queue.h"):
            with self.subTest(name):
                self.entries[name] = b"x"
                self.expect_fault("entries", f"{name} does not belong in it")
                del self.entries[name]

    def test_has_an_entry_twice(self):
        with zipfile.ZipFile(sound) as archive:
            content = [(info, archive.read(info)) for info in archive.infolist()]
        info, data = content[-1]
        with self.assertWarns(UserWarning):
            data = zipped([*content, (copy.copy(info), data)])
        self.expect_fault("entries", "proguard.txt is there twice", data)

    def rezipped(self, change):
        with zipfile.ZipFile(sound) as archive:
            content = [(info, archive.read(info)) for info in archive.infolist()]
        return zipped(change(content))

    def test_has_entries_out_of_order(self):
        self.expect_fault("repeatable", "not sorted", self.rezipped(lambda c: c[::-1]))

    def test_tells_when_it_was_built(self):
        def later(content):
            content[3][0].date_time = (2020, 1, 1, 0, 0, 0)
            return content
        self.expect_fault("repeatable", "different times", self.rezipped(later))

    def test_tells_the_umask(self):
        def private(content):
            content[3][0].external_attr = 0o100600 << 16
            return content
        self.expect_fault("repeatable", "permissions", self.rezipped(private))

    def test_has_a_jar_that_tells_the_umask(self):
        self.entries["classes.jar"] = zipped([(UTIL, self.util())])
        self.expect_fault("repeatable", "classes.jar: permissions")

    def test_differs_from_its_twin(self):
        expected.twin = self.folder / "twin.aar"
        self.addCleanup(setattr, expected, "twin", None)
        expected.twin.write_bytes(sound.read_bytes() + b"\0")
        self.expect_fault("repeatable", "was made of the same and differs", sound.read_bytes())

    # Libraries

    def test_has_a_library_for_another_processor(self):
        self.set_library(self.entries[f"jni/arm64-v8a/{LIBRARY}"])
        self.expect_fault("libraries", f"{JNI_X86}: is for AArch64")

    def test_has_no_library_under_its_name(self):
        self.set_library(b"not a library")
        self.expect_fault("libraries", f"{PREFAB_X86}: no ELF file")

    def test_has_a_library_with_symbols(self):
        self.set_library(unstripped.read_bytes())
        self.expect_fault("libraries", f"{JNI_X86}: is not stripped")

    def test_has_a_library_that_does_not_name_its_symbols(self):
        self.set_library(self.changed_library("--remove-section=.gnu_debuglink"))
        self.expect_fault("libraries", f"{JNI_X86}: does not name its symbols")

    def test_has_a_library_without_build_id(self):
        self.set_library(self.changed_library("--remove-section=.note.gnu.build-id"))
        self.expect_fault("libraries", f"{JNI_X86}: has no build-id")

    def test_has_a_library_of_another_name(self):
        self.set_library(self.entries[JNI_X86].replace(b"libdraventaUtil.so\0",
                                                       b"libdraventaUtim.so\0"))
        self.expect_fault("libraries", f"{JNI_X86}: SONAME")

    def test_has_a_library_that_lacks_a_native_method(self):
        self.set_library(self.entries[JNI_X86].replace(b"nativeIntAlloc\0", b"nativeIntAllok\0"))
        self.expect_fault("libraries", "nativeIntAllok")

    def test_has_a_library_that_tells_the_loader_where_to_look(self):
        library = self.folder / "searching.so"
        subprocess.run(["gcc", "-shared", "-Wl,-rpath,/opt", "-x", "c", "/dev/null", "-o", library],
                       check=True)
        self.assertTrue(check_aar.searched(library))
        subprocess.run(["gcc", "-shared", "-x", "c", "/dev/null", "-o", library], check=True)
        self.assertFalse(check_aar.searched(library))

    def test_has_two_libraries_for_one_abi(self):
        self.entries[PREFAB_X86] += b"\0"
        self.expect_fault("libraries", "different libraries for x86_64")

    def changed_library(self, option):
        path = self.folder / "changed.so"
        path.write_bytes(self.entries[JNI_X86])
        subprocess.run(["objcopy", option, path], check=True)
        return path.read_bytes()

    # Java

    def test_brings_a_class_of_android(self):
        self.set_classes({UTIL: self.util(), "android/graphics/Rect.class": self.util()})
        self.expect_fault("classes", "android/graphics/Rect.class does not belong in it")

    def test_has_classes_for_a_later_java(self):
        self.set_classes({UTIL: self.util()[:6] + (61).to_bytes(2, "big") + self.util()[8:]})
        self.expect_fault("classes", "for a Java later than 11")

    def test_does_not_keep_the_native_methods(self):
        self.replace("proguard.txt", b"native <methods>;", b"")
        self.expect_fault("keep rules", f"the native methods of {UTIL_CLASS} are not kept")

    def test_keeps_another_class(self):
        self.replace("proguard.txt", b"jni.Util {", b"jni.Utils {")
        self.expect_fault("keep rules", f"the native methods of {UTIL_CLASS} are not kept")

    def test_does_not_keep_a_field(self):
        for field in ("left", "right", "top", "bottom", "x", "y"):
            with self.subTest(field):
                rules = self.entries["proguard.txt"]
                self.replace("proguard.txt", f"int {field};".encode(), b"")
                self.expect_fault("keep rules", f"field {field} is not kept")
                self.entries["proguard.txt"] = rules

    def test_keeps_a_field_in_a_comment(self):
        self.replace("proguard.txt", b"int top;", b"# int top;")
        self.expect_fault("keep rules", "field top is not kept")

    # What it says of itself

    def test_has_a_manifest_that_is_no_xml(self):
        self.replace("AndroidManifest.xml", b"</manifest>", b"")
        self.expect_fault("manifest", "no element found")

    def test_runs_from_another_android_on(self):
        self.replace("AndroidManifest.xml", b'"21"', b'"16"')
        self.expect_fault("manifest", "['16'], not 21")

    def test_has_no_package(self):
        self.replace("AndroidManifest.xml", b"package=", b"name=")
        self.expect_fault("manifest", "no manifest with a package")

    def test_is_called_by_another_version(self):
        self.expect_fault("version", "the file is called", name=sound.name.replace("-", "-9.", 1))

    def test_says_another_version(self):
        self.entries[VERSION_FILE] = b"9.9.9\n"
        self.expect_fault("version", f"{VERSION_FILE} has '9.9.9\\n'")

    def test_says_another_version_to_native_code(self):
        self.set_json("prefab/prefab.json", "version", "9.9.9")
        self.expect_fault("version", "prefab.json has version '9.9.9'")

    def test_does_not_say_what_to_compile_against(self):
        self.replace(METADATA, b"minCompileSdk=", b"compileSdk=")
        self.expect_fault("metadata", "minCompileSdk is None")

    def test_has_a_prefab_package_of_another_schema(self):
        self.set_json("prefab/prefab.json", "schema_version", 1)
        self.expect_fault("prefab", "prefab.json")

    def test_promises_a_library_that_is_not_there(self):
        self.set_json(f"{MODULE}/module.json", "library_name", "libother")
        self.expect_fault("prefab", "libother.so is not there")

    def test_is_wrong_about_a_library(self):
        for key, value in (("abi", "x86"), ("api", 16), ("ndk", 99), ("stl", "c++_shared"),
                           ("static", True)):
            with self.subTest(key):
                name = f"{MODULE}/libs/android.x86_64/abi.json"
                content = self.entries[name]
                self.set_json(name, key, value)
                self.expect_fault("prefab", f"{key} is {value!r}")
                self.entries[name] = content

    def test_has_another_header_than_is_installed(self):
        self.entries[f"{MODULE}/include/selection/ze_rect.h"] += b"\n"
        self.expect_fault("headers", "selection/ze_rect.h is not as installed")

    def test_has_a_header_that_is_no_c(self):
        self.entries[f"{MODULE}/include/selection/ze_rect.h"] += b"class more;\n"
        self.expect_fault("headers", "is no c99")


def main():
    global sound, expected, unstripped
    parser = argparse.ArgumentParser(description=__doc__)
    parser.add_argument("archive", type=pathlib.Path)
    parser.add_argument("--version-of", required=True, metavar="BUILD")
    parser.add_argument("--headers", required=True, metavar="DIR")
    parser.add_argument("--ndk", default="", metavar="DIR")
    parser.add_argument("--unstripped", required=True, type=pathlib.Path, metavar="FILE",
                        help="the library for x86-64 before it was stripped")
    arguments = parser.parse_args()
    sound = arguments.archive
    expected = check_aar.Expected(assemble_aar.project_version(arguments.version_of),
                                  arguments.headers, assemble_aar.ndk_release(arguments.ndk))
    unstripped = arguments.unstripped
    unittest.main(argv=sys.argv[:1])


if __name__ == "__main__":
    main()
