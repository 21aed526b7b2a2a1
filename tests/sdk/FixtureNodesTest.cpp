// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Nodes of hand-written files: their placement, kinds and names, and the result for files
// that are inconsistent.
#include "FixtureFiles.h"

namespace Tarnell::Fbx {
namespace {

using test::FacadeRead;
using test::fixture;
using test::isNear;
using test::localRead;
using test::Names;
using test::positionOf;
using test::rotationOf;
using test::Samples;
using test::scaleOf;
using test::worldRead;
using testing::ElementsAre;
using testing::FloatNear;

/// The names of the nodes that a mask selects.
Names nodeNames(const char* file, long mask) {
    Names stacks, nodes;
    EXPECT_TRUE(Fbx().getAnimationStackNodeNames(fixture(file).c_str(), mask, stacks, nodes)) << lastError();
    return nodes;
}

// ---- Placement ----

// T · Roff · Rp · R · Rp⁻¹ · Soff · Sp · S · Sp⁻¹ takes the origin along
// (0,−3,0) → (0,−6,0) → (0,−3,0) → (0,−3,2) → (−1,−3,2) → (3,−1,2) → (4,−1,2) → (4,0,2) → (14,0,2)
TEST(RigFixture, PlacesANodeByItsPivotsAndOffsets) {
    FacadeRead<TnFbxNull> nulls(worldRead("rig_7400_ascii.fbx"));
    const TnFbxNull& node = nulls["pivots"];

    EXPECT_THAT(positionOf(node), isNear({14, 0, 2}));
    EXPECT_THAT(rotationOf(node), isNear({0, 0, 90}));
    EXPECT_THAT(scaleOf(node), isNear({1, 2, 1}));
}

// The tip is at (1,2,3) in its parent, whose rotation is Rpre · R · Rpost⁻¹ with Z before X in R: −90° about Y
// makes it (−3,2,1), 90° about Z (−2,−3,1), 90° about X (−2,−1,−3), and 90° about Z of the pre-rotation (1,−2,−3).
TEST(RigFixture, TurnsByPreAndPostRotationInTheNodesOrder) {
    FacadeRead<TnFbxNull> nulls(worldRead("rig_7400_ascii.fbx"));

    EXPECT_THAT(positionOf(nulls["oriented tip"]), isNear({101, -2, -3}));
}

// Neither the pre- and post-rotation nor the order is used: 90° about X maps (1,2,3) to (1,−3,2), about Z to (3,1,2).
TEST(RigFixture, TurnsInTheOrderXYZAloneWhenTheRotationIsNotActive) {
    FacadeRead<TnFbxNull> nulls(worldRead("rig_7400_ascii.fbx"));

    EXPECT_THAT(positionOf(nulls["inactive tip"]), isNear({203, 1, 2}));
}

TEST(RigFixture, GivesTheRotationAsItIsWhenReadLocally) {
    FacadeRead<TnFbxNull> nulls(fixture("rig_7400_ascii.fbx"));

    EXPECT_EQ(positionOf(nulls["pivots"]), Samples({10, 0, 0}));
    EXPECT_EQ(rotationOf(nulls["oriented"]), Samples({90, 0, 90}));
    EXPECT_EQ(nulls["oriented"].getTransformRotationOrder(), TnFbxTransform::kFbxRotationOrderZYX);
}

// The parent is at (10,0,0) and is scaled by 2 in X. Its children are at (1,0,0) in it and rotated by 90° about Z;
// their tips are at (1,1,0).
TEST(InheritTypesFixture, ScaleBeforeAfterOrWithoutTheChildsRotation) {
    FacadeRead<TnFbxNull> nulls(worldRead("inherit_types_7400_ascii.fbx"));

    EXPECT_THAT(positionOf(nulls["RrSs tip"]), isNear({11, 2, 0})); // scaled (2,1,0), then rotated (−1,2,0)
    EXPECT_THAT(positionOf(nulls["RSrs tip"]), isNear({10, 1, 0})); // rotated (−1,1,0), then scaled (−2,1,0)
    EXPECT_THAT(positionOf(nulls["Rrs tip"]), isNear({11, 1, 0}));  // rotated only
}

TEST(InheritTypesFixture, PlaceTheChildAlikeAndScaleItOtherwise) {
    FacadeRead<TnFbxNull> nulls(worldRead("inherit_types_7400_ascii.fbx"));

    for (const char* name : {"RrSs", "RSrs", "Rrs"}) {
        EXPECT_THAT(positionOf(nulls[name]), isNear({12, 0, 0})) << name;
        EXPECT_THAT(rotationOf(nulls[name]), isNear({0, 0, 90})) << name;
    }
    EXPECT_THAT(scaleOf(nulls["RrSs"]), isNear({2, 1, 1}));
    EXPECT_THAT(scaleOf(nulls["RSrs"]), isNear({1, 2, 1})); // along what was Y before its rotation
    EXPECT_THAT(scaleOf(nulls["Rrs"]), isNear({1, 1, 1}));
}

// (1,0,0) is scaled by two, rotated to (0,2,0) and moved by (1,2,3); the node itself is at (0,0,10).
TEST(GeometricTransformFixture, MovesThePointsOfTheMesh) {
    TnFbxReadInfo info = worldRead("geometric_transform_7400_ascii.fbx");
    info.setTransformPoints(true);
    FacadeRead<TnFbxMesh> meshes(info);

    EXPECT_THAT(positionOf(meshes["triangle"]), isNear({1, 2, 13}));
    EXPECT_THAT(test::pointsOf(meshes["triangle"]), isNear({1, 2, 13, 1, 4, 13, 0, 2, 13}));
}

TEST(GeometricTransformFixture, IsNotInherited) {
    FacadeRead<TnFbxNull> nulls(worldRead("geometric_transform_7400_ascii.fbx"));

    EXPECT_THAT(positionOf(nulls["rider"]), isNear({0, 0, 11}));
}

// ---- Kinds ----

TEST(KindsOfNodesFixture, PlacesNodesBelowBonesAndStereoCameras) {
    FacadeRead<TnFbxNull> nulls(worldRead("kinds_of_nodes_7400_ascii.fbx"));

    EXPECT_THAT(nulls.names(), ElementsAre("foot", "rail"));  // bones and the stereo camera are no nulls
    EXPECT_EQ(positionOf(nulls["foot"]), Samples({1, 1, 0})); // 10 − 4 − 5 in height
    EXPECT_EQ(positionOf(nulls["rail"]), Samples({0, 1, 20}));
}

TEST(KindsOfNodesFixture, NamesBonesByTheirMask) {
    EXPECT_THAT(nodeNames("kinds_of_nodes_7400_ascii.fbx", 0x2), ElementsAre("hip", "knee"));
}

TEST(KindsOfNodesFixture, ReadsTheTwoCamerasOfAStereoCamera) {
    FacadeRead<TnFbxCamera> cameras(fixture("kinds_of_nodes_7400_ascii.fbx"));

    EXPECT_EQ(cameras.count, 7 + 2); // the producer cameras and these, but not the stereo camera itself
    EXPECT_EQ(cameras["left"].getValue(TnFbxCamera::kFbxCameraFocalLength), 50.0f);
    EXPECT_EQ(cameras["right"].getValue(TnFbxCamera::kFbxCameraFocalLength), 60.0f);
    EXPECT_EQ(positionOf(cameras["right"]), Samples({3.25f, 0, 0}));
}

TEST(KindsOfNodesFixture, ReadsASharedAttributeOnEachOfItsNodes) {
    FacadeRead<TnFbxLight> lights(fixture("kinds_of_nodes_7400_ascii.fbx"));

    ASSERT_THAT(lights.names(), ElementsAre("lamp A", "lamp B"));
    EXPECT_EQ(lights["lamp A"].getValue(TnFbxLight::kFbxLightIntensity), 0.75f);
    EXPECT_EQ(lights["lamp B"].getValue(TnFbxLight::kFbxLightIntensity), 0.75f);
    EXPECT_EQ(positionOf(lights["lamp B"]), Samples({2, 0, 0}));
}

TEST(ProducerCamerasFixture, BelongToTheSettingsAndNotToTheTree) {
    constexpr long kCamerasAndSwitchers = 0x20 | 0x200;
    FacadeRead<TnFbxCamera> cameras(fixture("producer_cameras_6100_ascii.fbx"));

    EXPECT_THAT(cameras.names(),
                ElementsAre("Producer Perspective", "Producer Top")); // none is added to the file's own
    EXPECT_THAT(nodeNames("producer_cameras_6100_ascii.fbx", kCamerasAndSwitchers),
                ElementsAre("Producer Perspective", "Producer Top"));
    EXPECT_THAT(FacadeRead<TnFbxNull>(fixture("producer_cameras_6100_ascii.fbx")).names(), ElementsAre("null"));
}

TEST(ProducerCamerasFixture, HaveTheValuesOfTheFile) {
    FacadeRead<TnFbxCamera> cameras(fixture("producer_cameras_6100_ascii.fbx"));
    const TnFbxCamera& perspective = cameras["Producer Perspective"];

    EXPECT_EQ(positionOf(perspective), Samples({3, 4, 5}));
    EXPECT_EQ(perspective.getValue(TnFbxCamera::kFbxCameraFocalLength), 50.0f);
    EXPECT_EQ(perspective.getValue(TnFbxCamera::kFbxCameraNearPlane), 2.0f);
    EXPECT_EQ(positionOf(cameras["Producer Top"]), Samples({0, 500, 0}));
    EXPECT_EQ(perspective.getProjectionType(), TnFbxCamera::kFbxCameraPerspective);
    EXPECT_EQ(cameras["Producer Top"].getProjectionType(), TnFbxCamera::kFbxCameraOrthographic);
}

class SpotLightOfEachGeneration : public testing::TestWithParam<const char*> {};

INSTANTIATE_TEST_SUITE_P(Files, SpotLightOfEachGeneration,
                         testing::Values("lights_5800_ascii.fbx", "lights_6100_ascii.fbx"));

// It shines along −Y in files; the post-rotation, which enters inverted, and the rotation to −Z cancel each other.
TEST_P(SpotLightOfEachGeneration, GivesItsValuesAndShinesAlongItsZAxis) {
    FacadeRead<TnFbxLight> lights(worldRead(GetParam()));
    const TnFbxLight& spot = lights["spot"];

    EXPECT_EQ(spot.getLightType(), TnFbxLight::kFbxLightSpot);
    EXPECT_EQ(spot.getValue(TnFbxLight::kFbxLightGreen), 0.5f);
    EXPECT_EQ(spot.getValue(TnFbxLight::kFbxLightBlue), 0.25f);
    EXPECT_THAT(spot.getValue(TnFbxLight::kFbxLightIntensity), FloatNear(0.8f, 1e-6f)); // of 80 percent
    EXPECT_EQ(spot.getValue(TnFbxLight::kFbxLightConeAngle), 40.0f);
    EXPECT_THAT(positionOf(spot), isNear({1, 2, 3}));
    EXPECT_THAT(rotationOf(spot), isNear({0, 0, 0}));
}

TEST(TemplateFixture, GivesItsValuesToObjectsOfItsClassThatHaveNone) {
    FacadeRead<TnFbxLight> lights(fixture("template_7400_ascii.fbx"));

    EXPECT_THAT(lights["plain"].getValue(TnFbxLight::kFbxLightIntensity), FloatNear(0.42f, 1e-6f));
    EXPECT_EQ(lights["plain"].getValue(TnFbxLight::kFbxLightRed), 0.0f);
    EXPECT_EQ(lights["plain"].getValue(TnFbxLight::kFbxLightGreen), 1.0f);
    EXPECT_EQ(lights["plain"].getValue(TnFbxLight::kFbxLightBlue), 0.0f);
    EXPECT_THAT(lights["own value"].getValue(TnFbxLight::kFbxLightIntensity), FloatNear(0.07f, 1e-6f));
}

TEST(TemplateFixture, GivesNothingToObjectsOfAnotherClass) {
    constexpr float kFocalLengthOfTheClass = 34.89327621672628f;
    FacadeRead<TnFbxCamera> cameras(fixture("template_7400_ascii.fbx"));

    EXPECT_EQ(cameras["camera"].getValue(TnFbxCamera::kFbxCameraFocalLength), kFocalLengthOfTheClass);
}

// ---- Names and inconsistent files ----

TEST(NamesFixture, KeepsWhatAProgramCalledItsNodes) {
    FacadeRead<TnFbxNull> nulls(fixture("names_7400_ascii.fbx"));

    EXPECT_THAT(nulls.names(), ElementsAre("Куб", "🎥 two", "a::b", "", "Model::Model", "the \"best\"\n&amp;"));
}

TEST(NamesFixture, FindsNodesByTheirNames) {
    for (const char* name : {"Куб", "🎥 two", "a::b", "Model::Model"}) {
        TnFbxReadInfo info = localRead(fixture("names_7400_ascii.fbx"));
        info.setAllObjects(false);
        info.setObjectName(name);
        FacadeRead<TnFbxNull> nulls(info);

        EXPECT_EQ(nulls.names(), Names({name}));
    }
}

TEST(OddConnectionsFixture, LoadsWithWhatIsSoundInIt) {
    FacadeRead<TnFbxNull> nulls(worldRead("odd_connections_7400_ascii.fbx"));

    // parents before children, each once, whatever other connections there are
    EXPECT_THAT(nulls.names(),
                ElementsAre("first", "negative", "child of negative", "loop A", "loop B", "own child", "twice"));
}

TEST(OddConnectionsFixture, TakesTheFirstOfTwoObjectsOfOneId) {
    FacadeRead<TnFbxNull> nulls(worldRead("odd_connections_7400_ascii.fbx"));

    EXPECT_EQ(positionOf(nulls["first"]), Samples({1, 0, 0}));
}

TEST(OddConnectionsFixture, PlacesAChildByAParentOfANegativeId) {
    FacadeRead<TnFbxNull> nulls(worldRead("odd_connections_7400_ascii.fbx"));

    EXPECT_EQ(positionOf(nulls["child of negative"]), Samples({3, 4, 0}));
}

TEST(OddConnectionsFixture, KeepsTheFirstParentOfANode) {
    FacadeRead<TnFbxNull> nulls(worldRead("odd_connections_7400_ascii.fbx"));

    EXPECT_EQ(positionOf(nulls["twice"]), Samples({0, 0, 0})); // below "first" it would be at (1,0,0)
}

} // namespace
} // namespace Tarnell::Fbx
