// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Converting a scene to another axis system: every global matrix is rotated by the same rotation, at every time.
#include <array>
#include <string>
#include <vector>

#include <fbxsdk/FbxAxisSystem.h>
#include <fbxsdk/FbxCamera.h>
#include <fbxsdk/FbxCluster.h>
#include <fbxsdk/FbxNode.h>

#include "ConversionFixture.h"

namespace {

using namespace fbxsdk;
using namespace animate;

/// Up, front and the third axis of a system as the columns of a matrix.
plain::Matrix basisOf(const FbxAxisSystem& system) {
    const FbxAxisSystem::Axes axes = system.axes();
    plain::Matrix basis;
    for (auto& row : basis.at)
        row = {0, 0, 0, 0};
    basis.at[3][3] = 1;
    basis.at[static_cast<std::size_t>(axes.up)][0] = axes.upSign;
    basis.at[static_cast<std::size_t>(axes.front)][1] = axes.frontSign;
    basis.at[static_cast<std::size_t>(axes.coord)][2] = axes.coordSign;
    return basis;
}

/// The rotation from the source's axes to the target's.
plain::Matrix turnBetween(const FbxAxisSystem& source, const FbxAxisSystem& target) {
    return basisOf(target) * plain::transposed(basisOf(source));
}

std::vector<FbxAxisSystem> rightHandedSystems() {
    std::vector<FbxAxisSystem> systems;
    for (int up = 0; up < 3; ++up)
        for (int front = 0; front < 3; ++front)
            for (int signs = 0; up != front && signs < 8; ++signs) {
                const auto system = FbxAxisSystem::fromAxes(up, signs & 1 ? 1 : -1, front, signs & 2 ? 1 : -1,
                                                            3 - up - front, signs & 4 ? 1 : -1);
                if (system.GetCoorSystem() == FbxAxisSystem::eRightHanded)
                    systems.push_back(system);
            }
    return systems;
}

class AxisConversionTest : public ConversionFixture {
protected:
    void expectAllTurned(const FbxAxisSystem& source, const FbxAxisSystem& target) {
        scene->GetGlobalSettings().SetAxisSystem(source);
        const auto before = globals();
        target.ConvertScene(scene);
        // The pre-rotation passes through angles: double precision, but at right angles near the pole.
        expectAllChanged(before, turnBetween(source, target), 1e-7);
        EXPECT_EQ(scene->GetGlobalSettings().GetAxisSystem(), target);
    }

    /// A tree with pivots, orders, rotations active and not, and every inherit type.
    void buildTree(SeededRandom& random, FbxAnimLayer* layer) {
        FbxNode* parent = nullptr;
        for (int i = 0; i < 16; ++i) {
            FbxNode* node = addNode(("n" + std::to_string(i)).c_str(), i % 4 ? parent : nullptr);
            randomise(*node, random, 180);
            node->SetRotationActive(random.chance(2));
            node->SetRotationSpaceForLimitOnly(kSet, random.chance(4));
            node->SetRotationOrder(kSet, static_cast<FbxEuler::EOrder>(random.whole(6)));
            for (const char* component : {"X", "Y", "Z"}) {
                if (random.chance(2))
                    keys(node->LclTranslation, layer, component, {{0, random.real(-9, 9)}, {1, random.real(-9, 9)}});
                if (random.chance(2))
                    keys(node->LclRotation, layer, component, {{0, random.real(-90, 90)}, {2, random.real(-90, 90)}});
            }
            parent = node;
        }
    }
};

TEST_F(AxisConversionTest, TurnsZUpIntoYUp) {
    FbxNode* node = addNode("node");
    node->LclTranslation.Set(FbxDouble3(1, 2, 3));
    node->LclRotation.Set(FbxDouble3(10, 20, 30));
    scene->GetGlobalSettings().SetAxisSystem(FbxAxisSystem::MayaZUp);

    FbxAxisSystem::MayaYUp.ConvertScene(scene);

    EXPECT_EQ(node->LclTranslation.Get(), FbxDouble3(1, 3, -2));
    EXPECT_EQ(node->LclRotation.Get(), FbxDouble3(10, 20, 30));
    EXPECT_TRUE(node->GetRotationActive());
    EXPECT_NEAR(node->GetPreRotation(kSet)[0], -90.0, 1e-12);
    EXPECT_NEAR(node->GetPreRotation(kSet)[1], 0.0, 1e-12);
    EXPECT_NEAR(node->GetPreRotation(kSet)[2], 0.0, 1e-12);
}

TEST_F(AxisConversionTest, TurnsOnlyTheNodesBelowTheRoot) {
    FbxNode* child = addNode("child", addNode("top"));
    child->LclTranslation.Set(FbxDouble3(1, 2, 3));
    scene->GetGlobalSettings().SetAxisSystem(FbxAxisSystem::MayaZUp);

    FbxAxisSystem::MayaYUp.ConvertScene(scene);

    EXPECT_EQ(child->LclTranslation.Get(), FbxDouble3(1, 2, 3));
    EXPECT_FALSE(child->GetRotationActive());
}

TEST_F(AxisConversionTest, ChangesNothingInTheSystemItself) {
    FbxNode* node = addNode("node");
    node->LclTranslation.Set(FbxDouble3(1, 2, 3));

    FbxAxisSystem::MayaYUp.ConvertScene(scene);
    FbxAxisSystem::MayaYUp.ConvertScene(nullptr);

    EXPECT_EQ(node->LclTranslation.Get(), FbxDouble3(1, 2, 3));
    EXPECT_FALSE(node->GetRotationActive());
}

TEST_F(AxisConversionTest, TurnsEveryGlobalMatrixFromEverySystem) {
    const auto systems = rightHandedSystems();
    ASSERT_EQ(systems.size(), 24U);
    SeededRandom random(11);
    buildTree(random, addStack(*scene));

    // Each conversion starts from the result of the last one.
    for (const FbxAxisSystem& system : systems) {
        expectAllTurned(scene->GetGlobalSettings().GetAxisSystem(), system);
        ASSERT_FALSE(HasFailure());
    }
}

TEST_F(AxisConversionTest, TurnsEveryGlobalMatrixOfFreshScenesIntoYUp) {
    unsigned seed = 100;
    for (const FbxAxisSystem& system : rightHandedSystems()) {
        SeededRandom random(seed++);
        FbxScene* old = scene;
        scene = FbxScene::Create(manager, "fresh");
        old->Destroy();
        buildTree(random, addStack(*scene));

        expectAllTurned(system, FbxAxisSystem::MayaYUp);
        ASSERT_FALSE(HasFailure()) << seed;
    }
}

TEST_F(AxisConversionTest, TurnsEveryLayerOfEveryStack) {
    SeededRandom random(12);
    FbxAnimLayer* base = addStack(*scene);
    FbxAnimLayer* second = addLayer(*scene->GetCurrentAnimationStack());
    FbxAnimLayer* other = addStack(*scene, "other");
    buildTree(random, base);
    for (int i = 0; i < scene->GetRootNode()->GetChildCount(); ++i) {
        FbxNode* node = scene->GetRootNode()->GetChild(i);
        keys(node->LclTranslation, second, "X", {{0, 1}, {1, 2}});
        keys(node->LclRotation, second, "Y", {{0, 10}, {1, 20}});
        keys(node->LclTranslation, other, "Z", {{0, 5}, {1, 6}});
    }

    expectAllTurned(FbxAxisSystem::MayaZUp, FbxAxisSystem::MayaYUp);
    EXPECT_EQ(scene->GetRootNode()->GetChild(0)->LclTranslation.GetCurve(other, "Y")->KeyGetValue(1), 6.0F);

    scene->SetCurrentAnimationStack(other->GetDstObject<FbxAnimStack>());
    expectAllTurned(FbxAxisSystem::MayaYUp, rightHandedSystems()[5]);
}

TEST_F(AxisConversionTest, MovesCurvesToTheComponentThatTheyNowDrive) {
    FbxAnimLayer* layer = addStack(*scene);
    FbxNode* node = addNode("node");
    FbxAnimCurve* y = keys(node->LclTranslation, layer, "Y", {{0, 1}, {1, 2}});
    FbxAnimCurve* z = keys(node->LclTranslation, layer, "Z", {{0, 3}, {1, 4}});
    scene->GetGlobalSettings().SetAxisSystem(FbxAxisSystem::MayaZUp);

    FbxAxisSystem::MayaYUp.ConvertScene(scene);

    EXPECT_EQ(node->LclTranslation.GetCurve(layer, "X"), nullptr);
    EXPECT_EQ(node->LclTranslation.GetCurve(layer, "Y"), z);
    EXPECT_EQ(node->LclTranslation.GetCurve(layer, "Z"), y);
    EXPECT_EQ(z->KeyGetValue(1), 4.0F);
    EXPECT_EQ(y->KeyGetValue(1), -2.0F);
}

TEST_F(AxisConversionTest, ConvertsASharedCurveForItsUserAlone) {
    FbxAnimLayer* layer = addStack(*scene);
    FbxNode* a = addNode("a");
    FbxNode* b = addNode("b");
    FbxNode* child = addNode("child", a);
    FbxAnimCurve* shared = keys(a->LclTranslation, layer, "Y", {{0, 1}, {1, 2}});
    a->LclTranslation.GetCurveNode(layer)->ConnectToChannel(shared, "Z");
    b->LclTranslation.GetCurveNode(layer, true)->ConnectToChannel(shared, "Y");
    child->LclTranslation.GetCurveNode(layer, true)->ConnectToChannel(shared, "Y");
    child->LclRotation.GetCurveNode(layer, true)->ConnectToChannel(shared, "X");

    expectAllTurned(FbxAxisSystem::MayaZUp, FbxAxisSystem::MayaYUp);

    EXPECT_EQ(child->LclTranslation.GetCurve(layer, "Y")->KeyGetValue(1), 2.0F);
    EXPECT_EQ(a->LclTranslation.GetCurve(layer, "Y")->KeyGetValue(1), 2.0F);
    EXPECT_EQ(a->LclTranslation.GetCurve(layer, "Z")->KeyGetValue(1), -2.0F);
}

TEST_F(AxisConversionTest, PutsRotationInForceWithoutWhatWasNot) {
    FbxNode* node = addNode("node");
    node->SetRotationOrder(kSet, FbxEuler::eOrderZYX);
    node->SetPreRotation(kSet, FbxVector4(10, 20, 30));
    node->SetPostRotation(kSet, FbxVector4(40, 50, 60));
    node->LclRotation.Set(FbxDouble3(15, 25, 35));

    expectAllTurned(FbxAxisSystem::MayaZUp, FbxAxisSystem::MayaYUp);

    EXPECT_TRUE(node->GetRotationActive());
    EXPECT_EQ(node->GetPostRotation(kSet)[0], 0.0);
    FbxEuler::EOrder order = FbxEuler::eOrderZYX;
    node->GetRotationOrder(kSet, order);
    EXPECT_EQ(order, FbxEuler::eOrderXYZ);
}

TEST_F(AxisConversionTest, TurnsTheVectorsOfCameras) {
    FbxAnimLayer* layer = addStack(*scene);
    FbxCamera* camera = make<FbxCamera>();
    camera->Position.Set(FbxDouble3(1, 2, 3));
    camera->UpVector.Set(FbxDouble3(0, 0, 1));
    camera->InterestPosition.Set(FbxDouble3(4, 5, 6));
    keys(camera->InterestPosition, layer, "Z", {{0, 7}});
    scene->GetGlobalSettings().SetAxisSystem(FbxAxisSystem::MayaZUp);

    FbxAxisSystem::MayaYUp.ConvertScene(scene);

    EXPECT_EQ(camera->Position.Get(), FbxDouble3(1, 3, -2));
    EXPECT_EQ(camera->UpVector.Get(), FbxDouble3(0, 1, 0));
    EXPECT_EQ(camera->InterestPosition.Get(), FbxDouble3(4, 6, -5));
    EXPECT_EQ(camera->InterestPosition.EvaluateValue(seconds(0)), FbxDouble3(4, 7, -5));
}

TEST_F(AxisConversionTest, TurnsTheMatricesOfClusters) {
    FbxCluster* cluster = make<FbxCluster>();
    SeededRandom random(2);
    FbxAMatrix mesh, link;
    mesh.SetTRS(random.vector(-3, 3), random.vector(-90, 90), random.vector(1, 2));
    link.SetTRS(random.vector(-3, 3), random.vector(-90, 90), random.vector(1, 2));
    cluster->SetTransformMatrix(mesh);
    cluster->SetTransformLinkMatrix(link);
    scene->GetGlobalSettings().SetAxisSystem(FbxAxisSystem::MayaZUp);

    FbxAxisSystem::MayaYUp.ConvertScene(scene);

    const plain::Matrix turn = turnBetween(FbxAxisSystem::MayaZUp, FbxAxisSystem::MayaYUp);
    FbxAMatrix meshAfter, linkAfter;
    EXPECT_LT(plain::difference(plain::of(cluster->GetTransformMatrix(meshAfter)), turn * plain::of(mesh)), 1e-12);
    EXPECT_LT(plain::difference(plain::of(cluster->GetTransformLinkMatrix(linkAfter)), turn * plain::of(link)), 1e-12);
}

TEST_F(AxisConversionTest, TurnsTheLimitsOfTranslation) {
    FbxNode* node = addNode("node");
    node->FindProperty("TranslationMin").Set(FbxDouble3(-1, -2, -3));
    node->FindProperty("TranslationMax").Set(FbxDouble3(10, 20, 30));
    node->FindProperty("TranslationMinY").Set(true);
    node->FindProperty("TranslationMaxZ").Set(true);
    scene->GetGlobalSettings().SetAxisSystem(FbxAxisSystem::MayaZUp);

    FbxAxisSystem::MayaYUp.ConvertScene(scene); // (x, y, z) becomes (x, z, -y)

    EXPECT_EQ(node->FindProperty("TranslationMin").Get<FbxDouble3>(), FbxDouble3(-1, -3, -20));
    EXPECT_EQ(node->FindProperty("TranslationMax").Get<FbxDouble3>(), FbxDouble3(10, 30, 2));
    for (const char* off : {"MinX", "MaxX", "MinY", "MinZ"})
        EXPECT_FALSE(node->FindProperty(("Translation" + std::string(off)).c_str()).Get<FbxBool>()) << off;
    for (const char* on : {"MaxY", "MaxZ"})
        EXPECT_TRUE(node->FindProperty(("Translation" + std::string(on)).c_str()).Get<FbxBool>()) << on;
}

TEST_F(AxisConversionTest, LeavesAMirrorOutWhereHandednessDiffers) {
    FbxNode* node = addNode("node");
    node->LclTranslation.Set(FbxDouble3(1, 2, 3));
    scene->GetGlobalSettings().SetAxisSystem(FbxAxisSystem::DirectX);

    FbxAxisSystem::MayaYUp.ConvertScene(scene);

    EXPECT_EQ(node->LclTranslation.Get(), FbxDouble3(1, 2, 3));
    EXPECT_EQ(scene->GetGlobalSettings().GetAxisSystem(), FbxAxisSystem::MayaYUp);
}

TEST_F(AxisConversionTest, ConvertsBelowAnotherRootOnRequest) {
    FbxNode* top = addNode("top");
    FbxNode* child = addNode("child", top);
    child->LclTranslation.Set(FbxDouble3(1, 2, 3));

    FbxAxisSystem::MayaYUp.ConvertChildren(top, FbxAxisSystem::MayaZUp);
    FbxAxisSystem::MayaYUp.ConvertChildren(nullptr, FbxAxisSystem::MayaZUp);

    EXPECT_EQ(child->LclTranslation.Get(), FbxDouble3(1, 3, -2));
    EXPECT_FALSE(top->GetRotationActive());
}

TEST_F(AxisConversionTest, KeepsChannelsApartThatAreNotThree) {
    FbxAnimLayer* layer = addStack(*scene);
    FbxNode* node = addNode("node");
    FbxAnimCurveNode* odd = FbxAnimCurveNode::Create(scene, "T");
    odd->addChannel("X", 5.0);
    layer->AddMember(odd);
    node->LclTranslation.ConnectSrcObject(odd);
    scene->GetGlobalSettings().SetAxisSystem(FbxAxisSystem::MayaZUp);

    FbxAxisSystem::MayaYUp.ConvertScene(scene);

    EXPECT_EQ(odd->GetChannelsCount(), 1U);
    EXPECT_EQ(odd->GetChannelValue(0U, 0.0), 5.0);
}

} // namespace
