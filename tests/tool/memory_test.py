# SPDX-License-Identifier: MIT
# Copyright (c) Tarnell FBX contributors
#
# What the tool says when memory runs out in the middle of its work. Sanitized programs cannot be limited like this.
import os
import re
import resource
import sys
import tempfile
import unittest

from support import edited, run

CORNERS = 4_000_000
# The file can be opened and parsed within this, but the mesh, with 36 bytes per corner in its arrays, cannot be read.
LIMIT = 64 << 20


def limited():
    resource.setrlimit(resource.RLIMIT_AS, (LIMIT, LIMIT))


class OutOfMemory(unittest.TestCase):
    def setUp(self):
        folder = tempfile.TemporaryDirectory()
        self.addCleanup(folder.cleanup)
        self.folder = folder.name
        triangles = CORNERS // 3
        self.big = edited("mesh_7400_ascii.fbx", os.path.join(self.folder, "big.fbx"),
                          ("*7 {\n\t\t\ta: 0,1,2,-4,3,2,-5",
                           f"*{3 * triangles} {{\n\t\t\ta: " + ",".join(["0,1,-3"] * triangles)))

    def assertOneLine(self, result, file):
        self.assertEqual(result.returncode, 1)
        self.assertRegex(result.stderr, rf"\Atarnell-fbx: {re.escape(file)}: [^\n]*not enough memory\n\Z")

    def test_a_dump_gives_one_line_with_the_file_and_status_1(self):
        self.assertOneLine(run("dump", "--kind", "meshes", self.big, preexec_fn=limited), self.big)

    def test_a_conversion_gives_one_line_with_the_file_and_status_1(self):
        out = os.path.join(self.folder, "out.fbx")
        self.assertOneLine(run("convert", self.big, out, preexec_fn=limited), self.big)
        self.assertEqual(os.listdir(self.folder), ["big.fbx"])

    def test_a_small_file_fits(self):
        small = edited("mesh_7400_ascii.fbx", os.path.join(self.folder, "small.fbx"))
        result = run("dump", "--kind", "meshes", small, preexec_fn=limited)
        self.assertEqual((result.returncode, result.stderr), (0, ""))


unittest.main(argv=sys.argv[:1], verbosity=0)
