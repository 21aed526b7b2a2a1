# SPDX-License-Identifier: MIT
# Copyright (c) Tarnell FBX contributors
"""Exports the files of this folder with Blender, so that every run of the tests reads what an independent program wrote:

    blender --background --factory-startup --python export_fixtures.py

Written by Blender 3.4.1. The numbers of the scenes are those of BlenderFilesTest.cpp.
"""
import math
import os

import bpy

FOLDER = os.path.dirname(os.path.abspath(__file__))
FIRST, LAST = 1001, 1005


def empty_scene(fps_base=1.0):
    """A scene of a few frames that starts at frame 1001, at 24 frames per second or near to that."""
    bpy.ops.wm.read_factory_settings(use_empty=True)
    scene = bpy.context.scene
    scene.render.fps, scene.render.fps_base = 24, fps_base
    scene.frame_start, scene.frame_end = FIRST, LAST
    return scene


def add(name, data, location=(0.0, 0.0, 0.0)):
    thing = bpy.data.objects.new(name, data)
    thing.location = location
    bpy.context.scene.collection.objects.link(thing)
    return thing


def key_each_frame(owner, path, values):
    """Keys on frames FIRST…LAST, with straight lines between them."""
    for frame, value in zip(range(FIRST, LAST + 1), values):
        setattr(owner, path, value)
        owner.keyframe_insert(path, frame=frame)
    for curve in owner.animation_data.action.fcurves:
        for key in curve.keyframe_points:
            key.interpolation = "LINEAR"


def export(name, **options):
    bpy.ops.export_scene.fbx(filepath=os.path.join(FOLDER, name), add_leaf_bones=False, bake_anim_use_nla_strips=False,
                             bake_anim_use_all_actions=False, bake_anim_force_startend_keying=True,
                             bake_anim_simplify_factor=0.0, use_mesh_modifiers=False, **options)


def cameras_and_lights():
    """A dolly zoom, and a light of each kind."""
    scene = empty_scene()
    lens = bpy.data.cameras.new("lens")
    lens.sensor_fit = "HORIZONTAL"
    lens.sensor_width, lens.sensor_height = 25.4, 12.7
    lens.shift_x = 0.125
    camera = add("camera", lens)
    camera.rotation_euler = (math.pi / 2, 0.0, 0.0)
    key_each_frame(camera, "location", [(0.5, -2.0 - step, 1.0) for step in range(5)])
    key_each_frame(lens, "lens", [35.0 + 2.0 * step for step in range(5)])
    scene.camera = camera
    for kind, name in (("POINT", "bulb"), ("SUN", "sun"), ("SPOT", "spot")):
        light = bpy.data.lights.new(name, kind)
        light.color = (1.0, 0.5, 0.25)
        if kind == "SPOT":
            light.spot_size = math.radians(40.0)
        add(name, light, (1.0, 2.0, 3.0))
    add("locator", None, (-1.0, 0.0, 0.5))
    export("cameras_and_lights_7400_binary.fbx")


def skin():
    """A strip of four squares on two bones; the upper one bends by 90 degrees, 22.5 per frame."""
    empty_scene()
    bones = bpy.data.armatures.new("rig")
    rig = add("rig", bones)
    bpy.context.view_layer.objects.active = rig
    bpy.ops.object.mode_set(mode="EDIT")
    lower = bones.edit_bones.new("lower")
    lower.head, lower.tail = (0.0, 0.0, 0.0), (0.0, 0.0, 2.0)
    upper = bones.edit_bones.new("upper")
    upper.head, upper.tail, upper.parent = (0.0, 0.0, 2.0), (0.0, 0.0, 4.0), lower
    bpy.ops.object.mode_set(mode="OBJECT")

    points = [(x, 0.0, float(z)) for z in range(5) for x in (0.0, 1.0)]
    mesh = bpy.data.meshes.new("strip")
    mesh.from_pydata(points, [], [(2 * i, 2 * i + 1, 2 * i + 3, 2 * i + 2) for i in range(4)])
    strip = add("strip", mesh)
    for name, heights in (("lower", (0, 1, 2)), ("upper", (3, 4))):
        group = strip.vertex_groups.new(name=name)
        group.add([i for i, point in enumerate(points) if int(point[2]) in heights], 1.0, "REPLACE")
    strip.modifiers.new("armature", "ARMATURE").object = rig
    strip.parent = rig

    bone = rig.pose.bones["upper"]
    bone.rotation_mode = "XYZ"
    for step, frame in enumerate(range(FIRST, LAST + 1)):
        bone.rotation_euler = (math.radians(22.5 * step), 0.0, 0.0)
        bone.keyframe_insert("rotation_euler", frame=frame)
    export("skin_7400_binary.fbx")


def layers():
    """A quad and a triangle with texture coordinates, normals, colours, two materials and a shape key, at 23.976 frames
    per second."""
    empty_scene(fps_base=1.001)
    mesh = bpy.data.meshes.new("house")
    mesh.from_pydata([(0, 0, 0), (1, 0, 0), (1, 0, 1), (0, 0, 1), (0.5, 0, 2)], [], [(0, 1, 2, 3), (3, 2, 4)])
    for name, colour in (("wall", (0.5, 0.25, 0.125, 1.0)), ("roof", (1.0, 0.0, 0.0, 1.0))):
        material = bpy.data.materials.new(name)
        material.diffuse_color = colour
        mesh.materials.append(material)
    mesh.polygons[1].material_index = 1
    uvs = mesh.uv_layers.new(name="map")
    colours = mesh.color_attributes.new("paint", "FLOAT_COLOR", "CORNER")
    for corner in mesh.loops:
        x, _, z = mesh.vertices[corner.vertex_index].co
        uvs.data[corner.index].uv = (x, z / 2.0)
        colours.data[corner.index].color = (x, 0.0, z / 2.0, 1.0)
    house = add("house", mesh, (0.0, 0.0, 1.0))
    house.shape_key_add(name="Basis")
    tall = house.shape_key_add(name="tall")
    tall.data[4].co = (0.5, 0.0, 4.0)
    tall.value = 0.5
    export("layers_7400_binary.fbx", colors_type="LINEAR")


if __name__ == "__main__":
    cameras_and_lights()
    skin()
    layers()
