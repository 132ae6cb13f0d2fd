"""The mutants of the library: small deviations, one at a time, in the text of its sources.

They are found in the text itself, which clang-format keeps in one shape: a binary operator has
spaces on both sides, a template's brackets have none.
"""

import collections
import functools
import hashlib
import pathlib
import re
import subprocess

ROOT = pathlib.Path(__file__).resolve().parents[2]
FOLDERS = ["selection", "render", "jni", "support"]
JAVA = "java"

STANDARD_SHARE = 0.15  # of each file's mutants in the standard set, and at least STANDARD_LEAST
STANDARD_LEAST = 5
PROCESSORS = {  # whose compiler sees the lines that those before leave out
    "x86-64": "g++", "AArch64": "aarch64-linux-gnu-g++", "s390x": "s390x-linux-gnu-g++",
}
NO_TEST = {  # whose mutants cannot be run
    "support/operator_new.cpp": "part of the shared library alone, which the C++ tests do without",
}
LEFT_FOR_LATER = {  # not among --all; the page of the results names them
    "selection/front_queue.h": "its rewriting is under way",
    "selection/front_competition.cpp": "its rewriting is under way",
}
TABLE_FILES = {"support/fixed_point_tables.cpp": 8}  # numbers only: so many are mutated

Mutant = collections.namedtuple("Mutant", "file start end line column text change occurrence "
                                          "line_text line_number_among_alike replacement")

OPERATORS = {
    "<": ["<="], "<=": ["<"], ">": [">="], ">=": [">"], "==": ["!="], "!=": ["=="],
    "+": ["-"], "-": ["+"], "*": ["/"], "/": ["*"], "%": ["/"],
    ">>": ["<<"], "<<": [">>"], ">>>": ["<<"], "&": ["|"], "|": ["&"], "^": ["|"],
    "+=": ["-="], "-=": ["+="], "*=": ["+="], "&&": ["||"], "||": ["&&"],
}

# Words that stand for opposite directions, ends or axes; also as parts of a_name.
SWAPS = [
    "left right", "top bottom", "right below", "LEFT RIGHT", "UP DOWN", "x y", "dx dy", "DX DY",
    "px py", "nx ny", "x0 y0", "x1 y1", "x2 y2", "x0 x1", "y0 y1", "x1 x2", "y1 y2", "h v",
    "width height", "columns rows", "row column", "along across", "first last", "low high",
    "HIGHEST LOWEST", "min max", "prev next", "head tail", "src dst", "add sub", "true false",
    "small large", "best count",
]
JAVA_SWAPS = SWAPS + [
    "undo redo", "done undone", "brush core", "photo view", "begin end", "write read",
]


def both_ways(pairs):
    found = collections.defaultdict(list)
    for a, b in map(str.split, pairs):
        found[a].append(b)
        found[b].append(a)
    return found


OPPOSITES = both_ways(SWAPS)
JAVA_OPPOSITES = both_ways(JAVA_SWAPS)

NUMBER = re.compile(r"(?<![\w.])(0[xX][0-9a-fA-F]+|\d+\.\d+|\d+)([uUlLf]*)(?![\w.])")
WORD = re.compile(r"[A-Za-z_]\w*")
BINARY = re.compile(r"(?<= )(<=|>=|==|!=|<<|>>>|>>|&&|\|\||\+=|-=|\*=|[<>+\-*/%&|^])(?=[ \n])")
UNARY = re.compile(r"(?<=[(\[{ !])([!\-])(?=[\w(*])")
STEP = re.compile(r"\+\+|--")
CONDITION = re.compile(r"\b(?:if|while) (?=\()")
STATEMENT_START = re.compile(r"(?:[;{})]|(?<! ):|\belse)\s+(?=\w|\(|\*\w|\+\+|--)")
DECLARATION = re.compile(r"(?:[\w:]|<[^;()]*>)+[&*]*(?: const)?[&*]* [&*~]*\w")
JAVA_DECLARATION = re.compile(r"(?:[\w.]|<[^;()]*>)+(?:\[\])* \w")
DECLARES = re.compile(r"(?!(?:return|case|delete|else|goto)\b)(?<!\w)\w+(?:<[^<>]*>)?[*&]* $")
SINGLE_WORD_STATEMENTS = ("return", "break", "continue", "delete", "throw")
JAVA_NAME_PART = re.compile(r"[A-Z]?[a-z0-9]+|[A-Z]+(?![a-z])|_+")


def blanked(match):
    """Spaces in place of a match, line ends kept."""
    return re.sub(r"[^\n]", " ", match.group())


def code_only(text):
    """The text with comments, literals, preprocessor lines and static_asserts blanked out."""
    text = re.sub(r'//[^\n]*|/\*.*?\*/|"(?:\\.|[^"\\\n])*"|\'(?:\\.|[^\'\\\n])\'', blanked, text,
                  flags=re.S)
    text = re.sub(r"^[ \t]*#(?:[^\n]*\\\n)*[^\n]*", blanked, text, flags=re.M)
    text = re.sub(r"\bstatic_assert\s*\(.*?\)\s*;", blanked, text, flags=re.S)
    for thrown in re.finditer(r"\bthrow new \w+(?=\()", text):  # what an exception says
        end = closing(text, thrown.end())
        text = text[:thrown.end()] + re.sub(r"[^\n]", " ", text[thrown.end():end]) + text[end:]
    return text


def closing(code, opening):
    """Position behind the parenthesis that closes the one at `opening`."""
    depth = 0
    for i in range(opening, len(code)):
        depth += {"(": 1, ")": -1}.get(code[i], 0)
        if depth == 0:
            return i + 1
    return len(code)


def operator_changes(code):
    """Relational, arithmetic, bitwise and logical operators; signs; steps; choices."""
    for match in BINARY.finditer(code):
        for other in OPERATORS[match.group()]:
            yield match.start(), match.end(), other
    for match in UNARY.finditer(code):
        yield match.start(), match.end(), ""
    for match in STEP.finditer(code):
        yield match.start(), match.end(), {"++": "--", "--": "++"}[match.group()]
    for match in re.finditer(r"(?<= )\?(?= )", code):
        yield match.start(), match.end(), "== 0 ?"


def number_changes(code):
    """Every number: one more, one less, and 0."""
    for match in NUMBER.finditer(code):
        digits, suffix = match.groups()
        if "." in digits:
            value = float(digits)
            others = [value + 1, value - 1, 0.0]
        else:
            value = int(digits, 0)
            others = [value + 1, value - 1, 0]
        for other in dict.fromkeys(others):
            if other == value or (other < 0 and "u" in suffix.lower()):
                continue
            text = hex(other) if digits[:2].lower() == "0x" and other > 0 else str(other)
            yield match.start(), match.end(), f"({text}{suffix})" if other < 0 else text + suffix


def opposites(name):
    """Names that differ in one part of a_name."""
    parts = name.split("_")
    for i, part in enumerate(parts):
        for opposite in OPPOSITES.get(part, []):
            yield "_".join(parts[:i] + [opposite] + parts[i + 1:])


def java_opposites(name):
    """Names that differ in one part of aName or A_NAME."""
    parts = JAVA_NAME_PART.findall(name)
    for i, part in enumerate(parts):
        for opposite in JAVA_OPPOSITES.get(part.lower(), []):
            other = (opposite.upper() if part.isupper() and len(part) > 1 else
                     opposite.capitalize() if part[0].isupper() else opposite)
            yield "".join(parts[:i] + [other] + parts[i + 1:])


def swap_changes(code, opposites):
    """Words, or parts of names, turned into their opposites where the file knows such a name."""
    known = set(WORD.findall(code)) | {"min", "max", "true", "false", "wrap_add", "wrap_sub"}
    for match in WORD.finditer(code):
        if DECLARES.search(code[max(match.start() - 40, 0):match.start()]):
            continue  # another name for the same thing
        for name in opposites(match.group()):
            if name in known:
                yield match.start(), match.end(), name


def condition_changes(code):
    """Conditions of if and while turned round, unless an operator's change does just that."""
    for match in CONDITION.finditer(code):
        start, end = match.end(), closing(code, match.end())
        condition = code[start + 1:end - 1]
        simple = not re.search(r"&&|\|\||\?", condition)
        if simple and re.search(r"==|!=|^!", condition):
            continue
        yield start, end, f"(!{code[start:end]})"


def inside_parentheses(code):
    """For each position, whether a parenthesis has been opened since the last brace."""
    open_since = [0]
    inside = []
    for character in code:
        if character == "{":
            open_since.append(0)
        elif character == "}" and len(open_since) > 1:
            open_since.pop()
        open_since[-1] += {"(": 1, ")": -1}.get(character, 0)
        inside.append(open_since[-1] > 0)
    return inside


def statement_changes(code, declaration):
    """Whole statements left out, declarations not among them."""
    inside = inside_parentheses(code)
    starts = (m.end() for m in STATEMENT_START.finditer(code))
    for start in dict.fromkeys(starts):
        end = code.find(";", start)
        statement = plain(code[start:end])
        if end < 0 or inside[start] or "{" in statement:
            continue
        first = re.match(r"\w*", statement).group()
        if first in ("if", "for", "while", "else", "case", "default", "using", "namespace"):
            continue
        if first not in SINGLE_WORD_STATEMENTS and declaration.match(statement):
            continue
        yield start, end + 1, ";"


def all_changes(code, java):
    yield from operator_changes(code)
    yield from number_changes(code)
    yield from swap_changes(code, java_opposites if java else opposites)
    yield from condition_changes(code)
    yield from statement_changes(code, JAVA_DECLARATION if java else DECLARATION)


def plain(text):
    """Text with every run of white space turned into one space."""
    return " ".join(text.split())


def mutants_of(file, text):
    """All mutants of one source, from its top to its end."""
    code = code_only(text)
    lines = text.split("\n")
    line_starts = [0]
    for line in lines:
        line_starts.append(line_starts[-1] + len(line) + 1)
    alike = collections.Counter()
    among_alike = []
    for line in lines:
        alike[plain(line)] += 1
        among_alike.append(alike[plain(line)])

    found = []
    line = 0
    seen = collections.Counter()
    changes = all_changes(code, file.endswith(".java"))
    for start, end, replacement in sorted(set(changes), key=lambda c: (c[0], -c[1], c[2])):
        while line_starts[line + 1] <= start:
            line += 1
        old = plain(text[start:end])
        change = f"'{old}' -> '{plain(replacement)}'"
        seen[line, change] += 1
        found.append(Mutant(file, start, end, line + 1, start - line_starts[line] + 1, old, change,
                            seen[line, change], plain(lines[line]), among_alike[line],
                            replacement))
    if file in TABLE_FILES:
        numbers = [m for m in found if re.fullmatch(r"\d+|-", m.text)]
        return numbers[::max(len(numbers) // TABLE_FILES[file], 1)]
    return found


def description(mutant):
    """What changes, told apart from like changes in the same line."""
    number = f" #{mutant.occurrence}" if mutant.occurrence > 1 else ""
    return mutant.change + number


def key(mutant):
    """Identity that outlives edits elsewhere in the file."""
    return (mutant.file, mutant.line_number_among_alike, mutant.line_text, description(mutant))


def title(mutant):
    return f"{mutant.file}:{mutant.line}:{mutant.column} {description(mutant)}"


def library_files():
    return sorted(str(p.relative_to(ROOT)) for folder in FOLDERS
                  for p in (ROOT / folder).iterdir() if p.suffix in (".cpp", ".h"))


@functools.cache
def compiled_lines(file, compiler):
    """Lines of a source that a compiler does not skip because of #if."""
    text = subprocess.run([*compiler.split(), "-std=c++17", "-E", "-x", "c++", f"-I{ROOT}", ROOT / file],
                          check=True, capture_output=True, text=True).stdout
    lines = set()
    here = False
    for line in text.split("\n"):
        marker = re.match(r'# (\d+) "(.*?)"', line)
        if marker:
            number, here = int(marker[1]), pathlib.Path(marker[2]) == ROOT / file
        else:
            if here and line.strip():
                lines.add(number)
            number += 1
    return lines


@functools.cache
def has_branches(file):
    return bool(re.search(r"^[ \t]*#[ \t]*(if|el)(?!.*(_H\b|__cplusplus))", (ROOT / file).read_text(),
                          re.M))


def processor_of(mutant):
    """The first processor whose compiler sees the mutant; None if there is none."""
    if mutant.file.endswith(".java") or not has_branches(mutant.file):
        return next(iter(PROCESSORS))
    return next((name for name, compiler in PROCESSORS.items()
                 if mutant.line in compiled_lines(mutant.file, compiler)), None)


def java_files():
    return sorted(str(p.relative_to(ROOT)) for p in (ROOT / JAVA).rglob("*.java"))


def all_mutants():
    return [m for file in library_files() + java_files()
            for m in mutants_of(file, (ROOT / file).read_text())]


def standard_set(mutants):
    """STANDARD_SHARE of each file's mutants, in an order that edits elsewhere do not shuffle."""
    def draw(mutant):
        return hashlib.sha256(repr(key(mutant)).encode()).digest()

    by_file = collections.defaultdict(list)
    for mutant in mutants:
        by_file[mutant.file].append(mutant)
    return {key(m) for group in by_file.values()
            for m in sorted(group, key=draw)[:max(round(STANDARD_SHARE * len(group)),
                                                  STANDARD_LEAST)]}
