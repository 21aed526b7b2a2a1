// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Lists in the world: long clips, deep trees, the cost of a list, and the stack that is evaluated.
#include "DeformationScenes.h"

#include "TnFbxError.h"

#include "support/MemoryLimitScope.h"
#include "support/SceneBuilders.h"

#include <gtest/gtest.h>

#include <array>
#include <cmath>
#include <cstring>
#include <memory>
#include <vector>

namespace Tarnell::Fbx {
namespace {

using test::readAll;
using test::TestScene;
using Transform = TnFbxTransform;

constexpr auto kPositionX = Transform::kFbxTransformPositionX;

/// Every null of the scene, read in the world.
std::vector<TnFbxNull> nullsOf(TestScene& scene) {
    std::vector<TnFbxNull> nulls(static_cast<std::size_t>(scene.sdk.getNumberOfNulls()));
    TnFbxReadInfo info = readAll(/*global*/ true);
    EXPECT_TRUE(scene.sdk.getNulls(info, nulls.data(), static_cast<int>(nulls.size()))) << lastError();
    return nulls;
}

Transform::EFbxTransformChannelType channelAt(int index) {
    return static_cast<Transform::EFbxTransformChannelType>(index);
}

void expectSameBits(Transform& a, Transform& b) {
    for (int i = 0; i < 9; ++i) {
        const std::vector<float> left = test::samplesOf(a, channelAt(i));
        const std::vector<float> right = test::samplesOf(b, channelAt(i));
        ASSERT_EQ(left.size(), right.size());
        EXPECT_EQ(std::memcmp(left.data(), right.data(), left.size() * sizeof(float)), 0)
            << a.getName() << ", channel " << i;
    }
}

TEST(ListsInTheWorld, AnimateTheOneNullThatMovesInALongClip) {
    constexpr int kLast = 20'000;
    const support::MemoryLimitScope limit((kLast + 1) * sizeof(float)); // of the one channel that changes
    TestScene scene(0, kLast);
    for (int i = 0; i < 100; ++i)
        scene.addNode("still");
    scene.key(scene.addNode("moving")->LclTranslation, "X", {{0, 10.0f}, {kLast, 1010.0f}});

    std::vector<TnFbxNull> nulls = nullsOf(scene);

    for (TnFbxNull& null : nulls) {
        test::expectRange(null.getTransformTime(kPositionX), 0, kLast, 24.0f);
        EXPECT_EQ(null.getTransformChannel(kPositionX)->isConstant(), null.getName() == "still");
    }
    EXPECT_EQ(nulls.back().getTransformValueAt(kPositionX, 0.0f), 10.0f);
    EXPECT_NEAR(nulls.back().getTransformValueAt(kPositionX, kLast / 2.0f), 510.0f, 1e-3f);
    EXPECT_EQ(nulls.back().getTransformValueAt(kPositionX, static_cast<float>(kLast)), 1010.0f);
}

TEST(ListsInTheWorld, BakeEveryMeshAtItsFrameHoweverLongTheClip) {
    constexpr int kLast = 20'000;
    TestScene scene(0, kLast);
    fbxsdk::FbxNode* mover = scene.addNode("mover");
    scene.key(mover->LclTranslation, "X", {{0, 0.0f}, {kLast, 1000.0f}});
    std::vector<TnFbxMesh> meshes(40);
    for (std::size_t i = 0; i < meshes.size(); ++i)
        mover->AddChild(test::addTriangle(scene, "mesh"));
    TnFbxReadInfo info = readAll(/*global*/ true);
    info.setFrame(kLast);
    info.setTransformPoints(true);

    ASSERT_TRUE(scene.sdk.getMeshes(info, meshes.data(), static_cast<int>(meshes.size()))) << lastError();

    for (TnFbxMesh& mesh : meshes) {
        float x = 0.0f, y = 0.0f, z = 0.0f;
        mesh.getControlPoint(0, x, y, z);
        EXPECT_EQ(x, 1000.0f);
        EXPECT_EQ(mesh.getTransformValueAt(kPositionX, static_cast<float>(kLast)), 1000.0f);
    }
}

/// A chain that rotates and moves at every level, with a leaf at each, over more frames than one portion.
class DeepScene : public TestScene {
public:
    DeepScene() : TestScene(-3, 2500) {
        fbxsdk::FbxNode* parent = nullptr;
        for (int depth = 0; depth < 12; ++depth) {
            parent = addNode("joint", parent);
            parent->LclTranslation.Set({1.0, 0.5 * depth, -2.0});
            if (depth % 3 == 0)
                key(parent->LclRotation, "Z", {{0, 0.0f}, {2500, 700.0f + static_cast<float>(depth)}});
            if (depth % 5 == 0)
                key(parent->LclScaling, "Y", {{0, 1.0f}, {2500, 1.5f}});
            addNode("leaf", parent)->LclRotation.Set({10.0 * depth, 20.0, 30.0});
        }
        addNode("aside");
    }
};

/// What the nine channels are without the memory of frames before: the documented decomposition of each product.
std::array<float, 9> placementAt(TestScene& scene, fbxsdk::FbxNode& node, const fbxsdk::FbxAMatrix& offset, int frame) {
    const fbxsdk::FbxAMatrix matrix = node.EvaluateGlobalTransform(test::timeOfFrame(frame)) * offset;
    const fbxsdk::FbxVector4 place = matrix.GetT(), angles = matrix.GetR(), scale = matrix.GetS();
    std::array<float, 9> values{};
    for (int i = 0; i < 3; ++i) {
        const auto at = static_cast<std::size_t>(i);
        values[at] = static_cast<float>(place[i]);
        values[3 + at] = static_cast<float>(angles[i]);
        values[6 + at] = static_cast<float>(scale[i]);
    }
    if (place[0] == 0.0 && place[1] == 0.0 && place[2] == 0.0)
        scene.sdk.extractMatrixRotation(matrix, values[3], values[4], values[5]);
    return values;
}

TEST(ListsInTheWorld, KeepAxesOnlyWhileTheyHaveTheSameBits) {
    constexpr int kFirst = -300, kLast = 300;
    TestScene scene(kFirst, kLast);
    const auto mover = [&](const fbxsdk::FbxDouble3& angles) {
        fbxsdk::FbxNode* node = scene.addNode("mover");
        node->LclRotation.Set(angles);
        // Through the origin, where another decomposition applies, and where the sign changes.
        scene.key(node->LclTranslation, "X", {{kFirst, -300.0f}, {kLast, 300.0f}});
        scene.key(node->LclTranslation, "Y", {{kFirst, 30.0f}, {0, 0.0f}, {kLast, 30.0f}});
        return node;
    };
    fbxsdk::FbxNode* jumping = mover({90.0, 89.9999, -20.0});
    scene.key(jumping->LclRotation, "Z", {{-20, 0.0f}, {20, 0.0f}, {21, 50.0f}, {40, 50.0f}});
    const std::vector<fbxsdk::FbxNode*> nodes = {mover({0.0, 0.0, 0.0}), mover({0.0, 90.0, 0.0}),
                                                 mover({180.0, -90.0, 12.0}), jumping};
    fbxsdk::FbxAMatrix offset;
    offset.SetTRS(fbxsdk::FbxVector4(0.0, -0.0, 1.0), fbxsdk::FbxVector4(0.0, 180.0, 0.0),
                  fbxsdk::FbxVector4(1.0, -2.0, 1.0));

    for (fbxsdk::FbxNode* node : nodes) {
        for (const fbxsdk::FbxAMatrix& geometric : {fbxsdk::FbxAMatrix(), offset}) {
            Transform transform;
            TnFbxTime time = scene.time();
            fbxsdk::FbxAMatrix given = geometric;
            ASSERT_TRUE(scene.sdk.getTransform(time, true, false, 0.0f, node, transform, given));
            for (int frame = kFirst; frame <= kLast; ++frame) {
                const std::array<float, 9> expected = placementAt(scene, *node, geometric, frame);
                for (int i = 0; i < 9; ++i) {
                    const float value = transform.getTransformValueAt(channelAt(i), static_cast<float>(frame));
                    ASSERT_EQ(std::memcmp(&value, &expected[static_cast<std::size_t>(i)], sizeof value), 0)
                        << "frame " << frame << ", channel " << i << ": " << value << " instead of "
                        << expected[static_cast<std::size_t>(i)];
                }
            }
        }
    }
}

TEST(ListsInTheWorld, GiveTheSameBitsAsNodesReadOneByOne) {
    DeepScene listed, single;
    std::vector<TnFbxNull> nulls = nullsOf(listed);
    ASSERT_EQ(nulls.size(), 25u);
    std::vector<fbxsdk::FbxNode*> nodes; // from the last one to the first
    for (int i = single.scene->GetNodeCount() - 1; i >= 0; --i)
        nodes.push_back(single.scene->GetNode(i));

    std::size_t compared = 0;
    for (fbxsdk::FbxNode* node : nodes) {
        const fbxsdk::FbxVector4 place = node->EvaluateGlobalTransform(test::timeOfFrame(7)).GetT();
        for (TnFbxNull& null : nulls) {
            const bool isSame = null.getName() == node->GetName() &&
                                null.getTransformValueAt(kPositionX, 7.0f) == static_cast<float>(place[0]) &&
                                null.getTransformValueAt(channelAt(1), 7.0f) == static_cast<float>(place[1]);
            if (!isSame)
                continue;
            Transform alone;
            fbxsdk::FbxAMatrix geometric;
            TnFbxTime time = single.time();
            ASSERT_TRUE(single.sdk.getTransform(time, true, false, 0.0f, node, alone, geometric));
            alone.setName(null.getName());
            expectSameBits(null, alone);
            ++compared;
            break;
        }
    }
    EXPECT_EQ(compared, nulls.size());
}

TEST(ListsInTheWorld, FailForWhatMovesBeyondTheLimitAndSayOverWhichFrames) {
    const support::MemoryLimitScope limit(3 * 101 * sizeof(float));
    TestScene scene(0, 100);
    for (const char* name : {"first", "second", "third", "fourth"})
        scene.key(scene.addNode(name)->LclTranslation, "X", {{0, 0.0f}, {100, 10.0f}});
    std::vector<TnFbxNull> nulls(4);
    TnFbxReadInfo info = readAll(/*global*/ true);

    EXPECT_FALSE(scene.sdk.getNulls(info, nulls.data(), 4));
    EXPECT_NE(lastError().find("frames 0 to 100 at 24 frames per second"), std::string::npos) << lastError();
    EXPECT_EQ(nulls[3].getName(), "fourth");
    EXPECT_FALSE(nulls[3].getTransformAnimated(kPositionX));

    TnFbxReadInfo one = test::readNamed("fourth", /*global*/ true);
    EXPECT_TRUE(scene.sdk.getNulls(one, nulls.data(), 1)) << lastError();
    EXPECT_EQ(nulls[0].getTransformValueAt(kPositionX, 100.0f), 10.0f);
}

TEST(ListsInTheWorld, EvaluateNoMoreThanTheLimitWhereNothingShows) {
    // A billion frames that change by less than a float can represent: what is returned is bounded, too.
    const support::MemoryLimitScope limit(1 << 16);
    TestScene scene(0, 1'000'000'000);
    fbxsdk::FbxNode* node = scene.addNode("mover");
    node->LclTranslation.Set({0.0, 1e30, 0.0});
    scene.key(node->LclTranslation, "X", {{0, 0.0f}, {1, 1e-30f}});
    std::vector<TnFbxNull> nulls(1);
    TnFbxReadInfo info = readAll(/*global*/ true);

    EXPECT_FALSE(scene.sdk.getNulls(info, nulls.data(), 1));
}

TEST(CameraTargets, ThatAreStaticRotateACameraOnceHoweverLongTheClip) {
    const support::MemoryLimitScope limit(1 << 16);
    TestScene scene(0, 1'000'000'000);
    fbxsdk::FbxNode* node = scene.add<fbxsdk::FbxCamera>("camera");
    fbxsdk::FbxNode* target = scene.addNode("target");
    target->LclTranslation.Set({0.0, 0.0, -10.0});
    node->SetTarget(target);
    TnFbxTime time;
    time.setTime(0.0f, 0, 1'000'000, 24.0f);
    TnFbxCamera camera;
    fbxsdk::FbxAMatrix geometric;

    ASSERT_TRUE(scene.sdk.getCamera(time, true, false, 0.0f, false, node, camera, geometric)) << lastError();

    const TnFbxChannel& turn = *camera.getTransformChannel(Transform::kFbxTransformRotationY);
    test::expectRange(turn.getTime(), 0, 1'000'000, 24.0f);
    EXPECT_TRUE(turn.isConstant());
    float x = 0.0f, y = 0.0f, z = 0.0f;
    camera.calculateCameraRotationAt(x, y, z, 500'000.0f);
    EXPECT_EQ(turn.getAnimatedValue(500'000.0f), y);
}

// ---- The stack that was chosen ----

class TwoStacks : public testing::Test {
protected:
    TwoStacks() : scene(0, 10) {
        second = fbxsdk::FbxAnimStack::Create(scene.scene, "second");
        auto* layer = fbxsdk::FbxAnimLayer::Create(scene.scene, "layer");
        second->AddMember(layer);
        second->SetLocalTimeSpan({test::timeOfFrame(0), test::timeOfFrame(20)});
        mover = scene.addNode("mover");
        scene.key(mover->LclTranslation, "X", {{0, 0.0f}, {10, 10.0f}});
        scene.key(mover->LclTranslation, "X", {{0, 100.0f}, {20, 200.0f}}, layer);
    }

    float moverAt(float frame, bool global) {
        TnFbxNull null;
        TnFbxReadInfo info = test::readNamed("mover", global);
        EXPECT_TRUE(scene.sdk.getNulls(info, &null, 1)) << lastError();
        return null.getTransformValueAt(kPositionX, frame);
    }

    TestScene scene;
    fbxsdk::FbxAnimStack* second = nullptr;
    fbxsdk::FbxNode* mover = nullptr;
};

TEST_F(TwoStacks, AreReadAsTheOneThatWasChosenHasIt) {
    EXPECT_EQ(moverAt(10.0f, false), 10.0f);
    EXPECT_EQ(moverAt(10.0f, true), 10.0f);

    ASSERT_TRUE(scene.sdk.setCurrentAnimationStack("second"));

    test::expectRange(scene.time(), 0, 20, 24.0f);
    EXPECT_EQ(moverAt(10.0f, false), 150.0f);
    EXPECT_EQ(moverAt(10.0f, true), 150.0f);
    EXPECT_EQ(moverAt(20.0f, true), 200.0f);

    EXPECT_FALSE(scene.sdk.setCurrentAnimationStack("third"));
    EXPECT_EQ(moverAt(20.0f, true), 200.0f);

    scene.sdk.initCreateAnimationStack(); // as loading does: back to the first
    EXPECT_EQ(moverAt(10.0f, false), 10.0f);
    EXPECT_EQ(moverAt(10.0f, true), 10.0f);
}

TEST_F(TwoStacks, DeformSkinsAsTheOneThatWasChosenHasIt) {
    fbxsdk::FbxNode* mesh = test::addPoints(scene, 1);
    fbxsdk::FbxCluster* cluster = test::addCluster(scene, test::addSkin(scene, mesh), {0.0, 0.0, 0.0});
    cluster->SetLink(mover);
    cluster->AddControlPointIndex(0, 1.0);
    test::expectPoint(test::deformed(scene, mesh, 10).at(0), 10.0, 0.0, 0.0);

    ASSERT_TRUE(scene.sdk.setCurrentAnimationStack("second"));

    test::expectPoint(test::deformed(scene, mesh, 10).at(0), 150.0, 0.0, 0.0);
}

} // namespace
} // namespace Tarnell::Fbx
