# SPDX-License-Identifier: MIT
# Copyright (c) Tarnell FBX contributors
#
# The command that writes: what arrives in the written file, and what is refused.
import math
import os
import struct
import subprocess
import sys
import tempfile
import unittest

from support import NO_FRAMES, ROOT, SDK_DATA, SHOT, TOOL, dump, edited, named, run

MOVING = os.path.join(ROOT, "tests", "data", "tool", "moving_triangle.fbx")
SKINNED = os.path.join(ROOT, "tests", "data", "blender", "skin_7400_binary.fbx")
YEARS = {"2010": 6100, "2011": 7100, "2012": 7200, "2013": 7300, "2014": 7400, "2016": 7500}


def version_of(path):
    with open(path, "rb") as stream:
        start = stream.read(4096)
    if start.startswith(b"Kaydara FBX Binary"):
        return "binary", struct.unpack_from("<I", start, 23)[0]
    at = start.index(b"FBXVersion:")
    return "ascii", int(start[at + 11:].split()[0])


def samples(channel):
    return channel["samples"] if isinstance(channel, dict) else [channel]


def rotation(order, angles):
    """The matrix of Euler angles in degrees, of which the first axis of the order turns first."""
    matrix = [[float(i == j) for j in range(3)] for i in range(3)]
    for name in order:
        axis = "XYZ".index(name)
        c, s = math.cos(math.radians(angles[axis])), math.sin(math.radians(angles[axis]))
        i, j = (axis + 1) % 3, (axis + 2) % 3
        turn = [[float(a == b) for b in range(3)] for a in range(3)]
        turn[i][i], turn[i][j], turn[j][i], turn[j][j] = c, -s, s, c
        matrix = [[sum(turn[a][k] * matrix[k][b] for k in range(3)) for b in range(3)] for a in range(3)]
    return matrix


def changed(source, path, *replacements):
    """Writes a copy of a text file in which each (old, new) was replaced."""
    with open(source, encoding="utf-8") as stream:
        text = stream.read()
    for old, new in replacements:
        assert text.count(old) == 1, f"{source} has {text.count(old)} times: {old}"
        text = text.replace(old, new)
    with open(path, "w", encoding="utf-8") as stream:
        stream.write(text)
    return path


class Convert(unittest.TestCase):
    def setUp(self):
        self.folder = tempfile.TemporaryDirectory()
        self.addCleanup(self.folder.cleanup)
        self.out = os.path.join(self.folder.name, "out.fbx")

    def convert(self, *arguments, source=SHOT):
        result = run("convert", *arguments, source, self.out)
        self.assertEqual(result.returncode, 0, result.stderr)
        return result

    def bytes(self):
        with open(self.out, "rb") as stream:
            return stream.read()

    def assertSameChannel(self, expected, seen, what, places=3):
        expected, seen = samples(expected), samples(seen)
        length = max(len(expected), len(seen))
        expected = expected * length if len(expected) == 1 else expected
        seen = seen * length if len(seen) == 1 else seen
        self.assertEqual(len(expected), len(seen), what)
        for frame, (a, b) in enumerate(zip(expected, seen)):
            self.assertAlmostEqual(a, b, places=places, msg=f"{what} at sample {frame}")

    def test_writes_each_version_in_each_encoding(self):
        for year, version in YEARS.items():
            for encoding in ("ascii", "binary"):
                with self.subTest(year=year, encoding=encoding):
                    self.convert("--force", "--version", year, "--" + encoding)
                    self.assertEqual(version_of(self.out), (encoding, version))
                    self.assertEqual(len(dump("--kind", "lights", self.out)["lights"]),
                                     len(dump("--kind", "lights", SHOT)["lights"]))

    def test_the_newest_binary_is_written_when_nothing_is_said(self):
        self.convert()
        self.assertEqual(version_of(self.out), ("binary", 7500))

    def test_lens_and_film_of_a_camera_arrive_frame_by_frame(self):
        self.convert()
        before = named(dump("--kind", "cameras", SHOT)["cameras"], "shotCam")
        after = named(dump("--kind", "cameras", self.out)["cameras"], "shotCam")
        for channel in ("focalLength", "apertureWidth", "apertureHeight", "nearPlane", "farPlane", "filmOffsetX"):
            self.assertSameChannel(before["channels"][channel], after["channels"][channel], channel)
        lens = after["channels"]["focalLength"]
        self.assertEqual((lens["start"], lens["end"], lens["rate"]), (1001, 1048, 24))

    def test_a_camera_stands_and_looks_where_it_did(self):
        # The camera of this file has no post-rotation and looks along its X; the written one has one. The line along
        # which files say that a camera looks is X in both.
        self.convert()
        before = named(dump("--kind", "cameras", SHOT)["cameras"], "shotCam")
        after = named(dump("--kind", "cameras", self.out)["cameras"], "shotCam")
        for axis in "XYZ":
            self.assertSameChannel(before["transform"]["position" + axis], after["transform"]["position" + axis],
                                   "position" + axis)

        def angles(camera, frame):
            curves = [samples(camera["transform"]["rotation" + axis]) for axis in "XYZ"]
            return [curve[min(frame, len(curve) - 1)] for curve in curves]

        for frame in range(48):
            old = rotation(before["rotationOrder"], angles(before, frame))
            new = rotation(after["rotationOrder"], angles(after, frame))
            forward_before = [row[0] for row in old]
            forward_after = [-row[2] for row in new]  # turned by the post-rotation
            for a, b in zip(forward_before, forward_after):
                self.assertAlmostEqual(a, b, places=4, msg=f"sample {frame}")

    def test_nulls_and_lights_arrive_frame_by_frame(self):
        self.convert()
        before, after = dump(SHOT), dump(self.out)
        for kind in ("nulls", "lights"):
            for item in before[kind]:
                other = named(after[kind], item["name"])
                for channel in ("position", "scale"):
                    for axis in "XYZ":
                        self.assertSameChannel(item["transform"][channel + axis], other["transform"][channel + axis],
                                               f"{item['name']} {channel}{axis}")

    def test_rotations_go_on_from_frame_to_frame(self):
        self.convert()
        for item in dump("--kind", "nulls,lights", "--local", self.out)["nulls"]:
            for axis in "XYZ":
                values = samples(item["transform"]["rotation" + axis])
                for a, b in zip(values, values[1:]):
                    self.assertLess(abs(a - b), 90, item["name"])

    def test_a_mesh_stands_where_it_did(self):
        self.convert()
        before = dump("--kind", "meshes", "--frame", "1001", SHOT)["meshes"]
        after = dump("--kind", "meshes", self.out)["meshes"]
        self.assertEqual([mesh["name"] for mesh in before], [mesh["name"] for mesh in after])
        for a, b in zip(before, after):
            self.assertEqual(a["polygonVertexSizes"], b["polygonVertexSizes"])
            self.assertEqual(a["pointIndices"], b["pointIndices"])
            self.assertEqual(len(a["controlPoints"]), len(b["controlPoints"]))
            for u, v in zip(a["controlPoints"], b["controlPoints"]):
                self.assertAlmostEqual(u, v, places=3)

    def points(self, path):
        meshes = dump("--kind", "meshes", "--frames", "1003:1006", path)["meshes"]
        return [(mesh["name"], mesh["frame"], [round(c, 3) for c in mesh["controlPoints"]]) for mesh in meshes]

    def test_moving_points_become_a_cache_that_reads_back(self):
        self.convert("--frames", "1003:1006", source=MOVING)
        self.assertEqual(sorted(os.listdir(self.out[:-4] + "_fpc")), ["moving.mcx", "moving.xml"])
        expected = [("moving", frame, [4 + 2 * i, 0, 0, 5 + 2 * i, 0, 0, 4 + 2 * i, 1, 0])
                    for i, frame in enumerate(range(1003, 1007))]
        self.assertEqual(self.points(MOVING), expected)
        self.assertEqual(self.points(self.out), expected)

    def test_moving_points_become_a_max_cache(self):
        self.convert("--frames", "1003:1006", "--cache", "max", source=MOVING)
        with open(os.path.join(self.out[:-4] + "_fpc", "moving.pc2"), "rb") as stream:
            self.assertEqual(stream.read(12), b"POINTCACHE2\0")
            _, points, start, rate, samples_ = struct.unpack("<iiffi", stream.read(20))
        self.assertEqual((points, start, samples_), (3, 1003, 4))

    def test_a_skinned_mesh_stands_where_its_bones_take_it(self):
        """A strip that stands on two bones, of which the upper one bends by 90 degrees over four frames."""
        warned = self.convert("--frames", "1001:1005", "--cache", "max", source=SKINNED).stderr
        self.assertNotIn("deforming meshes", warned)
        for frame in (1001, 1003, 1005):
            points = dump("--kind", "meshes", "--frame", str(frame), self.out)["meshes"][0]["controlPoints"]
            angle = math.radians(22.5 * (frame - 1001))
            for i, height in enumerate((0, 100, 200, 300, 400)):
                bent = max(height - 200, 0)
                expected = [0, min(height, 200) + bent * math.cos(angle), bent * math.sin(angle)]
                for seen, wanted in zip(points[6 * i:6 * i + 3], expected):
                    self.assertAlmostEqual(seen, wanted, places=3)

    def test_a_deformation_that_is_not_written_is_said(self):
        self.assertIn("deforming meshes: 1", self.convert(source=SKINNED).stderr)

    def test_a_mesh_keeps_the_geometric_transform_of_its_node(self):
        with open(MOVING, encoding="utf-8") as stream:
            text = stream.read()
        turned = os.path.join(self.folder.name, "turned.fbx")
        anchor = '"Mesh" {\n\t\tVersion: 232\n'
        self.assertEqual(text.count(anchor), 1)
        offset = 'Properties70:  {\n\tP: "GeometricTranslation", "Vector3D", "Vector", "",0,0,7\n}\n'
        with open(turned, "w", encoding="utf-8") as stream:
            stream.write(text.replace(anchor, anchor + offset))
        self.convert("--frames", "1003:1003", "--cache", "none", source=turned)
        self.assertEqual(self.points(self.out)[0][2], [4, 0, 7, 5, 0, 7, 4, 1, 7])

    def test_a_mesh_moves_with_its_node_without_caches(self):
        self.convert("--frames", "1003:1006", "--cache", "none", source=MOVING)
        self.assertFalse(os.path.exists(self.out[:-4] + "_fpc"))
        self.assertEqual(self.points(self.out), self.points(MOVING))

    def test_without_caches_deformed_points_stand_as_at_the_first_frame(self):
        self.convert("--frames", "1003:1005", "--cache", "none", source=SKINNED)
        first, *others = [points for _, _, points in self.points(self.out)]
        self.assertEqual(others, [first] * 3)

    def test_frames_are_counted_at_the_new_rate(self):
        self.convert("--frames", "2004:2008", "--fps", "48", source=MOVING)
        meshes = dump("--kind", "meshes", "--frames", "2004:2008", self.out)["meshes"]
        self.assertEqual([round(mesh["controlPoints"][0], 3) for mesh in meshes], [2, 3, 4, 5, 6])

    def test_only_the_kinds_that_were_asked_for_are_written(self):
        self.convert("--kind", "cameras")
        page = dump(self.out)
        self.assertEqual([page[kind] for kind in ("lights", "nulls", "meshes")], [[], [], []])
        self.assertIsNotNone(named(page["cameras"], "shotCam"))

    def test_another_rate_samples_anew(self):
        self.convert("--fps", "48")
        lens = named(dump("--kind", "cameras", self.out)["cameras"], "shotCam")["channels"]["focalLength"]
        self.assertEqual((lens["start"], lens["end"], lens["rate"]), (2002, 2096, 48))
        old = samples(named(dump("--kind", "cameras", SHOT)["cameras"], "shotCam")["channels"]["focalLength"])
        self.assertSameChannel({"samples": old}, {"samples": lens["samples"][::2]}, "every other frame is an old one")
        self.assertAlmostEqual(lens["samples"][1], (old[0] + old[1]) / 2, places=4)

    def test_what_is_lost_is_said(self):
        self.assertIn("deforming meshes: 1\n", self.convert(source=SKINNED).stderr)
        self.assertNotIn("deforming meshes", self.convert("--force", "--frames", "1001:1011", source=SKINNED).stderr)
        self.assertEqual(self.convert("--force", source=MOVING).stderr, "")
        said = self.convert("--force").stderr
        self.assertIn("gate fits of cameras: 1\n", said)
        self.assertIn("resolutions of cameras: 1\n", said)
        again = run("convert", self.out, os.path.join(self.folder.name, "again.fbx"))
        self.assertEqual((again.returncode, again.stderr), (0, ""))  # they are gone: nothing more to lose

    def test_what_cameras_lose_is_said(self):
        clean = os.path.join(ROOT, "tests", "data", "lint", "clean.fbx")
        with open(clean, encoding="utf-8") as stream:
            text = stream.read()
        self.assertEqual(self.convert("--force", source=clean).stderr.count("of cameras"), 1)  # a resolution
        source = os.path.join(self.folder.name, "camera.fbx")
        for name, value, what in (("PreScale", 1.5, "pre-scales of cameras: 1"),
                                  ("FilmTranslateX", 0.5, "pre-scales of cameras: 1"),
                                  ("UseDepthOfField", 1, "depth of field of cameras: 1"), ("PreScale", 1, None)):
            with open(source, "w", encoding="utf-8") as stream:
                line = '\t\t\tP: "%s", "double", "Number", "",%s\n' % (name, value)
                stream.write(text.replace('\t\t\tP: "FilmWidth"', line + '\t\t\tP: "FilmWidth"'))
            said = self.convert("--force", source=source).stderr
            self.assertEqual(what is not None, said.count("of cameras") == 2, said)
            self.assertIn(what or "", said)

    def test_strict_makes_losses_the_exit_status(self):
        self.assertEqual(run("convert", "--strict", MOVING, self.out).returncode, 0)
        result = run("convert", "--strict", "--force", SKINNED, self.out)
        self.assertEqual(result.returncode, 3)
        self.assertIn("not written: skins: 1\n", result.stderr)
        self.assertEqual(version_of(self.out), ("binary", 7500))

    def source(self, fixture, *replacements):
        return edited(fixture, os.path.join(self.folder.name, "source.fbx"), *replacements)

    def faithful(self, path, *arguments):
        return dump("--faithful", *arguments, path)

    def assertSameTransform(self, expected, seen, places=4):
        self.assertEqual(expected["rotationOrder"], seen["rotationOrder"])
        for name, channel in expected["transform"].items():
            self.assertSameChannel(channel, seen["transform"][name], f"{expected['name']} {name}", places)

    def test_everything_stands_where_it_stood(self):
        for source in (SHOT, MOVING, SKINNED):
            self.convert("--force", source=source)
            before, after = self.faithful(source), self.faithful(self.out)
            self.assertEqual(len(before["transforms"]), len(after["transforms"]))
            for kind in ("cameras", "lights", "nulls", "transforms", "meshes"):
                for item in before[kind]:
                    self.assertSameTransform(item, named(after[kind], item["name"]))

    def test_the_stack_keeps_its_name(self):
        source = changed(MOVING, os.path.join(self.folder.name, "named.fbx"),
                         ("AnimStack::Take 001", "AnimStack::shot 010 | comp"))
        for arguments in ([], ["--version", "2010"]):
            self.convert("--force", *arguments, source=source)
            self.assertEqual(dump(self.out)["stacks"], ["shot 010 | comp"])

    def test_a_lens_with_an_angle_keeps_it(self):
        for mode, angle in (("horizontal", "filedOfView"), ("vertical", "filedOfView"),
                            ("horizontalAndVertical", "filedOfViewX")):
            number = ["horizontalAndVertical", "horizontal", "vertical"].index(mode)
            source = changed(os.path.join(SDK_DATA, "camera_7400_ascii.fbx"), os.path.join(self.folder.name, "lens.fbx"),
                             ('P: "ApertureMode", "enum", "", "",3',
                              f'P: "ApertureMode", "enum", "", "",{number}\n'
                              'P: "FieldOfView", "FieldOfView", "", "A",31\n'
                              'P: "FieldOfViewX", "FieldOfViewX", "", "A",33\nP: "FieldOfViewY", "FieldOfViewY", "", "A",22'))
            before = self.faithful(source, "--kind", "cameras")["cameras"][0]
            for arguments in ([], ["--version", "2014", "--ascii"], ["--version", "2010"]):
                self.convert("--force", *arguments, source=source)
                after = self.faithful(self.out, "--kind", "cameras")["cameras"][0]
                self.assertEqual(after["apertureMode"], mode)
                for channel in ("focalLength", "apertureWidth", "apertureHeight", angle):
                    self.assertSameChannel(before["channels"][channel], after["channels"][channel], channel)

    def test_a_mirrored_mesh_keeps_its_normals(self):
        source = changed(os.path.join(SDK_DATA, "mesh_7400_ascii.fbx"), os.path.join(self.folder.name, "mirrored.fbx"), ('"Mesh" {\n\t\tVersion: 232\n',
                                                     '"Mesh" {\n\t\tVersion: 232\n\t\tProperties70:  {\n\t\t\tP: '
                                                     '"Lcl Scaling", "Lcl Scaling", "", "A",-2,1,1\n\t\t}\n'))
        self.convert(source=source)
        before, after = (self.faithful(path, "--kind", "meshes")["meshes"][0] for path in (source, self.out))
        for key in ("pointIndices", "polygonVertexSizes"):
            self.assertEqual(before[key], after[key])
        for key in ("normals", "controlPoints"):
            self.assertEqual(len(before[key]), len(after[key]))
            for a, b in zip(before[key], after[key]):
                self.assertAlmostEqual(a, b, places=4, msg=key)

    def test_rates_come_back(self):
        for rate, exact in (("59.94", 60000 / 1001), ("12", 12), ("29.97", 30000 / 1001), ("23.976", 24000 / 1001),
                            ("15.5", 15.5)):
            for arguments in ([], ["--version", "2010"], ["--ascii"]):
                self.convert("--force", "--fps", rate, *arguments)
                lens = named(self.faithful(self.out, "--kind", "cameras")["cameras"], "shotCam")["channels"]
                self.assertAlmostEqual(lens["focalLength"]["rate"], exact, places=3)

    def test_a_spinning_node_at_the_origin_spins(self):
        source = changed(MOVING, os.path.join(self.folder.name, "spin.fbx"), ('"Lcl Translation"', '"Lcl Rotation"'),
                         ('105,104, "d|X"', '105,104, "d|Z"'))
        self.convert(source=source)
        angles = named(self.faithful(self.out)["transforms"], "moving")["transform"]["rotationZ"]
        self.assertEqual(len(set(samples(angles))), len(samples(angles)))

    def test_other_extensions_are_refused(self):
        for name in ("out.obj", "out.FBX.txt", "out.fbx.bak", ".obj"):
            target = os.path.join(self.folder.name, name)
            result = run("convert", SHOT, target)
            self.assertEqual(result.returncode, 2, name)
            self.assertIn(".fbx", result.stderr)
            self.assertFalse(os.path.exists(target))
        self.assertEqual(run("convert", SHOT, os.path.join(self.folder.name, "out.FBX")).returncode, 0)

    def test_a_dash_is_standard_output(self):
        self.convert("--ascii")
        seen = run("convert", "--ascii", SHOT, "-", env={**os.environ, "SOURCE_DATE_EPOCH": "0"})
        again = run("convert", "--ascii", SHOT, "-", env={**os.environ, "SOURCE_DATE_EPOCH": "0"})
        self.assertEqual(seen.returncode, 0, seen.stderr)
        self.assertTrue(seen.stdout.startswith("; FBX 7.5.0 project file"))
        self.assertEqual(seen.stdout, again.stdout)
        self.assertFalse(os.path.exists("-"))
        refused = run("convert", "--frames", "1001:1003", SHOT, "-")
        self.assertEqual((refused.returncode, refused.stdout), (2, ""))
        self.assertIn("--cache none", refused.stderr)

    def test_standard_output_that_is_full_is_a_failure(self):
        with open("/dev/full", "wb") as full:
            result = subprocess.run([TOOL, "convert", SHOT, "-"], stdout=full, stderr=subprocess.PIPE, check=False)
        self.assertEqual(result.returncode, 1)

    def twins(self):
        """The moving triangle beside another one of its name, which stands still 7 higher."""
        return changed(MOVING, os.path.join(self.folder.name, "twins.fbx"), (
            '\tAnimationStack: 102',
            '\tGeometry: 200, "Geometry::", "Mesh" {\n\t\tVertices: *9 {\n\t\t\ta: 0,7,0,1,7,0,0,8,0\n\t\t}\n'
            '\t\tPolygonVertexIndex: *3 {\n\t\t\ta: 0,1,-3\n\t\t}\n\t}\n'
            '\tModel: 201, "Model::moving", "Mesh" {\n\t\tVersion: 232\n\t}\n\tAnimationStack: 102'),
            ('\tC: "OO",101,0\n', '\tC: "OO",101,0\n\tC: "OO",201,0\n\tC: "OO",200,201\n\tC: "OP",104,201, '
                                  '"Lcl Translation"\n'))

    def test_meshes_of_one_name_have_their_own_caches(self):
        source = self.twins()
        self.convert("--frames", "1003:1006", source=source)
        self.assertEqual(len(os.listdir(self.out[:-4] + "_fpc")), 4)
        before, after = ([(mesh["frame"], mesh["controlPoints"])
                          for mesh in self.faithful(path, "--kind", "meshes", "--frames", "1003:1006")["meshes"]]
                         for path in (source, self.out))
        self.assertEqual(before, after)

    def test_a_camera_with_the_name_of_a_view_is_written_like_any_other(self):
        for name in ("Producer Left", "Producer Cam"):
            source = self.source("camera_7400_ascii.fbx", ("Model::shot", "Model::" + name))
            self.convert("--force", source=source)
            cameras = [camera["name"] for camera in dump("--kind", "cameras", self.out)["cameras"]]
            self.assertEqual(len(cameras), 8)
            self.assertEqual(cameras[7], name)

    def test_of_a_mesh_without_polygons_the_points_are_written(self):
        source = self.source("mesh_7400_ascii.fbx", ("*7 {\n\t\t\ta: 0,1,2,-4,3,2,-5", "*0 {\n\t\t\ta: "))
        self.assertIn("written as points: meshes without polygons: 1\n", self.convert(source=source).stderr)
        before, after = (self.faithful(path, "--kind", "meshes")["meshes"][0] for path in (source, self.out))
        self.assertEqual((after["name"], after["polygonVertexSizes"]), ("shape", []))
        self.assertEqual(before["controlPoints"], after["controlPoints"])

    def test_what_becomes_of_markers_is_said(self):
        source = self.source("markers_7400_ascii.fbx")
        count = len(dump("--kind", "markers", source)["markers"])
        self.assertGreater(count, 0)
        self.assertIn(f"written as nulls without look, size and colour: markers: {count}\n",
                      self.convert("--force", source=source).stderr)
        self.assertIn(f"not written: markers: {count}\n",
                      self.convert("--force", "--kind", "nulls", source=source).stderr)

    def test_a_copy_of_a_copy_is_the_same(self):
        self.convert()
        first = self.out
        self.out = os.path.join(self.folder.name, "again.fbx")
        self.convert(source=first)
        before, after = dump(first), dump(self.out)
        self.assertEqual(before["range"], after["range"])
        for kind in ("cameras", "lights", "nulls", "transforms"):
            self.assertEqual([item["name"] for item in before[kind]], [item["name"] for item in after[kind]])
            for a, b in zip(before[kind], after[kind]):
                for name, channel in a["transform"].items():
                    self.assertSameChannel(channel, b["transform"][name], f"{a['name']} {name}")

    def skewed(self):
        """A mesh that its parents' turns and unequal scales skew."""
        place = 'P: "InheritType", "enum", "", "",1\nP: "Lcl Rotation", "Lcl Rotation", "", "A",0,0,30\nP: "Lcl Scaling", "Lcl Scaling", "", "A",%s\n'
        models = "".join(f'Model: {number}, "Model::{name}", "{kind}" {{\nProperties70: {{\n{place % scale}}}\n}}\n'
                         for number, name, kind, scale in ((1, "upper", "Null", "1,3,1"), (2, "lower", "Mesh", "2,1,1")))
        path = os.path.join(self.folder.name, "skewed.fbx")
        with open(path, "w", encoding="utf-8") as file:
            file.write("; FBX 7.4.0 project file\nFBXHeaderExtension: {\nFBXVersion: 7400\n}\nObjects: {\n" + models +
                       'Geometry: 3, "Geometry::", "Mesh" {\nVertices: *9 {\na: 0,0,0,1,0,0,0,1,0\n}\n'
                       "PolygonVertexIndex: *3 {\na: 0,1,-3\n}\n}\n}\n"
                       'Connections: {\nC: "OO",1,0\nC: "OO",2,1\nC: "OO",3,2\n}\n')
        return path

    def test_a_copy_of_a_skewed_object_does_not_grow(self):
        source = self.skewed()
        before = self.faithful(source, "--kind", "meshes")["meshes"][0]
        for version in ("2016", "2010"):
            file = source
            for copy in range(3):
                self.out = os.path.join(self.folder.name, f"copy{version}{copy}.fbx")
                complaint = self.convert("--version", version, source=file).stderr
                self.assertEqual("objects with a parent: 1\n" in complaint, copy == 0, complaint)
                seen = self.faithful(self.out)
                self.assertEqual([item["name"] for item in seen["transforms"]], ["upper", "lower skew", "lower"])
                for x, y in zip(before["controlPoints"], seen["meshes"][0]["controlPoints"]):
                    self.assertAlmostEqual(x, y, places=4)
                file = self.out

    def test_the_stack_that_is_named_is_written(self):
        source = os.path.join(SDK_DATA, "two_stacks_7400_ascii.fbx")
        stacks = dump(source)["stacks"]
        self.assertEqual(len(stacks), 2)
        for name in stacks:
            self.convert("--force", "--stack", name, source=source)
            self.assertEqual(dump(self.out)["stacks"], [name])
            before = self.faithful(source, "--stack", name)
            after = self.faithful(self.out)
            self.assertEqual(before["range"], after["range"])
            for item in before["transforms"]:
                self.assertSameTransform(item, named(after["transforms"], item["name"]))

    def test_an_unknown_stack_is_refused_with_those_there_are(self):
        result = run("convert", "--stack", "nosuch", SHOT, self.out)
        self.assertEqual(result.returncode, 1)
        self.assertIn('there is no animation stack "nosuch"; the file has "', result.stderr)
        self.assertFalse(os.path.exists(self.out))

    def test_losses_are_those_of_the_kinds_that_are_asked_for(self):
        materials = os.path.join(SDK_DATA, "materials_7400_ascii.fbx")
        for source, what in ((SKINNED, "not written: skins: "), (materials, "not written: materials: ")):
            self.assertIn(what, self.convert("--force", source=source).stderr)
            self.assertIn(what, self.convert("--force", "--kind", "cameras,meshes", source=source).stderr)
            for kinds in ("cameras", "nulls", "transforms", "lights"):
                self.assertNotIn(what, self.convert("--force", "--kind", kinds, source=source).stderr)
        self.assertNotIn("gate fits", self.convert("--force", "--kind", "nulls").stderr)

    def test_extras_of_lights_are_counted(self):
        source = os.path.join(self.folder.name, "light.fbx")
        with open(source, "w", encoding="utf-8") as file:
            file.write("; FBX 7.4.0 project file\nFBXHeaderExtension: {\nFBXVersion: 7400\n}\nObjects: {\n"
                       'Model: 1, "Model::lamp", "Light" {\n}\nModel: 3, "Model::plain", "Light" {\n}\n'
                       'NodeAttribute: 4, "NodeAttribute::", "Light" {\n}\n'
                       'NodeAttribute: 2, "NodeAttribute::", "Light" {\nProperties70: {\n'
                       'P: "CastShadows", "bool", "", "",1\nP: "EnableBarnDoor", "Bool", "", "A",1\n'
                       'P: "InnerAngle", "Number", "", "A",12\nP: "CastLight", "bool", "", "",0\n}\n}\n}\n'
                       'Connections: {\nC: "OO",1,0\nC: "OO",2,1\nC: "OO",3,0\nC: "OO",4,3\n}\n')
        complaint = self.convert(source=source).stderr
        for what in ("not written: shadows of lights: 1", "not written: barn doors of lights: 1",
                     "not written: inner cones of lights: 1", "written as switched on: lights that are switched off: 1"):
            self.assertIn(what + "\n", complaint)
        self.assertEqual(self.convert("--force", "--kind", "cameras", source=source).stderr, "")

    def test_what_meshes_lose_is_counted(self):
        source = self.source("mesh_7400_ascii.fbx",
                             ("\t\tGeometryVersion: 124\n", "\t\tGeometryVersion: 124\n\t\tSmoothness: 3\n"))
        self.assertIn("not written: subdivision of meshes: 1\n", self.convert(source=source).stderr)
        instances = os.path.join(self.folder.name, "instances.fbx")
        with open(self.skewed(), encoding="utf-8") as stream:
            text = stream.read()
        with open(instances, "w", encoding="utf-8") as stream:
            stream.write(text.replace('"Null"', '"Mesh"').replace('C: "OO",3,2\n', 'C: "OO",3,2\nC: "OO",3,1\n'))
        self.assertNotIn("several nodes share", self.convert("--force", source=instances).stderr)
        self.assertEqual(run("records", "--path", "Objects/Geometry", "--depth", "1", self.out).stdout.count('S "Mesh"'), 1)

    def test_nothing_is_overwritten_unless_forced(self):
        with open(self.out, "w", encoding="utf-8") as stream:
            stream.write("precious")
        result = run("convert", SHOT, self.out)
        self.assertEqual(result.returncode, 2)
        self.assertIn("--force", result.stderr)
        with open(self.out, encoding="utf-8") as stream:
            self.assertEqual(stream.read(), "precious")
        self.convert("--force")
        self.assertEqual(version_of(self.out), ("binary", 7500))

    def test_caches_are_not_overwritten_unless_forced(self):
        os.mkdir(self.out[:-4] + "_fpc")
        result = run("convert", "--frames", "1001:1002", SHOT, self.out)
        self.assertEqual(result.returncode, 2)
        self.assertIn("_fpc", result.stderr)
        self.assertFalse(os.path.exists(self.out))

    def test_the_input_is_never_overwritten(self):
        self.convert()
        link = os.path.join(self.folder.name, "link.fbx")
        os.symlink(self.out, link)
        before = self.bytes()
        for target in (self.out, link, os.path.join(self.folder.name, ".", "out.fbx")):
            result = run("convert", "--force", self.out, target)
            self.assertEqual(result.returncode, 2)
            self.assertEqual(self.bytes(), before)

    def test_what_cannot_be_read_or_written_gives_one_line_and_status_1(self):
        for source, target in (("missing.fbx", self.out), (SHOT, os.path.join(self.folder.name, "no", "out.fbx"))):
            result = run("convert", source, target)
            self.assertEqual(result.returncode, 1)
            self.assertRegex(result.stderr.splitlines()[-1], r"^tarnell-fbx: .*(missing\.fbx|out\.fbx)")
        self.assertEqual(os.listdir(self.folder.name), [])

    def test_wrong_usage_gives_status_2(self):
        for arguments in (["--version", "2015"], ["--ascii", "--binary"], ["--kind", "markers"], ["--frames", "9:1"],
                          ["--fps", "0"], ["--cache", "alembic"], ["--fps", "-24"], ["--fps", "nan"], ["--fps", "inf"],
                          ["--fps", "1e39"], ["--fps", ""], ["--fps", "24x"], ["--kind", ""], ["--kind", "nulls,"],
                          ["--version", ""], ["--cache", ""], *(["--frames", frames] for frames in NO_FRAMES)):
            result = run("convert", *arguments, SHOT, self.out)
            self.assertEqual(result.returncode, 2, arguments)
        self.assertFalse(os.path.exists(self.out))

    def stack(self):
        return next(line for line in run("info", self.out).stdout.splitlines() if "Stacks" in line)

    def test_keeps_the_span_of_the_stack(self):
        for year in YEARS:
            for encoding in ([], ["--ascii"]):
                self.convert("--version", year, "--force", *encoding, source=MOVING)
                self.assertIn("frames 1001 to 1011", self.stack(), (year, encoding))
        self.convert("--force", "--frames", "990:1020", "--cache", "max", source=MOVING)
        self.assertIn("frames 990 to 1020", self.stack())

    def test_does_not_wait_for_a_pipe_that_nobody_reads(self):
        os.mkfifo(self.out)
        refused = run("convert", SHOT, self.out)
        self.assertEqual(refused.returncode, 2)
        self.assertIn("exists", refused.stderr)

        result = run("convert", "--force", SHOT, self.out)

        self.assertEqual(result.returncode, 1)
        self.assertIn(self.out + ": cannot be written: no process reads the pipe", result.stderr)

    def test_writes_to_standard_output_and_the_null_device(self):
        self.assertEqual(run("convert", "--force", SHOT, "/dev/null").returncode, 0)

        result = run("convert", "--force", "--ascii", SHOT, "/dev/stdout")

        self.assertEqual(result.returncode, 0, result.stderr)
        self.assertTrue(result.stdout.startswith("; FBX 7.5.0 project file"))

    def test_says_what_the_library_warns_of(self):
        self.assertIn("moving: objects with the same name are numbered",
                      self.convert("--version", "2010", source=self.twins()).stderr)
        self.assertEqual(run("convert", "--force", "--strict", "--version", "2010", self.twins(), self.out).returncode, 3)


unittest.main(argv=sys.argv[:1], verbosity=0)
