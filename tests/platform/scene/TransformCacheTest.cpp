// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The cache of global transforms: not observable, one evaluation of each ancestor per time, and within its budget.
#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <map>
#include <random>
#include <vector>

#include <fbxsdk/FbxNode.h>

#include "Animate.h"
#include "NodeEvaluationFixture.h"
#include "object/ManagerData.h"
#include "scene/NodeEvaluation.h"

namespace {

using namespace fbxsdk;
using namespace animate;

constexpr auto kSet = FbxNode::eSourcePivot;

class CacheInvalidationTest : public NodeEvaluationFixture {
protected:
    CacheInvalidationTest() : layer(addStack(*scene)), parent(addNode("parent")), child(addNode("child", parent)) {
        parent->LclTranslation.Set(FbxDouble3(1, 0, 0));
        child->LclTranslation.Set(FbxDouble3(10, 0, 0));
        curve = keys(child->LclRotation, layer, "Z", {{0, 0}, {1, 0}});
    }
    double x() { return globalX(child, seconds(0.5)); }

    FbxAnimLayer* layer;
    FbxNode* parent;
    FbxNode* child;
    FbxAnimCurve* curve;
};

TEST_F(CacheInvalidationTest, SeesAPropertyOfAnAncestorChange) {
    EXPECT_EQ(x(), 11.0);
    parent->LclTranslation.Set(FbxDouble3(2, 0, 0));
    EXPECT_EQ(x(), 12.0);
    scene->GetRootNode()->LclTranslation.Set(FbxDouble3(100, 0, 0));
    EXPECT_EQ(x(), 112.0);
}

TEST_F(CacheInvalidationTest, SeesPivotsAndInheritTypesChange) {
    EXPECT_EQ(x(), 11.0);
    parent->SetRotationOffset(kSet, FbxVector4(5, 0, 0));
    EXPECT_EQ(x(), 16.0);
    parent->SetPreRotation(kSet, FbxVector4(0, 0, 180));
    EXPECT_EQ(x(), 16.0);
    parent->SetRotationActive(true);
    EXPECT_NEAR(x(), -4.0, kMatrixTolerance);
}

TEST_F(CacheInvalidationTest, SeesANewKeyAndAChangedOne) {
    EXPECT_EQ(x(), 11.0);
    FbxAnimCurve* added = keys(parent->LclTranslation, layer, "X", {{0, 3}});
    EXPECT_EQ(x(), 13.0);
    added->KeySetValue(0, 4);
    EXPECT_EQ(x(), 14.0);
    added->KeyMultValue(2);
    EXPECT_EQ(x(), 18.0);
    added->KeyClear();
    EXPECT_EQ(x(), 11.0);
}

TEST_F(CacheInvalidationTest, SeesAChannelValueChange) {
    FbxAnimCurveNode* node = animate::constants(parent->LclTranslation, layer, 3, 0, 0);
    EXPECT_EQ(x(), 13.0);
    node->SetChannelValue(0, 4.0);
    EXPECT_EQ(x(), 14.0);
}

TEST_F(CacheInvalidationTest, SeesANodeMoveToAnotherParent) {
    EXPECT_EQ(x(), 11.0);
    FbxNode* other = addNode("other");
    other->LclTranslation.Set(FbxDouble3(5, 0, 0));
    other->AddChild(child);
    EXPECT_EQ(x(), 15.0);
    other->RemoveChild(child);
    EXPECT_EQ(x(), 10.0);
}

TEST_F(CacheInvalidationTest, SeesANewLayerAndItsSettings) {
    EXPECT_EQ(x(), 11.0);
    FbxAnimStack* stack = scene->GetCurrentAnimationStack();
    FbxAnimLayer* second = addLayer(*stack);
    keys(parent->LclTranslation, second, "X", {{0, 100}});
    EXPECT_EQ(x(), 111.0);
    second->Weight.Set(50.0);
    EXPECT_EQ(x(), 61.0);
    second->Mute.Set(true);
    EXPECT_EQ(x(), 11.0);
    second->Mute.Set(false);
    stack->RemoveMember(second);
    EXPECT_EQ(x(), 11.0);
}

TEST_F(CacheInvalidationTest, SeesTheCurrentStackChange) {
    FbxAnimLayer* other = addStack(*scene, "other");
    keys(parent->LclTranslation, other, "X", {{0, 50}});
    EXPECT_EQ(x(), 11.0);
    scene->SetCurrentAnimationStack(other->GetDstObject<FbxAnimStack>());
    EXPECT_EQ(x(), 60.0);
    scene->SetCurrentAnimationStack(nullptr);
    EXPECT_EQ(x(), 11.0);
}

TEST_F(CacheInvalidationTest, NotesThatObjectsAreDestroyed) {
    FbxAnimCurve* added = keys(parent->LclTranslation, layer, "X", {{0, 3}});
    EXPECT_EQ(x(), 13.0);
    added->Destroy();
    EXPECT_EQ(x(), 11.0);
    parent->Destroy();
    EXPECT_EQ(x(), 10.0);
    layer->Destroy();
    EXPECT_EQ(x(), 10.0);
}

TEST_F(CacheInvalidationTest, AsksAnAncestorOncePerTime) {
    keys(parent->LclTranslation, layer, "X", {{0, 0}, {1, 1}});
    FbxNode* leaf = addNode("leaf", child);

    for (int i = 0; i < 3; ++i) {
        globalX(leaf, seconds(0.25));
        globalX(leaf, seconds(0.5));
    }

    EXPECT_EQ(parent->evaluation().cache.used(), 2U);
    EXPECT_EQ(child->evaluation().cache.used(), 2U);
    EXPECT_EQ(leaf->evaluation().cache.places(), 0U); // a leaf's transform is not needed for another node
}

TEST_F(CacheInvalidationTest, KeepsOneTransformForAllTimesWhereNothingMoves) {
    FbxNode* still = addNode("still");
    FbxNode* leaf = addNode("leaf", still);
    for (int i = 0; i < 100; ++i)
        globalX(leaf, seconds(i));

    EXPECT_TRUE(still->evaluation().hasStillGlobal);
    EXPECT_TRUE(leaf->evaluation().hasStillGlobal);
    EXPECT_EQ(detail::evaluationBudgetOf(manager->data()).places(), 0U);
}

TEST_F(CacheInvalidationTest, CountsWhatItHoldsAndGivesItBack) {
    const detail::EvaluationBudget& budget = detail::evaluationBudgetOf(manager->data());
    keys(parent->LclTranslation, layer, "X", {{0, 0}, {1, 1}});
    addNode("leaf", child);
    for (int i = 0; i < 10; ++i)
        globalX(child, seconds(i));
    EXPECT_EQ(parent->evaluation().cache.used(), 10U);
    EXPECT_EQ(budget.places(), parent->evaluation().cache.places() + child->evaluation().cache.places());

    const std::size_t ofChild = child->evaluation().cache.places();
    parent->Destroy();

    EXPECT_EQ(budget.places(), ofChild);
}

TEST_F(CacheInvalidationTest, HandsTheMemoryOfReleasedTransformsToTheNextNode) {
    detail::EvaluationBudget& budget = detail::evaluationBudgetOf(manager->data());
    keys(parent->LclTranslation, layer, "X", {{0, 0}, {1, 1}});
    FbxNode* other = addNode("other");
    addNode("below", other);
    keys(other->LclTranslation, layer, "X", {{0, 0}, {1, 1}});
    for (int i = 0; i < 100; ++i)
        globalX(parent, seconds(i));
    const std::size_t places = parent->evaluation().cache.places();
    ASSERT_GE(places, 100U);

    budget.release(parent->evaluation());
    EXPECT_EQ(parent->evaluation().cache.places(), 0U);
    EXPECT_EQ(globalX(other, seconds(0)), 0.0);

    EXPECT_EQ(other->evaluation().cache.places(), places);
    EXPECT_EQ(other->evaluation().cache.used(), 1U);
    for (int i = 1; i < 100; ++i)
        EXPECT_EQ(globalX(other, seconds(i)), 1.0) << i;
    EXPECT_EQ(other->evaluation().cache.places(), places);
}

TEST_F(CacheInvalidationTest, StaysWithinItsBudgetHoweverManyNodesAndTimes) {
    keys(parent->LclTranslation, layer, "X", {{0, 0}, {1, 1}});
    FbxNode* node = child;
    for (int i = 0; i < 40; ++i)
        node = addNode("n", node);
    const detail::EvaluationBudget& budget = detail::evaluationBudgetOf(manager->data());

    for (int i = 0; i < 20'000; ++i)
        globalX(node, FbxTime(i));
    EXPECT_LE(budget.places(), detail::EvaluationBudget::kMostPlaces);

    // After that the result is that of a scene without a cache.
    EXPECT_EQ(globalX(node, seconds(1)), 11.0);
    EXPECT_EQ(globalX(child, seconds(0)), 10.0);
}

/// A chain whose first node is animated, evaluated node after node for the times of a list.
class LongChainTest : public NodeEvaluationFixture {
protected:
    LongChainTest() {
        FbxAnimLayer* layer = addStack(*scene);
        for (int i = 0; i < 20; ++i) // not more than the caches hold at 2,000 times each
            chain.push_back(addNode("n", chain.empty() ? nullptr : chain.back()));
        keys(chain.front()->LclTranslation, layer, "X", {{0, 0}, {2000, 2000}});
    }
    void readAll(const std::vector<FbxTime>& times) {
        for (FbxNode* node : chain)
            for (const FbxTime& time : times)
                EXPECT_NEAR(globalX(node, time), time.GetSecondDouble(), 1e-3);
    }
    static std::vector<FbxTime> ascending(int count) {
        std::vector<FbxTime> times;
        for (int i = 0; i < count; ++i)
            times.push_back(seconds(i * 0.25));
        return times;
    }

    std::vector<FbxNode*> chain;
};

TEST_F(LongChainTest, FindsEveryTimeOfTheParentWhateverTheirOrder) {
    std::vector<FbxTime> times = ascending(2000);
    for (int order = 0; order < 3; ++order) {
        if (order == 1)
            std::reverse(times.begin(), times.end());
        if (order == 2)
            std::shuffle(times.begin(), times.end(), std::minstd_rand(7));
        readAll(times);
        for (std::size_t i = 0; i + 1 < chain.size(); ++i)
            EXPECT_EQ(chain[i]->evaluation().cache.used(), times.size()) << "order " << order << ", node " << i;
        chain.front()->LclRotation.Set(FbxDouble3(0, 0, order)); // all recomputed
        chain.front()->LclRotation.Set(FbxDouble3(0, 0, 0));
    }
}

TEST_F(LongChainTest, NeedsRoomForOnePortionWhereTimesAreTakenInPortions) {
    const std::vector<FbxTime> times = ascending(4096);
    constexpr std::size_t kPortion = 64;
    for (std::size_t start = 0; start < times.size(); start += kPortion) {
        readAll({times.begin() + static_cast<std::ptrdiff_t>(start),
                 times.begin() + static_cast<std::ptrdiff_t>(start + kPortion)});
    }

    for (std::size_t i = 0; i + 1 < chain.size(); ++i)
        EXPECT_LE(chain[i]->evaluation().cache.places(), 2 * kPortion) << i;
}

TEST(TimeNumbers, GoUpByOneAndAreForgottenInTheirOrder) {
    detail::TimeNumbers numbers;
    EXPECT_EQ(numbers.numberOf(50), 0U);
    EXPECT_EQ(numbers.numberOf(10), 1U);
    EXPECT_EQ(numbers.numberOf(50), 0U);
    EXPECT_EQ(numbers.numberOf(10), 1U);
    EXPECT_EQ(numbers.newest(), 1U);

    constexpr auto kKept = static_cast<std::int64_t>(detail::TimeNumbers::kKept);
    for (std::int64_t i = 0; i < kKept - 1; ++i)
        EXPECT_EQ(numbers.numberOf(1000 + i), static_cast<std::uint64_t>(2 + i));
    EXPECT_EQ(numbers.numberOf(10), 1U);
    EXPECT_EQ(numbers.numberOf(50), detail::TimeNumbers::kKept + 1); // it was the oldest one
    EXPECT_EQ(numbers.numberOf(1000), 2U);
}

TEST(TimeNumbers, AreThoseOfAListOfTheLatestTimes) {
    detail::TimeNumbers numbers;
    std::map<std::int64_t, std::uint64_t> known;
    std::vector<std::int64_t> latest;
    std::minstd_rand random(5);
    constexpr auto kKept = static_cast<std::uint64_t>(detail::TimeNumbers::kKept);
    for (int i = 0; i < 200'000; ++i) {
        // Times that are close together, far apart, and the same in their lower bits.
        const auto ticks = static_cast<std::int64_t>(static_cast<std::uint64_t>(random() % 50'000) << (i % 3 * 20));
        const auto [place, isNew] = known.emplace(ticks, latest.size());
        ASSERT_EQ(numbers.numberOf(ticks), place->second) << i;
        if (!isNew)
            continue;
        latest.push_back(ticks);
        if (latest.size() > kKept)
            known.erase(latest[latest.size() - 1 - kKept]);
    }
    EXPECT_EQ(numbers.newest() + 1, latest.size());
    EXPECT_GT(latest.size(), 2 * kKept);
}

} // namespace
