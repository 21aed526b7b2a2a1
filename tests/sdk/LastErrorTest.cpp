// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The reason of the last failure: set and cleared.
#include "TnFbxError.h"

#include "FbxSdk.h"

#include <gtest/gtest.h>

#include <string>

namespace Tarnell::Fbx {
namespace {

TEST(LastError, IsSetByAFailureAndClearedByASuccess) {
    FbxSdk sdk;
    EXPECT_FALSE(sdk.destroyFbxSdkManager());
    EXPECT_FALSE(lastError().empty());

    EXPECT_TRUE(sdk.initFbxSdkManager());
    EXPECT_EQ(lastError(), "");
}

TEST(LastError, SurvivesTheEndOfTheContext) {
    {
        FbxSdk sdk;
        EXPECT_TRUE(sdk.initFbxSdkManager());
        EXPECT_FALSE(sdk.loadScene("no such file", true));
        EXPECT_TRUE(sdk.destroyFbxSdkManager());
    }
    EXPECT_NE(lastError().find("no such file"), std::string::npos);
}

} // namespace
} // namespace Tarnell::Fbx
