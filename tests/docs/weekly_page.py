#!/usr/bin/env python3
"""Writes what a weekly run found into a page, between two marks, with its date and machine.

Takes the tables that the commands of ./dev fill: a row a check (check, figure, limit, command) and a
row a command (command, seconds). What failed comes first. A table without rows, or a page without the
marks, is an error.
"""

import argparse
import datetime
import os
import pathlib
import platform
import re
import subprocess
import sys

BEGIN = "<!-- begin: written by ./dev weekly -->\n"
LOST = re.compile(r"failed with status |not checked: ")  # as ./dev has it
END = "<!-- end: written by ./dev weekly -->\n"


def rows(path, columns):
    """The rows of a table with tabs."""
    found = [line.split("\t") for line in path.read_text(encoding="utf-8").splitlines()]
    if not found:
        sys.exit(f"weekly_page: {path} has no rows: nothing was checked")
    for row in found:
        if len(row) != columns:
            sys.exit(f"weekly_page: {path}: expected {columns} columns: {row}")
    return found


def output_of(*command):
    return subprocess.run(command, check=True, capture_output=True, text=True).stdout.strip()


def processor():
    match = re.search(r"^model name\s*: (.*)$", pathlib.Path("/proc/cpuinfo").read_text(), re.M)
    return match[1] if match else platform.machine()


def state():
    """The commit that was checked, and whether the tree held anything else."""
    changed = output_of("git", "status", "--porcelain", "--untracked-files=no")
    return output_of("git", "rev-parse", "--short", "HEAD") + (" with changes" if changed else "")


def duration(seconds):
    return f"{seconds // 60}:{seconds % 60:02}"


def table(head, body):
    lines = [head, ["---"] * len(head), *body]
    return "".join("| " + " | ".join(cell.replace("|", "\\|") for cell in line) + " |\n"
                   for line in lines)


def text(checks, commands):
    """What stands between the marks."""
    failed = [check for check in checks if LOST.match(check[1])]
    held = [check for check in checks if not LOST.match(check[1])]
    total = sum(int(seconds) for _, seconds in commands)
    return (
        f"Run on {datetime.date.today()}, state {state()}, {os.cpu_count()} cores of {processor()}, "
        f"{duration(total)} minutes in all.\n\n"
        + table(["check", "figure", "limit"], [check[:3] for check in failed + held]) + "\n"
        + table(["command", "minutes"],
                [[f"`./dev {command}`", duration(int(seconds))] for command, seconds in commands]))


def main():
    parser = argparse.ArgumentParser(description=__doc__.splitlines()[0])
    parser.add_argument("checks", type=pathlib.Path, help="table of checks")
    parser.add_argument("commands", type=pathlib.Path, help="table of times")
    parser.add_argument("page", type=pathlib.Path, help="page with the marks")
    arguments = parser.parse_args()

    page = arguments.page.read_text(encoding="utf-8")
    before, begin, rest = page.partition(BEGIN)
    _, end, after = rest.partition(END)
    if not begin or not end:
        sys.exit(f"weekly_page: {arguments.page} has no '{BEGIN.strip()}' before '{END.strip()}'")
    written = text(rows(arguments.checks, 4), rows(arguments.commands, 2))
    arguments.page.write_text(before + begin + written + end + after, encoding="utf-8")


if __name__ == "__main__":
    main()
