// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The read options: defaults, storage, copying.
#include "TnFbxReadInfo.h"

#include "ModelValues.h"

#include <string>
#include <type_traits>

namespace Tarnell::Fbx {
namespace {

static_assert(TnFbxReadInfo::kDefaultSampleFPS == 24.0f);
static_assert(TnFbxReadInfo::kDefaultFrame == 0.0f);
static_assert(kFbxFidelityCompatible == 0);
static_assert(kFbxFidelityFaithful == 1);
static_assert(!std::is_polymorphic_v<TnFbxReadInfo>);

void expectDefaults(const TnFbxReadInfo& info) {
    EXPECT_EQ(info.getFileName(), "");
    EXPECT_EQ(info.getAimationStackName(), "");
    EXPECT_FALSE(info.haveAnimationStack());
    EXPECT_TRUE(info.getGlobalTransform());
    EXPECT_TRUE(info.getTransformPoints());
    EXPECT_FALSE(info.getUseSampleFPS());
    EXPECT_EQ(info.getSampleFPS(), 24.0f);
    EXPECT_EQ(info.getFrame(), 0.0f);
    EXPECT_FALSE(info.getComputeCameraRotation());
    EXPECT_TRUE(info.getAllObjects());
    EXPECT_EQ(info.getObjectName(), "");
    EXPECT_EQ(info.getObjectID(), -1);
    EXPECT_EQ(info.getFidelity(), kFbxFidelityCompatible);
}

/// Options in which every field differs from its default.
TnFbxReadInfo changedInfo() {
    TnFbxReadInfo info;
    EXPECT_TRUE(info.setFileName("scene.fbx"));
    EXPECT_TRUE(info.setAnimationStackName("Take 001"));
    EXPECT_TRUE(info.setGlobalTransform(false));
    EXPECT_TRUE(info.setTransformPoints(false));
    EXPECT_TRUE(info.setUseSampleFPS(true));
    EXPECT_TRUE(info.setSampleFPS(29.97f));
    EXPECT_TRUE(info.setFrame(12.5f));
    EXPECT_TRUE(info.setComputeCameraRotation(true));
    EXPECT_TRUE(info.setAllObjects(false));
    EXPECT_TRUE(info.setObjectName("camera1"));
    EXPECT_TRUE(info.setObjectID(7));
    EXPECT_TRUE(info.setFidelity(kFbxFidelityFaithful));
    return info;
}

void expectChanged(const TnFbxReadInfo& info) {
    EXPECT_EQ(info.getFileName(), "scene.fbx");
    EXPECT_EQ(info.getAimationStackName(), "Take 001");
    EXPECT_TRUE(info.haveAnimationStack());
    EXPECT_FALSE(info.getGlobalTransform());
    EXPECT_FALSE(info.getTransformPoints());
    EXPECT_TRUE(info.getUseSampleFPS());
    EXPECT_EQ(info.getSampleFPS(), 29.97f);
    EXPECT_EQ(info.getFrame(), 12.5f);
    EXPECT_TRUE(info.getComputeCameraRotation());
    EXPECT_FALSE(info.getAllObjects());
    EXPECT_EQ(info.getObjectName(), "camera1");
    EXPECT_EQ(info.getObjectID(), 7);
    EXPECT_EQ(info.getFidelity(), kFbxFidelityFaithful);
}

TEST(TnFbxReadInfo, StartsWithItsDefaults) { expectDefaults(TnFbxReadInfo()); }

TEST(TnFbxReadInfo, StoresEveryOption) { expectChanged(changedInfo()); }

TEST(TnFbxReadInfo, HasAnAnimationStackAsSoonAsItIsNamed) {
    TnFbxReadInfo info;

    info.setAnimationStackName("Take 001");
    EXPECT_TRUE(info.haveAnimationStack());
    EXPECT_EQ(info.getAimationStackName(), "Take 001");

    info.setAnimationStackName(" ");
    EXPECT_TRUE(info.haveAnimationStack());

    info.setAnimationStackName("");
    EXPECT_FALSE(info.haveAnimationStack());
}

TEST(TnFbxReadInfo, StoresWithoutACheck) {
    TnFbxReadInfo info;

    EXPECT_TRUE(info.setSampleFPS(-1.0f));
    EXPECT_TRUE(info.setFrame(-test::kInfinity));
    EXPECT_TRUE(info.setObjectID(test::kLowest));
    EXPECT_TRUE(info.setFileName(std::string("a\0b", 3)));
    EXPECT_TRUE(info.setObjectName("\xE4\xB8\xAD"));

    EXPECT_EQ(info.getSampleFPS(), -1.0f);
    EXPECT_EQ(info.getFrame(), -test::kInfinity);
    EXPECT_EQ(info.getObjectID(), test::kLowest);
    EXPECT_EQ(info.getFileName(), std::string("a\0b", 3));
    EXPECT_EQ(info.getObjectName(), "\xE4\xB8\xAD");
}

TEST(TnFbxReadInfo, ChangesOneFlagAtATime) {
    TnFbxReadInfo info;
    info.setGlobalTransform(false);
    EXPECT_TRUE(info.getTransformPoints());
    EXPECT_TRUE(info.getAllObjects());

    info.setUseSampleFPS(true);
    EXPECT_FALSE(info.getComputeCameraRotation());

    info.setAllObjects(false);
    EXPECT_TRUE(info.getTransformPoints());
    EXPECT_TRUE(info.getUseSampleFPS());
}

TEST(TnFbxReadInfo, InitAndDeleteRestoreTheDefaults) {
    TnFbxReadInfo info = changedInfo();
    EXPECT_TRUE(info.initReadInfo());
    expectDefaults(info);

    info = changedInfo();
    EXPECT_TRUE(info.deleteReadInfo());
    expectDefaults(info);
}

TEST(TnFbxReadInfo, AssignmentCopiesEveryOption) {
    TnFbxReadInfo target;

    target = changedInfo();
    expectChanged(target);

    const TnFbxReadInfo& alias = target;
    target = alias;
    expectChanged(target);
    expectChanged(TnFbxReadInfo(target));
}

} // namespace
} // namespace Tarnell::Fbx
