# SPDX-License-Identifier: MIT
# Copyright (c) Tarnell FBX contributors
#
# camera and the references of real files: lens and angles after gate fit, at every frame that a reference has.
import glob
import json
import os
import sys
import unittest

from support import ROOT, run

CORPUS = os.path.join(ROOT, "..", "shared", "corpus")


def close(actual, wanted):
    return abs(actual - wanted) <= 1e-5 * max(1, abs(wanted))


class References(unittest.TestCase):
    def test_agree_with_every_camera(self):
        compared = set()
        for path in sorted(glob.glob(os.path.join(CORPUS, "refs-faithful", "*.json"))):
            name = os.path.basename(path)[:-len(".json")]
            with open(path, encoding="utf-8") as stream:
                wanted = {node["name"]: node for node in json.load(stream)["nodes"]
                          if node.get("focalLength") and node["perspective"]}
            if not wanted:
                continue
            page = json.loads(run("camera", "--json", os.path.join(CORPUS, "fbx", name + ".fbx")).stdout)
            for camera in page["cameras"]:
                node = wanted.get(camera["name"])
                if not node or camera["lensChanges"]:
                    continue
                moment = camera["at"]
                for actual, key in ((moment["focalLength"], "focalLength"), (moment["pictureFov"][0], "fovX"),
                                    (moment["pictureFov"][1], "fovY"), (moment["picture"][0], "apertureWidth"),
                                    (moment["picture"][1], "apertureHeight")):
                    self.assertTrue(close(actual, node[key][0]), (name, camera["name"], key, actual, node[key][0]))
                compared.add(name)
        self.assertGreaterEqual(len(compared), 14)

    def test_a_maya_camera_in_words(self):
        page = run("camera", os.path.join(CORPUS, "fbx", "maya_ngon_maze_7700_binary.fbx")).stdout
        for line in ("camera1  perspective, lens driven by focal length, static",
                     "  Focal length  49.4546 mm",
                     "  Film back     1.41732 × 0.94488 in = 36.00 × 24.00 mm, 1.5:1, 35 mm still, full frame",
                     "  FOV of film   40.000° × 27.278°",
                     "  Resolution    960 × 540; gate fit fill → 40.000° × 23.141°",
                     "  World         (0, 2822.351, 3698.346) cm, looks (0, −0.671, −0.742)",
                     "  Post-rotation (0, −90, 0): rotation 0 looks along −Z",
                     "  In the file, not in force: FieldOfView 25.115, FieldOfViewX 40, FieldOfViewY 40"):
            self.assertIn(line + "\n", page)

    def test_orthographic_widths_of_maya_and_blender(self):
        for name, widths in (("maya_ortho_camera_size_7700_ascii", {"Ortho_30": 30, "Ortho_10": 10, "Ortho_100": 100,
                                                                    "Ortho_35": 35}),
                             ("blender_402_ortho_scale_local_7400_binary", {"Ortho_1": 100, "Ortho_2": 200,
                                                                            "Ortho_3": 300})):
            page = json.loads(run("camera", "--json", os.path.join(CORPUS, "fbx", name + ".fbx")).stdout)
            for camera in page["cameras"]:
                self.assertTrue(close(camera["ortho"]["width"], widths.pop(camera["name"])), name)
            self.assertEqual(widths, {})


if not os.path.isdir(CORPUS):
    print("no corpus")
    sys.exit(77)
unittest.main(argv=sys.argv[:1], verbosity=0)
