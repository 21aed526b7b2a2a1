# SPDX-License-Identifier: MIT
# Copyright (c) Tarnell FBX contributors
#
# How the tests of the tool call it. Each is called as: TEST.py TOOL PROJECT_ROOT
import json
import os
import subprocess
import sys

TOOL, ROOT = sys.argv[1], sys.argv[2]
SHOT = os.path.join(ROOT, "examples", "data", "shot_010.fbx")


def run(*arguments):
    return subprocess.run([TOOL, *arguments], capture_output=True, text=True, timeout=120)


def dump(*arguments):
    result = run("dump", *arguments)
    assert result.returncode == 0, result.stderr
    return json.loads(result.stdout)


def named(objects, name):
    return next(each for each in objects if each["name"] == name)
