// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Properties of stacks, layers and curve nodes. Order, types and defaults are those of files.
#include "schema/Schema.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

constinit const PropertyRow kAnimStackTable[] = {
    {"Description", &FbxStringDT, ""},  {"LocalStart", &FbxTimeDT, ""},    {"LocalStop", &FbxTimeDT, ""},
    {"ReferenceStart", &FbxTimeDT, ""}, {"ReferenceStop", &FbxTimeDT, ""},
};

constinit const PropertyRow kAnimLayerTable[] = {
    {"Weight", &FbxNumberDT, "A", {100}},
    {"Mute", &FbxBoolDT, ""},
    {"Solo", &FbxBoolDT, ""},
    {"Lock", &FbxBoolDT, ""},
    {"Color", &FbxColor3DT, "", {0.8, 0.8, 0.8}},
    {"BlendMode", &FbxEnumDT, ""},
    {"RotationAccumulationMode", &FbxEnumDT, ""},
    {"ScaleAccumulationMode", &FbxEnumDT, ""},
    {"BlendModeBypass", &FbxULongLongDT, ""},
};

constinit const PropertyRow kAnimCurveNodeTable[] = {
    {"d", &FbxCompoundDT, ""},
};

} // namespace detail
FBXSDK_NAMESPACE_END
