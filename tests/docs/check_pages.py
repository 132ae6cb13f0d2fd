#!/usr/bin/env python3
"""Checks the project's pages: their links, whose their pictures are, and those of docs/operations.

Every picture is listed in desktop/photos/ATTRIBUTION.md, as made from a photo or as without one.
The pictures of docs/operations are what the player makes of the scripts beside them, to the last
byte; --update puts them there anew. Exits with 1 and a line for each thing that is wrong.
"""

import argparse
import shutil
import subprocess
import sys
import tempfile

sys.dont_write_bytecode = True
from pages import LINK, ROOT, dead_links, pages, unattributed_pictures  # noqa: E402

PLAYER = ROOT / "build/release/desktop/player"
OPERATIONS = ROOT / "docs/operations"


def drawn_pictures(folder):
    """Plays the scripts; returns {name: bytes} of their pictures."""
    for script in sorted(OPERATIONS.glob("*.strokes")):
        subprocess.run([PLAYER, script, "--out", folder], check=True, stdout=subprocess.DEVNULL)
    return {picture.name: picture.read_bytes() for picture in folder.glob("*.png")}


def main():
    parser = argparse.ArgumentParser(description=__doc__,
                                     formatter_class=argparse.RawDescriptionHelpFormatter)
    parser.add_argument("--update", action="store_true", help="write the pictures anew")
    update = parser.parse_args().update

    wrong = []
    for page in pages():
        name = page.relative_to(ROOT)
        wrong += [f"{name}: nothing is at {target}; mend the link" for target in dead_links(page)]

    wrong += unattributed_pictures()

    with tempfile.TemporaryDirectory() as name:
        folder = type(ROOT)(name)
        drawn = drawn_pictures(folder)
        if update:
            for picture in drawn:
                shutil.copy(folder / picture, OPERATIONS / picture)
    kept = {picture.name: picture.read_bytes() for picture in OPERATIONS.glob("*.png")}
    for picture in sorted(drawn.keys() | kept.keys()):
        if picture not in drawn:
            wrong.append(f"docs/operations/{picture}: no script draws it; delete it")
        elif kept.get(picture) != drawn[picture]:
            wrong.append(f"docs/operations/{picture}: not what its script draws; "
                         "./dev docs --update draws it anew")
    if not drawn:
        wrong.append("docs/operations: no script draws a picture")
    if not any(LINK.search(page.read_text(encoding="utf-8")) for page in pages()):
        wrong.append("no page has a link, so none was checked; is this a checkout of the project?")

    print(f"{len(pages())} pages, {len(drawn)} pictures, {len(wrong)} wrong")
    for line in wrong:
        print(line, file=sys.stderr)
    return 1 if wrong else 0


if __name__ == "__main__":
    sys.exit(main())
