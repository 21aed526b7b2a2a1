# SPDX-License-Identifier: MIT
# Copyright (c) Tarnell FBX contributors
#
# Small files that demand much, made by the generator next to the corpus: loading one takes less than 64 MiB and
# 1,100 times its size, and so does converting one, except for a conversion's results. Without the generator nothing is
# tested, and the status is 77.
import os
import subprocess
import sys
import tempfile
import unittest

from support import ROOT, peak_of

# Those whose objects the tool holds while it converts: meshes that the file has once, or samples of every frame.
HANDED_OUT = {"surfaces": 1 << 30, "claim": 256 << 20, "clip_meshes": 256 << 20}
# The others at the generator's own sizes, which take seconds.
SIZES = {"nulls": 20_000, "meshes": 10_000, "big": 20_000}


def generator():
    corpus = os.environ.get("TARNELL_CORPUS", os.path.join(ROOT, "..", "shared", "corpus"))
    return os.path.join(os.path.dirname(os.path.normpath(corpus)), "damage", "make_cases.py")


class Damage(unittest.TestCase):
    @classmethod
    def setUpClass(cls):
        folder = tempfile.TemporaryDirectory()
        cls.addClassCleanup(folder.cleanup)
        cls.folder = os.path.join(folder.name, "cases")
        cls.copy = os.path.join(folder.name, "copy.fbx")
        subprocess.run([sys.executable, "-B", generator(), cls.folder], check=True)
        subprocess.run([sys.executable, "-B", generator(), cls.folder, *(f"{name}={n}" for name, n in SIZES.items())],
                       check=True)

    def each_case(self):
        for file in sorted(os.listdir(self.folder)):
            path = os.path.join(self.folder, file)
            yield file.removesuffix(".fbx"), path, (64 << 20) + 1100 * os.path.getsize(path)

    def test_loading_takes_no_more_than_the_file_allows(self):
        # Markers are what only the claim has, and a single one.
        for name, path, allowed in self.each_case():
            for command in (["dump", "--kind", "markers"], ["info"], ["tree"]):
                with self.subTest(name, command=command):
                    status, peak, complaint = peak_of(*command, path)

                    self.assertEqual((status, complaint), (0, ""))
                    self.assertLess(peak, allowed)

    def test_so_does_converting_but_for_what_is_handed_out(self):
        for name, path, allowed in self.each_case():
            with self.subTest(name):
                status, peak, _ = peak_of("convert", "--force", path, self.copy)

                self.assertEqual(status, 0)
                self.assertLess(peak, max(allowed, HANDED_OUT.get(name, 0)))


if not os.path.exists(generator()):
    print("skipped: no generator of damaged files beside the corpus")
    sys.exit(77)
unittest.main(argv=sys.argv[:1], verbosity=0)
