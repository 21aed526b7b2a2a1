// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Documents: a collection with the name of the active stack.
#include <fbxsdk/FbxDocument.h>

#include "object/ManagerData.h"
#include "scene/SceneData.h"

FBXSDK_NAMESPACE_BEGIN

namespace detail {
constinit const PropertyRow kDocumentTable[] = {{"ActiveAnimStackName", &FbxStringDT, ""}};
}

FBXSDK_OBJECT_IMPLEMENT(FbxDocument, FbxCollection, detail::kDocumentRows)

FbxDocument::FbxDocument(FbxManager& pManager, const detail::ClassInfo& pInfo)
    : FbxCollection(pManager, pInfo),
      ActiveAnimStackName(detail::bindProperty<FbxString>(*this, "ActiveAnimStackName")) {}
FbxDocument::~FbxDocument() = default;

FbxDocument* FbxObject::GetDocument() const { return mData->scene; }

FBXSDK_NAMESPACE_END
