// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Properties of geometry, deformers and caches. Order, types and defaults are those of files.
#include "schema/Schema.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

constinit const PropertyRow kMeshTable[] = {
    {"Color", &FbxColor3DT, "", {0.8, 0.8, 0.8}},
    {"BBoxMin", &FbxDouble3DT, ""},
    {"BBoxMax", &FbxDouble3DT, ""},
    {"Primary Visibility", &FbxBoolDT, "", {1}},
    {"Casts Shadows", &FbxBoolDT, "", {1}},
    {"Receive Shadows", &FbxBoolDT, "", {1}},
};

constinit const PropertyRow kLineTable[] = {
    {"Color", &FbxColor3DT, "", {0.8, 0.8, 0.8}},
    {"BBoxMin", &FbxDouble3DT, ""},
    {"BBoxMax", &FbxDouble3DT, ""},
    {"Primary Visibility", &FbxBoolDT, "", {1}},
    {"Casts Shadows", &FbxBoolDT, "", {1}},
    {"Receive Shadows", &FbxBoolDT, "", {1}},
    {"Renderable", &FbxBoolDT, ""},
};

constinit const PropertyRow kVertexCacheDeformerTable[] = {
    {"ChannelName", &FbxStringDT, ""},
    {"Active", &FbxBoolDT, "", {1}},
    {"CacheSet", &FbxStringDT, "", {}, "FbxCacheExport"},
    {"ChannelType", &FbxEnumDT, ""},
};

constinit const PropertyRow kBlendShapeChannelTable[] = {
    {"DeformPercent", &FbxNumberDT, "A"},
};

constinit const PropertyRow kCacheTable[] = {
    {"CacheFileName", &FbxStringDT, ""},
    {"CacheAbsoluteFileName", &FbxStringDT, ""},
    {"CacheFileType", &FbxEnumDT, ""},
};

} // namespace detail
FBXSDK_NAMESPACE_END
