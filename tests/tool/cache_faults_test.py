# SPDX-License-Identifier: MIT
# Copyright (c) Tarnell FBX contributors
#
# The output of `cache` for damaged caches: every fault with its place, and all valid data as well.
import json
import os
import shutil
import struct
import sys
import tempfile
import unittest

from support import SDK_DATA, run

CACHES = os.path.join(SDK_DATA, "caches")


class Faults(unittest.TestCase):
    def setUp(self):
        folder = tempfile.TemporaryDirectory()
        self.addCleanup(folder.cleanup)
        self.folder = os.path.join(folder.name, "caches")
        shutil.copytree(CACHES, self.folder)

    def path(self, name):
        return os.path.join(self.folder, name)

    def edit(self, name, edit):
        with open(self.path(name), "rb") as stream:
            data = stream.read()
        with open(self.path(name), "wb") as stream:
            stream.write(edit(data))

    def content(self, name, *options, status):
        result = run("cache", "--json", *options, self.path(name))
        self.assertEqual(result.returncode, status, result.stderr)
        entry = json.loads(result.stdout)["caches"][0]
        self.assertEqual(entry["sound"], not entry["content"]["faults"])
        return entry["content"]

    def faults(self, name):
        """Offsets by file of what --verify finds."""
        result = [(os.path.basename(each["file"]), each["offset"], each["reason"])
                  for each in self.content(name, "--verify", status=1)["faults"]]
        self.assertIn("caches have faults", run("cache", "--verify", self.path(name)).stderr)
        return result

    def samples(self, name):
        content = self.content(name, "--samples", status=0)
        return [(each["frame"], each["offset"]) for each in content["samples"]]

    def test_a_max_cache_that_is_cut_off(self):
        self.edit("max.pc2", lambda data: data[:80])  # 32 bytes of header, samples of 36: one and a piece
        self.assertEqual(self.samples("max.pc2"), [(1, 32)])
        self.assertEqual(self.faults("max.pc2"), [("max.pc2", 68, "truncated: 2 of 3 samples are missing")])
        self.edit("max.pc2", lambda data: data[:20])
        self.assertEqual([each[:2] for each in self.faults("max.pc2")], [("max.pc2", 20)])

    def test_a_max_cache_with_more_than_it_says(self):
        self.edit("max.pc2", lambda data: data + bytes(5))
        self.assertEqual(self.faults("max.pc2"), [("max.pc2", 140, "5 bytes after the last sample")])

    def test_numbers_that_are_none(self):
        nan = struct.pack("<f", float("nan"))
        self.edit("max.pc2", lambda data: data[:76] + nan + data[80:])
        self.assertEqual(self.faults("max.pc2"), [("max.pc2", 76, "a number that is not finite")])
        self.assertEqual(self.content("max.pc2", status=0)["faults"], [])  # without --verify numbers are not checked
        infinite = struct.pack(">f", float("inf"))
        self.edit("wide.mcx", lambda data: data[:352] + infinite + data[356:])
        self.assertEqual(self.faults("wide.xml"), [("wide.mcx", 352, "channel wave: a number that is not finite")])

    def test_a_maya_cache_that_is_cut_off(self):
        self.edit("wide.mcx", lambda data: data[:400])
        self.assertEqual(self.samples("wide.xml"), [(0, 200), (1, 348)])
        found = self.faults("wide.xml")
        self.assertEqual((found[0][0], found[0][2]), ("wide.mcx", "truncated or damaged"))
        self.assertEqual(found[1:], [("wide.xml", 0, "channel wave: no sample at frame 2")])

    def test_a_sample_whose_file_is_missing(self):
        os.remove(self.path("filesFrame1.mc"))
        self.assertEqual([frame for frame, _ in self.samples("files.xml")], [0, 2])
        self.assertEqual(self.faults("files.xml"), [("files.xml", 0, "channel wave: no sample at frame 1")])

    def test_a_data_file_that_is_missing(self):
        os.remove(self.path("narrow.mc"))
        found = self.faults("narrow.xml")
        self.assertEqual(found[0][0], "narrow.mc")
        self.assertIn("No such file", found[0][2])

    def test_a_data_file_leads_to_its_description(self):
        for data, description in (("wide.mcx", "wide.xml"), ("narrow.mc", "narrow.xml"),
                                  ("filesFrame2.mc", "files.xml")):
            content = self.content(data, "--verify", status=0)
            self.assertEqual(content["description"], self.path(description))
            os.remove(self.path(description))
            content = self.content(data, "--verify", status=0)
            self.assertEqual((content["description"], content["frameRate"], content["channels"]), ("", None, []))
            self.assertEqual(content["found"][0]["channel"], "wave")

    def test_no_cache_at_all(self):
        for name, data in (("words.xml", b"hello"), ("other.xml", b"<a/>"), ("words.pc2", b"hello"), ("empty.mc", b"")):
            with open(self.path(name), "wb") as stream:
                stream.write(data)
            result = run("cache", self.path(name))
            self.assertEqual((result.returncode, result.stdout), (1, ""), name)
            self.assertIn(name, result.stderr)


unittest.main(argv=sys.argv[:1], verbosity=0)
