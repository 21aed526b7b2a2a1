#!/usr/bin/env python3
# SPDX-License-Identifier: MIT
# Copyright (c) Tarnell FBX contributors
"""Builds the API reference of a product, and compares the number of its undocumented symbols with the recorded one.

Usage: api_docs.py PRODUCT SCRATCH_FOLDER    what ctest runs; fails when there are more than recorded, or fewer
       api_docs.py PRODUCT --list            all of them, as FILE:LINE: SYMBOL

PRODUCT is `library` or `platform`; its number is in undocumented_PRODUCT.txt and only ever falls.
"""

import subprocess
import sys
import tempfile
import xml.etree.ElementTree as ElementTree
from pathlib import Path

HERE = Path(__file__).resolve().parent
ROOT = HERE.parent.parent
COMPOUNDS = ("class", "struct", "union", "namespace")
MEMBERS = ("function", "variable", "enum", "typedef", "define")


def is_documented(element):
    texts = (element.find("briefdescription"), element.find("detaileddescription"))
    return any("".join(text.itertext()).strip() for text in texts if text is not None)


def is_public(element):
    return element.get("prot") in ("public", "protected")


def speaks_for_itself(member):
    """Destructors, and defaulted or deleted members."""
    arguments = member.findtext("argsstring") or ""
    return member.findtext("name").startswith("~") or arguments.endswith(("=default", "=delete"))


def place(element):
    location = element.find("location")
    return location.get("file"), int(location.get("line") or 0)


def undocumented_members(member, scope):
    name = f"{scope}::{member.findtext('name') or '(unnamed enum)'}" if scope else member.findtext("name")
    if not is_documented(member) and not speaks_for_itself(member):
        yield (*place(member), name + (member.findtext("argsstring") or ""))
    for value in member.findall("enumvalue"):
        if not is_documented(value):
            yield (*place(member), f"{name}::{value.findtext('name')}")


def undocumented(xml_folder):
    """Yields (file, line, symbol) of every public symbol without a description."""
    seen = set()
    for path in sorted(Path(xml_folder).glob("*.xml")):
        for compound in ElementTree.parse(path).getroot().findall("compounddef"):
            name = compound.findtext("compoundname")
            kind = compound.get("kind")
            is_scope = kind in COMPOUNDS
            if name == "std" or is_scope and not is_public(compound) and kind != "namespace":
                continue
            # An outer namespace that holds nothing but the inner one says nothing by itself.
            holds = compound.find("innerclass") is not None or compound.find(".//memberdef") is not None
            if is_scope and holds and not is_documented(compound):
                yield (*place(compound), name)
            for member in compound.iter("memberdef"):
                if member.get("kind") in MEMBERS and is_public(member) and member.get("id") not in seen:
                    seen.add(member.get("id"))
                    yield from undocumented_members(member, name if is_scope else "")


def verdict(number, recorded, number_file):
    if number > recorded:
        return f"{number} undocumented symbols, {recorded} are recorded: document what is new (--list shows all)"
    if number < recorded:
        return f"{number} undocumented symbols, {recorded} are recorded: write {number} to {number_file}"
    return None


def build(product, folder):
    """The folder of the XML, or none and Doxygen's warnings."""
    result = subprocess.run([ROOT / "scripts/api-docs", product, folder], capture_output=True, text=True, check=False)
    if result.returncode != 0 or result.stderr:
        return None, result.stderr or f"scripts/api-docs ended with {result.returncode}"
    return Path(folder) / "xml", None


def check(product, folder, number_file, show_all):
    xml, warnings = build(product, folder)
    if warnings:
        return warnings
    found = sorted(undocumented(xml))
    if show_all:
        print("\n".join(f"{file}:{line}: {symbol}" for file, line, symbol in found))
        return None
    return verdict(len(found), int(number_file.read_text(encoding="utf-8")), number_file.relative_to(ROOT))


def main():
    product, folder = sys.argv[1], sys.argv[2]
    number_file = HERE / f"undocumented_{product}.txt"
    if folder == "--list":
        with tempfile.TemporaryDirectory() as scratch:
            error = check(product, scratch, number_file, show_all=True)
    else:
        error = check(product, folder, number_file, show_all=False)
    if error:
        print(error)
    return 1 if error else 0


if __name__ == "__main__":
    sys.exit(main())
