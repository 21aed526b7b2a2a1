// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Meshes: their points, the side that they face, and the values of their layers.
#include "FaithfulFixture.h"

#include "TnFbxError.h"

#include <cmath>

namespace Tarnell::Fbx::test {
namespace {

Samples firstColourOf(const TnFbxMesh& mesh) {
    float red = 0.0f, green = 0.0f, blue = 0.0f, alpha = 0.0f;
    EXPECT_TRUE(mesh.getValidColours());
    mesh.getColour(0, red, green, blue, alpha);
    return {red, green, blue, alpha};
}

void addNormal(fbxsdk::FbxMesh& mesh, fbxsdk::FbxLayerElement::EMappingMode mapping) {
    auto* element = fbxsdk::FbxLayerElementNormal::Create(&mesh, "");
    element->SetMappingMode(mapping);
    element->SetReferenceMode(fbxsdk::FbxLayerElement::eDirect);
    element->GetDirectArray().Add({0.0, 0.0, 1.0});
    mesh.GetLayer(mesh.CreateLayer())->SetNormals(element);
}

TEST(FaithfulMesh, IsPlacedByTheExactMatrixWithItsGeometricTransform) {
    TestScene scene;
    fbxsdk::FbxNode* parent = scene.addNode("parent");
    parent->LclScaling.Set(fbxsdk::FbxDouble3(2.0, 1.0, 1.0));
    fbxsdk::FbxNode* node = addTriangle(scene, "mesh");
    parent->AddChild(node);
    node->LclRotation.Set(fbxsdk::FbxDouble3(0.0, 0.0, 90.0));
    node->SetTransformationInheritType(fbxsdk::FbxTransform::eInheritRSrs);
    node->SetGeometricTranslation(fbxsdk::FbxNode::eSourcePivot, {0.0, 3.0, 0.0});
    const SavedScene saved(scene);
    EXPECT_THAT(pointsOf(FacadeRead<TnFbxMesh>(saved.info())["mesh"]),
                isNear({-6.0f, 0.0f, 0.0f, -6.0f, 1.0f, 0.0f, -8.0f, 0.0f, 0.0f}));
    TnFbxReadInfo own = saved.info();
    own.setTransformPoints(false);
    EXPECT_THAT(pointsOf(FacadeRead<TnFbxMesh>(own)["mesh"]),
                isNear({0.0f, 3.0f, 0.0f, 1.0f, 3.0f, 0.0f, 0.0f, 4.0f, 0.0f}));
}

TEST(FaithfulMesh, IsTurnedRoundUnderAMirrorSoThatItFacesAsItDid) {
    TestScene scene;
    fbxsdk::FbxNode* node = addTriangle(scene, "mesh");
    addNormal(*node->GetMesh(), fbxsdk::FbxLayerElement::eAllSame);
    node->LclScaling.Set(fbxsdk::FbxDouble3(-1.0, 1.0, 1.0));
    auto read = readFaithfully<TnFbxMesh>(scene);
    EXPECT_THAT(pointIndicesOf(read["mesh"]), testing::ElementsAre(0, 2, 1));
    EXPECT_THAT(normalsOf(read["mesh"]), isNear({0.0f, 0.0f, 1.0f, 0.0f, 0.0f, 1.0f, 0.0f, 0.0f, 1.0f}));
}

TEST(FaithfulMesh, HasNormalsOfEveryMapping) {
    for (const auto mapping : {fbxsdk::FbxLayerElement::eAllSame, fbxsdk::FbxLayerElement::eByPolygon}) {
        TestScene scene;
        addNormal(*addTriangle(scene, "mesh")->GetMesh(), mapping);
        EXPECT_THAT(normalsOf(readFaithfully<TnFbxMesh>(scene)["mesh"]),
                    isNear({0.0f, 0.0f, 1.0f, 0.0f, 0.0f, 1.0f, 0.0f, 0.0f, 1.0f}));
    }
}

TEST(FaithfulMesh, HasTheColourOfItsOneMaterial) {
    const FacadeRead<TnFbxMesh> read(faithfulRead(fixture("materials_7400_ascii.fbx")));
    EXPECT_TRUE(read.objects[0].getValidColours());
    TestScene scene;
    fbxsdk::FbxNode* node = addTriangle(scene, "mesh");
    auto* material = fbxsdk::FbxSurfaceLambert::Create(scene.scene, "material");
    material->Diffuse.Set(fbxsdk::FbxDouble3(0.25, 0.5, 0.75));
    node->AddMaterial(material);
    EXPECT_THAT(firstColourOf(readFaithfully<TnFbxMesh>(scene)["mesh"]), isNear({0.25f, 0.5f, 0.75f, 1.0f}));
}

TEST(FaithfulMesh, ThatIsInstancedHasTheMaterialsOfItsOwnNode) {
    TestScene scene;
    fbxsdk::FbxNode* first = addTriangle(scene, "first");
    fbxsdk::FbxNode* second = scene.addNode("second");
    second->SetNodeAttribute(first->GetMesh());
    double red = 0.0;
    for (fbxsdk::FbxNode* node : {first, second}) {
        auto* material = fbxsdk::FbxSurfaceLambert::Create(scene.scene, node->GetName());
        material->Diffuse.Set(fbxsdk::FbxDouble3(red += 0.25, 0.0, 0.0));
        node->AddMaterial(material);
    }
    auto read = readFaithfully<TnFbxMesh>(scene);
    EXPECT_EQ(firstColourOf(read["first"])[0], 0.25f);
    EXPECT_EQ(firstColourOf(read["second"])[0], 0.5f);
}

TEST(FaithfulMesh, WithoutPolygonsHasItsPoints) {
    TestScene scene;
    fillMesh(*scene.add<fbxsdk::FbxMesh>("points")->GetMesh(), {{1.0, 2.0, 3.0}}, {});
    auto read = readFaithfully<TnFbxMesh>(scene);
    EXPECT_EQ(read["points"].getNumberOfControlPoints(), 1);
    EXPECT_THAT(pointsOf(read["points"]), isNear({1.0f, 2.0f, 3.0f}));
}

TEST(FaithfulBlendShapes, AreWeightedByPercentBetweenTheirTargets) {
    TestScene scene(0, 4);
    fbxsdk::FbxMesh& mesh = *addTriangle(scene, "mesh")->GetMesh();
    auto* blendShape = fbxsdk::FbxBlendShape::Create(scene.scene, "shapes");
    auto* channel = fbxsdk::FbxBlendShapeChannel::Create(scene.scene, "channel");
    for (const double height : {1.0, 4.0}) { // fully reached at 50 and at 100
        auto* shape = fbxsdk::FbxShape::Create(scene.scene, "target");
        shape->InitControlPoints(3);
        for (int i = 0; i < 3; ++i) {
            fbxsdk::FbxVector4 point = mesh.GetControlPointAt(i);
            point[2] += height;
            shape->SetControlPointAt(point, i);
        }
        channel->AddTargetShape(shape, height == 1.0 ? 50.0 : 100.0);
    }
    blendShape->AddBlendShapeChannel(channel);
    mesh.AddDeformer(blendShape);
    for (const auto& [percent, height] : {std::pair(25.0, 0.5f), std::pair(50.0, 1.0f), std::pair(75.0, 2.5f),
                                          std::pair(100.0, 4.0f), std::pair(0.0, 0.0f)}) {
        channel->DeformPercent.Set(percent); // not animated
        EXPECT_NEAR(static_cast<double>(pointsOf(readFaithfully<TnFbxMesh>(scene)["mesh"])[2]),
                    static_cast<double>(height), 1e-5)
            << percent;
    }
}

TEST(FaithfulSkins, AreInTheWorldOnce) {
    const std::string file = fixture("skin_7400_ascii.fbx");
    TnFbxReadInfo own = faithfulRead(file);
    own.setTransformPoints(false);
    FacadeRead<TnFbxMesh> world(faithfulRead(file));
    FacadeRead<TnFbxMesh> inside(own);
    ASSERT_EQ(world.count, 1);
    const Samples position = positionOf(world.objects[0]);
    const Samples placed = pointsOf(world.objects[0]);
    const Samples relative = pointsOf(inside.objects[0]);
    for (std::size_t i = 0; i < placed.size(); ++i)
        EXPECT_NEAR(static_cast<double>(placed[i]), static_cast<double>(relative[i] + position[i % 3]), 1e-5) << i;
}

/// A point at (0, 1, 0) halfway between a static bone and one that is rotated by 90 degrees about X.
TEST(FaithfulSkins, TwistByDualQuaternionsAsMuchAsTheyAreBlended) {
    for (const auto& [blend, expected] :
         {std::pair(0.0, std::sqrt(0.5)), std::pair(1.0, 1.0), std::pair(0.5, (std::sqrt(0.5) + 1.0) / 2.0)}) {
        TestScene scene;
        fbxsdk::FbxNode* node = scene.add<fbxsdk::FbxMesh>("mesh");
        fillMesh(*node->GetMesh(), {{0.0, 1.0, 0.0}, {1.0, 1.0, 0.0}, {0.0, 1.0, 1.0}}, {{0, 1, 2}});
        auto* skin = fbxsdk::FbxSkin::Create(scene.scene, "skin");
        skin->SetSkinningType(fbxsdk::FbxSkin::eBlend);
        skin->AddControlPointIndex(0, blend);
        for (const double turn : {0.0, 90.0}) {
            fbxsdk::FbxNode* bone = scene.add<fbxsdk::FbxSkeleton>("bone");
            bone->LclRotation.Set(fbxsdk::FbxDouble3(turn, 0.0, 0.0));
            auto* cluster = fbxsdk::FbxCluster::Create(scene.scene, "cluster");
            cluster->SetLink(bone);
            cluster->AddControlPointIndex(0, 0.5);
            cluster->SetTransformLinkMatrix(fbxsdk::FbxAMatrix({0.0, 0.0, 0.0}, {0.0, 0.0, 0.0}, {1.0, 1.0, 1.0}));
            skin->AddCluster(cluster);
        }
        // Bound away from the origin, since a skin that is bound there states no binding.
        fbxsdk::FbxAMatrix beside;
        beside.SetT({1.0, 0.0, 0.0});
        skin->GetCluster(0)->SetTransformLinkMatrix(beside);
        skin->GetCluster(0)->GetLink()->LclTranslation.Set(fbxsdk::FbxDouble3(1.0, 0.0, 0.0));
        node->GetMesh()->AddDeformer(skin);
        const Samples points = pointsOf(readFaithfully<TnFbxMesh>(scene)["mesh"]);
        const double length = std::hypot(static_cast<double>(points[1]), static_cast<double>(points[2]));
        EXPECT_NEAR(length, expected, 1e-5) << blend;
    }
}

TEST(FaithfulCaches, ThatCannotBeReadAreWarnedOf) {
    const FacadeRead<TnFbxMesh> read(faithfulRead(fixture("caches_7400_ascii.fbx")));
    EXPECT_EQ(read.count, 5);
    EXPECT_THAT(lastWarnings(), testing::Contains(testing::HasSubstr("cannot be read")));
}

} // namespace
} // namespace Tarnell::Fbx::test
