"""The project's pages: what they link to, and the commands that they show."""

import pathlib
import re
import subprocess

ROOT = pathlib.Path(__file__).resolve().parent.parent.parent

LINK = re.compile(r"!?\[[^\]]*\]\(([^)\s]+)\)")
FENCE = re.compile(r"^```\w*\n(.*?)^```$", re.M | re.S)
INLINE = re.compile(r"`((?:\./dev|cmake|ctest|grep|git) [^`]+)`")
SHOWN_COMMAND = re.compile(r"^(?:\./dev|cmake|ctest|grep|git)\b.*", re.M)


def pages():
    """Every Markdown page of the project."""
    listed = subprocess.run(["git", "ls-files", "--cached", "--others", "--exclude-standard", "*.md"],
                            cwd=ROOT, check=True, capture_output=True, text=True).stdout
    return [ROOT / name for name in listed.split()]


def dead_links(page):
    """What the page links to in the project, and is not there."""
    for target in LINK.findall(page.read_text(encoding="utf-8")):
        name, _, heading = target.partition("#")
        if "://" in name:
            continue
        file = page if name == "" else (page.parent / name).resolve()
        if not file.exists() or (heading and heading not in headings(file)):
            yield target


def headings(page):
    """The page's headings, as links name them."""
    found = re.findall(r"^#+ (.*)$", page.read_text(encoding="utf-8"), re.M)
    return {re.sub(r"[^\w -]", "", heading).strip().lower().replace(" ", "-") for heading in found}


def commands():
    """Every command that a page shows, and the first page that does, in order."""
    found = {}
    for page in pages():
        text = page.read_text(encoding="utf-8")
        shown = INLINE.findall(FENCE.sub("", text))
        for block in FENCE.findall(text):
            shown += SHOWN_COMMAND.findall(block.replace("\\\n", " "))
        for command in shown:
            found.setdefault(" ".join(command.split()), page.relative_to(ROOT))
    return found
