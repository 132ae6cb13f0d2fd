"""What becomes of mutants of the Java classes that are shipped.

A compiler that stays in memory compiles all of them with the mutant. Each group of test classes runs
in a virtual machine of its own, on the real library under -Xcheck:jni, until a test fails: the
classes' own tests first, then those of the player and the editing screen that use them.
"""

import os
import pathlib
import re
import shutil
import subprocess
import threading

from mutants import JAVA, ROOT
from processes import ENVIRONMENT, PROCESSOR, TICK, run
from steps import COMPILE_SECONDS, HANG_FACTOR, HANG_SECONDS, PROOF_FACTOR, PROOF_SECONDS
from steps import Fate, Settled, StepFailed

JUNIT = pathlib.Path("/usr/share/java/junit-platform-console-standalone.jar")
PACKAGE = "com.velt.android.orvane.lumetrix"
GROUPS = [  # of test classes; what comes first is quick
    ["selection.AreaTest", "selection.MaskChangeTest", "selection.SelectionSessionTest",
     "selection.SelectionRefusalsTest", "selection.SelectionDrawingTest",
     "selection.SelectionUndoTest"],
    ["jni.UtilAtFirstTest"],
    ["jni.UtilSessionTest", "jni.UtilDrawingTest", "jni.UtilStrokesTest"],
    ["jni.UtilLongSessionTest"],
    ["sample.SelectionViewTest", "desktop.RecordingTest", "desktop.RecordedScriptTest",
     "desktop.editing.StrokesTest", "desktop.editing.EditorTest", "desktop.editing.EditorReplayTest",
     "desktop.editing.EditorRandomTest"],
]
NOT_RUN = ["jni.UtilMemoryTest"]  # it measures the process, for a minute
SOURCES = {  # what is compiled, in this order; each sees those before
    "standins": ["desktop/standins"],
    "face": [JAVA],
    "desktop": ["desktop/src", "android/sample"],
    "tests": ["tests/jvm"],
    "tools": ["tests/mutation/jvm"],
}
# As tests/jvm/CMakeLists.txt has them; quicker to start, since no machine runs for long.
JAVA_OPTIONS = ["-Xcheck:jni", "-XX:TieredStopAtLevel=1", "-Xshare:auto", "-XX:+UseSerialGC",
                "-Djava.awt.headless=true", f"-Ddesktop.folder={ROOT}/desktop"]
JNI_WARNING = re.compile("WARNING in native method|WARNING: JNI|FATAL ERROR in native method")


def sources(folders):
    found = sorted(str(p) for folder in folders for p in (ROOT / folder).rglob("*.java"))
    if not found:
        raise StepFailed(f"no Java sources in {folders}")
    return found


class Original:
    """Classes, tests and library without a mutant. Workers share them."""

    def __init__(self, work):
        self.work = work / "java"
        self.library = self.work / "library"

    def prepare(self):
        if not JUNIT.exists():
            raise StepFailed(f"there is no {JUNIT}")
        classes = {f"{PACKAGE}.{name}" for group in GROUPS + [NOT_RUN] for name in group}
        present = {str(p.relative_to(ROOT / "tests/jvm"))[:-5].replace("/", ".")
                   for p in (ROOT / "tests/jvm").rglob("*Test.java")
                   if "/selection/" in str(p) or "/jni/" in str(p)}
        if present - classes:
            raise StepFailed(f"in no group of tests: {sorted(present - classes)}")
        self.work.mkdir(parents=True, exist_ok=True)
        self.build_library()
        for name, folders in SOURCES.items():
            shutil.rmtree(self.work / name, ignore_errors=True)
            release = "11" if name == "face" else "17"
            command = ["javac", "--release", release, "-g:none", "-nowarn", "-d", self.work / name,
                       "-cp", self.class_path(self.work / "face"), *sources(folders)]
            log = self.work / f"{name}.log"
            if not run(command, COMPILE_SECONDS, log=log).ok:
                raise StepFailed(f"compiling {folders} failed; see {log}")
        self.classes = class_files(self.work / "face")
        self.times = {}  # of a test's thread, in processor seconds
        self.seconds = []  # of the groups
        for group in GROUPS:
            log = self.work / "tests.log"
            outcome = run(self.command(self.work / "face", group), 600, log=log)
            output = log.read_text(errors="replace")
            if not outcome.ok or JNI_WARNING.search(output):
                raise StepFailed(f"not green without a mutant: see {log}")
            self.seconds.append(outcome.seconds)
            self.times.update((test, float(seconds)) for seconds, test
                              in re.findall(r"^OK (\S+) (.*)$", output, re.M))

    def build_library(self):
        configure = ["cmake", "-S", ROOT, "-B", self.library, "-G", "Ninja", "-DDRAVENTA_TESTS=OFF",
                     "-DDRAVENTA_JAVA=OFF", "-DCMAKE_BUILD_TYPE=Release"]
        log = self.work / "library.log"
        if not (run(configure, 300, log=log).ok and
                run(["ninja", "-C", self.library, "-j2", "draventaUtil"], 3600, log=log).ok):
            raise StepFailed(f"building the library failed; see {log}")

    def class_path(self, face):
        others = [self.work / name for name in SOURCES if name != "face"]
        return ":".join(map(str, [*others, face, JUNIT]))

    def command(self, face, tests):
        """Runs test classes, or one test by its id."""
        names = [t if t.startswith("[") else f"{PACKAGE}.{t}" for t in tests]
        return ["java", *JAVA_OPTIONS, f"-Djava.library.path={self.library}", "-cp",
                self.class_path(face), "FirstFailure", *names]


def class_files(folder):
    return {str(p.relative_to(folder)): p.read_bytes() for p in folder.rglob("*.class")}


class Compiler:
    """The compiler that stays."""

    def __init__(self, original):
        self.process = subprocess.Popen(
            ["java", "-XX:+UseSerialGC", "-Xshare:auto", "-cp", original.work / "tools", "Compiler"],
            stdin=subprocess.PIPE, stdout=subprocess.PIPE, stderr=subprocess.DEVNULL, text=True,
            env=ENVIRONMENT)

    def used(self):
        fields = pathlib.Path(f"/proc/{self.process.pid}/stat").read_text().rpartition(")")[2]
        return sum(map(int, fields.split()[11:13])) / TICK

    def compile(self, arguments, files):
        """Whether the files compile, and the processor seconds that it took."""
        before = self.used()
        self.process.stdin.write("\t".join([*map(str, arguments), "--", *files]) + "\n")
        self.process.stdin.flush()
        answer = self.process.stdout.readline().strip()
        if answer not in ("ok", "failed"):
            raise StepFailed("the Java compiler ended")
        return answer == "ok", self.used() - before

    def end(self):
        self.process.stdin.close()
        self.process.wait()


class Trial:
    """Finds out the fate of one mutant after the other, in a folder of its own."""

    def __init__(self, original, folder):
        self.original = original
        self.folder = folder / "java"
        self.folder.mkdir(parents=True, exist_ok=True)
        self.log = self.folder / "output.log"
        self.compiler = Compiler(original)

    def fate(self, mutant):
        self.seconds = 0
        try:
            self.go(mutant)
            return Fate("survived", "", self.seconds)
        except Settled as settled:
            return Fate(settled.fate, settled.by, self.seconds)

    def go(self, mutant):
        """Raises Settled, or returns when the mutant has survived."""
        text = (ROOT / mutant.file).read_text()
        changed = self.folder / pathlib.Path(mutant.file).name
        changed.write_text(text[:mutant.start] + mutant.replacement + text[mutant.end:])
        face = self.folder / "face"
        shutil.rmtree(face, ignore_errors=True)
        face.mkdir()
        files = [str(changed) if f == str(ROOT / mutant.file) else f for f in sources([JAVA])]
        ok, seconds = self.compiler.compile(
            ["--release", "11", "-g:none", "-nowarn", "-proc:none", "-d", face, "-cp",
             self.original.work / "standins"], files)
        changed.unlink()
        self.seconds += seconds
        if not ok:
            raise Settled("does not compile")
        if class_files(face) == self.original.classes:
            raise Settled("same code", "javac")
        for group, usual in zip(GROUPS, self.original.seconds):
            self.run_tests(face, group, max(HANG_FACTOR * usual, HANG_SECONDS))

    def run_tests(self, face, tests, limit):
        outcome = run(self.original.command(face, tests), limit, log=self.log)
        self.seconds += outcome.seconds
        output = self.log.read_text(errors="replace")
        if outcome.ok and not JNI_WARNING.search(output):
            return
        started = re.findall(r"^RUN (.*)$", output, re.M)
        test = started[-1] if started else ""
        if not outcome.ran_out:
            failed = re.search(r"^FAILED (.*)$", output, re.M)
            raise Settled("unit tests", short(failed[1]) if failed else f"crash in {short(test)}")
        if test not in self.original.times:
            raise Settled("hung", short(test) or "before the first test")
        outcome = run(self.original.command(face, [test]),
                      max(PROOF_FACTOR * self.original.times[test], PROOF_SECONDS), log=self.log)
        self.seconds += outcome.seconds
        if outcome.ran_out == PROCESSOR:
            raise Settled("hung, proven", short(test))
        raise Settled("hung" if outcome.ok or outcome.ran_out else "unit tests", short(test))

    def end(self):
        self.compiler.end()


def short(test):
    """Class and method of an id of JUnit's."""
    words = re.findall(r":([^\]]*)\]", test)[1:]
    return ".".join(word.split(".")[-1].split("(")[0] for word in words)
