// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <fbxsdk/FbxArch.h>

FBXSDK_NAMESPACE_BEGIN

/// How names are changed on export. The platform leaves them unchanged in every mode.
class FBXSDK_DLL FbxSceneRenamer {
public:
    /// From which program's rules to which; none of them renames anything here.
    enum ERenamingMode {
        eNone,               ///< unchanged
        eMAYA_TO_FBX5,       ///< Maya to FBX 5
        eMAYA_TO_FBX_MB75,   ///< Maya to MotionBuilder 7.5
        eMAYA_TO_FBX_MB70,   ///< Maya to MotionBuilder 7.0
        eFBXMB75_TO_FBXMB70, ///< MotionBuilder 7.5 to 7.0
        eFBX_TO_FBX,         ///< FBX to FBX
        eMAYA_TO_FBX,        ///< Maya to FBX
        eFBX_TO_MAYA         ///< FBX to Maya
    };
};

FBXSDK_NAMESPACE_END
