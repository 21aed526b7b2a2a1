#!/usr/bin/env python3
# SPDX-License-Identifier: MIT
# Copyright (c) Tarnell FBX contributors
"""Shows what kept_behaviours.py refuses."""

import tempfile
import unittest
from pathlib import Path

from kept_behaviours import violations

HEAD = "| Behaviour | Why it looks wrong | Held by |\n|---|---|---|\n"
TESTS = "TEST(Suite, Holds) {}\nTYPED_TEST(Typed, Holds) {}\nTEST_P(Param,\n       Holds) {}\n"


class KeptBehaviours(unittest.TestCase):
    def check(self, document):
        with tempfile.TemporaryDirectory() as folder:
            root = Path(folder)
            (root / "docs").mkdir()
            (root / "docs/kept-behaviours.md").write_text(document, encoding="utf-8")
            (root / "tests/model").mkdir(parents=True)
            (root / "tests/model/SomeTest.cpp").write_text(TESTS, encoding="utf-8")
            return violations(root)

    def test_accepts_tests_that_exist(self):
        row = "| a | b | `Suite.Holds`, `Typed.Holds`, `Param.Holds` |\n"
        self.assertEqual(self.check(HEAD + row), [])

    def test_refuses_a_test_that_does_not_exist(self):
        found = self.check(HEAD + "| a | b | `Suite.Holds` |\n| a | b | `Suite.Gone` |\n")
        self.assertEqual(found, ["docs/kept-behaviours.md:4: Suite.Gone: no such test"])

    def test_refuses_an_entry_without_a_test(self):
        self.assertEqual(self.check(HEAD + "| a | b | |\n"), ["docs/kept-behaviours.md:3: a: no test holds it"])

    def test_refuses_a_document_without_entries(self):
        self.assertTrue(self.check("# nothing\n"))

    def test_ignores_other_tables(self):
        other = "| Name | Value |\n|---|---|\n| a | `Suite.Gone` |\n\n"
        self.assertEqual(self.check(other + HEAD + "| a | b | `Suite.Holds` |\n"), [])


if __name__ == "__main__":
    unittest.main()
