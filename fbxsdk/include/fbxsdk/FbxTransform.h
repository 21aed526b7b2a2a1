// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <fbxsdk/FbxArch.h>

FBXSDK_NAMESPACE_BEGIN

/// How a node's transform inherits its parent's.
class FBXSDK_DLL FbxTransform {
public:
    /// Where the parent's scaling (S) is applied relative to the child's rotation (r) and scaling (s).
    enum EInheritType {
        eInheritRrSs = 0, ///< after the child's rotation, along the child's axes
        eInheritRSrs = 1, ///< before it: the plain product of the matrices
        eInheritRrs = 2   ///< the parent's own scaling is excluded
    };
};

FBXSDK_NAMESPACE_END
