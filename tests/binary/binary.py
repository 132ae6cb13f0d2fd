#!/usr/bin/env python3
"""Checks the built library itself: what it exports and needs, how it is laid out, its ABI, its size,
and that building it twice gives the same bytes.
"""

import argparse
import os
import pathlib
import re
import shutil
import subprocess
import sys
import tempfile

ROOT = pathlib.Path(__file__).resolve().parents[2]
COMMITTED_ABI = pathlib.Path(__file__).with_name("abi")
SIZES = ROOT / "docs" / "size.md"
SONAME = "libdraventaUtil.so"
PAGE = 16 * 1024  # the larger of the page sizes that Android's phones have
GROWTH = 1.1  # how many times its listed size a library may have

# The Android log, the maths and the C library with the loader that belongs to it. On Android that
# shows as libdl, which the unwinder of 32-bit ARM asks.
MAY_NEED = re.compile(r"lib(log|m|c|dl)\.so(\.\d+)?|ld-linux[-\w]*\.so\.\d+")


def output_of(*command):
    """What a command prints; ends the check when the command fails."""
    try:
        result = subprocess.run([str(c) for c in command], stdout=subprocess.PIPE, text=True,
                                stderr=subprocess.STDOUT, env=dict(os.environ, LC_ALL="C"))
    except OSError as error:
        sys.exit(f"binary: {command[0]} cannot be run ({error.strerror}); ./dev binary installs it")
    if result.returncode != 0:
        sys.exit(f"binary: {' '.join(map(str, command))} failed:\n{result.stdout}")
    return result.stdout


# --- one library ---------------------------------------------------------------------------------
# Each check returns "" or what is wrong.

def listed_exports():
    names = {line for line in (ROOT / "exports.txt").read_text().splitlines()
             if line and not line.startswith("#")}
    if not names:
        sys.exit("binary: exports.txt lists no name; list what the library exports")
    return names


def check_exports(library):
    listed = listed_exports()
    found = {line.split()[0] for line in
             output_of("nm", "-D", "--defined-only", "--format=posix", library).splitlines()}
    return " ".join([f"+{name}" for name in sorted(found - listed)]
                    + [f"-{name}" for name in sorted(listed - found)])


def dynamic_entries(library, tag):
    return re.findall(rf"\({tag}\)\s+(.*)", output_of("readelf", "-dW", library))


def names_in(entries):
    return [re.search(r"\[(.*)\]", entry)[1] for entry in entries]


def check_needed(library):
    names = names_in(dynamic_entries(library, "NEEDED"))
    if not any(name.startswith("liblog.so") for name in names):
        return "the Android log is not among what it needs"
    return " ".join(name for name in names if not MAY_NEED.fullmatch(name))


def check_soname(library):
    names = names_in(dynamic_entries(library, "SONAME"))
    return "" if names == [SONAME] else f"{names}"


def segments(library, kind):
    """The fields of each program header of a kind, from the file offset on."""
    return [line.split()[1:] for line in output_of("readelf", "-lW", library).splitlines()
            if line.split()[:1] == [kind]]


def is_64_bit(library):
    size = re.search(r"ELF(32|64)", output_of("readelf", "-h", library))
    if not size:
        sys.exit(f"binary: readelf does not say how many bits {library} has")
    return size[1] == "64"


def check_alignment(library):
    if not is_64_bit(library):
        return ""
    loaded = segments(library, "LOAD")
    if not loaded:
        return "no segment is loaded"
    return " ".join(s[-1] for s in loaded if int(s[-1], 16) < PAGE)


def check_relro(library):
    return "" if segments(library, "GNU_RELRO") else "no RELRO segment"


def check_bind_now(library):
    return "" if "BIND_NOW" in " ".join(dynamic_entries(library, "FLAGS")) else "lazy binding"


def check_stack(library):
    stacks = segments(library, "GNU_STACK")
    if not stacks:
        return "no GNU_STACK header"
    return "executable stack" if "E" in stacks[0][-2] else ""


def check_text_relocations(library):
    entries = output_of("readelf", "-dW", library)
    if "Dynamic section at" not in entries:
        return "no dynamic section"
    return "text relocations" if "TEXTREL" in entries else ""


LIBRARY_CHECKS = {
    "exports are those of exports.txt": check_exports,
    "needs only log, maths and C library": check_needed,
    "SONAME": check_soname,
    "segments aligned to 16 KiB (64-bit)": check_alignment,
    "RELRO": check_relro,
    "BIND_NOW": check_bind_now,
    "no executable stack": check_stack,
    "no text relocations": check_text_relocations,
}


def is_protected(file):
    """Whether a library or object is marked for AArch64's branch protection, both halves of it."""
    return re.search("AArch64 feature: BTI, PAC", output_of("readelf", "-nW", file)) is not None


def check_branch_protection(library, folders):
    """The library's own mark; where it is missing, the objects to blame, of those in the folders."""
    if is_protected(library):
        return ""
    objects = [o for folder in folders for o in sorted(pathlib.Path(folder).rglob("*.o"))]
    unprotected = " ".join(o.name for o in objects if not is_protected(o))
    return f"not marked; without protection are: {unprotected or 'none of its objects'}"


# --- ABI, bytes, size ----------------------------------------------------------------------------

def dump_abi(objects, folder):
    """Describes what each object exports, and its types, in a file of its own.

    Not the whole library at once: abidw drops a function that another source declares.
    """
    for o in sorted(pathlib.Path(objects).rglob("*.o")):
        dump = folder / f"{o.stem}.abi"
        output_of("abidw", "--no-corpus-path", "--no-comp-dir-path", "--no-show-locs",
                  "--drop-private-types", "--headers-dir", ROOT / "selection", "--headers-dir",
                  ROOT / "support", "--out-file", dump, o)
        dump.write_text(dump.read_text().replace(f"{ROOT}/", ""))  # wherever it was built


def check_described(folder):
    """That the type of every exported name is described."""
    described = set()
    for dump in folder.glob("*.abi"):
        described.update(re.findall(r"elf-symbol-id='([^']*)'", dump.read_text()))
    # A constructor's first name is an alias of its second; so is a destructor's.
    missing = {name for name in listed_exports()
               if name not in described and re.sub(r"(?<=[CD])1(?=E)", "2", name) not in described}
    return " ".join(sorted(missing))


def check_abi(objects, update):
    """Compares functions, variables and their types with the committed description."""
    with tempfile.TemporaryDirectory() as temporary:
        now = pathlib.Path(temporary)
        dump_abi(objects, now)
        wrong = check_described(now)
        if wrong:
            return f"not described: {wrong}"
        if update:
            shutil.rmtree(COMMITTED_ABI, ignore_errors=True)
            shutil.copytree(now, COMMITTED_ABI)
        changes = []
        for name in sorted({d.name for f in (now, COMMITTED_ABI) for d in f.glob("*.abi")}):
            if not (now / name).exists() or not (COMMITTED_ABI / name).exists():
                changes.append(f"{name} is new or gone")
                continue
            result = subprocess.run(["abidiff", COMMITTED_ABI / name, now / name],
                                    stdout=subprocess.PIPE, stderr=subprocess.STDOUT, text=True)
            if result.returncode != 0:
                changes.append(f"{name}:\n{result.stdout.strip()}")
    return "\n".join(changes)


def check_twins(one, two):
    if pathlib.Path(one).samefile(two):
        return f"{two} is the same file, not another build"
    same = pathlib.Path(one).read_bytes() == pathlib.Path(two).read_bytes()
    return "" if same else f"{one} and {two} differ"


def stripped_size(library):
    with tempfile.TemporaryDirectory() as folder:
        stripped = pathlib.Path(folder) / "stripped.so"
        # The host's strip knows its own machine alone.
        output_of("llvm-strip-19", "--strip-unneeded", library, "-o", stripped)
        return stripped.stat().st_size


def code_and_data(library):
    """Bytes of code and constants, and of data."""
    words = output_of("size", library).splitlines()[1].split()
    return int(words[0]), int(words[1]) + int(words[2])


def check_sizes(libraries, update):
    measured = {arch: (stripped_size(lib), *code_and_data(lib)) for arch, lib in libraries}
    if update:
        rows = "".join(f"| {arch} | {file:,} | {code:,} | {data:,} |\n"
                       for arch, (file, code, data) in measured.items())
        SIZES.write_text(
            "# Size of the library\n\n"
            "Release build by g++, stripped. Bytes of the file (its segments are aligned to 16 KiB\n"
            "on 64-bit machines), of code and constants, and of data, most of which are\n"
            "the tables of the fixed-point toolkit. `./dev binary` measures, and fails when a file\n"
            "has grown by more than a tenth; `./dev binary --update` rewrites this page.\n\n"
            "| processor | file | code and constants | data |\n|---|---:|---:|---:|\n" + rows)
    wrong = []
    listed = dict(re.findall(r"^\| ([\w-]+) \| ([\d,]+) \|", SIZES.read_text(), re.M))
    for arch, (file, _, _) in measured.items():
        limit = int(listed.get(arch, "0").replace(",", "")) * GROWTH
        if file > limit:
            wrong.append(f"{arch} has {file:,} bytes, listed are {listed.get(arch)}")
    return "; ".join(wrong)


# --- the run -------------------------------------------------------------------------------------

def pair(text):
    name, _, path = text.partition("=")
    if not pathlib.Path(path).is_file():
        raise argparse.ArgumentTypeError(f"'{text}' names no file, as in x86-64=library.so")
    return name, path


def main():
    parser = argparse.ArgumentParser(description=__doc__)
    parser.add_argument("--library", action="append", type=pair, required=True,
                        metavar="ARCH=FILE")
    parser.add_argument("--protected", required=True, metavar="FILE",
                        help="AArch64 library of the own objects alone: branch protection")
    parser.add_argument("--protected-objects", nargs="+", required=True, metavar="DIR",
                        help="the folders of its objects")
    parser.add_argument("--debug-objects", required=True, metavar="DIR",
                        help="folder of objects with debug info, for the ABI")
    parser.add_argument("--twins", nargs=2, action="append", required=True, metavar="FILE",
                        help="two builds of the same library")
    parser.add_argument("--update", action="store_true", help="commit ABI and sizes as they are")
    parser.add_argument("--summary", help="file to append the row of the final table to")
    arguments = parser.parse_args()

    results = []
    for arch, library in arguments.library:
        for what, check in LIBRARY_CHECKS.items():
            results.append((f"{arch}: {what}", check(library)))
    results.append(("AArch64: branch protection of the own objects, linked",
                    check_branch_protection(arguments.protected, arguments.protected_objects)))
    results.append(("ABI as committed", check_abi(arguments.debug_objects, arguments.update)))
    for one, two in arguments.twins:
        results.append((f"same bytes twice: {one}", check_twins(one, two)))
    results.append(("sizes of docs/size.md", check_sizes(arguments.library, arguments.update)))

    for what, wrong in results:
        print(f"{'WRONG' if wrong else 'ok':5}  {what}{': ' + wrong if wrong else ''}")
    failed = sum(bool(wrong) for _, wrong in results)
    if arguments.summary:
        with open(arguments.summary, "a") as summary:
            summary.write(f"binary\t{len(results) - failed} of {len(results)} properties\tall\n")
    if failed:
        sys.exit(f"binary: {failed} of {len(results)} properties do not hold")


if __name__ == "__main__":
    main()
