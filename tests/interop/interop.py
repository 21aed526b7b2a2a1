#!/usr/bin/env python3
# SPDX-License-Identifier: MIT
# Copyright (c) Tarnell FBX contributors
#
# Lets another program open files that we wrote, and compares what it sees with what went in.
#   interop.py PEER compatible|faithful SAMPLES_PROGRAM FOLDER COMMAND…
# The files are written in that way. The command gets two more arguments, the folder of the samples and one for its findings, a JSON object per file.
# A key that a peer does not report is one that it cannot see; PEERS says what each one must report.
import json
import math
import os
import shutil
import subprocess
import sys

# Peers compute in single precision, and turn angles into matrices and back. Where a peer keeps times as single
# precision too, frame 1001 is met to a ten-thousandth of a frame only.
TOLERANCE = 2e-5
TOLERANCE_OF_TIMES = 2e-4
ANIMATED = ["positions", "directions"]
# Blender 3.4 turns post-rotations the wrong way round, in files of every writer: what looks forward in them looks
# backward there. Whether it is the right one of the two is verified with three.js.
BACKWARD = ["positions", "axes"]
# Per peer: the versions and encodings that it opens, and what it reports of each kind.
PEERS = {
    "assimp": {
        "opens": lambda entry: entry["version"] >= 7100,
        "reports": {"camera": ["positions"], "light": ["positions", "type", "radiance", "coneAngle"],
                    "null": ["positions"], "mesh": ["points", "polygons"]},
    },
    "blender": {
        "opens": lambda entry: entry["version"] >= 7100 and not entry["ascii"],
        "reports": {"camera": BACKWARD + ["focalLengths", "filmWidth", "filmHeight", "filmOffset"],
                    "light": BACKWARD + ["type", "colour", "coneAngle"], "null": ANIMATED,
                    "mesh": ["points", "placed", "polygons", "polygonVertices", "uvs"]},
        "caches": ["cached"],
    },
    "three": {
        "tolerance": TOLERANCE_OF_TIMES,
        "opens": lambda entry: entry["version"] >= 7000,
        "reports": {"camera": ANIMATED, "light": ANIMATED + ["type", "colour", "intensity"], "null": ANIMATED,
                    "mesh": ["points", "placed"]},
    },
    "ufbx": {
        "opens": lambda entry: True,
        "reports": {"camera": ANIMATED + ["focalLengths", "filmWidth", "filmHeight", "filmOffset"],
                    "light": ANIMATED + ["type", "colour", "intensity", "coneAngle"], "null": ANIMATED,
                    "mesh": ["points", "placed", "polygons", "polygonVertices", "uvs", "cached"]},
        "scene": ["stacks", "rate"],
    },
}


def same(expected, seen, tolerance=TOLERANCE):
    if isinstance(expected, dict):
        return isinstance(seen, dict) and all(key in seen and same(value, seen[key], tolerance)
                                              for key, value in expected.items())
    if isinstance(expected, list):
        return (isinstance(seen, list) and len(expected) == len(seen)
                and all(same(a, b, tolerance) for a, b in zip(expected, seen)))
    if isinstance(expected, (int, float)) and isinstance(seen, (int, float)):
        return math.isclose(expected, seen, rel_tol=tolerance, abs_tol=tolerance)
    return expected == seen


def same_axes(expected, seen, tolerance):
    """The same directions, or all of them the other way round."""
    turned = {frame: [-c for c in direction] for frame, direction in expected.items()}
    return same(expected, seen, tolerance) or same(turned, seen, tolerance)


def same_points(expected, seen, tolerance):
    """The same points in any order: some programs sort corners by material or polygon."""
    def ordered(points):
        return sorted([round(c, 3) + 0.0 for c in point] for point in points)
    return same(ordered(expected), ordered(seen or []), tolerance)


def near_points(expected, seen, tolerance):
    """The same points in any order, where they are at every frame."""
    def near(points, others):
        return all(any(same(point, other, tolerance) for other in others) for point in points)
    return isinstance(seen, dict) and all(frame in seen and near(points, seen[frame]) and near(seen[frame], points)
                                          for frame, points in expected.items())


COMPARISONS = {"placed": near_points, "points": same_points, "axes": same_axes}


def first_difference(expected, seen):
    if isinstance(expected, dict) and isinstance(seen, dict):
        for key, value in expected.items():
            if key not in seen or not same(value, seen[key]):
                return f"{key}: {first_difference(value, seen.get(key))}"
    return f"{seen} instead of {expected}"


def differences(expected, seen, keys, tolerance):
    """What is wrong with one object."""
    if seen is None:
        return ["is missing"]
    found = []
    if seen["kind"] != expected["kind"]:
        found.append(f"is a {seen['kind']}")
    expected = dict(expected)
    if "colour" in expected:
        expected["radiance"] = [c * expected["intensity"] for c in expected["colour"]]
    if "directions" in expected:
        expected["axes"] = expected["directions"]
        seen = dict(seen, axes=seen.get("directions"))
    for key in keys:
        if key not in expected:
            continue
        compare = COMPARISONS.get(key, same)
        if not compare(expected[key], seen.get(key), tolerance):
            found.append(f"{key}: {first_difference(expected[key], seen.get(key))}")
    return found


def is_view(name):
    """Whether an object is one of the views that compatible files of 6.1 list."""
    return name == "Camera Switcher" or name.startswith("Producer ")


def check(peer, fidelity, samples, findings):
    with open(os.path.join(samples, "expected.json"), encoding="utf-8") as stream:
        expected = json.load(stream)
    rules = PEERS[peer]
    compared, wrong = 0, []
    for entry in filter(rules["opens"], expected["files"]):
        path = os.path.join(findings, entry["file"] + ".json")
        if not os.path.exists(path):
            wrong.append(f"{entry['file']}: was not opened")
            continue
        with open(path, encoding="utf-8") as stream:
            scene = json.load(stream)
        seen = {item["name"]: item for item in scene["objects"]}
        for key in rules.get("scene", []):
            compared += 1
            if not same(expected[key], scene.get(key)):
                wrong.append(f"{entry['file']}: {key}: {scene.get(key)} instead of {expected[key]}")
        names = {item["name"] for item in expected["objects"]}
        wrong += [f"{entry['file']}: there is an object too many, {name}" for name in sorted(set(seen) - names)
                  if fidelity == "faithful" or not is_view(name)]
        for item in expected["objects"]:
            keys = rules["reports"][item["kind"]] + rules.get("caches", [])
            compared += len([key for key in keys if key in item or key in ("axes", "radiance")])
            wrong += [f"{entry['file']}: {item['name']} {what}"
                      for what in differences(item, seen.get(item["name"]), keys,
                                             rules.get("tolerance", TOLERANCE))]
    return compared, wrong


def main():
    peer, fidelity, program, folder, *command = sys.argv[1:]
    samples, findings = os.path.join(folder, "samples"), os.path.join(folder, "findings")
    shutil.rmtree(folder, ignore_errors=True)
    os.makedirs(samples)
    subprocess.run([program, samples, fidelity], check=True)
    done = subprocess.run(command + [samples, findings], stdout=subprocess.PIPE, stderr=subprocess.STDOUT, text=True)
    compared, wrong = check(peer, fidelity, samples, findings)
    if done.returncode != 0:
        wrong.append(f"{peer} failed:\n{done.stdout}")
    print("\n".join(wrong))
    print(f"{peer}: {compared} values compared, {len(wrong)} differences")
    sys.exit(1 if wrong or compared == 0 else 0)


if __name__ == "__main__":
    main()
