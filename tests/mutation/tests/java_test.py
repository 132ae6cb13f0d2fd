#!/usr/bin/env python3
"""The Java side on tiny classes: the tools, and mutants whose fates are known."""

import pathlib
import subprocess
import sys
import tempfile
import unittest

sys.dont_write_bytecode = True
sys.path.insert(0, str(pathlib.Path(__file__).resolve().parents[1]))
import java
import mutants

TINY = """package tiny;

final class Tiny {
    static int half(int n) {
        return n / 2;
    }

    static int unseen(int n) {
        return n + 7;
    }

    static int steps(int n) {
        int count = 0;
        while (n > 0) {
            n = n - 1;
            ++count;
        }
        return count;
    }
}
"""
TINY_TEST = """package tiny;

import org.junit.jupiter.api.Assertions;
import org.junit.jupiter.api.Test;

final class TinyTest {
    @Test
    void halves() {
        Assertions.assertEquals(3, Tiny.half(6));
    }

    @Test
    void steps() {
        Assertions.assertEquals(3, Tiny.steps(3));
    }
}
"""


class TinyOriginal(java.Original):
    def build_library(self):
        pass


class TinyClasses(unittest.TestCase):
    @classmethod
    def setUpClass(cls):
        cls.folder = tempfile.TemporaryDirectory()
        root = pathlib.Path(cls.folder.name)
        for name, text in [("java/Tiny.java", TINY), ("tests/jvm/tiny/TinyTest.java", TINY_TEST),
                           ("standins/Nothing.java", "class Nothing {}\n")]:
            (root / name).parent.mkdir(parents=True, exist_ok=True)
            (root / name).write_text(text)
        tools = pathlib.Path(java.__file__).parent / "jvm"
        values = {"ROOT": root, "PACKAGE": "tiny", "GROUPS": [["TinyTest"]], "NOT_RUN": [],
                  "PROOF_SECONDS": 3, "PROOF_FACTOR": 1,
                  "SOURCES": {"standins": ["standins"], "face": ["java"], "desktop": ["standins"],
                              "tests": ["tests/jvm"], "tools": [tools]}}
        cls.saved = {name: getattr(java, name) for name in values}
        for name, value in values.items():
            setattr(java, name, value)
        cls.original = TinyOriginal(root / "work")
        cls.original.prepare()
        cls.trial = java.Trial(cls.original, root / "trial")
        cls.all = mutants.mutants_of("java/Tiny.java", TINY)

    @classmethod
    def tearDownClass(cls):
        cls.trial.end()
        for name, value in cls.saved.items():
            setattr(java, name, value)
        cls.folder.cleanup()

    def fate(self, line, change):
        found = [m for m in self.all if m.line_text == line and mutants.description(m) == change]
        self.assertEqual(len(found), 1, f"{line} {change}")
        fate = self.trial.fate(found[0])
        return fate.fate, fate.by

    def test_a_failing_test_kills(self):
        self.assertEqual(self.fate("return n / 2;", "'/' -> '*'"),
                         ("unit tests", "TinyTest.halves"))

    def test_what_no_test_runs_survives(self):
        self.assertEqual(self.fate("return n + 7;", "'7' -> '8'"), ("survived", ""))

    def test_a_loop_without_end_hangs(self):
        self.assertEqual(self.fate("n = n - 1;", "'n = n - 1;' -> ';'"),
                         ("hung, proven", "TinyTest.steps"))

    def test_some_do_not_compile(self):
        self.assertEqual(self.fate("return n / 2;", "'return n / 2;' -> ';'")[0], "does not compile")

    def test_no_tests_are_a_failure(self):
        command = self.original.command(self.original.work / "face", ["Tiny"])
        self.assertEqual(subprocess.run(command, capture_output=True).returncode, 2)


if __name__ == "__main__":
    unittest.main()
