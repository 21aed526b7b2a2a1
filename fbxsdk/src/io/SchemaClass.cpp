// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include "io/SchemaClass.h"

#include "schema/Schema.h"
#include "schema/Spellings.h"
#include "schema/SubClasses.h"

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

    {"NodeAttribute", SubClass::kNull, "NodeAttribute", &kFbxNullInfo, kNullRows},
    {"NodeAttribute", kSkeletonTypes[2], "NodeAttribute", &kFbxSkeletonInfo, kSkeletonRows},
    {"NodeAttribute", kSkeletonTypes[1], "NodeAttribute", &kFbxSkeletonInfo, kSkeletonRows},
    {"NodeAttribute", kSkeletonTypes[0], "NodeAttribute", &kFbxSkeletonInfo, kSkeletonRows},
    {"NodeAttribute", kSkeletonTypes[3], "NodeAttribute", &kFbxSkeletonInfo, kSkeletonRows},
    {"NodeAttribute", SubClass::kCamera, "NodeAttribute", &kFbxCameraInfo, kCameraRows},
    {"NodeAttribute", SubClass::kCameraStereo, "NodeAttribute", &kFbxCameraStereoInfo, kCameraStereoRows},
    {"NodeAttribute", SubClass::kCameraSwitcher, "NodeAttribute", &kFbxCameraSwitcherInfo, kCameraSwitcherRows},
    {"NodeAttribute", SubClass::kLight, "NodeAttribute", &kFbxLightInfo, kLightRows},
    {"NodeAttribute", kMarkerTypes[0], "NodeAttribute", &kFbxMarkerInfo, kMarkerRows},
    {"NodeAttribute", kMarkerTypes[1], "NodeAttribute", &kFbxMarkerInfo, kMarkerRows},
    {"NodeAttribute", kMarkerTypes[2], "NodeAttribute", &kFbxMarkerInfo, kMarkerRows},
    {"NodeAttribute", kMarkerTypes[3], "NodeAttribute", &kFbxMarkerInfo, kMarkerRows},
    {"NodeAttribute", SubClass::kLodGroup, "NodeAttribute", &kFbxLODGroupInfo, kLodGroupRows},
    {"NodeAttribute", SubClass::kOpticalReference, "NodeAttribute", &kFbxOpticalReferenceInfo, kNodeAttributeRows},
    {"NodeAttribute", SubClass::kCachedEffect, "NodeAttribute", &kFbxCachedEffectInfo, kNodeAttributeRows},
    {"NodeAttribute", kAny, "NodeAttribute", &kFbxNodeAttributeInfo, kNodeAttributeRows},

    {"Geometry", SubClass::kMesh, "Geometry", &kFbxMeshInfo, kMeshRows},
    {"Geometry", SubClass::kShape, "Geometry", &kFbxShapeInfo, kMeshRows},
    {"Geometry", SubClass::kNurbsSurface, "Geometry", &kFbxNurbsSurfaceInfo, kMeshRows},
    {"Geometry", SubClass::kNurbsCurve, "Geometry", &kFbxNurbsCurveInfo, kMeshRows},
    {"Geometry", SubClass::kTrimNurbsSurface, "Geometry", &kFbxTrimNurbsSurfaceInfo, kMeshRows},
    {"Geometry", SubClass::kBoundary, "Geometry", &kFbxBoundaryInfo, kMeshRows},
    {"Geometry", SubClass::kNurb, "Geometry", &kFbxNurbsInfo, kMeshRows},
    {"Geometry", SubClass::kPatch, "Geometry", &kFbxPatchInfo, kMeshRows},
    {"Geometry", SubClass::kLine, "Geometry", &kFbxLineInfo, kLineRows},

    {"Deformer", SubClass::kSkin, "Deformer", &kFbxSkinInfo, kNoRows},
    {"Deformer", SubClass::kCluster, "SubDeformer", &kFbxClusterInfo, kNoRows},
    {"Deformer", SubClass::kBlendShape, "Deformer", &kFbxBlendShapeInfo, kNoRows},
    {"Deformer", SubClass::kBlendShapeChannel, "SubDeformer", &kFbxBlendShapeChannelInfo, kNoRows},
    {"Deformer", SubClass::kVertexCacheDeformer, "Deformer", &kFbxVertexCacheDeformerInfo, kVertexCacheDeformerRows},
    {"Cache", kAny, "Cache", &kFbxCacheInfo, kCacheRows},

    {"Material", kAny, "Material", &kFbxSurfaceMaterialInfo, kMaterialRows},
    {"Material", kAny, "Material", &kFbxSurfaceLambertInfo, kLambertRows},
    {"Material", kAny, "Material", &kFbxSurfacePhongInfo, kPhongRows},
    {"Texture", kAny, "Texture", &kFbxFileTextureInfo, kFileTextureRows},
    {"LayeredTexture", kAny, "LayeredTexture", &kFbxLayeredTextureInfo, kLayeredTextureRows},
    {"Video", SubClass::kClip, "Video", &kFbxVideoInfo, kVideoRows},
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
