# SPDX-License-Identifier: MIT
# Copyright (c) Tarnell FBX contributors
#
# The document that dump prints: every key in its place, every word and every number, for the small hand-written files.
# Other programs check by it what the library reads. What is expected here follows from the content of the files; the
# functions below say what that is.
import json
import math
import os
import sys
import tempfile
import unittest

from support import ROOT, SDK_DATA, dump, edited, float32, named, run

MOVING = os.path.join(ROOT, "tests", "data", "tool", "moving_triangle.fbx")
KINDS = "lights,markers,nulls,transforms,meshes"
NAN, INFINITY = "nan", "inf"  # as the files spell them


def fixture(name):
    return os.path.join(SDK_DATA, name)


def parsed(text):
    """JSON with objects as lists of pairs, so that their order counts, and numbers as the floats they stand for."""
    def number(digits):
        return float32(float(digits))
    return json.loads(text, object_pairs_hook=lambda pairs: ("object", pairs), parse_int=number,
                      parse_float=number)


def expected(value):
    """What `parsed` makes of a document."""
    return parsed(json.dumps(value))


# ---- What the files hold ----

def animated(samples, start=0):
    """A channel with one sample per frame from the first on, at the 24 frames per second of all files."""
    return {"value": samples[0], "start": start, "end": start + len(samples) - 1, "rate": 24, "samples": samples}


def world(x=0, y=0, z=0, tilt=0, frames=1):
    """The transform in the world of an object that stands still and is not scaled. Position, rotation and scale are
    evaluated at every frame of the stack (a file without stack has the one frame 0); skew and pivot are never read."""
    channels = {}
    for kind, values in (("position", (x, y, z)), ("rotation", (tilt, 0, 0)), ("scale", (1, 1, 1))):
        channels.update({kind + axis: animated([value] * frames) for axis, value in zip("XYZ", values)})
    channels.update({kind + axis: 0 for kind in ("skew", "pivot") for axis in "XYZ"})
    return channels


def local(x=0, y=0, z=0):
    """The local transform of an object without keys: nine numbers, and the six that are never read."""
    channels = {"positionX": x, "positionY": y, "positionZ": z}
    for kind, value in (("rotation", 0), ("scale", 1), ("skew", 0), ("pivot", 0)):
        channels.update({kind + axis: value for axis in "XYZ"})
    return channels


def item(name, transform, **rest):
    """An object read in the world: its angles are always in the order ZXY."""
    return {"name": name, "rotationOrder": "ZXY", "transform": transform, **rest}


def page(file, span=None, **kinds):
    """A document of all kinds but cameras, of a file whose stack is "Take 001" or that has none and gets it."""
    document = {"file": file, "stacks": ["Take 001"], "range": span}
    document.update({kind: kinds.get(kind, []) for kind in KINDS.split(",")})
    return document


def lights_page():
    """Four lights at X 1, 2, 3, and the last one, an area light, at 4 below the third; types and decays 0 to 3 in turn.
    All are orange; intensities are 100, 50, 0 to 200 over frames 0 to 2, and 200 percent. Only the spot states a cone,
    the others have the 45 degrees of a light that states none. What shines along an axis of its own is tilted."""
    def light(name, x, tilt, kind, decay, intensity, cone=45):
        return item(name, world(x, tilt=tilt, frames=3), type=kind, decay=decay, channels={
            "red": 1, "green": 0.5, "blue": 0.25, "alpha": 1, "intensity": intensity, "cone angle": cone})
    spot = {**animated([0, 1, 2]), "value": 1}  # the property says 100 percent
    return page("lights_7400_ascii.fbx", {"start": 0, "end": 2 / 24}, lights=[
        light("point", 1, 0, "point", "none", 1), light("directional", 2, -90, "directional", "linear", 0.5),
        light("spot", 3, -90, "spot", "quadratic", spot, 30), light("area", 7, 0, "point", "cubic", 2)])


def markers_page():
    """A sphere of size 12 and colour (¼, ½, ¾) at X 1; a capsule at X 2 that says no more, so it has the size 100 and
    the grey of 0.8 of a marker that states none. Markers are transforms too."""
    def marker(name, x, size, look, red, green, blue):
        return item(name, world(x), size=size, look=look,
                    channels={"red": red, "green": green, "blue": blue, "alpha": 1})
    return page("markers_7400_ascii.fbx", markers=[marker("sphere", 1, 12, "sphere", 0.25, 0.5, 0.75),
                                                   marker("capsule", 2, 100, "cube", 0.8, 0.8, 0.8)],
                transforms=[item("sphere", world(1)), item("capsule", world(2))])


def nulls_page():
    """A null of size 25 at (1, 2, 3), and 10 along X from it a node without attribute: a null of size 1."""
    return page("nulls_7400_ascii.fbx", nulls=[item("parent", world(1, 2, 3), size=25, look="cross"),
                                               item("child", world(11, 2, 3), size=1, look="cross")],
                transforms=[item("parent", world(1, 2, 3)), item("child", world(11, 2, 3))])


def mesh_page():
    """A quad and a triangle on it, 10 along X. Texture coordinates are indexed 0, 1, 2, 3 and 3, 2, 4; the quad has the
    first of two colours, and its normals the other direction than the triangle's."""
    first, second = [1, 0.5, 0.25, 1], [0, 0.25, 0.5, 0.75]
    return page("mesh_7400_ascii.fbx", transforms=[item("shape", world(10))], meshes=[item(
        "shape", world(10), frame=0, polygonVertexSizes=[4, 3], pointIndices=[0, 1, 2, 3, 3, 2, 4],
        controlPoints=[10, 0, 0, 11, 0, 0, 11, 1, 0, 10, 1, 0, 10, 2, 0],
        normals=[0, 0, 1] * 4 + [0, 0, -1] * 3,
        uvs=[0, 0, 1, 0, 1, 0.5, 0, 0.5] + [0, 0.5, 1, 0.5, 0, 1],
        colours=first * 4 + second * 3)])


def camera_page():
    """A camera that goes from X 0 to 9 over frames 1001 to 1010 and zooms from 35 to 80 mm, turned by (10, 20, 30) in
    the order of a node that states none. Its film measures 1.5 by 0.75 inches, and its lens is driven by the focal
    length, so its fields of view are those of a camera that was never read into."""
    transform = local()
    transform.update(positionX=animated(list(range(10)), 1001), rotationX=10, rotationY=20, rotationZ=30)
    channels = {"lookAtPositionX": 0, "lookAtPositionY": 0, "lookAtPositionZ": 0,
                "upPositionX": 0, "upPositionY": 1, "upPositionZ": 0, "roll": 0,
                "focalLength": animated(list(range(35, 81, 5)), 1001), "apertureWidth": 1.5, "apertureHeight": 0.75,
                "nearPlane": 0.5, "farPlane": 5000, "filedOfView": 25.115, "filedOfViewX": 40, "filedOfViewY": 40,
                "filmOffsetX": 0, "filmOffsetY": 0}
    return {"file": "camera_7400_ascii.fbx", "stacks": ["Shot"], "range": {"start": 1001 / 24, "end": 1010 / 24},
            "cameras": [{"name": "shot", "rotationOrder": "XYZ", "transform": transform, "projection": "perspective",
                         "apertureMode": "focalLength", "channels": channels}]}


class Document(unittest.TestCase):
    maxDiff = None

    def setUp(self):
        folder = tempfile.TemporaryDirectory()
        self.addCleanup(folder.cleanup)
        self.file = os.path.join(folder.name, "edited.fbx")

    def printed(self, *arguments):
        result = run("dump", *arguments)
        self.assertEqual((result.returncode, result.stderr), (0, ""))
        return result.stdout

    def edited(self, name, *replacements):
        return edited(name, self.file, *replacements)


class WholeDocument(Document):
    def test_of_lights_markers_nulls_and_a_mesh(self):
        for document in (lights_page(), markers_page(), nulls_page(), mesh_page()):
            with self.subTest(document["file"]):
                self.assertEqual(parsed(self.printed("--kind", KINDS, fixture(document["file"]))), expected(document))

    def test_of_a_camera(self):
        printed = self.printed("--kind", "cameras", "--name", "shot", fixture("camera_7400_ascii.fbx"))
        self.assertEqual(parsed(printed), expected(camera_page()))

    def test_of_local_transforms(self):
        document = nulls_page()
        for kind in ("nulls", "transforms"):
            for each, place in zip(document[kind], (local(1, 2, 3), local(10))):
                each.update(rotationOrder="XYZ", transform=place)  # the order of a node that states none
        printed = self.printed("--local", "--kind", KINDS, fixture("nulls_7400_ascii.fbx"))
        self.assertEqual(parsed(printed), expected(document))

    def test_is_one_line_or_indented_by_two(self):
        file = fixture("nulls_7400_ascii.fbx")
        plain = self.printed("--kind", KINDS, file)
        self.assertEqual(plain, json.dumps(json.loads(plain), separators=(",", ":")) + "\n")
        pretty = self.printed("--pretty", "--kind", KINDS, file)
        self.assertEqual(pretty, json.dumps(json.loads(plain), indent=2) + "\n")


class Words(Document):
    def words(self, name, old, numbers, kind, key, *arguments):
        """What a key of the first object of a kind says for each number of a property."""
        words = []
        for number in numbers:
            file = self.edited(name, (f"{old},{number[0]}", f"{old},{number[1]}"))
            words.append(dump("--kind", kind, *arguments, file)[kind][0][key])
        return words

    def test_of_markers(self):
        # Number 4 is a capsule, and what is no shape of its own reads as a cube.
        self.assertEqual(self.words("markers_7400_ascii.fbx", '"Look", "enum", "", ""',
                                    [(3, 0), (3, 1), (3, 2), (3, 3), (3, 5)], "markers", "look"),
                         ["cube", "hardCross", "lightCross", "sphere", "cube"])

    def test_of_nulls(self):
        self.assertEqual(self.words("nulls_7400_ascii.fbx", '"Look", "enum", "", ""', [(1, 0), (1, 1)], "nulls",
                                    "look"), ["none", "cross"])

    def test_of_projections_and_aperture_modes(self):
        # A camera whose lens is driven by one field of view is read as one that is driven by its focal length.
        self.assertEqual(self.words("camera_7400_ascii.fbx", '"ApertureMode", "enum", "", ""',
                                    [(3, 0), (3, 1), (3, 2), (3, 3)], "cameras", "apertureMode", "--name", "shot"),
                         ["horizontalAndVertical", "focalLength", "focalLength", "focalLength"])
        mode = 'P: "ApertureMode", "enum", "", "",3\n'
        projections = []
        for number in (0, 1):
            file = self.edited("camera_7400_ascii.fbx",
                               (mode, f'{mode}P: "CameraProjectionType", "enum", "", "",{number}\n'))
            projections.append(dump("--kind", "cameras", "--name", "shot", file)["cameras"][0]["projection"])
        self.assertEqual(projections, ["perspective", "orthographic"])

    def test_of_rotation_orders(self):
        # Files number YZX before YXZ, and the last number is that of spherical angles, which read as XYZ.
        place = 'P: "Lcl Translation", "Lcl Translation", "", "A",1,2,3\n'
        words = []
        for number in range(7):
            file = self.edited("nulls_7400_ascii.fbx",
                               (place, f'{place}P: "RotationOrder", "enum", "", "",{number}\n'
                                       'P: "RotationActive", "bool", "", "",1\n'))
            words.append(dump("--local", "--kind", "nulls", file)["nulls"][0]["rotationOrder"])
        self.assertEqual(words, ["XYZ", "XZY", "YZX", "YXZ", "ZXY", "ZYX", "XYZ"])


class Numbers(Document):
    # Neighbours in the last bit, the smallest, the largest, both zeros, and numbers that need all of nine digits.
    HARD = ["0.1", "0.10000001", "0.099999994", "0.333333343", "16777215", "8388607.5", "1e-45", "1.17549435e-38",
            "3.40282347e+38", "-3.40282347e+38", "123456.789", "-0.0", "0", "1015.21014", "1001687.25"]

    def points(self, numbers):
        """The control points of the mesh of five points, as its file would hold these 15 numbers."""
        file = self.edited("mesh_7400_ascii.fbx", ("a: 0,0,0,1,0,0,1,1,0,0,1,0,0,2,0", "a: " + ",".join(numbers)))
        _, document = parsed(self.printed("--kind", "meshes", "--no-transform-points", file))
        _, mesh = dict(document)["meshes"][0]
        return dict(mesh)["controlPoints"]

    def test_read_back_as_the_same_floats(self):
        points = self.points(self.HARD)
        self.assertEqual([float.hex(number) for number in points],
                         [float.hex(float32(float(text))) for text in self.HARD])

    def test_that_are_none_are_null_in_arrays(self):
        numbers = [NAN, INFINITY, "-inf", "1.#QNAN", "1.#INF", "-1.#INF", "1e39", "-1e39"] + ["1"] * 7
        self.assertEqual(self.points(numbers), [None] * 8 + [1] * 7)

    def test_that_are_none_are_null_in_every_array_of_a_mesh(self):
        file = self.edited("mesh_7400_ascii.fbx", ("a: 0,0,1,0,0,1,", "a: 0,nan,1,0,0,-inf,"),
                           ("a: 0,0,1,0,1,0.5,", "a: inf,0,1,nan,1,0.5,"), ("a: 1,0.5,0.25,1,", "a: 1,nan,inf,1,"))
        mesh = dump("--kind", "meshes", "--no-transform-points", file)["meshes"][0]
        self.assertEqual(mesh["normals"][:6], [0, None, 1, 0, 0, None])
        self.assertEqual(mesh["uvs"][:4], [None, 0, 1, None])
        self.assertEqual(mesh["colours"][:4], [1, None, None, 1])

    def test_that_are_none_are_null_in_objects_and_channels(self):
        for number in (NAN, INFINITY, "-inf"):
            file = self.edited("nulls_7400_ascii.fbx", ('"Number", "",25', f'"Number", "",{number}'),
                               ('"A",1,2,3', f'"A",1,{number},3'))
            null = dump("--local", "--kind", "nulls", file)["nulls"][0]
            self.assertIsNone(null["size"])
            self.assertEqual([null["transform"]["position" + axis] for axis in "XYZ"], [1, None, 3])

    def test_that_are_none_are_null_in_samples(self):
        file = self.edited("lights_7400_ascii.fbx", ("a: 0,200", "a: 0,inf"),
                           ('"DecayType", "enum", "", "",2\n\t\t\tP: "Intensity", "Number", "", "A",100',
                            '"DecayType", "enum", "", "",2\n\t\t\tP: "Intensity", "Number", "", "A",nan'))
        spot = named(dump("--kind", "lights", file)["lights"], "spot")["channels"]["intensity"]
        self.assertIsNone(spot["value"])
        self.assertEqual((len(spot["samples"]), spot["samples"][0], spot["samples"][2]), (3, 0, None))


class Absences(Document):
    def test_of_a_layers_data_are_null(self):
        # Without vertex colours those of materials are read, but not of one for the whole mesh.
        for key, element in (("normals", "Normal"), ("uvs", "UV"), ("colours", "Color")):
            with self.subTest(key):
                file = self.edited("mesh_7400_ascii.fbx", (f"LayerElement{element}: 0 {{", "SomethingElse: 0 {"))
                mesh = dump("--kind", "meshes", file)["meshes"][0]
                self.assertEqual([name for name in ("normals", "uvs", "colours") if mesh[name] is None], [key])

    def test_of_animation_is_a_null_range(self):
        for name in ("nulls", "markers", "mesh"):
            self.assertIsNone(dump(fixture(f"{name}_7400_ascii.fbx"))["range"])


class Options(Document):
    def test_compute_camera_rotation(self):
        # The camera moves along X from 0 to 9; its interest stays at (0, 0, -100), to which it turns to the left.
        file = fixture("camera_7400_ascii.fbx")
        camera = dump("--compute-camera-rotation", "--kind", "cameras", "--name", "shot", file)["cameras"][0]
        self.assertEqual([camera["channels"]["lookAtPosition" + axis] for axis in "XYZ"], [0, 0, -100])
        self.assertEqual(camera["rotationOrder"], "ZXY")
        rotation = [camera["transform"]["rotation" + axis] for axis in "XYZ"]
        self.assertEqual([(channel["start"], channel["end"]) for channel in rotation], [(1001, 1010)] * 3)
        for x, angles in enumerate(zip(*(channel["samples"] for channel in rotation))):
            for seen, wanted in zip(angles, (0, math.degrees(math.atan2(x, 100)), 0)):
                self.assertAlmostEqual(seen, wanted, places=4)

    def frames(self, *arguments):
        """Frame and X of the first point of the triangle that moves along X, by 2 per frame from 0 at frame 1001 on."""
        return [(mesh["frame"], round(mesh["controlPoints"][0], 3))
                for mesh in dump("--kind", "meshes", *arguments, MOVING)["meshes"]]

    def test_frames(self):
        self.assertEqual(self.frames("--frame", "1004"), [(1004, 6)])
        self.assertEqual(self.frames("--frame", "1004.5"), [(1004.5, 7)])
        self.assertEqual(self.frames("--frames", "1004"), [(1004, 6)])
        self.assertEqual(self.frames("--frames", "1004:1006"), [(1004, 6), (1005, 8), (1006, 10)])

    def test_a_range_of_frames_goes_before_a_frame(self):
        for arguments in (("--frame", "1009", "--frames", "1004:1005"), ("--frames", "1004:1005", "--frame", "1009")):
            self.assertEqual(self.frames(*arguments), [(1004, 6), (1005, 8)])

    def test_a_name_picks_one_object_of_each_kind_that_bears_it(self):
        connection = 'C: "OO",2,0\n'
        second = ('Geometry: 11, "Geometry::other", "Mesh" {\n\tVertices: *9 {\n\t\ta: 0,0,0,1,0,0,0,1,0\n\t}\n'
                  '\tPolygonVertexIndex: *3 {\n\t\ta: 0,1,-3\n\t}\n\tGeometryVersion: 124\n}\n'
                  'Model: 12, "Model::other", "Mesh" {\n\tVersion: 232\n}\nGeometry: 1,')
        meshes = self.edited("mesh_7400_ascii.fbx", ("Geometry: 1,", second),
                             (connection, connection + 'C: "OO",12,0\nC: "OO",11,12\n'))
        for file, name, kinds in (
                (fixture("lights_7400_ascii.fbx"), "spot", ["lights"]),
                (fixture("markers_7400_ascii.fbx"), "capsule", ["markers", "transforms"]),
                (fixture("nulls_7400_ascii.fbx"), "child", ["nulls", "transforms"]),
                (meshes, "shape", ["transforms", "meshes"]), (meshes, "other", ["transforms", "meshes"]),
                (fixture("camera_7400_ascii.fbx"), "shot", ["cameras"]), (meshes, "Producer Top", ["cameras"])):
            with self.subTest(name):
                everything, picked = dump(file), dump("--name", name, file)
                self.assertEqual(list(picked), list(everything))
                for kind in list(picked)[3:]:
                    wanted = [each for each in everything[kind] if each["name"] == name]
                    self.assertEqual(len(wanted), 1 if kind in kinds else 0)
                    self.assertEqual(picked[kind], wanted)
        result = run("dump", "--name", "Shape", meshes)  # "shape" is another name
        self.assertEqual((result.returncode, result.stdout), (1, ""))


unittest.main(argv=sys.argv[:1], verbosity=0)
