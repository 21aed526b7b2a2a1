#!/usr/bin/env python3
# SPDX-License-Identifier: MIT
# Copyright (c) Tarnell FBX contributors
"""Fails when an include points the wrong way.

Usage: include_direction.py PROJECT_ROOT

Each rule is a row: which files it is about, which includes it judges, and what is allowed among them. A new rule is a
new row.
"""

import re
import sys
from pathlib import Path
from typing import NamedTuple

INCLUDE = re.compile(r'^[ \t]*#[ \t]*include[ \t]*([<"][^>"]+[>"])', re.MULTILINE)

# What belongs to the platform: its umbrella, its public folder, and its internals by layer.
PLATFORM = re.compile(
    r'^[<"](?:.*/)?(?:fbxsdk\.h|fbxsdk/.*|(?:core|container|schema|document|object|animation|scene|cache|geometry|conversion|io)/.*)[>"]$'
)
# What belongs to the library: its public headers and its own folders.
LIBRARY = re.compile(r'^[<"](?:.*/)?(?:Tn\w+\.h|Fbx\.h|FbxSdk\.h|(?:model|access|sdk|faithful)/.*)[>"]$')
# The layers above the value classes.
ABOVE_MODEL = re.compile(r'^[<"](?:.*/)?(?:Fbx\.h|FbxSdk\.h|TnFbxError\.h|(?:access|sdk|faithful)/.*)[>"]$')
# The two adapters.
COMPATIBLE = re.compile(r'^[<"](?:.*/)?(?:FbxSdk\.h|sdk/.*)[>"]$')
FAITHFUL = re.compile(r'^[<"](?:.*/)?faithful/.*[>"]$')
EITHER = re.compile(r'^[<"](?:.*/)?(?:FbxSdk\.h|(?:sdk|faithful)/.*)[>"]$')


class Rule(NamedTuple):
    patterns: tuple  # glob patterns of the files, relative to the root
    judged: re.Pattern
    allowed: frozenset
    reason: str


MODEL = ("include/Tn*.h", "src/model/*.h", "src/model/*.cpp")
RULES = (
    Rule(MODEL, PLATFORM, frozenset(), "the value classes know no platform"),
    Rule(("include/TnFbx[!E]*.h", "src/model/*.h", "src/model/*.cpp"), ABOVE_MODEL, frozenset(),
         "the value classes know neither adapter nor facade"),
    Rule(("include/*.h", "src/*/*.h", "src/*/*.cpp", "src/*.h", "src/*.cpp"), PLATFORM, frozenset({"<fbxsdk.h>"}),
         "the library sees the platform only as <fbxsdk.h>"),
    Rule(("src/access/*.h", "src/access/*.cpp"), EITHER, frozenset(), "what both adapters need knows neither"),
    Rule(("src/faithful/*.h", "src/faithful/*.cpp"), COMPATIBLE, frozenset(), "the adapters do not know each other"),
    Rule(("src/sdk/*.h", "src/sdk/*.cpp"), FAITHFUL, frozenset(), "the adapters do not know each other"),
    Rule(("fbxsdk/**/*.h", "fbxsdk/**/*.cpp"), LIBRARY, frozenset(), "the platform knows nothing of the library"),
)


def without_comments(source):
    return re.sub(r"/\*.*?\*/", lambda m: "\n" * m.group().count("\n"), source, flags=re.DOTALL)


def violations_of(rule, root):
    for pattern in rule.patterns:
        for path in sorted(root.glob(pattern)):
            source = without_comments(path.read_text(encoding="utf-8"))
            for match in INCLUDE.finditer(source):
                if rule.judged.match(match[1]) and match[1] not in rule.allowed:
                    line = source.count("\n", 0, match.start(1)) + 1
                    yield f"{path.relative_to(root)}:{line}: {match[1]}: {rule.reason}"


def violations(root):
    return [violation for rule in RULES for violation in violations_of(rule, root)]


def main():
    root = Path(sys.argv[1])
    if not any(root.glob("include/Tn*.h")):
        sys.exit(f"{root}: no library headers here")
    found = violations(root)
    print("\n".join(found))
    return 1 if found else 0


if __name__ == "__main__":
    sys.exit(main())
