"""What became of every mutant, kept from run to run.

results.tsv in the work folder holds a line a mutant, the latest last. A line tells of which state of
the files it speaks:

  state   the mutated file and the library's headers that it includes
  whole   all sources of the library, and all that the tests are made of; for Java, those of Java

The latest line of each mutant is also kept in the repository, in mutants.tsv.gz, so that a run on
another machine can go on from there.

A kill holds as long as `state` is the same: tests are only ever added, so what was noticed once
still is. All else, a survivor above all, holds only while `whole` is the same too.
"""

import collections
import csv
import datetime
import functools
import gzip
import hashlib
import pathlib
import re
import subprocess

from mutants import FOLDERS, JAVA, ROOT, description, key

KEPT = pathlib.Path(__file__).resolve().parent / "mutants.tsv.gz"
COLUMNS = ["file", "alike", "line", "change", "fate", "by", "seconds", "date", "commit", "state",
           "whole"]
Row = collections.namedtuple("Row", COLUMNS)

KILLED = ["unit tests", "differential", "sanitizers", "hung, proven"]
NOT_COUNTED = ["does not compile", "same code"]  # no deviation that a test could notice
ALIVE = ["hung", "survived"]
CPP = FOLDERS + ["tests", "cmake", "CMakeLists.txt", "draventaUtil.h"]
JAVA_CLASSES = [JAVA, "desktop", "android/sample", "tests/jvm"]
UNTESTED = {"tests/" + name for name in ("binary", "consumer", "coverage", "docs", "hostile",
                                         "install", "jvm", "mutation", "same_bits", "window")}


def digest(files):
    """One short digest of some files' names and contents."""
    mixed = hashlib.sha256()
    for file in sorted(files):
        content = hashlib.sha256((ROOT / file).read_bytes()).hexdigest()
        mixed.update(f"{file} {content}\n".encode())
    return mixed.hexdigest()[:12]


@functools.cache
def included(file):
    """A file and the library's headers that it includes, directly or not."""
    found = {file}
    for name in re.findall(r'^#include "((?:%s)/[\w.]+)"' % "|".join(FOLDERS),
                           (ROOT / file).read_text(), re.M):
        if (ROOT / name).exists():
            found |= included(name)
    return frozenset(found)


@functools.cache
def state(file):
    return digest(included(file))


@functools.cache
def whole(java):
    files = set()
    for name in JAVA_CLASSES if java else CPP:
        paths = (ROOT / name).rglob("*") if (ROOT / name).is_dir() else [ROOT / name]
        files |= {str(p.relative_to(ROOT)) for p in paths if p.is_file()}
    return digest(f for f in files if java or "/".join(f.split("/")[:2]) not in UNTESTED)


def is_java(file):
    return file.endswith(".java")


def row_key(row):
    return (row.file, int(row.alike), row.line, row.change)


def holds(row):
    """Whether a row still tells the fate of its mutant."""
    if row.state != state(row.file):
        return False
    if row.fate in KILLED or (row.fate in NOT_COUNTED and row.file.endswith(".cpp")):
        return True
    return row.whole == whole(is_java(row.file))


def rows_of(text):
    """The latest row of each mutant."""
    rows = {}
    for fields in csv.reader(text.split("\n"), delimiter="\t", quoting=csv.QUOTE_NONE):
        if len(fields) == len(COLUMNS) and fields != COLUMNS:  # not one that was cut off
            row = Row(*fields)
            rows[row_key(row)] = row
    return rows


class Results:
    """The file of results, read and added to. Without one, what the repository keeps."""

    def __init__(self, path):
        self.path = path
        if not path.exists() and KEPT.exists():
            path.write_bytes(gzip.decompress(KEPT.read_bytes()))
        self.rows = rows_of(path.read_text()) if path.exists() else {}
        self.commit = subprocess.run(["git", "-C", ROOT, "describe", "--always", "--dirty"],
                                     capture_output=True, text=True).stdout.strip() or "unknown"

    def open(self, files):
        """For adding rows, about the files as they are now."""
        for file in files:
            state(file)
            whole(is_java(file))
        content = self.path.read_text() if self.path.exists() else ""
        content = content or "\t".join(COLUMNS) + "\n"
        if not content.endswith("\n"):  # the last run was cut off
            content = content[:content.rfind("\n") + 1]
        self.path.write_text(content)
        self.file = open(self.path, "a")

    def keep(self):
        """Writes what the repository keeps: the same bytes for the same rows."""
        lines = sorted("\t".join(row) for row in self.rows.values())
        text = "".join(line + "\n" for line in ["\t".join(COLUMNS), *lines])
        KEPT.write_bytes(gzip.compress(text.encode(), mtime=0))

    def known(self, mutant):
        """The row of a mutant, if one holds."""
        row = self.rows.get(key(mutant))
        return row if row and holds(row) else None

    def add(self, mutant, fate):
        today = datetime.date.today().isoformat()
        row = Row(mutant.file, str(mutant.line_number_among_alike), mutant.line_text,
                  description(mutant), fate.fate, fate.by, f"{fate.seconds:.2f}", today, self.commit,
                  state(mutant.file), whole(is_java(mutant.file)))
        self.rows[key(mutant)] = row
        self.file.write("\t".join(row) + "\n")
        self.file.flush()
        return row
