// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Transforms of nodes: each term of the local matrix, the three inherit types, random trees against plain textbook
// matrices, and the cache.
#include <algorithm>
#include <array>
#include <limits>
#include <random>
#include <string>
#include <vector>

#include <fbxsdk/FbxNode.h>

#include "Animate.h"
#include "SceneFixture.h"
#include "SeededRandom.h"
#include "object/ManagerData.h"
#include "platform/conversion/PlainMatrix.h"
#include "scene/NodeEvaluation.h"

namespace {

using namespace fbxsdk;
using animate::addLayer;
using animate::addStack;
using animate::keys;
using animate::seconds;

constexpr auto kSet = FbxNode::eSourcePivot;
/// Double arithmetic over products of a dozen matrices with elements of a few hundred.
constexpr double kTolerance = 1e-9;

constexpr struct {
    FbxEuler::EOrder order;
    const char* letters;
} kOrders[] = {{FbxEuler::eOrderXYZ, "XYZ"},       {FbxEuler::eOrderXZY, "XZY"}, {FbxEuler::eOrderYZX, "YZX"},
               {FbxEuler::eOrderYXZ, "YXZ"},       {FbxEuler::eOrderZXY, "ZXY"}, {FbxEuler::eOrderZYX, "ZYX"},
               {FbxEuler::eOrderSphericXYZ, "XYZ"}};

class NodeEvaluationTest : public SceneFixture {
protected:
    FbxNode* addNode(const char* name = "node", FbxNode* parent = nullptr) {
        FbxNode* node = make<FbxNode>(name);
        (parent ? parent : scene->GetRootNode())->AddChild(node);
        return node;
    }

    static void expectLocal(FbxNode* node, const plain::Matrix& expected, const char* what = "") {
        const plain::Matrix actual = plain::of(node->EvaluateLocalTransform());
        EXPECT_LT(plain::difference(actual, expected), kTolerance) << what << "\n"
                                                                   << plain::text(actual) << "instead of\n"
                                                                   << plain::text(expected);
    }
    static void expectGlobal(FbxNode* node, const plain::Matrix& expected, FbxTime time = FBXSDK_TIME_INFINITE) {
        const plain::Matrix actual = plain::of(node->EvaluateGlobalTransform(time));
        EXPECT_LT(plain::difference(actual, expected), kTolerance * (1.0 + plain::largest(expected)))
            << node->GetName() << "\n"
            << plain::text(actual) << "instead of\n"
            << plain::text(expected);
    }
    static double globalX(FbxNode* node, FbxTime time = FBXSDK_TIME_INFINITE) {
        return node->EvaluateGlobalTransform(time).GetT()[0];
    }
};

// One term after the other.

TEST_F(NodeEvaluationTest, IsTheIdentityForANewNode) {
    FbxNode* node = addNode();

    EXPECT_TRUE(node->EvaluateLocalTransform().IsIdentity());
    EXPECT_TRUE(node->EvaluateGlobalTransform().IsIdentity());
    EXPECT_TRUE(scene->GetRootNode()->EvaluateGlobalTransform(seconds(3)).IsIdentity());
}

TEST_F(NodeEvaluationTest, ScalesFirstThenRotatesThenTranslates) {
    FbxNode* node = addNode();
    node->LclTranslation.Set(FbxDouble3(10, 20, 30));
    node->LclRotation.Set(FbxDouble3(0, 0, 90));
    node->LclScaling.Set(FbxDouble3(2, 3, 4));

    const FbxVector4 point = node->EvaluateLocalTransform().MultT(FbxVector4(1, 1, 1));

    EXPECT_NEAR(point[0], 10 - 3, kTolerance);
    EXPECT_NEAR(point[1], 20 + 2, kTolerance);
    EXPECT_NEAR(point[2], 30 + 4, kTolerance);
}

TEST_F(NodeEvaluationTest, RotatesInTheOrderOfTheLetters) {
    for (const auto& row : kOrders) {
        FbxNode* node = addNode();
        node->SetRotationActive(true);
        node->SetRotationOrder(kSet, row.order);
        node->LclRotation.Set(FbxDouble3(30, 50, 70));

        expectLocal(node, plain::rotation(FbxDouble3(30, 50, 70), row.letters), row.letters);
    }
}

TEST_F(NodeEvaluationTest, RotatesBeforeAndAfterAlwaysInXyz) {
    FbxNode* node = addNode();
    node->SetRotationActive(true);
    node->SetRotationOrder(kSet, FbxEuler::eOrderZYX);
    node->SetPreRotation(kSet, FbxVector4(10, 20, 30));
    node->SetPostRotation(kSet, FbxVector4(40, 50, 60));
    node->LclRotation.Set(FbxDouble3(5, 15, 25));

    const FbxDouble3 pre(10, 20, 30), post(40, 50, 60), angles(5, 15, 25);
    expectLocal(node, plain::rotation(pre) * plain::rotation(angles, "ZYX") * plain::transposed(plain::rotation(post)));
}

TEST_F(NodeEvaluationTest, IgnoresOrderAndOuterRotationsWhileRotationIsInactive) {
    FbxNode* node = addNode();
    node->SetRotationOrder(kSet, FbxEuler::eOrderZYX);
    node->SetPreRotation(kSet, FbxVector4(10, 20, 30));
    node->SetPostRotation(kSet, FbxVector4(40, 50, 60));
    node->LclRotation.Set(FbxDouble3(5, 15, 25));
    ASSERT_FALSE(node->GetRotationActive());

    expectLocal(node, plain::rotation(FbxDouble3(5, 15, 25)));
}

TEST_F(NodeEvaluationTest, IgnoresOrderAndOuterRotationsThatServeLimitsOnly) {
    FbxNode* node = addNode();
    node->SetRotationActive(true);
    node->SetRotationSpaceForLimitOnly(kSet, true);
    node->SetRotationOrder(kSet, FbxEuler::eOrderZYX);
    node->SetPreRotation(kSet, FbxVector4(10, 20, 30));
    node->SetPostRotation(kSet, FbxVector4(40, 50, 60));
    node->LclRotation.Set(FbxDouble3(5, 15, 25));

    expectLocal(node, plain::rotation(FbxDouble3(5, 15, 25)));
}

TEST_F(NodeEvaluationTest, IgnoresLimits) {
    // kept: files carry limits that their own values exceed; they bind the hand, not the value.
    FbxNode* node = addNode();
    node->FindProperty("TranslationActive").Set(true);
    node->FindProperty("TranslationMaxX").Set(true);
    node->FindProperty("TranslationMax").Set(FbxDouble3(1, 1, 1));
    node->LclTranslation.Set(FbxDouble3(10, 0, 0));

    EXPECT_EQ(globalX(node), 10.0);
}

TEST_F(NodeEvaluationTest, IgnoresTheGeometricTransform) {
    FbxNode* node = addNode();
    node->SetGeometricTranslation(kSet, FbxVector4(1, 2, 3));
    node->SetGeometricRotation(kSet, FbxVector4(10, 20, 30));
    node->SetGeometricScaling(kSet, FbxVector4(2, 2, 2));

    EXPECT_TRUE(node->EvaluateGlobalTransform().IsIdentity());
}

TEST_F(NodeEvaluationTest, TurnsAboutTheRotationPivot) {
    FbxNode* node = addNode();
    node->SetRotationPivot(kSet, FbxVector4(1, 0, 0));
    node->LclRotation.Set(FbxDouble3(0, 0, 90));

    const FbxAMatrix& local = node->EvaluateLocalTransform();

    EXPECT_NEAR(local.MultT(FbxVector4(1, 0, 0))[0], 1.0, kTolerance);
    EXPECT_NEAR(local.MultT(FbxVector4(1, 0, 0))[1], 0.0, kTolerance);
    EXPECT_NEAR(local.MultT(FbxVector4(0, 0, 0))[1], -1.0, kTolerance);
}

TEST_F(NodeEvaluationTest, ScalesAboutTheScalingPivot) {
    FbxNode* node = addNode();
    node->SetScalingPivot(kSet, FbxVector4(1, 0, 0));
    node->LclScaling.Set(FbxDouble3(3, 1, 1));

    const FbxAMatrix& local = node->EvaluateLocalTransform();

    EXPECT_NEAR(local.MultT(FbxVector4(1, 0, 0))[0], 1.0, kTolerance);
    EXPECT_NEAR(local.MultT(FbxVector4(2, 0, 0))[0], 4.0, kTolerance);
}

TEST_F(NodeEvaluationTest, ShiftsByTheRotationOffsetBeforeTheTurn) {
    FbxNode* node = addNode();
    node->SetRotationOffset(kSet, FbxVector4(5, 6, 7));
    node->LclRotation.Set(FbxDouble3(0, 0, 90));

    const FbxVector4 origin = node->EvaluateLocalTransform().GetT();

    EXPECT_NEAR(origin[0], 5.0, kTolerance);
    EXPECT_NEAR(origin[1], 6.0, kTolerance);
    EXPECT_NEAR(origin[2], 7.0, kTolerance);
}

TEST_F(NodeEvaluationTest, TurnsTheScalingOffsetAlong) {
    FbxNode* node = addNode();
    node->SetScalingOffset(kSet, FbxVector4(5, 0, 0));
    node->LclRotation.Set(FbxDouble3(0, 0, 90));
    node->LclScaling.Set(FbxDouble3(2, 2, 2));

    const FbxVector4 origin = node->EvaluateLocalTransform().GetT();

    EXPECT_NEAR(origin[0], 0.0, kTolerance);
    EXPECT_NEAR(origin[1], 5.0, kTolerance);
}

// Inherit types. The parent is scaled by (2, 1, 1) and turned by nothing; the child is turned by 90° about Z.

class InheritTypeTest : public NodeEvaluationTest {
protected:
    FbxNode* parent = nullptr;
    FbxNode* child = nullptr;

    void build(FbxTransform::EInheritType type) {
        parent = addNode("parent");
        parent->LclScaling.Set(FbxDouble3(2, 1, 1));
        child = addNode("child", parent);
        child->SetTransformationInheritType(type);
        child->LclTranslation.Set(FbxDouble3(10, 0, 0));
        child->LclRotation.Set(FbxDouble3(0, 0, 90));
        child->LclScaling.Set(FbxDouble3(3, 1, 1));
    }
    /// Images of the axes, and the position.
    void expectColumns(const FbxVector4& x, const FbxVector4& y, const FbxVector4& position, double z = 1.0) {
        const FbxAMatrix& global = child->EvaluateGlobalTransform();
        for (int i = 0; i < 3; ++i) {
            EXPECT_NEAR(global.Get(0, i), x[i], kTolerance) << i;
            EXPECT_NEAR(global.Get(1, i), y[i], kTolerance) << i;
            EXPECT_NEAR(global.Get(2, i), i == 2 ? z : 0.0, kTolerance) << i;
            EXPECT_NEAR(global.Get(3, i), position[i], kTolerance) << i;
        }
    }
};

TEST_F(InheritTypeTest, RSrsStretchesTheTurnedChildAlongTheParentsAxes) {
    build(FbxTransform::eInheritRSrs);
    expectColumns({0, 3, 0}, {-2, 0, 0}, {20, 0, 0});
}

TEST_F(InheritTypeTest, RrSsStretchesTheTurnedChildAlongItsOwnAxes) {
    build(FbxTransform::eInheritRrSs);
    expectColumns({0, 6, 0}, {-1, 0, 0}, {20, 0, 0});
}

TEST_F(InheritTypeTest, RrsLeavesTheParentsScalingOutButKeepsThePositionInItsSpace) {
    build(FbxTransform::eInheritRrs);
    expectColumns({0, 3, 0}, {-1, 0, 0}, {20, 0, 0});
}

TEST_F(InheritTypeTest, RrsKeepsTheScalingThatTheParentInherits) {
    build(FbxTransform::eInheritRrs);
    FbxNode* top = addNode("top");
    top->LclScaling.Set(FbxDouble3(5, 5, 5));
    top->AddChild(parent);

    expectColumns({0, 15, 0}, {-5, 0, 0}, {100, 0, 0}, 5);
}

// The grandparent's scaling of (5, 1, 1) reaches the child through its parent. The child is turned by 90° about Z:
// taken before its turn, what is handed on stretches along the world's x, so the child's own y, which points there.
TEST_F(InheritTypeTest, RrsCompensatesBeforeTheNodesOwnTurn) {
    build(FbxTransform::eInheritRrs);
    FbxNode* top = addNode("top");
    top->LclScaling.Set(FbxDouble3(5, 1, 1));
    top->AddChild(parent);

    expectColumns({0, 3, 0}, {-5, 0, 0}, {100, 0, 0});
}

TEST_F(InheritTypeTest, OfANodeBelowTheRootMakesNoDifference) {
    for (const auto type : {FbxTransform::eInheritRrSs, FbxTransform::eInheritRSrs, FbxTransform::eInheritRrs}) {
        FbxNode* node = addNode();
        node->SetTransformationInheritType(type);
        node->LclTranslation.Set(FbxDouble3(1, 2, 3));
        node->LclRotation.Set(FbxDouble3(10, 20, 30));
        node->LclScaling.Set(FbxDouble3(2, 3, 4));

        expectGlobal(node, plain::of(node->EvaluateLocalTransform()));
    }
}

TEST_F(InheritTypeTest, RrsSurvivesAParentWithoutExtent) {
    build(FbxTransform::eInheritRrs);
    parent->LclScaling.Set(FbxDouble3(0, 0, 0));

    for (int row = 0; row < 4; ++row)
        for (int column = 0; column < 4; ++column)
            EXPECT_FALSE(std::isnan(child->EvaluateGlobalTransform().Get(row, column)));
}

// Random trees against the formulas, written down a second time with plain matrices.

struct PlainNode {
    FbxVector4 t, r, s{1, 1, 1}, pre, post, rotationOffset, rotationPivot, scalingOffset, scalingPivot;
    std::string order = "XYZ";
    bool active = false, limitOnly = false;
    FbxTransform::EInheritType inherit = FbxTransform::eInheritRrSs;

    [[nodiscard]] bool inForce() const { return active && !limitOnly; }
    [[nodiscard]] plain::Matrix turn() const {
        if (!inForce())
            return plain::rotation(r);
        return plain::rotation(pre) * plain::rotation(r, order) * plain::inverse(plain::rotation(post));
    }
    [[nodiscard]] plain::Matrix local() const {
        using plain::inverse;
        using plain::translation;
        return translation(t) * translation(rotationOffset) * translation(rotationPivot) * turn() *
               inverse(translation(rotationPivot)) * translation(scalingOffset) * translation(scalingPivot) *
               plain::scaling(s) * inverse(translation(scalingPivot));
    }
};

PlainNode randomNode(SeededRandom& random) {
    PlainNode node;
    const auto& order = kOrders[random.whole(7)];
    node.order = order.letters;
    node.t = random.vector(-50, 50);
    node.r = random.vector(-200, 200);
    // Away from zero: an inverse is taken.
    for (int i = 0; i < 3; ++i)
        node.s[i] = random.real(0.3, 2.5) * (random.chance(5) ? -1.0 : 1.0);
    node.active = !random.chance(4);
    node.limitOnly = random.chance(6);
    node.pre = random.vector(-180, 180);
    node.post = random.vector(-180, 180);
    if (!random.chance(3)) {
        node.rotationOffset = random.vector(-5, 5);
        node.rotationPivot = random.vector(-5, 5);
        node.scalingOffset = random.vector(-5, 5);
        node.scalingPivot = random.vector(-5, 5);
    }
    node.inherit = static_cast<FbxTransform::EInheritType>(random.whole(3));
    return node;
}

void apply(const PlainNode& source, FbxNode& node) {
    const auto triple = [](const FbxVector4& v) { return FbxDouble3(v[0], v[1], v[2]); };
    node.LclTranslation.Set(triple(source.t));
    node.LclRotation.Set(triple(source.r));
    node.LclScaling.Set(triple(source.s));
    node.SetRotationActive(source.active);
    node.SetRotationSpaceForLimitOnly(kSet, source.limitOnly);
    for (const auto& row : kOrders)
        if (source.order == row.letters && row.order != FbxEuler::eOrderSphericXYZ)
            node.SetRotationOrder(kSet, row.order);
    node.SetPreRotation(kSet, source.pre);
    node.SetPostRotation(kSet, source.post);
    node.SetRotationOffset(kSet, source.rotationOffset);
    node.SetRotationPivot(kSet, source.rotationPivot);
    node.SetScalingOffset(kSet, source.scalingOffset);
    node.SetScalingPivot(kSet, source.scalingPivot);
    node.SetTransformationInheritType(source.inherit);
}

TEST_F(NodeEvaluationTest, AgreesWithPlainMatricesOverAThousandTrees) {
    SeededRandom random(20240117);
    for (int tree = 0; tree < 1000; ++tree) {
        FbxNode* node = nullptr;
        plain::Matrix global, turn, parentScaling;
        for (int depth = 0; depth < 4; ++depth) {
            const PlainNode source = randomNode(random);
            node = addNode("node", node);
            apply(source, *node);

            const plain::Matrix local = source.local();
            const plain::Matrix inherited = plain::transposed(turn) * plain::linear(global);
            const plain::Matrix own = plain::scaling(source.s);
            plain::Matrix result = turn * source.turn() * inherited * own;
            if (source.inherit == FbxTransform::eInheritRSrs)
                result = plain::linear(global * local);
            if (source.inherit == FbxTransform::eInheritRrs)
                result = plain::linear(global) * plain::inverse(parentScaling) * source.turn() * own;
            const plain::Matrix placed = global * local;
            for (std::size_t i = 0; i < 3; ++i)
                result.at[i][3] = placed.at[i][3];

            expectLocal(node, local);
            expectGlobal(node, result);
            ASSERT_FALSE(HasFailure()) << "tree " << tree << ", depth " << depth;
            global = result;
            turn = turn * source.turn();
            parentScaling = own;
        }
    }
}

TEST_F(NodeEvaluationTest, OfAnActiveNodeThatInheritsRSrsIsTheParentsTimesTheLocalOne) {
    FbxNode* parent = addNode("parent");
    FbxNode* child = addNode("child", parent);
    SeededRandom random(3);
    for (FbxNode* node : {parent, child}) {
        apply(randomNode(random), *node);
        node->SetTransformationInheritType(FbxTransform::eInheritRSrs);
    }

    const FbxAMatrix global = parent->EvaluateGlobalTransform();
    expectGlobal(child, plain::of(global) * plain::of(child->EvaluateLocalTransform()));
}

// Animation.

TEST_F(NodeEvaluationTest, TakesAnimatedValuesAtATimeAndStaticOnesAtInfinity) {
    FbxAnimLayer* layer = addStack(*scene);
    FbxNode* node = addNode();
    node->LclTranslation.Set(FbxDouble3(7, 8, 9));
    keys(node->LclTranslation, layer, "X", {{0, 0}, {1, 100}});

    EXPECT_NEAR(globalX(node, seconds(0.25)), 25.0, 1e-4); // keys are of single precision
    EXPECT_EQ(node->EvaluateGlobalTransform(seconds(0.25)).GetT()[1], 8.0);
    EXPECT_EQ(globalX(node), 7.0);
    EXPECT_EQ(globalX(node, seconds(-5)), 0.0);
    EXPECT_EQ(globalX(node, seconds(5)), 100.0);
}

TEST_F(NodeEvaluationTest, MovesChildrenWithTheirAnimatedParents) {
    FbxAnimLayer* layer = addStack(*scene);
    FbxNode* top = addNode("top");
    FbxNode* middle = addNode("middle", top);
    FbxNode* leaf = addNode("leaf", middle);
    keys(top->LclTranslation, layer, "X", {{0, 0}, {1, 100}});
    keys(top->LclScaling, layer, "X", {{0, 1}, {1, 3}});
    middle->LclTranslation.Set(FbxDouble3(10, 0, 0));
    leaf->LclTranslation.Set(FbxDouble3(1, 0, 0));

    for (const double time : {1.0, 0.0, 0.5, 0.5, 0.25, 1.0}) {
        EXPECT_NEAR(globalX(leaf, seconds(time)), 100 * time + (1 + 2 * time) * 11, 1e-3) << time;
    }
    EXPECT_EQ(globalX(leaf), 11.0);
}

TEST_F(NodeEvaluationTest, GivesTheSameInAnyOrderOfTimesAndNodes) {
    FbxAnimLayer* layer = addStack(*scene);
    std::vector<FbxNode*> chain;
    for (int i = 0; i < 5; ++i) {
        chain.push_back(addNode("n", chain.empty() ? nullptr : chain.back()));
        keys(chain.back()->LclTranslation, layer, "X", {{0, 0}, {1, 1.0 + i}});
        keys(chain.back()->LclRotation, layer, "Z", {{0, 0}, {1, 10.0 * i}});
    }
    const auto evaluate = [&](std::size_t node, int frame) {
        return plain::of(chain[node]->EvaluateGlobalTransform(seconds(frame / 24.0)));
    };
    std::vector<plain::Matrix> first;
    for (int frame = 0; frame < 24; ++frame)
        for (std::size_t node = 0; node < 5; ++node)
            first.push_back(evaluate(node, frame));
    scene->GetRootNode()->LclTranslation.Set(FbxDouble3(0, 0, 0)); // forgets what was computed

    SeededRandom random(5);
    for (int i = 0; i < 2000; ++i) {
        const int frame = random.whole(24);
        const auto node = static_cast<std::size_t>(random.whole(5));
        EXPECT_EQ(plain::difference(evaluate(node, frame), first[static_cast<std::size_t>(frame) * 5 + node]), 0.0);
    }
}

TEST_F(NodeEvaluationTest, OfANodeInNoSceneIsItsStaticTransform) {
    FbxNode* node = FbxNode::Create(manager, "loose");
    node->LclTranslation.Set(FbxDouble3(1, 2, 3));

    EXPECT_EQ(globalX(node, seconds(1)), 1.0);
}

TEST_F(NodeEvaluationTest, ReturnsReferencesThatOutliveTheNextNodesEvaluation) {
    FbxNode* first = addNode("first");
    FbxNode* second = addNode("second");
    first->LclTranslation.Set(FbxDouble3(1, 0, 0));
    second->LclTranslation.Set(FbxDouble3(2, 0, 0));

    const FbxAMatrix& kept = first->EvaluateGlobalTransform();
    const FbxAMatrix& local = first->EvaluateLocalTransform();
    second->EvaluateGlobalTransform();

    EXPECT_EQ(kept.GetT()[0], 1.0);
    EXPECT_EQ(local.GetT()[0], 1.0);
}

TEST_F(NodeEvaluationTest, SurvivesNumbersThatAreNone) {
    FbxNode* node = addNode();
    const double nan = std::numeric_limits<double>::quiet_NaN();
    const double infinite = std::numeric_limits<double>::infinity();
    node->LclTranslation.Set(FbxDouble3(nan, infinite, 1e308));
    node->LclRotation.Set(FbxDouble3(nan, infinite, 1e308));
    node->LclScaling.Set(FbxDouble3(0, -infinite, nan));
    FbxNode* child = addNode("child", node);

    EXPECT_TRUE(std::isnan(child->EvaluateGlobalTransform(seconds(1)).Get(0, 0)));
}

// The cache must never show.

class CacheInvalidationTest : public NodeEvaluationTest {
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
    EXPECT_NEAR(x(), -4.0, kTolerance);
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

TEST_F(CacheInvalidationTest, SeesObjectsDie) {
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
    EXPECT_EQ(leaf->evaluation().cache.places(), 0U); // nobody asks a leaf's transform for another node
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

    // After that everything is as in a scene that was never asked.
    EXPECT_EQ(globalX(node, seconds(1)), 11.0);
    EXPECT_EQ(globalX(child, seconds(0)), 10.0);
}

/// A chain whose first node moves, asked node after node for the times of a list.
class LongChainTest : public NodeEvaluationTest {
protected:
    LongChainTest() {
        FbxAnimLayer* layer = addStack(*scene);
        for (int i = 0; i < 20; ++i) // not more than the caches hold at 2,000 times each
            chain.push_back(addNode("n", chain.empty() ? nullptr : chain.back()));
        keys(chain.front()->LclTranslation, layer, "X", {{0, 0}, {2000, 2000}});
    }
    void readAll(const std::vector<FbxTime>& times) {
        for (FbxNode* node : chain) {
            for (const FbxTime& time : times)
                EXPECT_NEAR(globalX(node, time), time.GetSecondDouble(), 1e-3);
        }
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
        chain.front()->LclRotation.Set(FbxDouble3(0, 0, order)); // all anew
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

TEST_F(NodeEvaluationTest, WalksAChainOfTenThousandWithoutRecursion) {
    FbxAnimLayer* layer = addStack(*scene);
    FbxNode* node = nullptr;
    for (int i = 0; i < 10'000; ++i) {
        node = addNode("n", node);
        node->LclTranslation.Set(FbxDouble3(1, 0, 0));
    }
    keys(scene->GetRootNode()->GetChild(0)->LclTranslation, layer, "X", {{0, 1}, {1, 2}});

    EXPECT_EQ(globalX(node), 10'000.0);
    EXPECT_NEAR(globalX(node, seconds(1)), 10'001.0, 1e-6);
}

} // namespace
