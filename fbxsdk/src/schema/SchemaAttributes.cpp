// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Properties of lights and of attributes for display. Order, types and defaults are those of files.
#include "schema/Schema.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

constinit const PropertyRow kNodeAttributeTable[] = {
    {"Color", &FbxColor3DT, "", {0.8, 0.8, 0.8}},
};

constinit const PropertyRow kLightTable[] = {
    {"Color", &FbxAnimatedColorDT, "A", {1, 1, 1}},
    {"LightType", &FbxEnumDT, ""},
    {"CastLightOnObject", &FbxBoolDT, "", {1}},
    {"DrawVolumetricLight", &FbxBoolDT, "", {1}},
    {"DrawGroundProjection", &FbxBoolDT, "", {1}},
    {"DrawFrontFacingVolumetricLight", &FbxBoolDT, ""},
    {"Intensity", &FbxNumberDT, "A", {100}},
    {"InnerAngle", &FbxNumberDT, "A"},
    {"OuterAngle", &FbxNumberDT, "A", {45}},
    {"Fog", &FbxNumberDT, "A", {50}},
    {"DecayType", &FbxEnumDT, ""},
    {"DecayStart", &FbxNumberDT, "A"},
    {"FileName", &FbxStringDT, ""},
    {"EnableNearAttenuation", &FbxBoolDT, ""},
    {"NearAttenuationStart", &FbxNumberDT, "A"},
    {"NearAttenuationEnd", &FbxNumberDT, "A"},
    {"EnableFarAttenuation", &FbxBoolDT, ""},
    {"FarAttenuationStart", &FbxNumberDT, "A"},
    {"FarAttenuationEnd", &FbxNumberDT, "A"},
    {"CastShadows", &FbxBoolDT, ""},
    {"ShadowColor", &FbxAnimatedColorDT, "A"},
    {"AreaLightShape", &FbxEnumDT, ""},
    {"LeftBarnDoor", &FbxFloatDT, "A", {20}},
    {"RightBarnDoor", &FbxFloatDT, "A", {20}},
    {"TopBarnDoor", &FbxFloatDT, "A", {20}},
    {"BottomBarnDoor", &FbxFloatDT, "A", {20}},
    {"EnableBarnDoor", &kAnimatableBoolType, "A"},
};

constinit const PropertyRow kMarkerTable[] = {
    {"Color", &FbxColor3DT, "", {0.8, 0.8, 0.8}},
    {"Look", &FbxEnumDT, ""},
    {"DrawLink", &FbxBoolDT, "", {1}},
    {"Size", &FbxDoubleDT, "", {100}},
    {"ShowLabel", &FbxBoolDT, ""},
    {"IKPivot", &FbxDouble3DT, ""},
};

constinit const PropertyRow kNullTable[] = {
    {"Color", &FbxColor3DT, "", {0.8, 0.8, 0.8}},
    {"Size", &FbxDoubleDT, "", {100}},
    {"Look", &FbxEnumDT, "", {1}},
};

constinit const PropertyRow kSkeletonTable[] = {
    {"Color", &FbxColor3DT, "", {0.8, 0.8, 0.8}},
    {"Size", &FbxDoubleDT, "", {100}},
    {"LimbLength", &FbxDoubleDT, "H", {1}},
};

constinit const PropertyRow kLodGroupTable[] = {
    {"Color", &FbxColor3DT, "", {0.8, 0.8, 0.8}}, {"ThresholdsUsedAsPercentage", &FbxBoolDT, ""},
    {"MinMaxDistance", &FbxBoolDT, ""},           {"MinDistance", &FbxDoubleDT, "", {-100}},
    {"MaxDistance", &FbxDoubleDT, "", {100}},     {"WorldSpace", &FbxBoolDT, ""},
    {"Thresholds", &FbxCompoundDT, ""},           {"DisplayLevels", &FbxCompoundDT, ""},
};

} // namespace detail
FBXSDK_NAMESPACE_END
