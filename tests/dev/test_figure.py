#!/usr/bin/env python3
"""Prints how many tests of a CTest run passed, and exits with 1 when one was skipped or none ran.

Takes the file of `ctest --output-junit`. A test of CTest that runs a whole program counts as many
tests as the program says it ran.
"""

import re
import sys
import xml.etree.ElementTree

# What GoogleTest and JUnit print at the end.
PASSED = re.compile(r"^\[  PASSED  \] (\d+) tests?\.$|^\[ *(\d+) tests successful *\]$", re.M)
SKIPPED = re.compile(r"^\[  SKIPPED \] (\d+) tests?, listed below:$"
                     r"|^\[ *(\d+) tests (?:skipped|aborted) *\]$"
                     r"|YOU HAVE (\d+) DISABLED TESTS?", re.M)


def total(pattern, text):
    """The sum of the numbers that the pattern finds, or None when it finds none."""
    found = [int(next(filter(None, groups))) for groups in pattern.findall(text)]
    return sum(found) if found else None


def counts(case):
    """How many tests a testcase of the file stands for: (passed, skipped)."""
    text = case.findtext("system-out") or ""
    if case.get("status") != "run":
        return 0, 1
    passed, skipped = total(PASSED, text), total(SKIPPED, text)
    return (1 if passed is None else passed), skipped or 0


def main():
    if len(sys.argv) != 2:
        sys.exit("usage: test_figure.py FILE")
    try:
        cases = list(xml.etree.ElementTree.parse(sys.argv[1]).getroot().iter("testcase"))
    except (OSError, xml.etree.ElementTree.ParseError) as error:
        sys.exit(f"test_figure: {error}; CTest has not run the tests")
    passed = skipped = 0
    wrong = []
    for case in cases:
        passed_here, skipped_here = counts(case)
        passed += passed_here
        skipped += skipped_here
        if skipped_here:
            wrong.append(f"{case.get('name')}: {skipped_here} skipped; see its output, and give it "
                         "what it lacks")
        elif passed_here == 0:
            wrong.append(f"{case.get('name')}: ran no test")
    if not cases:
        wrong.append("no test ran")
    print(f"{passed:,} passed, {skipped} skipped")
    for line in wrong:
        print(f"test_figure: {line}", file=sys.stderr)
    return 1 if wrong else 0


if __name__ == "__main__":
    sys.exit(main())
