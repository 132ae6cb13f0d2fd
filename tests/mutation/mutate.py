#!/usr/bin/env python3
"""Mutation testing: would the tests notice a small mistake in the library?

Each mutant is the library with one small deviation in one source: `<` for `<=`, a constant off by
one, left for right, a statement left out. A copy of the sources is built with it, and the tests
run, the quickest first, until one fails:

  unit tests     cpp_tests in one process
  differential   a short comparison with the slow models
  sanitized      the unit tests once more, with AddressSanitizer and UndefinedBehaviorSanitizer

A mutant that none of them notices has survived: either a test is missing, or no caller could tell
the mutant from the library. The latter are listed with their reasons in survivors.txt. Mutants that
do not compile do not count, nor do those whose object files are the original's ("same code").

The standard set is a part of all mutants that covers every file; --all takes all, --rest those
outside the standard set. Exits with 1 when a survivor is not explained, or an explanation no longer
fits. The tree that holds this script is read only; everything is written under --work.
"""

import argparse
import collections
import fnmatch
import hashlib
import os
import pathlib
import queue
import random
import re
import resource
import shutil
import signal
import subprocess
import sys
import threading
import time

sys.dont_write_bytecode = True  # the tree is read only
from mutants import FOLDERS, ROOT, all_mutants, description, key, library_files, plain
from mutants import standard_set, title

SURVIVORS = pathlib.Path(__file__).resolve().parent / "survivors.txt"
COPIED = FOLDERS + ["cmake", "tests", "CMakeLists.txt", "draventaUtil.h", "exports.txt"]

UNIT_SECONDS = 20
DIFFERENTIAL_SECONDS = 3
SANITIZED_SECONDS = 60
MEMORY_LIMIT = 4 << 30
CHUNK = 20  # mutants that a worker takes at a time

# --- explained survivors --------------------------------------------------------------------------


def read_survivors(path):
    """Explained survivors, by key. survivors.txt says how it is written."""
    explained = {}
    place = None
    changes = []  # that share the next reason
    reason = ""

    def keep():
        for change in changes:
            explained[place + (change,)] = reason
        if changes and not reason:
            sys.exit(f"{path}: no reason for {changes[-1]} in {place[0]}: {place[2]}")

    for number, line in enumerate(path.read_text().split("\n"), 1):
        indent = len(line) - len(line.lstrip())
        if not line.strip() or line.startswith("#"):
            continue
        if indent < 4 and reason:
            keep()
            changes, reason = [], ""
        if indent == 0:
            keep()
            match = re.fullmatch(r"([^:@]+)(?:@(\d+))?: (.*)", line)
            if not match:
                sys.exit(f"{path}:{number}: expected 'file: line of source'")
            place = (match[1], int(match[2] or 1), plain(match[3]))
        elif indent == 2:
            changes.append(plain(line))
        else:
            reason = plain(reason + " " + line)
    keep()
    return explained


# --- building and testing -------------------------------------------------------------------------

# A changed header means most tests anew. Precompiled headers make that quicker, and a small program
# with the tests of that header alone, made first, mostly saves it.
CMAKE_EXTRA = """
cmake_language(DEFER CALL target_precompile_headers cpp_tests PRIVATE
               <gmock/gmock.h> <gtest/gtest.h>)

function(add_header_tests stem)
  find_package(GTest REQUIRED)
  file(GLOB helpers ${PROJECT_SOURCE_DIR}/tests/helpers/*.cpp)
  list(TRANSFORM ARGN PREPEND ${PROJECT_SOURCE_DIR}/ OUTPUT_VARIABLE tests)
  add_executable(${stem}_tests EXCLUDE_FROM_ALL ${tests} ${helpers})
  target_compile_options(${stem}_tests PRIVATE -O0)
  target_link_libraries(${stem}_tests PRIVATE draventa_core counted_allocations GTest::gmock
                        GTest::gtest_main)
endfunction()
"""

TESTS_OF_HEADERS = {  # those that have no test of their own name
    "jni/java_access.h": ["tests/jni/Util_drawing_test.cpp", "tests/jni/Util_selection_test.cpp"],
    "selection/lasso_values.h": ["tests/selection/lasso_segment_test.cpp",
                                 "tests/selection/region_fill_lasso_test.cpp"],
}


def header_tests():
    """Header -> test sources that name it first."""
    found = dict(TESTS_OF_HEADERS)
    for file in library_files():
        test = f"tests/{file[:-2]}_test.cpp"
        if file.endswith(".h") and (ROOT / test).exists():
            found[file] = [test]
    return found


def cmake_extra():
    calls = (f"cmake_language(DEFER CALL add_header_tests {pathlib.Path(header).stem} "
             f"{' '.join(tests)})\n" for header, tests in header_tests().items())
    return CMAKE_EXTRA + "".join(calls)


BUILDS = {  # folder -> CMake arguments
    "plain": ["-DCMAKE_CXX_FLAGS=-O1 -Werror=return-type"],
    "sanitized": ["-DCMAKE_CXX_FLAGS=-O1 -Werror=return-type",
                  "-DDRAVENTA_SANITIZERS=address,undefined,float-cast-overflow"],
}

ENVIRONMENT = dict(os.environ, ASAN_OPTIONS="allocator_may_return_null=1",
                   UBSAN_OPTIONS="halt_on_error=1")


class StepFailed(Exception):
    """A step that has to succeed did not."""


def resident_bytes(pid):
    """Memory that a process occupies, 0 once it has ended."""
    try:
        pages = pathlib.Path(f"/proc/{pid}/statm").read_text().split()[1]
    except (OSError, IndexError):
        return 0
    return int(pages) * os.sysconf("SC_PAGE_SIZE")


def run(command, seconds):
    """Runs a command in a process group of its own.

    True, False, or None when time ran out. One that takes all memory has failed; the address space
    says nothing, since some tests map sparse gigabytes.
    """
    def limit_time():  # for the case that this script ends before the command
        resource.setrlimit(resource.RLIMIT_CPU, (seconds + 1, seconds + 1))

    process = subprocess.Popen(command, stdin=subprocess.DEVNULL, stdout=subprocess.DEVNULL,
                               stderr=subprocess.DEVNULL, env=ENVIRONMENT, preexec_fn=limit_time,
                               start_new_session=True)
    end = time.monotonic() + seconds
    try:
        while time.monotonic() < end:
            try:
                return process.wait(0.25) == 0
            except subprocess.TimeoutExpired:
                if resident_bytes(process.pid) > MEMORY_LIMIT:
                    return False
        return None
    finally:
        if process.poll() is None:
            os.killpg(process.pid, signal.SIGKILL)
            process.wait()


class Workshop:
    """A copy of the sources with its build folders, for one mutant after the other."""

    def __init__(self, folder):
        self.source = folder / "source"
        self.builds = {name: folder / name for name in BUILDS}
        self.mutated = None

    def prepare(self):
        """Copies, builds and tests the library as it is."""
        for name in COPIED:
            self.copy(name)
        extra = self.source.parent / "extra.cmake"
        if not extra.exists() or extra.read_text() != cmake_extra():
            extra.write_text(cmake_extra())
        for name, build in self.builds.items():
            command = ["cmake", "-S", self.source, "-B", build, "-G", "Ninja",
                       "-DDRAVENTA_JAVA=OFF", f"-DCMAKE_PROJECT_INCLUDE={extra}", *BUILDS[name]]
            if not run(command, 120) or not self.build(name, "cpp_tests"):
                raise StepFailed(f"building {build} failed")
        if not self.build("plain", "differential"):
            raise StepFailed("building the differential program failed")
        for stage, test in self.stages():
            if not test():
                raise StepFailed(f"{stage}: not green without a mutant")
        self.original = {scope: self.objects(scope) for scope in ("draventa_core", "cpp_tests")}

    def copy(self, name):
        """Brings one file or folder of the copy up to date; what is equal keeps its time stamp."""
        paths = sorted((ROOT / name).rglob("*")) if (ROOT / name).is_dir() else [ROOT / name]
        files = {p.relative_to(ROOT) for p in paths if p.is_file()}
        present = (self.source / name).rglob("*") if (self.source / name).is_dir() else []
        for old in [p for p in present if p.is_file()]:
            if old.relative_to(self.source) not in files:
                old.unlink()
        for file in files:
            target = self.source / file
            content = (ROOT / file).read_bytes()
            if not target.exists() or target.read_bytes() != content:
                target.parent.mkdir(parents=True, exist_ok=True)
                target.write_bytes(content)

    def build(self, name, target):
        return run(["ninja", "-C", self.builds[name], "-j1", target], 600)

    def objects(self, scope):
        """Digests of the object files of a target."""
        files = sorted(self.builds["plain"].rglob(f"{scope}.dir/**/*.o"))
        return [hashlib.sha256(f.read_bytes()).digest() for f in files]

    def mutate(self, mutant):
        """Puts the mutant in place of the one before."""
        if self.mutated not in (None, mutant.file):
            shutil.copyfile(ROOT / self.mutated, self.source / self.mutated)
        text = (ROOT / mutant.file).read_text()
        changed = text[:mutant.start] + mutant.replacement + text[mutant.end:]
        (self.source / mutant.file).write_text(changed)
        self.mutated = mutant.file

    def stages(self):
        """The tests in their order, each with what builds and runs it."""
        unit = ["--gtest_brief=1", "--gtest_fail_fast"]
        plain_build, sanitized = self.builds["plain"], self.builds["sanitized"]

        def unit_tests():
            return run([plain_build / "tests/cpp_tests", *unit], UNIT_SECONDS)

        def differential():
            program = plain_build / "tests/differential/differential"
            return self.build("plain", "differential") and run(
                [program, "--seconds", str(DIFFERENTIAL_SECONDS)], 20 * DIFFERENTIAL_SECONDS)

        def sanitized_tests():
            return self.build("sanitized", "cpp_tests") and run(
                [sanitized / "tests/cpp_tests", *unit], SANITIZED_SECONDS)

        return [("unit tests", unit_tests), ("differential", differential),
                ("sanitized", sanitized_tests)]

    def header_tests_pass(self, header):
        """False when the tests of this header alone notice its mutant; True decides nothing."""
        target = pathlib.Path(header).stem + "_tests"
        return not self.build("plain", target) or run(
            [self.builds["plain"] / target, "--gtest_brief=1"], UNIT_SECONDS) is not False

    def fate(self, mutant):
        """'does not compile', 'same code', 'hung', 'survived', or the stage that noticed."""
        self.mutate(mutant)
        if not self.build("plain", "draventa_core"):
            return "does not compile"
        same_library = self.objects("draventa_core") == self.original["draventa_core"]
        if same_library and mutant.file.endswith(".cpp"):
            return "same code"
        if mutant.file in header_tests() and not self.header_tests_pass(mutant.file):
            return "unit tests"
        if not self.build("plain", "cpp_tests"):
            return "does not compile"
        if same_library and self.objects("cpp_tests") == self.original["cpp_tests"]:
            return "same code"
        for stage, test in self.stages():
            noticed = test()
            if noticed is None:
                return "hung"
            if not noticed:
                return stage
        return "survived"


# --- the run --------------------------------------------------------------------------------------


class Run:
    """All chosen mutants, spread over workers."""

    def __init__(self, mutants, work, workers):
        self.mutants = mutants
        self.work = work
        self.workers = workers
        self.fates = {}
        self.errors = []
        self.lock = threading.Lock()
        self.chunks = queue.Queue()
        for chunk in self.in_chunks():
            self.chunks.put(chunk)

    def in_chunks(self):
        """Mutants of one file together, since going on to another file means a rebuild of both.
        Headers come last, because they take longest."""
        groups = collections.defaultdict(list)
        for mutant in self.mutants:
            groups[mutant.file].append(mutant)
        for file in sorted(groups, key=lambda f: (f.endswith(".h"), f)):
            for i in range(0, len(groups[file]), CHUNK):
                yield groups[file][i:i + CHUNK]

    def worker(self, number):
        try:
            workshop = Workshop(self.work / f"worker-{number}")
            workshop.prepare()
            with self.lock:
                self.started = time.monotonic()
            while not self.errors:
                for mutant in self.chunks.get_nowait():
                    began = time.monotonic()
                    fate = workshop.fate(mutant)
                    with self.lock:
                        self.fates[mutant] = fate
                        self.results.write(f"{fate}\t{time.monotonic() - began:.1f}\t"
                                           f"{title(mutant)}\t{mutant.line_text}\n")
                        self.results.flush()
        except queue.Empty:
            pass
        except Exception as error:  # shown by the main thread
            self.errors.append(error)

    def go(self):
        """Runs everything and returns the fate of each mutant."""
        self.started = time.monotonic()
        threads = [threading.Thread(target=self.worker, args=[n], daemon=True)
                   for n in range(self.workers)]
        with open(self.work / "results.tsv", "w") as self.results:
            for thread in threads:
                thread.start()
            while any(thread.is_alive() for thread in threads):
                self.wait_and_say(threads)
        if self.errors:
            raise self.errors[0]
        return self.fates

    def wait_and_say(self, threads):
        until = time.monotonic() + 20
        while time.monotonic() < until and any(thread.is_alive() for thread in threads):
            time.sleep(0.2)
        done = len(self.fates)
        if not done:
            return say("building the library and its tests for each worker")
        left = (time.monotonic() - self.started) / done * (len(self.mutants) - done)
        alive = sum(fate == "survived" for fate in self.fates.values())
        say(f"{done} of {len(self.mutants)} mutants, {alive} survived, "
            f"about {left / 60:.0f} minutes left")


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


def report(fates, explained, everything, seconds):
    """Prints what became of the mutants. Returns figures and whether all is in order."""
    count = collections.Counter(fates.values())
    survivors = [m for m, fate in fates.items() if fate == "survived"]
    unexplained = [m for m in survivors if key(m) not in explained]
    killed_yet_explained = [m for m, fate in fates.items() if key(m) in explained
                            and fate not in ("survived", "same code")]
    known = {key(m) for m in everything}
    stale = [entry for entry in explained if entry not in known]

    counted = sum(n for fate, n in count.items() if fate not in ("does not compile", "same code"))
    killed = counted - count["survived"]
    say(f"\n{counted + count['same code']} mutants that compile, in {seconds / 60:.1f} minutes")
    for fate in ("unit tests", "hung", "differential", "sanitized", "same code"):
        say(f"  {count[fate]:5}  {fate}")
    say(f"  {len(survivors) - len(unexplained):5}  survived, explained")
    say(f"  {len(unexplained):5}  survived")
    say(f"and {count['does not compile']} that do not compile")

    show("\nNo test notices these mutants, and survivors.txt does not explain why:", unexplained)
    show("\nExplained in survivors.txt, yet a test notices them:", killed_yet_explained)
    if stale:
        say("\nNo longer in the sources, but in survivors.txt:")
    for file, number, line, change in stale:
        say(f"  {file}{'@' + str(number) if number > 1 else ''}: {line}\n    {change}")
    return killed, counted, not (unexplained or killed_yet_explained or stale), unexplained


def write_summary(path, killed, counted, in_order, unexplained):
    limit = "every survivor explained"
    if unexplained:
        limit += f", {len(unexplained)} not"
    elif not in_order:
        limit += ", survivors.txt out of date"
    with open(path, "a") as file:
        file.write(f"mutation\t{killed} of {counted} mutants killed\t{limit}\n")


def read_arguments():
    parser = argparse.ArgumentParser(description="Mutation testing of the library.")
    parser.add_argument("--all", action="store_true", help="all mutants, not the standard set")
    parser.add_argument("--rest", action="store_true", help="those outside the standard set")
    parser.add_argument("--files", metavar="GLOB", help="only sources that match, e.g. 'render/*'")
    parser.add_argument("--only", metavar="TEXT", action="append",
                        help="only mutants with TEXT in their name; may be given again")
    parser.add_argument("--sample", type=int, metavar="N", help="N of these, drawn at random")
    parser.add_argument("--seed", type=int, default=1, metavar="S", help="draws the sample")
    parser.add_argument("--workers", type=int, default=2, metavar="N", help="at a time (default 2)")
    parser.add_argument("--list", action="store_true", help="list the mutants and stop")
    parser.add_argument("--work", default=ROOT / "build" / "mutation", type=pathlib.Path,
                        metavar="DIR", help="copies and builds (default build/mutation)")
    parser.add_argument("--summary", type=pathlib.Path, metavar="FILE",
                        help="append 'mutation<TAB>figure<TAB>limit' to FILE")
    return parser.parse_args()


def chosen(everything, arguments):
    standard = standard_set(everything)
    mutants = [m for m in everything
               if arguments.all or (key(m) in standard) != arguments.rest]
    if arguments.files:
        mutants = [m for m in mutants if fnmatch.fnmatch(m.file, arguments.files)]
    if arguments.only:
        mutants = [m for m in mutants if any(text in title(m) for text in arguments.only)]
    if arguments.sample is not None and arguments.sample < len(mutants):
        mutants = random.Random(arguments.seed).sample(mutants, arguments.sample)
    return mutants


def main():
    arguments = read_arguments()
    everything = all_mutants()
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
    say(f"{len(mutants)} of {len(everything)} mutants, {arguments.workers} at a time, in {work}")
    began = time.monotonic()
    try:
        fates = Run(mutants, work, arguments.workers).go()
    except StepFailed as error:
        sys.exit(str(error))
    killed, counted, in_order, unexplained = report(fates, explained, everything,
                                                    time.monotonic() - began)
    if arguments.summary:
        write_summary(arguments.summary, killed, counted, in_order, unexplained)
    return 0 if in_order else 1


if __name__ == "__main__":
    sys.exit(main())
