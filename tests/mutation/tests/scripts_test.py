#!/usr/bin/env python3
"""Mutants, explanations, rules of resuming, and the page: all that needs no compiler."""

import collections
import contextlib
import pathlib
import sys
import tempfile
import unittest

sys.dont_write_bytecode = True
sys.path.insert(0, str(pathlib.Path(__file__).resolve().parents[1]))
import mutants
import mutate
import report
import results
from steps import Fate

Argument = collections.namedtuple("Argument", "all rest files only sample seed")


def changes(text, file="a.cpp"):
    return [mutants.description(m) for m in mutants.mutants_of(file, text)]


@contextlib.contextmanager
def changed(module, **values):
    saved = {name: getattr(module, name) for name in values}
    for name, value in values.items():
        setattr(module, name, value)
    try:
        yield
    finally:
        for name, value in saved.items():
            setattr(module, name, value)


class Mutants(unittest.TestCase):
    def test_operators_numbers_words_conditions_and_statements_are_changed(self):
        found = changes("void f() {\n    if (left < 10) g(left, right);\n    h();\n}\n")
        for change in ["'<' -> '<='", "'10' -> '11'", "'10' -> '9'", "'10' -> '0'",
                       "'left' -> 'right'", "'(left < 10)' -> '(!(left < 10))'", "'h();' -> ';'"]:
            self.assertIn(change, found)

    def test_comments_strings_and_preprocessor_lines_are_left_alone(self):
        self.assertEqual(changes('// 1 < 2\n/* 3 */\n#define N 4\nconst char* s = "5 < 6";\n'), [])

    def test_java_has_a_shift_of_its_own(self):
        self.assertIn("'>>>' -> '<<'", changes("class A { int f(int a) { return a >>> b; } }",
                                              "A.java"))

    def test_generics_arrows_and_annotations_are_left_alone(self):
        text = "class A {\n    @Override\n    List<Map<String, X>> f() { return g(a -> b); }\n}\n"
        self.assertEqual(changes(text, "A.java"), ["'return g(a -> b);' -> ';'"])

    def test_of_an_exception_only_the_throw_goes(self):
        text = 'class A { void f() {\n        throw new Bad("x" + (n - 1));\n    }\n}\n'
        self.assertEqual(len(changes(text, "A.java")), 1)

    def test_parts_of_java_names_are_swapped(self):
        text = "class A { int f(int firstRow, int lastRow) {\n        return firstRow;\n    } }"
        self.assertIn("'firstRow' -> 'lastRow'", changes(text, "A.java"))

    def test_every_source_has_its_share_in_the_standard_set(self):
        everything = mutants.all_mutants()
        drawn = collections.Counter(k[0] for k in mutants.standard_set(everything))
        for file, number in collections.Counter(m.file for m in everything).items():
            self.assertGreaterEqual(drawn[file], min(number, mutants.STANDARD_LEAST))
            self.assertAlmostEqual(drawn[file], mutants.STANDARD_SHARE * number,
                                   delta=mutants.STANDARD_LEAST)

    def test_lines_belong_to_the_first_processor_that_compiles_them(self):
        text = ("int f() { return 1; }\n#if defined(__aarch64__)\nint g() { return 2; }\n"
                "#elif defined(__s390x__)\nint h() { return 3; }\n"
                "#elif defined(__riscv)\nint i() { return 4; }\n#endif\n")
        compilers = {"x86-64": "g++", "AArch64": "g++ -D__aarch64__", "s390x": "g++ -D__s390x__"}
        with tempfile.TemporaryDirectory() as folder, \
                changed(mutants, ROOT=pathlib.Path(folder), PROCESSORS=compilers):
            pathlib.Path(folder, "a.cpp").write_text(text)
            found = {m.line: mutants.processor_of(m) for m in mutants.mutants_of("a.cpp", text)}
        self.assertEqual(found, {1: "x86-64", 3: "AArch64", 5: "s390x", 7: None})

    def test_what_is_left_for_later_runs_only_when_it_is_named(self):
        everything = mutants.mutants_of("render/a.cpp", "int f() { return 1; }")
        with changed(mutate, LEFT_FOR_LATER={"render/a.cpp": "later"},
                     processor_of=lambda m: "x86-64"):
            chosen = Argument(True, False, None, None, None, 1)
            self.assertEqual(mutate.chosen(everything, chosen), [])
            self.assertTrue(mutate.chosen(everything, chosen._replace(files="render/*")))


class Explanations(unittest.TestCase):
    def read(self, text):
        with tempfile.TemporaryDirectory() as folder:
            path = pathlib.Path(folder, "survivors.txt")
            path.write_text(text)
            return mutate.read_survivors(path)

    def test_changes_in_a_row_share_a_reason(self):
        found = self.read("a.cpp@2: f(1);\n  '1' -> '2'\n  '1' -> '0'\n    Why.\n    holds: 64-bit\n"
                          "  'f(1);' -> ';'\n    Other.\n")
        self.assertEqual([e.reason for e in found.values()], ["Why.", "Why.", "Other."])
        self.assertEqual([e.holds for e in found.values()], ["64-bit", "64-bit", ""])
        self.assertIn(("a.cpp", 2, "f(1);", "'1' -> '0'"), found)

    def test_one_for_other_processors_explains_nothing_here(self):
        found = self.read("a.cpp: f(1);\n  '1' -> '2'\n    Why.\n    holds: big-endian\n")
        explanation = next(iter(found.values()))
        self.assertFalse(explanation.on("x86-64"))
        self.assertTrue(explanation.on("s390x"))

    def test_without_a_reason_is_an_error(self):
        for text in ["a.cpp: f(1);\n  '1' -> '2'\n", "a.cpp: f(1);\n  '1' -> '2'\nb.cpp: g();\n",
                     "a.cpp: f(1);\n  '1' -> '2'\n    holds: 64-bit\n"]:
            with self.assertRaises(SystemExit):
                self.read(text)

    def test_an_unknown_processor_is_an_error(self):
        with self.assertRaises(SystemExit):
            self.read("a.cpp: f(1);\n  '1' -> '2'\n    Why.\n    holds: sometimes\n")

    def test_of_a_killed_mutant_is_an_error_as_is_one_whose_mutant_is_gone(self):
        mutant = mutants.mutants_of("a.cpp", "int f() { return 1; }")[0]
        explained = {mutants.key(mutant): mutate.Explanation()}
        row = collections.namedtuple("R", "fate")
        with contextlib.redirect_stdout(None), changed(mutate, processor_of=lambda m: "x86-64"):
            for fate, in_order in [("survived", True), ("same code", True), ("unit tests", False),
                                   ("hung, proven", False)]:
                outcome = mutate.print_outcome({mutant: row(fate)}, explained, [mutant])
                self.assertEqual(outcome[2], in_order, fate)
            explained[mutants.key(mutant)].holds = "big-endian"
            outcome = mutate.print_outcome({mutant: row("survived")}, explained, [mutant])
            self.assertFalse(outcome[2])
            self.assertFalse(mutate.print_outcome({}, explained, [])[2])
            self.assertFalse(mutate.print_outcome({mutant: row("hung")}, {}, [mutant])[2])


class Resuming(unittest.TestCase):
    """On a library of one source and one header."""

    def setUp(self):
        folder = tempfile.TemporaryDirectory()
        self.addCleanup(folder.cleanup)
        self.root = pathlib.Path(folder.name)
        for name in ("selection", "tests", "build"):
            (self.root / name).mkdir()
        self.write("selection/a.h", "int g();\n")
        self.write("selection/a.cpp", '#include "selection/a.h"\nint f() { return 1; }\n')
        self.write("tests/a_test.cpp", "// a test\n")
        self.write("draventaUtil.h", "")
        self.write("CMakeLists.txt", "")
        patch = changed(results, ROOT=self.root, KEPT=self.root / "kept.gz")
        patch.__enter__()
        self.addCleanup(patch.__exit__, None, None, None)
        self.mutant = mutants.mutants_of("selection/a.cpp",
                                         (self.root / "selection/a.cpp").read_text())[0]

    def write(self, name, text):
        (self.root / name).write_text(text)
        for function in (results.included, results.state, results.whole):
            function.cache_clear()

    def run_and_change(self, fate, name=None, text=""):
        """Whether a fate is still known after a change of a file."""
        path = self.root / "build/results.tsv"
        path.unlink(missing_ok=True)
        kept = results.Results(path)
        kept.open(["selection/a.cpp"])
        kept.add(self.mutant, Fate(fate, "", 1.5))
        kept.file.close()
        if name:
            self.write(name, text)
        known = results.Results(path).known(self.mutant)
        self.assertTrue(known is None or known.fate == fate)
        return known is not None

    def test_all_is_known_while_nothing_changes(self):
        for fate in results.KILLED + results.ALIVE + results.NOT_COUNTED:
            self.assertTrue(self.run_and_change(fate), fate)

    def test_a_kill_outlives_new_tests(self):
        for i, fate in enumerate(results.KILLED):
            self.assertTrue(self.run_and_change(fate, "tests/a_test.cpp", f"// {i}"), fate)

    def test_survivors_run_again_with_new_tests(self):
        for i, fate in enumerate(results.ALIVE):
            self.assertFalse(self.run_and_change(fate, "tests/a_test.cpp", f"// {i}"), fate)

    def test_nothing_outlives_a_change_of_the_source_or_of_what_it_includes(self):
        for i, fate in enumerate(results.KILLED + results.ALIVE + results.NOT_COUNTED):
            self.assertFalse(self.run_and_change(fate, "selection/a.h", f"int g{i}();\n"), fate)

    def test_what_the_repository_keeps_is_known_to_a_new_folder(self):
        self.run_and_change("unit tests")
        path = self.root / "build/results.tsv"
        results.Results(path).keep()
        first = results.KEPT.read_bytes()
        path.unlink()
        again = results.Results(path)
        self.assertEqual(again.known(self.mutant).fate, "unit tests")
        again.keep()
        self.assertEqual(results.KEPT.read_bytes(), first)

    def test_a_line_that_was_cut_off_is_dropped(self):
        self.run_and_change("unit tests")
        path = self.root / "build/results.tsv"
        whole = path.read_text()
        path.write_text(whole + "selection/a.cpp\t1\tcut o")
        kept = results.Results(path)
        self.assertEqual(len(kept.rows), 1)
        kept.open(["selection/a.cpp"])
        kept.file.close()
        self.assertEqual(path.read_text(), whole)


class Report(unittest.TestCase):
    def line(self, file, **counts):
        line = dict.fromkeys(report.COUNTS, 0) | counts
        return line | {"file": file, "state": "s", "mutants": sum(line.values()), "seconds": 2.0,
                       "from": "2026-01-01", "to": "2026-01-02", "commits": "abc"}

    def test_the_page_shows_the_losing_figures_first(self):
        table = {f: self.line(f, **c) for f, c in [
            ("render/good.cpp", {"unit tests": 9, "no build": 2}), ("render/bad.cpp", {"survived": 3})]}
        page = report.page_of(table, [report.Alive("render/bad.cpp", "1", "f(a | b);", "'|' -> '&'",
                                                   "survived")] * 3, [])
        self.assertLess(page.index("survived, not explained"), page.index("killed by unit tests"))
        self.assertLess(page.rindex("render/bad.cpp"), page.rindex("render/good.cpp"))
        self.assertIn("0 of 3, 0.0 %", page)
        self.assertIn("`f(a \\| b);`", page)
        self.assertIn("1 of 2 sources ran completely", page)
        self.assertIn("`render/good.cpp`: 2 mutants in lines that no build compiles", page)
        for file in mutants.LEFT_FOR_LATER:
            self.assertIn(file, page)

    def test_no_rate_is_made_of_a_part_of_a_source(self):
        table = {f: self.line(f, **c) for f, c in [
            ("render/whole.cpp", {"unit tests": 3, "explained": 1}),
            ("render/part.cpp", {"unit tests": 90, "not run": 1})]}
        page = report.page_of(table, [], [])
        self.assertIn("3 of 4, 75.0 %", page)
        self.assertIn("1 of 2 sources ran completely", page)

    def test_faults_are_found(self):
        files = mutants.library_files() + mutants.java_files()
        good = {file: self.line(file, **{"unit tests": 1}) for file in files}
        with tempfile.TemporaryDirectory() as folder, \
                changed(report, PAGE=pathlib.Path(folder, "page.md"), ROOT=pathlib.Path(folder)):
            report.PAGE.write_text("page")
            self.assertEqual(report.faults(good, [], {}, "page"), [])
            self.assertEqual(len(report.faults(good, [], {}, "another page")), 1)
            self.assertEqual(len(report.faults(dict(list(good.items())[1:]), [], {}, "page")), 1)
            wrong = good | {files[0]: good[files[0]] | {"mutants": 7}}
            self.assertEqual(len(report.faults(wrong, [], {}, "page")), 1)
            uncounted = report.Alive(files[0], "1", "f();", "'f();' -> ';'", "survived")
            self.assertEqual(len(report.faults(good, [uncounted], {}, "page")), 1)

    def test_a_smaller_run_does_not_take_the_place_of_a_larger_one(self):
        old = {"a.cpp": self.line("a.cpp", **{"unit tests": 9, "not run": 1})}
        new = {"a.cpp": self.line("a.cpp", **{"unit tests": 1, "not run": 9})}
        self.assertEqual(report.merged(new, [], old, [], {})[0], old)
        newer = {"a.cpp": new["a.cpp"] | {"state": "t"}}
        self.assertEqual(report.merged(newer, [], old, [], {})[0], newer)


class Arguments(unittest.TestCase):
    def test_a_sample_of_none_is_refused(self):
        for words in (["--sample", "0"], ["--minutes", "0"], ["--check"]):
            with changed(sys, argv=["mutate.py", *words]), contextlib.redirect_stderr(None):
                with self.assertRaises(SystemExit):
                    mutate.read_arguments()


if __name__ == "__main__":
    unittest.main()
