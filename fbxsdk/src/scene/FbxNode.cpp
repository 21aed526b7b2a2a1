// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Nodes: hierarchy, attributes, targets and materials. Connections are authoritative; the vectors cache them, so that
// access by index needs no search.
#include <fbxsdk/FbxNode.h>

#include <algorithm>
#include <string_view>

#include <fbxsdk/FbxCamera.h>
#include <fbxsdk/FbxLight.h>
#include <fbxsdk/FbxMarker.h>
#include <fbxsdk/FbxNull.h>
#include <fbxsdk/FbxSkeleton.h>
#include <fbxsdk/FbxSurfaceMaterial.h>

#include "object/ManagerData.h"
#include "scene/NodeEvaluation.h"
#include "scene/NodePivots.h"
#include "scene/NodeTree.h"
#include "schema/Schema.h"

FBXSDK_NAMESPACE_BEGIN

FBXSDK_OBJECT_IMPLEMENT(FbxNode, FbxObject, detail::kNodeRows)

namespace {

/// Indices of frequently used rows, looked up once.
struct NodeRows {
    int translation = detail::rowIndex(detail::kNodeRows, "Lcl Translation");
    int rotation = detail::rowIndex(detail::kNodeRows, "Lcl Rotation");
    int scaling = detail::rowIndex(detail::kNodeRows, "Lcl Scaling");
    int visibility = detail::rowIndex(detail::kNodeRows, "Visibility");
    int defaultAttribute = detail::rowIndex(detail::kNodeRows, "DefaultAttributeIndex");
    int target = detail::rowIndex(detail::kNodeRows, "LookAtProperty");
    int targetUp = detail::rowIndex(detail::kNodeRows, "UpVectorProperty");
};

const NodeRows& nodeRows() {
    static const NodeRows rows;
    return rows;
}

FbxProperty propertyOf(const FbxNode& node, int row) { return {const_cast<FbxNode*>(&node), row}; }

/// Null out of range.
template <class T>
T* at(const std::vector<T*>& objects, int index) {
    const auto place = static_cast<std::size_t>(index);
    return index >= 0 && place < objects.size() ? objects[place] : nullptr;
}

/// -1 when it is not in the list.
template <class T>
int indexIn(const std::vector<T*>& objects, const T* object) {
    const auto found = std::find(objects.begin(), objects.end(), object);
    return found == objects.end() ? -1 : static_cast<int>(found - objects.begin());
}

/// Removes the object. Connections are mostly removed in reverse order, so the search starts at the end.
template <class T>
void takeOut(std::vector<T*>& objects, const T* object) {
    const auto found = std::find(objects.rbegin(), objects.rend(), object);
    if (found != objects.rend())
        objects.erase(std::next(found).base());
}

template <class T>
void keepInStep(std::vector<T*>& objects, FbxObject& source, bool connected) {
    T* object = FbxCast<T>(&source);
    if (!object)
        return;
    if (connected)
        objects.push_back(object);
    else
        takeOut(objects, object);
}

void setOnlyNode(FbxProperty property, FbxNode* node) {
    while (auto* former = property.GetSrcObject<FbxNode>())
        if (!property.DisconnectSrcObject(former))
            break;
    if (node)
        property.ConnectSrcObject(node);
}

} // namespace

FbxNode::FbxNode(FbxManager& pManager, const detail::ClassInfo& pInfo)
    : FbxObject(pManager, pInfo), LclTranslation(propertyOf(*this, nodeRows().translation)),
      LclRotation(propertyOf(*this, nodeRows().rotation)), LclScaling(propertyOf(*this, nodeRows().scaling)),
      Visibility(propertyOf(*this, nodeRows().visibility)) {}

FbxNode::~FbxNode() {
    detail::ManagerData& manager = GetFbxManager()->data();
    if (mEvaluation && manager.evaluationBudget && !manager.tearingDown)
        manager.evaluationBudget->release(*mEvaluation);
}

detail::NodeEvaluation& FbxNode::evaluation() {
    if (!mEvaluation)
        mEvaluation = std::make_unique<detail::NodeEvaluation>();
    return *mEvaluation;
}

void FbxNode::connectionChanged(FbxObject& pSource, FbxObject& pDestination, bool pConnected) {
    // Both ends are notified; the destination updates the lists of both.
    if (&pDestination != this)
        return;
    if (auto* child = FbxCast<FbxNode>(&pSource)) {
        pConnected ? childConnected(*child) : childDisconnected(*child);
    } else {
        keepInStep(mAttributes, pSource, pConnected);
        keepInStep(mMaterials, pSource, pConnected);
    }
}

void FbxNode::childConnected(FbxNode& child) {
    if (child.mParent == this)
        return;
    if (detail::isAtOrBelow(child, *this)) {
        DisconnectSrcObject(&child);
        return;
    }
    FbxNode* former = child.mParent;
    child.mParent = this;
    mChildren.push_back(&child);
    if (former)
        former->DisconnectSrcObject(&child);
}

void FbxNode::childDisconnected(FbxNode& child) {
    takeOut(mChildren, &child);
    if (child.mParent == this)
        child.mParent = nullptr;
}

bool FbxNode::AddChild(FbxNode* pNode) {
    if (!pNode)
        return false;
    ConnectSrcObject(pNode);
    return pNode->mParent == this; // unless it would have come below itself
}

FbxNode* FbxNode::RemoveChild(FbxNode* pNode) {
    if (!pNode || pNode->mParent != this)
        return nullptr;
    DisconnectSrcObject(pNode);
    return pNode;
}

int FbxNode::GetChildCount(bool pRecursive) const {
    if (!pRecursive)
        return static_cast<int>(mChildren.size());
    int count = 0;
    detail::NodesBelow<const FbxNode> below(*this);
    while (below.next())
        ++count;
    return count;
}

FbxNode* FbxNode::GetChild(int pIndex) { return at(mChildren, pIndex); }

const FbxNode* FbxNode::GetChild(int pIndex) const { return at(mChildren, pIndex); }

FbxNode* FbxNode::FindChild(const char* pName, bool pRecursive, bool) {
    if (!pName)
        return nullptr;
    const std::string_view name = pName;
    if (!pRecursive) {
        const auto found =
            std::find_if(mChildren.begin(), mChildren.end(), [&](FbxNode* child) { return child->GetName() == name; });
        return found == mChildren.end() ? nullptr : *found;
    }
    detail::NodesBelow<FbxNode> below(*this);
    while (FbxNode* node = below.next())
        if (node->GetName() == name)
            return node;
    return nullptr;
}

FbxNodeAttribute* FbxNode::SetNodeAttribute(FbxNodeAttribute* pNodeAttribute) {
    FbxNodeAttribute* previous = GetNodeAttribute();
    if (previous && previous != pNodeAttribute)
        DisconnectSrcObject(previous);
    if (pNodeAttribute)
        ConnectSrcObject(pNodeAttribute);
    propertyOf(*this, nodeRows().defaultAttribute).Set(indexIn(mAttributes, pNodeAttribute));
    return previous;
}

const FbxNodeAttribute* FbxNode::GetNodeAttribute() const {
    if (mAttributes.size() <= 1)
        return mAttributes.empty() ? nullptr : mAttributes.front();
    const FbxNodeAttribute* chosen = at(mAttributes, propertyOf(*this, nodeRows().defaultAttribute).Get<FbxInt>());
    return chosen ? chosen : mAttributes.front();
}

FbxNodeAttribute* FbxNode::GetNodeAttribute() {
    return const_cast<FbxNodeAttribute*>(std::as_const(*this).GetNodeAttribute());
}

int FbxNode::GetNodeAttributeCount() const { return static_cast<int>(mAttributes.size()); }

FbxNodeAttribute* FbxNode::GetNodeAttributeByIndex(int pIndex) { return at(mAttributes, pIndex); }

const FbxNodeAttribute* FbxNode::GetNodeAttributeByIndex(int pIndex) const { return at(mAttributes, pIndex); }

FbxCamera* FbxNode::GetCamera() { return FbxCast<FbxCamera>(GetNodeAttribute()); }
FbxLight* FbxNode::GetLight() { return FbxCast<FbxLight>(GetNodeAttribute()); }
FbxNull* FbxNode::GetNull() { return FbxCast<FbxNull>(GetNodeAttribute()); }
FbxMarker* FbxNode::GetMarker() { return FbxCast<FbxMarker>(GetNodeAttribute()); }
FbxSkeleton* FbxNode::GetSkeleton() { return FbxCast<FbxSkeleton>(GetNodeAttribute()); }

void FbxNode::SetTarget(FbxNode* pNode) { setOnlyNode(propertyOf(*this, nodeRows().target), pNode); }

FbxNode* FbxNode::GetTarget() const { return propertyOf(*this, nodeRows().target).GetSrcObject<FbxNode>(); }

void FbxNode::SetTargetUp(FbxNode* pNode) { setOnlyNode(propertyOf(*this, nodeRows().targetUp), pNode); }

FbxNode* FbxNode::GetTargetUp() const { return propertyOf(*this, nodeRows().targetUp).GetSrcObject<FbxNode>(); }

int FbxNode::AddMaterial(FbxSurfaceMaterial* pMaterial) {
    if (!pMaterial)
        return -1;
    ConnectSrcObject(pMaterial);
    return indexIn(mMaterials, pMaterial);
}

int FbxNode::GetMaterialCount() const { return static_cast<int>(mMaterials.size()); }

FbxSurfaceMaterial* FbxNode::GetMaterial(int pIndex) const { return at(mMaterials, pIndex); }

FBXSDK_NAMESPACE_END
