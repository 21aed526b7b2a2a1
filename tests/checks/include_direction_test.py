#!/usr/bin/env python3
# SPDX-License-Identifier: MIT
# Copyright (c) Tarnell FBX contributors
"""Shows which includes include_direction.py refuses and which it accepts."""

import tempfile
import unittest
from pathlib import Path

from include_direction import violations


class IncludeDirection(unittest.TestCase):
    def check(self, file, source):
        with tempfile.TemporaryDirectory() as folder:
            path = Path(folder) / file
            path.parent.mkdir(parents=True)
            path.write_text(source, encoding="utf-8")
            return violations(Path(folder))

    def test_refuses_the_platform_in_the_model(self):
        for file in ("include/TnFbxMesh.h", "src/model/TnFbxMesh.cpp", "src/model/ChannelSet.h"):
            for include in ("<fbxsdk.h>", '"fbxsdk.h"', "<fbxsdk/FbxTime.h>", '"../../fbxsdk/include/fbxsdk.h"',
                            '"scene/Node.h"'):
                self.assertTrue(self.check(file, f"#pragma once\n#include {include}\n"), (file, include))

    def test_refuses_the_adapter_and_the_facade_in_the_model(self):
        for include in ('"FbxSdk.h"', '"Fbx.h"', '"sdk/SdkContext.h"', '"TnFbxError.h"'):
            self.assertTrue(self.check("src/model/TnFbxMesh.cpp", f"#include {include}\n"), include)

    def test_refuses_all_but_the_umbrella_in_the_adapter_and_the_facade(self):
        for file in ("src/sdk/SdkContext.cpp", "src/sdk/SdkContext.h", "src/Fbx.cpp", "include/FbxSdk.h"):
            for include in ("<fbxsdk/FbxTime.h>", '"scene/Node.h"', '"core/Time.h"', '"fbxsdk.h"'):
                self.assertTrue(self.check(file, f"#include {include}\n"), (file, include))

    def test_lets_the_number_of_threads_be_told_in_one_place(self):
        for file, refused in (("src/MaximumThreads.cpp", False), ("src/Fbx.cpp", True), ("src/sdk/SdkContext.cpp", True)):
            self.assertEqual(bool(self.check(file, "#include <fbxsdk/extensions/Threads.h>\n")), refused, file)

    def test_refuses_one_adapter_in_the_other_and_both_in_what_they_share(self):
        for file, include in (("src/sdk/SdkContext.cpp", '"faithful/Scene.h"'), ("src/faithful/Scene.cpp", '"FbxSdk.h"'),
                              ("src/faithful/Scene.cpp", '"sdk/NodeGeometry.h"'), ("src/access/NodeWalk.h", '"FbxSdk.h"'),
                              ("src/access/NodeWalk.h", '"faithful/Scene.h"'), ("src/faithful/Scene.h", '"core/Time.h"')):
            self.assertTrue(self.check(file, f"#include {include}\n"), (file, include))

    def test_refuses_the_library_in_the_platform(self):
        for file in ("fbxsdk/src/core/Time.cpp", "fbxsdk/include/fbxsdk/FbxTime.h"):
            for include in ('"TnFbxTime.h"', "<FbxSdk.h>", '"model/FrameArithmetic.h"', '"Fbx.h"'):
                self.assertTrue(self.check(file, f"#include {include}\n"), (file, include))

    def check_modules(self, files):
        files["fbxsdk/CMakeLists.txt"] = ("tarnell_module(core LIBRARIES Threads::Threads)\ntarnell_module(object NEEDS core)\n"
                                          "tarnell_module(document NEEDS core)\n"
                                          "tarnell_module(scene NEEDS object document)\n")
        with tempfile.TemporaryDirectory() as folder:
            for file, source in files.items():
                path = Path(folder) / file
                path.parent.mkdir(parents=True, exist_ok=True)
                path.write_text(source, encoding="utf-8")
            return violations(Path(folder))

    def test_refuses_a_module_that_is_not_needed(self):
        for file, include in (("fbxsdk/src/object/ObjectData.cpp", '"scene/SceneData.h"'),
                              ("fbxsdk/src/object/ObjectData.h", '"document/Document.h"'),
                              ("fbxsdk/src/core/deep/Time.cpp", '"object/ObjectData.h"'),
                              ("fbxsdk/src/object/ObjectData.cpp", "<fbxsdk/FbxNode.h>"),
                              ("fbxsdk/include/fbxsdk/FbxObject.h", "<fbxsdk/FbxNode.h>")):
            found = self.check_modules({"fbxsdk/src/scene/FbxNode.cpp": "", "fbxsdk/src/object/FbxObject.cpp": "",
                                      file: f"\n#include {include}\n"})
            self.assertEqual(len(found), 1, (file, include, found))
            self.assertTrue(found[0].startswith(f"{file}:2: {include}"), found)

    def test_lets_modules_use_what_they_need_and_what_that_needs(self):
        found = self.check_modules({"fbxsdk/src/object/FbxObject.cpp": '#include "core/Time.h"\n',
                                  "fbxsdk/src/scene/FbxNode.cpp": '#include <fbxsdk/FbxObject.h>\n#include "core/Time.h"\n'
                                                                  '#include "document/Document.h"\n'})
        self.assertEqual(found, [])

    def test_knows_the_module_of_a_class_by_the_source_that_implements_it(self):
        found = self.check_modules({"fbxsdk/src/scene/Attributes.cpp": "FBXSDK_OBJECT_IMPLEMENT(FbxNew, FbxObject, kRows)\n",
                                  "fbxsdk/include/fbxsdk/FbxNew.h": "",
                                  "fbxsdk/src/object/FbxObject.cpp": "#include <fbxsdk/FbxNew.h>\n"})
        self.assertEqual(len(found), 1, found)
        self.assertTrue(found[0].startswith("fbxsdk/src/object/FbxObject.cpp:1: <fbxsdk/FbxNew.h>"), found)

    def test_refuses_a_public_header_of_no_module(self):
        found = self.check_modules({"fbxsdk/include/fbxsdk/FbxNew.h": ""})
        self.assertEqual(len(found), 1, found)

    def test_names_file_and_line(self):
        found = self.check("src/model/TnFbxMesh.cpp", "// mesh\n\n#  include <fbxsdk.h>\n")

        self.assertEqual(len(found), 1)
        self.assertTrue(found[0].startswith("src/model/TnFbxMesh.cpp:3: <fbxsdk.h>"), found)

    def test_refuses_the_plain_name_of_the_platform_in_public_headers(self):
        self.assertEqual(len(self.check("include/FbxSdk.h", "#include <fbxsdk.h>\n")), 1)
        self.assertEqual(len(self.check("include/TnFbxMesh.h", '#include "FbxPlatform.h"\n')), 1)
        self.assertEqual(self.check("include/FbxSdk.h", '#include "FbxPlatform.h"\n'), [])

    def test_lets_pass_what_points_down(self):
        for file, source in (
            ("include/TnFbxMesh.h", '#include "TnFbxTransform.h"\n#include <vector>\n'),
            ("src/model/TnFbxMesh.cpp", '// #include <fbxsdk.h>\n/*\n#include "Fbx.h"\n*/\n#include "ChannelSet.h"\n'),
            ("src/sdk/SdkContext.cpp", '#include "FbxSdk.h"\n#include <fbxsdk.h>\n#include "model/FrameArithmetic.h"\n'),
            ("src/Fbx.cpp", '#include "Fbx.h"\n#include "sdk/SdkContext.h"\n'),
            ("fbxsdk/src/scene/FbxNode.cpp", '#include <fbxsdk/FbxTime.h>\n#include "core/Strings.h"\n'),
        ):
            self.assertEqual(self.check(file, source), [], file)


if __name__ == "__main__":
    unittest.main()
