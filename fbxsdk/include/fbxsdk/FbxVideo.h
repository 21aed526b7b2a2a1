// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The image or clip behind a texture.
#pragma once

#include <fbxsdk/FbxObject.h>

FBXSDK_NAMESPACE_BEGIN

/// Names are stored as given; no file is touched.
class FBXSDK_DLL FbxVideo : public FbxObject {
    FBXSDK_OBJECT_DECLARE(FbxVideo, FbxObject)

public:
    void SetFileName(const char* pName);
    [[nodiscard]] FbxString GetFileName() const;
    void SetRelativeFileName(const char* pName);
    [[nodiscard]] FbxString GetRelativeFileName() const;
    [[nodiscard]] bool GetImageTextureMipMap() const { return mMipMap; }
    void ImageTextureSetMipMap(bool pUseMipMap) { mMipMap = pUseMipMap; }

private:
    FbxPropertyT<FbxString> mPath, mRelativePath;
    bool mMipMap = false;
};

FBXSDK_NAMESPACE_END
