// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <fbxsdk/FbxCollection.h>

FBXSDK_NAMESPACE_BEGIN

/// The unit of import and export. Scenes are the only documents.
class FBXSDK_DLL FbxDocument : public FbxCollection {
    FBXSDK_OBJECT_DECLARE(FbxDocument, FbxCollection)

public:
    /// The name of the stack that the document's application had active; for information.
    FbxPropertyT<FbxString> ActiveAnimStackName;
};

FBXSDK_NAMESPACE_END
