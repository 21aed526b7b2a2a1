# SPDX-License-Identifier: MIT
# Copyright (c) Tarnell FBX contributors
#
# What `tarnell-fbx report` writes: the data in its page against what `dump --faithful` prints, and the rules of files.
import base64
import json
import os
import re
import struct
import sys
import tempfile
import unittest

sys.path.insert(0, os.path.join(os.path.dirname(os.path.abspath(__file__)), "..", "tool"))
import scenes  # noqa: E402
from schema import faults, load  # noqa: E402
from support import NO_FRAMES, SDK_DATA, SHOT, TOOL, dump, float32, named, run  # noqa: E402

LINT = os.path.join(SDK_DATA, "..", "lint")
SHOT_ELEMENT = re.compile(r'<script type="application/json" class="shot">(.*?)</script>\n'
                          r'<script type="text/plain" class="arrays">([A-Za-z0-9+/=]*)</script>\n', re.S)


class Shot:
    """One file of a page."""

    def __init__(self, document, arrays):
        self.data = json.loads(document)
        self.bytes = base64.b64decode(arrays, validate=True)
        self.nodes = self.data["nodes"]

    def numbers(self, kind, at, count):
        return list(struct.unpack_from(f"<{count}{kind}", self.bytes, at))

    def channel(self, node, name):
        """A value for each frame."""
        value, count = node["channels"][name], self.data["frames"]["count"]
        return self.numbers("f", value["at"], count) if isinstance(value, dict) else [value] * count

    def points(self, mesh, moment=0):
        flat = self.numbers("f", mesh["sets"][moment], 3 * mesh["drawnPoints"])
        return [flat[i:i + 3] for i in range(0, len(flat), 3)]

    def triangles(self, mesh):
        flat = self.numbers("H" if mesh["indexBytes"] == 2 else "I", mesh["indices"], 3 * mesh["drawnTriangles"])
        return [flat[i:i + 3] for i in range(0, len(flat), 3)]


def shots(page):
    return [Shot(*found) for found in SHOT_ELEMENT.findall(page)]


def area(a, b, c):
    """Twice the area of a triangle in the plane of X and Y."""
    return (b[0] - a[0]) * (c[1] - a[1]) - (b[1] - a[1]) * (c[0] - a[0])


def samples(channel, count):
    return channel["samples"] if isinstance(channel, dict) else [channel] * count


class Reports(unittest.TestCase):
    def setUp(self):
        folder = tempfile.TemporaryDirectory()
        self.addCleanup(folder.cleanup)
        self.folder = folder.name
        self.page = os.path.join(self.folder, "shot.html")

    def scene(self, name, text):
        return scenes.write(os.path.join(self.folder, name), text)

    def report(self, *arguments):
        result = run("report", *arguments, "-o", self.page)
        self.assertEqual((result.returncode, result.stdout, result.stderr), (0, "", ""))
        with open(self.page, encoding="utf-8") as stream:
            return shots(stream.read())

    def test_values_of_every_frame_are_the_faithful_ones(self):
        shot, = self.report(SHOT)
        self.assertEqual(shot.data["frames"], {"rate": 24, "first": 1001, "step": 1, "count": 48})
        expected = dump(SHOT, "--faithful")
        names = {"filedOfViewX": "fieldOfViewX", "filedOfViewY": "fieldOfViewY"}
        for kind in ("cameras", "lights"):
            for item in expected[kind]:
                node = named(shot.nodes, item["name"])
                channels = dict(item["transform"], **{names.get(name, name): value
                                                      for name, value in item["channels"].items()})
                compared = [name for name in node["channels"] if name in channels]
                self.assertGreater(len(compared), 15)
                for name in compared:
                    with self.subTest(object=item["name"], channel=name):
                        values = [struct.unpack("<f", struct.pack("<f", v))[0] for v in samples(channels[name], 48)]
                        seen = [struct.unpack("<f", struct.pack("<f", v))[0] for v in shot.channel(node, name)]
                        self.assertEqual(seen, values)
        self.assertEqual([node["name"] for node in shot.nodes], [node["name"] for node in expected["transforms"]])
        for node, item in zip(shot.nodes, expected["transforms"]):
            parent = shot.nodes[node["parent"]]["name"] if node["parent"] >= 0 else None
            self.assertEqual(parent, item["parent"])

    def test_as_json_are_the_numbers_of_the_page(self):
        files = [SHOT, os.path.join(SDK_DATA, "blend_shape_7400_ascii.fbx"), os.path.join(SDK_DATA, "lights_7400_ascii.fbx")]
        documents = json.loads(run("report", "--json", *files).stdout)
        schema = load("report")
        for document, shot in zip(documents, self.report(*files), strict=True):
            self.assertEqual(list(faults(document, schema, schema)), [])
            self.assertEqual(list(document)[:2], ["format", "file"])
            for key in ("file", "take", "info", "frames", "shapeFrames", "findings", "notes", "warnings"):
                self.assertEqual(document[key], shot.data[key])
            self.assertEqual(len(document["nodes"]), len(shot.nodes))
            for node, other in zip(document["nodes"], shot.nodes):
                self.assertEqual(list(node["channels"]), list(other["channels"]))
                for name, value in node["channels"].items():
                    values = value if isinstance(value, list) else [value] * document["frames"]["count"]
                    self.assertEqual([float32(each) for each in values],
                                     [float32(each) for each in shot.channel(other, name)])
            for mesh, other in zip(document["meshes"], shot.data["meshes"], strict=True):
                self.assertEqual(mesh["corners"], [each for corners in shot.triangles(other) for each in corners])
                self.assertEqual(len(mesh["sets"]), len(other["sets"]))
                for moment, flat in enumerate(mesh["sets"]):
                    self.assertEqual([float32(each) for each in flat],
                                     [each for point in shot.points(other, moment) for each in point])

    def test_of_takes_beyond_all_frame_numbers_have_frames_that_grow(self):
        file = os.path.join(LINT, "not-readable.fbx")  # a take of 2 400 000 000 frames, the last ones beyond an int
        document = json.loads(run("report", "--json", file).stdout)
        frames = document["frames"]
        self.assertGreater(frames["step"], 1)
        self.assertGreater(frames["count"], 1000)
        last = frames["first"] + (frames["count"] - 1) * frames["step"]
        self.assertTrue(1.9e9 < last < 2**31, last)
        self.assertTrue(any("are left out" in note for note in document["notes"]), document["notes"])

    def test_as_json_follow_the_rules_of_all_commands(self):
        missing = os.path.join(self.folder, "missing.fbx")
        result = run("report", "--jsonl", "--frames", "1001:1003", SHOT, missing)
        lines = [json.loads(line) for line in result.stdout.splitlines()]
        self.assertEqual((result.returncode, len(lines)), (1, 2))
        self.assertEqual(lines[0]["frames"]["count"], 3)
        self.assertEqual(list(lines[1]), ["format", "file", "error"])
        self.assertEqual([list(faults(line, load("report"), load("report"))) for line in lines], [[], []])
        for arguments in (("--json", "-o", self.page), ("--json", "--jsonl"), ()):
            result = run("report", *arguments, SHOT)
            self.assertEqual((result.returncode, result.stdout), (2, ""), arguments)
        self.assertFalse(os.path.exists(self.page))

    def test_points_are_those_of_the_mesh_in_the_space_of_its_node(self):
        shot, = self.report(SHOT)
        crate, = dump(SHOT, "--faithful", "--kind", "meshes", "--no-transform-points", "--frame", "1001")["meshes"]
        mesh, = shot.data["meshes"]
        flat = [c for point in shot.points(mesh) for c in point]
        self.assertEqual(flat, [struct.unpack("<f", struct.pack("<f", c))[0] for c in crate["controlPoints"]])
        self.assertEqual((mesh["triangles"], mesh["drawnTriangles"], mesh["polygons"]), (12, 12, 6))

    def test_points_that_move_have_a_set_for_each_frame(self):
        file = os.path.join(SDK_DATA, "blend_shape_7400_ascii.fbx")
        shot, = self.report(file)
        moments = [shot.data["frames"]["first"] + place for place in shot.data["shapeFrames"]]
        self.assertGreater(len(moments), 1)
        for moment, frame in enumerate(moments):
            for item in dump(file, "--faithful", "--kind", "meshes", "--no-transform-points", "--frame",
                             str(frame))["meshes"]:
                mesh = shot.data["meshes"][named(shot.nodes, item["name"])["mesh"]]
                flat = [c for point in shot.points(mesh, min(moment, len(mesh["sets"]) - 1)) for c in point]
                for seen, value in zip(flat, item["controlPoints"], strict=True):
                    self.assertAlmostEqual(seen, value, places=4, msg=f"frame {frame}")

    def test_concave_polygons_keep_their_form(self):
        shot, = self.report(self.scene("corner.fbx", scenes.scene_of_corners()))
        mesh, = shot.data["meshes"]
        points = shot.points(mesh)
        areas = [area(*(points[i] for i in triangle)) for triangle in shot.triangles(mesh)]
        self.assertEqual(sum(areas), 2 * (4 * 4 - 3 * 3))
        self.assertTrue(all(each > 0 for each in areas), areas)
        self.assertEqual(mesh["drawnPoints"], 6) # the one that is not finite stays away, and the page says so
        self.assertIn("1 polygon is not drawn", shot.data["notes"][0])

    def test_large_meshes_are_thinned_and_the_page_says_so(self):
        side = 400
        text = scenes.document([scenes.model(1, "ground", "Mesh"), scenes.mesh(2, *scenes.sheet(side))],
                               [(1, 0), (2, 1)])
        shot, = self.report(self.scene("ground.fbx", text))
        mesh, = shot.data["meshes"]
        self.assertEqual((mesh["triangles"], mesh["points"]), (2 * side * side, (side + 1) ** 2))
        self.assertLessEqual(mesh["drawnTriangles"], 250000)
        self.assertGreater(mesh["drawnTriangles"], 125000)
        self.assertIn("1 mesh is simplified: of 320000 triangles", shot.data["notes"][0])
        whole = {tuple(struct.unpack("<f", struct.pack("<f", c))[0] for c in point)
                 for point in zip(*[iter(scenes.sheet(side)[0])] * 3)}
        self.assertTrue(all(tuple(point) in whole for point in shot.points(mesh)))
        self.assertLess(max(max(each) for each in shot.triangles(mesh)), mesh["drawnPoints"])

    def test_long_clips_are_bounded_and_the_page_says_so(self):
        long = self.scene("long.fbx", scenes.document([scenes.model(1, "still", "Null")], [(1, 0)],
                                                      take=("Take", 1000000)))
        shot, = self.report(long)
        frames = shot.data["frames"]
        self.assertEqual((frames["first"], frames["step"], frames["count"]), (0, 11, 90910))
        self.assertIn("Of the 1000001 frames the report shows every 11th", shot.data["notes"][0])

    def test_frames_and_takes_can_be_chosen(self):
        shot, = self.report(SHOT, "--frames", "1010:1012")
        self.assertEqual(shot.data["frames"], {"rate": 24, "first": 1010, "step": 1, "count": 3})
        whole, = self.report(SHOT)
        for name in ("positionX", "focalLength"):
            camera = [named(each.nodes, "shotCam") for each in (shot, whole)]
            self.assertEqual(shot.channel(camera[0], name), whole.channel(camera[1], name)[9:12])
        for range_ in NO_FRAMES:
            self.assertEqual(run("report", SHOT, "-o", self.page, "--frames", range_).returncode, 2)
        for more, reason in ((("--frames", "1:5"), "there are no frames 1 to 5; the frames are 1001 to 1048"),
                             (("--take", "none"), 'there is no take "none"; takes: "Scene"')):
            result = run("report", SHOT, "-o", os.path.join(self.folder, "no.html"), *more)
            self.assertEqual((result.returncode, result.stderr), (1, f"tarnell-fbx: {SHOT}: {reason}\n"))
        self.assertFalse(os.path.exists(os.path.join(self.folder, "no.html")))

    def test_findings_are_those_of_lint(self):
        for file in (SHOT, os.path.join(SDK_DATA, "caches_7400_ascii.fbx")):
            expected = {}
            for finding in json.loads(run("lint", "--json", file).stdout)["findings"]:
                expected.setdefault(finding["rule"], []).append((finding["object"] or "", finding["text"]))
            shot, = self.report(file)
            self.assertGreater(len(expected), 0)
            self.assertEqual({rule["rule"]: [(each["object"], each["text"]) for each in rule["found"]]
                              for rule in shot.data["findings"]}, expected)

    def test_findings_that_are_many_are_counted(self):
        names = scenes.document([scenes.model(i + 1, "same", "Null") for i in range(30)] +
                                [scenes.model(i + 101, f"a/{i}\x07", "Null") for i in range(30)],
                                [(i + 1, 0) for i in range(30)] + [(i + 101, 0) for i in range(30)])
        shot, = self.report(self.scene("many.fbx", names))
        many = [rule for rule in shot.data["findings"] if rule["count"] > 20]
        self.assertGreater(len(many), 0, shot.data["findings"])
        self.assertEqual({len(rule["found"]) for rule in many}, {20})

    def test_names_stay_names(self):
        shot, = self.report(self.scene("names.fbx", scenes.scene_of_names()))
        self.assertEqual([node["name"] for node in shot.nodes][:len(scenes.NAMES)], scenes.NAMES)
        self.assertEqual(shot.data["take"], scenes.NAMES[0])
        with open(self.page, encoding="utf-8") as stream:
            page = stream.read()
        document = SHOT_ELEMENT.search(page).group(1)
        self.assertNotIn("<", document)
        self.assertNotRegex(document, r"[\x00-\x1f]")

    def test_several_files_share_a_page(self):
        first = self.scene("a.fbx", scenes.document([scenes.model(1, "a", "Null")], [(1, 0)]))
        second = self.scene("b.fbx", scenes.document([scenes.model(1, "b", "Null")], [(1, 0)]))
        both = self.report(os.path.join(self.folder, "?.fbx"))
        self.assertEqual([(shot.data["file"], shot.nodes[0]["name"]) for shot in both], [(first, "a"), (second, "b")])

    def test_a_file_that_fails_does_not_keep_the_others_out(self):
        broken = self.scene("broken.fbx", "Objects:  {\n")
        result = run("report", broken, SHOT, "-o", self.page)
        self.assertEqual(result.returncode, 1)
        self.assertRegex(result.stderr, r"^tarnell-fbx: .*broken\.fbx: [^\n]+\n$")
        with open(self.page, encoding="utf-8") as stream:
            self.assertEqual([shot.data["file"] for shot in shots(stream.read())], [SHOT])

    def test_what_is_no_report_is_not_overwritten(self):
        with open(self.page, "w", encoding="utf-8") as stream:
            stream.write("mine")
        result = run("report", SHOT, "-o", self.page)
        self.assertEqual((result.returncode, result.stderr),
                         (2, f"tarnell-fbx: {self.page}: exists and is not a report; --force overwrites it\n"))
        with open(self.page, encoding="utf-8") as stream:
            self.assertEqual(stream.read(), "mine")
        self.report(SHOT, "--force")
        self.report(SHOT) # a report makes room for the next one
        copy = self.scene("shot.fbx", "")
        self.assertEqual(run("report", copy, "-o", copy, "--force").returncode, 2)
        self.assertEqual(sorted(os.listdir(self.folder)), ["shot.fbx", "shot.html"])

    def test_a_page_that_cannot_be_written_is_an_error(self):
        page = os.path.join(self.folder, "none", "shot.html")
        result = run("report", SHOT, "-o", page)
        self.assertEqual((result.returncode, result.stderr), (1, f"tarnell-fbx: {page}: cannot be written\n"))
        result = run("report", os.path.join(self.folder, "*.fbx"), "-o", self.page)
        self.assertEqual(result.returncode, 1)
        self.assertFalse(os.path.exists(self.page))

    def test_standard_input_and_output_are_files_like_others(self):
        with open(SHOT, "rb") as stream:
            result = run("report", "-", "-o", "-", stdin=stream)
        self.assertEqual((result.returncode, result.stderr), (0, ""))
        self.assertEqual([shot.data["file"] for shot in shots(result.stdout)], ["standard input"])

    def test_the_same_file_gives_the_same_page(self):
        self.report(SHOT)
        with open(self.page, "rb") as stream:
            first = stream.read()
        self.report(SHOT)
        with open(self.page, "rb") as stream:
            self.assertEqual(stream.read(), first)


if __name__ == "__main__":
    unittest.main(argv=[sys.argv[0]])
