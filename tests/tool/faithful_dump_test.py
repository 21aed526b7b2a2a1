#!/usr/bin/env python3
# SPDX-License-Identifier: MIT
# Copyright (c) Tarnell FBX contributors
"""What dump --faithful adds to the document, and which animation it takes."""

import sys
import unittest

from support import SDK_DATA, dump, named, run


def fixture(name):
    return f"{SDK_DATA}/{name}"


class FaithfulDump(unittest.TestCase):
    def test_says_unit_and_axes_of_the_file_and_the_parent_and_space_of_each_object(self):
        page = dump("--faithful", fixture("nulls_metres_7400_ascii.fbx"))
        self.assertEqual(page["unitInCentimetres"], 100)
        self.assertIn("+Y up", page["axes"])
        self.assertEqual([null["parent"] for null in page["nulls"]], [None, page["nulls"][0]["name"]])
        self.assertEqual({null["space"] for null in page["nulls"]}, {"world"})
        local = dump("--faithful", "--local", "--kind", "nulls", fixture("nulls_metres_7400_ascii.fbx"))
        self.assertEqual({null["space"] for null in local["nulls"]}, {"parent"})

    def test_says_in_which_space_points_are(self):
        file = fixture("mesh_7400_ascii.fbx")
        self.assertEqual(dump("--faithful", "--kind", "meshes", file)["meshes"][0]["pointSpace"], "world")
        self.assertEqual(
            dump("--faithful", "--no-transform-points", "--kind", "meshes", file)["meshes"][0]["pointSpace"], "object")

    def test_leaves_producer_cameras_out(self):
        self.assertEqual(dump("--faithful", fixture("producer_cameras_6100_ascii.fbx"))["cameras"], [])
        camera = named(dump("--faithful", fixture("camera_7400_ascii.fbx"))["cameras"], "shot")
        self.assertIs(camera["producer"], False)

    def test_takes_the_stack_that_is_named(self):
        file = fixture("two_stacks_7400_ascii.fbx")
        for stack, start in (("walk", 1001), ("run", 0)):
            page = dump("--faithful", "--stack", stack, "--kind", "nulls", file)
            self.assertEqual(page["nulls"][0]["transform"]["positionX"]["start"], start)

    def test_fails_for_a_stack_that_is_not_there(self):
        result = run("dump", "--faithful", "--stack", "jump", fixture("two_stacks_7400_ascii.fbx"))
        self.assertEqual(result.returncode, 1)
        self.assertIn('"walk", "run"', result.stderr)

    def test_prints_the_document_without_the_additions_when_it_is_not_asked_for(self):
        page = dump(fixture("nulls_7400_ascii.fbx"))
        self.assertNotIn("axes", page)
        self.assertNotIn("parent", page["nulls"][0])


if __name__ == "__main__":
    unittest.main(argv=sys.argv[:1])
