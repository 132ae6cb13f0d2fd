"""The page docs/mutation.md, and the two tables that it is made of and that are kept with it.

  results.tsv      a line a source: how many mutants met which fate, when, on which commit
  unexplained.tsv  a line a mutant that is not killed and not explained

A source's line tells of its newest complete run: it is replaced by one that speaks of the same state
of the source only if that one leaves fewer mutants out.
"""

import collections
import csv
import pathlib

from mutants import JAVA, LEFT_FOR_LATER, NO_TEST, ROOT, java_files, key, library_files, processor_of
from results import KILLED, state

FOLDER = pathlib.Path(__file__).resolve().parent
TABLE = FOLDER / "results.tsv"
UNEXPLAINED = FOLDER / "unexplained.tsv"
PAGE = ROOT / "docs" / "mutation.md"

COUNTS = ["survived", "hung", "not run", "left for later", "no build", "explained", *KILLED, "same code",
          "does not compile"]
COLUMNS = ["file", "state", "mutants", *COUNTS, "seconds", "from", "to", "commits"]
ALIVE_COLUMNS = ["file", "alike", "line", "change", "fate"]
Alive = collections.namedtuple("Alive", ALIVE_COLUMNS)


def cannot_run(mutant):
    return mutant.file in NO_TEST or not processor_of(mutant)


def table_of(everything, results, explains):
    """The table of what holds now, and the mutants alive without an explanation."""
    table, alive = {}, []
    for file in library_files() + java_files():
        table[file] = dict.fromkeys(COUNTS, 0) | {
            "file": file, "state": state(file), "mutants": 0, "seconds": 0.0, "from": "-", "to": "-",
            "commits": "-"}
    rows_of = collections.defaultdict(list)
    for mutant in everything:
        line = table[mutant.file]
        line["mutants"] += 1
        row = results.known(mutant)
        if cannot_run(mutant):
            line["no build"] += 1
        elif not row:
            line["left for later" if mutant.file in LEFT_FOR_LATER else "not run"] += 1
        else:
            rows_of[mutant.file].append(row)
            line["seconds"] += float(row.seconds)
            if row.fate in ("survived", "hung"):
                if explains(mutant):
                    line["explained"] += 1
                    continue
                alive.append(Alive(*map(str, key(mutant)), row.fate))
            line[row.fate] += 1
    for file, rows in rows_of.items():
        table[file]["from"] = min(row.date for row in rows)
        table[file]["to"] = max(row.date for row in rows)
        table[file]["commits"] = " ".join(sorted({row.commit for row in rows}))
    return table, alive


def merged(new, new_alive, old, old_alive, explained):
    """The better line of each source, of two tables."""
    table, alive = {}, []
    for file, line in new.items():
        before = old.get(file)
        keep = (before and before["state"] == line["state"] and
                before["mutants"] == line["mutants"] and before["not run"] < line["not run"])
        table[file] = before if keep else line
        for entry in old_alive if keep else new_alive:
            if entry.file != file:
                continue
            if keep and (entry.file, int(entry.alike), entry.line, entry.change) in explained:
                before[entry.fate] -= 1
                before["explained"] += 1
            else:
                alive.append(entry)
    return table, alive


def read_tables():
    if not TABLE.exists():
        return {}, []
    with open(TABLE, newline="") as file:
        table = {line["file"]: line for line in csv.DictReader(file, delimiter="\t")}
    for line in table.values():
        line.update({name: int(line[name]) for name in ["mutants", *COUNTS]})
        line["seconds"] = float(line["seconds"])
    with open(UNEXPLAINED, newline="") as file:
        rows = list(csv.reader(file, delimiter="\t", quoting=csv.QUOTE_NONE))
    return table, [Alive(*row) for row in rows[1:]]


def write_tables(table, alive):
    lines = [COLUMNS] + [[f"{line[c]:.1f}" if c == "seconds" else str(line[c]) for c in COLUMNS]
                         for line in table.values()]
    TABLE.write_text("".join("\t".join(line) + "\n" for line in lines))
    UNEXPLAINED.write_text("".join("\t".join(line) + "\n" for line in [ALIVE_COLUMNS, *alive]))


# --- the page -------------------------------------------------------------------------------------

WORDS = {
    "survived": "survived, not explained",
    "hung": "hung, not proven, not explained",
    "not run": "not run",
    "left for later": "left for later",
    "no build": "compiled or tested by no build",
    "explained": "survived, explained",
    "unit tests": "killed by unit tests",
    "differential": "killed by the slow models",
    "sanitizers": "killed by sanitizers",
    "hung, proven": "killed: hung, proven",
    "same code": "the same code",
    "does not compile": "does not compile",
}

HEAD = """# Mutation

Would the tests notice a small mistake? [`mutate.py`](../tests/mutation/mutate.py) puts one mistake at
a time into the sources of the library and of the Java classes: `<` for `<=`, a constant off by one,
left for right, a statement left out. It builds the result, a *mutant*, and runs the tests until one
fails. `./dev mutate --all --resume` goes on with what is missing; `./dev mutate --report` writes this
page from [`results.tsv`](../tests/mutation/results.tsv).
"""

MEANING = """## What the words mean

- **Killed.** A test failed, the program crashed, or it took more than 4 GB of memory. Unit tests come
  first, then 230,000 cases against the slow models, then the unit tests under AddressSanitizer and
  UndefinedBehaviorSanitizer. Slow tests that run nothing of the changed objects are left out. What
  only AArch64 or s390x compiles runs emulated: the tests of rendering, then the models. Java classes
  have unit tests alone.
- **Hung.** The tests took more than 5 times the processor time that they take without the mutant, and
  2 seconds at least. Time on the clock plays no part, unless it is 60 times that. The test that was
  running is then run alone.
- **Hung, proven.** That test takes more than 100 times the processor time that it takes without the
  mutant, the start of the program aside, and 5 seconds at least. This counts as a kill. A test that
  ends before is no proof, nor is one that waits without using the processor: the mutant counts as
  alive.
- **The same code.** The compiler makes the same objects of it, plainly or at `-O2`. Nobody could
  notice. These mutants count neither as killed nor as alive.
- **Explained.** No caller could tell the mutant from the library.
  [`survivors.txt`](../tests/mutation/survivors.txt) says why, one by one. An explanation of a mutant
  that a test kills is an error.
- **Not run.** Nothing is known of these mutants in the present state of the sources. A kill is taken
  over from an earlier state as long as the mutated file and the headers that it includes are the same,
  because tests are only added. Survivors run again whenever tests or library change.
"""


def is_java(line):
    return line["file"].startswith(f"{JAVA}/")


def percent(part, whole):
    return f"{100 * part / whole:.1f} %" if whole else "-"


def totals(lines):
    return {name: sum(line[name] for line in lines) for name in ["mutants", *COUNTS]}


def grid(head, rows):
    yield "| " + " | ".join(head) + " |"
    yield "|---" + "|---:" * (len(head) - 1) + "|"
    for row in rows:
        yield "| " + " | ".join(map(str, row)) + " |"


def page_of(table, alive, narrow):
    """The page's text. `narrow`: explanations that hold on some processors only."""
    lines = list(table.values())
    cpp = totals([line for line in lines if not is_java(line)])
    java = totals([line for line in lines if is_java(line)])
    both = totals(lines)

    def effective(t):
        return sum(t[name] for name in ["survived", "hung", "explained", *KILLED])

    def killed(t):
        return sum(t[name] for name in KILLED)

    text = [HEAD, "## Figures", ""]
    rows = [[WORDS[name], cpp[name], java[name], both[name]] for name in COUNTS]
    rows.append(["**all mutants**", *(t["mutants"] for t in (cpp, java, both))])
    # Elsewhere kills that were taken over would stand beside survivors that were not.
    lines = [line for line in lines if line["mutants"]]
    complete = [line for line in lines
                if not line["not run"] + line["left for later"] + line["no build"]]
    shares = [totals([line for line in complete if is_java(line) in which])
              for which in ([False], [True], [False, True])]
    rows.append(["killed, of those that compile to other code, in sources that ran completely",
                 *(f"{killed(t)} of {effective(t)}, {percent(killed(t), effective(t))}"
                   for t in shares)])
    text += [*grid(["", "C++", "Java", "both"], rows), "",
             f"{len(complete)} of {len(lines)} sources ran completely."]

    dates = [d for line in lines for d in (line["from"], line["to"]) if d != "-"]
    commits = sorted({c for line in lines for c in line["commits"].split() if c != "-"})
    run = both["mutants"] - both["not run"] - both["left for later"] - both["no build"]
    if dates:
        seconds = sum(line["seconds"] for line in lines)
        text += [f"{run:,} mutants ran from {min(dates)} to {max(dates)}, on {', '.join(commits)}: "
                 f"{seconds / 3600:.1f} hours of one processor core, {seconds / run:.2f} seconds each."]
    text.append("")

    text += ["## Alive without an explanation", ""]
    if alive:
        text += ["Each is a missing test, or an explanation that nobody has written yet.", "",
                 "| source | line | change | fate |", "|---|---|---|---|"]
        text += [f"| `{a.file}` | {code(a.line)} | {code(a.change)} | {a.fate} |" for a in alive]
    else:
        text.append("None of those that were run.")
    text.append("")

    text += ["## What was not run", ""]
    text += [f"- `{file}`: {reason}." for file, reason in (LEFT_FOR_LATER | NO_TEST).items()]
    text += [f"- `{line['file']}`: {line['no build']} mutants in lines that no build compiles."
             for line in lines if line["no build"] and line["file"] not in NO_TEST]
    if both["not run"]:
        text.append(f"- {both['not run']:,} mutants of {sum(line['not run'] > 0 for line in lines)} "
                    "sources, as the last table counts them: the run has not come that far.")
    text.append("")

    text += ["## Source by source", ""]
    order = sorted(lines, key=lambda n: (-n["survived"] - n["hung"], -n["not run"],
                                         -n["explained"] / max(effective(n), 1), n["file"]))
    head = ["source", "mutants", "survived", "hung", "not run", "explained", "killed", "same code",
            "does not compile"]
    text += [*grid(head, [[f"`{n['file'].split('/lumetrix/')[-1]}`", n["mutants"], n["survived"],
                           n["hung"], n["not run"] + n["left for later"] + n["no build"],
                           n["explained"], killed(n), n["same code"], n["does not compile"]]
                          for n in order]), ""]

    if narrow:
        text += ["## Explanations that hold on some processors only", ""]
        text += [f"- `{entry[0]}`: {code(entry[2])}, {code(entry[3])}: {holds}."
                 for entry, holds in narrow]
        text.append("")
    return "\n".join(text) + "\n" + MEANING


def code(text):
    """Text as code in a table's cell."""
    ticks = "``" if "`" in text else "`"
    return ticks + text.replace("|", "\\|") + ticks


def faults(table, alive, explained, page):
    """What does not fit together."""
    found = []
    files = set(library_files() + java_files())
    if set(table) != files:
        found.append(f"results.tsv and the sources differ in {sorted(set(table) ^ files)}")
    for file, line in table.items():
        if line["mutants"] != sum(line[name] for name in COUNTS):
            found.append(f"the numbers of {file} do not add up")
        listed = collections.Counter(a.fate for a in alive if a.file == file)
        if any(line[fate] != listed[fate] for fate in ("survived", "hung")):
            found.append(f"unexplained.tsv lists others of {file} than results.tsv counts")
    for a in alive:
        if (a.file, int(a.alike), a.line, a.change) in explained:
            found.append(f"explained by now: {a.file}: {a.line} {a.change}")
    if not PAGE.exists() or PAGE.read_text() != page:
        found.append(f"{PAGE.relative_to(ROOT)} is not what these results make")
    return found
