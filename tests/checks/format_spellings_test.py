#!/usr/bin/env python3
# SPDX-License-Identifier: MIT
# Copyright (c) Tarnell FBX contributors
"""Shows which literals format_spellings.py refuses and which it accepts."""

import tempfile
import unittest
from pathlib import Path

from format_spellings import NUMBERS, TABLES, violations


class FormatSpellings(unittest.TestCase):
    def check(self, file, source):
        with tempfile.TemporaryDirectory() as folder:
            sources = Path(folder) / "fbxsdk/src"
            for name in (*TABLES, *NUMBERS):
                (sources / name).parent.mkdir(parents=True, exist_ok=True)
                (sources / name).write_text("", encoding="utf-8")
            (sources / "schema/Spellings.h").write_text('kTypes = {"DualQuaternion", "Closed"};', encoding="utf-8")
            (sources / "schema/KeySpellings.h").write_text("constexpr std::uint32_t user = 0x1000000;", encoding="utf-8")
            (sources / file).parent.mkdir(parents=True, exist_ok=True)
            (sources / file).write_text(source, encoding="utf-8")
            return list(violations(Path(folder)))

    def test_refuses_a_spelling_beside_its_table(self):
        self.assertTrue(self.check("geometry/Writing.cpp", 'writeText(sink, "SkinningType", "DualQuaternion");'))

    def test_refuses_the_bits_of_flags_beside_their_table(self):
        self.assertTrue(self.check("document/Keys.cpp", "constexpr auto kUser = 0x1000000;"))

    def test_takes_the_tables_themselves_and_other_words(self):
        for source in ('writeText(sink, "SkinningType", spellingOf(kTypes, 2, 0));', '// "DualQuaternion"',
                       '#include "DualQuaternion"', "auto n = 0x10000000;"):
            self.assertFalse(self.check("geometry/Writing.cpp", source), source)
        self.assertFalse(self.check("schema/Other.cpp", '"DualQuaternion"'))

    def test_takes_words_with_another_meaning(self):
        self.assertFalse(self.check("geometry/Patch.cpp", 'body.child("Closed")'))


if __name__ == "__main__":
    unittest.main()
