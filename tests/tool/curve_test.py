# SPDX-License-Identifier: MIT
# Copyright (c) Tarnell FBX contributors
#
# What curve says of keys explains what it says of samples: between two keys a curve is worked out here from the slopes
# and weights that were printed, as a Bézier curve.
import csv
import importlib.util
import io
import json
import os
import sys
import tempfile
import unittest

from support import ROOT, SDK_DATA, SHOT, edited, float32, run


spec = importlib.util.spec_from_file_location("make_lint_files",
                                              os.path.join(ROOT, "tests", "data", "lint", "make_lint_files.py"))
scenes = importlib.util.module_from_spec(spec)
spec.loader.exec_module(scenes)


def fixture(name):
    return os.path.join(SDK_DATA, name)


def curves(*arguments):
    result = run("curve", *arguments, "--json")
    assert result.returncode == 0, result.stderr
    return json.loads(result.stdout)


def bezier(points, u):
    return sum(factor * point * u**i * (1 - u)**(3 - i) for i, (factor, point) in enumerate(zip((1, 3, 3, 1), points)))


def between(left, right, seconds):
    """The value between two keys."""
    span = right["seconds"] - left["seconds"]
    t = (seconds - left["seconds"]) / span
    if left["interpolation"] == "constant":
        return left["value"]
    if left["interpolation"] == "next":
        return right["value"] if t > 1e-6 else left["value"]
    if left["interpolation"] == "linear":
        return left["value"] + t * (right["value"] - left["value"])
    assert left["interpolation"] == "cubic"
    handles = left["rightWeight"], right["leftWeight"]
    times = (0, handles[0], 1 - handles[1], 1)
    values = (left["value"], left["value"] + span * handles[0] * left["rightSlope"],
              right["value"] - span * handles[1] * right["leftSlope"], right["value"])
    low, high = 0, 1  # the time grows with the parameter
    for _ in range(60):
        middle = (low + high) / 2
        low, high = (middle, high) if bezier(times, middle) < t else (low, middle)
    return bezier(values, low)


def value_at(curve, seconds):
    keys = curve["keys"]
    if seconds <= keys[0]["seconds"]:
        return keys[0]["value"]
    for left, right in zip(keys, keys[1:]):
        if seconds < right["seconds"] - 1e-9:
            return between(left, right, seconds)
    return keys[-1]["value"]


class Samples(unittest.TestCase):
    def test_follow_from_the_keys(self):
        checked = 0
        for name, node, last in (("auto_curves_7400_ascii.fbx", "auto", 10), ("auto_curves_7400_ascii.fbx", "tcb", 10),
                                 ("curves_7400_ascii.fbx", "straight", 10), ("camera_7400_ascii.fbx", "shot", 1012)):
            page = curves(fixture(name), node, "--frames", f"0:{last}")
            self.assertTrue(page["channels"])
            for channel in page["channels"]:
                self.assertEqual(len(channel["curves"]), 1)
                self.assertEqual(channel["samples"]["firstFrame"], 0)
                for frame, sample in enumerate(channel["samples"]["values"]):
                    wanted = value_at(channel["curves"][0], frame / page["frameRate"])
                    self.assertAlmostEqual(sample, wanted, 4, (name, channel["property"], channel["component"], frame))
                    checked += 1
        self.assertGreater(checked, 1000)

    def test_add_up_over_layers(self):
        channel = curves(fixture("layers_7400_ascii.fbx"), "added", "--frames", "0:2")["channels"][0]
        self.assertEqual([curve["layer"] for curve in channel["curves"]], ["BaseLayer", "additive"])
        self.assertEqual([curve["blend"] for curve in channel["curves"]], ["additive", "additive"])
        self.assertEqual([curve["weight"] for curve in channel["curves"]], [100, 50])
        for frame, sample in enumerate(channel["samples"]["values"]):
            wanted = sum(curve["weight"] / 100 * value_at(curve, frame / 24) for curve in channel["curves"])
            self.assertAlmostEqual(sample, wanted, 4)

    def test_are_the_same_as_comma_separated_values(self):
        page = curves(SHOT, "shotCam", "--frames", "1001:1048")
        text = run("curve", SHOT, "shotCam", "--csv").stdout  # the take spans these frames
        rows = list(csv.reader(io.StringIO(text)))
        self.assertEqual(rows[0][:2], ["frame", "seconds"])
        self.assertEqual(len(rows[0]) - 2, len(page["channels"]))
        for i, row in enumerate(rows[1:]):
            self.assertEqual(int(row[0]), 1001 + i)
            self.assertAlmostEqual(float(row[1]), (1001 + i) / 24, 9)
            self.assertEqual([float(cell) for cell in row[2:]],
                             [channel["samples"]["values"][i] for channel in page["channels"]])


class Targets(unittest.TestCase):
    def names(self, *arguments):
        return [(each["class"], each["property"], each["component"]) for each in curves(*arguments)["channels"]]

    def test_a_node_answers_for_its_camera_and_each_channel_comes_once(self):
        names = self.names(SHOT, "shotCam")
        self.assertIn(("Camera", "FocalLength", ""), names)
        self.assertIn(("Node", "Lcl Translation", "X"), names)
        self.assertEqual(len(names), len(set(names)))

    def test_a_node_answers_for_its_blend_shapes_and_materials(self):
        file = fixture("blend_shape_7400_ascii.fbx")
        tree = json.loads(run("tree", "--json", file).stdout)["nodes"]
        shaped = [each for each in tree if any("blend shape" in text for text in each["deformers"])]
        self.assertEqual([each["animated"] for each in shaped], [True] * len(shaped))
        names = [name for each in shaped for name in self.names(file, each["name"])]
        self.assertIn(("BlendShapeChannel", "DeformPercent", ""), names)
        painted = scenes.scene(objects=scenes.record("Material", 30, "Material::paint", "", {"DiffuseFactor": 1.0}),
                               connections='C: "OO",30,20\n', on=30, animated="DiffuseFactor", channel="d|DiffuseFactor")
        self.assertIn("\npaint.DiffuseFactor  [Surface", run("curve", "-", "tri", input=painted).stdout)

    def test_properties_and_components_may_be_spelt_simply(self):
        whole = [("Node", "Lcl Translation", axis) for axis in "XYZ"]
        for spelling in ("Lcl Translation", "lcl translation", "Translation", "translation"):
            self.assertEqual(self.names(SHOT, "shotCam." + spelling), whole)
        for spelling in ("Lcl Translation.Y", "translation.y"):
            self.assertEqual(self.names(SHOT, "shotCam." + spelling), whole[1:2])

    def test_what_has_no_name_is_called_by_its_node(self):
        with open(os.path.join(ROOT, "tests", "data", "lint", "curve-that-stops-three-js.fbx"), encoding="utf-8") as stream:
            text = stream.read().replace("NodeAttribute::cam", "NodeAttribute::")
        for form, words in (((), "\ncam.FilmOffsetX  [Camera]\n"), (("--plot",), "\ncam.FilmOffsetX\n"),
                            (("--csv",), "frame,seconds,cam.FilmOffsetX\n")):
            self.assertIn(words, run("curve", *form, "-", "cam", input=text).stdout)
        self.assertEqual(json.loads(run("curve", "--json", "-", "cam", input=text).stdout)["channels"][0]["object"], "")
        self.assertIn('\n"cam"  Camera\n', run("props", "-", "cam", input=text).stdout)

    def test_names_may_hold_dots(self):
        with tempfile.TemporaryDirectory() as folder:
            file = edited("nulls_7400_ascii.fbx", os.path.join(folder, "dots.fbx"),
                          ('"Model::parent", "Null"', '"Model::a.b.X", "Null"'))
            self.assertEqual(curves(file, "a.b.X")["channels"], [])
            self.assertEqual(self.names(file, "a.b.X.translation.x"), [("Node", "Lcl Translation", "X")])
            self.assertEqual(curves(file, "a.b.X.translation.x")["channels"][0]["value"], 1)

    def test_what_there_is_not_is_an_error(self):
        for target in ("nosuch", "shotCam.nosuch", "shotCam.translation.w", "shotCam.", ".", ""):
            result = run("curve", SHOT, target)
            self.assertEqual((result.returncode, result.stdout), (1, ""), target)
            self.assertEqual(len(result.stderr.splitlines()), 1)


class Words(unittest.TestCase):
    def test_of_extrapolation_tell_endless_from_counted_repetition(self):
        file = fixture("extrapolation_7400_ascii.fbx")
        sides = {each["component"]: each["curves"][0] for each in curves(file, "endless")["channels"]}
        for component, kind in (("X", "repetition"), ("Y", "mirror")):
            for side in ("before", "after"):
                self.assertEqual(sides[component][side], {"type": kind, "count": None})
        page = run("curve", file, "endless").stdout
        self.assertIn("before repetition (endless), after repetition (endless)", page)
        self.assertIn("before slope, after slope", page)
        self.assertIn("before constant, after repetition (once)", run("curve", file, "other").stdout)

    def test_of_extrapolation_tell_zero_times_from_endless(self):
        with tempfile.TemporaryDirectory() as folder:
            file = edited("extrapolation_7400_ascii.fbx", os.path.join(folder, "zero.fbx"),
                          ("Type: R\n\t\t\tRepetition: 1\n", "Type: R\n\t\t\tRepetition: 0\n"))
            self.assertIn("after repetition (0 times)", run("curve", file, "other").stdout)

    def test_of_numbers_have_the_digits_that_floats_hold(self):
        page = curves(SHOT, "shotCam.FocalLength", "--frames", "1001:1010")["channels"][0]
        text = run("curve", SHOT, "shotCam.FocalLength", "--frames", "1001:1010").stdout
        for row, value in zip(text.splitlines()[-10:], page["samples"]["values"]):
            self.assertLessEqual(len(row.split()[-1]), 9)
            self.assertEqual(float32(float(row.split()[-1])), value)

    def test_of_frames_leave_out_what_ticks_round(self):
        file = os.path.join(ROOT, "tests", "data", "blender", "layers_7400_binary.fbx")  # at 23.976
        page = curves(file, "house.Lcl Translation.X")["channels"][0]["curves"][0]
        self.assertNotEqual(page["keys"][0]["frame"], 1001)  # the number of the file
        rows = run("curve", file, "house.Lcl Translation.X").stdout.splitlines()[-5:]
        self.assertEqual([row.split()[0] for row in rows], ["1001", "1002", "1003", "1004", "1005"])

    def test_of_samples_tell_channels_of_one_name_apart(self):
        def paint(number, name):
            return scenes.record("Material", number, "Material::" + name, "", {"DiffuseFactor": 1.0})
        keys = scenes.record("AnimationCurveNode", 41, "AnimCurveNode::D", "", {"d|DiffuseFactor": 0.0})
        text = scenes.scene(
            objects=paint(30, "paint") + paint(40, "rust") + keys + scenes.curve(42, (0, 4), [0.0, 1.0], 24),
            connections='C: "OO",30,20\nC: "OO",40,20\nC: "OO",41,11\nC: "OP",41,40, "DiffuseFactor"\n'
                        'C: "OP",42,41, "d|DiffuseFactor"\n',
            on=30, animated="DiffuseFactor", channel="d|DiffuseFactor")
        page = run("curve", "-", "tri", "--frames", "0:1", input=text).stdout
        self.assertIn("  Frame   Seconds  paint.DiffuseFactor  rust.DiffuseFactor\n", page)

    def test_of_a_plot_say_what_stands_still_in_a_line(self):
        text = run("curve", SHOT, "shotCam.FocusDistance", "--plot").stdout.splitlines()
        self.assertEqual(text[3:], ["shotCam.FocusDistance  1000000 constant, from frame 1001 to 1048"])


class Takes(unittest.TestCase):
    def test_are_chosen_by_name(self):
        file = fixture("two_stacks_7400_ascii.fbx")
        self.assertEqual(curves(file, "node")["take"]["name"], "walk")
        page = curves(file, "node", "--take", "run", "--frames", "0:1")
        self.assertEqual(page["take"]["name"], "run")
        self.assertEqual(page["channels"][0]["samples"]["values"], [100, 200])
        self.assertEqual(run("curve", file, "node", "--take", "jump").returncode, 1)


unittest.main(argv=sys.argv[:1], verbosity=0)
