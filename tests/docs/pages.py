"""The project's pages: what they link to, their pictures, and the commands that they show."""

import collections
import pathlib
import re
import subprocess

ROOT = pathlib.Path(__file__).resolve().parent.parent.parent

ATTRIBUTION = ROOT / "desktop/photos/ATTRIBUTION.md"
PICTURE_ENDINGS = (".png", ".jpg", ".jpeg", ".svg", ".gif", ".webp", ".bmp", ".tif", ".tiff", ".ico")

LINK = re.compile(r"!?\[[^\]]*\]\(([^)\s]+)\)")
FENCE = re.compile(r"^```\w*\n(.*?)^```$", re.M | re.S)
INLINE = re.compile(r"`((?:\./dev|cmake|ctest|grep|git) [^`]+)`")
SHOWN_COMMAND = re.compile(r"^(?:\./dev|cmake|ctest|grep|git)\b.*", re.M)


def project_files():
    """The path from the root of every file of the project that is there."""
    listed = subprocess.run(["git", "ls-files", "--cached", "--others", "--exclude-standard", "-z"],
                            cwd=ROOT, check=True, capture_output=True, text=True).stdout
    return [name for name in listed.split("\0") if (ROOT / name).is_file()]


def pages():
    """Every Markdown page of the project."""
    return [ROOT / name for name in project_files() if name.endswith(".md")]


def pictures():
    """Every picture of the project, by its path from the root."""
    return [name for name in project_files() if name.lower().endswith(PICTURE_ENDINGS)]


def unattributed_pictures():
    """What is wrong with the list of pictures, a line for each."""
    text = ATTRIBUTION.read_text(encoding="utf-8")
    rows = [[cell.strip() for cell in row.strip("|").split("|")]
            for row in re.findall(r"^\|.*\|$", text, re.M)]
    listed = collections.Counter(row[0].strip("`") for row in rows if row[0].startswith("`"))
    wrong = [f"{row[0]}: a column is empty" for row in rows if "" in row]
    wrong += [f"{name}: {count} times in the list" for name, count in listed.items() if count > 1]
    wrong += [f"{name}: not listed as made from a photo, nor as without one"
              for name in pictures() if name not in listed]
    wrong += [f"{name}: listed and not there" for name in listed if name not in pictures()]
    if not listed:
        wrong.append("no picture is listed")
    return [f"{ATTRIBUTION.relative_to(ROOT)}: {line}" for line in wrong]


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
