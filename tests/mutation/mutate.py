#!/usr/bin/env python3
"""Mutation testing: would the tests notice a small mistake in the library or the Java classes?

Each mutant is the library with one small deviation in one source: `<` for `<=`, a constant off by
one, left for right, a statement left out. It is built and tested, with the quickest tests first,
until one fails; cpp.py and java.py say how. Limits are processor time, so that a busy machine
changes nothing.

A mutant that no test notices has survived: either a test is missing, or no caller could tell the
mutant from the library. The latter are listed with their reasons in survivors.txt. Mutants that do
not compile do not count, nor do those whose objects are the original's ("same code"). One that
"hung" took longer than its limit, and counts as survived; it is "hung, proven" and killed when the
test in which it hung takes 100 times as long as without it, and 5 seconds at least.

The standard set is a part of all mutants that covers every file; --all takes all, --rest those
outside the standard set. Results are kept in results.tsv under --work, and --resume takes what still
holds from there; results.py says when. --report makes docs/mutation.md of them. Exits with 1 when a
survivor is not explained, or an explanation no longer fits. The tree that holds this script is read
only; everything is written under --work.
"""

import argparse
import collections
import fcntl
import fnmatch
import pathlib
import queue
import random
import re
import sys
import threading
import time

sys.dont_write_bytecode = True  # the tree is read only
import cpp
import java
import report
from mutants import LEFT_FOR_LATER, NO_TEST, PROCESSORS, ROOT, all_mutants, description, key, plain
from mutants import processor_of, standard_set, title
from results import ALIVE, KEPT, KILLED, Results, state
from steps import StepFailed

SURVIVORS = pathlib.Path(__file__).resolve().parent / "survivors.txt"
HOLDS = {  # what a line 'holds:' may say, and for which of PROCESSORS it is true
    "": {"x86-64", "AArch64", "s390x"},
    "64-bit": {"x86-64", "AArch64", "s390x"},
    "little-endian": {"x86-64", "AArch64"},
    "x86-64": {"x86-64"},
    "AArch64": {"AArch64"},
    "big-endian": {"s390x"},
}
CHUNK = 20  # mutants that a worker takes at a time

# --- explained survivors --------------------------------------------------------------------------


class Explanation:
    """Why a mutant makes no difference, and on which processors."""

    def __init__(self):
        self.reason = ""
        self.holds = ""

    def on(self, processor):
        return processor in HOLDS[self.holds]


def read_survivors(path):
    """Explanations by key. survivors.txt says how it is written."""
    explained = {}
    place = None
    changes = []  # that share the next reason
    explanation = Explanation()

    def keep():
        for change in changes:
            explained[place + (change,)] = explanation
        if changes and not explanation.reason:
            sys.exit(f"{path}: no reason for {changes[-1]} in {place[0]}: {place[2]}")

    for number, line in enumerate(path.read_text().split("\n"), 1):
        indent = len(line) - len(line.lstrip())
        if not line.strip() or line.startswith("#"):
            continue
        if indent < 4 and (explanation.reason or explanation.holds):
            keep()
            changes, explanation = [], Explanation()
        if indent == 0:
            keep()
            match = re.fullmatch(r"([^:@]+)(?:@(\d+))?: (.*)", line)
            if not match:
                sys.exit(f"{path}:{number}: expected 'file: line of source'")
            place = (match[1], int(match[2] or 1), plain(match[3]))
        elif indent == 2:
            changes.append(plain(line))
        elif line.strip().startswith("holds: "):
            explanation.holds = line.strip().removeprefix("holds: ")
            if explanation.holds not in HOLDS:
                sys.exit(f"{path}:{number}: '{explanation.holds}' is none of {list(HOLDS)[1:]}")
        else:
            explanation.reason = plain(explanation.reason + " " + line)
    keep()
    return explained


def explains(explained, mutant):
    """Whether a mutant is explained for the processor that it runs on."""
    return key(mutant) in explained and explained[key(mutant)].on(processor_of(mutant))


# --- the run --------------------------------------------------------------------------------------


class Run:
    """All chosen mutants, spread over workers."""

    def __init__(self, mutants, results, work, workers, minutes):
        self.mutants = mutants
        self.results = results
        self.work = work
        self.workers = workers
        self.end = time.monotonic() + 60 * minutes
        self.rows = {}  # mutant -> row
        self.seconds = 0
        self.errors = []
        self.lock = threading.Lock()
        self.chunks = queue.Queue()
        for chunk in self.in_chunks():
            self.chunks.put(chunk)

    def in_chunks(self):
        """Mutants of one file together. Headers and what is emulated come late, since they take long;
        last what ran before, of which most will survive again."""
        groups = collections.defaultdict(list)
        for mutant in self.mutants:
            emulated = list(PROCESSORS).index(processor_of(mutant))
            kind = [".cpp", ".h", ".java"].index(pathlib.Path(mutant.file).suffix)
            before = key(mutant) in self.results.rows
            groups[before, emulated, kind, mutant.file].append(mutant)
        for _, group in sorted(groups.items()):
            for i in range(0, len(group), CHUNK):
                yield group[i:i + CHUNK]

    def worker(self, number):
        trials = {}
        try:
            while True:
                for mutant in self.chunks.get_nowait():
                    if time.monotonic() > self.end or self.errors:
                        return
                    language = java if mutant.file.endswith(".java") else cpp
                    if language not in trials:
                        trials[language] = language.Trial(self.original(language),
                                                          self.work / f"worker-{number}")
                    fate = trials[language].fate(mutant)
                    with self.lock:
                        self.rows[mutant] = self.results.add(mutant, fate)
                        self.seconds += fate.seconds
        except queue.Empty:
            pass
        except Exception as error:  # shown by the main thread
            self.errors.append(error)
        finally:
            for trial in trials.values():
                trial.end()

    def original(self, language):
        """What the workers share of a language, made when it is needed."""
        with self.making:
            if language not in self.originals:
                original = language.Original(self.work)
                original.prepare()
                self.originals[language] = original
            return self.originals[language]

    def go(self):
        """Runs everything and returns the row of each mutant."""
        self.results.open({m.file for m in self.mutants})
        say("building what the mutants need, and running the tests without a mutant")
        self.originals = {}
        self.making = threading.Lock()
        self.started = time.monotonic()
        threads = [threading.Thread(target=self.worker, args=[n], daemon=True)
                   for n in range(self.workers)]
        for thread in threads:
            thread.start()
        while any(thread.is_alive() for thread in threads):
            self.wait_and_say(threads)
        if self.errors:
            raise self.errors[0]
        return self.rows

    def wait_and_say(self, threads):
        until = time.monotonic() + 60
        while time.monotonic() < until and any(thread.is_alive() for thread in threads):
            time.sleep(0.2)
        done = len(self.rows)
        if not done:
            return
        left = (time.monotonic() - self.started) / done * (len(self.mutants) - done)
        alive = sum(row.fate in ALIVE for row in self.rows.values())
        say(f"{done} of {len(self.mutants)} mutants, {alive} alive, {self.seconds / done:.2f} "
            f"processor seconds each, about {left / 60:.0f} minutes left")


def say(text):
    print(text, flush=True)


# --- the outcome ----------------------------------------------------------------------------------


def show(heading, mutants):
    if mutants:
        say(heading)
    for mutant in mutants:
        again = f"@{mutant.line_number_among_alike}" if mutant.line_number_among_alike > 1 else ""
        say(f"  {title(mutant)}\n    as in survivors.txt:\n"
            f"{mutant.file}{again}: {mutant.line_text}\n  {description(mutant)}")


def print_outcome(rows, explained, everything):
    """Prints what became of the mutants. Returns figures and whether all is in order."""
    count = collections.Counter(row.fate for row in rows.values())
    alive = [m for m, row in rows.items() if row.fate in ALIVE]
    unexplained = [m for m in alive if not explains(explained, m)]
    wrongly_explained = [m for m, row in rows.items() if key(m) in explained
                         and row.fate not in ALIVE + ["same code"]]
    known = {key(m) for m in everything}
    stale = [entry for entry in explained if entry not in known]

    killed = sum(count[fate] for fate in KILLED)
    say(f"\n{killed + len(alive)} mutants that compile, and not to the same code")
    for fate in KILLED:
        say(f"  {count[fate]:5}  killed: {fate}")
    say(f"  {len(alive) - len(unexplained):5}  not killed, explained")
    for fate in ALIVE:
        say(f"  {sum(rows[m].fate == fate for m in unexplained):5}  {fate}, not explained")
    say(f"and {count['same code']} of the same code, {count['does not compile']} that do not compile")

    show("\nNo test notices these mutants, and survivors.txt does not explain why:", unexplained)
    show("\nExplained in survivors.txt, yet a test notices them:", wrongly_explained)
    if stale:
        say("\nNo longer in the sources, but in survivors.txt:")
    for file, number, line, change in stale:
        say(f"  {file}{'@' + str(number) if number > 1 else ''}: {line}\n    {change}")
    in_order = not (unexplained or wrongly_explained or stale)
    return killed, killed + len(alive), in_order, unexplained


def write_summary(path, killed, counted, in_order, unexplained, left):
    limit = "every survivor explained"
    if left:
        limit += f", {left} mutants left"
    if unexplained:
        limit += f", {len(unexplained)} not"
    elif not in_order:
        limit += ", survivors.txt out of date"
    with open(path, "a") as file:
        file.write(f"mutation\t{killed} of {counted} mutants killed\t{limit}\n")


def positive(text):
    number = int(text)
    if number < 1:
        raise argparse.ArgumentTypeError(f"{number} is below 1")
    return number


def read_arguments():
    parser = argparse.ArgumentParser(description="Mutation testing of the library.")
    parser.add_argument("--all", action="store_true", help="all mutants, not the standard set")
    parser.add_argument("--rest", action="store_true", help="those outside the standard set")
    parser.add_argument("--files", metavar="GLOB", help="only sources that match, e.g. 'render/*'")
    parser.add_argument("--only", metavar="TEXT", action="append",
                        help="only mutants with TEXT in their name; may be given again")
    parser.add_argument("--sample", type=positive, metavar="N", help="N of these, drawn at random")
    parser.add_argument("--seed", type=int, default=1, metavar="S", help="draws the sample")
    parser.add_argument("--resume", action="store_true",
                        help="take from earlier runs what still holds")
    parser.add_argument("--minutes", type=positive, default=1 << 30, metavar="N",
                        help="stop after so many, keeping what is done")
    parser.add_argument("--workers", type=positive, default=2, metavar="N",
                        help="at a time (default 2)")
    parser.add_argument("--report", action="store_true",
                        help="write tables and page of the results that there are")
    parser.add_argument("--check", action="store_true",
                        help="with --report: write nothing, fail when the page does not fit")
    parser.add_argument("--list", action="store_true", help="list the mutants and stop")
    parser.add_argument("--work", default=ROOT / "build" / "mutation", type=pathlib.Path,
                        metavar="DIR", help="copies, builds and results (default build/mutation)")
    parser.add_argument("--summary", type=pathlib.Path, metavar="FILE",
                        help="append 'mutation<TAB>figure<TAB>limit' to FILE")
    arguments = parser.parse_args()
    if arguments.check and not arguments.report:
        parser.error("--check goes with --report")
    return arguments


def chosen(everything, arguments):
    runnable = [m for m in everything if m.file not in NO_TEST and processor_of(m)]
    standard = standard_set(runnable)
    mutants = [m for m in runnable
               if arguments.all or (key(m) in standard) != arguments.rest]
    if arguments.files:
        mutants = [m for m in mutants if fnmatch.fnmatch(m.file, arguments.files)]
    if arguments.only:
        mutants = [m for m in mutants if any(text in title(m) for text in arguments.only)]
    if not (arguments.files or arguments.only):
        mutants = [m for m in mutants if m.file not in LEFT_FOR_LATER]
    if arguments.sample is not None and arguments.sample < len(mutants):
        mutants = random.Random(arguments.seed).sample(mutants, arguments.sample)
    return mutants


def write_report(everything, explained, work):
    work.mkdir(parents=True, exist_ok=True)
    results = Results(work / "results.tsv")
    if not results.rows:
        sys.exit(f"there are no results in {work} to report")
    new = report.table_of(everything, results, lambda m: explains(explained, m))
    table, alive = report.merged(*new, *report.read_tables(), explained)
    report.write_tables(table, alive)
    results.keep()
    table, alive = report.read_tables()
    report.PAGE.write_text(report.page_of(table, alive, narrow(explained)))
    say(f"written: {KEPT}, {report.TABLE}, {report.UNEXPLAINED}, {report.PAGE}")
    return 0


def check_report(explained):
    table, alive = report.read_tables()
    faults = report.faults(table, alive, explained, report.page_of(table, alive, narrow(explained)))
    for fault in faults:
        say(fault)
    older = [line["file"] for line in table.values()
             if (ROOT / line["file"]).exists() and line["state"] != state(line["file"])]
    if older:
        say(f"changed since they were run: {', '.join(older)}")
    return 1 if faults else 0


def narrow(explained):
    return [(entry, e.holds) for entry, e in explained.items() if e.holds]


def main():
    arguments = read_arguments()
    if arguments.report and arguments.check:
        return check_report(read_survivors(SURVIVORS))
    everything = all_mutants()
    if arguments.report:
        return write_report(everything, read_survivors(SURVIVORS), arguments.work.resolve())
    mutants = chosen(everything, arguments)
    if arguments.list:
        for mutant in mutants:
            print(title(mutant))
        return 0
    if not mutants:
        sys.exit("no such mutants")
    explained = read_survivors(SURVIVORS)
    work = arguments.work.resolve()
    work.mkdir(parents=True, exist_ok=True)
    lock = open(work / "lock", "w")
    try:
        fcntl.flock(lock, fcntl.LOCK_EX | fcntl.LOCK_NB)
    except OSError:
        sys.exit(f"another run is at work in {work}")

    results = Results(work / "results.tsv")
    rows = {}
    if arguments.resume:
        known = {m: results.known(m) for m in mutants}
        rows = {m: row for m, row in known.items() if row}
        say(f"{len(rows)} of {len(mutants)} mutants are known from earlier runs")
    left = [m for m in mutants if m not in rows]
    say(f"{len(left)} of {len(everything)} mutants to run, {arguments.workers} at a time, in {work}")
    if left:
        try:
            rows |= Run(left, results, work, arguments.workers, arguments.minutes).go()
        except StepFailed as error:
            sys.exit(str(error))
    killed, counted, in_order, unexplained = print_outcome(rows, explained, everything)
    left_over = len(mutants) - len(rows)
    if left_over:
        say(f"\n{left_over} mutants are left for a run with --resume")
    if not counted:
        sys.exit("no mutant that compiles was run: give it more --minutes, or other --files")
    if arguments.summary:
        write_summary(arguments.summary, killed, counted, in_order, unexplained, left_over)
    return 0 if in_order else 1


if __name__ == "__main__":
    sys.exit(main())
