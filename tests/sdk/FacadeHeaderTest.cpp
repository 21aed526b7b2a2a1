// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// "Fbx.h" is the only header of the library here: what it returns can be used and deleted without another one.
#include "Fbx.h"

#include <memory>

#include <gtest/gtest.h>

#include "support/TemporaryFolder.h"

namespace Tarnell::Fbx {
namespace {

// Reads all objects of a kind and deletes them; their number, or -1 after a failure.
template <class Object, bool (Fbx::*read)(TnFbxReadInfo&, Object**, int&) const>
int numberRead(const std::string& fileName) {
    TnFbxReadInfo info;
    info.setFileName(fileName);
    info.setFidelity(kFbxFidelityFaithful);
    Object* objects = nullptr;
    int count = 0;
    const bool isRead = (Fbx().*read)(info, &objects, count);
    const std::unique_ptr<Object[]> owner(objects);
    for (int i = 0; i < count; ++i)
        EXPECT_FALSE(objects[i].getName().empty());
    return isRead ? count : -1;
}

TEST(FacadeHeader, IsAllThatAHostNeeds) {
    const support::TemporaryFolder folder;
    TnFbxWriteInfo info;
    info.setFileName(folder.file("host.fbx"));
    info.setFidelity(kFbxFidelityFaithful);
    TnFbxCamera camera;
    camera.setName("camera");
    TnFbxNull null;
    null.setName("null");

    setMemoryLimit(0);
    ASSERT_TRUE(Fbx().writeFile(info, {&camera}, {}, {}, {&null}, {})) << lastError();
    EXPECT_TRUE(lastWarnings().empty());

    EXPECT_EQ((numberRead<TnFbxCamera, &Fbx::getCameras>(info.getFileName())), 1);
    EXPECT_EQ((numberRead<TnFbxNull, &Fbx::getNulls>(info.getFileName())), 1);
    EXPECT_EQ((numberRead<TnFbxTransform, &Fbx::getTransforms>(info.getFileName())), 2); // every node
    EXPECT_EQ((numberRead<TnFbxLight, &Fbx::getLights>(info.getFileName())), 0);
    EXPECT_EQ((numberRead<TnFbxMarker, &Fbx::getMarkers>(info.getFileName())), 0);
    EXPECT_EQ((numberRead<TnFbxMesh, &Fbx::getMeshes>(info.getFileName())), 0);
}

} // namespace
} // namespace Tarnell::Fbx
