// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Files that somebody writes anew in place while they are read, as many exporters do: the old content, or a failure
// with a reason; never a signal, and never the one half of a file with the other half of another.
#include <atomic>
#include <filesystem>
#include <memory>
#include <string>
#include <thread>
#include <vector>

#include <gtest/gtest.h>

#include "Fbx.h"
#include "FbxSdk.h"
#include "TnFbxError.h"
#include "TnFbxMesh.h"
#include "TnFbxReadInfo.h"
#include "TnFbxWriteInfo.h"
#include "support/TemporaryFolder.h"

namespace Tarnell::Fbx {
namespace {

constexpr int kSide = 90; // points enough that their arrays are read late
constexpr int kPoints = kSide * kSide;

TnFbxMesh sheet(float seed, bool moving) {
    TnFbxMesh mesh;
    mesh.setName("sheet");
    for (int i = 0; i < kPoints; ++i) {
        const auto number = static_cast<float>(i);
        mesh.addControlPoint(number * seed, number * number * seed, seed);
    }
    for (int i = 0; i + kSide + 1 < kPoints; ++i) {
        mesh.addPolygonSize(3);
        for (const int corner : {i, i + 1, i + kSide})
            mesh.addPolygonVertex(corner);
    }
    if (moving)
        mesh.addPointAnimation(/*frames*/ 3);
    return mesh;
}

std::string written(const support::TemporaryFolder& folder, const std::string& name, float seed, bool ascii) {
    TnFbxMesh mesh = sheet(seed, false);
    TnFbxWriteInfo info;
    info.setFileName(folder.file(name));
    info.setAnimationStackName("Take 001");
    info.setFileFormat(ascii);
    EXPECT_TRUE(Fbx().writeFile(info, {}, {}, {}, {}, {&mesh})) << lastError();
    return folder.read(name);
}

} // namespace
} // namespace Tarnell::Fbx
