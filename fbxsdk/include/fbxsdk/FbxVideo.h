// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <fbxsdk/FbxObject.h>

FBXSDK_NAMESPACE_BEGIN

/// An image or clip of textures: a source of theirs. Names are stored as given, UTF-8; no file is accessed.
class FBXSDK_DLL FbxVideo : public FbxObject {
    FBXSDK_OBJECT_DECLARE(FbxVideo, FbxObject)

public:
    void SetFileName(const char* pName);                 ///< In files the property Path; null is the empty name.
    [[nodiscard]] FbxString GetFileName() const;         ///< Empty by default.
    void SetRelativeFileName(const char* pName);         ///< In files the property RelPath; null is the empty name.
    [[nodiscard]] FbxString GetRelativeFileName() const; ///< Empty by default.
    [[nodiscard]] bool GetImageTextureMipMap() const { return mMipMap; } ///< False by default.
    void ImageTextureSetMipMap(bool pUseMipMap) {
        mMipMap = pUseMipMap;
    } ///< Kept in memory; files are written with false.

private:
    FbxPropertyT<FbxString> mPath, mRelativePath;
    bool mMipMap = false;
};

FBXSDK_NAMESPACE_END
