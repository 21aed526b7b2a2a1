// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The settings of a whole scene. Order and types are those of files; the defaults are those of a new scene.
#include "schema/Schema.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

constinit const PropertyRow kGlobalSettingsTable[] = {
    {"UpAxis", &FbxIntDT, "", {1}},
    {"UpAxisSign", &FbxIntDT, "", {1}},
    {"FrontAxis", &FbxIntDT, "", {2}},
    {"FrontAxisSign", &FbxIntDT, "", {1}},
    {"CoordAxis", &FbxIntDT, ""},
    {"CoordAxisSign", &FbxIntDT, "", {1}},
    {"OriginalUpAxis", &FbxIntDT, "", {-1}},
    {"OriginalUpAxisSign", &FbxIntDT, "", {1}},
    {"UnitScaleFactor", &FbxDoubleDT, "", {1}},
    {"OriginalUnitScaleFactor", &FbxDoubleDT, "", {1}},
    {"AmbientColor", &FbxColor3DT, ""},
    {"DefaultCamera", &FbxStringDT, ""},
    {"TimeMode", &FbxEnumDT, ""},
    {"TimeProtocol", &FbxEnumDT, "", {2}},
    {"SnapOnFrameMode", &FbxEnumDT, ""},
    {"TimeSpanStart", &FbxTimeDT, ""},
    {"TimeSpanStop", &FbxTimeDT, "", {46186158000}},
    {"CustomFrameRate", &FbxDoubleDT, "", {-1}},
    {"TimeMarker", &FbxCompoundDT, ""},
    {"CurrentTimeMarker", &FbxIntDT, "", {-1}},
};

} // namespace detail
FBXSDK_NAMESPACE_END
