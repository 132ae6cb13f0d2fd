#!/usr/bin/env python3
"""Runs the commands that the project's pages show, but for those that .ci/run or ./dev weekly runs.

A command counts as run there when it has the same verb of ./dev and no option that the line there
lacks. What would take too long as it stands is run in a form of its own; SHORTER says in which
and why. Exits with 1 when a command fails.
"""

import re
import shlex
import subprocess
import sys

sys.dont_write_bytecode = True
from pages import ROOT, commands  # noqa: E402

# What is run in place of a command whose beginning is this.
SHORTER = {
    # Minutes, and other libraries, for figures that nobody reads here.
    "./dev bench": "./dev bench --no-peers --repetitions 1 --filter 'object box'",
    # It takes a script; any will do.
    "./dev play": "./dev play desktop/scripts/fig.strokes --out out/play",
    # They need a display; the test opens the same windows on one of its own.
    "./dev window": "./dev screen",
    # A quarter of an hour for more cases of the same kind.
    "./dev same-bits --size long": "./dev same-bits",
    # They need an NDK; the test hands them what looks like one.
    "cmake --preset android-": "./dev test -R '^android_presets$'",
    "cmake --build --preset android-": "./dev test -R '^android_presets$'",
    # It would rewrite a page; without it the same is measured and compared.
    "./dev binary --update": "./dev binary",
}


def options(command):
    return {word for word in shlex.split(command) if word.startswith("--")}


def regular_commands():
    """The lines of .ci/run, and those of ./dev weekly with itself."""
    ci = re.findall(r"^(\./dev .*)", (ROOT / ".ci/run").read_text(encoding="utf-8"), re.M)
    weekly = re.findall(r"^    (\./dev .*) \|\| ", (ROOT / "dev").read_text(encoding="utf-8"), re.M)
    for lines, place in ((ci, ".ci/run"), (weekly, "the weekly command of dev")):
        if not lines:
            sys.exit(f"no command was found in {place}, expected lines ./dev COMMAND")
    return [*ci, *weekly, "./dev weekly"]


def runs_regularly(command, regular):
    return any(shlex.split(line)[:2] == shlex.split(command)[:2] and
               options(command) <= options(line) for line in regular)


def shortened(command):
    for beginning, other in SHORTER.items():
        if command.startswith(beginning):
            command = other
    return re.sub(r"--seconds \d+", "--seconds 8", command)


def main():
    regular = regular_commands()
    done = set()
    failed = []
    for command, page in commands().items():
        form = shortened(command)
        if runs_regularly(form, regular):
            print(f"{page}: {command}: run by .ci/run or ./dev weekly", flush=True)
            continue
        print(f"{page}: {command}: running {'it' if form == command else form}", flush=True)
        if form in done:
            continue
        done.add(form)
        run = subprocess.run(form, shell=True, cwd=ROOT, stdout=subprocess.PIPE,
                             stderr=subprocess.STDOUT, text=True)
        if run.returncode != 0:
            failed.append(command)
            print(run.stdout[-3000:], file=sys.stderr)
            print(f"{page}: {command}: failed with status {run.returncode}", file=sys.stderr)
    if not done:
        print("no command was found in any page", file=sys.stderr)
        return 1
    print(f"{len(commands())} commands in the pages, {len(done)} run here, {len(failed)} failed")
    return 1 if failed else 0


if __name__ == "__main__":
    sys.exit(main())
