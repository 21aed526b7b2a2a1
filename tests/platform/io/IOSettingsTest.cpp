// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Import and export options: the known paths, and the result for others.
#include <fbxsdk/FbxIOSettings.h>

#include <string>

#include "platform/scene/SceneFixture.h"

namespace {

using namespace fbxsdk;

class FbxIOSettingsTest : public SceneFixture {
protected:
    FbxIOSettings* settings() { return FbxIOSettings::Create(manager, IOSROOT); }
};

constexpr const char* kOnByDefault[] = {
    "Import|AdvOptGrp|FileFormat|Fbx|Material",
    "Import|AdvOptGrp|FileFormat|Fbx|Texture",
    "Import|AdvOptGrp|FileFormat|Fbx|Link",
    "Import|AdvOptGrp|FileFormat|Fbx|Shape",
    "Import|AdvOptGrp|FileFormat|Fbx|Gobo",
    "Import|AdvOptGrp|FileFormat|Fbx|Animation",
    "Import|AdvOptGrp|FileFormat|Fbx|Global_Settings",
    "Export|AdvOptGrp|Fbx|Material",
    "Export|AdvOptGrp|Fbx|Texture",
    "Export|AdvOptGrp|Fbx|Shape",
    "Export|AdvOptGrp|Fbx|Gobo",
    "Export|AdvOptGrp|Fbx|Animation",
    "Export|AdvOptGrp|Fbx|Global_Settings",
};

TEST_F(FbxIOSettingsTest, AreCalledAsTheyWereMade) { EXPECT_STREQ(settings()->GetName(), "IOSRoot"); }

TEST_F(FbxIOSettingsTest, AreOnButForEmbedding) {
    const FbxIOSettings* made = settings();

    for (const char* path : kOnByDefault)
        EXPECT_TRUE(made->GetBoolProp(path, /*pDefValue*/ false)) << path;
    EXPECT_FALSE(made->GetBoolProp("Export|AdvOptGrp|Fbx|EMBEDDED", /*pDefValue*/ true));
}

TEST_F(FbxIOSettingsTest, HaveMacrosForTheirPaths) {
    EXPECT_STREQ(IMP_FBX_MATERIAL, "Import|AdvOptGrp|FileFormat|Fbx|Material");
    EXPECT_STREQ(IMP_FBX_GLOBAL_SETTINGS, "Import|AdvOptGrp|FileFormat|Fbx|Global_Settings");
    EXPECT_STREQ(EXP_FBX_EMBEDDED, "Export|AdvOptGrp|Fbx|EMBEDDED");
}

TEST_F(FbxIOSettingsTest, KeepWhatIsSet) {
    FbxIOSettings* made = settings();

    made->SetBoolProp(IMP_FBX_TEXTURE, false);
    made->SetBoolProp(EXP_FBX_EMBEDDED, true);

    EXPECT_FALSE(made->GetBoolProp(IMP_FBX_TEXTURE, true));
    EXPECT_TRUE(made->GetBoolProp(EXP_FBX_EMBEDDED, false));
    EXPECT_TRUE(made->GetBoolProp(IMP_FBX_MATERIAL, false));
}

TEST_F(FbxIOSettingsTest, AnswerWithTheGivenDefaultForAnUnknownPath) {
    const FbxIOSettings* made = settings();

    for (const char* path :
         {"Import|Nothing", "", "Export|AdvOptGrp|Fbx|embedded", static_cast<const char*>(nullptr)}) {
        EXPECT_TRUE(made->GetBoolProp(path, true));
        EXPECT_FALSE(made->GetBoolProp(path, false));
    }
}

TEST_F(FbxIOSettingsTest, DoNotLearnUnknownPaths) {
    FbxIOSettings* made = settings();

    made->SetBoolProp("Import|Nothing", true);
    made->SetBoolProp(nullptr, true);

    EXPECT_FALSE(made->GetBoolProp("Import|Nothing", false));
}

TEST_F(FbxIOSettingsTest, ShareNothingWithOthers) {
    FbxIOSettings* one = settings();
    one->SetBoolProp(IMP_FBX_LINK, false);

    EXPECT_TRUE(settings()->GetBoolProp(IMP_FBX_LINK, false));
}

TEST_F(FbxIOSettingsTest, AreThoseOfTheManagerUntilTheyAreDestroyed) {
    EXPECT_EQ(manager->GetIOSettings(), nullptr);
    FbxIOSettings* made = settings();

    manager->SetIOSettings(made);
    EXPECT_EQ(manager->GetIOSettings(), made);

    made->Destroy();
    EXPECT_EQ(manager->GetIOSettings(), nullptr);
}

} // namespace
