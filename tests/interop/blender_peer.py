# SPDX-License-Identifier: MIT
# Copyright (c) Tarnell FBX contributors
#
# What Blender sees in the files: blender --background --factory-startup --python blender_peer.py -- SAMPLES OUT
# Writes one JSON object per file into OUT, in the units and axes of the files.
import json
import os
import sys

import bpy
from mathutils import Vector

FOLDER, OUT = sys.argv[sys.argv.index("--") + 1:]
# Blender is Z up and counts in metres; the files are Y up and count in centimetres.
PER_UNIT = 100.0


def to_file_axes(v):
    return [v.x, v.z, -v.y]


def position(point):
    return [PER_UNIT * c for c in to_file_axes(point)]


def cached_points(path, frames):
    """The points that Blender's own modifier takes from a point cache, per frame, in the mesh's space."""
    mesh = bpy.data.meshes.new("probe")
    mesh.from_pydata([(0, 0, 0)] * 8, [], [])
    probe = bpy.data.objects.new("probe", mesh)
    bpy.context.collection.objects.link(probe)
    modifier = probe.modifiers.new("cache", "MESH_CACHE")
    modifier.cache_format = "PC2"
    modifier.filepath = path
    modifier.frame_start = frames[0]
    seen = {}
    for frame in range(frames[0], frames[1] + 1):
        bpy.context.scene.frame_set(frame)
        evaluated = probe.evaluated_get(bpy.context.evaluated_depsgraph_get())
        seen[str(frame)] = [list(v.co) for v in evaluated.data.vertices]
    bpy.data.objects.remove(probe)
    return seen


KINDS = {"CAMERA": "camera", "LIGHT": "light", "EMPTY": "null", "MESH": "mesh"}


def describe(item):
    seen = {"name": item.name, "kind": KINDS.get(item.type, item.type)}
    if item.type == "LIGHT":
        light = item.data
        seen["type"] = {"POINT": "point", "SUN": "directional", "SPOT": "spot"}.get(light.type, light.type)
        seen["colour"] = list(light.color)
        if light.type == "SPOT":
            seen["coneAngle"] = light.spot_size * 180.0 / 3.141592653589793
    if item.type == "CAMERA":
        camera = item.data
        seen["filmWidth"] = camera.sensor_width
        seen["filmHeight"] = camera.sensor_height
        seen["filmOffset"] = camera.shift_x * camera.sensor_width
        seen["focalLengths"] = {}
    if item.type == "MESH":
        mesh = item.data
        seen["points"] = [position(item.matrix_world @ v.co) for v in mesh.vertices]
        seen["polygons"] = len(mesh.polygons)
        seen["polygonVertices"] = len(mesh.loops)
        seen["uvs"] = [list(uv.uv) for uv in mesh.uv_layers[0].data] if mesh.uv_layers else []
        seen["placed"] = {}
    else:
        seen["positions"] = {}
        seen["directions"] = {}
    return seen


def look(path, caches, frames):
    bpy.ops.wm.read_factory_settings(use_empty=True)
    # Frame numbers are taken as they are: no frame is added to the times of the file.
    bpy.ops.import_scene.fbx(filepath=path, anim_offset=0.0)
    scene = bpy.context.scene
    objects = {item.name: describe(item) for item in scene.objects}
    for frame in range(frames[0], frames[1] + 1):
        scene.frame_set(frame)
        for item in scene.objects:
            seen = objects[item.name]
            if item.type == "MESH":
                seen["placed"][str(frame)] = [position(item.matrix_world @ v.co) for v in item.data.vertices]
                continue
            seen["positions"][str(frame)] = position(item.matrix_world.translation)
            direction = item.matrix_world.to_3x3() @ Vector((0, 0, -1))
            seen["directions"][str(frame)] = to_file_axes(direction.normalized())
            if item.type == "CAMERA":
                seen["focalLengths"][str(frame)] = item.data.lens
    for name, seen in objects.items():
        cache = os.path.join(caches, name + ".pc2")
        if os.path.exists(cache):
            seen["cached"] = cached_points(cache, frames)
    return {"objects": list(objects.values()), "rate": scene.render.fps / scene.render.fps_base}


with open(os.path.join(FOLDER, "expected.json"), encoding="utf-8") as stream:
    EXPECTED = json.load(stream)
os.makedirs(OUT, exist_ok=True)
for entry in EXPECTED["files"]:
    if entry["ascii"] or entry["version"] < 7100:
        continue  # Blender reads binary files of 7.1 and later
    file = os.path.join(FOLDER, entry["file"])
    seen = look(file, file[:-4] + "_fpc", EXPECTED["frames"])
    with open(os.path.join(OUT, entry["file"] + ".json"), "w", encoding="utf-8") as stream:
        json.dump(seen, stream, indent=1)
