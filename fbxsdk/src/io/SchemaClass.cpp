// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include "io/SchemaClass.h"

#include "schema/Schema.h"
#include "schema/Spellings.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

extern const ClassInfo kFbxNodeInfo, kFbxNodeAttributeInfo, kFbxNullInfo, kFbxSkeletonInfo, kFbxCameraInfo,
    kFbxCameraStereoInfo, kFbxCameraSwitcherInfo, kFbxLightInfo, kFbxMarkerInfo, kFbxLODGroupInfo,
    kFbxOpticalReferenceInfo, kFbxCachedEffectInfo, kFbxMeshInfo, kFbxShapeInfo, kFbxNurbsSurfaceInfo,
    kFbxNurbsCurveInfo, kFbxTrimNurbsSurfaceInfo, kFbxBoundaryInfo, kFbxNurbsInfo, kFbxPatchInfo, kFbxLineInfo,
    kFbxSkinInfo, kFbxClusterInfo, kFbxBlendShapeInfo, kFbxBlendShapeChannelInfo, kFbxVertexCacheDeformerInfo,
    kFbxCacheInfo, kFbxSurfaceMaterialInfo, kFbxSurfaceLambertInfo, kFbxSurfacePhongInfo, kFbxFileTextureInfo,
    kFbxLayeredTextureInfo, kFbxVideoInfo, kFbxAnimStackInfo, kFbxAnimLayerInfo, kFbxAnimCurveNodeInfo,
    kFbxAnimCurveInfo;

namespace {

constexpr std::string_view kAny = kAnySubClass;
constexpr std::span<const PropertyRow> kNoRows;

constinit const SchemaClass kClasses[] = {
    {"Model", kAny, "Model", &kFbxNodeInfo, kNodeRows},

    {"NodeAttribute", "Null", "NodeAttribute", &kFbxNullInfo, kNullRows},
    {"NodeAttribute", kSkeletonTypes[2], "NodeAttribute", &kFbxSkeletonInfo, kSkeletonRows},
    {"NodeAttribute", kSkeletonTypes[1], "NodeAttribute", &kFbxSkeletonInfo, kSkeletonRows},
    {"NodeAttribute", kSkeletonTypes[0], "NodeAttribute", &kFbxSkeletonInfo, kSkeletonRows},
    {"NodeAttribute", kSkeletonTypes[3], "NodeAttribute", &kFbxSkeletonInfo, kSkeletonRows},
    {"NodeAttribute", "Camera", "NodeAttribute", &kFbxCameraInfo, kCameraRows},
    {"NodeAttribute", "CameraStereo", "NodeAttribute", &kFbxCameraStereoInfo, kCameraStereoRows},
    {"NodeAttribute", "CameraSwitcher", "NodeAttribute", &kFbxCameraSwitcherInfo, kCameraSwitcherRows},
    {"NodeAttribute", "Light", "NodeAttribute", &kFbxLightInfo, kLightRows},
    {"NodeAttribute", kMarkerTypes[0], "NodeAttribute", &kFbxMarkerInfo, kMarkerRows},
    {"NodeAttribute", kMarkerTypes[1], "NodeAttribute", &kFbxMarkerInfo, kMarkerRows},
    {"NodeAttribute", kMarkerTypes[2], "NodeAttribute", &kFbxMarkerInfo, kMarkerRows},
    {"NodeAttribute", kMarkerTypes[3], "NodeAttribute", &kFbxMarkerInfo, kMarkerRows},
    {"NodeAttribute", "LodGroup", "NodeAttribute", &kFbxLODGroupInfo, kLodGroupRows},
    {"NodeAttribute", "OpticalReference", "NodeAttribute", &kFbxOpticalReferenceInfo, kNodeAttributeRows},
    {"NodeAttribute", "CachedEffect", "NodeAttribute", &kFbxCachedEffectInfo, kNodeAttributeRows},
    {"NodeAttribute", kAny, "NodeAttribute", &kFbxNodeAttributeInfo, kNodeAttributeRows},

    {"Geometry", "Mesh", "Geometry", &kFbxMeshInfo, kMeshRows},
    {"Geometry", "Shape", "Geometry", &kFbxShapeInfo, kMeshRows},
    {"Geometry", "NurbsSurface", "Geometry", &kFbxNurbsSurfaceInfo, kMeshRows},
    {"Geometry", "NurbsCurve", "Geometry", &kFbxNurbsCurveInfo, kMeshRows},
    {"Geometry", "TrimNurbsSurface", "Geometry", &kFbxTrimNurbsSurfaceInfo, kMeshRows},
    {"Geometry", "Boundary", "Geometry", &kFbxBoundaryInfo, kMeshRows},
    {"Geometry", "Nurb", "Geometry", &kFbxNurbsInfo, kMeshRows},
    {"Geometry", "Patch", "Geometry", &kFbxPatchInfo, kMeshRows},
    {"Geometry", "Line", "Geometry", &kFbxLineInfo, kLineRows},

    {"Deformer", "Skin", "Deformer", &kFbxSkinInfo, kNoRows},
    {"Deformer", "Cluster", "SubDeformer", &kFbxClusterInfo, kNoRows},
    {"Deformer", "BlendShape", "Deformer", &kFbxBlendShapeInfo, kNoRows},
    {"Deformer", "BlendShapeChannel", "SubDeformer", &kFbxBlendShapeChannelInfo, kNoRows},
    {"Deformer", "VertexCacheDeformer", "Deformer", &kFbxVertexCacheDeformerInfo, kVertexCacheDeformerRows},
    {"Cache", kAny, "Cache", &kFbxCacheInfo, kCacheRows},

    {"Material", kAny, "Material", &kFbxSurfaceMaterialInfo, kMaterialRows},
    {"Material", kAny, "Material", &kFbxSurfaceLambertInfo, kLambertRows},
    {"Material", kAny, "Material", &kFbxSurfacePhongInfo, kPhongRows},
    {"Texture", kAny, "Texture", &kFbxFileTextureInfo, kFileTextureRows},
    {"LayeredTexture", kAny, "LayeredTexture", &kFbxLayeredTextureInfo, kLayeredTextureRows},
    {"Video", "Clip", "Video", &kFbxVideoInfo, kVideoRows},
    {"Video", kAny, "Video", &kFbxVideoInfo, kVideoRows},

    {"AnimationStack", kAny, "AnimStack", &kFbxAnimStackInfo, kAnimStackRows},
    {"AnimationLayer", kAny, "AnimLayer", &kFbxAnimLayerInfo, kAnimLayerRows},
    {"AnimationCurveNode", kAny, "AnimCurveNode", &kFbxAnimCurveNodeInfo, kAnimCurveNodeRows},
    {"AnimationCurve", kAny, "AnimCurve", &kFbxAnimCurveInfo, kNoRows},
};

} // namespace

std::span<const SchemaClass> schemaClasses() { return kClasses; }

const SchemaClass* findSchema(std::string_view record, std::string_view subClass) {
    // A row for any sub-class follows those of its record that name one.
    for (const SchemaClass& row : kClasses)
        if (row.record == record && (row.subClass == subClass || row.subClass == kAny))
            return &row;
    return nullptr;
}

const SchemaClass* findSchema(const FbxClassId& id) {
    for (FbxClassId each = id; each.IsValid(); each = each.GetParent()) {
        for (const SchemaClass& row : kClasses)
            if (row.classId() == each)
                return &row;
    }
    return nullptr;
}

} // namespace detail
FBXSDK_NAMESPACE_END
