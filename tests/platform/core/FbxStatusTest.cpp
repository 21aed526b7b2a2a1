// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Outcomes.
#include <string>

#include <gtest/gtest.h>

#include <fbxsdk/FbxStatus.h>

namespace {

using namespace fbxsdk;

TEST(FbxStatus, IsSuccessAtFirst) {
    const FbxStatus status;
    EXPECT_FALSE(status.Error());
    EXPECT_TRUE(static_cast<bool>(status));
    EXPECT_EQ(status.GetCode(), FbxStatus::eSuccess);
    EXPECT_STREQ(status.GetErrorString(), "");
}

TEST(FbxStatus, HasASentenceForEveryCode) {
    for (int code = FbxStatus::eFailure; code <= FbxStatus::eSceneCheckFail; ++code) {
        FbxStatus status;
        status.SetCode(static_cast<FbxStatus::EStatusCode>(code));
        EXPECT_TRUE(status.Error()) << code;
        EXPECT_FALSE(static_cast<bool>(status)) << code;
        EXPECT_STRNE(status.GetErrorString(), "") << code;
    }
}

TEST(FbxStatus, FormatsItsSentence) {
    FbxStatus status;
    status.SetCode(FbxStatus::eInvalidFile, "%s: offset %d", "scene.fbx", 4711);
    EXPECT_EQ(status.GetCode(), FbxStatus::eInvalidFile);
    EXPECT_STREQ(status.GetErrorString(), "scene.fbx: offset 4711");
    status.SetCode(FbxStatus::eFailure, "in short: %s", status.GetErrorString());
    EXPECT_STREQ(status.GetErrorString(), "in short: scene.fbx: offset 4711");
    status.SetCode(FbxStatus::eFailure, "%s", "");
    EXPECT_STREQ(status.GetErrorString(), "");
    EXPECT_TRUE(status.Error());
}

TEST(FbxStatus, FormatsLongSentences) {
    const std::string name(10000, 'n');
    FbxStatus status;
    status.SetCode(FbxStatus::eFailure, "%s!", name.c_str());
    EXPECT_EQ(status.GetErrorString(), name + "!");
}

TEST(FbxStatus, ForgetsWhenCleared) {
    FbxStatus status(FbxStatus::eFailure);
    status.Clear();
    EXPECT_FALSE(status.Error());
    EXPECT_STREQ(status.GetErrorString(), "");
}

TEST(FbxStatus, ComparesCodes) {
    EXPECT_EQ(FbxStatus(FbxStatus::eFailure), FbxStatus(FbxStatus::eFailure));
    EXPECT_NE(FbxStatus(FbxStatus::eFailure), FbxStatus());
}

TEST(FbxStatus, HasASentenceForACodeThatDoesNotExist) {
    EXPECT_STRNE(FbxStatus(static_cast<FbxStatus::EStatusCode>(15)).GetErrorString(), "");
}

} // namespace
