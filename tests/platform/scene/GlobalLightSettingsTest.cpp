// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Ambient light and fog.
#include <fbxsdk/FbxGlobalLightSettings.h>

#include "SceneFixture.h"

namespace {

using namespace fbxsdk;

class FbxGlobalLightSettingsTest : public SceneFixture {
protected:
    [[nodiscard]] FbxGlobalLightSettings& settings() const { return scene->GlobalLightSettings(); }

    void expectDefaults() const {
        EXPECT_EQ(settings().GetAmbientColor(), FbxColor(0, 0, 0, 1));
        EXPECT_FALSE(settings().GetFogEnable());
        EXPECT_EQ(settings().GetFogColor(), FbxColor(1, 1, 1, 1));
        EXPECT_EQ(settings().GetFogMode(), FbxGlobalLightSettings::eLinear);
        EXPECT_EQ(settings().GetFogDensity(), 0.002);
        EXPECT_EQ(settings().GetFogStart(), 0.3);
        EXPECT_EQ(settings().GetFogEnd(), 1000.0);
    }

    void changeAll() const {
        settings().SetAmbientColor(FbxColor(0.1, 0.2, 0.3, 0.4));
        settings().SetFogEnable(true);
        settings().SetFogColor(FbxColor(0.5, 0.6, 0.7, 0.8));
        settings().SetFogMode(FbxGlobalLightSettings::eExponentialSquareRoot);
        settings().SetFogDensity(0.5);
        settings().SetFogStart(10.0);
        settings().SetFogEnd(20.0);
    }
};

TEST_F(FbxGlobalLightSettingsTest, HaveTheDefaultsOfFiles) { expectDefaults(); }

TEST_F(FbxGlobalLightSettingsTest, KeepWhatIsSet) {
    changeAll();

    EXPECT_EQ(settings().GetAmbientColor(), FbxColor(0.1, 0.2, 0.3, 0.4));
    EXPECT_TRUE(settings().GetFogEnable());
    EXPECT_EQ(settings().GetFogColor(), FbxColor(0.5, 0.6, 0.7, 0.8));
    EXPECT_EQ(settings().GetFogMode(), FbxGlobalLightSettings::eExponentialSquareRoot);
    EXPECT_EQ(settings().GetFogDensity(), 0.5);
    EXPECT_EQ(settings().GetFogStart(), 10.0);
    EXPECT_EQ(settings().GetFogEnd(), 20.0);
}

TEST_F(FbxGlobalLightSettingsTest, KeepTheAmbientColorInTheGlobalSettings) {
    settings().SetAmbientColor(FbxColor(0.1, 0.2, 0.3, 0.4));
    EXPECT_EQ(scene->GetGlobalSettings().GetAmbientColor(), FbxColor(0.1, 0.2, 0.3, 1));

    scene->GetGlobalSettings().SetAmbientColor(FbxColor(0.7, 0.8, 0.9));
    EXPECT_EQ(settings().GetAmbientColor(), FbxColor(0.7, 0.8, 0.9, 0.4));
}

TEST_F(FbxGlobalLightSettingsTest, GoBackToTheDefaults) {
    changeAll();

    settings().RestoreDefaultSettings();

    expectDefaults();
    EXPECT_EQ(scene->GetGlobalSettings().GetAmbientColor(), FbxColor(0, 0, 0, 1));
}

TEST_F(FbxGlobalLightSettingsTest, AreOneForEachScene) {
    FbxScene* other = FbxScene::Create(manager, "other");
    changeAll();

    EXPECT_FALSE(other->GlobalLightSettings().GetFogEnable());
    EXPECT_EQ(other->GlobalLightSettings().GetAmbientColor(), FbxColor(0, 0, 0, 1));
}

} // namespace
