#!/usr/bin/env python3
"""Finds strokes whose result depends on one line of the library.

A deviation is a change of the library's text. deviations.txt names some:

    NAME: FILE
      - text to be replaced, white space as you like; it must be there exactly once
      + text in its place
      = Why no stroke can tell it, where that is so.

A file's deviation may have several such pairs, and texts of several lines.

    search.py find NAME... [--seconds N] [--seed S] [--append]
    search.py find --file FILE --replace TEXT --by TEXT ...
        builds the library with the deviation, searches random strokes until one comes out otherwise
        than in the library as it is, makes it as simple as it can be and prints it; --append also
        writes it to pinned.txt; --missing leaves out what pinned.txt's strokes notice already
    search.py simplify NAME --cases FILE
        those of the file's cases that come out otherwise, as simple as they can be made
    search.py check [NAME...]
        which of pinned.txt's strokes notice each deviation

Exits with 1 when a search finds nothing, or a deviation is not noticed; with 2 when a text is not
there or a deviation does not compile. Everything is built under --work.
"""

import argparse
import concurrent.futures
import os
import pathlib
import re
import shutil
import subprocess
import sys

HERE = pathlib.Path(__file__).resolve().parent
ROOT = HERE.parents[1]
DEVIATIONS = HERE / "deviations.txt"
PINNED = HERE / "pinned.txt"

FLAGS = ["-std=c++17", "-O2", "-g0", "-ffp-contract=off", "-Wno-unused"]
ENGINE = ["selection/D_Queue.cpp", "selection/ER_selection.cpp", "selection/brush_painting.cpp",
          "selection/competition_plain.cpp", "selection/front_competition.cpp",
          "selection/lasso_segment.cpp", "support/fixed_point.cpp",
          "support/fixed_point_tables.cpp", "support/ze_alloc.cpp",
          "tests/strokes/stroke_engine.cpp"]
PROGRAM = ["tests/strokes/random_cases.cpp", "tests/strokes/search.cpp",
           "tests/strokes/simplify.cpp", "tests/strokes/stroke_cases.cpp"]
# What only the plain version runs, or what it shares with nothing that is compared.
PLAIN_SOURCES = ["selection/D_Queue.cpp", "selection/competition_plain.cpp"]


class Unusable(Exception):
    """A deviation that cannot be made, or a build that fails."""


class Deviation:
    def __init__(self, name, file):
        self.name = name
        self.file = file
        self.changes = []  # (text, its replacement)
        self.reason = ""  # why no stroke can tell it

    def version(self):
        return "plain" if self.file in PLAIN_SOURCES else "library"

    def applied(self):
        """The file's text with the deviation."""
        text = (ROOT / self.file).read_text()
        if not self.changes:
            raise Unusable(f"{self.name}: no change")
        for old, new in self.changes:
            words = old.split()
            found = list(re.finditer(r"\s+".join(map(re.escape, words)), text)) if words else []
            if len(found) != 1:
                raise Unusable(f"{self.name}: {self.file} holds this {len(found)} times: {old}")
            text = text[:found[0].start()] + new + text[found[0].end():]
        return text


def read_deviations(path):
    deviations = {}
    last = None  # kind of the line before
    for number, line in enumerate(path.read_text().split("\n"), 1):
        if not line.strip() or line.startswith("#"):
            continue
        match = re.fullmatch(r"([\w-]+): (\S+)", line)
        if match:
            name, file = match.groups()
            if name in deviations:
                raise Unusable(f"{path}:{number}: {name} is there already")
            current = deviations[name] = Deviation(name, file)
            last = None
            continue
        kind, text = line.strip()[0], line.strip()[1:].strip()
        if not line.startswith("  ") or not deviations or kind not in "-+=":
            raise Unusable(f"{path}:{number}: neither a name nor a text: {line}")
        if kind == "=":
            current.reason = f"{current.reason} {text}".strip()
        elif kind == "-" and last == "-":
            current.changes[-1][0] += "\n" + text
        elif kind == "-":
            current.changes.append([text, ""])
        elif not current.changes:
            raise Unusable(f"{path}:{number}: nothing to replace")
        else:
            current.changes[-1][1] += text + "\n"
        last = kind
    return deviations


# --- building -------------------------------------------------------------------------------------


def run_compiler(arguments):
    command = os.environ.get("CXX_LAUNCHER", "").split() + [os.environ.get("CXX", "c++")]
    done = subprocess.run(command + arguments, capture_output=True, text=True)
    if done.returncode != 0:
        raise Unusable(done.stderr)


class Workshop:
    """The search program, the library as it is, and copies with deviations."""

    def __init__(self, folder):
        self.folder = folder
        self.program = folder / "search"
        self.library = folder / "library.so"
        self.jobs = 2

    def prepare(self):
        self.folder.mkdir(parents=True, exist_ok=True)
        self.compile_all(ROOT, self.folder / "library", ENGINE)
        self.link_shared(self.folder / "library", {}, self.library)
        self.compile_all(ROOT, self.folder / "program", PROGRAM)
        run_compiler([str(self.object(self.folder / "program", s)) for s in PROGRAM] +
                     ["-o", str(self.program), "-ldl"])

    @staticmethod
    def object(folder, source):
        return folder / (source.replace("/", "_") + ".o")

    def compile_all(self, tree, folder, sources):
        folder.mkdir(parents=True, exist_ok=True)
        with concurrent.futures.ThreadPoolExecutor(self.jobs) as pool:
            list(pool.map(lambda source: self.compile(tree, folder, source), sources))

    def compile(self, tree, folder, source):
        target = self.object(folder, source)
        place = tree if (tree / source).exists() else ROOT
        run_compiler(FLAGS + ["-fPIC", "-fvisibility=hidden", "-fno-gnu-unique", "-MMD",
                              f"-I{tree}", f"-I{ROOT}", "-c", str(place / source), "-o",
                              str(target)])

    def link_shared(self, original, replaced, target):
        objects = [str(replaced.get(s, self.object(original, s))) for s in ENGINE]
        run_compiler(["-shared", "-Wl,-Bsymbolic", *objects, "-o", str(target)])

    def depends(self, source, file):
        dependencies = self.object(self.folder / "library", source).with_suffix(".d")
        names = dependencies.read_text().replace("\\\n", " ").split()
        return str(ROOT / file) in map(os.path.abspath, names)  # ccache writes relative ones

    def build(self, deviation):
        """The shared object with the deviation."""
        folder = self.folder / "deviant" / deviation.name
        shutil.rmtree(folder, ignore_errors=True)
        tree = folder / "source"
        for name in ["selection", "support"]:  # quoted includes look here first
            shutil.copytree(ROOT / name, tree / name)
        (tree / deviation.file).write_text(deviation.applied())
        shutil.copytree(HERE, tree / "tests/strokes",
                        ignore=shutil.ignore_patterns("*.txt", "*.py", "__pycache__"))
        sources = [s for s in ENGINE if self.depends(s, deviation.file)]
        if not sources:
            raise Unusable(f"{deviation.name}: {deviation.file} is no part of the engine")
        try:
            self.compile_all(tree, folder, sources)
            self.link_shared(self.folder / "library", {s: self.object(folder, s) for s in sources},
                             folder / "deviant.so")
        except Unusable as error:
            raise Unusable(f"{deviation.name} does not compile:\n{error}") from error
        return folder / "deviant.so"


def run_search(command, *arguments):
    """What the program prints; None when it found nothing."""
    done = subprocess.run([str(a) for a in arguments[:1]] + [command] +
                          [str(a) for a in arguments[1:]], stdout=subprocess.PIPE, text=True)
    if done.returncode == 1:
        return None
    if done.returncode != 0:
        raise Unusable(f"{command} failed")
    return done.stdout


# --- commands -------------------------------------------------------------------------------------


def number_of_cases(name):
    return len(re.findall(rf"^case {re.escape(name)} \d+$", PINNED.read_text(), re.M))


def noticed(workshop, deviation, deviant):
    """The names of pinned.txt's cases that come out otherwise."""
    found = run_search("check", workshop.program, workshop.library, deviant, deviation.version(),
                       PINNED)
    return (found or "").split("\n")[:-1]


def find(workshop, deviation, arguments):
    deviant = workshop.build(deviation)
    if arguments.missing and (deviation.reason or noticed(workshop, deviation, deviant)):
        return True
    case = f"{deviation.name} {number_of_cases(deviation.name) + 1}"
    found = run_search("find", workshop.program, workshop.library, deviant, deviation.version(),
                       PINNED, arguments.seconds, arguments.seed, case)
    if found is None:
        print(f"{deviation.name}: nothing found in {arguments.seconds} s")
        return False
    print(found, end="", flush=True)
    if arguments.append:
        with PINNED.open("a") as file:
            file.write("\n" + found)
    return True


def simplify(workshop, deviation, cases):
    found = run_search("simplify", workshop.program, workshop.library, workshop.build(deviation),
                       deviation.version(), cases)
    print(found or f"{deviation.name}: no case comes out otherwise", end="" if found else "\n")
    return bool(found)


def check(workshop, deviation):
    cases = noticed(workshop, deviation, workshop.build(deviation))
    if deviation.reason:
        said = "NOTICED, and yet explained" if cases else "explained"
    elif cases:
        said = f"noticed by {len(cases)}: {', '.join(cases[:3])}{', ...' if cases[3:] else ''}"
    else:
        said = "NOT NOTICED"
    print(f"{deviation.name:42} {said}", flush=True)
    return bool(cases) != bool(deviation.reason)


def chosen(arguments):
    if arguments.file:
        deviation = Deviation("deviation", arguments.file)
        deviation.changes.append([arguments.replace or "", arguments.by or ""])
        return [deviation]
    named = read_deviations(DEVIATIONS)
    for name in arguments.names:
        if name not in named:
            raise Unusable(f"deviations.txt names no {name}")
    if not named or arguments.command == "find" and not arguments.names and not arguments.missing:
        raise Unusable("no deviation")
    return [named[name] for name in arguments.names or named]


def main():
    parser = argparse.ArgumentParser(description=__doc__,
                                     formatter_class=argparse.RawDescriptionHelpFormatter)
    parser.add_argument("command", choices=["find", "simplify", "check"])
    parser.add_argument("names", nargs="*", metavar="NAME")
    parser.add_argument("--file")
    parser.add_argument("--replace", metavar="TEXT")
    parser.add_argument("--by", metavar="TEXT")
    parser.add_argument("--cases", type=pathlib.Path, default=PINNED)
    parser.add_argument("--seconds", type=float, default=60)
    parser.add_argument("--seed", type=int, default=1)
    parser.add_argument("--append", action="store_true")
    parser.add_argument("--missing", action="store_true")
    parser.add_argument("--work", type=pathlib.Path, default=ROOT / "build/strokes")
    arguments = parser.parse_args()
    try:
        deviations = chosen(arguments)
        for deviation in deviations:
            deviation.applied()  # before anything is built
        workshop = Workshop(arguments.work.resolve())
        workshop.prepare()
        if arguments.command == "find":
            good = [find(workshop, d, arguments) for d in deviations]
        elif arguments.command == "simplify":
            good = [simplify(workshop, d, arguments.cases) for d in deviations]
        else:
            good = [check(workshop, d) for d in deviations]
            print(f"{sum(good)} of {len(good)} deviations are noticed or explained")
    except Unusable as error:
        print(f"search.py: {error}", file=sys.stderr)
        sys.exit(2)
    sys.exit(0 if all(good) else 1)


if __name__ == "__main__":
    main()
