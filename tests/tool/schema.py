# SPDX-License-Identifier: MIT
# Copyright (c) Tarnell FBX contributors
#
# The part of JSON Schema that docs/schema uses. A keyword that is not known here is an error, so that no rule is passed
# over in silence.
import json
import os

from support import ROOT

ANNOTATIONS = {"$schema", "$defs", "title", "description"}
TYPES = {"object": dict, "array": list, "string": str, "boolean": bool, "null": type(None)}


def load(command):
    with open(os.path.join(ROOT, "docs", "schema", f"{command}.schema.json"), encoding="utf-8") as stream:
        return json.load(stream)


def is_type(value, name):
    if name in ("integer", "number"):
        kinds = (int,) if name == "integer" else (int, float)
        return isinstance(value, kinds) and not isinstance(value, bool)
    return isinstance(value, TYPES[name])


def of_any(value, schemas, root, place):
    found = [list(faults(value, each, root, place)) for each in schemas]
    if all(found):
        yield min(found, key=len)[0] + " (and no other form fits)"


def of_properties(value, schema, root, place):
    known = schema.get("properties", {})
    rest = schema.get("additionalProperties", True)
    for name, item in value.items():
        if name in known:
            yield from faults(item, known[name], root, f"{place}.{name}")
        elif rest is False:
            yield f"{place}: unknown key {name}"
        elif rest is not True:
            yield from faults(item, rest, root, f"{place}.{name}")


RULES = {
    "type": lambda v, rule, *_: [] if is_type(v, rule) else ["is no " + rule],
    "const": lambda v, rule, *_: [] if v == rule else [f"is not {rule!r}"],
    "enum": lambda v, rule, *_: [] if v in rule else [f"{v!r} is none of {rule}"],
    "minimum": lambda v, rule, *_: [f"{v} is less than {rule}"] if is_type(v, "number") and v < rule else [],
    "required": lambda v, rule, *_: [f"has no key {name}" for name in rule if isinstance(v, dict) and name not in v],
}


def faults(value, schema, root, place="document"):
    """Sentences about everything in the value that the schema does not allow."""
    for keyword, rule in schema.items():
        if keyword in RULES:
            yield from (f"{place}: {fault}" for fault in RULES[keyword](value, rule))
        elif keyword == "anyOf":
            yield from of_any(value, rule, root, place)
        elif keyword == "$ref":
            assert rule.startswith("#/$defs/"), rule
            yield from faults(value, root["$defs"][rule[len("#/$defs/"):]], root, place)
        elif keyword == "items":
            for i, item in enumerate(value if isinstance(value, list) else []):
                yield from faults(item, rule, root, f"{place}[{i}]")
        elif keyword == "properties":
            if isinstance(value, dict):
                yield from of_properties(value, schema, root, place)
        elif keyword == "additionalProperties":
            if "properties" not in schema and isinstance(value, dict):
                yield from of_properties(value, schema, root, place)
        else:
            assert keyword in ANNOTATIONS, f"{keyword}: this checker does not know it"
