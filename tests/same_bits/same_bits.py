#!/usr/bin/env python3
"""Compares the digests of several builds of the library with the committed ones.

Each build has programs that print a line "name cases digest" for each family of calls, or a line
"digest DIGEST  FILE" for each stroke script. All builds must give the same, and what digests.txt says.
"""

import argparse
import concurrent.futures
import os
import pathlib
import re
import shlex
import subprocess
import sys

TABLE = pathlib.Path(__file__).with_name("digests.txt")
HEAD = """\
# Digests of what the library returns and draws, the same for every processor, compiler,
# optimisation and place of the buffers. Read and, with --update, written by same_bits.py.
#
# size  family  cases  digest
"""


def read_table(size):
    """Returns the committed rows of a size: {family: (cases, digest)}, in order."""
    rows = {}
    if TABLE.exists():
        for line in TABLE.read_text().splitlines():
            words = line.split("#")[0].split()
            if words and words[0] == size:
                rows[words[1]] = (words[2], words[3])
    return rows


def write_table(size, measured):
    """Replaces the committed rows of a size."""
    tables = {s: read_table(s) for s in ("short", "long")}
    tables[size] = measured
    lines = [f"{s:5}  {family:16} {cases:>8}  {digest}\n"
             for s, rows in tables.items() for family, (cases, digest) in rows.items()]
    TABLE.write_text(HEAD + "".join(lines))


def read_digest(line):
    """Reads a line that a program prints: (family, (cases, digest)). The latter is None if it is no
    digest of at least one case."""
    script = re.fullmatch(r"digest ([0-9A-F]{8})  (.+)", line)
    if script:
        return pathlib.Path(script[2]).stem + ".strokes", ("1", script[1])
    family = re.fullmatch(r"(\S+) ([1-9]\d*) ([0-9a-f]{16})", line)
    return (family[1], (family[2], family[3])) if family else ("", None)


def measure(build):
    """Runs the commands of a build and returns its rows; ends the check when one fails."""
    label, commands = build
    rows = {}
    for command in commands:
        try:
            result = subprocess.run(shlex.split(command), stdout=subprocess.PIPE, text=True)
        except OSError as error:
            sys.exit(f"same_bits: {label}: '{command}' cannot be run ({error.strerror}); build it")
        if result.returncode != 0:
            sys.exit(f"same_bits: {label}: '{command}' failed:\n{result.stdout}")
        if not result.stdout.strip():
            sys.exit(f"same_bits: {label}: '{command}' printed no digest; build it anew")
        for line in result.stdout.splitlines():
            family, row = read_digest(line)
            if row is None:
                sys.exit(f"same_bits: {label}: '{command}' printed no digest but '{line}'")
            rows[family] = row
    print(f"measured {label}", flush=True)
    return label, rows


def families_of(builds):
    """Every family that a build has, in order."""
    return {family: None for _, rows in builds for family in rows}


def disagreements(builds):
    """A line for each family in which the builds differ."""
    lines = []
    for family in families_of(builds):
        by_row = {}
        for label, rows in builds:
            by_row.setdefault(rows.get(family, ("-", "nothing")), []).append(label)
        if len(by_row) > 1:
            lines.append(f"{family}: " + "; ".join(
                f"{digest} from {', '.join(labels)}" for (_, digest), labels in by_row.items()))
    return lines


def print_comparison(expected, builds):
    """Prints what was measured beside what is committed; returns how many families differ."""
    differing = 0
    print(f"{'family':16} {'cases':>8}  {'committed':16}  {'measured':16}  builds that agree")
    for family in {**expected, **families_of(builds)}:
        cases, committed = expected.get(family, ("-", "-"))
        others = [label for label, rows in builds if rows.get(family) != (cases, committed)]
        measured = sorted({rows.get(family, ("-", "-"))[1] for _, rows in builds})
        print(f"{family:16} {cases:>8}  {committed:16}  {' '.join(measured):16}  "
              f"{len(builds) - len(others)} of {len(builds)}"
              + (f"; not {', '.join(others)}" if others else ""))
        differing += bool(others)
    return differing


def main():
    parser = argparse.ArgumentParser(description=__doc__)
    parser.add_argument("builds", nargs="+", metavar="LABEL=COMMAND[;COMMAND]",
                        help="programs that print digests; {size} in a command becomes the size")
    parser.add_argument("--size", choices=("short", "long"), default="short")
    parser.add_argument("--update", action="store_true",
                        help="commit what is measured, if all builds agree")
    parser.add_argument("--summary", help="file to append the row of the final table to")
    arguments = parser.parse_args()

    builds = []
    if len(arguments.builds) < 2:
        parser.error("one build has nothing to agree with; name two or more")
    for build in arguments.builds:
        label, _, commands = build.partition("=")
        if not commands.strip():
            parser.error(f"'{build}' has no command; it reads LABEL=COMMAND")
        builds.append((label, commands.replace("{size}", arguments.size).split(";")))
    with concurrent.futures.ThreadPoolExecutor(os.cpu_count()) as pool:
        measured = list(pool.map(measure, builds))

    if arguments.update:
        lines = disagreements(measured)
        if lines:
            sys.exit("\n".join(lines) + "\nsame_bits: the builds disagree, so "
                     f"{TABLE.name} stays as it was; mend what differs first")
        write_table(arguments.size, measured[0][1])
    expected = read_table(arguments.size)
    differing = print_comparison(expected, measured)
    if arguments.summary:
        cases = sum(int(cases) for cases, _ in expected.values())
        with open(arguments.summary, "a") as summary:
            summary.write(f"same bits everywhere\t{len(expected) - differing} of {len(expected)} "
                          f"digests ({cases:,} cases) equal on {len(measured)} builds\tall\n")
    if differing:
        sys.exit(f"same_bits: {differing} digests differ from {TABLE.name}")


if __name__ == "__main__":
    main()
