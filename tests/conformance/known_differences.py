#!/usr/bin/env python3
# SPDX-License-Identifier: MIT
# Copyright (c) Tarnell FBX contributors
"""Every reason in expected.json, faithful.json and rewritten.json is in docs/known-differences.md, and vice versa.

    known_differences.py PROJECT_FOLDER
"""
import json
import re
import sys
from pathlib import Path


def recorded_reasons(expected: str, rewritten: str, faithful: str) -> set[str]:
    rows = [*json.loads(expected).values(), *json.loads(faithful).values()]
    return ({group["reason"] for row in rows for group in row["differing"]}
            | {exception["reason"] for exception in json.loads(rewritten)})


def documented_reasons(page: str) -> set[str]:
    first_cells = (re.match(r"\| (.+?) \|", line) for line in page.splitlines())
    return {cell.group(1) for cell in first_cells if cell} - {"Reason"}


def complaints(expected: str, page: str, rewritten: str = "[]", faithful: str = "{}") -> list[str]:
    recorded, documented = recorded_reasons(expected, rewritten, faithful), documented_reasons(page)
    return ([f"not in docs/known-differences.md: {reason}" for reason in sorted(recorded - documented)]
            + [f"no file differs for this reason: {reason}" for reason in sorted(documented - recorded)])


def main() -> None:
    project = Path(sys.argv[1])
    found = complaints((project / "tests/conformance/expected.json").read_text(),
                       (project / "docs/known-differences.md").read_text(),
                       (project / "tests/conformance/rewritten.json").read_text(),
                       (project / "tests/conformance/faithful.json").read_text())
    sys.exit("\n".join(found) or 0)


if __name__ == "__main__":
    main()
