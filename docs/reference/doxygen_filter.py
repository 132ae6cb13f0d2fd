#!/usr/bin/env python3
"""Turns a header's plain comments into Doxygen's, for the reference pages.

The first // block of a file describes the file, any other what stands below it, up to an empty line:
one declaration or several. Lines that are indented further than text are tables and stay as they
are. A // behind a declaration describes that one. The Doxyfile names this as its filter, so that
headers need no second kind of comment.
"""

import re
import sys

COMMENT = re.compile(r"^(\s*)// ?(.*)$")
COMMENT_BEHIND = re.compile(r"^(\s*\S.*?[;,{})])\s+// (.*)$")
GOES_ON = re.compile(r"^\s*(//|$|\}|#)")  # ends the declarations that share a comment


def escaped(text):
    return re.sub(r"([@\\<>#%&])", r"\\\1", text)


def marked_up(lines):
    """Text for Doxygen, with the tables in it set apart."""
    in_table = False
    for line in lines:
        is_table = line.startswith("  ") or (in_table and not line)
        if is_table != in_table:
            yield "\\verbatim" if is_table else "\\endverbatim"
        in_table = is_table
        yield line if is_table else escaped(line)
    if in_table:
        yield "\\endverbatim"


def declarations_below(lines):
    """How many of the lines belong to the comment above them, if it describes several declarations."""
    count = 0
    while count < len(lines) and not GOES_ON.match(lines[count]):
        if lines[count].rstrip().endswith("{"):
            return 0
        count += 1
    ends = sum(1 for line in lines[:count] if ";" in line)
    return count if ends > 1 else 0


def filtered(lines):
    out = []
    describes_file = True
    at = 0
    group_end = -1
    while at < len(lines):
        comment = COMMENT.match(lines[at])
        if at == group_end:
            out.append("///@}")
        if not comment:
            behind = COMMENT_BEHIND.match(lines[at])
            out.append(f"{behind[1]}  ///< {escaped(behind[2])}" if behind else lines[at])
            at += 1
            continue
        block = []
        while at < len(lines) and (more := COMMENT.match(lines[at])):
            block.append(more[2])
            at += 1
        text = [*marked_up(block), "*/"]
        if describes_file:
            out += ["/** \\file", *text]
        elif at < len(lines) and lines[at].strip():
            out += ["/**", *text]
            if shared := declarations_below(lines[at:]):
                out.append("///@{")
                group_end = at + shared
        describes_file = False
    if group_end == at:
        out.append("///@}")
    return out


if __name__ == "__main__":
    with open(sys.argv[1], encoding="utf-8") as source:
        print("\n".join(filtered(source.read().splitlines())))
