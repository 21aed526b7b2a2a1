# SPDX-License-Identifier: MIT
# Copyright (c) Tarnell FBX contributors
#
# The commands that look into files, as a user meets them: what they print, where, and with which exit status.
import json
import os
import subprocess
import sys
import tempfile
import unittest

from support import NO_FRAMES, SHOT, TOOL, dump, edited, float32, named, run

CAMERA_CHANNELS = [
    "lookAtPositionX", "lookAtPositionY", "lookAtPositionZ", "upPositionX", "upPositionY", "upPositionZ", "roll",
    "focalLength", "apertureWidth", "apertureHeight", "nearPlane", "farPlane", "filedOfView", "filedOfViewX",
    "filedOfViewY", "filmOffsetX", "filmOffsetY"]
TRANSFORM_CHANNELS = [kind + axis for kind in ("position", "rotation", "scale", "skew", "pivot") for axis in "XYZ"]


class StandardInput(unittest.TestCase):
    def test_every_command_reads_it(self):
        with open(SHOT, "rb") as file:
            content = file.read()
        page = json.loads(subprocess.run([TOOL, "dump", "-"], input=content, capture_output=True, check=True).stdout)
        self.assertEqual(page.pop("file"), "standard input")
        expected = dump(SHOT)
        del expected["file"]
        self.assertEqual(page, expected)
        shown = subprocess.run([TOOL, "info", "-"], input=content, capture_output=True, check=True).stdout
        self.assertTrue(shown.startswith(b"standard input\n"), shown[:40])
        with tempfile.TemporaryDirectory() as folder:
            out = os.path.join(folder, "out.fbx")
            subprocess.run([TOOL, "convert", "--kind", "cameras", "-", out], input=content, check=True)
            self.assertTrue(dump("--kind", "cameras", out)["cameras"])

    def test_what_is_no_fbx_file_is_refused_by_its_name(self):
        done = subprocess.run([TOOL, "dump", "-"], input=b"nothing", capture_output=True)
        self.assertEqual(done.returncode, 1)
        self.assertEqual(done.stderr, b"tarnell-fbx: standard input: neither a binary nor an ASCII FBX file\n")
        done = subprocess.run([TOOL, "info", "-"], input=b"", capture_output=True)
        self.assertEqual((done.returncode, done.stderr), (1, b"tarnell-fbx: standard input: the file is empty\n"))


class ControlCharacters(unittest.TestCase):
    def setUp(self):
        self.folder = tempfile.TemporaryDirectory()
        self.addCleanup(self.folder.cleanup)
        self.file = os.path.join(self.folder.name, "names.fbx")
        name = b"a\x1b[31m\x07b\x7fc\xc2\x9bd\xffe"
        with open(self.file, "wb") as file:
            file.write(b"; FBX 7.4.0 project file\nFBXHeaderExtension: {\n FBXVersion: 7400\n}\n"
                       b"Objects: {\n Model: 1, \"Model::" + name + b"\", \"Null\" {\n }\n}\n"
                       b"Connections: {\n C: \"OO\",1,0\n}\n")

    def assert_harmless(self, text):
        for byte in text:
            self.assertTrue(byte >= 0x20 and byte != 0x7F or byte == 0x0A, text)
        self.assertNotIn(b"\xc2\x9b", text)
        text.decode("utf-8")

    def test_of_names_are_escaped(self):
        for command in (["info"], ["dump"]):
            shown = subprocess.run([TOOL, *command, self.file], capture_output=True, check=True)
            self.assert_harmless(shown.stdout)
            self.assertIn(b"31m", shown.stdout)

    def test_of_errors_are_escaped(self):
        done = subprocess.run([TOOL, "info", os.path.join(self.folder.name, "\x1b[2J.fbx")], capture_output=True)
        self.assertEqual(done.returncode, 1)
        self.assert_harmless(done.stderr)


class Dump(unittest.TestCase):
    def test_prints_all_six_kinds_in_order(self):
        page = dump(SHOT)
        self.assertEqual(list(page), ["file", "stacks", "range", "cameras", "lights", "markers", "nulls", "transforms",
                                      "meshes"])
        self.assertEqual(page["file"], "shot_010.fbx")
        self.assertEqual(page["stacks"], ["Scene"])
        self.assertAlmostEqual(page["range"]["start"], 1001 / 24, places=4)
        self.assertAlmostEqual(page["range"]["end"], 1048 / 24, places=4)

    def test_a_kind_that_was_not_asked_for_has_no_key(self):
        page = dump("--kind", "nulls,lights", SHOT)
        self.assertEqual(list(page), ["file", "stacks", "range", "lights", "nulls"])

    def test_a_camera_has_all_its_channels_by_name(self):
        camera = named(dump("--kind", "cameras", SHOT)["cameras"], "shotCam")
        self.assertEqual(list(camera), ["name", "rotationOrder", "transform", "projection", "apertureMode", "channels"])
        self.assertEqual(list(camera["channels"]), CAMERA_CHANNELS)
        self.assertEqual(list(camera["transform"]), TRANSFORM_CHANNELS)
        lens = camera["channels"]["focalLength"]
        self.assertEqual((lens["start"], lens["end"], lens["rate"]), (1001, 1048, 24))
        self.assertEqual(len(lens["samples"]), 48)
        self.assertAlmostEqual(lens["samples"][0], 35, places=4)
        self.assertAlmostEqual(lens["samples"][-1], 50, places=4)
        self.assertAlmostEqual(camera["channels"]["apertureWidth"], 24.576 / 25.4, places=5)

    def test_producer_cameras_come_first(self):
        names = [camera["name"] for camera in dump("--kind", "cameras", SHOT)["cameras"]]
        self.assertEqual(names, ["Producer Perspective", "Producer Top", "Producer Bottom", "Producer Front",
                                 "Producer Back", "Producer Right", "Producer Left", "shotCam"])

    def test_samples_can_be_left_out(self):
        lens = named(dump("--no-samples", "--kind", "cameras", SHOT)["cameras"], "shotCam")["channels"]["focalLength"]
        self.assertEqual(list(lens), ["value", "start", "end", "rate"])

    def test_a_name_picks_one_object(self):
        page = dump("--name", "targetTip", "--kind", "nulls,cameras", SHOT)
        self.assertEqual([each["name"] for each in page["nulls"]], ["targetTip"])
        self.assertEqual(page["cameras"], [])

    def test_meshes_have_one_entry_per_frame(self):
        meshes = dump("--kind", "meshes", "--frames", "1001:1003", SHOT)["meshes"]
        self.assertEqual([(mesh["name"], mesh["frame"]) for mesh in meshes],
                         [("crate", 1001), ("crate", 1002), ("crate", 1003)])

    def test_a_mesh_in_the_world_stands_where_the_application_put_it(self):
        mesh = dump("--kind", "meshes", SHOT)["meshes"][0]
        self.assertEqual(mesh["polygonVertexSizes"], [4] * 6)
        self.assertEqual(len(mesh["pointIndices"]), 24)
        self.assertEqual(len(mesh["normals"]), 72)
        self.assertEqual(len(mesh["uvs"]), 48)
        self.assertEqual(len(mesh["colours"]), 96)
        heights = mesh["controlPoints"][1::3]
        self.assertAlmostEqual(min(heights), 0, places=3)
        self.assertAlmostEqual(max(heights), 100, places=3)

    def test_points_can_stay_in_the_space_of_the_node(self):
        mesh = dump("--kind", "meshes", "--no-transform-points", SHOT)["meshes"][0]
        self.assertAlmostEqual(max(mesh["controlPoints"]), 0.5, places=5)

    def test_resampling_changes_frames_and_rate(self):
        camera = named(dump("--kind", "cameras", "--sample-fps", "48", SHOT)["cameras"], "shotCam")
        self.assertEqual(camera["channels"]["focalLength"]["start"], 2002)

    def test_pretty_and_plain_say_the_same(self):
        self.assertEqual(dump("--pretty", SHOT), dump(SHOT))

    def test_a_file_that_cannot_be_read_gives_one_line_and_status_1(self):
        with tempfile.TemporaryDirectory() as folder:
            broken = os.path.join(folder, "broken.fbx")
            with open(SHOT, "rb") as source, open(broken, "wb") as target:
                target.write(source.read()[:5000])
            empty = os.path.join(folder, "empty.fbx")
            open(empty, "wb").close()
            text = os.path.join(folder, "words.fbx")
            with open(text, "w") as target:
                target.write("hello\n")
            for file in (os.path.join(folder, "missing.fbx"), folder, broken, empty, text):
                result = run("dump", file)
                self.assertEqual(result.returncode, 1, file)
                self.assertEqual(result.stdout, "")
                self.assertEqual(len(result.stderr.splitlines()), 1)
                self.assertTrue(result.stderr.startswith(f"tarnell-fbx: {file}: "), result.stderr)

    def test_wrong_usage_gives_status_2(self):
        for arguments in ((), ("dump",), ("dump", "--kind", "teapots", SHOT), ("dump", "--no-such-option", SHOT),
                          ("info",), ("bake",)):
            result = run(*arguments)
            self.assertEqual(result.returncode, 2, arguments)
            self.assertEqual(result.stdout, "")

    def test_what_is_no_kind_is_wrong_usage(self):
        for kinds in ("", ",", "nulls,", ",nulls", "nulls,,lights", "Nulls", " nulls"):
            result = run("dump", "--kind", kinds, SHOT)
            self.assertEqual((result.returncode, result.stdout), (2, ""), kinds)
            self.assertIn("--kind", result.stderr)

    def test_what_is_no_range_of_frames_is_wrong_usage(self):
        for frames in NO_FRAMES:
            result = run("dump", "--frames", frames, SHOT)
            self.assertEqual((result.returncode, result.stdout), (2, ""), frames)
            self.assertIn("--frames", result.stderr)
        self.assertEqual(run("dump", "--frames", "1001:1002", "--frames", "1003:1004", SHOT).returncode, 2)

    def test_what_is_no_number_is_wrong_usage(self):
        for option in ("--frame", "--sample-fps"):
            for number in ("", "x", "24x", "2 4", "nan", "inf", "1e39"):
                result = run("dump", option, number, SHOT)
                self.assertEqual((result.returncode, result.stdout), (2, ""), (option, number))
                self.assertIn(option, result.stderr)

    def test_frames_reach_from_the_lowest_int_to_the_highest(self):
        for frame in (-2147483648, -1, 0, 2147483647):
            for frames in (str(frame), f"{frame}:{frame}"):
                meshes = dump("--kind", "meshes", f"--frames={frames}", SHOT)["meshes"]
                self.assertEqual([mesh["frame"] for mesh in meshes], [float32(frame)])

    def test_help_is_no_error(self):
        self.assertEqual(run("--help").returncode, 0)
        self.assertIn("--frames", run("dump", "--help").stdout)


class Info(unittest.TestCase):
    def test_shows_what_a_person_asks_first(self):
        page = run("info", SHOT).stdout
        for fact in ("7.4, binary", "Blender", "centimetre", "+Y up", "24 frames per second",
                     '"Scene"  frames 1001 to 1048', "1 × camera", "shotCam  [camera]", "targetTip  [null]"):
            self.assertIn(fact, page)

    def test_says_that_a_rate_was_worked_out_from_the_keys(self):
        with tempfile.TemporaryDirectory() as folder:
            file = edited("custom_rate_7400_ascii.fbx", os.path.join(folder, "a.fbx"),
                          ('\t\tP: "CustomFrameRate", "double", "Number", "",12.5\n', ""),
                          ("a: 7389785280,18474463200", "a: 0,3694892640"))
            page = run("info", file).stdout
        self.assertIn("Frame rate    12.5 frames per second\n", page)
        self.assertIn("Repaired      the time mode is custom, but states no frame rate; 12.5 frames per second were "
                      "derived from its times\n", page)

    def test_takes_several_files_and_goes_on_after_a_bad_one(self):
        result = run("info", SHOT, "missing.fbx", SHOT)
        self.assertEqual(result.returncode, 1)
        self.assertEqual(result.stdout.count("24 frames per second"), 2)
        self.assertIn("missing.fbx", result.stderr)


unittest.main(argv=sys.argv[:1], verbosity=0)
