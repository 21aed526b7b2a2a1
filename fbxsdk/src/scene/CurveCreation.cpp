// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include <string_view>

#include <fbxsdk/FbxAnimCurve.h>
#include <fbxsdk/FbxAnimCurveNode.h>
#include <fbxsdk/FbxAnimLayer.h>
#include <fbxsdk/FbxScene.h>

#include "schema/PropertyTypes.h"

FBXSDK_NAMESPACE_BEGIN
namespace {

/// The channels of a property: one per number, up to four; none for text and references.
int channelCount(EFbxType type) {
    switch (type) {
    case eFbxUndefined:
    case eFbxDouble4x4:
    case eFbxString:
    case eFbxTime:
    case eFbxReference:
    case eFbxBlob:
    case eFbxDateTime:
    case eFbxEnumM:
    case eFbxTypeCount:
        return 0;
    default:
        return static_cast<int>(detail::componentCount(type));
    }
}

/// Files name the curve nodes of the three transform properties by a letter.
const char* curveNodeName(const char* propertyName) {
    constexpr struct {
        std::string_view property;
        const char* node;
    } kNames[] = {{"Lcl Translation", "T"}, {"Lcl Rotation", "R"}, {"Lcl Scaling", "S"}};
    for (const auto& row : kNames)
        if (row.property == propertyName)
            return row.node;
    return propertyName;
}

} // namespace

FbxAnimCurve* FbxAnimCurve::Create(FbxScene* pContainer, const char* pName) {
    return Create(static_cast<FbxObject*>(pContainer), pName);
}

FbxAnimCurveNode* FbxAnimCurveNode::CreateTypedCurveNode(FbxProperty& pProperty, FbxScene* pScene) {
    if (!pProperty.IsValid())
        return nullptr;
    const int count = channelCount(pProperty.GetPropertyDataType().GetType());
    if (count == 0)
        return nullptr;
    const char* name = curveNodeName(pProperty.GetNameAsCStr());
    FbxAnimCurveNode* node = pScene ? Create(pScene, name) : Create(pProperty.GetFbxObject()->GetFbxManager(), name);
    if (count == 1) {
        node->addChannel(pProperty.GetNameAsCStr(), pProperty.Get<FbxDouble>());
        return node;
    }
    const FbxDouble4 value = pProperty.Get<FbxDouble4>();
    constexpr const char* kComponents[] = {"X", "Y", "Z", "W"};
    for (int i = 0; i < count; ++i)
        node->addChannel(kComponents[i], value[i]);
    return node;
}

FbxAnimCurveNode* FbxAnimLayer::CreateCurveNode(FbxProperty& pProperty) {
    if (FbxAnimCurveNode* existing = pProperty.GetCurveNode(this, false))
        return existing;
    // Regardless of the flags: hosts key the film and the planes of cameras, which are not marked as animatable.
    FbxAnimCurveNode* node = FbxAnimCurveNode::CreateTypedCurveNode(pProperty, GetScene());
    if (!node)
        return nullptr;
    AddMember(node);
    pProperty.ConnectSrcObject(node);
    return node;
}

FBXSDK_NAMESPACE_END
