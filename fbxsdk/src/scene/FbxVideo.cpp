// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include <fbxsdk/FbxVideo.h>

#include "object/ManagerData.h"
#include "schema/Schema.h"

FBXSDK_NAMESPACE_BEGIN

FBXSDK_OBJECT_IMPLEMENT(FbxVideo, FbxObject, detail::kVideoRows)

FbxVideo::FbxVideo(FbxManager& pManager, const detail::ClassInfo& pInfo)
    : FbxObject(pManager, pInfo), mPath(detail::bindProperty<FbxString>(*this, "Path")),
      mRelativePath(detail::bindProperty<FbxString>(*this, "RelPath")) {}

FbxVideo::~FbxVideo() = default;

void FbxVideo::SetFileName(const char* pName) { mPath.Set(FbxString(pName)); }

FbxString FbxVideo::GetFileName() const { return mPath.Get(); }

void FbxVideo::SetRelativeFileName(const char* pName) { mRelativePath.Set(FbxString(pName)); }

FbxString FbxVideo::GetRelativeFileName() const { return mRelativePath.Get(); }

FBXSDK_NAMESPACE_END
