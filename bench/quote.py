#!/usr/bin/env python3
"""Puts what the benchmarks printed into the tables of README.md and docs/speed.md.

usage: ./dev bench | tee FILE; bench/quote.py FILE...

The pages quote some rows of some tables. A row is found again by its table's header and by its cells
before the first number; it takes over the numbers. Rows that the files do not have stay.
"""

import pathlib
import re
import sys

PROJECT = pathlib.Path(__file__).resolve().parent.parent
PAGES = [PROJECT / "README.md", PROJECT / "docs" / "speed.md"]
NUMBER = re.compile(r"\d+(\.\d+)?")


def cells(line):
    return [cell.strip() for cell in line.strip().strip("|").split("|")]


def key_of(row):
    key = []
    for cell in cells(row):
        if NUMBER.fullmatch(cell):
            break
        key.append(cell)
    return tuple(key)


def table_lines(lines):
    """Each line with the header of the table that it is a row of, or None."""
    header = None
    for number, line in enumerate(lines):
        if not line.startswith("|"):
            header = None
        elif header is None:
            header = line.strip()
        elif not line.startswith("|---"):
            yield number, header


def quote(page, printed):
    lines = page.read_text("utf-8").splitlines()
    quoted = 0
    for number, header in table_lines(lines):
        row = printed.get((header, key_of(lines[number])))
        if row is not None:
            lines[number] = row
            quoted += 1
    page.write_text("\n".join(lines) + "\n", "utf-8")
    return quoted


def main(files):
    printed = {}
    for file in files:
        lines = pathlib.Path(file).read_text("utf-8").splitlines()
        for number, header in table_lines(lines):
            printed[header, key_of(lines[number])] = lines[number]
    for page in PAGES:
        print(f"{page.name}: {quote(page, printed)} rows quoted")


if __name__ == "__main__":
    if len(sys.argv) < 2:
        sys.exit(__doc__)
    main(sys.argv[1:])
