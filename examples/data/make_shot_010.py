# SPDX-License-Identifier: MIT
# Copyright (c) Tarnell FBX contributors
#
# Builds shot_010.fbx, the sample shot of the demo and the examples, with Blender:
#   blender --background --python examples/data/make_shot_010.py -- examples/data/shot_010.fbx
#
# Frames 1001 to 1048 at 24 frames per second: a camera that cranes up and zooms in, a key light that warms, a tracking
# target that moves, a locator below it, and a cube with colours.
import math
import sys

import bpy

FIRST, LAST = 1001, 1048


def clear():
    bpy.ops.wm.read_factory_settings(use_empty=True)


def add(name, data, location=(0, 0, 0), parent=None):
    made = bpy.data.objects.new(name, data)
    bpy.context.scene.collection.objects.link(made)
    made.location = location
    made.parent = parent
    return made


def key(target, path, value, frame):
    setattr(target, path, value)
    target.keyframe_insert(data_path=path, frame=frame)


def build():
    scene = bpy.context.scene
    scene.frame_start, scene.frame_end = FIRST, LAST
    scene.render.fps = 24

    lens = bpy.data.cameras.new("shotCam")
    lens.sensor_width, lens.sensor_height = 24.576, 18.672
    lens.clip_start, lens.clip_end = 0.1, 1000
    camera = add("shotCam", lens)
    for frame, location, tilt, focal in ((FIRST, (0, -6, 1), 80, 35), (LAST, (1.5, -5, 2.5), 68, 50)):
        key(camera, "location", location, frame)
        key(camera, "rotation_euler", (math.radians(tilt), 0, math.radians(5)), frame)
        key(lens, "lens", focal, frame)

    lamp = bpy.data.lights.new("keyLight", "SPOT")
    lamp.spot_size = math.radians(50)
    lamp.energy = 100
    light = add("keyLight", lamp, (2, -3, 4))
    light.rotation_euler = (math.radians(35), 0, math.radians(30))

    target = add("target", None)
    for frame, x in ((FIRST, -1), (LAST, 1)):
        key(target, "location", (x, 0, 0.5), frame)
    add("targetTip", None, (0, 0, 1), target)

    bpy.ops.mesh.primitive_cube_add(size=1, location=(0, 0, 0.5))
    cube = bpy.context.object
    cube.name = "crate"
    colours = cube.data.color_attributes.new("Col", "FLOAT_COLOR", "CORNER")
    for i, corner in enumerate(colours.data):
        corner.color = (i % 2, (i // 2) % 2, 0.5, 1)


clear()
build()
bpy.ops.export_scene.fbx(
    filepath=sys.argv[sys.argv.index("--") + 1],
    object_types={"CAMERA", "LIGHT", "EMPTY", "MESH"},
    bake_anim=True,
    bake_anim_use_all_actions=False,
    bake_anim_use_nla_strips=False,
    bake_anim_simplify_factor=0,
    colors_type="SRGB",
)
