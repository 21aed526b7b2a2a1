// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include <fbxsdk/FbxCameraSwitcher.h>

#include "object/ManagerData.h"
#include "schema/Schema.h"

FBXSDK_NAMESPACE_BEGIN

FBXSDK_OBJECT_IMPLEMENT(FbxCameraSwitcher, FbxNodeAttribute, detail::kCameraSwitcherRows)

FbxCameraSwitcher::FbxCameraSwitcher(FbxManager& pManager, const detail::ClassInfo& pInfo)
    : FbxNodeAttribute(pManager, pInfo), CameraIndex(detail::bindProperty<FbxInt>(*this, "Camera Index")) {}

FbxCameraSwitcher::~FbxCameraSwitcher() = default;

FbxNodeAttribute::EType FbxCameraSwitcher::GetAttributeType() const { return eCameraSwitcher; }

FBXSDK_NAMESPACE_END
