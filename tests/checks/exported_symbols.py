#!/usr/bin/env python3
# SPDX-License-Identifier: MIT
# Copyright (c) Tarnell FBX contributors
"""Compares the exports of a shared library with its public headers.

Usage: exported_symbols.py LIBRARY_FILE PRODUCT COMPILER

PRODUCT is `library` or `platform`. Every exported symbol must be public in the product's headers or be one of the
exceptions below, and every public function that the headers only declare must be exported. Doxygen reads the headers.
What functions that are defined in the headers call must be exported as well, public or not: a compiler that can keep
all of them (gcc) tells.
"""

import re
import subprocess
import sys
import tempfile
import xml.etree.ElementTree as ElementTree
from collections import Counter
from pathlib import Path
from typing import NamedTuple

ROOT = Path(__file__).resolve().parent.parent.parent
# The reference shows no private members, and the platform's inline namespace neither.
SETTINGS = "GENERATE_HTML = NO\nEXTRACT_PRIVATE = YES\nEXCLUDE_SYMBOLS =\n"
HEADERS = {"library": "include", "platform": "fbxsdk/include"}
NAMESPACES = {"library": "Tarnell::Fbx::", "platform": "fbxsdk::"}
INLINE_NAMESPACE = "fbxsdk::tarnell::"
OF_A_CLASS = re.compile(r"^(?:typeinfo(?: name)?|vtable|VTT|guard variable) for ")

# Not public, and exported all the same: name (a pattern), and why.
EXCEPTIONS = {
    "library": (),
    "platform": (
        (r"fbxsdk::FbxProperty::(readValue|writeValue|evaluate)", "called by Get, Set and EvaluateValue, templates"),
        (r"fbxsdk::detail::(PlainStorage|StoredItems|ItemSource)(::.*)?", "called by FbxPlainArray, a template"),
        (r"fbxsdk::detail::throwMissing(Direct|Index)Array", "called by FbxLayerElementTemplate, a template"),
        (r"fbxsdk::FbxLayerElementTemplate::.*", "instances of a template"),
        (r"fbxsdk::Fbx(Layer::set|NurbsSurfaceBase::(knots|multiplicity)|(Cluster|LayerContainer)::loadSource)",
         "called by public functions that are defined in the headers"),
    ),
}


class Function(NamedTuple):
    is_public: bool
    is_declared_only: bool  # its definition is in the library


def functions_and_classes(xml_folder):
    """What the headers declare: functions and variables by name, and the names of public classes."""
    functions, classes = {}, set()
    for path in sorted(Path(xml_folder).glob("*.xml")):
        for compound in ElementTree.parse(path).getroot().findall("compounddef"):
            name = compound.findtext("compoundname")
            in_scope = compound.get("kind") in ("class", "struct", "namespace")
            is_internal = "detail" in name.split("::")
            if not in_scope or name.startswith("std"):
                continue
            if compound.get("prot") != "private" and not is_internal:
                classes.add(re.sub("<.*>", "", name).strip())
            for member in compound.iter("memberdef"):
                if member.get("kind") in ("function", "variable"):
                    functions.setdefault(f"{name}::{member.findtext('name')}", []).append(
                        Function(member.get("prot") == "public" and not is_internal,
                                 is_declared_only(member, compound)))
    return functions, classes


def is_declared_only(member, compound):
    arguments = member.findtext("argsstring") or ""
    has_body = member.get("inline") == "yes" or member.find("location").get("bodyfile") is not None
    is_template = member.find("templateparamlist") is not None or compound.find("templateparamlist") is not None
    return (member.get("kind") == "function" and not has_body and not is_template
            and not arguments.endswith(("=0", "=default", "=delete")))


def name_of(symbol):
    """The qualified name within a demangled symbol: without result, arguments and template arguments."""
    symbol = symbol.replace(INLINE_NAMESPACE, "fbxsdk::").replace("[abi:cxx11]", "")
    symbol = OF_A_CLASS.sub("", symbol)
    operator = re.search(r"operator(\(\)|<=|>=|<<|>>|->|<|>)", symbol)
    marked = symbol.replace(operator[0], "operator@", 1) if operator else symbol
    plain, depth = "", 0
    for character in marked:
        depth += (character in "<(") - (character in ">)")
        if depth == 0 and character not in ">)":
            plain += character
    plain = plain.removesuffix(" const").strip()
    if " operator" not in plain and "::operator " not in plain:
        plain = plain.split(" ")[-1]
    return plain.replace("operator@", operator[0]) if operator else plain


def violations(symbols, functions, classes, exceptions):
    exported = Counter()
    for symbol in sorted(set(symbols)):
        name = name_of(symbol)
        exported[name] += 1
        public = sum(function.is_public for function in functions.get(name, ()))
        is_public = name in classes if OF_A_CLASS.match(symbol) else exported[name] <= public
        # Each instance of a template is a symbol of its own.
        if not is_public and not ("<" in symbol.split("(")[0] and public):
            if not any(re.fullmatch(pattern, name) for pattern, _ in exceptions):
                yield f"exported, but not public: {symbol}"
    for name, overloads in sorted(functions.items()):
        if any(function.is_public and function.is_declared_only for function in overloads) and not exported[name]:
            yield f"public, but not exported: {name}"


def missing_calls(called, symbols):
    """What the headers' own functions call and the library does not export."""
    for symbol in sorted(set(called) - set(symbols)):
        yield f"called by a function in the headers, but not exported: {symbol}"


def exported_symbols(library):
    listing = subprocess.run(["nm", "-D", "--defined-only", "-C", library], capture_output=True, text=True, check=True)
    return [line.split(None, 2)[2] for line in listing.stdout.splitlines() if len(line.split(None, 2)) == 3]


def symbols_called_by_headers(product, compiler, folder):
    """The product's functions that inline functions of its headers call; nothing where the compiler lists none."""
    headers = ROOT / HEADERS[product]
    source, target = Path(folder) / "headers.cpp", Path(folder) / "headers.o"
    names = sorted(str(path.relative_to(headers)) for path in headers.rglob("*.h"))
    source.write_text("".join(f"#include <{name}>\n" for name in names), encoding="utf-8")
    result = subprocess.run([compiler, "-std=c++17", "-O0", "-Werror", "-fkeep-inline-functions", f"-I{headers}",
                             f"-I{ROOT}/fbxsdk/include", "-c", source, "-o", target],
                            capture_output=True, text=True, check=False)
    if result.returncode:
        print(f"{compiler} does not keep inline functions: what they call is not checked")
        return []
    listing = subprocess.run(["nm", "-u", "-C", target], capture_output=True, text=True, check=True)
    namespace = NAMESPACES[product]
    return [symbol for symbol in (line.split(None, 1)[1] for line in listing.stdout.splitlines())
            if name_of(symbol).startswith(namespace)]


def main():
    library, product, compiler = sys.argv[1:4]
    settings = (ROOT / f"docs/api/{product}.doxyfile").read_text(encoding="utf-8") + SETTINGS
    with tempfile.TemporaryDirectory() as folder:
        subprocess.run(["doxygen", "-"], input=f"{settings}OUTPUT_DIRECTORY = {folder}\n", text=True, check=True,
                       capture_output=True, cwd=ROOT)
        functions, classes = functions_and_classes(Path(folder) / "xml")
        called = symbols_called_by_headers(product, compiler, folder)
    symbols = exported_symbols(library)
    if not symbols or not functions:
        sys.exit(f"{library}: nothing is exported or declared")
    found = [*violations(symbols, functions, classes, EXCEPTIONS[product]), *missing_calls(called, symbols)]
    print("\n".join(found))
    return 1 if found else 0


if __name__ == "__main__":
    sys.exit(main())
