// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Converting a scene from one unit to another: the nodes below the root are scaled, so that every global matrix is the
// old one times the factor, and quantities in scene units that do not follow a node are scaled as well.
#include <cmath>
#include <initializer_list>
#include <vector>

#include <fbxsdk/FbxAnimLayer.h>
#include <fbxsdk/FbxAnimStack.h>
#include <fbxsdk/FbxCamera.h>
#include <fbxsdk/FbxNode.h>
#include <fbxsdk/FbxScene.h>
#include <fbxsdk/FbxSystemUnit.h>

#include "conversion/AnimatedValues.h"
#include "conversion/ClusterBinding.h"
#include "object/SceneMembers.h"

FBXSDK_NAMESPACE_BEGIN
namespace {

using detail::scaleAnimated;

/// Whether a scene can be multiplied by the factor; not so when one of the units is invalid.
bool isFactor(double k) { return k > 0.0 && std::isfinite(k); }

FbxVector4 multiplied(const FbxVector4& vector, double factor) {
    return {vector[0] * factor, vector[1] * factor, vector[2] * factor, 1.0};
}

/// Of layers that multiply scales only the base gets the unit's factor: every further one would apply it again.
bool carriesFactor(const FbxAnimLayer* layer) {
    if (!layer)
        return true;
    const FbxAnimStack* stack = layer->GetDstObject<FbxAnimStack>();
    const bool base = stack && stack->GetMember<FbxAnimLayer>(0) == layer;
    const bool additive =
        layer->BlendMode.Get() == FbxAnimLayer::eBlendAdditive && !layer->GetBlendModeBypass(eFbxDouble3);
    return base || !additive || layer->ScaleAccumulationMode.Get() != FbxAnimLayer::eScaleMultiply;
}

/// Scaling S becomes k S. The scaling offset compensates for the pivot: k Soff + (k - 1) Sp.
void scaleFirstLevel(FbxNode& node, double k) {
    constexpr auto kSet = FbxNode::eSourcePivot;
    scaleAnimated(node.LclTranslation, k);
    scaleAnimated(node.LclScaling, k, carriesFactor);
    node.SetRotationOffset(kSet, multiplied(node.GetRotationOffset(kSet), k));
    node.SetRotationPivot(kSet, multiplied(node.GetRotationPivot(kSet), k));
    FbxVector4 offset = multiplied(node.GetScalingOffset(kSet), k);
    const FbxVector4 pivot = node.GetScalingPivot(kSet);
    for (int i = 0; i < 3; ++i)
        offset[i] += (k - 1.0) * pivot[i];
    node.SetScalingOffset(kSet, offset);
}

bool ignoresParentScale(const FbxNode& node) {
    FbxTransform::EInheritType inherit = FbxTransform::eInheritRrSs;
    node.GetTransformationInheritType(inherit);
    return inherit == FbxTransform::eInheritRrs;
}

/// A node that does not inherit its parent's scaling would not inherit the factor either, so it is scaled itself. Its
/// position, which is in the parent's space, has the factor already: the pivot is divided by the factor, so that S Sp
/// stays the same at every time, and the offset compensates for the pivot.
void scaleIndependent(FbxNode& node, double k) {
    constexpr auto kSet = FbxNode::eSourcePivot;
    FbxVector4 offset = node.GetScalingOffset(kSet);
    const FbxVector4 pivot = node.GetScalingPivot(kSet);
    for (int i = 0; i < 3; ++i)
        offset[i] += pivot[i] - pivot[i] / k;
    node.SetScalingOffset(kSet, offset);
    node.SetScalingPivot(kSet, multiplied(pivot, 1.0 / k));
    scaleAnimated(node.LclScaling, k, carriesFactor);
}

/// The children of converted nodes that do not inherit their scaling, and in turn those of these.
std::vector<FbxNode*> independentBelow(FbxNode& root) {
    std::vector<FbxNode*> converted;
    converted.reserve(static_cast<std::size_t>(root.GetChildCount()));
    for (int i = 0; i < root.GetChildCount(); ++i)
        converted.push_back(root.GetChild(i));
    const std::size_t firstLevel = converted.size();
    for (std::size_t parent = 0; parent < converted.size(); ++parent) {
        for (int i = 0; i < converted[parent]->GetChildCount(); ++i) {
            FbxNode* child = converted[parent]->GetChild(i);
            if (ignoresParentScale(*child))
                converted.push_back(child);
        }
    }
    converted.erase(converted.begin(), converted.begin() + static_cast<std::ptrdiff_t>(firstLevel));
    return converted;
}

void scaleCameraPlanes(FbxScene& scene, double k) {
    for (FbxCamera* camera : detail::sourcesOf<FbxCamera>(scene))
        for (const char* plane : {"NearPlane", "FarPlane", "BackPlaneDistance", "FrontPlaneDistance"})
            scaleAnimated(camera->FindProperty(plane), k);
}

void scaleLimits(FbxNode& node, double k, std::initializer_list<const char*> limits) {
    for (const char* limit : limits) {
        FbxProperty property = node.FindProperty(limit);
        FbxDouble3 value = property.Get<FbxDouble3>();
        for (int component = 0; component < 3; ++component)
            value[component] *= k;
        property.Set(value);
    }
}

} // namespace

void FbxSystemUnit::ConvertChildren(FbxNode* pRoot, const FbxSystemUnit& pSrcUnit,
                                    const ConversionOptions& pOptions) const {
    const double k = pSrcUnit.GetConversionFactorTo(*this);
    if (!pRoot || !isFactor(k) || k == 1.0)
        return;
    for (int i = 0; i < pRoot->GetChildCount(); ++i) {
        scaleFirstLevel(*pRoot->GetChild(i), k);
        if (pOptions.mConvertLimits)
            scaleLimits(*pRoot->GetChild(i), k, {"TranslationMin", "TranslationMax", "ScalingMin", "ScalingMax"});
    }
    if (!pOptions.mConvertRrsNodes)
        return;
    for (FbxNode* node : independentBelow(*pRoot)) {
        scaleIndependent(*node, k);
        if (pOptions.mConvertLimits)
            scaleLimits(*node, k, {"ScalingMin", "ScalingMax"});
    }
}

void FbxSystemUnit::ConvertScene(FbxScene* pScene, FbxNode* pFbxRoot, const ConversionOptions& pOptions) const {
    if (!pScene)
        return;
    FbxGlobalSettings& settings = pScene->GetGlobalSettings();
    const FbxSystemUnit source = settings.GetSystemUnit();
    const double k = source.GetConversionFactorTo(*this);
    if (!isFactor(k) || source == *this)
        return;
    ConvertChildren(pFbxRoot, source, pOptions);
    if (pOptions.mConvertClusters) {
        FbxAMatrix factor;
        factor.SetS(FbxVector4(k, k, k));
        detail::transformBindMatrices(*pScene, factor);
    }
    if (pOptions.mConvertCameraClipPlanes)
        scaleCameraPlanes(*pScene, k);
    settings.SetSystemUnit(*this);
}

void FbxSystemUnit::ConvertScene(FbxScene* pScene, const ConversionOptions& pOptions) const {
    ConvertScene(pScene, pScene ? pScene->GetRootNode() : nullptr, pOptions);
}

FBXSDK_NAMESPACE_END
