// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Settings of a whole scene: the defaults of new ones, and the accessors' results for any number in a file.
#include <climits>
#include <cmath>

#include <fbxsdk/FbxGlobalSettings.h>

#include "SceneFixture.h"

namespace {

using namespace fbxsdk;

class FbxGlobalSettingsTest : public SceneFixture {
protected:
    // Setting a time mode sets the global one.
    ~FbxGlobalSettingsTest() override { FbxTime::SetGlobalTimeMode(FbxTime::eDefaultMode); }

    FbxGlobalSettings& settings() { return scene->GetGlobalSettings(); }
    FbxProperty property(const char* name) { return settings().FindProperty(name); }
};

TEST_F(FbxGlobalSettingsTest, StartWithTheDefaultsOfFiles) {
    const struct {
        const char* name;
        EFbxType type;
        double value;
    } kDefaults[] = {{"UpAxis", eFbxInt, 1},
                     {"UpAxisSign", eFbxInt, 1},
                     {"FrontAxis", eFbxInt, 2},
                     {"FrontAxisSign", eFbxInt, 1},
                     {"CoordAxis", eFbxInt, 0},
                     {"CoordAxisSign", eFbxInt, 1},
                     {"OriginalUpAxis", eFbxInt, -1},
                     {"OriginalUpAxisSign", eFbxInt, 1},
                     {"UnitScaleFactor", eFbxDouble, 1},
                     {"OriginalUnitScaleFactor", eFbxDouble, 1},
                     {"TimeMode", eFbxEnum, 0},
                     {"TimeProtocol", eFbxEnum, 2},
                     {"SnapOnFrameMode", eFbxEnum, 0},
                     {"CustomFrameRate", eFbxDouble, -1}};
    for (const auto& row : kDefaults) {
        EXPECT_EQ(property(row.name).GetPropertyDataType().GetType(), row.type) << row.name;
        EXPECT_EQ(property(row.name).Get<FbxDouble>(), row.value) << row.name;
    }
    EXPECT_EQ(property("AmbientColor").Get<FbxDouble3>(), FbxDouble3(0, 0, 0));
    EXPECT_STREQ(property("DefaultCamera").Get<FbxString>().Buffer(), "");
    EXPECT_EQ(property("TimeSpanStart").Get<FbxTime>(), FbxTime(0));
    EXPECT_EQ(property("TimeSpanStop").Get<FbxTime>(), FbxTime(46186158000));
}

TEST_F(FbxGlobalSettingsTest, AnswerWithThem) {
    FbxTimeSpan span;
    settings().GetTimelineDefaultTimeSpan(span);

    EXPECT_EQ(settings().GetAxisSystem(), FbxAxisSystem::MayaYUp);
    EXPECT_EQ(settings().GetOriginalUpAxis(), -1);
    EXPECT_EQ(settings().GetSystemUnit(), FbxSystemUnit::cm);
    EXPECT_EQ(settings().GetOriginalSystemUnit(), FbxSystemUnit::cm);
    EXPECT_EQ(settings().GetTimeMode(), FbxTime::eDefaultMode);
    EXPECT_EQ(settings().GetTimeProtocol(), FbxTime::eDefaultProtocol);
    EXPECT_EQ(settings().GetCustomFrameRate(), -1.0);
    EXPECT_EQ(span.GetStart(), FbxTime(0));
    EXPECT_EQ(span.GetStop(), FbxTime(46186158000));
}

TEST_F(FbxGlobalSettingsTest, KeepTheAxisSystemAsSixIntegers) {
    settings().SetAxisSystem(FbxAxisSystem::MayaZUp);

    EXPECT_EQ(settings().GetAxisSystem(), FbxAxisSystem::MayaZUp);
    EXPECT_EQ(property("UpAxis").Get<FbxInt>(), 2);
    EXPECT_EQ(property("UpAxisSign").Get<FbxInt>(), 1);
    EXPECT_EQ(property("FrontAxis").Get<FbxInt>(), 1);
    EXPECT_EQ(property("FrontAxisSign").Get<FbxInt>(), -1);
    EXPECT_EQ(property("CoordAxis").Get<FbxInt>(), 0);
    EXPECT_EQ(property("CoordAxisSign").Get<FbxInt>(), 1);

    settings().SetOriginalUpAxis(FbxAxisSystem::MayaZUp);
    EXPECT_EQ(settings().GetOriginalUpAxis(), 2);
    EXPECT_EQ(property("OriginalUpAxisSign").Get<FbxInt>(), 1);
}

TEST_F(FbxGlobalSettingsTest, TakeAxesThatAreNoneForTheDefault) {
    property("UpAxis").Set(INT_MAX);
    EXPECT_EQ(settings().GetAxisSystem(), FbxAxisSystem::MayaYUp);
    property("UpAxis").Set(0); // the coordinate axis already
    EXPECT_EQ(settings().GetAxisSystem(), FbxAxisSystem::MayaYUp);
}

TEST_F(FbxGlobalSettingsTest, KeepUnitsAsCentimetres) {
    settings().SetSystemUnit(FbxSystemUnit::Inch);
    settings().SetOriginalSystemUnit(FbxSystemUnit::m);

    EXPECT_EQ(property("UnitScaleFactor").Get<FbxDouble>(), 2.54);
    EXPECT_EQ(settings().GetSystemUnit().GetScaleFactor(), 2.54);
    EXPECT_EQ(settings().GetOriginalSystemUnit(), FbxSystemUnit::m);
}

TEST_F(FbxGlobalSettingsTest, TakeAnInvalidUnitForCentimetres) {
    for (const double wrong : {0.0, -2.54, 1e300, static_cast<double>(INFINITY), static_cast<double>(NAN)}) {
        property("UnitScaleFactor").Set(wrong);
        EXPECT_EQ(settings().GetSystemUnit(), FbxSystemUnit::cm) << wrong;
    }
}

TEST_F(FbxGlobalSettingsTest, KeepTheTimeModeAndMakeItTheGlobalOne) {
    settings().SetTimeMode(FbxTime::ePAL);
    EXPECT_EQ(settings().GetTimeMode(), FbxTime::ePAL);
    EXPECT_EQ(FbxTime::GetGlobalTimeMode(), FbxTime::ePAL);
    EXPECT_EQ(property("CustomFrameRate").Get<FbxDouble>(), -1.0);

    settings().SetTimeMode(FbxTime::eCustom);
    settings().SetCustomFrameRate(12.5);
    EXPECT_EQ(settings().GetCustomFrameRate(), 12.5);
    EXPECT_EQ(FbxTime::GetFrameRate(FbxTime::eCustom), 12.5);
}

TEST_F(FbxGlobalSettingsTest, TakeModesThatAreNoneForTheDefault) {
    for (const FbxInt wrong : {-1, static_cast<FbxInt>(FbxTime::eModesCount), INT_MAX, INT_MIN}) {
        property("TimeMode").Set(wrong);
        property("TimeProtocol").Set(wrong);
        EXPECT_EQ(settings().GetTimeMode(), FbxTime::eDefaultMode) << wrong;
        EXPECT_EQ(settings().GetTimeProtocol(), FbxTime::eDefaultProtocol) << wrong;
    }
}

TEST_F(FbxGlobalSettingsTest, KeepColourCameraProtocolAndTimeline) {
    settings().SetAmbientColor(FbxColor(0.1, 0.2, 0.3, 0.4));
    settings().SetTimeProtocol(FbxTime::eFrameCount);
    settings().SetTimelineDefaultTimeSpan(FbxTimeSpan(FbxTime(-5), FbxTime(17)));
    FbxTimeSpan span;
    settings().GetTimelineDefaultTimeSpan(span);

    EXPECT_EQ(settings().GetAmbientColor().mGreen, 0.2);
    EXPECT_EQ(settings().GetAmbientColor().mAlpha, 1.0); // not stored
    EXPECT_EQ(settings().GetTimeProtocol(), FbxTime::eFrameCount);
    EXPECT_EQ(span.GetStart(), FbxTime(-5));
    EXPECT_EQ(span.GetStop(), FbxTime(17));
    EXPECT_TRUE(settings().SetDefaultCamera("any"));
    EXPECT_FALSE(settings().SetDefaultCamera(nullptr));
    EXPECT_STREQ(settings().GetDefaultCamera().Buffer(), "any");
}

} // namespace
