# SPDX-License-Identifier: MIT
# Copyright (c) Tarnell FBX contributors
#
# The output of camera follows from the numbers in the file by arithmetic that is repeated here: lens and angle, film
# and picture, rotations and directions.
import csv
import io
import itertools
import json
import math
import os
import subprocess
import tempfile
import unittest

from support import ROOT, SDK_DATA, SHOT, TOOL, edited, run

INCH = 25.4
MODES = ("twoAngles", "horizontalAngle", "verticalAngle", "focalLength")  # as files number them
FITS = ("none", "vertical", "horizontal", "fill", "overscan", "stretch")

HEAD = """; FBX 7.4.0 project file
FBXHeaderExtension:  {
	FBXHeaderVersion: 1003
	FBXVersion: 7400
	Creator: "%s"
}
GlobalSettings:  {
	Version: 1000
	Properties70:  {
		P: "UpAxis", "int", "Integer", "",1
		P: "UpAxisSign", "int", "Integer", "",1
		P: "FrontAxis", "int", "Integer", "",2
		P: "FrontAxisSign", "int", "Integer", "",1
		P: "CoordAxis", "int", "Integer", "",0
		P: "CoordAxisSign", "int", "Integer", "",1
		P: "UnitScaleFactor", "double", "Number", "",%g
		P: "TimeMode", "enum", "", "",11
	}
}
"""


def property_line(name, value):
    if isinstance(value, tuple):
        return '\t\t\tP: "%s", "Vector3D", "Vector", "",%s\n' % (name, ",".join(repr(number) for number in value))
    kind = ("enum", "") if isinstance(value, int) else ("double", "Number")
    return '\t\t\tP: "%s", "%s", "%s", "",%r\n' % (name, *kind, value)


def scene(camera=None, node=None, unit=1.0, creator="written by hand"):
    """A file with one camera, called "cam", whose attribute and node have these properties."""
    lines = {1: "".join(property_line(*each) for each in (node or {}).items()),
             2: "".join(property_line(*each) for each in (camera or {}).items())}
    return (HEAD % (creator, unit) + 'Objects:  {\n\tModel: 1, "Model::cam", "Camera" {\n\t\tVersion: 232\n'
            "\t\tProperties70:  {\n" + lines[1] + '\t\t}\n\t}\n\tNodeAttribute: 2, "NodeAttribute::cam", "Camera" {\n'
            "\t\tProperties70:  {\n" + lines[2] + '\t\t}\n\t\tTypeFlags: "Camera"\n\t}\n}\n'
            'Connections:  {\n\tC: "OO",1,0\n\tC: "OO",2,1\n}\n')


def page_of(text, *arguments):
    result = run("camera", "-", "--json", *arguments, input=text)
    assert result.returncode == 0, result.stderr
    return json.loads(result.stdout)


def one(text, *arguments):
    cameras = page_of(text, *arguments)["cameras"]
    assert len(cameras) == 1
    return cameras[0]


def angle(inches, focal_length):
    return math.degrees(2 * math.atan(inches * INCH / (2 * focal_length)))


def focal_length(inches, degrees):
    return inches * INCH / (2 * math.tan(math.radians(degrees / 2)))


def gate(width, height, aspect, fit):
    """What a picture of that aspect shows of a film: the one side that fits, and the other as long as the picture has it."""
    by_width, by_height = (width, width / aspect), (height * aspect, height)
    if fit == "vertical":
        return by_height
    if fit == "horizontal":
        return by_width
    if fit == "fill":  # nothing beyond the film
        return min(by_width, by_height)
    if fit == "overscan":  # nothing of the film is lost
        return max(by_width, by_height)
    return width, height


def about(axis, degrees, vector):
    c, s = math.cos(math.radians(degrees)), math.sin(math.radians(degrees))
    a, b = [i for i in range(3) if i != axis]
    if axis == 1:
        a, b = b, a
    result = list(vector)
    result[a] = c * vector[a] - s * vector[b]
    result[b] = s * vector[a] + c * vector[b]
    return result


def turned(angles, vector):
    for axis in range(3):
        vector = about(axis, angles[axis], vector)
    return vector


def turned_back(angles, vector):
    for axis in (2, 1, 0):
        vector = about(axis, -angles[axis], vector)
    return vector


class Close(unittest.TestCase):
    def close(self, actual, wanted, note=None):
        self.assertEqual(len(actual), len(wanted))
        for a, w in zip(actual, wanted):
            self.assertLessEqual(abs(a - w), 2e-6 * max(1, abs(w)), (note, actual, wanted))


class Lens(Close):
    def test_follows_from_what_drives_it(self):
        width, height, squeeze = 0.9, 0.7, 1.25
        for mode, name in enumerate(MODES):
            camera = one(scene({"FilmWidth": width, "FilmHeight": height, "FilmSqueezeRatio": squeeze,
                                "ApertureMode": mode, "FieldOfView": 31.0, "FieldOfViewX": 47.0, "FieldOfViewY": 29.0,
                                "FocalLength": 42.0}))
            w, h = width * squeeze, height
            f = {"twoAngles": focal_length(w, 47), "horizontalAngle": focal_length(w, 31),
                 "verticalAngle": focal_length(h, 31), "focalLength": 42.0}[name]
            if name == "twoAngles":  # the film is as high as its angle says
                h = 2 * f * math.tan(math.radians(29 / 2)) / INCH
            self.assertEqual(camera["drivenBy"], name)
            self.close([camera["at"]["focalLength"], *camera["at"]["film"]], [f, w, h], name)
            self.close(camera["at"]["fov"], [angle(w, f), angle(h, f)], name)
            idle = {each["property"] for each in camera["notInForce"]}
            driving = {"twoAngles": {"FieldOfViewX", "FieldOfViewY"}, "horizontalAngle": {"FieldOfView"},
                       "verticalAngle": {"FieldOfView"}, "focalLength": {"FocalLength"}}[name]
            self.assertEqual(idle & {"FieldOfView", "FieldOfViewX", "FieldOfViewY", "FocalLength"},
                             {"FieldOfView", "FieldOfViewX", "FieldOfViewY", "FocalLength"} - driving)

    def test_picture_follows_from_the_gate_fit(self):
        width, height = 1.2, 0.8
        shapes = ((1920.0, 1080.0, 1.0), (600.0, 800.0, 1.0), (720.0, 576.0, 1.4222), (300.0, 200.0, 1.0))
        for fit, (w, h, pixel) in itertools.product(range(6), shapes):
            camera = one(scene({"FilmWidth": width, "FilmHeight": height, "ApertureMode": 3, "FocalLength": 50.0,
                                "AspectWidth": w, "AspectHeight": h, "PixelAspectRatio": pixel, "GateFit": fit}))
            wanted = gate(width, height, w * pixel / h, FITS[fit])
            self.assertEqual(camera["gateFit"], FITS[fit])
            self.close(camera["at"]["picture"], wanted, (fit, w, h))
            self.close(camera["at"]["pictureFov"], [angle(side, 50) for side in wanted], (fit, w, h))

    def test_known_gates_have_names(self):
        gates = {(0.404, 0.295): "16 mm theatrical", (0.493, 0.292): "Super 16", (0.864, 0.630): "35 mm academy",
                 (0.816, 0.612): "35 mm TV projection", (0.980, 0.735): "35 mm full aperture",
                 (0.825, 0.446): "35 mm 1.85 projection", (0.864, 0.732): "35 mm anamorphic",
                 (2.066, 0.906): "70 mm projection", (1.485, 0.991): "VistaVision", (2.080, 1.480): "Dynavision",
                 (2.772, 2.072): "IMAX", (36 / INCH, 24 / INCH): "35 mm still, full frame", (1.41732, 0.94488):
                 "35 mm still, full frame", (0.982, 0.735): None, (1.0, 1.0): None}
        for (width, height), name in gates.items():
            self.assertEqual(one(scene({"FilmWidth": width, "FilmHeight": height}))["gate"], name, width)
        squeezed = one(scene({"FilmWidth": 0.864, "FilmHeight": 0.732, "FilmSqueezeRatio": 2.0}))
        self.assertEqual(squeezed["gate"], "35 mm anamorphic")
        self.close(squeezed["at"]["film"], [1.728, 0.732])

    def test_without_a_resolution_the_picture_is_the_film(self):
        for height in (0.0, -1.0):
            camera = one(scene({"AspectWidth": 100.0, "AspectHeight": height, "GateFit": 2}))
            self.assertEqual(camera["resolution"]["aspect"], 0)
            self.assertEqual(camera["at"]["picture"], camera["at"]["film"])

    def test_a_ratio_may_stand_in_place_of_a_resolution(self):
        for mode, width, height, aspect in ((1, 2.39, 1.0, 2.39), (3, 1920.0, 0.5625, 1 / 0.5625), (4, 1.85, 1080.0, 1.85)):
            camera = one(scene({"AspectRatioMode": mode, "AspectWidth": width, "AspectHeight": height}))
            self.close([camera["resolution"]["aspect"]], [aspect])

    def test_orthographic_width(self):
        wide = {"CameraProjectionType": 1, "OrthoZoom": 2.5}
        self.close([one(scene(wide))["ortho"]["width"]], [75])
        self.close([one(scene(wide, unit=100.0))["ortho"]["width"]], [7500])
        blenders = one(scene(wide, {"Lcl Scaling": (4.0, 4.0, 4.0)}, creator="Blender (stable FBX IO) - 3.4.1"))
        self.close([blenders["ortho"]["width"]], [10])
        self.assertIsNone(one(scene())["ortho"])


class Place(Close):
    def test_direction_follows_from_the_rotations(self):
        for active, order in itertools.product((0, 1), ((0, -90, 0), (10, 20, 30))):
            before, rotation, after = (5.0, -15.0, 25.0), (12.0, 34.0, -56.0), tuple(float(each) for each in order)
            camera = one(scene(node={"PreRotation": before, "PostRotation": after, "RotationActive": active,
                                     "Lcl Rotation": rotation, "Lcl Translation": (1.0, 2.0, 3.0)}))
            for key, axis in (("direction", [1, 0, 0]), ("up", [0, 1, 0])):
                wanted = turned(before, turned(rotation, turned_back(after, axis))) if active else turned(rotation, axis)
                self.close(camera["at"][key], wanted, (active, order, key))
            self.close(camera["at"]["position"], [1, 2, 3])
            self.assertEqual(camera["rotationActive"], bool(active))
            self.assertEqual("PostRotation" in {each["property"] for each in camera["notInForce"]}, not active)

    def test_rotation_0_looks_along_x_or_where_the_post_rotation_says(self):
        for after, active, wanted in (((0.0, -90.0, 0.0), 1, "−Z"), ((0.0, -90.0, 0.0), 0, "+X"),
                                      ((0.0, 90.0, 0.0), 1, "+Z"), ((0.0, 180.0, 0.0), 1, "−X"),
                                      ((0.0, 0.0, 90.0), 1, "−Y"), ((0.0, -45.0, 0.0), 1, "(0.707, 0, −0.707)")):
            camera = one(scene(node={"PostRotation": after, "RotationActive": active}))
            self.assertEqual(camera["restDirection"], wanted)

    def test_units_become_centimetres(self):
        camera = one(scene({"NearPlane": 0.1, "FarPlane": 50.0, "InterestPosition": (4.0, 2.0, 3.0)},
                           {"Lcl Translation": (1.0, 2.0, 3.0)}, unit=100.0))
        self.close(camera["at"]["interest"], [400, 200, 300])
        self.close(camera["at"]["position"], [100, 200, 300])
        self.close(camera["at"]["planes"], [10, 5000])
        self.close(camera["scale"], [1, 1, 1])

    def test_negative_and_uneven_scales_show(self):
        camera = one(scene(node={"Lcl Scaling": (-1.0, 2.0, 3.0)}))
        self.assertEqual(sum(each < 0 for each in camera["scale"]), 1)
        self.close(sorted(abs(each) for each in camera["scale"]), [1, 2, 3])

    def test_a_target_turns_the_camera(self):
        with open(os.path.join(SDK_DATA, "target_camera_7400_ascii.fbx"), encoding="utf-8") as stream:
            camera = one(stream.read(), "--frames", "0:4")
        self.assertEqual(camera["target"], "target")
        for moment in camera["frames"]:
            away = [a - b for a, b in zip(moment["interest"], moment["position"])]
            self.close(moment["direction"], [each / math.hypot(*away) for each in away])
        self.assertTrue(camera["moves"])
        self.assertNotEqual(camera["frames"][0]["direction"], camera["frames"][4]["direction"])


class Frames(Close):
    FILE = os.path.join(SDK_DATA, "camera_7400_ascii.fbx")

    def test_are_those_of_the_curves(self):
        page = json.loads(run("camera", "--json", "--frames", "1002:1004", self.FILE).stdout)
        camera = page["cameras"][0]
        self.assertEqual((page["firstFrame"], page["lastFrame"], page["take"]), (1001, 1010, "Shot"))
        self.assertTrue(camera["moves"] and camera["lensChanges"])
        for step, moment in enumerate(camera["frames"], 1):  # linear: X from 0 to 9, the lens from 35 to 80
            self.close([moment["frame"], moment["position"][0], moment["focalLength"]],
                       [1001 + step, step, 35 + 5 * step])
            self.close([moment["fov"][0]], [angle(1.5, 35 + 5 * step)])
        channels = {each["property"]: each for each in camera["channels"]}
        self.assertEqual(set(channels), {"Lcl Translation.X", "FocalLength"})
        self.assertEqual([channels["FocalLength"][key] for key in ("keys", "least", "most", "inForce")],
                         [2, 35, 80, True])
        self.close([channels["FocalLength"]["firstFrame"], channels["FocalLength"]["lastFrame"]], [1001, 1010])

    def test_as_comma_separated_values_are_the_same(self):
        moments = json.loads(run("camera", "--json", "--frames", "1001:1010", self.FILE).stdout)["cameras"][0]["frames"]
        rows = list(csv.DictReader(io.StringIO(run("camera", "--csv", self.FILE, self.FILE).stdout)))
        self.assertEqual(len(rows), 20)
        for row, moment in zip(rows, moments + moments):
            self.assertEqual((row["file"], row["camera"]), (self.FILE, "shot"))
            self.close([float(row[key]) for key in ("frame", "focalLength", "pictureFovX", "positionX", "directionZ")],
                       [moment["frame"], moment["focalLength"], moment["pictureFov"][0], moment["position"][0],
                        moment["direction"][2]])

    def test_that_the_take_has_not_are_an_error(self):
        for frames in ("1000:1005", "1005:1011", "0"):
            result = run("camera", "--frames", frames, self.FILE)
            self.assertEqual((result.returncode, result.stdout), (1, ""))
            self.assertIn("1001 to 1010", result.stderr)

    def test_a_keyed_node_above_moves_the_camera_along(self):
        with open(self.FILE, encoding="utf-8") as stream:
            text = stream.read()
        below = text.replace("Objects:  {\n", 'Objects:  {\n\tModel: 50, "Model::rail", "Null" {\n\t}\n\tModel: 51, '
                             '"Model::head", "Null" {\n\t}\n', 1)
        below = below.replace('C: "OO",1,0', 'C: "OO",50,0\n\tC: "OO",51,50\n\tC: "OO",1,51', 1)
        below = below.replace('C: "OP",5,1, "Lcl Translation"', 'C: "OP",5,50, "Lcl Translation"', 1)
        camera = one(below, "--frames", "1001:1010")
        self.assertEqual((camera["movedBy"], camera["moves"]), ("rail", True))
        self.close(camera["frames"][9]["position"], [9, 0, 0])
        self.assertIsNone(one(text)["movedBy"])

    def test_that_are_too_many_are_refused(self):
        with open(os.path.join(ROOT, "tests", "data", "lint", "span-differs-from-keys.fbx"), encoding="utf-8") as stream:
            text = stream.read().replace('C: "OP",13,12, "d|X"', "")  # without its keys
        stop = next(line for line in text.splitlines() if '"LocalStop"' in line)
        text = text.replace(stop, stop.rsplit(",", 1)[0] + ",4618615800000000000")
        self.assertEqual(run("camera", "-", input=text).returncode, 0)
        for arguments in (("--csv",), ("--frames", "0:2000000")):
            result = run("camera", *arguments, "-", input=text)
            self.assertEqual(result.returncode, 1, arguments)
            self.assertIn("too many", result.stderr)

    def test_without_a_take_every_frame_is_alike(self):
        camera = one(scene({"FocalLength": 20.0, "ApertureMode": 3}), "--frames", "5:7")
        self.assertEqual([moment["frame"] for moment in camera["frames"]], [5, 6, 7])
        self.assertEqual({moment["focalLength"] for moment in camera["frames"]}, {20})

    def test_may_be_those_of_another_take(self):
        file = os.path.join(SDK_DATA, "two_stacks_7400_ascii.fbx")
        page = json.loads(run("camera", "--json", "--take", "run", file).stdout)
        self.assertEqual((page["take"], page["firstFrame"], page["lastFrame"], page["cameras"]), ("run", 0, 1, []))
        result = run("camera", "--take", "crawl", file)
        self.assertEqual((result.returncode, result.stdout), (1, ""))
        self.assertIn('"walk", "run"', result.stderr)


class Origins(Close):
    def lines(self, text):
        page = run("camera", "--explain", "-", input=text).stdout.split("Derivation\n")[1]
        return dict(line.strip().split(": ", 1) for line in page.splitlines())

    def test_of_orthographic_cameras_speak_of_no_lens(self):
        lines = self.lines(scene({"CameraProjectionType": 1, "FilmWidth": 1.5, "FilmHeight": 1.0, "GateFit": 3,
                                  "AspectRatioMode": 2, "AspectWidth": 300.0, "AspectHeight": 300.0}))
        self.assertNotIn("Focal length", lines)
        self.assertTrue(lines["Picture"].endswith("= 1:1"), lines["Picture"])

    def test_have_seven_digits_where_props_has_all(self):
        lines = self.lines(scene({"ApertureMode": 3, "FilmWidth": 1.4173200000000001, "FilmHeight": 0.999999985}))
        self.assertIn("FilmWidth 1.41732 in × FilmSqueezeRatio 1, FilmHeight 1 in", lines["Film back"])

    def test_name_the_keys_before_what_stands_without_them(self):
        page = run("camera", "--explain", SHOT).stdout
        self.assertIn("Focal length: FocalLength (keyed; static value 35 mm), unchanged", page)
        self.assertIn("Lcl Translation (keyed; static value (0, 100, 600)); × 1 cm", page)


class Choice(unittest.TestCase):
    def test_a_name_picks_cameras(self):
        file = os.path.join(SDK_DATA, "kinds_of_nodes_7400_ascii.fbx")
        every = json.loads(run("camera", "--json", file).stdout)["cameras"]
        self.assertTrue(any(each["stereo"] for each in every))
        for camera in every:
            chosen = json.loads(run("camera", "--json", "--name", camera["name"], file).stdout)["cameras"]
            self.assertEqual(chosen, [each for each in every if each["name"] == camera["name"]])
        result = run("camera", "--name", "nosuch", SHOT)
        self.assertEqual((result.returncode, result.stdout), (1, ""))
        self.assertIn('cameras: "shotCam"', result.stderr)

    def test_cameras_of_the_views_are_none(self):
        file = os.path.join(SDK_DATA, "producer_cameras_6100_ascii.fbx")
        self.assertEqual(json.loads(run("camera", "--json", file).stdout)["cameras"], [])
        self.assertIn("No cameras.", run("camera", file).stdout)

    def test_the_library_says_the_same(self):
        wanted = json.loads(run("dump", "--faithful", "--kind", "cameras", SHOT).stdout)["cameras"][0]
        camera = json.loads(run("camera", "--json", "--frames", "1001:1048", SHOT).stdout)["cameras"][0]
        samples = wanted["channels"]["focalLength"]["samples"]
        self.assertEqual([each["focalLength"] for each in camera["frames"]], samples)

    def test_names_cannot_write_on_terminals(self):
        with tempfile.TemporaryDirectory() as folder:
            file = edited("camera_7400_ascii.fbx", os.path.join(folder, "a.fbx"),
                          ('"Model::shot"', '"Model::a\x1b[31mb"'))
            shown = run("camera", "--explain", file).stdout
            self.assertIn("a\\x1b[31mb", shown)
            self.assertNotIn("\x1b", shown)


class Numbers(unittest.TestCase):
    def test_that_are_none_are_null_and_end_nothing(self):
        for name in ("FocalLength", "FilmWidth", "FilmHeight", "OrthoZoom", "AspectWidth", "FilmSqueezeRatio", "NearPlane"):
            for value in (float("nan"), float("inf"), 0.0, -1.0, 1e300):
                text = scene({"ApertureMode": 3, name: value}).replace(",nan", ",1e999").replace(",inf", ",1e999")
                for form in ("--json", "--csv", "--explain"):
                    result = subprocess.run([TOOL, "camera", form, "-"], input=text, capture_output=True, text=True,
                                            timeout=60, check=False)
                    self.assertEqual(result.returncode, 0, (name, value, result.stderr))
                    if form == "--json":
                        self.assertEqual(len(json.loads(result.stdout)["cameras"]), 1)


unittest.main(argv=[__file__], verbosity=0)
