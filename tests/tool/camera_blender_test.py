# SPDX-License-Identifier: MIT
# Copyright (c) Tarnell FBX contributors
#
# camera says of files that Blender exported what Blender itself says of the cameras (tests/data/blender/cameras.json), on
# every frame: lens, angles and shift of the picture, place and direction. Blender's metres with Z up are turned here.
import json
import os
import unittest

from support import ROOT, run

FOLDER = os.path.join(ROOT, "tests", "data", "blender")
INCH = 25.4


def y_up(vector):
    x, y, z = vector
    return [x, z, -y]


class CamerasOfBlender(unittest.TestCase):
    def close(self, actual, wanted, tolerance, slack=0.0):
        self.assertEqual(len(actual), len(wanted))
        for a, w in zip(actual, wanted):
            self.assertLessEqual(abs(a - w), tolerance * max(1, abs(w)) + slack, (actual, wanted))

    def check_frame(self, said, wanted, off):
        """`off`: how much of a frame Blender's keys lie beside whole frames."""
        self.assertEqual(said["frame"], wanted["frame"])
        self.close(said["position"], [100 * each for each in y_up(wanted["place"])], 2e-6, 25 * off)
        self.close(said["direction"], y_up(wanted["looks"]), 2e-6)
        if "lens" in wanted:
            self.close([said["focalLength"]], [wanted["lens"]], 1e-6, 12.5 * off)
            self.close(said["pictureFov"], wanted["angles"], 5e-6, 18 * off)
            self.close([each * INCH for each in said["filmOffset"]], wanted["shift"], 1e-5)

    def test_are_what_blender_shows(self):
        with open(os.path.join(FOLDER, "cameras.json"), encoding="utf-8") as stream:
            truth = json.load(stream)
        self.assertEqual(len(truth), 5)
        for file, wanted in truth.items():
            with self.subTest(file):
                result = run("camera", "--json", "--frames", "1001:1005", os.path.join(FOLDER, file))
                self.assertEqual(result.returncode, 0, result.stderr)
                page = json.loads(result.stdout)
                [camera] = page["cameras"]
                self.assertEqual(camera["name"], wanted["name"])
                self.close([page["frameRate"]], [wanted["rate"]], 1e-7)  # Blender's fps_base is a float
                self.close([each * INCH for each in camera["at"]["film"]], wanted["film"], 1e-6)
                self.close(camera["at"]["planes"], [100 * each for each in wanted["clip"]], 1e-6)
                self.assertEqual(len(camera["frames"]), len(wanted["frames"]))
                # At 59.94 Blender divides by a float, 1.001, and its keys come late: 0.00005 frames after 1001 frames.
                # From frame to frame that camera moves by 25 cm, its lens changes by 12.5 mm, and its angles by 17 degrees.
                off = 1001 * abs(wanted["rate"] / page["frameRate"] - 1) * 1.01
                for said, frame in zip(camera["frames"], wanted["frames"]):
                    self.check_frame(said, frame, off)
                if "picture" in wanted["frames"][0]:
                    self.close([camera["ortho"]["width"]], [100 * wanted["frames"][0]["picture"][0]], 1e-6)


if __name__ == "__main__":
    unittest.main(argv=["camera_blender_test"], verbosity=0)
