// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// What a file states beyond the documented API.
#include <memory>
#include <string>

#include <fbxsdk.h>
#include <fbxsdk/extensions/FileFacts.h>

#include "io/SceneReading.h"
#include "platform/document/DocumentFromText.h"
#include "platform/scene/SceneFixture.h"

namespace {

using namespace fbxsdk;

class FileFactsTest : public SceneFixture {
protected:
    ~FileFactsTest() override { FbxTime::SetGlobalTimeMode(FbxTime::eDefaultMode); }

    /// Reads a 7.4 file with these settings into the scene.
    void readSettings(const std::string& lines) {
        FbxStatus status;
        const std::shared_ptr<const detail::Document> document =
            detail::documentOf("7.4.0", "GlobalSettings: {\nProperties70: {\n" + lines + "}\n}\nObjects: {\n}\n");
        EXPECT_TRUE(detail::readScene(document, *scene, status)) << status.GetErrorString();
    }
};

std::string timeMode(int mode) { return "P: \"TimeMode\", \"enum\", \"\", \"\"," + std::to_string(mode) + "\n"; }
std::string customRate(double rate) {
    return "P: \"CustomFrameRate\", \"double\", \"Number\", \"\"," + std::to_string(rate) + "\n";
}

TEST_F(FileFactsTest, AFrameRateIsStatedByAModeOrByACustomOneWithARate) {
    EXPECT_FALSE(extensions::statesFrameRate(*scene)) << "made in memory";
    readSettings(timeMode(FbxTime::ePAL));
    EXPECT_TRUE(extensions::statesFrameRate(*scene));
    readSettings(timeMode(FbxTime::eDefaultMode) + customRate(25.0));
    EXPECT_FALSE(extensions::statesFrameRate(*scene)) << "the file that was read last counts";
    readSettings(timeMode(FbxTime::eCustom) + customRate(12.5));
    EXPECT_TRUE(extensions::statesFrameRate(*scene));
}

TEST_F(FileFactsTest, ACustomFrameRateThatIsAssumedIsNotStated) {
    for (const std::string& rate : {std::string(), customRate(0.0), customRate(-1.0)}) {
        readSettings(timeMode(FbxTime::eCustom) + rate);
        EXPECT_FALSE(extensions::statesFrameRate(*scene)) << rate;
    }
}

TEST_F(FileFactsTest, UserDefinedPropertiesAreThoseWithTheFlag) {
    FbxNode* const node = FbxNode::Create(scene, "n");
    FbxProperty own = FbxProperty::Create(node, FbxDoubleDT, "own");
    node->LclTranslation.Set(FbxDouble3(1, 2, 3));
    EXPECT_FALSE(extensions::hasUserDefinedProperties(*node));
    own.ModifyFlag(FbxPropertyFlags::eUserDefined, true);
    EXPECT_TRUE(extensions::hasUserDefinedProperties(*node));
    own.ModifyFlag(FbxPropertyFlags::eUserDefined, false);
    node->Visibility.ModifyFlag(FbxPropertyFlags::eUserDefined, true);
    EXPECT_TRUE(extensions::hasUserDefinedProperties(*node)) << "a property of the class may have it, too";
}

/// hasUserDefinedProperties relies on it.
TEST_F(FileFactsTest, NewObjectsHaveNoUserDefinedProperty) {
    for (FbxObject* object :
         {static_cast<FbxObject*>(FbxNode::Create(scene, "n")), static_cast<FbxObject*>(FbxCamera::Create(scene, "c")),
          static_cast<FbxObject*>(FbxLight::Create(scene, "l")),
          static_cast<FbxObject*>(FbxSurfacePhong::Create(scene, "p")),
          static_cast<FbxObject*>(&scene->GetGlobalSettings())})
        for (FbxProperty each = object->GetFirstProperty(); each.IsValid(); each = object->GetNextProperty(each))
            EXPECT_FALSE(each.GetFlag(FbxPropertyFlags::eUserDefined)) << each.GetNameAsCStr();
}

} // namespace
