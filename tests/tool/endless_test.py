# SPDX-License-Identifier: MIT
# Copyright (c) Tarnell FBX contributors
#
# How much memory a small file can make the tool take by claiming a long animation.
import os
import subprocess
import sys
import tempfile
import unittest

from support import TOOL

TICKS_PER_SECOND = 46_186_158_000
FRAMES_PER_SECOND = 24
# Those of the first channel fit what a file of any size may have, those of the second do not.
FRAMES = 12_500_000

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

    def test_samples_of_a_small_file_take_little_memory(self):
        peak = self.peakOfDump("--kind", "nulls", "--local")
        self.assertGreater(peak, 4 * FRAMES)  # the samples are there
        self.assertLess(peak, self.limit)

    def test_samples_in_the_world_take_no_more(self):
        peak = self.peakOfDump("--kind", "transforms")
        self.assertLess(peak, self.limit)


unittest.main(argv=sys.argv[:1], verbosity=0)
