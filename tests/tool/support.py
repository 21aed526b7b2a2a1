# SPDX-License-Identifier: MIT
# Copyright (c) Tarnell FBX contributors
#
# How the tests of the tool call it. Each is called as: TEST.py TOOL PROJECT_ROOT
import json
import os
import struct
import subprocess
import sys

TOOL, ROOT = sys.argv[1], sys.argv[2]
SHOT = os.path.join(ROOT, "examples", "data", "shot_010.fbx")
SDK_DATA = os.path.join(ROOT, "tests", "data", "sdk")

# Texts that are no range of frames: no numbers, too much around them, numbers outside int, and one that runs backwards.
NO_FRAMES = ("", ":", "x", "1:x", "x:1", "1:", ":1", "1:2:3", "1:2 ", " 1:2", "1: 2", "1.5", "1:2.5", "+1:2", "3:1",
             "4294967297:4294967298", "1:4294967298", "2147483648", "-2147483649:0", "99999999999999999999")


def run(*arguments, **more):
    return subprocess.run([TOOL, *arguments], capture_output=True, text=True, timeout=120, **more)


def peak_of(*arguments):
    """The exit status of the tool, the most memory that it had, in bytes, and what it complained of."""
    process = subprocess.Popen([TOOL, *arguments], stdout=subprocess.DEVNULL, stderr=subprocess.PIPE, text=True)
    complaint = process.stderr.read()
    process.stderr.close()
    _, status, usage = os.wait4(process.pid, 0)
    process.returncode = os.waitstatus_to_exitcode(status)
    return process.returncode, usage.ru_maxrss * 1024, complaint


def dump(*arguments):
    result = run("dump", *arguments)
    assert result.returncode == 0, result.stderr
    return json.loads(result.stdout)


def float32(number):
    """The number as a float holds it."""
    return struct.unpack("<f", struct.pack("<f", number))[0]


def named(objects, name):
    return next(each for each in objects if each["name"] == name)


def edited(fixture, path, *replacements):
    """Writes a copy of a hand-written file in which each (old, new) was replaced; every old text stands there once."""
    with open(os.path.join(SDK_DATA, fixture), encoding="utf-8") as stream:
        text = stream.read()
    for old, new in replacements:
        assert text.count(old) == 1, f"{fixture} has {text.count(old)} times: {old}"
        text = text.replace(old, new)
    with open(path, "w", encoding="utf-8") as stream:
        stream.write(text)
    return path
