# SPDX-License-Identifier: MIT
# Copyright (c) Tarnell FBX contributors
#
# Writes the files next to it: `clean.fbx`, in which lint finds only that it is ASCII, and one file per rule with
# the one thing in it that the rule is about. Called as: make_lint_files.py
import os

FOLDER = os.path.dirname(os.path.abspath(__file__))
TICKS = 46186158000  # per second

CAMERA = {"FilmWidth": 1.6, "FilmHeight": 0.9, "FilmAspectRatio": 16 / 9, "AspectWidth": 1920.0, "AspectHeight": 1080.0,
          "AspectRatioMode": 2, "ApertureMode": 3, "FocalLength": 35.0, "NearPlane": 1.0, "FarPlane": 10000.0,
          "InterestPosition": (100.0, 0.0, 0.0)}
AXES = (("UpAxis", 1), ("UpAxisSign", 1), ("FrontAxis", 2), ("FrontAxisSign", 1), ("CoordAxis", 0), ("CoordAxisSign", 1))
NORMALS = """		LayerElementNormal: 0 {
			Version: 101
			Name: ""
			MappingInformationType: "ByPolygonVertex"
			ReferenceInformationType: "Direct"
			Normals: *9 {
				a: 0,0,1,0,0,1,0,0,1
			} 
		}
		Layer: 0 {
			Version: 100
			LayerElement:  {
				Type: "LayerElementNormal"
				TypedIndex: 0
			}
		}
"""


def numbers(values):
    return ",".join(repr(value) for value in values)


def line(name, value):
    if isinstance(value, tuple):
        return '\t\t\tP: "%s", "Vector3D", "Vector", "",%s\n' % (name, numbers(value))
    kind = '"enum", ""' if isinstance(value, int) else '"double", "Number"'
    return '\t\t\tP: "%s", %s, "",%s\n' % (name, kind, value if isinstance(value, str) else repr(value))


def properties(values):
    return "\t\tProperties70:  {\n" + "".join(line(*each) for each in values.items()) + "\t\t}\n" if values else ""


def record(kind, number, name, sub, values=None, more=""):
    return '\t%s: %d, "%s", "%s" {\n%s%s\t}\n' % (kind, number, name, sub, properties(values), more)


def curve(number, frames, values, rate):
    times = [round(frame * TICKS / rate) for frame in frames]
    return record("AnimationCurve", number, "AnimCurve::", "", more=(
        "\t\tDefault: 0\n\t\tKeyVer: 4009\n\t\tKeyTime: *%d {\n\t\t\ta: %s\n\t\t} \n\t\tKeyValueFloat: *%d {\n"
        "\t\t\ta: %s\n\t\t} \n\t\tKeyAttrFlags: *1 {\n\t\t\ta: 260\n\t\t} \n\t\tKeyAttrDataFloat: *4 {\n"
        "\t\t\ta: 0,0,218434821,0\n\t\t} \n\t\tKeyAttrRefCount: *1 {\n\t\t\ta: %d\n\t\t} \n") % (
            len(times), numbers(times), len(values), numbers(values), len(times)))


def take(number, name, span, rate):
    times = {} if span is None else dict(zip(("LocalStart", "LocalStop", "ReferenceStart", "ReferenceStop"), span * 2))
    text = "".join('\t\t\tP: "%s", "KTime", "Time", "",%d\n' % (key, round(frame * TICKS / rate))
                   for key, frame in times.items())
    return record("AnimationStack", number, "AnimStack::" + name, "", more="\t\tProperties70:  {\n" + text + "\t\t}\n")


def mesh(number, name, corners="0,1,-3", normals=NORMALS, points=((0, 0, 0), (1, 0, 0), (0, 1, 0))):
    flat = [each for point in points for each in point]
    count = corners.count(",") + 1 if corners else 0
    polygons = "\t\tPolygonVertexIndex: *%d {\n\t\t\ta: %s\n\t\t} \n" % (count, corners) if corners else ""
    return record("Geometry", number, "Geometry::" + name, "Mesh", more=(
        "\t\tVertices: *%d {\n\t\t\ta: %s\n\t\t} \n%s\t\tGeometryVersion: 124\n%s") % (
            len(flat), ",".join(str(each) for each in flat), polygons, normals if corners else ""))


def scene(version=7400, unit=1.0, axes=AXES, time_mode=11, rate=24, span=(0, 4), frames=(0, 1, 2, 3, 4),
          values=None, animated="Lcl Translation", channel="d|X", on=1, camera=None, camera_node=None, mesh_node=None,
          the_mesh=None, names=("cam", "tri"), objects="", connections="", keyed=True, taken=True):
    """One camera (1, 2) that moves along X in a take (10 to 13), and a triangle (20, 21) before it."""
    camera = {key: value for key, value in {**CAMERA, **(camera or {})}.items() if value is not None}
    values = values if values is not None else [float(frame) for frame in frames]
    settings = "".join('\t\tP: "%s", "int", "Integer", "",%d\n' % each for each in axes)
    text = ("; FBX %d.%d.0 project file\nFBXHeaderExtension:  {\n\tFBXHeaderVersion: 1003\n\tFBXVersion: %d\n"
            '\tCreator: "written by hand"\n}\nGlobalSettings:  {\n\tVersion: 1000\n\tProperties70:  {\n%s'
            '\t\tP: "UnitScaleFactor", "double", "Number", "",%r\n\t\tP: "TimeMode", "enum", "", "",%d\n\t}\n}\n'
            "Objects:  {\n") % (version // 1000, version // 100 % 10, version, settings, unit, time_mode)
    text += record("Model", 1, "Model::" + names[0], "Camera", camera_node)
    text += record("NodeAttribute", 2, "NodeAttribute::cam", "Camera", camera, '\t\tTypeFlags: "Camera"\n')
    text += record("Model", 20, "Model::" + names[1], "Mesh", mesh_node or {"Lcl Translation": (10.0, 0.0, 0.0)})
    text += the_mesh or mesh(21, "tri")
    links = 'C: "OO",1,0\nC: "OO",2,1\nC: "OO",20,0\nC: "OO",21,20\n'
    if taken:
        text += take(10, "shot", span, rate) + record("AnimationLayer", 11, "AnimLayer::base", "")
        links += 'C: "OO",11,10\n'
    if taken and keyed:
        text += record("AnimationCurveNode", 12, "AnimCurveNode::T", "", {channel: 0.0}) + curve(13, frames, values, rate)
        links += 'C: "OO",12,11\nC: "OP",12,%d, "%s"\nC: "OP",13,12, "%s"\n' % (on, animated, channel)
    text += objects + "}\nConnections:  {\n"
    return text + "".join("\t%s\n" % each for each in (links + connections).splitlines()) + "}\n"


def cached(file, **more):
    objects = (record("Deformer", 22, "Deformer::cache", "VertexCacheDeformer", more=(
        '\t\tVersion: 100\n\t\tProperties70:  {\n\t\t\tP: "ChannelName", "KString", "", "", "wave"\n\t\t}\n'))
               + record("Cache", 23, "Cache::cache", "", more=(
                   '\t\tVersion: 100\n\t\tProperties70:  {\n%s\t\t\tP: "CacheFileType", "enum", "", "",2\n\t\t}\n' % file)))
    return scene(objects=objects, connections='C: "OO",22,21\nC: "OO",23,22\n', **more)


def beside(name):
    return '\t\t\tP: "CacheFileName", "KString", "", "", "%s"\n' % name


def elsewhere(name):
    return '\t\t\tP: "CacheAbsoluteFileName", "KString", "", "", "%s"\n' % name


def null(number, name, values=None):
    return record("Model", number, "Model::" + name, "Null", values)


def with_nulls(*nulls, below=()):
    """Nulls (number, name, properties), each at the root but for pairs (child, parent)."""
    parents = dict(below)
    return scene(objects="".join(null(*each) for each in nulls),
                 connections="".join('C: "OO",%d,%d\n' % (each[0], parents.get(each[0], 0)) for each in nulls))


def with_takes(*takes, **more):
    """Further takes (name, span, frames at which something is keyed, or None, and what: number, property, channel), 30
    numbers to each."""
    objects, connections = "", ""
    for place, (name, span, frames, *what) in enumerate(takes):
        first = 30 * (place + 1)
        objects += take(first, name, span, 24) + record("AnimationLayer", first + 1, "AnimLayer::" + name, "")
        connections += 'C: "OO",%d,%d\n' % (first + 1, first)
        if frames:
            on, animated, channel = what or (1, "Lcl Translation", "d|X")
            objects += record("AnimationCurveNode", first + 2, "AnimCurveNode::T", "", {channel: 0.0})
            objects += curve(first + 3, frames, [float(frame) for frame in frames], 24)
            connections += ('C: "OO",%d,%d\nC: "OP",%d,%d, "%s"\nC: "OP",%d,%d, "%s"\n'
                            % (first + 2, first + 1, first + 2, on, animated, first + 3, first + 2, channel))
    return scene(objects=objects, connections=connections, **more)


Z_UP = (("UpAxis", 2), ("UpAxisSign", 1), ("FrontAxis", 1), ("FrontAxisSign", -1), ("CoordAxis", 0),
            ("CoordAxisSign", 1))

FILES = {
    "clean": lambda: scene(),
    "not-readable": lambda: scene(span=(0, 2400000000)),
    "repaired": lambda: scene(time_mode=14),
    "old-version": lambda: scene(version=7000),
    "unit-shifts-optics": lambda: scene(unit=100.0),
    "axes-shift-optics": lambda: scene(axes=Z_UP),
    "left-handed": lambda: scene(axes=AXES[:5] + (("CoordAxisSign", -1),)),
    "not-finite": lambda: scene(the_mesh=mesh(21, "tri", points=((0, 0, 0), (1, 0, 0), (0, "1e999", 0)))),
    "rate-unstated": lambda: scene(time_mode=0, rate=30),
    "keys-between-frames": lambda: scene(frames=(0, 1, 2.25, 3, 4)),
    "span-differs-from-keys": lambda: scene(span=(0, 10)),
    "take-without-span": lambda: scene(span=(0, 0)),
    "take-without-keys": lambda: with_takes(("still", (0, 4), None)),
    "several-takes": lambda: with_takes(("other", (0, 4), (0, 1, 2, 3, 4))),
    "several-layers": lambda: scene(objects=record("AnimationLayer", 31, "AnimLayer::more", ""),
                                    connections='C: "OO",31,10\n'),
    "rotation-flips": lambda: scene(animated="Lcl Rotation", values=[170.0, 175.0, 180.0, -175.0, -170.0],
                                    camera={"InterestPosition": None}),
    "lens-out-of-range": lambda: scene(camera={"FocalLength": 0.0}),
    "lens-values-disagree": lambda: scene(camera={"FieldOfViewX": 90.0}),
    "film-shape-differs": lambda: scene(camera={"AspectWidth": 1000.0, "GateFit": 3}),
    "film-format-disagrees": lambda: scene(camera={"FilmFormatIndex": 5}),
    "squeezed-film": lambda: scene(camera={"FilmWidth": 0.8, "FilmAspectRatio": 0.8 / 0.9, "FilmSqueezeRatio": 2.0}),
    "film-offset": lambda: scene(camera={"FilmOffsetX": 0.125}),
    "clip-planes": lambda: scene(camera={"NearPlane": 10.0, "FarPlane": 5.0}),
    "clip-planes-far-apart": lambda: scene(camera={"NearPlane": 0.0001, "FarPlane": 100000.0}),
    "camera-scale": lambda: scene(camera_node={"Lcl Scaling": (1.0, 2.0, 1.0)}),
    "roll-without-target": lambda: scene(camera={"Roll": 15.0}),
    "interest-elsewhere": lambda: scene(camera={"InterestPosition": (0.0, 0.0, -100.0)}),
    "image-shift-not-read": lambda: scene(camera={"PreScale": 1.5}),
    "no-resolution": lambda: scene(camera={"AspectWidth": None, "AspectHeight": None, "FilmAspectRatio": 1.6,
                                           "FilmWidth": 1.44}),
    "far-from-origin": lambda: scene(mesh_node={"Lcl Translation": (200000.0, 0.0, 0.0)}),
    "mesh-at-origin": lambda: scene(mesh_node={"Lcl Rotation": (0.0, 0.0, 30.0)}),
    "zero-scale": lambda: with_nulls((30, "flat", {"Lcl Scaling": (1.0, 0.0, 1.0)})),
    "mirrored-node": lambda: scene(mesh_node={"Lcl Translation": (10.0, 0.0, 0.0), "Lcl Scaling": (-1.0, 1.0, 1.0)}),
    "sheared-node": lambda: with_nulls((30, "wide", {"Lcl Scaling": (3.0, 1.0, 1.0)}),
                                       (31, "leaning", {"Lcl Rotation": (0.0, 0.0, 30.0), "InheritType": 1}),
                                       below=((31, 30),)),
    "inherited-scale": lambda: with_nulls((30, "big", {"Lcl Scaling": (3.0, 3.0, 3.0)}), (31, "free", {"InheritType": 2}),
                                          below=((31, 30),)),
    "duplicate-names": lambda: scene(names=("twin", "twin")),
    "unnamed-nodes": lambda: scene(names=("cam", "")),
    "odd-names": lambda: scene(names=("cam", "tri\x07")),
    "unparented-nodes": lambda: scene(objects=null(30, "stray") + null(31, "below"), connections='C: "OO",31,30\n'),
    "constraints": lambda: scene(objects=record("Constraint", 30, "Constraint::aim", "Aim")),
    "curve-that-stops-three-js": lambda: scene(animated="FilmOffsetX", channel="d|FilmOffsetX", on=2,
                                               values=[0.0, 0.1, 0.2, 0.3, 0.4]),
    "polygons-out-of-range": lambda: scene(the_mesh=mesh(21, "tri", corners="0,1,-8")),
    "small-polygons": lambda: scene(the_mesh=mesh(21, "tri", corners="0,1,-3,0,-2")),
    "mesh-without-polygons": lambda: scene(the_mesh=mesh(21, "tri", corners="")),
    "mesh-without-normals": lambda: scene(the_mesh=mesh(21, "tri", normals="")),
    "cache-missing": lambda: cached(beside("lost.xml")),
    "cache-foreign-path": lambda: cached(beside("caches/narrow.xml") + elsewhere("Z:/shot/narrow.xml")),
    "cache-unusable": lambda: cached(beside("caches/narrow.xml"), the_mesh=mesh(
        21, "tri", points=((0, 0, 0), (1, 0, 0), (0, 1, 0), (1, 1, 0)))),
    "cache-range": lambda: cached(beside("caches/wide.xml")),
    "cache-rate": lambda: cached(beside("caches/narrow.xml"), time_mode=10, rate=25),
}


def main():
    for name, write in FILES.items():
        with open(os.path.join(FOLDER, name + ".fbx"), "w", encoding="utf-8", newline="\n") as stream:
            stream.write(write())


if __name__ == "__main__":
    main()
