#!/usr/bin/env python3
"""The engine on a tiny library whose mutants have known fates, and on programs that hang."""

import pathlib
import shutil
import sys
import tempfile
import unittest

sys.dont_write_bytecode = True
FOLDER = pathlib.Path(__file__).resolve().parent
sys.path.insert(0, str(FOLDER.parent))
import cpp
import mutants
import processes
from steps import Settled


class Limits(unittest.TestCase):
    def test_a_program_that_spins_runs_out_of_processor_time(self):
        outcome = processes.run(["sh", "-c", "while :; do :; done"], 1)
        self.assertEqual(outcome.ran_out, processes.PROCESSOR)
        self.assertFalse(outcome.ok)
        self.assertGreaterEqual(outcome.seconds, 0.9)

    def test_children_count_together(self):
        spin = "while :; do :; done"
        outcome = processes.run(["sh", "-c", f"({spin}) & ({spin}) & ({spin}) & wait"], 2)
        self.assertEqual(outcome.ran_out, processes.PROCESSOR)
        self.assertLess(outcome.seconds, 5)

    def test_each_program_is_limited_even_if_nobody_looks(self):
        with tempfile.NamedTemporaryFile("r") as log:
            processes.run(["sh", "-c", "ulimit -t; ulimit -c"], 7, log=log.name)
            self.assertEqual(log.read(), "9\n0\n")

    def test_waiting_for_ever_is_told_from_hanging(self):
        factor, processes.CLOCK_FACTOR = processes.CLOCK_FACTOR, 0.5
        try:
            outcome = processes.run(["sleep", "60"], 1)
        finally:
            processes.CLOCK_FACTOR = factor
        self.assertEqual(outcome.ran_out, processes.CLOCK)

    def test_time_on_the_clock_is_not_limited(self):
        outcome = processes.run(["sleep", "1.5"], 0.5)
        self.assertTrue(outcome.ok)
        self.assertFalse(outcome.ran_out)

    def test_a_program_that_takes_all_memory_has_failed(self):
        limit, processes.MEMORY_LIMIT = processes.MEMORY_LIMIT, 100 << 20
        try:
            hog = "import time; x = b'1' * (200 << 20); time.sleep(60)"
            outcome = processes.run([sys.executable, "-c", hog], 20)
        finally:
            processes.MEMORY_LIMIT = limit
        self.assertFalse(outcome.ok)
        self.assertFalse(outcome.ran_out)


class FakeBuild:
    """Stands in for a build whose tests are a shell script's."""
    name = "plain"
    folder = FOLDER
    tests = dict.fromkeys(["T.hangs", "T.passes", "T.fails", "T.d", "T.e", "T.f", "T.g"], "")
    every = set(tests)

    def command(self, program, *arguments):
        return ["sh", "-c", program, "sh", *arguments]

    def limit(self, tests):
        return 0.5

    def time_alone(self, *command):
        return 0.0005


class FakeOriginal:
    builds = {"plain": FakeBuild()}


# Their arguments hold GoogleTest's filter.
SPIN = 'while :; do :; done'
HANGS = f"""case "$*" in *T.hangs*) echo '[ RUN      ] T.hangs'; {SPIN} ;; esac"""
SLOW_IN_COMPANY = f"""case "$*" in
    *filter=T.hangs) echo '[ RUN      ] T.hangs' ;;
    *T.hangs*) echo '[ RUN      ] T.hangs'; {SPIN} ;;
esac"""
FAILS_TOO = HANGS + """
case "$*" in *T.fails*) printf '[ RUN      ] T.fails\\n[  FAILED  ] T.fails\\n'; exit 1 ;; esac"""


class Hangs(unittest.TestCase):
    def setUp(self):
        self.proof, cpp.PROOF_SECONDS = cpp.PROOF_SECONDS, 1
        self.folder = tempfile.TemporaryDirectory()
        self.trial = cpp.Trial(FakeOriginal(), pathlib.Path(self.folder.name))
        self.trial.seconds, self.trial.hung = 0, []

    def tearDown(self):
        cpp.PROOF_SECONDS = self.proof
        self.folder.cleanup()

    def settled(self, program, tests):
        build = FakeOriginal.builds["plain"]
        with self.assertRaises(Settled) as caught:
            self.trial.run_groups(build, program, [tests], "unit tests")
            self.trial.settle_hang()
        return caught.exception.fate, caught.exception.by

    def test_a_test_that_hangs_alone_as_well_is_proof(self):
        self.assertEqual(self.settled(HANGS, {"T.hangs", "T.passes"}), ("hung, proven", "T.hangs"))

    def test_a_test_that_ends_alone_is_none(self):
        self.assertEqual(self.settled(SLOW_IN_COMPANY, {"T.hangs", "T.passes"}), ("hung", "T.hangs"))

    def test_waiting_for_ever_is_no_proof(self):
        factor, processes.CLOCK_FACTOR = processes.CLOCK_FACTOR, 0.5
        try:
            waits = HANGS.replace(SPIN, "sleep 60")
            self.assertEqual(self.settled(waits, {"T.hangs"}), ("hung", "T.hangs"))
        finally:
            processes.CLOCK_FACTOR = factor

    def test_another_test_that_fails_is_a_kill(self):
        self.assertEqual(self.settled(FAILS_TOO, {"T.hangs", "T.fails"}), ("unit tests", "T.fails"))


class TinyLibrary(unittest.TestCase):
    @classmethod
    def setUpClass(cls):
        cls.folder = tempfile.TemporaryDirectory()
        root = pathlib.Path(cls.folder.name, "tiny")
        shutil.copytree(FOLDER / "tiny", root)
        for source in root.rglob("*.in"):  # so named that no check takes them for the library's
            source.rename(source.with_suffix(""))
        cls.saved = {(m, n): getattr(m, n) for m, n in
                     [(cpp, "ROOT"), (mutants, "ROOT"), (cpp, "COPIED"), (cpp, "PROOF_SECONDS"), (cpp, "LINKER")]}
        cpp.ROOT = mutants.ROOT = root
        cpp.COPIED = ["selection", "tests", "CMakeLists.txt"]
        cpp.PROOF_SECONDS = 1
        cpp.LINKER = []  # any will do
        original = cpp.Original(pathlib.Path(cls.folder.name, "work"))
        original.prepare()
        cls.trial = cpp.Trial(original, pathlib.Path(cls.folder.name, "trial"))
        cls.all = [m for file in ("selection/tiny.cpp", "selection/tiny.h")
                   for m in mutants.mutants_of(file, (root / file).read_text())]

    @classmethod
    def tearDownClass(cls):
        for (module, name), value in cls.saved.items():
            setattr(module, name, value)
        cls.folder.cleanup()

    def fate(self, line, change):
        found = [m for m in self.all if m.line_text == line and mutants.description(m) == change]
        self.assertEqual(len(found), 1, f"{line} {change}")
        fate = self.trial.fate(found[0])
        self.assertGreater(fate.seconds, 0)
        return fate.fate, fate.by

    def test_a_failing_test_kills(self):
        self.assertEqual(self.fate("return n / 10;", "'/' -> '*'"), ("unit tests", "Tiny.Divides"))

    def test_of_a_header_too(self):
        self.assertEqual(self.fate("inline int twice(int n) { return n + n; }", "'+' -> '-'"),
                         ("unit tests", "Tiny.Sums"))

    def test_the_models_kill_what_no_test_runs(self):
        self.assertEqual(self.fate("return n * 3;", "'3' -> '4'"), ("differential", "family times"))

    def test_the_sanitizers_see_a_read_beyond_the_end(self):
        self.assertEqual(self.fate("if (n == 99) return spare[1];", "'1' -> '2'"),
                         ("sanitizers", "crash in Tiny.ReadsWhatIsSpare"))

    def test_what_nothing_tells_apart_survives(self):
        self.assertEqual(self.fate("if (n == 0) return 0;", "'0' -> '1'"), ("survived", ""))

    def test_a_loop_without_end_hangs(self):
        self.assertEqual(self.fate("n /= 2;", "'n /= 2;' -> ';'"), ("hung, proven", "Tiny.Halves"))

    def test_equal_objects_are_the_same_code(self):
        self.assertEqual(self.fate("volatile int spare[2] = {0, 0};", "'0' -> '1'")[0], "survived")
        self.assertEqual(self.fate("if (n == 0) return 0;", "'return 0;' -> ';'"),
                         ("same code", "-O1"))
        self.assertEqual(self.fate("return *n > 1;", "'1' -> '2'"), ("same code", "-O2"))

    def test_some_do_not_compile(self):
        self.assertEqual(self.fate("return n / 10;", "'return n / 10;' -> ';'")[0],
                         "does not compile")


if __name__ == "__main__":
    unittest.main()
