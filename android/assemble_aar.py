#!/usr/bin/env python3
"""Puts the built library, its Java face and its headers together as an Android archive.

The same inputs give the same bytes: entries are sorted, have fixed permissions and one time, that
of SOURCE_DATE_EPOCH or else the first one that a zip file can hold.
"""

import argparse
import io
import json
import os
import pathlib
import re
import sys
import time
import zipfile

HERE = pathlib.Path(__file__).resolve().parent
NAME = "draventaUtil"
LIBRARY = f"lib{NAME}.so"
GROUP = "com.velt.android.orvane.lumetrix"
MIN_SDK = 21


def fail(what):
    sys.exit(f"assemble_aar: {what}")


def read(path, mend):
    """The bytes of a file; without it, says how to get it."""
    try:
        return pathlib.Path(path).read_bytes()
    except OSError as error:
        fail(f"cannot read {path} ({error.strerror}): {mend}")


def project_version(build):
    """The version of the project that a build folder was configured for."""
    cache = read(pathlib.Path(build) / "CMakeCache.txt", "call ./dev aar, which configures it")
    found = re.search(rb"^CMAKE_PROJECT_VERSION:STATIC=(.+)$", cache, re.M)
    if not found:
        fail(f"{build}/CMakeCache.txt names no version: remove the folder and call ./dev aar")
    return found[1].decode()


# --- zip files -----------------------------------------------------------------------------------

def zip_time():
    """The time of every entry: year to second, UTC."""
    epoch = os.environ.get("SOURCE_DATE_EPOCH", "0")
    if not epoch.isdecimal():
        fail(f"SOURCE_DATE_EPOCH is '{epoch}': set it to whole seconds since 1970, or unset it")
    first = (1980, 1, 1, 0, 0, 0)
    return max(first, tuple(time.gmtime(int(epoch))[:6]))


def zipped(entries):
    """A zip file of {path: bytes}."""
    date_time = zip_time()
    result = io.BytesIO()
    with zipfile.ZipFile(result, "w") as archive:
        for path in sorted(entries):
            info = zipfile.ZipInfo(path, date_time)
            info.compress_type = zipfile.ZIP_DEFLATED
            info.create_system = 3  # Unix, whose permissions these are: a file, rw-r--r--
            info.external_attr = 0o100644 << 16
            archive.writestr(info, entries[path], compresslevel=9)
    return result.getvalue()


# --- what goes in --------------------------------------------------------------------------------

def classes(jar):
    """classes.jar: the classes of a jar, without what javac's jar says of itself."""
    with zipfile.ZipFile(io.BytesIO(read(jar, "build the target draventa_java"))) as archive:
        return zipped({name: archive.read(name) for name in archive.namelist()
                       if name.endswith(".class")})


def as_json(value):
    return (json.dumps(value, indent=2) + "\n").encode()


def prefab_entries(version, libraries, headers, ndk):
    """What native code of an app finds by find_package(draventaUtil)."""
    module = f"prefab/modules/{NAME}"
    entries = {
        "prefab/prefab.json": as_json(
            {"schema_version": 2, "name": NAME, "version": version, "dependencies": []}),
        f"{module}/module.json": as_json(
            {"export_libraries": [], "library_name": f"lib{NAME}", "android": {}}),
    }
    for header in sorted(headers.rglob("*.h")):
        path = header.relative_to(headers).as_posix()
        entries[f"{module}/include/{path}"] = header.read_bytes()
    for abi, library in libraries.items():
        folder = f"{module}/libs/android.{abi}"
        entries[f"{folder}/{LIBRARY}"] = library
        # The C++ library inside is hidden and nothing of it shows in the headers, so callers may
        # use whichever they like, which is what "none" says.
        entries[f"{folder}/abi.json"] = as_json(
            {"abi": abi, "api": MIN_SDK, "ndk": ndk, "stl": "none", "static": False})
    return entries


def metadata_entries(version):
    lines = ("aarFormatVersion=1.0", "aarMetadataVersion=1.0", f"minCompileSdk={MIN_SDK}",
             "minAndroidGradlePluginVersion=1.0.0", "coreLibraryDesugaringEnabled=false")
    return {
        "META-INF/com/android/build/gradle/aar-metadata.properties":
            "".join(f"{line}\n" for line in lines).encode(),
        f"META-INF/{GROUP}_{NAME}.version": f"{version}\n".encode(),
    }


def archive_entries(version, libraries, jar, headers, ndk):
    entries = {
        "AndroidManifest.xml": (HERE / "AndroidManifest.xml").read_bytes(),
        "R.txt": b"",
        "classes.jar": classes(jar),
        "proguard.txt": (HERE / "proguard.txt").read_bytes(),
    }
    entries.update({f"jni/{abi}/{LIBRARY}": library for abi, library in libraries.items()})
    entries.update(prefab_entries(version, libraries, headers, ndk))
    entries.update(metadata_entries(version))
    return entries


def ndk_release(ndk_home):
    """The major release of an NDK; 0 without one."""
    if not ndk_home:
        return 0
    properties = read(pathlib.Path(ndk_home) / "source.properties", "is this an NDK?")
    return int(re.search(rb"^Pkg\.Revision *= *(\d+)", properties, re.M)[1])


# --- the run -------------------------------------------------------------------------------------

def pair(text):
    abi, _, path = text.partition("=")
    return abi, path


def main():
    parser = argparse.ArgumentParser(description=__doc__)
    parser.add_argument("--version-of", required=True, metavar="BUILD",
                        help="a build folder of this project, for the version")
    parser.add_argument("--library", action="append", type=pair, required=True,
                        metavar="ABI=FILE", help="the stripped library for an ABI")
    parser.add_argument("--jar", required=True, help="the Java face")
    parser.add_argument("--headers", required=True, type=pathlib.Path, metavar="DIR",
                        help="the folder of the installed headers")
    parser.add_argument("--ndk", default="", metavar="DIR",
                        help="the NDK that built the libraries; without it they are stand-ins")
    parser.add_argument("--out", required=True, type=pathlib.Path, metavar="DIR",
                        help="where to write the archive")
    arguments = parser.parse_args()

    version = project_version(arguments.version_of)
    libraries = {abi: read(path, "build the target 'stripped'") for abi, path in arguments.library}
    if not (arguments.headers / f"{NAME}.h").exists():
        fail(f"no {NAME}.h in {arguments.headers}: install the component 'headers' there")
    entries = archive_entries(version, libraries, arguments.jar, arguments.headers,
                              ndk_release(arguments.ndk))
    standin = "" if arguments.ndk else "-standin"
    archive = arguments.out / f"{NAME}-{version}{standin}.aar"
    archive.parent.mkdir(parents=True, exist_ok=True)
    archive.write_bytes(zipped(entries))
    print(f"{archive}: {len(entries)} entries, {archive.stat().st_size:,} bytes, "
          f"for {', '.join(libraries)}")


if __name__ == "__main__":
    main()
