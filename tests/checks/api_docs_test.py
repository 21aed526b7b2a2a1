#!/usr/bin/env python3
# SPDX-License-Identifier: MIT
# Copyright (c) Tarnell FBX contributors
"""Shows what api_docs.py counts as undocumented, and what it refuses."""

import subprocess
import tempfile
import unittest
from pathlib import Path

from api_docs import ROOT, undocumented, verdict


def count_in(header):
    """The undocumented symbols of a header, and the warnings of Doxygen."""
    with tempfile.TemporaryDirectory() as folder:
        root = Path(folder)
        (root / "sources").mkdir()
        (root / "sources/Sample.h").write_text(header, encoding="utf-8")
        settings = (ROOT / "docs/api/common.doxyfile").read_text(encoding="utf-8")
        settings += f"INPUT = {root}/sources\nOUTPUT_DIRECTORY = {root}\nSTRIP_FROM_PATH = {root}/sources\n"
        settings += "EXPAND_AS_DEFINED = DECLARE\n"
        result = subprocess.run(["doxygen", "-"], input=settings, capture_output=True, text=True, check=False)
        return [symbol for _, _, symbol in sorted(undocumented(root / "xml"))], result


class Undocumented(unittest.TestCase):
    def check(self, header, expected):
        found, _ = count_in(header)
        self.assertEqual(found, expected)

    def test_counts_classes_members_enumerators_and_constants(self):
        header = """
            class Lens { public: void focus(int distance); static constexpr int kBlades = 5; enum EKind : int { kZoom }; };
            using Length = double;"""
        self.check(header, ["Lens", "Lens::EKind", "Lens::EKind::kZoom", "Lens::focus(int distance)", "Lens::kBlades",
                            "Length"])

    def test_accepts_comments_before_and_behind(self):
        self.check("/// A lens.\nclass Lens { public:\n/// Millimetres.\nint a();\nint b(); ///< Degrees.\n};", [])

    def test_takes_the_comment_of_a_group_for_all_its_members(self):
        group = "/// Both in millimetres.\n/// @{\nint a();\nint b();\n/// @}\nint c();\n"
        self.check("/// A lens.\nclass Lens { public:\n" + group + "};", ["Lens::c()"])

    def test_counts_overloads_one_by_one(self):
        self.check("/// A lens.\nclass Lens { public:\n/// Millimetres.\nint a();\nint a(int b);\n};", ["Lens::a(int b)"])

    def test_asks_nothing_of_destructors_and_of_what_the_language_makes(self):
        members = "~Lens();\nLens(const Lens&) = default;\nLens& operator=(const Lens&) = delete;\n"
        self.check("/// A lens.\nclass Lens { public:\n" + members + "};", [])

    def test_asks_nothing_of_private_members_and_internal_namespaces(self):
        private = "private:\nint hidden();\nstruct Parts { int hidden; };\n"
        self.check("namespace detail { struct Hidden { int a; }; }\n/// A lens.\nclass Lens {\n" + private + "};", [])

    def test_counts_what_a_macro_declares_in_a_class(self):
        macro = "/// Declares.\n#define DECLARE(Class) static Class* make(); /** Kinds. */ static int kind();\n"
        self.check(macro + "/// A lens.\nclass Lens { public:\nDECLARE(Lens)\n};", ["Lens::make()"])


class Refusals(unittest.TestCase):
    def test_doxygen_warnings_are_errors(self):
        _, result = count_in("/// \\param nothing There is no such parameter.\nint measure(int length);\n")
        self.assertNotEqual(result.returncode, 0)
        self.assertIn("nothing", result.stderr)

    def test_sound_headers_have_no_warnings(self):
        _, result = count_in("/// Centimetres.\nint measure(int length);\n")
        self.assertEqual((result.returncode, result.stderr), (0, ""))

    def test_the_number_may_neither_grow_nor_stay_behind(self):
        self.assertIn("document what is new", verdict(6, 5, "file.txt"))
        self.assertIn("write 4 to file.txt", verdict(4, 5, "file.txt"))
        self.assertIsNone(verdict(5, 5, "file.txt"))


if __name__ == "__main__":
    unittest.main()
