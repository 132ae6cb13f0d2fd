#!/usr/bin/env python3
"""Hands ./dev and the scripts behind it what would let a check pass without checking: wrong
arguments, empty lists, missing tools, output of another form. Each must fail and say why.

Most tests run a copy of `dev` in a folder of its own. What would build or run for long is replaced
there by stand-ins: small shell scripts, first on the path.
"""

import argparse
import json
import os
import pathlib
import shutil
import subprocess
import sys
import tempfile
import unittest
import zipfile

ROOT = pathlib.Path(__file__).resolve().parents[2]
sys.dont_write_bytecode = True
sys.path[:0] = [str(ROOT / "tests" / folder) for folder in ("binary", "coverage")]
import binary  # noqa: E402
import coverage  # noqa: E402

programs = None  # the paths of what this build has: differential, cmake

# All that a copy of `dev` finds on its path besides stand-ins. On purpose without compilers, qemu,
# clang-format and the like, which some machines have and others lack.
TOOLS = ("awk basename bash cat chmod cp dirname echo env find flock grep head id ls mkdir mktemp "
         "mv nproc printf python3 readlink realpath rm sed sh sort tail tee touch tr true wc "
         "xargs").split()


# The commands that leave rows in the table.
CHECKS = ("test differential emulate same-bits sanitize valgrind fuzz coverage mutate strokes "
          "binary emulated-jvm screen format tidy aar docs commands").split()


def testcase(name, output="", status="run"):
    """A test in the form of `ctest --output-junit`."""
    return (f'<testcase name="{name}" status="{status}"><system-out><![CDATA[{output}]]>'
            '</system-out></testcase>')


class Project(unittest.TestCase):
    """A folder with a copy of `dev` and of the scripts that it calls."""

    def setUp(self):
        temporary = tempfile.TemporaryDirectory()
        self.addCleanup(temporary.cleanup)
        self.folder = pathlib.Path(temporary.name)
        for name in ("dev", "tests/dev/arguments.sh", "tests/dev/packages.sh", "tests/dev/table.sh",
                     "tests/dev/test_figure.py", "tests/same_bits/same_bits.py",
                     "tests/same_bits/digests.txt", "tests/docs/pages.py",
                     "tests/docs/check_pages.py", "tests/docs/run_commands.py",
                     "tests/jvm/emulated_jdk.sh", "fuzz/CMakeLists.txt", "CMakePresets.json"):
            self.write(name, (ROOT / name).read_bytes())
            (self.folder / name).chmod(0o755)
        for tool in TOOLS:
            (self.folder / "bin").mkdir(exist_ok=True)
            (self.folder / "bin" / tool).symlink_to(shutil.which(tool))
        # What is missing counts as installed, if nothing else is said.
        for tool in ("apt-get", "cmake", "ctest", "git"):
            self.stand_in(tool, "exit 0")
        self.stand_in("sudo", 'exec "$@"')

    def write(self, name, data):
        path = self.folder / name
        path.parent.mkdir(parents=True, exist_ok=True)
        path.write_bytes(data if isinstance(data, bytes) else data.encode())

    def program(self, name, script):
        (self.folder / name).unlink(missing_ok=True)  # it may be a link to the real one
        self.write(name, f"#!/bin/sh\n{script}\n")
        (self.folder / name).chmod(0o755)

    def stand_in(self, tool, script):
        self.program(f"bin/{tool}", script)

    def run_command(self, *command):
        environment = {"PATH": str(self.folder / "bin"), "HOME": str(self.folder), "LC_ALL": "C"}
        return subprocess.run([str(word) for word in command], cwd=self.folder, env=environment,
                              text=True, capture_output=True)

    def dev(self, *arguments):
        return self.run_command("./dev", *arguments)

    def rows(self):
        """The table: {command: [(check, figure)]}."""
        table = self.folder / "build/summary.tsv"
        found = {}
        for line in table.read_text().splitlines() if table.exists() else ():
            check, figure, _, command = line.split("\t")
            found.setdefault(command, []).append((check, figure))
        return found

    def expect_row(self, figure, *arguments):
        """The command succeeds, and its one row has this figure."""
        result = self.dev(*arguments)
        self.assertEqual(result.returncode, 0, result.stdout + result.stderr)
        self.assertEqual([row[1] for row in self.rows()[arguments[0]]], [figure])

    def expect_failure(self, message, *arguments):
        """The command fails, says why, and no row of it looks like success."""
        result = self.dev(*arguments)
        self.assertNotEqual(result.returncode, 0, result.stdout)
        self.assertIn(message, result.stdout + result.stderr)
        for _, figure in self.rows()[arguments[0]]:
            self.assertRegex(figure, "^(failed with status|not checked: )")

    def expect_refusal(self, message, *arguments):
        """The command ends with 2 and one line before it does anything."""
        result = self.dev(*arguments)
        self.assertEqual((result.returncode, result.stdout, result.stderr),
                         (2, "", f"dev: {message}\n"))
        self.assertEqual(self.rows(), {})

    def fake_results(self, *testcases):
        """CTest finds these results."""
        self.write("results.xml", f"<testsuite>{''.join(testcases)}</testsuite>")
        self.stand_in("ctest", '''
            while [ $# -gt 0 ]; do
                [ "$1" != --output-junit ] || cp results.xml "$2"
                shift
            done''')


class Arguments(Project):
    def test_those_that_a_command_does_not_take_are_refused(self):
        for command in ("demo", "build", "aar", "emulate", "valgrind", "coverage", "emulated-jvm",
                        "screen", "tidy", "commands", "summary", "weekly"):
            for argument in ("--foo", "x", ""):
                with self.subTest(command=command, argument=argument):
                    self.expect_refusal(f"{command} takes no arguments, not '{argument}'", command,
                                        argument)
        self.expect_refusal("tidy takes no arguments, not '--check'", "tidy", "--check")
        self.expect_refusal("binary takes --update, not 'x'", "binary", "x")
        self.expect_refusal("docs takes --update, not '--check'", "docs", "--check")
        self.expect_refusal("format takes --check, not 'x'", "format", "x")
        self.expect_refusal("same-bits takes --size short|long, --update, not '--size=long'",
                            "same-bits", "--size=long")
        for command in ("test", "sanitize"):
            self.expect_refusal(f"{command} takes -R REGEX, -E REGEX, -j N, -V, not 'lasso'",
                                command, "lasso")
        self.expect_refusal("fuzz takes --seconds N, --keep, not '--family'", "fuzz", "--family")

    def test_values_that_would_check_nothing_are_refused(self):
        whole = "a whole number from 1, of at most 9 digits"
        for command in ("differential", "fuzz"):
            for value in ("0", "-1", "1e3", "1.5", "x", "", "00", "9999999999", "0x10", " 5"):
                with self.subTest(command=command, value=value):
                    self.expect_refusal(f"--seconds takes {whole}, not '{value}'", command,
                                        "--seconds", value)
            self.expect_refusal(f"--seconds takes {whole}, not ''", command, "--seconds")
        for message, arguments in (
                (f"--cases takes {whole}, not '0'", "differential --cases 0"),
                ("--seed takes a whole number, not '1e3'", "differential --seed 1e3"),
                ("--family takes NAME, not '--seed'", "differential --family --seed 1"),
                ("--size takes short|long, not 'medium'", "same-bits --size medium"),
                ("-R takes REGEX, not ''", "test -R")):
            with self.subTest(arguments):
                self.expect_refusal(message, *arguments.split())

    def test_a_command_that_is_not_there_is_refused(self):
        self.expect_refusal("there is no command 'tests'; ./dev --help lists them", "tests")


class Summary(Project):
    def expect(self, status, message, table):
        if table is not None:
            self.write("build/summary.tsv", table)
            self.write("build/summary-times.tsv", "test\t60\n")
        result = self.dev("summary")
        self.assertEqual(result.returncode, status, result.stdout + result.stderr)
        self.assertIn(message, result.stdout + result.stderr)

    def test_without_a_table_or_with_an_empty_one_it_fails(self):
        self.expect(1, "no check has run yet: run one, such as ./dev test", None)
        self.expect(1, "no check has run yet: run one, such as ./dev test", "")

    def test_a_table_without_its_times_fails(self):
        self.expect(0, "1:00", "a\t5 passed\tnone\ttest\n")
        (self.folder / "build/summary-times.tsv").unlink()
        self.expect(1, "build/summary-times.tsv is missing", None)

    def test_a_row_without_a_figure_fails(self):
        for row in ("tests\t\tnone\ttest\n", "tests\t5 passed\tnone\n", "tests\n"):
            self.expect(1, "has a row with an empty cell", row)

    def test_a_check_that_failed_or_could_not_be_made_fails(self):
        for figure in ("not checked: no network", "failed with status 1"):
            self.expect(1, "the table has a check that failed or could not be made",
                        f"a\t5 passed\tnone\ttest\nb\t{figure}\t-\tdocs\n")

    def test_it_names_the_checks_that_did_not_run(self):
        self.expect(0, "not run: differential emulate", "a\t5 passed\tnone\ttest\n")
        table = "".join(f"a\tfine\tnone\t{check}\n" for check in CHECKS)
        self.expect(0, "", table)
        self.assertNotIn("not run", self.dev("summary").stdout)


class Table(Project):
    def test_a_check_without_a_row_fails(self):
        self.write("tests/coverage/coverage.py", "")
        self.write("build/clang-runtimes", "")
        self.expect_failure("coverage ended without a row for the table: it checked nothing",
                            "coverage")

    def test_rows_take_the_place_of_those_of_the_last_run(self):
        self.fake_results(testcase("a"))
        self.write("build/summary.tsv", "x\t7 passed\tnone\ttest\ny\tfine\tnone\tdocs\n")
        self.expect_row("1 passed, 0 skipped", "test")
        self.assertEqual(self.rows()["docs"], [("y", "fine")])
        self.stand_in("ctest", "exit 8")
        self.expect_failure("", "test")

    def test_a_filter_shows_in_the_row(self):
        self.fake_results(testcase("a"))
        self.dev("test", "-R", "lasso")
        self.assertEqual(self.rows()["test"],
                         [("tests on this machine (-R lasso)", "1 passed, 0 skipped")])


class RunsOfCTest(Project):
    GOOGLE_TESTS = "[==========] 12 tests from 3 test suites ran.\n[  PASSED  ] 10 tests.\n"
    JUNIT = ("[        12 tests found      ]\n[         {} tests skipped    ]\n"
             "[         {} tests aborted    ]\n[        10 tests successful ]\n")

    def test_what_passed_is_counted(self):
        self.fake_results(testcase("a"), testcase("b", self.GOOGLE_TESTS),
                          testcase("c", self.JUNIT.format(0, 0)))
        self.expect_row("21 passed, 0 skipped", "test")

    def test_what_was_skipped_is_an_error_wherever_tests_run(self):
        skipped = {
            "by GoogleTest": self.GOOGLE_TESTS + "[  SKIPPED ] 2 tests, listed below:\n",
            "by DISABLED_": self.GOOGLE_TESTS + "\n  YOU HAVE 2 DISABLED TESTS\n",
            "by @Disabled": self.JUNIT.format(2, 0),
            "by an assumption": self.JUNIT.format(0, 2),
        }
        for how, output in skipped.items():
            with self.subTest(how):
                self.fake_results(testcase("a"), testcase("b", output))
                self.expect_failure("test_figure: b: 2 skipped", "test")
        for status in ("notrun", "disabled"):
            self.fake_results(testcase("a"), testcase("b", "", status))
            for command in ("test", "emulate", "sanitize", "fuzz"):
                with self.subTest(command=command, status=status):
                    self.write("fuzz/seeds/queue.zip", "")
                    self.expect_failure("test_figure: b: 1 skipped", command)

    def test_a_program_that_ran_none_is_an_error(self):
        self.fake_results(testcase("a"), testcase("b", "[  PASSED  ] 0 tests.\n"))
        self.expect_failure("test_figure: b: ran no test", "test")

    def test_no_results_are_an_error(self):
        self.fake_results()
        self.expect_failure("test_figure: no test ran", "test")
        self.stand_in("ctest", "exit 0")
        self.expect_failure("CTest has not run the tests", "test")

    def test_a_filter_that_matches_nothing_is_an_error_in_every_preset(self):
        presets = json.loads((self.folder / "CMakePresets.json").read_text())["testPresets"]
        self.assertTrue(presets)
        for preset in presets:
            with self.subTest(preset["name"]):
                self.assertTrue(preset.get("inherits") == "release" or
                                preset["execution"]["noTestsAction"] == "error")


class Differential(Project):
    PROGRAM = "build/release/tests/differential/differential"

    def test_the_program_refuses_what_would_compare_nothing(self):
        for arguments in ("--seconds 0", "--seconds -1", "--seconds 1e3", "--seconds 1.5",
                          "--seconds x", "--seconds", "--seconds 99999999999999999999999",
                          "--cases 0", "--cases -1", "--cases 99999999999", "--family nobody",
                          "--family queue --family nobody", "--seed -1", "--digests tiny",
                          "--case 1", "x"):
            with self.subTest(arguments):
                result = self.run_command(programs.differential, *arguments.split())
                self.assertEqual((result.returncode, result.stdout), (2, ""))
                self.assertRegex(result.stderr, r"^differential: .*\nusage: ")

    def test_the_program_counts_what_it_compared(self):
        result = self.run_command(programs.differential, "--family", "queue", "--case", "1")
        self.assertEqual(result.stdout.splitlines()[-1], "0 differences in 1 case of 1 family")
        result = self.run_command(programs.differential, "--seconds", "1", "--family", "queue",
                                  "--family", "fixed-point")
        self.assertRegex(result.stdout, r"\n0 differences in [1-9]\d* cases of 2 families\n$")

    def test_cases_and_families_come_into_the_table(self):
        self.program(self.PROGRAM, "echo 0 differences in 1234 cases of 24 families")
        self.expect_row("1234 cases, families: 24", "differential")

    def test_no_cases_are_an_error(self):
        self.program(self.PROGRAM, "echo 0 differences in 0 cases of 24 families")
        self.expect_failure("so nothing was checked", "differential")

    def test_output_of_another_form_is_an_error(self):
        for output in ("", "queue 12 34 cases", "no difference"):
            self.program(self.PROGRAM, f"echo '{output}'")
            self.expect_failure("has no line", "differential")


class Fuzzing(Project):
    def setUp(self):
        super().setUp()
        self.fake_results(testcase("fuzz.seeds.queue"))
        self.write("fuzz/seeds/queue.zip", "")
        self.write("fuzz/seeds/lasso.zip", "")
        self.stand_in("nproc", "echo 1")
        for name in ("queue", "lasso"):
            self.program(f"build/sanitize/fuzz/fuzz_{name}",
                         'echo "$@" >>limits; echo "stat::number_of_executed_units: 21"')

    def test_inputs_come_into_the_table(self):
        self.dev("fuzz", "--seconds", "10")
        self.assertEqual(self.rows()["fuzz"][-1],
                         ("fuzzing against slow models", "42 inputs to 2 targets"))
        self.assertIn("-max_total_time=5 ", (self.folder / "limits").read_text())

    def test_less_than_a_second_for_each_target_is_refused(self):
        self.expect_refusal("--seconds is shared by 2 fuzz targets: give 2 or more", "fuzz",
                            "--seconds", "1")

    def test_no_archives_of_seeds_are_an_error(self):
        shutil.rmtree(self.folder / "fuzz/seeds")
        result = self.dev("fuzz")
        self.assertEqual(result.returncode, 1)
        self.assertIn("fuzz/seeds has no archive of seeds", result.stderr)

    def test_a_target_that_is_missing_is_an_error(self):
        (self.folder / "build/sanitize/fuzz/fuzz_queue").unlink()
        self.assertEqual(self.dev("fuzz").returncode, 1)
        self.assertIn("failed with status", str(self.rows()["fuzz"]))

    def test_a_target_without_inputs_is_an_error(self):
        for output, message in (("stat::number_of_executed_units: 0", "so nothing was checked"),
                                ("Done", "has no line")):
            self.program("build/sanitize/fuzz/fuzz_queue", f"echo '{output}'")
            result = self.dev("fuzz")
            self.assertEqual(result.returncode, 1)
            self.assertIn(message, result.stderr)

    def test_an_archive_without_seeds_is_an_error(self):
        with zipfile.ZipFile(self.folder / "fuzz/seeds/sessions.zip", "w"):
            pass
        ignored = ("add_library", "add_executable", "target_link_libraries",
                   "target_compile_options", "target_compile_definitions", "target_link_options")
        self.write("CMakeLists.txt", "cmake_minimum_required(VERSION 3.25)\nproject(seeds NONE)\n"
                   + "".join(f"macro({command})\nendmacro()\n" for command in ignored)
                   + "add_subdirectory(fuzz)\n")
        result = subprocess.run([programs.cmake, "-S", self.folder, "-B", self.folder / "seeds"],
                                text=True, capture_output=True)
        self.assertNotEqual(result.returncode, 0)
        self.assertIn("sessions.zip holds no seeds", result.stderr)


class SameBits(Project):
    FIRST = "echo queue 5 0123456789abcdef"

    def same_bits(self, *builds, update=False):
        return self.run_command("tests/same_bits/same_bits.py", *["--update"] * update, *builds)

    def expect(self, message, *builds):
        """The builds are found wrong, with --update for this reason, and nothing is written."""
        table = self.folder / "tests/same_bits/digests.txt"
        before = table.read_text()
        self.assertNotEqual(self.same_bits(*builds).returncode, 0)
        result = self.same_bits(*builds, update=True)
        self.assertNotEqual(result.returncode, 0)
        self.assertIn(message, result.stdout + result.stderr)
        self.assertEqual(table.read_text(), before)

    def test_what_all_builds_agree_on_is_written(self):
        result = self.same_bits(f"a={self.FIRST}", f"b={self.FIRST}", update=True)
        self.assertEqual(result.returncode, 0, result.stdout + result.stderr)
        self.assertIn("short  queue                   5  0123456789abcdef\nlong",
                      (self.folder / "tests/same_bits/digests.txt").read_text())

    def test_digests_of_scripts_are_read_as_the_replay_prints_them(self):
        self.program("replay", "echo 'digest 8A9E14CF  some folder/fig.calls'")
        result = self.same_bits("a=./replay", "b=./replay", update=True)
        self.assertEqual(result.returncode, 0, result.stdout + result.stderr)
        self.assertIn("short  fig.strokes             1  8A9E14CF\nlong",
                      (self.folder / "tests/same_bits/digests.txt").read_text())

    def test_builds_that_disagree_write_nothing(self):
        self.expect("queue: 0123456789abcdef from a; 9123456789abcdef from b\n"
                    "same_bits: the builds disagree",
                    f"a={self.FIRST}", "b=echo queue 5 9123456789abcdef")

    def test_a_family_missing_from_a_build_writes_nothing(self):
        second = f"{self.FIRST};echo fill 3 0123456789abcdef"
        for builds in ((f"a={self.FIRST}", f"b={second}"), (f"a={second}", f"b={self.FIRST}")):
            self.expect("from", *builds)

    def test_a_program_that_prints_nothing_is_an_error(self):
        self.expect("a: 'true' printed no digest; build it anew", "a=true", "b=true")

    def test_lines_that_are_no_digest_are_an_error(self):
        for line in ("queue 0 0123456789abcdef", "queue 5", "queue 5 0123", "digest 12 a.calls"):
            self.expect(f"printed no digest but '{line}'", f"a=echo {line}", f"b=echo {line}")

    def test_one_build_alone_is_refused(self):
        self.expect("one build has nothing to agree with", f"a={self.FIRST}")
        self.expect("'b=' has no command", f"a={self.FIRST}", "b=")

    def test_recordings_that_are_missing_are_an_error(self):
        for name in ("dandelion", "fig"):
            self.write(f"build/release/tests/replay/{name}.calls", "x")
        self.write("build/release/tests/replay/torture.calls", "")
        self.expect_failure("lasso.calls is missing", "same-bits", "--size", "long")


class Sources(Project):
    def setUp(self):
        super().setUp()
        self.stand_in("git", "echo a.cpp; echo b.cpp")
        for tool in ("clang-format", "clang-tidy"):
            self.stand_in(tool, "exit 0")

    def test_are_counted(self):
        self.expect_row("2 files", "format", "--check")
        self.expect_row("2 sources, 0 warnings", "tidy")

    def test_without_any_it_is_an_error(self):
        for git in ("exit 0", "echo 'fatal: not a git repository' >&2; exit 128"):
            self.stand_in("git", git)
            for arguments in (("format", "--check"), ("tidy",)):
                self.expect_failure("call this in a checkout of the project", *arguments)
            self.assertEqual(self.dev("format").returncode, 1)

    def test_a_tool_that_cannot_be_had_is_an_error(self):
        for tool, arguments in (("clang-format", ("format", "--check")), ("clang-tidy", ("tidy",))):
            (self.folder / "bin" / tool).unlink()
            self.stand_in("apt-get", "exit 100")
            self.expect_failure("failed; the whole log is", *arguments)
            self.stand_in("apt-get", "exit 0")  # and nothing is there all the same
            self.expect_failure("", *arguments)

    def test_a_warning_is_an_error_even_if_the_tool_is_content(self):
        self.stand_in("clang-tidy", 'echo "$4:3:1: warning: mistake"')
        self.expect_failure("clang-tidy warns 2 times", "tidy")

    def test_a_source_that_was_not_analysed_is_an_error(self):
        self.stand_in("clang-tidy", '[ "$4" != b.cpp ]')
        self.expect_failure("", "tidy")
        self.stand_in("xargs", "exit 0")
        self.expect_failure("clang-tidy analysed 0 of 2 sources", "tidy")


class Valgrind(Project):
    SUMMARY = "==12== ERROR SUMMARY: 0 errors from 0 contexts (suppressed: 0 from 0)"
    GOOD = ("[  PASSED  ] 706 tests.", "20000 rounds of hostile calls, no complaint",
            "0 differences in 2400 cases of 24 families", SUMMARY)

    def says(self, *lines):
        self.write("lines", "\n".join(lines) + "\n")
        self.stand_in("valgrind", "case $* in *cpp_tests*) cat lines ;; esac")

    def test_what_ran_is_counted(self):
        self.says(*self.GOOD)
        self.expect_row("706 tests, 20000 rounds of hostile calls, 2400 cases: 0 errors", "valgrind")

    def test_programs_that_say_nothing_are_an_error(self):
        for line in self.GOOD:
            with self.subTest(without=line):
                self.says(*(other for other in self.GOOD if other != line))
                self.expect_failure("has no line", "valgrind")

    def test_a_skipped_test_is_an_error(self):
        self.says(*self.GOOD, "[  SKIPPED ] 1 test, listed below:")
        self.expect_failure("a test was skipped", "valgrind")

    def test_errors_are_an_error_whatever_the_status(self):
        self.says(*self.GOOD, self.SUMMARY.replace("0 errors", "1,002 errors"))
        self.expect_failure("valgrind counts 1002 errors", "valgrind")


class EmulatedJvm(Project):
    def setUp(self):
        super().setUp()
        self.write("build/aarch64/libdraventaUtil.so", "")
        self.write("build/aarch64/tests/standins/liblog.so", "")
        self.write("desktop/scripts/fig.digest", "384A3168")

    def test_right_digests_are_counted(self):
        self.program("tests/jvm/emulated_jdk.sh", "echo 1 of 1 digests are right")
        self.expect_row("1 right digest", "emulated-jvm")

    def test_a_machine_that_cannot_be_had_is_an_error(self):
        self.stand_in("qemu-aarch64", "exit 0")
        self.stand_in("dpkg-deb", "exit 0")
        self.stand_in("apt-get", "case $* in *download*) exit 100 ;; esac")
        self.expect_failure("not checked: the packages cannot be had", "emulated-jvm")
        self.assertEqual(self.rows()["emulated-jvm"], [("fig script in an AArch64 Java VM",
                                                       "not checked: the packages cannot be had")])
        self.assertEqual(self.dev("summary").returncode, 1)

    def test_no_digest_is_an_error(self):
        for output in ("", "0 of 0 digests are right", "0 of 1 digests are right"):
            self.program("tests/jvm/emulated_jdk.sh", f"echo '{output}'")
            self.expect_failure("", "emulated-jvm")

    def test_a_wrong_digest_is_an_error(self):
        self.program("root/usr/lib/jvm/java-17-openjdk-arm64/bin/java", "exit 0")
        self.stand_in("qemu-aarch64", "exit 1")
        result = self.run_command("tests/jvm/emulated_jdk.sh", "root", "--library", "build/aarch64",
                                  "--player", "p.jar", "desktop/scripts/fig.strokes")
        self.assertEqual((result.returncode, result.stdout.splitlines()[-1]),
                         (1, "0 of 1 digests are right"))


class Screen(Project):
    def setUp(self):
        super().setUp()
        self.program("build/release/tests/window/times", "exit 0")
        for name in ("WindowTest", "HighDensityTest"):
            self.write(f"tests/window/{name}.java", "")

    def says(self, successful, skipped=0):
        self.stand_in("xvfb-run", f"""
            echo '[ {skipped} tests skipped ]'
            echo '[ 0 tests aborted ]'
            echo '[ {successful} tests successful ]'""")

    def test_tests_are_counted(self):
        self.says(14)
        self.expect_row("28 passed, 0 skipped", "screen")

    def test_no_test_is_an_error(self):
        self.says(0)
        self.expect_failure("so nothing was checked", "screen")
        self.stand_in("xvfb-run", "exit 0")
        self.expect_failure("has no line", "screen")

    def test_a_skipped_test_is_an_error(self):
        self.says(14, skipped=1)
        self.expect_failure("2 tests of the window were skipped", "screen")

    def test_a_class_that_no_call_runs_is_an_error(self):
        self.says(14)
        self.write("tests/window/TouchTest.java", "")
        self.expect_failure("no call here runs tests/window/TouchTest.java", "screen")


class Pages(Project):
    def test_without_pages_and_pictures_it_is_an_error(self):
        (self.folder / "docs/operations").mkdir(parents=True)
        self.write("desktop/photos/ATTRIBUTION.md", "")
        result = self.run_command("tests/docs/check_pages.py")
        self.assertEqual(result.returncode, 1)
        self.assertIn("no script draws a picture", result.stderr)
        self.assertIn("no page has a link", result.stderr)
        self.expect_failure("", "docs")

    def test_figures_of_another_form_are_an_error(self):
        for output in ("", "0 pages, 3 pictures, 0 wrong", "3 pages, 0 pictures, 0 wrong"):
            self.write("tests/docs/check_pages.py", f"print('{output}')")
            self.expect_failure("check_pages.py counted no pages and pictures", "docs")

    def documents(self, headers, classes):
        """Doxygen and javadoc write these pages of two installed headers and two classes."""
        self.write("CMakeLists.txt", "project(draventaUtil VERSION 1.0.0)\n")
        self.write("tests/docs/check_pages.py", "print('3 pages, 4 pictures, 0 wrong')")
        self.write("java/a/First.java", "public class First {}\n")
        self.write("java/a/Second.java", "public class Second {}\n")
        self.write("java/a/Third.java", "class Third {}\n")
        self.stand_in("git", "find java -name '*.java'")
        self.stand_in("cmake", """
            mkdir -p build/docs/installed
            touch build/docs/installed/a.h build/docs/installed/b.h""")
        self.stand_in("doxygen", f"cd build/docs/headers; touch {headers} end")
        self.stand_in("javadoc", f"""
            mkdir -p build/docs/java/a
            cd build/docs/java/a
            touch {classes} end""")

    def test_pages_of_the_reference_are_counted(self):
        self.documents("a_8h.html b_8h.html", "First.html Second.html")
        self.expect_row("3 pages, 4 pictures, 2 headers, 2 classes", "docs")

    def test_a_reference_without_a_header_or_a_class_is_an_error(self):
        self.documents("b_8h.html", "First.html Second.html")
        self.expect_failure("lacks a page for some of the 2 installed headers", "docs")
        self.documents("a_8h.html b_8h.html", "First.html")
        self.expect_failure("the reference lacks a page for a/Second.java", "docs")

    def test_without_commands_it_is_an_error(self):
        self.write(".ci/run", "./dev test\n")
        self.expect_failure("no command was found in any page", "commands")
        self.write(".ci/run", "")
        self.expect_failure("no command was found in .ci/run", "commands")


class Archive(Project):
    def test_no_way_to_break_it_is_an_error(self):
        self.write("build/release/package/libdraventaUtil.so", "")
        for script in ("assemble_aar.py", "check_aar.py", "tests/assemble_aar_test.py"):
            self.write(f"android/{script}", "")
        for output, message in (("Ran 0 tests in 0.0s", "so nothing was checked"),
                                ("", "has no line")):
            self.write("android/tests/check_aar_test.py", f"print('{output}')")
            self.expect_failure(message, "aar")


class Coverage(Project):
    def test_skipped_tests_and_no_tests_are_an_error(self):
        for output in ("[  PASSED  ] 0 tests.", "", "[  PASSED  ] 5 tests.\n[  SKIPPED ] 1 test"):
            self.program("cpp_tests", f"echo '{output}'")
            with self.assertRaisesRegex(SystemExit, "skipped tests or ran none"):
                coverage.run_tests([self.folder / "cpp_tests"], self.folder / "coverage")


class Binary(Project):
    MARK = "      Properties: AArch64 feature: BTI, PAC\n"

    def setUp(self):
        super().setUp()
        path = os.environ["PATH"]
        os.environ["PATH"] = str(self.folder / "bin")
        self.addCleanup(os.environ.__setitem__, "PATH", path)

    def test_tools_that_say_nothing_leave_no_property_right(self):
        self.stand_in("nm", "exit 0")
        for header in ("", "ELF64"):
            self.stand_in("readelf", f'[ "$1" != -h ] || echo {header}')
            for what, check in binary.LIBRARY_CHECKS.items():
                with self.subTest(what, header=header):
                    try:
                        self.assertNotEqual(check("library.so"), "")
                    except SystemExit as error:
                        self.assertIn("library.so", str(error))

    def protection(self, library, **objects):
        self.stand_in("readelf", 'cat "$2"')
        self.write("library.so", library)
        for name, notes in objects.items():
            self.write(f"objects/{name}.o", notes)
        return binary.check_branch_protection(self.folder / "library.so", [self.folder / "objects"])

    def test_a_library_with_branch_protection_is_marked(self):
        self.assertEqual(self.protection(self.MARK, a=self.MARK), "")

    def test_an_object_without_branch_protection_is_named(self):
        half = self.MARK.replace(", PAC", "")
        for notes in ("", half):
            self.assertEqual(self.protection(notes, a=self.MARK, operator_new=notes),
                             "not marked; without protection are: operator_new.o")

    def test_a_library_that_lost_its_mark_is_found(self):
        self.assertIn("none of its objects", self.protection("", a=self.MARK))

    def test_the_same_file_twice_is_no_pair_of_builds(self):
        self.write("library.so", "x")
        library = self.folder / "library.so"
        self.assertIn("is the same file", binary.check_twins(library, library))


class Exports(Project):
    def test_a_library_and_a_list_without_names_are_an_error(self):
        self.write("exports.txt", "# nothing\n")
        result = subprocess.run(
            [programs.cmake, "-D", "NM=true", "-D", "LIBRARY=library.so", "-D",
             f"EXPECTED={self.folder / 'exports.txt'}", "-P", ROOT / "tests/exports_test.cmake"],
            text=True, capture_output=True)
        self.assertNotEqual(result.returncode, 0)
        self.assertIn("exports nothing", result.stderr)


def main():
    global programs
    parser = argparse.ArgumentParser(description=__doc__.splitlines()[0])
    parser.add_argument("--differential", required=True, type=os.path.abspath,
                        help="the program that compares with models")
    parser.add_argument("--cmake", required=True)
    programs, others = parser.parse_known_args()
    unittest.main(argv=[sys.argv[0], *others])


if __name__ == "__main__":
    main()
