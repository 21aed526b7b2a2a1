#!/usr/bin/env python3
# SPDX-License-Identifier: MIT
# Copyright (c) Tarnell FBX contributors
"""Fails when an include points the wrong way.

Usage: include_direction.py PROJECT_ROOT

Each rule is a row: which files it is about, which includes it judges, and what is allowed among them. A new rule is a
new row. Among the modules of the platform, each file may use those that its module needs.
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
LIBRARY = re.compile(r'^[<"](?:.*/)?(?:Tn\w+\.h|Fbx\.h|FbxSdk\.h|FbxFaithful\.h|FbxPlatform\.h|(?:model|access|sdk|faithful)/.*)[>"]$')
# The layers above the value classes.
ABOVE_MODEL = re.compile(
    r'^[<"](?:.*/)?(?:Fbx\.h|FbxSdk\.h|FbxFaithful\.h|FbxPlatform\.h|TnFbxError\.h|(?:access|sdk|faithful)/.*)[>"]$'
)
# The two adapters.
COMPATIBLE = re.compile(r'^[<"](?:.*/)?(?:FbxSdk\.h|sdk/.*)[>"]$')
FAITHFUL = re.compile(r'^[<"](?:.*/)?(?:FbxFaithful\.h|faithful/.*)[>"]$')
EITHER = re.compile(r'^[<"](?:.*/)?(?:FbxSdk\.h|FbxFaithful\.h|(?:sdk|faithful)/.*)[>"]$')


class Rule(NamedTuple):
    patterns: tuple  # glob patterns of the files, relative to the root
    judged: re.Pattern
    allowed: frozenset
    reason: str
    exceptions: frozenset = frozenset()  # pairs of a file and what it may include


MODEL = ("include/Tn*.h", "src/model/*.h", "src/model/*.cpp")
RULES = (
    Rule(MODEL, PLATFORM, frozenset(), "the value classes know no platform"),
    Rule(("include/TnFbx[!E]*.h", "src/model/*.h", "src/model/*.cpp"), ABOVE_MODEL, frozenset(),
         "the value classes know neither adapter nor facade"),
    Rule(("include/*.h", "src/*/*.h", "src/*/*.cpp", "src/*.h", "src/*.cpp"), PLATFORM,
         frozenset({"<fbxsdk.h>", "<fbxsdk/Platform.h>"}), "the library sees the platform only as <fbxsdk.h>",
         # Only the bundled platform has extensions: builds against another one omit the includes.
         frozenset({("src/MaximumThreads.cpp", "<fbxsdk/extensions/Threads.h>"),
                    ("src/access/ItemReader.h", "<fbxsdk/extensions/ItemRuns.h>"),
                    ("src/access/NodeGeometry.h", "<fbxsdk/extensions/NodeSamples.h>"),
                    ("src/access/NodeGeometry.h", "<fbxsdk/extensions/PropertySamples.h>"),
                    ("src/sdk/CurveWriting.cpp", "<fbxsdk/extensions/CurveSamples.h>"),
                    ("src/sdk/PropertySampling.cpp", "<fbxsdk/extensions/CurveSamples.h>")})),
    Rule(("include/Fbx[!P]*.h",), re.compile("<fbxsdk.h>"), frozenset(),
         "where file names ignore case that is FbxSdk.h: public headers include FbxPlatform.h"),
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
            file = str(path.relative_to(root))
            for match in INCLUDE.finditer(source):
                if (rule.judged.match(match[1]) and match[1] not in rule.allowed
                        and (file, match[1]) not in rule.exceptions):
                    line = source.count("\n", 0, match.start(1)) + 1
                    yield f"{file}:{line}: {match[1]}: {rule.reason}"


def violations(root):
    return [violation for rule in RULES for violation in violations_of(rule, root)] + list(module_violations(root))


# The platform's modules: their dependencies are declared once, where they are built.
MODULES_FILE = "fbxsdk/CMakeLists.txt"
MODULE = re.compile(r"tarnell_module\((\w+)(?: NEEDS ([\w ]+?))?(?: LIBRARIES [^)]*)?\)")
PLATFORM_INCLUDE = re.compile(r'^(?:"(\w+)/[^"]+"|<fbxsdk/([\w/]+)\.h>)$')
IMPLEMENTED = re.compile(r"^FBXSDK_(?:OBJECT|ABSTRACT)_IMPLEMENT\((\w+),", re.MULTILINE)
# A class belongs to the module of the source that has its name or implements it; these have none.
OTHER_HEADERS = {
    "FbxArch": "core", "FbxArray": "core", "FbxColor": "core", "FbxEuler": "core", "FbxTypes": "core",
    "FbxVector2": "core", "FbxVector4": "core", "FbxTransform": "core", "FbxSystemUnit": "scene",
    "FbxAxisSystem": "scene", "FbxNurbs": "geometry", "FbxBlendShapeChannel": "geometry", "FbxSceneRenamer": "io",
    "FbxTakeInfo": "io", "Platform": "io",
}


def modules(root):
    """Each module with its dependencies."""
    path = root / MODULES_FILE
    text = path.read_text(encoding="utf-8") if path.exists() else ""
    usable = {}
    for match in MODULE.finditer(text):  # in the order of their needs
        needs = (match[2] or "").split()
        usable[match[1]] = {match[1], *needs, *(below for need in needs for below in usable[need])}
    return usable


def module_violations(root):
    usable = modules(root)
    module_of_class = dict(OTHER_HEADERS)
    sources = [path for pattern in ("*.h", "*.cpp") for path in sorted((root / "fbxsdk/src").rglob(pattern))]
    for path in sources:
        if path.suffix == ".cpp":
            module = path.relative_to(root / "fbxsdk/src").parts[0]
            if path.stem.startswith("Fbx"):
                module_of_class[path.stem] = module
            for implemented in IMPLEMENTED.finditer(path.read_text(encoding="utf-8")):
                module_of_class[implemented[1]] = module
    headers = sorted((root / "fbxsdk/include/fbxsdk").glob("*.h"))
    for path in (headers if usable else []):
        if path.stem not in module_of_class:
            yield f"{path.relative_to(root)}: no source has its name or implements its class: add it to OTHER_HEADERS"
    for path in sources + headers:
        module = module_of_class.get(path.stem) if path in headers else path.relative_to(root / "fbxsdk/src").parts[0]
        source = without_comments(path.read_text(encoding="utf-8"))
        for match in INCLUDE.finditer(source):
            included = PLATFORM_INCLUDE.match(match[1])
            other = included and (included[1] or module_of_class.get(included[2]))
            if module in usable and other in usable and other not in usable[module]:
                line = source.count("\n", 0, match.start(1)) + 1
                yield f"{path.relative_to(root)}:{line}: {match[1]}: {module} does not need {other}"


def main():
    root = Path(sys.argv[1])
    if not any(root.glob("include/Tn*.h")):
        sys.exit(f"{root}: no library headers here")
    found = violations(root)
    if not modules(root):
        found.append(f"{MODULES_FILE}: no modules here")
    print("\n".join(found))
    return 1 if found else 0


if __name__ == "__main__":
    sys.exit(main())
