// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// What a file says of one take.
#pragma once

#include <fbxsdk/FbxString.h>
#include <fbxsdk/FbxTime.h>

FBXSDK_NAMESPACE_BEGIN

class FBXSDK_DLL FbxTakeInfo {
public:
    enum EImportOffsetType { eAbsolute, eRelative };

    FbxString mName, mImportName, mDescription;
    bool mSelect = true;
    FbxTimeSpan mLocalTimeSpan, mReferenceTimeSpan;
    FbxTime mImportOffset;
    EImportOffsetType mImportOffsetType = eAbsolute;
};

FBXSDK_NAMESPACE_END
