#!/usr/bin/env python3
"""Checks an Android archive of the library: that everything an app needs is in it and nothing else,
and that what it says of itself is true.
"""

import argparse
import functools
import io
import json
import pathlib
import re
import subprocess
import sys
import tempfile
import xml.etree.ElementTree
import zipfile

from assemble_aar import LIBRARY, NAME, ndk_release, project_version

ROOT = pathlib.Path(__file__).resolve().parent.parent
sys.path.insert(0, str(ROOT / "tests" / "binary"))
import binary  # noqa: E402  what holds of any build of the library

PACKAGE = "com/velt/android/orvane/lumetrix/"
UTIL = f"{PACKAGE}jni/Util.class"
MIN_SDK = 21
NEWEST_CLASS_FILE = 55  # Java 11
MODULE = f"prefab/modules/{NAME}"
METADATA = "META-INF/com/android/build/gradle/aar-metadata.properties"
VERSION_FILE = f"META-INF/com.velt.android.orvane.lumetrix_{NAME}.version"
ANDROID = "{http://schemas.android.com/apk/res/android}"

# ABI to what readelf calls its machine.
MACHINES = {
    "arm64-v8a": "AArch64",
    "armeabi-v7a": "ARM",
    "x86_64": "Advanced Micro Devices X86-64",
}


class Archive:
    """An unpacked archive: its entries, and a folder that holds them."""

    def __init__(self, path, folder):
        self.path = pathlib.Path(path)
        self.folder = pathlib.Path(folder)
        with zipfile.ZipFile(path) as archive:
            self.infos = archive.infolist()
            self.entries = {info.filename: archive.read(info) for info in self.infos}
            archive.extractall(folder)

    def text(self, name):
        return self.entries[name].decode()

    def json(self, name):
        return json.loads(self.entries[name])

    def libraries(self):
        """Each library: its ABI and its path."""
        return [(abi, path) for abi in MACHINES
                for path in (f"jni/{abi}/{LIBRARY}", f"{MODULE}/libs/android.{abi}/{LIBRARY}")]


# Each check takes the archive and what it is compared with, and returns the faults that it finds.

# --- layout --------------------------------------------------------------------------------------

def check_entries(archive, expected):
    wanted = {"AndroidManifest.xml", "R.txt", "classes.jar", "proguard.txt", METADATA, VERSION_FILE,
              "prefab/prefab.json", f"{MODULE}/module.json"}
    wanted.update(path for _, path in archive.libraries())
    wanted.update(f"{MODULE}/libs/android.{abi}/abi.json" for abi in MACHINES)
    wanted.update(f"{MODULE}/include/{header}" for header in expected.headers)
    names = [info.filename for info in archive.infos]
    faults = [f"{name} is missing" for name in sorted(wanted - set(names))]
    faults += [f"{name} does not belong in it" for name in sorted(set(names) - wanted)]
    faults += [f"{name} is there twice" for name in sorted(set(names)) if names.count(name) > 1]
    return faults


def check_repeatable(archive, expected):
    """What would tell one assembly from another, in the archive and in its classes.jar."""
    with zipfile.ZipFile(io.BytesIO(archive.entries["classes.jar"])) as jar:
        parts = [("", archive.infos), ("classes.jar: ", jar.infolist())]
    faults = []
    for where, infos in parts:
        names = [info.filename for info in infos]
        if names != sorted(names):
            faults.append(f"{where}entries are not sorted")
        if len({info.date_time for info in infos}) > 1:
            faults.append(f"{where}entries have different times")
        if {info.external_attr >> 16 for info in infos} != {0o100644}:
            faults.append(f"{where}permissions other than rw-r--r--")
    if expected.twin and expected.twin.samefile(archive.path):
        faults.append(f"{expected.twin} is the same file, not another assembly")
    elif expected.twin and expected.twin.read_bytes() != archive.path.read_bytes():
        faults.append(f"{expected.twin} was made of the same and differs")
    return faults


# --- libraries -----------------------------------------------------------------------------------

@functools.cache  # an archive has each library twice, and those that break one break few
def library_faults(abi, data):
    """The faults of one library, given its bytes."""
    if data[:4] != b"\x7fELF":
        return ["no ELF file"]
    with tempfile.TemporaryDirectory() as folder:
        library = pathlib.Path(folder) / LIBRARY
        library.write_bytes(data)
        return elf_faults(abi, library)


def elf_faults(abi, library):
    header = binary.output_of("readelf", "-hW", library)
    machine = re.search(r"Machine: *(.*)", header)[1]
    faults = []
    if machine != MACHINES[abi]:
        faults.append(f"is for {machine}")
    if abi == "armeabi-v7a" and "hard-float" in header:
        faults.append("passes floats in registers, which Android's ARM does not")
    sections = binary.output_of("readelf", "-SW", library)
    if re.search(r"\.symtab|\.debug_", sections):
        faults.append("is not stripped")
    if ".gnu_debuglink" not in sections:
        faults.append("does not name its symbols")
    if ".note.gnu.build-id" not in sections or not re.search(
            r"Build ID: [0-9a-f]{40}\b", binary.output_of("readelf", "-nW", library)):
        faults.append("has no build-id")
    for what, check in binary.LIBRARY_CHECKS.items():
        wrong = check(library)
        if wrong:
            faults.append(f"{what}: {wrong}")
    return faults


def searched(library):
    """The folders that the loader is told to search, of which a phone has none."""
    return binary.dynamic_entries(library, "RUNPATH") + binary.dynamic_entries(library, "RPATH")


def check_libraries(archive, expected):
    faults = []
    for abi, path in archive.libraries():
        found = library_faults(abi, archive.entries[path])
        if expected.ndk and not found and searched(archive.folder / path):
            found = ["tells the loader where to look"]
        faults += [f"{path}: {fault}" for fault in found]
    for abi in MACHINES:
        copies = {archive.entries[path] for of, path in archive.libraries() if of == abi}
        if len(copies) > 1:
            faults.append(f"jni and prefab have different libraries for {abi}")
    return faults


# --- Java ----------------------------------------------------------------------------------------

def check_classes(archive, expected):
    with zipfile.ZipFile(io.BytesIO(archive.entries["classes.jar"])) as jar:
        entries = {name: jar.read(name) for name in jar.namelist()}
    faults = [] if UTIL in entries else [f"classes.jar: {UTIL} is missing"]
    for name, data in entries.items():
        if not name.startswith(PACKAGE) or not name.endswith(".class"):
            faults.append(f"classes.jar: {name} does not belong in it")
        elif int.from_bytes(data[6:8], "big") > NEWEST_CLASS_FILE:
            faults.append(f"classes.jar: {name} is for a Java later than 11")
    return faults


@functools.cache
def native_classes(data):
    """The names of the project's classes in a jar, given its bytes, that have native methods."""
    with tempfile.TemporaryDirectory() as folder:
        jar = pathlib.Path(folder) / "classes.jar"
        jar.write_bytes(data)
        with zipfile.ZipFile(jar) as archive:
            names = [name[:-len(".class")].replace("/", ".") for name in archive.namelist()
                     if name.startswith(PACKAGE) and name.endswith(".class")]
        return [name for name in names
                if re.search(r"\bnative\b.*;$",
                             binary.output_of("javap", "-p", "-cp", jar, name), re.M)]


def fields_by_name():
    """The names of the Java fields that the native methods look up."""
    sources = "".join(path.read_text() for path in sorted((ROOT / "jni").iterdir()))
    return set(re.findall(r'int_field\(\w+, \w+, "(\w+)"\)', sources))


def kept(rules):
    """What the keep rules name: {class: its members}."""
    without_comments = re.sub(r"#.*", "", rules)
    return {name: {member.strip() for member in members.split(";") if member.strip()}
            for name, members in
            re.findall(r"-keep[\w,]*\s+class\s+([\w.]+)\s*\{([^}]*)\}", without_comments)}


def check_keep_rules(archive, expected):
    rules = kept(archive.text("proguard.txt"))
    native = native_classes(archive.entries["classes.jar"])
    faults = [] if native else ["classes.jar: no class has a native method"]
    faults += [f"proguard.txt: the native methods of {name} are not kept"
               for name in native if "native <methods>" not in rules.get(name, ())]
    fields = fields_by_name()
    held = set().union(*rules.values()) if rules else set()
    if len(fields) < 6:  # of a rectangle and a point
        faults.append(f"jni/: only the fields {sorted(fields)} are looked up")
    faults += [f"proguard.txt: field {field} is not kept"
               for field in sorted(fields) if f"int {field}" not in held]
    return faults


# --- what it says of itself ----------------------------------------------------------------------

def check_manifest(archive, expected):
    try:
        manifest = xml.etree.ElementTree.fromstring(archive.entries["AndroidManifest.xml"])
    except xml.etree.ElementTree.ParseError as error:
        return [f"AndroidManifest.xml: {error}"]
    faults = []
    if manifest.tag != "manifest" or not re.fullmatch(r"[a-z]\w*(\.[a-z]\w*)+",
                                                      manifest.get("package", "")):
        faults.append("AndroidManifest.xml: no manifest with a package")
    found = [sdk.get(f"{ANDROID}minSdkVersion") for sdk in manifest.iter("uses-sdk")]
    if found != [str(MIN_SDK)]:
        faults.append(f"AndroidManifest.xml: minSdkVersion is {found}, not {MIN_SDK}")
    return faults


def check_versions(archive, expected):
    standin = "" if expected.ndk else "-standin"
    faults = []
    for what, found, wanted in (
            ("the file is called", archive.path.name, f"{NAME}-{expected.version}{standin}.aar"),
            ("prefab.json has version", archive.json("prefab/prefab.json")["version"],
             expected.version),
            (f"{VERSION_FILE} has", archive.text(VERSION_FILE), f"{expected.version}\n")):
        if found != wanted:
            faults.append(f"{what} {found!r}, not {wanted!r}")
    return faults


def check_metadata(archive, expected):
    found = dict(line.split("=", 1) for line in archive.text(METADATA).splitlines())
    wanted = {"aarFormatVersion": "1.0", "aarMetadataVersion": "1.0", "minCompileSdk": str(MIN_SDK)}
    return [f"{METADATA}: {key} is {found.get(key)}, not {value}"
            for key, value in wanted.items() if found.get(key) != value]


def check_prefab(archive, expected):
    faults = []
    package = archive.json("prefab/prefab.json")
    if (package["schema_version"], package["name"], package["dependencies"]) != (2, NAME, []):
        faults.append(f"prefab.json: {package}")
    module = archive.json(f"{MODULE}/module.json")
    for abi in MACHINES:
        folder = f"{MODULE}/libs/android.{abi}"
        if f"{folder}/{module['library_name']}.so" not in archive.entries:
            faults.append(f"{folder}: module.json's {module['library_name']}.so is not there")
        found = archive.json(f"{folder}/abi.json")
        wanted = {"abi": abi, "api": MIN_SDK, "ndk": expected.ndk, "stl": "none", "static": False}
        faults += [f"{folder}/abi.json: {key} is {found.get(key)!r}, not {value!r}"
                   for key, value in wanted.items() if found.get(key) != value]
    return faults


def check_headers(archive, expected):
    """That the headers are the installed ones, and compile where nothing else is to be found."""
    include = archive.folder / MODULE / "include"
    faults = [f"{header} is not as installed" for header, data in expected.headers.items()
              if archive.entries.get(f"{MODULE}/include/{header}") != data]
    for compiler, standard in (("gcc", "c99"), ("g++", "c++17")):
        result = subprocess.run(
            [compiler, f"-std={standard}", "-pedantic", "-Wall", "-Wextra", "-Werror",
             "-fsyntax-only", "-x", "c" if compiler == "gcc" else "c++", "-I", include, "-"],
            input=f"#include <{NAME}.h>\nextern int not_empty;\n", text=True, capture_output=True)
        if result.returncode != 0:
            faults.append(f"{NAME}.h is no {standard}: {result.stderr.splitlines()[0]}")
    return faults


# What the others read has to be there first.
CHECKS = {
    "entries": check_entries,
    "libraries": check_libraries,
    "classes": check_classes,
    "keep rules": check_keep_rules,
    "manifest": check_manifest,
    "version": check_versions,
    "metadata": check_metadata,
    "prefab": check_prefab,
    "headers": check_headers,
    "repeatable": check_repeatable,
}


class Expected:
    """What an archive is compared with."""

    def __init__(self, version, headers, ndk=0, twin=None):
        """headers: the folder of the installed ones; ndk: its release, 0 for stand-ins."""
        self.version = version
        self.headers = {path.relative_to(headers).as_posix(): path.read_bytes()
                        for path in pathlib.Path(headers).rglob("*.h")}
        self.ndk = ndk
        self.twin = twin


def faults_of(path, expected):
    """All that is wrong with an archive: {check: faults}; with entries missing, that alone."""
    with tempfile.TemporaryDirectory() as folder:
        archive = Archive(path, folder)
        result = {}
        for what, check in CHECKS.items():
            result[what] = check(archive, expected)
            if what == "entries" and result[what]:
                break
    return result


def main():
    parser = argparse.ArgumentParser(description=__doc__)
    parser.add_argument("archive", type=pathlib.Path)
    parser.add_argument("--version-of", required=True, metavar="BUILD",
                        help="a build folder of this project, for the version")
    parser.add_argument("--headers", required=True, metavar="DIR",
                        help="the folder of the installed headers")
    parser.add_argument("--ndk", default="", metavar="DIR",
                        help="the NDK that built the libraries; without it they are stand-ins")
    parser.add_argument("--twin", type=pathlib.Path,
                        help="an archive that must have the same bytes")
    arguments = parser.parse_args()

    expected = Expected(project_version(arguments.version_of), arguments.headers,
                        ndk_release(arguments.ndk), arguments.twin)
    try:
        results = faults_of(arguments.archive, expected)
    except (OSError, zipfile.BadZipFile) as e:
        sys.exit(f"check_aar: {arguments.archive} cannot be unpacked: {e}; pack it anew")
    for what, faults in results.items():
        print(f"{'WRONG' if faults else 'ok':5}  {what}")
        for fault in faults:
            print(f"         {fault}")
    if any(results.values()):
        sys.exit(f"check_aar: {arguments.archive} is not as it should be")


if __name__ == "__main__":
    main()
