#!/usr/bin/env python3
# SPDX-License-Identifier: MIT
# Copyright (c) Tarnell FBX contributors
"""Fails when a spelling of the format occurs outside of the table that readers and writers share.

Usage: format_spellings.py PROJECT_ROOT

What is in a table of these headers may be a literal of no other source of the platform. A word that means something else
there as well is a row of OTHER_MEANINGS.
"""

import re
import sys
from pathlib import Path

TABLES = (
    "schema/LayerElements.h",
    "schema/OldNames.h",
    "schema/ProducerCameras.h",
    "schema/Spellings.h",
    "schema/SubClasses.h",
    "container/FileFormat.h",
)
# Numbers with names: that one may be spelt as a number nowhere else.
NUMBERS = {"schema/KeySpellings.h": re.compile(r"= (0x[0-9A-Fa-f]{4,});")}
OTHER_MEANINGS = {
    "Visibility": "a property of nodes",
    "Closed": "a record of patches",
    "Normals": "a record of models before 6.0, and of shapes",
    "Materials": "a record of models before 6.0",
    "Camera": "a kind of attribute",
    "Shape": "a record of geometry before 7.0",
    "Light": "a kind of attribute",
    "Marker": "the type flags of markers",
    "LimbNode": "the kind that the type flags of skeletons mean before 6.0",
    "Cone angle": "a type of properties",
    # Present names that classes bind, and names that are records before 6.0.
    "InnerAngle": "a property of lights",
    "OuterAngle": "a property of lights",
    "CastLightOnObject": "a property of lights",
    "HotSpot": "a record of lights",
    "ConeAngle": "a record of lights",
    "CastLight": "a record of lights",
    "AspectWidth": "a property of cameras",
    "AspectHeight": "a property of cameras",
    "AspectRatioMode": "a property of cameras",
    "AspectW": "a record of cameras",
    "AspectH": "a record of cameras",
}
STRING = re.compile(r'"((?:[^"\\\n]|\\.)*)"')


def without_comments_and_includes(source):
    source = re.sub(r"^\s*#\s*include[^\n]*$", "", source, flags=re.MULTILINE)
    return re.sub(r"//[^\n]*", "", source)


def literals(path):
    text = without_comments_and_includes(path.read_text(encoding="utf-8"))
    return {match[1] for match in STRING.finditer(text)}


def violations(root):
    sources = root / "fbxsdk/src"
    tables = {sources / name for name in TABLES}
    spellings = {text: name for name in TABLES for text in literals(sources / name) if len(text) > 1}
    numbers = {}
    for name, pattern in NUMBERS.items():
        for match in pattern.finditer((sources / name).read_text(encoding="utf-8")):
            numbers[match[1]] = name
    for path in sorted([*sources.rglob("*.h"), *sources.rglob("*.cpp")]):
        if path in tables:
            continue
        place = path.relative_to(sources)
        text = without_comments_and_includes(path.read_text(encoding="utf-8"))
        if place.parts[0] != "schema":
            for spelling in sorted(literals(path) & (spellings.keys() - OTHER_MEANINGS.keys())):
                yield f"fbxsdk/src/{place}: \"{spelling}\" is in {spellings[spelling]}"
        if str(place) not in NUMBERS:
            for number, name in numbers.items():
                if re.search(rf"\b{number}\b", text):
                    yield f"fbxsdk/src/{place}: {number} is in {name}"


def main():
    root = Path(sys.argv[1])
    if not (root / "fbxsdk/src/schema").is_dir():
        sys.exit(f"{root}: no project root")
    found = list(violations(root))
    for violation in found:
        print(violation, file=sys.stderr)
    return 1 if found else 0


if __name__ == "__main__":
    sys.exit(main())
