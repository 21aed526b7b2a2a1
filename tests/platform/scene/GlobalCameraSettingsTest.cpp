// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The default camera and the producer cameras.
#include <fbxsdk/FbxGlobalCameraSettings.h>

#include <string>
#include <vector>

#include <fbxsdk/FbxCamera.h>
#include <fbxsdk/FbxCameraSwitcher.h>
#include <fbxsdk/FbxNode.h>
#include <fbxsdk/FbxNull.h>

#include "SceneFixture.h"

namespace {

using namespace fbxsdk;

class FbxGlobalCameraSettingsTest : public SceneFixture {
protected:
    [[nodiscard]] FbxGlobalCameraSettings& settings() const { return scene->GlobalCameraSettings(); }

    FbxNode* cameraNode(const char* name, FbxNode* parent) {
        FbxNode* node = make<FbxNode>(name);
        node->SetNodeAttribute(make<FbxCamera>(name));
        if (parent)
            parent->AddChild(node);
        return node;
    }
};

struct Expected {
    const char* name;
    FbxCamera* (FbxGlobalCameraSettings::*camera)() const;
    FbxDouble3 position, up;
    FbxCamera::EProjectionType projection;
    double nearPlane, farPlane;
};

using Settings = FbxGlobalCameraSettings;
constexpr auto kPerspective = FbxCamera::ePerspective;
constexpr auto kOrthogonal = FbxCamera::eOrthogonal;
constexpr FbxDouble3 kUpY(0, 1, 0), kBackZ(0, 0, -1);
const Expected kExpected[] = {
    {"Producer Perspective", &Settings::GetCameraProducerPerspective, {0, 71.3, 287.5}, kUpY, kPerspective, 10, 4000},
    {"Producer Top", &Settings::GetCameraProducerTop, {0, 4000, 0}, kBackZ, kOrthogonal, 1, 30000},
    {"Producer Bottom", &Settings::GetCameraProducerBottom, {0, -4000, 0}, kBackZ, kOrthogonal, 1, 30000},
    {"Producer Front", &Settings::GetCameraProducerFront, {0, 0, 4000}, kUpY, kOrthogonal, 1, 30000},
    {"Producer Back", &Settings::GetCameraProducerBack, {0, 0, -4000}, kUpY, kOrthogonal, 1, 30000},
    {"Producer Right", &Settings::GetCameraProducerRight, {4000, 0, 0}, kUpY, kOrthogonal, 1, 30000},
    {"Producer Left", &Settings::GetCameraProducerLeft, {-4000, 0, 0}, kUpY, kOrthogonal, 1, 30000},
};

TEST_F(FbxGlobalCameraSettingsTest, HaveNoProducerCamerasAtFirst) {
    for (const Expected& row : kExpected)
        EXPECT_EQ((settings().*row.camera)(), nullptr) << row.name;
    EXPECT_EQ(settings().GetCameraSwitcher(), nullptr);
    EXPECT_FALSE(settings().IsProducerCamera(nullptr));
}

TEST_F(FbxGlobalCameraSettingsTest, MakeSevenCamerasWithTheirViews) {
    settings().CreateProducerCameras();

    for (const Expected& row : kExpected) {
        const FbxCamera* camera = (settings().*row.camera)();
        ASSERT_NE(camera, nullptr) << row.name;
        EXPECT_STREQ(camera->GetName(), row.name);
        EXPECT_EQ(camera->Position.Get(), row.position) << row.name;
        EXPECT_EQ(camera->UpVector.Get(), row.up) << row.name;
        EXPECT_EQ(camera->InterestPosition.Get(), FbxDouble3(0, 0, 0)) << row.name;
        EXPECT_EQ(camera->ProjectionType.Get(), row.projection) << row.name;
        EXPECT_EQ(camera->NearPlane.Get(), row.nearPlane) << row.name;
        EXPECT_EQ(camera->FarPlane.Get(), row.farPlane) << row.name;
        EXPECT_TRUE(settings().IsProducerCamera(camera)) << row.name;
    }
}

TEST_F(FbxGlobalCameraSettingsTest, GiveAllSevenTheSameLens) {
    settings().CreateProducerCameras();

    for (const Expected& row : kExpected) {
        const FbxCamera* camera = (settings().*row.camera)();
        EXPECT_EQ(camera->FieldOfView.Get(), 40.0) << row.name;
        EXPECT_EQ(camera->FocalLength.Get(), 21.354493494969105) << row.name;
        EXPECT_EQ(camera->FilmWidth.Get(), 0.816) << row.name;
        EXPECT_EQ(camera->FilmHeight.Get(), 0.612) << row.name;
        EXPECT_EQ(camera->Roll.Get(), 0.0) << row.name;
        EXPECT_EQ(camera->GetApertureMode(), FbxCamera::eVertical) << row.name;
    }
}

TEST_F(FbxGlobalCameraSettingsTest, AttachEachCameraToAnUnparentedNodeOfItsOwn) {
    settings().CreateProducerCameras();

    for (const Expected& row : kExpected) {
        FbxCamera* camera = (settings().*row.camera)();
        FbxNode* node = camera->GetNode(0);
        ASSERT_NE(node, nullptr) << row.name;
        EXPECT_EQ(camera->GetNodeCount(), 1) << row.name;
        EXPECT_STREQ(node->GetName(), row.name);
        EXPECT_EQ(node->GetNodeAttribute(), camera) << row.name;
        EXPECT_EQ(node->GetScene(), scene) << row.name;
        EXPECT_EQ(camera->GetScene(), scene) << row.name;
        EXPECT_EQ(node->GetParent(), nullptr) << row.name;
    }
    EXPECT_EQ(scene->GetRootNode()->GetChildCount(), 0);
    EXPECT_EQ(scene->GetNodeCount(), 1 + 7 + 1); // the root, the cameras, the switcher
}

TEST_F(FbxGlobalCameraSettingsTest, MakeTheSwitcherWithANode) {
    settings().CreateProducerCameras();

    FbxCameraSwitcher* switcher = settings().GetCameraSwitcher();
    ASSERT_NE(switcher, nullptr);
    ASSERT_NE(switcher->GetNode(0), nullptr);
    EXPECT_STREQ(switcher->GetNode(0)->GetName(), "Camera Switcher");
    EXPECT_EQ(switcher->GetNode(0)->GetParent(), nullptr);
    EXPECT_EQ(switcher->GetScene(), scene);
}

TEST_F(FbxGlobalCameraSettingsTest, MakeThemOnceOnly) {
    const auto cameras = [this] {
        std::vector<const FbxCamera*> found;
        for (const Expected& row : kExpected)
            found.push_back((settings().*row.camera)());
        return found;
    };
    settings().CreateProducerCameras();
    const std::vector<const FbxCamera*> first = cameras();
    const FbxCameraSwitcher* switcher = settings().GetCameraSwitcher();
    const int nodeCount = scene->GetNodeCount();

    settings().CreateProducerCameras();

    EXPECT_EQ(cameras(), first);
    EXPECT_EQ(settings().GetCameraSwitcher(), switcher);
    EXPECT_EQ(scene->GetNodeCount(), nodeCount);
}

TEST_F(FbxGlobalCameraSettingsTest, DestroyThemWithTheirNodes) {
    settings().CreateProducerCameras();

    settings().DestroyProducerCameras();

    for (const Expected& row : kExpected)
        EXPECT_EQ((settings().*row.camera)(), nullptr) << row.name;
    EXPECT_EQ(settings().GetCameraSwitcher(), nullptr);
    EXPECT_EQ(scene->GetNodeCount(), 1);
    EXPECT_EQ(scene->GetSrcObjectCount<FbxCamera>(), 0);
    settings().DestroyProducerCameras(); // and again, with none there
}

TEST_F(FbxGlobalCameraSettingsTest, ForgetACameraThatAHostDestroys) {
    settings().CreateProducerCameras();

    settings().GetCameraProducerTop()->Destroy();
    settings().GetCameraSwitcher()->Destroy();

    EXPECT_EQ(settings().GetCameraProducerTop(), nullptr);
    EXPECT_EQ(settings().GetCameraSwitcher(), nullptr);
    ASSERT_NE(settings().GetCameraProducerBottom(), nullptr);
    settings().CreateProducerCameras();
    EXPECT_NE(settings().GetCameraProducerTop(), nullptr);
    EXPECT_NE(settings().GetCameraSwitcher(), nullptr);
}

TEST_F(FbxGlobalCameraSettingsTest, KeepTheCameraWhoseNodeAHostDestroys) {
    settings().CreateProducerCameras();
    FbxCamera* camera = settings().GetCameraProducerLeft();

    camera->GetNode(0)->Destroy();

    EXPECT_EQ(settings().GetCameraProducerLeft(), camera);
    EXPECT_EQ(camera->GetNode(0), nullptr);
    settings().DestroyProducerCameras();
    EXPECT_EQ(settings().GetCameraProducerLeft(), nullptr);
}

TEST_F(FbxGlobalCameraSettingsTest, KnowNoOtherCameraForAProducerCamera) {
    settings().CreateProducerCameras();
    FbxNode* node = cameraNode("Producer Top", scene->GetRootNode());

    EXPECT_FALSE(settings().IsProducerCamera(node->GetCamera()));
}

TEST_F(FbxGlobalCameraSettingsTest, AdoptACameraOfThatNameFromAFile) {
    FbxNode* node = cameraNode("Producer Front", nullptr);

    EXPECT_TRUE(settings().adoptProducerCamera(*node));
    EXPECT_EQ(settings().GetCameraProducerFront(), node->GetCamera());

    settings().CreateProducerCameras();
    EXPECT_EQ(settings().GetCameraProducerFront(), node->GetCamera());
    EXPECT_NE(settings().GetCameraProducerBack(), nullptr);
}

TEST_F(FbxGlobalCameraSettingsTest, AdoptNeitherASecondOneNorOneOfAnotherNameOrKind) {
    ASSERT_TRUE(settings().adoptProducerCamera(*cameraNode("Producer Front", nullptr)));
    FbxNode* null = make<FbxNode>("Producer Back");
    null->SetNodeAttribute(make<FbxNull>());

    EXPECT_FALSE(settings().adoptProducerCamera(*cameraNode("Producer Front", nullptr)));
    EXPECT_FALSE(settings().adoptProducerCamera(*cameraNode("producer back", nullptr)));
    EXPECT_FALSE(settings().adoptProducerCamera(*null));
    EXPECT_FALSE(settings().adoptProducerCamera(*make<FbxNode>("Producer Left")));
    EXPECT_EQ(settings().GetCameraProducerBack(), nullptr);
    EXPECT_EQ(settings().GetCameraProducerLeft(), nullptr);
}

TEST_F(FbxGlobalCameraSettingsTest, AdoptTheSwitcherOfAFile) {
    FbxNode* node = make<FbxNode>("Camera Switcher");
    auto* switcher = make<FbxCameraSwitcher>("Camera Switcher");
    node->SetNodeAttribute(switcher);

    EXPECT_TRUE(settings().adoptProducerCamera(*node));
    EXPECT_EQ(settings().GetCameraSwitcher(), switcher);
    EXPECT_FALSE(settings().adoptProducerCamera(*node));
}

TEST_F(FbxGlobalCameraSettingsTest, TakeAHostsSwitcherIntoTheScene) {
    auto* switcher = FbxCameraSwitcher::Create(manager, "mine");

    settings().SetCameraSwitcher(switcher);

    EXPECT_EQ(settings().GetCameraSwitcher(), switcher);
    EXPECT_EQ(switcher->GetScene(), scene);
    settings().SetCameraSwitcher(nullptr);
    EXPECT_EQ(settings().GetCameraSwitcher(), nullptr);
}

TEST_F(FbxGlobalCameraSettingsTest, TakeNoSwitcherOfAnotherScene) {
    auto* elsewhere = FbxCameraSwitcher::Create(FbxScene::Create(manager, "other"), "theirs");

    settings().SetCameraSwitcher(elsewhere);

    EXPECT_EQ(settings().GetCameraSwitcher(), nullptr);
}

TEST_F(FbxGlobalCameraSettingsTest, NameTheProducerPerspectiveByDefault) {
    EXPECT_STREQ(settings().GetDefaultCamera(), "Producer Perspective");
    EXPECT_STREQ(scene->GetGlobalSettings().GetDefaultCamera().Buffer(), "");
}

TEST_F(FbxGlobalCameraSettingsTest, TakeTheEightFixedNamesForTheDefaultCamera) {
    for (const char* name : {"Producer Perspective", "Producer Top", "Producer Front", "Producer Back",
                             "Producer Right", "Producer Left", "Producer Bottom", "Camera Switcher"}) {
        FbxStatus status(FbxStatus::eFailure);
        EXPECT_TRUE(settings().SetDefaultCamera(name, &status)) << name;
        EXPECT_EQ(status.GetCode(), FbxStatus::eSuccess) << name;
        EXPECT_STREQ(settings().GetDefaultCamera(), name);
        EXPECT_STREQ(scene->GetGlobalSettings().GetDefaultCamera().Buffer(), name);
    }
}

TEST_F(FbxGlobalCameraSettingsTest, TakeACameraBelowTheRootForTheDefaultCamera) {
    FbxNode* group = make<FbxNode>("group");
    scene->GetRootNode()->AddChild(group);
    cameraNode("Shot", group);

    EXPECT_TRUE(settings().SetDefaultCamera("Shot"));
    EXPECT_STREQ(settings().GetDefaultCamera(), "Shot");
}

TEST_F(FbxGlobalCameraSettingsTest, TakeACameraThatSharesItsNameWithOtherNodes) {
    scene->GetRootNode()->AddChild(make<FbxNode>("Shot"));
    cameraNode("Shot", scene->GetRootNode());

    EXPECT_TRUE(settings().SetDefaultCamera("Shot"));
}

TEST_F(FbxGlobalCameraSettingsTest, RefuseWhatIsNoCameraBelowTheRoot) {
    scene->GetRootNode()->AddChild(make<FbxNode>("Group"));
    cameraNode("Loose", nullptr);
    ASSERT_TRUE(settings().SetDefaultCamera("Producer Top"));

    for (const char* name : {"Group", "Loose", "producer top", "", static_cast<const char*>(nullptr)}) {
        FbxStatus status;
        EXPECT_FALSE(settings().SetDefaultCamera(name, &status));
        EXPECT_EQ(status.GetCode(), FbxStatus::eInvalidParameter);
        EXPECT_STRNE(status.GetErrorString(), "");
        EXPECT_FALSE(settings().SetDefaultCamera(name, nullptr));
    }
    EXPECT_STREQ(settings().GetDefaultCamera(), "Producer Top");
}

TEST_F(FbxGlobalCameraSettingsTest, SayWhatTheGlobalSettingsOfAFileSay) {
    scene->GetGlobalSettings().SetDefaultCamera("Kamera Süd");

    EXPECT_STREQ(settings().GetDefaultCamera(), "Kamera Süd");
}

TEST_F(FbxGlobalCameraSettingsTest, RestoreTheCamerasAndTheDefault) {
    settings().CreateProducerCameras();
    settings().GetCameraProducerTop()->Position.Set(FbxDouble3(1, 2, 3));
    settings().SetDefaultCamera("Camera Switcher");

    settings().RestoreDefaultSettings();

    ASSERT_NE(settings().GetCameraProducerTop(), nullptr);
    EXPECT_EQ(settings().GetCameraProducerTop()->Position.Get(), FbxDouble3(0, 4000, 0));
    EXPECT_STREQ(settings().GetDefaultCamera(), "Producer Perspective");
}

} // namespace
