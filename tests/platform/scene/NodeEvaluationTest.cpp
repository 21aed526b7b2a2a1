// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Transforms of nodes: each term of the local matrix, the three inherit types, random trees against plain textbook
// matrices.
#include <cmath>
#include <cstddef>
#include <cstring>
#include <limits>
#include <string>
#include <vector>

#include <fbxsdk/FbxNode.h>
#include <fbxsdk/extensions/NodeSamples.h>

#include "Animate.h"
#include "NodeEvaluationFixture.h"
#include "SeededRandom.h"
#include "scene/NodeEvaluation.h"

namespace {

using namespace fbxsdk;
using namespace animate;

constexpr auto kSet = FbxNode::eSourcePivot;

constexpr struct {
    FbxEuler::EOrder order;
    const char* letters;
} kOrders[] = {{FbxEuler::eOrderXYZ, "XYZ"},       {FbxEuler::eOrderXZY, "XZY"}, {FbxEuler::eOrderYZX, "YZX"},
               {FbxEuler::eOrderYXZ, "YXZ"},       {FbxEuler::eOrderZXY, "ZXY"}, {FbxEuler::eOrderZYX, "ZYX"},
               {FbxEuler::eOrderSphericXYZ, "XYZ"}};

using NodeEvaluationTest = NodeEvaluationFixture;

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

    EXPECT_NEAR(point[0], 10 - 3, kMatrixTolerance);
    EXPECT_NEAR(point[1], 20 + 2, kMatrixTolerance);
    EXPECT_NEAR(point[2], 30 + 4, kMatrixTolerance);
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
    // kept: files have limits that their own values exceed; they limit interaction, not the value.
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

    EXPECT_NEAR(local.MultT(FbxVector4(1, 0, 0))[0], 1.0, kMatrixTolerance);
    EXPECT_NEAR(local.MultT(FbxVector4(1, 0, 0))[1], 0.0, kMatrixTolerance);
    EXPECT_NEAR(local.MultT(FbxVector4(0, 0, 0))[1], -1.0, kMatrixTolerance);
}

TEST_F(NodeEvaluationTest, ScalesAboutTheScalingPivot) {
    FbxNode* node = addNode();
    node->SetScalingPivot(kSet, FbxVector4(1, 0, 0));
    node->LclScaling.Set(FbxDouble3(3, 1, 1));

    const FbxAMatrix& local = node->EvaluateLocalTransform();

    EXPECT_NEAR(local.MultT(FbxVector4(1, 0, 0))[0], 1.0, kMatrixTolerance);
    EXPECT_NEAR(local.MultT(FbxVector4(2, 0, 0))[0], 4.0, kMatrixTolerance);
}

TEST_F(NodeEvaluationTest, ShiftsByTheRotationOffsetBeforeTheTurn) {
    FbxNode* node = addNode();
    node->SetRotationOffset(kSet, FbxVector4(5, 6, 7));
    node->LclRotation.Set(FbxDouble3(0, 0, 90));

    const FbxVector4 origin = node->EvaluateLocalTransform().GetT();

    EXPECT_NEAR(origin[0], 5.0, kMatrixTolerance);
    EXPECT_NEAR(origin[1], 6.0, kMatrixTolerance);
    EXPECT_NEAR(origin[2], 7.0, kMatrixTolerance);
}

TEST_F(NodeEvaluationTest, RotatesTheScalingOffset) {
    FbxNode* node = addNode();
    node->SetScalingOffset(kSet, FbxVector4(5, 0, 0));
    node->LclRotation.Set(FbxDouble3(0, 0, 90));
    node->LclScaling.Set(FbxDouble3(2, 2, 2));

    const FbxVector4 origin = node->EvaluateLocalTransform().GetT();

    EXPECT_NEAR(origin[0], 0.0, kMatrixTolerance);
    EXPECT_NEAR(origin[1], 5.0, kMatrixTolerance);
}

// Inherit types. The parent is scaled by (2, 1, 1) without rotation; the child is rotated by 90° about Z.

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
            EXPECT_NEAR(global.Get(0, i), x[i], kMatrixTolerance) << i;
            EXPECT_NEAR(global.Get(1, i), y[i], kMatrixTolerance) << i;
            EXPECT_NEAR(global.Get(2, i), i == 2 ? z : 0.0, kMatrixTolerance) << i;
            EXPECT_NEAR(global.Get(3, i), position[i], kMatrixTolerance) << i;
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

// The grandparent's scaling of (5, 1, 1) reaches the child through its parent. The child is rotated by 90° about Z:
// applied before its rotation, what it inherits stretches along the world's x, so the child's own y, which points
// there.
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

// Random trees against the formulas, implemented a second time with plain matrices.

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
    // Not close to zero: an inverse is computed.
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

    for (const double time : {1.0, 0.0, 0.5, 0.5, 0.25, 1.0})
        EXPECT_NEAR(globalX(leaf, seconds(time)), 100 * time + (1 + 2 * time) * 11, 1e-3) << time;
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
    scene->GetRootNode()->LclTranslation.Set(FbxDouble3(0, 0, 0)); // discards what was computed

    SeededRandom random(5);
    for (int i = 0; i < 2000; ++i) {
        const int frame = random.whole(24);
        const auto node = static_cast<std::size_t>(random.whole(5));
        EXPECT_EQ(plain::difference(evaluate(node, frame), first[static_cast<std::size_t>(frame) * 5 + node]), 0.0);
    }
}

/// An order, a rotation before it and a pivot.
void setRandomRotation(FbxNode& node, SeededRandom& random) {
    node.SetRotationActive(true);
    node.SetRotationOrder(kSet, kOrders[random.whole(6)].order);
    node.SetPreRotation(kSet, random.vector(-90, 90));
    node.SetRotationPivot(kSet, random.vector(-5, 5));
}

TEST_F(NodeEvaluationTest, GivesTheSameBitsForManyTimesTogether) {
    FbxAnimLayer* base = addStack(*scene);
    FbxAnimLayer* additive = addLayer(*base->GetScene()->GetCurrentAnimationStack());
    SeededRandom random(23);
    std::vector<FbxNode*> nodes = {scene->GetRootNode()};
    for (int i = 0; i < 60; ++i) {
        FbxNode* node = addNode("n", nodes[static_cast<std::size_t>(random.whole(static_cast<int>(nodes.size())))]);
        node->LclTranslation.Set(random.triple(-10, 10));
        node->LclScaling.Set(random.triple(0.5, 2));
        node->SetTransformationInheritType(static_cast<FbxTransform::EInheritType>(random.whole(3)));
        if (random.chance(2))
            setRandomRotation(*node, random);
        if (!random.chance(3)) {
            for (FbxAnimLayer* layer : {base, additive}) {
                keys(node->LclRotation, layer, "Y", {{0, random.real(-90, 90)}, {3, random.real(-90, 90)}});
                keys(node->LclTranslation, layer, "X", {{0, random.real(-9, 9)}, {1, 4}, {2, random.real(-9, 9)}});
            }
        }
        nodes.push_back(node);
    }
    std::vector<FbxTime> times;
    for (int frame = -10; frame < 150; ++frame)
        times.push_back(seconds(frame / 24.0));
    times.push_back(FBXSDK_TIME_INFINITE);
    times.push_back(times.front());

    std::vector<FbxAMatrix> together(times.size());
    for (FbxNode* node : nodes) {
        extensions::evaluateGlobalTransforms(*node, times.data(), static_cast<int>(times.size()), together.data());
        for (std::size_t i = 0; i < times.size(); ++i) {
            const FbxAMatrix alone = node->EvaluateGlobalTransform(times[i]);
            ASSERT_EQ(std::memcmp(&together[i], &alone, sizeof alone), 0) << node->GetName() << ' ' << i;
        }
    }
    for (auto node = nodes.rbegin(); node != nodes.rend(); ++node) { // children first, nothing in the cache
        scene->GetRootNode()->LclTranslation.Set(FbxDouble3(0, 0, 0));
        const std::vector<FbxAMatrix> before = [&] {
            std::vector<FbxAMatrix> matrices;
            for (const FbxTime& time : times)
                matrices.push_back((*node)->EvaluateGlobalTransform(time));
            return matrices;
        }();
        scene->GetRootNode()->LclTranslation.Set(FbxDouble3(0, 0, 0));
        extensions::evaluateGlobalTransforms(**node, times.data(), static_cast<int>(times.size()), together.data());
        ASSERT_EQ(std::memcmp(together.data(), before.data(), before.size() * sizeof(FbxAMatrix)), 0);
    }
    extensions::evaluateGlobalTransforms(*nodes.back(), nullptr, 0, nullptr);
}

/// A tree in which at most translations are animated. Its twin rotates and scales by level curves: it has the same
/// transforms, and their axes are computed at every time.
std::vector<FbxNode*> translatedTree(FbxScene& scene, bool isTwin) {
    FbxAnimLayer* layer = addStack(scene);
    SeededRandom random(41);
    std::vector<FbxNode*> nodes = {scene.GetRootNode()};
    for (int i = 0; i < 80; ++i) {
        FbxNode* node = FbxNode::Create(&scene, ("n" + std::to_string(i)).c_str());
        nodes[static_cast<std::size_t>(random.whole(static_cast<int>(nodes.size())))]->AddChild(node);
        node->LclTranslation.Set(random.triple(-10, 10));
        const auto angle = static_cast<double>(static_cast<float>(random.real(-180, 180)));
        const auto scale = static_cast<double>(static_cast<float>(random.real(-2, 2)));
        node->LclRotation.Set(FbxDouble3(angle, 30.0, -0.0));
        node->LclScaling.Set(FbxDouble3(1.0, random.chance(9) ? 0.0 : scale, random.chance(9) ? 1e200 : 1.0));
        node->SetTransformationInheritType(static_cast<FbxTransform::EInheritType>(random.whole(3)));
        if (random.chance(2)) {
            setRandomRotation(*node, random);
            node->SetScalingOffset(kSet, random.vector(-5, 5));
        }
        if (random.chance(3))
            keys(node->LclTranslation, layer, "X", {{0, random.real(-9, 9)}, {1, 1e30}, {2, random.real(-9, 9)}});
        if (isTwin) {
            keys(node->LclRotation, layer, "X", {{0, angle}});
            keys(node->LclScaling, layer, "X", {{0, 1.0}});
        }
        nodes.push_back(node);
    }
    return nodes;
}

TEST_F(NodeEvaluationTest, HasTheSameBitsWhereOnlyTranslationsAreAnimated) {
    FbxScene* twin = FbxScene::Create(manager, "twin");
    const std::vector<FbxNode*> nodes = translatedTree(*scene, false);
    const std::vector<FbxNode*> twins = translatedTree(*twin, true);
    std::vector<FbxTime> times = {FBXSDK_TIME_INFINITE, FbxTime(INT64_MIN), FbxTime(INT64_MAX), seconds(1e6)};
    for (int frame = -10; frame < 80; ++frame)
        times.push_back(seconds(frame / 24.0));
    const int count = static_cast<int>(times.size());
    std::vector<FbxAMatrix> matrices(times.size()), others(times.size());

    int translated = 0;
    for (std::size_t i = nodes.size(); i-- > 0;) { // children first
        extensions::evaluateGlobalTransforms(*nodes[i], times.data(), count, matrices.data());
        extensions::evaluateGlobalTransforms(*twins[i], times.data(), count, others.data());
        translated += nodes[i]->evaluation().chain == detail::Chain::translated ? 1 : 0;
        for (std::size_t at = 0; at < times.size(); ++at) {
            ASSERT_EQ(std::memcmp(&matrices[at], &others[at], sizeof(FbxAMatrix)), 0)
                << nodes[i]->GetName() << ' ' << at << plain::text(plain::of(matrices[at]))
                << plain::text(plain::of(others[at]));
            const FbxAMatrix alone = nodes[i]->EvaluateGlobalTransform(times[at]);
            ASSERT_EQ(std::memcmp(&matrices[at], &alone, sizeof alone), 0) << nodes[i]->GetName() << ' ' << at;
        }
    }
    EXPECT_GT(translated, 30);
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
