# SPDX-License-Identifier: MIT
# Copyright (c) Tarnell FBX contributors
#
# How much memory loading a file takes: never more than 64 MiB and 1,100 times the size of the file, whatever the file
# demands. Objects of a kind that the file does not have are read, so that nothing is returned.
import os
import sys
import tempfile
import unittest

from support import peak_of

NUMBERS = "*{} {{\na: {}\n}}\n"


def numbers(values):
    values = list(values)
    return NUMBERS.format(len(values), ",".join(map(str, values)))


def model(number, kind):
    return f'Model: {number}, "Model::m{number}", "{kind}" {{\nVersion: 232\n}}\n'


def triangles(points):
    corners = (c for i in range(points - 2) for c in (i, i + 1, -(i + 2) - 1))
    return f"Vertices: {numbers(i % 97 for i in range(3 * points))}PolygonVertexIndex: {numbers(corners)}"


def surface(step_u, step_v):
    return (f'NurbOrder: 2,2\nDimensions: 2,2\nStep: {step_u},{step_v}\nForm: "Open","Open"\n'
            f"Points: {numbers((0, 0, 0, 1, 1, 0, 0, 1, 0, 1, 0, 1, 1, 1, 0, 1))}"
            f"KnotVectorU: {numbers((0, 0, 1, 1))}KnotVectorV: {numbers((0, 0, 1, 1))}")


def geometries(count, kind, body):
    """So many models with a geometry each."""
    objects = (f'Geometry: {100 + 2 * i}, "Geometry::", "{kind}" {{\n{body}}}\n{model(101 + 2 * i, kind)}'
               for i in range(count))
    connections = (f'C: "OO",{101 + 2 * i},0\nC: "OO",{100 + 2 * i},{101 + 2 * i}\n' for i in range(count))
    return objects, connections


def instances(count):
    objects = [f'Geometry: 10, "Geometry::", "Mesh" {{\n{triangles(6000)}}}\n',
               *(model(100 + i, "Mesh") for i in range(count))]
    return objects, (f'C: "OO",{100 + i},0\nC: "OO",10,{100 + i}\n' for i in range(count))


def nulls(count):
    return (model(100 + i, "Null") for i in range(count)), (f'C: "OO",{100 + i},0\n' for i in range(count))


def plain(record, name_class, count):
    return (f'{record}: {100 + i}, "{name_class}::o{i}", "" {{\n}}\n' for i in range(count)), ()


CASES = {
    "surfaces of few points that ask for many steps": lambda: geometries(1000, "Nurb", surface(127, 127)),
    "surfaces that ask for steps in one direction": lambda: geometries(1000, "Nurb", surface(16000, 1)),
    "many small meshes": lambda: geometries(10_000, "Mesh", triangles(3)),
    "a mesh on many nodes": lambda: instances(3000),
    "many nodes": lambda: nulls(50_000),
    "many stacks": lambda: plain("AnimationStack", "AnimStack", 30_000),
    "many layers": lambda: plain("AnimationLayer", "AnimLayer", 30_000),
    "many materials": lambda: plain("Material", "Material", 30_000),
}


class Loading(unittest.TestCase):
    def setUp(self):
        folder = tempfile.TemporaryDirectory()
        self.addCleanup(folder.cleanup)
        self.file = os.path.join(folder.name, "case.fbx")

    def write(self, objects, connections):
        with open(self.file, "w", encoding="utf-8") as file:
            file.write("; FBX 7.4.0 project file\nFBXHeaderExtension: {\nFBXVersion: 7400\n}\nObjects: {\n")
            file.writelines(objects)
            file.write("}\nConnections: {\n")
            file.writelines(connections)
            file.write("}\n")

    def test_takes_no_more_than_the_file_allows(self):
        for name, make in CASES.items():
            with self.subTest(name):
                self.write(*make())

                status, peak, complaint = peak_of("dump", "--kind", "lights", self.file)

                self.assertEqual((status, complaint), (0, ""))
                self.assertLess(peak, (64 << 20) + 1100 * os.path.getsize(self.file))

    def test_meshes_of_surfaces_take_little_beyond(self):
        self.write(*geometries(300, "Nurb", surface(127, 127)))

        status, peak, _ = peak_of("dump", "--kind", "meshes", self.file)

        self.assertEqual(status, 0)
        self.assertLess(peak, 600 << 20)

    def test_what_is_no_file_of_ours_is_refused_unread(self):
        with open(self.file, "wb") as file:
            file.truncate(6 << 30)  # zeros that take no room on the disk

        status, peak, complaint = peak_of("info", self.file)

        self.assertEqual(status, 1)
        self.assertRegex(complaint, "neither a binary nor an ASCII FBX file")
        self.assertLess(peak, 64 << 20)


unittest.main(argv=sys.argv[:1], verbosity=0)
