// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Scenes that are converted to another unit or other axes, and the placement of their nodes before and after.
#pragma once

#include <cstddef>
#include <iterator>
#include <vector>

#include <fbxsdk/FbxNode.h>

#include "platform/scene/Animate.h"
#include "platform/scene/PlainMatrix.h"
#include "platform/scene/SceneFixture.h"
#include "platform/scene/SeededRandom.h"

class ConversionFixture : public SceneFixture {
protected:
    static constexpr fbxsdk::FbxNode::EPivotSet kSet = fbxsdk::FbxNode::eSourcePivot;

    fbxsdk::FbxNode* addNode(const char* name, fbxsdk::FbxNode* parent = nullptr) {
        auto* node = make<fbxsdk::FbxNode>(name);
        (parent ? parent : scene->GetRootNode())->AddChild(node);
        return node;
    }

    /// The global matrices of all nodes below the root, at infinity and at a handful of times.
    std::vector<plain::Matrix> globals() {
        std::vector<plain::Matrix> matrices;
        for (int i = 1; i < scene->GetNodeCount(); ++i) {
            fbxsdk::FbxNode* node = scene->GetNode(i);
            matrices.push_back(plain::of(node->EvaluateGlobalTransform()));
            for (const double time : kTimes)
                matrices.push_back(plain::of(node->EvaluateGlobalTransform(animate::seconds(time))));
        }
        return matrices;
    }

    /// Every global matrix is the change times its former value.
    void expectAllChanged(const std::vector<plain::Matrix>& before, const plain::Matrix& change, double tolerance) {
        constexpr std::size_t kPerNode = std::size(kTimes) + 1;
        const auto after = globals();
        ASSERT_EQ(before.size(), after.size());
        for (std::size_t i = 0; i < before.size(); ++i) {
            const plain::Matrix expected = change * before[i];
            EXPECT_LT(plain::difference(after[i], expected), tolerance * (1.0 + plain::largest(expected)))
                << scene->GetNode(static_cast<int>(i / kPerNode) + 1)->GetName() << ", time " << i % kPerNode << "\n"
                << plain::text(after[i]) << "instead of\n"
                << plain::text(expected);
        }
    }

    /// Pivots, offsets and rotations before and after; the rest is the caller's.
    static void randomise(fbxsdk::FbxNode& node, SeededRandom& random, double rotationRange) {
        node.LclTranslation.Set(random.triple(-5, 5));
        node.LclRotation.Set(random.triple(-180, 180));
        node.LclScaling.Set(random.triple(0.4, 2));
        node.SetPreRotation(kSet, random.vector(-rotationRange, rotationRange));
        node.SetPostRotation(kSet, random.vector(-rotationRange, rotationRange));
        node.SetRotationOffset(kSet, random.vector(-2, 2));
        node.SetRotationPivot(kSet, random.vector(-2, 2));
        node.SetScalingOffset(kSet, random.vector(-2, 2));
        node.SetScalingPivot(kSet, random.vector(-2, 2));
        node.SetTransformationInheritType(static_cast<fbxsdk::FbxTransform::EInheritType>(random.whole(3)));
    }

private:
    static constexpr double kTimes[] = {-1, 0, 0.3, 1, 1.7, 5};
};
