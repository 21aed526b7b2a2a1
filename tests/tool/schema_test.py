# SPDX-License-Identifier: MIT
# Copyright (c) Tarnell FBX contributors
#
# The documents that commands print agree with the schemas in docs/schema, for every file of tests/data and for files
# that cannot be read. First the checker itself: it refuses what a schema does not allow.
import glob
import json
import os
import sys
import tempfile
import unittest

from schema import faults, load
from support import ROOT, SHOT, run

FILES = sorted(glob.glob(os.path.join(ROOT, "tests", "data", "**", "*.fbx"), recursive=True)) + [SHOT]
CACHES = sorted(glob.glob(os.path.join(ROOT, "tests", "data", "sdk", "caches", "*.*")))


def documents(*arguments):
    return [json.loads(line) for line in run(*arguments, "--jsonl").stdout.splitlines()]


class Checker(unittest.TestCase):
    def test_refuses_what_a_schema_does_not_allow(self):
        page = {"type": "object", "properties": {"n": {"type": "integer", "minimum": 0}, "s": {"enum": ["a", "b"]}},
                "required": ["n"], "additionalProperties": False}
        self.assertEqual(list(faults({"n": 1, "s": "a"}, page, page)), [])
        for wrong in ({"s": "a"}, {"n": -1}, {"n": 1.5}, {"n": True}, {"n": "1"}, {"n": 1, "s": "c"}, {"n": 1, "x": 2},
                      [], None):
            self.assertTrue(list(faults(wrong, page, page)), wrong)
        either = {"anyOf": [{"type": "array", "items": {"const": 1}}, {"type": "null"}]}
        self.assertEqual(list(faults([1, 1], either, either)) + list(faults(None, either, either)), [])
        self.assertTrue(list(faults([1, 2], either, either)))

    def test_knows_every_keyword_or_says_so(self):
        with self.assertRaises(AssertionError):
            list(faults(1, {"maximum": 2}, {}))


class Schemas(unittest.TestCase):
    def check(self, command, pages):
        schema = load(command)
        self.assertTrue(pages)
        for page in pages:
            self.assertEqual(list(faults(page, schema, schema)), [], page["file"])
            self.assertEqual(list(page)[:2], ["format", "file"])

    def test_of_commands_that_take_many_files(self):
        for command in ("info", "tree", "records", "camera", "lint"):
            with self.subTest(command):
                pages = documents(command, *FILES)
                self.assertEqual([page["file"] for page in pages], FILES)
                self.check(command, pages)

    def test_of_reports(self):
        if "made without npm" in run("report").stderr:
            self.skipTest("this build has no reports")
        self.check("report", documents("report", *FILES))

    def test_of_caches(self):
        self.check("cache", documents("cache", "--samples", "--verify", *FILES, *CACHES))

    def test_of_props_and_curves(self):
        data = os.path.join(ROOT, "tests", "data", "sdk")
        for file, name in ((SHOT, "shotCam"), (SHOT, "crate"), (os.path.join(data, "curves_7400_ascii.fbx"), "cubic"),
                           (os.path.join(data, "auto_curves_7400_ascii.fbx"), "tcb"),
                           (os.path.join(data, "extrapolation_7400_ascii.fbx"), "other")):
            pages = documents("props", "--all", file, name) + documents("curve", file, name, "--frames", "0:3")
            self.assertNotIn("error", [*pages[0], *pages[1]])
            self.check("props", pages[:1])
            self.check("curve", pages[1:])

    def test_of_differences(self):
        data = os.path.join(ROOT, "tests", "data")
        schema = load("diff")
        clean = os.path.join(data, "lint", "clean.fbx")
        for other in FILES:
            page = documents("diff", clean, other)[0]
            self.assertEqual(list(faults(page, schema, schema)), [], other)
            self.assertEqual(list(page)[:3], ["format", "a", "b"])
        self.assertEqual(list(documents("diff", clean, "missing.fbx")[0]), ["format", "a", "b", "error"])

    def test_of_explained_cameras_at_frames(self):
        pages = documents("camera", "--explain", "--frames", "1001:1003", SHOT)
        self.assertEqual(len(pages[0]["cameras"][0]["frames"]), 3)
        self.check("camera", pages)

    def test_of_a_file_that_cannot_be_read(self):
        with tempfile.TemporaryDirectory() as folder:
            missing = os.path.join(folder, "missing.fbx")
            for command in ("info", "tree", "records", "cache", "camera", "lint"):
                pages = documents(command, SHOT, missing)
                self.check(command, pages)
                self.assertEqual(list(pages[1]), ["format", "file", "error"])
            for command in ("props", "curve"):
                self.check(command, documents(command, missing, "node"))


unittest.main(argv=sys.argv[:1], verbosity=0)
