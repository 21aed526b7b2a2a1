#!/usr/bin/env python3
# SPDX-License-Identifier: MIT
# Copyright (c) Tarnell FBX contributors
"""The check of docs/known-differences.md refuses what it should."""
import unittest

from known_differences import complaints

EXPECTED = '{"nodes": {"differing": [{"reason": "kept on purpose", "files": ["cube"]}]}}'
PAGE = "| Reason | Evidence |\n|---|---|\n| {} | because |\n"


class KnownDifferences(unittest.TestCase):
    def test_accepts_equal_lists(self):
        self.assertEqual(complaints(EXPECTED, PAGE.format("kept on purpose")), [])

    def test_refuses_a_reason_that_is_not_documented(self):
        found = complaints(EXPECTED, "")
        self.assertEqual(found, ["not in docs/known-differences.md: kept on purpose"])

    def test_refuses_a_documented_reason_without_files(self):
        found = complaints('{"nodes": {"differing": []}}', PAGE.format("kept on purpose"))
        self.assertEqual(found, ["no file differs for this reason: kept on purpose"])

    def test_knows_the_reasons_of_rewritten_files(self):
        found = complaints(EXPECTED, PAGE.format("kept on purpose"), '[{"reason": "no layers"}]')
        self.assertEqual(found, ["not in docs/known-differences.md: no layers"])


if __name__ == "__main__":
    unittest.main()
