// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Converting a scene from one unit to another: the nodes below the root are scaled, so that every global matrix is the
// old one times the factor, and what is measured in scene units but not moved by a node follows.
#include <vector>

#include <fbxsdk/FbxAnimLayer.h>
#include <fbxsdk/FbxAnimStack.h>
#include <fbxsdk/FbxCamera.h>
#include <fbxsdk/FbxNode.h>
#include <fbxsdk/FbxScene.h>
#include <fbxsdk/FbxSystemUnit.h>

#include "scene/AnimatedValues.h"
#include "scene/ClusterBinding.h"
#include "scene/SceneMembers.h"

FBXSDK_NAMESPACE_BEGIN
namespace {

using detail::scaleAnimated;

FbxVector4 multiplied(const FbxVector4& vector, double factor) {
    return {vector[0] * factor, vector[1] * factor, vector[2] * factor, 1.0};
}

/// Of layers that multiply scales only the base carries the unit's factor: every further one would apply it again.
bool carriesFactor(const FbxAnimLayer* layer) {
    if (!layer)
        return true;
    const FbxAnimStack* stack = layer->GetDstObject<FbxAnimStack>();
    const bool base = stack && stack->GetMember<FbxAnimLayer>(0) == layer;
    const bool additive = layer->BlendMode.Get() == FbxAnimLayer::eBlendAdditive;
    return base || !additive || layer->ScaleAccumulationMode.Get() != FbxAnimLayer::eScaleMultiply;
}

/// Scaling S becomes k S. The scaling offset takes up what the pivot would move: k Soff + (k - 1) Sp.
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

/// A node that leaves its parent's scaling out would lose the factor with it, so it is scaled itself; its position,
/// which lies in the parent's space, has the factor already, and the offset keeps its scaling pivot from moving it.
void scaleIndependent(FbxNode& node, double k) {
    constexpr auto kSet = FbxNode::eSourcePivot;
    FbxVector4 offset = node.GetScalingOffset(kSet);
    const FbxVector4 pivot = node.GetScalingPivot(kSet);
    const FbxDouble3 scaling = node.LclScaling.Get();
    for (int i = 0; i < 3; ++i)
        offset[i] += (k - 1.0) * scaling[i] * pivot[i];
    node.SetScalingOffset(kSet, offset);
    scaleAnimated(node.LclScaling, k, carriesFactor);
}

void scaleNodes(FbxNode& root, double k, bool convertIndependent) {
    std::vector<FbxNode*> converted;
    for (int i = 0; i < root.GetChildCount(); ++i) {
        scaleFirstLevel(*root.GetChild(i), k);
        converted.push_back(root.GetChild(i));
    }
    while (convertIndependent && !converted.empty()) {
        FbxNode* parent = converted.back();
        converted.pop_back();
        for (int i = 0; i < parent->GetChildCount(); ++i) {
            FbxNode* child = parent->GetChild(i);
            if (!ignoresParentScale(*child))
                continue;
            scaleIndependent(*child, k);
            converted.push_back(child);
        }
    }
}

void scaleCameraPlanes(FbxScene& scene, double k) {
    for (FbxCamera* camera : detail::sourcesOf<FbxCamera>(scene)) {
        for (const char* plane : {"NearPlane", "FarPlane", "BackPlaneDistance", "FrontPlaneDistance"}) {
            scaleAnimated(camera->FindProperty(plane), k);
        }
    }
}

void scaleLimits(FbxNode& root, double k) {
    for (int i = 0; i < root.GetChildCount(); ++i) {
        for (const char* limit : {"TranslationMin", "TranslationMax", "ScalingMin", "ScalingMax"}) {
            FbxProperty property = root.GetChild(i)->FindProperty(limit);
            FbxDouble3 value = property.Get<FbxDouble3>();
            for (int component = 0; component < 3; ++component)
                value[component] *= k;
            property.Set(value);
        }
    }
}

} // namespace

void FbxSystemUnit::ConvertChildren(FbxNode* pRoot, const FbxSystemUnit& pSrcUnit,
                                    const ConversionOptions& pOptions) const {
    const double k = pSrcUnit.GetConversionFactorTo(*this);
    if (!pRoot || !(k > 0.0) || k == 1.0)
        return;
    scaleNodes(*pRoot, k, pOptions.mConvertRrsNodes);
    if (pOptions.mConvertLimits)
        scaleLimits(*pRoot, k);
}

void FbxSystemUnit::ConvertScene(FbxScene* pScene, FbxNode* pFbxRoot, const ConversionOptions& pOptions) const {
    if (!pScene)
        return;
    FbxGlobalSettings& settings = pScene->GetGlobalSettings();
    const FbxSystemUnit source = settings.GetSystemUnit();
    const double k = source.GetConversionFactorTo(*this);
    if (!(k > 0.0) || source == *this)
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
