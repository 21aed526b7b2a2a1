# SPDX-License-Identifier: MIT
# Copyright (c) Tarnell FBX contributors
#
# Point caches that cannot be used: the mesh shows as if it had none, and info says why.
import os
import re
import shutil
import struct
import tempfile
import unittest

from support import ROOT, dump, run

SHAPED = os.path.join(ROOT, "tests", "data", "tool", "shaped_triangle.fbx")
FRAMES = "1003:1006"


class Cache(unittest.TestCase):
    kind = "maya"

    def setUp(self):
        folder = tempfile.TemporaryDirectory()
        self.addCleanup(folder.cleanup)
        self.file = os.path.join(folder.name, "shot.fbx")
        result = run("convert", SHAPED, self.file, "--frames", FRAMES, "--cache", self.kind)
        self.assertEqual(result.returncode, 0, result.stderr)
        self.caches = self.file[:-4] + "_fpc"

    def path(self, extension):
        return os.path.join(self.caches, "moving" + extension)

    def change(self, extension, edit):
        with open(self.path(extension), "rb") as stream:
            old = stream.read()
        new = edit(old)
        self.assertNotEqual(old, new)
        with open(self.path(extension), "wb") as stream:
            stream.write(new)

    def reasons(self):
        result = run("info", self.file)
        self.assertEqual(result.returncode, 0, result.stderr)
        found = re.findall(r'^  Cache +"moving" cannot use its point cache: (.+)$', result.stdout, re.MULTILINE)
        self.assertEqual(len(found), result.stdout.count("  Cache "))
        return found

    def shapes(self):
        """The points of each frame, rounded."""
        meshes = dump("--kind", "meshes", "--frames", FRAMES, self.file)["meshes"]
        return [[round(c, 3) for c in mesh["controlPoints"]] for mesh in meshes]

    def check_unused(self, reason):
        found = self.reasons()
        self.assertEqual(len(found), 1, found)
        self.assertRegex(found[0], reason)
        shapes = self.shapes()
        self.assertEqual(len(shapes), 4)
        for shape in shapes:
            self.assertEqual(shape, shapes[0])

    def check_used(self):
        self.assertEqual(self.reasons(), [])
        self.assertEqual([shape[0] for shape in self.shapes()], [4, 6, 8, 10])


class MayaCache(Cache):
    def test_a_sound_cache_moves_the_mesh_and_gives_no_reason(self):
        self.check_used()

    def test_a_missing_folder(self):
        shutil.rmtree(self.caches)
        self.check_unused(r"moving\.xml: .*No such file")

    def test_missing_data(self):
        os.remove(self.path(".mcx"))
        self.check_unused(r"moving\.mcx: .*No such file")

    def test_a_folder_in_place_of_the_description(self):
        os.remove(self.path(".xml"))
        os.mkdir(self.path(".xml"))
        self.check_unused(r"moving\.xml: ")

    def test_a_pipe_in_place_of_the_data_is_not_waited_for(self):
        os.remove(self.path(".mcx"))
        os.mkfifo(self.path(".mcx"))
        self.check_unused(r"moving\.mcx: ")

    def test_an_empty_description(self):
        self.change(".xml", lambda old: b"")
        self.check_unused(r"moving\.xml: ")

    def test_a_description_that_is_cut_off(self):
        self.change(".xml", lambda old: old[:len(old) // 2])
        self.check_unused(r"moving\.xml: offset \d+: ")

    def test_a_description_of_something_else(self):
        self.change(".xml", lambda old: b"<scene/>")
        self.check_unused(r"moving\.xml: not a cache description")

    def test_a_description_of_another_channel(self):
        self.change(".xml", lambda old: old.replace(b'"moving"', b'"standing"'))
        self.check_unused(r'it has no channel "moving"; its channels: "standing"')

    def test_a_description_without_channels(self):
        self.change(".xml", lambda old: re.sub(rb"<channel0[^>]*/>", b"", old))
        self.check_unused(r'it has no channel "moving"; its channels: none')

    def test_data_of_another_channel(self):
        self.change(".mcx", lambda old: old.replace(b"moving", b"gnivom"))
        self.check_unused(r"frame 1003: the sample has no channel moving")

    def test_data_that_is_cut_off_before_the_first_sample(self):
        self.change(".mcx", lambda old: old[:60])
        self.check_unused(r"moving\.mcx: offset \d+: truncated or damaged")

    def test_data_that_is_cut_off_in_the_last_sample(self):
        self.change(".mcx", lambda old: old[:-1])
        self.check_unused(r"moving\.mcx: offset \d+: truncated or damaged")

    def test_data_that_is_no_cache(self):
        self.change(".mcx", lambda old: bytes(len(old)))
        self.check_unused(r"moving\.xml: no samples in its data files")

    def test_samples_of_another_number_of_points(self):
        other = struct.pack(">q", 4) + struct.pack(">i", 2) + bytes(4)
        self.change(".mcx", lambda old: old.replace(struct.pack(">q", 4) + struct.pack(">i", 3) + bytes(4), other))
        self.check_unused(r"frame 1003: ")

    def test_points_that_are_not_finite_are_named(self):
        self.change(".mcx", lambda old: old.replace(struct.pack(">d", 6), struct.pack(">d", float("nan"))))
        found = self.reasons()
        self.assertEqual(len(found), 1)
        self.assertRegex(found[0], r"frame 100\d: points that are not finite")


class MaxCache(Cache):
    kind = "max"

    def header(self, points=3, start=1003.0, rate=1.0, samples=4, magic=b"POINTCACHE2\0"):
        self.change(".pc2", lambda old: magic + struct.pack("<iiffi", 1, points, start, rate, samples) + old[32:])

    def test_a_sound_cache_moves_the_mesh_and_gives_no_reason(self):
        self.check_used()

    def test_a_missing_file(self):
        os.remove(self.path(".pc2"))
        self.check_unused(r"moving\.pc2: .*No such file")

    def test_a_file_that_is_cut_off(self):
        self.change(".pc2", lambda old: old[:-1])
        self.check_unused(r"moving\.pc2: offset 16: 3 points and 4 samples do not fit 175 bytes")

    def test_a_head_that_is_cut_off(self):
        self.change(".pc2", lambda old: old[:31])
        self.check_unused(r"moving\.pc2: offset 0: not a point cache")

    def test_something_else(self):
        self.header(magic=b"POINTCACHE1\0")
        self.check_unused(r"moving\.pc2: offset 0: not a point cache")

    def test_counts_that_cannot_be(self):
        with open(self.path(".pc2"), "rb") as stream:
            sound = stream.read()
        for points, samples in ((0, 4), (-3, 4), (3, 0), (3, -4), (3, 5), (0x7FFFFFFF, 0x7FFFFFFF), (-2**31, -2**31)):
            with self.subTest(points=points, samples=samples):
                with open(self.path(".pc2"), "wb") as stream:
                    stream.write(sound)
                self.header(points=points, samples=samples)
                self.check_unused(rf"{points} points and {samples} samples do not fit 176 bytes")

    def test_another_number_of_points(self):
        self.header(points=2)
        self.check_unused(r"it has 2 points, but the mesh has 3")

    def test_points_that_are_not_finite_are_named(self):
        self.change(".pc2", lambda old: old[:32 + 36] + struct.pack("<f", float("inf")) + old[32 + 40:])
        self.assertEqual(self.reasons(), ["frame 1004: points that are not finite"])

    def test_frames_before_zero_are_no_reason_to_stop(self):
        self.header(start=-2.0)
        self.assertEqual(self.reasons(), [])
        self.header(start=float("nan"))
        self.assertEqual(self.reasons(), [])
        self.header(start=3e38)
        self.assertEqual(self.reasons(), [])


del Cache  # a base, not a test
unittest.main(argv=["cache_test"], verbosity=0)
