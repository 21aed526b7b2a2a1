# SPDX-License-Identifier: MIT
# Copyright (c) Tarnell FBX contributors
"""Exports the cameras of this folder with Blender, and Blender's own values on every frame to cameras.json:

    blender --background --factory-startup --python export_cameras.py [-- FOLDER]

Written by Blender 3.4.1.
"""
import json
import math
import os
import sys

import bpy
from mathutils import Vector

sys.path.insert(0, os.path.dirname(os.path.abspath(__file__)))
import export_fixtures as fixtures  # noqa: E402

FRAMES = range(fixtures.FIRST, fixtures.LAST + 1)


def scene_of(width, height, fps=24, fps_base=1.0, pixel_aspect=(1.0, 1.0)):
    scene = fixtures.empty_scene()
    render = scene.render
    render.resolution_x, render.resolution_y = width, height
    render.pixel_aspect_x, render.pixel_aspect_y = pixel_aspect
    render.fps, render.fps_base = fps, fps_base
    return scene


def camera(name, location, rotation, sensor, **values):
    lens = bpy.data.cameras.new(name)
    lens.sensor_width, lens.sensor_height = sensor
    lens.sensor_fit = "HORIZONTAL"
    for key, value in values.items():
        setattr(lens, key, value)
    thing = fixtures.add(name, lens, location)
    thing.rotation_euler = [math.radians(angle) for angle in rotation]
    return thing


def handheld():
    """A camera that follows a rig, which is rotated, scaled and moves, and zooms; 59.94 frames per second."""
    scene_of(1920, 1080, 60, 1.001)
    rig = fixtures.add("rig", None)
    rig.rotation_euler = (0.0, 0.0, math.radians(30.0))
    rig.scale = (2.0, 2.0, 2.0)
    fixtures.key_each_frame(rig, "location", [(1.0, 0.25 * step, 0.5) for step in range(5)])
    seen = camera("handheld", (0.5, -1.0, 0.75), (80.0, 5.0, 10.0), (24.576, 13.824), clip_start=0.25, clip_end=750.0)
    seen.parent = rig
    fixtures.key_each_frame(seen.data, "lens", [24.0 + 12.5 * step for step in range(5)])


def portrait():
    """A tall picture, of a film that is shifted up."""
    scene_of(1080, 1920)
    camera("portrait", (0.0, -4.0, 1.5), (85.0, 0.0, 0.0), (36.0, 64.0), lens=50.0, shift_y=0.25)


def squeezed():
    """Pixels that are twice as wide as they are high."""
    scene_of(1828, 1556, pixel_aspect=(2.0, 1.0))
    camera("scope", (-3.0, 2.0, 1.0), (90.0, 0.0, -120.0), (43.892, 18.68), lens=75.0)


def plan():
    """An orthographic camera that looks down, in a file whose Z points up."""
    scene_of(1000, 1000, 25)
    seen = camera("plan", (2.0, 3.0, 10.0), (0.0, 0.0, 45.0), (32.0, 32.0), type="ORTHO", ortho_scale=6.0)
    fixtures.key_each_frame(seen, "location", [(2.0 + step, 3.0, 10.0) for step in range(5)])


def tracking():
    """A camera that is held to an object by a constraint, which the exporter makes keys of."""
    scene_of(2048, 858)
    thing = fixtures.add("actor", None)
    fixtures.key_each_frame(thing, "location", [(step - 2.0, 0.0, 0.5 * step) for step in range(5)])
    seen = camera("tracking", (4.0, -6.0, 2.0), (0.0, 0.0, 0.0), (24.89, 10.427), lens=32.0)
    hold = seen.constraints.new("TRACK_TO")
    hold.target, hold.track_axis, hold.up_axis = thing, "TRACK_NEGATIVE_Z", "UP_Y"


def facts():
    """What Blender shows through the scene's one camera, on each frame: metres and Z up, millimetres and degrees."""
    scene = bpy.context.scene
    seen = next(thing for thing in scene.objects if thing.type == "CAMERA")
    frames = []
    for frame in FRAMES:
        scene.frame_set(frame)
        evaluated = seen.evaluated_get(bpy.context.evaluated_depsgraph_get())
        corners = evaluated.data.view_frame(scene=scene)
        width, height = (max(c[i] for c in corners) - min(c[i] for c in corners) for i in (0, 1))
        matrix = evaluated.matrix_world
        direction = (matrix.to_3x3() @ Vector((0.0, 0.0, -1.0))).normalized()
        at = {"frame": frame, "place": list(matrix.translation), "looks": list(direction)}
        if evaluated.data.type == "ORTHO":
            at["picture"] = [width, height]
        else:
            at["lens"] = evaluated.data.lens
            away = -corners[0][2]
            at["angles"] = [2.0 * math.degrees(math.atan(side / 2.0 / away)) for side in (width, height)]
            at["shift"] = [sum(c[i] for c in corners) / 4.0 / away * at["lens"] for i in (0, 1)]
        frames.append(at)
    data = seen.data
    return {"name": seen.name, "film": [data.sensor_width, data.sensor_height], "clip": [data.clip_start, data.clip_end],
            "rate": scene.render.fps / scene.render.fps_base, "frames": frames}


if __name__ == "__main__":
    if "--" in sys.argv:
        fixtures.FOLDER = os.path.abspath(sys.argv[sys.argv.index("--") + 1])
    said = {}
    for make, options in ((handheld, {}), (portrait, {}), (squeezed, {}), (tracking, {}),
                          (plan, {"axis_forward": "Y", "axis_up": "Z"})):
        make()
        file = f"{make.__name__}_7400_binary.fbx"
        said[file] = facts()
        fixtures.export(file, **options)
    with open(os.path.join(fixtures.FOLDER, "cameras.json"), "w", encoding="utf-8") as stream:
        json.dump(said, stream, indent=1)
        stream.write("\n")
