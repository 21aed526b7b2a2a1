// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The factories of nodes, textures and materials: the state of a new one before its channels are written.
#include "support/WritingBuilders.h"

#include "TnFbxError.h"

#include <gtest/gtest.h>

#include <limits>

namespace Tarnell::Fbx {
namespace {

using fbxsdk::FbxCamera;
using fbxsdk::FbxLight;
using test::WrittenScene;

void expectVector(const fbxsdk::FbxDouble3& vector, double x, double y, double z) {
    EXPECT_EQ(vector[0], x);
    EXPECT_EQ(vector[1], y);
    EXPECT_EQ(vector[2], z);
}

TEST(CameraConstruction, GivesACameraAFilmAndAVerticalAperture) {
    WrittenScene scene;

    fbxsdk::FbxNode* node = scene.sdk.createCamera(scene.scene, "camera");

    ASSERT_NE(node, nullptr);
    EXPECT_STREQ(node->GetName(), "camera");
    FbxCamera* camera = node->GetCamera();
    ASSERT_NE(camera, nullptr);
    EXPECT_STREQ(camera->GetName(), "camera");
    EXPECT_EQ(camera->GetApertureMode(), FbxCamera::eVertical);
    EXPECT_EQ(camera->GetApertureWidth(), 0.816);
    EXPECT_EQ(camera->GetApertureHeight(), 0.612);
    EXPECT_EQ(camera->GetSqueezeRatio(), 1.0);
}

TEST(NodeConstruction, MakesCamerasAndLightsInTheSceneAndNullsOutsideOfIt) {
    WrittenScene scene;

    EXPECT_EQ(scene.sdk.createCamera(scene.scene, "camera")->GetScene(), scene.scene);
    EXPECT_EQ(scene.sdk.createLight(scene.scene, TnFbxLight::kFbxLightPoint, "light")->GetScene(), scene.scene);
    EXPECT_EQ(scene.sdk.createNull(scene.manager, "null")->GetScene(), nullptr);
    EXPECT_EQ(scene.sdk.createMesh(scene.manager, test::polygonMesh("mesh").get(), "mesh")->GetScene(), nullptr);
    EXPECT_EQ(scene.scene->GetRootNode()->GetChildCount(), 0);
}

TEST(NodeConstruction, NeedsASceneOrAManager) {
    FbxSdk sdk;

    EXPECT_EQ(sdk.createCamera(nullptr, "camera"), nullptr);
    EXPECT_FALSE(lastError().empty());
    EXPECT_EQ(sdk.createLight(nullptr, TnFbxLight::kFbxLightPoint, "light"), nullptr);
    EXPECT_EQ(sdk.createNull(nullptr, "null"), nullptr);
    EXPECT_EQ(sdk.createMesh(nullptr, test::polygonMesh("mesh").get(), "mesh"), nullptr);
    EXPECT_EQ(sdk.createTexture(nullptr, "texture.png"), nullptr);
    EXPECT_EQ(sdk.createLambertMaterial(nullptr, "material", 0), nullptr);
}

TEST(NullConstruction, GivesANullItsDefaultLookAndSize) {
    WrittenScene scene;

    fbxsdk::FbxNode* node = scene.sdk.createNull(scene.manager, "null");

    ASSERT_NE(node, nullptr);
    EXPECT_STREQ(node->GetName(), "null");
    ASSERT_NE(node->GetNull(), nullptr);
    EXPECT_EQ(node->GetNull()->Look.Get(), fbxsdk::FbxNull::sDefaultLook);
    EXPECT_EQ(node->GetNull()->Size.Get(), fbxsdk::FbxNull::sDefaultSize);
}

FbxLight::EType typeFor(TnFbxLight::EFbxLightType type) {
    WrittenScene scene;
    FbxLight* light = scene.sdk.createLight(scene.scene, type, "light")->GetLight();
    EXPECT_TRUE(light->CastLight.Get());
    EXPECT_STREQ(light->GetName(), "light");
    return light->LightType.Get();
}

TEST(LightConstruction, MapsTheType) {
    EXPECT_EQ(typeFor(TnFbxLight::kFbxLightPoint), FbxLight::ePoint);
    EXPECT_EQ(typeFor(TnFbxLight::kFbxLightDirectional), FbxLight::eDirectional);
    EXPECT_EQ(typeFor(TnFbxLight::kFbxLightSpot), FbxLight::eSpot);
}

TEST(LightConstruction, LeavesTheDefaultTypeForWhatIsNoType) {
    WrittenScene scene;
    const FbxLight::EType otherwise = FbxLight::Create(scene.manager, "")->LightType.Get();

    EXPECT_EQ(typeFor(static_cast<TnFbxLight::EFbxLightType>(3)), otherwise);
    EXPECT_EQ(typeFor(static_cast<TnFbxLight::EFbxLightType>(-1)), otherwise);
}

TEST(TextureConstruction, MapsTheFileByTextureCoordinates) {
    using Texture = fbxsdk::FbxFileTexture;
    WrittenScene scene;

    Texture* texture = scene.sdk.createTexture(scene.scene, "maps/wood.png");

    ASSERT_NE(texture, nullptr);
    EXPECT_STREQ(texture->GetName(), "maps/wood.png");
    EXPECT_STREQ(texture->GetFileName(), "maps/wood.png");
    EXPECT_EQ(texture->GetTextureUse(), Texture::eStandard);
    EXPECT_EQ(texture->GetMappingType(), Texture::eUV);
    EXPECT_EQ(texture->GetMaterialUse(), Texture::eModelMaterial);
    EXPECT_FALSE(texture->GetSwapUV());
    EXPECT_EQ(texture->GetTranslationU(), 0.0);
    EXPECT_EQ(texture->GetTranslationV(), 0.0);
    EXPECT_EQ(texture->GetScaleU(), 1.0);
    EXPECT_EQ(texture->GetScaleV(), 1.0);
    EXPECT_EQ(texture->GetRotationU(), 0.0);
    EXPECT_EQ(texture->GetRotationV(), 0.0);
    EXPECT_EQ(texture->GetRotationW(), 0.0);
    EXPECT_EQ(texture->GetScene(), scene.scene);
}

TEST(MaterialConstruction, NumbersTheNameAndIsGrey) {
    WrittenScene scene;

    fbxsdk::FbxSurfaceLambert* material = scene.sdk.createLambertMaterial(scene.manager, "material", 3);

    ASSERT_NE(material, nullptr);
    EXPECT_STREQ(material->GetName(), "material3");
    expectVector(material->Emissive.Get(), 0.0, 0.0, 0.0);
    EXPECT_EQ(material->EmissiveFactor.Get(), 1.0);
    expectVector(material->Ambient.Get(), 0.0, 0.0, 0.0);
    EXPECT_EQ(material->AmbientFactor.Get(), 1.0);
    expectVector(material->Diffuse.Get(), 0.5, 0.5, 0.5);
    EXPECT_EQ(material->DiffuseFactor.Get(), 0.8);
    expectVector(material->TransparentColor.Get(), 0.0, 0.0, 0.0);
    EXPECT_EQ(material->TransparencyFactor.Get(), 0.0);
    EXPECT_STREQ(material->ShadingModel.Get(), "Lambert");
}

TEST(MaterialConstruction, WritesAnyIndex) {
    WrittenScene scene;

    EXPECT_STREQ(scene.sdk.createLambertMaterial(scene.manager, "", 0)->GetName(), "0");
    EXPECT_STREQ(scene.sdk.createLambertMaterial(scene.manager, "m", std::numeric_limits<int>::min())->GetName(),
                 "m-2147483648");
}

} // namespace
} // namespace Tarnell::Fbx
