// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Skins: link modes, bindings, weights and dual quaternions. Every expected point follows from shifts and from
// rotations about Z, written down in the test.
#include "FaithfulFixture.h"

#include <cmath>
#include <utility>
#include <vector>

namespace Tarnell::Fbx::test {
namespace {

using fbxsdk::FbxAMatrix;
using fbxsdk::FbxCluster;
using fbxsdk::FbxDouble3;
using fbxsdk::FbxNode;
using fbxsdk::FbxSkin;

constexpr double kRadians = 0.017453292519943295769;

FbxAMatrix placeAt(double x, double y, double z, double degreesAboutZ = 0.0) {
    FbxAMatrix matrix;
    matrix.SetTRS({x, y, z}, {0.0, 0.0, degreesAboutZ}, {1.0, 1.0, 1.0});
    return matrix;
}

Samples point(double x, double y, double z = 0.0) {
    return {static_cast<float>(x), static_cast<float>(y), static_cast<float>(z)};
}

/// A triangle (0,0,0), (1,0,0), (0,1,0) with a skin. Weights are those of the point (1,0,0).
struct SkinnedScene : TestScene {
    explicit SkinnedScene(FbxCluster::ELinkMode linkMode = FbxCluster::eNormalize, int lastFrame = 0)
        : TestScene(0, lastFrame), mode(linkMode) {
        node = addTriangle(*this, "mesh");
        skin = addSkin();
    }

    FbxSkin* addSkin() {
        auto* added = FbxSkin::Create(scene, "skin");
        node->GetMesh()->AddDeformer(added);
        return added;
    }

    /// On a bone that is at the origin now.
    FbxCluster& addCluster(double weight, const FbxAMatrix& boneWhenBound) {
        auto* cluster = FbxCluster::Create(scene, "cluster");
        cluster->SetLink(add<fbxsdk::FbxSkeleton>("bone"));
        cluster->SetLinkMode(mode);
        cluster->SetTransformLinkMatrix(boneWhenBound);
        cluster->AddControlPointIndex(1, weight);
        skin->AddCluster(cluster);
        return *cluster;
    }
    /// On a bone that moved since.
    FbxCluster& addShift(double weight, double x, double y, double z = 0.0) {
        FbxCluster& cluster = addCluster(weight, placeAt(10.0, 20.0, 30.0));
        cluster.GetLink()->LclTranslation.Set(FbxDouble3(10.0 + x, 20.0 + y, 30.0 + z));
        return cluster;
    }
    /// On a bone that rotated about Z since, about its own place.
    FbxCluster& addTurn(double weight, double degrees, double x = 0.0, double y = 0.0) {
        constexpr double z = 5.0; // two bones at the origin would state no binding
        FbxCluster& cluster = addCluster(weight, placeAt(x, y, z));
        cluster.GetLink()->LclTranslation.Set(FbxDouble3(x, y, z));
        cluster.GetLink()->LclRotation.Set(FbxDouble3(0.0, 0.0, degrees));
        return cluster;
    }

    /// All three points at a frame.
    Samples points(float frame = 0.0f, bool placed = true) {
        const SavedScene saved(*this);
        TnFbxReadInfo info = saved.info();
        info.setFrame(frame);
        info.setTransformPoints(placed);
        return pointsOf(FacadeRead<TnFbxMesh>(info)["mesh"]);
    }
    /// The one that has weights.
    Samples moved(float frame = 0.0f, bool placed = true) {
        const Samples all = points(frame, placed);
        return all.size() == 9 ? Samples(all.begin() + 3, all.begin() + 6) : Samples();
    }

    FbxCluster::ELinkMode mode;
    FbxNode* node = nullptr;
    FbxSkin* skin = nullptr;
};

// ---- Link modes and weights ----

TEST(FaithfulLinkModes, NormalizeDividesByTheSumOfTheWeights) {
    SkinnedScene scene(FbxCluster::eNormalize);
    scene.addShift(1.0, 4.0, 0.0);
    scene.addShift(3.0, 0.0, 8.0);
    EXPECT_THAT(scene.moved(), isNear(point(1.0 + 4.0 * 0.25, 8.0 * 0.75)));
    SkinnedScene weak(FbxCluster::eNormalize); // a share of the whole, however small
    weak.addShift(0.0001, 4.0, 0.0);
    EXPECT_THAT(weak.moved(), isNear(point(5.0, 0.0)));
}

TEST(FaithfulLinkModes, TotalOneLeavesTheRestWithTheMesh) {
    SkinnedScene scene(FbxCluster::eTotalOne);
    scene.addShift(0.25, 4.0, 0.0);
    scene.addShift(0.125, 0.0, 8.0);
    EXPECT_THAT(scene.moved(), isNear(point(2.0, 1.0)));
    // The mesh moves, too: a quarter and an eighth follow the bones, which were bound to it at the origin.
    scene.node->LclTranslation.Set(FbxDouble3(0.0, 0.0, 16.0));
    EXPECT_THAT(scene.moved(), isNear(point(2.0, 1.0, 16.0 * 0.625)));
}

TEST(FaithfulLinkModes, TotalOneTakesMoreThanOneAsItIs) {
    SkinnedScene scene(FbxCluster::eTotalOne);
    scene.addShift(1.0, 4.0, 0.0);
    scene.addShift(1.0, 0.0, 8.0);
    EXPECT_THAT(scene.moved(), isNear(point(5.0, 8.0)));
}

TEST(FaithfulLinkModes, AdditiveAppliesOneBoneAfterTheOther) {
    SkinnedScene turnedFirst(FbxCluster::eAdditive);
    turnedFirst.addTurn(1.0, 90.0);
    turnedFirst.addShift(0.5, 4.0, 0.0);
    EXPECT_THAT(turnedFirst.moved(), isNear(point(2.0, 1.0)));
    SkinnedScene shiftedFirst(FbxCluster::eAdditive);
    shiftedFirst.addShift(0.5, 4.0, 0.0);
    shiftedFirst.addTurn(1.0, 90.0);
    EXPECT_THAT(shiftedFirst.moved(), isNear(point(0.0, 3.0)));
}

TEST(FaithfulLinkModes, AdditiveWeightsAreSharesBetweenBeforeAndAfter) {
    SkinnedScene half(FbxCluster::eAdditive);
    half.addTurn(0.5, 90.0);
    EXPECT_THAT(half.moved(), isNear(point(0.5, 0.5)));
    SkinnedScene twice(FbxCluster::eAdditive);
    twice.addShift(2.0, 4.0, 0.0);
    EXPECT_THAT(twice.moved(), isNear(point(9.0, 0.0)));
}

TEST(FaithfulLinkModes, AdditiveIsRelativeToTheMesh) {
    SkinnedScene scene(FbxCluster::eAdditive);
    scene.addShift(0.5, 4.0, 0.0);
    scene.node->LclTranslation.Set(FbxDouble3(0.0, 8.0, 0.0));
    // In the mesh's own space the bone moved it by (4, −8, 0), of which half applies.
    EXPECT_THAT(scene.moved(), isNear(point(3.0, 4.0)));
    EXPECT_THAT(scene.points(), isNear({0.0f, 8.0f, 0.0f, 3.0f, 4.0f, 0.0f, 0.0f, 9.0f, 0.0f}));
}

TEST(FaithfulLinkModes, AdditiveIsRelativeToTheAssociateModelWhereThereIsOne) {
    SkinnedScene scene(FbxCluster::eAdditive);
    FbxCluster& cluster = scene.addShift(1.0, 5.0, 0.0);
    FbxNode* associate = scene.addNode("associate");
    associate->LclTranslation.Set(FbxDouble3(13.0, 0.0, 0.0));
    cluster.SetAssociateModel(associate);
    cluster.SetTransformAssociateModelMatrix(placeAt(10.0, 0.0, 0.0)); // it moved by 3 of the 5
    scene.node->LclTranslation.Set(FbxDouble3(0.0, 7.0, 0.0));
    EXPECT_THAT(scene.moved(), isNear(point(3.0, 7.0)));
}

TEST(FaithfulLinkModes, AnAssociateModelThatMovesLikeTheBoneLeavesThePoint) {
    SkinnedScene scene(FbxCluster::eAdditive);
    FbxCluster& cluster = scene.addTurn(1.0, 90.0);
    FbxNode* associate = scene.addNode("associate");
    associate->LclRotation.Set(FbxDouble3(0.0, 0.0, 90.0));
    cluster.SetAssociateModel(associate);
    EXPECT_THAT(scene.moved(), isNear(point(1.0, 0.0)));
    cluster.GetLink()->LclRotation.Set(FbxDouble3(0.0, 0.0, 120.0));
    EXPECT_THAT(scene.moved(), isNear(point(std::cos(30.0 * kRadians), std::sin(30.0 * kRadians))));
}

TEST(FaithfulLinkModes, AreThatOfTheFirstCluster) {
    SkinnedScene scene(FbxCluster::eTotalOne);
    scene.addShift(0.25, 4.0, 0.0);
    scene.addShift(0.25, 0.0, 8.0).SetLinkMode(FbxCluster::eNormalize);
    EXPECT_THAT(scene.moved(), isNear(point(2.0, 2.0)));
}

TEST(FaithfulWeights, OfZeroAndMissingOnesLeaveAPointWithItsNode) {
    for (const auto mode : {FbxCluster::eNormalize, FbxCluster::eAdditive, FbxCluster::eTotalOne}) {
        SkinnedScene scene(mode);
        scene.addShift(0.0, 4.0, 0.0);
        scene.node->LclTranslation.Set(FbxDouble3(0.0, 7.0, 0.0));
        EXPECT_THAT(scene.points(), isNear({0.0f, 7.0f, 0.0f, 1.0f, 7.0f, 0.0f, 0.0f, 8.0f, 0.0f})) << mode;
    }
}

TEST(FaithfulWeights, MayBeNegative) {
    SkinnedScene scene(FbxCluster::eNormalize);
    scene.addShift(1.5, 4.0, 0.0);
    scene.addShift(-0.5, 0.0, 8.0);
    EXPECT_THAT(scene.moved(), isNear(point(7.0, -4.0)));
}

TEST(FaithfulWeights, OfPointsThatTheMeshDoesNotHaveAreIgnored) {
    for (const auto mode : {FbxCluster::eNormalize, FbxCluster::eAdditive}) {
        SkinnedScene scene(mode);
        FbxCluster& cluster = scene.addShift(1.0, 4.0, 0.0);
        for (const int index : {-1, 3, 2147483647})
            cluster.AddControlPointIndex(index, 1.0);
        EXPECT_THAT(scene.points(), isNear({0.0f, 0.0f, 0.0f, 5.0f, 0.0f, 0.0f, 0.0f, 1.0f, 0.0f})) << mode;
    }
}

TEST(FaithfulWeights, OfOnePointInOneClusterAddUp) {
    SkinnedScene scene(FbxCluster::eTotalOne);
    scene.addShift(0.25, 4.0, 0.0).AddControlPointIndex(1, 0.5);
    EXPECT_THAT(scene.moved(), isNear(point(4.0, 0.0)));
}

TEST(FaithfulWeights, OfSeveralSkinsCountTogether) {
    SkinnedScene scene(FbxCluster::eNormalize);
    scene.addShift(1.0, 4.0, 0.0);
    scene.skin = scene.addSkin();
    scene.addShift(1.0, 0.0, 8.0);
    EXPECT_THAT(scene.moved(), isNear(point(3.0, 4.0)));
}

// ---- Bindings ----

TEST(FaithfulBindings, TurnAboutThePlaceWhereTheBoneWasBound) {
    SkinnedScene scene;
    FbxCluster& cluster = scene.addCluster(1.0, placeAt(2.0, 0.0, 0.0, 90.0)); // by −90 degrees since
    cluster.GetLink()->LclTranslation.Set(FbxDouble3(2.0, 0.0, 0.0));
    EXPECT_THAT(scene.moved(), isNear(point(2.0, 1.0)));
}

TEST(FaithfulBindings, PlaceTheMeshWhereItWasBoundNotWhereItIs) {
    SkinnedScene scene;
    scene.addShift(1.0, 3.0, 0.0).SetTransformMatrix(placeAt(0.0, 5.0, 0.0));
    scene.node->LclTranslation.Set(FbxDouble3(100.0, 100.0, 100.0));
    EXPECT_THAT(scene.moved(), isNear(point(4.0, 5.0)));
    // In the object's own space, to which its transform applies.
    EXPECT_THAT(scene.moved(0.0f, /*placed*/ false), isNear(point(-96.0, -95.0, -100.0)));
}

TEST(FaithfulBindings, IncludeTheGeometricTransform) {
    for (const auto mode : {FbxCluster::eNormalize, FbxCluster::eAdditive, FbxCluster::eTotalOne}) {
        SkinnedScene scene(mode);
        scene.node->SetGeometricTranslation(FbxNode::eSourcePivot, {0.0, 0.0, 9.0});
        scene.node->SetGeometricRotation(FbxNode::eSourcePivot, {0.0, 0.0, 90.0});
        scene.node->SetGeometricScaling(FbxNode::eSourcePivot, {2.0, 1.0, 1.0});
        scene.addShift(1.0, 4.0, 0.0);
        // (1,0,0) is at (0,2,9), (0,1,0) at (−1,0,9).
        EXPECT_THAT(scene.points(), isNear({0.0f, 0.0f, 9.0f, 4.0f, 2.0f, 9.0f, -1.0f, 0.0f, 9.0f})) << mode;
    }
}

TEST(FaithfulBindings, IncludeTheGeometricTransformRelativeToAnAssociateModel) {
    SkinnedScene scene(FbxCluster::eAdditive);
    scene.node->SetGeometricRotation(FbxNode::eSourcePivot, {0.0, 0.0, 90.0});
    scene.node->LclTranslation.Set(FbxDouble3(0.0, 0.0, 7.0));
    FbxCluster& cluster = scene.addShift(1.0, 5.0, 0.0);
    FbxNode* associate = scene.addNode("associate");
    associate->LclTranslation.Set(FbxDouble3(3.0, 0.0, 0.0));
    cluster.SetAssociateModel(associate);
    EXPECT_THAT(scene.moved(), isNear(point(2.0, 1.0, 7.0))); // (0,1,0) moved by 5 − 3
}

TEST(FaithfulBindings, OfClustersWithoutALinkKeepPointsInTheBindPose) {
    SkinnedScene scene;
    auto* cluster = FbxCluster::Create(scene.scene, "cluster");
    cluster->AddControlPointIndex(1, 1.0);
    cluster->SetTransformMatrix(placeAt(0.0, 5.0, 0.0));
    scene.skin->AddCluster(cluster);
    scene.node->LclTranslation.Set(FbxDouble3(0.0, 7.0, 0.0));
    EXPECT_THAT(scene.points(), isNear({0.0f, 7.0f, 0.0f, 1.0f, 5.0f, 0.0f, 0.0f, 8.0f, 0.0f}));
    scene.addShift(3.0, 0.0, 0.0, 4.0).SetTransformMatrix(placeAt(0.0, 5.0, 0.0));
    EXPECT_THAT(scene.moved(), isNear(point(1.0, 5.0, 3.0)));
}

/// Two clusters that state nothing; the first bone is static at (2,0,0) and moves by 4 along Z until frame 4.
struct UnboundScene : SkinnedScene {
    explicit UnboundScene(FbxCluster::ELinkMode linkMode) : SkinnedScene(linkMode, 4) {
        node->LclTranslation.Set(FbxDouble3(0.0, 7.0, 0.0));
        moving = &addCluster(1.0, FbxAMatrix());
        moving->GetLink()->LclTranslation.Set(FbxDouble3(2.0, 0.0, 0.0));
        key(moving->GetLink()->LclTranslation, "Z", {{0, 0.0f}, {4, 4.0f}});
        other = &addCluster(0.0, FbxAMatrix());
    }
    FbxCluster* moving = nullptr;
    FbxCluster* other = nullptr;
};

TEST(FaithfulBindings, OfSkinsThatStateNoneAreTheStaticPose) {
    for (const auto mode : {FbxCluster::eNormalize, FbxCluster::eAdditive, FbxCluster::eTotalOne}) {
        UnboundScene scene(mode);
        EXPECT_THAT(scene.moved(0.0f), isNear(point(1.0, 7.0))) << mode;
        EXPECT_THAT(scene.moved(3.0f), isNear(point(1.0, 7.0, 3.0))) << mode;
    }
}

TEST(FaithfulBindings, OfSkinsThatStateNoneAreTheStaticPoseForClustersWithoutALinkToo) {
    for (const auto mode : {FbxCluster::eNormalize, FbxCluster::eAdditive, FbxCluster::eTotalOne}) {
        UnboundScene scene(mode);
        scene.other->SetLink(nullptr);
        scene.other->AddControlPointIndex(2, 1.0);
        EXPECT_THAT(scene.points(3.0f), isNear({0.0f, 7.0f, 0.0f, 1.0f, 7.0f, 3.0f, 0.0f, 8.0f, 0.0f})) << mode;
    }
}

TEST(FaithfulBindings, OfSkinsThatStateNoneAreTheStaticPoseOfAssociateModelsToo) {
    UnboundScene scene(FbxCluster::eAdditive);
    FbxNode* associate = scene.addNode("associate");
    associate->LclTranslation.Set(FbxDouble3(11.0, 12.0, 13.0));
    scene.key(associate->LclTranslation, "Z", {{0, 13.0f}, {4, 15.0f}});
    scene.moving->SetAssociateModel(associate);
    EXPECT_THAT(scene.moved(0.0f), isNear(point(1.0, 7.0)));
    EXPECT_THAT(scene.moved(4.0f), isNear(point(1.0, 7.0, 2.0))); // 4, of which the associate model moved 2
}

TEST(FaithfulBindings, OfASingleClusterAreStatedEvenAtTheOrigin) {
    SkinnedScene scene;
    scene.addCluster(1.0, FbxAMatrix()).GetLink()->LclTranslation.Set(FbxDouble3(2.0, 0.0, 0.0));
    EXPECT_THAT(scene.moved(), isNear(point(3.0, 0.0)));
}

TEST(FaithfulSkins, ThatMirrorTurnTheirPolygonsRound) {
    SkinnedScene scene;
    FbxCluster& cluster = scene.addCluster(1.0, placeAt(0.0, 0.0, 0.0));
    for (const int index : {0, 2})
        cluster.AddControlPointIndex(index, 1.0);
    cluster.GetLink()->LclScaling.Set(FbxDouble3(-1.0, 1.0, 1.0));
    auto read = readFaithfully<TnFbxMesh>(scene);
    EXPECT_THAT(pointsOf(read["mesh"]), isNear({0.0f, 0.0f, 0.0f, -1.0f, 0.0f, 0.0f, 0.0f, 1.0f, 0.0f}));
    EXPECT_THAT(pointIndicesOf(read["mesh"]), testing::ElementsAre(0, 2, 1));
}

// ---- Dual quaternions ----

struct DualScene : SkinnedScene {
    explicit DualScene(FbxCluster::ELinkMode linkMode = FbxCluster::eNormalize) : SkinnedScene(linkMode) {
        skin->SetSkinningType(FbxSkin::eDualQuaternion);
    }
};

/// Where a rotation about Z, through a place on the X axis, moves (1,0,0).
Samples turned(double degrees, double x) {
    return point(x + (1.0 - x) * std::cos(degrees * kRadians), (1.0 - x) * std::sin(degrees * kRadians));
}

TEST(FaithfulDualQuaternions, BlendARotationAboutItsOwnAxis) {
    for (const double share : {0.25, 0.5, 0.75, 1.0}) {
        DualScene scene;
        scene.addShift(1.0 - share, 0.0, 0.0);
        scene.addTurn(share, 90.0, 3.0);
        // Half of the angle of (1 − share) + share · (cos 45° + sin 45° k).
        const double angle = 2.0 * std::atan2(share * std::sqrt(0.5), 1.0 - share + share * std::sqrt(0.5)) / kRadians;
        EXPECT_THAT(scene.moved(), isNear(turned(angle, 3.0))) << share;
    }
}

TEST(FaithfulDualQuaternions, BlendShiftsLikeMatrices) {
    DualScene scene;
    scene.addShift(1.0, 4.0, 0.0);
    scene.addShift(3.0, 0.0, 8.0, -4.0);
    EXPECT_THAT(scene.moved(), isNear(point(2.0, 6.0, -3.0)));
}

TEST(FaithfulDualQuaternions, GoTheShorterWayRound) {
    DualScene scene;
    scene.addTurn(1.0, 100.0);
    scene.addTurn(1.0, -100.0); // 160 degrees further, through 180
    EXPECT_THAT(scene.moved(), isNear(point(-1.0, 0.0)));
}

TEST(FaithfulDualQuaternions, StretchBeforeTheyTurn) {
    DualScene scene;
    for (const double degrees : {0.0, 60.0}) {
        FbxCluster& cluster = scene.addTurn(1.0, degrees);
        cluster.GetLink()->LclScaling.Set(FbxDouble3(degrees > 0.0 ? 3.0 : 1.0, 1.0, 1.0));
    }
    // Twice as long, in the mean, and turned by 30 degrees.
    EXPECT_THAT(scene.moved(), isNear(point(2.0 * std::cos(30.0 * kRadians), 2.0 * std::sin(30.0 * kRadians))));
}

TEST(FaithfulDualQuaternions, MirrorAsTheirBonesDo) {
    DualScene scene;
    scene.addTurn(1.0, 90.0).GetLink()->LclScaling.Set(FbxDouble3(-2.0, 1.0, 1.0));
    EXPECT_THAT(scene.moved(), isNear(point(0.0, -2.0)));
}

TEST(FaithfulDualQuaternions, OfTotalOneBlendWithTheMesh) {
    DualScene scene(FbxCluster::eTotalOne);
    scene.addTurn(0.5, 90.0);
    EXPECT_THAT(scene.moved(), isNear(turned(45.0, 0.0)));
}

TEST(FaithfulDualQuaternions, LeavePointsWithoutWeightsWithTheNode) {
    DualScene scene;
    scene.addTurn(1.0, 90.0);
    scene.node->LclTranslation.Set(FbxDouble3(0.0, 7.0, 0.0));
    EXPECT_THAT(scene.points(), isNear({0.0f, 7.0f, 0.0f, 0.0f, 1.0f, 0.0f, 0.0f, 8.0f, 0.0f}));
}

TEST(FaithfulDualQuaternions, ApplyWhereABlendedSkinHasAShare) {
    for (const double share : {0.0, 0.25, 1.0}) {
        SkinnedScene scene;
        scene.skin->SetSkinningType(FbxSkin::eBlend);
        for (const int index : {-1, 1, 3})
            scene.skin->AddControlPointIndex(index, share);
        scene.addTurn(1.0, 0.0, 0.0, 5.0);
        scene.addTurn(1.0, 90.0);
        // The mean of (1,0) and (0,1), and the point halfway on the circle.
        const double half = std::sqrt(0.5);
        const double both = 0.5 + share * (half - 0.5);
        EXPECT_THAT(scene.moved(), isNear(point(both, both))) << share;
    }
}

} // namespace
} // namespace Tarnell::Fbx::test
