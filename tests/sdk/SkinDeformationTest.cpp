// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Skins of meshes with thousands of points, bit for bit against the matrices of one point after the other.
#include "support/SceneBuilders.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cstring>
#include <limits>
#include <memory>
#include <random>
#include <vector>

namespace Tarnell::Fbx {
namespace {

using fbxsdk::FbxAMatrix;
using fbxsdk::FbxCluster;
using fbxsdk::FbxVector4;
using Mode = FbxCluster::ELinkMode;
using Points = std::vector<FbxVector4>;

constexpr int kPoints = 2500; // several blocks, the last one not full
constexpr int kBones = 5;
constexpr int kHighest = std::numeric_limits<int>::max();

struct Influence {
    int point;
    double weight;
};
using Lists = std::vector<std::vector<Influence>>; ///< one per bone

/// Every point on about half of the bones.
Lists seededLists() {
    std::mt19937 random(11);
    Lists lists(kBones);
    for (int point = 0; point < kPoints; ++point) {
        for (auto& list : lists)
            if (random() % 2 == 0)
                list.push_back({point, static_cast<double>(random() % 1000) / 700.0});
    }
    return lists;
}

class BigSkin {
public:
    BigSkin(Mode mode, const Lists& lists) : mMode(mode), mLists(lists) {
        mNode = mScene.add<fbxsdk::FbxMesh>("mesh");
        std::mt19937 random(12);
        for (int i = 0; i < kPoints; ++i) {
            const auto number = [&random] { return static_cast<double>(random() % 100'000) / 777.0; };
            mRest.emplace_back(number(), number(), number());
        }
        test::fillMesh(*mNode->GetMesh(), mRest, {{0, 1, 2}});
        fbxsdk::FbxSkin* skin = fbxsdk::FbxSkin::Create(mScene.scene, "skin");
        mNode->GetMesh()->AddDeformer(skin);
        for (int bone = 0; bone < kBones; ++bone)
            skin->AddCluster(makeCluster(bone));
    }

    /// The library's result for the points.
    Points deformed() {
        fbxsdk::FbxTime time = test::timeOfFrame(0);
        FbxAMatrix identity;
        FbxVector4* made = nullptr;
        mScene.sdk.getDeformedControlPoints(mNode, mNode->GetMesh(), time, identity, &made);
        const std::unique_ptr<FbxVector4[]> owned(made);
        return {made, made + kPoints};
    }

    /// The same one influence after the other, on whole matrices.
    Points expected() {
        const bool additive = mMode == FbxCluster::eAdditive;
        FbxAMatrix none;
        mScene.sdk.matrixScale(none, 0.0);
        std::vector<FbxAMatrix> sums(kPoints, additive ? FbxAMatrix() : none);
        std::vector<double> totals(kPoints, 0.0);
        for (std::size_t bone = 0; bone < mLists.size(); ++bone) {
            const FbxAMatrix motion = mBones[bone]->EvaluateGlobalTransform(test::timeOfFrame(0));
            for (const Influence& influence : mLists[bone]) {
                if (influence.point < 0 || influence.point >= kPoints || influence.weight < 1e-5)
                    continue;
                const auto point = static_cast<std::size_t>(influence.point);
                FbxAMatrix scaled = (motion.Inverse() * FbxAMatrix()).Inverse() * FbxAMatrix();
                mScene.sdk.matrixScale(scaled, influence.weight);
                if (additive) {
                    mScene.sdk.matrixAddToDiagonal(scaled, 1.0 - influence.weight);
                    sums[point] = scaled * sums[point];
                } else {
                    mScene.sdk.matrixAdd(sums[point], scaled);
                }
                totals[point] += influence.weight;
            }
        }
        Points points = mRest;
        for (std::size_t i = 0; i < points.size(); ++i)
            if (totals[i] > 0.0)
                points[i] = placed(sums[i], totals[i], points[i]);
        return points;
    }

private:
    FbxCluster* makeCluster(int bone) {
        fbxsdk::FbxNode* node = mScene.addNode("bone");
        node->LclTranslation.Set({1.0 + bone, 2.0 * bone, 3.0});
        node->LclRotation.Set({10.0 * bone, 20.0, 30.0 - bone});
        FbxCluster* cluster = FbxCluster::Create(mScene.scene, "cluster");
        cluster->SetLink(node);
        cluster->SetLinkMode(mMode);
        for (const Influence& influence : mLists[static_cast<std::size_t>(bone)])
            cluster->AddControlPointIndex(influence.point, influence.weight);
        mBones.push_back(node);
        return cluster;
    }

    [[nodiscard]] FbxVector4 placed(const FbxAMatrix& sum, double total, const FbxVector4& rest) const {
        const FbxVector4 moved = sum.MultT(rest);
        if (mMode == FbxCluster::eAdditive)
            return moved;
        return mMode == FbxCluster::eNormalize ? moved / total : moved + rest * (1.0 - total);
    }

    test::TestScene mScene;
    Mode mMode;
    Lists mLists;
    fbxsdk::FbxNode* mNode = nullptr;
    std::vector<fbxsdk::FbxNode*> mBones;
    Points mRest;
};

/// The first point with other bits, or the number of points.
std::size_t firstDifference(const Points& a, const Points& b) {
    std::size_t i = 0;
    while (i < a.size() && i < b.size() && std::memcmp(&a[i], &b[i], sizeof(FbxVector4)) == 0)
        ++i;
    return i;
}

void expectBitsAsExpected(Mode mode, const Lists& lists) {
    BigSkin skin(mode, lists);
    EXPECT_EQ(firstDifference(skin.deformed(), skin.expected()), std::size_t{kPoints});
}

class SkinOfThousands : public testing::TestWithParam<Mode> {};
INSTANTIATE_TEST_SUITE_P(AllModes, SkinOfThousands,
                         testing::Values(FbxCluster::eNormalize, FbxCluster::eAdditive, FbxCluster::eTotalOne));

TEST_P(SkinOfThousands, IsTheSameAsPointAfterPoint) { expectBitsAsExpected(GetParam(), seededLists()); }

TEST_P(SkinOfThousands, TakesListsInAnyOrder) {
    Lists lists = seededLists();
    std::reverse(lists[1].begin(), lists[1].end());
    std::shuffle(lists[3].begin(), lists[3].end(), std::mt19937(13));

    expectBitsAsExpected(GetParam(), lists);
}

TEST_P(SkinOfThousands, AddsAPointThatIsListedTwiceTwice) {
    Lists lists = seededLists();
    lists[0].insert(lists[0].begin(), {{0, 0.5}, {0, 0.25}});
    lists[2].insert(lists[2].end(), {{kPoints - 1, 0.5}, {kPoints - 1, 0.25}});

    expectBitsAsExpected(GetParam(), lists);
}

TEST_P(SkinOfThousands, PassesOverIndicesOnBothSidesOfThePoints) {
    Lists lists = seededLists();
    lists[0].insert(lists[0].begin(), {{-kHighest - 1, 1.0}, {-1, 1.0}});
    lists[0].insert(lists[0].end(), {{kPoints, 1.0}, {kHighest, 1.0}});

    expectBitsAsExpected(GetParam(), lists);
}

TEST_P(SkinOfThousands, PassesOverIndicesThatAreNoPointsInTheMiddleOfAList) {
    Lists lists = seededLists();
    const std::vector<Influence> wrong = {{-1, 1.0}, {kHighest, 1.0}, {kPoints, 1.0}, {-kHighest - 1, 1.0}};
    lists[4].insert(lists[4].begin() + 500, wrong.begin(), wrong.end());

    expectBitsAsExpected(GetParam(), lists);
}

TEST(SkinOfFewPoints, MovesThePointsAtTheEdgesOfBlocksAndNoOthers) {
    Lists lists(kBones);
    lists[0] = {{0, 1.0}, {1023, 1.0}, {1024, 1.0}, {2047, 1.0}, {2048, 1.0}, {kPoints - 1, 1.0}};

    expectBitsAsExpected(FbxCluster::eNormalize, lists);
}

} // namespace
} // namespace Tarnell::Fbx
