// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The write options: defaults, storage, and the one option that assignment does not copy.
#include "TnFbxWriteInfo.h"

#include "ModelValues.h"

#include <type_traits>

namespace Tarnell::Fbx {
namespace {

static_assert(TnFbxWriteInfo::kDefaultFPS == 24.0f);
static_assert(TnFbxWriteInfo::kDefaultStartFrame == 1.0f);
static_assert(TnFbxWriteInfo::kDefaultEndFrame == 1.0f);
static_assert(TnFbxWriteInfo::kFbxVersion2010 == 0);
static_assert(TnFbxWriteInfo::kFbxVersion2011 == 1);
static_assert(TnFbxWriteInfo::kFbxVersion2012 == 2);
static_assert(TnFbxWriteInfo::kFbxVersion2013 == 3);
static_assert(TnFbxWriteInfo::kFbxVersion2014 == 4);
static_assert(TnFbxWriteInfo::kFbxVersion2016 == 5);
static_assert(sizeof(TnFbxWriteInfo::eCompatibilityVersion) == 4);
static_assert(!std::is_polymorphic_v<TnFbxWriteInfo>);

struct Flag {
    const char* name;
    bool (TnFbxWriteInfo::*set)(bool);
    bool (TnFbxWriteInfo::*get)() const;
};

constexpr Flag kFlags[] = {
    {"FileFormat", &TnFbxWriteInfo::setFileFormat, &TnFbxWriteInfo::getFileFormat},
    {"WriteCameras", &TnFbxWriteInfo::setWriteCameras, &TnFbxWriteInfo::getWriteCameras},
    {"WriteLights", &TnFbxWriteInfo::setWriteLights, &TnFbxWriteInfo::getWriteLights},
    {"WriteTransforms", &TnFbxWriteInfo::setWriteTransforms, &TnFbxWriteInfo::getWriteTransforms},
    {"WriteNulls", &TnFbxWriteInfo::setWriteNulls, &TnFbxWriteInfo::getWriteNulls},
    {"WriteMeshes", &TnFbxWriteInfo::setWriteMeshes, &TnFbxWriteInfo::getWriteMeshes},
    {"AnimateMeshVertices", &TnFbxWriteInfo::setAnimateMeshVertices, &TnFbxWriteInfo::getAnimateMeshVertices},
    {"MayaVertexCacheFormat", &TnFbxWriteInfo::setMayaVertexCacheFormat, &TnFbxWriteInfo::getMayaVertexCacheFormat},
    {"ComputeCameraRotation", &TnFbxWriteInfo::setComputeCameraRotation, &TnFbxWriteInfo::getComputeCameraRotation},
};

void expectDefaults(const TnFbxWriteInfo& info) {
    EXPECT_EQ(info.getFileName(), "");
    EXPECT_EQ(info.getAnimationStackName(), "");
    for (const Flag& flag : kFlags)
        EXPECT_TRUE((info.*flag.get)()) << flag.name;
    EXPECT_EQ(info.getFPS(), 24.0f);
    EXPECT_EQ(info.getStartFrame(), 1.0f);
    EXPECT_EQ(info.getEndFrame(), 1.0f);
    EXPECT_EQ(info.getCompatibilityVersion(), 5);
    EXPECT_EQ(info.getFidelity(), kFbxFidelityCompatible);
}

/// Options in which every field differs from its default.
TnFbxWriteInfo changedInfo() {
    TnFbxWriteInfo info;
    EXPECT_TRUE(info.setFileName("out.fbx"));
    EXPECT_TRUE(info.setAnimationStackName("Walk"));
    for (const Flag& flag : kFlags)
        EXPECT_TRUE((info.*flag.set)(false)) << flag.name;
    EXPECT_TRUE(info.setFPS(30.0f));
    EXPECT_TRUE(info.setStartFrame(-2.5f));
    EXPECT_TRUE(info.setEndFrame(99.75f));
    EXPECT_TRUE(info.setCompatibilityVersion(TnFbxWriteInfo::kFbxVersion2012));
    EXPECT_TRUE(info.setFidelity(kFbxFidelityFaithful));
    return info;
}

void expectChanged(const TnFbxWriteInfo& info, TnFbxWriteInfo::eCompatibilityVersion version) {
    EXPECT_EQ(info.getFileName(), "out.fbx");
    EXPECT_EQ(info.getAnimationStackName(), "Walk");
    for (const Flag& flag : kFlags)
        EXPECT_FALSE((info.*flag.get)()) << flag.name;
    EXPECT_EQ(info.getFPS(), 30.0f);
    EXPECT_EQ(info.getStartFrame(), -2.5f);
    EXPECT_EQ(info.getEndFrame(), 99.75f);
    EXPECT_EQ(info.getCompatibilityVersion(), version);
    EXPECT_EQ(info.getFidelity(), kFbxFidelityFaithful);
}

TEST(TnFbxWriteInfo, StartsWithItsDefaults) { expectDefaults(TnFbxWriteInfo()); }

TEST(TnFbxWriteInfo, StoresEveryOption) { expectChanged(changedInfo(), TnFbxWriteInfo::kFbxVersion2012); }

TEST(TnFbxWriteInfo, ChangesOneFlagAtATime) {
    for (const Flag& changed : kFlags) {
        TnFbxWriteInfo info;
        (info.*changed.set)(false);
        for (const Flag& flag : kFlags)
            EXPECT_EQ((info.*flag.get)(), &flag != &changed) << changed.name << ", " << flag.name;
    }
}

TEST(TnFbxWriteInfo, StoresWithoutACheck) {
    TnFbxWriteInfo info;

    for (const int version : {0, 5, 6, -1, test::kLowest, test::kHighest}) {
        EXPECT_TRUE(info.setCompatibilityVersion(static_cast<TnFbxWriteInfo::eCompatibilityVersion>(version)));
        EXPECT_EQ(info.getCompatibilityVersion(), version);
    }
    EXPECT_TRUE(info.setFPS(0.0f));
    EXPECT_TRUE(info.setStartFrame(test::kInfinity));
    EXPECT_TRUE(info.setEndFrame(-1e30f));
    EXPECT_EQ(info.getFPS(), 0.0f);
    EXPECT_EQ(info.getStartFrame(), test::kInfinity);
    EXPECT_EQ(info.getEndFrame(), -1e30f);
}

TEST(TnFbxWriteInfo, InitAndDeleteRestoreTheDefaultsWithTheVersion) {
    TnFbxWriteInfo info = changedInfo();
    EXPECT_TRUE(info.initWriteInfo());
    expectDefaults(info);

    info = TnFbxWriteInfo(changedInfo());
    info.setCompatibilityVersion(TnFbxWriteInfo::kFbxVersion2010);
    EXPECT_TRUE(info.deleteWriteInfo());
    expectDefaults(info);
}

TEST(TnFbxWriteInfo, AssignmentCopiesEverythingButTheVersion) {
    TnFbxWriteInfo target;

    target = changedInfo();

    expectChanged(target, TnFbxWriteInfo::kFbxVersion2016);
}

TEST(TnFbxWriteInfo, AssignmentToItselfChangesNothing) {
    TnFbxWriteInfo info = changedInfo();
    const TnFbxWriteInfo& alias = info;

    info = alias;

    expectChanged(info, TnFbxWriteInfo::kFbxVersion2012);
}

TEST(TnFbxWriteInfo, ACopyHasTheVersionToo) {
    const TnFbxWriteInfo source = changedInfo();

    const TnFbxWriteInfo copy(source);

    expectChanged(copy, TnFbxWriteInfo::kFbxVersion2012);
}

} // namespace
} // namespace Tarnell::Fbx
