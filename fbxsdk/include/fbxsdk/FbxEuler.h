// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <fbxsdk/FbxArch.h>

FBXSDK_NAMESPACE_BEGIN

/// The orders in which three angles about the axes are applied.
class FBXSDK_DLL FbxEuler {
public:
    /// The letters are in the order of application: eOrderXYZ turns about X first, then Y, then Z. The numbers are
    /// those of files.
    enum EOrder : int {
        eOrderXYZ = 0,   ///< the order of matrices, and of nodes whose rotation is not active
        eOrderXZY,       ///< X, Z, Y
        eOrderYZX,       ///< Y, Z, X
        eOrderYXZ,       ///< Y, X, Z
        eOrderZXY,       ///< Z, X, Y
        eOrderZYX,       ///< Z, Y, X
        eOrderSphericXYZ ///< evaluated as X, Y, Z
    };
};

/// The same type under the name that FbxNode uses.
typedef FbxEuler::EOrder EFbxRotationOrder;

inline constexpr EFbxRotationOrder eEulerXYZ = FbxEuler::eOrderXYZ; ///< The same as FbxEuler::eOrderXYZ.
inline constexpr EFbxRotationOrder eEulerXZY = FbxEuler::eOrderXZY; ///< The same as FbxEuler::eOrderXZY.
inline constexpr EFbxRotationOrder eEulerYZX = FbxEuler::eOrderYZX; ///< The same as FbxEuler::eOrderYZX.
inline constexpr EFbxRotationOrder eEulerYXZ = FbxEuler::eOrderYXZ; ///< The same as FbxEuler::eOrderYXZ.
inline constexpr EFbxRotationOrder eEulerZXY = FbxEuler::eOrderZXY; ///< The same as FbxEuler::eOrderZXY.
inline constexpr EFbxRotationOrder eEulerZYX = FbxEuler::eOrderZYX; ///< The same as FbxEuler::eOrderZYX.
/// The same as FbxEuler::eOrderSphericXYZ.
inline constexpr EFbxRotationOrder eSphericXYZ = FbxEuler::eOrderSphericXYZ;

FBXSDK_NAMESPACE_END
