#!/usr/bin/env python3
"""Compares the digests of several builds of the library with the committed ones.

Each build has programs that print a line "name cases digest" for each family of calls, or a line
"digest DIGEST FILE" for each stroke script. All builds must give the same, and what digests.txt says.
"""

import argparse
import concurrent.futures
import os
import pathlib
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


def measure(build):
    """Runs the commands of a build and returns its rows; ends the check when one fails."""
    label, commands = build
    rows = {}
    for command in commands:
        result = subprocess.run(shlex.split(command), stdout=subprocess.PIPE, text=True)
        if result.returncode != 0:
            sys.exit(f"same_bits: {label}: '{command}' failed:\n{result.stdout}")
        for line in result.stdout.splitlines():
            words = line.split()
            if words[0] == "digest":
                rows[pathlib.Path(words[2]).stem + ".strokes"] = ("1", words[1])
            else:
                rows[words[0]] = (words[1], words[2])
    print(f"measured {label}", flush=True)
    return label, rows


def print_comparison(expected, builds):
    """Prints what was measured beside what is committed; returns how many families differ."""
    differing = 0
    print(f"{'family':16} {'cases':>8}  {'committed':16}  {'measured':16}  builds that agree")
    for family in {**expected, **builds[0][1]}:
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
    for build in arguments.builds:
        label, _, commands = build.partition("=")
        builds.append((label, commands.replace("{size}", arguments.size).split(";")))
    with concurrent.futures.ThreadPoolExecutor(os.cpu_count()) as pool:
        measured = list(pool.map(measure, builds))

    if arguments.update:
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
