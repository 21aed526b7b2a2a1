// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Directions without length, axes without scale, matrices without inverse and values that are no numbers.
#include "FaithfulFixture.h"

#include "TnFbxError.h"

#include "faithful/Decomposition.h"

#include <cmath>
#include <limits>
#include <utility>
#include <vector>

namespace Tarnell::Fbx::test {
namespace {

using fbxsdk::FbxCamera;
using fbxsdk::FbxDouble3;
using fbxsdk::FbxNode;
using Transform = TnFbxTransform;

constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();
constexpr double kRadians = 0.017453292519943295769;

Samples numbers(double x, double y, double z) {
    return {static_cast<float>(x), static_cast<float>(y), static_cast<float>(z)};
}

/// A direction of an object's own space in that of its parent, rotated about X, Y and Z in turn.
Samples directed(const Transform& object, double x, double y, double z) {
    EXPECT_EQ(object.getTransformRotationOrder(), Transform::kFbxRotationOrderXYZ);
    const Samples angles = rotationOf(object);
    double vector[3] = {x, y, z};
    for (std::size_t axis = 0; axis < 3; ++axis) {
        const double angle = static_cast<double>(angles[axis]) * kRadians;
        double& first = vector[(axis + 1) % 3];
        double& second = vector[(axis + 2) % 3];
        const double turned = first * std::cos(angle) - second * std::sin(angle);
        second = first * std::sin(angle) + second * std::cos(angle);
        first = turned;
    }
    return numbers(vector[0], vector[1], vector[2]);
}

// ---- Cameras ----

/// A camera at the origin that looks along X without its target.
struct AimedScene : TestScene {
    AimedScene() {
        node = add<FbxCamera>("camera");
        target = addNode("target");
        node->SetTarget(target);
    }

    void expectAxes(const Samples& right, const Samples& forward) {
        auto cameras = readFaithfully<TnFbxCamera>(*this);
        EXPECT_THAT(directed(cameras["camera"], 1.0, 0.0, 0.0), isNear(right)) << "to the right";
        EXPECT_THAT(directed(cameras["camera"], 0.0, 0.0, -1.0), isNear(forward)) << "forward";
        EXPECT_THAT(scaleOf(cameras["camera"]), isNear({1.0f, 1.0f, 1.0f}));
    }

    FbxNode* node = nullptr;
    FbxNode* target = nullptr;
};

TEST(FaithfulAim, AtTheCamerasOwnPlaceLeavesItsRotation) {
    AimedScene scene;
    for (FbxNode* node : {scene.node, scene.target})
        node->LclTranslation.Set(FbxDouble3(1.0, 2.0, 3.0));
    scene.node->LclRotation.Set(FbxDouble3(0.0, 30.0, 0.0));
    const double angle = 30.0 * kRadians;
    scene.expectAxes(numbers(std::sin(angle), 0.0, std::cos(angle)), numbers(std::cos(angle), 0.0, -std::sin(angle)));
}

TEST(FaithfulAim, AlongTheUpVectorKeepsTheCamerasOwnUpDirection) {
    AimedScene scene;
    scene.target->LclTranslation.Set(FbxDouble3(0.0, 10.0, 0.0));
    scene.node->LclRotation.Set(FbxDouble3(90.0, 0.0, 0.0)); // its up direction is Z
    scene.expectAxes(numbers(1.0, 0.0, 0.0), numbers(0.0, 1.0, 0.0));
}

TEST(FaithfulAim, AlongTheUpVectorAndTheCamerasOwnKeepsWhatIsOnItsRight) {
    for (const double height : {10.0, -10.0}) {
        AimedScene scene;
        scene.target->LclTranslation.Set(FbxDouble3(0.0, height, 0.0));
        scene.expectAxes(numbers(0.0, 0.0, 1.0), numbers(0.0, height / 10.0, 0.0));
        scene.node->LclRotation.Set(FbxDouble3(0.0, 90.0, 0.0)); // along −Z
        scene.expectAxes(numbers(1.0, 0.0, 0.0), numbers(0.0, height / 10.0, 0.0));
    }
}

TEST(FaithfulAim, WithoutAnUpDirectionKeepsTheCamerasOwn) {
    for (const double up : {0.0, kNaN}) {
        AimedScene scene;
        scene.target->LclTranslation.Set(FbxDouble3(0.0, 0.0, -10.0));
        scene.node->GetCamera()->UpVector.Set(FbxDouble3(up, up, up));
        scene.node->LclRotation.Set(FbxDouble3(90.0, 0.0, 0.0)); // Z, which is along the view: its right is −Y
        scene.expectAxes(numbers(0.0, -1.0, 0.0), numbers(0.0, 0.0, -1.0));
        scene.node->LclRotation.Set(FbxDouble3(0.0, 0.0, 0.0));
        scene.expectAxes(numbers(1.0, 0.0, 0.0), numbers(0.0, 0.0, -1.0));
    }
}

TEST(FaithfulAim, AlongTheUpVectorIsRolledFromThere) {
    AimedScene scene;
    scene.target->LclTranslation.Set(FbxDouble3(0.0, 10.0, 0.0));
    scene.node->GetCamera()->Roll.Set(90.0);
    scene.expectAxes(numbers(1.0, 0.0, 0.0), numbers(0.0, 1.0, 0.0)); // its up direction is now on its left
}

TEST(FaithfulAim, AtAnInterestAtTheCamerasOwnPlaceLeavesItsRotation) {
    for (const double place : {2.0, kNaN}) {
        TestScene scene;
        FbxNode* node = scene.add<FbxCamera>("camera");
        node->LclTranslation.Set(FbxDouble3(1.0, 2.0, 3.0));
        node->LclRotation.Set(FbxDouble3(0.0, 30.0, 0.0));
        node->GetCamera()->InterestPosition.Set(FbxDouble3(1.0, place, 3.0));
        const SavedScene saved(scene);
        TnFbxReadInfo info = saved.info();
        info.setComputeCameraRotation(true);
        FacadeRead<TnFbxCamera> read(info);
        EXPECT_THAT(rotationOf(read["camera"]), isNear({0.0f, -60.0f, 0.0f})) << place; // −90 from X to −Z
    }
}

TEST(FaithfulAim, OfACameraOfNoSizeAlongTheUpVectorLeavesItsRotation) {
    AimedScene scene;
    scene.target->LclTranslation.Set(FbxDouble3(0.0, 10.0, 0.0));
    scene.node->LclTranslation.Set(FbxDouble3(0.0, 3.0, 0.0));
    scene.node->LclScaling.Set(FbxDouble3(0.0, 0.0, 0.0));
    auto read = readFaithfully<TnFbxCamera>(scene);
    EXPECT_THAT(positionOf(read["camera"]), isNear({0.0f, 3.0f, 0.0f}));
    EXPECT_THAT(rotationOf(read["camera"]), isNear({0.0f, 0.0f, 0.0f})) << "nothing determines one";
    EXPECT_THAT(scaleOf(read["camera"]), isNear({0.0f, 0.0f, 0.0f}));
}

TEST(FaithfulAim, FollowsAnUpNode) {
    AimedScene scene;
    scene.node->LclTranslation.Set(FbxDouble3(5.0, 0.0, 0.0));
    scene.target->LclTranslation.Set(FbxDouble3(5.0, 0.0, -10.0));
    FbxNode* above = scene.addNode("above");
    scene.node->SetTargetUp(above);
    above->LclTranslation.Set(FbxDouble3(9.0, 0.0, 0.0)); // along X
    scene.expectAxes(numbers(0.0, -1.0, 0.0), numbers(0.0, 0.0, -1.0));
    above->LclTranslation.Set(FbxDouble3(5.0, 0.0, 0.0)); // where the camera is
    scene.expectAxes(numbers(1.0, 0.0, 0.0), numbers(0.0, 0.0, -1.0));
}

TEST(FaithfulAim, IsInTheParentsSpaceWhereThePlacementIs) {
    AimedScene scene;
    FbxNode* parent = scene.addNode("parent");
    parent->LclTranslation.Set(FbxDouble3(10.0, 0.0, 0.0));
    parent->LclRotation.Set(FbxDouble3(0.0, 90.0, 0.0)); // its X is −Z of the world
    parent->AddChild(scene.node);
    scene.node->GetCamera()->UpVector.Set(FbxDouble3(0.0, 0.0, 1.0));
    scene.target->LclTranslation.Set(FbxDouble3(10.0, 6.0, -5.0));
    const SavedScene saved(scene);
    TnFbxReadInfo info = saved.info();
    info.setGlobalTransform(false);
    FacadeRead<TnFbxCamera> read(info);
    const TnFbxCamera& camera = read["camera"];
    EXPECT_NEAR(camera.getValue(TnFbxCamera::kFbxCameraLookAtPositionX), 5.0f, 1e-5f);
    EXPECT_NEAR(camera.getValue(TnFbxCamera::kFbxCameraLookAtPositionY), 6.0f, 1e-5f);
    EXPECT_NEAR(camera.getValue(TnFbxCamera::kFbxCameraLookAtPositionZ), 0.0f, 1e-5f);
    EXPECT_NEAR(camera.getValue(TnFbxCamera::kFbxCameraUpPositionX), -1.0f, 1e-5f);
    EXPECT_NEAR(camera.getValue(TnFbxCamera::kFbxCameraUpPositionZ), 0.0f, 1e-5f);
    const double length = std::hypot(5.0, 6.0);
    EXPECT_THAT(directed(camera, 0.0, 0.0, -1.0), isNear(numbers(5.0 / length, 6.0 / length, 0.0)));
}

TEST(FaithfulAim, BelowAFlatParentIsTheNodesOwnPlaceAndRotation) {
    AimedScene scene;
    FbxNode* parent = scene.addNode("parent");
    parent->LclScaling.Set(FbxDouble3(1.0, 0.0, 1.0));
    parent->LclTranslation.Set(FbxDouble3(100.0, 0.0, 0.0));
    parent->AddChild(scene.node);
    scene.node->LclTranslation.Set(FbxDouble3(1.0, 2.0, 3.0));
    scene.node->LclRotation.Set(FbxDouble3(0.0, 90.0, 0.0));
    scene.target->LclTranslation.Set(FbxDouble3(0.0, 50.0, 0.0));
    const SavedScene saved(scene);
    TnFbxReadInfo info = saved.info();
    info.setGlobalTransform(false);
    FacadeRead<TnFbxCamera> read(info);
    EXPECT_THAT(positionOf(read["camera"]), isNear({1.0f, 2.0f, 3.0f}));
    EXPECT_THAT(directed(read["camera"], 0.0, 0.0, -1.0), isNear({0.0f, 0.0f, -1.0f}));
}

// ---- Axes without scale ----

TEST(FaithfulFlatNodes, KeepTheirAnglesAndTheOtherScales) {
    for (const auto& [x, y, z] : {std::tuple(1.0, 0.0, 3.0), std::tuple(2.0, 0.0, 0.0), std::tuple(0.0, 0.0, -4.0),
                                  std::tuple(0.0, 0.0, 0.0)}) {
        TestScene scene;
        FbxNode* node = scene.addNode("node");
        node->LclTranslation.Set(FbxDouble3(7.0, 8.0, 9.0));
        node->LclRotation.Set(FbxDouble3(10.0, 20.0, 400.0));
        node->LclScaling.Set(FbxDouble3(x, y, z));
        auto read = readFaithfully<Transform>(scene);
        EXPECT_THAT(positionOf(read["node"]), isNear({7.0f, 8.0f, 9.0f}));
        EXPECT_THAT(rotationOf(read["node"]), isNear({10.0f, 20.0f, 400.0f})) << x << ' ' << y << ' ' << z;
        EXPECT_THAT(scaleOf(read["node"]), isNear(numbers(x, y, z)));
    }
}

TEST(FaithfulFlatNodes, ThatGrowFromNothingDoNotTurn) {
    TestScene scene(0, 3);
    FbxNode* node = scene.addNode("node");
    node->LclRotation.Set(FbxDouble3(10.0, 20.0, 30.0));
    for (const char* component : {"X", "Y", "Z"})
        scene.key(node->LclScaling, component, {{1, 0.0f}, {3, 2.0f}});
    auto read = readFaithfully<Transform>(scene);
    EXPECT_THAT(samplesOf(read["node"], Transform::kFbxTransformScaleY), isNear({0.0f, 0.0f, 1.0f, 2.0f}));
    EXPECT_THAT(rotationOf(read["node"]), isNear({10.0f, 20.0f, 30.0f}));
    for (const auto channel :
         {Transform::kFbxTransformRotationX, Transform::kFbxTransformRotationY, Transform::kFbxTransformRotationZ})
        EXPECT_FALSE(read["node"].getTransformAnimated(channel));
}

TEST(FaithfulFlatNodes, BelowParentsThatVanishDoNotTurnInTheWorld) {
    TestScene scene(0, 4);
    FbxNode* parent = scene.addNode("parent");
    parent->LclRotation.Set(FbxDouble3(0.0, 0.0, 50.0));
    for (const char* component : {"X", "Y", "Z"})
        scene.key(parent->LclScaling, component, {{0, 2.0f}, {2, 0.0f}, {3, 0.0f}, {4, 1.0f}});
    FbxNode* node = scene.addNode("node", parent);
    node->LclRotation.Set(FbxDouble3(0.0, 0.0, 20.0));
    auto read = readFaithfully<Transform>(scene);
    EXPECT_THAT(samplesOf(read["node"], Transform::kFbxTransformScaleX), isNear({2.0f, 1.0f, 0.0f, 0.0f, 1.0f}));
    EXPECT_THAT(rotationOf(read["node"]), isNear({0.0f, 0.0f, 70.0f}));
    EXPECT_FALSE(read["node"].getTransformAnimated(Transform::kFbxTransformRotationZ));
}

TEST(FaithfulFlatNodes, BelowAFlatParentHaveTheirOwnLocalTransform) {
    TestScene scene;
    FbxNode* parent = scene.addNode("parent");
    parent->LclScaling.Set(FbxDouble3(1.0, 0.0, 1.0));
    FbxNode* node = scene.addNode("node", parent);
    node->LclTranslation.Set(FbxDouble3(1.0, 2.0, 3.0));
    node->LclRotation.Set(FbxDouble3(10.0, 20.0, 30.0));
    node->LclScaling.Set(FbxDouble3(4.0, 5.0, 6.0));
    const SavedScene saved(scene);
    TnFbxReadInfo info = saved.info();
    FacadeRead<Transform> world(info);
    EXPECT_THAT(positionOf(world["node"]), isNear({1.0f, 0.0f, 3.0f}));
    info.setGlobalTransform(false);
    FacadeRead<Transform> read(info);
    EXPECT_THAT(positionOf(read["node"]), isNear({1.0f, 2.0f, 3.0f}));
    EXPECT_THAT(rotationOf(read["node"]), isNear({10.0f, 20.0f, 30.0f}));
    EXPECT_THAT(scaleOf(read["node"]), isNear({4.0f, 5.0f, 6.0f}));
}

TEST(FaithfulFlatNodes, HaveFlatPointsAndTheNormalsThatAreLeft) {
    TestScene scene;
    FbxNode* node = addTriangle(scene, "mesh");
    auto* normals = fbxsdk::FbxLayerElementNormal::Create(node->GetMesh(), "");
    normals->SetMappingMode(fbxsdk::FbxLayerElement::eByControlPoint);
    normals->SetReferenceMode(fbxsdk::FbxLayerElement::eDirect);
    for (const fbxsdk::FbxVector4& normal :
         {fbxsdk::FbxVector4(0.0, 0.6, 0.8), fbxsdk::FbxVector4(1.0, 0.0, 0.0), fbxsdk::FbxVector4(0.0, 0.0, -1.0)})
        normals->GetDirectArray().Add(normal);
    node->GetMesh()->GetLayer(node->GetMesh()->CreateLayer())->SetNormals(normals);
    node->LclTranslation.Set(FbxDouble3(0.0, 0.0, 5.0));
    node->LclScaling.Set(FbxDouble3(2.0, 3.0, 0.0));
    auto read = readFaithfully<TnFbxMesh>(scene);
    EXPECT_THAT(pointsOf(read["mesh"]), isNear({0.0f, 0.0f, 5.0f, 2.0f, 0.0f, 5.0f, 0.0f, 3.0f, 5.0f}));
    EXPECT_THAT(normalsOf(read["mesh"]), isNear({0.0f, 0.0f, 1.0f, 0.0f, 0.0f, 0.0f, 0.0f, 0.0f, -1.0f}));
}

TEST(FaithfulFlatNodes, WhosePointsASkinPlacesInTheWorldAreWarnedOf) {
    TestScene scene;
    FbxNode* parent = scene.addNode("parent");
    FbxNode* node = addTriangle(scene, "mesh");
    parent->AddChild(node);
    parent->LclScaling.Set(FbxDouble3(1.0, 1.0, 0.0));
    auto* skin = fbxsdk::FbxSkin::Create(scene.scene, "skin");
    auto* cluster = fbxsdk::FbxCluster::Create(scene.scene, "cluster");
    FbxNode* bone = scene.add<fbxsdk::FbxSkeleton>("bone");
    bone->LclTranslation.Set(FbxDouble3(0.0, 0.0, 4.0));
    cluster->SetLink(bone);
    for (int i = 0; i < 3; ++i)
        cluster->AddControlPointIndex(i, 1.0);
    skin->AddCluster(cluster);
    node->GetMesh()->AddDeformer(skin);
    const SavedScene saved(scene);
    const Samples inWorld = {0.0f, 0.0f, 4.0f, 1.0f, 0.0f, 4.0f, 0.0f, 1.0f, 4.0f};
    TnFbxReadInfo info = saved.info();
    EXPECT_THAT(pointsOf(FacadeRead<TnFbxMesh>(info)["mesh"]), isNear(inWorld));
    EXPECT_THAT(lastWarnings(), testing::IsEmpty());
    for (const bool global : {true, false}) {
        info.setGlobalTransform(global);
        info.setTransformPoints(!global); // the object's own space, and the parent's
        EXPECT_THAT(pointsOf(FacadeRead<TnFbxMesh>(info)["mesh"]), isNear(inWorld));
        EXPECT_THAT(lastWarnings(), testing::ElementsAre(testing::HasSubstr("the skin of \"mesh\"")));
    }
}

// ---- Values that are no numbers ----

TEST(FaithfulValuesThatAreNoNumbers, StayAndLeaveTheRestAlone) {
    TestScene scene;
    FbxNode* lost = scene.addNode("lost");
    lost->LclTranslation.Set(FbxDouble3(kNaN, 2.0, 3.0));
    lost->LclRotation.Set(FbxDouble3(0.0, 30.0, 0.0));
    FbxNode* spinning = scene.addNode("spinning");
    spinning->LclTranslation.Set(FbxDouble3(1.0, 2.0, 3.0));
    spinning->LclRotation.Set(FbxDouble3(0.0, kNaN, 0.0));
    FbxNode* sound = scene.addNode("sound");
    sound->LclTranslation.Set(FbxDouble3(4.0, 5.0, 6.0));
    auto read = readFaithfully<Transform>(scene);
    EXPECT_TRUE(std::isnan(positionOf(read["lost"])[0]));
    EXPECT_THAT(rotationOf(read["lost"]), isNear({0.0f, 30.0f, 0.0f}));
    EXPECT_THAT(positionOf(read["spinning"]), isNear({1.0f, 2.0f, 3.0f}));
    EXPECT_TRUE(std::isnan(rotationOf(read["spinning"])[1]));
    EXPECT_THAT(positionOf(read["sound"]), isNear({4.0f, 5.0f, 6.0f}));
}

TEST(FaithfulValuesThatAreNoNumbers, OfATargetLeaveTheCamerasRotation) {
    AimedScene scene;
    scene.target->LclTranslation.Set(FbxDouble3(kNaN, 0.0, 0.0));
    scene.expectAxes(numbers(0.0, 0.0, 1.0), numbers(1.0, 0.0, 0.0));
}

// ---- The arithmetic ----

TEST(FaithfulDecomposition, OfOneAxisHasARotationAndMakesItAgain) {
    for (std::size_t axis = 0; axis < 3; ++axis) {
        for (const auto& [x, y, z] : {std::tuple(3.0, 0.0, 0.0), std::tuple(0.0, 2.0, 0.0), std::tuple(0.0, 0.0, 5.0),
                                      std::tuple(1.0, 2.0, -2.0)}) {
            fbxsdk::FbxAMatrix matrix = fbxsdk::FbxAMatrix() * 0.0;
            matrix[static_cast<int>(axis)] = fbxsdk::FbxVector4(x, y, z, 0.0);
            const faithful::Parts parts = faithful::decompose(matrix, {1.0, 1.0, 1.0});
            EXPECT_NEAR(faithful::handedness(parts.rotation), 1.0, 1e-12);
            EXPECT_EQ(parts.skew, (faithful::Vector{0.0, 0.0, 0.0}));
            for (std::size_t other = 0; other < 3; ++other) {
                EXPECT_NEAR(parts.scale[other], other == axis ? std::hypot(x, y, z) : 0.0, 1e-12);
                double product = 0.0; // the axes are perpendicular and of unit length
                for (int i = 0; i < 3; ++i)
                    product +=
                        parts.rotation.Get(static_cast<int>(axis), i) * parts.rotation.Get(static_cast<int>(other), i);
                EXPECT_NEAR(product, other == axis ? 1.0 : 0.0, 1e-12);
            }
            EXPECT_NEAR(parts.rotation.Get(static_cast<int>(axis), 0) * std::hypot(x, y, z), x, 1e-12);
            EXPECT_NEAR(parts.rotation.Get(static_cast<int>(axis), 2) * std::hypot(x, y, z), z, 1e-12);
        }
    }
}

TEST(FaithfulDecomposition, OfAnAxisAlongAnotherIsASkew) {
    fbxsdk::FbxAMatrix matrix; // Y is along X: position · rotation · H · scale has no room for both but the skew
    matrix[1] = fbxsdk::FbxVector4(2.0, 0.0, 0.0, 0.0);
    const faithful::Parts parts = faithful::decompose(matrix, {1.0, 1.0, 1.0});
    EXPECT_EQ(parts.scale, (faithful::Vector{1.0, 0.0, 1.0}));
    EXPECT_TRUE(parts.rotation.IsIdentity());
    EXPECT_EQ(parts.skew, (faithful::Vector{0.0, 0.0, 0.0})) << "what has no length has no skew";
}

} // namespace
} // namespace Tarnell::Fbx::test
