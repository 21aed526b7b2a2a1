#!/usr/bin/env python3
# SPDX-License-Identifier: MIT
# Copyright (c) Tarnell FBX contributors
"""Fails when docs/kept-behaviours.md names a test that does not exist, or an entry without a test.

Usage: kept_behaviours.py PROJECT_ROOT

An entry is a row of a table whose last column is headed "Held by"; that column names tests as `Suite.Name`.
"""

import re
import sys
from pathlib import Path

TEST_MACRO = re.compile(r"\b(?:TYPED_)?TEST(?:_[FP])?\s*\(\s*(\w+)\s*,\s*(\w+)\s*\)")
TEST_NAME = re.compile(r"`(\w+\.\w+)`")


def existing_tests(root):
    names = set()
    for path in root.glob("tests/**/*Test.cpp"):
        names.update(f"{suite}.{name}" for suite, name in TEST_MACRO.findall(path.read_text(encoding="utf-8")))
    return names


def entries(document):
    """Yields (line number, behaviour, tests) of every row of every "Held by" table."""
    in_table = False
    for number, line in enumerate(document.splitlines(), start=1):
        cells = [cell.strip() for cell in re.split(r"(?<!\\)\|", line.strip().strip("|"))]
        if not line.startswith("|"):
            in_table = False
        elif cells[-1] == "Held by":
            in_table = True
        elif in_table and not set(line) <= set("|-: "):
            yield number, cells[0], TEST_NAME.findall(cells[-1])


def violations(root):
    document = (root / "docs/kept-behaviours.md").read_text(encoding="utf-8")
    tests = existing_tests(root)
    rows = list(entries(document))
    if not rows:
        return ["docs/kept-behaviours.md: no entries found"]
    found = []
    for number, behaviour, names in rows:
        if not names:
            found.append(f"docs/kept-behaviours.md:{number}: {behaviour}: no test holds it")
        found += [f"docs/kept-behaviours.md:{number}: {name}: no such test" for name in names if name not in tests]
    return found


def main():
    found = violations(Path(sys.argv[1]))
    print("\n".join(found))
    return 1 if found else 0


if __name__ == "__main__":
    sys.exit(main())
