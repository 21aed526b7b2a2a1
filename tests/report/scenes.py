# SPDX-License-Identifier: MIT
# Copyright (c) Tarnell FBX contributors
#
# Files for the tests of reports, written as text.
#   scenes.py FOLDER TOOL: all of them, large.fbx binary and of about 20 MB
import os
import random
import subprocess
import sys

SECOND = 46186158000

# What would be markup, end the element around it, leave a text, write on a terminal or turn the direction of writing.
NAMES = ["<script>window.hacked=1</script>", "</script><img src=x onerror=window.hacked=1>", "<!-- <script>", "a&b &amp;",
         "it's \\ `${1}`", "tab\tbell\x07", "\u202egnp.exe", "]]> --> \u2028", "Größe 東京"]


def document(objects, connections, take=None):
    """A file of version 7.4; objects are texts, connections pairs of ids."""
    header = """; FBX 7.4.0 project file
FBXHeaderExtension:  {
	FBXHeaderVersion: 1003
	FBXVersion: 7400
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
		P: "UnitScaleFactor", "double", "Number", "",1
		P: "TimeMode", "enum", "", "",11
	}
}
"""
    if take:
        name, frames = take
        objects = [*objects, f"""	AnimationStack: 900, "AnimStack::{name}", "" {{
		Properties70:  {{
			P: "LocalStop", "KTime", "Time", "",{SECOND * frames // 24}
		}}
	}}
	AnimationLayer: 901, "AnimLayer::Base", "" {{
	}}
"""]
        connections = [*connections, (901, 900)]
    links = "".join(f'	C: "OO",{child},{parent}\n' for child, parent in connections)
    return header + "Objects:  {\n" + "".join(objects) + "}\nConnections:  {\n" + links + "}\n"


def model(number, name, kind, properties=""):
    name = name.replace('"', "&quot;").replace("\n", "&lf;")
    return f'\tModel: {number}, "Model::{name}", "{kind}" {{\n\t\tProperties70:  {{\n{properties}\t\t}}\n\t}}\n'


def mesh(number, points, polygons):
    corners = [corner if i + 1 < len(polygon) else -corner - 1 for polygon in polygons
               for i, corner in enumerate(polygon)]
    return (f'\tGeometry: {number}, "Geometry::", "Mesh" {{\n'
            f'\t\tVertices: *{len(points)} {{\n\t\t\ta: {",".join(map(repr, points))}\n\t\t}}\n'
            f'\t\tPolygonVertexIndex: *{len(corners)} {{\n\t\t\ta: {",".join(map(str, corners))}\n\t\t}}\n'
            f'\t\tGeometryVersion: 124\n\t}}\n')


def scene_of_names():
    """A null of each name, and a camera, a light and a mesh of the first one."""
    objects = [model(i + 1, name, "Null") for i, name in enumerate(NAMES)]
    connections = [(i + 1, 0) for i in range(len(NAMES))]
    for number, kind in ((101, "Camera"), (102, "Light"), (103, "Mesh")):
        objects.append(model(number, NAMES[0], kind))
        connections.append((number, 0))
    objects += ['\tNodeAttribute: 201, "NodeAttribute::", "Camera" {\n\t\tTypeFlags: "Camera"\n\t}\n',
                '\tNodeAttribute: 202, "NodeAttribute::", "Light" {\n\t\tTypeFlags: "Light"\n\t}\n',
                mesh(203, [0, 0, 0, 1, 0, 0, 0, 1, 0], [(0, 1, 2)])]
    connections += [(201, 101), (202, 102), (203, 103)]
    return document(objects, connections, take=(NAMES[0], 10))


def scene_of_orders():
    """A camera for each rotation order, all with the same angles, under a parent that is turned, scaled and moved."""
    turned = ('\t\t\tP: "Lcl Translation", "Lcl Translation", "", "A",1,2,3\n'
              '\t\t\tP: "Lcl Rotation", "Lcl Rotation", "", "A",10,20,30\n')
    objects = [model(1, "parent", "Null", turned + '\t\t\tP: "Lcl Scaling", "Lcl Scaling", "", "A",2,2,2\n')]
    connections = [(1, 0)]
    for order in range(6):
        active = '\t\t\tP: "RotationActive", "bool", "", "",1\n'
        objects.append(model(10 + order, f"order{order}", "Camera",
                             turned + active + f'\t\t\tP: "RotationOrder", "enum", "", "",{order}\n'))
        objects.append(f'\tNodeAttribute: {20 + order}, "NodeAttribute::", "Camera" {{\n\t\tTypeFlags: "Camera"\n\t}}\n')
        connections += [(10 + order, 1), (20 + order, 10 + order)]
    return document(objects, connections)


def scene_of_corners():
    """Two corners in one plane: a polygon that is concave, and one whose last corner is not finite."""
    points = [0, 0, 0, 4, 0, 0, 4, 1, 0, 1, 1, 0, 1, 4, 0, 0, 4, 0]
    text = mesh(2, [*points, 0, 0, 0], [(0, 1, 2, 3, 4, 5), (0, 1, 6)])
    return document([model(1, "corner", "Mesh"), text.replace(",0,0,0\n", ",0,0,1.#INF\n")], [(1, 0), (2, 1)])


def sheet(side, seed=1):
    """A square of uneven ground, of side × side quads."""
    height = random.Random(seed)
    points = [c for z in range(side + 1) for x in range(side + 1) for c in (x, round(height.random(), 12), z)]
    quads = [(z * (side + 1) + x, z * (side + 1) + x + 1, (z + 1) * (side + 1) + x + 1, (z + 1) * (side + 1) + x)
             for z in range(side) for x in range(side)]
    return points, quads


def large_scene(side=1150):
    return document([model(1, "ground", "Mesh"), mesh(2, *sheet(side))], [(1, 0), (2, 1)])


def write(path, text):
    with open(path, "w", encoding="utf-8", newline="\n") as stream:
        stream.write(text)
    return path


if __name__ == "__main__":
    folder, tool = sys.argv[1:]
    os.makedirs(folder, exist_ok=True)
    write(os.path.join(folder, "names.fbx"), scene_of_names())
    write(os.path.join(folder, "orders.fbx"), scene_of_orders())
    text = write(os.path.join(folder, "large_text.fbx"), large_scene())
    subprocess.run([tool, "convert", "--force", text, os.path.join(folder, "large.fbx")], check=True)
    os.remove(text)
