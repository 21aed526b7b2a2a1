// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// How names are changed on export. The platform leaves them as they are, whatever is asked for.
#pragma once

#include <fbxsdk/FbxArch.h>

FBXSDK_NAMESPACE_BEGIN

class FBXSDK_DLL FbxSceneRenamer {
public:
    enum ERenamingMode {
        eNone,
        eMAYA_TO_FBX5,
        eMAYA_TO_FBX_MB75,
        eMAYA_TO_FBX_MB70,
        eFBXMB75_TO_FBXMB70,
        eFBX_TO_FBX,
        eMAYA_TO_FBX,
        eFBX_TO_MAYA
    };
};

FBXSDK_NAMESPACE_END
