// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Node attributes, and the list of each attribute's nodes.
#include <fbxsdk/FbxNodeAttribute.h>

#include <algorithm>

#include <fbxsdk/FbxNode.h>

#include "object/ManagerData.h"
#include "schema/Schema.h"

FBXSDK_NAMESPACE_BEGIN

FBXSDK_OBJECT_IMPLEMENT(FbxNodeAttribute, FbxObject, detail::kNodeAttributeRows)

const char* const FbxNodeAttribute::sColor = "Color";
const FbxDouble3 FbxNodeAttribute::sDefaultColor(0.8, 0.8, 0.8);

FbxNodeAttribute::FbxNodeAttribute(FbxManager& pManager, const detail::ClassInfo& pInfo)
    : FbxObject(pManager, pInfo), Color(detail::bindProperty<FbxDouble3>(*this, "Color")) {}

FbxNodeAttribute::~FbxNodeAttribute() = default;

FbxNodeAttribute::EType FbxNodeAttribute::GetAttributeType() const { return eUnknown; }

int FbxNodeAttribute::GetNodeCount() const { return static_cast<int>(mNodes.size()); }

FbxNode* FbxNodeAttribute::GetNode(int pIndex) const {
    const auto place = static_cast<std::size_t>(pIndex);
    return pIndex >= 0 && place < mNodes.size() ? mNodes[place] : nullptr;
}

void FbxNodeAttribute::connectionChanged(FbxObject& pSource, FbxObject& pDestination, bool pConnected) {
    auto* node = FbxCast<FbxNode>(&pDestination);
    if (&pSource != this || !node)
        return;
    if (pConnected) {
        mNodes.push_back(node);
        return;
    }
    // Connections are mostly removed in reverse order.
    const auto found = std::find(mNodes.rbegin(), mNodes.rend(), node);
    if (found != mNodes.rend())
        mNodes.erase(std::next(found).base());
}

FBXSDK_NAMESPACE_END
