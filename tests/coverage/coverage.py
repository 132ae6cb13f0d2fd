#!/usr/bin/env python3
"""Checks that the unit tests run every function, line, branch and condition of the library.

Takes test programs of builds configured with DRAVENTA_COVERAGE, one build for each processor that
has code of its own. Runs them, and lists by file what they leave out all together. Whatever
exclusions.txt does not excuse is an error. So is code that none of these builds compiles.

A condition is covered (MC/DC) when two evaluations of its decision differ in their result and,
among the conditions evaluated in both, in this one alone.
"""

import argparse
import bisect
import collections
import concurrent.futures
import json
import os
import pathlib
import re
import shlex
import subprocess
import sys

ROOT = pathlib.Path(__file__).resolve().parents[2]
SOURCE_FOLDERS = ("jni", "render", "selection", "support")
EXCLUSIONS = pathlib.Path(__file__).with_name("exclusions.txt")
KINDS = ("sources", "functions", "lines", "branches", "conditions")
REPORTED = {"lines": "lines", "branches": "branches", "conditions": "MC/DC"}  # to the summary

# A thing to be covered. `source` is the text of its line, `missing` what has not been seen of it,
# or None when it is covered.
Place = collections.namedtuple("Place", "file line kind source missing")


class Source:
    """A source file: its text by position. Lines and columns count from 1, columns in bytes."""

    def __init__(self, name):
        self.name = name
        self.lines = (ROOT / name).read_bytes().split(b"\n")

    def line(self, number):
        return plain(self.lines[number - 1])

    def text(self, first_line, first_column, last_line, last_column):
        """The text between two positions, as one line."""
        part = self.lines[first_line - 1 : last_line]
        part[-1] = part[-1][: last_column - 1]
        part[0] = part[0][first_column - 1 :]
        return plain(b" ".join(part))

    def place(self, line, kind, missing):
        return Place(self.name, line, kind, self.line(line), missing)

    def code(self):
        """The whole text with blanks for comments, strings and preprocessor lines."""
        blanked = lambda match: re.sub(r"[^\n]", " ", match.group())
        text = b"\n".join(self.lines).decode("latin-1")  # one character per byte
        text = re.sub(r"//.*|/\*[\s\S]*?\*/|\"(\\.|[^\"\\\n])*\"|'(\\.|[^'\\\n])+'", blanked, text)
        return re.sub(r"^ *#.*(\\\n.*)*", blanked, text, flags=re.MULTILINE)


def plain(text):
    return " ".join(text.decode().split())


# --- what the compiler and the run say --------------------------------------------------------


class Build:
    """A build for one processor: what it compiles, and what llvm-cov exports of its tests' run."""

    def __init__(self, command):
        *emulator, program = shlex.split(command)
        program = pathlib.Path(program).resolve()
        folder = program.parents[1]
        self.sources = counted_sources(folder / "compile_commands.json")
        exported = run_tests([*emulator, program], folder / "coverage")
        self.functions = exported["functions"]
        self.files = {file["filename"]: file for file in exported["files"]}


def counted_sources(compile_commands):
    """Names of the sources that a build compiles with counters."""
    entries = json.loads(compile_commands.read_text())
    counted = {pathlib.Path(entry["directory"], entry["file"]).resolve() for entry in entries
               if "-fcoverage-mapping" in shlex.split(entry["command"])}
    return {str(file.relative_to(ROOT)) for file in counted if file.is_relative_to(ROOT)}


def run_tests(command, folder):
    """Runs a program and returns what llvm-cov exports of it."""
    program = command[-1]
    folder.mkdir(exist_ok=True)
    for old in folder.glob("*.profraw"):
        old.unlink()
    # %p: a test may start a process of its own.
    environment = dict(os.environ, LLVM_PROFILE_FILE=str(folder / "%p.profraw"))
    tests = subprocess.run([*command, "--gtest_brief=1"], env=environment, text=True,
                           stdout=subprocess.PIPE, stderr=subprocess.STDOUT)
    if tests.returncode != 0:
        sys.exit(f"{tests.stdout}coverage: {program} failed, so what it covers means nothing")
    # A test that was skipped or left out covers less, and nothing else would show it.
    ran = re.search(r"^\[  PASSED  \] ([1-9]\d*) tests?\.$", tests.stdout, re.M)
    if not ran or "[  SKIPPED ]" in tests.stdout:
        sys.exit(f"{tests.stdout}coverage: {program} skipped tests or ran none; call it with what "
                 "they lack")
    print(f"{ran[1]} tests ran")
    counts = list(folder.glob("*.profraw"))
    if not counts:
        sys.exit(f"coverage: {program} counts nothing; is it built with DRAVENTA_COVERAGE?")
    profile = folder / "tests.profdata"
    subprocess.run(["llvm-profdata-19", "merge", "-sparse", "-o", profile, *counts], check=True)
    exported = subprocess.run(["llvm-cov-19", "export", program, f"-instr-profile={profile}"],
                              check=True, stdout=subprocess.PIPE)
    return json.loads(exported.stdout)["data"][0]


def sources():
    files = [f for folder in SOURCE_FOLDERS for f in (ROOT / folder).rglob("*.*")]
    return sorted(str(f.relative_to(ROOT)) for f in files if f.suffix in (".h", ".cpp"))


# --- functions ----------------------------------------------------------------------------------


def function_bodies(source):
    """Positions of the braces that open the bodies of functions and lambdas.

    The compiler lists no template that nothing instantiates, nothing of a header that no source
    includes, and no function that it has only run itself, for a constant. Reading them off the
    text keeps those from going unnoticed.
    """
    text = source.code()
    for brace in re.finditer("{", text):
        before = text[max(brace.start() - 1000, 0) : brace.start()]  # far more than any head
        before = re.sub(r"(\s|\bconst\b|\bnoexcept\b|\bmutable\b|->[\s\w:<>,*&]+)*$", "", before)
        if is_statement_head(before) or not before.endswith((")", "]", "}")):
            continue
        if before.endswith("}") and not re.search(r"[\w>]\{[^{}]*\}$", before):
            continue  # a block after a block; what is left ends a constructor's initialisers
        start = text.rfind("\n", 0, brace.start())
        yield text.count("\n", 0, brace.start()) + 1, brace.start() - start


def is_statement_head(before):
    """`before` ends with the parentheses of an if, for, while or switch."""
    if not before.endswith(")"):
        return False
    depth = 0
    for i in range(len(before) - 1, -1, -1):
        depth += {")": 1, "(": -1}.get(before[i], 0)
        if depth == 0:
            return re.search(r"\b(if|if constexpr|for|while|switch)\s*$", before[:i]) is not None
    return False


def regions_of_functions(source, builds):
    """For each function of a source, in each build: its regions there, and how often it ran."""
    for build in builds:
        for function in build.functions:
            regions = [r for r in function["regions"]
                       if function["filenames"][r[5]] == str(ROOT / source.name)]
            if regions:
                yield regions, function["count"]


def functions(source, builds):
    """A place for each function: instantiations of a template, and copies of an inline function
    in several objects, are one."""
    calls = collections.Counter()
    starts = set()
    for regions, count in regions_of_functions(source, builds):
        calls[tuple(regions[0][:2])] += count
        starts.update(tuple(r[:2]) for r in regions)
    for (line, _), count in calls.items():
        yield source.place(line, "functions", None if count else "function never called")
    for position in function_bodies(source):
        if position not in starts:
            yield source.place(position[0], "functions", "function not compiled into any object")


# --- lines, branches, conditions ----------------------------------------------------------------


class Segments:
    """The counts of a file, summed over instantiations: each holds from its start to the next."""

    def __init__(self, segments):
        self.starts = [tuple(s[:2]) for s in segments]
        self.segments = segments

    def count_at(self, line, column):
        """How often the code at a position ran, or None where there is none."""
        i = bisect.bisect_right(self.starts, (line, column)) - 1
        return self.segments[i][2] if i >= 0 and self.segments[i][3] else None

    def lines(self, code):
        """For each line with code, how often its most frequent part ran."""
        starting = collections.defaultdict(list)
        for line, _, count, has_count, is_entry, is_gap in self.segments:
            if has_count and is_entry and not is_gap:
                starting[line].append(count)
        for line, text in enumerate(code, 1):
            if text.strip():
                # What runs on from the line above.
                before = self.count_at(line, len(text) - len(text.lstrip()) + 1)
                counts = starting[line] + ([] if before is None else [before])
                if counts:
                    yield line, max(counts)


def lines(source, builds, segments):
    """A place for each line that some build compiles, and for each that is left out of all."""
    code = source.code().split("\n")
    counts = collections.Counter()
    for in_build in segments:
        for line, count in in_build.lines(code):
            counts[line] += count
    for line, count in sorted(counts.items()):
        yield source.place(line, "lines", None if count else "line never run")
    inside = {line for regions, _ in regions_of_functions(source, builds)
              for line in range(regions[0][0], regions[0][2] + 1)}
    for line in sorted(inside - counts.keys()):
        if code[line - 1].strip():
            yield source.place(line, "lines", "line not compiled into any object")


def branches(source, segments, files):
    """Two places for each condition that something branches on: true and false.

    The compiler counts each instantiation of a template by itself. Here a branch is covered when
    it is in one of them: the source has it once, and instantiations differ in what they can reach.
    So do builds.
    """
    counts = collections.defaultdict(lambda: [0, 0])
    for file in files:
        for *region, true_count, false_count, _, _, _ in file["branches"]:
            counts[tuple(region)][0] += true_count
            counts[tuple(region)][1] += false_count
    for region, (true_count, false_count) in sorted(counts.items()):
        if true_count == false_count == 0 and any(s.count_at(*region[:2]) for s in segments):
            continue  # the compiler knows the value: a template's constant
        for value, count in (("true", true_count), ("false", false_count)):
            missing = f'branch "{source.text(*region)}" never {value}'
            yield source.place(region[0], "branches", None if count else missing)


def conditions(source, files):
    """A place for each condition of a decision with && or ||. As with branches, one instantiation
    is enough; the pair of evaluations has to come from the same one."""
    decisions = collections.defaultdict(list)
    for file in files:
        for *region, _, _, covered in file["mcdc_records"]:
            decisions[tuple(region)].append(covered)
    condition_regions = sorted({tuple(b[:4]) for file in files for b in file["branches"]})
    for region, covered in sorted(decisions.items()):
        inside = [c for c in condition_regions if region[:2] <= c[:2] and c[2:] <= region[2:]]
        total = len(covered[0])
        for i in range(total):
            # Where another decision lies inside, its conditions are not told apart.
            shown = inside[i] if len(inside) == total else region
            missing = f'MC/DC: condition {i + 1} of {total}, "{source.text(*shown)}", ' \
                      'never decides alone'
            done = any(instance[i] for instance in covered)
            yield source.place(shown[0], "conditions", None if done else missing)


def places(source, builds):
    if source.name.endswith(".cpp"):
        is_compiled = any(source.name in build.sources for build in builds)
        yield source.place(1, "sources", None if is_compiled else "source not in any counted build")
    yield from functions(source, builds)
    path = str(ROOT / source.name)
    files = [build.files[path] for build in builds if path in build.files]
    segments = [Segments(file["segments"]) for file in files]
    yield from lines(source, builds, segments)
    yield from branches(source, segments, files)
    yield from conditions(source, files)


# --- exclusions ---------------------------------------------------------------------------------


class Exclusion:
    """One place that cannot be covered, as exclusions.txt words it."""

    def __init__(self, fields, missing, line):
        self.file = fields["file"]
        self.source = fields["source"]
        self.missing = missing
        self.line = line

    def matches(self, place):
        return (self.file, self.source, self.missing) == (place.file, place.source, place.missing)


def read_exclusions(path):
    """Entries are separated by empty lines; # begins a comment. See the file for the fields."""
    entries = []
    fields, missing, last = {}, [], None
    text = path.read_text().splitlines()
    for number, line in enumerate([*text, ""], 1):
        if line.startswith("#"):
            continue
        if not line.strip():
            if fields or missing:
                if set(fields) != {"file", "source", "reason"} or not missing:
                    sys.exit(f"{path}:{number - 1}: an entry has file, source, missing and reason")
                entries += [Exclusion(fields, m, number_of_m) for number_of_m, m in missing]
            fields, missing, last = {}, [], None
        elif line[0].isspace() and last == "reason":
            fields["reason"] += " " + line.strip()
        else:
            last, colon, value = (part.strip() for part in line.partition(":"))
            value = " ".join(value.split())
            if last == "missing" and value:
                missing.append((number, value))
            elif last in ("file", "source", "reason") and value and last not in fields:
                fields[last] = value
            else:
                sys.exit(f"{path}:{number}: not understood: {line}")
    return entries


# --- the report ---------------------------------------------------------------------------------


def figure(counts, kind):
    covered, total = counts[kind]
    return f"{covered}/{total}" if total else "-"


def print_table(by_file):
    header = ("file", *KINDS)
    rows = [(name, *(figure(counts, kind) for kind in KINDS)) for name, counts in by_file.items()]
    widths = [max(len(row[i]) for row in [header, *rows]) for i in range(len(header))]
    for row in [header, *rows]:
        figures = [cell.rjust(width) for cell, width in zip(row[1:], widths[1:])]
        print("  ".join([row[0].ljust(widths[0]), *figures]))


def count(all_places):
    counts = {kind: [0, 0] for kind in KINDS}
    for place in all_places:
        counts[place.kind][0] += place.missing is None
        counts[place.kind][1] += 1
    return counts


def append_summary(path, totals, excluded):
    with open(path, "a") as summary:
        for kind, name in REPORTED.items():
            covered, total = totals[kind]
            listed = f", {excluded[kind]} excluded" if excluded[kind] else ""
            summary.write(f"coverage: {name}\t{covered} of {total}{listed}\tall, or listed\n")


def main():
    parser = argparse.ArgumentParser(description=__doc__.splitlines()[0])
    parser.add_argument("programs", nargs="+", metavar="PROGRAM",
                        help="BUILD/tests/PROGRAM with DRAVENTA_COVERAGE; before it its emulator")
    parser.add_argument("--summary", metavar="FILE", help="append the totals to FILE, with tabs")
    arguments = parser.parse_args()

    with concurrent.futures.ThreadPoolExecutor(os.cpu_count()) as pool:
        builds = list(pool.map(Build, arguments.programs))
    by_file = {name: list(places(Source(name), builds)) for name in sources()}
    everything = [place for file_places in by_file.values() for place in file_places]
    totals = count(everything)
    if not all(total for _, total in totals.values()):
        sys.exit(f"coverage: nothing was counted of {', '.join(SOURCE_FOLDERS)} ({totals}); is "
                 f"{build} a build of {ROOT}?")
    tables = {name: count(file_places) for name, file_places in by_file.items() if file_places}
    print_table({**tables, "all": totals})

    exclusions = read_exclusions(EXCLUSIONS)
    excluded = collections.Counter()
    errors = 0
    for place in everything:
        if place.missing is None:
            continue
        is_listed = any(exclusion.matches(place) for exclusion in exclusions)
        excluded[place.kind] += is_listed
        errors += not is_listed
        print(f"\n{place.file}:{place.line}: {place.missing}" + " (excluded)" * is_listed)
        print(f"    {place.source}")
    for exclusion in exclusions:
        matched = sum(exclusion.matches(place) for place in everything)
        if matched != 1:
            errors += 1
            what = "excludes nothing" if matched == 0 else f"is not clear: {matched} places match"
            print(f"\n{EXCLUSIONS.relative_to(ROOT)}:{exclusion.line}: {what}")
            print(f"    {exclusion.file}: {exclusion.source}: {exclusion.missing}")
    if arguments.summary:
        append_summary(arguments.summary, totals, excluded)
    print(f"\n{sum(excluded.values())} excluded, {errors} errors")
    return 1 if errors else 0


if __name__ == "__main__":
    sys.exit(main())
