// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Materials: the class tree, defaults and names.
#include <fbxsdk/FbxSurfaceMaterial.h>

#include "SceneFixture.h"

namespace {

using namespace fbxsdk;

using FbxSurfaceMaterialTest = SceneFixture;

TEST_F(FbxSurfaceMaterialTest, DerivesPhongFromLambertFromTheRest) {
    FbxSurfacePhong* phong = make<FbxSurfacePhong>();
    FbxSurfaceLambert* lambert = make<FbxSurfaceLambert>();

    EXPECT_TRUE(phong->GetClassId().Is(FbxSurfaceLambert::ClassId));
    EXPECT_TRUE(phong->GetClassId().Is(FbxSurfaceMaterial::ClassId));
    EXPECT_FALSE(lambert->GetClassId().Is(FbxSurfacePhong::ClassId));
    EXPECT_EQ(FbxSurfacePhong::ClassId.GetParent(), FbxSurfaceLambert::ClassId);
    EXPECT_EQ(FbxSurfaceLambert::ClassId.GetParent(), FbxSurfaceMaterial::ClassId);
    EXPECT_EQ(FbxSurfaceMaterial::ClassId.GetParent(), FbxObject::ClassId);
    EXPECT_EQ(FbxCast<FbxSurfaceLambert>(phong), phong);
}

TEST_F(FbxSurfaceMaterialTest, NamesItsShadingModel) {
    EXPECT_EQ(make<FbxSurfaceMaterial>()->ShadingModel.Get(), FbxString("Unknown"));
    EXPECT_EQ(make<FbxSurfaceLambert>()->ShadingModel.Get(), FbxString("Lambert"));
    EXPECT_EQ(make<FbxSurfacePhong>()->ShadingModel.Get(), FbxString("Phong"));
    EXPECT_FALSE(make<FbxSurfaceMaterial>()->MultiLayer.Get());
}

TEST_F(FbxSurfaceMaterialTest, HasNoColorsOfItsOwn) {
    EXPECT_FALSE(make<FbxSurfaceMaterial>()->FindProperty("DiffuseColor").IsValid());
}

void expectLambertDefaults(const FbxSurfaceLambert& material) {
    const struct {
        const FbxPropertyT<FbxDouble3>& member;
        const char* name;
        double value;
    } colors[] = {{material.Emissive, "EmissiveColor", 0},
                  {material.Ambient, "AmbientColor", 0.2},
                  {material.Diffuse, "DiffuseColor", 0.8},
                  {material.NormalMap, "NormalMap", 0},
                  {material.Bump, "Bump", 0},
                  {material.TransparentColor, "TransparentColor", 0},
                  {material.DisplacementColor, "DisplacementColor", 0},
                  {material.VectorDisplacementColor, "VectorDisplacementColor", 0}};
    for (const auto& each : colors) {
        EXPECT_STREQ(each.member.GetNameAsCStr(), each.name);
        EXPECT_EQ(each.member.Get(), FbxDouble3(each.value, each.value, each.value)) << each.name;
    }
    const struct {
        const FbxPropertyT<FbxDouble>& member;
        const char* name;
        double value;
    } factors[] = {{material.EmissiveFactor, "EmissiveFactor", 1},
                   {material.AmbientFactor, "AmbientFactor", 1},
                   {material.DiffuseFactor, "DiffuseFactor", 1},
                   {material.BumpFactor, "BumpFactor", 1},
                   {material.TransparencyFactor, "TransparencyFactor", 0},
                   {material.DisplacementFactor, "DisplacementFactor", 1},
                   {material.VectorDisplacementFactor, "VectorDisplacementFactor", 1}};
    for (const auto& each : factors) {
        EXPECT_STREQ(each.member.GetNameAsCStr(), each.name);
        EXPECT_EQ(each.member.Get(), each.value) << each.name;
    }
}

TEST_F(FbxSurfaceMaterialTest, GivesLambertTheDefaultsOfFiles) { expectLambertDefaults(*make<FbxSurfaceLambert>()); }

TEST_F(FbxSurfaceMaterialTest, GivesPhongTheDefaultsOfFiles) {
    FbxSurfacePhong* phong = make<FbxSurfacePhong>();

    expectLambertDefaults(*phong);
    EXPECT_EQ(phong->Specular.Get(), FbxDouble3(0.2, 0.2, 0.2));
    EXPECT_STREQ(phong->Specular.GetNameAsCStr(), "SpecularColor");
    EXPECT_EQ(phong->SpecularFactor.Get(), 1.0);
    EXPECT_EQ(phong->Shininess.Get(), 20.0);
    EXPECT_STREQ(phong->Shininess.GetNameAsCStr(), "ShininessExponent");
    EXPECT_EQ(phong->Reflection.Get(), FbxDouble3(0, 0, 0));
    EXPECT_STREQ(phong->Reflection.GetNameAsCStr(), "ReflectionColor");
    EXPECT_EQ(phong->ReflectionFactor.Get(), 1.0);
}

TEST_F(FbxSurfaceMaterialTest, StoresAColorUnderTheFilesName) {
    FbxSurfaceLambert* lambert = make<FbxSurfaceLambert>();

    lambert->Diffuse.Set(FbxDouble3(0.1, 0.2, 0.3));

    EXPECT_EQ(lambert->FindProperty("DiffuseColor").Get<FbxDouble3>(), FbxDouble3(0.1, 0.2, 0.3));
    EXPECT_TRUE(lambert->Diffuse.GetFlag(FbxPropertyFlags::eAnimatable));
}

} // namespace
