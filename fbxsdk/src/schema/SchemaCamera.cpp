// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Properties of cameras, stereo rigs and the switcher. Order, types and defaults are those of files.
#include <algorithm>

#include "schema/Schema.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

constexpr PropertyRow kCameraTable[] = {
    {"Color", &FbxColor3DT, "", {0.8, 0.8, 0.8}},
    {"Position", &FbxVectorDT, "A"},
    {"UpVector", &FbxVectorDT, "A", {0, 1, 0}},
    {"InterestPosition", &FbxVectorDT, "A"},
    {"Roll", &FbxRollDT, "A"},
    {"OpticalCenterX", &FbxOpticalCenterXDT, "A"},
    {"OpticalCenterY", &FbxOpticalCenterYDT, "A"},
    {"BackgroundColor", &FbxAnimatedColorDT, "A", {0.63, 0.63, 0.63}},
    {"TurnTable", &FbxNumberDT, "A"},
    {"DisplayTurnTableIcon", &FbxBoolDT, ""},
    {"UseMotionBlur", &FbxBoolDT, ""},
    {"UseRealTimeMotionBlur", &FbxBoolDT, "", {1}},
    {"Motion Blur Intensity", &FbxNumberDT, "A", {1}},
    {"AspectRatioMode", &FbxEnumDT, ""},
    {"AspectWidth", &FbxDoubleDT, "", {320}},
    {"AspectHeight", &FbxDoubleDT, "", {200}},
    {"PixelAspectRatio", &FbxDoubleDT, "", {1}},
    {"FilmOffsetX", &FbxNumberDT, "A"},
    {"FilmOffsetY", &FbxNumberDT, "A"},
    {"FilmWidth", &FbxDoubleDT, "", {0.816}},
    {"FilmHeight", &FbxDoubleDT, "", {0.612}},
    {"FilmAspectRatio", &FbxDoubleDT, "", {1.3333333333333333}},
    {"FilmSqueezeRatio", &FbxDoubleDT, "", {1}},
    {"FilmFormatIndex", &FbxEnumDT, ""},
    {"PreScale", &FbxNumberDT, "A", {1}},
    {"FilmTranslateX", &FbxNumberDT, "A"},
    {"FilmTranslateY", &FbxNumberDT, "A"},
    {"FilmRollPivotX", &FbxNumberDT, "A"},
    {"FilmRollPivotY", &FbxNumberDT, "A"},
    {"FilmRollValue", &FbxNumberDT, "A"},
    {"FilmRollOrder", &FbxEnumDT, ""},
    {"ApertureMode", &FbxEnumDT, "", {2}},
    {"GateFit", &FbxEnumDT, ""},
    {"FieldOfView", &FbxFieldOfViewDT, "A", {25.114999771118164}},
    {"FieldOfViewX", &FbxFieldOfViewXDT, "A", {40}},
    {"FieldOfViewY", &FbxFieldOfViewYDT, "A", {40}},
    {"FocalLength", &FbxNumberDT, "A", {34.89327621672628}},
    {"CameraFormat", &FbxEnumDT, ""},
    {"UseFrameColor", &FbxBoolDT, ""},
    {"FrameColor", &FbxColor3DT, "", {0.3, 0.3, 0.3}},
    {"ShowName", &FbxBoolDT, "", {1}},
    {"ShowInfoOnMoving", &FbxBoolDT, "", {1}},
    {"ShowGrid", &FbxBoolDT, "", {1}},
    {"ShowOpticalCenter", &FbxBoolDT, ""},
    {"ShowAzimut", &FbxBoolDT, "", {1}},
    {"ShowTimeCode", &FbxBoolDT, ""},
    {"ShowAudio", &FbxBoolDT, ""},
    {"AudioColor", &FbxDouble3DT, "", {0, 1, 0}},
    {"NearPlane", &FbxDoubleDT, "", {10}},
    {"FarPlane", &FbxDoubleDT, "", {4000}},
    {"AutoComputeClipPanes", &FbxBoolDT, ""},
    {"ViewCameraToLookAt", &FbxBoolDT, "", {1}},
    {"ViewFrustumNearFarPlane", &FbxBoolDT, ""},
    {"ViewFrustumBackPlaneMode", &FbxEnumDT, "", {2}},
    {"BackPlaneDistance", &FbxNumberDT, "A", {4000}},
    {"BackPlaneDistanceMode", &FbxEnumDT, "", {1}},
    {"ViewFrustumFrontPlaneMode", &FbxEnumDT, "", {2}},
    {"FrontPlaneDistance", &FbxNumberDT, "A", {10}},
    {"FrontPlaneDistanceMode", &FbxEnumDT, "", {1}},
    {"LockMode", &FbxBoolDT, ""},
    {"LockInterestNavigation", &FbxBoolDT, ""},
    {"BackPlateFitImage", &FbxBoolDT, ""},
    {"BackPlateCrop", &FbxBoolDT, ""},
    {"BackPlateCenter", &FbxBoolDT, "", {1}},
    {"BackPlateKeepRatio", &FbxBoolDT, "", {1}},
    {"BackgroundAlphaTreshold", &FbxDoubleDT, "", {0.5}},
    {"ShowBackplate", &FbxBoolDT, "", {1}},
    {"BackPlaneOffsetX", &FbxNumberDT, "A"},
    {"BackPlaneOffsetY", &FbxNumberDT, "A"},
    {"BackPlaneRotation", &FbxNumberDT, "A"},
    {"BackPlaneScaleX", &FbxNumberDT, "A", {1}},
    {"BackPlaneScaleY", &FbxNumberDT, "A", {1}},
    {"Background Texture", &FbxReferenceDT, ""},
    {"FrontPlateFitImage", &FbxBoolDT, "", {1}},
    {"FrontPlateCrop", &FbxBoolDT, ""},
    {"FrontPlateCenter", &FbxBoolDT, "", {1}},
    {"FrontPlateKeepRatio", &FbxBoolDT, "", {1}},
    {"Foreground Opacity", &FbxDoubleDT, "", {1}},
    {"ShowFrontplate", &FbxBoolDT, "", {1}},
    {"FrontPlaneOffsetX", &FbxNumberDT, "A"},
    {"FrontPlaneOffsetY", &FbxNumberDT, "A"},
    {"FrontPlaneRotation", &FbxNumberDT, "A"},
    {"FrontPlaneScaleX", &FbxNumberDT, "A", {1}},
    {"FrontPlaneScaleY", &FbxNumberDT, "A", {1}},
    {"Foreground Texture", &FbxReferenceDT, ""},
    {"DisplaySafeArea", &FbxBoolDT, ""},
    {"DisplaySafeAreaOnRender", &FbxBoolDT, ""},
    {"SafeAreaDisplayStyle", &FbxEnumDT, "", {1}},
    {"SafeAreaAspectRatio", &FbxDoubleDT, "", {1.33333333333333}},
    {"Use2DMagnifierZoom", &FbxBoolDT, ""},
    {"2D Magnifier Zoom", &FbxNumberDT, "A", {100}},
    {"2D Magnifier X", &FbxNumberDT, "A", {50}},
    {"2D Magnifier Y", &FbxNumberDT, "A", {50}},
    {"CameraProjectionType", &FbxEnumDT, ""},
    {"OrthoZoom", &FbxDoubleDT, "", {1}},
    {"UseRealTimeDOFAndAA", &FbxBoolDT, ""},
    {"UseDepthOfField", &FbxBoolDT, ""},
    {"FocusSource", &FbxEnumDT, ""},
    {"FocusAngle", &FbxDoubleDT, "", {3.5}},
    {"FocusDistance", &FbxDoubleDT, "", {200}},
    {"UseAntialiasing", &FbxBoolDT, ""},
    {"AntialiasingIntensity", &FbxDoubleDT, "", {0.77777}},
    {"AntialiasingMethod", &FbxEnumDT, ""},
    {"UseAccumulationBuffer", &FbxBoolDT, ""},
    {"FrameSamplingCount", &FbxIntDT, "", {7}},
    {"FrameSamplingType", &FbxEnumDT, "", {1}},
};

constinit const PropertyRow kCameraSwitcherTable[] = {
    {"Color", &FbxColor3DT, "", {0.8, 0.8, 0.8}},
    {"Camera Index", &kAnimatableIntType, "A"},
};

namespace {

constexpr PropertyRow kStereoOnly[kStereoOnlyRowCount] = {
    {"Stereo", &FbxEnumDT, ""},
    {"InteraxialSeparation", &FbxNumberDT, "A"},
    {"ZeroParallax", &FbxNumberDT, "A"},
    {"ToeInAdjust", &FbxNumberDT, "A"},
    {"FilmOffsetRightCam", &FbxNumberDT, "A"},
    {"FilmOffsetLeftCam", &FbxNumberDT, "A"},
    {"RightCamera", &FbxReferenceDT, ""},
    {"LeftCamera", &FbxReferenceDT, ""},
    {"PrecompFileName", &FbxStringDT, ""},
    {"RelativePrecompFileName", &FbxStringDT, ""},
};

/// A stereo rig has the properties of a camera and more.
constexpr auto stereoTable() {
    std::array<PropertyRow, std::size(kCameraTable) + kStereoOnlyRowCount> table{};
    std::copy(std::begin(kStereoOnly), std::end(kStereoOnly),
              std::copy(std::begin(kCameraTable), std::end(kCameraTable), table.begin()));
    return table;
}

} // namespace

constinit const std::array<PropertyRow, std::size(kCameraTable) + kStereoOnlyRowCount> kCameraStereoTable =
    stereoTable();

} // namespace detail
FBXSDK_NAMESPACE_END
