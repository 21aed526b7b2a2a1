// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Faithful reads through the facade: of files of the test data, and of scenes that a test builds.
#pragma once

#include "sdk/FixtureFiles.h"
#include "support/TemporaryFolder.h"

#include "TnFbxWriteInfo.h"

#include <string>

namespace Tarnell::Fbx::test {

/// In the world, from the first stack.
inline TnFbxReadInfo faithfulRead(const std::string& fileName) {
    TnFbxReadInfo info;
    info.setFileName(fileName);
    info.setFidelity(kFbxFidelityFaithful);
    return info;
}

/// A built scene as a file, removed with the object.
class SavedScene {
public:
    explicit SavedScene(TestScene& scene) : mFile(mFolder.file("scene.fbx")) {
        EXPECT_TRUE(scene.sdk.saveScene(scene.scene->GetFbxManager(), scene.scene, mFile, /*asciiFormat*/ false,
                                        TnFbxWriteInfo::kFbxVersion2014, /*embedMedia*/ false));
    }
    TnFbxReadInfo info() const { return faithfulRead(mFile); }

private:
    support::TemporaryFolder mFolder;
    std::string mFile;
};

template <class Object>
FacadeRead<Object> readFaithfully(TestScene& scene) {
    return FacadeRead<Object>(SavedScene(scene).info());
}

/// Three numbers for each corner; empty for a mesh without normals.
inline Samples normalsOf(const TnFbxMesh& mesh) {
    Samples normals;
    for (int i = 0; mesh.getValidNormals() && i < mesh.getNumberOfPolygonVertices(); ++i) {
        float x = 0.0f, y = 0.0f, z = 0.0f;
        EXPECT_TRUE(mesh.getNormal(i, x, y, z));
        normals.insert(normals.end(), {x, y, z});
    }
    return normals;
}

} // namespace Tarnell::Fbx::test
