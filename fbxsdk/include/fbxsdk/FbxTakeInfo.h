// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <fbxsdk/FbxString.h>
#include <fbxsdk/FbxTime.h>

FBXSDK_NAMESPACE_BEGIN

/// What a file states about one of its animation stacks, before anything is imported. Changing it has no effect on
/// Import.
class FBXSDK_DLL FbxTakeInfo {
public:
    /// The meaning of mImportOffset; of no effect here.
    enum EImportOffsetType {
        eAbsolute, ///< the stack begins there
        eRelative  ///< the stack is moved by it
    };

    FbxString mName,                                 ///< of the stack, UTF-8
        mImportName,                                 ///< the same name
        mDescription;                                ///< of files from 7.0 on; usually empty
    bool mSelect = true;                             ///< true for every stack: all are imported
    FbxTimeSpan mLocalTimeSpan,                      ///< as the file states it; from zero to zero when it does not
        mReferenceTimeSpan;                          ///< as the file states it; from zero to zero when it does not
    FbxTime mImportOffset;                           ///< zero; of no effect here
    EImportOffsetType mImportOffsetType = eAbsolute; ///< of no effect here
};

FBXSDK_NAMESPACE_END
