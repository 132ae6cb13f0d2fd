"""What becomes of mutants of the C++ sources.

One snapshot of the sources is built twice, plainly and with sanitizers. A mutant is a folder that
holds the changed file alone and comes first on the include path: only what includes that file is
compiled anew, by the compiler itself, and linked with the objects that are there.

A mutant goes through these steps until one settles its fate:

  compile        the objects of the library; do they differ from the original's?
  unit tests     the tests of the file's own name, then all quick ones, then the slow ones
  same code      equal objects with optimisation as well
  differential   a fixed number of cases against the slow models
  sanitizers     the tests once more, with AddressSanitizer and UndefinedBehaviorSanitizer

A header's mutant is tested first with the tests' objects as they were. A failure counts, since the
linker takes the library's copy of an inline function. A pass decides nothing: then the tests that
include it are compiled anew, those of its own name first.
"""

import json
import pathlib
import re
import shlex
import subprocess
import threading

from mutants import FOLDERS, ROOT, processor_of
from processes import PROCESSOR, run
from steps import COMPILE_SECONDS, HANG_FACTOR, HANG_SECONDS, PROOF_FACTOR, PROOF_SECONDS
from steps import Fate, Settled, StepFailed

COPIED = FOLDERS + ["cmake", "tests", "CMakeLists.txt", "draventaUtil.h", "exports.txt"]
UNCOPIED = ["tests/mutation", "tests/jvm"]  # what this script and the Java tests are made of

FLAGS = "-O1 -Werror=return-type"
TOOLCHAIN = "-DCMAKE_TOOLCHAIN_FILE={source}/cmake/toolchains/{name}.cmake"
BUILDS = {  # folder -> CMake arguments, what runs its programs
    "plain": ([], []),
    "sanitized": (["-DDRAVENTA_SANITIZERS=address,undefined,float-cast-overflow"], []),
    "aarch64": ([TOOLCHAIN], ["qemu-aarch64", "-L", "/usr/aarch64-linux-gnu"]),
    "s390x": ([TOOLCHAIN], ["qemu-s390x", "-L", "/usr/s390x-linux-gnu"]),
}
TESTS = "tests/cpp_tests"
MODELS = "tests/differential/differential"
FAMILY_DONE = r"^(\S+) \d+ [0-9a-f]{16}$"  # the line that the models print behind a family
BUILDS_OF = {  # what takes the mutants that a processor's compiler sees
    "x86-64": ["plain", "sanitized"],
    "AArch64": ["aarch64"],
    "s390x": ["s390x"],
}
NOTHING = pathlib.Path("/nonexistent")  # for an overlay
LINKER = ["-fuse-ld=mold", "-Wl,--threads=1"]
MODEL_CASES = ["--digests", "short"]  # some 230,000, always the same

QUICK = 0.05  # seconds of a test
HANGS = 2  # that are looked past for a test that fails

EMULATED_TESTS = "tests/render/"  # what only other processors compile is a matter of rendering

TESTS_OF_FILES = {  # those that have no test of their own name
    "jni/java_access.h": ["tests/jni/Util_drawing_test.cpp", "tests/jni/Util_selection_test.cpp"],
    "render/row_kernels_neon.cpp": ["tests/render/row_kernels_test.cpp",
                                    "tests/render/compositing_test.cpp"],
    "render/row_loops.h": ["tests/render/row_kernels_test.cpp"],
    "selection/competition_rules.h": ["tests/selection/competition_plain_test.cpp"],
    "selection/front_queue.h": ["tests/selection/front_competition_test.cpp"],
    "selection/interior_pass.h": ["tests/selection/region_erase_test.cpp"],
    "selection/lasso_values.h": ["tests/selection/lasso_segment_test.cpp",
                                 "tests/selection/region_fill_lasso_test.cpp"],
}

def own_tests(file):
    """Test sources that carry a source's name."""
    test = f"tests/{file.rpartition('.')[0]}_test.cpp"
    return TESTS_OF_FILES.get(file) or ([test] if (ROOT / test).exists() else [])


# --- the library as it is -------------------------------------------------------------------------


class Unit:
    """A source that is compiled into one object."""

    def __init__(self, entry, source):
        words = [w for w in shlex.split(entry["command"]) if not w.endswith("ccache")]
        self.folder = entry["directory"]
        self.file = str(pathlib.Path(entry["file"]).relative_to(source))
        self.object = words[words.index("-o") + 1]
        self.words = words
        self.of_library = "draventa_core.dir/" in self.object
        self.dependencies = set()  # files of ours that it is made of

    def command(self, source, overlay, output, *options):
        """Compiles with the overlay's files before those of the source."""
        words = list(self.words)
        words[words.index("-o") + 1] = output
        words[1:1] = [f"-I{overlay}"]
        words[words.index("-c"):words.index("-c")] = options
        if (overlay / self.file).exists():
            words[words.index(str(source / self.file))] = overlay / self.file
        return words


class Build:
    """A build folder: its units, how its programs are linked, and what its tests take."""

    def __init__(self, work, source, name):
        self.name = name
        self.folder = work / name
        self.source = source
        options, self.emulator = BUILDS[name]
        self.options = [o.format(source=source, name=name) for o in options]
        self.linker = [] if self.emulator else LINKER
        self.links = {}
        self.times = {}  # of a test alone, in processor seconds
        self.lock = threading.Lock()
        self.optimised = {}

    def make(self, *targets):
        configure = ["cmake", "-S", self.source, "-B", self.folder, "-G", "Ninja",
                     "-DDRAVENTA_JAVA=OFF", f"-DCMAKE_CXX_FLAGS={FLAGS}", *self.options]
        log = f"{self.folder}.log"
        if not run(configure, 300, log=log).ok:
            raise StepFailed(f"configuring {self.folder} failed; see {log}")
        if not run(["ninja", "-C", self.folder, "-j2", *targets], 3600, log=log).ok:
            raise StepFailed(f"building {self.folder} failed; see {log}")
        self.units = self.read_units()
        for target in targets:
            commands = self.ninja("-t", "commands", target).split("\n")
            link = [c for c in commands if f" -o {target} " in c][-1]
            words = shlex.split(link)
            first = 2 if words[0] == ":" else 0  # ': && c++ … && :'
            last = words.index("&&", first) if "&&" in words[first:] else len(words)
            self.links[target] = [w for w in words[first:last] if not w.endswith("ccache")]
        self.read_tests()
        if MODELS in targets:
            outcome = self.green([MODELS, *MODEL_CASES], "models")
            self.model_seconds = outcome.seconds
            self.families = re.findall(FAMILY_DONE, outcome.output.read_text(), re.M)

    def ninja(self, *arguments):
        return subprocess.run(["ninja", "-C", self.folder, "--quiet", *arguments], check=True,
                              capture_output=True, text=True).stdout

    def read_units(self):
        """The units of library, tests and models, with the files each depends on."""
        entries = json.loads((self.folder / "compile_commands.json").read_text())
        units = [Unit(e, self.source) for e in entries
                 if pathlib.Path(e["file"]).is_relative_to(self.source)]
        units = {u.object: u for u in units
                 if re.search(r"(draventa_core|cpp_tests|draventa_differential)\.dir/", u.object)}
        unit = None
        for line in self.ninja("-t", "deps").split("\n"):
            if line and not line.startswith(" "):
                unit = units.get(line.split(":")[0])
            elif line.strip() and unit:
                path = (self.folder / line.strip()).resolve()
                if path.is_relative_to(self.source):
                    unit.dependencies.add(str(path.relative_to(self.source)))
        return list(units.values())

    def command(self, program, *arguments):
        """Runs a program of this build, or one in its place."""
        return [*self.emulator, self.folder / program, *arguments]

    def green(self, command, name):
        """The outcome of a program that has to succeed, as it does without a mutant."""
        outcome = run(self.command(*command), 3600, self.folder, f"{self.folder}-{name}.log")
        if not outcome.ok:
            raise StepFailed(f"not green without a mutant: see {outcome.output}")
        return outcome._replace(output=pathlib.Path(outcome.output))

    def read_tests(self):
        """Which tests there are, of which source, which are slow, and what they take."""
        listed = self.read_output("--gtest_list_tests")
        self.every = set(listed)
        self.tests = {}  # name -> source
        for name, test in listed.items():
            file = (self.folder / test["file"]).resolve()  # a compiler cache shortens it
            source = str(file.relative_to(self.source))
            if not self.emulator or source.startswith(EMULATED_TESTS):
                self.tests[name] = source
        if not self.tests:
            raise StepFailed("there are no tests")
        output = self.read_output(filter_of(set(self.tests), self.every))
        self.clock = {name: float(output[name]["time"].rstrip("s")) for name in self.tests}
        self.slow = {name for name, clock in self.clock.items() if clock >= QUICK}

    def read_output(self, option):
        """What the tests say in JSON, by name."""
        result = self.folder / "tests.json"
        self.seconds = self.green([TESTS, option, f"--gtest_output=json:{result}"], "tests").seconds
        return {f"{suite['name']}.{test['name']}": test
                for suite in json.loads(result.read_text())["testsuites"]
                for test in suite["testsuite"]}

    def groups(self, file):
        """All tests in the order to run them: groups of names."""
        own_sources = own_tests(file)
        own = {t for t, source in self.tests.items() if source in own_sources}
        every = set(self.tests)
        return [g for g in (own - self.slow, every - own - self.slow, own & self.slow,
                            (every - own) & self.slow) if g]

    def groups_in(self, test_file):
        names = {t for t, source in self.tests.items() if source == test_file}
        return [names] if names else []

    def limit(self, tests):
        """Processor seconds after which some of the tests are taken to hang."""
        share = sum(self.clock[t] for t in tests) / max(sum(self.clock.values()), 0.001)
        return max(HANG_FACTOR * self.seconds * share, HANG_SECONDS)

    def time_alone(self, *command):
        """Processor seconds that a program takes without a mutant."""
        with self.lock:
            if command not in self.times:
                self.times[command] = self.green(command, "alone").seconds
            return self.times[command]

    def optimised_object(self, unit):
        """The bytes of a unit's object at -O2."""
        with self.lock:
            if unit.object not in self.optimised:
                output = self.folder / "optimised.o"
                command = unit.command(self.source, NOTHING, output, "-O2")
                if not run(command, COMPILE_SECONDS, unit.folder).ok:
                    raise StepFailed(f"{unit.file} does not compile at -O2")
                self.optimised[unit.object] = output.read_bytes()
            return self.optimised[unit.object]

    def link(self, target, replaced, output):
        """Links a program with some objects replaced."""
        words = [replaced.get(w, w) for w in self.links[target]]
        words[words.index("-o") + 1] = output
        return words[:1] + self.linker + words[1:]


class Original:
    """The library without a mutant, built and tested. Workers share it."""

    def __init__(self, work):
        self.work = work
        self.source = work / "source"
        self.builds = {}
        self.making = threading.Lock()

    def prepare(self):
        """Takes the snapshot; builds are made when the first mutant needs them."""
        for name in COPIED:
            self.copy(name)

    def build_for(self, processor):
        """The build with the unit tests and the models for a processor."""
        names = BUILDS_OF[processor]
        with self.making:
            if names[0] not in self.builds:
                made = {name: Build(self.work, self.source, name) for name in names}
                for name, build in made.items():
                    build.make(*([TESTS] if name == "sanitized" else [TESTS, MODELS]))
                self.builds.update(made)
                if "sanitized" in made:
                    self.find_reach()
        return self.builds[names[0]]

    def copy(self, name):
        """Brings one file or folder of the snapshot up to date; what is equal stays untouched."""
        paths = sorted((ROOT / name).rglob("*")) if (ROOT / name).is_dir() else [ROOT / name]
        files = {p.relative_to(ROOT) for p in paths if p.is_file()
                 and not any(p.is_relative_to(ROOT / u) for u in UNCOPIED)}
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

    def find_reach(self):
        """Which slow tests run anything of a unit of the library, as gcov counts it."""
        folder = self.work / "counted"
        folder.mkdir(exist_ok=True)
        plain = self.builds["plain"]
        units = [u for u in plain.units if u.of_library]
        replaced = {}
        for number, unit in enumerate(units):
            output = folder / f"{number}.o"
            command = unit.command(self.source, NOTHING, output, "--coverage")
            if not run(command, COMPILE_SECONDS, unit.folder).ok:
                raise StepFailed(f"{unit.file} does not compile with counters")
            replaced[unit.object] = output
        program = folder / "tests"
        link = plain.link(TESTS, replaced, program) + ["--coverage"]
        if not run(link, COMPILE_SECONDS, plain.folder).ok:
            raise StepFailed("the tests do not link with counters")
        self.reach = {unit.object: set() for unit in units}
        for test in sorted(plain.slow):
            plain.green([program, f"--gtest_filter={test}"], "counted")
            for number, unit in enumerate(units):
                if self.takes_part(folder / f"{number}.gcda"):
                    self.reach[unit.object].add(test)

    def reaching(self, groups, objects):
        """Groups of tests without those slow ones that run nothing of some of the library's
        objects, and so cannot notice a change there."""
        reaching = set().union(*(self.reach[name] for name in objects))
        left_out = self.builds["plain"].slow - reaching
        return [group - left_out for group in groups if group - left_out]

    @staticmethod
    def takes_part(counts):
        """Whether a function was run; true where there are none, but data perhaps."""
        if not counts.exists():
            return True
        text = subprocess.run(["gcov", "--json-format", "--stdout", counts], check=True,
                              capture_output=True, text=True).stdout
        counts.unlink()
        functions = [f for file in json.loads(text)["files"] for f in file["functions"]]
        return not functions or any(f["execution_count"] for f in functions)


def filter_of(names, every):
    """GoogleTest's filter for some of all tests, the shorter way round."""
    others = every - names
    return "--gtest_filter=" + (":".join(names) if len(names) <= len(others)
                                else "-" + ":".join(others))


# --- one mutant -----------------------------------------------------------------------------------


class Trial:
    """Finds out the fate of one mutant after the other, in a folder of its own."""

    def __init__(self, original, folder):
        self.original = original
        self.folder = folder
        self.overlay = folder / "overlay"
        self.log = folder / "output.log"

    def fate(self, mutant):
        self.seconds = 0
        path = self.overlay / mutant.file
        path.parent.mkdir(parents=True, exist_ok=True)
        text = (self.original.source / mutant.file).read_text()
        path.write_text(text[:mutant.start] + mutant.replacement + text[mutant.end:])
        try:
            self.go(mutant.file, self.original.build_for(processor_of(mutant)))
            fate, by = "survived", ""
        except Settled as settled:
            fate, by = settled.fate, settled.by
        finally:
            path.unlink()
        return Fate(fate, by, self.seconds)

    def run(self, command, seconds, folder):
        outcome = run(command, seconds, folder, self.log)
        self.seconds += outcome.seconds
        return outcome

    def go(self, file, build):
        """Raises Settled, or returns when the mutant has survived."""
        affected = [u for u in build.units if file in u.dependencies]
        library = [u for u in affected if u.of_library]
        tests = [u for u in affected if "cpp_tests.dir/" in u.object]
        models = [u for u in affected if "draventa_differential.dir/" in u.object]
        if not library:
            raise StepFailed(f"no object of the library is made of {file}")

        self.hung = []
        self.objects = {}
        for unit in library:
            self.compile(unit)
        if not self.objects and not tests:
            raise Settled("same code", "-O1")
        groups = build.groups(file)
        if build.name == "plain" and not tests:
            groups = self.original.reaching(groups, self.objects)
        if self.objects:
            self.unit_tests(build, groups)
        if tests:
            of_library = len(self.objects)
            for unit in sorted(tests, key=lambda u: u.file not in own_tests(file)):
                if self.compile(unit):
                    self.unit_tests(build, build.groups_in(unit.file))
            if not self.objects:
                raise Settled("same code", "-O1")
            if len(self.objects) > of_library:
                self.unit_tests(build, groups)
        if self.hung:
            self.settle_hang()
        self.same_when_optimised(build, library + tests)
        self.models(build, models)
        if build.name == "plain":
            self.sanitizers(file, {u.object for u in library})

    def compile(self, unit, prefix=""):
        """Compiles a unit with the mutant. Keeps its object and returns True if it differs from the
        original."""
        output = self.folder / f"{prefix}{len(self.objects)}.o"
        command = unit.command(self.original.source, self.overlay, output)
        outcome = self.run(command, COMPILE_SECONDS, unit.folder)
        if outcome.ran_out:
            raise Settled("hung", f"compiling {unit.file}")
        if not outcome.ok:
            raise Settled("does not compile")
        if output.read_bytes() == (pathlib.Path(unit.folder) / unit.object).read_bytes():
            return False
        self.objects[unit.object] = output
        return True

    def link(self, build, target):
        program = self.folder / pathlib.Path(target).name
        command = build.link(target, self.objects, program)
        if not self.run(command, COMPILE_SECONDS, build.folder).ok:
            raise Settled("does not compile", "it does not link")
        return program

    def unit_tests(self, build, groups):
        self.run_groups(build, self.link(build, TESTS), groups, "unit tests")

    def run_groups(self, build, program, groups, stage):
        """Runs groups of tests until one fails. Tests that hang are looked past a few times, for
        one that fails."""
        for group in groups:
            left = group - {entry[-1] for entry in self.hung}
            while left:
                command = build.command(program, "--gtest_fail_fast", filter_of(left, build.every))
                outcome = self.run(command, build.limit(left), build.folder)
                if outcome.ok:
                    break
                output = self.log.read_text(errors="replace")
                started = re.findall(r"^\[ RUN      \] (\S+)", output, re.M)
                test = started[-1] if started else ""
                if not outcome.ran_out:
                    failed = re.search(r"^\[  FAILED  \] ([^\s,]+)", output, re.M)
                    raise Settled(stage, failed[1] if failed else f"crash in {test}")
                if test not in left:
                    raise Settled("hung", "between tests")
                self.hung.append((build, program, stage, test))
                if len(self.hung) >= HANGS:
                    self.settle_hang()
                left = left - {test}

    def settle_hang(self):
        build, program, stage, test = self.hung[0]
        alone = f"--gtest_filter={test}"
        start = build.time_alone(TESTS, "--gtest_filter=-*")
        usual = max(build.time_alone(TESTS, alone) - start, 0)
        self.prove(build, stage, usual, [program, alone], test)

    def prove(self, build, stage, usual, command, by):
        """What takes a hundred times as long as without the mutant hangs."""
        outcome = self.run(build.command(*command),
                           max(PROOF_FACTOR * usual, PROOF_SECONDS), build.folder)
        if outcome.ran_out == PROCESSOR:
            raise Settled("hung, proven", by)
        if not outcome.ok and not outcome.ran_out:
            raise Settled(stage, by)
        raise Settled("hung", by)  # slow alone: somebody has to say why that is right

    def same_when_optimised(self, build, units):
        for unit in units:
            output = self.folder / "optimised.o"
            command = unit.command(self.original.source, self.overlay, output, "-O2")
            if not self.run(command, COMPILE_SECONDS, unit.folder).ok:
                return
            if output.read_bytes() != build.optimised_object(unit):
                return
        raise Settled("same code", "-O2")

    def models(self, build, units):
        objects = dict(self.objects)
        for unit in units:
            self.compile(unit)
        program = self.link(build, MODELS)
        self.objects = objects
        limit = max(HANG_FACTOR * build.model_seconds, HANG_SECONDS)
        outcome = self.run(build.command(program, *MODEL_CASES), limit, build.folder)
        if outcome.ok:
            return
        output = self.log.read_text(errors="replace")
        family = build.families[len(re.findall(FAMILY_DONE, output, re.M))]
        if not outcome.ran_out:
            raise Settled("differential", f"family {family}")
        alone = [*MODEL_CASES, "--family", family]
        self.prove(build, "differential", build.time_alone(MODELS, *alone), [program, *alone],
                   f"family {family}")

    def sanitizers(self, file, library):
        """The tests' own objects stay as they are, with what they hold of a header."""
        build = self.original.builds["sanitized"]
        self.objects = {}
        for unit in build.units:
            if unit.object in library:
                self.compile(unit, "sanitized-")
        if not self.objects:
            return  # only the optimiser told them apart
        groups = self.original.reaching(build.groups(file), self.objects)
        self.run_groups(build, self.link(build, TESTS), groups, "sanitizers")
        if self.hung:
            self.settle_hang()

    def end(self):
        pass
