# SPDX-License-Identifier: MIT
# Copyright (c) Tarnell FBX contributors
#
# How much memory a small file that claims a long animation takes: that of the samples which change, and no more.
import os
import subprocess
import sys
import tempfile
import unittest

from support import TOOL

TICKS_PER_SECOND = 46_186_158_000
FRAMES_PER_SECOND = 24
FRAMES = 5_000_000

SCENE = """; FBX 7.4.0 project file
GlobalSettings: {{ Properties70: {{
P: "TimeMode", "enum", "", "",11
}} }}
Objects: {{
Model: 1, "Model::locator", "Null" {{ }}
AnimationStack: 2, "AnimStack::Take 001", "" {{ Properties70: {{
P: "LocalStop", "KTime", "Time", "",{end}
}} }}
AnimationLayer: 3, "AnimLayer::Base", "" {{ }}
AnimationCurveNode: 4, "AnimCurveNode::T", "" {{ }}
AnimationCurve: 5, "AnimCurve::", "" {{ KeyTime: *2 {{ a: 0,{end} }}
KeyValueFloat: *2 {{ a: 1,3 }}
KeyAttrFlags: *1 {{ a: 4 }}
KeyAttrRefCount: *1 {{ a: 2 }} }}
}}
Connections: {{
C: "OO",1,0
C: "OO",3,2
C: "OO",4,3
C: "OP",4,1,"Lcl Translation"
C: "OP",5,4,"d|X"
C: "OP",5,4,"d|Y"
}}
"""


class EndlessAnimation(unittest.TestCase):
    def peakOfDump(self, *options):
        """The most memory that the tool had, in bytes."""
        process = subprocess.Popen([TOOL, "dump", *options, self.file], stdout=subprocess.DEVNULL)
        _, status, usage = os.wait4(process.pid, 0)
        process.returncode = os.waitstatus_to_exitcode(status)
        self.assertEqual(process.returncode, 0)
        return usage.ru_maxrss * 1024

    def setUp(self):
        folder = tempfile.TemporaryDirectory()
        self.addCleanup(folder.cleanup)
        self.file = os.path.join(folder.name, "endless.fbx")
        with open(self.file, "w", encoding="utf-8") as file:
            file.write(SCENE.format(end=FRAMES // FRAMES_PER_SECOND * TICKS_PER_SECOND))
        self.limit = (64 << 20) + 1100 * os.path.getsize(self.file)

    def test_two_channels_that_change_take_the_memory_of_two(self):
        for options in (("--kind", "nulls", "--local"), ("--kind", "transforms")):
            peak = self.peakOfDump(*options)
            self.assertGreater(peak, 2 * 4 * FRAMES)  # the samples are there
            self.assertLess(peak, self.limit + 2 * 4 * FRAMES)


unittest.main(argv=sys.argv[:1], verbosity=0)
