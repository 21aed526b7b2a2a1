// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Converting a scene to another unit: every global matrix becomes the factor times its former value, at every time.
#include <algorithm>
#include <string>
#include <vector>

#include <fbxsdk/FbxCamera.h>
#include <fbxsdk/FbxCluster.h>
#include <fbxsdk/FbxLight.h>
#include <fbxsdk/FbxNode.h>
#include <fbxsdk/FbxSystemUnit.h>

#include "ConversionFixture.h"

namespace {

using namespace fbxsdk;
using namespace animate;

class UnitConversionTest : public ConversionFixture {
protected:
    /// Converts from metres (k = 100) and compares everything but the root.
    void expectAllScaled(const FbxSystemUnit& source, const FbxSystemUnit& target) {
        scene->GetGlobalSettings().SetSystemUnit(source);
        const double k = source.GetConversionFactorTo(target);
        const auto before = globals();
        target.ConvertScene(scene);
        // Keys are of single precision, and are multiplied as such.
        expectAllChanged(before, plain::scaling(FbxDouble3(k, k, k)), 4e-6);
    }

    static void randomise(FbxNode& node, SeededRandom& random) {
        ConversionFixture::randomise(node, random, 90);
        node.SetRotationActive(true);
    }

    static void animateRandomly(FbxNode& node, FbxAnimLayer* layer, SeededRandom& random) {
        for (const char* component : {"X", "Y", "Z"}) {
            if (random.chance(2))
                keys(node.LclTranslation, layer, component, {{0, random.real(-9, 9)}, {1, random.real(-9, 9)}});
            if (random.chance(2))
                keys(node.LclScaling, layer, component, {{0, random.real(0.5, 2)}, {1.5, random.real(0.5, 2)}});
            if (random.chance(2))
                keys(node.LclRotation, layer, component, {{0, random.real(-90, 90)}, {2, random.real(-90, 90)}});
        }
    }
};

TEST_F(UnitConversionTest, ScalesTheNodesBelowTheRootAndStatesTheNewUnit) {
    FbxNode* top = addNode("top");
    FbxNode* child = addNode("child", top);
    top->LclTranslation.Set(FbxDouble3(1, 2, 3));
    child->LclTranslation.Set(FbxDouble3(4, 5, 6));
    scene->GetGlobalSettings().SetSystemUnit(FbxSystemUnit::m);
    scene->GetGlobalSettings().SetOriginalSystemUnit(FbxSystemUnit::m);

    FbxSystemUnit(1.0, 1.0).ConvertScene(scene, FbxSystemUnit::DefaultConversionOptions);

    EXPECT_EQ(top->LclTranslation.Get(), FbxDouble3(100, 200, 300));
    EXPECT_EQ(top->LclScaling.Get(), FbxDouble3(100, 100, 100));
    EXPECT_EQ(child->LclTranslation.Get(), FbxDouble3(4, 5, 6));
    EXPECT_EQ(child->LclScaling.Get(), FbxDouble3(1, 1, 1));
    EXPECT_EQ(scene->GetGlobalSettings().GetSystemUnit(), FbxSystemUnit::cm);
    EXPECT_EQ(scene->GetGlobalSettings().GetOriginalSystemUnit(), FbxSystemUnit::m);
}

TEST_F(UnitConversionTest, ChangesNothingInTheUnitItself) {
    FbxNode* top = addNode("top");
    top->LclTranslation.Set(FbxDouble3(1, 2, 3));

    FbxSystemUnit::cm.ConvertScene(scene);
    FbxSystemUnit::cm.ConvertScene(nullptr);

    EXPECT_EQ(top->LclTranslation.Get(), FbxDouble3(1, 2, 3));
    EXPECT_EQ(top->LclScaling.Get(), FbxDouble3(1, 1, 1));
}

TEST_F(UnitConversionTest, IsDoneOnceOnly) {
    FbxNode* top = addNode("top");
    scene->GetGlobalSettings().SetSystemUnit(FbxSystemUnit::m);

    FbxSystemUnit::cm.ConvertScene(scene);
    FbxSystemUnit::cm.ConvertScene(scene);

    EXPECT_EQ(top->LclScaling.Get(), FbxDouble3(100, 100, 100));
}

TEST_F(UnitConversionTest, TakesAnInvalidUnitForCentimetres) {
    FbxNode* top = addNode("top");
    for (const double wrong : {0.0, -1.0, static_cast<double>(NAN), static_cast<double>(INFINITY)}) {
        scene->GetGlobalSettings().FindProperty("UnitScaleFactor").Set(wrong);
        FbxSystemUnit::cm.ConvertScene(scene);
        EXPECT_EQ(top->LclScaling.Get(), FbxDouble3(1, 1, 1)) << wrong;
    }
}

TEST_F(UnitConversionTest, RefusesATargetThatIsNoUnit) {
    FbxNode* top = addNode("top");

    for (const double wrong : {0.0, -1.0, static_cast<double>(NAN)})
        FbxSystemUnit(wrong).ConvertScene(scene);

    EXPECT_EQ(top->LclScaling.Get(), FbxDouble3(1, 1, 1));
    EXPECT_EQ(scene->GetGlobalSettings().GetSystemUnit(), FbxSystemUnit::cm);
}

TEST_F(UnitConversionTest, MultipliesEveryGlobalMatrix) {
    for (unsigned seed = 1; seed <= 30; ++seed) {
        SeededRandom random(seed);
        std::vector<FbxNode*> nodes{scene->GetRootNode()};
        for (int i = 0; i < 12; ++i) {
            nodes.push_back(addNode(("n" + std::to_string(i)).c_str(),
                                    nodes[static_cast<std::size_t>(random.whole(static_cast<int>(nodes.size())))]));
            randomise(*nodes.back(), random);
        }

        expectAllScaled(seed % 2 ? FbxSystemUnit::m : FbxSystemUnit::Inch,
                        seed % 3 ? FbxSystemUnit::cm : FbxSystemUnit::Foot);
        ASSERT_FALSE(HasFailure()) << "seed " << seed;
        for (std::size_t i = 1; i < nodes.size(); ++i)
            nodes[i]->Destroy();
    }
}

TEST_F(UnitConversionTest, MultipliesEveryGlobalMatrixOfAnimatedNodes) {
    FbxAnimLayer* layer = addStack(*scene);
    SeededRandom random(99);
    FbxNode* parent = nullptr;
    for (int i = 0; i < 40; ++i) {
        FbxNode* node = addNode(("n" + std::to_string(i)).c_str(), i % 4 ? parent : nullptr);
        randomise(*node, random);
        animateRandomly(*node, layer, random);
        parent = node;
    }

    expectAllScaled(FbxSystemUnit::m, FbxSystemUnit::cm);
}

TEST_F(UnitConversionTest, KeepsIndependentChildrenInPlaceWhileTheyScale) {
    FbxAnimLayer* layer = addStack(*scene);
    FbxNode* top = addNode("top");
    FbxNode* child = addNode("child", top);
    FbxNode* grandchild = addNode("grandchild", child);
    top->SetTransformationInheritType(FbxTransform::eInheritRSrs);
    for (FbxNode* node : {child, grandchild}) {
        node->SetTransformationInheritType(FbxTransform::eInheritRrs);
        node->SetScalingPivot(kSet, FbxVector4(1, 2, 3));
        node->SetScalingOffset(kSet, FbxVector4(0.5, 0, 0));
        node->LclTranslation.Set(FbxDouble3(5, 0, 0));
        keys(node->LclScaling, layer, "X", {{0, 1}, {1, 3}});
    }

    expectAllScaled(FbxSystemUnit::m, FbxSystemUnit::cm);
    EXPECT_EQ(child->LclScaling.Get(), FbxDouble3(100, 100, 100));
    EXPECT_EQ(child->LclTranslation.Get(), FbxDouble3(5, 0, 0));
}

TEST_F(UnitConversionTest, LeavesIndependentChildrenAloneWhenTold) {
    FbxNode* child = addNode("child", addNode("top"));
    child->SetTransformationInheritType(FbxTransform::eInheritRrs);
    scene->GetGlobalSettings().SetSystemUnit(FbxSystemUnit::m);
    FbxSystemUnit::ConversionOptions options;
    options.mConvertRrsNodes = false;

    FbxSystemUnit::cm.ConvertScene(scene, options);

    EXPECT_EQ(child->LclScaling.Get(), FbxDouble3(1, 1, 1));
}

class LayeredUnitConversionTest : public UnitConversionTest,
                                  public testing::WithParamInterface<std::tuple<int, int, double>> {};

TEST_P(LayeredUnitConversionTest, MultipliesEveryGlobalMatrix) {
    const auto [blend, scale, weight] = GetParam();
    FbxAnimLayer* base = addStack(*scene);
    FbxAnimLayer* second = addLayer(*scene->GetCurrentAnimationStack());
    FbxAnimLayer* third = addLayer(*scene->GetCurrentAnimationStack());
    SeededRandom random(7);
    for (FbxAnimLayer* layer : {second, third}) {
        layer->BlendMode.Set(blend);
        layer->ScaleAccumulationMode.Set(scale);
        layer->Weight.Set(weight);
    }
    FbxNode* onAll = addNode("on all");
    FbxNode* onUpper = addNode("on upper", nullptr);
    FbxNode* independent = addNode("independent", onAll);
    for (FbxNode* node : {onAll, onUpper, independent})
        randomise(*node, random);
    independent->SetTransformationInheritType(FbxTransform::eInheritRrs);
    for (FbxAnimLayer* layer : {base, second, third}) {
        for (FbxNode* node : {onAll, independent})
            animateRandomly(*node, layer, random);
        if (layer != base)
            animateRandomly(*onUpper, layer, random);
    }

    expectAllScaled(FbxSystemUnit::m, FbxSystemUnit::cm);
}

INSTANTIATE_TEST_SUITE_P(BlendModes, LayeredUnitConversionTest,
                         testing::Combine(testing::Values(FbxAnimLayer::eBlendAdditive, FbxAnimLayer::eBlendOverride,
                                                          FbxAnimLayer::eBlendOverridePassthrough),
                                          testing::Values(FbxAnimLayer::eScaleMultiply, FbxAnimLayer::eScaleAdditive),
                                          testing::Values(100.0, 40.0, 0.0)));

TEST_F(UnitConversionTest, MultipliesLayersThatBypassBlending) {
    FbxAnimLayer* base = addStack(*scene);
    FbxAnimLayer* second = addLayer(*scene->GetCurrentAnimationStack());
    second->SetBlendModeBypass(eFbxDouble3, true);
    FbxNode* node = addNode("node");
    for (FbxAnimLayer* layer : {base, second}) {
        keys(node->LclScaling, layer, "X", {{0, 1}, {1, 3}});
        keys(node->LclTranslation, layer, "X", {{0, 1}, {1, 3}});
    }

    expectAllScaled(FbxSystemUnit::m, FbxSystemUnit::cm);
}

TEST_F(UnitConversionTest, ConvertsEveryStack) {
    FbxAnimLayer* first = addStack(*scene, "first");
    FbxAnimLayer* second = addStack(*scene, "second");
    FbxNode* node = addNode("node");
    keys(node->LclTranslation, first, "X", {{0, 1}});
    keys(node->LclTranslation, second, "X", {{0, 2}});
    scene->SetCurrentAnimationStack(second->GetDstObject<FbxAnimStack>());

    expectAllScaled(FbxSystemUnit::m, FbxSystemUnit::cm);

    EXPECT_EQ(node->LclTranslation.GetCurve(first, "X")->KeyGetValue(0), 100.0F);
    EXPECT_EQ(node->LclTranslation.GetCurve(second, "X")->KeyGetValue(0), 200.0F);
}

TEST_F(UnitConversionTest, ConvertsASharedCurveForItsUserAlone) {
    FbxAnimLayer* layer = addStack(*scene);
    FbxNode* top = addNode("top");
    FbxNode* other = addNode("other");
    FbxNode* child = addNode("child", top);
    FbxAnimCurve* shared = keys(top->LclTranslation, layer, "X", {{0, 1}, {1, 2}});
    other->LclTranslation.GetCurveNode(layer, true)->ConnectToChannel(shared, "X");
    child->LclTranslation.GetCurveNode(layer, true)->ConnectToChannel(shared, "Y");
    child->LclRotation.GetCurveNode(layer, true)->ConnectToChannel(shared, "Z");

    expectAllScaled(FbxSystemUnit::m, FbxSystemUnit::cm);

    EXPECT_EQ(top->LclTranslation.GetCurve(layer, "X")->KeyGetValue(1), 200.0F);
    EXPECT_EQ(other->LclTranslation.GetCurve(layer, "X")->KeyGetValue(1), 200.0F);
    EXPECT_EQ(child->LclTranslation.GetCurve(layer, "Y")->KeyGetValue(1), 2.0F);
    EXPECT_EQ(child->LclRotation.GetCurve(layer, "Z")->KeyGetValue(1), 2.0F);
}

TEST_F(UnitConversionTest, ConvertsThousandsOfUsersOfOneCurve) {
    FbxAnimLayer* layer = addStack(*scene);
    FbxAnimCurve* shared = keys(addNode("first")->LclTranslation, layer, "X", {{0, 1}});
    for (int i = 0; i < 5'000; ++i)
        addNode("n")->LclTranslation.GetCurveNode(layer, true)->ConnectToChannel(shared, "X");
    scene->GetGlobalSettings().SetSystemUnit(FbxSystemUnit::m);

    FbxSystemUnit::cm.ConvertScene(scene);

    for (const int index : {0, 1, 2'500, 5'000})
        EXPECT_EQ(scene->GetRootNode()->GetChild(index)->EvaluateGlobalTransform(seconds(0)).GetT()[0], 100.0);
}

TEST_F(UnitConversionTest, ConvertsTangentsWithTheirKeys) {
    FbxAnimLayer* layer = addStack(*scene);
    FbxNode* node = addNode("node");
    FbxAnimCurve* curve = node->LclTranslation.GetCurve(layer, "X", true);
    for (int i = 0; i < 3; ++i)
        curve->KeySet(curve->KeyAdd(seconds(i)), seconds(i), static_cast<float>(i * i),
                      FbxAnimCurveDef::eInterpolationCubic, FbxAnimCurveDef::eTangentUser, 3.0F, -2.0F);

    expectAllScaled(FbxSystemUnit::m, FbxSystemUnit::cm);
}

TEST_F(UnitConversionTest, LeavesWhatIsNoLengthAlone) {
    FbxNode* node = addNode("node");
    FbxCamera* camera = make<FbxCamera>();
    FbxLight* light = make<FbxLight>();
    node->SetNodeAttribute(camera);
    node->LclRotation.Set(FbxDouble3(10, 20, 30));
    node->SetGeometricTranslation(kSet, FbxVector4(1, 2, 3));
    camera->Position.Set(FbxDouble3(1, 2, 3));
    camera->FocalLength.Set(35.0);
    light->Intensity.Set(100.0);
    scene->GetGlobalSettings().SetSystemUnit(FbxSystemUnit::m);

    FbxSystemUnit::cm.ConvertScene(scene);

    EXPECT_EQ(node->LclRotation.Get(), FbxDouble3(10, 20, 30));
    EXPECT_EQ(node->GetGeometricTranslation(kSet)[2], 3.0);
    EXPECT_EQ(camera->Position.Get(), FbxDouble3(1, 2, 3));
    EXPECT_EQ(camera->FocalLength.Get(), 35.0);
    EXPECT_EQ(light->Intensity.Get(), 100.0);
}

TEST_F(UnitConversionTest, MovesTheClippingPlanesByDefault) {
    FbxCamera* camera = make<FbxCamera>();
    camera->NearPlane.Set(1.0);
    camera->FarPlane.Set(20.0);
    scene->GetGlobalSettings().SetSystemUnit(FbxSystemUnit::m);

    FbxSystemUnit::cm.ConvertScene(scene);
    EXPECT_EQ(camera->NearPlane.Get(), 100.0);
    EXPECT_EQ(camera->FarPlane.Get(), 2000.0);

    FbxSystemUnit::ConversionOptions options;
    options.mConvertCameraClipPlanes = false;
    FbxSystemUnit::m.ConvertScene(scene, options);
    EXPECT_EQ(camera->NearPlane.Get(), 100.0);
}

TEST_F(UnitConversionTest, ScalesTheLimitsOfWhatItConverts) {
    FbxNode* top = addNode("top");
    FbxNode* child = addNode("child", top);
    FbxNode* independent = addNode("independent", top);
    independent->SetTransformationInheritType(FbxTransform::eInheritRrs);
    for (FbxNode* node : {top, child, independent})
        for (const char* limit : {"TranslationMin", "TranslationMax", "ScalingMin", "ScalingMax", "RotationMax"})
            node->FindProperty(limit).Set(FbxDouble3(1, 2, 3));
    scene->GetGlobalSettings().SetSystemUnit(FbxSystemUnit::m);

    FbxSystemUnit::cm.ConvertScene(scene);

    const FbxDouble3 scaled(100, 200, 300), kept(1, 2, 3);
    const auto limit = [](FbxNode* node, const char* name) { return node->FindProperty(name).Get<FbxDouble3>(); };
    EXPECT_EQ(limit(top, "TranslationMin"), scaled);
    EXPECT_EQ(limit(top, "TranslationMax"), scaled);
    EXPECT_EQ(limit(top, "ScalingMin"), scaled);
    EXPECT_EQ(limit(top, "ScalingMax"), scaled);
    EXPECT_EQ(limit(top, "RotationMax"), kept);
    EXPECT_EQ(limit(child, "ScalingMax"), kept);
    EXPECT_EQ(limit(independent, "ScalingMax"), scaled);
    EXPECT_EQ(limit(independent, "TranslationMax"), kept);
}

TEST_F(UnitConversionTest, ScalesAllMatricesOfAClusterSoThatTheSkinStays) {
    FbxCluster* cluster = make<FbxCluster>();
    SeededRandom random(2);
    FbxAMatrix mesh, link;
    mesh.SetTRS(random.vector(-3, 3), random.vector(-90, 90), random.vector(1, 2));
    link.SetTRS(random.vector(-3, 3), random.vector(-90, 90), random.vector(1, 2));
    cluster->SetTransformMatrix(mesh);
    cluster->SetTransformLinkMatrix(link);
    scene->GetGlobalSettings().SetSystemUnit(FbxSystemUnit::m);

    FbxSystemUnit::cm.ConvertScene(scene);

    FbxAMatrix meshAfter, linkAfter;
    cluster->GetTransformMatrix(meshAfter);
    cluster->GetTransformLinkMatrix(linkAfter);
    const plain::Matrix k = plain::scaling(FbxDouble3(100, 100, 100));
    EXPECT_LT(plain::difference(plain::of(meshAfter), k * plain::of(mesh)), 1e-10);
    EXPECT_LT(plain::difference(plain::of(linkAfter), k * plain::of(link)), 1e-10);
    EXPECT_LT(plain::difference(plain::inverse(plain::of(linkAfter)) * plain::of(meshAfter),
                                plain::inverse(plain::of(link)) * plain::of(mesh)),
              1e-10);
}

TEST_F(UnitConversionTest, ConvertsBelowAnotherRootOnRequest) {
    FbxNode* top = addNode("top");
    FbxNode* child = addNode("child", top);

    FbxSystemUnit::cm.ConvertChildren(top, FbxSystemUnit::m);
    FbxSystemUnit::cm.ConvertChildren(nullptr, FbxSystemUnit::m);

    EXPECT_EQ(top->LclScaling.Get(), FbxDouble3(1, 1, 1));
    EXPECT_EQ(child->LclScaling.Get(), FbxDouble3(100, 100, 100));
    EXPECT_EQ(scene->GetGlobalSettings().GetSystemUnit(), FbxSystemUnit::cm);
}

} // namespace
