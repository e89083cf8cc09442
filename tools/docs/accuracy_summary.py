# SPDX-FileCopyrightText: The Arbor Lumen authors
# SPDX-License-Identifier: Apache-2.0
"""accuracy_summary.py FOLDER: one table of the largest errors on all accuracy pages of a folder."""

from __future__ import annotations

import re
import sys
from pathlib import Path

TYPES = {"h": "half", "s": "float", "d": "double"}
TIERS = ("ha", "la", "ep")
LIBRARY = {"C library, float": "s", "C library, double": "d"}

HEADER = """# Accuracy

The largest error of each function in ulp of its element type, over all labels of its device bodies,
beside that of the C library (glibc) at the same arguments. A function's page has the bodies one by
one, with the arguments and the mean errors. `ep` promises 11 bits at float (8192 ulp) and 26 at double
(1.3e8 ulp). Written by `scripts/accuracy`.

| Function | Type | `ha` | `la` | `ep` | C library |
|---|---|---|---|---|---|
"""


def page_rows(page: Path) -> list[tuple[str, float]]:
    rows = []
    for line in page.read_text().splitlines():
        cells = [cell.strip() for cell in line.split("|")[1:-1]]
        if len(cells) == 6 and re.fullmatch(r"\d+", cells[2]):
            rows.append((cells[0], float(cells[3])))
    return rows


def summary_lines(page: Path) -> list[str]:
    function = page.stem
    largest: dict[tuple[str, str], float] = {}
    for name, error in page_rows(page):
        if name in LIBRARY:
            key = (LIBRARY[name], "library")
        else:
            letter, tier = name.removeprefix(function + "_").split("_")[:2]
            key = (letter, tier)
        largest[key] = max(error, largest.get(key, 0.0))

    def cell(letter: str, column: str) -> str:
        error = largest.get((letter, column))
        return "" if error is None else f"{error:.3g}"

    return [
        f"| [{function}]({page.name}) | {TYPES[letter]} | "
        + " | ".join(cell(letter, column) for column in (*TIERS, "library"))
        + " |"
        for letter in TYPES
        if any(key[0] == letter for key in largest)
    ]


def main() -> None:
    folder = Path(sys.argv[1])
    pages = sorted(page for page in folder.glob("*.md") if page.name != "README.md")
    lines = [line for page in pages for line in summary_lines(page)]
    (folder / "README.md").write_text(HEADER + "\n".join(lines) + "\n")


if __name__ == "__main__":
    main()
