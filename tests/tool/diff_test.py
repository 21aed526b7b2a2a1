# SPDX-License-Identifier: MIT
# Copyright (c) Tarnell FBX contributors
#
# diff finds nothing between a file and itself, nothing between the same scene in other units and encodings, and of what
# was changed in a copy just that, with the frame and the amount that follow from the change.
import glob
import html.parser
import importlib.util
import json
import math
import os
import tempfile
import unittest

from support import ROOT, SDK_DATA, SHOT, edited, run

LINT = os.path.join(ROOT, "tests", "data", "lint")
spec = importlib.util.spec_from_file_location("make_lint_files", os.path.join(LINT, "make_lint_files.py"))
scenes = importlib.util.module_from_spec(spec)
spec.loader.exec_module(scenes)


class Folder(unittest.TestCase):
    def setUp(self):
        folder = tempfile.TemporaryDirectory()
        self.addCleanup(folder.cleanup)
        self.folder = folder.name

    def file(self, name, text):
        path = os.path.join(self.folder, name)
        with open(path, "w", encoding="utf-8") as stream:
            stream.write(text)
        return path

    def diff(self, a, b, *arguments):
        """The differences of two files, or of two texts."""
        if a.startswith(";"):
            a, b = self.file("a.fbx", a), self.file("b.fbx", b)
        result = run("diff", "--json", *arguments, a, b)
        page = json.loads(result.stdout)
        self.assertNotIn("error", page)
        self.assertEqual(page["equal"], not page["differences"])
        self.assertEqual(result.returncode, 0 if page["equal"] else 1)
        return page["differences"]

    def only(self, differences, kind, name, what):
        """The one difference that there is."""
        self.assertEqual([(each["kind"], each["object"], each["what"]) for each in differences], [(kind, name, what)])
        return differences[0]


class Equal(Folder):
    def test_is_every_file_to_itself(self):
        files = glob.glob(os.path.join(SDK_DATA, "*.fbx")) + glob.glob(os.path.join(LINT, "*.fbx")) + [SHOT]
        compared = 0
        for file in files:
            result = run("diff", "--json", file, file)
            page = json.loads(result.stdout)
            if "error" in page:  # what cannot be read faithfully
                self.assertEqual(os.path.basename(file), "not-readable.fbx", page)
                continue
            self.assertEqual((result.returncode, page["differences"]), (0, []), file)
            compared += 1
        self.assertGreater(compared, 80)

    def test_are_a_text_and_a_binary_file_of_one_scene(self):
        files = [os.path.join(self.folder, name) for name in ("a.fbx", "b.fbx")]
        for file, form in zip(files, ("--ascii", "--binary")):
            self.assertEqual(run("convert", form, SHOT, file).returncode, 0)
        self.assertEqual(self.diff(*files), [])

    def test_is_a_scene_in_metres_but_for_the_unit(self):
        centimetres = scenes.scene(frames=(0, 4), values=[0.0, 4.0])
        metres = scenes.scene(
            unit=100.0, frames=(0, 4), values=[0.0, 0.04], camera={"NearPlane": 0.01, "FarPlane": 100.0},
            mesh_node={"Lcl Translation": (0.1, 0.0, 0.0)},
            the_mesh=scenes.mesh(21, "tri", points=((0, 0, 0), (0.01, 0, 0), (0, 0.01, 0))))
        self.assertEqual(self.only(self.diff(centimetres, metres), "unit", None, "unit")["b"], "metre")


class Transforms(Folder):
    def test_differ_at_the_worst_frame(self):
        other = scenes.scene(values=[0.0, 1.0, 2.5, 3.0, 4.25])
        found = self.diff(scenes.scene(), other)
        self.assertEqual({each["kind"] for each in found}, {"transform", "curve"})
        worst = next(each for each in found if each["kind"] == "transform")
        self.assertEqual((worst["object"], worst["what"], worst["amount"], worst["unit"], worst["frame"]),
                         ("cam", "position", 0.5, "cm", 2))

    def test_of_turned_nodes_differ_by_the_angle(self):
        for angle in (0.5, 30.0, 90.0, 180.0, -120.0):
            base = scenes.scene(objects=scenes.null(30, "n"), connections='C: "OO",30,0\n')
            other = scenes.scene(objects=scenes.null(30, "n", {"Lcl Rotation": (0.0, angle, 0.0)}),
                                 connections='C: "OO",30,0\n')
            found = self.only(self.diff(base, other), "transform", "n", "rotation")
            self.assertAlmostEqual(found["amount"], abs(angle), 3)

    def test_of_what_hangs_below_are_carried_along(self):
        def tree(x, tip):
            return scenes.with_nulls((30, "hand", {"Lcl Translation": (x, 0.0, 0.0)}),
                                     (31, "finger", {"Lcl Translation": (0.0, 5.0, 0.0)}),
                                     (32, "tip", {"Lcl Translation": (0.0, tip, 0.0)}), below=((31, 30), (32, 31)))
        found = self.only(self.diff(tree(0.0, 1.0), tree(7.0, 1.0)), "transform", "hand", "position")
        self.assertEqual((found["amount"], found["carried"]), (7, 2))
        found = self.diff(tree(0.0, 1.0), tree(7.0, 2.0))
        self.assertEqual([(each["object"], each["carried"]) for each in found], [("hand", 1), ("tip", 0)])
        self.assertAlmostEqual(found[1]["amount"], math.hypot(7, 1), 4)

    def test_within_the_tolerance_are_equal(self):
        base = scenes.scene(mesh_node={"Lcl Translation": (10.0, 0.0, 0.0)})
        other = scenes.scene(mesh_node={"Lcl Translation": (10.5, 0.0, 0.0)})
        self.assertEqual(self.diff(base, other, "--tolerance", "0.1"), [])
        self.assertEqual(self.only(self.diff(base, other, "--tolerance", "0.01"), "transform", "tri", "position")["amount"],
                         0.5)


class Trees(Folder):
    def test_have_added_and_removed_nodes(self):
        base, more = scenes.scene(), scenes.with_nulls((30, "new", None), (31, "below", None), below=((31, 30),))
        self.assertEqual([(each["kind"], each["object"], each["b"]) for each in self.diff(base, more)],
                         [("added", "new", "below the root"), ("added", "below", 'below "new"')])
        self.assertEqual([(each["kind"], each["object"], each["a"]) for each in self.diff(more, base)],
                         [("removed", "new", "below the root"), ("removed", "below", 'below "new"')])

    def test_have_renamed_nodes(self):
        found = self.only(self.diff(scenes.scene(), scenes.scene(names=("cam", "triangle"))), "renamed", "tri", "mesh")
        self.assertEqual((found["a"], found["b"]), ("tri", "triangle"))
        base = scenes.with_nulls((30, "left", None), (31, "right", None))
        other = scenes.with_nulls((30, "leftHand", None), (31, "rightHand", None))  # distinguished by their numbers
        self.assertEqual([(each["kind"], each["a"], each["b"]) for each in self.diff(base, other)],
                         [("renamed", "left", "leftHand"), ("renamed", "right", "rightHand")])

    def test_have_nodes_that_moved(self):
        nodes = (30, "a", None), (31, "b", None), (32, "c", None)
        found = self.only(self.diff(scenes.with_nulls(*nodes, below=((32, 30),)), scenes.with_nulls(*nodes, below=((32, 31),))),
                          "moved", "c", "node")
        self.assertEqual((found["a"], found["b"]), ('below "a"', 'below "b"'))

    def test_of_nodes_with_one_name_match_in_their_order(self):
        nodes = [(30 + i, "same", {"Lcl Translation": (float(i), 0.0, 0.0)}) for i in range(3)]
        base = scenes.with_nulls(*nodes)
        self.assertEqual(self.diff(base, base), [])
        self.assertEqual(self.diff(base, scenes.with_nulls(*nodes[:2]))[0]["kind"], "removed")


class Optics(Folder):
    def test_differ_in_what_was_changed(self):
        for change, what, a, b in (({"FocalLength": 50.0}, "focalLength", "35", "50"),
                                   ({"FilmOffsetX": 0.25}, "filmOffsetX", "0", "0.25"),
                                   ({"NearPlane": 2.0}, "near", "1", "2"), ({"GateFit": 1}, "gate fit", "none", "vertical"),
                                   ({"AspectWidth": 3840.0, "AspectHeight": 2160.0}, "resolution", "1920 × 1080", "3840 × 2160"),
                                   ({"ApertureMode": 2, "FieldOfView": 2 * math.degrees(math.atan(0.9 * 25.4 / 70))},
                                    "driven by", "focal length", "vertical angle")):
            found = self.diff(scenes.scene(), scenes.scene(camera=change))
            self.assertEqual([(each["kind"], each["what"], each["a"], each["b"]) for each in found
                              if not each["what"].startswith("pictureFov")], [("optics", what, a, b)], change)

    def test_of_the_picture_follow_from_the_gate_fit(self):
        film, focal = {"FilmWidth": 1.6, "FilmHeight": 1.2, "FilmAspectRatio": 4 / 3, "GateFit": 1}, 35.0
        found = self.diff(scenes.scene(camera=film), scenes.scene(camera={**film, "GateFit": 2}))
        by_what = {each["what"]: each for each in found}
        angle = lambda inches: math.degrees(2 * math.atan(inches * 25.4 / 2 / focal))
        self.assertAlmostEqual(by_what["pictureFovX"]["amount"], angle(1.2 * 16 / 9) - angle(1.6), 4)
        self.assertAlmostEqual(by_what["pictureFovY"]["amount"], angle(1.2) - angle(0.9), 4)

    def test_of_lights_differ(self):
        lights = os.path.join(SDK_DATA, "lights_7400_ascii.fbx")
        with open(lights, encoding="utf-8") as stream:
            text = stream.read()
        start = text.index("LightType")
        other = self.file("b.fbx", text[:start] + text[start:].replace('LightType", "enum", "", "",2', 'LightType", "enum", "", "",1', 1))
        found = self.diff(lights, other)
        self.assertIn(("light", "type", "spot", "directional"),
                      [(each["kind"], each["what"], each["a"], each["b"]) for each in found])


class Curves(Folder):
    def test_differ_in_number_time_and_value(self):
        base = scenes.scene()
        sparse = scenes.scene(frames=(0, 4), values=[0.0, 4.0])  # the same motion with fewer keys
        found = self.only(self.diff(base, sparse), "curve", "cam", "Lcl Translation.X")
        self.assertEqual((found["a"], found["b"]), ("5 keys", "2 keys"))
        late = self.diff(base, scenes.scene(frames=(0, 1, 2, 3.5, 4), values=[0.0, 1.0, 2.0, 3.5, 4.0]))
        found = self.only(late, "curve", "cam", "Lcl Translation.X (times)")
        self.assertAlmostEqual(found["amount"], 0.5, 6)
        self.assertAlmostEqual(found["frame"], 3, 6)
        none = self.diff(base, scenes.scene(keyed=False))
        self.assertIn(("5 keys", "not keyed"), [(each["a"], each["b"]) for each in none])

    def test_of_time_differ(self):
        found = self.diff(scenes.scene(span=(0, 8)), scenes.scene(span=(0, 16)))
        self.assertEqual(self.only(found, "take", None, "span")["b"], "frames 0 to 16 (0 to 0.6667 s)")
        found = self.diff(scenes.scene(rate=24), scenes.scene(rate=24, time_mode=10))
        self.assertIn(("rate", "24", "25"), [(each["kind"], each["a"], each["b"]) for each in found])


class Meshes(Folder):
    def test_differ_in_points(self):
        other = scenes.scene(the_mesh=scenes.mesh(21, "tri", points=((0, 0, 0), (1, 3, 4), (0, 1.5, 0))))
        found = self.only(self.diff(scenes.scene(), other), "points", "tri", "2 of 3 points, largest difference at point 1")
        self.assertEqual((found["amount"], found["a"], found["b"]), (5, "(1, 0, 0)", "(1, 3, 4)"))

    def test_differ_in_topology(self):
        other = scenes.scene(the_mesh=scenes.mesh(21, "tri", corners="0,2,-2"))
        found = self.only(self.diff(scenes.scene(), other), "topology", "tri", "vertices of polygon 0")
        self.assertEqual((found["a"], found["b"]), ("0, 1, 2", "0, 2, 1"))
        without = self.diff(scenes.scene(), scenes.scene(the_mesh=scenes.mesh(21, "tri", normals="")))
        self.assertEqual(self.only(without, "topology", "tri", "normals")["b"], "no")

    def test_at_the_frames_that_are_asked_for(self):
        name = "blend_shape_7400_ascii.fbx"
        with open(os.path.join(SDK_DATA, name), encoding="utf-8") as stream:
            text = stream.read()
        keys = text[text.index("KeyValueFloat"):].split("a: ", 1)[1].split("\n", 1)[0]
        last = keys.rsplit(",", 1)
        other = edited(name, os.path.join(self.folder, "b.fbx"), ("a: " + keys, "a: " + last[0] + ",0"))
        ours = os.path.join(SDK_DATA, name)
        found = self.diff(ours, other)
        self.assertNotIn("points", [each["kind"] for each in found])
        self.assertEqual({each["kind"] for each in found}, {"curve"})  # at the first frame only the keys differ
        self.assertTrue(all(each["what"].endswith(".DeformPercent") for each in found), found)
        frames = [each for each in self.diff(ours, other, "--frames", "0:4") if each["kind"] == "points"]
        self.assertEqual(len(frames), 1)
        self.assertEqual(frames[0]["frame"], 4)


class Materials(Folder):
    """materials_7400_ascii.fbx: the polygons of "strip" are glass, red, glass; glass has the texture bark."""
    name = "materials_7400_ascii.fbx"

    def changed(self, *replacements):
        """The differences of the file to a copy in which each text, wherever it stands, is another."""
        ours = os.path.join(SDK_DATA, self.name)
        with open(ours, encoding="utf-8") as stream:
            text = stream.read()
        for old, new in replacements:
            self.assertIn(old, text)
            text = text.replace(old, new)
        return self.diff(ours, self.file("b.fbx", text))

    def test_differ_in_colours_and_factors(self):
        found = self.only(self.changed(('"A",1,0.25,0.125', '"A",1,0.5,0.125')), "material", "red", "DiffuseColor")
        self.assertEqual((found["a"], found["b"], found["amount"], found["frame"]),
                         ("(1, 0.25, 0.125)", "(1, 0.5, 0.125)", 0.25, None))
        found = self.only(self.changed(('"A",0.75', '"A",0.5')), "material", "glass", "TransparencyFactor")
        self.assertEqual((found["a"], found["b"], found["amount"]), ("0.75", "0.5", 0.25))
        self.assertEqual(self.changed(('"A",0.75', '"A",0.75001')), [])

    def test_differ_in_what_is_stated_on_one_side(self):
        shine = 'P: "DiffuseColor", "Color", "", "A",0,0.5,1\n\t\t\tP: "Sheen", "Number", "", "AU",0.5'
        found = self.only(self.changed(('P: "DiffuseColor", "Color", "", "A",0,0.5,1', shine)), "material", "glass", "Sheen")
        self.assertEqual((found["a"], found["b"]), (None, "0.5"))

    def test_differ_in_their_class(self):
        found = self.changed(('"lambert"', '"phong"'))
        self.assertEqual([(each["kind"], each["object"], each["what"], each["a"], each["b"]) for each in found],
                         [("material", "red", "class", "SurfaceLambert", "SurfacePhong")])

    def test_are_renamed_added_and_removed(self):
        found = self.only(self.changed(("Material::red", "Material::crimson")), "renamed", "red", "material")
        self.assertEqual((found["a"], found["b"]), ("red", "crimson"))
        new = '\tMaterial: 9, "Material::new", "" {\n\t\tVersion: 102\n\t\tShadingModel: "lambert"\n\t}\n\tTexture: 5'
        found = self.only(self.changed(("\tTexture: 5", new)), "added", "new", "material")
        self.assertEqual((found["a"], found["b"]), (None, "not assigned"))
        found = self.changed(("\tTexture: 5", new), ('C: "OO",4,2\n', 'C: "OO",4,2\n\tC: "OO",9,2\n'))
        self.assertEqual([(each["kind"], each["object"], each["what"], each["a"], each["b"]) for each in found],
                         [("added", "new", "material", None, 'assigned to "strip"'),
                          ("material", "strip", "materials", '"red", "glass"', '"red", "glass", "new"')])

    def test_are_those_of_other_polygons(self):
        found = self.only(self.changed(("a: 1,0,1", "a: 1,1,0")), "material", "strip", "2 of 3 polygons, the first at polygon 1")
        self.assertEqual((found["a"], found["b"]), ('"red"', '"glass"'))
        # In another order, with the indices to match: the same to look at.
        self.assertEqual(self.changed(("a: 1,0,1", "a: 0,1,0"), ('C: "OO",3,2\n\tC: "OO",4,2', 'C: "OO",4,2\n\tC: "OO",3,2')),
                         [])

    def test_differ_in_keys_and_at_the_worst_frame(self):
        def keyed(values):
            return scenes.scene(objects=scenes.record("Material", 30, "Material::paint", "", more=(
                '\t\tVersion: 102\n\t\tShadingModel: "lambert"\n\t\tProperties70:  {\n'
                '\t\t\tP: "DiffuseFactor", "Number", "", "A",1\n\t\t}\n')), connections='C: "OO",30,20\n',
                                on=30, animated="DiffuseFactor", channel="d|DiffuseFactor", values=values)
        found = self.diff(keyed([0.0, 0.25, 0.5, 0.75, 1.0]), keyed([0.0, 0.25, 1.0, 0.75, 1.0]))
        self.assertEqual([(each["kind"], each["object"], each["what"], each["a"], each["b"], each["amount"], each["frame"])
                          for each in found], [("curve", "paint", "DiffuseFactor", "0.5", "1", 0.5, 2),
                                               ("material", "paint", "DiffuseFactor", "0.5", "1", 0.5, 2)])

    def test_have_other_texture_files(self):
        found = self.only(self.changed(("bark.png", "oak.png")), "texture", "glass", "DiffuseColor")
        self.assertEqual((found["a"], found["b"]), ("bark.png", "oak.png"))
        found = self.only(self.changed(('C: "OP",5,4, "DiffuseColor"', "")), "texture", "glass", "DiffuseColor")
        self.assertEqual((found["a"], found["b"]), ("bark.png", None))
        # The folder of another machine, under the same relative name.
        self.assertEqual(self.changed(('FileName: "bark.png"', 'FileName: "D:\\textures\\bark.png"')), [])

    def test_of_files_before_7_0_have_the_textures_of_polygons(self):
        data = lambda version: os.path.join(SDK_DATA, f"materials_{version}_ascii.fbx")
        with open(data("6100"), encoding="utf-8") as stream:
            whole = stream.read()
        # All polygons have the texture there, so that "red" has it, too.
        found = [each for each in self.diff(data("6100"), data("7400")) if each["kind"] != "topology"]
        self.assertEqual([(each["kind"], each["object"], each["what"], each["a"], each["b"]) for each in found],
                         [("texture", "red", "DiffuseColor", "bark.png", None)])
        self.assertIn("red\"  DiffuseColor: bark.png → nothing\n", run("diff", data("6100"), data("7400")).stdout)
        element = whole[whole.index("LayerElementTexture: 0"):]
        element = element[:element.index("TextureId: 0")]
        one = element.replace('"AllSame"', '"ByPolygon"')
        self.assertNotEqual(element, one)
        other = self.file("b.fbx", whole.replace(element + "TextureId: 0", one + "TextureId: 0,-1,0"))
        found = [each for each in self.diff(other, data("7400")) if each["kind"] != "topology"]
        self.assertEqual(found, [])

    def test_have_textures_that_lie_otherwise(self):
        found = self.only(self.changed(('\t\tRelativeFilename: "bark.png"\n\t}\n\tVideo',
                                        '\t\tRelativeFilename: "bark.png"\n\t\tProperties70:  {\n'
                                        '\t\t\tP: "Scaling", "Vector", "", "A",2,2,1\n\t\t}\n\t}\n\tVideo')),
                          "texture", "bark", "Scaling")
        self.assertEqual((found["a"], found["b"], found["amount"]), ("(1, 1, 1)", "(2, 2, 1)", 1))


class Page(html.parser.HTMLParser):
    def __init__(self, text):
        super().__init__()
        self.tags, self.texts = [], []
        self.feed(text)

    def handle_starttag(self, tag, attrs):
        self.tags.append(tag)
        assert not any(name in ("src", "href") or name.startswith("on") for name, _ in attrs), attrs

    def handle_data(self, data):
        self.texts.append(data)


class Forms(Folder):
    def test_of_a_page_hold_names_as_names(self):
        a = self.file("a.fbx", scenes.scene())
        b = self.file("b<b>.fbx", scenes.scene(names=("cam", "<script>alert(1)</script>&amp;")))
        result = run("diff", "--html", a, b)
        self.assertEqual(result.returncode, 1)
        page = Page(result.stdout)
        self.assertNotIn("script", page.tags)
        self.assertNotIn("b", page.tags)
        self.assertIn("<script>alert(1)</script>&amp;", page.texts)
        self.assertNotIn("http", result.stdout)
        same = run("diff", "--html", a, a)
        self.assertEqual((same.returncode, "No difference" in same.stdout), (0, True))

    def test_of_lines_say_the_same_as_documents(self):
        a, b = self.file("a.fbx", scenes.scene()), self.file("b.fbx", scenes.scene(camera={"FocalLength": 50.0}))
        line = run("diff", "--jsonl", a, b).stdout
        self.assertEqual(line.count("\n"), 1)
        self.assertEqual(json.loads(line), json.loads(run("diff", "--json", a, b).stdout))
        self.assertIn('"cam"  focalLength: 35 → 50, 15 mm apart at frame 0', run("diff", a, b).stdout)

    def test_of_text_gather_the_curves_of_which_files_say_the_same(self):
        still = self.file("b.fbx", scenes.scene(keyed=False))
        turned = scenes.record("AnimationCurveNode", 40, "AnimCurveNode::R", "", {"d|Z": 0.0})
        a = self.file("a.fbx", scenes.scene(
            frames=(0, 4), values=[0.0, 0.0], objects=turned + scenes.curve(41, (0, 4), [0.0, 0.0], 24),
            connections='C: "OO",40,11\nC: "OP",40,1, "Lcl Rotation"\nC: "OP",41,40, "d|Z"\n'))
        self.assertEqual(len([each for each in self.diff(a, still) if each["kind"] == "curve"]), 2)
        self.assertIn('"cam"  Lcl Rotation.Z, Lcl Translation.X: 2 keys → not keyed\n', run("diff", a, still).stdout)

    def test_of_text_do_not_say_a_kind_twice(self):
        a, b = self.file("a.fbx", scenes.scene()), self.file("b.fbx", scenes.scene(unit=100.0))
        self.assertIn("  unit       centimetre → metre\n", run("diff", a, b).stdout)

    def test_of_the_readme_is_what_is_printed(self):
        self.file("old.fbx", scenes.scene())
        self.file("new.fbx", scenes.scene(names=("shotCam", "tri"), frames=(0, 4), values=[0.5, 4.5],
                                          camera={"FocalLength": 50.0}))
        with open(os.path.join(ROOT, "README.md"), encoding="utf-8") as stream:
            self.assertIn("$ tarnell-fbx diff old.fbx new.fbx\n" + run("diff", "old.fbx", "new.fbx", cwd=self.folder).stdout,
                          stream.read())

    def test_of_standard_input(self):
        text = scenes.scene()
        a = self.file("a.fbx", text)
        for arguments in (("-", a), (a, "-")):
            self.assertEqual(run("diff", *arguments, input=text).returncode, 0)
        self.assertEqual(run("diff", "-", "-", input=text).returncode, 2)


class Failures(Folder):
    def test_are_none_of_takes_that_claim_billions_of_frames_for_what_stands_still(self):
        still = scenes.scene(span=(0, 2400000000), keyed=False)
        self.assertEqual(self.diff(still, still), [])
        other = scenes.scene(span=(0, 2400000000), keyed=False, camera={"FocalLength": 50.0})
        self.assertIn("focalLength", [each["what"] for each in self.diff(still, other)])

    def test_of_materials_keyed_over_billions_of_frames_are_prompt(self):
        text = scenes.scene(span=(0, 2400000000), objects=scenes.record("Material", 30, "Material::paint", "", {
            "DiffuseFactor": 1.0}), connections='C: "OO",30,20\n', on=30, animated="DiffuseFactor",
                            channel="d|DiffuseFactor")
        a, b = self.file("a.fbx", text), self.file("b.fbx", text)
        result = run("diff", a, b)
        self.assertEqual((result.returncode, result.stdout), (1, ""))
        self.assertIn("frames, but at most 16777216 are compared", result.stderr)

    def test_name_the_file(self):
        missing = os.path.join(self.folder, "missing.fbx")
        for arguments in ((SHOT, missing), (missing, SHOT)):
            result = run("diff", *arguments)
            self.assertEqual((result.returncode, result.stdout), (1, ""))
            self.assertIn("missing.fbx", result.stderr)
            page = json.loads(run("diff", "--json", *arguments).stdout)
            self.assertEqual(list(page), ["format", "a", "b", "error"])
            self.assertIn("missing.fbx", page["error"])

    def test_of_a_take_that_one_has_not(self):
        result = run("diff", "--take", "nosuch", SHOT, SHOT)
        self.assertEqual((result.returncode, result.stdout), (1, ""))
        self.assertIn('"Scene"', result.stderr)

    def test_of_tolerances_that_are_none(self):
        for tolerance in ("-1", "nan", "inf", "", "x", "1x"):
            result = run("diff", "--tolerance", tolerance, SHOT, SHOT)
            self.assertEqual((result.returncode, result.stdout), (2, ""), tolerance)


unittest.main(argv=[__file__], verbosity=0)
