// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Keys against the memory limit: a channel whose samples are all equal takes the memory of one, and as many keys as it
// has frames.
#include "support/FacadeReads.h"
#include "support/MemoryLimitScope.h"
#include "support/TemporaryFolder.h"
#include "support/WritingBuilders.h"

#include "Fbx.h"
#include "TnFbxError.h"
#include "TnFbxLimits.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <limits>

namespace Tarnell::Fbx {
namespace {

using support::MemoryLimitScope;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::StartsWith;

class KeyMemory : public testing::Test {
protected:
    bool write(int lastFrame) {
        TnFbxTime time;
        time.setTime(0.0f, 0, lastFrame, 24.0f);
        light.getTransformChannel(TnFbxTransform::kFbxTransformPositionX)->setConstantValues(time, 1.0f);
        TnFbxWriteInfo info;
        info.setFileName(folder.file("shot.fbx"));
        info.setAnimationStackName("Take 001");
        return Fbx().writeFile(info, {}, {&light}, {}, {}, {});
    }

    TnFbxLight light;
    support::TemporaryFolder folder;
};

TEST_F(KeyMemory, OfMoreThanTheLimitIsRefusedWithAReason) {
    const MemoryLimitScope limit(std::uint64_t{1} << 20);

    EXPECT_FALSE(write(std::numeric_limits<int>::max()));

    EXPECT_THAT(lastError(), StartsWith(folder.file("shot.fbx")));
    EXPECT_THAT(lastError(), HasSubstr("32.0 GiB of keys would be needed; the limit is 1.0 MiB"));
    EXPECT_THAT(folder.files(), IsEmpty());
}

TEST_F(KeyMemory, OfAllChannelsCountsTogether) {
    const MemoryLimitScope limit(std::uint64_t{40} << 10);
    EXPECT_TRUE(write(2000)) << lastError(); // of 16 bytes each
    TnFbxTime time;
    time.setTime(0.0f, 0, 2000, 24.0f);
    light.getLightChannel(TnFbxLight::kFbxLightRed)->setConstantValues(time, 1.0f);

    EXPECT_FALSE(write(2000));
}

// Channels at two rates are keyed together at the frames of one of them.
TEST_F(KeyMemory, OfRatesThatAreFarApartIsRefusedWithAReason) {
    const MemoryLimitScope limit(std::uint64_t{1} << 20);
    TnFbxCamera camera;
    camera.setValueAt(TnFbxCamera::kFbxCameraLookAtPositionX, test::timeOf(0, 3, 24.0f), {1.0f, 2.0f, 3.0f});
    camera.setTransformValueAt(TnFbxTransform::kFbxTransformPositionX, test::timeOf(0, 3, 1e-6f), {1.0f, 2.0f, 3.0f});
    TnFbxWriteInfo info;
    info.setFileName(folder.file("shot.fbx"));
    info.setAnimationStackName("Take 001");
    info.setFidelity(kFbxFidelityFaithful);

    EXPECT_FALSE(Fbx().writeFile(info, {&camera}, {}, {}, {}, {}));

    EXPECT_THAT(lastError(), HasSubstr("of keys would be needed; the limit is 1.0 MiB"));
    EXPECT_THAT(folder.files(), IsEmpty());
}

TEST_F(KeyMemory, WithinTheLimitIsWritten) {
    const MemoryLimitScope limit(std::uint64_t{1} << 20);

    ASSERT_TRUE(write(1000)) << lastError();

    test::FacadeRead<TnFbxLight> read(folder.file("shot.fbx"));
    EXPECT_EQ(read.objects[0].getTransformTime(TnFbxTransform::kFbxTransformPositionX).getEndFrame(), 1000);
}

} // namespace
} // namespace Tarnell::Fbx
