// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Textures and clips.
#include <fbxsdk/FbxTexture.h>

#include <fbxsdk/FbxVideo.h>

#include "SceneFixture.h"

namespace {

using namespace fbxsdk;

class FbxFileTextureTest : public SceneFixture {
protected:
    FbxFileTexture* texture = make<FbxFileTexture>("texture");
};

TEST_F(FbxFileTextureTest, HasTheDefaultsOfFiles) {
    EXPECT_EQ(texture->Alpha.Get(), 1.0);
    EXPECT_STREQ(texture->Alpha.GetNameAsCStr(), "Texture alpha");
    EXPECT_EQ(texture->WrapModeU.Get(), FbxTexture::eRepeat);
    EXPECT_EQ(texture->WrapModeV.Get(), FbxTexture::eRepeat);
    EXPECT_FALSE(texture->GetSwapUV());
    EXPECT_TRUE(texture->PremultiplyAlpha.Get());
    EXPECT_EQ(texture->Translation.Get(), FbxDouble3(0, 0, 0));
    EXPECT_EQ(texture->Rotation.Get(), FbxDouble3(0, 0, 0));
    EXPECT_EQ(texture->Scaling.Get(), FbxDouble3(1, 1, 1));
    EXPECT_STREQ(texture->RotationPivot.GetNameAsCStr(), "TextureRotationPivot");
    EXPECT_STREQ(texture->ScalingPivot.GetNameAsCStr(), "TextureScalingPivot");
    EXPECT_EQ(texture->UVSet.Get(), FbxString("default"));
    EXPECT_FALSE(texture->UseMaterial.Get());
    EXPECT_FALSE(texture->UseMipMap.Get());
    EXPECT_EQ(texture->GetTextureUse(), FbxTexture::eStandard);
    EXPECT_EQ(texture->GetMappingType(), FbxTexture::eUV);
    EXPECT_EQ(texture->GetMaterialUse(), FbxFileTexture::eModelMaterial);
    EXPECT_STREQ(texture->GetFileName(), "");
    EXPECT_STREQ(texture->GetRelativeFileName(), "");
}

TEST_F(FbxFileTextureTest, DerivesTheRelativeNameOnlyWhenItIsEmpty) {
    EXPECT_TRUE(texture->SetFileName("/images/wood/oak.png"));
    EXPECT_STREQ(texture->GetFileName(), "/images/wood/oak.png");
    EXPECT_STREQ(texture->GetRelativeFileName(), "oak.png");

    EXPECT_TRUE(texture->SetRelativeFileName("wood/oak.png"));
    texture->SetFileName("C:\\images\\ash.png");
    EXPECT_STREQ(texture->GetFileName(), "C:\\images\\ash.png");
    EXPECT_STREQ(texture->GetRelativeFileName(), "wood/oak.png");
}

TEST_F(FbxFileTextureTest, TakesANullNameForTheEmptyOne) {
    EXPECT_TRUE(texture->SetFileName(nullptr));
    EXPECT_TRUE(texture->SetRelativeFileName(nullptr));

    EXPECT_STREQ(texture->GetFileName(), "");
    EXPECT_STREQ(texture->GetRelativeFileName(), "");
}

TEST_F(FbxFileTextureTest, WritesUvMappingAsZero) {
    FbxProperty number = texture->FindProperty("CurrentMappingType");

    texture->SetMappingType(FbxTexture::ePlanar);
    EXPECT_EQ(number.Get<FbxEnum>(), 1);
    texture->SetMappingType(FbxTexture::eUV);
    EXPECT_EQ(number.Get<FbxEnum>(), 0);

    for (const auto type : {FbxTexture::eNull, FbxTexture::ePlanar, FbxTexture::eSpherical, FbxTexture::eCylindrical,
                            FbxTexture::eBox, FbxTexture::eFace, FbxTexture::eUV, FbxTexture::eEnvironment}) {
        texture->SetMappingType(type);
        EXPECT_EQ(texture->GetMappingType(), type);
    }
}

TEST_F(FbxFileTextureTest, TakesNumbersOfAFileThatAreNoneForTheFirst) {
    texture->FindProperty("CurrentMappingType").Set(FbxEnum{99});
    texture->FindProperty("TextureTypeUse").Set(FbxEnum{-1});

    EXPECT_EQ(texture->GetMappingType(), FbxTexture::eNull);
    EXPECT_EQ(texture->GetTextureUse(), FbxTexture::eStandard);
}

TEST_F(FbxFileTextureTest, StoresItsPlacement) {
    texture->SetTranslation(0.25, 0.5);
    texture->SetScale(2, 3);
    texture->SetRotation(10, 20, 30);
    texture->SetSwapUV(true);
    texture->SetTextureUse(FbxTexture::eBumpNormalMap);
    texture->SetMaterialUse(FbxFileTexture::eDefaultMaterial);

    EXPECT_EQ(texture->FindProperty("Translation").Get<FbxDouble3>(), FbxDouble3(0.25, 0.5, 0));
    EXPECT_EQ(texture->FindProperty("Scaling").Get<FbxDouble3>(), FbxDouble3(2, 3, 1));
    EXPECT_EQ(texture->FindProperty("Rotation").Get<FbxDouble3>(), FbxDouble3(10, 20, 30));
    EXPECT_EQ(texture->GetTranslationU(), 0.25);
    EXPECT_EQ(texture->GetTranslationV(), 0.5);
    EXPECT_EQ(texture->GetScaleU(), 2.0);
    EXPECT_EQ(texture->GetScaleV(), 3.0);
    EXPECT_EQ(texture->GetRotationU(), 10.0);
    EXPECT_EQ(texture->GetRotationV(), 20.0);
    EXPECT_EQ(texture->GetRotationW(), 30.0);
    EXPECT_TRUE(texture->FindProperty("UVSwap").Get<FbxBool>());
    EXPECT_EQ(texture->FindProperty("TextureTypeUse").Get<FbxEnum>(), 5);
    EXPECT_EQ(texture->GetMaterialUse(), 1);
}

TEST_F(FbxFileTextureTest, IsATexture) {
    EXPECT_TRUE(texture->Is<FbxTexture>());
    EXPECT_TRUE(make<FbxLayeredTexture>()->Is<FbxTexture>());
    EXPECT_FALSE(make<FbxLayeredTexture>()->Is<FbxFileTexture>());
}

using FbxLayeredTextureTest = SceneFixture;

TEST_F(FbxLayeredTextureTest, HasTexturesForSources) {
    FbxLayeredTexture* layers = make<FbxLayeredTexture>();
    FbxFileTexture* first = make<FbxFileTexture>();
    FbxFileTexture* second = make<FbxFileTexture>();

    layers->ConnectSrcObject(first);
    layers->ConnectSrcObject(second);

    EXPECT_EQ(layers->GetSrcObjectCount<FbxTexture>(), 2);
    EXPECT_EQ(layers->GetSrcObject<FbxTexture>(1), second);
    EXPECT_EQ(layers->UVSet.Get(), FbxString("default"));
}

using FbxVideoTest = SceneFixture;

TEST_F(FbxVideoTest, KeepsItsFileNames) {
    FbxVideo* video = make<FbxVideo>();
    EXPECT_EQ(video->GetFileName(), FbxString(""));
    EXPECT_FALSE(video->GetImageTextureMipMap());

    video->SetFileName("/images/雪.png");
    video->SetRelativeFileName("雪.png");
    video->ImageTextureSetMipMap(true);

    EXPECT_EQ(video->FindProperty("Path").Get<FbxString>(), FbxString("/images/雪.png"));
    EXPECT_EQ(video->GetRelativeFileName(), FbxString("雪.png"));
    EXPECT_TRUE(video->GetImageTextureMipMap());

    video->SetFileName(nullptr);
    EXPECT_EQ(video->GetFileName(), FbxString(""));
}

} // namespace
