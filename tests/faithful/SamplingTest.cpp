// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Faithful samples are made some at a time: each is what a read of its frame alone gives.
#include "faithful/Sampling.h"
#include "FaithfulFixture.h"

#include "FbxFaithful.h"
#include "TnFbxError.h"

#include <gtest/gtest.h>

#include <cstring>
#include <limits>

namespace Tarnell::Fbx {
namespace {

using test::SavedScene;
using test::TestScene;
using Transform = TnFbxTransform;

TEST(FaithfulSampling, TakesZerosAndWhatIsNoNumberForOneValueEach) {
    const double nan = std::numeric_limits<double>::quiet_NaN();
    faithful::Columns<2> columns;
    columns.add(std::array<double, 2>{0.0, nan});
    columns.add(std::array<double, 2>{-0.0, -nan});
    ASSERT_EQ(columns.size(), 2u);
    for (std::size_t i = 0; i < 2; ++i) {
        detail::SampleRun run;
        run.begin(2);
        EXPECT_FALSE(run.spreadsWith(columns[i], 2));
    }
}

/// Position, scale and skew: angles are continuous from frame to frame.
void expectSameAsAlone(const Transform& samples, const Transform& alone, int frame) {
    for (int i = 0; i <= Transform::kFbxTransformSkewZ; ++i) {
        const auto channel = static_cast<Transform::EFbxTransformChannelType>(i);
        if (channel >= Transform::kFbxTransformRotationX && channel <= Transform::kFbxTransformRotationZ)
            continue;
        const float sample = samples.getTransformValueAt(channel, static_cast<float>(frame)) + 0.0f;
        const float value = alone.getTransformValue(channel) + 0.0f;
        EXPECT_EQ(std::memcmp(&sample, &value, sizeof value), 0)
            << Transform::getTransformChannelName(channel) << " at " << frame << ": " << sample << ", " << value;
    }
}

TEST(FaithfulSampling, GivesTheBitsOfEachFrameAlone) {
    constexpr int kLast = 600; // more than two portions
    TestScene built(0, kLast);
    fbxsdk::FbxNode* parent = nullptr;
    for (int depth = 0; depth < 5; ++depth) {
        parent = built.addNode("joint", parent);
        parent->LclTranslation.Set({3.0, depth - 0.7, 1.0});
        parent->LclScaling.Set({1.0, 1.5, 0.5 + depth});
        parent->SetTransformationInheritType(fbxsdk::FbxTransform::eInheritRSrs);
        if (depth != 1)
            built.key(parent->LclTranslation, "X", {{0, 1.0f}, {kLast, 200.0f}});
        if (depth % 2 == 1)
            built.key(parent->LclRotation, "Y", {{0, -10.0f}, {300, 500.0f}});
        if (depth == 3)
            built.key(parent->LclScaling, "X", {{0, 1.0f}, {kLast, -1.0f}});
        built.addNode("leaf", parent)->LclRotation.Set({10.0, 20.0 * depth, 5.0});
    }
    for (const bool global : {true, false}) {
        const SavedScene saved(built);
        TnFbxReadInfo info = saved.info();
        info.setGlobalTransform(global);
        FbxFaithful reader;
        ASSERT_TRUE(reader.load(info)) << lastError();
        for (int i = 0; i < reader.getScene()->GetNodeCount(); ++i) {
            fbxsdk::FbxNode& node = *reader.getScene()->GetNode(i);
            Transform samples;
            ASSERT_TRUE(reader.setFrame(0.0f) && reader.read(node, samples)) << lastError();
            for (const int frame : {0, 1, 63, 64, 255, 256, 257, 511, 512, 599, 600}) {
                Transform alone;
                ASSERT_TRUE(reader.setFrame(static_cast<float>(frame)) && reader.read(node, alone)) << lastError();
                expectSameAsAlone(samples, alone, frame);
            }
        }
    }
}

} // namespace
} // namespace Tarnell::Fbx
