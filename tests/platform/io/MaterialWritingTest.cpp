// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Materials and textures are read back from a file of any version.

#include <fbxsdk/FbxMesh.h>
#include <fbxsdk/FbxSurfaceMaterial.h>
#include <fbxsdk/FbxTexture.h>
#include <fbxsdk/FbxVideo.h>

#include "ExportFixture.h"

namespace {

using namespace fbxsdk;
using exporting::expectVector;

class MaterialWriting : public exporting::EveryLayout {};

INSTANTIATE_TEST_SUITE_P(Versions, MaterialWriting, testing::ValuesIn(exporting::allLayouts()));

TEST_P(MaterialWriting, KeepsMaterialsInOrderWithTheirTextures) {
    FbxNode* node = addNode("node", make<FbxMesh>("mesh"));
    FbxSurfacePhong* phong = make<FbxSurfacePhong>("phong");
    phong->Diffuse.Set(FbxDouble3(1, 0.5, 0.25));
    phong->Shininess.Set(42.0);
    FbxSurfaceLambert* lambert = make<FbxSurfaceLambert>("lambert");
    lambert->Ambient.Set(FbxDouble3(0.125, 0, 0));
    FbxSurfaceMaterial* plain = make<FbxSurfaceMaterial>("plain");
    plain->ShadingModel.Set("toon");
    for (FbxSurfaceMaterial* material :
         {static_cast<FbxSurfaceMaterial*>(phong), static_cast<FbxSurfaceMaterial*>(lambert), plain})
        node->AddMaterial(material);
    FbxFileTexture* texture = make<FbxFileTexture>("texture");
    texture->SetFileName("/absolute/\"image\".png");
    texture->SetRelativeFileName("..\\image.png");
    texture->SetSwapUV(true);
    texture->SetScale(2, 3);
    lambert->Diffuse.ConnectSrcObject(texture);
    FbxVideo* video = make<FbxVideo>("video");
    video->SetFileName("/absolute/image.png");
    texture->ConnectSrcObject(video);

    FbxScene* copy = writeAndRead();

    FbxNode* back = childOf(copy);
    ASSERT_EQ(back->GetMaterialCount(), 3);
    auto* backPhong = FbxCast<FbxSurfacePhong>(back->GetMaterial(0));
    auto* backLambert = FbxCast<FbxSurfaceLambert>(back->GetMaterial(1));
    ASSERT_NE(backPhong, nullptr);
    ASSERT_NE(backLambert, nullptr);
    expectVector(backPhong->Diffuse.Get(), 1, 0.5, 0.25);
    EXPECT_EQ(backPhong->Shininess.Get(), 42.0);
    expectVector(backLambert->Ambient.Get(), 0.125, 0, 0);
    EXPECT_STREQ(back->GetMaterial(2)->ShadingModel.Get().Buffer(), "toon");
    EXPECT_EQ(back->GetMaterial(2)->GetClassId(), FbxSurfaceMaterial::ClassId);
    auto* backTexture = backLambert->Diffuse.GetSrcObject<FbxFileTexture>();
    ASSERT_NE(backTexture, nullptr);
    EXPECT_STREQ(backTexture->GetFileName(), "/absolute/\"image\".png");
    EXPECT_STREQ(backTexture->GetRelativeFileName(), "..\\image.png");
    EXPECT_TRUE(backTexture->GetSwapUV());
    EXPECT_EQ(backTexture->GetScaleV(), 3.0);
    ASSERT_NE(backTexture->GetSrcObject<FbxVideo>(), nullptr);
    EXPECT_STREQ(backTexture->GetSrcObject<FbxVideo>()->GetFileName().Buffer(), "/absolute/image.png");
}

TEST_P(MaterialWriting, NeverTakesAMaterialForAnother) {
    FbxNode* node = addNode("node", make<FbxMesh>("mesh"));
    FbxSurfaceMaterial* plain = make<FbxSurfaceMaterial>("plain");
    plain->ShadingModel.Set("Phong");
    FbxSurfaceLambert* lambert = make<FbxSurfaceLambert>("lambert");
    lambert->ShadingModel.Set("blinn");
    node->AddMaterial(plain);
    node->AddMaterial(lambert);

    FbxNode* back = childOf(writeAndRead());

    ASSERT_EQ(back->GetMaterialCount(), 2);
    EXPECT_EQ(back->GetMaterial(0)->GetClassId(), FbxSurfaceMaterial::ClassId);
    EXPECT_EQ(back->GetMaterial(1)->GetClassId(), FbxSurfaceLambert::ClassId);
}

TEST_P(MaterialWriting, WritesTexturesThatNothingUses) {
    make<FbxFileTexture>("alone")->SetFileName("a.png");

    auto* back = writeAndRead()->GetSrcObject<FbxFileTexture>();

    ASSERT_NE(back, nullptr);
    EXPECT_STREQ(back->GetName(), "alone");
}

} // namespace
